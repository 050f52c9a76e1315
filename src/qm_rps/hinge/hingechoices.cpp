#include "qm_rps/hinge/hingechoices.h"

#include "qm_base/msgfunction.h"
#include "qm_rps/hinge/hingetheta.h"
#include "qm_rps/hinge/pageyield.h"

#include <algorithm>

namespace {

using ENTRY = T_SKCV_ENTRY;
constexpr ENTRY kBilinear{"IDS_RPS_PO_PHGT_SKCV_Bilinear_Type", SKEL_TYPE::Bilinear};
constexpr ENTRY kTrilinear{"IDS_RPS_PO_PHGT_SKCV_Trilinear_Type", SKEL_TYPE::Trilinear};
constexpr ENTRY kSlipBi{"IDS_RPS_PO_PHGT_SKCV_Slip_Bilinear_Type", SKEL_TYPE::SlipBilinear};
constexpr ENTRY kSlipTri{"IDS_RPS_PO_PHGT_SKCV_Slip_Trilinear_Type", SKEL_TYPE::SlipTrilinear};
constexpr ENTRY kCompression{"IDS_RPS_PO_PHGT_SKCV_Compression_Only_Type",
                             SKEL_TYPE::CompressionOnly};
constexpr ENTRY kFema{"IDS_RPS_PO_PHGT_SKCV_FEMA", SKEL_TYPE::Fema};
constexpr ENTRY kDegrading{"IDS_RPS_PO_PHGT_SKCV_STRENGTH_DEG_TYPE", SKEL_TYPE::Fema};
constexpr ENTRY kGsd{"IDS_RPS_PO_PHGT_SKCV_GSD_TYPE", SKEL_TYPE::Fema};
constexpr const char* kEc8Key = "IDS_RPS_PO_PHGT_SKCV_EC8";

struct T_CODE_PAIR {
    const char *concrete, *steel;
    YIELD_CODE code;
};
constexpr T_CODE_PAIR kCodePairs[] = {
    {"Eurocode2", "Eurocode3", YIELD_CODE::Eurocode},
    {"Eurocode2", "Eurocode3:05", YIELD_CODE::Eurocode},
    {"Eurocode2:04", "Eurocode3", YIELD_CODE::Eurocode},
    {"Eurocode2:04", "Eurocode3:05", YIELD_CODE::Eurocode},
    {"AIJ-WSD99", "AIJ-ASD02", YIELD_CODE::Aij},
};

/// The entry under which code 4 is listed, or null.
const ENTRY* FemaEntry(const T_PHGT_D& t, HINGE_COMPONENT c, const T_HINGE_CONTEXT& x)
{
    if (!x.altHysteresis) return &kFema;
    if (t.element == HINGE_ELEMENT::Wall && x.strengthDegradation) return &kDegrading;
    return IsBending(c) && x.gsd && x.gsdAllowed ? &kGsd : nullptr;
}

using T = T_PHGT_D;
using C = HINGE_COMPONENT;

bool IsFrame(const T& t)
{
    return t.element == HINGE_ELEMENT::BeamColumn;
}
bool IsWall(const T& t)
{
    return t.element == HINGE_ELEMENT::Wall;
}
bool IsTruss(const T& t)
{
    return t.element == HINGE_ELEMENT::Truss;
}
bool Bends(const T& t)
{
    return IsFrame(t) || IsWall(t);
}
bool IsLine(const T& t)
{
    return Bends(t) || IsTruss(t);
}
bool BySection(const T& t)
{
    return t.definition != HINGE_DEFINITION::MomentRotation;
}
bool BendingActive(const T& t)
{
    return At(t, C::My).active || At(t, C::Mz).active;
}
bool CanInteract(const T& t)
{
    return BendingActive(t) || HasShearPair(t);
}
template <HINGE_INTERACTION I>
bool Interacts(const T& t)
{
    return (At(t, C::My).active && InteractionOf(t, C::My) == I) ||
           (At(t, C::Mz).active && InteractionOf(t, C::Mz) == I);
}
bool HasFrameFibres(const T& t)
{
    return (IsFrame(t) || IsTruss(t)) && BySection(t);
}
bool HasWallFibres(const T& t)
{
    return IsWall(t) && BySection(t);
}
bool IsDistributed(const T& t)
{
    return Bends(t) && t.definition == HINGE_DEFINITION::CurvatureDistributed;
}
bool IsMasonry(const T& t)
{
    return Bends(t) && t.material == MATL_CLASS::Masonry;
}
bool HasFemaAxial(const T& t)
{
    return At(t, C::Fx).active && At(t, C::Fx).type == SKEL_TYPE::Fema;
}

/// Disabled where it is not shown.
struct T_PART_ROW {
    HINGE_PART part;
    bool (*shown)(const T&);
    bool (*enabled)(const T&) = nullptr; // null: always
};
using P = HINGE_PART;
constexpr T_PART_ROW kParts[] = {
    {P::Interaction, Bends, CanInteract},
    {P::YieldSurface, Bends, Interacts<HINGE_INTERACTION::PMM>},
    {P::UserInteraction, Bends, HasUserInteraction},
    {P::Section, IsLine},
    {P::Thickness, IsWall},
    {P::FibreFrame, HasFrameFibres},
    {P::FibreWall, HasWallFibres},
    {P::IntegrationPoints, IsDistributed},
    {P::HingeLength, Bends}, // enabled by the components
    {P::Location, Bends},
    {P::Masonry, IsMasonry},
    {P::InfillStrut, IsTruss, HasFemaAxial},
};

template <class CURVE>
T_SIDES<std::optional<double>> StiffnessOf(const CURVE& curve, HINGE_COMPONENT c, HINGE_END end,
                                           const T_THETA_LOOKUP& lookup)
{
    const auto at = end == HINGE_END::J ? HINGE_LOCATION::JEnd : HINGE_LOCATION::IEnd;
    const auto stiffness = [&](const auto& side) {
        return CHingeTheta::CalcStiffness(lookup, c, at, curve.initStiffness, side.userStiffness);
    };
    const bool two = HasTwoStiffnesses(curve);
    return {stiffness(curve.sides.pos), stiffness(two ? curve.sides.neg : curve.sides.pos)};
}

} // namespace

std::vector<T_SKCV_ENTRY> OfferedCurves(const T_PHGT_D& type, HINGE_COMPONENT c,
                                        const T_HINGE_CONTEXT& context)
{
    if (type.element == HINGE_ELEMENT::PointSpring) return {kCompression, kBilinear, kTrilinear};
    if (type.definition == HINGE_DEFINITION::CurvatureDistributed) return {kFema};
    std::vector<ENTRY> list{kBilinear, kTrilinear};
    if (const ENTRY* fema = FemaEntry(type, c, context)) list.push_back(*fema);
    list.push_back(kSlipBi);
    list.push_back(kSlipTri);
    if (!context.altHysteresis && c != HINGE_COMPONENT::Mx &&
        type.element != HINGE_ELEMENT::GeneralLink)
        list.push_back(
            {kEc8Key, SKEL_TYPE::Ec8, IsEurocodePair(context.concreteCode, context.steelCode)});
    return list;
}

const char* CurveKey(SKEL_TYPE code)
{
    static constexpr const char* keys[] = {kBilinear.key,   kTrilinear.key, kSlipBi.key,
                                           kSlipTri.key,    kFema.key,      kEc8Key,
                                           kCompression.key};
    const auto at = static_cast<std::size_t>(code);
    return at < std::size(keys) ? keys[at] : "IDS_PUSHOVER_Error";
}

YIELD_CODE YieldCodeOf(const std::string& concreteCode, const std::string& steelCode)
{
    const auto pair = [&](const T_CODE_PAIR& p) {
        return concreteCode == p.concrete && steelCode == p.steel;
    };
    const auto at = std::ranges::find_if(kCodePairs, pair);
    return at == std::end(kCodePairs) ? YIELD_CODE::General : at->code;
}

std::string YieldCodeText(const std::string& concreteCode, const std::string& steelCode)
{
    static constexpr const char* keys[] = {"IDS_QM_HINGE_CODE_GENERAL", "IDS_QM_HINGE_CODE_EURO",
                                           "IDS_QM_HINGE_CODE_AIJ"};
    const auto code = static_cast<std::size_t>(YieldCodeOf(concreteCode, steelCode));
    return zql::lib::MMSGFunction::GetValue(keys[code]);
}

bool IsEurocodePair(const std::string& concreteCode, const std::string& steelCode)
{
    return YieldCodeOf(concreteCode, steelCode) == YIELD_CODE::Eurocode;
}

bool HasComponent(HINGE_ELEMENT element, HINGE_COMPONENT c)
{
    return element != HINGE_ELEMENT::Truss || c == HINGE_COMPONENT::Fx;
}

HINGE_INTERACTION InteractionOf(const T_PHGT_D& type, HINGE_COMPONENT c)
{
    return c == C::Mz ? type.interactionMz.value_or(type.interaction) : type.interaction;
}

bool HasShearPair(const T_PHGT_D& type)
{
    return At(type, C::Fy).active && At(type, C::Fz).active;
}

bool SharesMoments(const T_PHGT_D& type)
{
    return ShareSurface(type) && InteractionOf(type, C::My) == HINGE_INTERACTION::PMM &&
           InteractionOf(type, C::Mz) == HINGE_INTERACTION::PMM;
}

bool ShareSurface(const T_PHGT_D& type)
{
    const auto shares = [&type](HINGE_COMPONENT c) {
        const HINGE_INTERACTION i = InteractionOf(type, c);
        return At(type, c).active && (i == HINGE_INTERACTION::MyMz || i == HINGE_INTERACTION::PMM);
    };
    return shares(C::My) && shares(C::Mz);
}

bool HasUserInteraction(const T_PHGT_D& type)
{
    return Interacts<HINGE_INTERACTION::User>(type);
}

std::size_t OfferedInteractions(const T_PHGT_D& type, HINGE_COMPONENT c)
{
    const bool shear = HasShearPair(type) || InteractionOf(type, c) == HINGE_INTERACTION::VyVz;
    return kInteractions.size() - (shear ? 0 : 1);
}

SKEL_TYPE YieldSurfaceCurve(const T_PHGT_D& type)
{
    const T_HINGE_COMPONENT& my = At(type, C::My);
    return my.active ? my.type : At(type, C::Mz).type;
}

T_LENGTH_NEEDS LengthNeeds(const T_PHGT_D& type, bool altHysteresis)
{
    T_LENGTH_NEEDS needs{};
    for (std::size_t i = 0; i < needs.size(); ++i) {
        const T_HINGE_COMPONENT& c = type.components[i];
        const auto which = static_cast<HINGE_COMPONENT>(i);
        const bool bending = IsBending(which) && !(which == C::Mz && type.withholdMzLength);
        const bool any = c.active && (altHysteresis || (bending && c.type == SKEL_TYPE::Ec8));
        const bool both = c.location == HINGE_LOCATION::BothEnds;
        needs[i].I = any && (both || c.location == HINGE_LOCATION::IEnd);
        needs[i].J = any && (both || c.location == HINGE_LOCATION::JEnd);
    }
    return needs;
}

T_PART_STATES PartStates(const T_PHGT_D& type, bool altHysteresis)
{
    T_PART_STATES states{};
    for (const T_PART_ROW& row : kParts) {
        T_PART_STATE& state = states[static_cast<std::size_t>(row.part)];
        state.shown = row.shown(type);
        state.enabled = state.shown && (!row.enabled || row.enabled(type));
    }
    T_PART_STATE& length = states[static_cast<std::size_t>(P::HingeLength)];
    length.enabled = length.shown && std::ranges::any_of(LengthNeeds(type, altHysteresis),
                                                         [](auto e) { return e.I || e.J; });
    return states;
}

std::vector<T_STIFFNESS_ROW> StiffnessRows(const T_PHGT_D& type, const T_HINGE_CONTEXT& context,
                                           double memberLength)
{
    const CHingeSources* from = context.sources.get();
    const T_THETA_LOOKUP lookup =
        LookupOf(type, from ? from->Section(type.section) : nullptr,
                 from ? from->Material(type.sectionMaterial) : nullptr, memberLength);
    std::vector<T_STIFFNESS_ROW> rows;
    for (std::size_t i = 0; i < type.components.size(); ++i) {
        if (!type.components[i].active) continue;
        const auto c = static_cast<HINGE_COMPONENT>(i);
        ForEachPage(type.components[i], [&](HINGE_END end, const T_SKEL_CURVE& curve) {
            std::visit(
                [&](const auto& k) {
                    rows.push_back({c, end, k.initStiffness, StiffnessOf(k, c, end, lookup)});
                },
                curve);
        });
    }
    return rows;
}
