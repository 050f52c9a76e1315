// Views of the dialogs of the pushover curve window.
#include "qm_rps/pushovercomparisondlg.h"
#include "qm_rps/pushovercurvedampparamuser.h"
#include "qm_rps/pushovertextdlg.h"
#include "qm_ui/plot/plotfile.h"
#include "qm_ui/pushover/comparisonplot.h"
#include "qm_ui/pushover/pushovercurveplot.h"
#include "qm_ui/pushover/pushovercurveview.h"
#include "qm_ui/pushover/pushoverfields.h"

void BuildUserDamping(CFormView& form, CPushOverCurveDampParamUser& m)
{
    form.Note(KeyText("IDS_QM_UI_PUSH_USER_NOTE"));
    form.Number(KeyText("IDS_QM_UI_PUSH_BETA_1"), Ref(m.m_beta1), PlainLabel("%")).name = "beta1";
    form.Number(KeyText("IDS_QM_UI_PUSH_KAPPA_1"), Ref(m.m_kappa1)).name = "kappa1";
    form.Number(KeyText("IDS_QM_UI_PUSH_BETA_2"), Ref(m.m_beta2), PlainLabel("%")).name = "beta2";
    form.Number(KeyText("IDS_QM_UI_PUSH_KAPPA_2"), Ref(m.m_kappa2)).name = "kappa2";
    AddPicture(form, [&m] { return UserDampingPlot(m); }, {480, 300});
}

void BuildPushOverText(CFormView& form, CPushOverTextDlg& m)
{
    form.Custom({}, MakeTextPage([&m] { return m.m_text; }, form.Host())).name = "text";
    form.Button(KeyText("IDS_QM_UI_PUSH_SAVE_TEXT"), [&m] { m.OnSave(); }).name = "save";
    auto& saved = form.Note([&m] { return m.SavedPath(); });
    saved.name = "saved";
    saved.shown = [&m] { return !m.SavedPath().empty(); };
}

void BuildPushOverComparison(CFormView& form, CPushOverComparisonDlg& m)
{
    const auto pushes = [&m] { return m.LoadCases(); };
    const auto spectra = [&m] { return m.Spectra(); };
    form.m_onChange = [&m] { m.Update(); };
    form.Columns();
    form.Choice(KeyText("IDS_QM_UI_HEAD_PUSHOVER"), NameRef(m.m_push, pushes), pushes).name =
        "push";
    form.NextColumn();
    form.Choice(KeyText("IDS_QM_UI_HEAD_SPECTRUM"), NameRef(m.m_spectrum, spectra), spectra).name =
        "spectrum";
    form.NextColumn();
    form.Choice(
            KeyText("IDS_QM_UI_PUSH_BEHAVIOR"), Ref(m.m_behavior),
            KeyTexts({"IDS_QM_UI_PUSH_TYPE_A", "IDS_QM_UI_PUSH_TYPE_B", "IDS_QM_UI_PUSH_TYPE_C"}))
        .name = "behavior";
    form.EndColumns();
    const auto plot = [&m] {
        T_PLOT shown = ComparisonPlot(m.Comparison());
        shown.notes.clear(); // their values stand in the table
        return shown;
    };
    AddPicture(form, plot, {720, 400}).name = "plot";
    form.Grid(GridOf([&m] { return m.Cells(); })).name = "table";
    form.Note([&m] { return m.SpreadText(); }).name = "spread";
    form.Button(KeyText("IDS_QM_UI_PUSH_PICTURE"),
                [&m] {
                    const std::string path = m.m_askPath ? m.m_askPath() : std::string();
                    std::string error;
                    if (!path.empty() &&
                        !WritePlotFile(ComparisonPlot(m.Comparison()), path, error))
                        m.SayNotWritten(error);
                })
        .name = "picture";
}
