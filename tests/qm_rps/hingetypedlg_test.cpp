#include "hingesample.h"
#include "qm_rps/hinge/hingetypefindings.h"
#include "qm_rps/po_hingemasonrydlg.h"
#include "qm_rps/po_hingetypedlg.h"
#include "qm_rps/po_hingetypelistdlg.h"

#include <gtest/gtest.h>

namespace {

using C = HINGE_COMPONENT;
using EL = HINGE_ELEMENT;
using DEF = HINGE_DEFINITION;
constexpr auto kRot = DEF::MomentRotation;
constexpr auto kDist = DEF::CurvatureDistributed;

struct T_OFFER {
    EL element;
    DEF definition;
    C component;
    bool alt, degrading, gsd, allowed, euro;
    const char* codes;  // "!" follows a disabled entry
    const char* fourth; // end of the key under which code 4 is listed
};
// clang-format off
const T_OFFER kOffers[] = {
    { EL::BeamColumn,  kRot,  C::My, false, false, false, false, true,  "014235",  "SKCV_FEMA" },
    { EL::BeamColumn,  kRot,  C::My, false, false, false, false, false, "014235!", "SKCV_FEMA" },
    { EL::PointSpring, kRot,  C::Fx, false, false, false, false, true,  "601",     "" },
    { EL::Wall,        kDist, C::Fx, false, false, false, false, true,  "4",       "SKCV_FEMA" },
    { EL::BeamColumn,  kRot,  C::My, true,  true,  false, true,  true,  "0123",    "" },
    { EL::BeamColumn,  kRot,  C::Mz, true,  false, true,  true,  true,  "01423",   "GSD_TYPE" },
    { EL::BeamColumn,  kRot,  C::My, true,  false, true,  false, true,  "0123",    "" },
    { EL::BeamColumn,  kRot,  C::Fx, true,  false, true,  true,  true,  "0123",    "" },
    { EL::Wall,        kRot,  C::Fx, true,  true,  false, false, true,  "01423",   "STRENGTH_DEG_TYPE" },
    { EL::Truss,       kRot,  C::Fx, false, true,  false, false, true,  "01423" "5", "SKCV_FEMA" },
};
// clang-format on

TEST(HingeType, OffersCurveTypesByElementDefinitionAndOptions)
{
    for (const T_OFFER& o : kOffers) {
        T_PHGT_D type;
        type.element = o.element;
        type.definition = o.definition;
        T_HINGE_CONTEXT x;
        x.altHysteresis = o.alt;
        x.strengthDegradation = o.degrading;
        x.gsd = o.gsd;
        x.gsdAllowed = o.allowed;
        x.concreteCode = "Eurocode2:04";
        x.steelCode = o.euro ? "Eurocode3" : "AIJ-ASD02";
        std::string codes, fourth;
        for (const auto& e : OfferedCurves(type, o.component, x)) {
            codes += std::to_string(static_cast<int>(e.code)) + (e.enabled ? "" : "!");
            if (e.code == SKEL_TYPE::Fema) fourth = e.key;
        }
        EXPECT_EQ(o.codes, codes) << "row " << &o - kOffers;
        EXPECT_TRUE(fourth.ends_with(o.fourth)) << fourth;
    }
}

T_PHGT_D ValidType()
{
    T_PHGT_D t;
    t.name = "column";
    T_SKEL_FEMA f = ValidBackbone<T_SKEL_FEMA>();
    t.components[0] = ComponentWith(SKEL_TYPE::Fema, f);
    t.components[4] = ComponentWith(SKEL_TYPE::Fema, f);
    t.components[4].sameEnds = false;
    return t;
}

TEST(HingeType, RefillsCurveTypesWhenTheElementOrDefinitionChanges)
{
    CPO_HingeTypeDlg dlg({});
    dlg.Data2Dlg(ValidType());
    EXPECT_EQ(2, dlg.SelectedSkcv(C::My)); // 0 1 4 ...
    dlg.OnSelChangeElement(EL::PointSpring);
    EXPECT_EQ(SKEL_TYPE::CompressionOnly, dlg.Type().components[4].type);
    dlg.OnSelChangeElement(EL::BeamColumn); // 6 is not offered there
    EXPECT_EQ(SKEL_TYPE::Bilinear, dlg.Type().components[4].type);
    EXPECT_EQ(0, dlg.OnSelChangeSkcv(C::My, 5)); // EC8, disabled without Eurocode
    dlg.OnSelChangeDefinition(kDist);
    EXPECT_TRUE(std::holds_alternative<T_SKEL_FEMA>(dlg.Type().components[4].curves.I));
}

TEST(HingeType, ConvertsInteractionCodesBothWays)
{
    CPO_HingeTypeDlg dlg({});
    for (int i = 0; i < 4; ++i) {
        EXPECT_EQ(1, dlg.OnSelChangeInteraction(i));
        EXPECT_EQ(i, CPO_HingeTypeDlg::ConvertInteraction(dlg.Type().interaction));
    }
    EXPECT_EQ(HINGE_INTERACTION::User, dlg.Type().interaction);
    EXPECT_EQ(0, dlg.OnSelChangeInteraction(4));
    EXPECT_EQ(-1, CPO_HingeTypeDlg::ConvertInteraction(HINGE_INTERACTION::VyVz));
}

TEST(HingeType, ReportsEveryFindingAndRefusesAsAWhole)
{
    T_MATL_D concrete;
    concrete.type = MATL_CLASS::Concrete;
    T_SECT_D noBars;
    noBars.shape = SECT_SHAPE::Rectangle;
    noBars.size = {4, 3};
    T_HINGE_CONTEXT x;
    x.sources = std::make_shared<CHingeSources>(T_TABLE<T_SECT_D>{{1, noBars}},
                                                T_TABLE<T_MATL_D>{{1, concrete}});
    T_PHGT_D stored = ValidType();
    CPO_HingeTypeDlg dlg(x);
    dlg.Data2Dlg(stored);
    EXPECT_EQ(1, dlg.CheckData());
    const auto first = [&](const T_PHGT_D& t) {
        const auto found = HingeTypeFindings(t, x);
        return found.empty() ? "" : found.front().messageKey;
    };
    T_PHGT_D t = ValidType();
    t.name = "";
    EXPECT_EQ("IDS_QM_HINGE_NAME_EMPTY", first(t));
    t = ValidType(), t.section = 2;
    EXPECT_EQ("IDS_CMD_IEHP_NO_SECT", first(t));
    t = ValidType(), t.sectionMaterial = 2;
    EXPECT_EQ("IDS_CMD_IEHP_NO_MATL", first(t));
    t = ValidType(), t.section = t.sectionMaterial = 1;
    EXPECT_EQ("", first(t)); // strengths are entered
    std::get<T_SKEL_FEMA>(t.components[0].curves.I).autoYield = true;
    EXPECT_EQ("IDS_CMD_IEHP_NO_RBAR", first(t));
    t = ValidType(), t.components[3] = ComponentWith(SKEL_TYPE::Ec8, ValidBackbone<T_SKEL_EC8>());
    EXPECT_EQ("IDS_QM_HINGE_CURVE_NOT_OFFERED", first(t)); // torsion
    t = ValidType(), t.masonry = T_MASONRY_HINGE{1, 1, 1, 0, 1};
    EXPECT_EQ("IDS_RPS_PO_Masonry_Hp_0", first(t));

    t = ValidType();
    std::get<T_SKEL_FEMA>(t.components[4].curves.J).sides.pos.IO = 5;
    std::get<T_SKEL_FEMA>(t.components[0].curves.I).sides.pos.yield = 0;
    dlg.Data2Dlg(t);
    const T_PHGT_D before = stored;
    EXPECT_EQ(0, dlg.Dlg2Data(stored));
    EXPECT_EQ(before, stored);
    const auto found = dlg.Findings();
    ASSERT_EQ(2u, found.size());
    EXPECT_EQ(HINGE_END::J, EndOf(found[1]));
    EXPECT_EQ(found[0].text, dlg.Messages().back().text);
    dlg.OnComponentCtrl(C::Fx, false);
    dlg.OnLocationCtrl(C::My, HINGE_LOCATION::IEnd); // the J-end has no hinge
    EXPECT_EQ(1, dlg.Dlg2Data(stored));
}

TEST(HingeLength, FollowsCurveLocationAndOptions)
{
    T_PHGT_D t;
    const auto state = [&](std::size_t i, bool alt) {
        const auto s = LengthNeeds(t, alt)[i];
        return std::string(s.I ? "I" : "") + (s.J ? "J" : "");
    };
    for (auto& c : t.components)
        c = ComponentWith(SKEL_TYPE::Ec8, T_SKEL_EC8());
    EXPECT_EQ("IJ", state(4, false));
    EXPECT_EQ("", state(0, false));
    EXPECT_EQ("IJ", state(0, true));
    t.components[4].location = HINGE_LOCATION::IEnd;
    EXPECT_EQ("I", state(4, false));
    t.components[4].location = HINGE_LOCATION::JEnd;
    EXPECT_EQ("J", state(4, false));
    t.components[4].location = HINGE_LOCATION::Center;
    EXPECT_EQ("", state(4, true));
    t.withholdMzLength = true;
    EXPECT_EQ("", state(5, false));
    EXPECT_EQ("IJ", state(5, true));
    t.components[5] = ComponentWith(SKEL_TYPE::Fema, T_SKEL_FEMA());
    t.withholdMzLength = false;
    EXPECT_EQ("", state(5, false));
}

TEST(HingeMasonry, ChecksStrengthsBeforeTheFormsOwnValue)
{
    const struct {
        T_MASONRY_HINGE m;
        const char* key;
    } rows[] = {
        {{1, 0, 0, 0, 1}, "IDS_RPS_PO_Masonry_Comp_Strength_larger_than_0"},
        {{1, 1, 0, 0, 1}, "IDS_RPS_PO_Masonry_Shear_Strength_larger_than_0"},
        {{1, 1, 1, 0, 1}, "IDS_RPS_PO_Masonry_Hp_0"},
        {{1, 1, 1, 1e-9, 0}, ""},
        {{2, 1, 1, 0, 1}, ""},
        {{2, 1, 1, 0, 1.001}, "IDS_RPS_PO_Masonry_Dist_Coeff_0_1"},
        {{2, 1, 1, 0, 0}, "IDS_RPS_PO_Masonry_Dist_Coeff_0_1"},
        {{2, 1, 0, 0, 0}, "IDS_RPS_PO_Masonry_Shear_Strength_larger_than_0"},
    };
    for (const auto& row : rows) {
        CPO_HingeMasonryDlg dlg;
        dlg.Data2Dlg(row.m);
        T_MASONRY_HINGE stored{2, 9, 9, 9, 0.9};
        EXPECT_EQ(*row.key ? 0 : 1, dlg.Dlg2Data(stored));
        EXPECT_EQ(row.key, dlg.Messages().empty() ? "" : dlg.Messages().front().key);
        EXPECT_EQ(*row.key ? 9 : 1, stored.compStrength);
    }
}

TEST(HingeTypeList, NamesTypesAndRefusesToDeleteUsedOnes)
{
    T_TABLE<T_PHGT_D> table{{3, ValidType()}, {7, ValidType()}};
    table[7].element = static_cast<EL>(9);
    CPO_HingeTypeListDlg dlg({[&] { return table; },
                              [](int key) {
                                  return key == 3 ? std::vector{12, 15} : std::vector<int>();
                              },
                              [&](int key) { return static_cast<int>(table.erase(key)); }});
    ASSERT_EQ(2u, dlg.Rows().size());
    EXPECT_EQ((CPO_HingeTypeListDlg::T_ROW{3, "3 : column", "Beam-column"}), dlg.Rows()[0]);
    EXPECT_EQ("Error", dlg.Rows()[1].element);
    const auto refused = [&](int key) {
        dlg.m_selected = key;
        EXPECT_EQ(0, dlg.OnDelete());
        return dlg.Messages().back();
    };
    EXPECT_EQ("IDS_PUSHOVER_No_selected_Hinge_Data_Type__nChoose_o", refused(0).key);
    EXPECT_EQ("IDS_PUSHOVER_Hinge_Data_Type_key__d_does_not_exits_", refused(5).key);
    EXPECT_EQ("IDS_QM_HINGE_TYPE_USED", refused(3).key);
    EXPECT_EQ(2u, table.size());
    dlg.m_selected = 7;
    EXPECT_EQ(1, dlg.OnDelete());
    EXPECT_EQ(0u, table.count(7));
}

} // namespace
