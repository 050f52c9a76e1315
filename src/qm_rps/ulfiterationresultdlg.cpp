#include "qm_rps/ulfiterationresultdlg.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"

std::string CUlfIterationResultDlg::Summary() const
{
    return zql::lib::MMSGFunction::Format(
        "IDS_QM_UI_ULF_SOLUTION",
        {std::to_string(m_step.iteration), FormatText("%.6g", m_step.tolerance)});
}

std::string UlfIterCellText(const T_ULF_ITER_ROW& row, std::size_t column)
{
    switch (column) {
    case 0:
        return row.place;
    case 1:
        return row.load;
    case 2:
        return FormatText("%.9g", row.factor + 0.0);
    default:
        return row.pretension ? "1" : "0";
    }
}
