// Structures built in stages, by hand and by superposition.
#include "staged.h"

#include <cmath>

namespace {

using namespace sample;

constexpr auto kBeam = ELEMENT_KIND::Beam;
constexpr auto kTruss = ELEMENT_KIND::Truss;
constexpr double kE = 2.1e8, kA = 5.4e-3, kIy = 3.7e-5, kEI = kE * kIy;

// ---- balanced cantilever ------------------------------------------------------------------------

constexpr std::size_t kSegments = 5; // on each side of the pier
constexpr double kSegment = 3.0, kDensity = 7.85;
constexpr double kWeight = kDensity * kA * 9.80665;

/// The pier's head is node 0; nodes 2 j - 1 to the right, 2 j to the left; two segments a stage.
T_STAGED_MODEL Balanced()
{
    T_STAGED_MODEL model;
    model.groups = {LOAD_GROUP::Dead};
    model.frame = Empty();
    model.frame.materials[0].density = kDensity;
    AddNode(model.frame, {0, 0, 0});
    FixAll(model.frame, 0);
    for (std::size_t j = 1; j <= kSegments; ++j) {
        const double x = kSegment * static_cast<double>(j);
        AddNode(model.frame, {x, 0, 0});
        AddNode(model.frame, {-x, 0, 0});
        Join(model.frame, kBeam, j == 1 ? 0 : 2 * j - 3, 2 * j - 1);
        Join(model.frame, kBeam, j == 1 ? 0 : 2 * j - 2, 2 * j);
        T_STAGE stage;
        stage.activateElements = {2 * j - 2, 2 * j - 1};
        model.stages.push_back(stage);
    }
    model.stages[0].activateSupports = {{0, {}}};
    model.stages[0].activateLoads = {{0, kFirstStep}};
    return model;
}

/// Deflection at x of a cantilever with a load w from a to b, down; x <= a or x >= b.
double Sag(double w, double a, double b, double x)
{
    if (x <= a) return w * (b - a) * x * x * (1.5 * (a + b) - x) / (6 * kEI);
    const auto part = [x](double s) { return s * s * s * (x - s / 4); };
    return w * (part(b) - part(a)) / (6 * kEI);
}

TEST(StagedSolver, CantileverArmsDeflectByTheSegmentsThatComeAfterThem)
{
    CStagedSolver staged;
    Build(staged, Balanced(), {Weight()});
    for (std::size_t stage = 0; stage < kSegments; ++stage) {
        const T_RESULT r = Case(staged, stage, 0);
        const double length = kSegment * static_cast<double>(stage + 1);
        for (std::size_t i = 1; i <= kSegments; ++i) {
            double sag = 0.0; // each segment at its design position when it comes
            for (std::size_t j = i; j <= stage + 1; ++j)
                sag += Sag(kWeight, kSegment * double(j - 1), kSegment * double(j),
                           kSegment * double(i));
            EXPECT_NEAR(-sag, r.displacement[2 * i - 1][2], 1e-12) << stage << " " << i;
            EXPECT_NEAR(-sag, r.displacement[2 * i][2], 1e-12) << stage << " " << i;
        }
        EXPECT_NEAR(kWeight * length * length / 2, r.force[0][0][4], 1e-9);
        EXPECT_NEAR(2 * kWeight * length, r.reaction[0][2], 1e-9);
        EXPECT_NEAR(0, r.reaction[0][4], 1e-9);
    }
}

TEST(StagedSolver, SegmentsBornToDesignDeflectAsIfBuiltAtOnce)
{
    T_STAGED_MODEL model = Balanced();
    model.options.birth = BIRTH::ToDesign;
    CStagedSolver staged;
    Build(staged, model, {Weight()});
    const T_RESULT r = Case(staged, kSegments - 1, 0);
    const double L = kSegment * kSegments;
    for (std::size_t i = 1; i <= kSegments; ++i) {
        const double x = kSegment * double(i);
        const double sag = kWeight * x * x * (6 * L * L - 4 * L * x + x * x) / (24 * kEI);
        EXPECT_NEAR(-sag, r.displacement[2 * i][2], 1e-12) << i;
    }
}

// ---- supports, elements and loads that come and go ----------------------------------------------

/// Cantilever of two beams of 4, clamped at node 0.
T_FRAME Cantilever()
{
    T_FRAME frame = Empty();
    for (const double x : {0.0, 4.0, 8.0})
        AddNode(frame, {x, 0, 0});
    FixAll(frame, 0);
    Join(frame, kBeam, 0, 1);
    Join(frame, kBeam, 1, 2);
    return frame;
}

constexpr T_DIRS6 kInZ{false, false, true, false, false, false};

TEST(StagedSolver, APropHoldsTheDeflectionThatItFinds)
{
    T_STAGED_MODEL model = OneStage(Cantilever(), 2);
    model.stages[0].activateLoads.pop_back();
    T_STAGE prop;
    prop.activateSupports = {{2, kInZ}};
    prop.activateLoads = {{1, kFirstStep}};
    T_STAGE away;
    away.deactivateSupports = {{2, {}}};
    model.stages.insert(model.stages.end(), {prop, away});
    CStagedSolver staged;
    Build(staged, model, {At(2, {0, 0, -10, 0, 0, 0}), At(1, {0, 0, -32, 0, 0, 0})});
    // PL3 / 3EI of the first load stays; the prop takes 5 / 16 of the second at mid-span.
    EXPECT_NEAR(-10 * 512.0 / (3 * kEI), Case(staged, 1, 0).displacement[2][2], 1e-12);
    EXPECT_NEAR(0, Case(staged, 1, 0).reaction[2][2], 1e-10);
    EXPECT_NEAR(10, Case(staged, 1, 1).reaction[2][2], 1e-10);
    EXPECT_NEAR(0, Case(staged, 1, 1).displacement[2][2], 1e-15);
    // Without it the second load deflects as if it had never been there: P a2 (3 L - a) / 6EI.
    EXPECT_NEAR(-32 * 16 * 20 / (6 * kEI), Case(staged, 2, 1).displacement[2][2], 1e-12);
}

TEST(StagedSolver, ASettlementLeavesWithItsSupportAndIsHeldByTheNext)
{
    T_STAGED_MODEL model = OneStage(Cantilever(), 1);
    model.stages[0].activateSupports.push_back({2, kInZ});
    T_STAGE away, again, lifted;
    away.deactivateSupports = {{2, kInZ}};
    again.activateSupports = {{2, kInZ}};
    lifted.deactivateLoads = {{0, kFirstStep}};
    model.stages.insert(model.stages.end(), {away, again, lifted});
    T_LOAD_CASE sink;
    sink.settlement.push_back({2, {0, 0, -0.01, 0, 0, 0}});
    CStagedSolver staged;
    Build(staged, model, {sink});
    const double tip[] = {-0.01, 0.0, 0.0, 0.01}; // lifting the settlement lifts the new support
    for (std::size_t s = 0; s < 4; ++s)
        EXPECT_NEAR(tip[s], Case(staged, s, 0).displacement[2][2], 1e-14) << s;
    EXPECT_NEAR(0.01 * 3 * kEI / 512, Case(staged, 3, 0).reaction[2][2], 1e-9);
}

TEST(StagedSolver, TakingAnElementAwayReleasesItsForces)
{
    T_FRAME whole = Cantilever();
    const std::size_t top = AddNode(whole, {0, 0, 6});
    FixAll(whole, top);
    Join(whole, kTruss, top, 2);
    T_LOAD_CASE load = At(1, {0, 0, -7, 0, 0, 0});
    load.pretension.push_back({2, 40.0});
    const T_RESULT before = Solved(whole, load);
    T_FRAME alone = Cantilever();
    AddNode(alone, {0, 0, 6});
    FixAll(alone, top);
    const double n = before.force[2][0][0]; // pulls node 2 towards (-0.8, 0, 0.6)
    const T_RESULT released = Solved(alone, At(2, {0.8 * n, 0, -0.6 * n, 0, 0, 0}));

    T_STAGED_MODEL model = OneStage(whole, 1);
    T_STAGE away;
    away.deactivateElements = {2};
    model.stages.push_back(away);
    CStagedSolver staged;
    Build(staged, model, {load});
    const T_RESULT after = Case(staged, 1, 0);
    for (const std::size_t node : {1, 2})
        for (std::size_t d = 0; d < 6; ++d)
            EXPECT_NEAR(before.displacement[node][d] + released.displacement[node][d],
                        after.displacement[node][d], 1e-14);
    for (std::size_t k = 0; k < 6; ++k)
        EXPECT_NEAR(before.force[0][0][k] + released.force[0][0][k], after.force[0][0][k], 1e-10);
    EXPECT_EQ(T_VEC6{}, after.force[2][0]);
}

TEST(StagedSolver, LoadsComeAndGoAtTheirSteps)
{
    T_STAGED_MODEL model = OneStage(Cantilever(), 3);
    T_STAGE& stage = model.stages[0];
    stage.steps = 4;
    stage.activateLoads = {{0, 2}, {1, kLastStep}, {2, kFirstStep}};
    stage.deactivateLoads = {{2, 3}};
    CStagedSolver staged;
    Build(staged, model,
          {At(2, {0, 0, -1, 0, 0, 0}), At(2, {0, 0, -2, 0, 0, 0}), At(2, {0, 0, -4, 0, 0, 0})});
    const double unit = -512.0 / (3 * kEI), sum[] = {4, 5, 1, 3};
    for (int step = 1; step <= 4; ++step) {
        T_RESULT r;
        ASSERT_TRUE(staged.ReadSum(0, step, STAGE_SUM::All, r));
        EXPECT_NEAR(unit * sum[step - 1], r.displacement[2][2], 1e-13) << step;
    }
    EXPECT_EQ(1u, staged.Cost().factorisations); // the stiffness is the same in all steps
    T_RESULT r;
    EXPECT_FALSE(staged.Read(0, 5, std::vector<double>{1, 1, 1}, r));
    EXPECT_FALSE(staged.Read(1, 1, std::vector<double>{1, 1, 1}, r));
    EXPECT_FALSE(staged.Read(0, 1, std::vector<double>{1, 1}, r));
}

TEST(StagedSolver, SumsTakeTheCasesOfTheirGroup)
{
    T_STAGED_MODEL model = OneStage(Cantilever(), 4);
    model.groups = {LOAD_GROUP::Dead, LOAD_GROUP::Erection, LOAD_GROUP::Rest, LOAD_GROUP::Dead};
    std::vector<T_LOAD_CASE> cases;
    for (const double p : {1.0, 10.0, 100.0, 1000.0})
        cases.push_back(At(2, {0, 0, p, 0, 0, 0}));
    CStagedSolver staged;
    Build(staged, model, cases);
    const std::pair<STAGE_SUM, double> sums[] = {{STAGE_SUM::Dead, 1001},
                                                 {STAGE_SUM::Erection, 10},
                                                 {STAGE_SUM::Rest, 100},
                                                 {STAGE_SUM::All, 1111}};
    for (const auto& [sum, force] : sums) {
        T_RESULT r;
        ASSERT_TRUE(staged.ReadSum(0, kLastStep, sum, r));
        EXPECT_NEAR(-force, r.reaction[0][2], 1e-9);
    }
}

TEST(StagedSolver, RunsAgainWithoutAnotherAnalysis)
{
    T_STAGED_MODEL model = Balanced();
    model.stages.push_back({}); // nothing changes in it
    CStagedSolver staged;
    Build(staged, model, {Weight()});
    const T_RESULT once = Case(staged, kSegments, 0);
    EXPECT_EQ(kSegments, staged.Cost().analyses);
    EXPECT_EQ(kSegments, staged.Cost().factorisations);
    T_LOAD_CASE twice = Weight();
    twice.selfWeight[2] *= 2;
    T_SOLVER_ERROR error;
    ASSERT_TRUE(staged.Run(std::vector<T_LOAD_CASE>{twice}, error)) << error.reason.Text();
    EXPECT_EQ(kSegments, staged.Cost().analyses);
    ExpectSame(Sum(once, once), Case(staged, kSegments, 0), 1e-12);

    CStagedSolver other = staged.Again();
    T_RESULT none;
    EXPECT_FALSE(other.ReadCase(kSegments, kLastStep, 0, none));
    ASSERT_TRUE(other.Run(std::vector<T_LOAD_CASE>{Weight()}, error)) << error.reason.Text();
    EXPECT_EQ(0U, other.Cost().analyses);
    ExpectSame(once, Case(other, kSegments, 0), 1e-12);
    ExpectSame(Sum(once, once), Case(staged, kSegments, 0), 1e-12); // stays
}

} // namespace
