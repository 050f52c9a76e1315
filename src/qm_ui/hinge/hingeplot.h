// Pictures of a hinge: the backbone of a component with its acceptance criteria, and interaction.
#pragma once

#include "qm_rps/hinge/hingesources.h"
#include "qm_ui/plot/plotdata.h"

#include <optional>

/// Backbone of one page of a component, whole, or as the small preview: cut to the box -2 ... 2
/// with its ends extended. Null series where the curve has no shape yet (the plot then says so).
T_PLOT HingeBackbonePlot(const T_PHGT_D& type, HINGE_COMPONENT component, const T_SKEL_CURVE& curve,
                         const std::string& page, bool box = false);

/// Interaction curves of one level of a yield surface, about y and z, both signs: through its ten
/// points or, where the level is a calculated one, as the whole `lines` with the points on them; as
/// ratios, or as forces and moments in the units given.
T_PLOT HingeInteractionPlot(const T_PHGT_D& type, const T_YIELD_LEVEL& level,
                            const std::string& what, const T_PM_LINES& lines = {},
                            const std::optional<T_UNITS>& values = {});

/// P-M curves of the user, one per axis.
T_PLOT UserInteractionPlot(const T_PHGT_D& type, const T_PMM_TABLE& table);
