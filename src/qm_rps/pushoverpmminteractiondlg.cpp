#include "qm_rps/pushoverpmminteractiondlg.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"

#include <cmath>

namespace {

T_FINDING Finding(const char* key, std::string field, std::string rule, std::string point)
{
    T_FINDING f;
    f.field = std::move(field);
    f.ruleText = std::move(rule);
    f.messageKey = key;
    f.text = zql::lib::MMSGFunction::GetValue(key);
    f.point = std::move(point);
    return f;
}

/// The value does not rise from the point before; the first point must only be finite.
bool NotRising(const double* before, double value)
{
    return std::isfinite(value) && (!before || value <= *before);
}

} // namespace

std::vector<T_FINDING> CPushOverPMMInteractionDlg::Findings() const
{
    constexpr const char* kCurveKey = "IDS_PUSHOVER_Wrong_Data_in_P_values";
    std::vector<T_FINDING> out;
    for (std::size_t c = 0; c < m_table.curves.size(); ++c) {
        const T_PM_POINT* before = nullptr;
        for (std::size_t i = 0; i < m_table.curves[c].size(); ++i) {
            const T_PM_POINT& now = m_table.curves[c][i];
            const std::string field = FormatText("curves[%zu][%zu].", c, i);
            if (!NotRising(before ? &before->p : nullptr, now.p))
                out.push_back(Finding(kCurveKey, field + "p", "P/Pmax", std::to_string(i + 1)));
            if (!NotRising(before ? &before->m : nullptr, now.m))
                out.push_back(Finding(kCurveKey, field + "m", "M/Mmax", std::to_string(i + 1)));
            before = &now;
        }
    }
    if (!(m_table.Pmax >= 0.0) || !std::isfinite(m_table.Pmax))
        out.push_back(Finding("IDS_PUSHOVER_PMAX_POS", "Pmax", "Pmax >= 0", ""));
    return out;
}

int CPushOverPMMInteractionDlg::CheckData()
{
    const std::vector<T_FINDING> findings = Findings();
    if (findings.empty()) return 1;
    ShowMessage(findings.front().messageKey, findings.front().text);
    return 0;
}

int CPushOverPMMInteractionDlg::OnOK()
{
    if (!CheckData()) return 0;
    m_record = m_table;
    return 1;
}
