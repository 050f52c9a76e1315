// A section and its material from the records, as the section calculator takes them. SI.
#pragma once

#include "qm_rps/section/sectionvalues.h"
#include "qm_solver/sectionmodel.h"

/// Concrete: parabola-rectangle with the strains of EN 1992-1-1 Table 3.1, the block of ACI 318, or
/// Mander's curve (core and cover). The cover is 0.004 strong in strain (Mander), eps_cu2 (Eurocode
/// core), and spalls there. Bars are elastic-plastic. Steel: full plasticity, or with `strains`
/// elastic-plastic up to a limit of 15 times its yield strain.
std::optional<solver::T_SECTION_MODEL> SectionModelOf(const T_SECT_D& section,
                                                      const T_MATL_D& material,
                                                      const T_SECTION_OPTIONS& options,
                                                      bool strains, CCodeSheet& sheet);
