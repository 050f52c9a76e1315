// Views of the dialogs of the pushover curve window.
#include "qm_base/msgfunction.h"
#include "qm_rps/dialog/texttable.h"
#include "qm_rps/pushoveradditionalstepdlg.h"
#include "qm_rps/pushovercomparisondlg.h"
#include "qm_rps/pushovercontroldlg.h"
#include "qm_rps/pushovercurvedampparamuser.h"
#include "qm_rps/pushovertextdlg.h"
#include "qm_ui/plot/plotfile.h"
#include "qm_ui/pushover/comparisonplot.h"
#include "qm_ui/pushover/pushovercurveplot.h"
#include "qm_ui/pushover/pushovercurveview.h"
#include "qm_ui/pushover/pushoverfields.h"

using zql::lib::MMSGFunction;

void BuildPushOverControl(CFormView& form, CPushOverControlDlg& m)
{
    form.SetFindings([&m] { return m.Findings(); });
    form.Note([&m] { return m.ControlText(); });
    form.Choice(KeyText("IDS_QM_UI_PUSH_DRIFT_KIND"),
                {[&m] { return m.m_driftKind - 1; }, [&m](const int& i) { m.m_driftKind = i + 1; }},
                KeyTexts({"IDS_QM_UI_PUSH_DRIFT_1", "IDS_QM_UI_PUSH_DRIFT_2"}))
        .name = "driftKind";
    form.Optional(KeyText("IDS_QM_UI_PUSH_WEIGHT"), Ref(m.m_weight),
                  PlainLabel(std::string(NameOf(m.Units().force))))
        .name = "weight";
    for (std::size_t i = 0; i < m.m_nodes.size(); ++i) {
        const auto caption = [i] {
            return MMSGFunction::Format("IDS_QM_UI_PUSH_NODE", {std::to_string(i + 1)});
        };
        form.Integer(caption, Ref(m.m_nodes[i])).name =
            i == 0 ? "monitoredNodes" : "node" + std::to_string(i + 1);
    }
}

void BuildAdditionalSteps(CFormView& form, CPushOverAdditionalStepDlg& m)
{
    form.Note([&m] {
        return MMSGFunction::Format("IDS_QM_UI_PUSH_STEPS_NOTE", {std::to_string(m.StepCount())});
    });
    T_GRID_BINDING list = GridOf([&m] {
        T_TEXT_TABLE t{{{MMSGFunction::GetValue("IDS_QM_UI_PUSH_STEP"), true}}, {}};
        for (const int step : m.Steps())
            t.rows.push_back({std::to_string(step)});
        return t;
    });
    list.selected = [&m] { return m.m_row; };
    list.select = [&m](int row) { m.m_row = row; };
    form.Grid(std::move(list)).name = "list";
    form.Integer(KeyText("IDS_QM_UI_PUSH_STEP"), Ref(m.m_step)).name = "step";
    form.Columns();
    form.Button(KeyText("IDS_QM_UI_PUSH_ADD_STEP"), [&m] { m.OnAdd(); }).name = "add";
    form.NextColumn();
    form.Button(KeyText("IDS_QM_UI_PUSH_REMOVE"), [&m] { m.OnRemove(); }).name = "remove";
    form.EndColumns();
}

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
    form.Custom({}, MakeTextPage([&m] { return m.Text(); }, form.Host())).name = "text";
    auto& intro = form.Flag(KeyText("IDS_QM_UI_PUSH_WITH_INTRO"), Ref(m.m_withIntro));
    intro.name = "intro";
    intro.shown = [&m] { return !m.m_intro.empty(); };
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
