// Models that can move, as CFrameSolver refuses them, and stiff ones that it must not refuse.
#include "qm_solver/framesolver.h"

#include "frames.h"

#include <gtest/gtest.h>

#include <cmath>

namespace {

using namespace sample;

constexpr int X = 0, Y = 1, Z = 2, RX = 3, RY = 4, RZ = 5;

/// A portal in the plane XZ: feet 0 and 3, knees 1 and 2 at 3 m, clamped.
T_FRAME Portal(bool plane = true)
{
    T_FRAME frame = Empty();
    for (auto [x, z] : {std::pair{0.0, 0.0}, {0.0, 3.0}, {5.0, 3.0}, {5.0, 0.0}})
        AddNode(frame, {x, 0, z});
    for (std::size_t n : {0, 1, 2})
        Join(frame, ELEMENT_KIND::Beam, n, n + 1);
    for (std::size_t n : {0, 3})
        Fix(frame, n, {X, Y, Z, RX, RY, RZ});
    for (std::size_t n : {1, 2})
        if (plane) Fix(frame, n, {Y, RX, RZ});
    return frame;
}

void Hinge(T_FRAME& frame, std::size_t element, bool atI, std::initializer_list<std::size_t> about)
{
    T_ELEMENT& e = frame.elements[element];
    for (std::size_t d : about)
        (atI ? e.releaseI : e.releaseJ)[d] = true;
}

struct T_CASE {
    const char* label;
    T_FRAME frame;
    std::vector<std::size_t> nodes; // that may be named
    int direction;
};

std::vector<T_CASE> Cases()
{
    std::vector<T_CASE> cases;
    T_FRAME sway = Portal(); // hinges at both ends of both columns
    for (std::size_t column : {0u, 2u})
        for (bool atI : {true, false})
            Hinge(sway, column, atI, {RY});
    cases.push_back({"four hinges sway", sway, {1, 2}, X});

    T_FRAME loose = Portal(); // all three... both beams that meet at the knee are hinged there
    Hinge(loose, 0, false, {RY});
    Hinge(loose, 1, true, {RY});
    cases.push_back({"a node between hinges turns", loose, {1}, RY});

    T_FRAME spin = Portal();
    Hinge(spin, 1, true, {RX}); // twist released at both ends: the beam's own matter, no node's
    spin.nodes[1].fixed[RX] = spin.nodes[1].fixed[Y] = spin.nodes[1].fixed[RZ] = false;
    Hinge(spin, 0, false, {RX, RY, RZ});
    cases.push_back({"a knee twists about the girder", spin, {1}, RX});

    T_FRAME truss = Portal(); // a node on two trusses in one line swings out of it
    const std::size_t mid = AddNode(truss, {2.5, 0, 1.5});
    const std::size_t far = AddNode(truss, {5.0, 0, 3.0});
    Fix(truss, far, {X, Y, Z});
    Join(truss, ELEMENT_KIND::Truss, 0, mid);
    Join(truss, ELEMENT_KIND::Truss, mid, far);
    Fix(truss, mid, {Z}); // held along Z, and so along X by the trusses: Y is left
    cases.push_back({"two trusses in a line", truss, {mid}, Y});

    T_FRAME slot = Portal();   // a column's foot on a slot within the beam's own releases
    Hinge(slot, 2, true, {X}); // the right column carries no axial force
    Hinge(slot, 1, false, {RY});
    slot.elements[1].releaseJ[Z] = true; // and the girder no shear at its end
    cases.push_back({"a knee without vertical force", slot, {2}, Z});
    return cases;
}

TEST(Unstable, ModelsAreRefusedWithNodeAndDirection)
{
    for (const T_CASE& c : Cases()) {
        SCOPED_TRACE(c.label);
        CFrameSolver solver;
        T_SOLVER_ERROR error;
        ASSERT_EQ(0, solver.Prepare(c.frame, error));
        EXPECT_EQ(SOLVER_FAULT::Mechanism, error.fault) << error.reason;
        EXPECT_EQ(1, std::count(c.nodes.begin(), c.nodes.end(), std::size_t(error.node)))
            << error.node;
        EXPECT_EQ(c.direction, error.direction) << error.reason;
        EXPECT_TRUE(error.part.empty());
        std::vector<T_RESULT> results;
        EXPECT_EQ(0, solver.Solve(std::vector<T_LOAD_CASE>(1), results, error)); // no model held
    }
}

TEST(Unstable, PartsAreRefusedBeforeTheFactorisation)
{
    T_FRAME frame = Portal(false);
    for (std::size_t n : {0u, 3u})
        frame.nodes[n].fixed = {true, false, true, false, true, true};
    CFrameSolver solver;
    T_SOLVER_ERROR error;
    ASSERT_EQ(0, solver.Prepare(frame, error));
    EXPECT_EQ("the part is free to move along Y and to turn about X (axis through its centre)",
              error.reason.substr(0, error.reason.find(" (")) + " (axis through its centre)");
    EXPECT_EQ(4u, error.part.size());
    EXPECT_EQ(Y, error.direction);
}

TEST(Unstable, IsNotWhatIsMerelyOfVeryDifferentStiffness)
{
    // A clamped portal whose girder is stiffer by the contrast. The limit of a rigid girder is
    // two columns clamped at both ends: 2 * 12 EI / h^3 against sway.
    const double sway = 2.0 * 12.0 * 2.1e8 * 3.7e-5 / 27.0;
    for (double contrast : {1e4, 1e7, 1e10, 1e14}) {
        SCOPED_TRACE(contrast);
        T_FRAME frame = Portal();
        T_SECTION rigid = frame.sections[0];
        for (double* p : {&rigid.A, &rigid.J, &rigid.Iy, &rigid.Iz})
            *p *= contrast;
        frame.sections.push_back(rigid);
        frame.elements[1].section = 1;
        CFrameSolver solver;
        T_SOLVER_ERROR error;
        ASSERT_EQ(1, solver.Prepare(frame, error)) << error.reason;
        if (contrast > 1e10) continue; // accepted; its figures have lost their digits
        T_LOAD_CASE push;
        push.nodal.push_back({1, {10.0, 0, 0, 0, 0, 0}});
        std::vector<T_RESULT> results;
        ASSERT_EQ(1, solver.Solve(std::span(&push, 1), results, error)) << error.reason;
        // The columns' axial strain lets the girder tilt: a relative effect of 12 I / A / b^2 * 3.
        EXPECT_NEAR(10.0 / sway, results[0].displacement[1][0], 0.02 * 10.0 / sway);
    }
}

} // namespace
