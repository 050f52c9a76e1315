// Shows a plot in a window: read-out under the mouse, zoom and pan.
#pragma once

#include "qm_ui/plot/plotdata.h"
#include "qm_ui/plot/plotlayout.h"

#include <QPixmap>
#include <QPoint>
#include <QPointF>
#include <QSize>
#include <QWidget>

#include <cstddef>
#include <optional>

/// The plot component on a widget. The wheel zooms at the cursor (left of the frame: y only; below:
/// x only), dragging with the left button pans, a double click shows the whole plot again, and the
/// point of a series near the mouse is read out in a box.
/// State: the plot and the part of it on show.
class CPlotWidget : public QWidget {
public:
    explicit CPlotWidget(QWidget* parent = nullptr);

    void SetPlot(T_PLOT plot); // shows the whole plot
    /// The same picture with other values: while the axes are the same, the part on show stays.
    void UpdatePlot(T_PLOT plot);
    [[nodiscard]] const T_PLOT& Plot() const { return m_plot; }
    [[nodiscard]] const T_PLOT_VIEW& View() const { return m_view; }
    void SetView(const T_PLOT_VIEW& view);

    /// The layout now on show.
    [[nodiscard]] const T_PLOT_LAYOUT& Layout();

    /// The text of the read-out for the mouse at pos: series name and coordinates, three lines.
    /// Empty when no point is near.
    [[nodiscard]] QString ReadOut(QPointF pos);

    /// The size that a window gives it at first, 960 x 640 otherwise.
    void SetSizeHint(const QSize& size);
    [[nodiscard]] QSize sizeHint() const override;
    [[nodiscard]] QSize minimumSizeHint() const override;

protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void wheelEvent(QWheelEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    void mouseDoubleClickEvent(QMouseEvent* event) override;
    void leaveEvent(QEvent* event) override;

private:
    struct T_HIT {
        std::size_t series = 0;
        std::size_t point = 0;
        QPointF at;
    };
    struct T_GRAB { // the values under the mouse when the drag began
        double x = 0.0;
        double y = 0.0;
    };

    void Forget();
    void ShowValueAt(T_GRAB value, QPointF pos, double spanX, double spanY);
    [[nodiscard]] std::optional<T_HIT> FindHit(QPointF pos);
    [[nodiscard]] QString HitText(const T_HIT& hit) const;
    void DrawReadOut(QPainter& painter);

    QSize m_wanted{960, 640};
    T_PLOT m_plot;
    T_PLOT_VIEW m_view;
    std::optional<T_PLOT_LAYOUT> m_layout; // empty: to be computed
    QPixmap m_picture;                     // null: to be drawn
    std::optional<T_GRAB> m_grab;
    std::optional<T_HIT> m_hit;
};
