#include "qm_ui/hinge/figureview.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_rps/dialog/unithead.h"
#include "qm_rps/po_femastrlossfigure0dlg.h"
#include "qm_rps/po_femastrlossfigureedlg.h"
#include "qm_rps/po_femaunloadstifffigureedlg.h"
#include "qm_rps/po_hingeskcvtabfemaaxialdlg.h"

using zql::lib::MMSGFunction;

namespace {

constexpr double kLowest = 1.3, kLegendRow = 0.15; // of the y axis: room for the legend
constexpr int kPictureHeight = 530;
constexpr QSize kFigureSize{820, 660}, kAxialSize{640, 420};
constexpr double kFirstWidth = 3.0, kOtherWidth = 1.6; // of the curves, px

void BuildFigure(CFormView& form, const CFemaFigureDlg& figure)
{
    CFormField& picture = form.Picture([&figure] { return FigurePlot(figure); });
    picture.name = "figure";
    picture.widget->setMaximumHeight(kPictureHeight); // the text below stays in sight
    form.Note(KeyText(figure.TextKey()));
}

template <class FIGURE>
void RegisterFigure(CViewFactory& factory)
{
    const std::string title = FIGURE().TitleKey();
    T_VIEW more;
    more.showsOnly = true;
    more.size = kFigureSize;
    more.placement = PLACEMENT::Beside;
    factory.Register<FIGURE>(
        KeyText(title), [](CFormView& form, FIGURE& figure) { BuildFigure(form, figure); }, more);
}

using AXIAL = CPO_HingeSkcvTabFemaAxialDlg;

/// "Yield strength (+) (kN or kN m)": the table does not know of which component it is.
TextFn YieldHead(const AXIAL& d, const char* key)
{
    return [&d, key] {
        const std::string force(NameOf(d.m_units.force)), length(NameOf(d.m_units.length));
        return MMSGFunction::GetValue(key) + " (" + force + ", " + force + " " + length + ")";
    };
}

std::string AxialText(const AXIAL& d, std::size_t row, std::size_t column)
{
    const double axial = d.Keys().at(row);
    const T_SIDES<T_SKEL_SIDE>& sides = d.SidesOf(axial);
    return ShortestText(column == 0 ? axial : column == 1 ? sides.pos.yield : sides.neg.yield);
}

int SetAxial(AXIAL& d, std::size_t row, std::size_t column, const std::string& text)
{
    const std::vector<double> keys = d.Keys();
    const auto value = ParseFinite(text);
    if (!value || row >= keys.size()) return 0;
    if (column == 0) return d.ChangeForce(keys[row], *value);
    return d.SetYield(keys[row], column == 1 ? HINGE_SIDE::Positive : HINGE_SIDE::Negative, *value);
}

void BuildAxial(CFormView& form, AXIAL& d)
{
    const auto chosen = std::make_shared<int>(-1);
    const auto forceHead = [&d] {
        return HeadWithUnit("IDS_QM_UI_AXIAL_FORCE", kDimForce, d.m_units);
    };
    T_GRID_BINDING grid;
    grid.columns = {{forceHead, CELL_KIND::Number, true},
                    {YieldHead(d, "IDS_QM_UI_AXIAL_POS"), CELL_KIND::Number, true},
                    {YieldHead(d, "IDS_QM_UI_AXIAL_NEG"), CELL_KIND::Number, true}};
    grid.rows = [&d] { return d.Keys().size(); };
    grid.text = [&d](std::size_t r, std::size_t c) { return AxialText(d, r, c); };
    grid.set = [&d](std::size_t r, std::size_t c, const std::string& t) {
        return SetAxial(d, r, c, t);
    };
    grid.select = [chosen](int row) { *chosen = row; };
    form.Group(KeyText("IDS_QM_UI_AXIAL_TABLE"));
    form.Grid(std::move(grid)).name = "rows";
    form.EndGroup();
    form.Number(KeyText("IDS_QM_UI_AXIAL_NEW"), Ref(d.m_newForce),
                [&d] { return std::string(NameOf(d.m_units.force)); })
        .name = "new";
    form.Columns();
    form.Button(KeyText("IDS_QM_UI_AXIAL_ADD"), [&d] { (void)d.AddForce(d.m_newForce); }).name =
        "add";
    form.NextColumn();
    CFormField& remove = form.Button(KeyText("IDS_QM_UI_AXIAL_REMOVE"), [&d, chosen] {
        const auto row = static_cast<std::size_t>(*chosen);
        if (row < d.Keys().size()) (void)d.RemoveForce(d.Keys()[row]);
    });
    remove.name = "remove";
    remove.enabled = [&d] { return !d.Keys().empty(); };
    form.EndColumns();
    form.Note(KeyText("IDS_QM_UI_AXIAL_NOTE"));
}

} // namespace

T_PLOT FigurePlot(const CFemaFigureDlg& figure)
{
    T_PLOT plot;
    plot.title = MMSGFunction::GetValue(figure.TitleKey());
    plot.x.title = MMSGFunction::GetValue("IDS_QM_UI_FIGURE_X");
    plot.y.title = MMSGFunction::GetValue("IDS_QM_UI_FIGURE_Y");
    const std::vector<T_FIGURE_CURVE> curves = figure.Curves();
    plot.y.range =
        T_PLOT_RANGE{-kLowest, kLowest + kLegendRow * static_cast<double>(curves.size())};
    for (const T_FIGURE_CURVE& curve : curves) {
        T_PLOT_SERIES series;
        series.name = curve.name;
        series.marker = PLOT_MARKER::None;
        series.width = plot.series.empty() ? kFirstWidth : kOtherWidth;
        if (curves.size() == 2) series.line = PLOT_LINE::Solid; // told by width and colour
        for (const T_FIGURE_POINT& p : curve.points) {
            series.x.push_back(p.x);
            series.y.push_back(p.y);
        }
        plot.series.push_back(std::move(series));
    }
    for (const T_FIGURE_POINT& p : figure.Points())
        plot.labels.push_back({p.x, p.y, p.label, PLOT_MARKER::Circle, true});
    return plot;
}

void RegisterFigureViews(CViewFactory& factory)
{
    RegisterFigure<CPO_FEMAStrLossFigure0Dlg>(factory);
    RegisterFigure<CPO_FEMAStrLossFigureEDlg>(factory);
    RegisterFigure<CPO_FEMAUnloadStiffFigureEDlg>(factory);
    T_VIEW more;
    more.size = kAxialSize;
    factory.Register<AXIAL>(KeyText("IDS_QM_UI_AXIAL_TITLE"), BuildAxial, more);
}
