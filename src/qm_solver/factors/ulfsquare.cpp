#include "qm_solver/factors/ulfsquare.h"

#include <algorithm>

void AcceptUlf(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& scaled,
               std::span<const long double> y, std::vector<long double> multipliers,
               T_ULF_ANSWER& answer)
{
    std::vector<double> x = UnscaleUlf(scaled, y);
    answer.code = ULF_NOT_CERTIFIED;
    answer.x.clear();
    answer.certificate = CertifyUlf(problem, scaled, x, multipliers);
    if (!answer.certificate.Holds(kUlfRelaxedTol)) return;
    answer.code = answer.certificate.Holds(kUlfFeasibleTol) ? ULF_SOLVED : ULF_RELAXED;
    answer.x = std::move(x);
    answer.multipliers = std::move(multipliers);
}

void AddUlfSigns(const T_ULF_SCALED& scaled, T_ULF_ROWS& rows)
{
    if (scaled.sign == 0) return;
    for (std::size_t j = 0; j < scaled.nVar; ++j)
        rows.AddShort({j, static_cast<double>(-scaled.sign), j, 0.0});
}

T_ULF_ANSWER SolveUlfSquare(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& scaled)
{
    T_ULF_ROWS rows;
    rows.SetWide(scaled.rows, scaled.rhs, scaled.nEq, scaled.nVar, scaled.nVar);
    AddUlfSigns(scaled, rows);
    const struct {
        std::size_t end;
        int code;
    } stages[] = {{scaled.nEq, ULF_EQUALITIES_CONTRADICT},
                  {scaled.nCon, ULF_NO_SOLUTION},
                  {rows.Size(), ULF_OTHER_SIGN_ONLY}};
    CUlfActiveSet method(rows);
    T_ULF_ANSWER answer;
    for (std::size_t begin = 0; const auto& stage : stages) {
        const ULF_STEP step = method.Solve(begin, stage.end);
        begin = stage.end;
        if (step == ULF_STEP::Done) continue;
        answer.code = step == ULF_STEP::Limit ? static_cast<int>(ULF_ITERATION_LIMIT) : stage.code;
        for (const auto& [row, factor] : method.Proof()) {
            if (row < scaled.nCon) answer.proof.push_back(row);
            answer.proofNeedsSign = answer.proofNeedsSign || row >= scaled.nCon;
        }
        std::sort(answer.proof.begin(), answer.proof.end());
        return answer;
    }
    std::vector<long double> multipliers = method.Multipliers();
    multipliers.resize(scaled.nCon);
    AcceptUlf(problem, scaled, method.Y(), std::move(multipliers), answer);
    return answer;
}
