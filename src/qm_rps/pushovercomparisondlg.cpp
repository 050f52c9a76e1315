#include "qm_rps/pushovercomparisondlg.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/desk/recordnames.h"
#include "qm_rps/pushover/outcometext.h"
#include "qm_rps/pushovercalculators.h"

using zql::lib::MMSGFunction;

std::vector<std::string> CPushOverComparisonDlg::LoadCases() const
{
    return PushNames(m_doc.Data().Model());
}

std::vector<std::string> CPushOverComparisonDlg::Spectra() const
{
    return NamesOf(m_doc.Data().Model().spectra);
}

int CPushOverComparisonDlg::Update()
{
    TakeOneOf(LoadCases(), m_push);
    TakeOneOf(Spectra(), m_spectrum);
    m_error.clear();
    if (m_push.empty() || m_spectrum.empty()) {
        m_error = MMSGFunction::GetValue(m_push.empty() ? "IDS_QM_UI_PUSH_NO_CASE"
                                                        : "IDS_QM_UI_PUSH_NO_SPECTRUM");
        return 0;
    }
    CPushEvaluator evaluator(m_doc, RunPerfPtProcedure);
    T_FINDING refusal;
    const int done =
        ComparePushover(evaluator, {m_push, m_spectrum, m_behavior, {}}, m_comparison, refusal);
    m_error = refusal.text;
    return done;
}

T_TEXT_TABLE CPushOverComparisonDlg::Cells() const
{
    const T_UNITS units = m_doc.Unit().Units();
    const std::string L(NameOf(units.length)), F(NameOf(units.force));
    const auto text = [](const char* key) { return MMSGFunction::GetValue(key); };
    T_TEXT_TABLE t{{{text("IDS_QM_UI_HEAD_METHOD")},
                    {"D (" + L + ")", true},
                    {"V (" + F + ")", true},
                    {"Sd (" + L + ")", true},
                    {"Sa (g)", true},
                    {text("IDS_QM_UI_PUSH_TO_MEAN"), true},
                    {text("IDS_QM_UI_PUSH_OUTCOME")}},
                   {}};
    for (const T_COMPARISON_ROW& row : m_comparison.rows) {
        const auto value = [&](double v) { return row.found ? FormatText("%.5g", v) : "-"; };
        t.rows.push_back({row.label, value(row.D), value(row.V), value(row.Sd), value(row.Sa),
                          row.found ? FormatText("%.3f", row.D / m_comparison.meanD) : "-",
                          OutcomeText(row.outcome)});
    }
    return t;
}

std::string CPushOverComparisonDlg::SpreadText() const
{
    if (!m_error.empty()) return m_error;
    const T_PUSH_COMPARISON& c = m_comparison;
    if (c.count == 0) return MMSGFunction::GetValue("IDS_QM_UI_PUSH_NO_SPREAD");
    std::string text =
        MMSGFunction::Format("IDS_QM_UI_PUSH_SPREAD",
                             {std::to_string(c.count), FormatText("%.5g", c.minD),
                              FormatText("%.5g", c.maxD), NameOf(m_doc.Unit().Units().length),
                              FormatText("%.5g", c.meanD), FormatText("%.3f", c.maxD / c.minD)});
    for (const std::string& remark : RemarksOf(c))
        text += "\n! " + remark;
    return text;
}
