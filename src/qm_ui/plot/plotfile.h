// Writes a plot to a picture file.
#pragma once

#include "qm_ui/plot/plotdata.h"

#include <string>

/// The plot as a picture of 960 px width, as high as it says. Formats, returns: WritePictureFile.
[[nodiscard]] int WritePlotFile(const T_PLOT& plot, const std::string& path, std::string& error);
