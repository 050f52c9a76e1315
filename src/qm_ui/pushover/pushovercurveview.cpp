#include "qm_ui/pushover/pushovercurveview.h"

#include "qm_base/msgfunction.h"
#include "qm_rps/pushover/report/pushovercells.h"
#include "qm_ui/plot/plotdrawing.h"
#include "qm_ui/plot/plotfile.h"
#include "qm_ui/pushover/evaluationplot.h"
#include "qm_ui/pushover/pushovercurveplot.h"
#include "qm_ui/pushover/pushoverfields.h"
#include "qm_ui/report/printing.h"

namespace {

using zql::lib::MMSGFunction;
using MODEL = CPushOverCurveEdit;

T_PLOT PlotOf(const MODEL& m)
{
    return PushoverCurvePlot(m.Shown().Pictured(), m.m_show, m.Shown().Trial());
}

void OnGraphExport(MODEL& m)
{
    const std::string path = m.AskPath("IDS_QM_UI_PICTURE_FILTER");
    std::string error;
    if (!path.empty() && !WritePlotFile(PlotOf(m), path, error)) m.SayNotWritten(error);
}

void OnGraphPrint(QWidget* parent, const MODEL& m)
{
    const T_PLOT plot = PlotOf(m);
    (void)PrintDrawing(parent, DrawingOf(plot));
}

void BuildEvaluation(CFormView& form, MODEL& m)
{
    form.Group(KeyText("IDS_QM_UI_PUSH_EVALUATION"));
    const auto entries = [&m] {
        std::vector<std::string> names{MMSGFunction::GetValue("IDS_QM_UI_PUSH_NEW")};
        for (std::string& name : m.Evaluations())
            names.push_back(std::move(name));
        return names;
    };
    const T_BINDING<int> stored = NameRef(m.m_settings.name, entries);
    form.Choice(KeyText("IDS_QM_UI_PUSH_OPEN"),
                {[stored] { return std::max(stored.get(), 0); },
                 [&m, entries](const int& i) {
                     if (i < 1 || !m.OnOpen(entries()[static_cast<std::size_t>(i)])) m.OnNew();
                 }},
                entries)
        .name = "open";
    form.Text(KeyText("IDS_QM_UI_PUSH_NAME"), Ref(m.m_settings.name)).name = "name";
    form.Button(KeyText("IDS_QM_UI_PUSH_STORE"), [&m] { (void)m.OnStore(); }).name = "store";
    form.EndGroup();
}

void BuildMethod(CFormView& form, MODEL& m)
{
    T_EVAL_D& s = m.m_settings;
    const auto pushes = [&m] { return m.m_methodPage.LoadCases(); };
    const auto spectra = [&m] { return m.m_demandPage.Spectra(); };
    form.Choice(KeyText("IDS_QM_UI_HEAD_PUSHOVER"), NameRef(s.push, pushes), pushes).name = "push";
    form.Choice(
            KeyText("IDS_QM_UI_HEAD_METHOD"),
            {[&s] { return static_cast<int>(s.method) - static_cast<int>(PUSH_METHOD::Fema440); },
             [&m](const int& i) {
                 m.m_methodPage.ChangeMethod(
                     static_cast<PUSH_METHOD>(i + static_cast<int>(PUSH_METHOD::Fema440)));
             }},
            CPushOverCurveSub1Dlg::Methods)
        .name = "method";
    auto& procedure =
        form.Choice(KeyText("IDS_QM_UI_PUSH_PROCEDURE"),
                    {[&s] { return s.procedure.value_or('A') - 'A'; },
                     [&s](const int& i) { s.procedure = static_cast<char>('A' + i); }},
                    [&m] { return m.m_methodPage.Procedures(); });
    procedure.name = "procedure";
    procedure.shown = [&m] { return !m.m_methodPage.IsTarget(); };
    form.Choice(KeyText("IDS_QM_UI_HEAD_SPECTRUM"), NameRef(s.spectrum, spectra), spectra).name =
        "spectrum";
    form.Choice(KeyText("IDS_QM_UI_PUSH_PLOT"),
                {[&s] { return s.plotType.value_or(static_cast<int>(s.method)); },
                 [&s](const int& i) { s.plotType = i; }},
                CPushOverCurveSub1Dlg::PlotTypes)
        .name = "plotType";
}

void BuildDamping(CFormView& form, MODEL& m)
{
    T_EVAL_D& s = m.m_settings;
    auto& behavior =
        form.Choice([&m] { return m.m_demandPage.BehaviorLabel(); }, OrDefault(s.behavior, 0),
                    [&m] { return m.m_demandPage.Behaviors(); });
    behavior.name = "behavior";
    behavior.shown = [&m] { return !m.m_methodPage.IsTarget(); };
    auto& damping = form.Number(KeyText("IDS_QM_UI_PUSH_ELASTIC_DAMPING"),
                                OrDefault(s.elasticDamping, 5.0), PlainLabel("%"));
    damping.name = "elasticDamping";
    damping.shown = [&m] { return !m.m_methodPage.IsTarget(); };
    auto& user = form.Button(KeyText("IDS_QM_UI_PUSH_USER_DAMPING"), [&m] { m.OnUserDamping(); });
    user.name = "userDamping";
    user.shown = [&m] { return m.m_demandPage.HasUserDamping(); };
    form.Flag(KeyText("IDS_QM_UI_PUSH_EIGEN"), OrDefault(s.eigenFactors, true)).name = "eigen";
    auto& percent =
        form.Flag(KeyText("IDS_QM_UI_PUSH_ALPHA_PCT"), OrDefault(s.alphaInPercent, false));
    percent.name = "alphaInPercent";
    percent.shown = [&m] { return m.m_settings.method == PUSH_METHOD::Fema440; };
    auto& drift = form.Choice(
        KeyText("IDS_QM_UI_PUSH_DRIFT_KIND"),
        {[&s] { return s.driftKind.value_or(1) - 1; }, [&s](const int& i) { s.driftKind = i + 1; }},
        KeyTexts({"IDS_QM_UI_PUSH_DRIFT_1", "IDS_QM_UI_PUSH_DRIFT_2"}));
    drift.name = "driftKind";
    form.Button(KeyText("IDS_QM_UI_PUSH_CONTROL"), [&m] { (void)m.OnControl(); }).name = "control";
    drift.shown = [&m] { return m.m_methodPage.IsTarget(); };
    auto& masonry = form.Flag(KeyText("IDS_QM_UI_PUSH_MASONRY"), {[&m] { return m.IsMasonry(); },
                                                                  [&m, &s](const bool& on) {
                                                                      if (on != m.IsMasonry())
                                                                          s.masonry = on;
                                                                  }});
    masonry.name = "masonry";
    masonry.shown = [&m] { return m.m_settings.method == PUSH_METHOD::Ec8Opcm; };
}

void BuildBilinear(CFormView& form, MODEL& model)
{
    CPushOverCurveSub4Dlg& m = model.m_bilinearPage;
    const auto value = [&m](auto member) {
        using T = std::remove_reference_t<decltype(m.Options().*member)>;
        return T_BINDING<T>{[&m, member] { return m.Options().*member; },
                            [&m, member](const T& v) { m.Options().*member = v; }};
    };
    static const std::vector<std::string> rules{"", "ec8", "ntc", "masonry"};
    form.Choice(KeyText(CPushOverCurveSub4Dlg::kLabels[0]),
                {[&m] {
                     const auto it = std::ranges::find(rules, m.Options().rule.value_or(""));
                     return static_cast<int>(it - rules.begin());
                 },
                 [&m](const int& i) {
                     if (i == 0)
                         m.Options().rule.reset();
                     else
                         m.Options().rule = rules[static_cast<std::size_t>(i)];
                 }},
                KeyTexts({"IDS_QM_UI_PUSH_RULE_OWN", "IDS_QM_UI_PUSH_RULE_EC8",
                          "IDS_QM_UI_PUSH_RULE_NTC", "IDS_QM_UI_PUSH_RULE_MASONRY"}))
        .name = "bilinear.rule";
    form.Note(KeyText(CPushOverCurveSub4Dlg::kLabels[1]));
    form.Optional(KeyText("IDS_QM_UI_PUSH_FRACTION"), value(&T_EVAL_BILINEAR::secant)).name =
        "bilinear.secant";
    form.Choice(KeyText(CPushOverCurveSub4Dlg::kLabels[2]),
                {[&m] { return m.Options().strength == "peak" ? 1 : 0; },
                 [&m](const int& i) {
                     if (i == 1)
                         m.Options().strength = "peak";
                     else
                         m.Options().strength.reset();
                 }},
                KeyTexts({"IDS_QM_UI_PUSH_STRENGTH_RULE", "IDS_QM_UI_PUSH_STRENGTH_PEAK"}))
        .name = "bilinear.strength";
    form.Note(KeyText(CPushOverCurveSub4Dlg::kLabels[3]));
    form.Optional(KeyText("IDS_QM_UI_PUSH_FRACTION"), value(&T_EVAL_BILINEAR::drop)).name =
        "bilinear.drop";
    auto& iterate = form.Flag(KeyText("IDS_QM_UI_PUSH_ITERATE"),
                              {[&m] { return m.Options().iterate.value_or(false); },
                               [&m](const bool& on) { m.Options().iterate = on; }});
    iterate.name = "bilinear.iterate";
    iterate.enabled = [&model] { return model.m_settings.method == PUSH_METHOD::Ec8Opcm; };
}

void BuildShown(CFormView& form, MODEL& m)
{
    T_PUSH_SHOW& s = m.m_show;
    const auto lines = [&s] { return s.guideLines; };
    form.Flag(KeyText("IDS_QM_UI_PUSH_SHOW_LINES"), Ref(s.guideLines)).name = "guideLines";
    form.Flag(KeyText("IDS_QM_UI_PUSH_SHOW_DEMAND"), Ref(s.demandLines)).enabled = lines;
    form.Flag(KeyText("IDS_QM_UI_PUSH_SHOW_CAPACITY"), Ref(s.capacityLines)).enabled = lines;
    form.Flag(KeyText("IDS_QM_UI_PUSH_SHOW_QSTAR"), Ref(s.qStarLine)).enabled = lines;
    form.Flag(KeyText("IDS_QM_UI_PUSH_SHOW_SYMBOLS"), Ref(s.symbols)).name = "symbols";
}

void BuildResults(CFormView& form, MODEL& m)
{
    const auto target = [&m] { return m.m_methodPage.IsTarget(); };
    const auto point = [&m] { return !m.m_methodPage.IsTarget(); };
    form.Page(KeyText("IDS_QM_UI_PUSH_PAGE_RESULT"));
    form.Grid(GridOf([&m] { return PushoverResultCells(m.Shown().Result()); })).name = "cells";
    form.Page(KeyText("IDS_QM_UI_PUSH_PAGE_STATES"), target);
    form.Grid(GridOf([&m] { return PushoverStateCells(m.Shown().Result()); })).name = "states";
    form.Note([&m] { return m.StoredStepsText(); });
    form.Button(KeyText("IDS_QM_UI_PUSH_STORE_STEPS"), [&m] { (void)m.OnStoreSteps(); }).name =
        "storeSteps";
    form.Page(KeyText("IDS_QM_UI_PUSH_TRIALS"), point);
    T_GRID_BINDING trials = GridOf([&m] { return PushoverTrialCells(m.Shown().Pictured()); });
    trials.selected = [&m] { return m.Shown().Trial() - 1; };
    trials.select = [&m](int row) { m.Shown().SetTrial(row + 1); };
    form.Grid(std::move(trials)).name = "trials";
    form.Page(KeyText("IDS_QM_UI_PUSH_PAGE_OUTCOME"));
    form.Custom({}, MakeTextPage(
                        [&m] {
                            return OutcomeLines(m.Shown().Result()) + "\n" + m.Shown().CaseText() +
                                   "\n" + m.Shown().Result().gammaNote;
                        },
                        form.Host()))
        .name = "outcome";
    form.Page(KeyText("IDS_QM_UI_PUSH_PAGE_CURVE"));
    form.Grid(GridOf([&m] { return PushoverCurveCells(m.Shown().Pictured()); })).name = "curve";
}

/// The demand alone, over displacements or periods.
void BuildDemand(CFormView& form, MODEL& m)
{
    form.Page(KeyText("IDS_QM_UI_HEAD_SPECTRUM"));
    form.Choice(KeyText("IDS_QM_UI_PUSH_SPECTRUM_OVER"),
                {[&m] { return static_cast<int>(m.m_show.spectrumOver); },
                 [&m](const int& i) { m.m_show.spectrumOver = static_cast<SPECTRUM_SHOW>(i); }},
                KeyTexts({"IDS_QM_UI_PUSH_OVER_SD", "IDS_QM_UI_PUSH_OVER_T"}))
        .name = "spectrumOver";
    AddPicture(form, [&m] { return DemandPlot(m.Shown().Result()); }, {680, 260}).name = "demand";
}

void BuildAdditional(CFormView& form, MODEL& m)
{
    const auto list = [&form](T_GRID_BINDING grid, int& row, const char* name) {
        grid.selected = [&row] { return row; };
        grid.select = [&row](int r) { row = r; };
        form.Grid(std::move(grid)).name = name;
    };
    const auto buttons = [&form](const char* add, std::function<void()> onAdd,
                                 std::function<void()> onRemove, const std::string& name) {
        form.Columns();
        form.Button(KeyText(add), std::move(onAdd)).name = "add" + name;
        form.NextColumn();
        form.Button(KeyText("IDS_QM_UI_PUSH_REMOVE"), std::move(onRemove)).name = "remove" + name;
        form.EndColumns();
    };
    form.Page(KeyText("IDS_QM_UI_PUSH_PAGE_STEPS"));
    list(GridOf([&m] { return AdditionalStepCells(m.Shown().Result()); }), m.m_stepRow, "steps");
    form.Integer(KeyText("IDS_QM_UI_PUSH_STEP"), Ref(m.m_addStep)).name = "addStepNumber";
    buttons(
        "IDS_QM_UI_PUSH_ADD_STEP", [&m] { m.OnAddStep(); }, [&m] { m.OnRemoveStep(m.m_stepRow); },
        "Step");
    form.Button(KeyText("IDS_QM_UI_PUSH_STEPS_DLG"), [&m] { (void)m.OnSteps(); }).name = "stepsDlg";
    form.Page(KeyText("IDS_QM_UI_PUSH_PAGE_POINTS"), [&m] { return !m.m_methodPage.IsTarget(); });
    list(GridOf([&m] { return AdditionalPointCells(m.Shown().Result()); }), m.m_pointRow, "points");
    const auto spectra = [&m] { return m.m_demandPage.Spectra(); };
    form.Choice(KeyText("IDS_QM_UI_HEAD_SPECTRUM"), NameRef(m.m_addSpectrum, spectra), spectra)
        .name = "addPointSpectrum";
    buttons(
        "IDS_QM_UI_PUSH_ADD_POINT", [&m] { m.OnAddPoint(); },
        [&m] { m.OnRemovePoint(m.m_pointRow); }, "Point");
}

void BuildButtons(CFormView& form, MODEL& m)
{
    struct T_BUTTON {
        const char* key;
        const char* name;
        std::function<void()> run;
    };
    QWidget* const host = form.Host();
    const T_BUTTON buttons[] = {
        {"IDS_QM_UI_PUSH_POINTS_HINGES", "hinges", [&m] { (void)m.OnHinges(); }},
        {"IDS_QM_UI_JUDGE", "judge", [&m] { (void)m.OnJudge(); }},
        {"IDS_QM_UI_PUSH_REPORT", "report", [&m] { m.OnPushoverCurveTextout(); }},
        {"IDS_QM_UI_PUSH_CURVE_FILE", "curveFile", [&m] { m.OnCurveText(); }},
        {"IDS_QM_UI_PUSH_PICTURE", "picture", [&m] { OnGraphExport(m); }},
        {"IDS_QM_UI_PUSH_PRINT", "print", [host, &m] { OnGraphPrint(host, m); }},
        {"IDS_QM_UI_PUSH_COMPARE", "compare", [&m] { m.OnCompare(); }}};
    form.Columns();
    for (const T_BUTTON& button : buttons) {
        if (&button != buttons) form.NextColumn();
        form.Button(KeyText(button.key), button.run).name = button.name;
    }
    form.EndColumns();
}

} // namespace

void BuildPushOverCurve(CFormView& form, CPushOverCurveEdit& m)
{
    form.m_onChange = [&m] { m.OnEdited(); };
    form.SetFindings([&m] { return m.Findings(); });
    form.Columns();
    BuildEvaluation(form, m);
    form.Page(KeyText("IDS_QM_UI_PUSH_PAGE_METHOD"));
    BuildMethod(form, m);
    BuildDamping(form, m);
    form.Space();
    form.Page(KeyText("IDS_QM_UI_PUSH_PAGE_BILINEAR"), [&m] { return m.m_methodPage.IsTarget(); });
    BuildBilinear(form, m);
    form.Space();
    form.Page(KeyText("IDS_QM_UI_PUSH_PAGE_SHOWN"));
    BuildShown(form, m);
    form.Space();
    form.EndPages();
    form.NextColumn(1);
    auto& refusal = form.Note([&m] { return m.Shown().Refusal(); });
    refusal.name = "refusal";
    refusal.shown = [&m] { return !m.Shown().Refusal().empty(); };
    auto& remark = form.Note([&m] { return RemarkLine(m.Shown().Result()); });
    remark.name = "remark";
    remark.shown = [&m] { return !m.Shown().Result().messages.empty(); };
    const auto plot = [&m] {
        T_PLOT shown = PlotOf(m);
        shown.notes.clear(); // their values stand in the cells
        return shown;
    };
    AddPicture(form, plot, {680, 400}).name = "plot";
    auto& trial = form.Custom(
        KeyText("IDS_QM_UI_PUSH_TRIAL"),
        MakeStepField(
            {[&m] { return m.Shown().Trial(); }, [&m](const int& k) { m.Shown().SetTrial(k); }},
            [&m] { return m.Shown().TrialCount(); }, form.Changed(), form.Host()));
    trial.name = "trial";
    trial.shown = [&m] { return !m.m_methodPage.IsTarget(); };
    BuildResults(form, m);
    BuildDemand(form, m);
    BuildAdditional(form, m);
    form.EndPages();
    BuildButtons(form, m);
    form.EndColumns();
}
