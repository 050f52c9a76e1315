// The finished judgement of an evaluation: what table, JSON, sheet, report, window and picture
// show. SI.
#pragma once

#include "qm_rps/judge/judgement.h"

/// A limit state in one mode along the push, and the ground acceleration that brings its first end
/// there. A ground acceleration stands for the displacement that the evaluation's method finds with
/// the spectrum scaled to it (of DL and NC, whose demands are shares of that of SD: that of SD). So
/// the one of a capacity is the same whichever limit state asks.
struct T_JUDGED_LIMIT {
    T_FIRST_PASS first;
    std::string state; // as that of the points: "SD"
    /// Displacements of the control node from the first step on, magnitudes: at the first pass, and
    /// what the evaluation finds.
    std::optional<double> capacity, demand;
    std::optional<double> factor;       // on the ordinates of the spectrum, to the capacity
    std::optional<double> demandFactor; // to the demand: 1 where that is what the method finds
    std::optional<double> pga;          // g: ordinate of the spectrum at the period 0
    std::string why;                    // a factor is missing

    std::optional<double> CapacityPga() const { return Times(factor); }
    std::optional<double> DemandPga() const { return Times(demandFactor); }
    /// PGA_C / PGA_D.
    std::optional<double> PgaRatio() const
    {
        return factor && demandFactor ? std::optional(*factor / *demandFactor) : std::nullopt;
    }

private:
    std::optional<double> Times(std::optional<double> by) const
    {
        return by && pga ? std::optional(*by * *pga) : std::nullopt;
    }
};

struct T_JUDGEMENT {
    std::string evaluation, push;
    T_UNITS units;
    std::string note; // why there is nothing; else empty
    /// The numbers of hinges in the push are no longer those of the model; empty: they are.
    std::string stale;
    double start = 0.0; // displacement of the control node where the push begins
    T_JUDGE_OPTIONS options;
    std::vector<T_JUDGED_END> ends;
    std::vector<T_JUDGED_STATE> states;
    std::vector<T_JUDGED_LIMIT> limits;

    /// The least sure figure that some capacity rests on.
    CODE_MARK LeastSure() const;
    /// Not fulfilled where an end is not in some state; not checked where a state or end is not, or
    /// where there is nothing to judge.
    VERDICT Verdict() const;
};

/// Of one limit state.
VERDICT VerdictOf(const T_JUDGED_STATE& state);

/// The reached state whose worst ratio is the largest; null: none is reached.
const T_JUDGED_STATE* WorstState(const T_JUDGEMENT& judgement);

/// The least sure mark of all figures of something.
CODE_MARK LeastSureOf(const T_END_CHECKS& checks);
