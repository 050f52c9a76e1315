#include "qm_rps/judge/judgementresult.h"

#include <algorithm>
#include <limits>

CODE_MARK LeastSureOf(const std::vector<T_CODE_TRACE>& trace)
{
    CODE_MARK least = CODE_MARK::Computed;
    for (const T_CODE_TRACE& line : trace)
        least = std::max(least, line.mark);
    return least;
}

std::string ClauseOf(const T_JUDGED_END& end, const T_JUDGED_ROW& row, JUDGE_MODE mode,
                     std::size_t level)
{
    if (end.basis != JUDGE_BASIS::Code || !row.checks.Of(mode, level)) return {};
    const bool rotation = mode == JUDGE_MODE::Rotation;
    const bool chord = IsChordCode(end.member.code);
    const auto& trace = rotation ? row.checks.rotationTrace : row.checks.shearTrace;
    const auto last = [&](std::string_view symbol) {
        const auto at = std::find_if(trace.rbegin(), trace.rend(), [&](const T_CODE_TRACE& line) {
            return line.symbol == symbol;
        });
        return at == trace.rend() ? std::string() : at->clause;
    };
    if (!rotation) {
        if (chord) return last("Vw"); // (A.12) and what limits it
        return last(end.column ? "V_Col" : "Vn");
    }
    return last(chord ? (level == 0 ? "theta_y" : "theta_um") : end.Levels()[level]);
}

CODE_MARK T_JUDGEMENT::LeastSure() const
{
    CODE_MARK least = CODE_MARK::Computed;
    for (const T_JUDGED_STATE& state : states)
        for (const T_JUDGED_ROW& row : state.rows)
            least = std::max(
                {least, LeastSureOf(row.checks.rotationTrace), LeastSureOf(row.checks.shearTrace)});
    return least;
}

VERDICT T_JUDGEMENT::Verdict() const
{
    VERDICT verdict = states.empty() ? VERDICT::NotChecked : VERDICT::Fulfilled;
    for (const T_JUDGED_STATE& state : states) {
        const auto& count = state.all.count;
        if (count[static_cast<std::size_t>(VERDICT::NotFulfilled)] > 0)
            return VERDICT::NotFulfilled;
        if (state.found != AT_POINT::Reached ||
            count[static_cast<std::size_t>(VERDICT::NotChecked)] > 0)
            verdict = VERDICT::NotChecked;
    }
    return verdict;
}

const T_JUDGED_STATE* WorstState(const T_JUDGEMENT& judgement)
{
    const auto ratio = [](const T_JUDGED_STATE& state) {
        if (state.rows.empty()) return -1.0;
        const T_JUDGED_ROW& worst = state.rows.front();
        if (worst.ratio) return *worst.ratio;
        return worst.verdict == VERDICT::NotFulfilled ? std::numeric_limits<double>::max() : -1.0;
    };
    const T_JUDGED_STATE* worst = nullptr;
    for (const T_JUDGED_STATE& state : judgement.states)
        if (state.found == AT_POINT::Reached && (!worst || ratio(state) > ratio(*worst)))
            worst = &state;
    return worst;
}
