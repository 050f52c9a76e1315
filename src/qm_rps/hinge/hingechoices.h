// What a hinge type offers: curve types of a component, parts of the type, hinge lengths.
#pragma once

#include "qm_rps/hinge/hingecontext.h"
#include "qm_rps/hinge/hingefindings.h"

struct T_SKCV_ENTRY {
    const char* key; // of its text
    SKEL_TYPE code;
    bool enabled = true;
    bool operator==(const T_SKCV_ENTRY&) const = default;
};

/// Curve types that a component of such a type offers, in their order.
std::vector<T_SKCV_ENTRY> OfferedCurves(const T_PHGT_D& type, HINGE_COMPONENT c,
                                        const T_HINGE_CONTEXT& context);
/// Key of the text of a curve type; a code outside the list is shown as an error.
const char* CurveKey(SKEL_TYPE code);
/// Mode of the strength calculation of a pair of design codes, exact spelling: Eurocode "Eurocode2"
/// or "Eurocode2:04" with "Eurocode3" or "Eurocode3:05"; AIJ "AIJ-WSD99" with "AIJ-ASD02"; any
/// other pair is general.
enum class YIELD_CODE { General, Eurocode, Aij };
YIELD_CODE YieldCodeOf(const std::string& concreteCode, const std::string& steelCode);
/// What it means for the strengths here, in words.
std::string YieldCodeText(const std::string& concreteCode, const std::string& steelCode);
/// The codes under which the Eurocode curve is enabled: "Eurocode2", "Eurocode2:04" with
/// "Eurocode3", "Eurocode3:05".
bool IsEurocodePair(const std::string& concreteCode, const std::string& steelCode);

/// Degrees of freedom that the element type has: a truss Fx alone, others all.
bool HasComponent(HINGE_ELEMENT element, HINGE_COMPONENT c);

/// My and Mz each offer these interactions, in this order; Vy-Vz where Fy and Fz are active.
inline constexpr std::array<HINGE_INTERACTION, 5> kInteractions{
    HINGE_INTERACTION::P, HINGE_INTERACTION::MyMz, HINGE_INTERACTION::PMM, HINGE_INTERACTION::User,
    HINGE_INTERACTION::VyVz};
/// The interaction of My or Mz.
HINGE_INTERACTION InteractionOf(const T_PHGT_D& type, HINGE_COMPONENT c);
/// How many of them a component offers: Vy-Vz too where it has it already.
std::size_t OfferedInteractions(const T_PHGT_D& type, HINGE_COMPONENT c);
bool HasShearPair(const T_PHGT_D& type);
/// My and Mz are active and share one surface.
bool ShareSurface(const T_PHGT_D& type);
/// They do with P-M-M interaction: the surface follows the axial force.
bool SharesMoments(const T_PHGT_D& type);
/// My or Mz is active and has the P-M curves of the user.
bool HasUserInteraction(const T_PHGT_D& type);

/// The curve type that fixes the levels of the yield surface: that of My, else of Mz.
SKEL_TYPE YieldSurfaceCurve(const T_PHGT_D& type);

/// Which components need a hinge length at the I-end and the J-end.
using T_LENGTH_NEEDS = std::array<T_ENDS<bool>, 6>;
T_LENGTH_NEEDS LengthNeeds(const T_PHGT_D& type, bool altHysteresis);

/// Parts of a type besides its components.
enum class HINGE_PART {
    Interaction, // of My and Mz
    YieldSurface,
    UserInteraction, // P-M curves of the user
    Section,
    Thickness,
    FibreFrame,
    FibreWall,
    IntegrationPoints,
    HingeLength,
    Location,
    Masonry,
    InfillStrut, // choice of the strut form in Fx
    Count
};
struct T_PART_STATE {
    bool shown = false, enabled = false;
    bool operator==(const T_PART_STATE&) const = default;
};
using T_PART_STATES = std::array<T_PART_STATE, static_cast<std::size_t>(HINGE_PART::Count)>;

/// Which parts are shown, and which of these can be used, for the element type, definition,
/// material class, interaction and components.
T_PART_STATES PartStates(const T_PHGT_D& type, bool altHysteresis);

/// Initial stiffness of a page of a component; empty where its data are missing.
struct T_STIFFNESS_ROW {
    HINGE_COMPONENT component = HINGE_COMPONENT::Fx;
    HINGE_END end = HINGE_END::Both;
    INIT_STIFFNESS option = INIT_STIFFNESS::EI6L;
    T_SIDES<std::optional<double>> stiffness;
};
/// A row per page of the active components, from section and material of the type and the span
/// that the type gives, else `memberLength`.
std::vector<T_STIFFNESS_ROW> StiffnessRows(const T_PHGT_D& type, const T_HINGE_CONTEXT& context,
                                           double memberLength);
