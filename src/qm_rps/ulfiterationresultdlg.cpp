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

std::string UlfStayText(const T_ULF_STAY& stay, std::size_t column)
{
    const auto number = [](const std::optional<double>& value) {
        return value ? FormatText("%.7g", *value + 0.0) : std::string();
    };
    switch (column) {
    case 0:
        return std::to_string(stay.element);
    case 1:
        return stay.load;
    case 2:
        return number(stay.start);
    case 3:
        return number(stay.Factor());
    case 4:
        return number(stay.now);
    default:
        return number(stay.force);
    }
}
