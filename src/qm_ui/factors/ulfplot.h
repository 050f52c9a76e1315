// Picture of an unknown load factor result: every constrained quantity against its bounds.
#pragma once

#include "qm_rps/unknownloadfactorresultdlg.h"
#include "qm_ui/plot/plotdata.h"

#include <optional>
#include <string>
#include <vector>

/// One constraint. An equality has its target as both bounds.
struct T_ULF_BAR {
    std::string name;
    std::string unit; // of the value; empty: none
    double value = 0.0;
    std::optional<double> upper{}, lower{};
    bool active = false;   // it holds the solution
    bool violated = false; // not met
    double scale = 0.0;    // size of what makes up the value, what is 1e-10 of it is zero
};

struct T_ULF_PICTURE {
    std::string title;
    std::string subtitle;
    std::vector<T_ULF_BAR> bars;
    std::vector<std::string> notes{}; // the factors, say
};

/// The constraints of a solved item, with its factors as notes.
[[nodiscard]] T_ULF_PICTURE UlfPictureOf(const CUnknownLoadFactorResultDlg& dialog);

/// Where a value lies: -1 on its lower bound, 1 on its upper bound, 0 in the middle. With one
/// bound, 0 is the value zero (a bound of zero: the distance is in parts of the scale). Of an
/// equality, 0 is the target and the deviation is in parts of the larger of target and scale.
[[nodiscard]] double UlfPosition(const T_ULF_BAR& bar);

/// One row for each constraint, the first on top, with value, unit and bounds as text. Rows of
/// values that are not finite show the text alone. The page is high enough for every row.
[[nodiscard]] T_PLOT UlfPlot(const T_ULF_PICTURE& picture);
