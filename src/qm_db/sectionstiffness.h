// Stiffness of sections as analyses take it.
#pragma once

#include "qm_db/records.h"
#include "qm_db/sectionproperties.h"

#include <string>

/// G of a material as given, else of E and Poisson's ratio.
double ShearModulus(const T_MATL_D& material);

/// Factors of a prismatic element: the mean of those of both ends.
T_SECT_FACTORS MeanFactors(const T_SECT_D& section);

/// The properties of the section (CSectionProperties::Calc) times their mean factors; those of
/// strength as they are. 1 done; 0 with the fault (Factors: one of an end is not above 0), `out`
/// unchanged. `in` and `out` may be the same record.
[[nodiscard]] int CalcStiffness(const T_SECT_D& in, T_SECT_D& out, SECT_FAULT& fault);

/// "beam 30x50: Iyy 0.35, Izz 0.4 (0.3 at I, 0.5 at J)" for each section with factors that beams
/// and trusses have, in a sentence; empty: none has any.
std::string StiffnessFactorText(const T_MODEL& model);
