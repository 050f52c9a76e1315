#include "qm_rps/ssreportinforw.h"

#include "qm_db/recordfacts.h"
#include "qm_rps/evaluatedsteps.h"
#include "qm_rps/pushovercalculators.h"

namespace {

constexpr std::array<const char*, 3> kEc8Names{"DL", "SD", "NC"};
constexpr std::array<const char*, 3> kNtcNames{"SLD", "SLV", "SLC"}; // SLO is not kept

void AddStoreys(CDBDoc& doc, SSReportInfoRW& out)
{
    const T_UNITS units = doc.Unit().Units();
    double elevation = 0.0;
    for (const auto& [key, storey] : doc.Data().Model().storeys) {
        T_REPORT_STOREY row;
        row.key = key;
        row.name = storey.name;
        row.height = ShortFromSi(storey.height, units, kDimLength);
        elevation += row.height; // in the shown units: 3 x 168 is 504
        row.elevation = elevation;
        row.nodes = storey.nodes;
        for (const int id : storey.nodes) {
            T_NODE_D node;
            if (!doc.Attr().GetNode(id, node)) continue;
            for (std::size_t d = 0; d < row.mass.size(); ++d)
                row.mass[d] += node.mass[d];
        }
        out.storeys.push_back(std::move(row));
    }
}

/// False: the results can't be read.
bool ReadStep(CDBDoc& doc, T_REPORT_PUSH& push, int turn, int step)
{
    CPostCtrl& post = doc.Post();
    T_REPORT_STEP row;
    row.step = step;
    if (!post.SelectStep(step) || !post.GetStepFactor_PO(row.loadFactor) ||
        !post.GetReacNew(row.baseReaction) ||
        !post.GetDispNew(push.controlNode, row.controlDisplacement))
        return false;
    if (!doc.Data().Model().storeys.empty())
        (void)post.GetPushoverStoryDrifts(push.key, step, row.drifts, turn); // none: stays empty
    push.steps.push_back(std::move(row));
    return true;
}

void AddLimitStates(CDBDoc& doc, T_REPORT_PUSH& push)
{
    const CPoverInfo& info = *doc.Post().GetPoverInfo();
    std::array<int, 3> steps{};
    const auto add = [&](int found, const std::array<const char*, 3>& names) {
        for (std::size_t i = 0; found && i < names.size(); ++i)
            push.limitStates.push_back({names[i], steps[i]});
    };
    add(info.GetStepEC8(push.key, steps), kEc8Names);
    add(info.GetStepNTC2008(push.key, steps), kNtcNames);
}

/// The load case as it stands, or one of the directions of its static angle.
int AddPushover(CDBDoc& doc, const T_POLC_D& record, T_PUSH_NAME id, SSReportInfoRW& out,
                std::string& error)
{
    CPostCtrl& post = doc.Post();
    const std::string name =
        id.turn == 0 ? record.name : TurnedNames(record)[static_cast<std::size_t>(id.turn - 1)];
    T_REPORT_PUSH push{id.key,
                       name,
                       record.controlNode,
                       record.direction,
                       {},
                       {},
                       PushEndedOf(doc, id.key, id.turn),
                       {}};
    (void)post.IsStale(id.key, push.old, id.turn);
    const int steps = post.SelectPushover(id.key, id.turn) ? post.GetStepCount() : 0;
    for (int step = 1; step <= steps; ++step) {
        if (ReadStep(doc, push, id.turn, step)) continue;
        error = "pushover load case \"" + name + "\", step " + std::to_string(step) + ": " +
                (post.Error().empty() ? "no results" : post.Error());
        return 0;
    }
    if (id.turn == 0) AddLimitStates(doc, push);
    out.pushovers.push_back(std::move(push));
    return 1;
}

int AddPushovers(CDBDoc& doc, SSReportInfoRW& out, std::string& error)
{
    for (const auto& [key, record] : doc.Data().Model().pushovers) {
        const int last =
            doc.Post().SelectPushover(key) ? 0 : static_cast<int>(std::ssize(TurnedNames(record)));
        for (int turn = last > 0 ? 1 : 0; turn <= last; ++turn)
            if (!AddPushover(doc, record, {key, turn}, out, error)) return 0;
    }
    return 1;
}

int AddEvaluations(CDBDoc& doc, SSReportInfoRW& out, std::string& error)
{
    CPushEvaluator driver(doc, RunPerfPtProcedure);
    T_FINDING refusal;
    driver.SetStoreSteps(false); // a report changes nothing
    for (const T_EVAL_D& eval : EvaluationsOf(doc)) {
        if (!driver.SetEvaluation(eval, refusal)) {
            error = "evaluation \"" + eval.name + "\": " + refusal.text;
            return 0;
        }
        driver.Evaluate();
        out.evaluations.push_back(driver.Result());
    }
    return 1;
}

} // namespace

int BuildReportInfo(CDBDoc& doc, SSReportInfoRW& out, std::string& error)
{
    SSReportInfoRW info;
    T_STYP_D styp;
    if (doc.Attr().GetStyp(styp)) info.title = styp.title;
    info.units = doc.Unit().Units();
    info.gravity = CPushEvaluator(doc, RunPerfPtProcedure).FindGravity(false);
    AddStoreys(doc, info);
    if (!AddPushovers(doc, info, error) || !AddEvaluations(doc, info, error)) return 0;
    out = std::move(info);
    return 1;
}
