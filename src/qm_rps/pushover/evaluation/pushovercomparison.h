// Every applicable method on one capacity curve with one spectrum, side by side.
#pragma once

#include "qm_rps/pushover/evaluation/pushevaluator.h"

struct T_COMPARISON_ROW {
    std::string label; // "ATC-40 A", "EC8 SD", "NTC2018 SLV"
    bool found = false;
    double Sd = 0.0, Sa = 0.0; // the point; of a target displacement, the curve at it
    double D = 0.0, V = 0.0;   // MDOF
    T_OUTCOME outcome;
};

struct T_PUSH_COMPARISON {
    std::vector<T_PUSH_EVALUATION> results; // in the order of the rows
    std::vector<T_COMPARISON_ROW> rows;
    int count = 0;                              // rows with a displacement
    double minD = 0.0, maxD = 0.0, meanD = 0.0; // over those rows
};

/// Sa of a capacity spectrum at Sd, its first ordinate counted from the origin; empty beyond its
/// end.
std::optional<double> CapacityAt(const T_ADRS_CURVE& curve, double Sd);
/// Finished evaluations of one load case side by side, labelled by their names. Of a target
/// displacement the row is that of SD or SLV, else of the last state with a demand; V is alpha Sa M
/// g on the capacity curve.
T_PUSH_COMPARISON ComparisonOf(std::vector<T_PUSH_EVALUATION> results);

/// The messages of all results, each text once, in their order.
std::vector<std::string> RemarksOf(const T_PUSH_COMPARISON& comparison);

/// What is compared.
struct T_COMPARISON_CASE {
    std::string push, spectrum; // names
    int behavior = 0;           // 0 to 2
    /// Called before each method and after the last. Empty: nobody is told.
    std::function<void(std::size_t done, std::size_t total)> progress{};
};

/// ATC-40 A and B, FEMA 440 A, B and C, Eurocode 8 (SD) and NTC 2008 and 2018 (SLV), with their
/// defaults. The evaluator no longer stores steps: the model is not changed. 1 done; 0 there is no
/// such load case or spectrum (refusal says which), output as it was.
[[nodiscard]] int ComparePushover(CPushEvaluator& evaluator, const T_COMPARISON_CASE& asked,
                                  T_PUSH_COMPARISON& out, T_FINDING& refusal);
