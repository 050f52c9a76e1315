#include "qm_ui/factors/iterationplot.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"

#include <algorithm>

using zql::lib::MMSGFunction;

namespace {

std::string FactorName(const std::vector<T_ULF_ITER_ROW>& rows, std::size_t row)
{
    const std::string& load = rows[row].load;
    return MMSGFunction::Format(
        "IDS_QM_PLOT_FACTOR",
        {std::to_string(row + 1), rows[row].place + (load.empty() ? "" : " " + load)});
}

constexpr std::size_t kNamed = 8; // factors with a line in the legend

T_PLOT_SERIES FactorSeries(const std::vector<T_ULF_ITER_STEP>& history, std::size_t row)
{
    T_PLOT_SERIES s;
    if (row < kNamed) s.name = FactorName(history.front().rows, row);
    for (const T_ULF_ITER_STEP& step : history) {
        s.x.push_back(step.iteration);
        s.y.push_back(step.rows[row].factor);
    }
    s.width = 1.2;
    return s;
}

/// What lies this far below the wanted tolerance is drawn there: a tolerance may get to 0.
double Floor(const T_ULF_ITER_SETTINGS& settings)
{
    return std::max(1e-16, 1e-3 * settings.tolerance);
}

T_PLOT_SERIES ToleranceSeries(const std::vector<T_ULF_ITER_STEP>& history, double floor)
{
    T_PLOT_SERIES s;
    s.name = MMSGFunction::GetValue("IDS_QM_PLOT_TOLERANCE");
    for (const T_ULF_ITER_STEP& step : history) {
        s.x.push_back(step.iteration);
        s.y.push_back(std::max(step.tolerance, floor));
    }
    s.line = PLOT_LINE::Solid;
    s.width = 2.6;
    s.color = T_PLOT_COLOR{0, 0, 0};
    s.marker = PLOT_MARKER::Circle;
    return s;
}

} // namespace

T_PLOT IterationPlot(const std::string& item, const T_ULF_ITER_SETTINGS& settings,
                     const std::vector<T_ULF_ITER_STEP>& history)
{
    T_PLOT plot;
    if (history.empty()) return plot;
    plot.title = MMSGFunction::Format("IDS_QM_PLOT_ITERATION_TITLE", {item});
    const T_ULF_ITER_STEP& end = history.back();
    const bool converged = end.iteration > 0 && settings.tolerance >= end.tolerance;
    plot.subtitle =
        MMSGFunction::Format(converged ? "IDS_QM_PLOT_CONVERGED" : "IDS_QM_PLOT_NOT_CONVERGED",
                             {std::to_string(end.iteration), std::to_string(settings.required),
                              FormatText("%.3g", end.tolerance)});
    plot.x.title = MMSGFunction::GetValue("IDS_QM_PLOT_ITERATION");
    plot.x.range = T_PLOT_RANGE{-0.2, std::max(1, history.back().iteration) + 0.2};
    for (const T_ULF_ITER_STEP& step : history)
        plot.x.labels.push_back({double(step.iteration), std::to_string(step.iteration)});
    plot.y.title = MMSGFunction::GetValue("IDS_QM_PLOT_FACTOR_TOLERANCE");
    plot.y.log = true;
    const double floor = Floor(settings);
    plot.series.push_back(ToleranceSeries(history, floor));
    if (std::ranges::any_of(history, [&](const auto& step) { return step.tolerance < floor; }))
        plot.notes.push_back(
            MMSGFunction::Format("IDS_QM_PLOT_TOLERANCE_FLOOR", {FormatText("%.3g", floor)}));
    const std::vector<T_ULF_ITER_ROW>& last = history.back().rows;
    for (std::size_t row = 0; row < last.size(); ++row) {
        plot.series.push_back(FactorSeries(history, row));
        plot.notes.push_back(MMSGFunction::Format(
            last[row].pretension ? "IDS_QM_PLOT_FACTOR_IS" : "IDS_QM_PLOT_FACTOR_IS_PLAIN",
            {FactorName(last, row), FormatText("%.6g", last[row].factor)}));
    }
    if (settings.tolerance > 0.0)
        plot.guides.push_back({PLOT_GUIDE::Horizontal, settings.tolerance,
                               MMSGFunction::GetValue("IDS_QM_PLOT_TOLERANCE_WANTED")});
    return plot;
}
