#include "qm_rps/pushovercurvesub4dlg.h"

int CPushOverCurveSub4Dlg::CheckData()
{
    const auto inRange = [](const std::optional<double>& v) {
        return !v || (*v > 0.0 && *v <= 1.0); // a NaN fails
    };
    if (inRange(m_options.secant) && inRange(m_options.drop)) return 1;
    ShowMessage("IDS_DB_PO_CURVE_PP_BETWEEN_0_1");
    return 0;
}
