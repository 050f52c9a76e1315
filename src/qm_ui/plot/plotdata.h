// What a plot shows: plain data, without any drawing library.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

struct T_PLOT_COLOR {
    std::uint8_t r = 0, g = 0, b = 0;
    bool operator==(const T_PLOT_COLOR&) const = default;
};

/// Values from lo to hi, lo < hi, finite; both above zero on a log axis.
struct T_PLOT_RANGE {
    double lo = 0.0;
    double hi = 1.0;
    bool operator==(const T_PLOT_RANGE&) const = default;
};

/// Auto gives each series its own dash, so that a black and white print stays readable.
enum class PLOT_LINE { Auto, Solid, Dash, Dot, DashDot, None };

/// Auto gives a marker of its own to each series without a line and to each one past the fourth.
enum class PLOT_MARKER { Auto, None, Circle, Square, Triangle, Cross, Plus };

enum class PLOT_GUIDE { Vertical, Horizontal, Radial };

/// A text in place of a number on an axis; `across` stands on the other side of the plot area (y
/// axis only).
struct T_PLOT_AXIS_LABEL {
    double value = 0.0;
    std::string text{};
    std::string across{};
    bool operator==(const T_PLOT_AXIS_LABEL&) const = default;
};

struct T_PLOT_AXIS {
    std::string title{};                     // with the unit: "Spectral displacement (m)"
    bool log = false;                        // log10 axis: values not above zero are skipped
    std::optional<T_PLOT_RANGE> range{};     // empty or not usable: taken from the data
    std::vector<T_PLOT_AXIS_LABEL> labels{}; // not empty: these and no numbers
    bool bare = false;                       // neither numbers nor grid
    bool operator==(const T_PLOT_AXIS&) const = default;
};

/// One curve. Points that are not finite are skipped and leave a gap in the line; when x and y
/// differ in length the surplus is ignored.
struct T_PLOT_SERIES {
    std::string name{}; // empty: not in the legend
    std::vector<double> x{};
    std::vector<double> y{};
    PLOT_LINE line = PLOT_LINE::Auto;    // None: markers only
    double width = 1.8;                  // line width, px at 96 dpi
    std::optional<T_PLOT_COLOR> color{}; // empty: from the palette
    PLOT_MARKER marker = PLOT_MARKER::Auto;
    double markerSize = 7.0; // px at 96 dpi
    bool operator==(const T_PLOT_SERIES&) const = default;
};

/// A thin line across the plot: x = value, y = value, or y = value * x.
struct T_PLOT_GUIDE {
    PLOT_GUIDE kind = PLOT_GUIDE::Vertical;
    double value = 0.0;
    std::string label{}; // may hold several lines
    PLOT_LINE line = PLOT_LINE::Dash;
    T_PLOT_COLOR color{110, 110, 110};
    bool operator==(const T_PLOT_GUIDE&) const = default;
};

/// A marked point with a text near it, joined by a leader line where the text must move away.
struct T_PLOT_LABEL {
    double x = 0.0;
    double y = 0.0;
    std::string text{}; // may hold several lines
    PLOT_MARKER marker = PLOT_MARKER::Circle;
    bool bold = false;
    bool operator==(const T_PLOT_LABEL&) const = default;
};

/// A whole plot. All texts are UTF-8.
struct T_PLOT {
    std::string title{};
    std::string subtitle{};
    T_PLOT_AXIS x{};
    T_PLOT_AXIS y{};
    std::vector<T_PLOT_SERIES> series{};
    std::vector<T_PLOT_GUIDE> guides{};
    std::vector<T_PLOT_LABEL> labels{};
    bool legend = true;
    bool equalScales = false;         // x and y in the same scale: shapes keep their angles
    double pageHeight = 640;          // of a picture file, px at 96 dpi; its width is 960
    std::vector<std::string> notes{}; // printed in columns below the plot
    bool operator==(const T_PLOT&) const = default;
};

/// Top left corner of the legend as fractions of the plot area, 0..1 from the left and the top.
struct T_PLOT_CORNER {
    double right = 0.0;
    double down = 0.0;
    bool operator==(const T_PLOT_CORNER&) const = default;
};

/// The part of the plot on show. Empty fields: the whole plot, and the legend where it hides least.
struct T_PLOT_VIEW {
    std::optional<T_PLOT_RANGE> x{};
    std::optional<T_PLOT_RANGE> y{};
    std::optional<T_PLOT_CORNER> legend{};
    bool operator==(const T_PLOT_VIEW&) const = default;
};
