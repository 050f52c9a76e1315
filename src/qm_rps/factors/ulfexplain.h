// Why load factors are what they are, or why there are none, in words and data.
#pragma once

#include "qm_db/records.h"
#include "qm_rps/factors/ulfresult.h"

#include <functional>

/// What holds a solution where it is.
struct T_ULF_HOLD {
    enum class LIMIT { Target, Upper, Lower, Sign };
    std::string name; // constraint; load case of a factor that the sign restriction holds at 0
    LIMIT limit = LIMIT::Target;
    double value = 0.0; // the limit, in the constraint's unit
    std::string unit;   // of the limit; empty for a factor
    /// Change of the objective when the limit rises by one unit (a sign restriction: when the
    /// factor may go one beyond 0 to the side that is not allowed).
    double multiplier = 0.0;
    /// Of a limit, what one unit to each side changes at first; empty: no solution is left, or it
    /// was not tried (see kUlfMostPriced).
    std::optional<double> raised{}, lowered{};
    double part = 0.0; // 1 % of the limit; of a limit of 0, of what makes up the row
    bool operator==(const T_ULF_HOLD&) const = default;
};

/// A constraint that takes part in a contradiction, and by which of its limits.
struct T_ULF_CLASH {
    std::string name;
    T_ULF_HOLD::LIMIT limit = T_ULF_HOLD::LIMIT::Target;
    double value = 0.0;
    std::string unit;
    bool operator==(const T_ULF_CLASH&) const = default;
};

struct T_ULF_EXPLAINED {
    // The influence matrix of the unknown cases, each row of unit length in weighted unknowns.
    int unknowns = 0, rows = 0;
    int rank = 0;
    double condition = 0.0;          // largest over smallest singular value; 0: a zero matrix
    std::vector<std::string> unfelt; // unknown cases that no constraint feels

    bool solved = false;
    double objective = 0.0;       // of a solution
    std::vector<T_ULF_HOLD> held; // by what a solution is held

    bool contradicts = false;          // no factors satisfy all constraints
    std::vector<T_ULF_CLASH> conflict; // smallest set that contradicts itself
    bool conflictWithSign = false;     // the sign restriction is part of it
    bool notProved = false;            // nearly parallel rows leave open whether they contradict
    bool cancelled = false;            // the search for it was cancelled

    /// No solution: the factors that miss the constraints least (least squares of the misses
    /// divided by the length of their rows). An offer, never taken for a solution.
    std::optional<T_ULF_RESULT> compromise;

    std::vector<std::string> lines; // all of it in words
};

/// progress (members tried, members) of the search for the conflict may be empty; false cancels.
/// 1 done; 0 the run never got as far as its rows (its message says why), `out` as it was.
[[nodiscard]] int ExplainUlf(const T_ULF_RUN& run, const T_UNITS& units, T_ULF_EXPLAINED& out,
                             const std::function<bool(int, int)>& progress = {});
