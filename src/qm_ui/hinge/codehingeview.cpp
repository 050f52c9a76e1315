#include "qm_base/say.h"
#include "qm_rps/codehingedlg.h"
#include "qm_rps/dialog/unithead.h"
#include "qm_ui/frame/frameview.h"
#include "qm_ui/hinge/hingeplot.h"
#include "qm_ui/hinge/hingeviews.h"
#include "qm_ui/plot/plotwidget.h"

#include <array>
#include <variant>

namespace {

using DLG = CCodeHingeDlg;

class CChoiceView : public CFrameView {
public:
    using CFrameView::CFrameView;
    QSize sizeHint() const override { return {460, 260}; }
};

/// The frame, whose members are chosen by clicks and boxes.
class CMemberField : public CFormField {
public:
    CMemberField(DLG& dialog, const ChangedFn& changed, QWidget* parent)
        : m_dialog(dialog), m_view(new CChoiceView(parent))
    {
        widget = m_view;
        m_view->SetCamera(CameraFor(CFrameScene::FlatAxis(dialog.Scene())));
        T_FRAME_OPTIONS options;
        options.elementNumbers = true;
        m_view->SetOptions(options);
        m_view->m_onLine = [this, changed](std::size_t line) {
            m_dialog.OnLine(line);
            changed();
        };
        m_view->m_onLines = [this, changed](const std::vector<std::size_t>& lines) {
            m_dialog.OnLines(lines);
            changed();
        };
    }
    void Show() override
    {
        T_FRAME_PICTURE picture;
        picture.scene = &m_dialog.Scene();
        for (std::size_t i = 0; i < picture.scene->lines.size(); ++i)
            picture.chosen.push_back(m_dialog.IsChosen(i));
        m_view->SetPicture(std::move(picture));
    }

private:
    DLG& m_dialog;
    CFrameView* m_view;
};

struct T_BUTTON {
    const char* key;
    std::function<void()> pressed;
    std::function<bool()> enabled{};
};

void AddButtons(CFormView& form, const std::vector<T_BUTTON>& buttons)
{
    form.Columns();
    for (std::size_t i = 0; i < buttons.size(); ++i) {
        if (i > 0) form.NextColumn();
        CFormField& field = form.Button(KeyText(buttons[i].key), buttons[i].pressed);
        field.enabled = buttons[i].enabled;
        field.name = buttons[i].key;
    }
    form.EndColumns();
}

/// A table from this height to another one: frame and picture take the room that is left.
void AddTable(CFormView& form, T_GRID_BINDING grid, const char* name, QSize least, int most)
{
    CFormField& field = form.Grid(std::move(grid));
    field.name = name;
    field.widget->setMinimumSize(least);
    field.widget->setMaximumHeight(most);
}

/// A member of the options.
template <class T>
T_BINDING<T> Option(DLG& d, T& value)
{
    return {[&value] { return value; },
            [&d, &value](const T& v) {
                value = v;
                d.OnOptions();
            }};
}

template <class E>
T_BINDING<int> OptionIndex(DLG& d, E& value)
{
    return {[&value] { return static_cast<int>(value); },
            [&d, &value](const int& index) {
                value = static_cast<E>(index);
                d.OnOptions();
            }};
}

/// What is not given is read from the frame.
void AddConnection(CFormView& form, DLG& d)
{
    CCodeHingeOptions& o = d.m_options;
    CFormField& kind = form.Choice(KeyText("IDS_QM_UI_GEN_CONNECTION"), Option(d, o.m_connection),
                                   [] { return CCodeHingeOptions::ConnectionTexts(); });
    kind.name = "connection";
    kind.shown = [&d] { return d.AsksConnection(); };
    const auto asked = [&d] { return d.AsksConnection() && d.m_options.m_connection > 0; };
    for (std::size_t i = 0; i < kConnectionMeasures.size(); ++i) {
        const T_CONNECTION_MEASURE& measure = kConnectionMeasures[i];
        CFormField& field = form.Optional(
            [&o, &measure] {
                const bool number = measure.dim == kDimNone;
                return HeadWithUnit(Say(measure.key),
                                    number ? std::nullopt : std::optional(measure.dim), o.Units());
            },
            Option(d, o.m_measures[i]));
        field.name = measure.name;
        field.shown = asked;
    }
    form.Note(KeyText("IDS_QM_UI_GEN_MEASURES")).shown = asked;
}

void AddOptions(CFormView& form, DLG& d)
{
    CCodeHingeOptions& o = d.m_options;
    const auto head = [&o](const char* key) {
        return [&o, key] { return HeadWithUnit(Say(key), kDimForce, o.Units()); };
    };
    form.Columns();
    form.Choice(KeyText("IDS_QM_UI_GEN_CODE"), OptionIndex(d, o.m_code),
                [] { return DLG::CodeTexts(); })
        .name = "code";
    form.NextColumn();
    form.Choice(KeyText("IDS_QM_UI_GEN_LEVEL"), OptionIndex(d, o.m_secondary),
                KeyTexts({"IDS_QM_UI_GEN_PRIMARY", "IDS_QM_UI_GEN_SECONDARY_MEMBER"}))
        .name = "level";
    form.EndColumns();
    form.Choice(KeyText("IDS_QM_UI_GEN_SHEAR"), Option(d, o.m_shear),
                [&o] { return o.ShearTexts(); })
        .name = "shear";
    form.Columns();
    CFormField& from = form.Optional(head("IDS_QM_UI_GEN_AXIAL_FROM"), Option(d, o.m_axial[0]));
    from.name = "axialFrom";
    form.NextColumn();
    CFormField& to = form.Optional(KeyText("IDS_QM_UI_GEN_AXIAL_TO"), Option(d, o.m_axial[1]));
    to.name = "axialTo";
    form.EndColumns();
    for (CFormField* field : {&from, &to})
        field->shown = [&o] { return o.HasAxialCurves(); };
    CFormField& tie = form.Number(head("IDS_QM_UI_GEN_TIE"), Option(d, o.m_tie));
    tie.name = "tie";
    tie.shown = [&o] { return o.HasMasonry(); };
    AddConnection(form, d);
}

void AddMembers(CFormView& form, DLG& d)
{
    AddOptions(form, d);
    CFormField& frame =
        form.Custom({}, std::make_unique<CMemberField>(d, form.Changed(), form.Host()));
    frame.name = "frame";
    frame.widget->setMinimumSize(340, 150);
    form.Note(KeyText("IDS_QM_UI_GEN_HOW"));
    form.Text(KeyText("IDS_QM_UI_GEN_ELEMENTS"),
              {[&d] { return d.ElementsText(); },
               [&d](const std::string& text) { (void)d.OnElements(text); }})
        .name = "elements";
    AddButtons(form,
               {{"IDS_QM_UI_GEN_ALL", [&d] { d.OnAll(); }},
                {"IDS_QM_UI_GEN_NONE", [&d] { d.OnNone(); }},
                {"IDS_QM_UI_GEN_STALE_BTN", [&d] { d.OnStale(); }, [&d] { return d.HasStale(); }}});
    form.Flag(KeyText("IDS_QM_UI_GEN_KEEP_GOING"), Option(d, d.m_options.m_keepGoing)).name =
        "keepGoing";
    const auto chosen = [&d] { return d.ChosenCount() > 0; };
    AddButtons(form, {{"IDS_QM_UI_GEN_PREVIEW", [&d] { (void)d.OnPreview(); }, chosen},
                      {"IDS_QM_UI_GEN_APPLY", [&d] { (void)d.OnApply(); }, chosen},
                      {"IDS_QM_UI_GEN_AGAIN", [&d] { (void)d.OnRegenerate(); },
                       [&d] { return d.HasStale(); }}});
}

void AddPreview(CFormView& form, DLG& d)
{
    T_GRID_BINDING types = GridOf([&d] { return d.Types(); });
    types.select = [&d](int row) {
        if (row >= 0 && row != d.Type()) d.OnType(row);
    };
    types.selected = [&d] { return d.Type(); };
    AddTable(form, std::move(types), "types", {380, 84}, 150);
    T_GRID_BINDING sides = GridOf([&d] { return d.Sides(); });
    sides.select = [&d](int row) {
        if (row >= 0 && row != d.Side()) d.OnSide(row);
    };
    sides.selected = [&d] { return d.Side(); };
    AddTable(form, std::move(sides), "sides", {380, 84}, 150);
    form.Note([&d] { return d.StatusText(); }).name = "status";
    form.Note([&d] { return d.WarningsText(); }).name = "warnings";
    form.Space();
}

/// The backbone of the chosen side. Criteria of chord rotations are called as their codes do.
T_PLOT BackbonePlot(const DLG& d)
{
    T_PLOT plot;
    const DLG::T_SHOWN* shown = d.Shown();
    if (!shown) {
        plot.notes.push_back(Say("IDS_QM_UI_GEN_NO_PREVIEW"));
        return plot;
    }
    plot = HingeBackbonePlot(shown->type, shown->component, shown->curve, shown->page);
    constexpr std::array<std::array<const char*, 2>, 3> kChord{
        {{"IO", "DL"}, {"LS", "SD"}, {"CP", "NC"}}};
    for (T_PLOT_LABEL& label : plot.labels)
        for (const auto& [plastic, chord] : kChord)
            if (std::holds_alternative<T_SKEL_EC8>(shown->curve) && label.text.ends_with(plastic))
                label.text.replace(label.text.size() - 2, 2, chord);
    return plot;
}

/// The trace beside its backbone.
void AddNumbers(CFormView& form, DLG& d)
{
    form.Columns();
    CFormField& picture = form.Picture([&d] { return BackbonePlot(d); });
    picture.widget->setMinimumSize(340, 240);
    if (auto* view = dynamic_cast<CPlotWidget*>(picture.widget)) view->SetSizeHint({480, 330});
    form.NextColumn(1);
    AddTable(form, GridOf([&d] { return d.Trace(); }), "trace", {400, 200}, 1000);
    form.EndColumns();
}

void Build(CFormView& form, DLG& d)
{
    form.Columns();
    AddMembers(form, d);
    form.NextColumn(1);
    AddPreview(form, d);
    form.EndColumns();
    AddNumbers(form, d);
}

} // namespace

void RegisterCodeHingeView(CViewFactory& factory)
{
    factory.Register<DLG>(KeyText("IDS_QM_UI_GEN_TITLE"), Build,
                          {.showsOnly = true, .size = {1260, 900}});
}
