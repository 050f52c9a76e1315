#include "qm_solver/stages/stageplan.h"

#include <algorithm>
#include <cmath>

namespace solver {

namespace {

using T_FAULT = std::optional<T_SOLVER_ERROR>;

T_SOLVER_ERROR Bad(T_SOLVER_REASON reason)
{
    T_SOLVER_ERROR error;
    error.fault = SOLVER_FAULT::BadModel;
    error.reason = std::move(reason);
    return error;
}
T_SOLVER_ERROR BadAt(long T_SOLVER_ERROR::*where, std::size_t index, T_SOLVER_REASON reason)
{
    T_SOLVER_ERROR error = Bad(std::move(reason));
    error.*where = static_cast<long>(index);
    return error;
}

bool Any(const T_DIRS6& directions)
{
    return std::any_of(directions.begin(), directions.end(), [](bool d) { return d; });
}

/// Goes through the stages and keeps what is active.
class CPlanner {
public:
    CPlanner(const T_STAGED_MODEL& model, T_STAGE_PLAN& plan)
        : m_model(model), m_plan(plan), m_leftIn(model.frame.elements.size(), -1),
          m_held(model.frame.nodes.size()), m_on(model.groups.size(), 0)
    {
        m_plan = {};
        m_plan.bornIn.assign(m_leftIn.size(), -1);
    }

    T_FAULT Stage(std::size_t s)
    {
        const T_STAGE& stage = m_model.stages[s];
        if (stage.steps < 1) return Bad("IDS_QM_ENGINE_STAGE_NO_STEPS");
        if (!(std::isfinite(stage.duration) && stage.duration >= 0.0))
            return Bad("IDS_QM_ENGINE_STAGE_DURATION");
        if (T_FAULT fault = Elements(stage, static_cast<int>(s))) return fault;
        if (T_FAULT fault = Supports(stage)) return fault;
        if (T_FAULT fault = Loads(stage)) return fault;
        T_ACTIVE active{{}, m_held};
        for (std::size_t e = 0; e < m_leftIn.size(); ++e)
            if (m_plan.bornIn[e] >= 0 && m_leftIn[e] < 0) active.elements.push_back(e);
        if (active.elements.empty()) return Bad("IDS_QM_ENGINE_STAGE_EMPTY");
        m_plan.active.push_back(std::move(active));
        return {};
    }

private:
    T_FAULT Elements(const T_STAGE& stage, int s)
    {
        const auto bad = [](std::size_t e, const char* reason) {
            return BadAt(&T_SOLVER_ERROR::element, e, reason);
        };
        for (const std::size_t e : stage.deactivateElements) {
            if (e >= m_leftIn.size()) return bad(e, "IDS_QM_ENGINE_LEAVES_MISSING");
            if (m_plan.bornIn[e] < 0) return bad(e, "IDS_QM_ENGINE_LEAVES_UNBORN");
            if (m_leftIn[e] >= 0) return bad(e, "IDS_QM_ENGINE_LEFT_ALREADY");
            m_leftIn[e] = s;
        }
        for (const std::size_t e : stage.activateElements) {
            if (e >= m_leftIn.size()) return bad(e, "IDS_QM_ENGINE_BORN_MISSING");
            if (m_plan.bornIn[e] >= 0) return bad(e, "IDS_QM_ENGINE_BORN_TWICE");
            m_plan.bornIn[e] = s;
        }
        return {};
    }

    T_FAULT Supports(const T_STAGE& stage)
    {
        for (const bool comes : {false, true})
            for (const T_STAGE_SUPPORT& support :
                 comes ? stage.activateSupports : stage.deactivateSupports)
                if (T_FAULT fault = Support(support, comes)) return fault;
        return {};
    }

    T_FAULT Support(const T_STAGE_SUPPORT& support, bool comes)
    {
        const auto bad = [&](T_SOLVER_REASON reason) {
            return BadAt(&T_SOLVER_ERROR::node, support.node, std::move(reason));
        };
        if (support.node >= m_held.size()) return bad("IDS_QM_ENGINE_SUPPORT_NO_NODE");
        T_DIRS6& held = m_held[support.node];
        T_DIRS6 directions = support.directions;
        if (!Any(directions)) directions = comes ? m_model.frame.nodes[support.node].fixed : held;
        if (!Any(directions))
            return bad(comes ? "IDS_QM_ENGINE_SUPPORT_HOLDS_NOTHING"
                             : "IDS_QM_ENGINE_SUPPORT_NOT_THERE");
        for (std::size_t d = 0; d < 6; ++d) {
            if (!directions[d]) continue;
            if (held[d] == comes)
                return bad(comes ? "IDS_QM_ENGINE_SUPPORT_THERE"
                                 : "IDS_QM_ENGINE_SUPPORT_NOT_THERE");
            held[d] = comes;
        }
        return {};
    }

    T_FAULT Loads(const T_STAGE& stage)
    {
        std::vector<T_LOAD_CHANGE> change(static_cast<std::size_t>(stage.steps));
        for (const bool comes : {false, true})
            for (const T_STAGE_LOAD& load : comes ? stage.activateLoads : stage.deactivateLoads) {
                const auto bad = [&](T_SOLVER_REASON reason) {
                    return BadAt(&T_SOLVER_ERROR::loadCase, load.loadCase, std::move(reason));
                };
                if (load.loadCase >= m_on.size()) return bad("IDS_QM_ENGINE_STAGE_NO_CASE");
                const int step = load.step == kLastStep ? stage.steps : load.step;
                if (step < 1 || step > stage.steps)
                    return bad({"IDS_QM_ENGINE_STAGE_NO_STEP",
                                {std::to_string(load.step), std::to_string(stage.steps)}});
                T_LOAD_CHANGE& at = change[static_cast<std::size_t>(step - 1)];
                (comes ? at.on : at.off).push_back(load.loadCase);
            }
        for (const T_LOAD_CHANGE& at : change)
            for (const bool comes : {false, true})
                for (const std::size_t c : comes ? at.on : at.off) {
                    if ((m_on[c] != 0) == comes)
                        return BadAt(&T_SOLVER_ERROR::loadCase, c,
                                     comes ? "IDS_QM_ENGINE_CASE_ACTS"
                                           : "IDS_QM_ENGINE_CASE_ACTS_NOT");
                    m_on[c] = comes ? 1 : 0;
                }
        m_plan.change.push_back(std::move(change));
        return {};
    }

    const T_STAGED_MODEL& m_model;
    T_STAGE_PLAN& m_plan;
    std::vector<int> m_leftIn;
    std::vector<T_DIRS6> m_held;
    std::vector<char> m_on; // by load case
};

} // namespace

std::optional<T_SOLVER_ERROR> MakePlan(const T_STAGED_MODEL& model, T_STAGE_PLAN& plan)
{
    if (model.stages.empty()) return Bad("IDS_QM_ENGINE_NO_STAGES");
    if (!model.cable.empty() && model.cable.size() != model.frame.elements.size())
        return Bad("IDS_QM_ENGINE_CABLES");
    CPlanner planner(model, plan);
    for (std::size_t s = 0; s < model.stages.size(); ++s)
        if (T_FAULT fault = planner.Stage(s)) {
            fault->stage = static_cast<long>(s);
            return fault;
        }
    return {};
}

} // namespace solver
