#include "qm_rps/evaluatedsteps.h"

#include "qm_base/say.h"
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

    double At(double magnitude) const { return start + sign * std::fabs(magnitude); }
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
    const bool many = record.control && record.control->generateStaticAngle;
    return many ? Say("IDS_QM_PUSH_AT_DIRECTIONS") : std::string();
}

/// A step of the run without those of evaluations is there: it stays one that these read.
bool IsStep(const T_PUSH_RUN& run, double displacement)
{
    return std::ranges::any_of(run.displacement, [&](double d) {
        return std::fabs(d - displacement) <= kSameDisplacement * std::fabs(displacement);
    });
}

/// Displacements that the engine can be asked for.
std::vector<double> StepsAt(const T_POLC_D& record, const std::vector<T_PUSH_POINT>& points)
{
    std::vector<double> out;
    for (const T_PUSH_POINT& point : points)
        if (IsOnTheWay(record, point.displacement)) out.push_back(point.displacement);
    return out;
}

/// Pushes a load case to the points of its evaluations, and shares these out.
void PushToPoints(CPushRun& push, int key, const T_POLC_D& record,
                  const std::map<T_HINGES_AT*, std::vector<T_PUSH_POINT>>& wanted,
                  const PUSH_PROGRESS_FN& progress)
{
    std::vector<T_PUSH_POINT> all;
    for (const auto& [to, points] : wanted)
        all.insert(all.end(), points.begin(), points.end());
    std::vector<T_PUSH_RUN> runs;
    std::string note = WhyNotPushed(record), error;
    if (note.empty() && !push.Run(key, progress, runs, error, StepsAt(record, all)))
        note = error;
    else if (note.empty() && runs.front().cancelled)
        note = Say("IDS_QM_PUSH_AT_INTERRUPTED");
    for (const auto& [to, points] : wanted) {
        to->note = note;
        if (note.empty()) to->points = PushAtPoints(runs.front(), points);
    }
}

} // namespace

std::vector<T_HINGES_AT> HingesOfEvaluations(CDBDoc& doc,
                                             std::span<const T_PUSH_EVALUATION> results,
                                             const PUSH_PROGRESS_FN& progress)
{
    std::vector<T_HINGES_AT> out(results.size());
    std::map<int, std::map<T_HINGES_AT*, std::vector<T_PUSH_POINT>>> wanted; // by load case
    for (std::size_t i = 0; i < results.size(); ++i) {
        const T_PUSH_EVALUATION& e = results[i];
        int key = 0;
        std::string old;
        if (!doc.Attr().FindPolc(e.eval.push, key) || !doc.Post().RunOf(key) ||
            doc.Post().IsStale(key, old))
            continue;
        const int controlNode = doc.Data().Model().pushovers.at(key).controlNode;
        out[i].evaluation = e.eval.name.empty() ? MethodName(e.eval.method) : e.eval.name;
        out[i].push = e.eval.push;
        out[i].units = e.units;
        if (e.loadCase.controlNode != controlNode) {
            out[i].note = Say("IDS_QM_PUSH_AT_OTHER_NODE", std::to_string(e.loadCase.controlNode),
                              std::to_string(controlNode));
            continue;
        }
        std::vector<T_PUSH_POINT> points = PointsOf(e, WayOf(*doc.Post().RunOf(key), controlNode));
        if (!points.empty()) wanted[key][&out[i]] = std::move(points);
    }
    CPushRun push(doc);
    for (const auto& [key, of] : wanted)
        PushToPoints(push, key, doc.Data().Model().pushovers.at(key), of, progress);
    return out;
}

std::vector<double> StepsOfEvaluations(CDBDoc& doc, std::span<const T_PUSH_RUN> runs)
{
    if (runs.size() != 1 || runs.front().cancelled) return {};
    const T_POLC_D record = doc.Data().Model().pushovers.at(runs.front().key);
    if (!record.additionalEvaluations) return {};
    std::vector<double> out;
    IPushRun* const stored = doc.Post().RunOf(runs.front().key);
    if (!stored) return out;
    const T_WAY way = WayOf(*stored, record.controlNode);
    CPushEvaluator evaluator(doc, RunPerfPtProcedure);
    evaluator.SetStoreSteps(false);
    evaluator.SetFindAllPoints(false);
    for (const auto& entry : doc.Data().Model().evaluations) {
        T_EVAL_D eval;
        T_FINDING refusal;
        if (entry.second.push != record.name || !doc.Attr().GetEval(entry.first, eval) ||
            !evaluator.SetEvaluation(eval, refusal) || evaluator.Evaluate() == 0 ||
            evaluator.Result().loadCase.controlNode != record.controlNode)
            continue;
        const T_PUSH_EVALUATION& result = evaluator.Result();
        const auto add = [&](double d) {
            // an evaluation counts from the start of the push, a step is told by the whole
            const double si = way.At(ToSi(d, doc.Unit().Units(), kDimLength));
            if (si != 0.0 && IsOnTheWay(record, si) && !IsStep(runs.front(), si)) out.push_back(si);
        };
        if (result.point) add(result.point->D);
        for (const T_LIMIT_ROW& row : result.limitStates)
            if (row.demand) add(*row.demand);
    }
    return out;
}
