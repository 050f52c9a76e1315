#include "qm_ui/factors/tuningplot.h"

#include "qm_base/say.h"

namespace {

constexpr T_PLOT_COLOR kBefore{130, 130, 130}, kNow{0, 90, 170};

T_PLOT_SERIES Line(const char* name, const std::vector<T_DECK_STATION>& at,
                   const std::vector<double>& values, PLOT_LINE line, T_PLOT_COLOR color)
{
    T_PLOT_SERIES s;
    s.name = Say(name);
    for (std::size_t i = 0; i < std::min(at.size(), values.size()); ++i) {
        s.x.push_back(at[i].along);
        s.y.push_back(values[i]);
    }
    s.line = line;
    s.marker = PLOT_MARKER::None;
    s.width = 2.2;
    s.color = color;
    return s;
}

T_PLOT DeckPlot(const char* title, const std::string& unit, const CUlfTuningDlg& tuned,
                const std::vector<T_DECK_STATION>& at,
                std::vector<double> CUlfDeckValues::T_VALUES::*values)
{
    T_PLOT plot;
    plot.title = Say(title);
    plot.x.title =
        Say("IDS_QM_TUNE_ALONG") + " (" + std::string(NameOf(tuned.Units().length)) + ")";
    plot.y.title = unit;
    plot.pageHeight = 420;
    if (!tuned.IsSolved()) return plot;
    plot.series.push_back(
        Line("IDS_QM_TUNE_BEFORE", at, tuned.ValuesBefore().*values, PLOT_LINE::Dash, kBefore));
    plot.series.push_back(
        Line("IDS_QM_TUNE_NOW", at, tuned.Values().*values, PLOT_LINE::Solid, kNow));
    return plot;
}

} // namespace

T_PLOT TuningDisplacementPlot(const CUlfTuningDlg& tuned)
{
    return DeckPlot("IDS_QM_TUNE_DECK", std::string(NameOf(tuned.Units().length)), tuned,
                    tuned.Deck().displacements, &CUlfDeckValues::T_VALUES::displacements);
}

T_PLOT TuningMomentPlot(const CUlfTuningDlg& tuned)
{
    const T_UNITS units = tuned.Units();
    const std::string unit =
        std::string(NameOf(units.force)) + " " + std::string(NameOf(units.length));
    const std::vector<T_DECK_STATION>& at = tuned.Deck().moments;
    T_PLOT plot =
        DeckPlot("IDS_QM_TUNE_MOMENT", unit, tuned, at, &CUlfDeckValues::T_VALUES::moments);
    constexpr int kMomentY = 5;
    if (!at.empty()) plot.subtitle = at.front().what.component == kMomentY ? "My" : "Mz";
    return plot;
}
