#include "qm_rps/pushovercontroldlg.h"

#include "qm_base/msgfunction.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/pushover/pushovercurvedata.h"

#include <algorithm>

using zql::lib::MMSGFunction;

void CPushOverControlDlg::Data2Dlg(const T_EVAL_D& evaluation)
{
    m_read = evaluation;
    m_driftKind = evaluation.driftKind.value_or(1);
    m_weight = evaluation.weight;
    m_nodes = {};
    std::ranges::copy_n(
        evaluation.monitoredNodes.begin(),
        static_cast<std::ptrdiff_t>(std::min(evaluation.monitoredNodes.size(), m_nodes.size())),
        m_nodes.begin());
}

void CPushOverControlDlg::Dlg2Data(T_EVAL_D& evaluation) const
{
    if (evaluation.driftKind || m_driftKind != 1) evaluation.driftKind = m_driftKind;
    evaluation.weight = m_weight;
    evaluation.monitoredNodes.clear();
    std::ranges::copy_if(m_nodes, std::back_inserter(evaluation.monitoredNodes),
                         [](int node) { return node != 0; });
}

std::string CPushOverControlDlg::ControlText() const
{
    T_POLC_D polc;
    const auto push = FindPush(m_doc.Data().Model(), m_read.push);
    if (!push || !m_doc.Attr().GetPolc(push->key, polc)) return {};
    return polc.controlOption == kNamedControlNode
               ? MMSGFunction::Format("IDS_QM_UI_PUSH_CONTROL_NAMED",
                                      {std::to_string(polc.controlNode)})
               : MMSGFunction::GetValue("IDS_QM_UI_PUSH_CONTROL_FOUND");
}

std::vector<T_FINDING> CPushOverControlDlg::Findings() const
{
    T_EVAL_D evaluation = m_read;
    Dlg2Data(evaluation);
    return EvaluationFindings(evaluation, m_doc.Data().Model());
}
