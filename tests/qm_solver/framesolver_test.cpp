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

TEST(FrameSolver, ThreeBarsShareALoadByTheirStiffness)
{
    // delta = P / (EA / 4 + 2 EA / 5 (4/5)^2); N middle = EA delta / 4, side = EA delta (4/5) / 5.
    T_LOAD_CASE load;
    load.nodal.push_back({0, {0, 0, -100, 0, 0, 0}});
    const T_RESULT r = Solved(ThreeBars(), load);
    const double share = 100.0 / (0.25 + 2 * 0.64 / 5);
    EXPECT_NEAR(-share / kEA, r.displacement[0][2], 1e-15);
    EXPECT_NEAR(share / 4, r.force[1][0][0], 1e-10);
    for (const std::size_t side : {0, 2})
        for (const T_VEC6& position : r.force[side])
            EXPECT_NEAR(share * 0.16, position[0], 1e-10);
    EXPECT_NEAR(share / 4, r.reaction[2][2], 1e-10);
    EXPECT_NEAR(-share * 0.16 * 0.6, r.reaction[1][0], 1e-10);
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
    load.beam.push_back({0, BEAM_LOAD::Distributed, false, 0, {0, 6}, {0.5, 1}});
    const T_RESULT r = Solved(frame, load);
    const double half = 8.0 * kA * 9.80665; // of the pin's bar of 4 m: factor 2, half of the bar
    EXPECT_NEAR(4 * half, r.reaction[2][2], 1e-12);
    EXPECT_NEAR((4 + 5 + 5) * half, r.reaction[0][2], 1e-12);
    // Triangle over 2.5 m: 7.5, its centre at 5/6 of the bar.
    EXPECT_NEAR(-7.0 - 7.5 / 6, r.reaction[1][0], 1e-12);
    EXPECT_NEAR(-3.0 - 7.5 * 5 / 6, r.reaction[0][0], 1e-12);
}

TEST(FrameSolver, SettlementOfAClampedBeamGivesTheTabledMoments)
{
    // 6 EI d / L^2 at both ends; rotation: 4 EI / L and 2 EI / L.
    T_FRAME frame = Empty();
    AddNode(frame, {0, 0, 0});
    AddNode(frame, {4, 0, 0});
    FixAll(frame, 0);
    FixAll(frame, 1);
    Join(frame, ELEMENT_KIND::Beam, 0, 1);
    const double EI = kE * 3.7e-5;
    T_LOAD_CASE sinks, turns;
    sinks.settlement.push_back({1, {0, 0, -0.01, 0, 0, 0}});
    turns.settlement.push_back({1, {0, 0, 0, 0, 0.002, 0}});
    const std::vector<T_RESULT> r = Solved(frame, std::vector<T_LOAD_CASE>{sinks, turns});
    EXPECT_DOUBLE_EQ(-0.01, r[0].displacement[1][2]);
    EXPECT_NEAR(6 * EI * 0.01 / 16, r[0].force[0][0][4], 1e-9); // tension above I
    EXPECT_NEAR(-6 * EI * 0.01 / 16, r[0].force[0][4][4], 1e-9);
    EXPECT_NEAR(-12 * EI * 0.01 / 64, r[0].reaction[1][2], 1e-9);
    EXPECT_NEAR(4 * EI * 0.002 / 4, r[1].reaction[1][4], 1e-9);
    EXPECT_NEAR(2 * EI * 0.002 / 4, r[1].reaction[0][4], 1e-9);
}

TEST(FrameSolver, SpringsAndLinksInSeriesAndTheirReactions)
{
    // Ground - spring 300 - link 600 - load: 1/300 + 1/600 = 1/200. One direction turns.
    T_FRAME frame = Empty();
    AddNode(frame, {0, 0, 0});
    AddNode(frame, {0, 0, 0});
    Join(frame, ELEMENT_KIND::Spring, 0, 0, {300, 0, 0, 0, 70, 0});
    Join(frame, ELEMENT_KIND::Link, 0, 1, {600, 0, 0, 0, 30, 0});
    T_LOAD_CASE load;
    load.nodal.push_back({1, {20, 0, 0, 0, 42, 0}});
    const T_RESULT r = Solved(frame, load);
    EXPECT_NEAR(20.0 / 200, r.displacement[1][0], 1e-15);
    EXPECT_NEAR(20.0 / 300, r.displacement[0][0], 1e-15);
    EXPECT_NEAR(42.0 / 21, r.displacement[1][4], 1e-13);
    EXPECT_NEAR(-20.0, r.reaction[0][0], 1e-12);
    EXPECT_NEAR(-42.0, r.reaction[0][4], 1e-12);
    for (const T_VEC6& position : r.force[1]) {
        EXPECT_NEAR(20.0, position[0], 1e-12);
        EXPECT_NEAR(42.0, position[4], 1e-12);
    }
    EXPECT_EQ(0.0, r.force[0][0][0]);
}

/// Four cantilever columns of 3 m at the corners of 6 m x 4 m, tops tied by a diaphragm to a free
/// node at (cx, cy), which is first in the diaphragm. Section with Iy = Iz.
T_FRAME Floor(double cx, double cy)
{
    T_FRAME frame = Empty();
    frame.sections[0].Iy = frame.sections[0].Iz = 2e-5;
    T_DIAPHRAGM floor;
    floor.nodes.push_back(AddNode(frame, {cx, cy, 3}));
    for (auto [x, y] : {std::pair{0.0, 0.0}, {6.0, 0.0}, {6.0, 4.0}, {0.0, 4.0}}) {
        const std::size_t foot = AddNode(frame, {x, y, 0}), top = AddNode(frame, {x, y, 3});
        FixAll(frame, foot);
        Join(frame, ELEMENT_KIND::Beam, foot, top);
        floor.nodes.push_back(top);
    }
    frame.diaphragms.push_back(floor);
    return frame;
}

TEST(FrameSolver, ADiaphragmTurnsAsOneBody)
{
    // Tops are free to turn about X and Y: 3 EI / L^3 per column. Centre of stiffness (3, 2);
    // a force at (1, 5) along X turns by -(5 - 2) F over sum k r^2 + 4 GJ / L.
    const double k = 3 * kE * 2e-5 / 27, F = 12.0;
    const double turning = 4 * k * 13 + 4 * 8.1e7 * 2.1e-7 / 3, theta = -3 * F / turning;
    T_LOAD_CASE load;
    load.nodal.push_back({0, {F, 0, 0, 0, 0, 0}});
    const T_RESULT r = Solved(Floor(1, 5), load);
    for (std::size_t n : {0, 2, 4, 6, 8}) {
        const T_VEC3 at = Floor(1, 5).nodes[n].xyz;
        EXPECT_NEAR(F / (4 * k) - theta * (at[1] - 2), r.displacement[n][0], 1e-14);
        EXPECT_NEAR(theta * (at[0] - 3), r.displacement[n][1], 1e-14);
        EXPECT_NEAR(theta, r.displacement[n][5], 1e-14);
    }
}

TEST(FrameSolver, TheMasterOfADiaphragmDoesNotMatter)
{
    T_FRAME frame = Floor(1, 5), turned = frame;
    std::reverse(turned.diaphragms[0].nodes.begin(), turned.diaphragms[0].nodes.end());
    turned.diaphragms.push_back({{2, 0, 8}, 2}); // overlapping, says nothing new
    turned.equalDisplacements.push_back({{0, 4}, {false, false, false, false, false, true}});
    T_LOAD_CASE load;
    load.nodal.push_back({0, {5, -7, 0, 0, 0, 3}});
    load.nodal.push_back({4, {1, 2, 3, 4, 5, 6}});
    const T_RESULT a = Solved(frame, load), b = Solved(turned, load);
    for (std::size_t n = 0; n < frame.nodes.size(); ++n)
        for (std::size_t d = 0; d < 6; ++d) {
            EXPECT_NEAR(a.displacement[n][d], b.displacement[n][d], 1e-13);
            EXPECT_NEAR(a.reaction[n][d], b.reaction[n][d], 1e-10);
        }
}

TEST(FrameSolver, ASupportedSlaveHandsItsForceToTheSupport)
{
    // Node 1 must move as node 0, which is fixed: the truss can't shorten.
    T_FRAME frame = ThreeBars();
    frame.equalDisplacements.push_back({{0, 1}, {true, false, true, false, false, false}});
    Fix(frame, 0, {0, 2});
    T_LOAD_CASE load, both;
    load.settlement.push_back({0, {0, 0, 0.001, 0, 0, 0}});
    load.settlement.push_back({1, {0, 0, 0.001, 0, 0, 0}});
    load.nodal.push_back({0, {7, 0, 0, 0, 0, 0}});
    const T_RESULT r = Solved(frame, load);
    EXPECT_NEAR(0.0, r.force[0][0][0], 1e-12);
    EXPECT_NEAR(-kEA * 0.001 / 4, r.force[1][0][0], 1e-9);
    EXPECT_NEAR(-7.0, r.reaction[0][0] + r.reaction[1][0] + r.reaction[2][0] + r.reaction[3][0],
                1e-10);
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

TEST(FrameSolver, ATemperatureThatNothingResistsLeavesNoForce)
{
    T_FRAME frame = Empty();
    frame.materials[0].alpha = 1e-5;
    AddNode(frame, {0, 0, 0});
    AddNode(frame, {3, 0, 4});
    FixAll(frame, 0);
    Join(frame, ELEMENT_KIND::Beam, 0, 1);
    T_LOAD_CASE load;
    load.temperature.push_back({0, 30});
    const T_RESULT r = Solved(frame, load);
    EXPECT_NEAR(3e-4 * 3, r.displacement[1][0], 1e-15);
    EXPECT_NEAR(3e-4 * 4, r.displacement[1][2], 1e-15);
    EXPECT_NEAR(0.0, r.force[0][2][0], 1e-9);
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
