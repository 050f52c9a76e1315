// Set-up of a push in the case file, in the model file and in a document.
#include "casetext.h"
#include "numbers.h"

#include "qm_db/dbdoc.h"
#include "qm_db/recordfacts.h"

#include <gtest/gtest.h>

namespace {

std::string AllText()
{
    return CaseText("push_all_members.json");
}

/// "field: message key" of each.
std::vector<std::string> Places(const std::vector<T_FINDING>& findings)
{
    std::vector<std::string> all;
    for (const T_FINDING& f : findings)
        all.push_back(f.field + ": " + f.messageKey);
    return all;
}

} // namespace

TEST(PushCase, EveryMemberComesBackLetterForLetter)
{
    const T_MODEL_CONTENT content = ParseGood(AllText());
    EXPECT_EQ(AllText(), PrintGood(content));
    ExpectRoundTrips(content, "push");
    ExpectLosslessInEveryUnit(content);
}

TEST(PushCase, ReadsEveryMemberIntoItsField)
{
    const T_MODEL m = ParseGood(AllText()).model;
    const std::vector<T_PUSH_INITIAL_LOAD> loads{{2, 0.3}, {1, 1.0}};
    const T_POGC_D global{
        loads, PUSH_P_DELTA::Updated, 40, PUSH_FAILURE::Stop, PUSH_FLOW::Associated, {5}, 200,
        3000};
    EXPECT_EQ(global, m.pushControl);
    const T_POLC_D& p = m.pushovers.at(1);
    EXPECT_EQ("first half", p.initialCase);
    EXPECT_FALSE(p.initialLoads);
    EXPECT_EQ((T_PUSH_STOPS_D{0.02, PUSH_STATE_STOP::CP, 0.8}), p.stops);
    EXPECT_EQ(-0.05, p.eccentricity);
    EXPECT_EQ((std::vector{-2 * 0.0254, -3.5 * 0.0254}), p.additionalDisplacements); // 1 in
    EXPECT_TRUE(p.additionalEvaluations);
    EXPECT_EQ(9, m.pushovers.at(3).steps);

    T_POGC_D own = global; // what the load case has goes before what holds for all
    own.pDelta = PUSH_P_DELTA::None;
    own.steps = 7;
    own.onFailure = PUSH_FAILURE::Drop;
    EXPECT_EQ(own, PushControlOf(m, p));
    own = global;
    own.initialLoads.clear();
    EXPECT_EQ(own, PushControlOf(m, m.pushovers.at(2)));
}

// A rotation that is controlled is in rad whatever the units; those of the file are kips and in.
TEST(PushCase, ControlByARotationIsInRadians)
{
    std::string text = AllText();
    const std::size_t at = text.find("\"direction\"");
    ASSERT_NE(std::string::npos, at);
    const T_POLC_D along = ParseGood(text).model.pushovers.at(1);
    text.replace(at, text.find(',', at) - at, "\"direction\": \"RY\"");
    const T_MODEL_CONTENT content = ParseGood(text);
    const T_POLC_D& about = content.model.pushovers.at(1);
    EXPECT_DOUBLE_EQ(along.control->masterMaxDispl / 0.0254, about.control->masterMaxDispl);
    EXPECT_EQ((std::vector{-2.0, -3.5}), about.additionalDisplacements);
    EXPECT_EQ(text, PrintGood(content));
    ExpectLosslessInEveryUnit(content);
}

TEST(PushCase, BadInputNamesThePlace)
{
    ExpectRefused(AllText(), "push_refusals.txt");
}

TEST(PushCase, TheWindowFindsWhatTheReaderRefuses)
{
    const T_MODEL m = ParseGood(AllText()).model;
    T_POLC_D p = m.pushovers.at(1);
    EXPECT_TRUE(LoadCaseFindings(p, m, 1).empty());
    p.name =
        "renamed"; // its new name is not in the model yet; "first half" starts from the old one
    p.steps = kMostPushSteps + 1;
    p.stops = {kNan, {}, kNan};
    p.eccentricity = kNan;
    p.additionalDisplacements = {kNan};
    p.initialLoads = {{3, 1.0}, {1, kNan}};
    p.control->incrementFunction = 2;
    T_MODEL circle = m;
    circle.pushovers.at(2).initialCase = "second half";
    EXPECT_EQ(
        (std::vector<std::string>{
            "control.incrementFunction: IDS_RPS_PO_Error_No_Increment_Function",
            "steps: IDS_QM_PUSH_STEPS", "initialCase: IDS_QM_PUSH_CIRCLE",
            "stops.drift: IDS_QM_PUSH_DRIFT", "stops.fractionOfPeak: IDS_QM_PUSH_FRACTION_OF_PEAK",
            "eccentricity: IDS_QM_PUSH_ECCENTRICITY",
            "additionalDisplacements: IDS_QM_PUSH_ADDITIONAL",
            "initialLoads[0].loadCase: IDS_QM_UI_POLC_NO_CASE",
            "initialLoads[1].factor: IDS_QM_PUSH_INITIAL_FACTOR"}),
        Places(LoadCaseFindings(p, circle, 1)));

    T_POGC_D c;
    c.initialLoads = {{3, 0.0}};
    c.steps = c.mostEvents = c.mostSteps = 0;
    c.hingeTypes = {1, 3};
    EXPECT_EQ((std::vector<std::string>{"initialLoads[0].loadCase: IDS_QM_UI_POLC_NO_CASE",
                                        "initialLoads[0].factor: IDS_QM_PUSH_INITIAL_FACTOR",
                                        "steps: IDS_QM_PUSH_STEPS", "mostEvents: IDS_QM_PUSH_MOST",
                                        "mostSteps: IDS_QM_PUSH_MOST",
                                        "hingeTypes: IDS_QM_PUSH_NO_HINGE_TYPE"}),
              Places(PushControlFindings(c, m)));
}

TEST(PushCase, IncrementFunctionsRiseFromTheOrigin)
{
    using S = std::vector<double>;
    const struct {
        S step, factor;
        S found; // 0 rows, 1 step, 2 factor
    } rows[] = {{{1, 2}, {0.5, 1}, {}},  {{0, 2}, {0, 1}, {}},
                {{3}, {1}, {}},          {{}, {}, {0}},
                {{0}, {0}, {0}},         {{0, 2}, {0.5, 1}, {1}},
                {{1, 2}, {0, 1}, {2}},   {{1, 1}, {0.5, 1}, {1}},
                {{1, 2}, {1, 0.5}, {2}}, {{1, kNan}, {1, kNan}, {1, 2}}};
    constexpr const char* kFound[] = {"step: IDS_QM_PUSH_FUNCTION_ROWS",
                                      "step: IDS_QM_PUSH_FUNCTION_RISE",
                                      "factor: IDS_QM_PUSH_FUNCTION_RISE"};
    for (const auto& row : rows) {
        std::vector<std::string> expected;
        for (const double found : row.found)
            expected.emplace_back(kFound[static_cast<std::size_t>(found)]);
        EXPECT_EQ(expected, Places(IncrementFunctionFindings({"f", row.step, row.factor})))
            << "row " << &row - rows;
    }
}

TEST(PushCase, NamesFollowAndWhatIsUsedStays)
{
    CDBDoc doc;
    doc.Data().Assign(ParseGood(AllText()));
    const T_MODEL before = doc.Data().Model();
    T_POLC_D first;
    T_POGC_D control;
    T_RECORD_USERS users;
    ASSERT_TRUE(doc.Attr().GetPolc(2, first) && doc.Attr().GetPogc(control));
    first.name = "start";
    control.steps = 12;
    EXPECT_EQ(0, doc.Edit().PutPogc(control)); // no step is open
    ASSERT_TRUE(doc.Edit().Begin("edit") && doc.Edit().Put(2, first) &&
                doc.Edit().PutPogc(control));
    EXPECT_EQ("start", doc.Data().Model().pushovers.at(1).initialCase);
    EXPECT_EQ(12, doc.Data().Model().pushControl.steps);

    EXPECT_EQ(0, doc.Edit().Erase<T_POLC_D>(2, users));
    EXPECT_EQ((T_RECORD_USERS{{KindOf<T_POLC_D>(), 1}}), users);
    EXPECT_EQ(0, doc.Edit().Erase<T_STLD_D>(2, users));
    ASSERT_EQ((T_RECORD_USERS{{kPushControlKind, 0}}), users);
    EXPECT_EQ("the control of the pushover analysis",
              DescribeUser(doc.Data().Model(), users.front()));
    EXPECT_EQ(0, doc.Edit().Erase<T_PHGT_D>(5, users));
    EXPECT_EQ(1, doc.Edit().Erase<T_PHGT_D>(1, users)); // does not act: nothing names it
    ASSERT_TRUE(doc.Edit().Commit() && doc.Undo().Undo());
    EXPECT_EQ(before, doc.Data().Model());
}
