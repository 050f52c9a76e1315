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
