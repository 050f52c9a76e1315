#include "qm_rps/evaluatedsteps.h"

#include "qm_base/say.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/pushovercalculators.h"

#include <algorithm>
#include <cmath>
#include <map>

namespace {

/// What leads from the displacements of an evaluation (magnitudes, counted from the first step) to
/// those that a step is told by: the whole one of the control node, with its sign; m.
struct T_WAY {
    double start = 0.0; // before the first step
    double sign = 1.0;  // where the control node has gone, however it is controlled
    double reach = 0.0; // furthest displacement of the stored push, a magnitude

    double At(double magnitude) const { return start + sign * std::fabs(magnitude); }
    bool Reaches(double displacement) const
    {
        return std::fabs(displacement - start) <= reach * (1.0 + kSameDisplacement);
    }
};

T_WAY WayOf(IPushRun& run, int controlNode)
{
    T_WAY way;
    std::vector<T_DOF6> start;
    std::vector<double> moved;
    const std::vector<int> nodes = run.NodeIds();
    const auto at = std::ranges::lower_bound(nodes, controlNode);
    if (!run.ReadStart(start) || !run.ReadDisplacements(controlNode, moved) || moved.empty())
        return way;
    for (std::size_t d = 0; d < 6; ++d)
        way.start += run.Head().control[d] * start[static_cast<std::size_t>(at - nodes.begin())][d];
    const double furthest =
        *std::ranges::max_element(moved, {}, [](double u) { return std::fabs(u); });
    way.sign = furthest < 0.0 ? -1.0 : 1.0;
    way.reach = std::fabs(furthest);
    return way;
}

std::vector<T_PUSH_POINT> PointsOf(const T_PUSH_EVALUATION& e, const T_WAY& way)
{
    std::vector<T_PUSH_POINT> out;
    const auto add = [&](PUSH_POINT kind, const std::string& state, std::optional<double> d) {
        if (!d || *d == 0.0 || !std::isfinite(*d)) return;
        out.push_back({kind, state, way.At(ToSi(*d, e.units, kDimLength))});
    };
    if (e.point) add(PUSH_POINT::Performance, {}, e.point->D);
    for (const T_LIMIT_ROW& row : e.limitStates) {
        add(PUSH_POINT::Demand, row.name, row.demand);
        if (!e.elastic) add(PUSH_POINT::Capacity, row.name, row.capacity);
    }
    return out;
}

/// Why a load case is not pushed to displacements; empty: it is.
std::string WhyNotPushed(const T_POLC_D& record)
{
    constexpr int kFirstRotation = 4;
    if (record.direction >= kFirstRotation) return Say("IDS_QM_PUSH_AT_TURN");
    return {};
}

/// A step of a run without those of evaluations is there: it stays one that these read.
bool IsStep(std::span<const T_PUSH_RUN> runs, double displacement)
{
    const auto same = [&](double d) {
        return std::fabs(d - displacement) <= kSameDisplacement * std::fabs(displacement);
    };
    return std::ranges::any_of(
        runs, [&](const T_PUSH_RUN& run) { return std::ranges::any_of(run.displacement, same); });
}

/// What is wanted of the results of one load case.
struct T_WANTED {
    T_HINGES_AT* to = nullptr;
    int turn = 0;
    std::vector<T_PUSH_POINT> points;
    T_WAY way;
    std::vector<double> path{}; // further displacements
};

/// Displacements that the engine can be asked for, no further than the stored pushes have come.
std::vector<double> StepsAt(const T_POLC_D& record, const std::vector<T_WANTED>& wanted)
{
    std::vector<double> out;
    for (const T_WANTED& one : wanted) {
        const auto add = [&](double d) {
            if (one.way.Reaches(d) && IsOnTheWay(record, d)) out.push_back(d);
        };
        for (const T_PUSH_POINT& point : one.points)
            add(point.displacement);
        for (const double d : one.path)
            add(d);
    }
    return out;
}

/// A hinge has come to the end of its rise: strength may drop there.
bool MayDrop(const T_RUN_EVENT& event)
{
    return std::ranges::any_of(event.turns, [](const T_RUN_TURN& turn) {
        return turn.turn == solver::HINGE_TURN::Point && turn.point > 1;
    });
}

/// Displacements at the vertices of a stored push. At a drop of strength
/// the step is the state after it: one right before it is the state that it starts from.
std::vector<double> PathOf(IPushRun& run, const T_WAY& way)
{
    constexpr double kBefore = 1e-6, kSame = 1e-9; // of the reach
    std::vector<double> out;
    std::vector<T_RUN_EVENT> events;
    if (!run.ReadEvents(events)) return out;
    const int last = events.empty() ? 0 : events.back().stage;
    const auto add = [&](double d) {
        const double before = out.empty() ? way.At(0.0) : out.back();
        const bool isBehind = way.sign * (d - way.At(0.0)) > kSame * way.reach;
        if (isBehind && std::fabs(d - before) > kSame * way.reach) out.push_back(d);
    };
    for (const T_RUN_EVENT& event : events) {
        if (event.stage != last) continue;
        if (MayDrop(event)) add(event.displacement - way.sign * kBefore * way.reach);
        add(event.displacement);
    }
    return out;
}

/// A push that was cancelled comes further when it is pushed again: what the stored one has not
/// reached stays without values.
std::vector<T_PUSH_AT_POINT> PointsAsStored(const T_PUSH_RUN& run, const T_WANTED& wanted)
{
    std::vector<T_PUSH_AT_POINT> out = PushAtPoints(run, wanted.points);
    for (T_PUSH_AT_POINT& at : out)
        if (!wanted.way.Reaches(at.point.displacement)) {
            const T_PUSH_POINT point = at.point;
            at = {};
            at.point = point;
        }
    return out;
}

/// The points of an evaluation on a push of our own that is not older than the model, and the key
/// of its load case; without such a push `to` stays empty, a note says why there are no points.
T_WANTED WantedOf(CDBDoc& doc, const T_PUSH_EVALUATION& e, int& key, T_HINGES_AT& to)
{
    const T_MODEL& model = doc.Data().Model();
    const auto push = FindPush(model, e.eval.push);
    IPushRun* const run = push ? doc.Post().RunOf(push->key, push->turn) : nullptr;
    std::string old;
    if (!run || doc.Post().IsStale(push->key, old, push->turn)) return {};
    key = push->key;
    to.evaluation = e.eval.name.empty() ? MethodName(e.eval.method) : e.eval.name;
    to.push = e.eval.push;
    to.units = e.units;
    const int controlNode = model.pushovers.at(key).controlNode;
    if (e.loadCase.controlNode != controlNode) {
        to.note = Say("IDS_QM_PUSH_AT_OTHER_NODE", std::to_string(e.loadCase.controlNode),
                      std::to_string(controlNode));
        return {};
    }
    const T_WAY way = WayOf(*run, controlNode);
    return {&to, push->turn, PointsOf(e, way), way};
}

/// Pushes a load case to the points of its evaluations, and shares these out. The run of the first
/// of them; empty: the notes say why not.
T_PUSH_RUN PushToPoints(CPushRun& push, int key, const T_POLC_D& record,
                        const std::vector<T_WANTED>& wanted, const PUSH_PROGRESS_FN& progress)
{
    std::vector<T_PUSH_RUN> runs;
    std::string note = WhyNotPushed(record), error;
    if (note.empty() && !push.Run(key, progress, runs, error, StepsAt(record, wanted)))
        note = error;
    else if (note.empty() && runs.back().cancelled)
        note = Say("IDS_QM_PUSH_AT_INTERRUPTED");
    for (const T_WANTED& one : wanted) {
        one.to->note = note;
        const auto run = std::ranges::find(runs, one.turn, &T_PUSH_RUN::turn);
        if (note.empty() && run != runs.end()) one.to->points = PointsAsStored(*run, one);
    }
    const auto first = std::ranges::find(runs, wanted.front().turn, &T_PUSH_RUN::turn);
    return note.empty() && first != runs.end() ? std::move(*first) : T_PUSH_RUN();
}

} // namespace

std::vector<T_EVAL_D> EvaluationsOf(CDBDoc& doc, const std::string& only)
{
    std::vector<T_EVAL_D> out;
    const T_MODEL& model = doc.Data().Model();
    for (const auto& entry : model.evaluations) {
        T_EVAL_D eval;
        if (!doc.Attr().GetEval(entry.first, eval) || (!only.empty() && eval.name != only))
            continue;
        const auto push = FindPush(model, eval.push);
        std::vector<std::string> pushes{eval.push};
        if (push && push->turn == 0 && !doc.Post().SelectPushover(push->key))
            if (auto turned = TurnedNames(model.pushovers.at(push->key)); !turned.empty())
                pushes = std::move(turned);
        const std::string name = eval.name;
        for (std::string& one : pushes) {
            if (pushes.size() > 1) eval.name = name + ", " + one;
            eval.push = std::move(one);
            out.push_back(eval);
        }
    }
    return out;
}

std::vector<T_HINGES_AT> HingesOfEvaluations(CDBDoc& doc,
                                             std::span<const T_PUSH_EVALUATION> results,
                                             const PUSH_PROGRESS_FN& progress)
{
    std::vector<T_HINGES_AT> out(results.size());
    std::map<int, std::vector<T_WANTED>> wanted; // by load case
    for (std::size_t i = 0; i < results.size(); ++i) {
        int key = 0;
        T_WANTED one = WantedOf(doc, results[i], key, out[i]);
        if (!one.points.empty()) wanted[key].push_back(std::move(one));
    }
    CPushRun push(doc);
    for (const auto& [key, of] : wanted)
        (void)PushToPoints(push, key, doc.Data().Model().pushovers.at(key), of, progress);
    return out;
}

T_HINGES_AT PushToEvaluation(CDBDoc& doc, const T_PUSH_EVALUATION& result,
                             const PUSH_PROGRESS_FN& progress, T_PUSH_RUN& run,
                             const PUSH_FORCES_FN& forces)
{
    T_HINGES_AT out;
    int key = 0;
    T_WANTED wanted = WantedOf(doc, result, key, out);
    run = {};
    if (wanted.points.empty()) return out;
    CPushRun push(doc);
    if (forces) {
        wanted.path = PathOf(*doc.Post().RunOf(key, wanted.turn), wanted.way);
        push.TellForces([&forces, turn = wanted.turn](const T_STEP_FORCES& step) {
            if (step.run.turn == turn) forces(step);
        });
    }
    run = PushToPoints(push, key, doc.Data().Model().pushovers.at(key), {std::move(wanted)},
                       progress);
    return out;
}

int EvaluateStored(CDBDoc& doc, const std::string& name, T_PUSH_EVALUATION& out, std::string& error)
{
    const auto& records = doc.Data().Model().evaluations;
    const auto record =
        std::ranges::find_if(records, [&](const auto& e) { return e.second.name == name; });
    T_EVAL_D eval;
    if (record == records.end() || !doc.Attr().GetEval(record->first, eval)) {
        error = Say("IDS_QM_CLI_NO_EVALUATION", name);
        return 0;
    }
    CPushEvaluator evaluator(doc, RunPerfPtProcedure);
    evaluator.SetStoreSteps(false);
    evaluator.SetFindAllPoints(false);
    T_FINDING refusal;
    if (!evaluator.SetEvaluation(eval, refusal)) {
        error = refusal.text;
        return 0;
    }
    evaluator.Evaluate();
    out = evaluator.Result();
    return 1;
}

std::vector<double> StepsOfEvaluations(CDBDoc& doc, std::span<const T_PUSH_RUN> runs)
{
    std::vector<double> out;
    if (runs.empty() || runs.back().cancelled) return out;
    const int key = runs.front().key;
    const T_POLC_D record = doc.Data().Model().pushovers.at(key);
    if (!record.additionalEvaluations) return out;
    CPushEvaluator evaluator(doc, RunPerfPtProcedure);
    evaluator.SetStoreSteps(false);
    evaluator.SetFindAllPoints(false);
    for (const T_EVAL_D& eval : EvaluationsOf(doc)) {
        T_FINDING refusal;
        const auto push = FindPush(doc.Data().Model(), eval.push);
        IPushRun* const stored =
            push && push->key == key ? doc.Post().RunOf(key, push->turn) : nullptr;
        if (!stored || !evaluator.SetEvaluation(eval, refusal) || evaluator.Evaluate() == 0 ||
            evaluator.Result().loadCase.controlNode != record.controlNode)
            continue;
        const T_PUSH_EVALUATION& result = evaluator.Result();
        const T_WAY way = WayOf(*stored, record.controlNode);
        const auto add = [&](double d) {
            const double si =
                way.At(ToSi(d, doc.Unit().Units(), DisplacementDim(record.direction)));
            if (si != 0.0 && IsOnTheWay(record, si) && !IsStep(runs, si)) out.push_back(si);
        };
        if (result.point) add(result.point->D);
        for (const T_LIMIT_ROW& row : result.limitStates)
            if (row.demand) add(*row.demand);
    }
    return out;
}
