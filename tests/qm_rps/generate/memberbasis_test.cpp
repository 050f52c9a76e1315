// What members of a model are to the codes' formulas: rows of bars, steel shapes with fillets,
// lengths between rigid offsets, and what a generated type hangs on.
#include "qm_db/sectionproperties.h"
#include "qm_rps/codes/en1993class.h"
#include "qm_rps/generate/codehingetype.h"
#include "qm_rps/generate/rcmember.h"
#include "qm_rps/generate/steelmember.h"

#include <gtest/gtest.h>

#include <cmath>
#include <functional>
#include <numbers>

namespace {

constexpr double kBar = 314e-6;

T_SECT_D Concrete(SECT_SHAPE shape, std::initializer_list<std::pair<double, double>> bars)
{
    T_SECT_D s;
    s.shape = shape;
    s.size = {0.4, shape == SECT_SHAPE::Circle ? 0.0 : 0.4, 0.0, 0.0};
    s.detailing = T_SECT_DETAIL{0.03, 0.008, 0.15};
    for (const auto& [y, z] : bars)
        s.bars.push_back({y, z, kBar});
    return s;
}

/// Eight bars all round, as a rule lays them: those on an axis lie 1e-17 m beside it.
T_SECT_D Round()
{
    T_SECT_D s = Concrete(SECT_SHAPE::Circle, {});
    for (int i = 0; i < 8; ++i)
        s.bars.push_back({0.152 * std::sin(i * std::numbers::pi / 4),
                          0.152 * std::cos(i * std::numbers::pi / 4), kBar});
    return s;
}

T_SECT_D Hea240()
{
    T_SECT_D s;
    s.shape = SECT_SHAPE::IShape;
    s.size = {0.23, 0.24, 7.5e-3, 12e-3};
    s.fillet = 21e-3;
    return s;
}

/// A column of steel of 4 m between nodes, with rigid ends of 0.3 and 0.7 m.
T_MODEL Column()
{
    T_MODEL m;
    m.nodes[1] = {};
    m.nodes[2] = {};
    m.nodes[2].xyz = {0, 0, 4};
    T_MATL_D steel;
    steel.E = 210e9, steel.nu = 0.3, steel.Fy = 235e6, steel.confidence = 1.0;
    m.materials[1] = steel;
    m.sections[1] = Hea240();
    T_ELEM_D e;
    e.id = 1, e.nodeI = 1, e.nodeJ = 2, e.section = 1, e.material = 1;
    e.offset.I = {0, 0, 0.3};
    e.offset.J = {0, 0, -0.7};
    m.elements[1] = e;
    return m;
}

T_HINGE_MEMBER Read(const T_MODEL& model)
{
    T_HINGE_MEMBER member;
    std::string reason;
    EXPECT_TRUE(ReadMember(model, 1, CInitialAxial{}, member, reason)) << reason;
    return member;
}

TEST(MemberBasis, SymmetricBarsAreTheSameFromBothSides)
{
    const struct {
        const char* label;
        T_SECT_D section;
        double bars, web, dPrime; // tension as compression; between; depth of the compressed ones
    } cases[] = {
        // Three bars and half of two on the axis: (48 + 2 x 92.52 + 200)/4 mm.
        {"circle, bars on both axes", Round(), 4, 0, 0.1082599},
        {"square, bars at mid-depth",
         Concrete(SECT_SHAPE::Rectangle, {{-.15, -.15},
                                          {.15, -.15},
                                          {-.15, 1e-17},
                                          {.15, -1e-17},
                                          {1e-17, .15},
                                          {-1e-17, -.15},
                                          {-.15, .15},
                                          {.15, .15}}),
         3, 2, 0.05},
        // A tenth of 0.4 m: 0.15 - 0.11 lies on the edge of the row.
        {"square, bars on the edge of the row",
         Concrete(SECT_SHAPE::Rectangle, {{-.15, -.15},
                                          {.15, -.15},
                                          {-.15, .15},
                                          {.15, .15},
                                          {-.11, -.11},
                                          {.11, -.11},
                                          {-.11, .11},
                                          {.11, .11}}),
         4, 0, 0.07},
    };
    for (const auto& c : cases)
        for (const bool aboutY : {true, false})
            for (const bool positive : {true, false}) {
                CCodeSheet sheet;
                const auto b = RcBending(c.section, aboutY, positive, sheet);
                ASSERT_TRUE(b) << c.label;
                EXPECT_NEAR(c.bars * kBar, b->As, 1e-12) << c.label << aboutY << positive;
                EXPECT_NEAR(c.bars * kBar, b->AsPrime, 1e-12) << c.label << aboutY << positive;
                EXPECT_NEAR(c.web * kBar, b->AsWeb, 1e-12) << c.label << aboutY << positive;
                EXPECT_NEAR(c.dPrime, b->dPrime, 1e-7) << c.label << aboutY << positive;
            }
}

TEST(MemberBasis, FilletsCountInPlatesAndShear)
{
    // HEA 240: flange (240 - 7.5 - 42)/24 = 7.94 is of class 1, without the fillet 9.69 of class 2.
    const T_MODEL model = Column();
    const T_MEMBER_END end =
        EndOf(model, Read(model), {HINGE_CODE::En1998}, HINGE_COMPONENT::My, true, 0.0);
    CCodeSheet sheet;
    const auto basis = SteelBasis(end, sheet);
    ASSERT_TRUE(basis);
    EXPECT_EQ(1, En1993Class(basis->shape, true, 0.0, basis->fy, sheet));
    EXPECT_NEAR(25.18e-4, *EnShearArea(basis->shape, true, sheet), 0.01e-4); // of the catalogue
    EXPECT_NEAR(0.164, basis->Member().h, 1e-12);                            // 230 - 24 - 42
    T_SECT_D box; // 200 x 100 x 8: outer radius 16, inner 8
    box.shape = SECT_SHAPE::Box;
    box.size = {0.2, 0.1, 8e-3, 8e-3};
    box.fillet = 16e-3;
    EXPECT_NEAR(8e-3, SteelShapeOf(box, sheet)->r, 1e-15);
    // No code has rows for hinges of channels: never the row of another shape.
    T_MODEL other = model;
    other.sections[1].shape = SECT_SHAPE::Channel;
    for (const HINGE_CODE code : {HINGE_CODE::En1998, HINGE_CODE::Asce17}) {
        CCodeSheet refused;
        EXPECT_FALSE(
            SteelBasis(EndOf(other, Read(other), {code}, HINGE_COMPONENT::My, true, 0.0), refused));
        ASSERT_TRUE(refused.Fault());
        EXPECT_EQ("shape: channel", refused.Fault()->member);
    }
}

TEST(MemberBasis, WhatBendsLiesBetweenTheRigidOffsets)
{
    const T_MODEL model = Column();
    const T_MEMBER_END end =
        EndOf(model, Read(model), {HINGE_CODE::Asce17}, HINGE_COMPONENT::My, true, 0.0);
    EXPECT_NEAR(3.0, end.clear, 1e-12);
    EXPECT_NEAR(1e5 * 3.0 / (6 * end.EI), end.Turn(1e5), 1e-15);
    T_CODE_HINGE hinge;
    std::string reason;
    ASSERT_TRUE(MakeCodeHinge(model, Read(model), {HINGE_CODE::Asce17}, hinge, reason)) << reason;
    EXPECT_FALSE(hinge.type.length.autoSpan); // the push takes its elastic part from there
    EXPECT_NEAR(3.0, hinge.type.length.span, 1e-12);
    const auto& bone = hinge.components.front().ends.I.pos.bone;
    EXPECT_NEAR(end.Turn(bone.yield), bone.yieldDeform, 1e-12);
    // 3 % of the slope M/theta_y over the plastic rotation of C.
    EXPECT_NEAR(1 + 0.03 * (bone.C.deform / bone.yieldDeform - 1), bone.C.strength, 1e-9);
}

TEST(MemberBasis, StiffnessIsThatOfTheAnalysisAndStrengthThatOfTheSection)
{
    T_MODEL model = Column();
    const auto end = [&model] {
        return EndOf(model, Read(model), {HINGE_CODE::Asce17}, HINGE_COMPONENT::My, true, 0.0);
    };
    const T_MEMBER_END whole = end();
    T_SECT_D& section = model.sections[1];
    section.factorsI.Iyy = 0.3, section.factorsJ.Iyy = 0.5; // 0.4 on the mean
    section.factorsI.Asz = section.factorsJ.Asz = 0.2;
    section.factorsI.area = section.factorsJ.area = 0.6;
    const T_MEMBER_END cracked = end();
    EXPECT_NEAR(0.4 * whole.EI, cracked.EI, 1e-9 * whole.EI);
    EXPECT_NEAR(0.2 * whole.GA, cracked.GA, 1e-9 * whole.GA);
    EXPECT_NEAR(0.6 * whole.EA, cracked.EA, 1e-9 * whole.EA);
    EXPECT_EQ(whole.section.area, cracked.section.area);
    EXPECT_NEAR(whole.Turn(1.0) / 0.4, cracked.Turn(1.0), 1e-9 * cracked.Turn(1.0));
}

TEST(MemberBasis, AllThatGoesIntoATypeIsAmongItsInputs)
{
    const T_MODEL model = Column();
    const std::vector<double> made = InputsOf(model, Read(model));
    const struct {
        const char* label;
        std::function<void(T_MODEL&)> change;
        bool stale;
    } cases[] = {
        {"fillet", [](T_MODEL& m) { m.sections[1].fillet = 18e-3; }, true},
        {"G", [](T_MODEL& m) { m.materials[1].G = 70e9; }, true},
        {"nu", [](T_MODEL& m) { m.materials[1].nu = 0.2; }, true},
        {"G that nu gives", [](T_MODEL& m) { m.materials[1].G = 210e9 / 2.6; }, false},
        {"factor", [](T_MODEL& m) { m.sections[1].factorsJ.Izz = 0.5; }, true},
        {"density", [](T_MODEL& m) { m.materials[1].density = 7850; }, false},
    };
    for (const auto& c : cases) {
        T_MODEL changed = model;
        c.change(changed);
        EXPECT_EQ(!c.stale, SameInputs(made, InputsOf(changed, Read(changed)))) << c.label;
    }
}

} // namespace
