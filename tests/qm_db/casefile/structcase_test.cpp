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

// From kN and m by hand: 1 kN = 1000 N; mass kN s2/m = 1000 kg.
TEST(StructCase, ReadsMembersIntoTheirFieldsInSi)
{
    const T_MODEL m = ParseGood(AllText()).model;
    EXPECT_EQ(MODEL_PLANE::XZ, m.styp.plane);
    const T_MATL_D& steel = m.materials.at(1);
    EXPECT_DOUBLE_EQ(8.1e10, *steel.G);
    EXPECT_DOUBLE_EQ(7850.0, steel.density);
    EXPECT_EQ(1.2e-5, steel.alpha);
    EXPECT_DOUBLE_EQ(355e6, steel.Fy);
    EXPECT_FALSE(m.materials.at(4).G);
    EXPECT_EQ(SECT_SHAPE::Value, m.sections.at(1).shape);
    EXPECT_EQ(3.69e-5, m.sections.at(1).Iyy);

    const T_ELEM_D& beam = m.elements.at(1);
    EXPECT_EQ((std::array<double, 3>{0, 1, 0}), beam.zAxis);
    EXPECT_EQ((T_DIRS6{true, false, false, false, false, true}), beam.release.I);
    EXPECT_EQ((std::array<double, 3>{0, 0, -0.2}), beam.offset.J);
    EXPECT_EQ(4, m.elements.at(2).material);
    EXPECT_EQ(ELEM_KIND::Link, m.elements.at(3).kind);
    EXPECT_EQ((std::array<double, 6>{1e6, 2e6, 3e6, 4e4, 5e4, 6e4}), m.elements.at(3).stiffness);
    EXPECT_EQ(ELEM_KIND::Spring, m.elements.at(7).kind);
    EXPECT_EQ(0, m.elements.at(7).nodeJ);
    EXPECT_EQ(0, m.diaphragms.at(5).normal);
    EXPECT_TRUE(m.equalDisplacements.at(1).directions[5]);

    const T_STLD_D& g = m.loadCases.at(1);
    EXPECT_EQ((std::array<double, 6>{1e4, 2e4, 3e4, 1e3, 2e3, 3e3}), g.nodal[0].load);
    EXPECT_EQ(
        (T_BEAM_LOAD{
            1, BEAM_LOAD_AXES::Global, 0, BEAM_LOAD_TYPE::Distributed, {1e3, 0}, {0.25, 0.75}}),
        g.beam[1]);
    EXPECT_EQ(
        (T_BEAM_LOAD{1, BEAM_LOAD_AXES::Local, 1, BEAM_LOAD_TYPE::Point, {1e4, 0}, {0.3, 1.0}}),
        g.beam[2]);
    EXPECT_EQ(-0.01, g.settlement[0].displacement[2]);
    EXPECT_EQ(-20.0, g.temperature[0].change);
    EXPECT_EQ(1e5, g.pretension[0].force);
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
        const T_MODEL_CONTENT back = ParseGood(PrintGood(c));
        EXPECT_EQ(PrintGood(c), PrintGood(back)) << i;
        EXPECT_EQ(c.model.elements, back.model.elements) << i;
        EXPECT_EQ(c.model.ulfItems, back.model.ulfItems) << i;
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

TEST(StructCase, WhatCannotBeReadIsNotWritten)
{
    struct T_ROW {
        const char* message;
        void (*spoil)(T_MODEL& m);
    };
    const T_ROW rows[] = {
        {"elements[0].material: no name for the key 9",
         [](T_MODEL& m) { m.elements.at(1).material = 9; }},
        {"load_cases[0].nodal[0].load: item [1] is not a finite number",
         [](T_MODEL& m) { m.loadCases.at(1).nodal[0].load[1] = NAN; }},
        {"combinations[1].items[0].case: no name for the key 2",
         [](T_MODEL& m) { m.combinations.at(2).items[0].key = 2; }},
        {"ulf_constraints[0]",
         [](T_MODEL& m) {
             m.ulfConstraints.at(1).upper.reset();
             m.ulfConstraints.at(1).lower.reset();
         }},
    };
    for (const T_ROW& row : rows) {
        T_MODEL_CONTENT content = ParseGood(AllText());
        row.spoil(content.model);
        std::string text;
        T_FILE_ERROR error;
        EXPECT_EQ(0, CCaseFile::Print(content, text, error)) << row.message;
        EXPECT_EQ(0U, error.text.find(row.message)) << error.text;
    }
}

// Every quantity of the structure with its powers of force and length.
TEST(StructCase, UnitsChangeEveryQuantityByItsDimension)
{
    const auto factor = [](const T_UNITS& from, int force, int length) {
        return std::pow(NewtonsPer(from.force), force) * std::pow(MetresPer(from.length), length);
    };
    T_MATL_D matl;
    matl.E = matl.Fy = matl.density = matl.alpha = matl.nu = 1.0;
    matl.G = 1.0;
    T_ELEM_D elem;
    elem.zAxis = {1, 1, 1};
    elem.offset.J = {1, 1, 1};
    T_ELEM_D spring;
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
    for (int i = 0; i < 35; ++i) {
        const T_UNITS u{static_cast<FORCE_UNIT>(i % 7), static_cast<LENGTH_UNIT>(i / 7)};
        const auto f = [&](int force, int length) { return factor(u, force, length); };
        T_MATL_D m = matl;
        RecordToSi(m, u);
        EXPECT_DOUBLE_EQ(f(1, -2), *m.G) << i;
        EXPECT_DOUBLE_EQ(f(1, -4), m.density) << i; // force s2 / length per volume
        EXPECT_EQ(1.0, m.alpha);
        T_ELEM_D e = elem, s = spring;
        RecordToSi(e, u);
        RecordToSi(s, u);
        EXPECT_EQ(1.0, e.zAxis[0]);
        EXPECT_DOUBLE_EQ(f(0, 1), e.offset.J[2]) << i;
        EXPECT_DOUBLE_EQ(f(1, -1), s.stiffness[2]) << i;
        EXPECT_DOUBLE_EQ(f(1, 1), s.stiffness[3]) << i;
        T_STLD_D l = load;
        RecordToSi(l, u);
        EXPECT_EQ(1.0, l.selfWeight[2]);
        EXPECT_DOUBLE_EQ(f(1, 0), l.nodal[0].load[2]);
        EXPECT_DOUBLE_EQ(f(1, 1), l.nodal[0].load[3]);
        EXPECT_DOUBLE_EQ(f(0, 1), l.settlement[0].displacement[2]);
        EXPECT_EQ(1.0, l.settlement[0].displacement[3]);
        EXPECT_EQ(1.0, l.temperature[0].change);
        EXPECT_DOUBLE_EQ(f(1, 0), l.pretension[0].force);
        EXPECT_DOUBLE_EQ(f(1, -1), l.beam[0].w[0]);
        EXPECT_DOUBLE_EQ(f(1, 0), l.beam[1].w[0]);
        EXPECT_DOUBLE_EQ(f(1, 1), l.beam[2].w[0]);
        EXPECT_EQ(0.5, l.beam[2].at[0]);
        const int dims[4][2][2] = {{{1, 0}, {1, 1}},
                                   {{0, 1}, {0, 0}},
                                   {{1, 0}, {1, 0}},
                                   {{1, 0}, {1, 1}}}; // by type, for components 2 and 4
        for (int type = 0; type < 4; ++type) {
            for (int k = 0; k < 2; ++k) {
                T_ULFC_D c{"c", static_cast<ULFC_TYPE>(type), 1, 0, k == 0 ? 2 : 4, true};
                if (type == 2) c.component = 0;
                c.upper = c.lower = 1.0;
                RecordToSi(c, u);
                EXPECT_DOUBLE_EQ(f(dims[type][k][0], dims[type][k][1]), *c.upper) << i << type;
                EXPECT_EQ(*c.upper, *c.lower);
            }
        }
    }
}

TEST(StructCase, AHundredThousandElementsComeBackFromTheModelFile)
{
    T_MODEL_CONTENT c = GridContent(100001, 1);
    c.model.materials[1].name = "S";
    c.model.sections[1].name = "B";
    for (int i = 1; i <= 100000; ++i) {
        T_ELEM_D e{i, 10 * i, 10 * i + 10, 1, 1, 0};
        e.release.I[4] = i % 3 == 0;
        e.offset.J[2] = 0.1 * (i % 7);
        e.kind = i % 5 == 0 ? ELEM_KIND::Truss : ELEM_KIND::Beam;
        c.model.elements.emplace_hint(c.model.elements.end(), i, e);
    }
    const CTempFolder folder;
    const std::string path = folder.File("large.qmdb");
    T_MODEL_CONTENT back;
    T_FILE_ERROR error;
    ASSERT_EQ(1, CModelStore().Save(path, c, error)) << error.text;
    ASSERT_EQ(1, CModelStore().Open(path, OPEN_MODE::ReadOnly, back, error)) << error.text;
    EXPECT_EQ(c.model.elements, back.model.elements);
}

TEST(StructCase, DamageInTheListsOfElementsIsFound)
{
    const CTempFolder folder;
    const std::string path = folder.File("m.qmdb");
    T_FILE_ERROR error;
    ASSERT_EQ(1, CModelStore().Save(path, ParseGood(AllText()), error)) << error.text;
    std::string bytes = BytesOf(path);
    bytes[bytes.find("stiffness") + 20] ^= 1;
    WriteBytes(path, bytes);
    T_MODEL_CONTENT none;
    EXPECT_EQ(0, CModelStore().Open(path, OPEN_MODE::ReadOnly, none, error));
    EXPECT_EQ(FILE_FAULT::BadInput, error.fault);
}
