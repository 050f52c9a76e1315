// The figures of an evaluation that are looked at first, each with what it is.
#pragma once

#include "qm_rps/pushover/overview/evaluationentry.h"

struct T_CARD {
    std::string symbol;     // the same for every evaluation: "D", "T_eff"
    std::string definition; // with its formula where it has one, and its state; without a value why
    std::optional<double> value;
    std::string unit; // empty: none
    /// "2.183", "-".
    std::string NumberText() const;
};

/// What the cards are, in their order.
enum class CARD { D, V, Drift, Teff, Damping, Gamma, Mstar, Ductility };
/// Names for commands: "D", "V", "drift", "T_eff", "damping", "Gamma", "m*", "ductility".
inline constexpr std::array<const char*, 8> kCardNames{"D",       "V",     "drift", "T_eff",
                                                       "damping", "Gamma", "m*",    "ductility"};

/// All of them, by CARD; those that the evaluation has not are without a value.
std::vector<T_CARD> CardsOf(const T_EVALUATION_ENTRY& entry);
