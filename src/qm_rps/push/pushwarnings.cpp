#include "qm_rps/push/pushwarnings.h"

#include "qm_base/say.h"
#include "qm_rps/hinge/hingefindings.h"
#include "qm_rps/hinge/hingetypefindings.h"

#include <algorithm>
#include <set>

namespace {

/// Types of the hinges that stand on elements and act.
std::set<int> ActingTypes(const T_MODEL& model)
{
    const std::vector<int>& acting = model.pushControl.hingeTypes; // empty: all
    std::set<int> types;
    for (const auto& [key, hinge] : model.hinges)
        if (acting.empty() || std::ranges::find(acting, hinge.hingeType) != acting.end())
            types.insert(hinge.hingeType);
    return types;
}

/// The type has a component that can yield.
bool Yields(const T_MODEL& model, int type)
{
    const auto at = model.hingeTypes.find(type);
    return at == model.hingeTypes.end() || // refused before it could act
           std::ranges::any_of(at->second.components, &T_HINGE_COMPONENT::active);
}

} // namespace

std::string NoHingeText(const T_MODEL& model)
{
    const std::set<int> types = ActingTypes(model);
    if (std::ranges::any_of(types, [&](int type) { return Yields(model, type); })) return {};
    return Say(model.hinges.empty() ? "IDS_QM_PUSH_NO_HINGE" : "IDS_QM_PUSH_NO_HINGE_ACTS");
}

std::vector<std::string> PushWarnings(CDBDoc& doc)
{
    std::vector<std::string> out;
    for (const int key : ActingTypes(doc.Data().Model())) {
        T_PHGT_D type; // in current units
        if (!doc.Attr().GetPhgt(key, type)) continue;
        for (const T_FINDING& f : VoidInputWarnings(type))
            out.push_back(
                Say("IDS_QM_CLI_HINGE_WARNING", type.name, PathInType(f), f.ruleText, f.text));
    }
    return out;
}
