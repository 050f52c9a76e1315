#include "qm_ui/push/storeyplot.h"

#include "qm_base/say.h"
#include "qm_rps/push/pushquantity.h"

#include <algorithm>

namespace {

struct T_LOOK {
    const char* title;
    T_DIM dim;
};
// By STOREY_VALUE.
constexpr T_LOOK kLooks[] = {{"IDS_QM_UI_STOREY_DISPLACEMENT", kDimLength},
                             {"IDS_QM_UI_STOREY_DRIFT", kDimNone},
                             {"IDS_QM_UI_STOREY_SHEAR", kDimForce}};

/// One value for each storey over the height; `of` picks it from the steps.
template <class OF>
T_PLOT_SERIES OverHeight(const std::vector<T_PUSH_STOREY_SERIES>& storeys, STOREY_VALUE value,
                         const T_UNITS& units, OF of)
{
    const T_PUSH_QUANTITY q{kLooks[static_cast<std::size_t>(value)].dim, units};
    const T_PUSH_QUANTITY length{kDimLength, units};
    T_PLOT_SERIES s;
    const auto add = [&](double x, double elevation) {
        s.x.push_back(q.Shown(x));
        s.y.push_back(length.Shown(elevation));
    };
    if (value == STOREY_VALUE::Displacement && !storeys.empty())
        add(0.0, storeys.front().elevation - storeys.front().height);
    for (const T_PUSH_STOREY_SERIES& storey : storeys) {
        const std::vector<double>& values = ValuesOf(storey, value);
        if (values.empty()) return {};
        const double x = of(values);
        if (value != STOREY_VALUE::Displacement) add(x, storey.elevation - storey.height);
        add(x, storey.elevation);
    }
    return s;
}

/// From 0 on, so that lengths along the axis can be compared.
T_PLOT_RANGE FromZero(const std::vector<T_PLOT_SERIES>& series)
{
    constexpr double kRoom = 1.1;
    T_PLOT_RANGE range{0.0, 0.0};
    for (const T_PLOT_SERIES& s : series)
        for (const double x : s.x) {
            range.lo = std::min(range.lo, kRoom * x);
            range.hi = std::max(range.hi, kRoom * x);
        }
    return range;
}

} // namespace

T_PLOT StoreyPlot(const CPushOverStoreyDlg& shown, STOREY_VALUE value)
{
    T_PLOT plot;
    const T_LOOK& look = kLooks[static_cast<std::size_t>(value)];
    const T_PUSH_QUANTITY q{look.dim, shown.Units()};
    plot.title = shown.TitleText();
    plot.subtitle = shown.PointText();
    plot.x.title = value == STOREY_VALUE::Drift ? Say(look.title) : q.Head(look.title);
    plot.y.title = T_PUSH_QUANTITY{kDimLength, shown.Units()}.Head("IDS_QM_UI_STOREY_HEIGHT");
    if (!shown.HasStoreys()) return plot;
    const auto& storeys = shown.Run().storeys;
    const auto step = static_cast<std::size_t>(shown.Step() - 1);
    T_PLOT_SERIES now = OverHeight(storeys, value, shown.Units(),
                                   [step](const auto& values) { return values[step]; });
    now.name = shown.MarkName();
    now.color = T_PLOT_COLOR{21, 78, 140};
    now.line = PLOT_LINE::Solid;
    now.width = 2.4;
    plot.series.push_back(std::move(now));
    // The axis stays as the slider moves.
    T_PLOT_SERIES most = OverHeight(storeys, value, shown.Units(), Envelope);
    most.name = Say("IDS_QM_UI_STOREY_LARGEST");
    most.color = T_PLOT_COLOR{190, 90, 20};
    most.line = PLOT_LINE::Dash;
    plot.series.push_back(std::move(most));
    plot.x.range = FromZero(plot.series);
    if (!shown.m_envelope) plot.series.pop_back();
    return plot;
}
