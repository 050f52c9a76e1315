// A sparse symmetric matrix as the engine hands it on.
#pragma once

#include <cstddef>
#include <vector>

namespace solver {

/// Upper triangle with the diagonal, by rows; columns ascending in a row, indices from 0.
struct T_SYMMETRIC_MATRIX {
    std::vector<int> rowStart; // size n + 1
    std::vector<int> column;
    std::vector<double> value;
    std::size_t Size() const { return rowStart.empty() ? 0 : rowStart.size() - 1; }
};

} // namespace solver
