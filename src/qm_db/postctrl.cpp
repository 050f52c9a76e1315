#include "qm_db/postctrl.h"

#include "qm_db/records/evalnames.h"
#include "qm_db/records/storeyrules.h"
#include "qm_db/storyload.h"

#include <algorithm>
#include <cmath>

namespace {

T_POVR_D StepsOf(const CDataCtrl& data, int loadCase)
{
    const auto it = data.Model().poverSteps.find(loadCase);
    return it == data.Model().poverSteps.end() ? T_POVR_D{} : it->second;
}

} // namespace

void CPoverInfo::SetStepEC8(int loadCase, int stepDL, int stepSD, int stepNC)
{
    T_POVR_D steps = StepsOf(m_data, loadCase);
    steps.ec8 = {stepDL, stepSD, stepNC};
    m_data.SetPoverSteps(loadCase, steps);
}

void CPoverInfo::SetStepNTC2008(int loadCase, int stepSLD, int stepSLV, int stepSLC)
{
    T_POVR_D steps = StepsOf(m_data, loadCase);
    steps.ntc = {stepSLD, stepSLV, stepSLC};
    m_data.SetPoverSteps(loadCase, steps);
}

int CPoverInfo::GetStepEC8(int loadCase, std::array<int, 3>& out) const
{
    const auto it = m_data.Model().poverSteps.find(loadCase);
    if (it == m_data.Model().poverSteps.end() || !it->second.ec8) return 0;
    out = *it->second.ec8;
    return 1;
}

int CPoverInfo::GetStepNTC2008(int loadCase, std::array<int, 3>& out) const
{
    const auto it = m_data.Model().poverSteps.find(loadCase);
    if (it == m_data.Model().poverSteps.end() || !it->second.ntc) return 0;
    out = *it->second.ntc;
    return 1;
}

int CPostCtrl::GetNumEigvPost() const
{
    return static_cast<int>(m_data.Model().modes.size());
}

int CPostCtrl::SelectMode(int mode)
{
    if (mode != 0 && !m_data.Model().modes.contains(mode)) return 0;
    m_mode = mode;
    return 1;
}

void CPostCtrl::GetEiMode(int node, T_DOF6& out) const
{
    out = {};
    const auto mode = m_data.Model().modes.find(m_mode);
    if (mode == m_data.Model().modes.end()) return;
    const auto it = mode->second.shape.find(node);
    if (it != mode->second.shape.end()) out = it->second;
}

// L and M of the participation factor in the three translations; rotations have no nodal inertia.
void CPostCtrl::DeriveParticipation(const T_EIGV_D& mode, T_MPAF_D& factor, T_MPAM_D& percent) const
{
    std::array<double, 3> L{}, total{};
    double M = 0.0;
    for (const T_NODAL_MASS& nodal : CStoryLoad(m_data).Calc_Nodal_Mass()) {
        const auto it = mode.shape.find(nodal.node);
        for (std::size_t d = 0; d < 3; ++d) {
            total[d] += nodal.mass[d];
            if (it == mode.shape.end()) continue;
            L[d] += nodal.mass[d] * it->second[d];
            M += nodal.mass[d] * it->second[d] * it->second[d];
        }
    }
    for (std::size_t d = 0; d < 3 && M > 0.0; ++d) {
        factor.factor[d] = L[d] / M;
        if (total[d] > 0.0) percent.percent[d] = 100.0 * L[d] * L[d] / (M * total[d]);
    }
}

int CPostCtrl::GetEiMpafNeutral(int mode, T_MPAF_D& out) const
{
    const auto it = m_data.Model().modes.find(mode);
    if (it == m_data.Model().modes.end()) return 0;
    T_MPAF_D factor;
    T_MPAM_D percent;
    if (it->second.participation)
        factor.factor = *it->second.participation;
    else
        DeriveParticipation(it->second, factor, percent);
    out = factor;
    return 1;
}

int CPostCtrl::GetEiMpam(int mode, T_MPAM_D& out) const
{
    const auto it = m_data.Model().modes.find(mode);
    if (it == m_data.Model().modes.end()) return 0;
    T_MPAF_D factor;
    T_MPAM_D percent;
    if (it->second.massPercent)
        percent.percent = *it->second.massPercent;
    else
        DeriveParticipation(it->second, factor, percent);
    out = percent;
    return 1;
}

int CPostCtrl::CalcEiParticipation(int mode, T_MPAF_D& factor, T_MPAM_D& percent) const
{
    const auto it = m_data.Model().modes.find(mode);
    if (it == m_data.Model().modes.end()) return 0;
    DeriveParticipation(it->second, factor, percent);
    return 1;
}

IPushResult* CPostCtrl::SourceOf(int loadCase, int turn) const
{
    const auto in = [](const auto& map, const auto& key) {
        const auto it = map.find(key);
        return it == map.end() ? nullptr : it->second.get();
    };
    return turn == 0 ? in(m_data.Content().results, loadCase)
                     : in(m_data.Content().turnedResults, std::pair(loadCase, turn));
}

int CPostCtrl::Direction() const
{
    const auto it = m_data.Model().pushovers.find(m_pushover);
    return it == m_data.Model().pushovers.end() ? 0 : it->second.direction - 1;
}

T_DIM CPostCtrl::DispDim() const
{
    return DisplacementDim(Direction() + 1);
}
T_DIM CPostCtrl::ReacDim() const
{
    return ReactionDim(Direction() + 1);
}

int CPostCtrl::SelectPushover(int loadCase, int turn)
{
    if (!SourceOf(loadCase, turn) || !m_data.Model().pushovers.contains(loadCase)) return 0;
    const bool isSame = m_pushover == loadCase && m_turn == turn;
    m_pushover = loadCase;
    m_turn = turn;
    if (!isSame || m_revision != m_data.Revision()) {
        m_levels.clear(); // they look into the series
        m_series.clear();
        m_factors.clear();
        m_reactions.clear();
        m_revision = m_data.Revision();
    }
    m_step = 0;
    m_error.clear();
    return 1;
}

int CPostCtrl::GetStepCount() const
{
    return Source() ? Source()->StepCount() : 0;
}

int CPostCtrl::SelectStep(int step)
{
    if (step < 1 || step > GetStepCount()) return 0;
    m_step = step;
    return 1;
}

int CPostCtrl::ReadCurve()
{
    IPushResult* source = Source();
    if (!source || m_step < 1) return 0;
    if (!m_factors.empty()) return 1;
    if (!source->ReadLoadFactors(m_factors) || !source->ReadBaseReactions(m_reactions)) {
        m_error = source->Error();
        m_factors.clear();
        return 0;
    }
    for (double& r : m_reactions)
        r = FromSi(r, m_data.Units(), ReacDim());
    return 1;
}

int CPostCtrl::ReadSeries(int node, const std::vector<double>*& out)
{
    const auto known = m_series.find(node);
    if (known != m_series.end()) {
        out = &known->second;
        return 1;
    }
    IPushResult* source = Source();
    if (!source || !source->HasNode(node)) return 0;
    std::vector<double> values;
    if (!source->ReadDisplacements(node, values)) {
        m_error = source->Error();
        return 0;
    }
    for (double& v : values)
        v = FromSi(v, m_data.Units(), DispDim());
    out = &(m_series[node] = std::move(values));
    return 1;
}

int CPostCtrl::GetStepFactor_PO(double& factor)
{
    if (!ReadCurve()) return 0;
    factor = m_factors[static_cast<std::size_t>(m_step - 1)];
    return 1;
}

int CPostCtrl::GetReacNew(double& reaction)
{
    if (!ReadCurve()) return 0;
    reaction = m_reactions[static_cast<std::size_t>(m_step - 1)];
    return 1;
}

int CPostCtrl::GetDispNew(int node, double& displacement)
{
    const std::vector<double>* series = nullptr;
    if (m_step < 1 || !ReadSeries(node, series)) return 0;
    displacement = (*series)[static_cast<std::size_t>(m_step - 1)];
    return 1;
}

bool CPostCtrl::ExistNodePost(int node) const
{
    return Source() && Source()->HasNode(node);
}

// The series are not kept: there may be many nodes.
int CPostCtrl::FindControlNode(int& node)
{
    IPushResult* source = Source();
    if (!source || source->StepCount() == 0) return 0;
    double largest = -1.0;
    int found = 0;
    std::vector<double> values;
    for (const int id : source->NodeIds()) {
        if (!source->ReadDisplacements(id, values)) {
            m_error = source->Error();
            return 0;
        }
        if (!(std::fabs(values.back()) > largest)) continue;
        largest = std::fabs(values.back());
        found = id;
    }
    if (found == 0) return 0;
    node = found;
    return 1;
}

/// Mass that moves along the direction of control: of a turned push between the axes, of each its
/// share.
double CPostCtrl::MassAlong(const T_NODE_D& node) const
{
    const IPushRun* const run = RunOf(m_pushover, m_turn);
    const auto direction = static_cast<std::size_t>(Direction());
    if (!run || m_turn == 0) return direction < 3 ? node.mass[direction] : 0.0;
    double mass = 0.0;
    for (std::size_t d = 0; d < 3; ++d)
        mass += run->Head().control[d] * run->Head().control[d] * node.mass[d];
    return mass;
}

// In the units of the document; a level without results adds its height to the next one.
int CPostCtrl::ReadLevels()
{
    if (!m_levels.empty()) return 1;
    if (!StoreyFindings(m_data.Model()).empty()) return 0; // drifts between the wrong levels
    double height = 0.0;
    for (const auto& [key, storey] : m_data.Model().storeys) {
        height += FromSi(storey.height, m_data.Units(), kDimLength);
        T_LEVEL level{key, height, {}};
        for (const int id : storey.nodes) {
            const auto node = m_data.Model().nodes.find(id);
            T_LEVEL_NODE& at = level.nodes.emplace_back();
            if (node == m_data.Model().nodes.end() || !ReadSeries(id, at.moves)) {
                level.nodes.pop_back();
                continue;
            }
            for (const std::size_t axis : {0U, 1U})
                at.plan[axis] = FromSi(node->second.xyz[axis], m_data.Units(), kDimLength);
            at.mass = MassAlong(node->second);
        }
        if (level.nodes.empty() || !(height > 0.0)) continue;
        if (!m_levels.empty()) PairWithBelow(level, m_levels.back());
        m_levels.push_back(std::move(level));
        height = 0.0;
    }
    if (!m_error.empty()) m_levels.clear();
    return m_levels.empty() ? 0 : 1;
}

int CPostCtrl::GetPushoverStoryDrifts(int loadCase, int step, std::vector<T_STOREY_DRIFT>& out,
                                      int turn)
{
    m_error.clear();
    if (!SelectPushover(loadCase, turn) || !SelectStep(step) || !ReadLevels()) return 0;
    const auto index = static_cast<std::size_t>(step - 1);
    out.clear();
    for (std::size_t i = 0; i < m_levels.size(); ++i)
        out.push_back(DriftOf(m_levels[i], i == 0 ? nullptr : &m_levels[i - 1], index));
    return 1;
}

int CPostCtrl::GetPushoverStoryDriftRatio(int loadCase, int step, double& kind1, double& kind2,
                                          int turn)
{
    std::vector<T_STOREY_DRIFT> drifts;
    if (!GetPushoverStoryDrifts(loadCase, step, drifts, turn)) return 0;
    kind1 = kind2 = 0.0;
    for (const T_STOREY_DRIFT& drift : drifts) {
        kind1 = std::max(kind1, std::fabs(drift.plain));
        kind2 = std::max(kind2, std::fabs(drift.centre));
    }
    return 1;
}

bool CPostCtrl::HasStoreyGaps(int loadCase, int turn) const
{
    const IPushResult* const source = SourceOf(loadCase, turn);
    if (!source) return false;
    const auto known = [&](const auto& entry) {
        return std::ranges::any_of(entry.second.nodes,
                                   [&](int node) { return source->HasNode(node); });
    };
    const auto& storeys = m_data.Model().storeys;
    return std::ranges::any_of(storeys, known) && !std::ranges::all_of(storeys, known);
}
