#include "qm_rps/push/pushrun.h"

#include "qm_base/say.h"
#include "qm_db/recordfacts.h"
#include "qm_db/sectionproperties.h"
#include "qm_rps/push/loadalgebra.h"
#include "qm_rps/push/pushcollector.h"
#include "qm_rps/push/pushwarnings.h"
#include "qm_rps/push/stopwarnings.h"
#include "qm_solver/framesolver.h"

#include <algorithm>
#include <cmath>

/// A basis with its factorisation.
struct CPushRun::T_PREPARED {
    T_PUSH_BASIS basis;
    solver::CPushSolver solver;
    T_PUSH_HINGES hinges;
    std::vector<solver::T_RESULT> initial; // of the linear analysis, where it was needed
    std::vector<solver::T_MODE> modes;
};

CPushRun::CPushRun(CDBDoc& doc) : m_doc(doc), m_model(doc.Data().Model()), m_frame(m_model) {}
CPushRun::~CPushRun() = default;

std::string CPushRun::Words(const solver::T_SOLVER_ERROR& error) const
{
    return m_frame.ErrorOf(error, {}).text;
}

int CPushRun::BuildFrame(std::string& error)
{
    T_ANALYSIS_ERROR fault;
    m_hasFrame = m_hasFrame || m_frame.BuildFrame(fault);
    if (!m_hasFrame) error = fault.text;
    return m_hasFrame ? 1 : 0;
}

int CPushRun::AxialOf(const solver::T_LOAD_CASE& initial, T_PREPARED& to, std::string& error)
{
    solver::CFrameSolver linear;
    solver::T_SOLVER_ERROR fault;
    if (linear.Prepare(m_frame.Frame(), fault) && linear.Solve({&initial, 1}, to.initial, fault))
        return 1;
    error = Words(fault);
    return 0;
}

int CPushRun::PrepareNew(const T_PUSH_BASIS& basis, T_PREPARED& to, std::string& error)
{
    to.basis = basis;
    for (const T_FINDING& wrong : StoreyFindings(m_model)) {
        error = wrong.text;
        return 0;
    }
    solver::T_PUSH_MODEL model;
    if (!BuildInitialLoads(m_frame, basis.initialLoads, model.initial, error)) return 0;
    const T_POGC_D& control = m_model.pushControl;
    T_PUSH_LAW_OPTIONS options;
    options.types = control.hingeTypes;
    options.flow = control.flow == PUSH_FLOW::Associated ? solver::HINGE_FLOW::Associated
                                                         : solver::HINGE_FLOW::Rotations;
    if (NeedsInitialAxial(m_model, control.hingeTypes) && !basis.initialLoads.empty()) {
        if (!AxialOf(model.initial, to, error)) return 0;
        options.axial = [&to](std::size_t element, double at) {
            const auto& force = to.initial.front().force[element];
            const double place = at * (solver::kBeamPositions - 1);
            const auto i = std::min(static_cast<std::size_t>(place), solver::kBeamPositions - 2);
            return force[i][0] + (place - static_cast<double>(i)) * (force[i + 1][0] - force[i][0]);
        };
    }
    if (!BuildPushHinges(m_doc, m_frame.ElementIds(), options, to.hinges, error)) return 0;
    model.frame = m_frame.Frame();
    model.hinges = to.hinges.hinges;
    static_assert(static_cast<int>(PUSH_P_DELTA::Updated) ==
                  static_cast<int>(solver::P_DELTA::Updated));
    model.pDelta = static_cast<solver::P_DELTA>(basis.pDelta);
    model.vertical = static_cast<int>(VerticalAxis(m_model));
    model.drifts = DriftsOf(m_model, m_frame, StoreysOf(m_model, m_frame, 0));
    model.mostEvents = static_cast<std::size_t>(control.mostEvents);
    solver::T_SOLVER_ERROR fault;
    if (to.solver.Prepare(std::move(model), fault)) return 1;
    error = Words(fault);
    return 0;
}

int CPushRun::Prepare(const T_PUSH_BASIS& basis, T_PREPARED*& out, std::string& error)
{
    for (const auto& prepared : m_prepared)
        if (prepared->basis == basis) {
            out = prepared.get();
            return 1;
        }
    auto fresh = std::make_unique<T_PREPARED>();
    if (!PrepareNew(basis, *fresh, error)) return 0;
    out = m_prepared.emplace_back(std::move(fresh)).get();
    return 1;
}

int CPushRun::Modes(std::size_t count, std::vector<solver::T_MODE>& out, std::string& error)
{
    const T_POGC_D& control = m_model.pushControl;
    T_PREPARED* on = nullptr;
    if (!BuildFrame(error) || !Prepare({control.initialLoads, control.pDelta}, on, error)) return 0;
    solver::T_SOLVER_ERROR fault;
    if (on->solver.Modes(count, out, fault)) return 1;
    error = Words(fault);
    return 0;
}

std::vector<solver::T_VEC6> CPushRun::ModeShape(T_PREPARED& on, int mode, const T_POLC_D& record,
                                                std::string& error)
{
    const std::string number = std::to_string(mode);
    const auto index = static_cast<std::size_t>(mode - 1);
    solver::T_SOLVER_ERROR fault;
    if (mode < 1 || (on.modes.size() <= index && !on.solver.Modes(index + 1, on.modes, fault)) ||
        on.modes.size() <= index) {
        error = Say("IDS_QM_PUSH_PATTERN_NO_MODE", number,
                    fault.reason.empty() ? Say("IDS_QM_PUSH_PATTERN_FEW_MODES") : Words(fault));
        return {};
    }
    std::vector<solver::T_VEC6> shape = on.modes[index].shape;
    const std::vector<int>& ids = m_frame.NodeIds();
    const auto at = std::ranges::lower_bound(ids, record.controlNode);
    const double control = shape[static_cast<std::size_t>(at - ids.begin())]
                                [static_cast<std::size_t>(record.direction - 1)];
    double largest = 0.0;
    for (const solver::T_VEC6& v : shape)
        for (const double x : v)
            largest = std::max(largest, std::fabs(x));
    constexpr double kStill = 1e-9; // of the largest movement
    if (!(std::fabs(control) > kStill * largest)) {
        error = Say("IDS_QM_PUSH_PATTERN_MODE_STILL", number);
        return {};
    }
    for (solver::T_VEC6& v : shape)
        for (double& x : v)
            x /= control;
    return shape;
}

int CPushRun::RunCase(T_PREPARED& on, const T_PUSH_CASE& c, const PUSH_PROGRESS_FN& progress,
                      T_PUSH_RUN& out, std::string& error)
{
    CPushCollector collector(m_model, m_frame, on.hinges, c);
    std::vector<solver::T_PUSH_STEP> steps, starts; // where their forces are told
    solver::T_PUSH_SINK sink;
    sink.step = [&](const solver::T_PUSH_STEP& step) {
        if (!collector.Take(step)) return true;
        if (m_forces) steps.push_back(step);
        const T_PUSH_RUN& so = collector.SoFar();
        return !progress || progress({c.name, so.loadFactor.size(), c.stages.back().steps.size(),
                                      so.displacement.back(), so.baseReaction.back(),
                                      so.startDisplacement, so.startReaction.value_or(0.0)});
    };
    sink.start = [&](const solver::T_PUSH_STEP& step) {
        collector.Start(step);
        if (m_forces) starts.push_back(step);
    };
    sink.event = [&](const solver::T_PUSH_EVENT& event) { collector.Take(event); };
    solver::T_PUSH_END end;
    solver::T_SOLVER_ERROR fault;
    if (!on.solver.Run(c.stages, sink, end, fault)) {
        error = Words(fault);
        return 0;
    }
    out = collector.Finish(end);
    return TellStarts(on, c, starts, error) && TellSteps(on, out, steps, error) ? 1 : 0;
}

/// The first stage starts under the initial loads, the last one is that of the case.
int CPushRun::TellStarts(T_PREPARED& on, const T_PUSH_CASE& c,
                         const std::vector<solver::T_PUSH_STEP>& starts, std::string& error)
{
    const std::size_t own = c.stages.size() - 1;
    const auto tell = [&](const solver::T_PUSH_STEP& start, FORCES_OF of) {
        solver::T_RESULT result;
        solver::T_SOLVER_ERROR fault;
        if (!on.solver.Forces(start, result, fault)) {
            error = Words(fault);
            return false;
        }
        solver::T_PUSH_STEP step = start;
        step.stage = own;
        CPushCollector alone(m_model, m_frame, on.hinges, c);
        (void)alone.Take(step);
        const T_PUSH_RUN run = alone.Finish({});
        m_forces({run, 0, m_frame.ElementIds(), result, of});
        return true;
    };
    for (const solver::T_PUSH_STEP& start : starts) {
        if (start.stage == 0 && !tell(start, FORCES_OF::InitialLoads)) return 0;
        if (start.stage == own && !tell(start, FORCES_OF::Start)) return 0;
    }
    return 1;
}

int CPushRun::TellSteps(T_PREPARED& on, const T_PUSH_RUN& run,
                        const std::vector<solver::T_PUSH_STEP>& steps, std::string& error)
{
    for (std::size_t i = 0; i < steps.size(); ++i) {
        solver::T_RESULT result;
        solver::T_SOLVER_ERROR fault;
        if (!on.solver.Forces(steps[i], result, fault)) {
            error = Words(fault);
            return 0;
        }
        m_forces({run, i, m_frame.ElementIds(), result});
    }
    return 1;
}

void CPushRun::Keep(std::vector<T_PUSH_RUN>& runs)
{
    std::map<int, std::vector<std::shared_ptr<IPushRun>>> byCase;
    for (const T_PUSH_RUN& run : runs)
        byCase[run.key].push_back(MakePushRun(run.data));
    for (const auto& [key, all] : byCase)
        m_doc.Data().SetPushRuns(key, all);
}

int CPushRun::PrepareCases(int key, std::vector<T_PUSH_CASE>& out, T_PREPARED*& on,
                           std::string& error)
{
    const auto record = m_model.pushovers.find(key);
    if (record == m_model.pushovers.end()) {
        error = Say("IDS_QM_PUSH_NO_INITIAL_CASE");
        return 0;
    }
    for (const T_FINDING& wrong : PushControlFindings(m_model.pushControl, m_model)) {
        error = Say("IDS_QM_UI_POGC_TITLE") + ": " + wrong.field + ": " + wrong.text;
        return 0;
    }
    if (!BuildFrame(error)) return 0;
    std::vector<int> chain;
    T_PUSH_BASIS basis;
    // Shapes that the engine makes belong to the case at the end of the chain.
    const MODE_SHAPE_FN shape = [&](int mode, std::string& why) {
        return ModeShape(*on, mode, record->second, why);
    };
    if (PushChainOf(m_model, key, chain, error) && PushBasisOf(m_model, chain, basis, error) &&
        Prepare(basis, on, error) && BuildPushCases(m_model, m_frame, chain, shape, out, error))
        return 1;
    error = Say("IDS_QM_PUSH_CASE_QUOTED", record->second.name) + ": " + error;
    return 0;
}

/// P-Delta goes with the chord of a member; a kink inside it is not seen.
int CPushRun::Run(int key, const PUSH_PROGRESS_FN& progress, std::vector<T_PUSH_RUN>& out,
                  std::string& error, const std::vector<double>& extra)
{
    T_PREPARED* on = nullptr;
    std::vector<T_PUSH_CASE> cases;
    if (!PrepareCases(key, cases, on, error)) return 0;
    const auto warnings = StopWarnings(m_model.pushovers.at(key).stops,
                                       !StoreysOf(m_model, m_frame, 0).empty(), on->hinges.laws);
    const std::string elastic = NoHingeText(m_model), factors = StiffnessFactorText(m_model);
    std::vector<T_PUSH_RUN> runs;
    for (T_PUSH_CASE& c : cases) {
        std::vector<double>& steps = c.stages.back().additional;
        steps.insert(steps.end(), extra.begin(), extra.end());
        c.evaluated = extra;
        if (!RunCase(*on, c, progress, runs.emplace_back(), error)) {
            error = Say("IDS_QM_PUSH_CASE_QUOTED", m_model.pushovers.at(key).name) + ": " + error;
            return 0;
        }
        for (const std::string& text : {elastic, factors})
            if (!text.empty()) runs.back().warnings.push_back(text);
        for (const T_FINDING& warning : warnings)
            runs.back().warnings.push_back(warning.field + ": " + warning.text);
        if (runs.back().cancelled) break;
    }
    out.insert(out.end(), std::make_move_iterator(runs.begin()),
               std::make_move_iterator(runs.end()));
    return 1;
}

/// Load factors at the ends of the cases that this one starts from; empty: their results are not
/// there any more.
std::optional<std::vector<double>> CPushRun::FactorsBefore(int key)
{
    std::vector<int> chain;
    std::vector<double> out, factors;
    std::string error;
    if (!PushChainOf(m_model, key, chain, error)) return std::nullopt;
    chain.pop_back();
    for (const int before : chain) {
        IPushRun* const run = m_doc.Post().RunOf(before);
        if (!run || m_doc.Post().IsStale(before, error) || !run->ReadLoadFactors(factors) ||
            factors.empty())
            return std::nullopt;
        out.push_back(factors.back());
    }
    return out;
}

namespace {

/// A stored step as the engine gave it.
solver::T_PUSH_STEP StepOf(const T_RUN_DATA& data, std::size_t i, const T_PUSH_HINGES& hinges)
{
    const T_RUN_STEP& from = data.steps[i];
    solver::T_PUSH_STEP step{static_cast<std::size_t>(from.stage),
                             from.loadFactor,
                             from.displacement,
                             from.base,
                             from.residual,
                             from.additional,
                             data.displacement[i],
                             {},
                             std::vector<double>(hinges.hinges.size())};
    for (std::size_t h = 0; h < hinges.laws.size(); ++h) {
        const T_RUN_STATE& state = data.states[i][h];
        step.hinges.push_back({state.deformation, state.force, state.place});
        step.axial[hinges.laws[h].hinge] = state.axial;
    }
    return step;
}

solver::T_PUSH_EVENT EventOf(const T_RUN_EVENT& from, const T_PUSH_HINGES& hinges)
{
    solver::T_PUSH_EVENT event{from.stage, from.loadFactor, from.displacement, from.base, {}};
    for (const T_RUN_TURN& turn : from.turns) {
        const T_PUSH_LAW_PLACE& place = hinges.laws[static_cast<std::size_t>(turn.hinge)];
        event.hinges.push_back({place.hinge, place.law, turn.turn, turn.point, turn.positive});
    }
    return event;
}

} // namespace

int CPushRun::Read(int key, int turn, T_PUSH_RUN& out, std::string& error)
{
    IPushRun* const stored = m_doc.Post().RunOf(key, turn);
    T_RUN_DATA data;
    T_PREPARED* on = nullptr;
    std::vector<T_PUSH_CASE> cases;
    error = Say("IDS_QM_PUSH_NO_RUN");
    if (!stored || m_doc.Post().IsStale(key, error, turn) || !ReadWholeRun(*stored, data, error) ||
        !PrepareCases(key, cases, on, error))
        return 0;
    const auto c = std::ranges::find(cases, turn, &T_PUSH_CASE::turn);
    if (c == cases.end() || data.hinges.size() != on->hinges.laws.size() || data.steps.empty())
        return 0;
    CPushCollector collector(m_model, m_frame, on->hinges, *c);
    const auto before = FactorsBefore(key);
    if (before) collector.SetFactorsBefore(*before);
    solver::T_PUSH_STEP start;
    start.stage = c->stages.size() - 1;
    start.nodes = data.start;
    start.nodes.resize(data.nodes.size());
    collector.Start(start);
    for (std::size_t i = 0; i < data.steps.size(); ++i)
        (void)collector.Take(StepOf(data, i, on->hinges));
    for (const T_RUN_EVENT& event : data.events)
        collector.Take(EventOf(event, on->hinges));
    const T_RUN_END& end = data.head.end;
    const bool knowsHinge = end.hinge > 0 && end.hinge <= std::ssize(on->hinges.laws);
    const std::size_t law = knowsHinge ? static_cast<std::size_t>(end.hinge - 1) : 0;
    const long hinge = knowsHinge ? static_cast<long>(on->hinges.laws[law].hinge) : -1;
    out = collector.Finish({end.outcome, static_cast<std::size_t>(end.stage), end.loadFactor,
                            end.displacement, hinge, -1},
                           end.storey);
    out.data.steps = std::move(data.steps); // with what evaluations have asked for
    out.data.head.startReaction = data.head.startReaction;
    out.startReaction.reset();
    if (!data.start.empty()) out.startReaction = data.head.startReaction;
    if (!before)
        for (T_PUSH_STOREY_SERIES& storey : out.storeys)
            storey.shear.clear();
    return 1;
}
