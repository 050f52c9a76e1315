// Products with symmetric matrices of which the upper triangle is stored.
#pragma once

#include "qm_solver/sparse/symmetricmatrix.h"

#include <span>

namespace solver {

/// Calls visit(i, j, value) for each stored entry, j >= i.
template <typename VISIT>
void ForEachEntry(const T_SYMMETRIC_MATRIX& m, const VISIT& visit)
{
    for (std::size_t i = 0; i < m.Size(); ++i)
        for (int e = m.rowStart[i]; e < m.rowStart[i + 1]; ++e) {
            const auto at = static_cast<std::size_t>(e);
            visit(i, static_cast<std::size_t>(m.column[at]), m.value[at]);
        }
}

/// y += M x, with the elements' type of y.
template <typename T>
void AddProduct(const T_SYMMETRIC_MATRIX& m, std::span<const double> x, std::span<T> y)
{
    ForEachEntry(m, [&](std::size_t i, std::size_t j, double value) {
        y[i] += static_cast<T>(value) * x[j];
        if (j != i) y[j] += static_cast<T>(value) * x[i];
    });
}

} // namespace solver
