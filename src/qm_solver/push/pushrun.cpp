#include "qm_solver/push/pushrun.h"

#include <algorithm>
#include <cmath>

namespace solver {

namespace {

constexpr std::size_t kStepBlock = 16; // stored steps that are solved together
constexpr double kBalanced = 1e-8;     // residual of a stored step
constexpr double kTensionKept = 1e-10; // of the largest axial force: P-Delta is up to date
constexpr int kMostUpdates = 30;

bool IsEmpty(const T_LOAD_CASE& loads)
{
    return loads.selfWeight == T_VEC3{} && loads.nodal.empty() && loads.beam.empty() &&
           loads.settlement.empty() && loads.temperature.empty() && loads.pretension.empty();
}

bool Differ(std::span<const double> a, std::span<const double> b)
{
    double most = 0.0, apart = 0.0;
    for (std::size_t i = 0; i < a.size(); ++i) {
        most = std::max(most, std::fabs(a[i]));
        apart = std::max(apart, std::fabs(a[i] - (b.empty() ? 0.0 : b[i])));
    }
    return apart > kTensionKept * most;
}

/// The target, or a stop that was asked for: what follows starts from there.
bool IsWanted(PUSH_OUTCOME outcome)
{
    constexpr PUSH_OUTCOME kWanted[] = {
        PUSH_OUTCOME::Reached,       PUSH_OUTCOME::DriftStop,     PUSH_OUTCOME::PeakFractionStop,
        PUSH_OUTCOME::StiffnessStop, PUSH_OUTCOME::MarkStop,      PUSH_OUTCOME::StrengthLossStop,
        PUSH_OUTCOME::LastPointStop, PUSH_OUTCOME::ReachedByLeaps};
    return std::find(std::begin(kWanted), std::end(kWanted), outcome) != std::end(kWanted);
}

T_PUSH_STAGE InitialStage(const T_PUSH_MODEL& model)
{
    T_PUSH_STAGE stage;
    stage.loads = model.initial;
    stage.control = PUSH_CONTROL::LoadFactor;
    stage.target = 1.0;
    return stage;
}

} // namespace

CPushRun::T_FAULT CPushRun::Go(std::span<const T_PUSH_STAGE> stages, T_PUSH_END& end)
{
    end = {};
    bool goesOn = true;
    if (!stages.empty()) m_follows = {stages[0].node, WayOf(stages[0])};
    m_structure.DropLoads();
    m_structure.Stiffen();
    if (auto fault = Initial(end, goesOn)) return fault;
    for (std::size_t s = 0; s < stages.size() && goesOn; ++s)
        if (auto fault = Stage(stages[s], s, end, goesOn)) return fault;
    return {};
}

/// With P-Delta the axial forces at the end of the initial loads make the couples of all of them.
CPushRun::T_FAULT CPushRun::Initial(T_PUSH_END& end, bool& goesOn)
{
    if (auto fault = m_structure.Factorise({})) return fault;
    m_path = std::make_unique<CPushPath>(m_model, m_structure);
    if (IsEmpty(m_model.initial)) return {};
    if (auto fault = m_structure.AddLoads(m_model.initial, 0)) return fault;
    if (auto fault = m_structure.SolveLoads()) return fault;
    if (auto fault = InitialPath(end, goesOn)) return fault;
    std::vector<double> tension;
    for (int tries = 0; m_model.pDelta != P_DELTA::None && goesOn && tries < kMostUpdates;
         ++tries) {
        const T_PUSH_STATE state = m_path->State();
        T_PUSH_STEP step;
        std::vector<double> axial;
        if (auto fault = m_structure.Displace({&state, 1}, {&step, 1}, axial)) return fault;
        std::vector<double> now = m_structure.Coupled(std::move(axial));
        if (!Differ(now, tension)) break;
        tension = now;
        if (auto fault = m_structure.Factorise(std::move(now))) return fault;
        if (auto fault = m_structure.SolveLoads()) return fault;
        if (auto fault = InitialPath(end, goesOn)) return fault;
    }
    for (const T_PUSH_EVENT& event : m_events)
        if (m_sink.event) m_sink.event(event);
    m_events.clear();
    return {};
}

CPushRun::T_FAULT CPushRun::InitialPath(T_PUSH_END& end, bool& goesOn)
{
    m_events.clear();
    m_eventCount = 0;
    m_isFirst = true;
    m_path = std::make_unique<CPushPath>(m_model, m_structure);
    m_nodeWatch.clear();
    m_driftWatch.clear();
    const T_PUSH_STAGE stage = InitialStage(m_model);
    m_controlWatch = m_path->Watch(m_structure.Displacement(m_follows.node, m_follows.way));
    m_nodeWatch.push_back(m_controlWatch);
    if (auto fault = m_path->BeginStage(0, std::nullopt)) return fault;
    MakeTargets(stage);
    if (auto fault = Follow(stage, -1, end)) return fault;
    goesOn = end.outcome == PUSH_OUTCOME::Reached;
    if (end.outcome == PUSH_OUTCOME::NoEquilibrium || end.outcome == PUSH_OUTCOME::NoPath)
        end.outcome = PUSH_OUTCOME::InitialLoads;
    return {};
}

CPushRun::T_FAULT CPushRun::Stage(T_PUSH_STAGE stage, std::size_t number, T_PUSH_END& end,
                                  bool& goesOn)
{
    const std::size_t set = m_structure.LoadCount();
    if (auto fault = m_structure.AddLoads(stage.loads, number)) return fault;
    if (auto fault = m_structure.SolveLoads()) return fault;
    m_nodeWatch.clear();
    m_driftWatch.clear();
    const T_VEC6 way = WayOf(stage);
    const auto watch = [&](std::size_t node) {
        return m_path->Watch(m_structure.Displacement(node, way));
    };
    m_controlWatch = watch(stage.node);
    if (stage.control == PUSH_CONTROL::LargestTranslation)
        for (std::size_t n = 0; n < m_model.frame.nodes.size(); ++n)
            m_nodeWatch.push_back(watch(n));
    else
        m_nodeWatch.push_back(m_controlWatch);
    for (const T_PUSH_DRIFT& drift : m_model.drifts) {
        const std::size_t top = watch(drift.node);
        m_driftWatch.push_back({top, drift.below == T_PUSH_DRIFT::kGround ? T_PUSH_DRIFT::kGround
                                                                          : watch(drift.below)});
    }
    double moved = 0.0; // by the load factor 1, elastically
    m_held.reset();
    if (stage.control != PUSH_CONTROL::LoadFactor) {
        const std::vector<double>& unknowns = m_structure.Loads(set).unknowns;
        for (std::size_t w = 0; w < m_nodeWatch.size(); ++w) {
            const std::size_t node = m_nodeWatch.size() == 1 ? stage.node : w;
            const double own = m_structure.Value(m_structure.Displacement(node, way), unknowns);
            if (m_held && !(std::fabs(own) > std::fabs(moved))) continue;
            m_held = m_nodeWatch[w];
            moved = own;
        }
    }
    if (stage.control == PUSH_CONTROL::LargestTranslation)
        stage.target = std::copysign(stage.target, moved); // where the loads go
    if (auto fault = m_path->BeginStage(set, m_held)) return fault;
    if (auto fault = GiveStart(number)) return fault;
    MakeTargets(stage);
    if (auto fault = Follow(stage, static_cast<int>(number), end)) return fault;
    end.stage = number;
    goesOn = IsWanted(end.outcome);
    return {};
}

void CPushRun::NoteEvent(int number)
{
    T_PUSH_EVENT event;
    event.hinges = m_path->TakeTurned();
    if (event.hinges.empty()) return;
    event.stage = number;
    event.loadFactor = m_path->Factor();
    event.displacement = m_path->Watched(m_controlWatch);
    event.base = Base();
    if (number < 0)
        m_events.push_back(std::move(event));
    else if (m_sink.event)
        m_sink.event(event);
}

CPushRun::T_FAULT CPushRun::GiveStart(std::size_t number)
{
    if (!m_sink.start) return {};
    const T_PUSH_STATE state = m_path->State();
    T_PUSH_STEP step;
    step.stage = number;
    step.loadFactor = m_path->Factor();
    step.displacement = m_path->Watched(m_controlWatch);
    step.hinges = m_path->HingeStates();
    std::vector<double> tension;
    if (auto fault = m_structure.Displace({&state, 1}, {&step, 1}, tension)) return fault;
    m_kept.push_back({number, step.loadFactor, step.displacement, state});
    m_sink.start(step);
    return {};
}

/// P-Delta with the axial forces of this step: factorised again until they are those of the factor.
CPushRun::T_FAULT CPushRun::Update(const T_PUSH_STAGE&, std::optional<double> control)
{
    std::vector<double> before;
    for (int tries = 0; tries < kMostUpdates; ++tries) {
        const T_PUSH_STATE state = m_path->State();
        T_PUSH_STEP step;
        std::vector<double> axial;
        if (auto fault = m_structure.Displace({&state, 1}, {&step, 1}, axial)) return fault;
        std::vector<double> now = m_structure.Coupled(std::move(axial));
        if (!Differ(now, m_structure.Tension())) break;
        if (auto fault = m_structure.Factorise(std::move(now))) return fault;
        if (auto fault = m_structure.SolveLoads()) return fault;
        if (auto fault = m_path->Renew()) return fault;
        if (auto fault = m_path->Correct(control)) return fault;
    }
    return {};
}

/// The event that the axial forces of the last factorisation have told, with those of here.
CPushRun::T_FAULT CPushRun::Approach(const T_PUSH_STAGE& stage, double by)
{
    const auto here = m_held ? std::optional(m_path->Watched(*m_held)) : std::nullopt;
    if (auto fault = Update(stage, here)) return fault;
    m_path->SetDrive({T_PUSH_DRIVE::KIND::Before, 1.0, {}});
    if (!m_path->Again()) return {};
    const double left = m_path->NextEvent(by);
    if (left < by) m_path->Advance(left);
    return {};
}

CPushRun::T_FAULT CPushRun::Store(const T_PUSH_STAGE& stage, int number, bool additional,
                                  T_PUSH_END& end)
{
    if (number < 0) return {};
    const double place = stage.control == PUSH_CONTROL::LoadFactor ? m_path->Watched(m_controlWatch)
                                                                   : Present(stage);
    if (IsStored(place)) return {};
    m_storedAt = place;
    T_PUSH_STEP& step = m_steps.emplace_back();
    step.stage = static_cast<std::size_t>(number);
    step.loadFactor = m_stored = m_path->Factor();
    step.displacement = m_path->Watched(m_controlWatch);
    step.additional = additional;
    step.hinges = m_path->HingeStates();
    m_states.push_back(m_path->State());
    m_wholeStates.push_back(m_path->WholeState());
    end.loadFactor = step.loadFactor;
    end.displacement = step.displacement;
    return m_steps.size() >= kStepBlock || IsUpdated() ? Flush(end) : T_FAULT{};
}

/// Displacements of the steps that wait, checked, and handed on. A step that is out of balance is
/// solved once more with a fresh factor; then the run ends before it.
CPushRun::T_FAULT CPushRun::Flush(T_PUSH_END& end)
{
    if (m_steps.empty()) return {};
    std::vector<double> axial;
    if (auto fault = m_structure.Displace(m_states, m_steps, axial)) return fault;
    for (std::size_t s = 0; s < m_steps.size() && !m_cancelled; ++s) {
        if (m_steps[s].residual > kBalanced) {
            if (auto fault = m_structure.Refactorise()) return fault;
            if (auto fault = m_structure.Displace({&m_states[s], 1}, {&m_steps[s], 1}, axial))
                return fault;
        }
        if (m_steps[s].residual > kBalanced) {
            end.outcome = PUSH_OUTCOME::OutOfBalance;
            m_cancelled = true;
            break;
        }
        m_kept.push_back(
            {m_steps[s].stage, m_steps[s].loadFactor, m_steps[s].displacement, m_states[s]});
        if (m_sink.step && !m_sink.step(m_steps[s])) {
            end.outcome = PUSH_OUTCOME::Cancelled;
            m_cancelled = true;
        }
    }
    m_steps.clear();
    m_states.clear();
    m_wholeStates.clear();
    return {};
}

CPushRun::T_FAULT CPushRun::Follow(const T_PUSH_STAGE& stage, int number, T_PUSH_END& end)
{
    const bool byLoad = stage.control == PUSH_CONTROL::LoadFactor;
    const auto finish = [&](PUSH_OUTCOME outcome) -> T_FAULT {
        // The last state that stands is a step, too.
        const bool isStep = outcome == PUSH_OUTCOME::NoEquilibrium ||
                            outcome == PUSH_OUTCOME::NoPath || outcome == PUSH_OUTCOME::Mechanism ||
                            outcome == PUSH_OUTCOME::AxialStrength;
        if (isStep && number >= 0 && m_path->Factor() != m_stored && !IsBehind(stage)) {
            if (auto fault = m_path->Correct(std::nullopt)) return fault;
            if (auto fault = Store(stage, number, false, end)) return fault;
            if (m_cancelled) outcome = end.outcome;
        }
        end.outcome = outcome;
        end.loadFactor = m_path->Factor();
        end.displacement = m_path->Watched(m_controlWatch);
        return Flush(end);
    };
    const auto drive = [&] {
        return T_PUSH_DRIVE{
            byLoad ? T_PUSH_DRIVE::KIND::Factor : T_PUSH_DRIVE::KIND::Control, m_sign, {}};
    };
    m_path->SetDrive(drive());
    // A snap-back may take all of the way here back, not more.
    const double mostBack =
        std::max(std::fabs(m_start - m_origin), std::fabs(stage.target - m_start));
    while (m_target < m_targets.size()) {
        T_FAULT fault;
        const CPushPath::WAY found = m_path->Select(fault);
        if (found == CPushPath::WAY::Fault) return fault;
        NoteEvent(number);
        if (found == CPushPath::WAY::On && m_path->WantsFold()) {
            if ((fault = Flush(end)) || (fault = m_path->Fold())) return fault;
            if (m_cancelled) return finish(end.outcome);
            m_path->SetDrive({T_PUSH_DRIVE::KIND::Before, 1.0, {}});
            continue;
        }
        if (found == CPushPath::WAY::None && number >= 0 && stage.leaps &&
            stage.control == PUSH_CONTROL::Displacement) {
            const CPushPath::WAY lept = Leap(stage, number, end, fault);
            if (lept == CPushPath::WAY::Fault) return fault;
            if (m_cancelled) return finish(end.outcome);
            if (lept == CPushPath::WAY::On && StopsBehindLeap(stage, number, end))
                return finish(end.outcome);
            if (lept == CPushPath::WAY::On) continue;
        }
        if (found == CPushPath::WAY::None || (byLoad && !m_path->LoadGrows()))
            return finish(byLoad ? PUSH_OUTCOME::NoEquilibrium : PUSH_OUTCOME::NoPath);
        if (stage.control == PUSH_CONTROL::Displacement && m_path->IsElsewhere())
            return finish(PUSH_OUTCOME::Mechanism);
        if (number >= 0 && StopsHere(stage, end)) {
            if (m_path->Factor() != 0.0 && (fault = Store(stage, number, false, end))) return fault;
            return finish(end.outcome);
        }
        T_PUSH_END stop;
        const bool isBehind = IsBehind(stage);
        double toEvent = m_path->NextEvent(), toTarget = ToTarget(stage),
               toStop = number < 0 || isBehind ? CHingeBackbone::kFar : ToStop(stage, stop),
               toReturn = isBehind ? ToReturn(stage) : CHingeBackbone::kFar;
        std::size_t extra = 0;
        double toExtra = number < 0 || isBehind ? CHingeBackbone::kFar : ToExtra(extra);
        const double by = std::min({toEvent, toTarget, toStop, toReturn, toExtra});
        if (!(by < CHingeBackbone::kFar)) return finish(PUSH_OUTCOME::NoPath);
        m_path->Advance(by);
        if (m_path->Recede(by) < 0.0) {
            toEvent = by;
            toTarget = toStop = toReturn = toExtra = CHingeBackbone::kFar;
        }
        if (!isBehind) m_peak.reaction = std::max(m_peak.reaction, m_sign * Reaction(stage));
        if (!byLoad && m_sign * (Present(stage) - m_far) > 0.0) m_far = Present(stage);
        if (toReturn <= by) m_far = Present(stage);
        if (toExtra <= by && toTarget > by && toStop > by) {
            m_extra.erase(m_extra.begin() + static_cast<long>(extra));
            if ((fault = m_path->Correct(std::nullopt)) ||
                (fault = Store(stage, number, true, end)))
                return fault;
            if (m_cancelled) return finish(end.outcome);
        } else if (toTarget <= by || toStop <= by) {
            const bool onTarget = toTarget <= by;
            const std::optional<double> control =
                onTarget && stage.control == PUSH_CONTROL::Displacement
                    ? std::optional(m_targets[m_target].value)
                    : std::nullopt;
            if ((fault = m_path->Correct(control))) return fault;
            if (IsUpdated() && number >= 0 && (fault = Update(stage, control))) return fault;
            if ((fault = Store(stage, number, onTarget && m_targets[m_target].additional, end)))
                return fault;
            if (m_cancelled) return finish(end.outcome);
            if (!onTarget) {
                end.hinge = stop.hinge;
                end.drift = stop.drift;
                return finish(stop.outcome);
            }
            ++m_target;
        } else if (m_path->IsCurved() && (fault = m_path->Correct(std::nullopt))) {
            return fault;
        }
        if (toEvent <= by) {
            if (IsUpdated() && number >= 0 && (fault = Approach(stage, by))) return fault;
            if (++m_eventCount > m_model.mostEvents) return finish(PUSH_OUTCOME::TooManyEvents);
            ++m_structure.Cost().events;
            const long outside = m_path->Turn();
            if (byLoad) m_path->SetDrive(drive());
            if (outside >= 0) {
                end.hinge = outside;
                return finish(PUSH_OUTCOME::AxialStrength);
            }
        } else {
            m_path->SetDrive({T_PUSH_DRIVE::KIND::Before, 1.0, {}});
            if (byLoad) m_path->SetDrive(drive());
        }
        if (!byLoad && m_sign * (m_start - Present(stage)) > mostBack)
            return finish(PUSH_OUTCOME::SnapBack);
    }
    return finish(m_hasLept ? PUSH_OUTCOME::ReachedByLeaps : PUSH_OUTCOME::Reached);
}

const T_PUSH_STATE* CPushRun::StateOf(const T_PUSH_STEP& step) const
{
    for (const T_KEPT& kept : m_kept)
        if (kept.stage == step.stage && kept.loadFactor == step.loadFactor &&
            kept.displacement == step.displacement)
            return &kept.state;
    return nullptr;
}

} // namespace solver
