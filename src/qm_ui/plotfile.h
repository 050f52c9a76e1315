// Writes a plot to a picture file.
#pragma once

#include "qm_ui/picturefile.h"
#include "qm_ui/plotdata.h"

#include <string>

/// The plot as a drawing, 960 px wide and as high as the plot says. It keeps a reference.
[[nodiscard]] T_DRAWING DrawingOf(const T_PLOT& plot);

/// See WritePictureFile.
[[nodiscard]] int WritePlotFile(const T_PLOT& plot, const std::string& path, std::string& error);
