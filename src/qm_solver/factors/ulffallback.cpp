#include "qm_solver/factors/ulffallback.h"

#include "qm_solver/factors/ulfsquare.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr int kRounds = 10;
constexpr double kHeldTols[] = {1e-6, 1e-8,
                                1e-10}; // a multiplier above it holds its row on the face

/// The rows of the optimal face, all hard, and the linear objective on it.
struct T_FACE {
    T_ULF_ROWS rows;
    std::vector<double> cost;
    std::vector<std::size_t> held; // rows with a multiplier
};

/// A row with a multiplier holds as an equality. An elastic row at its cap stays violated, and the
/// objective is linear on that side.
T_FACE Face(const T_ULF_LINEAR& linear, const std::vector<double>& multipliers, double heldTol)
{
    const T_ULF_ROWS& from = linear.rows;
    T_FACE face{from, linear.cost, {}};
    for (std::size_t i = 0; i < from.Size(); ++i) {
        const double held = multipliers[i], cap = from.cap[i];
        face.rows.cap[i] = T_ULF_ROWS::kHard;
        if (held > cap - heldTol) {
            T_ULF_SHORT_ROW& row = face.rows.shortRows[i - from.nWideRows];
            face.cost[row.j] += cap * row.a;
            row.a = -row.a;
        } else if (std::fabs(held) > heldTol) {
            face.rows.equality[i] = true;
            face.held.push_back(i);
        }
    }
    return face;
}

/// Takes the library's multipliers of held rows that the refined ones do not confirm away. True
/// when there were any.
bool Release(const T_ULF_LINEAR& linear, const T_FACE& face,
             const std::vector<long double>& refined, std::vector<double>& multipliers,
             double heldTol)
{
    bool any = false;
    for (std::size_t i = 0; i < linear.rows.Size(); ++i) {
        if (linear.rows.equality[i] || !face.rows.equality[i] || refined[i] > heldTol) continue;
        multipliers[i] = 0.0;
        any = true;
    }
    return any;
}

/// Smallest square sum on the face of the vertex; code 10 when it is not certified.
void SolveOnFace(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& scaled,
                 const T_ULF_LINEAR& linear, const T_ULF_VERTEX& vertex, double heldTol,
                 ULF_PRECISION precision, T_ULF_ANSWER& answer)
{
    std::vector<double> held = vertex.multipliers;
    for (int round = 0; round < kRounds; ++round) {
        const T_FACE face = Face(linear, held, heldTol);
        CUlfActiveSet prices(face.rows, precision), method(face.rows, precision);
        prices.Start(face.held);
        std::vector<long double> multipliers = prices.MultipliersOf(face.cost, 0.0);
        if (Release(linear, face, multipliers, held, heldTol)) continue;
        if (method.Solve(0, face.rows.Size()) != ULF_STEP::Done) return;
        multipliers.resize(scaled.nCon);
        AcceptUlf(problem, scaled, method.Y().first(scaled.nVar), std::move(multipliers), answer);
        return;
    }
}

} // namespace

T_ULF_ANSWER SolveUlfFallback(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& scaled,
                              ULF_PRECISION precision)
{
    T_ULF_ANSWER answer;
    const T_ULF_LINEAR linear = LinearUlf(problem.objective, scaled);
    T_ULF_VERTEX vertex;
    if (!SolveUlfVertex(linear, vertex)) {
        std::vector<long double> any;
        const T_ULF_ANSWER why = MeetUlf(scaled, precision, any);
        const bool hasReason = why.code >= ULF_EQUALITIES_CONTRADICT && why.code < ULF_RELAXED;
        return hasReason ? why : answer;
    }
    for (double heldTol : kHeldTols) {
        SolveOnFace(problem, scaled, linear, vertex, heldTol, precision, answer);
        if (answer.code != ULF_NOT_CERTIFIED) break;
    }
    return answer;
}
