#include "qm_rps/pushovercurvedampparamuser.h"

#include "qm_db/recordfacts.h"
#include "qm_rps/pushover/adrsformulas.h"

#include <algorithm>

void CPushOverCurveDampParamUser::Data2Dlg(const std::array<double, 4>& points)
{
    m_beta1 = points[0];
    m_kappa1 = points[1];
    m_beta2 = points[2];
    m_kappa2 = points[3];
}

void CPushOverCurveDampParamUser::Dlg2Data(std::array<double, 4>& points) const
{
    points = {m_beta1, m_kappa1, m_beta2, m_kappa2};
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
    T_EVAL_D evaluation; // its other options are absent, which is in order
    Dlg2Data(evaluation.userDamping.emplace());
    const std::vector<T_FINDING> found = OptionFindings(evaluation);
    if (found.empty()) return 1;
    ShowMessage(found.front().messageKey, found.front().text);
    return 0;
}
