// Light and dark: colours of windows, and of the drawings in them.
#pragma once

#include "qm_rps/shell/preferences.h"

class QImage;

/// Colours of every window of the application, at once. System: those that the platform gave at the
/// start. Plots and frames, which are drawn for white paper, are shown with their lightness turned
/// over while the theme is dark; files, prints and pages of a report stay as they are.
void ApplyTheme(THEME theme);
/// Whether windows are dark now.
bool IsDark();

/// Turns the lightness of every pixel over, hue and chroma kept, so that white becomes the ground
/// of dark windows and black nearly white.
void TurnLightness(QImage& image);
