// Picture of one hinge of a push: its law, the path on it, where it is now.
#pragma once

#include "qm_rps/push/pushrun.h"
#include "qm_ui/plot/plotdata.h"

/// step: from 1; the path is that of the stored steps up to it. The law is the one of the hinge as
/// it was used: at the present axial force where its strength follows it. Deformations are those
/// beyond the elastic member.
T_PLOT HingeLawPlot(const T_PUSH_RUN& run, std::size_t hinge, int step, const T_UNITS& units);

/// Vertices of a side from the origin on, magnitudes, with its gap, up to a deformation: beyond the
/// last one the force stays. factor: on the forces.
std::vector<solver::T_BACKBONE_POINT> BackboneUpTo(const solver::T_HINGE_SIDE& side, double factor,
                                                   double deformation);
/// Strength at an axial force over that of the law's first vertex; 1 where it does not follow one.
double StrengthFactor(const solver::T_HINGE_LAW& law, bool positive, double axial);
