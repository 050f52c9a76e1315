// A judgement as one table: a row for every member end, brace, joint and limit state, the worst of
// a state first. Terminal, sheet, window and report show its cells.
#pragma once

#include "qm_rps/judge/judgementresult.h"

/// Columns in their order.
enum class JUDGED_COLUMN {
    State,
    Element,
    End,
    Axis,
    Storey,
    Code,
    N,
    M,
    V,
    Span,
    ThetaY,
    Theta,
    ThetaCapacity,
    ThetaRatio,
    Shear,
    ShearCapacity,
    ShearRatio,
    Other, // of the other modes
    OtherCapacity,
    OtherUnit,
    OtherRatio,
    Governing,
    Clause,
    Verdict,
    Figures,
    Reason
};
inline constexpr std::size_t kJudgedColumns = 26;

/// A text, or a number in the units of the judgement.
struct T_JUDGED_CELL {
    std::string text;
    std::optional<double> number;
};
using T_JUDGED_CELLS = std::array<T_JUDGED_CELL, kJudgedColumns>;

T_JUDGED_CELLS CellsOf(const T_JUDGEMENT& judgement, const T_JUDGED_STATE& state,
                       const T_JUDGED_ROW& row);
/// "N (kN)", "theta capacity (rad)".
std::array<std::string, kJudgedColumns> JudgedHeads(const T_UNITS& units);
inline const T_JUDGED_CELL& At(const T_JUDGED_CELLS& cells, JUDGED_COLUMN column)
{
    return cells[static_cast<std::size_t>(column)];
}

/// "fulfilled" ..., "rotation", "shear", in the chosen language.
std::string VerdictText(VERDICT verdict);
std::string ModeText(JUDGE_MODE mode);
/// "Whole: fulfilled", with the remark that hinges are stale where they are.
std::string WholeVerdictText(const T_JUDGEMENT& judgement);
/// "fulfilled 3, not fulfilled 1, not checked 0; joints of these 1, 0, 0".
std::string VerdictCountText(const T_VERDICT_COUNT& count);
/// "3 J My", "3 Fx", "node 5 X".
std::string EndText(const T_JUDGED_END& end);
/// What must be known beside the table: what is not judged, how sure the figures are, warnings of
/// the codes, each once.
std::vector<std::string> JudgementNotes(const T_JUDGEMENT& judgement);
/// Why things have no numbers at a state, how many for each reason.
std::vector<std::string> UncheckedTexts(const T_JUDGED_STATE& state);
/// "SD", where the ends' code has another name for it "SD (LS)".
std::string StateText(const T_JUDGEMENT& judgement, const T_JUDGED_STATE& state);
/// "SD (LS): demand", "LS, performance point".
std::string StateAtText(const T_JUDGEMENT& judgement, const T_JUDGED_STATE& state);
