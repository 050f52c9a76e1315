#include "qm_rps/push/pushresultlist.h"

#include "qm_base/say.h"
#include "qm_db/recordfacts.h"

#include <algorithm>
#include <cmath>
#include <numeric>

namespace {

double Along(const T_DOF6& control, const T_DOF6& v)
{
    return std::inner_product(control.begin(), control.end(), v.begin(), 0.0);
}

/// The state before the first step, where the model still names the node that was followed.
void ReadStart(const T_POLC_D& record, T_PUSH_RUN& run)
{
    const T_RUN_DATA& data = run.data;
    const auto at = std::ranges::lower_bound(data.nodes, record.controlNode);
    if (data.start.empty() || run.displacement.empty() || at == data.nodes.end() ||
        *at != record.controlNode)
        return;
    const auto node = static_cast<std::size_t>(at - data.nodes.begin());
    if (Along(data.head.control, data.displacement.front()[node]) != run.displacement.front())
        return;
    run.startDisplacement = Along(data.head.control, data.start[node]);
    run.startReaction = data.head.startReaction;
}

} // namespace

std::size_t DirectionOf(const T_RUN_HEAD& head)
{
    const auto largest =
        std::ranges::max_element(head.control, {}, [](double c) { return std::fabs(c); });
    return static_cast<std::size_t>(largest - head.control.begin());
}

bool HasImportedSteps(CDBDoc& doc, int key)
{
    const T_RESULT_MAP& results = doc.Data().Content().results;
    const auto it = results.find(key);
    return it != results.end() && it->second && !it->second->Run();
}

std::vector<T_PUSH_RESULT_ID> PushResultsOf(CDBDoc& doc)
{
    std::vector<T_PUSH_RESULT_ID> out;
    const T_MODEL& model = doc.Data().Model();
    const auto add = [&](int key, int turn, IPushResult& result) {
        const auto record = model.pushovers.find(key);
        if (record == model.pushovers.end() || !result.Run()) return;
        const T_RUN_HEAD& head = result.Run()->Head();
        out.push_back(
            {key, turn,
             turn > 0 ? TurnedName(record->second.name, head.angle) : record->second.name});
    };
    for (const auto& [key, result] : doc.Data().Content().results)
        if (result) add(key, 0, *result);
    for (const auto& [at, result] : doc.Data().Content().turnedResults)
        if (result) add(at.first, at.second, *result);
    std::ranges::sort(out, {},
                      [](const T_PUSH_RESULT_ID& id) { return std::pair(id.key, id.turn); });
    return out;
}

int ReadOldRun(CDBDoc& doc, const T_PUSH_RESULT_ID& id, T_PUSH_RUN& out, std::string& error)
{
    IPushRun* const stored = doc.Post().RunOf(id.key, id.turn);
    T_PUSH_RUN run;
    if (!stored) {
        error = Say("IDS_QM_PUSH_NO_RUN");
        return 0;
    }
    if (!ReadWholeRun(*stored, run.data, error)) return 0;
    run.name = id.name;
    run.key = id.key;
    run.turn = id.turn;
    run.direction = DirectionOf(run.data.head);
    run.status = StatusOf(run.data.head.end.outcome);
    run.outcome = PushOutcomeName(run.data.head.end.outcome);
    for (const T_RUN_STEP& step : run.data.steps) {
        run.loadFactor.push_back(step.loadFactor);
        run.displacement.push_back(step.displacement);
        run.baseReaction.push_back(step.baseReaction);
        run.residual.push_back(step.residual);
    }
    const auto record = doc.Data().Model().pushovers.find(id.key);
    if (record != doc.Data().Model().pushovers.end()) ReadStart(record->second, run);
    out = std::move(run);
    return 1;
}
