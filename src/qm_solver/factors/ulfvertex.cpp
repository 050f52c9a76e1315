// Clp behind one function.
#include "qm_solver/factors/ulffallback.h"

#include <algorithm>
#include <cmath>
#include <coin/ClpSimplex.hpp>
#include <coin/CoinPackedMatrix.hpp>

namespace {

constexpr double kBox = 1e6; // scaled unknowns; a solution has the size of 1
constexpr double kLibraryTol = 1e-9;

struct T_TRIPLETS {
    std::vector<int> row, col;
    std::vector<double> value;
    void Add(std::size_t r, std::size_t c, double v)
    {
        row.push_back(static_cast<int>(r));
        col.push_back(static_cast<int>(c));
        value.push_back(v);
    }
};

/// The linear program with one more column for each elastic row: what it is violated by.
struct T_PROGRAM {
    T_TRIPLETS matrix;
    std::vector<double> cost, colLow, colHigh, rowLow, rowHigh;
};

void AddNormal(const T_ULF_ROWS& rows, std::size_t i, T_TRIPLETS& to)
{
    if (const T_ULF_SHORT_ROW* s = rows.Short(i)) {
        to.Add(i, s->j, s->a);
        if (s->k != s->j) to.Add(i, s->k, s->b);
        return;
    }
    for (std::size_t j = 0; j < rows.nWide; ++j)
        to.Add(i, j, rows.Wide(i)[j]);
}

T_PROGRAM Program(const T_ULF_LINEAR& linear)
{
    const T_ULF_ROWS& rows = linear.rows;
    T_PROGRAM p;
    p.cost = linear.cost;
    p.colLow.assign(rows.nVar, -kBox);
    p.colHigh.assign(rows.nVar, kBox);
    for (std::size_t i = 0; i < rows.Size(); ++i) {
        AddNormal(rows, i, p.matrix);
        p.rowHigh.push_back(rows.rhs[i]);
        p.rowLow.push_back(rows.equality[i] ? rows.rhs[i] : -COIN_DBL_MAX);
        if (!std::isfinite(rows.cap[i])) continue;
        p.matrix.Add(i, p.cost.size(), -1.0);
        p.cost.push_back(rows.cap[i]);
        p.colLow.push_back(0.0);
        p.colHigh.push_back(COIN_DBL_MAX);
    }
    return p;
}

} // namespace

int SolveUlfVertex(const T_ULF_LINEAR& linear, T_ULF_VERTEX& vertex)
{
    const T_PROGRAM p = Program(linear);
    const CoinPackedMatrix matrix(true, p.matrix.row.data(), p.matrix.col.data(),
                                  p.matrix.value.data(),
                                  static_cast<CoinBigIndex>(p.matrix.value.size()));
    ClpSimplex model;
    model.setLogLevel(0);
    model.loadProblem(matrix, p.colLow.data(), p.colHigh.data(), p.cost.data(), p.rowLow.data(),
                      p.rowHigh.data());
    model.setPrimalTolerance(kLibraryTol);
    model.setDualTolerance(kLibraryTol);
    model.primal();
    if (!model.isProvenOptimal()) return 0;
    const double* y = model.getColSolution();
    const double* price = model.getRowPrice(); // reduced costs are cost - A' price
    vertex.y.assign(y, y + linear.rows.nVar);
    vertex.multipliers.assign(price, price + linear.rows.Size());
    for (double& m : vertex.multipliers)
        m = -m;
    return 1;
}
