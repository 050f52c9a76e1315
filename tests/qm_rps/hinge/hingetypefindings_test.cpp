// Rules of a whole hinge type: what it refers to, codes, symmetry, automatic strengths, parts.
#include "hingesample.h"
#include "qm_rps/hinge/hingetypefindings.h"

#include <functional>
#include <gtest/gtest.h>

namespace {

constexpr const char* kNoSect = "IDS_CMD_IEHP_NO_SECT";
constexpr const char* kNoMatl = "IDS_CMD_IEHP_NO_MATL";
constexpr const char* kNoWall = "IDS_CMD_IEHP_NO_WALL";
constexpr const char* kAuto = "IDS_QM_HINGE_AUTO_STRENGTH";
constexpr const char* kSymmetry = "IDS_QM_HINGE_NOT_SYMMETRIC";

/// Sections 1 by values, 2 rectangle, 3 circle, 4 rectangle with bars. Materials 1 steel,
/// 2 concrete, 3 masonry.
T_HINGE_CONTEXT Context()
{
    T_SECT_D values, wall, circle, column;
    values.area = 3, values.Asy = values.Asz = 1, values.Zy = values.Zz = 2;
    values.Iyy = values.Izz = values.J = 1;
    wall.shape = SECT_SHAPE::Rectangle, wall.size = {300, 200};
    circle.shape = SECT_SHAPE::Circle, circle.size = {300};
    column = wall;
    column.bars = {{80, 120, 300}, {-80, 120, 300}, {80, -120, 300}, {-80, -120, 300}};
    T_MATL_D steel, concrete, masonry;
    steel.Fy = 275;
    concrete.type = MATL_CLASS::Concrete, concrete.fck = 25, concrete.fyk = 450;
    concrete.Es = 200000;
    masonry.type = MATL_CLASS::Masonry, masonry.fck = 3;
    T_HINGE_CONTEXT x;
    x.concreteCode = "Eurocode2:04";
    x.steelCode = "Eurocode3";
    x.sources = std::make_shared<CHingeSources>(
        T_TABLE<T_SECT_D>{{1, values}, {2, wall}, {3, circle}, {4, column}},
        T_TABLE<T_MATL_D>{{1, steel}, {2, concrete}, {3, masonry}},
        T_UNITS{FORCE_UNIT::N, LENGTH_UNIT::mm});
    return x;
}

T_PHGT_D Type(HINGE_COMPONENT c = HINGE_COMPONENT::My)
{
    T_PHGT_D t;
    t.name = "column";
    t.components[static_cast<std::size_t>(c)] =
        ComponentWith(SKEL_TYPE::Fema, ValidBackbone<T_SKEL_FEMA>());
    return t;
}
T_SKEL_FEMA& Fema(T_PHGT_D& t, HINGE_COMPONENT c = HINGE_COMPONENT::My)
{
    return std::get<T_SKEL_FEMA>(t.components[static_cast<std::size_t>(c)].curves.I);
}
void Automatic(T_PHGT_D& t, int section, int material)
{
    Fema(t).autoYield = true;
    t.section = section;
    t.sectionMaterial = material;
}
/// My with a symmetric curve of which both sides are stored.
void Symmetric(T_PHGT_D& t)
{
    T_SKEL_FEMA& f = Fema(t);
    f.symmetric = true;
    T_SKEL_SIDE& n = f.sides.neg;
    const T_SKEL_SIDE& p = f.sides.pos;
    n.yield = p.yield, n.yieldDeform = p.yieldDeform;
    n.B = {-1, -1}, n.C = {-6, -1.2}, n.D = {-6, -0.2}, n.E = {-8, -0.2};
    n.IO = -2, n.LS = -4, n.CP = -6;
}

struct T_CASE {
    const char* label;
    std::function<void(T_PHGT_D&)> edit;
    const char* key = nullptr; // of the only finding; null: none
    const char* field = "";
};

void Expect(const std::vector<T_CASE>& cases, const T_HINGE_CONTEXT& context)
{
    for (const T_CASE& c : cases) {
        SCOPED_TRACE(c.label);
        T_PHGT_D t = Type();
        c.edit(t);
        const auto found = HingeTypeFindings(t, context);
        ASSERT_EQ(c.key ? 1u : 0u, found.size()) << (found.empty() ? "" : found[0].text);
        if (!c.key) continue;
        EXPECT_EQ(c.key, found[0].messageKey);
        EXPECT_EQ(c.field, found[0].field);
    }
}

using T = T_PHGT_D;
constexpr auto kWall = HINGE_ELEMENT::Wall;

} // namespace

TEST(HingeTypeFindings, ReferencesExistAndFitTheElement)
{
    Expect(
        {
            {"none", [](T&) {}},
            {"fibres of a frame", [](T& t) { t.fibreSection = 3; }},
            {"missing", [](T& t) { t.fibreSection = 9; }, kNoSect, "fibreSection"},
            {"without shape", [](T& t) { t.fibreSection = 1; }, "IDS_QM_HINGE_FIBRE_SHAPE",
             "fibreSection"},
            {"fibres of a wall", [](T& t) { t.element = kWall, t.fibreSection = 2; }},
            {"round wall", [](T& t) { t.element = kWall, t.fibreSection = 3; },
             "IDS_QM_HINGE_FIBRE_SHAPE", "fibreSection"},
            {"link", [](T& t) { t.element = HINGE_ELEMENT::GeneralLink, t.fibreSection = 2; },
             "IDS_QM_HINGE_NO_FIBRES", "fibreSection"},
            {"thickness", [](T& t) { t.element = kWall, t.thicknessSection = 2; }},
            {"thickness of a circle", [](T& t) { t.element = kWall, t.thicknessSection = 3; },
             kNoWall, "thicknessSection"},
            {"thickness of a frame", [](T& t) { t.thicknessSection = 2; }, kNoWall,
             "thicknessSection"},
            {"round wall section", [](T& t) { t.element = kWall, t.section = 3; }, kNoWall,
             "section"},
        },
        Context());
}

TEST(HingeTypeFindings, AutomaticStrengthsNeedASectionAndMaterialThatGiveThem)
{
    Expect(
        {
            {"no reference: judged on the elements", [](T& t) { Automatic(t, 0, 0); }},
            {"steel by values", [](T& t) { Automatic(t, 1, 1); }},
            {"entered", [](T& t) { t.section = 3, t.sectionMaterial = 3; }},
            {"no material", [](T& t) { Automatic(t, 1, 0); }, kNoMatl, "sectionMaterial"},
            {"no section", [](T& t) { Automatic(t, 0, 1); }, kNoSect, "section"},
            {"masonry", [](T& t) { Automatic(t, 2, 3); }, kAuto, "autoYield"},
            {"concrete with bars", [](T& t) { Automatic(t, 4, 2); }},
            {"concrete without bars", [](T& t) { Automatic(t, 2, 2); }, "IDS_CMD_IEHP_NO_RBAR",
             "section"},
            {"no method for torsion",
             [](T& t) {
                 std::swap(t.components[3], t.components[4]);
                 Fema(t, HINGE_COMPONENT::Mx).autoYield = true;
                 t.section = t.sectionMaterial = 1;
             },
             kAuto, "autoYield"},
            {"not active", [](T& t) { Automatic(t, 2, 3), t.components[4].active = false; }},
        },
        Context());
}

TEST(HingeTypeFindings, AnEurocodeCurveNeedsTheEurocodePair)
{
    const auto ec8 = [](T& t) {
        t.components[4] = ComponentWith(SKEL_TYPE::Ec8, ValidBackbone<T_SKEL_EC8>());
    };
    T_HINGE_CONTEXT x = Context();
    Expect({{"Eurocode", ec8}}, x);
    x.steelCode = "AIJ-ASD02";
    Expect({{"mixed pair", ec8, "IDS_QM_HINGE_CURVE_CODES", "type"}}, x);
}

TEST(HingeTypeFindings, AStoredNegativeSideMustNotContradictSymmetry)
{
    Expect(
        {
            {"mirrored", Symmetric},
            {"left out", [](T& t) { Fema(t).symmetric = true, Fema(t).sides.neg = {}; }},
            {"energy is its own", [](T& t) { Symmetric(t), Fema(t).sides.neg.energy = {}; }},
            {"strength", [](T& t) { Symmetric(t), Fema(t).sides.neg.C.strength = -1.1999999; },
             kSymmetry, "sides.neg.C.strength"},
            {"sign", [](T& t) { Symmetric(t), Fema(t).sides.neg.CP = 6; }, kSymmetry,
             "sides.neg.CP"},
            {"yield", [](T& t) { Symmetric(t), Fema(t).sides.neg.yield = 0; }, kSymmetry,
             "sides.neg.yield"},
            {"multilinear gap is its own",
             [](T& t) {
                 T_SKEL_MULTI m;
                 m.sides.pos = m.sides.neg = {10, 0, 0, 0, 0, 0, 0.1, 0, 0.5, 0};
                 m.sides.neg.gap = 0;
                 t.components[4] = ComponentWith(SKEL_TYPE::SlipBilinear, m);
             }},
            {"multilinear strength",
             [](T& t) {
                 T_SKEL_MULTI m;
                 m.sides.pos.P1 = 10, m.sides.neg.P1 = -10; // magnitudes
                 t.components[4] = ComponentWith(SKEL_TYPE::Bilinear, m);
             },
             kSymmetry, "sides.neg.P1"},
        },
        Context());
}

TEST(HingeTypeFindings, PartsOfTheTypeAreCheckedUnderTheirNames)
{
    Expect(
        {
            {"name", [](T& t) { t.name = ""; }, "IDS_QM_HINGE_NAME_EMPTY", "name"},
            {"torsion has no Eurocode curve",
             [](T& t) {
                 t.components[3] = ComponentWith(SKEL_TYPE::Ec8, ValidBackbone<T_SKEL_EC8>());
             },
             "IDS_QM_HINGE_CURVE_NOT_OFFERED", "type"},
            {"criteria in use", [](T& t) { Fema(t).sides.pos.IO = 5; },
             "IDS_RPS_Error_Pushove_Hinge_Properties_DOF_s_contains_ERROR", "sides.pos.LS"},
            {"inactive", [](T& t) { Fema(t).sides.pos.IO = 5, Fema(t).compliance = false; }},
            {"masonry",
             [](T& t) {
                 t.masonry = {1, 1, 1, 0, 1};
             },
             "IDS_RPS_PO_Masonry_Hp_0", "masonry.Hp"},
            {"user curves", [](T& t) { t.pmm.emplace().Pmax = 0; }},
            {"user Pmax", [](T& t) { t.pmm.emplace().Pmax = -1e-9; }, "IDS_PUSHOVER_PMAX_POS",
             "pmm.Pmax"},
            {"own span", [](T& t) { t.length.autoSpan = false; }, "IDS_QM_HINGE_SPAN",
             "length.span"},
            {"automatic trilinear without a crack strength",
             [](T& t) { t.components[4] = ComponentWith(SKEL_TYPE::Trilinear, T_SKEL_MULTI()); },
             "IDS_QM_HINGE_NO_CRACK", "sides.pos.P1"},
            {"crack strength above the calculated one, Zy fy = 550",
             [](T& t) {
                 T_SKEL_MULTI m;
                 m.symmetric = false;
                 m.sides.pos.P1 = 550.001, m.sides.neg.P1 = 550;
                 t.components[4] = ComponentWith(SKEL_TYPE::Trilinear, m);
                 t.section = t.sectionMaterial = 1;
             },
             kHingeItemMessage, "sides.pos.P1"},
            {"surface without axes",
             [](T& t) {
                 T_YIELD_LEVEL& l = t.yieldSurface.emplace().yield;
                 l.y.used = l.z.used = false, l.compression = 1;
             },
             "IDS_CMD_IEHP_YIELD", "yieldSurface.yield.tension"},
        },
        Context());
}

TEST(HingeTypeWarnings, RatiosMustSuitSeveralCurvesAtOnce)
{
    const struct {
        SKEL_TYPE type;
        std::size_t curves;
        double alpha1, alpha2;
        std::size_t warnings;
        bool useDeformation = false;
    } kCases[] = {
        {SKEL_TYPE::Trilinear, 2, 0.1, 0.1, 0}, // equal ratios suit
        {SKEL_TYPE::Trilinear, 2, 0.1, 0.11, 2},       {SKEL_TYPE::Trilinear, 1, 0.1, 0.11, 0},
        {SKEL_TYPE::Bilinear, 2, 0.1, 0.11, 0}, // alpha2 is not in use
        {SKEL_TYPE::Bilinear, 2, 1.0, 0.1, 0},         {SKEL_TYPE::Bilinear, 2, 1.001, 0.1, 2},
        {SKEL_TYPE::Bilinear, 2, 1.001, 0.1, 0, true},
    };
    for (const auto& c : kCases) {
        T_SKEL_MULTI m;
        m.sides.pos.alpha1 = c.alpha1, m.sides.pos.alpha2 = c.alpha2;
        m.sides.neg.alpha1 = m.sides.neg.alpha2 = 0.1;
        m.useDeformation = c.useDeformation;
        T_PHGT_D t;
        for (std::size_t i = 0; i < c.curves; ++i)
            t.components[4 + i] = ComponentWith(c.type, m);
        EXPECT_EQ(c.warnings, HingeTypeWarnings(t).size()) << "row " << &c - kCases;
    }
}

TEST(HingeTypeWarnings, AUserStiffnessMakesAnotherYieldDeformationVoid)
{
    const struct {
        bool multi;
        double K, deform; // beside a strength of 200
        const char* text; // empty: no warning
    } kCases[] = {{false, 50000, 0.006, "200 / 50000 = 0.004; yield_deform = 0.006"},
                  {false, 50000, 0.00402, ""}, // as many digits as somebody enters
                  {false, 0, 0.006, ""},       // rigid: the plastic measure has no other yield
                  {true, 40000, 0.01, "200 / 40000 = 0.005; D1 = 0.01"},
                  {true, 40000, 0.005, ""}};
    for (const auto& c : kCases) {
        T_PHGT_D t;
        if (c.multi) {
            T_SKEL_MULTI m;
            m.autoYield = false, m.useDeformation = true, m.initStiffness = INIT_STIFFNESS::User;
            m.sides.pos = {.P1 = 200, .D1 = c.deform, .D2 = 0.05, .userStiffness = c.K};
            t.components[4] = ComponentWith(SKEL_TYPE::Bilinear, m);
        } else {
            t = Type();
            T_SKEL_FEMA& f = Fema(t);
            f.autoYield = false, f.initStiffness = INIT_STIFFNESS::User;
            f.symmetric = true;
            f.sides.pos.yield = 200, f.sides.pos.yieldDeform = c.deform;
            f.sides.pos.userStiffness = c.K;
        }
        const auto found = HingeTypeWarnings(t);
        EXPECT_EQ(*c.text ? 1u : 0u, found.size()) << c.text;
        EXPECT_EQ(c.text, First(found));
    }
}

TEST(HingeTypeWarnings, PointsLieWhereTheMeasureHasThem)
{
    using F = T_SKEL_FEMA;
    const auto at = [](F& f, double force) {
        f.multiCurve = true, f.curves = {{force, f.sides}, {900, f.sides}};
    };
    // clang-format off
    const std::pair<const char*, std::function<void(F&)>> kCases[] = { // the only warning
        {"", [](F&) {}},
        {"D(B) = 1", [](F& f) { f.sides.pos.B.deform = 1.1; }},
        {"D(B) = 1", [](F& f) { f.sides.neg.B.deform = -0.9; }},
        {"D(B) = 0", [](F& f) { f.measure = SKEL_MEASURE::Plastic, f.sides.neg.B.deform = 0; }},
        {"F(B) = 1", [](F& f) { f.sides.neg.B.strength = -1.1; }},
        {"", [](F& f) { f.sides.pos.CP = 8; }},
        {"CP <= D(E)", [](F& f) { f.sides.pos.CP = 8.001; }},
        {"", [](F& f) { f.sides.pos.CP = 9, f.compliance = false; }},
        {"P = 500", [&](F& f) { at(f, 500); }},
        {"", [&](F& f) { at(f, 0); }},
    };
    // clang-format on
    for (const auto& [rule, spoil] : kCases) {
        T_PHGT_D t = Type();
        Fema(t).initStiffness = INIT_STIFFNESS::EI6L; // gives no yield deformation of its own
        spoil(Fema(t));
        const auto found = HingeTypeWarnings(t);
        EXPECT_EQ(*rule ? 1u : 0u, found.size()) << rule;
        EXPECT_EQ(rule, First(found));
    }
}
