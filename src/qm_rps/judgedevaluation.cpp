#include "qm_rps/judgedevaluation.h"

#include "qm_base/say.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/judge/judgementtext.h"
#include "qm_rps/judge/spectrumfactor.h"
#include "qm_rps/judge/stalehinges.h"
#include "qm_rps/pushovercalculators.h"

#include <algorithm>
#include <cmath>
#include <map>

namespace {

/// The level of a limit state of an evaluation; empty: codes give no limit of members for it (SLO).
std::optional<std::size_t> LevelOf(const std::string& state)
{
    for (const T_LEVELS& names : kLevelNames)
        for (std::size_t i = 0; i < kLevels; ++i)
            if (state == names[i]) return i;
    return {};
}

/// The limit states that are judged at the points of an evaluation.
std::vector<T_JUDGED_STATE> StatesOf(const T_HINGES_AT& hinges, const T_JUDGE_OPTIONS& options,
                                     const T_LEVELS& names)
{
    std::vector<T_JUDGED_STATE> out;
    const auto add = [&](const T_PUSH_AT_POINT& at, std::size_t level, const std::string& name) {
        if (options.level && *options.level != level) return;
        T_JUDGED_STATE& state = out.emplace_back();
        state.point = at.point;
        state.level = level;
        state.name = name;
        state.found = at.found;
        state.drifts = at.storeys;
    };
    for (const T_PUSH_AT_POINT& at : hinges.points) {
        if (at.point.kind == PUSH_POINT::Performance)
            for (std::size_t i = 0; i < kLevels; ++i)
                add(at, i, names[i]);
        else if (at.point.kind == PUSH_POINT::Demand)
            if (const auto level = LevelOf(at.point.state)) add(at, *level, at.point.state);
    }
    return out;
}

/// What a performance point's limit states are called: as the first end that is judged.
const T_LEVELS& NamesOf(const std::vector<T_JUDGED_END>& ends)
{
    const auto end = std::ranges::find_if(
        ends, [](const T_JUDGED_END& e) { return e.basis != JUDGE_BASIS::Nothing; });
    return end == ends.end() ? kLevelNames[0] : end->Levels();
}

/// Takes the states of all ends from the initial loads, the start and the steps of a push.
class CPathTaker {
public:
    CPathTaker(const T_MODEL& model, const T_JUDGE_OPTIONS& options)
        : m_model(model), m_options(options)
    {
    }
    void Take(const T_STEP_FORCES& step)
    {
        const bool isGravity = step.of == FORCES_OF::InitialLoads; // the first that is told
        if (isGravity) {
            ends = JudgedEnds(m_model, step.run, m_options);
            path = {};
        } else {
            path.displacement.push_back(step.run.displacement[step.step]);
            path.baseReaction.push_back(step.run.baseReaction[step.step]);
        }
        std::vector<T_END_STATE> states;
        for (const T_JUDGED_END& end : ends) {
            T_END_STATE& s = states.emplace_back(StateOf(end, step));
            s.largestV = std::fabs(s.V);
            if (!isGravity && !path.ends.empty())
                s.largestV = std::max(s.largestV, path.ends.back()[states.size() - 1].largestV);
        }
        if (isGravity)
            path.gravity = std::move(states);
        else
            path.ends.push_back(std::move(states));
    }

    std::vector<T_JUDGED_END> ends;
    T_JUDGED_PATH path;

private:
    const T_MODEL& m_model;
    const T_JUDGE_OPTIONS& m_options;
};

/// What the evaluation's method finds with its spectrum times a factor, by limit state; m.
class CScaledEvaluation {
public:
    CScaledEvaluation(CDBDoc& doc, const T_EVAL_D& eval)
        : m_doc(doc), m_eval(eval), m_evaluator(doc, RunPerfPtProcedure)
    {
        m_evaluator.SetStoreSteps(false);
        m_evaluator.SetFindAllPoints(false);
        T_FINDING refusal;
        m_isSet = m_evaluator.SetEvaluation(eval, refusal) != 0;
    }
    /// The factor at which the target of a limit state is a displacement; each is found once.
    std::optional<double> FactorTo(double displacement, const std::string& state)
    {
        const auto [at, isNew] = m_factors.try_emplace({displacement, state});
        if (!isNew) return at->second;
        const double now = At(1.0, state).value_or(displacement);
        at->second = FactorFor(displacement, now > 0.0 ? displacement / now : 1.0,
                               [&](double factor) { return At(factor, state); });
        return at->second;
    }
    /// state: of a target displacement; else the performance point.
    std::optional<double> At(double factor, const std::string& state)
    {
        if (!m_isSet) return {};
        m_evaluator.SetSpectrumFactor(factor);
        (void)m_evaluator.Evaluate();
        const T_PUSH_EVALUATION& e = m_evaluator.Result();
        std::optional<double> found;
        if (!e.IsTarget() && e.point) found = e.point->D;
        for (const T_LIMIT_ROW& row : e.limitStates)
            if (row.name == state) found = row.demand;
        if (!found || !std::isfinite(*found)) return {};
        return std::fabs(ToSi(*found, e.units, kDimLength));
    }
    /// Ground acceleration of the spectrum of a limit state, g; empty: a table that does not begin
    /// at the period 0.
    std::optional<double> Pga(const std::string& state) const
    {
        int key = 0;
        T_SPFC_D record;
        if (!m_doc.Attr().FindSpfc(m_eval.spectrum, key) || !m_doc.Attr().GetSpfc(key, record))
            return {};
        const auto* const table = std::get_if<T_SPFC_USER>(&record.data);
        if (table && table->T.front() > 0.0) return {};
        const auto at = std::ranges::find(kLimitStateNames, state);
        const LIMIT_STATE limit = at == kLimitStateNames.end()
                                      ? LIMIT_STATE::SLV
                                      : static_cast<LIMIT_STATE>(at - kLimitStateNames.begin());
        const auto spectrum = MakeDesignSpectrum(record, m_eval.behavior.value_or(0), limit);
        if (!spectrum) return {};
        return spectrum->CalcSaAt(0.0);
    }

private:
    CDBDoc& m_doc;
    const T_EVAL_D& m_eval;
    CPushEvaluator m_evaluator;
    bool m_isSet = false;
    std::map<std::pair<double, std::string>, std::optional<double>> m_factors;
};

/// The limit state whose demand is the target displacement itself: of DL, SD, NC, whose demands are
/// shares and multiples of one target (EN 1998-3), SD; else each its own.
std::string TargetOf(const std::string& state)
{
    const T_LEVELS& shares = kLevelNames[1];
    return std::ranges::find(shares, state) == shares.end() ? state : shares[1];
}

T_JUDGED_LIMIT LimitOf(const T_FIRST_PASS& first, const T_JUDGED_STATE& state, double start,
                       CScaledEvaluation& scaled)
{
    T_JUDGED_LIMIT limit;
    limit.first = first;
    limit.state = state.name;
    limit.demand = std::fabs(state.point.displacement - start);
    const std::string target = TargetOf(state.point.state);
    limit.pga = scaled.Pga(target);
    limit.demandFactor = target == state.point.state ? 1.0 : scaled.FactorTo(*limit.demand, target);
    if (!first.end) {
        const bool none = first.unchecked == first.all;
        limit.why = Say(none ? "IDS_QM_JUDGE_NO_END" : "IDS_QM_JUDGE_NOT_PASSED");
        return limit;
    }
    limit.capacity = std::fabs(first.displacement - start);
    if (first.atStart) {
        limit.why = Say("IDS_QM_JUDGE_AT_START");
        return limit;
    }
    limit.factor = scaled.FactorTo(*limit.capacity, target);
    if (!limit.PgaRatio()) limit.why = Say("IDS_QM_JUDGE_NO_FACTOR");
    return limit;
}

void FindLimits(CDBDoc& doc, const T_PUSH_EVALUATION& result, const T_JUDGED_PATH& path,
                double start, T_JUDGEMENT& out)
{
    const std::vector<T_FIRST_PASS> passes = FirstPasses(out.ends, path, out.options.factors);
    CScaledEvaluation scaled(doc, result.eval);
    for (const T_JUDGED_STATE& state : out.states)
        for (const T_FIRST_PASS& first : passes)
            if (first.level == state.level)
                out.limits.push_back(LimitOf(first, state, start, scaled));
}

/// The state of the path at a displacement that is one of its steps.
std::optional<std::size_t> IndexAt(const T_JUDGED_PATH& path, double displacement)
{
    constexpr double kSame = 1e-9; // of the largest, as steps are told from one another
    double furthest = 0.0;
    for (const double d : path.displacement)
        furthest = std::max(furthest, std::fabs(d));
    const auto at = std::ranges::find_if(path.displacement, [&](double d) {
        return std::fabs(d - displacement) <= kSame * furthest;
    });
    if (at == path.displacement.end()) return {};
    return static_cast<std::size_t>(at - path.displacement.begin());
}

} // namespace

T_JUDGEMENT JudgeEvaluation(CDBDoc& doc, const T_PUSH_EVALUATION& result,
                            const T_JUDGE_OPTIONS& options, const PUSH_PROGRESS_FN& progress)
{
    T_JUDGEMENT out;
    out.evaluation = result.eval.name.empty() ? MethodName(result.eval.method) : result.eval.name;
    out.push = result.eval.push;
    out.units = result.units;
    out.options = options;
    CPathTaker taker(doc.Data().Model(), options);
    T_PUSH_RUN run;
    const T_HINGES_AT hinges = PushToEvaluation(
        doc, result, progress, run, [&](const T_STEP_FORCES& step) { taker.Take(step); });
    out.note = hinges.note;
    if (hinges.push.empty()) out.note = Say("IDS_QM_JUDGE_OTHER_PUSH");
    if (out.note.empty() && hinges.points.empty()) out.note = Say("IDS_QM_JUDGE_NO_POINT");
    if (!out.note.empty()) return out;
    out.ends = std::move(taker.ends);
    const T_JUDGED_PATH path = std::move(taker.path);
    out.start = run.startDisplacement;
    out.stale = StaleHinges(doc);
    out.states = StatesOf(hinges, options, NamesOf(out.ends));
    for (T_JUDGED_STATE& state : out.states)
        if (state.found == AT_POINT::Reached)
            if (const auto index = IndexAt(path, state.point.displacement))
                JudgeState(out.ends, path, *index, options, state);
    FindLimits(doc, result, path, run.startDisplacement, out);
    return out;
}

std::optional<T_JUDGEMENT> JudgementForReport(CDBDoc& doc, const T_PUSH_EVALUATION& result,
                                              const T_JUDGE_OPTIONS& options,
                                              const PUSH_PROGRESS_FN& progress)
{
    const T_MODEL& model = doc.Data().Model();
    const bool hasHinges = std::ranges::any_of(model.hinges, [&](const auto& entry) {
        const auto type = model.hingeTypes.find(entry.second.hingeType);
        return type != model.hingeTypes.end() && type->second.generated;
    });
    if (!options.code && !hasHinges) return std::nullopt;
    return JudgeEvaluation(doc, result, options, progress);
}

std::string ReportOfJudgement(CDBDoc& doc, const T_PUSH_EVALUATION& result,
                              const T_JUDGE_OPTIONS& options, const PUSH_PROGRESS_FN& progress)
{
    const auto judgement = JudgementForReport(doc, result, options, progress);
    return judgement ? JudgementReport(*judgement) : std::string();
}
