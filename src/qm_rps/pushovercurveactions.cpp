// What the person asks the pushover curve window to do.
#include "qm_rps/pushovercurveedit.h"

#include "qm_base/msgfunction.h"
#include "qm_rps/desk/recordnames.h"
#include "qm_rps/pushover/pushoverreport.h"
#include "qm_rps/pushovercomparisondlg.h"
#include "qm_rps/pushovercurvedampparamuser.h"
#include "qm_rps/pushovertextdlg.h"

using zql::lib::MMSGFunction;

namespace {

/// Points of kappa that a new window starts with: type B of ATC-40 Table 8-1, 0.67 up to 25 per
/// cent and 0.53 at 45 per cent.
constexpr std::array<double, 4> kFirstUserDamping{25.0, 0.67, 45.0, 0.53};

} // namespace

int CPushOverCurveEdit::Say(const char* key)
{
    ShowMessage(key);
    return 0;
}

int CPushOverCurveEdit::OnUserDamping()
{
    const std::array<double, 4> now = m_settings.userDamping.value_or(kFirstUserDamping);
    CPushOverCurveDampParamUser points;
    points.Data2Dlg({kUserBehavior, 0.0, now[0], now[1], now[2], now[3]});
    points.SetView(View());
    if (!points.DoModal()) return 0;
    T_DAMP_PARAM damping;
    points.Dlg2Data(damping);
    m_settings.userDamping = {damping.beta1, damping.kappa1, damping.beta2, damping.kappa2};
    Update();
    return 1;
}

int CPushOverCurveEdit::OnStore()
{
    if (!Update()) {
        ShowMessage("IDS_QM_UI_PUSH_NOT_STORED",
                    MMSGFunction::Format("IDS_QM_UI_PUSH_NOT_STORED", {m_refusal}));
        return 0;
    }
    if (m_settings.name.empty()) return Say("IDS_QM_UI_PUSH_NO_NAME");
    const auto& table = m_doc.Data().Model().evaluations;
    int key = table.empty() ? 1 : table.rbegin()->first + 1;
    for (const auto& [other, record] : table) {
        if (record.name != m_settings.name) continue;
        if (record == m_settings) return 1;
        if (!AskYesNo("IDS_QM_UI_PUSH_REPLACE",
                      MMSGFunction::Format("IDS_QM_UI_PUSH_REPLACE", {record.name})))
            return 0;
        key = other;
        break;
    }
    CEditData& edit = m_doc.Edit();
    if (!edit.Begin(MMSGFunction::GetValue("IDS_QM_UI_TABLE_EVALUATIONS")))
        return Say("IDS_QM_UI_EDIT_BUSY");
    if (!edit.Put(key, m_settings) || !edit.Commit()) {
        edit.Rollback();
        return Say("IDS_QM_UI_EDIT_BUSY");
    }
    Update();
    if (m_changed) m_changed();
    return 1;
}

int CPushOverCurveEdit::OnStoreSteps()
{
    if (!IsTarget() || !Update() || m_result.limitStates.empty() || m_result.result == 0)
        return Say("IDS_QM_UI_PUSH_NO_STEPS");
    if (m_doc.Data().IsLocked()) return Say("IDS_QM_UI_EDIT_BUSY");
    Evaluate(true);
    if (m_changed) m_changed();
    return 1;
}

void CPushOverCurveEdit::ShowText(const char* titleKey, std::string text)
{
    CPushOverTextDlg preview;
    preview.SetView(View());
    preview.m_title = MMSGFunction::GetValue(titleKey);
    preview.m_text = std::move(text);
    preview.m_askPath = [this] { return AskPath("IDS_QM_UI_PUSH_TEXT_FILTER"); };
    (void)preview.DoModal();
}

void CPushOverCurveEdit::OnPushoverCurveTextout()
{
    ShowText("IDS_QM_UI_PUSH_REPORT_TITLE", PushoverReportText(m_result));
}

void CPushOverCurveEdit::OnCurveText()
{
    ShowText("IDS_QM_UI_PUSH_CURVE_TITLE", PushoverCurveText(m_result));
}

void CPushOverCurveEdit::OnCompare()
{
    CPushOverComparisonDlg comparison(m_doc);
    comparison.SetView(View());
    comparison.m_push = m_settings.push;
    comparison.m_spectrum = m_settings.spectrum;
    comparison.m_behavior = std::min(m_settings.behavior.value_or(0), kUserBehavior - 1);
    comparison.m_askPath = [this] { return AskPath("IDS_QM_UI_PICTURE_FILTER"); };
    comparison.Update();
    (void)comparison.DoModal();
}

std::string CPushOverCurveEdit::AskPath(const char* filterKey) const
{
    return m_askPath ? m_askPath(filterKey) : std::string();
}

int CPushOverCurveEdit::OnAddStep()
{
    if (!Update()) return Say("IDS_QM_SETTINGS");
    m_driver.ClearMessages();
    const int done = m_driver.OnPushoverCurveAddStep(m_addStep);
    if (done)
        m_steps.push_back(m_addStep);
    else
        ShowMessage(m_driver.Messages().back().key, m_driver.Messages().back().text);
    Update();
    return done;
}

int CPushOverCurveEdit::OnAddPoint()
{
    TakeOneOf(Spectra(), m_addSpectrum);
    if (Contains(m_points, m_addSpectrum))
        return Say("IDS_PUSHOVER_Error___The_data_already_exist_");
    if (!Update()) return Say("IDS_QM_SETTINGS");
    m_driver.ClearMessages();
    const int done = m_driver.CalcAdditionalPerformancePoint(m_addSpectrum);
    if (done)
        m_points.push_back(m_addSpectrum);
    else
        ShowMessage(m_driver.Messages().back().key, m_driver.Messages().back().text);
    Update();
    return done;
}

void CPushOverCurveEdit::OnRemoveStep(int row)
{
    if (row < 0 || row >= static_cast<int>(m_result.additionalSteps.size())) return;
    std::erase(m_steps, m_result.additionalSteps[static_cast<std::size_t>(row)].step);
    Update();
}

void CPushOverCurveEdit::OnRemovePoint(int row)
{
    if (row < 0 || row >= static_cast<int>(m_result.additionalPoints.size())) return;
    std::erase(m_points, m_result.additionalPoints[static_cast<std::size_t>(row)].spectrum);
    Update();
}
