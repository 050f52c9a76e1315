// How many decimals tables and read-outs show of each quantity. Stored values are never touched.
#pragma once

#include <array>
#include <string>
#include <string_view>

/// What a number is of, as its head says by the unit.
enum class QUANTITY { Force, Moment, Length, Displacement, Stress, Ratio, Count };
inline constexpr std::size_t kQuantities = static_cast<std::size_t>(QUANTITY::Count);

/// Decimals by quantity.
using T_DECIMALS = std::array<int, kQuantities>;
inline constexpr int kAllDigits = -1; // as many as the value has
inline constexpr int kMostDecimals = 12;
inline constexpr T_DECIMALS kAsStored{kAllDigits, kAllDigits, kAllDigits,
                                      kAllDigits, kAllDigits, kAllDigits};

/// The quantity of a column or an axis by its head, "My (kN m)" or "Displacement [mm]": by the unit
/// in the last brackets, and for lengths by the words for a displacement in the catalogue. Count:
/// there is no unit, or one of another quantity.
QUANTITY QuantityOf(std::string_view head);

/// A number's text with so many decimals. All digits, a text that is no number and a value that
/// would be shown as zero without being it (two digits then, "4.2e-07") lose nothing of their size.
std::string WithDecimals(const std::string& number, int decimals);
