#include "qm_ui/push/pushcurveplot.h"

#include "qm_base/say.h"
#include "qm_rps/push/pushquantity.h"

#include <algorithm>
#include <cmath>
#include <set>

namespace {

constexpr std::size_t kMostNamed = 4; // runs whose first yield is named

T_PLOT EmptyPlot(const std::string& title, std::size_t direction, const T_UNITS& units)
{
    T_PLOT plot;
    plot.title = title;
    plot.x.title = DisplacementIn(direction, units).Head("IDS_QM_PLOT_PUSH_DISPLACEMENT");
    plot.y.title = ReactionIn(direction, units).Head("IDS_QM_PLOT_PUSH_REACTION");
    return plot;
}

T_PLOT_SERIES Curve(const std::string& name, std::size_t direction, const T_UNITS& units,
                    const std::vector<double>& displacement, const std::vector<double>& reaction)
{
    T_PLOT_SERIES s;
    s.name = name;
    for (const double d : displacement)
        s.x.push_back(DisplacementIn(direction, units).Shown(d));
    for (const double r : reaction)
        s.y.push_back(ReactionIn(direction, units).Shown(r));
    return s;
}

/// A value before the push; what is left of rounding would widen an axis by a tick.
double BeforePush(double value, const std::vector<double>& steps)
{
    constexpr double kRounding = 1e-9; // of the largest value of a step
    double largest = 0.0;
    for (const double step : steps)
        largest = std::max(largest, std::fabs(step));
    return std::fabs(value) <= kRounding * largest ? 0.0 : value;
}

/// From the state before the push on, where it is known.
T_PLOT_SERIES CurveFromStart(const T_PUSH_RUN& run, const T_UNITS& units,
                             std::vector<double> displacement, std::vector<double> reaction)
{
    if (run.startReaction) {
        displacement.insert(displacement.begin(),
                            BeforePush(run.startDisplacement, run.displacement));
        reaction.insert(reaction.begin(), BeforePush(*run.startReaction, run.baseReaction));
    }
    return Curve({}, run.direction, units, displacement, reaction);
}

std::string NameOf(const T_PUSH_RUN& run, std::size_t hinge)
{
    const T_PUSH_LAW_PLACE& place = run.hinges[hinge].place;
    return Say("IDS_QM_UI_PUSH_HINGE_NAME", std::to_string(place.element), place.end,
               kComponentNames[static_cast<std::size_t>(place.component)]);
}

/// Points at which hinges reach a letter of their curves for the first time; all, or the first.
T_PLOT_SERIES Reached(const T_PUSH_RUN& run, const std::string& letter, bool all,
                      const T_UNITS& units)
{
    T_PLOT_SERIES s;
    std::set<std::size_t> reached;
    for (const T_PUSH_EVENT_ROW& event : run.events) {
        bool isNew = false;
        for (const auto& turn : event.hinges)
            isNew = (turn.to == letter && reached.insert(turn.hinge).second) || isNew;
        if (!isNew || event.initial) continue;
        if (!all && !s.x.empty()) break;
        s.x.push_back(DisplacementIn(run.direction, units).Shown(event.displacement));
        s.y.push_back(ReactionIn(run.direction, units).Shown(event.baseReaction));
    }
    s.line = PLOT_LINE::None;
    return s;
}

void AddEvents(T_PLOT& plot, std::span<const T_PUSH_RUN> runs, const T_UNITS& units)
{
    struct T_LETTER {
        const char* letter;
        const char* key;
        PLOT_MARKER marker;
        T_PLOT_COLOR color;
    };
    constexpr T_LETTER kLetters[] = {
        {"B", "IDS_QM_PLOT_PUSH_B", PLOT_MARKER::Circle, {46, 125, 50}},
        {"C", "IDS_QM_PLOT_PUSH_C", PLOT_MARKER::Triangle, {198, 40, 40}}};
    for (const T_LETTER& l : kLetters) {
        bool named = false; // once in the legend
        for (const T_PUSH_RUN& run : runs) {
            T_PLOT_SERIES s = Reached(run, l.letter, runs.size() == 1, units);
            if (s.x.empty()) continue;
            if (!named) s.name = Say(l.key);
            named = true;
            s.marker = l.marker;
            s.color = l.color;
            s.markerSize = 6.0;
            plot.series.push_back(std::move(s));
        }
    }
}

/// The path through its vertices, the events: it turns back where a hinge loses strength faster
/// than the steps follow.
T_PLOT_SERIES VertexPath(const T_PUSH_RUN& run, const T_UNITS& units)
{
    std::vector<double> displacement, reaction;
    for (const T_PUSH_EVENT_ROW& event : run.events) {
        if (event.initial) continue;
        displacement.push_back(event.displacement);
        reaction.push_back(event.baseReaction);
    }
    if (!displacement.empty() && !run.displacement.empty()) {
        displacement.push_back(run.displacement.back());
        reaction.push_back(run.baseReaction.back());
    }
    if (displacement.empty()) return {};
    T_PLOT_SERIES s = CurveFromStart(run, units, std::move(displacement), std::move(reaction));
    s.line = PLOT_LINE::Solid;
    s.width = 0.9;
    s.color = T_PLOT_COLOR{150, 150, 150};
    s.marker = PLOT_MARKER::None;
    return s;
}

/// The first hinge that reaches B while the case is pushed.
void NameFirst(T_PLOT& plot, const T_PUSH_RUN& run, const T_UNITS& units)
{
    for (const T_PUSH_EVENT_ROW& event : run.events) {
        if (event.initial) continue;
        for (const auto& turn : event.hinges) {
            if (turn.to != "B") continue;
            plot.labels.push_back({DisplacementIn(run.direction, units).Shown(event.displacement),
                                   ReactionIn(run.direction, units).Shown(event.baseReaction),
                                   Say("IDS_QM_PLOT_PUSH_FIRST", NameOf(run, turn.hinge)),
                                   PLOT_MARKER::None});
            return;
        }
    }
}

} // namespace

T_PLOT PushCurvePlot(std::span<const T_PUSH_RUN> runs, const T_UNITS& units,
                     const std::string& title)
{
    T_PLOT plot = EmptyPlot(title, runs.empty() ? 0 : runs.front().direction, units);
    for (const T_PUSH_RUN& run : runs) {
        T_PLOT_SERIES curve = CurveFromStart(run, units, run.displacement, run.baseReaction);
        curve.name = run.name;
        plot.series.push_back(std::move(curve));
    }
    if (runs.size() == 1) {
        T_PLOT_SERIES path = VertexPath(runs.front(), units);
        path.name = Say("IDS_QM_PLOT_PUSH_PATH");
        if (!path.x.empty()) plot.series.push_back(std::move(path));
    }
    AddEvents(plot, runs, units);
    if (runs.size() <= kMostNamed)
        for (const T_PUSH_RUN& run : runs)
            NameFirst(plot, run, units);
    return plot;
}

T_PLOT GrowingCurvePlot(const CPushOverRunDlg& run)
{
    const std::string title = Say("IDS_QM_PLOT_PUSH_TITLE");
    if (!run.IsRunning() && !run.Runs().empty())
        return PushCurvePlot(run.Runs(), run.Units(), title);
    T_PLOT plot = EmptyPlot(title, run.Direction(), run.Units());
    for (const CPushOverRunDlg::T_CURVE& c : run.Curves())
        plot.series.push_back(
            Curve(c.name, run.Direction(), run.Units(), c.displacement, c.baseReaction));
    return plot;
}

T_PLOT StepCurvePlot(const CPushOverResultDlg& shown)
{
    const T_PUSH_RUN& run = shown.Run();
    if (shown.Step() < 1) return {};
    T_PLOT plot = PushCurvePlot({&run, 1}, shown.Units(), shown.TitleText());
    plot.subtitle = shown.PointText();
    const auto i = static_cast<std::size_t>(shown.Step() - 1);
    const double x = DisplacementIn(run.direction, shown.Units()).Shown(run.displacement[i]);
    const double y = ReactionIn(run.direction, shown.Units()).Shown(run.baseReaction[i]);
    T_PLOT_SERIES at;
    at.name = shown.MarkName();
    at.x = {x};
    at.y = {y};
    at.line = PLOT_LINE::None;
    at.marker = PLOT_MARKER::Square;
    at.markerSize = 10.0;
    at.color = T_PLOT_COLOR{0, 0, 0};
    plot.series.push_back(std::move(at));
    T_PLOT_GUIDE guide;
    guide.value = x;
    plot.guides.push_back(guide);
    return plot;
}
