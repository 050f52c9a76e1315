#include "numbers.h"
#include "qm_rps/dialog/unithead.h"
#include "qm_rps/po_hingeyieldpropdlgnew.h"
#include "qm_rps/po_hingeyieldpropgrid.h"
#include "qm_rps/yieldstrengthcalcoptdlg.h"

#include <functional>
#include <gtest/gtest.h>

namespace {

T_YIELD_LEVEL Level()
{
    T_YIELD_LEVEL l;
    l.tension = 1;
    l.compression = 10;
    T_PM_CURVE curve;
    for (std::size_t i = 0; i < 10; ++i)
        curve[i] = {1.0 - 0.12 * static_cast<double>(i), 0.5};
    l.y = l.z = {true, {1, 1}, {2, 4}, {curve, curve}};
    return l;
}
T_YIELD_SURFACE Surface()
{
    return {Level(), Level()};
}

struct T_RULE_CASE {
    SKEL_TYPE type;
    const char* rule; // null: passes
    std::function<void(T_YIELD_SURFACE&)> edit;
    const char* field = nullptr;
};

void Expect(const std::vector<T_RULE_CASE>& cases)
{
    for (const T_RULE_CASE& c : cases) {
        SCOPED_TRACE(c.rule ? c.rule : "passes");
        T_YIELD_SURFACE record = Surface();
        CPO_HingeYieldPropDlgNew dlg(record, c.type);
        c.edit(dlg.m_surface);
        const T_YIELD_SURFACE before = record;
        ASSERT_EQ(c.rule ? 0 : 1, dlg.OnOK());
        if (!c.rule) continue;
        EXPECT_EQ(before, record);
        ASSERT_EQ(1u, dlg.Messages().size());
        EXPECT_EQ("IDS_CMD_IEHP_YIELD", dlg.Messages()[0].key);
        const T_FINDING first = dlg.Findings().front();
        EXPECT_EQ(c.rule, first.ruleText);
        EXPECT_EQ(dlg.Messages()[0].text, first.text);
        EXPECT_TRUE(!c.field || c.field == first.field) << first.field;
    }
}

using S = T_YIELD_SURFACE;
constexpr SKEL_TYPE kBi = SKEL_TYPE::Bilinear, kTri = SKEL_TYPE::Trilinear, kEc8 = SKEL_TYPE::Ec8;

} // namespace

TEST(YieldPropDlg, EveryStrengthOfItsLevelMustBePositive)
{
    Expect({
        {kTri, nullptr, [](S&) {}},
        {kTri, "PC(t) > 0", [](S& s) { s.crack->tension = 0; }, "crack.tension"},
        {kTri, "Pmax(c) > 0", [](S& s) { s.crack->compression = -1e-9; }, "crack.compression"},
        {kTri, "MCy(+) > 0", [](S& s) { s.crack->y.moment.pos = 0; }, "crack.y.moment.pos"},
        {kTri, "MCz(-) > 0", [](S& s) { s.crack->z.moment.neg = 0; }, "crack.z.moment.neg"},
        {kTri, "MYy,max(+) > 0", [](S& s) { s.crack->y.momentMax.pos = 0; }},
        {kTri, "MYz,max(-) > 0", [](S& s) { s.crack->z.momentMax.neg = 0; }},
        {kTri, "PC(t) > 0", [](S& s) { s.crack.reset(); }},
        {kBi, "PY(t) > 0", [](S& s) { s.yield.tension = 0; }, "yield.tension"},
        {kBi, nullptr, [](S& s) { s.yield.tension = 1e-12; }},
        {kBi, "Pmax(c) > 0", [](S& s) { s.yield.compression = kInf; }},
        {kBi, "MYy(+) > 0", [](S& s) { s.yield.y.moment.pos = 0; }},
        {kBi, "MYz(+) > 0", [](S& s) { s.yield.z.moment.pos = 0; }},
        {kBi, "MYy(-) > 0", [](S& s) { s.yield.y.moment.neg = 0; }},
        {kBi, "MUy,max(+) > 0", [](S& s) { s.yield.y.momentMax.pos = 0; }},
        {kBi, "MUz,max(-) > 0", [](S& s) { s.yield.z.momentMax.neg = 0; }},
        {kBi, nullptr,
         [](S& s) {
             s.yield.z = {false, {0, 0}, {0, 0}, {}};
         }}, // not in use
        {kEc8, "PC0(t) > 0", [](S& s) { s.yield.tension = 0; }},
        {kEc8, "MC0y(+) > 0", [](S& s) { s.yield.y.moment.pos = s.yield.y.momentMax.pos = 0; }},
        {kEc8, "MUy,max(+) > 0", [](S& s) { s.yield.y.momentMax.pos = s.yield.z.moment.pos = 0; }},
        {kEc8, "MC0z(+) > 0", [](S& s) { s.yield.z.moment.pos = s.yield.y.moment.neg = 0; }},
        {kEc8, "MUz,max(+) > 0", [](S& s) { s.yield.z.momentMax.pos = s.yield.y.moment.neg = 0; }},
        {kEc8, "MC0y(-) > 0", [](S& s) { s.yield.y.moment.neg = 0; }},
        {kEc8, "MUy,max(-) > 0", [](S& s) { s.yield.y.momentMax.neg = s.yield.z.moment.neg = 0; }},
        {kEc8, "MC0z(-) > 0", [](S& s) { s.yield.z.moment.neg = 0; }},
        {kEc8, "MUz,max(-) > 0", [](S& s) { s.yield.z.momentMax.neg = 0; }},
    });
}

TEST(YieldPropDlg, RatiosStayInsideOneAndAxialForcesFall)
{
    Expect({
        {kBi, nullptr, [](S& s) { s.yield.y.curves.pos[3].m = 0.999; }},
        {kBi, "-1 < M/MY,max(+) < 1", [](S& s) { s.yield.y.curves.pos[3].m = 1.0; },
         "yield.y.curves.pos[3].m"},
        {kBi, nullptr, [](S& s) { s.yield.z.curves.neg[9].m = -0.999; }},
        {kBi, "-1 < M/MY,max(-) < 1", [](S& s) { s.yield.z.curves.neg[9].m = -1.0; },
         "yield.z.curves.neg[9].m"},
        {kBi, "-1 < M/MY,max(-) < 1", [](S& s) { s.yield.z.curves.neg[0].m = kNan; }},
        {kBi, "P/Pmax(t)", [](S& s) { s.yield.y.curves.pos[7].p = s.yield.y.curves.pos[6].p; },
         "yield.y.curves.pos[7].p"},
        {kBi, "P/Pmax(c)", [](S& s) { s.yield.y.curves.neg[4].p = s.yield.y.curves.neg[3].p; },
         "yield.y.curves.neg[4].p"},
        {kBi, "P/Pmax(c)", [](S& s) { s.yield.z.curves.pos[0].p = kInf; }},
        // From A(c) to A(t) there is no rule: the tension side starts anew.
        {kBi, nullptr, [](S& s) { s.yield.y.curves.pos[5].p = 0.7; }},
        // Strengths come before ratios, ratios before axial forces, over all levels.
        {kTri, "PY(t) > 0", [](S& s) { s.crack->y.curves.pos[0].m = 1, s.yield.tension = 0; }},
        {kTri, "-1 < M/MY,max(+) < 1",
         [](S& s) { s.crack->y.curves.pos[9].p = 1, s.yield.z.curves.pos[9].m = 1; }},
        // Tension before compression on a curve; (+) before (-) at a point.
        {kBi, "P/Pmax(t)",
         [](S& s) { s.yield.y.curves.pos[1].p = 2, s.yield.y.curves.pos[9].p = 1; }},
        {kBi, "-1 < M/MY,max(-) < 1",
         [](S& s) { s.yield.y.curves.neg[1].m = 1, s.yield.y.curves.pos[2].m = 1; }},
    });
}

TEST(YieldPropGrid, ShowsRatiosOrValuesAndStoresRatios)
{
    T_YIELD_LEVEL level = Level();
    level.z.curves.neg[1] = {1.0 / 3, 0.25};
    CPO_HingeYieldPropGrid grid(level, false);
    EXPECT_EQ("0.333333333333333", grid.CellText(1, 2));
    EXPECT_EQ("M/MYz,max(-)", grid.ColumnHead(3));
    grid.m_showValue = true;
    EXPECT_EQ("1", grid.CellText(1, 3)); // 0.25 * 4
    EXPECT_EQ(1, grid.SetCellText(1, 3, "3"));
    EXPECT_EQ(0.75, level.z.curves.neg[1].m);
    const T_YIELD_LEVEL before = level;
    for (const char* text : {"1,5", "nan", "", "1e999"})
        EXPECT_EQ(0, grid.SetCellText(1, 3, text)) << text;
    EXPECT_EQ(0, grid.SetCellText(10, 0, "1") + grid.SetCellText(0, 4, "1"));
    EXPECT_EQ(before, level);
    level.z.momentMax.neg = 0.0;
    EXPECT_EQ(0, grid.SetCellText(1, 3, "3")) << "a value without a scale has no ratio";
}

TEST(YieldStrengthCalcOpt, RefusesASelectionOfAnotherKind)
{
    CDBDoc doc;
    CYieldStrengthCalcOptDlg dlg(doc, HINGE_ELEMENT::BeamColumn);
    EXPECT_EQ(1, dlg.OnSelectElemChk(true, {{7}, {3}}));
    const T_YIELD_CALC_OPT selected{true, {3, 7}};
    EXPECT_EQ(selected, dlg.Data());
    EXPECT_EQ(0, dlg.OnSelectElemChk(true, {{1}, {2, HINGE_ELEMENT::Wall}}));
    EXPECT_EQ("IDS_CMD2_SOD_SEL_ELEM_WRONG_ELEM", dlg.Messages().at(0).key);
    EXPECT_EQ(selected, dlg.Data());
    EXPECT_EQ(1, dlg.OnSelectElemChk(false, {{2, HINGE_ELEMENT::Wall}}));
    EXPECT_EQ(T_YIELD_CALC_OPT{}, dlg.Data());
}

TEST(UnitHead, NamesAUnitOnlyWhereThereIsOne)
{
    const T_UNITS units;
    EXPECT_EQ("nu", HeadWithUnit("nu", kDimNone, units));
    EXPECT_EQ("nu", HeadWithUnit("nu", {}, units));
    EXPECT_EQ("L (" + std::string(NameOf(units.length)) + ")",
              HeadWithUnit("L", kDimLength, units));
}
