// Beam-column joints: what they are in a frame, and their check, by hand.
#include "qm_rps/generate/jointcheck.h"

#include <gtest/gtest.h>

#include <cmath>

namespace {

/// Columns 0.40 x 0.40 and beams 0.30 x 0.50 (d = 0.453) in the plane XZ around node 5: one below,
/// one above, one on each side.
T_MODEL Frame()
{
    T_MODEL m;
    const struct {
        int id;
        std::array<double, 3> xyz;
    } nodes[] = {{2, {0, 0, 0}},  {5, {0, 0, 3}}, {8, {0, 0, 6}},
                 {4, {-5, 0, 3}}, {6, {5, 0, 3}}, {9, {5, 0, 6}}};
    for (const auto& n : nodes) {
        T_NODE_D node;
        node.xyz = n.xyz;
        m.nodes.emplace(n.id, node);
    }
    T_MATL_D concrete;
    concrete.type = MATL_CLASS::Concrete;
    concrete.fck = 20e6, concrete.fyk = 400e6, concrete.Es = 200e9, concrete.E = 15e9;
    concrete.mean = T_MATL_MEAN{28e6, 450e6, 0.0};
    concrete.knowledge = MATL_KNOWLEDGE::KL2;
    m.materials.emplace(1, concrete);
    for (const bool beam : {false, true}) {
        T_SECT_D s;
        s.shape = SECT_SHAPE::Rectangle;
        s.size = {beam ? 0.5 : 0.4, beam ? 0.3 : 0.4, 0.0, 0.0};
        s.detailing = T_SECT_DETAIL{0.03, 0.008, 0.15};
        for (const double z : {-1.0, 1.0})
            for (const double y : {-0.1, 0.1})
                s.bars.push_back({y, z * (beam ? 0.203 : 0.153), 254.469e-6});
        m.sections.emplace(beam ? 2 : 1, s);
    }
    const struct {
        int id, i, j, section;
    } elements[] = {{1, 2, 5, 1}, {2, 5, 8, 1}, {11, 4, 5, 2}, {12, 5, 6, 2}, {13, 8, 9, 2}};
    for (const auto& e : elements) {
        T_ELEM_D element;
        element.id = e.id, element.nodeI = e.i, element.nodeJ = e.j;
        element.section = e.section, element.material = 1;
        m.elements.emplace(e.id, element);
    }
    return m;
}

using T_WAY = std::array<double, 3>;
constexpr T_WAY kX{1, 0, 0}, kY{0, 1, 0};

int Read(const T_MODEL& model, int node, const T_WAY& along, HINGE_CODE code, T_JOINT& joint,
         std::string& reason)
{
    return ReadJoint(model, BeamsByNode(model)[node], node, along, code, joint, reason);
}

TEST(JointCheck, ByEachCode)
{
    // Vj = 343.302 / (0.9 x 0.453) - 100 = 742.045; joint 0.40 x 0.40, N = 640.
    const T_JOINT_DEMAND demand{343.302e3, 100e3, 640e3};
    const double shear = 343.302e3 / (0.9 * 0.453) - 100e3;
    // Principal stresses over 0.40 m by the 0.306 m between the bars: 320 and 742.045/0.1224.
    const double pressed = 320e3 / 0.1224, radius = std::hypot(pressed, shear / 0.1224);
    const struct {
        HINGE_CODE code;
        double demand, capacity;
    } cases[] = {
        // 10 sqrt(20 MPa in psi) 0.16 m2: no hoops, no transverse beams.
        {HINGE_CODE::Asce17, shear, 10 * std::sqrt(20e6 * 6894.757293168) * 0.16},
        // 0.6 (1 - 23.333/250) 23.333 sqrt(1 - 0.171429/0.544) 0.1224
        {HINGE_CODE::En1998, shear,
         0.544 * 28e6 / 1.2 * std::sqrt(1 - 640e3 / 0.16 / (28e6 / 1.2) / 0.544) * 0.1224},
        {HINGE_CODE::Circolare2019, radius - pressed, 0.3e6 * std::sqrt(28 / 1.2)},
    };
    for (const auto& c : cases) {
        T_JOINT joint;
        T_JOINT_CHECK check;
        std::string reason;
        ASSERT_EQ(1, Read(Frame(), 5, kX, c.code, joint, reason)) << reason;
        EXPECT_EQ(JOINT_KIND::Interior, joint.kind);
        EXPECT_EQ((std::vector<int>{12, 11}), joint.beams);
        ASSERT_EQ(1, CheckJoint(joint, demand, check, reason)) << reason;
        EXPECT_NEAR(shear, check.shear, 1e-6 * shear);
        EXPECT_NEAR(c.demand, check.demand, 1e-6 * c.demand);
        EXPECT_NEAR(c.capacity, check.capacity, 1e-6 * c.capacity);
        // V / Vn = 742.0/702.9 with the expected strength: row NC, P/(Ag f'cE) = 0.143.
        EXPECT_EQ(c.code == HINGE_CODE::Asce17, check.rotations.has_value());
        if (check.rotations) {
            EXPECT_DOUBLE_EQ(0.005, check.rotations->a);
            EXPECT_NEAR(0.02 - 0.005 * (640.0 / 0.16 / 28e3 - 0.1) / 0.3, check.rotations->b,
                        1e-12);
        }
        EXPECT_FALSE(check.trace.empty());
    }
}

TEST(JointCheck, KindsAndRefusals)
{
    T_JOINT joint;
    std::string reason;
    T_MODEL model = Frame();
    ASSERT_EQ(1, Read(model, 8, kX, HINGE_CODE::Asce17, joint, reason));
    EXPECT_EQ(JOINT_KIND::Knee, joint.kind);
    model.elements.erase(11);
    ASSERT_EQ(1, Read(model, 5, kX, HINGE_CODE::Asce17, joint, reason));
    EXPECT_EQ(JOINT_KIND::Exterior, joint.kind);
    EXPECT_EQ(0, Read(model, 2, kX, HINGE_CODE::Asce17, joint, reason)); // a foot
    EXPECT_EQ(0, Read(model, 5, kY, HINGE_CODE::Asce17, joint, reason)); // no beams along Y
    model.sections.at(2).bars.clear();
    EXPECT_EQ(0, Read(model, 5, kX, HINGE_CODE::Asce17, joint, reason));
    EXPECT_NE(std::string::npos, reason.find("bars"));
    T_JOINT_CHECK check;
    EXPECT_EQ(0, CheckJoint(joint, {std::nan(""), 0.0, 0.0}, check, reason));
}

// Turned by 30 degrees in plan, columns 0.40 (along the beams) x 0.60 with it.
TEST(JointCheck, TurnedFramesHaveTheJointsOfStraightOnes)
{
    T_MODEL model = Frame();
    model.sections.at(1).size[1] = 0.6;
    const double c = std::sqrt(0.75);
    for (auto& [id, node] : model.nodes)
        node.xyz = {c * node.xyz[0], 0.5 * node.xyz[0], node.xyz[2]};
    T_JOINT joint;
    std::string reason;
    const std::vector<T_WAY> planes = JointPlanes(model, BeamsByNode(model)[5], 5);
    ASSERT_EQ(1U, planes.size());
    EXPECT_NEAR(0.5, planes[0][1], 1e-12);
    // The columns' local z is X still: their sides are 30 degrees from the beams.
    EXPECT_EQ(0, Read(model, 5, planes[0], HINGE_CODE::En1998, joint, reason));
    for (const int column : {1, 2})
        model.elements.at(column).zAxis = {c, 0.5, 0.0};
    ASSERT_EQ(1, Read(model, 5, planes[0], HINGE_CODE::En1998, joint, reason)) << reason;
    EXPECT_EQ(0.4, joint.hc);
    EXPECT_NEAR(0.5, joint.width, 1e-12); // 0.3 + 0.4/2
    EXPECT_EQ(JOINT_KIND::Interior, joint.kind);
}

TEST(JointCheck, WhatIsNoJointOfOneColumnIsRefused)
{
    T_JOINT joint;
    std::string reason;
    T_MODEL wall = Frame();
    wall.sections.at(1).size[0] = 2.0;
    EXPECT_EQ(0, Read(wall, 5, kX, HINGE_CODE::En1998, joint, reason));
    T_MODEL several = Frame(); // a second member above node 5, to (1, 0, 6)
    several.nodes.at(9).xyz = {1, 0, 6};
    several.elements.at(13).nodeI = 5, several.elements.at(13).section = 1;
    EXPECT_EQ(0, Read(several, 5, kX, HINGE_CODE::En1998, joint, reason));
    T_MODEL skewed = Frame(); // its beam pushes the joint in the plane of the other, too
    skewed.nodes.at(6).xyz = {5, 1, 3};
    EXPECT_EQ(0, Read(skewed, 5, kX, HINGE_CODE::En1998, joint, reason));
    EXPECT_EQ(2U, JointPlanes(skewed, BeamsByNode(skewed)[5], 5).size());
}

} // namespace
