#include "qm_rps/pushovercurvesub4dlg.h"

T_EVAL_BILINEAR& CPushOverCurveSub4Dlg::Options()
{
    if (!m_settings.bilinear) m_settings.bilinear.emplace();
    return *m_settings.bilinear;
}

void CPushOverCurveSub4Dlg::DropEmpty()
{
    if (m_settings.bilinear == T_EVAL_BILINEAR{}) m_settings.bilinear.reset();
}
