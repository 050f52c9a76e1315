#include "hingesample.h"
#include "qm_rps/hinge/hingetypefindings.h"
#include "qm_rps/po_hingemasonrydlg.h"
#include "qm_rps/po_hingetypedlg.h"

#include <gtest/gtest.h>

namespace {

using C = HINGE_COMPONENT;
using EL = HINGE_ELEMENT;
constexpr auto kDist = HINGE_DEFINITION::CurvatureDistributed;

/// Codes of the curves offered ("!" follows a disabled one), and the key of code 4. Options:
/// (a)lternative or (d)egrading hysteresis, (g)sd wanted, (G)sd allowed, (e) Eurocode.
std::string Offers(EL element, C component, const std::string& options,
                   HINGE_DEFINITION definition = HINGE_DEFINITION::MomentRotation)
{
    const auto has = [&](char c) { return options.find(c) != std::string::npos; };
    T_HINGE_CONTEXT x;
    x.altHysteresis = has('a'), x.strengthDegradation = has('d');
    x.gsd = has('g'), x.gsdAllowed = has('G');
    x.concreteCode = "Eurocode2:04";
    x.steelCode = has('e') ? "Eurocode3" : "AIJ-ASD02";
    T_PHGT_D type;
    type.element = element, type.definition = definition;
    std::string codes, fourth;
    for (const auto& e : OfferedCurves(type, component, x)) {
        codes += std::to_string(static_cast<int>(e.code)) + (e.enabled ? "" : "!");
        if (e.code == SKEL_TYPE::Fema) fourth = std::string(" ") + e.key;
    }
    return codes + fourth;
}

TEST(HingeType, OffersCurveTypesByElementDefinitionAndOptions)
{
    const std::string fema = " IDS_RPS_PO_PHGT_SKCV_FEMA";
    EXPECT_EQ("014235" + fema, Offers(EL::BeamColumn, C::My, "e"));
    EXPECT_EQ("014235!" + fema, Offers(EL::BeamColumn, C::My, ""));
    EXPECT_EQ("601", Offers(EL::PointSpring, C::Fx, "e"));
    EXPECT_EQ("4" + fema, Offers(EL::Wall, C::Fx, "e", kDist));
    EXPECT_EQ("0123", Offers(EL::BeamColumn, C::My, "eadG"));
    EXPECT_EQ("01423 IDS_RPS_PO_PHGT_SKCV_GSD_TYPE", Offers(EL::BeamColumn, C::Mz, "eagG"));
    EXPECT_EQ("0123", Offers(EL::BeamColumn, C::My, "eag"));
    EXPECT_EQ("0123", Offers(EL::BeamColumn, C::Fx, "eagG"));
    EXPECT_EQ("01423 IDS_RPS_PO_PHGT_SKCV_STRENGTH_DEG_TYPE", Offers(EL::Wall, C::Fx, "ead"));
    EXPECT_EQ("014235" + fema, Offers(EL::Truss, C::Fx, "ed"));
}

T_PHGT_D ValidType()
{
    T_PHGT_D t;
    t.name = "column";
    T_SKEL_FEMA f = ValidBackbone<T_SKEL_FEMA>();
    f.sides.pos.yieldDeform = f.sides.neg.yieldDeform = 0; // the stiffness gives another one
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

TEST(HingeType, ReportsEveryFindingAndRefusesAsAWhole)
{
    T_PHGT_D stored = ValidType();
    CPO_HingeTypeDlg dlg({});
    dlg.Data2Dlg(stored);
    EXPECT_EQ(1, dlg.CheckData());
    T_PHGT_D t = ValidType();
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
    using L = HINGE_LOCATION;
    const auto needs = [](std::size_t i, L location, bool alt, bool withheld = false) {
        T_PHGT_D t;
        t.components[i] = ComponentWith(SKEL_TYPE::Ec8, T_SKEL_EC8());
        t.components[i].location = location;
        t.withholdMzLength = withheld;
        const auto s = LengthNeeds(t, alt)[i];
        return std::string(s.I ? "I" : "") + (s.J ? "J" : "");
    };
    EXPECT_EQ("IJ", needs(4, L::BothEnds, false));
    EXPECT_EQ("", needs(0, L::BothEnds, false));
    EXPECT_EQ("IJ", needs(0, L::BothEnds, true));
    EXPECT_EQ("I", needs(4, L::IEnd, false));
    EXPECT_EQ("J", needs(4, L::JEnd, false));
    EXPECT_EQ("", needs(4, L::Center, true));
    EXPECT_EQ("", needs(5, L::BothEnds, false, true));
    EXPECT_EQ("IJ", needs(5, L::BothEnds, true, true));
    EXPECT_FALSE(LengthNeeds(ValidType(), false)[4].I); // FEMA
}

TEST(HingeMasonry, ChecksStrengthsBeforeTheFormsOwnValue)
{
    const std::pair<T_MASONRY_HINGE, const char*> rows[] = {
        {{1, 0, 0, 0, 1}, "IDS_RPS_PO_Masonry_Comp_Strength_larger_than_0"},
        {{2, 1, 0, 0, 0}, "IDS_RPS_PO_Masonry_Shear_Strength_larger_than_0"},
        {{1, 1, 1, 0, 1}, "IDS_RPS_PO_Masonry_Hp_0"},
        {{1, 1, 1, 1e-9, 0}, ""},
        {{2, 1, 1, 0, 1}, ""},
        {{2, 1, 1, 0, 1.001}, "IDS_RPS_PO_Masonry_Dist_Coeff_0_1"},
        {{2, 1, 1, 0, 0}, "IDS_RPS_PO_Masonry_Dist_Coeff_0_1"},
        {{0, 1, 1, 0, 9}, "IDS_QM_MASONRY_FORM"},
        {{3, 1, 1, 0, 9}, "IDS_QM_MASONRY_FORM"},
    };
    for (const auto& [given, key] : rows) {
        CPO_HingeMasonryDlg dlg;
        dlg.Data2Dlg(given);
        const T_MASONRY_HINGE before{2, 9, 9, 9, 0.9};
        T_MASONRY_HINGE stored = before;
        EXPECT_EQ(*key ? 0 : 1, dlg.Dlg2Data(stored));
        EXPECT_EQ(key, dlg.Messages().empty() ? "" : dlg.Messages().front().key);
        EXPECT_EQ(*key ? before : given, stored);
    }
}

} // namespace
