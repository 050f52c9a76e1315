// Ticks of an axis at round values, with labels that hold no rounding noise.
#pragma once

#include "qm_ui/plot/plotdata.h"

#include <string>
#include <vector>

struct T_PLOT_TICK {
    double value = 0.0;
    std::string label;
};

struct T_PLOT_TICKS {
    std::vector<T_PLOT_TICK> major; // ascending, inside the range
    std::vector<double> minor;      // ascending, inside the range, none equal to a major one
    int exponent10 = 0;             // the labels are to be multiplied by 10 to this power
};

/// A step of 1, 2 or 5 times a power of ten. Multiples are formed from whole numbers, so that
/// 3 steps of 0.1 are 0.3 and not 0.30000000000000004.
struct T_PLOT_STEP {
    int mantissa = 1; // 1, 2 or 5
    int exponent10 = 0;
    [[nodiscard]] double Value(double count) const;
};

/// The smallest 1-2-5 step with which `span` (above zero) holds at most maxCount steps.
[[nodiscard]] T_PLOT_STEP NicePlotStep(double span, int maxCount);

/// Ticks for a usable range, about maxCount major ones at most. Log axes have decades, with 2 and 5
/// when few decades are shown and with minor ticks at 2 to 9; a log axis of less than a factor of
/// five takes linear steps.
[[nodiscard]] T_PLOT_TICKS MakePlotTicks(T_PLOT_RANGE range, bool log, int maxCount);

/// 10 to the power n with raised digits, in UTF-8 ("10" followed by superscripts).
[[nodiscard]] std::string PowerOfTenText(int n);

/// At most `digits` significant digits, decimal point '.', no trailing zeros.
[[nodiscard]] std::string PlotNumberText(double value, int digits);
