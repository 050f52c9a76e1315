#include "qm_base/say.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/curvewizarddlg.h"
#include "qm_rps/dialog/unithead.h"
#include "qm_ui/create/createfields.h"
#include "qm_ui/create/createplots.h"
#include "qm_ui/create/createviews.h"
#include "qm_ui/plot/plotwidget.h"

namespace {

using DLG = CCurveWizardDlg;
constexpr int kLeftWidth = 560; // of the pages at most: the picture takes the rest

template <std::size_t N>
std::function<std::vector<std::string>()> NamesOf(const std::array<const char*, N>& names)
{
    return [&names] { return std::vector<std::string>(names.begin(), names.end()); };
}

/// What was pasted and how it is read.
void AddText(CFormView& form, DLG& d, const std::function<void()>& tell)
{
    form.Page(KeyText("IDS_QM_NEW_PAGE_CURVE"));
    form.Note(KeyText("IDS_QM_NEW_PASTE_HOW"));
    CFormField& text = form.Custom(
        {}, MakePasteField(Told(d.m_curve.text, tell), form.Changed(true), form.Host()));
    text.name = "text";
    text.widget->setMinimumSize(320, 150);
    text.widget->setMaximumWidth(kLeftWidth);
    form.Button(KeyText("IDS_QM_NEW_FILE"), [&d] { (void)d.OnFile(); }).name = "file";
    form.Columns();
    form.Choice(KeyText("IDS_QM_NEW_FORCE_UNIT"), ToldIndex(d.m_units.force, tell),
                NamesOf(kForceNames))
        .name = "force";
    form.NextColumn();
    form.Choice(KeyText("IDS_QM_NEW_LENGTH_UNIT"), ToldIndex(d.m_units.length, tell),
                NamesOf(kLengthNames))
        .name = "length";
    form.EndColumns();
    form.Text(KeyText("IDS_QM_NEW_COLUMNS_ARE"), Told(d.m_curve.columns, tell)).name = "columns";
    form.Choice(KeyText("IDS_QM_NEW_DECIMAL"), ToldIndex(d.m_curve.decimal, tell),
                KeyTexts({"IDS_QM_NEW_DECIMAL_AUTO", "IDS_QM_NEW_DECIMAL_POINT",
                          "IDS_QM_NEW_DECIMAL_COMMA"}))
        .name = "decimal";
    form.Flag(KeyText("IDS_QM_NEW_ADD_ORIGIN"), Told(d.m_curve.addOrigin, tell)).name = "origin";
    form.Flag(KeyText("IDS_QM_NEW_REVERSE"), Told(d.m_curve.reverseForce, tell)).name = "reverse";
    AddReadTable(
        form, [&d] { return d.Points(); }, "points", {320, 130}, 1000)
        .widget->setMaximumWidth(kLeftWidth);
}

void AddMasses(CFormView& form, DLG& d, const std::function<void()>& tell)
{
    form.Page(KeyText("IDS_QM_NEW_PAGE_MASSES"));
    form.Text(KeyText("IDS_QM_NEW_TITLE_OF"), Told(d.m_title, tell)).name = "title";
    form.Note(KeyText("IDS_QM_NEW_LISTS_HOW"));
    form.Text([&d] { return HeadWithUnit(Say("IDS_QM_NEW_HEIGHTS_OF"), kDimLength, d.m_units); },
              Told(d.m_heights, tell))
        .name = "heights";
    form.Choice(KeyText("IDS_QM_NEW_MASS_IS"), ToldIndex(d.m_massGiven, tell),
                [&d] { return d.MassTexts(); })
        .name = "massGiven";
    form.Text([&d] { return d.MassTexts().at(static_cast<std::size_t>(d.m_massGiven)); },
              Told(d.m_masses, tell))
        .name = "masses";
    form.Flag(KeyText("IDS_QM_NEW_IS_TOTAL"), Told(d.m_isTotal, tell)).name = "total";
    form.Choice(KeyText("IDS_QM_NEW_SHAPE_OF"), ToldIndex(d.m_shape, tell),
                KeyTexts({"IDS_QM_NEW_SHAPE_HEIGHTS", "IDS_QM_NEW_SHAPE_CURVE",
                          "IDS_QM_NEW_SHAPE_TYPED"}))
        .name = "shape";
    CFormField& typed = form.Text(KeyText("IDS_QM_NEW_SHAPE_LIST"), Told(d.m_typedShape, tell));
    typed.name = "typedShape";
    typed.shown = [&d] { return d.m_shape == SHAPE_GIVEN::Typed; };
    AddReadTable(
        form, [&d] { return d.Storeys(); }, "storeys", {320, 130}, 400)
        .widget->setMaximumWidth(kLeftWidth);
    form.Space();
}

void AddDemand(CFormView& form, DLG& d, const std::function<void()>& tell)
{
    form.Page(KeyText("IDS_QM_NEW_PAGE_SPECTRUM"));
    CFormField& picture = form.Picture(
        [&d] { return SpectrumPlot(d.m_spectrum.Record(), SPECTRUM_AXES::Periods, d.m_units); });
    picture.widget->setMinimumSize(320, 220);
    picture.widget->setMaximumWidth(kLeftWidth);
    form.Choice(KeyText("IDS_QM_NEW_METHOD"),
                {[&d] { return d.MethodIndex(); },
                 [&d, tell](const int& index) {
                     d.OnMethod(index);
                     tell();
                 }},
                [] { return DLG::MethodTexts(); })
        .name = "method";
    AddSpectrumFields(form, d.m_spectrum, tell, false);
    form.Space();
}

void Build(CFormView& form, DLG& d)
{
    const auto tell = [&d] { d.OnChange(); };
    form.Columns();
    AddText(form, d, tell);
    AddMasses(form, d, tell);
    AddDemand(form, d, tell);
    form.EndPages();
    form.NextColumn(1);
    CFormField& picture = form.Picture([&d] { return CurvePlot(d.Read(), d.m_units); });
    picture.name = "plot";
    picture.widget->setMinimumSize(420, 320);
    if (auto* view = dynamic_cast<CPlotWidget*>(picture.widget)) view->SetSizeHint({640, 440});
    CFormField& notes = form.Note([&d] { return d.NotesText(); });
    notes.name = "notes";
    CFormField& command =
        form.Text(KeyText("IDS_QM_NEW_COMMAND"), {[&d] { return d.CommandText(); }, {}});
    command.name = "command";
    form.EndColumns();
    form.SetFindings([&d] { return d.Findings(); });
}

} // namespace

void RegisterCurveWizardView(CViewFactory& factory)
{
    T_VIEW view;
    view.size = {1120, 780};
    view.accept = [](const zql::frx::MDialog&) { return Say("IDS_QM_NEW_MAKE"); };
    factory.Register<DLG>(KeyText("IDS_QM_NEW_CURVE_TITLE"), Build, view);
}
