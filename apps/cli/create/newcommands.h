// The commands that make models.
#pragma once

#include "exitcodes.h"
#include "qm_rps/create/building.h"

#include <optional>
#include <string>
#include <vector>

/// `new --curve`: texts as they were given.
struct T_NEW_CURVE_OPTIONS {
    std::string curve; // file of the table, "-" for standard input
    std::string units, title, columns, masses, totalMass, heights, shape, spectrum, spectrumTable;
    std::string decimal = "auto", massUnit = "model";
    std::vector<std::string> methods;
    std::string out;
    bool addOrigin = false, reverseForce = false, overwrite = false;
};

/// `new frame`: lists and choices as they were given.
struct T_NEW_FRAME_OPTIONS {
    T_BUILDING building; // numbers, sections and grades
    std::string units = "kN,m", baysX, baysY, storeys, grade, braces, braceBays, loaded, out;
    std::optional<double> deadRoof, liveRoof; // absent: as the floors
    int modes = 0;
    bool push = false, noDiaphragms = false, overwrite = false;
};

EXIT_CODE RunNewFrame(const T_NEW_FRAME_OPTIONS& options);
EXIT_CODE RunNewCurve(const T_NEW_CURVE_OPTIONS& options);
