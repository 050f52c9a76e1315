// What the hinge type editor offers and what its buttons do.
#include "hingesample.h"
#include "qm_rps/po_hingeskcvtabdlg.h"
#include "qm_rps/po_hingetypedlg.h"
#include "scriptview.h"

#include <gtest/gtest.h>

namespace {

using C = HINGE_COMPONENT;

T_HINGE_CONTEXT Context()
{
    T_SECT_D values, wall, circle;
    values.name = "values";
    values.area = 6, values.Asy = 5, values.Asz = 4, values.J = 3, values.Iyy = 2, values.Izz = 7;
    values.factorsI.Iyy = 0.5;
    wall.name = "wall", wall.shape = SECT_SHAPE::Rectangle, wall.size = {3, 0.25};
    circle.name = "round", circle.shape = SECT_SHAPE::Circle, circle.size = {1};
    T_MATL_D m;
    m.E = 260, m.nu = 0.3; // G = 100
    T_HINGE_CONTEXT x;
    x.sources =
        std::make_shared<CHingeSources>(T_TABLE<T_SECT_D>{{1, values}, {4, wall}, {7, circle}},
                                        T_TABLE<T_MATL_D>{{1, m}}, T_UNITS());
    return x;
}

std::string Keys(const CPO_HingeTypeDlg::T_REF_LIST& list)
{
    std::string text;
    for (const auto& entry : list)
        text += entry.text + ";";
    return text;
}

/// "s" shown, "e" enabled as well.
std::string ModeOf(const T_PHGT_D& type)
{
    CPO_HingeTypeDlg dlg(Context());
    dlg.Data2Dlg(type);
    std::string text;
    for (const auto& part : dlg.CustomizeDlgByMode())
        text += part.enabled ? 'e' : part.shown ? 's' : '-';
    return text;
}

} // namespace

TEST(HingeTypeLists, OfferSectionsByTheirShape)
{
    CPO_HingeTypeDlg dlg(Context());
    EXPECT_EQ("4 : wall;7 : round;", Keys(dlg.InitFiberCombo_Fibr()));
    EXPECT_EQ("4 : wall;", Keys(dlg.InitFiberCombo_Fibw()));
    EXPECT_EQ("4 : 0.25;", Keys(dlg.InitPropCombo_Thik()));
    EXPECT_EQ("1 : ;", Keys(dlg.InitPropCombo_Matl())); // steel, as the type
    dlg.OnSelChangeMaterial(MATL_CLASS::Concrete);
    EXPECT_EQ("", Keys(dlg.InitPropCombo_Matl()));
    dlg.Edited().sectionMaterial = 1; // what is chosen stays on the list
    EXPECT_EQ("1 : ;", Keys(dlg.InitPropCombo_Matl()));
    EXPECT_EQ("1 : values;4 : wall;7 : round;", Keys(dlg.InitPropCombo_Sect()));
    dlg.OnSelChangeElement(HINGE_ELEMENT::Wall);
    EXPECT_EQ("4 : wall;", Keys(dlg.InitPropCombo_Sect()));
    dlg.OnUpdate({}); // the document lost its sections
    EXPECT_EQ("", Keys(dlg.InitPropCombo_Sect()));
}

// Order: interaction, yield surface, user interaction, section, thickness, fibres of frames and of
// walls, integration points, hinge length, location, masonry, infill strut.
TEST(HingeTypeMode, FollowsElementDefinitionAndInteraction)
{
    T_PHGT_D t;
    EXPECT_EQ("ssse----se--", ModeOf(t));
    t.components[4].active = true;
    t.interaction = HINGE_INTERACTION::PMM;
    EXPECT_EQ("eese----se--", ModeOf(t));
    t.interaction = HINGE_INTERACTION::User;
    t.material = MATL_CLASS::Masonry;
    EXPECT_EQ("esee----see-", ModeOf(t));
    t.element = HINGE_ELEMENT::Wall;
    t.definition = HINGE_DEFINITION::CurvatureDistributed;
    EXPECT_EQ("eseee-eesee-", ModeOf(t));
    t.element = HINGE_ELEMENT::Truss;
    EXPECT_EQ("---e-e-----s", ModeOf(t));
    t.components[0].active = true; // the FEMA curve alone is offered there
    EXPECT_EQ("---e-e-----e", ModeOf(t));
    t.element = HINGE_ELEMENT::PointSpring;
    EXPECT_EQ("------------", ModeOf(t));
    EXPECT_FALSE(HasComponent(HINGE_ELEMENT::Truss, C::My));
}

// By hand: E = 260, G = 100, L = 2; A = 6, Asy = 5, Asz = 4, J = 3, Iyy = 2 (0.5 at I), Izz = 7.
TEST(HingeTypeInteraction, MyAndMzHaveTheirOwnAndShearItsPair)
{
    using I = HINGE_INTERACTION;
    CPO_HingeTypeDlg dlg(Context());
    T_PHGT_D type;
    type.interaction = I::PMM;
    dlg.Data2Dlg(type);
    const auto both = [&dlg] {
        return std::pair(InteractionOf(dlg.Type(), C::My), InteractionOf(dlg.Type(), C::Mz));
    };
    EXPECT_EQ(std::pair(I::PMM, I::PMM), both());
    EXPECT_EQ(1, dlg.OnSelChangeInteraction(C::My, 0)); // Mz stays
    EXPECT_EQ(std::pair(I::P, I::PMM), both());
    EXPECT_EQ(1, dlg.OnSelChangeInteraction(C::Mz, 3));
    EXPECT_EQ(std::pair(I::P, I::User), both());
    EXPECT_EQ(1, dlg.OnSelChangeInteraction(C::Mz, 0));
    EXPECT_EQ(std::nullopt, dlg.Type().interactionMz) << "as My again";
    EXPECT_EQ(0, dlg.OnSelChangeInteraction(C::My, 4)) << "Vy-Vz needs Fy and Fz";
    dlg.OnComponentCtrl(C::Fy, true);
    dlg.OnComponentCtrl(C::Fz, true);
    EXPECT_EQ(1, dlg.OnSelChangeInteraction(C::My, 4));
    EXPECT_EQ(I::VyVz, dlg.Type().interaction);
    const auto names = [&dlg](const char* key) {
        const auto found = dlg.Findings();
        return std::ranges::count(found, key, &T_FINDING::messageKey);
    };
    EXPECT_EQ(0, names("IDS_QM_HINGE_SHEAR_PAIR"));
    dlg.OnComponentCtrl(C::Fz, false);
    EXPECT_EQ(1, names("IDS_QM_HINGE_SHEAR_PAIR"));
}

TEST(HingeTypeStiffness, ComesFromSectionMaterialAndLength)
{
    T_PHGT_D t;
    t.section = t.sectionMaterial = 1;
    const INIT_STIFFNESS options[] = {INIT_STIFFNESS::Elastic, INIT_STIFFNESS::Elastic,
                                      INIT_STIFFNESS::EI6L,    INIT_STIFFNESS::EI6L,
                                      INIT_STIFFNESS::EI3L,    INIT_STIFFNESS::User};
    for (std::size_t i = 0; i < 6; ++i) {
        T_SKEL_MULTI m;
        m.initStiffness = options[i];
        m.sides.pos.userStiffness = 11, m.sides.neg.userStiffness = 12;
        m.symmetric = i != 5;
        t.components[i] = ComponentWith(SKEL_TYPE::Bilinear, m);
    }
    t.components[4].sameEnds = false;
    const auto rows = [&](double length) {
        CPO_HingeTypeDlg dlg(Context());
        dlg.Data2Dlg(t);
        dlg.m_memberLength = length;
        return dlg.UpdateInitialStiffness();
    };
    const auto all = rows(2);
    ASSERT_EQ(7u, all.size());
    EXPECT_DOUBLE_EQ(780, *all[0].stiffness.pos); // E A / L
    EXPECT_DOUBLE_EQ(500, *all[1].stiffness.pos); // G Asy
    EXPECT_FALSE(all[2].stiffness.pos);           // no bending stiffness of a shear
    EXPECT_DOUBLE_EQ(150, *all[3].stiffness.neg); // G J / L
    EXPECT_DOUBLE_EQ(390, *all[4].stiffness.pos); // 3 E 0.5 Iyy / L at the I-end
    EXPECT_DOUBLE_EQ(780, *all[5].stiffness.pos); // at the J-end
    EXPECT_EQ(12, *all[6].stiffness.neg);         // entered
    t.length.autoSpan = false, t.length.span = 4;
    EXPECT_DOUBLE_EQ(195, *rows(2)[4].stiffness.pos);
    t.length.autoSpan = true;
    EXPECT_FALSE(rows(0)[4].stiffness.pos.has_value());
    t.sectionMaterial = 2; // missing
    EXPECT_FALSE(rows(2)[0].stiffness.pos.has_value());
    EXPECT_EQ(11, *rows(2)[6].stiffness.pos);
}

TEST(HingeTypeDefaults, PutActiveComponentsBack)
{
    T_PHGT_D t;
    for (const std::size_t i : {0u, 4u, 5u})
        t.components[i] = ComponentWith(SKEL_TYPE::Fema, ValidBackbone<T_SKEL_FEMA>());
    t.components[5].active = false;
    CPO_HingeTypeDlg dlg({});
    dlg.Data2Dlg(t);
    dlg.InitDataCheckedAll();
    const auto& now = dlg.Type().components;
    EXPECT_EQ(SKEL_TYPE::Bilinear, now[0].type);
    EXPECT_EQ(HINGE_LOCATION::Center, now[0].location);
    EXPECT_EQ(HINGE_LOCATION::BothEnds, now[4].location);
    EXPECT_EQ(INIT_STIFFNESS::EI6L, std::get<T_SKEL_MULTI>(now[4].curves.J).initStiffness);
    EXPECT_EQ(t.components[5], now[5]);
}

TEST(HingeTypeDefaults, AskFirstAndTakeTheRatiosOfTheModel)
{
    T_HINGE_CONTEXT context;
    context.alpha1 = {0.1, 0.1}, context.alpha2 = {0.02, 0.03};
    CPO_HingeTypeDlg dlg(context);
    CScriptView view;
    dlg.SetView(&view);
    T_PHGT_D t;
    t.components[4] = ComponentWith(SKEL_TYPE::Fema, ValidBackbone<T_SKEL_FEMA>());
    dlg.Data2Dlg(t);
    EXPECT_EQ(0, dlg.OnBtnDefaults()); // no
    EXPECT_EQ(t, dlg.Type());
    view.m_yes = true;
    EXPECT_EQ(1, dlg.OnBtnDefaults());
    const auto& m = std::get<T_SKEL_MULTI>(dlg.Type().components[4].curves.J);
    EXPECT_EQ(0.1, m.sides.neg.alpha1);
    EXPECT_EQ(0.03, m.sides.neg.alpha2);
    EXPECT_FALSE(m.symmetric) << "0.02 and 0.03 differ";
    // The button of a page of the editor gives them back.
    CPO_HingeSkcvTabDlg editor;
    editor.m_alpha1 = {0.2, 0.3};
    T_HINGE_COMPONENT edited = dlg.Type().components[4];
    ASSERT_EQ(1, editor.Data2Dlg(C::My, edited));
    editor.OnDefaultAlphaBtn(HINGE_END::Both);
    EXPECT_EQ(0.3, editor.Curve(HINGE_END::Both)->sides.neg.alpha1);
    EXPECT_EQ(0.0, editor.Curve(HINGE_END::Both)->sides.pos.alpha2);
}

TEST(HingeTypeLengths, AreShownWhereTheCurveNeedsThem)
{
    T_PHGT_D t;
    t.length.My = {0.3, 0.25};
    t.length.components.J[4] = 0.5;
    CPO_HingeTypeDlg dlg({});
    dlg.Data2Dlg(t);
    EXPECT_EQ("", dlg.GetHingeLength_MTheta(C::My)); // needed by the EC8 curve alone
    t.components[4] = ComponentWith(SKEL_TYPE::Ec8, ValidBackbone<T_SKEL_EC8>());
    t.components[4].location = HINGE_LOCATION::JEnd;
    dlg.Data2Dlg(t);
    EXPECT_EQ("J 0.25", dlg.GetHingeLength_MTheta(C::My));
    EXPECT_EQ("J 0.5", dlg.GetHingeLength_MPhi(C::My));
    EXPECT_EQ("My: J 0.25", dlg.HingeLengthsText());
    EXPECT_STREQ("IDS_RPS_PO_HINGE_LENGTH_LPL", dlg.HingeLengthCaption());
    T_HINGE_CONTEXT alternative;
    alternative.altHysteresis = true;
    dlg.OnUpdate(alternative);
    EXPECT_STREQ("IDS_RPS_PO_HINGE_LENGTH_LV", dlg.HingeLengthCaption());
}
