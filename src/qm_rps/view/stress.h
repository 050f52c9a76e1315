// Extreme fibre stresses of members, elastic: N / A and bending.
#pragma once

#include "qm_rps/view/diagram.h"

/// By line: the largest magnitude of the normal stress along it and its sign there.
struct T_LINE_STRESS {
    std::size_t line = 0;
    std::vector<double> value; // at equally spaced places, current units; empty: not checked
};
struct T_STRESS_PICTURE {
    std::string unit;
    double largest = 0.0; // magnitude, wherever along a line it is
    std::vector<T_LINE_STRESS> lines;
    std::size_t unchecked = 0; // lines whose section has no dimensions
};
inline constexpr std::size_t kStressPlaces = 9;

/// Of the gross section as it is, elastic, without shear and torsion: sigma = N / A + My z / Iy -
/// Mz y / Iz at the fibre that is strained most (frameresult.h). Sections that are given by their
/// values have no fibres: not checked. Trusses: N / A.
[[nodiscard]] T_STRESS_PICTURE StressesOf(const CViewFrame& frame, const T_MODEL& model,
                                          const T_FRAME_SCENE& scene, const T_VIEW_RESULTS& results,
                                          const solver::T_LOAD_CASE& loads, const T_UNITS& units);
