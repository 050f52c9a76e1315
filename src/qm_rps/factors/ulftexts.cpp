#include "qm_rps/factors/ulftexts.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"

#include <array>
#include <span>

using zql::lib::MMSGFunction;

namespace {

constexpr std::array<const char*, 6> kDisplacements{"DX", "DY", "DZ", "RX", "RY", "RZ"};
constexpr std::array<const char*, 6> kReactions{"FX", "FY", "FZ", "MX", "MY", "MZ"};
constexpr std::array<const char*, 6> kForces{"IDS_RPS_Axial",    "IDS_RPS_Shear_Y",
                                             "IDS_RPS_Shear_Z",  "IDS_RPS_Torsion",
                                             "IDS_RPS_Moment_Y", "IDS_RPS_Moment_Z"};
constexpr std::array<const char*, 5> kPositions{
    "IDS_RPS_UNKNOWN_TABLE_I_END", "IDS_RPS_UNKNOWN_TABLE_1_4_Pos", "IDS_RPS_UNKNOWN_TABLE_2_4_Pos",
    "IDS_RPS_UNKNOWN_TABLE_3_4_Pos", "IDS_RPS_UNKNOWN_TABLE_J_END"};

const char* At(std::span<const char* const> names, int index)
{
    const auto at = static_cast<std::size_t>(index);
    return index >= 0 && at < names.size() ? names[at] : nullptr;
}

bool OfNode(ULFC_TYPE type)
{
    return type == ULFC_TYPE::Reaction || type == ULFC_TYPE::Displacement;
}

} // namespace

std::string UlfComponentText(ULFC_TYPE type, int component)
{
    if (OfNode(type)) {
        const char* name = At(type == ULFC_TYPE::Reaction ? kReactions : kDisplacements, component);
        return name ? name : "";
    }
    const char* key = At(kForces, component);
    return key ? MMSGFunction::GetValue(key) : "";
}

std::string UlfPositionText(int position)
{
    const char* key = At(kPositions, position);
    return key ? MMSGFunction::GetValue(key) : "";
}

std::string UlfRelationText(const T_ULFC_D& c)
{
    std::string text;
    if (c.inequality) {
        if (c.upper) text += std::string(" <= ") + FormatText(" %10.4f", *c.upper);
        if (c.lower) text += std::string(" >= ") + FormatText(" %10.4f", *c.lower);
        return text;
    }
    if (c.compareWithValue) return std::string(" = ") + FormatText(" %10.4f", c.value);
    return MMSGFunction::Format(OfNode(c.type) ? "IDS_RPS__That_of_Node__d"
                                               : "IDS_RPS__That_of_Elem__d",
                                {std::to_string(c.otherId)});
}

std::string UlfDescription(const T_ULFC_D& c)
{
    const std::string id = std::to_string(c.id);
    const std::string component = UlfComponentText(c.type, c.component);
    const std::string position = UlfPositionText(c.position);
    const std::string relation = UlfRelationText(c);
    switch (c.type) {
    case ULFC_TYPE::Truss:
        return MMSGFunction::Format("IDS_RPS_Axial_Force_of_Truss__d_at__s__s",
                                    {id, position, relation});
    case ULFC_TYPE::Beam:
        return MMSGFunction::Format("IDS_RPS__s_of_Beam__d_at__s__s",
                                    {component, id, position, relation});
    default:
        return MMSGFunction::Format("IDS_RPS__s_of_Node__d__s", {component, id, relation});
    }
}

std::string UlfUnitText(ULFC_TYPE type, int component, const T_UNITS& units)
{
    const std::string length(NameOf(units.length)), force(NameOf(units.force));
    const bool angular = component >= 3;
    if (type == ULFC_TYPE::Displacement) return angular ? "rad" : length;
    return angular ? force + "*" + length : force;
}
