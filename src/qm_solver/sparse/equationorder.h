// In which order the equations of a matrix are eliminated.
#pragma once

#include "qm_solver/sparse/symmetricmatrix.h"

#include <span>

namespace solver {

/// Position of each equation, from 1, by nested dissection of the graph of the blocks; equations of
/// a block follow each other. block[i]: the block of equation i, counting from 0 in order.
std::vector<int> EquationOrder(const T_SYMMETRIC_MATRIX& matrix, std::span<const int> block);

} // namespace solver
