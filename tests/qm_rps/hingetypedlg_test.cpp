#include "hingesample.h"
#include "qm_rps/hinge/hingetypefindings.h"
#include "qm_rps/po_hingemasonrydlg.h"
#include "qm_rps/po_hingetypedlg.h"

#include <gtest/gtest.h>

namespace {

using C = HINGE_COMPONENT;
using EL = HINGE_ELEMENT;
constexpr auto kDist = HINGE_DEFINITION::CurvatureDistributed;

struct T_OFFER {
    EL element;
    C component;
    const char* options; // hysteresis (a)lternative, (d)egrading, (g)sd wanted, (G)sd allowed
    bool euro;
    const char* codes;  // "!" follows a disabled entry
    const char* fourth; // end of the key under which code 4 is listed
};
const T_OFFER kOffers[] = {
    {EL::BeamColumn, C::My, "", true, "014235", "SKCV_FEMA"},
    {EL::BeamColumn, C::My, "", false, "014235!", "SKCV_FEMA"},
    {EL::PointSpring, C::Fx, "", true, "601", ""},
    {EL::BeamColumn, C::My, "adG", true, "0123", ""},
    {EL::BeamColumn, C::Mz, "agG", true, "01423", "GSD_TYPE"},
    {EL::BeamColumn, C::My, "ag", true, "0123", ""},
    {EL::BeamColumn, C::Fx, "agG", true, "0123", ""},
    {EL::Wall, C::Fx, "ad", true, "01423", "STRENGTH_DEG_TYPE"},
    {EL::Truss, C::Fx, "d", true, "014235", "SKCV_FEMA"},
};

TEST(HingeType, OffersCurveTypesByElementDefinitionAndOptions)
{
    const auto offered = [](const T_PHGT_D& type, const T_OFFER& o, std::string& fourth) {
        const auto has = [&](char c) {
            return std::string(o.options).find(c) != std::string::npos;
        };
        T_HINGE_CONTEXT x;
        x.altHysteresis = has('a');
        x.strengthDegradation = has('d');
        x.gsd = has('g');
        x.gsdAllowed = has('G');
        x.concreteCode = "Eurocode2:04";
        x.steelCode = o.euro ? "Eurocode3" : "AIJ-ASD02";
        std::string codes;
        for (const auto& e : OfferedCurves(type, o.component, x)) {
            codes += std::to_string(static_cast<int>(e.code)) + (e.enabled ? "" : "!");
            if (e.code == SKEL_TYPE::Fema) fourth = e.key;
        }
        return codes;
    };
    T_PHGT_D type;
    std::string fourth;
    for (const T_OFFER& o : kOffers) {
        type.element = o.element;
        fourth = "";
        EXPECT_EQ(o.codes, offered(type, o, fourth)) << "row " << &o - kOffers;
        EXPECT_TRUE(fourth.ends_with(o.fourth)) << fourth;
    }
    type.element = EL::Wall;
    type.definition = kDist;
    EXPECT_EQ("4", offered(type, {EL::Wall, C::Fx, "", true, "4", ""}, fourth));
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
    const struct {
        SKEL_TYPE type;
        std::size_t component;
        L location;
        bool withheld, alt;
        const char* needs;
    } kCases[] = {
        {SKEL_TYPE::Ec8, 4, L::BothEnds, false, false, "IJ"},
        {SKEL_TYPE::Ec8, 0, L::BothEnds, false, false, ""},
        {SKEL_TYPE::Ec8, 0, L::BothEnds, false, true, "IJ"},
        {SKEL_TYPE::Ec8, 4, L::IEnd, false, false, "I"},
        {SKEL_TYPE::Ec8, 4, L::JEnd, false, false, "J"},
        {SKEL_TYPE::Ec8, 4, L::Center, false, true, ""},
        {SKEL_TYPE::Ec8, 5, L::BothEnds, true, false, ""},
        {SKEL_TYPE::Ec8, 5, L::BothEnds, true, true, "IJ"},
        {SKEL_TYPE::Fema, 5, L::BothEnds, false, false, ""},
    };
    for (const auto& c : kCases) {
        T_PHGT_D t;
        const bool ec8 = c.type == SKEL_TYPE::Ec8;
        t.components[c.component] =
            ComponentWith(c.type, ec8 ? T_SKEL_CURVE(T_SKEL_EC8()) : T_SKEL_CURVE(T_SKEL_FEMA()));
        t.components[c.component].location = c.location;
        t.withholdMzLength = c.withheld;
        const auto needs = LengthNeeds(t, c.alt)[c.component];
        EXPECT_EQ(c.needs, std::string(needs.I ? "I" : "") + (needs.J ? "J" : ""))
            << "row " << &c - kCases;
    }
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
