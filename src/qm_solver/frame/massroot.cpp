#include "qm_solver/frame/massroot.h"

#include "qm_solver/sparse/symmetricproduct.h"

#include <algorithm>
#include <cmath>
#include <numeric>

#include <Eigen/Dense>

namespace solver {

namespace {

constexpr double kRankTolerance = 1.0e-12; // of eigenvalues of a cluster with unit diagonal

/// The lowest unknown of each unknown's cluster.
std::vector<std::size_t> Clusters(const T_SYMMETRIC_MATRIX& mass)
{
    std::vector<std::size_t> parent(mass.Size());
    std::iota(parent.begin(), parent.end(), std::size_t{0});
    const auto root = [&](std::size_t i) {
        while (parent[i] != i)
            i = parent[i] = parent[parent[i]];
        return i;
    };
    ForEachEntry(mass, [&](std::size_t i, std::size_t j, double) {
        const std::size_t a = root(i), b = root(j);
        parent[std::max(a, b)] = std::min(a, b);
    });
    for (std::size_t i = 0; i < parent.size(); ++i)
        parent[i] = root(i);
    return parent;
}

struct T_TRIPLET {
    int row, column;
    double value;
};

T_SYMMETRIC_MATRIX Compressed(std::size_t n, std::vector<T_TRIPLET> entries)
{
    std::stable_sort(entries.begin(), entries.end(), [](const T_TRIPLET& a, const T_TRIPLET& b) {
        return a.row != b.row ? a.row < b.row : a.column < b.column;
    });
    T_SYMMETRIC_MATRIX m;
    m.rowStart.assign(n + 1, 0);
    int row = -1;
    for (const T_TRIPLET& e : entries) {
        if (e.row == row && e.column == m.column.back()) {
            m.value.back() += e.value;
            continue;
        }
        row = e.row;
        ++m.rowStart[static_cast<std::size_t>(e.row) + 1];
        m.column.push_back(e.column);
        m.value.push_back(e.value);
    }
    std::partial_sum(m.rowStart.begin(), m.rowStart.end(), m.rowStart.begin());
    return m;
}

} // namespace

T_SYMMETRIC_MATRIX ReducedMass(const CFrameDofs& dofs, std::span<const T_VEC3> mass)
{
    std::vector<T_TRIPLET> entries;
    for (std::size_t node = 0; node < mass.size(); ++node)
        for (std::size_t d = 0; d < 3; ++d) {
            if (!(mass[node][d] > 0.0)) continue;
            const std::span<const T_TERM> terms = dofs.Terms(6 * node + d);
            for (const T_TERM& a : terms)
                for (const T_TERM& b : terms)
                    if (a.index <= b.index)
                        entries.push_back({a.index, b.index, mass[node][d] * a.factor * b.factor});
        }
    return Compressed(dofs.EquationCount(), std::move(entries));
}

CMassRoot::CMassRoot(T_SYMMETRIC_MATRIX mass) : m_mass(std::move(mass))
{
    const std::size_t n = m_mass.Size();
    const std::vector<std::size_t> lowest = Clusters(m_mass);
    std::vector<std::vector<std::size_t>> members(n);
    std::vector<std::size_t> place(n); // in the cluster
    std::vector<char> heavy(n, 0);
    ForEachEntry(m_mass, [&](std::size_t i, std::size_t j, double value) {
        if (i == j && value > 0.0) heavy[i] = 1;
    });
    for (std::size_t i = 0; i < n; ++i) {
        if (!heavy[i]) continue;
        place[i] = members[lowest[i]].size();
        members[lowest[i]].push_back(i);
    }
    std::vector<std::vector<double>> dense(n);
    for (std::size_t c = 0; c < n; ++c)
        dense[c].assign(members[c].size() * members[c].size(), 0.0);
    ForEachEntry(m_mass, [&](std::size_t i, std::size_t j, double value) {
        if (!heavy[i] || !heavy[j]) return;
        const std::size_t c = lowest[i], size = members[c].size();
        dense[c][place[i] * size + place[j]] = dense[c][place[j] * size + place[i]] = value;
    });
    for (std::size_t c = 0; c < n; ++c)
        if (!members[c].empty()) AddCluster(members[c], dense[c]);
}

void CMassRoot::AddCluster(std::span<const std::size_t> equations, std::span<const double> dense)
{
    const auto size = static_cast<Eigen::Index>(equations.size());
    Eigen::MatrixXd m = Eigen::Map<const Eigen::MatrixXd>(dense.data(), size, size);
    const Eigen::VectorXd scale = m.diagonal().cwiseSqrt();
    m = scale.cwiseInverse().asDiagonal() * m * scale.cwiseInverse().asDiagonal();
    const Eigen::SelfAdjointEigenSolver<Eigen::MatrixXd> eigen(m);
    for (Eigen::Index c = 0; c < size; ++c) {
        const double root = std::sqrt(std::max(0.0, eigen.eigenvalues()(c)));
        if (root * root <= kRankTolerance) continue;
        for (Eigen::Index i = 0; i < size; ++i) {
            const double q = eigen.eigenvectors()(i, c);
            m_entries.push_back({equations[static_cast<std::size_t>(i)], scale(i) * q * root,
                                 q / (scale(i) * root)});
        }
        m_start.push_back(m_entries.size());
    }
}

void CMassRoot::Apply(std::span<const double> y, std::span<double> q) const
{
    std::fill(q.begin(), q.end(), 0.0);
    for (std::size_t c = 0; c < Rank(); ++c)
        for (std::size_t e = m_start[c]; e < m_start[c + 1]; ++e)
            q[m_entries[e].equation] += m_entries[e].value * y[c];
}

void CMassRoot::ApplyTransposed(std::span<const double> q, std::span<double> y) const
{
    for (std::size_t c = 0; c < Rank(); ++c) {
        y[c] = 0.0;
        for (std::size_t e = m_start[c]; e < m_start[c + 1]; ++e)
            y[c] += m_entries[e].value * q[m_entries[e].equation];
    }
}

std::vector<double> CMassRoot::Coordinates(std::span<const double> g) const
{
    std::vector<double> y(Rank(), 0.0);
    for (std::size_t c = 0; c < Rank(); ++c)
        for (std::size_t e = m_start[c]; e < m_start[c + 1]; ++e)
            y[c] += m_entries[e].inverse * g[m_entries[e].equation];
    return y;
}

} // namespace solver
