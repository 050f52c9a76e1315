// Draws arrows of loads and reactions, bands of distributed loads, and the colours of stresses.
#pragma once

#include "qm_ui/frame/resultpainter.h"

#include <QPen>

/// px: lengths in space of one px. Returns the end away from the place that it acts at.
QPointF DrawArrowMark(QPainter& painter, const CProjection& projection, const T_ARROW_MARK& arrow,
                      double px);

/// Tails of the first and the last arrow, and the places that they point at.
struct T_DRAWN_BAND {
    QPointF from, to, base, baseTo;
};
T_DRAWN_BAND DrawBandMark(QPainter& painter, const CProjection& projection, const T_BAND_MARK& band,
                          double px);

/// Equal parts of the largest stress; one more: not checked.
inline constexpr std::size_t kStressBands = 5;
std::size_t StressBand(double magnitude, double largest);
QPen StressPen(std::size_t band);

void AddMarkLegend(const T_LOAD_MARKS& marks, std::vector<T_LEGEND_ENTRY>& out);
void AddStressLegend(const T_STRESS_PICTURE& stress, std::vector<T_LEGEND_ENTRY>& out);
