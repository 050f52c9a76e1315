#include "numbers.h"
#include "qm_base/appbase.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/po_loadcasedlg.h"

#include <gtest/gtest.h>

namespace {

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

using P = T_POLC_D;
using C = T_POLC_CONTROL;

/// Controlled by a force that follows no function; by the displacement of the control node, or by
/// the largest one.
enum START { kForce, kMasterNode, kAnyNode };

P Start(START start)
{
    P p;
    p.name = "PX";
    C& c = p.control.emplace();
    c.incrementMethod = start == kForce ? 2 : 1;
    c.masterNodeControl = start == kMasterNode;
    if (start == kMasterNode) c.masterMaxDispl = 0.3;
    if (start == kAnyNode) c.maxTransDispl = 0.3;
    return p;
}

struct T_CASE {
    std::vector<std::string> keys; // in the order of the check
    START start;
    void (*spoil)(P&, C&);
};
// clang-format off
const T_CASE kCases[] = { // function 4 exists
    { {}, kMasterNode, [](P&, C& c) { c.masterMaxDispl = -0.05; c.stiffnessRatioLimit = -1; } },
    { {}, kAnyNode, [](P&, C&) {} },
    { {kName, kRatio}, kForce, [](P& p, C& c) { p.name = ""; c.stiffnessRatioLimit = -0.01; } },
    { {kName}, kForce, [](P& p, C&) { p.name = ""; p.control.reset(); } },
    { {kFunction}, kForce, [](P&, C& c) { c.incrementOption = 2; c.incrementFunction = 5; } },
    { {}, kForce, [](P&, C& c) { c.incrementOption = 2; c.incrementFunction = 4; } },
    { {}, kForce, [](P&, C& c) { c.incrementOption = 1; c.incrementFunction = 5; } },
    { {kRatio}, kForce, [](P&, C& c) { c.stiffnessRatioLimit = kNan; } },
    { {kAngle}, kForce, [](P&, C& c) { c.generateStaticAngle = true; } },
    { {}, kForce, [](P&, C& c) { c.generateStaticAngle = true; c.staticAngle = 1e-9; } },
    { {kMaster}, kMasterNode, [](P&, C& c) { c.masterMaxDispl = 0; } },
    { {kTrans}, kAnyNode, [](P&, C& c) { c.maxTransDispl = -0.05; } },
};
// clang-format on

std::vector<std::string> Keys(const std::vector<T_FINDING>& findings)
{
    std::vector<std::string> keys;
    for (const T_FINDING& f : findings)
        keys.push_back(f.messageKey);
    return keys;
}

} // namespace

TEST(LoadCase, FindsEachRuleThatIsNotKept)
{
    T_MODEL model;
    model.incrementFunctions[4] = {};
    for (const T_CASE& c : kCases) {
        P p = Start(c.start);
        c.spoil(p, *p.control);
        EXPECT_EQ(c.keys, Keys(LoadCaseFindings(p, model))) << "row " << &c - kCases;
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
        CPO_LoadCaseDlg dlg;
        const T_POLC_PATTERN before{9, 9, 9};
        T_POLC_PATTERN out = before;
        EXPECT_EQ(row.number ? 1 : 0, dlg.CheckPattern(row.in, out));
        EXPECT_EQ(row.key, dlg.Messages().empty() ? "" : dlg.Messages().front().key);
        EXPECT_EQ(row.number ? (T_POLC_PATTERN{row.in.kind, row.number, row.in.factor}) : before,
                  out);
    }
    T_POLC_PATTERN out;
    CAppBase::TakeAssertions_ST();
    EXPECT_EQ(1, CPO_LoadCaseDlg().CheckPattern({4, 7, 2, 5, 1.5}, out)); // no such kind
    EXPECT_EQ((T_POLC_PATTERN{4, 0, 1.5}), out);
    EXPECT_EQ("src/qm_rps/po_loadcasedlg", CAppBase::TakeAssertions_ST().at(0).source);
}

TEST(LoadCase, AddsPatternsByTheirNumberAlone)
{
    CPO_LoadCaseDlg dlg;
    dlg.Data2Dlg(Start(kForce));
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
    const std::vector<T_POLC_PATTERN> rows{{0, 1, 0}, {2, 0, 1}, {1, 1, 1}, {1, 2, 1}};
    const auto found = PatternFindings(rows);
    EXPECT_EQ((std::vector<std::string>{kFactor, kMode, kFirst, kExists}), Keys(found));
    EXPECT_EQ("patterns[0]", found[0].field);
    EXPECT_EQ("patterns[2]", found[3].field);
    EXPECT_TRUE(PatternFindings(std::vector<T_POLC_PATTERN>{{2, 1, 1}, {0, 3, 1}}).empty());
}
