// Hinges generated for elements, their list, and what an element lacks.
#include "hingesample.h"
#include "qm_rps/hinge/hingegenerator.h"
#include "qm_rps/hinge/hingetable.h"
#include "qm_rps/pushoverhingedatatype.h"
#include "qm_rps/pushoverhingelistdlg.h"

#include <gtest/gtest.h>

namespace {

/// Elements (kN, m): 1 sound, 2 without section, 3 without material, 4 concrete without bars,
/// 5 masonry, 6 of a member with a node that is gone, 7 a link, 8 a point spring. Types 1 automatic
/// My and entered trilinear Fz, 2 the same for walls, 3 automatic Mx, 4 and 5 automatic My of
/// concrete and masonry, 6 and 7 entered Fx of a link and a spring, 8 automatic Fx of a link, 9
/// with a mistake.
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

    const auto my = [&](MATL_CLASS material) {
        T_PHGT_D t;
        t.name = "my", t.material = material, t.components[4] = type.components[4];
        return t;
    };
    T_SKEL_MULTI axial;
    axial.sides.pos.P1 = axial.sides.neg.P1 = 50;
    T_PHGT_D link = my(MATL_CLASS::Steel), spring, automatic, wrong = type;
    link.element = HINGE_ELEMENT::GeneralLink, link.components = {};
    automatic = link;
    automatic.components[0] = ComponentWith(SKEL_TYPE::Bilinear, axial);
    axial.autoYield = false;
    link.components[0] = ComponentWith(SKEL_TYPE::Bilinear, axial);
    spring = link, spring.element = HINGE_ELEMENT::PointSpring;
    std::get<T_SKEL_FEMA>(wrong.components[4].curves.I).sides.pos.C.deform = 0.5;

    T_STYP_D styp;
    styp.units = {FORCE_UNIT::kN, LENGTH_UNIT::m};
    auto& edit = doc.Edit();
    ASSERT_EQ(1, edit.Begin("model"));
    ASSERT_EQ(1, edit.PutStyp(styp));
    EXPECT_EQ(2, edit.Put(1, T_NODE_D{1, {0, 0, 0}}) + edit.Put(2, T_NODE_D{2, {0, 0, 3}}));
    EXPECT_EQ(2, edit.Put(1, i) + edit.Put(2, plain));
    EXPECT_EQ(3, edit.Put(1, steel) + edit.Put(2, concrete) + edit.Put(3, masonry));
    T_ELEM_D elements[] = {{1, 1, 2, 1, 1}, {2, 1, 2, 0, 1}, {3, 1, 2, 1, 0}, {4, 1, 2, 2, 2},
                           {5, 1, 2, 2, 3}, {6, 1, 9, 1, 1}, {7, 1, 2, 0, 0}, {8, 1, 0, 0, 0}};
    elements[6].kind = ELEM_KIND::Link, elements[7].kind = ELEM_KIND::Spring;
    for (const T_ELEM_D& e : elements)
        EXPECT_EQ(1, edit.Put(e.id, e));
    int key = 0;
    for (const T_PHGT_D& t : {type, wall, torsion, my(MATL_CLASS::Concrete),
                              my(MATL_CLASS::Masonry), link, spring, automatic, wrong})
        EXPECT_EQ(1, edit.Put(++key, t));
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
        ASSERT_EQ(1, doc.Edit().Put(key, T_PHGE_D{element, 99, {}, {}}));
    ASSERT_EQ(1, doc.Edit().Commit());
    EXPECT_EQ("99 : Error", list.Rows(false)[1].type);
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
        {1, 9, "IDS_CMD_IEHP_NO_ELEM"},     {1, 2, "IDS_CMD_IEHP_NO_SECT"},
        {1, 3, "IDS_CMD_IEHP_NO_MATL"},     {4, 4, "IDS_CMD_IEHP_NO_RBAR"},
        {5, 5, "IDS_QM_SECT_CLASS"},        {1, 6, "IDS_CMD_IEHP_NO_MEMB"},
        {2, 1, "IDS_CMD_IEHP_NO_WALL"},     {3, 1, "IDS_QM_HINGE_NO_METHOD"},
        {1, 4, "IDS_QM_HINGE_WRONG_CLASS"}, {1, 7, "IDS_QM_HINGE_WRONG_KIND"},
        {6, 1, "IDS_QM_HINGE_WRONG_KIND"},  {6, 8, "IDS_QM_HINGE_WRONG_KIND"},
        {8, 7, "IDS_QM_HINGE_NO_METHOD"},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.key);
        T_HINGE_REFUSAL refusal;
        EXPECT_EQ(0, CHingeGenerator(doc).Generate(row.type, {row.element}, refusal));
        EXPECT_EQ(row.key, refusal.key);
        EXPECT_EQ(row.element, refusal.element);
        EXPECT_EQ(before, doc.Data().Model());
    }
    T_HINGE_REFUSAL refusal;
    EXPECT_EQ(0, CHingeGenerator(doc).Generate(9, {1}, refusal)); // C before B
    EXPECT_EQ(kHingeRuleMessage, refusal.key);
    EXPECT_EQ(0, CHingeGenerator(doc).Generate(10, {1}, refusal));
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
    EXPECT_EQ("IDS_QM_HINGE_WRONG_CLASS", found[2].ruleText);
    EXPECT_TRUE(CHingeGenerator(doc).ElementFindings(2).empty());
}

TEST(HingeGenerator, TakesLinksAndSpringsWithoutASection)
{
    CDBDoc doc;
    Fill(doc);
    T_HINGE_REFUSAL refusal;
    ASSERT_EQ(1, CHingeGenerator(doc).Generate(6, {7}, refusal)) << refusal.text;
    ASSERT_EQ(1, CHingeGenerator(doc).Generate(7, {8}, refusal)) << refusal.text;
    EXPECT_EQ((T_SIDES<double>{50, 50}), Yield(doc, 1, 0));
    EXPECT_EQ((T_SIDES<double>{50, 50}), Yield(doc, 2, 0));
}

TEST(HingeGenerator, KeepsTheStrengthsOfTheJEnd)
{
    CDBDoc doc;
    Fill(doc);
    T_PHGT_D type;
    ASSERT_EQ(1, doc.Attr().GetPhgt(1, type));
    T_HINGE_COMPONENT& fz = type.components[2]; // trilinear, 5 8 and 4 7
    fz.sameEnds = false;
    std::get<T_SKEL_MULTI>(fz.curves.J).sides.pos = {2, 3};
    type.components[4].location = HINGE_LOCATION::IEnd;
    ASSERT_EQ(1, StoreHingeType(doc, 1, type));
    T_HINGE_REFUSAL refusal;
    ASSERT_EQ(1, CHingeGenerator(doc).Generate(1, {1}, refusal)) << refusal.text;
    const CPushOverHingeListDlg list(doc);
    const auto yield = list.Rows(false), crack = list.Rows(true);
    ASSERT_EQ(2u, yield.size());
    EXPECT_EQ("1 : column, J-end", yield[1].type);
    EXPECT_EQ((T_SIDES<double>{8, 7}), yield[0].strengths[2]);
    EXPECT_EQ((T_SIDES<double>{3, 7}), yield[1].strengths[2]);
    EXPECT_EQ((T_SIDES<double>{2, 4}), crack[1].strengths[2]);
    EXPECT_NEAR(300, yield[0].strengths[4].pos, 1e-9);
    EXPECT_EQ(0.0, yield[1].strengths[4].pos); // My is hinged at the I-end alone
}

TEST(HingeGenerator, TellsStrengthsThatTheSectionNoLongerGives)
{
    CDBDoc doc;
    Fill(doc);
    T_HINGE_REFUSAL refusal;
    ASSERT_EQ(1, CHingeGenerator(doc).Generate(1, {1}, refusal));
    EXPECT_TRUE(CHingeGenerator(doc).ElementFindings(1).empty());
    T_SECT_D section;
    ASSERT_EQ(1, doc.Attr().GetSect(1, section));
    section.Zy = 2.8; // m3, fy 100 kN/m2
    ASSERT_EQ(1, doc.Edit().Begin("section") && doc.Edit().Put(1, section) && doc.Edit().Commit());
    const auto found = CHingeGenerator(doc).ElementFindings(1);
    ASSERT_EQ(1u, found.size());
    EXPECT_EQ("IDS_QM_HINGE_STALE", found[0].messageKey);
    EXPECT_EQ("My(+) 300, now 280; My(-) 300, now 280",
              CPushOverHingeListDlg(doc).Rows(false)[0].stale);
    // Where the axial force of its strengths is gone, the reason stands within the sentence.
    T_PHGE_D hinge;
    ASSERT_EQ(1, doc.Attr().GetPhge(1, hinge));
    hinge.axialCase = 7;
    ASSERT_EQ(1, doc.Edit().Begin("case") && doc.Edit().Put(1, hinge) && doc.Edit().Commit());
    const auto lost = CHingeGenerator(doc).ElementFindings(1);
    ASSERT_FALSE(lost.empty());
    EXPECT_EQ(std::string::npos, lost.back().text.find(".."));
    EXPECT_NE(std::string::npos, lost.back().text.find("not known")) << lost.back().text;
    // A hinge that is assigned, but has no strengths yet, is not stale.
    ASSERT_EQ(1,
              doc.Edit().Begin("bare") && doc.Edit().Put(1, T_PHGE_D{1, 1}) && doc.Edit().Commit());
    EXPECT_TRUE(CHingeGenerator(doc).ElementFindings(1).empty());
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
