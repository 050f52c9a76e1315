// Picture of a section: its outline, the stirrup, the bars in their size.
#pragma once

#include "qm_db/records.h"
#include "qm_ui/plot/plotdata.h"

/// In the units of the section, y to the right and z upwards, as it is seen from J. A section that
/// is given by values has no outline; the plot then says so.
T_PLOT SectionBarsPlot(const T_SECT_D& section, const T_UNITS& units);
