// The numbers of an evaluation with their definitions, clauses and formulas with the numbers put
// in. Reads the finished result, computes nothing but what the formulas say.
#pragma once

#include "qm_rps/pushover/explain/fact.h"
#include "qm_rps/pushover/pushevaluation.h"

#include <vector>

/// Facts about one thing, in the order in which they follow from one another.
struct T_FACT_GROUP {
    std::string title;
    std::vector<T_FACT> facts;
};

/// The equivalent system; the bilinear curve; then the performance point with the trial that found
/// it, or the target of each limit state. In the units of the result. Without a curve: empty.
std::vector<T_FACT_GROUP> FactsOf(const T_PUSH_EVALUATION& e);

/// What was asked for, each default as it was taken: method, load case, spectrum, damping, options.
std::vector<T_FACT> InputsOf(const T_PUSH_EVALUATION& e, const T_SPFC_D* spectrum);
