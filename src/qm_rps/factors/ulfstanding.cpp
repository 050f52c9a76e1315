#include "qm_rps/factors/ulfstanding.h"

#include "qm_db/datactrl.h"
#include "qm_rps/factors/ulfstageplace.h"

#include <algorithm>

namespace {

void Bring(const std::vector<int>& what, std::set<int>& to)
{
    to.insert(what.begin(), what.end());
}
void Take(const std::vector<int>& what, std::set<int>& from)
{
    for (const int id : what)
        from.erase(id);
}

} // namespace

T_STANDING StandingAt(const T_MODEL& model, int stage)
{
    T_STANDING s;
    s.elements = StandingElements(model, stage);
    for (auto it = model.stages.begin(); it != model.stages.upper_bound(stage); ++it) {
        Take(it->second.deactivate.supports, s.supports); // what goes leaves first
        Bring(it->second.activate.supports, s.supports);
    }
    for (const int id : s.elements)
        if (const auto it = model.elements.find(id); it != model.elements.end())
            s.nodes.insert({it->second.nodeI, it->second.nodeJ});
    return s;
}

std::vector<int> CasesBroughtBy(const T_MODEL& model, int stage, int step)
{
    std::set<int> cases;
    const int last = UlfStepNumber(model, stage, step);
    for (auto it = model.stages.begin(); it != model.stages.upper_bound(stage); ++it)
        for (const T_STAG_LOAD& load : it->second.activate.loads)
            if (it->first < stage || StageStepNumber(it->second, load.step) <= last)
                cases.insert(load.loadCase);
    return {cases.begin(), cases.end()};
}

bool ReadsSum(const T_ULSI_ROW& row)
{
    return row.loadGroup == kLoadGroupDead || row.loadGroup == kLoadGroupErection;
}

bool ReadsCase(const T_MODEL& model, const T_ULSI_D& item, const T_ULSI_ROW& row, int loadCase)
{
    if (!ReadsSum(row)) return row.loadCase == loadCase;
    const auto it = model.loadCases.find(loadCase);
    return it != model.loadCases.end() &&
           (item.sumStageLoads || it->second.group == kLoadGroupDead);
}

std::optional<std::pair<int, int>> ReadingPlace(const T_MODEL& model, const T_ULSI_D& item,
                                                const T_ULFC_D& constraint)
{
    const auto numbered = [&](int stage, int step) {
        return std::pair(stage, UlfStepNumber(model, stage, step)); // last and its number are one
    };
    if (constraint.stage != 0) return numbered(constraint.stage, constraint.step);
    if (item.rows.empty()) return std::nullopt;
    const auto place = numbered(item.rows.front().stage, item.rows.front().step);
    const bool isOne = std::ranges::all_of(
        item.rows, [&](const T_ULSI_ROW& row) { return numbered(row.stage, row.step) == place; });
    return isOne ? std::optional(place) : std::nullopt;
}
