#include "qm_rps/po_femaunloadstifffigureedlg.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"

using zql::lib::MMSGFunction;

namespace {
constexpr double kFactors[] = {-1.0, 0.0, 1.0};
}

std::vector<T_FIGURE_CURVE> CPO_FEMAUnloadStiffFigureEDlg::Curves() const
{
    std::vector<T_FIGURE_CURVE> curves{
        {MMSGFunction::GetValue("IDS_QM_UI_FIGURE_FULL_LOOP"), DegradedLoop(kDuctility, 1.0, 0.0)}};
    for (const double factor : kFactors)
        curves.push_back({MMSGFunction::Format("IDS_QM_UI_FIGURE_FACTOR",
                                               {factor == 0.0 ? "0" : FormatText("%+.0f", factor)}),
                          DegradedLoop(kDuctility, kEnergy, factor)});
    return curves;
}

/// The ends of unloading, with the stiffness that leads there.
std::vector<T_FIGURE_POINT> CPO_FEMAUnloadStiffFigureEDlg::Points() const
{
    std::vector<T_FIGURE_POINT> points;
    for (const double factor : kFactors) {
        T_FIGURE_POINT end = DegradedLoop(kDuctility, kEnergy, factor)[1];
        end.label = FormatText("Ku = %.2f K0", UnloadingStiffness(kDuctility, kEnergy, factor));
        points.push_back(std::move(end));
    }
    return points;
}
