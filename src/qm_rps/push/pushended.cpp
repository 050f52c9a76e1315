#include "qm_rps/push/pushended.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/push/pushcases.h"
#include "qm_rps/push/pushquantity.h"
#include "qm_rps/push/pushresultlist.h"
#include "qm_solver/pushresult.h"

#include <algorithm>

namespace {

/// Displacement of the control at the last step, along its direction; SI.
double LastDisplacement(IPushRun& run)
{
    std::vector<T_RUN_STEP> steps;
    return run.ReadSteps(steps) && !steps.empty() ? steps.back().displacement
                                                  : run.Head().end.displacement;
}

/// Where the first leap of the case has led to; SI.
std::optional<double> FirstLeap(IPushRun& run)
{
    std::vector<T_RUN_EVENT> events;
    if (!run.ReadEvents(events)) return std::nullopt;
    const auto leaps = [](const T_RUN_EVENT& event) {
        return std::ranges::find(event.turns, solver::HINGE_TURN::Leap, &T_RUN_TURN::turn) !=
               event.turns.end();
    };
    const auto first = std::ranges::find_if(events, leaps);
    return first == events.end() ? std::nullopt : std::optional(first->displacement);
}

/// In a load case that this one starts from. The present ones tell nothing of a run that is older
/// than they are.
bool EndedEarlier(CDBDoc& doc, int key, int turn, IPushRun& run)
{
    std::vector<int> chain;
    std::string unused;
    return run.StepCount() == 0 && run.Head().end.outcome != solver::PUSH_OUTCOME::InitialLoads &&
           !doc.Post().IsStale(key, unused, turn) &&
           PushChainOf(doc.Data().Model(), key, chain, unused) &&
           run.Head().end.stage + 1 < std::ssize(chain);
}

} // namespace

std::optional<T_PUSH_ENDED> PushEndedOf(CDBDoc& doc, int key, int turn)
{
    IPushRun* const run = doc.Post().RunOf(key, turn);
    if (!run) return std::nullopt;
    const T_RUN_END& end = run->Head().end;
    T_PUSH_ENDED out{StatusOf(end.outcome), end.outcome, false, 0.0, {}};
    out.earlier = EndedEarlier(doc, key, turn, *run);
    if (out.earlier) out.status = PUSH_STATUS::Failed;
    const T_PUSH_QUANTITY length = DisplacementIn(DirectionOf(run->Head()), doc.Unit().Units());
    const std::optional<double> leap = FirstLeap(*run);
    if (leap) out.leap = length.Shown(*leap);
    out.displacement = length.Shown(LastDisplacement(*run));
    out.unit = length.Unit();
    return out;
}

std::optional<zql::frx::T_MESSAGE> PushRemark(CDBDoc& doc, const std::string& push)
{
    const std::optional<T_PUSH_NAME> name = FindPush(doc.Data().Model(), push);
    if (!name) return std::nullopt;
    const std::optional<T_PUSH_ENDED> ended = PushEndedOf(doc, name->key, name->turn);
    if (!ended) return std::nullopt;
    const auto at = [&](double displacement) {
        return FormatText("%.6g", displacement) + " " + ended->unit;
    };
    std::string key, words;
    const auto add = [&](const char* text, double displacement) {
        if (key.empty()) key = text;
        words += (words.empty() ? "" : " ") +
                 Say(text, push, at(displacement), PushOutcomeText(ended->outcome));
    };
    if (ended->status == PUSH_STATUS::Failed)
        add(ended->outcome == solver::PUSH_OUTCOME::Cancelled ? "IDS_QM_PUSH_CUT_CANCELLED"
            : ended->earlier                                  ? "IDS_QM_PUSH_CUT_EARLIER"
                                                              : "IDS_QM_PUSH_CUT",
            ended->displacement);
    if (ended->leap)
        add("IDS_QM_PUSH_CUT_LEAPS", *ended->leap);
    else if (ended->outcome == solver::PUSH_OUTCOME::ReachedByLeaps)
        add("IDS_QM_PUSH_CUT_LEAPS_BEFORE", ended->displacement);
    if (key.empty()) return std::nullopt;
    return zql::frx::T_MESSAGE{key, words};
}
