#include "qm_rps/push/pushcases.h"

#include "qm_base/say.h"
#include "qm_rps/push/loadalgebra.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace {

constexpr int kFollowsFunction = 2; // increment option
constexpr int kByDisplacement = 1;  // increment method

int Fail(std::string& error, std::string text)
{
    error = std::move(text);
    return 0;
}

int KeyByName(const T_MODEL& model, const std::string& name)
{
    for (const auto& [key, record] : model.pushovers)
        if (record.name == name) return key;
    return 0;
}

/// Marks stand in the order IO, LS, CP.
void PutStops(const T_POLC_D& record, const T_POGC_D& control, solver::T_PUSH_STOPS& stops)
{
    stops.drift = record.stops.drift.value_or(0.0);
    stops.fractionOfPeak = record.stops.fractionOfPeak.value_or(0.0);
    stops.stiffnessRatio = record.control->stiffnessRatioLimit;
    stops.strengthLoss = control.onFailure == PUSH_FAILURE::Stop;
    if (!record.stops.state) return;
    if (*record.stops.state == PUSH_STATE_STOP::Failed)
        stops.lastPoint = true;
    else
        stops.mark = *record.stops.state == PUSH_STATE_STOP::LS ? 1 : 2;
}

/// A factor between the rows of a function, from 0 at step 0.
double FactorAt(const T_POFC_D& f, double step)
{
    double s0 = 0.0, f0 = 0.0;
    for (std::size_t i = 0; i < f.step.size(); ++i) {
        if (step <= f.step[i])
            return f.step[i] > s0 ? f0 + (f.factor[i] - f0) * (step - s0) / (f.step[i] - s0)
                                  : f.factor[i];
        s0 = f.step[i];
        f0 = f.factor[i];
    }
    return f0;
}

/// Builds the stage of one load case.
class CStage {
public:
    CStage(const T_MODEL& model, const CAnalysisModel& frame, const MODE_SHAPE_FN& modeShape)
        : m_model(model), m_frame(frame), m_modeShape(modeShape)
    {
    }

    int Build(const T_POLC_D& record, solver::T_PUSH_STAGE& out, std::string& error) const
    {
        const T_POGC_D control = PushControlOf(m_model, record);
        solver::T_PUSH_STAGE stage;
        if (!FindControl(record, stage, error)) return 0;
        const double ratio = record.control->stiffnessRatioLimit;
        if (!(ratio >= 0.0 && ratio < 1.0)) return Fail(error, Say("IDS_QM_PUSH_CASE_RATIO"));
        T_PUSH_INCREMENTS increments = EqualIncrements(control.steps);
        if (record.control->incrementOption == kFollowsFunction) {
            const auto f = m_model.incrementFunctions.find(record.control->incrementFunction);
            if (f == m_model.incrementFunctions.end())
                return Fail(error, Say("IDS_RPS_PO_Error_No_Increment_Function"));
            for (const T_FINDING& wrong : IncrementFunctionFindings(f->second))
                return Fail(error, Say("IDS_QM_CASE_FUNCTION", f->second.name) + ": " +
                                       wrong.field + ": " + wrong.text);
            increments = IncrementsOf(f->second);
        }
        if (increments.fractions.empty() ||
            increments.fractions.size() > static_cast<std::size_t>(control.mostSteps))
            return Fail(error,
                        Say("IDS_QM_PUSH_CASE_STEPS", std::to_string(increments.fractions.size()),
                            std::to_string(control.mostSteps)));
        stage.steps = std::move(increments.fractions);
        stage.additional = record.additionalDisplacements;
        PutTarget(*record.control, increments.target, stage);
        PutStops(record, control, stage.stops);
        stage.leaps = control.onFailure == PUSH_FAILURE::Leap;
        if (!BuildPattern(m_model, m_frame, record, m_modeShape, stage.loads, error)) return 0;
        // By load the push finds its way; only the displacement and the reaction say nothing of it.
        if (stage.control != solver::PUSH_CONTROL::LoadFactor &&
            !PushesAlong(stage.loads, m_frame, static_cast<std::size_t>(stage.direction)))
            return Fail(error, Say("IDS_QM_PUSH_CASE_ACROSS",
                                   kDirectionNames[static_cast<std::size_t>(stage.direction)]));
        out = std::move(stage);
        return 1;
    }

private:
    int FindControl(const T_POLC_D& record, solver::T_PUSH_STAGE& stage, std::string& error) const
    {
        const std::vector<int>& ids = m_frame.NodeIds();
        const auto node = std::ranges::lower_bound(ids, record.controlNode);
        if (node == ids.end() || *node != record.controlNode)
            return Fail(error, Say("IDS_QM_ANALYSIS_NO_NODE", std::to_string(record.controlNode)));
        stage.node = static_cast<std::size_t>(node - ids.begin());
        stage.direction = record.direction - 1;
        const auto d = static_cast<std::size_t>(stage.direction);
        if (d > 5 || m_frame.Frame().nodes[stage.node].fixed[d])
            return Fail(error, Say("IDS_QM_PUSH_CASE_FIXED", std::to_string(record.controlNode),
                                   d > 5 ? "?" : kDirectionNames[d]));
        return 1;
    }

    static void PutTarget(const T_POLC_CONTROL& control, double fraction,
                          solver::T_PUSH_STAGE& stage)
    {
        stage.control = solver::PUSH_CONTROL::LoadFactor;
        stage.target = fraction;
        if (control.incrementMethod != kByDisplacement) return;
        stage.control = control.masterNodeControl ? solver::PUSH_CONTROL::Displacement
                                                  : solver::PUSH_CONTROL::LargestTranslation;
        stage.target =
            fraction * (control.masterNodeControl ? control.masterMaxDispl : control.maxTransDispl);
    }

    const T_MODEL& m_model;
    const CAnalysisModel& m_frame;
    const MODE_SHAPE_FN& m_modeShape;
};

solver::T_VEC3 AxisOf(std::size_t direction)
{
    solver::T_VEC3 v{};
    if (direction < 3) v[direction] = 1.0;
    return v;
}

/// The case in one direction of its static angle.
int Turn(const CAnalysisModel& frame, double step, int times, T_PUSH_CASE& c, std::string& error)
{
    const double angle = times * step;
    c.turn = times;
    if (c.direction > 1) return Fail(error, Say("IDS_QM_PUSH_CASE_ANGLE"));
    solver::T_LOAD_CASE axis;
    axis.selfWeight = c.along;
    c.along = TurnedAboutZ(axis, frame.Frame(), angle).selfWeight;
    c.direction = std::fabs(c.along[0]) >= std::fabs(c.along[1]) ? 0 : 1;
    solver::T_PUSH_STAGE& stage = c.stages.back();
    stage.direction = static_cast<int>(c.direction);
    stage.along = c.along;
    stage.loads = TurnedAboutZ(stage.loads, frame.Frame(), angle);
    c.angle = angle;
    c.name = TurnedName(c.name, angle);
    for (const std::size_t d : {0U, 1U})
        if (c.along[d] != 0.0 && frame.Frame().nodes[c.controlNode].fixed[d])
            return Fail(error,
                        Say("IDS_QM_PUSH_CASE_FIXED",
                            std::to_string(frame.NodeIds()[c.controlNode]), kDirectionNames[d]));
    return 1;
}

} // namespace

T_PUSH_INCREMENTS EqualIncrements(int count)
{
    T_PUSH_INCREMENTS out;
    for (int i = 1; i <= count; ++i)
        out.fractions.push_back(static_cast<double>(i) / count);
    return out;
}

T_PUSH_INCREMENTS IncrementsOf(const T_POFC_D& function)
{
    T_PUSH_INCREMENTS out;
    if (function.step.empty() || !(function.factor.back() > 0.0)) return out;
    out.target = function.factor.back();
    const double last = function.step.back();
    for (double step = 1.0; step < last && step <= kMostPushSteps; step += 1.0)
        out.fractions.push_back(FactorAt(function, step) / out.target);
    out.fractions.push_back(1.0);
    return out;
}

int PushChainOf(const T_MODEL& model, int key, std::vector<int>& out, std::string& error)
{
    std::vector<int> chain;
    while (key != 0) {
        const auto at = model.pushovers.find(key);
        if (at == model.pushovers.end()) return Fail(error, Say("IDS_QM_PUSH_NO_INITIAL_CASE"));
        if (std::ranges::find(chain, key) != chain.end())
            return Fail(error, Say("IDS_QM_PUSH_CIRCLE"));
        if (!at->second.control) return Fail(error, Say("IDS_QM_PUSH_CASE_NO_CONTROL"));
        chain.push_back(key);
        if (at->second.initialCase.empty()) break;
        key = KeyByName(model, at->second.initialCase);
        if (key == 0) return Fail(error, Say("IDS_QM_PUSH_NO_INITIAL_CASE"));
    }
    std::ranges::reverse(chain);
    out = std::move(chain);
    return 1;
}

int PushBasisOf(const T_MODEL& model, const std::vector<int>& chain, T_PUSH_BASIS& out,
                std::string& error)
{
    const T_POGC_D first = PushControlOf(model, model.pushovers.at(chain.front()));
    for (const int key : chain)
        if (PushControlOf(model, model.pushovers.at(key)).pDelta != first.pDelta)
            return Fail(error, Say("IDS_QM_PUSH_CASE_P_DELTA"));
    out = {first.initialLoads, first.pDelta};
    return 1;
}

int BuildPushCases(const T_MODEL& model, const CAnalysisModel& frame, const std::vector<int>& chain,
                   const MODE_SHAPE_FN& modeShape, std::vector<T_PUSH_CASE>& out,
                   std::string& error)
{
    const T_POLC_D& record = model.pushovers.at(chain.back());
    const CStage builder(model, frame, modeShape);
    T_PUSH_CASE c;
    c.name = record.name;
    c.key = chain.back();
    for (const int key : chain)
        if (!builder.Build(model.pushovers.at(key), c.stages.emplace_back(), error)) return 0;
    c.direction = static_cast<std::size_t>(c.stages.back().direction);
    c.along = AxisOf(c.direction);
    c.controlNode = c.stages.back().node;
    std::vector<T_PUSH_CASE> cases;
    if (!record.control->generateStaticAngle) {
        cases.push_back(std::move(c));
    } else {
        const double angle = record.control->staticAngle;
        constexpr double kLeast = 1.0; // degrees: 359 directions
        if (!(angle >= kLeast && angle < 360.0))
            return Fail(error, Say("IDS_QM_PUSH_CASE_ANGLE_SMALL"));
        for (int i = 1; i * angle < 360.0; ++i)
            if (!Turn(frame, angle, i, cases.emplace_back(c), error)) return 0;
    }
    out = std::move(cases);
    return 1;
}
