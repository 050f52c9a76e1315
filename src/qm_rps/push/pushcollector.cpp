#include "qm_rps/push/pushcollector.h"

#include "qm_base/say.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/push/loadalgebra.h"

#include <cmath>

namespace {

/// What the recorder reads of the engine's model.
solver::T_PUSH_MODEL EngineOf(const T_PUSH_HINGES& hinges)
{
    solver::T_PUSH_MODEL model;
    model.hinges = hinges.hinges;
    return model;
}

} // namespace

T_RUN_HEAD CPushCollector::HeadOf(const T_PUSH_CASE& c)
{
    T_RUN_HEAD head;
    head.turn = c.turn;
    head.angle = c.angle.value_or(0.0);
    if (c.direction > 2) head.control[c.direction] = 1.0;
    for (std::size_t d = 0; d < 3; ++d)
        if (c.direction < 3) head.control[d] = c.along[d];
    return head;
}

CPushCollector::CPushCollector(const T_MODEL& model, const CAnalysisModel& frame,
                               const T_PUSH_HINGES& hinges, const T_PUSH_CASE& c)
    : m_frame(frame.Frame()), m_hinges(hinges), m_case(c), m_vertical(VerticalAxis(model)),
      m_storeys(StoreysOf(model, frame, c.direction)), m_factors(c.stages.size(), 0.0),
      m_recorder(model, c.key, HeadOf(c), EngineOf(hinges), frame.NodeIds(), frame.ElementIds())
{
    for (const solver::T_PUSH_STAGE& stage : c.stages)
        m_forces.push_back(NodeForces(stage.loads, m_frame));
    m_lawAt.resize(hinges.hinges.size());
    for (std::size_t i = 0; i < hinges.laws.size(); ++i) {
        m_lawAt[hinges.laws[i].hinge].push_back(i);
        const solver::T_PUSH_HINGE& hinge = hinges.hinges[hinges.laws[i].hinge];
        m_run.hinges.push_back(
            {hinges.laws[i], hinge.laws[hinges.laws[i].law], hinge.biaxial, {}, {}, {}});
    }
    for (const solver::T_PUSH_DRIFT& drift : DriftsOf(model, frame, m_storeys)) {
        const auto has = [&](const T_PUSH_STOREY& storey) {
            return std::ranges::find(storey.nodes, drift.node) != storey.nodes.end() &&
                   storey.height == drift.height;
        };
        const auto at = std::ranges::find_if(m_storeys, has);
        m_driftStorey.push_back(static_cast<int>(at - m_storeys.begin()) + 1);
    }
    for (const T_PUSH_STOREY& storey : m_storeys)
        m_run.storeys.push_back({storey.name, storey.elevation, storey.height, {}, {}, {}});
    m_run.name = c.name;
    m_run.key = c.key;
    m_run.direction = c.direction;
    m_run.turn = c.turn;
}

/// Translation or force along the direction of control; of a rotation the turn or moment.
double CPushCollector::Along(const solver::T_VEC6& v) const
{
    if (m_case.direction > 2) return v[m_case.direction];
    double sum = 0.0;
    for (std::size_t d = 0; d < 3; ++d)
        if (m_case.along[d] != 0.0) sum += m_case.along[d] * v[d];
    return sum;
}

void CPushCollector::Start(const solver::T_PUSH_STEP& step)
{
    if (step.stage + 1 != m_case.stages.size()) return;
    m_run.startDisplacement = Along(step.nodes[m_case.controlNode]);
    m_run.startReaction = 0.0 - Along(step.base);
    m_recorder.Start(step);
}

bool CPushCollector::Take(const solver::T_PUSH_STEP& step)
{
    m_factors[step.stage] = step.loadFactor;
    if (step.stage + 1 != m_case.stages.size()) return false;
    m_run.loadFactor.push_back(step.loadFactor);
    m_run.displacement.push_back(Along(step.nodes[m_case.controlNode]));
    m_run.baseReaction.push_back(0.0 - Along(step.base));
    m_run.residual.push_back(step.residual);
    if (step.additional) m_run.additional.push_back(static_cast<int>(m_run.loadFactor.size()));
    for (std::size_t i = 0; i < m_run.hinges.size(); ++i) {
        T_PUSH_HINGE_SERIES& series = m_run.hinges[i];
        const solver::T_HINGE_STATE& state = step.hinges[i];
        series.deformation.push_back(state.deformation);
        series.force.push_back(state.force);
        series.state.push_back(StateOf(series.place, series.law, state));
    }
    TakeStoreys(step);
    m_recorder.Add(step, step.additional && IsEvaluated(m_run.displacement.back()));
    return true;
}

/// The place of a step that evaluations have asked for.
bool CPushCollector::IsEvaluated(double displacement) const
{
    return std::ranges::any_of(m_case.evaluated, [&](double d) {
        return std::fabs(d - displacement) <= kSameDisplacement * std::fabs(d);
    });
}

void CPushCollector::TakeStoreys(const solver::T_PUSH_STEP& step)
{
    double below = 0.0;
    for (std::size_t k = 0; k < m_storeys.size(); ++k) {
        const T_PUSH_STOREY& storey = m_storeys[k];
        const double displacement = DisplacementOf(storey, step.nodes, m_case.along);
        double shear = 0.0;
        for (std::size_t s = 0; s < m_forces.size(); ++s)
            shear += m_factors[s] * ShearOf(storey, m_forces[s], m_frame, m_vertical, m_case.along);
        m_run.storeys[k].displacement.push_back(displacement);
        m_run.storeys[k].drift.push_back((displacement - below) / storey.height);
        m_run.storeys[k].shear.push_back(shear);
        below = displacement;
    }
}

void CPushCollector::Take(const solver::T_PUSH_EVENT& event)
{
    const int own = static_cast<int>(m_case.stages.size()) - 1;
    const bool initial = event.stage < 0;
    if (event.stage != own && !(initial && own == 0)) return;
    m_recorder.Add(event);
    T_PUSH_EVENT_ROW row{
        initial, event.loadFactor, event.displacement, 0.0 - Along(event.base), {}};
    for (const solver::T_HINGE_EVENT& h : event.hinges) {
        const std::size_t at = m_lawAt[h.hinge][h.law];
        row.hinges.push_back({at, EventTarget(m_run.hinges[at].place, h)});
    }
    m_run.events.push_back(std::move(row));
}

std::string CPushCollector::HingeWords(long hinge) const
{
    if (hinge < 0 || static_cast<std::size_t>(hinge) >= m_lawAt.size()) return {};
    const std::vector<std::size_t>& laws = m_lawAt[static_cast<std::size_t>(hinge)];
    std::string components;
    for (const std::size_t law : laws)
        components +=
            (components.empty() ? "" : "-") +
            std::string(kComponentNames[static_cast<std::size_t>(m_hinges.laws[law].component)]);
    const T_PUSH_LAW_PLACE& place = m_hinges.laws[laws.front()];
    return Say("IDS_QM_PUSH_HINGE_AT", std::to_string(place.element), place.end, components);
}

/// The hinge or the storey that ended it; empty: neither.
std::string CPushCollector::PlaceWords(const solver::T_PUSH_END& end, int storey) const
{
    if (const std::string hinge = HingeWords(end.hinge); !hinge.empty())
        return Say("IDS_QM_PUSH_ADVICE_HINGE", hinge);
    if (storey < 1 || storey > std::ssize(m_storeys)) return {};
    return Say("IDS_QM_PUSH_ADVICE_STOREY", m_storeys[static_cast<std::size_t>(storey - 1)].name);
}

/// Measured as the case is controlled. A drop of strength passes its vertices on the way back.
bool CPushCollector::IsBeyondLastStep(const T_PUSH_EVENT_ROW& event) const
{
    if (event.initial) return false;
    if (m_run.loadFactor.empty()) return true;
    if (m_case.stages.back().control == solver::PUSH_CONTROL::LoadFactor)
        return event.loadFactor > m_run.loadFactor.back() * (1.0 + kSameDisplacement);
    const double last = m_run.displacement.back() - m_run.startDisplacement;
    return (event.displacement - m_run.startDisplacement) * last >
           last * last * (1.0 + kSameDisplacement);
}

/// The engine hands on steps in blocks, and vertices as it passes them: of a run that was broken
/// off it has told vertices that no step leads to.
void CPushCollector::EndAtLastStep()
{
    const auto beyond = std::ranges::find_if(
        m_run.events, [this](const T_PUSH_EVENT_ROW& event) { return IsBeyondLastStep(event); });
    m_run.events.erase(beyond, m_run.events.end());
    m_run.data.events.resize(m_run.events.size());
}

T_PUSH_RUN CPushCollector::Finish(solver::T_PUSH_END end, int storey)
{
    const bool broken = end.outcome == solver::PUSH_OUTCOME::Cancelled ||
                        end.outcome == solver::PUSH_OUTCOME::OutOfBalance;
    if (broken && !m_run.loadFactor.empty()) {
        end.loadFactor = m_run.loadFactor.back();
        end.displacement = m_run.displacement.back();
    }
    if (end.drift >= 0 && end.drift < std::ssize(m_driftStorey))
        storey = m_driftStorey[static_cast<std::size_t>(end.drift)];
    m_run.cancelled = end.outcome == solver::PUSH_OUTCOME::Cancelled;
    m_run.status = StatusOf(end.outcome);
    m_run.outcome = PushOutcomeName(end.outcome);
    m_run.advice = PushOutcomeAdvice(end.outcome, end.loadFactor, PlaceWords(end, storey),
                                     !m_run.loadFactor.empty());
    if (end.stage + 1 < m_case.stages.size() && end.outcome != solver::PUSH_OUTCOME::InitialLoads) {
        m_run.status = PUSH_STATUS::Failed;
        m_run.advice = Say("IDS_QM_PUSH_ADVICE_EARLIER") + " " + m_run.advice;
    }
    m_recorder.End(end, storey);
    m_run.data = m_recorder.Take();
    if (broken) EndAtLastStep();
    return std::move(m_run);
}
