#include "qm_ui/push/incrementfunctionplot.h"

#include "qm_base/msgfunction.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/push/pushcases.h"

using zql::lib::MMSGFunction;

T_PLOT IncrementFunctionPlot(const T_POFC_D& function)
{
    T_PLOT plot;
    plot.title = MMSGFunction::Format("IDS_QM_UI_POFC_PLOT", {function.name});
    plot.x.title = MMSGFunction::GetValue("IDS_QM_UI_POFC_STEP");
    plot.y.title = MMSGFunction::GetValue("IDS_QM_UI_POFC_FACTOR");
    if (!IncrementFunctionFindings(function).empty()) {
        plot.subtitle = MMSGFunction::GetValue("IDS_QM_UI_POFC_BROKEN");
        return plot;
    }
    T_PLOT_SERIES rows;
    rows.name = MMSGFunction::GetValue("IDS_QM_UI_POFC_ROWS");
    rows.x.push_back(0.0);
    rows.y.push_back(0.0);
    rows.x.insert(rows.x.end(), function.step.begin(), function.step.end());
    rows.y.insert(rows.y.end(), function.factor.begin(), function.factor.end());
    rows.line = PLOT_LINE::Solid;
    rows.marker = PLOT_MARKER::Square;
    const T_PUSH_INCREMENTS increments = IncrementsOf(function);
    plot.subtitle =
        MMSGFunction::Format("IDS_QM_UI_POFC_COUNT", {std::to_string(increments.fractions.size())});
    plot.series = {std::move(rows)};
    return plot;
}
