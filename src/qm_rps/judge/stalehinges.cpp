#include "qm_rps/judge/stalehinges.h"

#include "qm_base/say.h"
#include "qm_rps/generate/generatedtypes.h"
#include "qm_rps/hinge/hingegenerator.h"
#include "qm_rps/hinge/hingetable.h"

#include <set>

std::string StaleHinges(CDBDoc& doc)
{
    constexpr std::size_t kShown = 5;
    CGeneratedTypes types(doc);
    const std::vector<int> ofCodes = types.StaleElements();
    std::set<int> elements(ofCodes.begin(), ofCodes.end());
    const CHingeGenerator generator(doc);
    for (const auto& [key, hinge] : HingesOf(doc))
        if (!elements.contains(hinge.element) && !generator.StaleText(hinge).empty())
            elements.insert(hinge.element);
    if (elements.empty()) return {};
    std::string list;
    std::size_t shown = 0;
    for (const int element : elements) {
        if (++shown > kShown) {
            list += ", ...";
            break;
        }
        list += (list.empty() ? "" : ", ") + std::to_string(element);
    }
    return Say("IDS_QM_JUDGE_STALE", std::to_string(elements.size()), list);
}
