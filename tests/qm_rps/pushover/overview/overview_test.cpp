#include "qm_rps/pushover/overview/evaluationcards.h"
#include "qm_rps/pushover/overview/evaluationunits.h"
#include "qm_rps/pushover/overview/factcells.h"
#include "qm_rps/pushover/overview/plotregion.h"

#include <gtest/gtest.h>

namespace {

/// A found target displacement of Eurocode 8 on a curve that ends at Sd = 0.2 m; Gamma = 1.25, so
/// that the control node ends at 0.25 m. V = alpha Sa M g with 0.8 x 100 x 10.
T_PUSH_EVALUATION Target()
{
    T_PUSH_EVALUATION e;
    e.eval.method = PUSH_METHOD::Ec8Opcm;
    e.result = 1;
    e.factors.gamma = 1.25;
    e.factors.alpha = 0.8;
    e.factors.mass = 100.0;
    e.factors.gravity = 10.0;
    e.capacity = {{0.01, 0.1, 0.2}, {0.05, 0.5, 0.6}};
    e.demand = {{0.0, 0.05, 0.3}, {0.4, 1.0, 0.2}};
    e.limitStates = {{"DL", 0.05, 0.06, {}, {}, "OK"},
                     {"SD", 0.125, 0.2, {}, {}, "OK"},
                     {"NC", 0.19, 0.25, {}, {}, "OK"}};
    e.bilinear = T_BILINEAR{0.04, 0.5, 0.2, 0.5};
    e.targets = {{}};
    e.targets[0].found = true;
    e.targets[0].dy = 0.04;
    e.targets[0].dt = 0.1;
    e.targets[0].Tstar = 0.56;
    return e;
}

T_PUSH_EVALUATION Point()
{
    T_PUSH_EVALUATION e = Target();
    e.eval.method = PUSH_METHOD::Atc40;
    e.limitStates.clear();
    e.targets.clear();
    e.bilinear.reset();
    e.point = T_PERF_POINT{0.15, 0.55, 0.1875, 440.0, 1.05, 12.0};
    T_PERFPT_TRIAL last;
    last.dpi = 0.149;
    last.api = 0.549;
    last.dy = 0.05;
    e.trace = {last};
    return e;
}

double Value(const T_PUSH_EVALUATION& e, CARD card)
{
    return CardsOf({e.eval, e, {}, {}})[static_cast<std::size_t>(card)].value.value_or(-1.0);
}

} // namespace

TEST(Overview, VerdictsAndTheirReasons)
{
    struct T_CASE {
        const char *word, *reason;
        void (*make)(T_PUSH_EVALUATION&);
        bool point = false;
        const char* refused = "";
    };
    using E = T_PUSH_EVALUATION;
    const T_CASE cases[] = {
        {"OK", "DL, SD, NC", [](E&) {}},
        // Of a state that is compared with nothing nothing is known.
        {"OK in part", "at NC there is none", [](E& e) { e.limitStates[2].remark.clear(); }},
        {"NG", "at NC", [](E& e) { e.limitStates[2].remark = "N/A"; }},
        {"NG", "at DL, NC",
         [](E& e) {
             e.limitStates[0].remark = "NG";
             e.limitStates[2].remark = "N/A";
         }},
        {"not checked", "at DL", [](E& e) { e.limitStates[0].remark = kNotChecked; }},
        // One that is not met outweighs one that is not known.
        {"NG", "at SD",
         [](E& e) {
             e.limitStates[0].remark = kNotChecked;
             e.limitStates[1].remark = "NG";
         }},
        {"not checked", "no limit state",
         [](E& e) {
             for (T_LIMIT_ROW& row : e.limitStates)
                 row.remark.clear();
         }},
        {"beyond push", "push further",
         [](E& e) {
             for (T_LIMIT_ROW& row : e.limitStates)
                 row.demand = 0.26; // the control node ends at 0.25
         }},
        {"no point", "Push the structure further",
         [](E& e) {
             e.result = 0;
             e.outcome.code = PUSH_OUTCOME::CurveTooShort;
         }},
        // Nothing is said about a structure that was pushed as another one.
        {"not checked", "older",
         [](E& e) {
             e.messages = {{kResultsAreOld, "old"}};
         }},
        {"not checked", "no verdict", [](E&) {}, true},
        {"refused", "no such spectrum", [](E&) {}, true, "no such spectrum"}};
    for (const T_CASE& c : cases) {
        T_EVALUATION_ENTRY entry;
        entry.result = c.point ? Point() : Target();
        entry.refused = c.refused;
        c.make(entry.result);
        EXPECT_EQ(c.word, VerdictText(VerdictOf(entry))) << c.reason;
        EXPECT_NE(std::string::npos, VerdictReason(entry).find(c.reason)) << VerdictReason(entry);
    }
}

TEST(Overview, TheAnswerOfATargetIsThatOfItsLimitState)
{
    T_PUSH_EVALUATION e = Target();
    // SD: Sd = 0.125 / 1.25 = 0.1, where the curve is at 0.5 g; V = 0.8 x 0.5 x 100 x 10.
    auto answer = AnswerOf(e);
    ASSERT_TRUE(answer);
    EXPECT_EQ("SD", answer->state);
    EXPECT_DOUBLE_EQ(0.1, answer->Sd);
    EXPECT_DOUBLE_EQ(0.5, *answer->Sa);
    EXPECT_DOUBLE_EQ(400.0, *answer->V);
    EXPECT_EQ("SD: D = 0.125 m, V = 400 kN", ResultText({e.eval, e, {}, {}}));
    EXPECT_DOUBLE_EQ(2.5, Value(e, CARD::Ductility)); // 0.1 / 0.04
    EXPECT_DOUBLE_EQ(0.56, Value(e, CARD::Teff));
    EXPECT_EQ(-1.0, Value(e, CARD::Damping));
    e.limitStates[1].demand = 0.4; // beyond the end of the curve: no force belongs to it
    answer = AnswerOf(e);
    ASSERT_TRUE(answer);
    EXPECT_FALSE(answer->Sa || answer->V);
    EXPECT_DOUBLE_EQ(3.0, Value(Point(), CARD::Ductility)); // 0.15 / 0.05
}

TEST(Overview, TheRegionHoldsDemandPointsAndTargets)
{
    const T_PUSH_EVALUATION point = Point();
    T_PUSH_EVALUATION target = Target(), none = Target();
    target.guideLines = {{T_GUIDE_LINE::KIND::Demand, 0.152, "NC"},
                         {T_GUIDE_LINE::KIND::Capacity, 5.0, "NC"}}; // not what is looked at
    none.limitStates.clear();
    const T_PUSH_EVALUATION* both[] = {&point, &target};
    const auto region = RegionOf(both);
    ASSERT_TRUE(region);
    EXPECT_GT(region->Sd, 0.152);
    EXPECT_LT(region->Sd, 0.3); // the demand goes on to 0.3, of no interest there
    EXPECT_GT(region->Sa, 1.0); // its plateau
    const T_PUSH_EVALUATION* nothing[] = {&none};
    EXPECT_FALSE(RegionOf(nothing)); // the whole curve is shown
}

// The same structure in other units: 1 in = 0.0254 m, 1 kip = 4448.2216152605 N.
TEST(Overview, OtherUnitsChangeLengthsAndForcesAlone)
{
    const T_PUSH_EVALUATION metric = Target();
    const T_PUSH_EVALUATION e = InUnits(metric, {FORCE_UNIT::kips, LENGTH_UNIT::in});
    const double inch = 1.0 / 0.0254, kip = 1000.0 / 4448.2216152605;
    EXPECT_NEAR(0.125 * inch, AnswerOf(e)->D, 1e-12);
    EXPECT_NEAR(400.0 * kip, *AnswerOf(e)->V, 1e-9); // by the formula, from mass and gravity
    EXPECT_NEAR(100.0 * kip / inch, e.factors.mass, 1e-12);
    EXPECT_EQ(metric.capacity.Sa, e.capacity.Sa);
    EXPECT_DOUBLE_EQ(2.5, Value(e, CARD::Ductility));
    EXPECT_EQ(metric.factors.gamma, e.factors.gamma);
}

// Procedure B of ATC-40 goes on to the end of its family: the ductility at 0.15 m is that of the
// trial at 0.14 m, 0.15 / 0.05, not 0.15 / 0.1 of the one at 0.5 m.
TEST(Overview, AFamilyOfTrialsIsReadAtThePointNotAtItsEnd)
{
    T_PUSH_EVALUATION e = Point();
    T_PERFPT_TRIAL end = e.trace.back();
    e.trace.back().dpi = 0.14;
    end.dpi = 0.5;
    end.dy = 0.1;
    e.trace.push_back(end);
    EXPECT_DOUBLE_EQ(1.5, Value(e, CARD::Ductility));
    e.eval.procedure = 'B';
    e.procedure = 'B';
    EXPECT_DOUBLE_EQ(3.0, Value(e, CARD::Ductility));
}

TEST(Overview, FactsStandWithDefinitionClauseAndNumbers)
{
    T_PUSH_EVALUATION e = Point();
    const T_TEXT_TABLE table = FactCells(e, nullptr);
    const auto D = std::ranges::find_if(table.rows, [](const auto& row) { return row[0] == "D"; });
    ASSERT_NE(table.rows.end(), D);
    EXPECT_EQ("0.1875 m", (*D)[1]);
    EXPECT_EQ("Gamma Sd", (*D)[4]);
    EXPECT_EQ("1.25 x 0.15", (*D)[5]);
}
