#include "qm_rps/hinge/hingelabels.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_rps/hinge/hingefindings.h"

#include <algorithm>

namespace {

using zql::lib::MMSGFunction;

const char* ElasticText(HINGE_COMPONENT c)
{
    if (c == HINGE_COMPONENT::Fx) return "EA/L";
    return c == HINGE_COMPONENT::Mx ? "GJ/L" : "G As";
}

} // namespace

std::string ElementText(HINGE_ELEMENT element)
{
    static constexpr std::array<const char*, 5> keys{
        "IDS_RPS_PO_Element_Beam_Column", "IDS_RPS_PO_Element_Wall", "IDS_RPS_PO_Element_Truss",
        "IDS_RPS_PO_Element_GeneralLink", "IDS_RPS_PO_Element_PointSpringSupport"};
    const auto at = static_cast<std::size_t>(element);
    return MMSGFunction::GetValue(at < keys.size() ? keys[at] : "IDS_PUSHOVER_Error");
}

std::string StrengthHead(const std::string& name, HINGE_COMPONENT c, const T_HINGE_OWNER& owner)
{
    return HeadWithUnit(name, StrengthDim(c), owner.units);
}

std::string DeformHead(const std::string& name, HINGE_COMPONENT c, const T_HINGE_OWNER& owner)
{
    const std::string head = HeadWithUnit(name, DeformDim(c, owner.type.definition), owner.units);
    const bool rotation = IsMoment(c) && owner.type.definition == HINGE_DEFINITION::MomentRotation;
    return rotation ? head + " (rad)" : head;
}

std::string StiffnessHead(const std::string& name, HINGE_COMPONENT c, const T_HINGE_OWNER& owner)
{
    const T_DIM s = StrengthDim(c), d = DeformDim(c, owner.type.definition);
    const T_DIM dim{s.force - d.force, s.length - d.length};
    if (dim != kDimMass) return HeadWithUnit(name, dim, owner.units);
    // Force over length, which elsewhere is the unit of a mass.
    return HeadWithUnit(name, {}, owner.units) + " (" + std::string(NameOf(owner.units.force)) +
           "/" + std::string(NameOf(owner.units.length)) + ")";
}

const char* YieldDeformKey(HINGE_COMPONENT c, HINGE_DEFINITION definition)
{
    const bool moment = IsMoment(c);
    if (definition == HINGE_DEFINITION::MomentRotation)
        return moment ? "IDS_RPS_Yield_Rotation" : "IDS_RPS_Yield_Displacement";
    return moment ? "IDS_RPS_Yield_Curvature" : "IDS_RPS_Yield_Strain";
}

std::vector<INIT_STIFFNESS> StiffnessOptions(HINGE_COMPONENT c)
{
    if (!IsBending(c)) return {INIT_STIFFNESS::Elastic, INIT_STIFFNESS::User};
    return {INIT_STIFFNESS::EI6L, INIT_STIFFNESS::EI3L, INIT_STIFFNESS::EI2L, INIT_STIFFNESS::User};
}

std::vector<std::string> StiffnessTexts(HINGE_COMPONENT c)
{
    const std::string user = MMSGFunction::GetValue("IDS_RPS_PUSHOVER_User");
    if (!IsBending(c)) return {ElasticText(c), user};
    std::vector<std::string> texts;
    for (const char* key :
         {"IDS_RPS_PO_FEMA_INIT_STIFF_ELASTIC1", "IDS_RPS_PO_FEMA_INIT_STIFF_ELASTIC2",
          "IDS_RPS_PO_FEMA_INIT_STIFF_ELASTIC3"})
        texts.push_back(MMSGFunction::GetValue(key));
    texts.push_back(user);
    return texts;
}

int StiffnessPosition(HINGE_COMPONENT c, INIT_STIFFNESS option)
{
    const bool axial = c == HINGE_COMPONENT::Fx || c == HINGE_COMPONENT::Mx;
    if (axial && option != INIT_STIFFNESS::User) return 0;
    const std::vector<INIT_STIFFNESS> options = StiffnessOptions(c);
    const auto at = std::ranges::find(options, option);
    return at == options.end() ? -1 : static_cast<int>(at - options.begin());
}

std::string HingeModelLabel(HINGE_DEFINITION definition, HINGE_COMPONENT c)
{
    static constexpr const char* labels[] = {"Moment - Rotation (M-%s)",
                                             "Moment - Curvature (M-%s Lumped)",
                                             "Moment - Curvature (M-%s Distributed)"};
    static constexpr const char* symbols[] = {"Rx", "Ry", "Rz"};
    if (!IsMoment(c)) return {};
    const auto symbol = static_cast<std::size_t>(c) - static_cast<std::size_t>(HINGE_COMPONENT::Mx);
    return FormatText(labels[static_cast<std::size_t>(definition)], symbols[symbol]);
}

const char* HingeLengthCaptionKey(bool altHysteresis)
{
    return altHysteresis ? "IDS_RPS_PO_HINGE_LENGTH_LV" : "IDS_RPS_PO_HINGE_LENGTH_LPL";
}

std::string CriterionText(bool inUse, double value)
{
    return inUse ? ShortestText(value) : MMSGFunction::GetValue("IDS_RPS_PO_FEMA_Inactive");
}
