#include "qm_ui/frame/shapeplot.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"

#include <algorithm>
#include <cmath>
#include <limits>

using zql::lib::MMSGFunction;

namespace {

using VEC3 = std::array<double, 3>;
using VEC6 = std::array<double, 6>;

constexpr double kNan = std::numeric_limits<double>::quiet_NaN();
constexpr std::size_t kPoints = 17; // of a curved member
constexpr double kShare = 0.10;     // of the frame's size: the largest displacement drawn
constexpr const char* kAxisNames = "XYZ";

struct T_STATE_STYLE {
    T_PLOT_COLOR color;
    PLOT_LINE line;
    double width;
};
constexpr std::array<T_STATE_STYLE, 4> kStyles{{{{190, 90, 20}, PLOT_LINE::Dash, 1.7},
                                                {{20, 66, 140}, PLOT_LINE::Solid, 2.2},
                                                {{30, 120, 70}, PLOT_LINE::DashDot, 1.7},
                                                {{110, 50, 140}, PLOT_LINE::Dot, 1.7}}};
constexpr std::size_t kAlone = 1; // the style of one state alone: a full line

VEC3 Cross(const VEC3& a, const VEC3& b)
{
    return {a[1] * b[2] - a[2] * b[1], a[2] * b[0] - a[0] * b[2], a[0] * b[1] - a[1] * b[0]};
}

double Dot(const VEC3& a, const VEC3& b)
{
    return a[0] * b[0] + a[1] * b[1] + a[2] * b[2];
}

VEC3 Plus(const VEC3& a, const VEC3& b, double factor)
{
    return {a[0] + factor * b[0], a[1] + factor * b[1], a[2] + factor * b[2]};
}

VEC3 Part(const VEC6& v, std::size_t from)
{
    return {v[from], v[from + 1], v[from + 2]};
}

/// Displacement of a member's end: that of the node and the turn of the rigid offset.
VEC3 EndMove(const VEC6& node, const VEC3& offset)
{
    return Plus(Part(node, 0), Cross(Part(node, 3), offset), 1.0);
}

/// Slopes (displacement per length) of the cubic at both ends, across the member.
std::array<VEC3, 2> EndSlopes(const T_SHAPE_MEMBER& m, const VEC6& di, const VEC6& dj,
                              const VEC3& axis, const VEC3& chord)
{
    if (!m.beam || (m.pinI && m.pinJ)) return {chord, chord};
    VEC3 i = Cross(Part(di, 3), axis), j = Cross(Part(dj, 3), axis);
    // No moment at a pinned end: three halves of the chord less half the other end.
    const auto pinned = [&](const VEC3& other) {
        return Plus({1.5 * chord[0], 1.5 * chord[1], 1.5 * chord[2]}, other, -0.5);
    };
    if (m.pinI) i = pinned(j);
    if (m.pinJ) j = pinned(i);
    return {i, j};
}

struct T_VIEW {
    VEC3 right{}, up{};
    int flat = -1; // axis that is seen end on; -1: isometric
};

/// Where every state can be seen: a plane when nothing leaves it.
T_VIEW ViewOf(const T_SHAPE& shape, const VEC3& size)
{
    const double whole = std::max({size[0], size[1], size[2]});
    VEC3 moves{};
    for (const T_SHAPE_STATE& s : shape.states)
        for (const VEC6& d : s.displacement)
            for (std::size_t k = 0; k < 3; ++k)
                moves[k] = std::max(moves[k], std::fabs(d[k]));
    const double largest = std::max({moves[0], moves[1], moves[2]});
    constexpr std::array<int, 3> kOrder{1, 2, 0}; // XZ before XY before YZ
    for (const int axis : kOrder) {
        const auto k = static_cast<std::size_t>(axis);
        if (size[k] > 1e-9 * whole || moves[k] > 1e-6 * largest) continue;
        T_VIEW view;
        view.flat = axis;
        view.right[axis == 0 ? 1 : 0] = 1.0;
        view.up[axis == 2 ? 1 : 2] = 1.0;
        return view;
    }
    // Seen from (1, -1, 1): X to the lower right, Y to the upper right, Z up.
    const double a = 1.0 / std::sqrt(2.0), b = 1.0 / std::sqrt(6.0);
    return {{a, a, 0.0}, {-b, b, 2.0 * b}, -1};
}

VEC3 SizeOf(const T_SHAPE& shape)
{
    VEC3 lo{kNan, kNan, kNan}, hi = lo, size{};
    for (const T_SHAPE_NODE& n : shape.nodes)
        for (std::size_t k = 0; k < 3; ++k) {
            lo[k] = std::fmin(lo[k], n.xyz[k]);
            hi[k] = std::fmax(hi[k], n.xyz[k]);
            size[k] = hi[k] - lo[k];
        }
    return size;
}

/// The largest translation of a state and its node.
std::pair<double, std::size_t> Largest(const T_SHAPE_STATE& s)
{
    std::pair<double, std::size_t> out{0.0, 0};
    for (std::size_t n = 0; n < s.displacement.size(); ++n) {
        const VEC3 d = Part(s.displacement[n], 0);
        const double length = std::sqrt(Dot(d, d));
        if (length > out.first) out = {length, n};
    }
    return out;
}

/// The largest translation of a node or of the middle of a member.
double LargestDrawn(const T_SHAPE& shape, const T_SHAPE_STATE& s)
{
    double largest = Largest(s).first;
    if (s.displacement.size() != shape.nodes.size()) return 0.0;
    for (const T_SHAPE_MEMBER& m : shape.members) {
        const auto at = MemberShape(shape, m, &s, 1.0, 3),
                   from = MemberShape(shape, m, nullptr, 0.0, 3);
        for (std::size_t n = 0; n < at.size(); ++n) {
            const VEC3 d = Plus(at[n], from[n], -1.0);
            largest = std::max(largest, std::sqrt(Dot(d, d)));
        }
    }
    return largest;
}

/// 1, 2 or 5 times a power of ten, not above the value.
double RoundDown(double value)
{
    const double decade = std::pow(10.0, std::floor(std::log10(value)));
    const double part = value / decade;
    return decade * (part >= 5.0 ? 5.0 : part >= 2.0 ? 2.0 : 1.0);
}

double ScaleOf(const T_SHAPE& shape, const VEC3& size)
{
    if (shape.scale) return *shape.scale;
    double largest = 0.0;
    for (const T_SHAPE_STATE& s : shape.states)
        largest = std::max(largest, LargestDrawn(shape, s));
    const double diagonal = std::sqrt(Dot(size, size));
    const double wanted = kShare * diagonal / largest;
    return largest > 0.0 && std::isfinite(wanted) && wanted > 0.0 ? RoundDown(wanted) : 1.0;
}

void AddPoint(T_PLOT_SERIES& s, const T_VIEW& view, const VEC3& p)
{
    s.x.push_back(Dot(view.right, p));
    s.y.push_back(Dot(view.up, p));
}

T_PLOT_SERIES Wires(const T_SHAPE& shape, const T_VIEW& view, const T_SHAPE_STATE* state,
                    double scale)
{
    T_PLOT_SERIES out;
    for (const T_SHAPE_MEMBER& m : shape.members) {
        const std::size_t count = state && m.beam ? kPoints : 2;
        for (const VEC3& p : MemberShape(shape, m, state, scale, count))
            AddPoint(out, view, p);
        out.x.push_back(kNan);
        out.y.push_back(kNan);
    }
    out.marker = PLOT_MARKER::None;
    return out;
}

void AddSupports(T_PLOT& plot, const T_SHAPE& shape, const T_VIEW& view)
{
    T_PLOT_SERIES out;
    out.name = MMSGFunction::GetValue("IDS_QM_PLOT_SUPPORT");
    out.line = PLOT_LINE::None;
    out.marker = PLOT_MARKER::Triangle;
    out.color = T_PLOT_COLOR{90, 90, 90};
    for (const T_SHAPE_NODE& n : shape.nodes)
        if (n.support) AddPoint(out, view, n.xyz);
    if (!out.x.empty()) plot.series.push_back(std::move(out));
}

/// `size`: the largest displacement of all states, beside which rounding is nothing.
std::string LargestText(const T_SHAPE& shape, const T_SHAPE_STATE& s, double size)
{
    constexpr double kZero = 1e-12;
    const auto [length, node] = Largest(s);
    if (!(length > kZero * size))
        return s.name + ": " + MMSGFunction::GetValue("IDS_QM_PLOT_NO_DISPLACEMENT");
    return s.name + ": " +
           MMSGFunction::Format("IDS_QM_PLOT_LARGEST_DISPLACEMENT",
                                {FormatText("%.4g", length), shape.lengthUnit,
                                 std::to_string(shape.nodes[node].id)});
}

void AddStates(T_PLOT& plot, const T_SHAPE& shape, const T_VIEW& view, double scale)
{
    const std::string times =
        shape.mode
            ? std::string()
            : ", " + MMSGFunction::Format("IDS_QM_PLOT_MAGNIFIED", {FormatText("%.10g", scale)});
    const bool alone = shape.states.size() == 1;
    double size = 0.0;
    for (const T_SHAPE_STATE& s : shape.states)
        size = std::max(size, Largest(s).first);
    for (std::size_t i = 0; i < shape.states.size(); ++i) {
        const T_SHAPE_STATE& s = shape.states[i];
        if (s.displacement.size() != shape.nodes.size()) continue;
        T_PLOT_SERIES line = Wires(shape, view, &s, scale);
        const T_STATE_STYLE& style = kStyles[alone ? kAlone : i % kStyles.size()];
        line.name = s.name + times;
        line.color = style.color;
        line.line = style.line;
        line.width = style.width;
        plot.series.push_back(std::move(line));
        if (!shape.mode) plot.notes.push_back(LargestText(shape, s, size));
    }
}

/// The three directions at the lower left of an isometric picture, where the frame is not.
void AddTripod(T_PLOT& plot, const T_SHAPE& shape, const T_VIEW& view, const VEC3& size)
{
    double left = kNan, bottom = kNan;
    for (const T_PLOT_SERIES& s : plot.series)
        for (std::size_t i = 0; i < s.x.size(); ++i) {
            left = std::fmin(left, s.x[i]);
            bottom = std::fmin(bottom, s.y[i]);
        }
    if (!std::isfinite(left) || shape.nodes.empty()) return;
    const double arm = 0.10 * std::sqrt(Dot(size, size));
    T_PLOT_SERIES axes;
    axes.color = T_PLOT_COLOR{60, 60, 60};
    axes.line = PLOT_LINE::Solid;
    axes.width = 1.3;
    axes.marker = PLOT_MARKER::None;
    const double x0 = left - 0.6 * arm, y0 = bottom - 0.2 * arm;
    for (std::size_t k = 0; k < 3; ++k) {
        const double x = x0 + arm * view.right[k], y = y0 + arm * view.up[k];
        axes.x.insert(axes.x.end(), {x0, x, kNan});
        axes.y.insert(axes.y.end(), {y0, y, kNan});
        plot.labels.push_back({x, y, std::string(1, kAxisNames[k]), PLOT_MARKER::None, true});
    }
    plot.series.push_back(std::move(axes));
}

void SetAxes(T_PLOT& plot, const T_SHAPE& shape, const T_VIEW& view)
{
    plot.equalScales = true;
    if (view.flat < 0) {
        plot.x.bare = plot.y.bare = true;
        plot.x.title = MMSGFunction::Format("IDS_QM_PLOT_ISOMETRIC", {shape.lengthUnit});
        return;
    }
    const auto title = [&](int axis) {
        return std::string(1, kAxisNames[axis]) + " (" + shape.lengthUnit + ")";
    };
    plot.x.title = title(view.flat == 0 ? 1 : 0);
    plot.y.title = title(view.flat == 2 ? 1 : 2);
}

} // namespace

std::vector<std::array<double, 3>> MemberShape(const T_SHAPE& shape, const T_SHAPE_MEMBER& m,
                                               const T_SHAPE_STATE* state, double scale,
                                               std::size_t count)
{
    const std::size_t nodes = shape.nodes.size();
    if (m.i >= nodes || m.j >= nodes || count < 2) return {};
    const VEC3 a = Plus(shape.nodes[m.i].xyz, m.offsetI, 1.0);
    const VEC3 b = Plus(shape.nodes[m.j].xyz, m.offsetJ, 1.0);
    const VEC3 line = Plus(b, a, -1.0);
    const double length = std::sqrt(Dot(line, line));
    const VEC6 still{};
    const VEC6& di = state ? state->displacement[m.i] : still;
    const VEC6& dj = state ? state->displacement[m.j] : still;
    const VEC3 ui = EndMove(di, m.offsetI), uj = EndMove(dj, m.offsetJ);
    const VEC3 move = Plus(uj, ui, -1.0);
    VEC3 axis{}, chord{};
    for (std::size_t k = 0; k < 3 && length > 0.0; ++k) {
        axis[k] = line[k] / length;
        chord[k] = move[k] / length;
    }
    const auto slopes = EndSlopes(m, di, dj, axis, chord);
    const auto across = [&](const VEC3& v) { return Plus(v, axis, -Dot(v, axis)); };
    const VEC3 si = across(Plus(slopes[0], chord, -1.0)), sj = across(Plus(slopes[1], chord, -1.0));
    std::vector<VEC3> out;
    for (std::size_t n = 0; n < count; ++n) {
        const double s = static_cast<double>(n) / static_cast<double>(count - 1);
        VEC3 u = Plus(ui, move, s);                      // the chord
        u = Plus(u, si, length * s * (1 - s) * (1 - s)); // and what the ends turn against it
        u = Plus(u, sj, length * s * s * (s - 1));
        out.push_back(Plus(Plus(a, line, s), u, scale));
    }
    return out;
}

T_PLOT ShapePlot(const T_SHAPE& shape)
{
    const VEC3 size = SizeOf(shape);
    const T_VIEW view = ViewOf(shape, size);
    const double scale = ScaleOf(shape, size);
    T_PLOT plot;
    plot.title = shape.title;
    plot.subtitle = shape.subtitle;
    T_PLOT_SERIES still = Wires(shape, view, nullptr, 0.0);
    still.name = MMSGFunction::GetValue("IDS_QM_PLOT_UNDEFORMED");
    still.width = 0.9;
    still.line = PLOT_LINE::Solid;
    still.color = T_PLOT_COLOR{140, 140, 140};
    plot.series.push_back(std::move(still));
    AddStates(plot, shape, view, scale);
    AddSupports(plot, shape, view);
    SetAxes(plot, shape, view);
    if (view.flat < 0) AddTripod(plot, shape, view, size);
    return plot;
}
