// Problems of unknown load factors with a planted answer.
#pragma once

#include "qm_solver/ulfproblem.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <random>
#include <vector>

/// What is made hard about a problem.
enum class PLANT {
    Plain,
    Degenerate,    // repeated active rows, and active rows that hold nothing
    Scaled,        // rows from 1e-9 to 1e6, weights from 1e-3 to 1e3
    NearDuplicate, // active rows that differ by 1e-7
    NoEqualities,  // code 5: contradictory equalities
    NoRows,        // code 6
    WrongSign,     // code 7
};

/// A problem with its storage, and its only answer (none for the classes without a solution).
struct T_PLANTED {
    int nVar = 0, nEq = 0, objective = 2, sign = 0;
    std::vector<double> rows, rhs, weights;
    std::vector<double> x;
    T_ULF_PROBLEM Problem() const { return {nVar, nEq, rows, rhs, weights, objective, sign}; }
};

/// Plants the conditions of Karush, Kuhn and Tucker for the linear or square objective, and for the
/// smallest square sum among its optima; the random numbers are the same on every machine.
class CUlfPlanter {
public:
    explicit CUlfPlanter(std::uint64_t seed) : m_random(seed) {}

    T_PLANTED Plant(PLANT kind, int objective, int sign, int nVar, int nCon)
    {
        m_n = static_cast<std::size_t>(nVar);
        m_sign = sign;
        const auto nAct = static_cast<std::size_t>(std::max(3, nVar / 2));
        m_eq = nAct / 3;
        Normals(nAct);
        if (objective == 1) PlantSum();
        if (objective == 2) PlantSquare();
        if (objective == 3) PlantLargest();
        std::vector<T_ROW> equal, less;
        for (std::size_t i = 0; i < nAct; ++i)
            (i < m_eq ? equal : less).push_back({m_act[i], Dot(m_act[i], m_y)});
        Harden(kind, equal, less);
        while (equal.size() + less.size() < static_cast<std::size_t>(nCon)) {
            T_ROW row{Vector(-1.0, 1.0), 0.0};
            row.b = Dot(row.a, m_y) + Uniform(0.01, 2.0) * Length(m_y);
            less.push_back(row);
        }
        Contradict(kind, equal, less);
        return Pack(kind, objective, equal, less);
    }
    double Uniform(double low, double high)
    {
        return low + (high - low) * static_cast<double>(m_random() >> 11) * 0x1p-53;
    }
    std::size_t Below(std::size_t n) { return static_cast<std::size_t>(m_random() % n); }

private:
    using T_VECTOR = std::vector<double>;
    struct T_ROW {
        T_VECTOR a;
        double b;
    };
    T_VECTOR Vector(double low, double high)
    {
        T_VECTOR v(m_n);
        for (double& e : v)
            e = Uniform(low, high);
        return v;
    }
    static double Dot(const T_VECTOR& a, const T_VECTOR& b)
    {
        long double sum = 0.0L;
        for (std::size_t j = 0; j < a.size(); ++j)
            sum += static_cast<long double>(a[j]) * b[j];
        return static_cast<double>(sum);
    }
    static double Length(const T_VECTOR& v) { return std::sqrt(Dot(v, v)); }

    /// Active normals and multipliers: any for equalities (the first m_eq), positive for the rest.
    void Normals(std::size_t count)
    {
        m_act.clear();
        m_held.clear();
        for (std::size_t i = 0; i < count; ++i) {
            m_act.push_back(Vector(-1.0, 1.0));
            m_held.push_back(i < m_eq ? Uniform(-1.0, 1.0) : Uniform(0.2, 1.0));
        }
    }
    /// Sum of random multiples of all active normals but the last, columns turned to the sign.
    T_VECTOR Short()
    {
        T_VECTOR y(m_n), mu;
        for (std::size_t i = 0; i + 1 < m_act.size(); ++i)
            mu.push_back(Uniform(-1.0, 1.0));
        for (std::size_t j = 0; j < m_n; ++j) {
            for (std::size_t i = 0; i < mu.size(); ++i)
                y[j] += mu[i] * m_act[i][j];
            if (y[j] * m_sign >= 0.0) continue;
            y[j] = -y[j];
            for (std::size_t i = 0; i < mu.size(); ++i)
                m_act[i][j] = -m_act[i][j];
        }
        return y;
    }
    /// Makes the sum of multiplier * normal equal to -pull by the last normal.
    void Close(const T_VECTOR& pull)
    {
        T_VECTOR& last = m_act.back();
        for (std::size_t j = 0; j < m_n; ++j) {
            double sum = pull[j];
            for (std::size_t i = 0; i + 1 < m_act.size(); ++i)
                sum += m_held[i] * m_act[i][j];
            last[j] = -sum / m_held.back();
        }
    }
    void PlantSquare()
    {
        m_y.assign(m_n, 0.0);
        for (std::size_t j = 0; j < m_n; ++j) {
            for (std::size_t i = 0; i < m_act.size(); ++i)
                m_y[j] -= m_held[i] * m_act[i][j];
            if (m_sign * m_y[j] < 0.0) m_y[j] = 0.0;
        }
        if (Length(m_y) > 0.0) return;
        Normals(m_act.size()); // no row holds zero: another draw
        PlantSquare();
    }
    void PlantSum()
    {
        m_y = Short();
        T_VECTOR pull(m_n);
        for (std::size_t j = 0; j < m_n; ++j) {
            const bool isZero = j % 2 == 1;
            if (isZero) m_y[j] = 0.0;
            pull[j] = isZero ? Uniform(-0.9, 0.9) : (m_y[j] > 0.0 ? 1.0 : -1.0);
        }
        Close(pull);
    }
    void PlantLargest()
    {
        m_y = Short();
        double most = 0.0, sum = 0.0;
        for (double v : m_y)
            most = std::max(most, 1.2 * std::fabs(v));
        T_VECTOR pull(m_n);
        for (std::size_t j = 0; j < m_n; j += 3) {
            m_y[j] = m_y[j] > 0.0 ? most : -most;
            sum += std::fabs(pull[j] = std::copysign(Uniform(0.2, 1.0), m_y[j]));
        }
        for (double& p : pull)
            p /= sum;
        Close(pull);
    }
    void Harden(PLANT kind, std::vector<T_ROW>& equal, std::vector<T_ROW>& less)
    {
        const std::size_t nEqual = equal.size(), nLess = less.size();
        for (std::size_t i = 0; i < nLess && kind == PLANT::NearDuplicate; ++i) {
            T_ROW near = less[i];
            for (double& e : near.a)
                e += 1e-7 * Uniform(-1.0, 1.0);
            near.b = Dot(near.a, m_y) + (i % 2 ? 1e-7 : 0.0);
            less.push_back(near);
        }
        if (kind != PLANT::Degenerate) return;
        for (std::size_t i = 0; i < nLess; ++i) {
            less.push_back(Times(less[i], Uniform(0.5, 3.0)));
            T_ROW idle{Vector(-1.0, 1.0), 0.0};
            idle.b = Dot(idle.a, m_y);
            less.push_back(idle);
        }
        for (std::size_t i = 0; i < nEqual; ++i) {
            equal.push_back(Times(equal[i], Uniform(-3.0, -0.5)));
            less.push_back(Times(equal[i], 0.7));
        }
    }
    static T_ROW Times(T_ROW row, double factor)
    {
        for (double& e : row.a)
            e *= factor;
        row.b *= factor;
        return row;
    }
    /// Adds the row that leaves no solution.
    void Contradict(PLANT kind, std::vector<T_ROW>& equal, std::vector<T_ROW>& less)
    {
        T_ROW bad{T_VECTOR(m_n), 0.0};
        const std::vector<T_ROW>& from = kind == PLANT::NoEqualities ? equal : less;
        for (std::size_t i = 0; i < std::min<std::size_t>(3, from.size()); ++i) {
            const double f = Uniform(0.3, 1.0);
            for (std::size_t j = 0; j < m_n; ++j)
                bad.a[j] -= f * from[i].a[j];
            bad.b -= f * from[i].b;
        }
        bad.b -= 0.01 * Length(m_y);
        if (kind == PLANT::NoEqualities) equal.push_back(bad);
        if (kind == PLANT::NoRows) less.push_back(bad);
        if (kind != PLANT::WrongSign) return;
        bad.a = Vector(0.1, 1.0); // no y with the sign makes sign * a * y negative
        for (double& e : bad.a)
            e *= m_sign;
        const T_VECTOR turned = Turned(equal, less);
        bad.b = Dot(bad.a, turned);
        less.push_back(bad);
    }
    /// Turns the answer to the wrong sign, rows with it, so that it still meets all of them.
    T_VECTOR Turned(std::vector<T_ROW>& equal, std::vector<T_ROW>& less)
    {
        for (std::vector<T_ROW>* rows : {&equal, &less})
            for (T_ROW& row : *rows)
                for (double& e : row.a)
                    e = -e;
        T_VECTOR y = m_y;
        for (double& e : y)
            e = -e;
        return y;
    }
    T_PLANTED Pack(PLANT kind, int objective, const std::vector<T_ROW>& equal,
                   const std::vector<T_ROW>& less)
    {
        T_PLANTED p;
        p.nVar = static_cast<int>(m_n);
        p.nEq = static_cast<int>(equal.size());
        p.objective = objective;
        p.sign = m_sign;
        const bool isWide = kind == PLANT::Scaled;
        const double size = std::exp2(Uniform(-20.0, 20.0));
        for (std::size_t j = 0; j < m_n; ++j) {
            p.weights.push_back(isWide ? std::pow(10.0, Uniform(-3.0, 3.0)) : Uniform(0.5, 2.0));
            p.x.push_back(size * m_y[j] / p.weights[j]);
        }
        for (const auto* rows : {&equal, &less})
            for (const T_ROW& row : *rows) {
                const double f = isWide ? std::pow(10.0, Uniform(-9.0, 6.0)) : 1.0;
                for (std::size_t j = 0; j < m_n; ++j)
                    p.rows.push_back(f * row.a[j] * p.weights[j]);
                p.rhs.push_back(f * size * row.b);
            }
        return p;
    }

    std::mt19937_64 m_random;
    std::size_t m_n = 0, m_eq = 0;
    int m_sign = 0;
    std::vector<T_VECTOR> m_act;
    T_VECTOR m_held, m_y;
};
