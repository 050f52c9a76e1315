// Switching a backbone between the ratio D/Dy and the plastic deformation D - Dy.
#pragma once

#include "qm_db/records.h"

/// (ratio - 1) * thetaY: plastic deformation of a D/Dy ratio; 0 where |thetaY| < 1e-7.
double PlasticFromRatio(double ratio, double thetaY);
/// 1 + plastic / thetaY: D/Dy ratio of a plastic deformation; 0 where |thetaY| < 1e-7.
double RatioFromPlastic(double plastic, double thetaY);

/// Converts all points and acceptance criteria of both sides by the yield deformation of the side.
/// The negative side holds negative numbers: it is converted by magnitude. Where several numbers
/// within 1e-13 convert back to the entered one exactly, the shortest decimal is taken, so that
/// entered digits come back when the measure is switched back.
void ConvertSides(T_SIDES<T_SKEL_SIDE>& sides, SKEL_MEASURE to);

/// Puts back the values that a switch started from: for each value of `now` (just converted from
/// `was`) that stood in `was` as the earlier switch had left it (`after`), the value that this
/// switch had found (`before`). Values edited in between, or of another yield deformation, stay.
void RestoreSides(T_SIDES<T_SKEL_SIDE>& now, const T_SIDES<T_SKEL_SIDE>& was,
                  const T_SIDES<T_SKEL_SIDE>& after, const T_SIDES<T_SKEL_SIDE>& before);
