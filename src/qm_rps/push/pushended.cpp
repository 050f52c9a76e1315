#include "qm_rps/push/pushended.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/push/pushcases.h"
#include "qm_rps/push/pushquantity.h"

namespace {

/// Displacement of the control at the last step (SI), along the direction of a turned push.
double LastDisplacement(IPushRun& run, int controlNode)
{
    std::vector<T_RUN_STEP> steps;
    std::vector<T_DOF6> moved;
    if (!run.ReadSteps(steps) || steps.empty()) return run.Head().end.displacement;
    if (run.Head().turn == 0 || !run.ReadNode(controlNode, moved)) return steps.back().displacement;
    double along = 0.0;
    for (std::size_t d = 0; d < 6; ++d)
        along += run.Head().control[d] * moved.back()[d];
    return along;
}

} // namespace

std::optional<T_PUSH_ENDED> PushEndedOf(CDBDoc& doc, int key, int turn)
{
    IPushRun* const run = doc.Post().RunOf(key, turn);
    const auto record = doc.Data().Model().pushovers.find(key);
    if (!run || record == doc.Data().Model().pushovers.end()) return std::nullopt;
    const T_RUN_END& end = run->Head().end;
    T_PUSH_ENDED out{StatusOf(end.outcome), end.outcome, false, 0.0, {}};
    std::vector<int> chain;
    std::string unknown;
    out.earlier = end.outcome != solver::PUSH_OUTCOME::InitialLoads &&
                  PushChainOf(doc.Data().Model(), key, chain, unknown) &&
                  end.stage + 1 < std::ssize(chain);
    if (out.earlier) out.status = PUSH_STATUS::Failed;
    const T_PUSH_QUANTITY length =
        DisplacementIn(static_cast<std::size_t>(record->second.direction - 1), doc.Unit().Units());
    out.displacement = length.Shown(LastDisplacement(*run, record->second.controlNode));
    out.unit = length.Unit();
    return out;
}

std::optional<zql::frx::T_MESSAGE> PushRemark(CDBDoc& doc, const std::string& push)
{
    const std::optional<T_PUSH_NAME> name = FindPush(doc.Data().Model(), push);
    if (!name) return std::nullopt;
    const std::optional<T_PUSH_ENDED> ended = PushEndedOf(doc, name->key, name->turn);
    const bool lept = ended && ended->outcome == solver::PUSH_OUTCOME::ReachedByLeaps;
    if (!ended || (ended->status != PUSH_STATUS::Failed && !lept)) return std::nullopt;
    const char* const text = lept ? "IDS_QM_PUSH_CUT_LEAPS"
                             : ended->outcome == solver::PUSH_OUTCOME::Cancelled
                                 ? "IDS_QM_PUSH_CUT_CANCELLED"
                             : ended->earlier ? "IDS_QM_PUSH_CUT_EARLIER"
                                              : "IDS_QM_PUSH_CUT";
    const std::string where = FormatText("%.6g", ended->displacement) + " " + ended->unit;
    return zql::frx::T_MESSAGE{text, Say(text, push, where, PushOutcomeText(ended->outcome))};
}
