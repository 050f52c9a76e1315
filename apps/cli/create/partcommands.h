// The commands that make parts of a model: storeys, spectra.
#pragma once

#include "exitcodes.h"

#include <optional>
#include <string>

struct T_STOREYS_OPTIONS {
    std::string file, out;
    std::optional<double> tolerance; // length of the model
    bool overwrite = false;
};
EXIT_CODE RunStoreys(const T_STOREYS_OPTIONS& options);

struct T_SPECTRUM_OPTIONS {
    std::string file, out, set, remove;
    bool overwrite = false;
};
EXIT_CODE RunSpectrum(const T_SPECTRUM_OPTIONS& options);

struct T_MODES_OPTIONS {
    std::string file, out, shape, direction = "X";
    std::optional<double> period; // s, of a typed mode
    int find = 0, remove = 0;     // how many to find; number of the one to delete
    bool overwrite = false;
};
EXIT_CODE RunModes(const T_MODES_OPTIONS& options);
