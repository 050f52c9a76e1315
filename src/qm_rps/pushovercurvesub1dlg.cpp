#include "qm_rps/pushovercurvesub1dlg.h"

#include "qm_base/msgfunction.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/desk/recordnames.h"
#include "qm_rps/pushover/pushovercurvedata.h"

using zql::lib::MMSGFunction;

std::vector<std::string> CPushOverCurveSub1Dlg::LoadCases() const
{
    return PushNames(m_doc.Data().Model());
}

std::vector<std::string> CPushOverCurveSub1Dlg::Methods()
{
    return {kMethodNames.begin(), kMethodNames.end()};
}

std::vector<std::string> CPushOverCurveSub1Dlg::Procedures() const
{
    constexpr std::array kKeys{"IDS_RPS_PO_PROC_TYPE_A", "IDS_RPS_PO_PROC_TYPE_B",
                               "IDS_RPS_PO_PROC_TYPE_C"};
    return TextsOf(std::span(kKeys).first(ProceduresOf(m_settings.method).size()));
}

std::vector<std::string> CPushOverCurveSub1Dlg::PlotTypes()
{
    constexpr std::array kKeys{"IDS_QM_UI_PUSH_PLOT_REACTION", "IDS_QM_UI_PUSH_PLOT_SHEAR",
                               "IDS_QM_UI_PUSH_PLOT_DRIFT", "IDS_QM_UI_PUSH_PLOT_FACTOR"};
    std::vector<std::string> texts = TextsOf(kKeys);
    for (const char* const method : kMethodNames)
        texts.push_back(MMSGFunction::Format("IDS_QM_UI_PUSH_PLOT_SPECTRUM", {method}));
    return texts;
}

void CPushOverCurveSub1Dlg::ChangeMethod(PUSH_METHOD method)
{
    if (method == m_settings.method) return;
    if (m_settings.plotType && IsSpectral(static_cast<PLOT_TYPE>(*m_settings.plotType)))
        m_settings.plotType.reset();
    m_settings.method = method;
    const auto index = static_cast<std::size_t>(m_settings.procedure.value_or('A') - 'A');
    if (index >= ProceduresOf(method).size()) m_settings.procedure.reset();
}
