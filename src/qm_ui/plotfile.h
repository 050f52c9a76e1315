// Writes a plot to a picture file.
#pragma once

#include "qm_ui/plotdata.h"

#include <string>

/// Writes the plot as .svg, .pdf (both vector) or .png (twice the screen size), told by the
/// extension in any case; the picture is 960 px wide and as high as
/// the plot says (640 px usually) at 96 dpi, the PDF one landscape page of that
/// size. Needs no screen: without a running Qt application it makes one for the call.
/// Returns 1; or 0 with a text in `error` that names the file: unknown extension, or the file can't
/// be written. The file is replaced as a whole or left as it was; nothing else stays behind. On 1
/// the error text is empty. Numbers keep the C locale after the call.
[[nodiscard]] int WritePlotFile(const T_PLOT& plot, const std::string& path, std::string& error);
