#include "qm_rps/judge/judgementresult.h"

#include <algorithm>
#include <limits>

CODE_MARK LeastSureOf(const T_END_CHECKS& checks)
{
    CODE_MARK least = CODE_MARK::Computed;
    for (const T_MODE_CHECK& check : checks.modes)
        least = std::max(least, check.leastSure);
    return least;
}

CODE_MARK T_JUDGEMENT::LeastSure() const
{
    CODE_MARK least = CODE_MARK::Computed;
    for (const T_JUDGED_STATE& state : states)
        for (const T_JUDGED_ROW& row : state.rows)
            least = std::max(least, LeastSureOf(row.checks));
    return least;
}

VERDICT T_JUDGEMENT::Verdict() const
{
    VERDICT verdict = states.empty() ? VERDICT::NotChecked : VERDICT::Fulfilled;
    for (const T_JUDGED_STATE& state : states) {
        const VERDICT of = VerdictOf(state);
        if (of == VERDICT::NotFulfilled) return of;
        if (of == VERDICT::NotChecked) verdict = of;
    }
    return verdict;
}

VERDICT VerdictOf(const T_JUDGED_STATE& state)
{
    const auto& count = state.all.count;
    if (count[static_cast<std::size_t>(VERDICT::NotFulfilled)] > 0) return VERDICT::NotFulfilled;
    const bool isWhole = state.found == AT_POINT::Reached &&
                         count[static_cast<std::size_t>(VERDICT::NotChecked)] == 0 &&
                         count[static_cast<std::size_t>(VERDICT::Fulfilled)] > 0;
    return isWhole ? VERDICT::Fulfilled : VERDICT::NotChecked;
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
