// The factor on a demand spectrum at which a method finds a given displacement.
#pragma once

#include <functional>
#include <optional>

/// Displacement that a method finds with the spectrum times a factor; empty: none (beyond the
/// curve, or no answer).
using DISPLACEMENT_AT_FACTOR = std::function<std::optional<double>(double factor)>;

/// Brackets from `guess` on, then false position (Illinois), halving where that is slow. A factor
/// without an answer counts as beyond the target. The answer is one whose displacement is the
/// target to 1e-6; empty: there is none, the method steps over the target.
std::optional<double> FactorFor(double target, double guess, const DISPLACEMENT_AT_FACTOR& at);
