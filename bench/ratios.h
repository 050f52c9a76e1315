// Ratios of benchmark times, printed after the run: name, measured, and the limit we hold.
#pragma once

#include <string>

/// Asks for time(numerator) / time(denominator) * scale to be printed after the run.
struct T_RATIO {
    std::string what;
    std::string numerator, denominator; // benchmark names
    double scale = 1.0;
    double limit = 0.0;
};

/// Registered from static initialisers of the benchmark files.
int AddRatio(T_RATIO ratio);
