#include "qm_db/results/stagedresult.h"

bool BelongsTo(int load, int loadCase, int group)
{
    switch (load) {
    case kStageLoadSum:
        return true;
    case kStageLoadDead:
        return group == kLoadGroupDead;
    case kStageLoadErection:
        return group == kLoadGroupErection;
    default:
        return load == loadCase;
    }
}

std::set<int> StandingElements(const T_MODEL& model, int stage)
{
    std::set<int> standing;
    for (const auto& [key, record] : model.stages) {
        if (key > stage) break;
        for (const int id : record.deactivate.elements)
            standing.erase(id);
        standing.insert(record.activate.elements.begin(), record.activate.elements.end());
    }
    return standing;
}
