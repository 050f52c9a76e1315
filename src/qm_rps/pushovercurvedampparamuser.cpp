#include "qm_rps/pushovercurvedampparamuser.h"

#include "qm_rps/pushover/adrsformulas.h"

#include <algorithm>
#include <cmath>

void CPushOverCurveDampParamUser::Data2Dlg(const T_DAMP_PARAM& damping)
{
    m_beta1 = damping.beta1;
    m_kappa1 = damping.kappa1;
    m_beta2 = damping.beta2;
    m_kappa2 = damping.kappa2;
}

void CPushOverCurveDampParamUser::Dlg2Data(T_DAMP_PARAM& damping) const
{
    damping.beta1 = m_beta1;
    damping.kappa1 = m_kappa1;
    damping.beta2 = m_beta2;
    damping.kappa2 = m_kappa2;
}

std::vector<T_POINT2> CPushOverCurveDampParamUser::Curve() const
{
    return {{0.0, m_kappa1},
            {m_beta1, m_kappa1},
            {m_beta2, m_kappa2},
            {std::max(m_beta2, kFullLoopPct), m_kappa2}};
}

int CPushOverCurveDampParamUser::CheckData()
{
    const bool finite =
        std::isfinite(m_beta2) && std::isfinite(m_kappa1) && std::isfinite(m_kappa2);
    if (finite && m_beta1 <= m_beta2 && m_beta1 > 0.0 && m_beta2 > 0.0) return 1;
    ShowMessage("IDS_PUSHOVER_Wrong_Input_");
    return 0;
}
