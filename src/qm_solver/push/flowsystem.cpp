#include "qm_solver/push/flowsystem.h"

#include <Eigen/LU>

#include <algorithm>
#include <cmath>

namespace solver {

namespace {

constexpr double kLost = 1e-7;      // relative size of a pivot that has lost its digits
constexpr double kSingular = 1e-14; // reciprocal condition, rows and columns scaled
constexpr double kResidual = 1e-9;  // of a solution that is not refined any more
constexpr std::size_t kMostChanges = 200;
constexpr std::size_t kCheckEvery = 8; // changes

using T_DENSE = Eigen::Map<Eigen::MatrixXd, 0, Eigen::OuterStride<>>;
using T_LINE = Eigen::Map<const Eigen::VectorXd>;

T_DENSE View(std::vector<double>& of, std::size_t size, std::size_t room)
{
    const auto n = static_cast<Eigen::Index>(size);
    return {of.data(), n, n, Eigen::OuterStride<>(static_cast<Eigen::Index>(room))};
}

T_LINE View(std::span<const double> of)
{
    return {of.data(), static_cast<Eigen::Index>(of.size())};
}

} // namespace

void CFlowSystem::Grow()
{
    if (m_size < m_room) return;
    const std::size_t room = std::max<std::size_t>(16, 2 * m_room);
    std::vector<double> matrix(room * room), inverse(room * room);
    for (std::size_t j = 0; j < m_size; ++j) {
        std::copy_n(m_matrix.begin() + static_cast<long>(j * m_room), m_size,
                    matrix.begin() + static_cast<long>(j * room));
        std::copy_n(m_inverse.begin() + static_cast<long>(j * m_room), m_size,
                    inverse.begin() + static_cast<long>(j * room));
    }
    m_matrix = std::move(matrix);
    m_inverse = std::move(inverse);
    m_room = room;
}

void CFlowSystem::Reset(double control)
{
    m_size = 0;
    Grow();
    m_size = 1;
    At(0, 0) = control;
    m_known = false;
}

void CFlowSystem::Add(std::span<const double> row, std::span<const double> column, double diagonal)
{
    Grow();
    const std::size_t n = m_size++;
    for (std::size_t k = 0; k < n; ++k) {
        At(n, k) = row[k];
        At(k, n) = column[k];
    }
    At(n, n) = diagonal;
    if (!m_known || ++m_changes > kMostChanges) {
        m_known = false;
        return;
    }
    auto inverse = View(m_inverse, n, m_room);
    const Eigen::VectorXd right = inverse * View(column);
    const Eigen::RowVectorXd left = View(row).transpose() * inverse;
    const double taken = View(row).dot(right), pivot = diagonal - taken;
    if (!(std::fabs(pivot) > kLost * (std::fabs(diagonal) + std::fabs(taken)))) {
        m_known = false;
        return;
    }
    auto whole = View(m_inverse, m_size, m_room);
    const auto last = static_cast<Eigen::Index>(n);
    inverse.noalias() += right * (left / pivot);
    whole.col(last).head(last) = -right / pivot;
    whole.row(last).head(last) = -left / pivot;
    whole(last, last) = 1.0 / pivot;
}

void CFlowSystem::Remove(std::size_t k)
{
    auto matrix = View(m_matrix, m_size, m_room);
    auto inverse = View(m_inverse, m_size, m_room);
    const auto at = static_cast<Eigen::Index>(k), n = static_cast<Eigen::Index>(m_size);
    if (m_known) {
        const double pivot = inverse(at, at);
        const double size = inverse.col(at).cwiseAbs().maxCoeff();
        m_known = ++m_changes <= kMostChanges && std::fabs(pivot) > kLost * size;
        if (m_known) {
            const Eigen::VectorXd column = inverse.col(at) / pivot;
            const Eigen::RowVectorXd row = inverse.row(at);
            inverse.noalias() -= column * row;
        }
    }
    for (auto* of : {&matrix, &inverse}) {
        for (Eigen::Index j = at; j + 1 < n; ++j)
            of->col(j) = of->col(j + 1).eval();
        for (Eigen::Index i = at; i + 1 < n; ++i)
            of->row(i) = of->row(i + 1).eval();
    }
    --m_size;
}

void CFlowSystem::AddToDiagonal(std::size_t k, double by)
{
    At(k, k) += by;
    if (!m_known) return;
    auto inverse = View(m_inverse, m_size, m_room);
    const auto at = static_cast<Eigen::Index>(k);
    const double pivot = 1.0 + by * inverse(at, at);
    m_known = ++m_changes <= kMostChanges &&
              std::fabs(pivot) > kLost * (1.0 + std::fabs(by * inverse(at, at)));
    if (!m_known) return;
    const Eigen::VectorXd column = inverse.col(at) * (by / pivot);
    const Eigen::RowVectorXd row = inverse.row(at);
    inverse.noalias() -= column * row;
}

void CFlowSystem::SetControl(std::span<const double> row)
{
    SetEquation(0, row);
}

void CFlowSystem::SetEquation(std::size_t k, std::span<const double> row)
{
    for (std::size_t j = 0; j < m_size; ++j)
        At(k, j) = row[j];
    m_known = false;
}

/// With rows and columns scaled, so that a singular matrix shows itself whatever the units are.
int CFlowSystem::Invert()
{
    auto matrix = View(m_matrix, m_size, m_room);
    if (!matrix.allFinite()) return 0;
    const auto n = static_cast<Eigen::Index>(m_size);
    Eigen::VectorXd rows(n), columns(n);
    const auto inverted = [](double most) { return most > 0.0 ? 1.0 / most : 1.0; };
    for (Eigen::Index i = 0; i < n; ++i)
        rows(i) = inverted(matrix.row(i).cwiseAbs().maxCoeff());
    for (Eigen::Index j = 0; j < n; ++j)
        columns(j) = inverted(matrix.col(j).cwiseProduct(rows).cwiseAbs().maxCoeff());
    const Eigen::PartialPivLU<Eigen::MatrixXd> lu(rows.asDiagonal() * matrix *
                                                  columns.asDiagonal());
    if (!(lu.rcond() > kSingular)) return 0;
    View(m_inverse, m_size, m_room) = columns.asDiagonal() * lu.inverse() * rows.asDiagonal();
    m_known = true;
    m_changes = 0;
    return 1;
}

int CFlowSystem::Direction(std::vector<double>& x)
{
    if (!m_known || m_changes % kCheckEvery == 0) {
        std::vector<double> right(m_size, 0.0);
        right[0] = 1.0;
        return Solve(right, x);
    }
    x.assign(m_inverse.begin(), m_inverse.begin() + static_cast<long>(m_size));
    return std::all_of(x.begin(), x.end(), [](double v) { return std::isfinite(v); });
}

int CFlowSystem::Solve(std::span<const double> right, std::vector<double>& x)
{
    const auto matrix = View(m_matrix, m_size, m_room);
    const auto inverse = View(m_inverse, m_size, m_room);
    const T_LINE given = View(right);
    Eigen::VectorXd solution;
    for (int tries = 0; tries < 2; ++tries) {
        if (!m_known && !Invert()) return 0;
        solution = inverse * given;
        const Eigen::VectorXd left = given - matrix * solution;
        const Eigen::VectorXd more = inverse * left;
        solution += more;
        const double size = solution.cwiseAbs().maxCoeff();
        if (solution.allFinite() && more.cwiseAbs().maxCoeff() <= kResidual * size) break;
        if (m_changes == 0) break; // as good as it gets
        m_known = false;
    }
    if (!solution.allFinite()) return 0;
    x.assign(solution.data(), solution.data() + solution.size());
    return 1;
}

} // namespace solver
