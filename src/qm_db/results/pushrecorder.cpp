#include "qm_db/results/pushrecorder.h"

CPushRecorder::CPushRecorder(const T_MODEL& model, int loadCase, T_RUN_HEAD head,
                             const solver::T_PUSH_MODEL& engine, std::span<const int> nodes,
                             std::span<const int> elements)
{
    head.print = PrintOfPush(model, loadCase);
    m_data.head = std::move(head);
    m_data.nodes.assign(nodes.begin(), nodes.end());
    for (std::size_t h = 0; h < engine.hinges.size(); ++h) {
        const solver::T_PUSH_HINGE& hinge = engine.hinges[h];
        m_element.push_back(elements[hinge.element]);
        m_first.push_back(static_cast<int>(m_hinge.size()));
        for (const solver::T_HINGE_LAW& law : hinge.laws) {
            m_hinge.push_back(h);
            m_data.hinges.push_back({m_element.back(), hinge.at, law.component});
        }
    }
}

/// The supports push back: in the control direction they take what is against it.
double CPushRecorder::BaseReaction(const T_DOF6& base) const
{
    double sum = 0.0;
    for (std::size_t i = 0; i < base.size(); ++i)
        sum -= m_data.head.control[i] * base[i];
    return sum;
}

void CPushRecorder::Start(const solver::T_PUSH_STEP& step)
{
    m_data.start = step.nodes;
    m_data.head.startReaction = BaseReaction(step.base);
}

void CPushRecorder::Add(const solver::T_PUSH_STEP& step, bool evaluated)
{
    std::vector<T_RUN_STATE> states;
    for (std::size_t i = 0; i < m_hinge.size(); ++i) {
        const solver::T_HINGE_STATE& s = step.hinges[i];
        states.push_back({s.deformation, s.force, step.axial[m_hinge[i]], s.place});
    }
    m_data.steps.push_back({static_cast<int>(step.stage), step.loadFactor, step.displacement,
                            BaseReaction(step.base), step.base, step.residual, step.additional,
                            evaluated});
    m_data.displacement.push_back(step.nodes);
    m_data.states.push_back(std::move(states));
}

void CPushRecorder::Add(const solver::T_PUSH_EVENT& event)
{
    T_RUN_EVENT out{event.stage,        event.loadFactor,
                    event.displacement, BaseReaction(event.base),
                    event.base,         {}};
    for (const solver::T_HINGE_EVENT& e : event.hinges)
        out.turns.push_back(
            {m_first[e.hinge] + static_cast<int>(e.law), e.turn, e.point, e.positive});
    m_data.events.push_back(std::move(out));
}

void CPushRecorder::End(const solver::T_PUSH_END& end, int storey)
{
    m_data.head.end = {
        end.outcome, static_cast<int>(end.stage), end.loadFactor, end.displacement, 0, 0, storey};
    if (end.hinge < 0) return;
    const auto hinge = static_cast<std::size_t>(end.hinge);
    m_data.head.end.element = m_element[hinge];
    m_data.head.end.hinge = m_first[hinge] + 1;
}
