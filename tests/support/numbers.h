// Numbers that no routine may take or give back.
#pragma once

#include <limits>

constexpr double kNan = std::numeric_limits<double>::quiet_NaN();
constexpr double kInf = std::numeric_limits<double>::infinity();
