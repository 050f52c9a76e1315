#include "qm_solver/factors/ulffactor.h"

#define EIGEN_MPL2_ONLY
#include <Eigen/Dense>
#include <cmath>

namespace {

using T_MATRIX = Eigen::Map<Eigen::MatrixXd>;
using T_CONST_MATRIX = Eigen::Map<const Eigen::MatrixXd>;
using T_CONST_VECTOR = Eigen::Map<const Eigen::VectorXd>;
using Eigen::Index;

Index I(std::size_t i)
{
    return static_cast<Index>(i);
}

T_MATRIX Square(std::vector<double>& v, std::size_t n)
{
    return {v.data(), I(n), I(n)};
}
T_CONST_MATRIX Square(const std::vector<double>& v, std::size_t n)
{
    return {v.data(), I(n), I(n)};
}
T_CONST_VECTOR Vector(std::span<const double> v)
{
    return {v.data(), I(v.size())};
}
Eigen::Map<Eigen::VectorXd> Vector(std::vector<double>& v)
{
    return {v.data(), I(v.size())};
}

} // namespace

CUlfFactor::CUlfFactor(std::size_t nVar) : m_nVar(nVar), m_r(nVar * nVar)
{
    Clear();
}

void CUlfFactor::Clear()
{
    m_count = 0;
    m_q.assign(m_nVar * m_nVar, 0.0);
    for (std::size_t j = 0; j < m_nVar; ++j)
        m_q[j * m_nVar + j] = 1.0;
}

void CUlfFactor::Direct(const T_ULF_ROWS& rows, std::size_t row, double orient,
                        T_ULF_DIRECTION& to) const
{
    const T_CONST_MATRIX q = Square(m_q, m_nVar);
    const Index k = I(m_count), rest = I(m_nVar) - k;
    to.d.resize(m_nVar);
    to.r.resize(m_count);
    to.z.resize(m_nVar);
    auto d = Vector(to.d);
    if (const T_ULF_SHORT_ROW* s = rows.Short(row))
        d = orient * (s->a * q.row(I(s->j)) + s->b * q.row(I(s->k))).transpose();
    else
        d.noalias() = orient * (q.topRows(I(rows.nWide)).transpose() * Vector(rows.Wide(row)));
    auto r = Vector(to.r);
    r = d.head(k);
    Square(m_r, m_nVar).topLeftCorner(k, k).triangularView<Eigen::Upper>().solveInPlace(r);
    Vector(to.z).noalias() = q.rightCols(rest) * d.tail(rest);
    to.zz = d.tail(rest).squaredNorm();
}

void CUlfFactor::Append(const T_ULF_DIRECTION& direction)
{
    T_MATRIX q = Square(m_q, m_nVar);
    const Index k = I(m_count), rest = I(m_nVar) - k;
    const T_CONST_VECTOR d = Vector(std::span<const double>(direction.d));
    const double length = d.tail(rest).norm();
    const double alpha = d(k) > 0.0 ? -length : length;
    Eigen::VectorXd v = d.tail(rest);
    v(0) -= alpha;
    // Q2 (I - v v' / (v' v / 2)); Q2 v = z - alpha q(k)
    const Eigen::VectorXd qv =
        (Vector(std::span<const double>(direction.z)) - alpha * q.col(k)) / (-alpha * v(0));
    for (Index j = 0; j < rest; ++j)
        if (v(j) != 0.0) q.col(k + j) -= v(j) * qv; // zeros are exact: unit rows at the start
    T_MATRIX r = Square(m_r, m_nVar);
    r.col(k).head(k) = d.head(k);
    r(k, k) = alpha;
    ++m_count;
}

void CUlfFactor::Remove(std::size_t at)
{
    T_MATRIX q = Square(m_q, m_nVar), r = Square(m_r, m_nVar);
    const Index last = I(m_count) - 1;
    for (Index j = I(at); j < last; ++j)
        r.col(j).head(j + 2) = r.col(j + 1).head(j + 2);
    for (Index j = I(at); j < last; ++j) {
        Eigen::JacobiRotation<double> g;
        double norm = 0.0;
        g.makeGivens(r(j, j), r(j + 1, j), &norm);
        r(j, j) = norm;
        r(j + 1, j) = 0.0;
        if (j + 1 < last) r.middleCols(j + 1, last - j - 1).applyOnTheLeft(j, j + 1, g.adjoint());
        q.applyOnTheRight(j, j + 1, g);
    }
    --m_count;
}

void CUlfFactor::Solve(std::span<const double> first, std::span<const double> second,
                       std::vector<double>& z, std::vector<double>& r) const
{
    const T_CONST_MATRIX q = Square(m_q, m_nVar);
    const Index k = I(m_count);
    const auto upper = Square(m_r, m_nVar).topLeftCorner(k, k).triangularView<Eigen::Upper>();
    const Eigen::VectorXd qFirst = q.transpose() * Vector(first);
    Eigen::VectorXd both = qFirst; // Q' z: R^-T second, then Q2' first
    if (k > 0) {
        Eigen::VectorXd head = Vector(second);
        upper.transpose().solveInPlace(head);
        both.head(k) = head;
    }
    z.resize(m_nVar);
    Vector(z).noalias() = q * both;
    r.resize(m_count);
    Eigen::VectorXd tail = qFirst.head(k) - both.head(k);
    if (k > 0) upper.solveInPlace(tail);
    Vector(r) = tail;
}
