#include "qm_ui/factors/iterationplot.h"

#include "qm_base/textformat.h"

#include <algorithm>

namespace {

std::string NameOf(const T_ULF_ITER_ROW& row)
{
    return row.place + (row.load.empty() ? "" : " " + row.load);
}

constexpr std::size_t kNamed = 8; // factors with a line in the legend

T_PLOT_SERIES FactorSeries(const std::vector<T_ULF_ITER_STEP>& history, std::size_t row)
{
    T_PLOT_SERIES s;
    if (row < kNamed)
        s.name = FormatText("Factor %d, ", static_cast<int>(row) + 1) +
                 NameOf(history.front().rows[row]);
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
    s.name = "Tolerance";
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
    plot.title = "Iterative analysis for pretension: " + item;
    const T_ULF_ITER_STEP& end = history.back();
    const bool converged = end.iteration > 0 && settings.tolerance >= end.tolerance;
    plot.subtitle = FormatText("%s after %d of at most %d iterations, tolerance %.3g",
                               converged ? "Converged" : "Not converged", end.iteration,
                               settings.required, end.tolerance);
    plot.x.title = "Iteration";
    plot.x.range = T_PLOT_RANGE{-0.2, std::max(1, history.back().iteration) + 0.2};
    for (const T_ULF_ITER_STEP& step : history)
        plot.x.labels.push_back({double(step.iteration), std::to_string(step.iteration)});
    plot.y.title = "Factor, tolerance (-)";
    plot.y.log = true;
    const double floor = Floor(settings);
    plot.series.push_back(ToleranceSeries(history, floor));
    if (std::ranges::any_of(history, [&](const auto& step) { return step.tolerance < floor; }))
        plot.notes.push_back(FormatText("Tolerances below %.3g are drawn there", floor));
    const std::vector<T_ULF_ITER_ROW>& last = history.back().rows;
    for (std::size_t row = 0; row < last.size(); ++row) {
        plot.series.push_back(FactorSeries(history, row));
        plot.notes.push_back(FormatText("Factor %d, %s = %.6g%s", static_cast<int>(row) + 1,
                                        NameOf(last[row]).c_str(), last[row].factor,
                                        last[row].pretension ? "" : " (no pretension)"));
    }
    if (settings.tolerance > 0.0)
        plot.guides.push_back(
            {PLOT_GUIDE::Horizontal, settings.tolerance, "convergence tolerance"});
    return plot;
}
