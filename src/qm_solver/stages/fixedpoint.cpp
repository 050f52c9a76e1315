#include "qm_solver/stages/fixedpoint.h"

#include <Eigen/Dense>

namespace solver {

namespace {

constexpr std::size_t kDepth = 4;

} // namespace

std::vector<double> CFixedPoint::Next(std::span<const double> x, std::span<const double> g)
{
    T_ITERATE now{{g.begin(), g.end()}, {g.begin(), g.end()}};
    for (std::size_t i = 0; i < x.size(); ++i)
        now.residual[i] -= x[i];
    m_past.push_back(std::move(now));
    if (m_past.size() > kDepth + 1) m_past.pop_front();

    const T_ITERATE& last = m_past.back();
    std::vector<double> next = last.g;
    const auto rows = static_cast<Eigen::Index>(next.size());
    const auto columns = static_cast<Eigen::Index>(m_past.size()) - 1;
    if (columns == 0 || rows == 0) return next;
    Eigen::MatrixXd change(rows, columns);
    for (Eigen::Index k = 0; k < columns; ++k)
        for (Eigen::Index i = 0; i < rows; ++i)
            change(i, k) =
                last.residual[static_cast<std::size_t>(i)] -
                m_past[static_cast<std::size_t>(k)].residual[static_cast<std::size_t>(i)];
    const Eigen::Map<const Eigen::VectorXd> residual(last.residual.data(), rows);
    const Eigen::VectorXd mix = change.completeOrthogonalDecomposition().solve(residual);
    for (Eigen::Index k = 0; k < columns; ++k)
        for (std::size_t i = 0; i < next.size(); ++i)
            next[i] -= mix(k) * (last.g[i] - m_past[static_cast<std::size_t>(k)].g[i]);
    return next;
}

} // namespace solver
