#include "qm_rps/pushovercurvesub1dlg.h"

#include "qm_base/msgfunction.h"
#include "qm_rps/pushover/pushevaluation.h"

namespace {

constexpr std::array<const char*, 3> kProcedureKeys{
    "IDS_RPS_PO_PROC_TYPE_A", "IDS_RPS_PO_PROC_TYPE_B", "IDS_RPS_PO_PROC_TYPE_C"};

} // namespace

std::span<const char* const> CPushOverCurveSub1Dlg::Procedures(PUSH_METHOD method)
{
    const std::span<const char* const> all(kProcedureKeys);
    if (method == PUSH_METHOD::Fema440) return all;
    return method == PUSH_METHOD::Atc40 ? all.first(2) : all.first(0);
}

int CPushOverCurveSub1Dlg::CheckData()
{
    const auto offered = Procedures(m_method).size();
    const auto index = static_cast<std::size_t>(m_procedure - 'A');
    // A target displacement has no procedure: A stands for its only way.
    if (index < (offered == 0 ? 1 : offered)) return 1;
    ShowMessage(
        "IDS_QM_NO_SUCH_PROCEDURE",
        zql::lib::MMSGFunction::Format("IDS_QM_NO_SUCH_PROCEDURE",
                                       {MethodName(m_method), std::string(1, m_procedure)}));
    return 0;
}
