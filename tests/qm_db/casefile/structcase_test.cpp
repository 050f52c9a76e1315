// Structure, loads, combinations and unknown load factors in the case file and in the model file.
#include "casetext.h"
#include "qm_db/records/recordunits.h"

#include <cmath>
#include <gtest/gtest.h>

namespace {

std::string AllText()
{
    return CaseText("struct_all_members.json");
}

} // namespace

TEST(StructCase, TheTextOfEveryMemberComesBackLetterForLetter)
{
    const T_MODEL_CONTENT content = ParseGood(AllText());
    EXPECT_EQ(AllText(), PrintGood(content));
    ExpectRoundTrips(content, "all members");
}

// From kN and m by hand, what the engine's model does not show: 1 kN = 1000 N.
TEST(StructCase, ReadsMembersIntoTheirFieldsInSi)
{
    const T_MODEL m = ParseGood(AllText()).model;
    const T_MATL_D& steel = m.materials.at(1);
    EXPECT_DOUBLE_EQ(7850.0, steel.density);
    EXPECT_EQ(1.2e-5, steel.alpha);
    EXPECT_DOUBLE_EQ(355e6, steel.Fy);
    EXPECT_EQ(3.69e-5, m.sections.at(1).Iyy);
    EXPECT_EQ((std::array<double, 3>{0, 1, 0}), m.elements.at(1).zAxis);
    EXPECT_EQ(
        (T_BEAM_LOAD{1, BEAM_LOAD_AXES::Local, 1, BEAM_LOAD_TYPE::Point, {1e4, 0}, {0.3, 1.0}}),
        m.loadCases.at(1).beam[2]);
    EXPECT_EQ((std::vector<T_LCOM_ITEM>{{false, 1, 1.35}, {true, 2, 0.7}}),
              m.combinations.at(1).items); // C0 stands behind C1

    EXPECT_EQ((T_ULFC_D{"D5", ULFC_TYPE::Displacement, 5, 0, 2, true, true, 0, 0, 0.01, -0.01}),
              m.ulfConstraints.at(1));
    EXPECT_EQ(0.01, m.ulfConstraints.at(2).upper); // radians
    EXPECT_EQ((T_ULFC_D{"R1", ULFC_TYPE::Reaction, 1, 0, 4, false, true, 12500.0}),
              m.ulfConstraints.at(3));
    EXPECT_EQ((T_ULFC_D{"N2", ULFC_TYPE::Truss, 2, 0, 0, false, false, 0, 6}),
              m.ulfConstraints.at(4));
    EXPECT_EQ((T_ULFC_D{"B1", ULFC_TYPE::Beam, 1, 3, 4, true, true, 0, 0, {}, -8e4}),
              m.ulfConstraints.at(5));
    EXPECT_EQ((T_ULFI_D{"T1", 1, 2, 2, true, {{3, 1.0}, {1, 2.5}}, {"D5", "not, there"}}),
              m.ulfItems.at(1));
}

TEST(StructCase, EveryChoiceOfEveryListComesBack)
{
    T_MODEL_CONTENT c = ParseGood(AllText());
    for (int i = 0; i < 6; ++i) {
        const auto at = static_cast<std::size_t>(i);
        c.model.styp.plane = static_cast<MODEL_PLANE>(i % 3);
        c.model.elements.at(1).release.I = {};
        c.model.elements.at(1).release.I[at] = true;
        c.model.diaphragms.at(1).normal = i % 3;
        c.model.equalDisplacements.at(1).directions = {};
        c.model.equalDisplacements.at(1).directions[at] = true;
        c.model.loadCases.at(1).beam[0].direction = i % 3;
        c.model.ulfConstraints.at(1).component = c.model.ulfConstraints.at(3).component = i;
        c.model.ulfConstraints.at(5).component = i;
        c.model.ulfConstraints.at(5).position = i % 5;
        c.model.ulfItems.at(1).objective = c.model.ulfItems.at(1).sign = i % 3;
        EXPECT_TRUE(SameContent(c, ParseGood(PrintGood(c)))) << i;
    }
}

TEST(StructCase, IsLosslessInEveryUnit)
{
    ExpectLosslessInEveryUnit(ParseGood(AllText()));
}

TEST(StructCase, BadInputNamesThePlace)
{
    ExpectRefused(AllText(), "struct_refusals.txt");
}

// 1 of every quantity in kip and inch; 1 kip = 4448.2216152605 N, 1 in = 0.0254 m.
TEST(StructCase, UnitsChangeEveryQuantityByItsDimension)
{
    const auto si = [](auto record) {
        RecordToSi(record, {FORCE_UNIT::kips, LENGTH_UNIT::in});
        return record;
    };
    T_MATL_D matl;
    matl.density = matl.alpha = 1.0;
    matl.G = 1.0;
    T_ELEM_D elem, spring;
    elem.zAxis = elem.offset.J = {1, 1, 1};
    spring.kind = ELEM_KIND::Spring;
    spring.stiffness = {1, 1, 1, 1, 1, 1};
    T_STLD_D load;
    load.selfWeight = {1, 1, 1};
    load.nodal = {{1, {1, 1, 1, 1, 1, 1}}};
    load.settlement = {{1, {1, 1, 1, 1, 1, 1}}};
    load.temperature = {{1, 1.0}};
    load.pretension = {{1, 1.0}};
    for (const auto type :
         {BEAM_LOAD_TYPE::Distributed, BEAM_LOAD_TYPE::Point, BEAM_LOAD_TYPE::Moment})
        load.beam.push_back({1, BEAM_LOAD_AXES::Local, 2, type, {1, 0}, {0.5, 1}});
    const T_MATL_D m = si(matl);
    const T_ELEM_D e = si(elem), k = si(spring);
    const T_STLD_D l = si(load);
    const auto bound = [&](ULFC_TYPE type, int component) {
        return *si(T_ULFC_D{"c", type, 1, 0, component, true, true, 0, 0, 1.0}).upper;
    };
    const struct {
        const char* what;
        double value;
        int force, length;
    } rows[] = {
        {"G", *m.G, 1, -2},
        {"density", m.density, 1, -4}, // force s2 / length per volume
        {"expansion", m.alpha, 0, 0},
        {"axis", e.zAxis[0], 0, 0},
        {"offset", e.offset.J[2], 0, 1},
        {"stiffness", k.stiffness[2], 1, -1},
        {"stiffness against turning", k.stiffness[3], 1, 1},
        {"weight", l.selfWeight[2], 0, 0},
        {"force", l.nodal[0].load[2], 1, 0},
        {"moment", l.nodal[0].load[3], 1, 1},
        {"settlement", l.settlement[0].displacement[2], 0, 1},
        {"rotation", l.settlement[0].displacement[3], 0, 0},
        {"temperature", l.temperature[0].change, 0, 0},
        {"pretension", l.pretension[0].force, 1, 0},
        {"line load", l.beam[0].w[0], 1, -1},
        {"point load", l.beam[1].w[0], 1, 0},
        {"moment on a beam", l.beam[2].w[0], 1, 1},
        {"its place", l.beam[2].at[0] + 0.5, 0, 0},
        {"bound of a reaction", bound(ULFC_TYPE::Reaction, 2), 1, 0},
        {"... of a moment", bound(ULFC_TYPE::Reaction, 4), 1, 1},
        {"... of a displacement", bound(ULFC_TYPE::Displacement, 2), 0, 1},
        {"... of a rotation", bound(ULFC_TYPE::Displacement, 4), 0, 0},
        {"... of a truss", bound(ULFC_TYPE::Truss, 0), 1, 0},
        {"... of a shear force", bound(ULFC_TYPE::Beam, 2), 1, 0},
        {"... of a bending moment", bound(ULFC_TYPE::Beam, 4), 1, 1},
    };
    for (const auto& row : rows)
        EXPECT_DOUBLE_EQ(std::pow(4448.2216152605, row.force) * std::pow(0.0254, row.length),
                         row.value)
            << row.what;
}
