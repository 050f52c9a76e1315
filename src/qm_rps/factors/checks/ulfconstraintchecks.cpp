#include "qm_rps/factors/checks/ulfconstraintchecks.h"

#include "qm_base/msgfunction.h"
#include "qm_base/ruletable.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr const char* kInputError = "IDS_RPS_UNKNOWN_LOAD_FACTOR_CONSTRAINT_INPUT_ERROR";

struct T_CHECK {
    const T_ULFC_D& own;
    const T_MODEL& model;
    int ownKey;
};

// ---- what is asked of a constraint --------------------------------------------------------------

bool KnownType(const T_CHECK& c)
{
    return c.own.type >= ULFC_TYPE::Reaction && c.own.type <= ULFC_TYPE::Beam;
}
bool OfNode(const T_CHECK& c)
{
    return c.own.type == ULFC_TYPE::Reaction || c.own.type == ULFC_TYPE::Displacement;
}
bool OfTruss(const T_CHECK& c)
{
    return c.own.type == ULFC_TYPE::Truss;
}
bool OfBeam(const T_CHECK& c)
{
    return c.own.type == ULFC_TYPE::Beam;
}
bool OfElement(const T_CHECK& c)
{
    return OfTruss(c) || OfBeam(c);
}
bool Bounded(const T_CHECK& c)
{
    return c.own.inequality;
}
bool ToValue(const T_CHECK& c)
{
    return !c.own.inequality && c.own.compareWithValue;
}
bool Compared(const T_CHECK& c)
{
    return !c.own.inequality && !c.own.compareWithValue;
}
/// Compared, and of that type.
template <bool (*OF)(const T_CHECK&)>
bool ComparedAnd(const T_CHECK& c)
{
    return Compared(c) && OF(c);
}

// ---- what has to hold ---------------------------------------------------------------------------

bool HasName(const T_CHECK& c)
{
    return !c.own.name.empty();
}
bool NameIsFree(const T_CHECK& c)
{
    return std::ranges::none_of(c.model.ulfConstraints, [&](const auto& other) {
        return other.first != c.ownKey && other.second.name == c.own.name;
    });
}
template <int T_ULFC_D::*ID>
bool NodeExists(const T_CHECK& c)
{
    return c.model.nodes.contains(c.own.*ID);
}
template <int T_ULFC_D::*ID>
bool ElementExists(const T_CHECK& c)
{
    return c.model.elements.contains(c.own.*ID);
}
template <int T_ULFC_D::*ID, ELEM_KIND KIND>
bool IsOfKind(const T_CHECK& c)
{
    const auto it = c.model.elements.find(c.own.*ID);
    return it == c.model.elements.end() ||
           it->second.kind == KIND; // a missing one has its own rule
}
bool PositionExists(const T_CHECK& c)
{
    return c.own.position >= 0 && c.own.position <= 4;
}
/// A truss carries its axial force alone.
bool ComponentExists(const T_CHECK& c)
{
    return c.own.component >= 0 && c.own.component <= (OfTruss(c) ? 0 : 5);
}
bool OtherIsAnother(const T_CHECK& c)
{
    return c.own.otherId != c.own.id;
}
bool ValueIsFinite(const T_CHECK& c)
{
    return std::isfinite(c.own.value);
}
bool HasBound(const T_CHECK& c)
{
    return c.own.upper || c.own.lower;
}
template <std::optional<double> T_ULFC_D::*BOUND>
bool BoundIsFinite(const T_CHECK& c)
{
    return !(c.own.*BOUND) || std::isfinite(*(c.own.*BOUND));
}
bool BoundsDoNotCross(const T_CHECK& c)
{
    return !c.own.upper || !c.own.lower || !(*c.own.lower > *c.own.upper);
}

constexpr auto kId = &T_ULFC_D::id, kOther = &T_ULFC_D::otherId;
constexpr auto kUpper = &T_ULFC_D::upper, kLower = &T_ULFC_D::lower;
constexpr ELEM_KIND kTruss = ELEM_KIND::Truss, kBeam = ELEM_KIND::Beam;

constexpr T_RULE_HEAD Says(const char* message, const char* field)
{
    return {.message = message, .field = field};
}
constexpr T_RULE_HEAD Wrong(const char* key, const char* field)
{
    return {.message = kInputError, .key = key, .field = field};
}

// clang-format off
constexpr T_RULE<T_CHECK> kRules[] = {
    {Says ("IDS_RPS_No_Constraint_Name_",       "name"),      HasName},
    {Wrong("IDS_QM_ULFC_NAME_EXISTS",           "name"),      NameIsFree, HasName},
    {Wrong("IDS_QM_ULFC_TYPE",                  "type"),      KnownType},
    {Says ("IDS_RPS_the_Node_Id_doesn_t_exist", "id"),        NodeExists<kId>, OfNode},
    {Says ("IDS_RPS_the_Elem_Id_doesn_t_exist", "id"),        ElementExists<kId>, OfElement},
    {Says ("IDS_RPS_Elem_Id_is_not_of_Truss_",  "id"),        IsOfKind<kId, kTruss>, OfTruss},
    {Says ("IDS_RPS_Elem_Id_is_not_of_Beam_",   "id"),        IsOfKind<kId, kBeam>, OfBeam},
    {Wrong("IDS_QM_ULFC_POSITION",              "position"),  PositionExists, OfBeam},
    {Wrong("IDS_QM_ULFC_COMPONENT",             "component"), ComponentExists, KnownType},
    {Says ("IDS_RPS_the_Other_Node_Id_doesn_t_exist",    "otherId"),
     NodeExists<kOther>, ComparedAnd<OfNode>},
    {Says ("IDS_RPS_the_Other_Elem_Id_doesn_t_exist",    "otherId"),
     ElementExists<kOther>, ComparedAnd<OfElement>},
    {Says ("IDS_RPS_the_Other_Elem_Id_is_not_of_Truss_", "otherId"),
     IsOfKind<kOther, kTruss>, ComparedAnd<OfTruss>},
    {Says ("IDS_RPS_the_Other_Elem_Id_is_not_of_Beam_",  "otherId"),
     IsOfKind<kOther, kBeam>, ComparedAnd<OfBeam>},
    {Wrong("IDS_QM_ULFC_COMPARED_WITH_ITSELF",  "otherId"),   OtherIsAnother, Compared},
    {Wrong("IDS_QM_ULFC_VALUE",                 "value"),     ValueIsFinite, ToValue},
    {Wrong("IDS_QM_ULFC_NO_BOUND",              "upper"),     HasBound, Bounded},
    {Wrong("IDS_QM_ULFC_VALUE",                 "upper"),     BoundIsFinite<kUpper>, Bounded},
    {Wrong("IDS_QM_ULFC_VALUE",                 "lower"),     BoundIsFinite<kLower>, Bounded},
    {Wrong("IDS_QM_ULFC_BOUNDS_CROSS",          "lower"),     BoundsDoNotCross, Bounded},
};
// clang-format on

} // namespace

std::vector<T_FINDING> CheckUlfConstraint(const T_ULFC_D& constraint, int ownKey,
                                          const T_MODEL& model)
{
    using zql::lib::MMSGFunction;
    std::vector<T_FINDING> out;
    WalkRules(kRules, {constraint, model, ownKey}, {}, out);
    for (T_FINDING& f : out) // {3} and {4} are the ids
        f.text = MMSGFunction::Format(
            f.messageKey, {constraint.name, MMSGFunction::GetValue(f.ruleText),
                           std::to_string(constraint.id), std::to_string(constraint.otherId)});
    return out;
}

int FindUlfConstraint(const T_MODEL& model, const std::string& name)
{
    const auto it = std::ranges::find_if(
        model.ulfConstraints, [&](const auto& entry) { return entry.second.name == name; });
    return it == model.ulfConstraints.end() ? 0 : it->first;
}
