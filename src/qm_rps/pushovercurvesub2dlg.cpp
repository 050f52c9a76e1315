#include "qm_rps/pushovercurvesub2dlg.h"

#include "qm_base/msgfunction.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/desk/recordnames.h"
#include "qm_rps/pushovercurvedampparamuser.h"

std::vector<std::string> CPushOverCurveSub2Dlg::Spectra() const
{
    return NamesOf(m_doc.Data().Model().spectra);
}

std::vector<std::string> CPushOverCurveSub2Dlg::Behaviors() const
{
    constexpr std::array kAtc{"IDS_QM_UI_PUSH_TYPE_A", "IDS_QM_UI_PUSH_TYPE_B",
                              "IDS_QM_UI_PUSH_TYPE_C", "IDS_QM_UI_PUSH_TYPE_USER"};
    constexpr std::array kFema{"IDS_QM_UI_PUSH_MODEL_BILINEAR", "IDS_QM_UI_PUSH_MODEL_STIFFNESS",
                               "IDS_QM_UI_PUSH_MODEL_STRENGTH", "IDS_QM_UI_PUSH_MODEL_ANY"};
    return TextsOf(IsFema440() ? kFema : kAtc);
}

std::string CPushOverCurveSub2Dlg::BehaviorLabel() const
{
    return zql::lib::MMSGFunction::GetValue(IsFema440() ? "IDS_QM_UI_PUSH_HYSTERESIS"
                                                        : "IDS_QM_UI_PUSH_BEHAVIOR");
}

bool CPushOverCurveSub2Dlg::HasUserDamping() const
{
    return m_settings.method == PUSH_METHOD::Atc40 && m_settings.behavior == kUserBehavior;
}

int CPushOverCurveSub2Dlg::OnUserDamping()
{
    CPushOverCurveDampParamUser points;
    points.Data2Dlg(m_settings.userDamping.value_or(std::array<double, 4>{})); // as it is evaluated
    points.SetView(View());
    if (!points.DoModal()) return 0;
    points.Dlg2Data(m_settings.userDamping.emplace());
    return 1;
}
