// Windows of the hinge editors with the types of an example, for pictures.
#include "hingetools.h"
#include "mainwindow.h"

#include "qm_rps/codehingedlg.h"
#include "qm_rps/po_hingealphayspandlg.h"
#include "qm_rps/po_hingeintegrationpointdlg.h"
#include "qm_rps/po_hingelengthmphidlg.h"
#include "qm_rps/po_hingelengthmthetadlg.h"
#include "qm_rps/po_hingemasonrydlg.h"
#include "qm_rps/po_hingeskcvtabdlg.h"
#include "qm_rps/po_hingeskcvtabeurodlg.h"
#include "qm_rps/po_hingeskcvtabfemaaxialgrid.h"
#include "qm_rps/po_hingeskcvtabfemadlg.h"
#include "qm_rps/po_hingetypedlg.h"
#include "qm_rps/po_hingetypelistdlg.h"
#include "qm_rps/po_hingeyieldpropdlgnew.h"
#include "qm_rps/pushoverhingedatatype.h"
#include "qm_rps/pushoverhingelistdlg.h"
#include "qm_rps/pushoverpmminteractiondlg.h"
#include "qm_rps/sectioncurvesdlg.h"
#include "qm_rps/yieldstrengthcalcopteffdescdlg.h"
#include "qm_rps/yieldstrengthcalcoptmatdescdlg.h"
#include "qm_ui/form/dialogwindow.h"

namespace {

constexpr const char* kModel = "hinge-library";
constexpr int kBeam = 1, kColumn = 2, kConcrete = 3, kBrace = 4, kPier = 5, kMistake = 6; // types

template <class DLG>
std::unique_ptr<QWidget> WindowOf(CMainWindow& main, std::unique_ptr<DLG> dlg)
{
    const CViewFactory& factory = main.Desktop().factory;
    auto window = std::make_unique<CDialogWindow>(factory, *factory.Find(*dlg), *dlg, &main);
    KeepWith(*window, std::move(dlg));
    return window;
}

T_PHGT_D TypeOf(CMainWindow& main, int key)
{
    T_PHGT_D type;
    (void)main.Doc().Attr().GetPhgt(key, type);
    return type;
}

T_HINGE_OWNER OwnerOf(CMainWindow& main, int key)
{
    return {TypeOf(main, key), main.Doc().Unit().Units()};
}

template <class DLG>
std::unique_ptr<QWidget> CurveWindow(CMainWindow& main, int key, HINGE_COMPONENT c)
{
    auto dlg = std::make_unique<DLG>();
    dlg->m_owner = OwnerOf(main, key);
    (void)dlg->Data2Dlg(c, dlg->m_owner.type.components[static_cast<std::size_t>(c)]);
    return WindowOf(main, std::move(dlg));
}

std::unique_ptr<QWidget> TypeWindow(CMainWindow& main, int key)
{
    auto dlg = std::make_unique<CPO_HingeTypeDlg>(HingeContextOf(main.Doc()));
    dlg->Data2Dlg(TypeOf(main, key));
    return WindowOf(main, std::move(dlg));
}

/// A surface whose curves fall from full compression over the largest moment to tension.
T_YIELD_SURFACE ExampleSurface()
{
    constexpr std::array<double, 10> kP{1.0, 0.8, 0.6, 0.4, 0.2, 0.1, 0.0, -0.1, -0.2, -0.3};
    constexpr std::array<double, 10> kM{0.0, 0.45, 0.75, 0.95, 0.98, 0.9, 0.75, 0.55, 0.3, 0.0};
    T_YIELD_SURFACE s;
    s.yield.tension = 1000;
    s.yield.compression = 4500;
    for (T_YIELD_AXIS* axis : {&s.yield.y, &s.yield.z}) {
        axis->moment = {180, 180};
        axis->momentMax = {310, 310};
        for (std::size_t i = 0; i < kP.size(); ++i) {
            axis->curves.pos[i] = {kP[i], kM[i]};
            axis->curves.neg[i] = {kP[i], -kM[i]};
        }
    }
    return s;
}

T_PMM_TABLE ExampleTable()
{
    T_PMM_TABLE table;
    table.Pmax = 4500;
    for (std::size_t i = 0; i < table.curves[0].size(); ++i)
        for (auto& curve : table.curves)
            curve[i] = {1.0 - 0.1 * static_cast<double>(i),
                        1.0 - 0.01 * static_cast<double>(i * i)};
    return table;
}

template <class DLG>
std::unique_ptr<QWidget> PartWindow(CMainWindow& main, std::function<void(DLG&)> fill)
{
    auto dlg = std::make_unique<DLG>();
    if constexpr (requires { dlg->m_owner; }) dlg->m_owner = OwnerOf(main, kConcrete);
    fill(*dlg);
    return WindowOf(main, std::move(dlg));
}

std::unique_ptr<QWidget> SurfaceWindow(CMainWindow& main)
{
    auto record = std::make_unique<T_YIELD_SURFACE>(ExampleSurface());
    auto dlg = std::make_unique<CPO_HingeYieldPropDlgNew>(*record, SKEL_TYPE::Ec8);
    dlg->m_owner = OwnerOf(main, kConcrete);
    auto window = WindowOf(main, std::move(dlg));
    KeepWith(*window, std::move(record));
    return window;
}

std::unique_ptr<QWidget> InteractionWindow(CMainWindow& main)
{
    auto record = std::make_unique<T_PMM_TABLE>(ExampleTable());
    auto dlg = std::make_unique<CPushOverPMMInteractionDlg>(*record);
    dlg->m_owner = OwnerOf(main, kConcrete);
    auto window = WindowOf(main, std::move(dlg));
    KeepWith(*window, std::move(record));
    return window;
}

std::unique_ptr<QWidget> GeneratedWindow(CMainWindow& main)
{
    auto dlg = std::make_unique<CPushOverHingeListDlg>(main.Doc());
    dlg->m_type = kColumn;
    return WindowOf(main, std::move(dlg));
}

std::unique_ptr<QWidget> TableWindow(CMainWindow& main)
{
    auto dlg = std::make_unique<CPushOverHingeDataType>(main.Doc());
    (void)dlg->ChooseFirst();
    return WindowOf(main, std::move(dlg));
}

template <class DLG>
std::unique_ptr<QWidget> DescriptionWindow(CMainWindow& main)
{
    return WindowOf(main, std::make_unique<DLG>(main.Doc(), std::vector<int>{1, 2, 3}));
}

std::unique_ptr<QWidget> ListWindow(CMainWindow& main)
{
    auto dlg = std::make_unique<CPO_HingeTypeListDlg>(main.Doc());
    dlg->m_selected = kColumn;
    return WindowOf(main, std::move(dlg));
}

std::unique_ptr<QWidget> MasonryWindow(CMainWindow& main)
{
    auto dlg = std::make_unique<CPO_HingeMasonryDlg>();
    dlg->m_owner = OwnerOf(main, kPier);
    dlg->Data2Dlg(dlg->m_owner.type.masonry.value_or(T_MASONRY_HINGE{}));
    return WindowOf(main, std::move(dlg));
}

std::unique_ptr<QWidget> AxialWindow(CMainWindow& main)
{
    return PartWindow<CPO_HingeSkcvTabFemaAxialGrid>(main, [&](auto& dlg) {
        const T_PHGT_D column = TypeOf(main, kColumn);
        dlg.Data2Dlg(std::get<T_SKEL_FEMA>(column.components[4].curves.I).curves);
    });
}

std::unique_ptr<QWidget> SectionWindow(CMainWindow& main)
{
    auto dlg = std::make_unique<CSectionCurvesDlg>(main.Doc());
    dlg->m_options.values = SECTION_VALUES::Mean;
    dlg->m_options.core = SECTION_CORE::Mander;
    dlg->m_options.hoopStrain = 0.1;
    dlg->m_axial = "0 400 800";
    return WindowOf(main, std::move(dlg));
}

/// What all members of a frame would get, with the trace of a column.
std::unique_ptr<QWidget> CodeWindow(CMainWindow& main)
{
    auto dlg = std::make_unique<CCodeHingeDlg>(main.Doc());
    dlg->OnAll();
    (void)dlg->OnPreview();
    const QSize size = main.Desktop().factory.Find(*dlg)->size;
    std::unique_ptr<QWidget> window = WindowOf(main, std::move(dlg));
    window->show();
    window->resize(size);
    return window;
}

} // namespace

std::vector<T_WINDOW_EXAMPLE> HingeWindowExamples()
{
    using C = HINGE_COMPONENT;
    const auto type = [](int key) {
        return [key](CMainWindow& main) { return TypeWindow(main, key); };
    };
    return {
        {"hinge-types", kModel, ListWindow},
        {"hinge-type-beam", kModel, type(kBeam)},
        {"hinge-type-concrete", kModel, type(kConcrete)},
        {"hinge-type-mistake", kModel, type(kMistake)},
        {"hinge-fema", kModel,
         [](CMainWindow& m) { return CurveWindow<CPO_HingeSkcvTabFemaDlg>(m, kColumn, C::My); }},
        {"hinge-fema-mistake", kModel,
         [](CMainWindow& m) { return CurveWindow<CPO_HingeSkcvTabFemaDlg>(m, kMistake, C::My); }},
        {"hinge-multilinear", kModel,
         [](CMainWindow& m) { return CurveWindow<CPO_HingeSkcvTabDlg>(m, kBrace, C::Fx); }},
        {"hinge-eurocode", kModel,
         [](CMainWindow& m) { return CurveWindow<CPO_HingeSkcvTabEuroDlg>(m, kConcrete, C::My); }},
        {"hinge-axial-forces", kModel, AxialWindow},
        {"hinge-yield-surface", kModel, SurfaceWindow},
        {"hinge-interaction", kModel, InteractionWindow},
        {"hinge-lengths", kModel,
         [](CMainWindow& m) {
             return PartWindow<CPO_HingeLengthMThetaDlg>(
                 m, [](auto& d) { d.Data2Dlg(d.m_owner.type.length); });
         }},
        {"hinge-lengths-curvature", kModel,
         [](CMainWindow& m) {
             return PartWindow<CPO_HingeLengthMPhiDlg>(m, [](auto& d) { d.OnEnChangeMy_I(0.3); });
         }},
        {"hinge-integration-points", kModel,
         [](CMainWindow& m) {
             return PartWindow<CPO_HingeIntegrationPointDlg>(m, [](auto& d) { d.SetInitValue(5); });
         }},
        {"hinge-span", kModel,
         [](CMainWindow& m) { return PartWindow<CPO_HingeAlphaYSpanDlg>(m, [](auto&) {}); }},
        {"hinge-masonry", kModel, MasonryWindow},
        {"hinges-generated", kModel, GeneratedWindow},
        {"hinge-strength-options", kModel,
         [](CMainWindow& m) {
             return WindowOf(
                 m, std::make_unique<CYieldStrengthCalcOptDlg>(m.Doc(), HINGE_ELEMENT::BeamColumn));
         }},
        {"hinge-materials", kModel, DescriptionWindow<CYieldStrengthCalcOptMatDescDlg>},
        {"hinge-sections", kModel, DescriptionWindow<CYieldStrengthCalcOptEffDescDlg>},
        {"hinge-table", kModel, TableWindow},
        {"section-curves", "rc-frame-code-hinges", SectionWindow},
        {"code-hinges", "rc-frame-code-hinges", CodeWindow},
    };
}
