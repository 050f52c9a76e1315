#include "qm_rps/judge/judgement.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace {

constexpr double kNever = std::numeric_limits<double>::infinity();

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

/// The ratios of an end in a state, by the limits that are looked for; below 0: not known.
struct T_RATIOS {
    std::size_t index = 0; // of the state
    std::vector<double> at;
};

class CFirstPasses {
public:
    CFirstPasses(const std::vector<T_JUDGED_END>& ends, const T_JUDGED_PATH& path,
                 const T_JUDGE_FACTORS& factors)
        : m_ends(ends), m_path(path), m_factors(factors), m_peak(LargestShearAt(path))
    {
        std::array<std::size_t, kModes> having{};
        for (const T_JUDGED_END& end : ends)
            for (const JUDGE_MODE mode : ModesOf(end))
                ++having[static_cast<std::size_t>(mode)];
        for (std::size_t level = 0; level < kLevels; ++level)
            for (std::size_t mode = 0; mode < kModes; ++mode)
                if (having[mode] > 0)
                    out.push_back({level,
                                   static_cast<JUDGE_MODE>(mode),
                                   {},
                                   false,
                                   0.0,
                                   0.0,
                                   0,
                                   having[mode]});
        m_place.assign(out.size(), kNever);
    }

    void Judge(std::size_t end)
    {
        if (m_path.displacement.empty()) return;
        m_end = end;
        m_modes.assign(out.size(), false);
        for (const JUDGE_MODE mode : ModesOf(m_ends[end]))
            for (std::size_t k = 0; k < out.size(); ++k)
                if (out[k].mode == mode) m_modes[k] = true;
        m_missing.assign(out.size(), false);
        T_RATIOS from = At(0);
        Take(from);
        const std::size_t last = m_path.displacement.size() - 1;
        for (const std::size_t to : {std::min(m_peak, last), last}) {
            const std::size_t end1 = std::min(to, Horizon());
            if (end1 <= from.index) continue;
            const T_RATIOS until = At(end1);
            Visit(from, until);
            from = until;
        }
        for (std::size_t k = 0; k < out.size(); ++k)
            if (m_missing[k]) ++out[k].unchecked;
    }

    std::vector<T_FIRST_PASS> out;

private:
    T_PIECE Piece(std::size_t from) const
    {
        return {m_ends[m_end], m_path, m_end, from, m_peak, m_factors};
    }

    T_RATIOS At(std::size_t index)
    {
        const T_END_CHECKS checks = Piece(index).At(0.0);
        T_RATIOS r{index, std::vector<double>(out.size(), -1.0)};
        for (std::size_t k = 0; k < out.size(); ++k)
            if (const auto check = checks.At(out[k].mode, out[k].level))
                r.at[k] =
                    check->Holds() ? check->Ratio().value_or(0.0) : check->Ratio().value_or(kNever);
            else if (m_modes[k])
                m_missing[k] = true;
        return r;
    }

    /// The last state at which this end may still be the first one somewhere.
    std::size_t Horizon() const
    {
        double furthest = 0.0;
        for (std::size_t k = 0; k < out.size(); ++k)
            if (m_modes[k]) furthest = std::max(furthest, m_place[k]);
        const std::size_t last = m_path.displacement.size() - 1;
        return furthest < static_cast<double>(last) ? static_cast<std::size_t>(std::ceil(furthest))
                                                    : last;
    }

    /// Between two judged states, the first of which is taken.
    void Visit(const T_RATIOS& a, const T_RATIOS& b)
    {
        if (a.index >= Horizon()) return;
        if (b.index - a.index > 1 && !IsQuiet(a, b)) {
            const T_RATIOS middle = At(a.index + (b.index - a.index) / 2);
            Visit(a, middle);
            Visit(middle, b);
        } else {
            Take(b);
        }
    }

    /// Nothing that is still looked for can happen between.
    bool IsQuiet(const T_RATIOS& a, const T_RATIOS& b) const
    {
        constexpr double kLeast = 0.02;
        for (std::size_t k = 0; k < out.size(); ++k) {
            if (!m_modes[k] || m_place[k] <= static_cast<double>(a.index)) continue;
            if ((a.at[k] < 0.0) != (b.at[k] < 0.0)) return false;
            const double left = 1.0 - std::max(a.at[k], b.at[k]);
            if (left < std::max(kLeast, 2.0 * std::fabs(a.at[k] - b.at[k]))) return false;
        }
        return IsBounded(a.index, b.index);
    }

    /// The states between lie within those two, in everything.
    bool IsBounded(std::size_t from, std::size_t to) const
    {
        constexpr double kBeyond = 0.01; // of the larger one
        const T_END_STATE &a = m_path.ends[from][m_end], &b = m_path.ends[to][m_end];
        for (double T_END_STATE::*m : kEndStateMembers) {
            const double beyond = kBeyond * std::max(std::fabs(a.*m), std::fabs(b.*m));
            const double low = std::min(a.*m, b.*m) - beyond, high = std::max(a.*m, b.*m) + beyond;
            for (std::size_t i = from + 1; i < to; ++i) {
                const double value = m_path.ends[i][m_end].*m;
                if (value < low || value > high) return false;
            }
        }
        return true;
    }

    /// Notes what the end passes at a state whose predecessor it keeps, or at the first one.
    void Take(const T_RATIOS& b)
    {
        const std::size_t from = b.index == 0 ? 0 : b.index - 1;
        for (std::size_t k = 0; k < out.size(); ++k) {
            T_FIRST_PASS& first = out[k];
            if (!(b.at[k] > 1.0) || m_place[k] <= static_cast<double>(from)) continue;
            const double at = b.index == 0 ? 0.0 : ShareOf(Piece(from), first.mode, first.level);
            const double place = static_cast<double>(from) + at;
            if (place >= m_place[k]) continue;
            m_place[k] = place;
            first.end = m_end;
            first.atStart = b.index == 0;
            const auto between = [&](const std::vector<double>& v) {
                return v[from] + at * (v[b.index] - v[from]);
            };
            first.displacement = between(m_path.displacement);
            first.baseReaction = between(m_path.baseReaction);
        }
    }

    const std::vector<T_JUDGED_END>& m_ends;
    const T_JUDGED_PATH& m_path;
    const T_JUDGE_FACTORS& m_factors;
    std::size_t m_peak = 0, m_end = 0;
    std::vector<double> m_place; // of the first passes so far: state and share of the way behind it
    std::vector<bool> m_modes;   // limits of modes that the end has
    std::vector<bool> m_missing; // those of them that some state has no numbers for
};

} // namespace

std::vector<T_FIRST_PASS> FirstPasses(const std::vector<T_JUDGED_END>& ends,
                                      const T_JUDGED_PATH& path, const T_JUDGE_FACTORS& factors)
{
    CFirstPasses passes(ends, path, factors);
    for (std::size_t e = 0; e < ends.size(); ++e)
        passes.Judge(e);
    return std::move(passes.out);
}
