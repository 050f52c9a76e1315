#include "qm_solver/checks/stabilitycheck.h"

#include "solved.h"

#include <gtest/gtest.h>

namespace {

using namespace sample;
using Fixed = std::vector<std::pair<std::size_t, std::vector<int>>>;

constexpr int X = 0, Y = 1, Z = 2, RX = 3, RY = 4, RZ = 5;

/// Four columns of 3 m under a floor of beams, plan 4 m x 6 m about (102, 203), unsupported.
/// Nodes 0 to 3 at the foot, (100, 200), (104, 200), (104, 206), (100, 206).
T_FRAME Tower()
{
    T_FRAME frame = Empty();
    for (double z : {10.0, 13.0})
        for (auto [x, y] :
             {std::pair{100.0, 200.0}, {104.0, 200.0}, {104.0, 206.0}, {100.0, 206.0}})
            AddNode(frame, {x, y, z});
    for (std::size_t c = 0; c < 4; ++c) {
        Join(frame, ELEMENT_KIND::Beam, c, c + 4);
        Join(frame, ELEMENT_KIND::Beam, c + 4, 4 + (c + 1) % 4);
    }
    return frame;
}

struct T_TOWER_CASE {
    const char* label;
    Fixed fixed;
    const char* reason; // empty: held
    int direction;
};

TEST(StabilityCheck, NamesWhatTheSupportsLeaveFree)
{
    const T_TOWER_CASE cases[] = {
        {"clamped at one foot", {{0, {X, Y, Z, RX, RY, RZ}}}, "", -1},
        {"six rods", {{0, {X, Y, Z}}, {1, {Y, Z}}, {3, {Z}}}, "", -1},
        {"no X", {{0, {Y, Z, RX, RY, RZ}}}, "the part is free to move along X", X},
        {"no RX",
         {{0, {X, Y, Z, RY, RZ}}},
         "the part is free to turn about X (axis through (102, 200, 10))",
         RX},
        {"no RY",
         {{0, {X, Y, Z, RX, RZ}}},
         "the part is free to turn about Y (axis through (100, 203, 10))",
         RY},
        {"no RZ",
         {{0, {X, Y, Z, RX, RY}}},
         "the part is free to turn about Z (axis through (100, 200, 11.5))",
         RZ},
        {"a diagonal hinge line",
         {{0, {X, Y, Z}}, {2, {Z}}, {1, {Y}}},
         "the part is free to turn about the direction (0.5547, 0.83205, 0) "
         "(axis through (102, 203, 10))",
         -1},
        {"one inclined way out is left",
         {{0, {Z, RX, RY, RZ}}},
         "the part is free to move along X and to move along Y",
         X},
        {"no supports at all",
         {},
         "the part is free to move along X, to move along Y, to move along Z, "
         "to turn about X (axis through its centre), to turn about Y (axis through its centre) "
         "and to turn about Z (axis through its centre)",
         X},
    };
    for (const T_TOWER_CASE& c : cases) {
        SCOPED_TRACE(c.label);
        T_FRAME frame = Tower();
        for (const auto& [node, directions] : c.fixed)
            Fix(frame, node, directions);
        const auto error = CheckRigidBodies(frame);
        ASSERT_EQ(*c.reason != '\0', error.has_value());
        if (!error) continue;
        EXPECT_EQ(SOLVER_FAULT::Mechanism, error->fault);
        EXPECT_EQ(c.reason, error->reason.Text());
        EXPECT_EQ(c.direction, error->direction);
        EXPECT_EQ(8u, error->part.size());
    }
}

TEST(StabilityCheck, IsTheSameInMillimetresAndFarFromTheOrigin)
{
    for (double scale : {1.0e-3, 1.0e3})
        for (double shift : {0.0, 5.0e3}) {
            T_FRAME frame = Tower();
            for (T_NODE& node : frame.nodes)
                for (double& x : node.xyz)
                    x = (x + shift) * scale;
            Fix(frame, 0, {X, Y, Z, RX, RY});
            const auto error = CheckRigidBodies(frame);
            ASSERT_TRUE(error);
            EXPECT_EQ(RZ, error->direction);
            Fix(frame, 1, {Y});
            EXPECT_FALSE(CheckRigidBodies(frame));
        }
}

TEST(StabilityCheck, CountsSpringsAsSupports)
{
    T_FRAME frame = Tower();
    Fix(frame, 0, {X, Y, Z, RX, RY});
    Join(frame, ELEMENT_KIND::Spring, 2, 0, {0.0, 0.0, 5.0, 0.0, 0.0, 0.0});
    EXPECT_TRUE(CheckRigidBodies(frame)); // along Z: no help against turning about Z
    Join(frame, ELEMENT_KIND::Spring, 2, 0, {0.0, 1.0e-3, 0.0, 0.0, 0.0, 0.0});
    EXPECT_FALSE(CheckRigidBodies(frame));
}

TEST(StabilityCheck, FindsThePartThatFloats)
{
    T_FRAME frame = Tower();
    for (std::size_t n = 0; n < 4; ++n)
        Fix(frame, n, {X, Y, Z});
    const std::size_t a = AddNode(frame, {0, 0, 0}), b = AddNode(frame, {5, 0, 0});
    Join(frame, ELEMENT_KIND::Beam, b, a);
    Fix(frame, a, {X, Y, Z, RX, RY});
    const auto error = CheckRigidBodies(frame);
    ASSERT_TRUE(error);
    EXPECT_EQ((std::vector<std::size_t>{a, b}), error->part);
    EXPECT_EQ("the part is free to turn about Z (axis through (0, 0, 0))", error->reason.Text());
    // Tied to the tower it is held, whichever way it is tied.
    T_FRAME linked = frame;
    Join(linked, ELEMENT_KIND::Link, 0, b, {1.0, 1.0, 0.0, 0.0, 0.0, 0.0});
    EXPECT_FALSE(CheckRigidBodies(linked));
    T_FRAME equal = frame;
    equal.equalDisplacements.push_back({{4, b}, {false, true}});
    EXPECT_FALSE(CheckRigidBodies(equal));
    T_FRAME slab = frame;
    slab.diaphragms.push_back({{4, 5, a, b}, 2});
    EXPECT_FALSE(CheckRigidBodies(slab));
}

TEST(StabilityCheck, LetsAChainOfTrussesSpinButNotSwing)
{
    T_FRAME frame = Empty(); // inclined, so that nothing is exact
    const std::size_t a = AddNode(frame, {1.0, 2.0, 3.0}), b = AddNode(frame, {2.1, 4.3, 3.7});
    Join(frame, ELEMENT_KIND::Truss, a, b);
    Fix(frame, a, {X, Y, Z, RX, RY, RZ}); // the rotations hold nothing
    const auto error = CheckRigidBodies(frame);
    ASSERT_TRUE(error);
    EXPECT_NE(std::string::npos, error->reason.Text().find("turn about"));
    Fix(frame, b, {X, Y, Z});
    EXPECT_FALSE(CheckRigidBodies(frame));
    frame.elements[0].kind = ELEMENT_KIND::Beam; // a beam does not spin freely
    frame.nodes[a].fixed = {true, true, true, false, false, false};
    ASSERT_TRUE(CheckRigidBodies(frame));
    Fix(frame, a, {RX});
    EXPECT_FALSE(CheckRigidBodies(frame));
}

TEST(StabilityCheck, TakesAPlaneFrameAsThePlaneRestrainsIt)
{
    T_FRAME frame = Empty(); // a beam along X in the plane XZ
    for (double x : {0.0, 4.0, 8.0})
        Fix(frame, AddNode(frame, {x, 0, 0}), {Y, RX, RZ});
    Join(frame, ELEMENT_KIND::Beam, 0, 1);
    Join(frame, ELEMENT_KIND::Beam, 1, 2);
    Fix(frame, 0, {X, Z});
    auto error = CheckRigidBodies(frame);
    ASSERT_TRUE(error);
    EXPECT_EQ("the part is free to turn about Y (axis through (0, 0, 0))", error->reason.Text());
    Fix(frame, 2, {Z});
    EXPECT_FALSE(CheckRigidBodies(frame));
    for (T_ELEMENT& e : frame.elements) // as trusses: the middle swings, but no rigid body does
        e.kind = ELEMENT_KIND::Truss;
    EXPECT_FALSE(CheckRigidBodies(frame));
}

TEST(StabilityCheck, ADiaphragmOverTwoHeightsHoldsAPost)
{
    T_FRAME frame = Empty(); // its plane lets neither node move sideways against the other
    Fix(frame, AddNode(frame, {0, 0, 0}), {X, Y, Z, RZ});
    AddNode(frame, {0, 0, 3});
    Join(frame, ELEMENT_KIND::Beam, 0, 1);
    EXPECT_TRUE(CheckRigidBodies(frame));
    frame.diaphragms.push_back({{0, 1}, 2});
    EXPECT_FALSE(CheckRigidBodies(frame));
    T_LOAD_CASE push;
    push.nodal.push_back({1, {10, 0, 0, 0, 0, 0}});
    const T_RESULT r = Solved(frame, push);
    EXPECT_NEAR(-10.0, r.reaction[0][0], 1e-12);
    EXPECT_NEAR(0.0, r.displacement[1][0], 1e-15);
    frame.nodes[1].xyz[2] = 0.0; // of one height it holds no turning
    frame.nodes[1].xyz[0] = 3.0;
    EXPECT_TRUE(CheckRigidBodies(frame));
}

TEST(StabilityCheck, LeavesLooseNodesAndEmptyFramesAlone)
{
    T_FRAME frame = Empty();
    EXPECT_FALSE(CheckRigidBodies(frame));
    AddNode(frame, {1, 1, 1});
    EXPECT_FALSE(CheckRigidBodies(frame));
    Join(frame, ELEMENT_KIND::Spring, 0, 0, {1.0, 0.0, 0.0, 0.0, 0.0, 0.0});
    EXPECT_FALSE(CheckRigidBodies(frame));
}

} // namespace
