// What a number and a name must be, whatever file or window they come from.
#pragma once

#include <cmath>
#include <string_view>

/// Largest magnitude of a number that is read, in SI: products of three such numbers still fit.
inline constexpr double kLargestInput = 1e100;

/// False for what is not finite, too.
inline bool IsUsableNumber(double value)
{
    return std::fabs(value) <= kLargestInput;
}

/// Why a record can't have the name, a catalogue key; null: it can.
const char* NameFault(std::string_view name);
