#include "qm_solver/factors/ulfcompromise.h"

#include "qm_solver/factors/ulfsquare.h"

#define EIGEN_MPL2_ONLY
#include <Eigen/Dense>
#include <algorithm>
#include <cmath>

namespace {

using Eigen::Index;
using Eigen::VectorXd;
using T_ROWS = Eigen::Matrix<double, Eigen::Dynamic, Eigen::Dynamic, Eigen::RowMajor>;

constexpr int kPasses = 500;
constexpr int kBlockPasses = 30;
constexpr int kBisections = 80;
constexpr double kGradientTol = 1e-12; // rows have unit length, right-hand sides the size of 1
constexpr double kDamping = 1e-9;      // keeps steps short along directions that no row feels

class CLeastViolation {
public:
    explicit CLeastViolation(const T_ULF_SCALED& s)
        : m_a(s.rows.data(), static_cast<Index>(s.nCon), static_cast<Index>(s.nVar)),
          m_b(s.rhs.data(), static_cast<Index>(s.nCon)), m_nEq(static_cast<Index>(s.nEq)),
          m_sign(s.sign), m_y(VectorXd::Zero(m_a.cols())), m_held(s.nVar, false)
    {
    }

    bool Run()
    {
        for (int pass = 0; pass < kPasses; ++pass) {
            m_excess = m_a * m_y - m_b;
            const VectorXd violated = Violated(m_excess);
            const VectorXd gradient = m_a.transpose() * violated;
            const double tol = kGradientTol * std::max(1.0, violated.norm());
            if (Slope(gradient) <= tol && !Free(gradient, tol, pass < kBlockPasses)) return true;
            Move(Step());
        }
        return false;
    }
    /// Violations of the rows, negative only for equalities.
    VectorXd Violations() const { return Violated(m_a * m_y - m_b); }
    const VectorXd& Y() const { return m_y; }

private:
    VectorXd Violated(VectorXd excess) const
    {
        excess.tail(excess.size() - m_nEq) = excess.tail(excess.size() - m_nEq).cwiseMax(0.0);
        return excess;
    }
    double Slope(const VectorXd& gradient) const
    {
        double most = 0.0;
        for (Index j = 0; j < gradient.size(); ++j)
            if (!m_held[static_cast<std::size_t>(j)]) most = std::max(most, std::fabs(gradient(j)));
        return most;
    }
    /// Lets go of the factors at zero that want to take their own sign: all of them, or the one
    /// that wants it most (which can't go in circles). False: none.
    bool Free(const VectorXd& gradient, double tol, bool all)
    {
        Index best = -1;
        for (Index j = 0; j < gradient.size(); ++j) {
            const auto at = static_cast<std::size_t>(j);
            if (!m_held[at] || -m_sign * gradient(j) <= tol) continue;
            if (all) m_held[at] = false;
            if (!all) tol = -m_sign * gradient(j);
            best = j;
        }
        if (best >= 0) m_held[static_cast<std::size_t>(best)] = false;
        return best >= 0;
    }
    /// Newton step of the factors that are not held, on the rows that are violated now.
    VectorXd Step() const
    {
        std::vector<Index> rows, cols;
        for (Index i = 0; i < m_a.rows(); ++i)
            if (i < m_nEq || m_excess(i) > 0.0) rows.push_back(i);
        for (Index j = 0; j < m_a.cols(); ++j)
            if (!m_held[static_cast<std::size_t>(j)]) cols.push_back(j);
        const auto m = static_cast<Index>(rows.size()), n = static_cast<Index>(cols.size());
        Eigen::MatrixXd part = Eigen::MatrixXd::Zero(m + n, n);
        VectorXd right = VectorXd::Zero(m + n);
        part.topRows(m) = m_a(rows, cols);
        part.bottomRows(n).diagonal().setConstant(kDamping);
        right.head(m) = -m_excess(rows);
        VectorXd step = VectorXd::Zero(m_a.cols());
        step(cols) = part.householderQr().solve(right);
        return step;
    }
    /// Goes to the lowest point along the step; factors that reach zero stop it and are held.
    void Move(const VectorXd& step)
    {
        double end = 1.0;
        const auto room = [&](Index j) { // until factor j reaches zero
            return m_sign * step(j) < 0.0 ? -m_y(j) / step(j) : 2.0;
        };
        for (Index j = 0; j < step.size(); ++j)
            end = std::min(end, room(j));
        const VectorXd change = m_a * step;
        const auto slope = [&](double t) { return change.dot(Violated(m_excess + t * change)); };
        double low = end > 0.0 && slope(end) > 0.0 ? 0.0 : end;
        for (int i = 0; i < kBisections && low < end; ++i)
            (slope((low + end) / 2) > 0.0 ? end : low) = (low + end) / 2;
        for (Index j = 0; j < step.size(); ++j) {
            const bool stops = room(j) <= low;
            m_y(j) = stops ? 0.0 : m_y(j) + low * step(j);
            if (stops) m_held[static_cast<std::size_t>(j)] = true;
        }
    }

    Eigen::Map<const T_ROWS> m_a;
    Eigen::Map<const VectorXd> m_b;
    Index m_nEq;
    int m_sign;
    VectorXd m_y, m_excess;
    std::vector<bool> m_held; // factors kept at zero
};

} // namespace

int LeastViolation(const T_ULF_SCALED& scaled, std::vector<long double>& y)
{
    CLeastViolation least(scaled);
    if (!least.Run()) return 0;
    T_ULF_SCALED moved = scaled;
    const VectorXd violations = least.Violations();
    for (std::size_t i = 0; i < moved.nCon; ++i)
        moved.rhs[i] += violations(static_cast<Index>(i));
    T_ULF_ROWS rows;
    rows.SetWide(moved.rows, moved.rhs, moved.nEq, moved.nVar, moved.nVar);
    AddUlfSigns(moved, rows);
    CUlfActiveSet method(rows);
    if (method.Solve(0, rows.Size()) == ULF_STEP::Done)
        y.assign(method.Y().begin(), method.Y().end());
    else // contradicts itself by rounding: the point itself, without the shortening
        y.assign(least.Y().begin(), least.Y().end());
    return 1;
}
