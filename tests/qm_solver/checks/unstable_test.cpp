// Models that can move, as CFrameSolver refuses them, and stiff ones that it must not refuse.
#include "qm_solver/framesolver.h"

#include "frames.h"

#include <gtest/gtest.h>

#include <cmath>

namespace {

using namespace sample;

constexpr int X = 0, Y = 1, Z = 2, RX = 3, RY = 4, RZ = 5;

/// A portal in the plane XZ: feet 0 and 3, knees 1 and 2 at 3 m, clamped.
T_FRAME Portal()
{
    T_FRAME frame = Empty();
    for (auto [x, z] : {std::pair{0.0, 0.0}, {0.0, 3.0}, {5.0, 3.0}, {5.0, 0.0}})
        AddNode(frame, {x, 0, z});
    for (std::size_t n : {0, 1, 2})
        Join(frame, ELEMENT_KIND::Beam, n, n + 1);
    for (std::size_t n : {0, 3})
        Fix(frame, n, {X, Y, Z, RX, RY, RZ});
    for (std::size_t n : {1, 2})
        Fix(frame, n, {Y, RX, RZ});
    return frame;
}

void Hinge(T_FRAME& frame, std::size_t element, bool atI, const std::vector<std::size_t>& about)
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

    T_FRAME loose = Portal(); // both beams that meet at the knee are hinged there
    Hinge(loose, 0, false, {RY});
    Hinge(loose, 1, true, {RY});
    cases.push_back({"a node between hinges turns", loose, {1}, RY});

    T_FRAME truss = Portal(); // a node on two trusses in one line swings out of it
    const std::size_t mid = AddNode(truss, {2.5, 0, 1.5});
    const std::size_t far = AddNode(truss, {5.0, 0, 3.0});
    Fix(truss, far, {X, Y, Z});
    Join(truss, ELEMENT_KIND::Truss, 0, mid);
    Join(truss, ELEMENT_KIND::Truss, mid, far);
    Fix(truss, mid, {Z}); // held along Z, and so along X by the trusses: Y is left
    cases.push_back({"two trusses in a line", truss, {mid}, Y});

    return cases;
}

TEST(Unstable, ModelsAreRefusedWithNodeAndDirection)
{
    for (const T_CASE& c : Cases()) {
        SCOPED_TRACE(c.label);
        CFrameSolver solver;
        T_SOLVER_ERROR error;
        ASSERT_EQ(0, solver.Prepare(c.frame, error));
        EXPECT_EQ(SOLVER_FAULT::Mechanism, error.fault) << error.reason.Text();
        EXPECT_EQ(1, std::count(c.nodes.begin(), c.nodes.end(), std::size_t(error.node)))
            << error.node;
        EXPECT_EQ(c.direction, error.direction) << error.reason.Text();
        EXPECT_TRUE(error.part.empty());
        std::vector<T_RESULT> results;
        EXPECT_EQ(0, solver.Solve(std::vector<T_LOAD_CASE>(1), results, error)); // no model held
    }
}

TEST(Unstable, IsATowerOnAStoreyOfHingedColumns)
{
    for (std::size_t storeys : {2u, 12u, 60u})
        for (double stiffer : {1.0, 1e6}) { // the columns of the ground floor
            SCOPED_TRACE(testing::Message() << storeys << " " << stiffer);
            T_FRAME frame = IrregularTower(storeys);
            T_SECTION section = frame.sections[0];
            for (double* p : {&section.A, &section.J, &section.Iy, &section.Iz})
                *p *= stiffer;
            frame.sections.push_back(section);
            const std::size_t hinged = storeys / 2;
            for (std::size_t c = 0; c < 4; ++c) {
                frame.elements[2 * c].section = 1;
                for (bool atI : {true, false})
                    Hinge(frame, 8 * hinged + 2 * c, atI, {RY, RZ});
            }
            CFrameSolver solver;
            T_SOLVER_ERROR error;
            ASSERT_EQ(0, solver.Prepare(frame, error));
            EXPECT_EQ(SOLVER_FAULT::Mechanism, error.fault) << error.reason.Text();
            EXPECT_GE(error.node, long(4 * (hinged + 1))); // above the hinges
            EXPECT_LE(error.direction, Z);
            for (std::size_t c = 0; c < 4; ++c) // hinges at one end are no mechanism
                frame.elements[8 * hinged + 2 * c].releaseJ = {};
            EXPECT_EQ(1, solver.Prepare(frame, error)) << error.reason.Text();
        }
}

TEST(Unstable, IsNotWhatIsMerelyOfVeryDifferentStiffness)
{
    // A clamped portal whose girder is stiffer by the contrast: as a rigid body it sways on two
    // columns clamped at both ends, 12 EI / h^3 each, and tilts by their axial flexibility. The
    // girder's axial stiffness is 3e1 times the contrast over that of sway.
    const double h = 3.0, b = 5.0, ea = 2.1e8 * 5.4e-3, ei = 2.1e8 * 3.7e-5;
    // Push 10 at the knees: sway d and tilt t of the knees from the equilibrium of the girder.
    // Column shear 12 EI/h^3 d - 6 EI/h^2 t, column moment 4 EI/h t - 6 EI/h^2 d, axial b/2 t EA/h.
    const double k11 = 2.0 * 12.0 * ei / (h * h * h), k12 = -2.0 * 6.0 * ei / (h * h);
    const double k22 = 2.0 * 4.0 * ei / h + 2.0 * b * b / 4.0 * ea / h;
    const double sway = 10.0 * k22 / (k11 * k22 - k12 * k12);
    for (double contrast : {1e3, 1e5, 1e8, 1e10, 1e14}) {
        SCOPED_TRACE(contrast);
        T_FRAME frame = Portal();
        T_SECTION rigid = frame.sections[0];
        for (double* p : {&rigid.A, &rigid.J, &rigid.Iy, &rigid.Iz})
            *p *= contrast;
        frame.sections.push_back(rigid);
        frame.elements[1].section = 1;
        CFrameSolver solver;
        T_SOLVER_ERROR error;
        ASSERT_EQ(1, solver.Prepare(frame, error)) << error.reason.Text();
        if (contrast > 1e8) continue; // accepted; whether figures keep their digits, Solve says
        T_LOAD_CASE push;
        push.nodal.push_back({1, {10.0, 0, 0, 0, 0, 0}});
        std::vector<T_RESULT> results;
        ASSERT_EQ(1, solver.Solve(std::span(&push, 1), results, error)) << error.reason.Text();
        // The girder's own flexibility is the rest: EI b / 12 against the columns, 1 / contrast.
        EXPECT_NEAR(sway, results[0].displacement[1][X], sway * (1.0 / contrast + 1e-6));
    }
}

} // namespace
