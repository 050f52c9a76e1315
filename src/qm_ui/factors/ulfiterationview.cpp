#include "qm_ui/factors/ulfiterationview.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_rps/ulfiterationrundlg.h"
#include "qm_rps/unknownloadfactoriteranaldlg.h"
#include "qm_ui/factors/iterationplot.h"
#include "qm_ui/form/localnumber.h"

#include <QAbstractSpinBox>
#include <QLineEdit>

using zql::lib::MMSGFunction;

namespace {

using RUN = CUlfIterationRunDlg;
using RESULT = CUlfIterationResultDlg;
using SETTINGS = CUnknownLoadFactorIterAnalDlg;

constexpr CELL_KIND kText = CELL_KIND::Text, kNumber = CELL_KIND::Number, kFlag = CELL_KIND::Flag;

// ---- settings -----------------------------------------------------------------------------------

/// A text that the model's spin button counts up and down.
class CSpinBox : public QAbstractSpinBox {
public:
    CSpinBox(SETTINGS& settings, QWidget* parent) : QAbstractSpinBox(parent), m_settings(settings)
    {
        connect(lineEdit(), &QLineEdit::textEdited, this,
                [this](const QString& text) { m_settings.m_required = text.toStdString(); });
    }
    void stepBy(int steps) override
    {
        m_settings.OnSpin(steps);
        ShowModel();
    }
    void ShowModel() { lineEdit()->setText(QString::fromStdString(m_settings.m_required)); }

protected:
    StepEnabled stepEnabled() const override { return StepUpEnabled | StepDownEnabled; }

private:
    SETTINGS& m_settings;
};

class CSpinField : public CFormField {
public:
    CSpinField(SETTINGS& settings, QWidget* parent) : m_box(new CSpinBox(settings, parent))
    {
        widget = m_box;
    }
    void Show() override { m_box->ShowModel(); }

private:
    CSpinBox* m_box;
};

void BuildSettings(CFormView& form, SETTINGS& settings)
{
    form.Custom(KeyText("IDS_QM_UI_ULF_REQUIRED"),
                std::make_unique<CSpinField>(settings, form.Host()));
    const auto read = [&settings](const QString& typed) {
        settings.m_tolerance = PlainNumberText(typed);
        return QString(); // judged by the model
    };
    form.Custom(KeyText("IDS_QM_UI_ULF_LIMIT"),
                MakeTextField([&settings] { return LocalNumberText(settings.m_tolerance); }, read,
                              form.Changed(), form.Host()));
    form.Note(KeyText("IDS_QM_UI_ULF_SETTINGS_NOTE"));
}

// ---- result between iterations ------------------------------------------------------------------

void BuildResult(CFormView& form, RESULT& result)
{
    form.Note([&result] { return result.Summary(); });
    T_GRID_BINDING b;
    b.columns = UlfColumns(RESULT::kHeads, {kText, kText, kNumber, kFlag});
    b.rows = [&result] { return result.Step().rows.size(); };
    b.text = [&result](std::size_t row, std::size_t column) {
        return UlfIterCellText(result.Step().rows.at(row), column);
    };
    AddUlfGrid(form, std::move(b), {460, 200});
    form.Flag(KeyText("IDS_QM_UI_ULF_DO_ITERATE"), Ref(result.m_iterate));
    form.Flag(KeyText("IDS_QM_UI_ULF_DONT_ASK"), Ref(result.m_dontAsk)).enabled = [&result] {
        return result.m_iterate;
    };
}

// ---- run ----------------------------------------------------------------------------------------

T_GRID_BINDING StepGrid(RUN& run)
{
    T_GRID_BINDING b;
    b.columns = UlfColumns(RUN::kStepHeads, {kNumber, kNumber, kText});
    b.rows = [&run] { return run.History().size(); };
    b.text = [&run](std::size_t row, std::size_t column) { return run.StepText(row, column); };
    b.select = [&run](int row) { run.m_step = row; };
    b.selected = [&run] { return run.m_step; };
    return b;
}

T_GRID_BINDING RowGrid(RUN& run)
{
    T_GRID_BINDING b;
    b.columns = UlfColumns(RUN::kRowHeads, {kText, kText, kNumber, kFlag, kNumber});
    b.rows = [&run] { return run.Rows(); };
    b.text = [&run](std::size_t row, std::size_t column) { return run.RowText(row, column); };
    return b;
}

T_GRID_BINDING AnalysedGrid(RUN& run)
{
    T_GRID_BINDING b;
    b.columns = UlfColumns(RUN::kAnalysedHeads, {kText, kNumber, kNumber, kNumber, kText});
    b.rows = [&run] { return run.Analysed().size(); };
    b.text = [&run](std::size_t row, std::size_t column) { return run.AnalysedText(row, column); };
    b.tone = [&run](std::size_t row, std::size_t) {
        return run.Analysed().at(row).Agrees() ? CELL_TONE::Plain : CELL_TONE::Fault;
    };
    return b;
}

T_GRID_BINDING StayGrid(RUN& run)
{
    T_GRID_BINDING b;
    b.columns = UlfColumns(kUlfStayHeads, {kNumber, kText, kNumber, kNumber, kNumber, kNumber});
    b.rows = [&run] { return run.Stays().size(); };
    b.text = [&run](std::size_t row, std::size_t column) {
        return UlfStayText(run.Stays().at(row), column);
    };
    return b;
}

T_PLOT PictureOf(const RUN& run)
{
    const std::vector<std::string> names = run.ItemTexts();
    const auto index = static_cast<std::size_t>(run.ItemIndex());
    return IterationPlot(index < names.size() ? names[index] : "", run.Settings(), run.History());
}

void AddRunHead(CFormView& form, RUN& run)
{
    const auto idle = [&run] { return !run.IsRunning(); };
    form.Choice(KeyText("IDS_QM_UI_ULF_ITEM"),
                {[&run] { return run.ItemIndex(); },
                 [&run](const int& index) { run.OnSelChangeItem(index); }},
                [&run] { return run.ItemTexts(); })
        .enabled = idle;
    form.Note([&run] {
        const T_ULF_ITER_SETTINGS s = run.Settings();
        return MMSGFunction::Format("IDS_QM_UI_ULF_SETTINGS_ARE",
                                    {std::to_string(s.required), ShortestText(s.tolerance)});
    });
    AddUlfButtons(form,
                  {{"IDS_QM_UI_ULF_START", [&run] { (void)run.OnRun(); },
                    [&run] { return !run.IsRunning() && run.ItemIndex() >= 0; }, false},
                   {"IDS_QM_UI_ULF_STOP", [&run] { run.OnCancelRun(); },
                    [&run] { return run.IsRunning(); }, false},
                   {"IDS_QM_UI_ULF_SETTINGS", [&run] { (void)run.OnSettings(); }, idle, false},
                   {"IDS_QM_UI_ULF_SHOW_RESULT", [&run] { (void)run.OnShowResult(); },
                    [&run] { return !run.IsRunning() && !run.History().empty(); }, false}});
    form.Note([&run] { return run.StatusText(); });
}

void BuildRun(CFormView& form, RUN& run)
{
    run.m_changed = [&form] { form.Refresh(); };
    AddRunHead(form, run);
    form.Columns();
    AddUlfGrid(form, StepGrid(run), {380, 150});
    form.Note(KeyText("IDS_QM_UI_ULF_CHOSEN_ITERATION"));
    AddUlfGrid(form, RowGrid(run), {380, 150});
    form.Note([&run] { return MMSGFunction::Format("IDS_QM_UI_ULF_STAYS", {run.ForceUnit()}); });
    AddUlfGrid(form, StayGrid(run), {380, 110});
    form.NextColumn();
    form.Note(KeyText("IDS_QM_UI_ULF_ANALYSED_BESIDE"));
    AddUlfGrid(form, AnalysedGrid(run), {420, 110});
    form.Picture([&run] { return PictureOf(run); }).widget->setMinimumSize(420, 300);
    form.EndColumns();
}

} // namespace

void RegisterUlfIterationViews(CViewFactory& factory)
{
    factory.Register<SETTINGS>(KeyText("IDS_QM_UI_ULF_SETTINGS_TITLE"), BuildSettings);
    T_VIEW result;
    result.accept = [](const zql::frx::MDialog& model) {
        return MMSGFunction::GetValue(dynamic_cast<const RESULT&>(model).m_iterate
                                          ? "IDS_QM_UI_ULF_GO_ON"
                                          : "IDS_QM_UI_ULF_END");
    };
    factory.Register<RESULT>(KeyText("IDS_QM_UI_ULF_STEP_TITLE"), BuildResult, result);
    T_VIEW run;
    run.showsOnly = true;
    run.size = {1120, 680};
    run.closes = [](zql::frx::MDialog& model) { return dynamic_cast<RUN&>(model).OnClose(); };
    factory.Register<RUN>(KeyText("IDS_QM_UI_ULF_RUN_TITLE"), BuildRun, run);
}
