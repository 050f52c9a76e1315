#include "qm_db/analysis/stagedanalysis.h"

#include "qm_base/say.h"
#include "qm_db/results/fingerprint.h"

#include <algorithm>
#include <set>

namespace {

// Enumerations and numbers that are converted as they are.
static_assert(static_cast<int>(STAGE_BIRTH::ToDesign) == static_cast<int>(solver::BIRTH::ToDesign));
static_assert(kLoadGroupErection == static_cast<int>(solver::LOAD_GROUP::Erection) &&
              kLoadGroupRest == static_cast<int>(solver::LOAD_GROUP::Rest));
static_assert(kStageLastStep == solver::kLastStep && kStageFirstStep == solver::kFirstStep);

/// Index of a key in an ascending list; none: its size.
std::size_t IndexOf(const std::vector<int>& keys, int key)
{
    const auto it = std::lower_bound(keys.begin(), keys.end(), key);
    return it == keys.end() || *it != key ? keys.size()
                                          : static_cast<std::size_t>(it - keys.begin());
}

/// Results that the engine gives from its records of displacements.
class CEngineStagedResult : public IStagedResult {
public:
    struct T_KEYS {
        std::vector<int> stages, cases, groups, nodes, elements; // groups: by case
    };
    CEngineStagedResult(solver::CStagedSolver engine, T_KEYS keys, const T_MODEL& model)
        : m_engine(std::move(engine)), m_keys(std::move(keys)),
          m_fingerprint(FingerprintOfStages(model)), m_plan(FingerprintOfStagePlan(model))
    {
    }
    const solver::CStagedSolver& Engine() const { return m_engine; }
    std::uint64_t Plan() const { return m_plan; }

    std::uint64_t Fingerprint() const override { return m_fingerprint; }
    std::vector<T_STAGE_CASE> Cases() const override
    {
        std::vector<T_STAGE_CASE> all;
        for (std::size_t stage = 0; stage < m_keys.stages.size(); ++stage)
            for (int step = kStageFirstStep; step <= m_engine.StepCount(stage); ++step)
                for (std::size_t i = 0; i < m_keys.cases.size(); ++i)
                    all.push_back(
                        {{m_keys.stages[stage], step, m_keys.cases[i]}, m_keys.groups[i]});
        return all;
    }
    int Open(const T_STAGE_CHOICE& choice,
             std::vector<std::shared_ptr<IStaticResult>>& out) const override
    {
        solver::T_RESULT result;
        const std::size_t stage = IndexOf(m_keys.stages, choice.stage);
        if (stage == m_keys.stages.size() || !ReadEngine(stage, choice, result)) return 0;
        out = {MakeStaticResult({m_fingerprint, m_keys.nodes, std::move(result.displacement),
                                 std::move(result.reaction), m_keys.elements,
                                 std::move(result.force)})};
        return 1;
    }

private:
    int ReadEngine(std::size_t stage, const T_STAGE_CHOICE& choice, solver::T_RESULT& out) const
    {
        using S = solver::STAGE_SUM;
        switch (choice.load) {
        case kStageLoadSum:
            return m_engine.ReadSum(stage, choice.step, S::All, out);
        case kStageLoadDead:
            return m_engine.ReadSum(stage, choice.step, S::Dead, out);
        case kStageLoadErection:
            return m_engine.ReadSum(stage, choice.step, S::Erection, out);
        default:
            return m_engine.ReadCase(stage, choice.step, IndexOf(m_keys.cases, choice.load), out);
        }
    }

    solver::CStagedSolver m_engine;
    T_KEYS m_keys;
    std::uint64_t m_fingerprint, m_plan;
};

} // namespace

std::vector<int> StageLoadCases(const T_MODEL& model)
{
    std::set<int> keys;
    for (const auto& entry : model.stages)
        for (const T_STAG_PART* part : {&entry.second.activate, &entry.second.deactivate})
            for (const T_STAG_LOAD& load : part->loads)
                keys.insert(load.loadCase);
    return {keys.begin(), keys.end()};
}

CStagedAnalysis::CStagedAnalysis(const T_MODEL& model)
    : m_model(model), m_frame(model), m_cases(StageLoadCases(model))
{
}

std::size_t CStagedAnalysis::StepCount() const
{
    std::size_t count = 0;
    for (const auto& entry : m_model.stages)
        count += static_cast<std::size_t>(std::max(entry.second.steps, 0));
    return count;
}

/// Puts the stage before an error; 0.
int CStagedAnalysis::InStage(int key, T_ANALYSIS_ERROR& error) const
{
    error.stage = key;
    const bool more = error.node != 0 || error.element != 0 || error.loadCase != 0;
    error.text = Say("IDS_QM_ANALYSIS_STAGE", m_model.stages.at(key).name) + (more ? ", " : ": ") +
                 error.text;
    return 0;
}

int CStagedAnalysis::Fail(const solver::T_SOLVER_ERROR& fault, T_ANALYSIS_ERROR& error) const
{
    error = m_frame.ErrorOf(fault, m_cases);
    return fault.stage < 0 ? 0 : InStage(m_stages.at(static_cast<std::size_t>(fault.stage)), error);
}

int CStagedAnalysis::AddElements(const std::vector<int>& ids, std::vector<std::size_t>& out,
                                 T_ANALYSIS_ERROR& error) const
{
    for (const int id : ids) {
        out.push_back(IndexOf(m_frame.ElementIds(), id));
        if (out.back() < m_frame.ElementIds().size()) continue;
        error.fault = ANALYSIS_FAULT::BadModel;
        error.element = id;
        error.text = Say("IDS_QM_ANALYSIS_NO_ELEMENT", std::to_string(id));
        return 0;
    }
    return 1;
}

/// The directions in the plane; those out of it are held anyway.
int CStagedAnalysis::AddSupport(int node, std::vector<solver::T_STAGE_SUPPORT>& out,
                                T_ANALYSIS_ERROR& error) const
{
    const auto record = m_model.nodes.find(node);
    solver::T_STAGE_SUPPORT support{IndexOf(m_frame.NodeIds(), node), {}};
    const solver::T_DIRS6 away = m_frame.OutOfPlane();
    bool any = false;
    for (std::size_t d = 0; record != m_model.nodes.end() && d < away.size(); ++d) {
        support.directions[d] = record->second.restraint[d] != 0 && !away[d];
        any = any || support.directions[d];
    }
    out.push_back(support);
    if (any) return 1;
    error.fault = ANALYSIS_FAULT::BadModel;
    error.node = node;
    error.text = Say(record == m_model.nodes.end() ? "IDS_QM_ANALYSIS_NO_NODE"
                                                   : "IDS_QM_ANALYSIS_NO_RESTRAINT",
                     std::to_string(node));
    return 0;
}

void CStagedAnalysis::AddLoads(const std::vector<T_STAG_LOAD>& loads,
                               std::vector<solver::T_STAGE_LOAD>& out) const
{
    for (const T_STAG_LOAD& load : loads)
        out.push_back({IndexOf(m_cases, load.loadCase), load.step});
}

int CStagedAnalysis::AddStage(int key, const T_STAG_D& stage, T_ANALYSIS_ERROR& error)
{
    solver::T_STAGE s;
    const auto part = [&](const T_STAG_PART& from, std::vector<std::size_t>& elements,
                          std::vector<solver::T_STAGE_SUPPORT>& supports,
                          std::vector<solver::T_STAGE_LOAD>& loads) {
        AddLoads(from.loads, loads);
        return AddElements(from.elements, elements, error) &&
               std::all_of(from.supports.begin(), from.supports.end(),
                           [&](int node) { return AddSupport(node, supports, error) != 0; });
    };
    if (!part(stage.activate, s.activateElements, s.activateSupports, s.activateLoads) ||
        !part(stage.deactivate, s.deactivateElements, s.deactivateSupports, s.deactivateLoads))
        return InStage(key, error);
    s.steps = stage.steps;
    s.duration = stage.duration;
    m_stages.push_back(key);
    m_staged.stages.push_back(std::move(s));
    return 1;
}

void CStagedAnalysis::HoldOutOfPlane()
{
    if (!m_model.styp.plane || m_staged.stages.empty()) return;
    for (std::size_t node = 0; node < m_staged.frame.nodes.size(); ++node)
        m_staged.stages.front().activateSupports.push_back({node, m_frame.OutOfPlane()});
}

int CStagedAnalysis::Build(T_ANALYSIS_ERROR& error)
{
    if (!m_frame.BuildFrame(error)) return 0;
    m_staged = {};
    m_stages.clear();
    m_staged.frame = m_frame.Frame();
    m_loads.assign(m_cases.size(), {});
    for (std::size_t i = 0; i < m_cases.size(); ++i) {
        if (!m_frame.BuildCase(m_cases[i], m_loads[i], error)) return 0;
        m_staged.groups.push_back(
            static_cast<solver::LOAD_GROUP>(m_model.loadCases.at(m_cases[i]).group));
    }
    for (const auto& [key, stage] : m_model.stages) {
        if (!AddStage(key, stage, error)) return 0;
    }
    HoldOutOfPlane();
    const T_STCT_D& control = m_model.styp.stageControl;
    m_staged.options = {static_cast<solver::BIRTH>(control.birth), control.geometricStiffness,
                        control.cableSag};
    return 1;
}

int CStagedAnalysis::Run(const solver::ProgressFn& progress,
                         const std::shared_ptr<IStagedResult>& before,
                         std::shared_ptr<IStagedResult>& out, T_ANALYSIS_ERROR& error)
{
    error = {};
    if (!Build(error)) return 0;
    solver::CStagedSolver engine;
    solver::T_SOLVER_ERROR fault;
    const auto* known = dynamic_cast<const CEngineStagedResult*>(before.get());
    if (known && known->Plan() == FingerprintOfStagePlan(m_model))
        engine = known->Engine().Again();
    else if (!engine.Prepare(m_staged, fault))
        return Fail(fault, error);
    if (!engine.Run(m_loads, fault, progress)) return Fail(fault, error);
    m_accuracy = engine.Cost().accuracy;
    std::vector<int> groups;
    for (const int key : m_cases)
        groups.push_back(m_model.loadCases.at(key).group);
    out = std::make_shared<CEngineStagedResult>(
        std::move(engine),
        CEngineStagedResult::T_KEYS{m_stages, m_cases, std::move(groups), m_frame.NodeIds(),
                                    m_frame.ElementIds()},
        m_model);
    return 1;
}
