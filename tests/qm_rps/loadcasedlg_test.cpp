#include "qm_base/appbase.h"
#include "qm_rps/po_loadcasedlg.h"

#include <gtest/gtest.h>
#include <limits>

namespace {

using P = T_POLC_D;
constexpr double kNan = std::numeric_limits<double>::quiet_NaN();
constexpr const char* kName = "IDS_PUSHOVER_Error___Loadcase_name_is_not_input_";
constexpr const char* kFunction = "IDS_RPS_PO_Error_No_Increment_Function";
constexpr const char* kRatio = "IDS_RPS_PO_POLC_Current_Stif_Ratio_0";
constexpr const char* kAngle = "IDS_PUSHOVER_STATIC_ANGLE_GEN";
constexpr const char* kMaster = "IDS_PUSHOVER_Error___Master_Max_Displ__must_be_grea";
constexpr const char* kTrans = "IDS_PUSHOVER_Error___Max__Translational_Displ__must";
constexpr const char* kFactor = "IDS_PUSHOVER_the_Scale_Factor_can_not_be_zero";
constexpr const char* kMode = "IDS_PUSHOVER_Error___Mode_must_be_greater_than_0";
constexpr const char* kFirst = "IDS_PUSHOVER_The_Load_Pattern_of_Mode_Shape_can_hav";
constexpr const char* kExists = "IDS_PUSHOVER_Error___The_data_already_exist_";

P ByForce()
{
    P p;
    p.name = "PX";
    p.control = T_POLC_CONTROL();
    p.control->incrementMethod = 2;
    return p;
}

P ByDispl(bool master)
{
    P p = ByForce();
    p.control->incrementMethod = 1;
    p.control->masterNodeControl = master;
    p.control->masterMaxDispl = master ? 0.3 : 0;
    p.control->maxTransDispl = master ? 0 : 0.3;
    return p;
}

struct T_CASE {
    const char* key;
    P start;
    void (*spoil)(P&);
};
// clang-format off
const T_CASE kCases[] = { // function 4 exists
    { "", ByDispl(true), [](P&) {} },
    { "", ByDispl(false), [](P&) {} },
    { kName, ByForce(), [](P& p) { p.name = ""; p.control->stiffnessRatioLimit = -1; } },
    { kName, ByForce(), [](P& p) { p.name = ""; p.control.reset(); } },
    { "", ByForce(), [](P& p) { p.control.reset(); } },
    { kFunction, ByForce(), [](P& p) { p.control->incrementOption = 2; p.control->incrementFunction = 5; p.control->stiffnessRatioLimit = -1; } },
    { "", ByForce(), [](P& p) { p.control->incrementOption = 2; p.control->incrementFunction = 4; } },
    { kRatio, ByForce(), [](P& p) { p.control->stiffnessRatioLimit = -0.01; p.control->generateStaticAngle = true; } },
    { kRatio, ByForce(), [](P& p) { p.control->stiffnessRatioLimit = kNan; } },
    { kAngle, ByForce(), [](P& p) { p.control->generateStaticAngle = true; } },
    { "", ByForce(), [](P& p) { p.control->generateStaticAngle = true; p.control->staticAngle = 1e-9; } },
    { kMaster, ByDispl(true), [](P& p) { p.control->masterMaxDispl = 0; } },
    { "", ByDispl(true), [](P& p) { p.control->masterMaxDispl = -0.05; p.control->stiffnessRatioLimit = -1; } },
    { kTrans, ByDispl(false), [](P& p) { p.control->maxTransDispl = 0; } },
    { kTrans, ByDispl(false), [](P& p) { p.control->maxTransDispl = -0.05; } },
};
// clang-format on

bool Exists(int key)
{
    return key == 4;
}

TEST(LoadCase, ReportsEachRuleInOrderAndWritesNothing)
{
    for (const T_CASE& c : kCases) {
        P p = c.start;
        c.spoil(p);
        CPO_LoadCaseDlg dlg(Exists);
        dlg.Data2Dlg(p);
        P stored;
        stored.name = "before";
        const P before = stored;
        EXPECT_EQ(*c.key ? 0 : 1, dlg.Dlg2Data(stored)) << "row " << &c - kCases;
        EXPECT_EQ(c.key, dlg.Messages().empty() ? "" : dlg.Messages().front().key)
            << "row " << &c - kCases;
        EXPECT_TRUE(!*c.key || before == stored) << "row " << &c - kCases;
    }
}

TEST(LoadCase, ChecksPatternRows)
{
    const struct {
        CPO_LoadCaseDlg::T_PATTERN_INPUT in; // kind, load case, direction index, mode, factor
        int number;                          // 0: refused
        const char* key;
    } rows[] = {
        {{0, 7, 2, 5, 1}, 7, ""},         {{1, 7, 2, 5, -1}, 3, ""},
        {{2, 7, 2, 2.7, 1}, 2, ""},       {{3, 7, 2, 1, 1e-9}, 1, ""},
        {{2, 7, 2, 0.99, 1}, 0, kMode},   {{3, 7, 2, kNan, 1}, 0, kMode},
        {{2, 7, 2, 1e12, 1}, 0, kMode},   {{2, 7, 2, 0, 0}, 0, kFactor},
        {{0, 7, 2, 0, kNan}, 0, kFactor},
    };
    for (const auto& row : rows) {
        CPO_LoadCaseDlg dlg(Exists);
        T_POLC_PATTERN out{9, 9, 9};
        EXPECT_EQ(row.number ? 1 : 0, dlg.CheckPattern(row.in, out));
        EXPECT_EQ(row.key, dlg.Messages().empty() ? "" : dlg.Messages().front().key);
        const T_POLC_PATTERN untouched{9, 9, 9};
        EXPECT_EQ(row.number ? (T_POLC_PATTERN{row.in.kind, row.number, row.in.factor}) : untouched,
                  out);
    }
}

TEST(LoadCase, AssertsOnAnUnknownPatternKindAndKeepsItsFactor)
{
    CPO_LoadCaseDlg dlg(Exists);
    T_POLC_PATTERN out;
    CAppBase::TakeAssertions_ST();
    EXPECT_EQ(1, dlg.CheckPattern({4, 7, 2, 5, 1.5}, out));
    EXPECT_EQ((T_POLC_PATTERN{4, 0, 1.5}), out);
    EXPECT_EQ("src/qm_rps/po_loadcasedlg", CAppBase::TakeAssertions_ST().at(0).source);
}

TEST(LoadCase, AddsPatternsByTheirNumberAlone)
{
    CPO_LoadCaseDlg dlg(Exists);
    dlg.Data2Dlg(ByForce());
    EXPECT_EQ(1, dlg.OnAddPattern({0, 1, 0, 0, 1}));
    EXPECT_EQ(0, dlg.OnAddPattern({1, 0, 0, 0, 1})); // direction 1 collides with load case 1
    EXPECT_EQ(kExists, dlg.Messages().back().key);
    EXPECT_EQ(0, dlg.OnAddPattern({2, 0, 0, 1, 1})); // the list is not empty: that rule goes first
    EXPECT_EQ(kFirst, dlg.Messages().back().key);
    EXPECT_EQ(1, dlg.OnAddPattern({1, 0, 1, 0, 2}));
    EXPECT_EQ(1, dlg.m_selected);
    EXPECT_EQ((std::vector<T_POLC_PATTERN>{{0, 1, 1}, {1, 2, 2}}), dlg.m_case.patterns);
    EXPECT_EQ(1, dlg.OnDeletePattern());
    EXPECT_EQ(0, dlg.OnDeletePattern());
    EXPECT_EQ(1u, dlg.m_case.patterns.size());
}

TEST(LoadCase, FindsWhatStoredPatternsBreak)
{
    const auto found =
        CPO_LoadCaseDlg::PatternFindings({{0, 1, 0}, {2, 0, 1}, {1, 1, 1}, {1, 2, 1}});
    const char* keys[] = {kFactor, kMode, kFirst, kExists};
    const char* fields[] = {"patterns[0]", "patterns[1]", "patterns[1]", "patterns[2]"};
    ASSERT_EQ(4u, found.size());
    for (std::size_t i = 0; i < 4; ++i) {
        EXPECT_EQ(keys[i], found[i].messageKey);
        EXPECT_EQ(fields[i], found[i].field);
    }
    EXPECT_TRUE(CPO_LoadCaseDlg::PatternFindings({{2, 1, 1}, {0, 3, 1}}).empty());
}

} // namespace
