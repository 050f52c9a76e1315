// Works out where everything in a plot goes, in pixels, without drawing.
#pragma once

#include "qm_ui/plot/plotdata.h"
#include "qm_ui/plot/plotgeometry.h"
#include "qm_ui/plot/plotscale.h"
#include "qm_ui/plot/plotspace.h"
#include "qm_ui/plot/plotstyle.h"
#include "qm_ui/plot/plotticks.h"

#include <cstddef>
#include <functional>
#include <optional>
#include <string>
#include <vector>

enum class PLOT_ALIGN { Left, Center, Right };

/// One line of text. A turned text reads upwards; its box is the box on the page.
struct T_PLOT_TEXT {
    std::string text;
    T_PLOT_BOX box;
    double sizePx = 12.0;
    bool bold = false;
    PLOT_ALIGN align = PLOT_ALIGN::Left;
    bool turned = false;
};

/// The visible part of one series.
struct T_PLOT_CURVE {
    T_PLOT_STYLE style;
    std::vector<PLOT_RUN> lines;
    std::vector<T_PLOT_PX> markers;
};

struct T_PLOT_GUIDE_LINE {
    std::size_t guide = 0; // index in T_PLOT::guides
    std::vector<PLOT_RUN> lines;
};

/// A placed label and its lines of text.
struct T_PLOT_LABEL_PLACE {
    std::vector<std::string> lines;
    T_PLOT_PLACE place;
    bool bold = false;
};

struct T_PLOT_LEGEND {
    T_PLOT_BOX box;
    double columnWidth = 0.0;
    double rowHeight = 0.0;
    std::size_t rows = 0;             // per column
    std::vector<std::size_t> entries; // indices in T_PLOT::series, column by column
};

struct T_PLOT_LAYOUT {
    T_PLOT_BOX page;
    T_PLOT_BOX area; // inside the frame; empty when the page is too small to draw on
    CPlotScale x;
    CPlotScale y;
    T_PLOT_TICKS xTicks;
    T_PLOT_TICKS yTicks;
    std::vector<T_PLOT_TEXT> texts; // titles, tick labels, notes
    std::vector<T_PLOT_CURVE> curves;
    std::vector<T_PLOT_GUIDE_LINE> guides;
    std::vector<std::size_t> points;        // indices in T_PLOT::labels of those inside the area
    std::vector<T_PLOT_LABEL_PLACE> labels; // of points and guides; those without room are left out
    std::optional<T_PLOT_LEGEND> legend;
    bool hasData = false; // some point of some series can be shown on these axes
};

/// Width in px of one line of text of the given font size.
using PLOT_MEASURE = std::function<double(const std::string& line, double sizePx, bool bold)>;

/// The layout of one plot; the plot must outlive it. Lengths in px at 96 dpi.
/// The height of the area depends on the page and the texts only, its width on the y range only,
/// so that zooming can compute in that order.
class CPlotLayout {
public:
    CPlotLayout(const T_PLOT& plot, PLOT_MEASURE measure);

    [[nodiscard]] T_PLOT_LAYOUT Calc(const T_PLOT_BOX& page, const T_PLOT_VIEW& view) const;

    static constexpr double kTextPx = 12.0;       // ticks, legend, labels, notes
    static constexpr double kLineFactor = 1.3;    // line height over font size
    static constexpr double kLegendSample = 34.0; // length of the line sample
    static constexpr double kLegendPad = 8.0;

private:
    struct T_LABEL_SIZE {
        std::vector<std::string> lines;
        double w = 0.0;
        double h = 0.0;
    };

    void SetScales(const T_PLOT_VIEW& view, T_PLOT_LAYOUT& out) const;
    void AddTitles(T_PLOT_BOX& rest, T_PLOT_LAYOUT& out) const;
    void AddNotes(T_PLOT_BOX& rest, T_PLOT_LAYOUT& out) const;
    void AddYAxis(T_PLOT_BOX& rest, T_PLOT_LAYOUT& out) const;
    double AddAcrossLabels(const T_PLOT_BOX& rest, T_PLOT_LAYOUT& out) const;
    [[nodiscard]] double EqualScales(const T_PLOT_BOX& rest, T_PLOT_LAYOUT& out) const;
    [[nodiscard]] T_PLOT_TICKS Ticks(const T_PLOT_AXIS& axis, T_PLOT_RANGE range, int count) const;
    void AddXAxis(T_PLOT_LAYOUT& out) const;
    void AddCurves(T_PLOT_LAYOUT& out) const;
    void AddGuides(T_PLOT_LAYOUT& out) const;
    void Place(const T_PLOT_VIEW& view, T_PLOT_LAYOUT& out) const;
    void PlaceLegend(const T_PLOT_VIEW& view, CPlotSpace& space, T_PLOT_LAYOUT& out) const;
    void PlaceLabels(CPlotSpace& space, T_PLOT_LAYOUT& out) const;
    [[nodiscard]] T_PLOT_RANGE Range(const T_PLOT_AXIS& axis,
                                     const std::optional<T_PLOT_RANGE>& view, bool isX) const;
    [[nodiscard]] std::vector<double> AxisValues(bool isX) const;
    [[nodiscard]] T_LABEL_SIZE MeasureLabel(const std::string& text, bool bold) const;

    const T_PLOT& m_plot;
    PLOT_MEASURE m_measure;
};
