// Named outcomes of an evaluation: what happened, beside the return code.
#pragma once

#include <array>
#include <string>

enum class PUSH_OUTCOME {
    None,
    Converged,
    Elastic,
    NoCrossing,
    Trials1500,
    CapacityEnds,
    NoTrialPoint,
    Cycles,
    BilinearFailed,
    DampingFailed,
    ZeroTrial,
    NoLocusCrossing,
    PeriodUndefined,
    NoCapacity,
    ConversionFailed,
    NoEigen,
    EigenError,
    DuctilityBelow1,
    CoefficientsFailed,
    NoPeriodCrossing,
    CurveTooShort,
    NotComputed,
    TargetFound,
    NoTarget,
    BilinearTooShort,
    ZeroDemand,
    TargetBeyond,
    TrialBeyond,   // no trial point either: the capacity ends before it
    TargetBelow,   // the curve starts beyond the target
    TargetCycles,  // iterated bilinear curves do not settle
    NegativeGamma, // the control node moves against the mode
    NotFinite      // a number of the result is too large for any
};

/// An outcome with its numbers, where it has some.
struct T_OUTCOME {
    PUSH_OUTCOME code = PUSH_OUTCOME::None;
    int count = 0;                   // trials of a cycle
    std::array<double, 2> between{}; // targets that do not settle, length
    bool operator==(const T_OUTCOME&) const = default;
};

/// Short name, always in English ("converged", "cycles between 2 trials").
std::string OutcomeName(const T_OUTCOME& outcome);
/// One sentence on what to look at, in the chosen language.
std::string OutcomeAdvice(const T_OUTCOME& outcome);
