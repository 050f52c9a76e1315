// What the optimising methods give back.
#pragma once

#include "qm_solver/factors/ulfcertificate.h"

/// Factors with their proof, or the rows that contradict each other.
struct T_ULF_ANSWER {
    int code = ULF_NOT_CERTIFIED;
    std::vector<double> x;                // empty when there is none
    std::vector<long double> multipliers; // one per row, see CertifyUlf
    std::vector<long double> prices;      // d objective / d right-hand side, in the caller's units
    std::vector<std::size_t> proof;       // codes 5 to 7: rows that together have no solution
    bool proofNeedsSign = false;          // ... and the sign restriction with them
    T_ULF_CERTIFICATE certificate;
    bool byWeights = false; // found in the metric of the weights, not in that of ScaleUlf
    double quadratic = 0.0; // objectives 1 and 3: the quadratic term that was small enough
};

/// Sets code 0 or 9 and keeps x when its certificate holds, 10 and no x otherwise.
void AcceptUlf(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& scaled,
               std::span<const long double> y, std::vector<long double> multipliers,
               T_ULF_ANSWER& answer);
