// Draws a plot with any QPainter: screen, SVG, PDF, PNG, printer.
#pragma once

#include "qm_ui/plot/plotdata.h"
#include "qm_ui/plot/plotlayout.h"

#include <QRectF>

class QColor;
class QFont;
class QPainter;

/// The plot component. Lengths are px at 96 dpi; scale the painter for finer devices.
/// Lines are thinned and clipped here, not by the painter, so that every device gets a small and
/// equal picture. State: none.
class CPlot {
public:
    /// Fills rect and draws the plot in it. A plot without a point to show gets an empty frame
    /// with a "no data" note; a rect too small for a frame gets the titles only.
    static void Draw(QPainter& painter, const QRectF& rect, const T_PLOT& plot,
                     const T_PLOT_VIEW& view);

    /// The layout that Draw uses, for read-outs and zooming.
    [[nodiscard]] static T_PLOT_LAYOUT Layout(const QRectF& rect, const T_PLOT& plot,
                                              const T_PLOT_VIEW& view);

    [[nodiscard]] static QFont Font(double sizePx, bool bold);
    [[nodiscard]] static QColor Color(const T_PLOT_COLOR& color);
};
