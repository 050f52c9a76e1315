#include "qm_solver/factors/ulffactor.h"

#define EIGEN_MPL2_ONLY
#include <Eigen/Dense>
#include <cmath>

namespace {

using Eigen::Index;

Index I(std::size_t i)
{
    return static_cast<Index>(i);
}

template <class T>
using T_VECTOR_OF = Eigen::Matrix<T, Eigen::Dynamic, 1>;

template <class T>
T_VECTOR_OF<T> In(std::span<const long double> v)
{
    return Eigen::Map<const T_VECTOR_OF<long double>>(v.data(), I(v.size())).template cast<T>();
}
template <class T>
void Out(const T_VECTOR_OF<T>& v, std::vector<long double>& to)
{
    to.assign(v.begin(), v.end());
}

template <class T>
class CUlfFactor : public IUlfFactor {
    using VECTOR = T_VECTOR_OF<T>;
    using MATRIX = Eigen::Matrix<T, Eigen::Dynamic, Eigen::Dynamic>;

public:
    explicit CUlfFactor(std::size_t nVar)
        : m_q(MATRIX::Identity(I(nVar), I(nVar))), m_r(MATRIX::Zero(I(nVar), I(nVar)))
    {
    }
    void Clear() override
    {
        m_count = 0;
        m_q.setIdentity();
    }
    void Direct(const T_ULF_ROWS& rows, std::size_t row, double orient,
                T_ULF_DIRECTION& to) const override
    {
        const Index rest = m_q.cols() - m_count;
        VECTOR d;
        if (const T_ULF_SHORT_ROW* s = rows.Short(row))
            d = T(orient) * (T(s->a) * m_q.row(I(s->j)) + T(s->b) * m_q.row(I(s->k))).transpose();
        else
            d.noalias() = m_q.topRows(I(rows.nWide)).transpose() * Normal(rows.Wide(row), orient);
        VECTOR r = d.head(m_count);
        Upper().solveInPlace(r);
        const VECTOR z = m_q.rightCols(rest) * d.tail(rest);
        to.zz = d.tail(rest).squaredNorm();
        Out<T>(d, to.d);
        Out<T>(r, to.r);
        Out<T>(z, to.z);
    }
    void Append(const T_ULF_DIRECTION& direction) override
    {
        const Index k = m_count, rest = m_q.cols() - k;
        const VECTOR d = In<T>(direction.d);
        const T length = d.tail(rest).norm();
        const T alpha = d(k) > T(0) ? -length : length;
        VECTOR v = d.tail(rest);
        v(0) -= alpha;
        // Q2 (I - v v' / (v' v / 2)); Q2 v = z - alpha q(k)
        const VECTOR qv = (In<T>(direction.z) - alpha * m_q.col(k)) / (-alpha * v(0));
        for (Index j = 0; j < rest; ++j)
            if (v(j) != T(0))
                m_q.col(k + j) -= v(j) * qv; // zeros are exact: unit rows at the start
        m_r.col(k).head(k) = d.head(k);
        m_r(k, k) = alpha;
        ++m_count;
    }
    void Remove(std::size_t at) override
    {
        const Index last = m_count - 1;
        for (Index j = I(at); j < last; ++j)
            m_r.col(j).head(j + 2) = m_r.col(j + 1).head(j + 2);
        for (Index j = I(at); j < last; ++j) {
            Eigen::JacobiRotation<T> g;
            T norm = 0;
            g.makeGivens(m_r(j, j), m_r(j + 1, j), &norm);
            m_r(j, j) = norm;
            m_r(j + 1, j) = T(0);
            if (j + 1 < last)
                m_r.middleCols(j + 1, last - j - 1).applyOnTheLeft(j, j + 1, g.adjoint());
            m_q.applyOnTheRight(j, j + 1, g);
        }
        --m_count;
    }
    void Solve(std::span<const long double> first, std::span<const long double> second,
               std::vector<long double>& z, std::vector<long double>& r) const override
    {
        const VECTOR qFirst = m_q.transpose() * In<T>(first);
        VECTOR both = qFirst; // Q' z: R^-T second, then Q2' first
        if (m_count > 0) {
            VECTOR head = In<T>(second);
            const auto upper = Upper();
            upper.transpose().solveInPlace(head);
            both.head(m_count) = head;
        }
        VECTOR tail = qFirst.head(m_count) - both.head(m_count);
        if (m_count > 0) Upper().solveInPlace(tail);
        Out<T>(m_q * both, z);
        Out<T>(tail, r);
    }

private:
    auto Upper() const
    {
        return m_r.topLeftCorner(m_count, m_count).template triangularView<Eigen::Upper>();
    }
    static VECTOR Normal(std::span<const double> row, double orient)
    {
        return (orient * Eigen::Map<const Eigen::VectorXd>(row.data(), I(row.size())))
            .template cast<T>();
    }

    Index m_count = 0;
    MATRIX m_q, m_r; // of r the upper triangle
};

} // namespace

std::unique_ptr<IUlfFactor> MakeUlfFactor(std::size_t nVar, ULF_PRECISION precision)
{
    if (precision == ULF_PRECISION::LongDouble)
        return std::make_unique<CUlfFactor<long double>>(nVar);
    return std::make_unique<CUlfFactor<double>>(nVar);
}
