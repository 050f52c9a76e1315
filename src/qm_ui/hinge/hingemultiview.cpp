#include "qm_base/msgfunction.h"
#include "qm_rps/hinge/hingetypefindings.h"
#include "qm_rps/po_hingeskcvtabdlg.h"
#include "qm_ui/hinge/hingefieldsview.h"
#include "qm_ui/hinge/hingeplot.h"
#include "qm_ui/hinge/hingeviews.h"

namespace {

using DLG = CPO_HingeSkcvTabDlg;
using SIDE = T_SKEL_MULTI_SIDE;

/// One page of the editor. It keeps no data: everything is asked for again.
struct T_MULTI_PAGE {
    DLG& dlg;
    HINGE_END end;
    std::string prefix;
    T_SKEL_MULTI& Curve() const { return *dlg.Curve(end); }
    bool Tri() const { return IsTrilinear(dlg.Component().type); }
    bool Slip() const
    {
        return dlg.Component().type == SKEL_TYPE::SlipBilinear ||
               dlg.Component().type == SKEL_TYPE::SlipTrilinear;
    }
    bool Moment() const { return dlg.Which() >= HINGE_COMPONENT::Mx; }
};
using P = T_MULTI_PAGE;

/// What the number of a row is, for its unit.
enum class KIND { Strength, Deform, Stiffness, Ratio };

/// Keys of the text for a force and for a moment.
using TEXTS = std::array<const char*, 2>;

/// A row of the table: shown for the curves that have it, usable with the options in force.
struct T_ROW {
    const char* name; // of the member
    double SIDE::*member;
    KIND kind;
    TEXTS texts;
    bool (*shown)(const P&);
    bool (*enabled)(const P&);
};

bool Always(const P&)
{
    return true;
}
bool Entered(const P& p)
{
    return !p.Curve().autoYield;
}
bool ShowsYield(const P& p)
{
    return IsYieldShown(p.Curve(), p.dlg.Calculated(p.end));
}
bool Deformation(const P& p)
{
    return p.Curve().useDeformation;
}
bool Ratios(const P& p)
{
    return !p.Curve().useDeformation;
}
bool Tri(const P& p)
{
    return p.Tri();
}
bool Bi(const P& p)
{
    return !p.Tri();
}
bool BiYield(const P& p)
{
    return Bi(p) && ShowsYield(p);
}
bool TriYield(const P& p)
{
    return Tri(p) && ShowsYield(p);
}
/// The second point of a bilinear curve: its strength counts with its deformation, or below P3.
bool Second(const P& p)
{
    return p.Curve().useUltimate || p.Curve().useDeformation;
}
bool Ultimate(const P& p)
{
    return p.Curve().useUltimate;
}
bool User(const P& p)
{
    return p.Curve().initStiffness == INIT_STIFFNESS::User;
}

bool TriDeformation(const P& p)
{
    return Tri(p) && Deformation(p);
}
bool TriRatios(const P& p)
{
    return Tri(p) && Ratios(p);
}

constexpr TEXTS Both(const char* key)
{
    return {key, key};
}
constexpr TEXTS kYield{"IDS_RPS_PUSHOVER_YIELD_FROCE", "IDS_RPS_PUSHOVER_YIELD_MOMENT"};
constexpr TEXTS kCrack{"IDS_RPS_PUSHOVER_CRACK_FROCE", "IDS_RPS_PUSHOVER_CRACK_MOMENT"};
constexpr TEXTS kSecond{"IDS_QM_UI_HINGE_SECOND_FORCE", "IDS_QM_UI_HINGE_SECOND_MOMENT"};
constexpr TEXTS kUltimate{"IDS_QM_UI_HINGE_ULT_FORCE", "IDS_QM_UI_HINGE_ULT_MOMENT"};
constexpr TEXTS kStiffness = Both("IDS_QM_UI_HINGE_USER_STIFFNESS");

// clang-format off
constexpr T_ROW kRows[] = {
    {"P1",     &SIDE::P1,     KIND::Strength, kYield,    BiYield,  Entered},
    {"P1",     &SIDE::P1,     KIND::Strength, kCrack,    Tri, Always},
    {"P2",     &SIDE::P2,     KIND::Strength, kYield,    TriYield, Entered},
    {"P2",     &SIDE::P2,     KIND::Strength, kSecond,   Bi,  Second},
    {"P3",     &SIDE::P3,     KIND::Strength, kUltimate, Always, Ultimate},
    {"D1",     &SIDE::D1,     KIND::Deform,   Both("IDS_QM_UI_HINGE_D1"), Deformation, Always},
    {"D2",     &SIDE::D2,     KIND::Deform,   Both("IDS_QM_UI_HINGE_D2"), Deformation, Always},
    {"D3",     &SIDE::D3,     KIND::Deform,   Both("IDS_QM_UI_HINGE_D3"), TriDeformation, Always},
    {"alpha1", &SIDE::alpha1, KIND::Ratio,    Both("IDS_QM_UI_HINGE_ALPHA1"), Ratios, Always},
    {"alpha2", &SIDE::alpha2, KIND::Ratio,    Both("IDS_QM_UI_HINGE_ALPHA2"), TriRatios, Always},
    {"userStiffness", &SIDE::userStiffness, KIND::Stiffness, kStiffness, Always, User},
};
// clang-format on

std::string TextOf(const P& p, const T_ROW& row)
{
    const std::string key = row.texts[p.Moment() ? 1 : 0];
    switch (row.kind) {
    case KIND::Strength:
        return StrengthHead(key, p.dlg.Which(), p.dlg.m_owner);
    case KIND::Deform:
        return DeformHead(key, p.dlg.Which(), p.dlg.m_owner);
    case KIND::Stiffness:
        return StiffnessHead(key, p.dlg.Which(), p.dlg.m_owner);
    case KIND::Ratio:
        break;
    }
    return HeadWithUnit(key, kDimNone, p.dlg.m_owner.units);
}

/// The gap has its own entry on each side, for the sides that have one.
void AddGapRow(CFormView& form, const P& p, const std::function<T_SIDES<SIDE>&()>& sides)
{
    const TextFn text = [p] {
        return DeformHead("IDS_QM_UI_HINGE_GAP", p.dlg.Which(), p.dlg.m_owner);
    };
    const auto shown = [p] { return p.Slip(); };
    const auto gap = [](SIDE& s) -> double& { return s.gap; };
    Set(form.Note(text), "", {}, shown);
    for (const bool positive : {true, false}) {
        const GAP_SIDES other = positive ? GAP_SIDES::Negative : GAP_SIDES::Positive;
        Set(
            form.Number(text, SideValue(sides, positive, gap)),
            p.prefix + (positive ? "sides.pos.gap" : "sides.neg.gap"),
            [p, other] { return p.Curve().gapSides != other; }, shown);
    }
}

void AddTable(CFormView& form, const P& p)
{
    const std::function<T_SIDES<SIDE>&()> sides = [p]() -> auto&
    {
        return p.Curve().sides;
    };
    AddByElementNote(form, [p] { return ShowsYield(p); });
    form.Cells({{}, PlainLabel("(+)"), PlainLabel("(-)")});
    for (const T_ROW& row : kRows)
        AddSideRow(form,
                   {p.prefix, row.name, [p, row] { return TextOf(p, row); },
                    [p] { return !p.Curve().symmetric; }, [p, row] { return row.shown(p); },
                    [p, row] { return row.enabled(p); }},
                   sides, [m = row.member](SIDE& s) -> double& { return s.*m; });
    AddGapRow(form, p, sides);
    form.EndCells();
}

T_BINDING<bool> FlagOf(const P& p, bool T_SKEL_MULTI::*member)
{
    return {[p, member] { return p.Curve().*member; },
            [p, member](const bool& on) { p.Curve().*member = on; }};
}

void AddPage(CFormView& form, const P& p)
{
    form.Note([p] { return zql::lib::MMSGFunction::GetValue(CurveKey(p.dlg.Component().type)); });
    AddModelNote(form, p.dlg.Which(), p.dlg.m_owner);
    AutoYieldChoice(form, {[p] { return p.Curve().autoYield; },
                           [p](const bool& on) { p.dlg.OnUserAutoRdo(p.end, on); }})
        .name = p.prefix + "autoYield";
    StiffnessChoice(form, p.dlg.Which(),
                    {[p] { return p.Curve().initStiffness; },
                     [p](const INIT_STIFFNESS& v) { p.dlg.ChangeInitStiff(p.end, v); }});
    form.Choice(KeyText("IDS_QM_UI_HINGE_BY"),
                {[p] { return p.Curve().useDeformation ? 1 : 0; },
                 [p](const int& i) { p.Curve().useDeformation = i == 1; }},
                KeyTexts({"IDS_QM_UI_HINGE_BY_RATIOS", "IDS_QM_UI_HINGE_BY_DEFORM"}));
    Set(form.Choice(
            KeyText("IDS_QM_UI_HINGE_GAP_SIDES"),
            {[p] { return static_cast<int>(p.Curve().gapSides); },
             [p](const int& i) { p.dlg.OnChangeSlipInitGap(p.end, static_cast<GAP_SIDES>(i)); }},
            KeyTexts({"IDS_QM_UI_HINGE_GAP_BOTH", "IDS_QM_UI_HINGE_GAP_POS",
                      "IDS_QM_UI_HINGE_GAP_NEG"})),
        "", {}, [p] { return p.Slip(); });
    Set(form.Button(KeyText("IDS_QM_UI_HINGE_TAKE_RATIOS"),
                    [p] { p.dlg.OnDefaultAlphaBtn(p.end); }),
        p.prefix + "defaultAlpha", [p] { return !p.Curve().useDeformation; });
    form.Columns();
    form.Flag(KeyText("IDS_QM_UI_HINGE_SYMMETRIC"), FlagOf(p, &T_SKEL_MULTI::symmetric));
    form.NextColumn();
    form.Flag(KeyText("IDS_QM_UI_HINGE_ULTIMATE"), FlagOf(p, &T_SKEL_MULTI::useUltimate));
    form.EndColumns();
    AddTable(form, p);
}

void BuildMulti(CFormView& form, DLG& dlg)
{
    dlg.OnEdited();
    form.m_onChange = [&dlg] { dlg.OnEdited(); };
    form.SetFindings([&dlg] {
        std::vector<T_FINDING> found = dlg.Findings();
        for (T_FINDING& f : found)
            f.field = PathOnPages(f);
        return found;
    });
    ForEachPage(dlg.Component(), [&](HINGE_END end, const T_SKEL_CURVE&) {
        const char* title = PageTitleKey(dlg.Component(), end);
        form.Page(KeyText(title));
        form.Columns();
        AddPage(form, {dlg, end, end == HINGE_END::J ? "J." : ""});
        form.NextColumn();
        AddBackbonePicture(form, [&dlg, end, title](bool box) {
            return HingeBackbonePlot(dlg.m_owner.type, dlg.Which(), *dlg.Curve(end),
                                     zql::lib::MMSGFunction::GetValue(title), box);
        }).name = std::string(end == HINGE_END::J ? "J." : "") + "picture";
        form.EndColumns();
    });
    form.EndPages();
}

} // namespace

void RegisterHingeMultiView(CViewFactory& factory)
{
    factory.Register<DLG>(KeyText("IDS_QM_UI_HINGE_MULTI_TITLE"), BuildMulti, {.size = {1050, 0}});
}
