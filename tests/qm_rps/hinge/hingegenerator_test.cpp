// Hinges generated for elements, their list, and what an element lacks.
#include "hingesample.h"
#include "qm_rps/hinge/hingegenerator.h"
#include "qm_rps/hinge/hingetable.h"
#include "qm_rps/pushoverhingedatatype.h"
#include "qm_rps/pushoverhingelistdlg.h"

#include <gtest/gtest.h>

namespace {

/// Elements 1 to 6 (kN, m): 1 sound, 2 without section, 3 without material, 4 concrete without
/// bars, 5 masonry, 6 of a member with a node that is gone. Types 1 automatic My and entered
/// trilinear Fz, 2 the same for walls, 3 automatic Mx.
void Fill(CDBDoc& doc)
{
    T_SECT_D i, plain;
    i.area = 2, i.Asy = i.Asz = 1, i.J = i.Iyy = i.Izz = 1, i.Zy = 3, i.Zz = 4;
    plain.shape = SECT_SHAPE::Rectangle, plain.size = {0.4, 0.3};
    T_MATL_D steel, concrete, masonry;
    steel.Fy = 100;
    concrete.type = MATL_CLASS::Concrete;
    concrete.fck = 25000, concrete.fyk = 450000, concrete.Es = 2e8;
    masonry.type = MATL_CLASS::Masonry, masonry.fck = 3000;
    T_PHGT_D type;
    type.name = "column";
    T_SKEL_FEMA f = ValidBackbone<T_SKEL_FEMA>();
    f.autoYield = true;
    type.components[4] = ComponentWith(SKEL_TYPE::Fema, f);
    T_SKEL_MULTI m;
    m.autoYield = m.symmetric = false;
    m.sides.pos.P1 = 5, m.sides.pos.P2 = 8, m.sides.neg.P1 = 4, m.sides.neg.P2 = 7;
    type.components[2] = ComponentWith(SKEL_TYPE::Trilinear, m);
    T_PHGT_D wall = type, torsion = type;
    wall.name = "wall", wall.element = HINGE_ELEMENT::Wall;
    torsion.name = "torsion", std::swap(torsion.components[3], torsion.components[4]);

    T_STYP_D styp;
    styp.units = {FORCE_UNIT::kN, LENGTH_UNIT::m};
    auto& edit = doc.Edit();
    ASSERT_EQ(1, edit.Begin("model"));
    ASSERT_EQ(1, edit.PutStyp(styp));
    EXPECT_EQ(2, edit.Put(1, T_NODE_D{1, {0, 0, 0}}) + edit.Put(2, T_NODE_D{2, {0, 0, 3}}));
    EXPECT_EQ(2, edit.Put(1, i) + edit.Put(2, plain));
    EXPECT_EQ(3, edit.Put(1, steel) + edit.Put(2, concrete) + edit.Put(3, masonry));
    const T_ELEM_D elements[] = {{1, 1, 2, 1, 1}, {2, 1, 2, 0, 1}, {3, 1, 2, 1, 0},
                                 {4, 1, 2, 2, 2}, {5, 1, 2, 2, 3}, {6, 1, 9, 1, 1}};
    for (const T_ELEM_D& e : elements)
        EXPECT_EQ(1, edit.Put(e.id, e));
    EXPECT_EQ(3, edit.Put(1, type) + edit.Put(2, wall) + edit.Put(3, torsion));
    ASSERT_EQ(1, edit.Commit());
}

T_SIDES<double> Yield(CDBDoc& doc, int hinge, std::size_t component)
{
    T_PHGE_D h;
    EXPECT_EQ(1, doc.Attr().GetPhge(hinge, h));
    return h.yield[component];
}

} // namespace

TEST(HingeGenerator, GivesElementsTheirStrengthsAsOneEdit)
{
    CDBDoc doc;
    Fill(doc);
    const T_MODEL before = doc.Data().Model();
    T_HINGE_REFUSAL refusal;
    ASSERT_EQ(1, CHingeGenerator(doc).Generate(1, {1, 1}, refusal)) << refusal.text;
    ASSERT_EQ(1u, doc.Data().Model().hinges.size());
    EXPECT_NEAR(300, Yield(doc, 1, 4).neg, 1e-9); // Zy fy
    EXPECT_EQ((T_SIDES<double>{8, 7}), Yield(doc, 1, 2));
    T_PHGE_D hinge;
    ASSERT_EQ(1, doc.Attr().GetPhge(1, hinge));
    EXPECT_EQ((T_SIDES<double>{5, 4}), hinge.crack[2]);

    const CPushOverHingeListDlg list(doc);
    EXPECT_EQ("1 : column", list.Rows(true)[0].type);
    EXPECT_EQ((T_SIDES<double>{5, 4}), list.Rows(true)[0].strengths[2]);
    EXPECT_EQ((T_SIDES<double>{8, 7}), list.Rows(false)[0].strengths[2]);

    // Another hinge of the element goes when it is generated again, the first keeps its key.
    ASSERT_EQ(1, doc.Edit().Begin("second"));
    for (const auto& [key, element] : {std::pair(5, 1), std::pair(6, 4), std::pair(7, 4)})
        ASSERT_EQ(1, doc.Edit().Put(key, T_PHGE_D{element, 9, {}, {}}));
    ASSERT_EQ(1, doc.Edit().Commit());
    EXPECT_EQ("9 : Error", list.Rows(false)[1].type);
    ASSERT_EQ(1, CHingeGenerator(doc).Generate(1, {1}, refusal));
    EXPECT_EQ(3u, doc.Data().Model().hinges.size()); // 1, and both of element 4
    EXPECT_FALSE(doc.Data().Model().hinges.contains(5));
    for (int step = 0; step < 3; ++step)
        ASSERT_EQ(1, doc.Undo().Undo());
    EXPECT_EQ(before, doc.Data().Model());
}

TEST(HingeGenerator, RefusesTheFirstElementThatLacksSomething)
{
    CDBDoc doc;
    Fill(doc);
    const T_MODEL before = doc.Data().Model();
    const struct {
        int type, element;
        const char* key;
    } rows[] = {
        {1, 7, "IDS_CMD_IEHP_NO_ELEM"}, {1, 2, "IDS_CMD_IEHP_NO_SECT"},
        {1, 3, "IDS_CMD_IEHP_NO_MATL"}, {1, 4, "IDS_CMD_IEHP_NO_RBAR"},
        {1, 5, "IDS_QM_SECT_CLASS"},    {1, 6, "IDS_CMD_IEHP_NO_MEMB"},
        {2, 1, "IDS_CMD_IEHP_NO_WALL"}, {3, 1, "IDS_QM_HINGE_NO_METHOD"},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.key);
        T_HINGE_REFUSAL refusal;
        EXPECT_EQ(0, CHingeGenerator(doc).Generate(row.type, {1, row.element}, refusal));
        EXPECT_EQ(row.key, refusal.key);
        EXPECT_EQ(row.element, refusal.element);
        EXPECT_EQ(before, doc.Data().Model());
    }
    T_HINGE_REFUSAL refusal;
    EXPECT_EQ(0, CHingeGenerator(doc).Generate(8, {1}, refusal));
    EXPECT_EQ("IDS_PUSHOVER_No_selected_Hinge_Data_Type__nChoose_o", refusal.key);
    EXPECT_EQ(0, CHingeGenerator(doc).Generate(1, {}, refusal));
    EXPECT_EQ(before, doc.Data().Model());
}

TEST(HingeGenerator, NamesTheElementsOnWhichStrengthsFail)
{
    CDBDoc doc;
    Fill(doc);
    ASSERT_EQ(1, doc.Edit().Begin("hinges"));
    for (int e = 1; e <= 5; ++e)
        ASSERT_EQ(1, doc.Edit().Put(e, T_PHGE_D{e, 1, {}, {}}));
    ASSERT_EQ(1, doc.Edit().Commit());
    const auto found = CHingeGenerator(doc).ElementFindings(1);
    ASSERT_EQ(4u, found.size());
    EXPECT_EQ("element 2", found[0].field);
    EXPECT_EQ("IDS_CMD_IEHP_NO_RBAR", found[2].ruleText);
    EXPECT_TRUE(CHingeGenerator(doc).ElementFindings(2).empty());
}

TEST(HingeDataType, ChecksTheDiagramBeforeTheCriteria)
{
    constexpr const char* kDiagram = "IDS_PUSHOVER_Wrong_Data_in_the_Hinge_Diagram_Table_";
    constexpr const char* kCriteria = "IDS_PUSHOVER_Wrong_Data_in_Acceptance_Criteria_";
    CDBDoc doc;
    T_PHGT_D type;
    type.components[4] = ComponentWith(SKEL_TYPE::Fema, ValidBackbone<T_SKEL_FEMA>());
    ASSERT_EQ(1, StoreHingeType(doc, 3, type));
    using DLG = CPushOverHingeDataType;
    const struct {
        int key;
        void (*edit)(DLG&);
        const char* message; // empty: stored
    } kCases[] = {
        {0, [](DLG&) {}, "IDS_PUSHOVER_No_selected_Hinge_Data_Type__nChoose_o"},
        {4, [](DLG&) {}, "IDS_PUSHOVER_Hinge_Data_Type_key__d_does_not_exits_"},
        {3, [](DLG& d) { d.Point(6)->deform = 6.001, *d.Criterion(1, true) = 7; }, kDiagram},
        {3, [](DLG& d) { d.Point(0)->deform = -4.99; }, kDiagram}, // -E inside -D
        {3, [](DLG& d) { *d.Criterion(1, true) = 6; }, ""},        // LS = CP
        {3, [](DLG& d) { *d.Criterion(1, true) = 6.001; }, kCriteria},
        {3, [](DLG& d) { *d.Criterion(0, false) = -3.001; }, kCriteria},
        {3, [](DLG& d) { d.Point(6)->strength = 1.3; }, ""},
    };
    const auto stored = [&] { return doc.Data().Model().hingeTypes.at(3); };
    for (const auto& c : kCases) {
        SCOPED_TRACE(&c - kCases);
        DLG dlg(doc);
        const T_PHGT_D before = stored();
        const bool opened = dlg.Data2Dlg(c.key, HINGE_COMPONENT::My);
        if (opened) c.edit(dlg);
        EXPECT_EQ(!*c.message, opened && dlg.OnOK());
        EXPECT_EQ(!*c.message, before != stored());
        EXPECT_EQ(c.message, dlg.Messages().empty() ? "" : dlg.Messages().back().key);
    }
    EXPECT_EQ(1.3, std::get<T_SKEL_FEMA>(stored().components[4].curves.J).sides.pos.C.strength);
}
