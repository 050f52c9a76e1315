#include "qm_rps/pushoverpmminteractiondlg.h"

#include "qm_base/textformat.h"
#include "qm_rps/hinge/hingesiderules.h"

#include <cmath>

namespace {

constexpr const char* kCurve = "IDS_PUSHOVER_Wrong_Data_in_P_values";
constexpr auto kLit = RULE_TEXT::Literal;

struct T_POINT_CHECK {
    const T_PM_POINT& now;
    const T_PM_POINT* before; // null: the first point, which must only be finite
};
using P = T_POINT_CHECK;

// clang-format off
const T_HINGE_RULE<P> kPoint[] = {
    {{kCurve, kLit, "P/Pmax", nullptr, "p"}, [](const P& c) { return c.before ? NotAbove(c.now.p, c.before->p) : std::isfinite(c.now.p); }},
    {{kCurve, kLit, "M/Mmax", nullptr, "m"}, [](const P& c) { return c.before ? NotAbove(c.now.m, c.before->m) : std::isfinite(c.now.m); }},
};
const T_HINGE_RULE<T_PMM_TABLE> kTable[] = {
    {{"IDS_PUSHOVER_PMAX_POS", kLit, "Pmax >= 0", nullptr, "Pmax"}, [](const T_PMM_TABLE& t) { return NotAbove(0, t.Pmax); }},
};
// clang-format on

} // namespace

std::vector<T_FINDING> CPushOverPMMInteractionDlg::Findings() const
{
    std::vector<T_FINDING> out;
    for (std::size_t c = 0; c < m_table.curves.size(); ++c)
        for (std::size_t i = 0; i < m_table.curves[c].size(); ++i) {
            const P check{m_table.curves[c][i], i ? &m_table.curves[c][i - 1] : nullptr};
            WalkRules(kPoint, check,
                      {-1, HINGE_END::Both, -1, FormatText("curves[%zu][%zu].", c, i),
                       std::to_string(i + 1)},
                      out);
        }
    WalkRules(kTable, m_table, {}, out);
    return out;
}

int CPushOverPMMInteractionDlg::OnOK()
{
    if (!CheckData()) return 0;
    m_record = m_table;
    return 1;
}
