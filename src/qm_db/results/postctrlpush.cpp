#include "qm_base/say.h"
#include "qm_db/postctrl.h"
#include "qm_db/results/pushprint.h"

// Results of pushes of our own.

IPushRun* CPostCtrl::RunOf(int loadCase, int turn) const
{
    IPushResult* const source = SourceOf(loadCase, turn);
    return source ? source->Run() : nullptr;
}

bool CPostCtrl::IsStale(int loadCase, std::string& reason, int turn)
{
    const IPushRun* const run = RunOf(loadCase, turn);
    const auto it = m_data.Model().pushovers.find(loadCase);
    if (!run || it == m_data.Model().pushovers.end()) return false;
    if (m_printsAt != m_data.Revision()) m_prints.clear();
    m_printsAt = m_data.Revision();
    const auto [print, isNew] = m_prints.try_emplace(loadCase);
    if (isNew) print->second = PrintOfPush(m_data.Model(), loadCase);
    const char* const change = ChangeSince(run->Head().print, print->second);
    if (change) reason = Say("IDS_QM_DB_PUSH_OLD", it->second.name, Say(change));
    return change != nullptr;
}

/// Reads from the run of the selected load case.
template <class T, class... A>
int CPostCtrl::ReadRun(int (IPushRun::*read)(A..., std::vector<T>&), A... what, std::vector<T>& out)
{
    m_error.clear();
    out.clear();
    IPushRun* const run = RunOf(m_pushover, m_turn);
    if (!run) return 0;
    if ((run->*read)(what..., out)) return 1;
    m_error = run->Error();
    return 0;
}

int CPostCtrl::GetRunHead(T_RUN_HEAD& out) const
{
    const IPushRun* const run = RunOf(m_pushover, m_turn);
    if (!run) return 0;
    out = run->Head();
    out.end.displacement = FromSi(out.end.displacement, m_data.Units(), DispDim());
    return 1;
}

int CPostCtrl::GetRunSteps(std::vector<T_RUN_STEP>& out)
{
    if (!ReadRun<T_RUN_STEP>(&IPushRun::ReadSteps, out)) return 0;
    for (T_RUN_STEP& step : out)
        PathToCurrentUnits(step);
    return 1;
}

int CPostCtrl::GetRunEvents(std::vector<T_RUN_EVENT>& out)
{
    if (!ReadRun<T_RUN_EVENT>(&IPushRun::ReadEvents, out)) return 0;
    for (T_RUN_EVENT& event : out)
        PathToCurrentUnits(event);
    return 1;
}

template <class T>
void CPostCtrl::PathToCurrentUnits(T& at) const
{
    at.displacement = FromSi(at.displacement, m_data.Units(), DispDim());
    at.baseReaction = FromSi(at.baseReaction, m_data.Units(), ReacDim());
    ToCurrentUnits(at.base, kDimForce, kDimMoment);
}

int CPostCtrl::GetRunHinges(std::vector<T_RUN_HINGE>& out)
{
    return ReadRun<T_RUN_HINGE>(&IPushRun::ReadHinges, out);
}

int CPostCtrl::GetRunNode(int node, std::vector<T_DOF6>& out)
{
    if (!ReadRun<T_DOF6, int>(&IPushRun::ReadNode, node, out)) return 0;
    for (T_DOF6& u : out)
        ToCurrentUnits(u, kDimLength, kDimNone);
    return 1;
}

int CPostCtrl::GetRunShape(int step, std::vector<T_DOF6>& out)
{
    if (!ReadRun<T_DOF6, int>(&IPushRun::ReadShape, step, out)) return 0;
    for (T_DOF6& u : out)
        ToCurrentUnits(u, kDimLength, kDimNone);
    return 1;
}

void CPostCtrl::StateToCurrentUnits(T_RUN_STATE& state, int component) const
{
    const bool along = component < 3;
    state.deformation = FromSi(state.deformation, m_data.Units(), along ? kDimLength : kDimNone);
    state.force = FromSi(state.force, m_data.Units(), along ? kDimForce : kDimMoment);
    state.axial = FromSi(state.axial, m_data.Units(), kDimForce);
}

int CPostCtrl::GetRunHinge(std::size_t hinge, std::vector<T_RUN_STATE>& out)
{
    std::vector<T_RUN_HINGE> hinges;
    if (!GetRunHinges(hinges) ||
        !ReadRun<T_RUN_STATE, std::size_t>(&IPushRun::ReadHinge, hinge, out))
        return 0;
    for (T_RUN_STATE& state : out)
        StateToCurrentUnits(state, hinges[hinge].component);
    return 1;
}

int CPostCtrl::GetRunStates(int step, std::vector<T_RUN_STATE>& out)
{
    std::vector<T_RUN_HINGE> hinges;
    if (!GetRunHinges(hinges) || !ReadRun<T_RUN_STATE, int>(&IPushRun::ReadStates, step, out))
        return 0;
    for (std::size_t i = 0; i < out.size(); ++i)
        StateToCurrentUnits(out[i], hinges[i].component);
    return 1;
}
