#include "qm_ui/factors/ulftuningview.h"

#include "qm_base/say.h"
#include "qm_rps/ulftuningdlg.h"
#include "qm_ui/factors/tuningplot.h"

#include <QSignalBlocker>
#include <QSlider>

namespace {

using TUNED = CUlfTuningDlg;

/// The factor of the chosen unknown.
class CFactorSlider : public CFormField {
public:
    CFactorSlider(TUNED& tuned, const ChangedFn& changed, QWidget* parent)
        : m_tuned(tuned), m_slider(new QSlider(Qt::Horizontal, parent))
    {
        widget = m_slider;
        m_slider->setRange(0, TUNED::kSlider);
        QObject::connect(m_slider, &QSlider::valueChanged, [this, changed](int position) {
            m_tuned.OnSlider(position);
            changed();
        });
    }
    void Show() override
    {
        const QSignalBlocker quiet(m_slider);
        m_slider->setValue(m_tuned.SliderPosition());
    }

private:
    TUNED& m_tuned;
    QSlider* m_slider;
};

T_GRID_BINDING StayGrid(TUNED& tuned)
{
    T_GRID_BINDING b = GridOf([&tuned] { return tuned.StayCells(); });
    b.select = [&tuned](int row) {
        if (const int unknown = tuned.UnknownOfRow(row); unknown >= 0) tuned.m_chosen = unknown;
    };
    b.selected = [&tuned] {
        // Of several stays of one unknown the first one is shown as chosen.
        return tuned.RowOfUnknown(tuned.m_chosen);
    };
    return b;
}

void AddHead(CFormView& form, TUNED& tuned, const T_ULF_HOOKS& hooks)
{
    const auto idle = [&tuned] { return !tuned.IsRunning() && tuned.ItemIndex() >= 0; };
    auto& item = form.Choice(KeyText("IDS_QM_UI_ULF_ITEM"),
                             {[&tuned] { return tuned.ItemIndex(); },
                              [&tuned](const int& index) { tuned.OnSelChangeItem(index); }},
                             [&tuned] { return tuned.ItemTexts(); });
    item.name = "item";
    item.enabled = idle;
    QWidget* const host = form.Host();
    const auto solve = [&tuned, host, hooks] {
        (void)hooks.run(host, UlfText("IDS_QM_UI_ANALYSING"),
                        [&tuned](const ULF_PROGRESS& progress) { return tuned.OnSolve(progress); });
    };
    AddUlfButtons(form, {{"IDS_QM_TUNE_SOLVE", solve, idle, false},
                         {"IDS_QM_TUNE_RESET", [&tuned] { tuned.OnReset(); },
                          [&tuned, idle] { return idle() && tuned.IsSolved(); }, false},
                         {"IDS_QM_TUNE_ITERATE", [&tuned] { (void)tuned.OnIterate(); },
                          [&tuned, idle] { return idle() && tuned.IsStage(); }, false},
                         {"IDS_QM_TUNE_STOP", [&tuned] { tuned.OnStop(); },
                          [&tuned] { return tuned.IsRunning(); }, false}});
    form.Note([&tuned] { return tuned.StatusText(); }).name = "status";
}

void AddFactor(CFormView& form, TUNED& tuned)
{
    const auto has = [&tuned] {
        return !tuned.IsRunning() && tuned.IsSolved() &&
               tuned.m_chosen < static_cast<int>(tuned.Unknowns());
    };
    const auto chosen = [&tuned] { return static_cast<std::size_t>(tuned.m_chosen); };
    auto& number = form.Number(
        [&tuned, has, chosen] {
            return has() ? Say("IDS_QM_TUNE_FACTOR", tuned.NameOf(chosen()))
                         : Say("IDS_RPS_GXGRID_Factor");
        },
        {[&tuned, has, chosen] { return has() ? tuned.Factor(chosen()) : 0.0; },
         [&tuned, chosen](const double& factor) { (void)tuned.OnFactor(chosen(), factor); }});
    number.name = "factor";
    number.enabled = has;
    auto& slider =
        form.Custom({}, std::make_unique<CFactorSlider>(tuned, form.Changed(true), form.Host()));
    slider.name = "slider";
    slider.enabled = has;
}

void BuildTuning(CFormView& form, TUNED& tuned, const T_ULF_HOOKS& hooks)
{
    tuned.m_changed = [&form] { form.Refresh(); };
    AddHead(form, tuned, hooks);
    form.Columns();
    AddUlfGrid(form, StayGrid(tuned), {620, 200}).name = "stays";
    AddFactor(form, tuned);
    AddUlfGrid(form, GridOf([&tuned] { return tuned.ConstraintCells(); }), {620, 200}).name =
        "constraints";
    form.NextColumn(1);
    form.Picture([&tuned] { return TuningDisplacementPlot(tuned); }).name = "deck";
    form.Picture([&tuned] { return TuningMomentPlot(tuned); }).name = "moments";
    form.EndColumns();
}

} // namespace

void RegisterUlfTuningView(CViewFactory& factory, const T_ULF_HOOKS& hooks)
{
    T_VIEW view;
    view.showsOnly = true;
    view.size = {1320, 780};
    view.closes = [](zql::frx::MDialog& model) { return dynamic_cast<TUNED&>(model).OnClose(); };
    factory.Register<TUNED>(
        KeyText("IDS_QM_TUNE_TITLE"),
        [hooks](CFormView& form, TUNED& tuned) { BuildTuning(form, tuned, hooks); }, view);
}
