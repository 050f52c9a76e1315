// Titles, legend and drift bars around the picture of a frame.
#pragma once

#include "qm_ui/frame/framepainter.h"

#include <QColor>
#include <QPen>

inline const QColor kSupportColor{0x37, 0x47, 0x4f};
inline const QColor kHingeColor{0xef, 0x6c, 0x00};
inline const QColor kChosenColor{0xff, 0xd5, 0x4f};

/// Pen of the lines of a kind of elements; faint: of the frame as it was.
QPen FramePen(ELEM_KIND kind, bool faint, bool thick);

/// Pen of a band of ratios (ratiobands.h).
QPen BandPen(std::size_t band);

QColor HingeStateColor(PUSH_STATE state);
/// A hinge in a state, by colour and shape.
void DrawHingeState(QPainter& painter, QPointF at, PUSH_STATE state);

/// Draws titles above, the legend below and drift bars at the right; returns what is left. Without
/// a painter it only measures.
QRectF DrawFrameLegend(QPainter* painter, const QRectF& rect, const T_FRAME_PICTURE& picture,
                       const T_FRAME_OPTIONS& options);
