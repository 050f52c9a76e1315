// Structure, loads and combinations in a document: undo, protection of what is used, flattening.
#include "qm_db/dbdoc.h"

#include <gtest/gtest.h>
#include <limits>

namespace {

/// Nodes 1, 2, 3; a beam and a truss; two load cases, two combinations, one item.
T_MODEL_CONTENT Used()
{
    T_MODEL_CONTENT c;
    T_MODEL& m = c.model;
    for (const int id : {1, 2, 3, 4, 5})
        m.nodes[id] = {id, {1.0 * id, 0, 0}, {}, {}};
    m.materials[1].name = "S";
    m.materials[2].name = "spare";
    m.sections[1].name = "B";
    m.elements[1] = {1, 1, 2, 1, 1, 0};
    m.elements[2] = {2, 2, 3, 1, 1, 0};
    m.elements[9] = {9, 1, 3, 0, 0, 0};
    m.loadCases[1].name = "G";
    m.loadCases[1].nodal = {{3, {}}};
    m.loadCases[1].beam = {{1}};
    m.loadCases[2].name = "S";
    m.loadCases[2].settlement = {{4, {}}};
    m.loadCases[2].pretension = {{2, 1.0}};
    m.loadCases[3].name = "free";
    m.combinations[1] = {"C1", {{false, 1, 1.5}, {true, 2, 0.5}}};
    m.combinations[2] = {"C2", {{false, 2, 2.0}, {false, 1, -1.0}}};
    m.diaphragms[1] = {{4, 5}, 2};
    m.equalDisplacements[3] = {{1, 5}, {true}};
    m.ulfItems[1] = {"T", 1, 0, 1, false, {{2, 1.0}}, {}};
    m.stages[1] = {"S1", {{2}, {4}, {{2, 1}}}, {}, 1, 0.0};
    m.stages[2] = {"S2", {}, {{9}, {}, {}}, 1, 0.0};
    m.pushovers[1].name = "PX";
    m.pushovers[1].patterns = {{0, 3, 1.0}, {1, 2, 1.0}}; // a load case, a direction
    m.ulfConstraints[1].name = "mid";
    m.ulfConstraints[1].stage = 2;
    m.ulfStageItems[1] = {"tune", {{1, 1, 2, false, 1.0, 1.0, false, 0}}, 0, 0, false, {}};
    return c;
}

template <class T>
std::string UsersAsText(CDBDoc& doc, int key)
{
    T_RECORD_USERS users;
    EXPECT_EQ(1, doc.Edit().Begin("erase"));
    const int done = doc.Edit().Erase<T>(key, users);
    doc.Edit().Rollback();
    EXPECT_EQ(done == 1, users.empty());
    std::string text;
    for (const T_RECORD_USER& user : users)
        text += (text.empty() ? "" : ", ") + DescribeUser(doc.Data().Model(), user);
    return text;
}

T_LCOM_D Flat(CDBDoc& doc, const T_LCOM_D& in)
{
    T_LCOM_D out;
    std::string error;
    EXPECT_EQ(1, doc.Attr().NormalizeLcom(in, out, error)) << error;
    return out;
}

} // namespace

TEST(LoadEdit, RecordsAreFoundByTheirNames)
{
    CDBDoc doc;
    doc.Data().Assign(Used());
    CAttrCtrl& attr = doc.Attr();
    T_LCOM_D combination;
    T_ULFC_D constraint;
    EXPECT_TRUE(attr.GetLcom_("C2", combination) && attr.GetUlfc_("mid", constraint));
    EXPECT_EQ("C2mid", combination.name + constraint.name);
    EXPECT_FALSE(attr.GetLcom_("mid", combination) || attr.GetUlfc_("C2", constraint));
    EXPECT_TRUE(attr.ExistLcom("C1") && !attr.ExistLcom("c1"));
    int load = 0, key = 0, item = 0;
    EXPECT_TRUE(attr.FindStld("S", load) && attr.GetLcomKey("C2", key) && attr.FindUlfi("T", item));
    EXPECT_EQ((std::array{2, 2, 1}), (std::array{load, key, item}));
    EXPECT_EQ(0, attr.FindStld("C1", key));
}

TEST(LoadEdit, WhatIsUsedIsNotErasedAndItsUsersAreNamed)
{
    CDBDoc doc;
    doc.Data().Assign(Used());
    const T_MODEL before = doc.Data().Model();
    EXPECT_EQ("element 1, element 9, equal displacements 3", UsersAsText<T_NODE_D>(doc, 1));
    EXPECT_EQ("element 2, element 9, load case \"G\"", UsersAsText<T_NODE_D>(doc, 3));
    EXPECT_EQ("diaphragm 1, load case \"S\", construction stage \"S1\"",
              UsersAsText<T_NODE_D>(doc, 4));
    EXPECT_EQ("load case \"S\", construction stage \"S1\"", UsersAsText<T_ELEM_D>(doc, 2));
    EXPECT_EQ("construction stage \"S2\"", UsersAsText<T_ELEM_D>(doc, 9));
    EXPECT_EQ("element 1, element 2", UsersAsText<T_MATL_D>(doc, 1));
    EXPECT_EQ("", UsersAsText<T_MATL_D>(doc, 2));
    EXPECT_EQ("element 1, element 2", UsersAsText<T_SECT_D>(doc, 1));
    EXPECT_EQ("combination \"C1\", combination \"C2\"", UsersAsText<T_STLD_D>(doc, 1));
    EXPECT_EQ("combination \"C2\", unknown load factor item \"T\", construction stage \"S1\", "
              "unknown load factor item \"tune\" of construction stages",
              UsersAsText<T_STLD_D>(doc, 2));
    EXPECT_EQ("pushover load case \"PX\"", UsersAsText<T_STLD_D>(doc, 3));
    EXPECT_EQ("combination \"C1\"", UsersAsText<T_LCOM_D>(doc, 2));
    EXPECT_EQ("unknown load factor item \"T\"", UsersAsText<T_LCOM_D>(doc, 1));
    EXPECT_EQ("unknown load factor item \"tune\" of construction stages",
              UsersAsText<T_STAG_D>(doc, 1));
    EXPECT_EQ("constraint \"mid\" of unknown load factors", UsersAsText<T_STAG_D>(doc, 2));
    EXPECT_EQ(before, doc.Data().Model());
    EXPECT_FALSE(doc.Undo().CanUndo());
}

TEST(LoadEdit, WhatARecordDoesNotUseIsDroppedWhenItIsPut)
{
    CDBDoc doc;
    ASSERT_EQ(1, doc.Edit().Begin("put"));
    T_ELEM_D e{1, 2, 3, 4, 5, 6};
    e.zAxis = {1, 0, 0};
    e.release.I[0] = true;
    e.offset.J[1] = 1.0;
    e.stiffness[0] = 1.0;
    for (int kind = 0; kind < 4; ++kind) {
        e.id = kind + 1;
        e.kind = static_cast<ELEM_KIND>(kind);
        ASSERT_EQ(1, doc.Edit().Put(e.id, e));
    }
    const auto& elements = doc.Data().Model().elements;
    EXPECT_EQ(0.0, elements.at(1).stiffness[0]);
    EXPECT_TRUE(elements.at(1).release.I[0] && elements.at(1).section == 4);
    EXPECT_FALSE(elements.at(2).release.I[0]);
    EXPECT_EQ(5, elements.at(2).material);
    EXPECT_EQ(0, elements.at(3).material + elements.at(3).section);
    EXPECT_EQ(3, elements.at(3).nodeJ);
    EXPECT_EQ(0, elements.at(4).nodeJ);
    EXPECT_GT(elements.at(4).stiffness[0], 0.0);

    T_ULFC_D c{"c", ULFC_TYPE::Truss, 1, 3, 4, true, false, 5.0, 6, 7.0, 8.0};
    ASSERT_EQ(1, doc.Edit().Put(1, c));
    EXPECT_EQ((T_ULFC_D{"c", ULFC_TYPE::Truss, 1, 0, 0, true, true, 0.0, 0, 7000.0, 8000.0}),
              doc.Data().Model().ulfConstraints.at(1));
    c.inequality = false;
    ASSERT_EQ(1, doc.Edit().Put(1, c));
    EXPECT_EQ((T_ULFC_D{"c", ULFC_TYPE::Truss, 1, 0, 0, false, false, 0.0, 6}),
              doc.Data().Model().ulfConstraints.at(1));
}

TEST(LoadEdit, CombinationsAreFlattenedInOrderOfFirstAppearance)
{
    CDBDoc doc;
    doc.Data().Assign(Used());
    // 1.5 G + 0.5 (2 S - G) = G + S
    EXPECT_EQ((T_LCOM_D{"C1", {{false, 1, 1.0}, {false, 2, 1.0}}}),
              Flat(doc, doc.Data().Model().combinations.at(1)));
    // 2 (2 S - G) + 3 free + G = 4 S - G + 3 free
    const T_LCOM_D nested{"x", {{true, 2, 2.0}, {false, 3, 3.0}, {false, 1, 1.0}}};
    EXPECT_EQ((T_LCOM_D{"x", {{false, 2, 4.0}, {false, 1, -1.0}, {false, 3, 3.0}}}),
              Flat(doc, nested));
    T_LCOM_D same = nested;
    ASSERT_EQ(1, doc.Attr().NormalizeLcom(same, same));
    EXPECT_EQ(Flat(doc, nested), same);
    EXPECT_TRUE(Flat(doc, {"none", {}}).items.empty());
}

// Each level names the one below twice: 2^40 paths, 40 combinations.
TEST(LoadEdit, FlatteningDoesNotWalkEveryPath)
{
    T_MODEL_CONTENT c = Used();
    c.model.combinations[101] = {"1", {{false, 1, 1.0}}};
    for (int level = 2; level <= 40; ++level)
        c.model.combinations[100 + level] = {std::to_string(level),
                                             {{true, 99 + level, 1.0}, {true, 99 + level, 1.0}}};
    CDBDoc doc;
    doc.Data().Assign(c);
    const T_LCOM_D flat = Flat(doc, c.model.combinations.at(140));
    EXPECT_EQ((std::vector<T_LCOM_ITEM>{{false, 1, 549755813888.0}}), flat.items); // 2^39
}

TEST(LoadEdit, FlatteningRefusesCyclesAndWhatIsMissing)
{
    T_MODEL_CONTENT c = Used();
    c.model.combinations[3] = {"own", {{true, 3, 1.0}}};
    c.model.combinations[4] = {"A", {{true, 5, 1.0}}};
    c.model.combinations[5] = {"B", {{true, 6, 1.0}}};
    c.model.combinations[6] = {"C", {{true, 4, 1.0}}};
    CDBDoc doc;
    doc.Data().Assign(c);
    const struct {
        T_LCOM_D in;
        const char* error;
    } rows[] = {
        {{"x", {{true, 3, 1.0}}}, "Combination \"own\" contains itself."},
        {c.model.combinations.at(4), "Combination \"B\" contains itself."},
        {{"x", {{false, 7, 1.0}}},
         "Combination \"x\" refers to load case 7, which does not exist."},
        {{"x", {{true, 7, 1.0}}},
         "Combination \"x\" refers to combination 7, which does not exist."},
        {{"x", {{false, 1, 1e308}, {false, 1, 1e308}}},
         "A factor of combination \"x\" is not a finite number."},
    };
    for (const auto& row : rows) {
        T_LCOM_D out{"before", {}};
        std::string error;
        EXPECT_EQ(0, doc.Attr().NormalizeLcom(row.in, out, error));
        EXPECT_EQ(row.error, error);
        EXPECT_EQ("before", out.name);
    }
}

TEST(LoadEdit, AddLcomIsAStepOfItsOwnOrPartOfTheOpenOne)
{
    CDBDoc doc;
    doc.Data().Assign(Used());
    EXPECT_EQ(0, doc.Data().AddLcom({"", {}}));
    EXPECT_EQ(0, doc.Data().AddLcom({"C1", {}}));
    EXPECT_EQ(0, doc.Data().AddLcom({"x", {{false, 8, 1.0}}}));
    EXPECT_EQ(0, doc.Data().AddLcom({"x", {{true, 3, 1.0}}})); // its own key to be
    ASSERT_EQ(1, doc.Edit().Begin("cycle"));
    EXPECT_EQ(0, doc.Edit().Put(2, T_LCOM_D{"C2", {{true, 1, 1.0}}})); // C1 has C2
    doc.Edit().Rollback();
    EXPECT_FALSE(doc.Undo().CanUndo());

    EXPECT_NE(0, doc.Data().AddLcom({"new", {{false, 1, 2.0}}}));
    EXPECT_EQ("new", doc.Undo().UndoTitle());
    ASSERT_EQ(1, doc.Edit().Begin("two"));
    EXPECT_NE(0, doc.Data().AddLcom({"a", {}}));
    EXPECT_NE(0, doc.Data().AddLcom({"b", {{true, 4, 1.0}}}));
    ASSERT_EQ(1, doc.Edit().Commit());
    EXPECT_EQ(5U, doc.Data().Model().combinations.size());
    ASSERT_EQ(1, doc.Undo().Undo());
    EXPECT_EQ(3U, doc.Data().Model().combinations.size());
    ASSERT_EQ(1, doc.Undo().Undo());
    EXPECT_EQ(Used().model, doc.Data().Model());
}
