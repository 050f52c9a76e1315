#include "qm_rps/judge/judgement.h"

#include "qm_base/say.h"

#include <algorithm>
#include <cmath>
#include <tuple>

namespace {

/// Checks that govern first: no capacity, then the larger ratio.
bool Governs(const T_CHECK& a, const T_CHECK& b)
{
    const auto ra = a.Ratio(), rb = b.Ratio();
    if (ra.has_value() != rb.has_value()) return !ra;
    return ra && *ra > *rb;
}

void Conclude(std::size_t level, T_JUDGED_ROW& row)
{
    bool isWhole = true, holds = true;
    const T_CHECK* worst = nullptr;
    for (const T_MODE_CHECK& mode : row.checks.modes) {
        const std::optional<T_CHECK>& check = mode.at[level];
        if (!check) {
            isWhole = false;
            continue;
        }
        holds = holds && check->Holds();
        if (worst && !Governs(*check, *worst)) continue;
        worst = &*check;
        row.governing = mode.mode;
    }
    if (worst) row.ratio = worst->Ratio();
    row.verdict = !holds    ? VERDICT::NotFulfilled
                  : isWhole ? VERDICT::Fulfilled
                            : VERDICT::NotChecked;
}

void Count(const T_JUDGED_END& end, VERDICT verdict, T_VERDICT_COUNT& to)
{
    ++to.count[static_cast<std::size_t>(verdict)];
    if (end.joint) ++to.joints[static_cast<std::size_t>(verdict)];
}

/// Not fulfilled without capacity, then falling ratios, then those without one; equal ones (but for
/// rounding) by their place.
std::vector<T_JUDGED_ROW> Sorted(std::vector<T_JUDGED_ROW> rows)
{
    constexpr double kDigits = 1e9; // ratios that differ by less are one
    const auto key = [&](const T_JUDGED_ROW& r) {
        const double ratio = r.ratio ? -std::round(*r.ratio * kDigits) / kDigits : 0.0;
        const int group = !r.ratio ? (r.verdict == VERDICT::NotFulfilled ? 0 : 2) : 1;
        return std::tuple(group, ratio, r.end);
    };
    std::ranges::sort(rows, {}, key);
    return rows;
}

} // namespace

T_STATE_CONTEXT ContextOf(const T_JUDGED_PATH& path, std::size_t end, const T_END_STATE& brittle,
                          const T_JUDGE_FACTORS& factors)
{
    T_STATE_CONTEXT with;
    with.brittle = brittle;
    if (!path.gravity.empty()) with.gravity = path.gravity[end];
    with.factors = factors;
    return with;
}

bool ReadsShearAtPeak(const T_JUDGED_END& end)
{
    return end.basis == JUDGE_BASIS::Code && end.By() == HINGE_CODE::Circolare2019;
}

void JudgeState(const std::vector<T_JUDGED_END>& ends, const T_JUDGED_PATH& path, std::size_t index,
                const T_JUDGE_OPTIONS& options, T_JUDGED_STATE& state)
{
    const std::size_t shearIndex = std::min(index, LargestShearAt(path));
    for (std::size_t e = 0; e < ends.size(); ++e) {
        T_JUDGED_ROW row;
        row.end = e;
        row.state = path.ends[index][e];
        row.shearState = path.ends[ReadsShearAtPeak(ends[e]) ? shearIndex : index][e];
        row.checks =
            CheckEnd(ends[e], row.state, ContextOf(path, e, row.shearState, options.factors));
        if (!options.trace)
            for (T_MODE_CHECK& mode : row.checks.modes)
                mode.trace = {};
        Conclude(state.level, row);
        Count(ends[e], row.verdict, state.all);
        auto storey = std::ranges::find(state.storeys, ends[e].storey, &T_VERDICT_COUNT::storey);
        if (storey == state.storeys.end())
            storey = state.storeys.insert(storey, {ends[e].storey, {}});
        Count(ends[e], row.verdict, *storey);
        state.rows.push_back(std::move(row));
    }
    state.rows = Sorted(std::move(state.rows));
    if (shearIndex < index && std::ranges::any_of(ends, ReadsShearAtPeak))
        state.shearAt = Say("IDS_QM_JUDGE_AT_PEAK");
}
