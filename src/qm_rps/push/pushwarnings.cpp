#include "qm_rps/push/pushwarnings.h"

#include "qm_base/say.h"
#include "qm_rps/hinge/hingefindings.h"
#include "qm_rps/hinge/hingetypefindings.h"

#include <algorithm>
#include <set>

std::vector<std::string> PushWarnings(CDBDoc& doc)
{
    const T_MODEL& model = doc.Data().Model();
    const std::vector<int>& acting = model.pushControl.hingeTypes; // empty: all
    std::set<int> types;
    for (const auto& [key, hinge] : model.hinges)
        if (acting.empty() || std::ranges::find(acting, hinge.hingeType) != acting.end())
            types.insert(hinge.hingeType);
    std::vector<std::string> out;
    for (const int key : types) {
        T_PHGT_D type; // in current units
        if (!doc.Attr().GetPhgt(key, type)) continue;
        for (const T_FINDING& f : VoidInputWarnings(type))
            out.push_back(
                Say("IDS_QM_CLI_HINGE_WARNING", type.name, PathInType(f), f.ruleText, f.text));
    }
    return out;
}
