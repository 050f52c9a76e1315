// Dense matrices for the tests of the sparse solvers.
#pragma once

#include "qm_solver/sparse/sparsefactor.h"

#include <Eigen/Dense>

#include <algorithm>
#include <random>
#include <vector>

namespace sample {

inline solver::T_SYMMETRIC_MATRIX Upper(const Eigen::MatrixXd& dense)
{
    solver::T_SYMMETRIC_MATRIX m;
    m.rowStart.push_back(0);
    for (Eigen::Index i = 0; i < dense.rows(); ++i) {
        for (Eigen::Index j = i; j < dense.cols(); ++j)
            if (j == i || dense(i, j) != 0.0) {
                m.column.push_back(static_cast<int>(j));
                m.value.push_back(dense(i, j));
            }
        m.rowStart.push_back(static_cast<int>(m.column.size()));
    }
    return m;
}

inline std::vector<int> Blocks(Eigen::Index n, int size)
{
    std::vector<int> block(static_cast<std::size_t>(n));
    for (std::size_t i = 0; i < block.size(); ++i)
        block[i] = static_cast<int>(i) / size;
    return block;
}

/// Sparse random symmetric matrix; `shift` times the identity makes it definite or not.
inline Eigen::MatrixXd RandomMatrix(Eigen::Index n, double shift, unsigned seed)
{
    std::mt19937 random(seed);
    std::uniform_real_distribution<double> uniform(-1.0, 1.0);
    Eigen::MatrixXd a = Eigen::MatrixXd::Zero(n, n);
    for (Eigen::Index i = 0; i < n; ++i)
        for (Eigen::Index j = i; j < std::min(n, i + 40); ++j)
            if (j - i < 3 || uniform(random) > 0.8) a(i, j) = a(j, i) = uniform(random);
    return a + shift * Eigen::MatrixXd::Identity(n, n);
}

} // namespace sample
