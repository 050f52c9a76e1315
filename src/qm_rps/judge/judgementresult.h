// The finished judgement of an evaluation: what table, JSON, sheet, report, window and picture
// show. SI.
#pragma once

#include "qm_rps/judge/judgement.h"

/// A limit state in one mode along the push, and the ground acceleration that brings its first end
/// there.
struct T_JUDGED_LIMIT {
    T_FIRST_PASS first;
    std::string state; // as that of the points: "SD"
    /// Displacements of the control node from the first step on, magnitudes: at the first pass, and
    /// what the evaluation finds.
    std::optional<double> capacity, demand;
    std::optional<double> factor;    // on the ordinates of the spectrum: PGA_C / PGA_D
    std::optional<double> demandPga; // g: ordinate of the spectrum at the period 0
    std::string why;                 // there is no factor
};

struct T_JUDGEMENT {
    std::string evaluation, push;
    T_UNITS units;
    std::string note; // why there is nothing; else empty
    T_JUDGE_OPTIONS options;
    std::vector<T_JUDGED_END> ends;
    std::vector<T_JUDGED_STATE> states;
    std::vector<T_JUDGED_LIMIT> limits;

    /// The least sure figure that some capacity rests on.
    CODE_MARK LeastSure() const;
    /// Not fulfilled where an end is not in some state; not checked where a state or end is not.
    VERDICT Verdict() const;
};

/// The reached state whose worst ratio is the largest; null: none is reached.
const T_JUDGED_STATE* WorstState(const T_JUDGEMENT& judgement);

/// The least sure mark of all figures of something.
CODE_MARK LeastSureOf(const T_END_CHECKS& checks);
