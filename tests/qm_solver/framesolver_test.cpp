// Small structures with known answers.
#include "solved.h"

#include <cmath>

namespace {

using namespace sample;

constexpr double kE = 2.1e8, kA = 5.4e-3, kEA = kE * kA;

/// Trusses from pins at (-3, 0, 4), (0, 0, 4), (3, 0, 4) to a node at the origin, plane X-Z.
T_FRAME ThreeBars()
{
    T_FRAME frame = Empty();
    AddNode(frame, {0, 0, 0});
    Fix(frame, 0, {1});
    for (double x : {-3.0, 0.0, 3.0}) {
        const std::size_t pin = AddNode(frame, {x, 0, 4});
        Fix(frame, pin, {0, 1, 2});
        Join(frame, ELEMENT_KIND::Truss, pin, 0);
    }
    return frame;
}

TEST(FrameSolver, LackOfFitIsWhatEquilibriumLeaves)
{
    // Initial tension T in the middle bar: stiffness of the others against its own.
    const double T = 50.0, own = 0.25, others = 2 * 0.64 / 5;
    T_LOAD_CASE tension, cold, settled;
    tension.pretension.push_back({1, T});
    T_FRAME frame = ThreeBars();
    frame.materials[0].alpha = 1.2e-5;
    cold.temperature.push_back({1, -T / (kEA * 1.2e-5)});
    T_SETTLEMENT up{2, {}};
    up.displacement[2] = T * 4 / kEA; // the pin pulls the bar by as much
    settled.settlement.push_back(up);
    for (const T_LOAD_CASE& load : {tension, cold, settled}) {
        const T_RESULT r = Solved(frame, load);
        EXPECT_NEAR(T * others / (own + others), r.force[1][2][0], 1e-10);
        EXPECT_NEAR(T / (own + others) / kEA, r.displacement[0][2], 1e-15);
    }
}

TEST(FrameSolver, LoadsOnATrussGoToItsNodesByTheLeverRule)
{
    T_FRAME frame = ThreeBars();
    frame.materials[0].density = 8.0;
    FixAll(frame, 0);
    T_LOAD_CASE load;
    load.selfWeight = {0, 0, -2};
    load.beam.push_back({0, BEAM_LOAD::Point, false, 0, {10, 0}, {0.3, 1}});
    load.beam.push_back({0, BEAM_LOAD::Distributed, false, 0, {2, 6}, {0.5, 1}});
    const T_RESULT r = Solved(frame, load);
    const double half = 8.0 * kA * 9.80665; // of the pin's bar of 4 m: factor 2, half of the bar
    EXPECT_NEAR(4 * half, r.reaction[2][2], 1e-12);
    EXPECT_NEAR((4 + 5 + 5) * half, r.reaction[0][2], 1e-12);
    // Over 2.5 m: 5 with its centre at 3/4 of the bar, a triangle of 5 with its own at 5/6.
    EXPECT_NEAR(-7.0 - 5.0 / 4 - 5.0 / 6, r.reaction[1][0], 1e-12);
    EXPECT_NEAR(-3.0 - 5.0 * 3 / 4 - 5.0 * 5 / 6, r.reaction[0][0], 1e-12);
}

TEST(FrameSolver, ManyCasesAreWhatEachGivesAlone)
{
    // More than one block of right-hand sides, each a multiple of the first.
    std::vector<T_LOAD_CASE> cases(130);
    for (std::size_t c = 0; c < cases.size(); ++c) {
        cases[c].nodal.push_back({0, {double(c), 0, -100, 0, 0, 0}});
        cases[c].pretension.push_back({c % 3, double(c % 7)});
    }
    const T_FRAME frame = ThreeBars();
    const std::vector<T_RESULT> all = Solved(frame, cases);
    ASSERT_EQ(cases.size(), all.size());
    for (std::size_t c = 0; c < cases.size(); ++c) {
        const T_RESULT one = Solved(frame, cases[c]);
        for (std::size_t e = 0; e < 3; ++e)
            EXPECT_NEAR(one.force[e][0][0], all[c].force[e][0][0], 1e-11);
    }
}

TEST(FrameSolver, NodesThatNothingHoldsStayAtRest)
{
    T_FRAME frame = ThreeBars();
    const std::size_t lone = AddNode(frame, {9, 9, 9});
    T_LOAD_CASE load;
    load.nodal.push_back({0, {1, 0, 0, 0, 0, 0}});
    const T_RESULT r = Solved(frame, load);
    for (std::size_t d = 0; d < 6; ++d)
        EXPECT_EQ(0.0, r.displacement[lone][d]);
    for (std::size_t d = 3; d < 6; ++d)
        EXPECT_EQ(0.0, r.displacement[0][d]); // trusses do not turn their nodes
}

TEST(FrameSolver, CancelsBetweenBlocksAndGivesNothing)
{
    CFrameSolver frameSolver;
    T_SOLVER_ERROR error;
    ASSERT_TRUE(frameSolver.Prepare(ThreeBars(), error));
    std::vector<T_RESULT> out(3);
    std::size_t calls = 0;
    EXPECT_FALSE(frameSolver.Solve(std::vector<T_LOAD_CASE>(100), out, error,
                                   [&](std::size_t done, std::size_t total) {
                                       ++calls;
                                       EXPECT_EQ(64u, done);
                                       EXPECT_EQ(100u, total);
                                       return false;
                                   }));
    EXPECT_EQ(SOLVER_FAULT::Cancelled, error.fault);
    EXPECT_EQ(1u, calls);
    EXPECT_TRUE(out.empty());
}

} // namespace
