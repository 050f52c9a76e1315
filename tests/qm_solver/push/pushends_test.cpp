// How pushes end and what they refuse; numbers of the column are worked out by hand: by P at its
// top it moves P 8 / 300 and twice the rotation of its base, whose moment is 2 P.
#include "pushframes.h"

#include <gtest/gtest.h>

#include <cmath>

namespace {

using namespace sample;

T_PUSH_MODEL YieldingColumn(std::vector<T_BACKBONE_POINT> points = {{0, 100}})
{
    T_PUSH_MODEL model = Column();
    AddHinge(model, Side(std::move(points)));
    return model;
}

struct T_END_CASE {
    const char* name;
    T_PUSH_MODEL model;
    T_PUSH_STAGE stage;
    PUSH_OUTCOME outcome;
    double load, displacement;
};

std::vector<T_END_CASE> EndCases()
{
    const T_PUSH_MODEL ideal = YieldingColumn();
    // from 100 down to 50 over a rotation of 0.5
    const T_PUSH_MODEL soft = YieldingColumn({{0, 100}, {0.5, 50}});
    std::vector<T_END_CASE> cases;
    const auto add = [&](const char* name, const T_PUSH_MODEL& model, PUSH_OUTCOME outcome,
                         double load, double displacement) -> T_END_CASE& {
        return cases.emplace_back(
            T_END_CASE{name, model, PushTo(3.0), outcome, load, displacement});
    };
    add("target", ideal, PUSH_OUTCOME::Reached, 50.0, 3.0);
    add("back", ideal, PUSH_OUTCOME::Reached, -50.0, -3.0).stage.target = -3.0;
    T_END_CASE& load = add("load control", ideal, PUSH_OUTCOME::NoEquilibrium, 50.0, 4.0 / 3.0);
    load.stage.control = PUSH_CONTROL::LoadFactor;
    load.stage.target = 80.0;
    load.stage.steps = {0.25, 0.5, 0.75, 1.0};
    add("largest translation", ideal, PUSH_OUTCOME::Reached, 50.0, 3.0).stage.control =
        PUSH_CONTROL::LargestTranslation;
    const auto against = [](T_END_CASE& c, PUSH_CONTROL control, double target) {
        c.stage.loads.nodal[0].load[0] = -1.0;
        c.stage.control = control;
        c.stage.target = target;
    };
    against(add("largest translation the other way", ideal, PUSH_OUTCOME::Reached, 50.0, -3.0),
            PUSH_CONTROL::LargestTranslation, 3.0);
    T_END_CASE& other =
        add("stiffness the other way, by load", YieldingColumn({{0, 100}, {1, 200}}),
            PUSH_OUTCOME::StiffnessStop, 50.0, -4.0 / 3.0);
    against(other, PUSH_CONTROL::LoadFactor, 80.0);
    other.stage.stops.stiffnessRatio = 0.7;
    // A mast of length 2 on top moves 4 / 3 + 2 (slope of the tip) + 4 (rotation of the base) = 5
    // by the rotation 5 / 12; the control node below it by 4 / 3 + 2 of it.
    T_END_CASE& mast = add("largest translation of another node", ideal, PUSH_OUTCOME::Reached,
                           50.0, 4.0 / 3.0 + 10.0 / 12.0);
    AddNode(mast.model.frame, {0, 0, 4});
    Join(mast.model.frame, ELEMENT_KIND::Beam, 1, 2);
    mast.stage.control = PUSH_CONTROL::LargestTranslation;
    mast.stage.target = 5.0;
    // 10 on the tip, whose upper 0.4 is rigid: about the base 2 P + 10 u = 100.
    T_END_CASE& arm = add("rigid end with P-Delta", ideal, PUSH_OUTCOME::Reached, 35.0, 3.0);
    arm.model.frame.elements[0].offsetJ = {0, 0, -0.4};
    arm.model.pDelta = P_DELTA::Initial;
    arm.model.initial = PushTo(1.0).loads;
    arm.model.initial.nodal[0].load = {0, 0, -10, 0, 0, 0};
    // A strut between two pins, pressed by 10, its hinge at half its length: P 2 / 4 + 10 p 2 / 4 =
    // 100 where the hinge has turned by p, and its foot by P 4 / 1600 + p / 2.
    T_END_CASE& strut = add("hinge inside a strut", ideal, PUSH_OUTCOME::Reached, 190.0, 0.975);
    strut.model.frame.nodes[0].fixed[4] = false;
    Fix(strut.model.frame, 1, {0, 1});
    strut.model.hinges[0].at = 0.5;
    strut.model.pDelta = P_DELTA::Initial;
    strut.model.initial = PushTo(1.0).loads;
    strut.model.initial.nodal[0].load = {0, 0, -10, 0, 0, 0};
    T_BEAM_LOAD across;
    across.type = BEAM_LOAD::Point;
    across.w = {1.0, 0.0};
    across.at = {0.5, 0.0};
    strut.stage.loads.nodal.clear();
    strut.stage.loads.beam.push_back(across);
    strut.stage.node = 0;
    strut.stage.direction = 4;
    strut.stage.target = 0.975;
    T_END_CASE& elastic = add("no hinges, back", Column(), PUSH_OUTCOME::Reached, -3.75, -0.1);
    elastic.stage.target = -0.1;
    elastic.stage.steps = {0.5, 1.0};
    for (const PUSH_CONTROL control :
         {PUSH_CONTROL::Displacement, PUSH_CONTROL::LargestTranslation}) {
        T_END_CASE& slanted = add("across the axes", Column(), PUSH_OUTCOME::Reached, 30.0, 0.8);
        slanted.stage.control = control;
        slanted.stage.along = {0.6, 0.8, 0.0};
        slanted.stage.loads.nodal[0].load = {0.6, 0.8, 0.0, 0.0, 0.0, 0.0};
        slanted.stage.target = 0.8;
    }
    add("drift", ideal, PUSH_OUTCOME::DriftStop, 37.5, 1.0).stage.stops.drift = 0.5;
    cases.back().model.drifts.push_back({1, T_PUSH_DRIFT::kGround, 2.0});
    add("mark", ideal, PUSH_OUTCOME::MarkStop, 50.0, 4.0 / 3.0 + 0.04).stage.stops.mark = 1;
    cases.back().model.hinges[0].laws[0].negative.marks = {0.01, 0.02};
    cases.back().model.hinges[0].laws[0].positive.marks = {0.01, 0.02};
    add("part of the peak", soft, PUSH_OUTCOME::PeakFractionStop, 40.0, 40.0 * 8.0 / 300.0 + 0.4)
        .stage.stops.fractionOfPeak = 0.8;
    add("stiffness", ideal, PUSH_OUTCOME::StiffnessStop, 50.0, 4.0 / 3.0)
        .stage.stops.stiffnessRatio = 0.1;
    add("strength loss", soft, PUSH_OUTCOME::StrengthLossStop, 50.0, 4.0 / 3.0)
        .stage.stops.strengthLoss = true;
    add("last point", soft, PUSH_OUTCOME::LastPointStop, 25.0, 25.0 * 8.0 / 300.0 + 1.0)
        .stage.stops.lastPoint = true;
    // A column that snaps beside a spring of 100: 50 and 133.3 before, 133.3 after. The path goes
    // back to the origin in between, which is no fall of the reaction.
    T_PUSH_MODEL beside = YieldingColumn({{0, 100}, {0, 0}});
    Join(beside.frame, ELEMENT_KIND::Spring, 1, 0, {100, 0, 0, 0, 0, 0});
    add("half of the peak is left", beside, PUSH_OUTCOME::Reached, 300.0, 3.0)
        .stage.stops.fractionOfPeak = 0.5;
    add("drop below the part", beside, PUSH_OUTCOME::PeakFractionStop, 400.0 / 3.0, 4.0 / 3.0)
        .stage.stops.fractionOfPeak = 0.8;
    // Two columns apart, both loaded by 1; the second is stronger and controls: at 50 the first one
    // turns without end.
    T_END_CASE& apart = add("mechanism elsewhere", ideal, PUSH_OUTCOME::Mechanism, 50.0, 4.0 / 3.0);
    AddNode(apart.model.frame, {3, 0, 0});
    AddNode(apart.model.frame, {3, 0, 2});
    Fix(apart.model.frame, 2, {0, 1, 2, 3, 4, 5});
    Join(apart.model.frame, ELEMENT_KIND::Beam, 2, 3);
    apart.stage.node = 3;
    apart.stage.loads.nodal.push_back(apart.stage.loads.nodal[0]);
    apart.stage.loads.nodal[1].node = 3;
    T_END_CASE& initial = add("initial loads", ideal, PUSH_OUTCOME::InitialLoads, 0.625, 4.0 / 3.0);
    initial.model.initial = PushTo(1.0).loads;
    initial.model.initial.nodal[0].load[0] = 80.0;
    // 100 at no axial force, 0 at a tension of 60; drawn by 10 for each 1 across: 2 P stays below
    // the line until the tension of 60 comes
    T_END_CASE& axial = add("axial strength", Column(), PUSH_OUTCOME::AxialStrength, 0.0, 0.0);
    axial.model.hinges.clear();
    T_PUSH_HINGE hinge;
    hinge.laws.push_back({4,
                          Side({{0, 100}}),
                          Side({{0, 100}}),
                          0.0,
                          {{-200, 100, 100}, {0, 100, 100}, {60, 60, 60}}});
    axial.model.hinges.push_back(hinge);
    axial.stage.loads.nodal[0].load[2] = 10.0;
    axial.load = 6.0;
    axial.displacement = 6.0 * 8.0 / 300.0;
    return cases;
}

TEST(PushEnds, EveryOutcomeComesWhereItIsDue)
{
    for (const T_END_CASE& c : EndCases()) {
        SCOPED_TRACE(c.name);
        const T_PUSHED run = Pushed(c.model, {c.stage});
        ASSERT_TRUE(run.done) << run.error.reason.key;
        EXPECT_EQ(run.end.outcome, c.outcome);
        EXPECT_NEAR(run.end.loadFactor, c.load, 1e-9);
        EXPECT_NEAR(run.end.displacement, c.displacement, 1e-9);
        for (const T_PUSH_STEP& step : run.steps)
            EXPECT_LE(step.residual, 1e-10);
    }
}

TEST(PushEnds, CancellingKeepsTheStepsDone)
{
    T_PUSH_STAGE stage = PushTo(3.0);
    for (int k = 1; k <= 40; ++k)
        stage.steps.push_back(k / 40.0);
    const T_PUSHED run = Pushed(YieldingColumn(), {stage}, 7);
    ASSERT_TRUE(run.done);
    EXPECT_EQ(run.end.outcome, PUSH_OUTCOME::Cancelled);
    ASSERT_EQ(run.steps.size(), 7u);
    EXPECT_NEAR(run.steps[6].displacement, 3.0 * 7.0 / 40.0, 1e-12);
}

TEST(PushEnds, AdditionalStepsAreExactAndMarked)
{
    T_PUSH_STAGE stage = PushTo(3.0);
    stage.additional = {4.0 / 3.0, -1.0, 9.0}; // at yield; behind and beyond the push
    const T_PUSHED run = Pushed(YieldingColumn(), {stage});
    ASSERT_EQ(run.steps.size(), 2u);
    EXPECT_TRUE(run.steps[0].additional);
    EXPECT_FALSE(run.steps[1].additional);
    EXPECT_NEAR(run.steps[0].loadFactor, 50.0, 1e-9);
}

TEST(PushEnds, AStopOnAStepIsThatStep)
{
    const struct {
        PUSH_OUTCOME outcome;
        double step; // where the stop is due, by hand as above
    } kRows[] = {{PUSH_OUTCOME::DriftStop, 1.0},
                 {PUSH_OUTCOME::MarkStop, 4.0 / 3.0 + 0.04},
                 {PUSH_OUTCOME::StiffnessStop, 4.0 / 3.0}};
    for (const auto& row : kRows) {
        T_PUSH_MODEL model = YieldingColumn();
        model.drifts.push_back({1, T_PUSH_DRIFT::kGround, 2.0});
        model.hinges[0].laws[0].negative.marks = model.hinges[0].laws[0].positive.marks = {0.02};
        T_PUSH_STAGE stage = PushTo(3.0);
        stage.steps = {0.1, row.step / 3.0, 1.0};
        if (row.outcome == PUSH_OUTCOME::DriftStop) stage.stops.drift = 0.5;
        if (row.outcome == PUSH_OUTCOME::MarkStop) stage.stops.mark = 0;
        if (row.outcome == PUSH_OUTCOME::StiffnessStop) stage.stops.stiffnessRatio = 0.1;
        const T_PUSHED run = Pushed(model, {stage});
        EXPECT_EQ(row.outcome, run.end.outcome);
        ASSERT_EQ(2u, run.steps.size()) << row.step;
        EXPECT_NEAR(row.step, run.steps[1].displacement, 1e-12);
    }
}

/// Work of the loads from step to step, energy in the members, and what the hinges have taken.
TEST(PushEnds, WorkIsElasticEnergyAndDissipation)
{
    T_PUSH_MODEL model = Column(); // a portal: two columns and a beam
    AddNode(model.frame, {3, 0, 2});
    AddNode(model.frame, {3, 0, 0});
    Fix(model.frame, 3, {0, 1, 2, 3, 4, 5});
    Join(model.frame, ELEMENT_KIND::Beam, 1, 2);
    Join(model.frame, ELEMENT_KIND::Beam, 3, 2);
    double strength = 80.0;
    for (const std::size_t e : {0u, 1u, 2u})
        for (const double at : {0.0, 1.0})
            AddHinge(model, Side({{0, strength += 7.0}, {0.2, strength + 10.0}, {0.3, 30.0}}), e,
                     at);
    T_PUSH_STAGE stage = PushTo(4.0);
    for (const T_PUSH_EVENT& event : Pushed(model, {stage}).events)
        stage.additional.push_back(event.displacement);
    T_PUSHED run = Pushed(model, {stage});
    ASSERT_TRUE(run.done);
    ASSERT_GT(run.events.size(), 6u);
    double work = 0.0, taken = 0.0;
    T_PUSH_STEP before;
    before.hinges.resize(6);
    for (const T_PUSH_STEP& step : run.steps) {
        work +=
            0.5 * (step.loadFactor + before.loadFactor) * (step.displacement - before.displacement);
        for (std::size_t h = 0; h < 6; ++h)
            taken += 0.5 * (step.hinges[h].force + before.hinges[h].force) *
                     (step.hinges[h].deformation - before.hinges[h].deformation);
        before = step;
    }
    T_RESULT forces;
    ASSERT_TRUE(run.solver.Forces(run.steps.back(), forces, run.error));
    double stored = 0.0;
    const double lengths[] = {2.0, 3.0, 2.0};
    for (std::size_t e = 0; e < 3; ++e) {
        const double i = forces.force[e][0][4], j = forces.force[e][4][4],
                     n = forces.force[e][0][0];
        stored += lengths[e] * ((i * i + i * j + j * j) / 600.0 + n * n / 2e6);
    }
    EXPECT_NEAR(work, stored + taken, 1e-9 * work);
}

TEST(PushEnds, RefusesWhatCanNotBePushed)
{
    struct T_CASE {
        const char* key;
        std::function<void(T_PUSH_MODEL&, T_PUSH_STAGE&)> spoil;
    };
    const auto law = [](T_PUSH_MODEL& m) -> T_HINGE_LAW& { return m.hinges[0].laws[0]; };
    const T_CASE cases[] = {
        {"IDS_QM_ENGINE_HINGE_NO_STRENGTH", [&](auto& m, auto&) { law(m).negative.points = {}; }},
        {"IDS_QM_ENGINE_HINGE_NO_STRENGTH",
         [&](auto& m, auto&) { law(m).positive.points[0].force = 0.0; }},
        {"IDS_QM_ENGINE_HINGE_FALLS",
         [&](auto& m, auto&) {
             law(m).positive.points = {{0.2, 100}, {0.1, 110}};
         }},
        {"IDS_QM_ENGINE_HINGE_FALLS", // the spring alone deforms more than the law
         [&](auto& m, auto&) {
             law(m).stiffness = 10.0;
             law(m).positive.points[0].deformation = 1;
         }},
        {"IDS_QM_ENGINE_HINGE_RELEASED",
         [](auto& m, auto&) {
             m.frame.elements[0].releaseJ[4] = true;
             m.hinges[0].at = 1.0;
         }},
        {"IDS_QM_ENGINE_HINGE_TWICE", [](auto& m, auto&) { m.hinges.push_back(m.hinges[0]); }},
        {"IDS_QM_ENGINE_HINGE_PLACE", [](auto& m, auto&) { m.hinges[0].at = 1.5; }},
        {"IDS_QM_ENGINE_PUSH_CONTROL_FIXED", [](auto&, auto& s) { s.node = 0; }},
        {"IDS_QM_ENGINE_PUSH_NO_TARGET", [](auto&, auto& s) { s.target = 0.0; }},
        {"IDS_QM_ENGINE_PUSH_STEPS",
         [](auto&, auto& s) {
             s.steps = {0.5, 0.4, 1.0};
         }},
        {"IDS_QM_ENGINE_PUSH_BUCKLES", // pi^2 E I / (4 L^2) is 61.7, of the chord 3 E I / L^2 75
         [](auto& m, auto&) {
             m.pDelta = P_DELTA::Initial;
             m.initial.nodal.push_back({1, {0, 0, -80.0, 0, 0, 0}});
         }},
    };
    for (const T_CASE& c : cases) {
        T_PUSH_MODEL model = YieldingColumn();
        T_PUSH_STAGE stage = PushTo(3.0);
        c.spoil(model, stage);
        const T_PUSHED run = Pushed(model, {stage});
        EXPECT_FALSE(run.done);
        EXPECT_EQ(run.error.reason.key, c.key);
    }
}

} // namespace
