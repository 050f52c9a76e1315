#include "qm_rps/judge/judgement.h"

#include "qm_base/say.h"

#include <algorithm>
#include <cmath>
#include <tuple>

namespace {

T_STATE_CONTEXT ContextOf(const T_JUDGED_PATH& path, std::size_t end, const T_END_STATE& brittle,
                          const T_JUDGE_FACTORS& factors)
{
    T_STATE_CONTEXT with;
    with.brittle = brittle;
    if (path.hasStart) with.gravity = path.ends.front()[end];
    with.factors = factors;
    return with;
}

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

/// The check of one end between two states of the path.
struct T_PIECE {
    const T_JUDGED_END& end;
    const T_JUDGED_PATH& path;
    std::size_t index = 0, from = 0; // of the end; state before
    std::size_t peak = 0;            // state of the largest base reaction
    const T_JUDGE_FACTORS& factors;

    /// The checks at a share of the way to the next state.
    T_END_CHECKS At(double share) const
    {
        const T_END_STATE& a = path.ends[from][index];
        const T_END_STATE s = share == 0.0 ? a : Between(a, path.ends[from + 1][index], share);
        const bool before = from < peak || (from == peak && share == 0.0);
        const T_END_STATE& shear = ReadsShearAtPeak(end) && !before ? path.ends[peak][index] : s;
        return CheckEnd(end, s, ContextOf(path, index, shear, factors));
    }
};

bool Passes(const T_END_CHECKS& checks, JUDGE_MODE mode, std::size_t level)
{
    const T_MODE_CHECK* const check = checks.Of(mode);
    return check && check->at[level] && !check->at[level]->Holds();
}

/// Share of the piece at which the end passes the limit; it does at its end.
double ShareOf(const T_PIECE& piece, JUDGE_MODE mode, std::size_t level)
{
    constexpr double kClose = 1e-9;
    double keeps = 0.0, passes = 1.0;
    while (passes - keeps > kClose) {
        const double middle = 0.5 * (keeps + passes);
        (Passes(piece.At(middle), mode, level) ? passes : keeps) = middle;
    }
    return passes;
}

} // namespace

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
        ++state.all.count[static_cast<std::size_t>(row.verdict)];
        auto storey = std::ranges::find(state.storeys, ends[e].storey, &T_VERDICT_COUNT::storey);
        if (storey == state.storeys.end())
            storey = state.storeys.insert(storey, {ends[e].storey, {}});
        ++storey->count[static_cast<std::size_t>(row.verdict)];
        state.rows.push_back(std::move(row));
    }
    state.rows = Sorted(std::move(state.rows));
    if (shearIndex < index && std::ranges::any_of(ends, ReadsShearAtPeak))
        state.shearAt = Say("IDS_QM_JUDGE_AT_PEAK");
}

std::vector<T_FIRST_PASS> FirstPasses(const std::vector<T_JUDGED_END>& ends,
                                      const T_JUDGED_PATH& path, const T_JUDGE_FACTORS& factors)
{
    std::array<std::size_t, kModes> having{};
    for (const T_JUDGED_END& end : ends)
        for (const JUDGE_MODE mode : ModesOf(end))
            ++having[static_cast<std::size_t>(mode)];
    std::vector<T_FIRST_PASS> out;
    for (std::size_t level = 0; level < kLevels; ++level)
        for (std::size_t mode = 0; mode < kModes; ++mode)
            if (having[mode] > 0)
                out.push_back(
                    {level, static_cast<JUDGE_MODE>(mode), {}, false, 0.0, 0.0, 0, having[mode]});
    const std::size_t peak = LargestShearAt(path);
    for (std::size_t i = 0; i < path.displacement.size(); ++i) {
        std::vector<double> share(out.size(), 2.0); // of the piece before the state; 2: none
        for (std::size_t e = 0; e < ends.size(); ++e) {
            const T_END_CHECKS now = T_PIECE{ends[e], path, e, i, peak, factors}.At(0.0);
            for (std::size_t k = 0; k < out.size(); ++k) {
                T_FIRST_PASS& first = out[k];
                const T_MODE_CHECK* const check = now.Of(first.mode);
                if (i == 0 && check && !check->at[first.level]) ++first.unchecked;
                if ((first.end && share[k] > 1.0) || !Passes(now, first.mode, first.level))
                    continue;
                const T_PIECE piece{ends[e], path, e, i == 0 ? 0 : i - 1, peak, factors};
                const double at = i == 0 ? 0.0 : ShareOf(piece, first.mode, first.level);
                if (at >= share[k]) continue;
                share[k] = at;
                first.end = e;
                first.atStart = i == 0;
                const std::size_t from = piece.from, to = i;
                const auto between = [&](const std::vector<double>& v) {
                    return v[from] + at * (v[to] - v[from]);
                };
                first.displacement = between(path.displacement);
                first.baseReaction = between(path.baseReaction);
            }
        }
        if (std::ranges::all_of(out, [](const T_FIRST_PASS& f) { return f.end.has_value(); }))
            break;
    }
    return out;
}
