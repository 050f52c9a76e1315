// Rotations and forces of member ends against hand values.
#include "qm_rps/judge/judgement.h"

#include <gtest/gtest.h>

#include <cmath>

namespace {

/// A column of 3 m along Z with 0.5 m rigid at its top and a beam of 4 m along X from there with
/// 0.2 m rigid at its start: flexible lengths 2.5 m and 3.8 m.
T_MODEL Frame()
{
    T_MODEL model;
    model.nodes[1].xyz = {0, 0, 0};
    model.nodes[2].xyz = {0, 0, 3};
    model.nodes[3].xyz = {4, 0, 3};
    T_ELEM_D column, beam;
    column.nodeI = 1, column.nodeJ = 2, column.offset.J = {0, 0, -0.5};
    beam.nodeI = 2, beam.nodeJ = 3, beam.offset.I = {0.2, 0, 0};
    model.elements = {{7, column}, {9, beam}};
    return model;
}

/// A step in which node 2 has moved by (0.03, 0.02, -0.001) and turned by (0.002, 0.004, 0.003).
struct T_STEP {
    T_STEP()
    {
        run.displacement = {0.03};
        run.data.nodes = {1, 2, 3};
        run.data.displacement = {{{}, {0.03, 0.02, -0.001, 0.002, 0.004, 0.003}, {}}};
        T_PUSH_HINGE_SERIES hinge;
        hinge.deformation = {-0.006};
        hinge.force = {-120.0};
        run.hinges = {hinge};
        result.force.resize(2);
        for (std::size_t p = 0; p < solver::kBeamPositions; ++p)
            for (std::size_t c = 0; c < 6; ++c)
                result.force[1][p][c] = 10.0 * static_cast<double>(p) + static_cast<double>(c);
    }
    T_PUSH_RUN run;
    std::vector<int> elements{7, 9};
    solver::T_RESULT result;
    T_STEP_FORCES Forces() const { return {run, 0, elements, result}; }
};

} // namespace

// Column: local x up, z along X, y = z cross x = -Y. Its top moves by 0.03 + 0.004 (-0.5) = 0.028
// along X and 0.02 + 0.002 * 0.5 = 0.021 along Y. Beam: x along X, z up, y = z cross x = Y; its
// start moves by -0.001 - 0.004 * 0.2 = -0.0018 along Z and 0.02 + 0.003 * 0.2 = 0.0206 along Y.
TEST(EndState, RotationIsThatOfTheEndLessThatOfTheChord)
{
    const T_MODEL model = Frame();
    const T_STEP step;
    using enum HINGE_COMPONENT;
    const struct {
        const char* label;
        T_END_PLACE place;
        double chord;
    } kCases[] = {
        {"foot, y: chord turns by -0.028 / 2.5 about y", {7, false, My}, 0.028 / 2.5},
        {"head, y: turns by -0.004 about y", {7, true, My}, -0.004 + 0.028 / 2.5},
        {"foot, z: y points to -Y", {7, false, Mz}, 0.021 / 2.5},
        {"head, z: turns by 0.002 about z, which is X", {7, true, Mz}, 0.002 + 0.021 / 2.5},
        {"beam, y, at I", {9, false, My}, 0.004 + 0.0018 / 3.8},
        {"beam, y, at J", {9, true, My}, 0.0018 / 3.8},
        {"beam, z, at I", {9, false, Mz}, 0.003 + 0.0206 / 3.8},
        {"beam, z, at J", {9, true, Mz}, 0.0206 / 3.8},
    };
    for (const auto& c : kCases) {
        const auto axes = AxesOf(model, model.elements.at(c.place.element));
        ASSERT_TRUE(axes) << c.label;
        EXPECT_NEAR(c.chord, EndState(c.place, *axes, -1, step.Forces()).chord, 1e-15) << c.label;
    }
    const auto axes = AxesOf(model, model.elements.at(9));
    const T_END_STATE s = EndState({9, true, Mz}, *axes, 0, step.Forces());
    EXPECT_EQ((std::array{-40.0, 45.0, 41.0}), (std::array{s.N, s.M, s.V})); // at J: p = 4
    EXPECT_EQ((std::array{-0.006, -120.0}), (std::array{s.flowed, s.hingeMoment}));
    const T_END_STATE y = EndState({9, false, My}, *axes, -1, step.Forces());
    EXPECT_EQ((std::array{0.0, 4.0, 2.0, 0.0}), (std::array{y.N, y.M, y.V, y.flowed}));
}

// Turned by 30 degrees in plan, column and all: forces in the joint are those of its own plane. At
// the beam's start M = 4 about its y; the column's head (above the joint: J) has V = 42, N = -40.
TEST(EndState, JointStateIsThatOfThePlaneOfItsBeams)
{
    T_MODEL model = Frame();
    T_STEP own;
    own.result.force[0] = own.result.force[1];
    const double c = std::sqrt(0.75);
    for (const double along : {1.0, c}) {
        const double across = std::sqrt(1.0 - along * along);
        model.nodes[3].xyz = {4 * along, 4 * across, 3};
        model.elements[9].offset.I = {0.2 * along, 0.2 * across, 0};
        model.elements[7].zAxis = {along, across, 0};
        T_JUDGED_JOINT joint;
        joint.forth = {along, across, 0}, joint.up = {0, 0, 1};
        joint.beams = {{9, false, *AxesOf(model, model.elements[9])}};
        joint.above = T_JUDGED_JOINT::T_PART{7, true, *AxesOf(model, model.elements[7])};
        const T_END_STATE s = JointState(joint, own.Forces());
        EXPECT_NEAR(4.0, s.M, 1e-12);
        EXPECT_NEAR(42.0, s.V, 1e-12);
        EXPECT_NEAR(-40.0, s.N, 1e-12);
        EXPECT_EQ(along == 1.0 ? "X" : "X+30", PlaneName(joint.forth, 2));
    }
}
