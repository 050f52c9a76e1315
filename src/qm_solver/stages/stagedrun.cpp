#include "qm_solver/stages/stagedrun.h"

#include "qm_base/textformat.h"
#include "qm_solver/checks/balance.h"
#include "qm_solver/element/beamelement.h"
#include "qm_solver/element/cablesag.h"
#include "qm_solver/stages/fixedpoint.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace solver {

namespace {

constexpr std::size_t kCaseBlock = 64; // right-hand sides solved together
constexpr std::size_t kMaxIterations = 50;
constexpr double kConverged = 1e-12; // change of displacements and tensions over the largest
constexpr double kRounding = 1e-9;   // below this a change that no longer shrinks is rounding

T_SOLVER_ERROR Fault(SOLVER_FAULT fault, T_SOLVER_REASON reason)
{
    T_SOLVER_ERROR error;
    error.fault = fault;
    error.reason = std::move(reason);
    return error;
}

/// Largest change over the largest value, rotations times the size of the model.
double Change(std::span<const double> now, std::span<const double> before, double size)
{
    double change = 0.0, largest = 0.0;
    for (std::size_t i = 0; i < now.size(); ++i) {
        const double lever = i % 6 < 3 ? 1.0 : size;
        change = std::max(change, lever * std::fabs(now[i] - before[i]));
        largest = std::max(largest, lever * std::fabs(now[i]));
    }
    return largest > 0.0 ? change / largest : 0.0;
}

} // namespace

CStagedRun::CStagedRun(const T_STAGED_MODEL& model, const T_STAGE_PLAN& plan, T_PARTS parts,
                       std::span<const std::size_t> partOf, std::span<const T_LOAD_CASE> cases,
                       T_STAGED_COST& cost)
    : m_model(model), m_plan(plan), m_parts(parts), m_partOf(partOf),
      m_cases(cases.begin(), cases.end()), m_cost(cost), m_records(model, plan),
      m_cable(model.cable), m_held(cases.size()), m_tension(model.frame.elements.size(), 0.0),
      m_clamped(m_tension)
{
    m_now.on.assign(cases.size(), 0);
    m_now.moved.resize(cases.size());
    m_cable.resize(model.frame.elements.size(), 0);
    for (const T_LOAD_CASE& load : m_cases)
        for (const T_PRETENSION& p : load.pretension)
            if (p.element < m_cable.size()) m_cable[p.element] = 1;
}

CStagedRun::T_FAULT CStagedRun::Go(const ProgressFn& progress)
{
    std::size_t total = 0, done = 0;
    for (const auto& steps : m_plan.change)
        total += steps.size();
    for (std::size_t s = 0; s < m_partOf.size(); ++s) {
        T_FAULT fault = BeginPart(s);
        m_records.BeginStage();
        for (std::size_t step = 0; step < m_plan.change[s].size() && !fault; ++step) {
            fault = Step(s, step);
            if (!fault && progress && !progress(++done, total))
                fault = Fault(SOLVER_FAULT::Cancelled, "IDS_QM_ENGINE_CANCELLED");
        }
        if (!fault) continue;
        fault->stage = static_cast<long>(s);
        return fault;
    }
    return {};
}

/// Loads that go on acting must find their place in the new part.
CStagedRun::T_FAULT CStagedRun::BeginPart(std::size_t stage)
{
    const bool same = stage > 0 && m_partOf[stage] == m_now.part;
    m_now.part = m_partOf[stage];
    if (same) return {};
    m_factorised = false;
    const auto& off = m_plan.change[stage].front().off;
    for (std::size_t c = 0; c < m_cases.size(); ++c) {
        if (!m_now.on[c] || std::find(off.begin(), off.end(), c) != off.end()) continue;
        if (T_FAULT fault = Part().CheckLoads(m_cases[c], c, false)) return fault;
    }
    HoldDisplacements();
    for (std::size_t e = 0; e < m_tension.size(); ++e)
        if (!Part().Holds(e)) m_tension[e] = m_clamped[e] = 0.0;
    return {};
}

/// With u = T q + S g + held, what is left of the displacement that is there for q and g at hand.
/// Of unknowns of their own it is 0, of supports all but the settlement, of slaves what they were
/// apart from their masters when the tie came. What is not part of the model any more goes to 0.
void CStagedRun::HoldDisplacements()
{
    const CFrameDofs& dofs = Part().Dofs();
    std::vector<double> q(dofs.EquationCount());
    for (std::size_t c = 0; c < m_cases.size(); ++c) {
        m_held[c].clear();
        if (!m_now.moved[c]) continue;
        const T_FIELD& moved = *m_now.moved[c];
        for (std::size_t i = 0; i < q.size(); ++i)
            q[i] = moved[dofs.Owner(i)];
        T_FIELD& held = m_held[c];
        held.resize(moved.size());
        dofs.Expand(q, held);
        const CCaseLoads loads(Part().Frame(), dofs, Loads(m_now, {{c, 1.0}}));
        for (std::size_t i = 0; i < held.size(); ++i) {
            const bool known = !dofs.Terms(i).empty() || !dofs.FixedTerms(i).empty();
            const double settled = loads.Settled().empty() ? 0.0 : loads.Settled()[i];
            held[i] = known ? moved[i] - held[i] - settled : 0.0;
        }
    }
}

CStagedRun::T_FAULT CStagedRun::Step(std::size_t stage, std::size_t step)
{
    const T_LOAD_CHANGE& change = m_plan.change[stage][step];
    if (T_FAULT fault = ChangeLoads(change)) return fault;
    T_FAULT fault;
    if (SecondOrder()) {
        fault = Iterate();
    } else {
        std::vector<std::size_t> cases = Moving();
        if (m_factorised) { // only what changes
            cases = change.off;
            cases.insert(cases.end(), change.on.begin(), change.on.end());
            std::sort(cases.begin(), cases.end());
            cases.erase(std::unique(cases.begin(), cases.end()), cases.end());
        } else {
            fault = Part().Factorise();
            ++m_cost.factorisations;
            m_factorised = true;
        }
        m_cost.iterations = std::max<std::size_t>(m_cost.iterations, 1);
        if (!fault) fault = SolveCases(cases);
    }
    if (!fault) m_records.Add(m_now);
    return fault;
}

CStagedRun::T_FAULT CStagedRun::ChangeLoads(const T_LOAD_CHANGE& change)
{
    for (const std::size_t c : change.off)
        m_now.on[c] = 0;
    for (const std::size_t c : change.on) {
        if (T_FAULT fault = Part().CheckLoads(m_cases[c], c, true)) return fault;
        m_now.on[c] = 1;
    }
    return {};
}

/// Load cases that act or have acted.
std::vector<std::size_t> CStagedRun::Moving() const
{
    std::vector<std::size_t> cases;
    for (std::size_t c = 0; c < m_cases.size(); ++c)
        if (m_now.on[c] || m_now.moved[c]) cases.push_back(c);
    return cases;
}

T_MIX CStagedRun::Everything() const
{
    T_MIX mix;
    for (const std::size_t c : Moving())
        mix.emplace_back(c, 1.0);
    return mix;
}

T_LOAD_CASE CStagedRun::Loads(const T_STEP_RECORD& record, const T_MIX& mix) const
{
    T_LOAD_CASE sum;
    for (const auto& [loadCase, factor] : mix)
        if (record.on[loadCase]) m_parts[record.part]->AddLoads(m_cases[loadCase], factor, sum);
    return sum;
}

CStagedRun::T_FAULT CStagedRun::SolveCases(std::span<const std::size_t> cases)
{
    for (std::size_t first = 0; first < cases.size(); first += kCaseBlock)
        if (T_FAULT fault =
                SolveBlock(cases.subspan(first, std::min(kCaseBlock, cases.size() - first))))
            return fault;
    return {};
}

CStagedRun::T_FAULT CStagedRun::SolveBlock(std::span<const std::size_t> cases)
{
    CStagePart& part = Part();
    std::vector<T_LOAD_CASE> loads;
    std::vector<T_MIX> columns;
    T_HISTORY history;
    for (const std::size_t c : cases) {
        columns.push_back({{c, 1.0}});
        loads.push_back(Loads(m_now, columns.back()));
        history.held.push_back(m_held[c]);
    }
    history.birth = m_records.Births(part, std::move(columns));
    history.axial = m_now.axial;
    const CCaseBlock block(part.Frame(), part.Dofs(), loads, &history);
    T_SOLUTION solution;
    T_SOLVER_REASON reason;
    std::size_t at = 0;
    if (!SolveBalanced(block, part.Dofs(), part.Size(), part.Matrix(), part.Factor(), solution, at,
                       reason)) {
        T_SOLVER_ERROR error = Fault(SOLVER_FAULT::Failed, reason);
        error.loadCase = at < cases.size() ? static_cast<long>(cases[at]) : -1;
        return error;
    }
    for (const T_ACCURACY& known : solution.accuracy)
        if (known.unrefined > m_cost.accuracy.unrefined) m_cost.accuracy = known;
    std::vector<T_FIELD> moved = block.Displacements(solution.x);
    for (std::size_t k = 0; k < cases.size(); ++k)
        m_now.moved[cases[k]] = std::make_shared<const T_FIELD>(std::move(moved[k]));
    return {};
}

int CStagedRun::Read(std::size_t stage, int step, const T_MIX& mix, T_RESULT& out) const
{
    out = {};
    const T_STEP_RECORD* record = m_records.Find(stage, step);
    if (!record) return 0;
    const CStagePart& part = *m_parts[record->part];
    const T_LOAD_CASE load = Loads(*record, mix);
    T_HISTORY history;
    history.birth = m_records.Births(part, {mix});
    history.axial = record->axial;
    const CCaseBlock block(part.Frame(), part.Dofs(), {&load, 1}, &history);
    const T_FIELD moved = CStageRecords::Sum(*record, mix, part.Dofs().FullCount());
    std::vector<T_RESULT> results;
    block.Results({&moved, 1}, results);
    out = std::move(results[0]);
    const auto own = std::move(out.force);
    out.force.assign(m_model.frame.elements.size(), {});
    for (std::size_t e = 0; e < own.size(); ++e)
        out.force[part.Active().elements[e]] = own[e];
    return 1;
}

// ---- second order -------------------------------------------------------------------------------

/// The tensions that a step begins with come from the step before; they are no iterate's result.
CStagedRun::T_FAULT CStagedRun::Iterate()
{
    CStagePart& part = Part();
    GuessTensions();
    const T_MIX everything = Everything();
    const std::vector<std::size_t> cases = Moving();
    const std::size_t full = part.Dofs().FullCount();
    CFixedPoint tensions;
    T_FIELD before(full, 0.0);
    double last = std::numeric_limits<double>::infinity();
    for (std::size_t it = 1; it <= kMaxIterations; ++it) {
        m_now.axial = AxialState(it == 1);
        ++m_cost.factorisations;
        m_cost.iterations = std::max(m_cost.iterations, it);
        if (T_FAULT fault = part.Factorise(m_now.axial, it == 1)) return fault;
        if (T_FAULT fault = SolveCases(cases)) return fault;
        const T_FIELD now = CStageRecords::Sum(m_now, everything, full);
        const std::vector<double> given = m_tension;
        ReadTensions(now);
        const double change =
            std::max(Change(now, before, part.Size()), Change(m_tension, given, 1.0));
        if (change <= kConverged || (change <= kRounding && change >= last)) return CheckBuckling();
        m_tension = tensions.Next(given, m_tension);
        last = change;
        before = now;
    }
    return Fault(SOLVER_FAULT::NotConverged,
                 {"IDS_QM_ENGINE_AXIAL_DIVERGES",
                  {std::to_string(kMaxIterations), FormatText("%.3g", last)}});
}

/// Unstable where the stiffness with its axial forces has a negative eigenvalue.
CStagedRun::T_FAULT CStagedRun::CheckBuckling() const
{
    const CStagePart& part = Part();
    const T_FACTOR_INFO& info = m_parts[m_now.part]->Factor().Info();
    if (part.Dofs().EquationCount() > 0 && (info.negativePivots > 0 || !info.nullPivots.empty()))
        return Fault(SOLVER_FAULT::Mechanism, "IDS_QM_ENGINE_BUCKLES");
    for (std::size_t own = 0; own < part.Frame().elements.size(); ++own) {
        const T_ELEMENT& element = part.Frame().elements[own];
        const double tension = m_now.axial[own].tension;
        if (element.kind != ELEMENT_KIND::Beam || !(tension < 0.0)) continue;
        if (CBeamElement(part.Frame(), element, tension).Loose() < 0) continue;
        T_SOLVER_ERROR error = Fault(SOLVER_FAULT::Mechanism, "IDS_QM_ENGINE_BEAM_BUCKLES");
        error.element = static_cast<long>(part.Active().elements[own]);
        return error;
    }
    return {};
}

/// Tension of the step before and what new initial tension and temperature would give clamped.
void CStagedRun::GuessTensions()
{
    const CStagePart& part = Part();
    const CCaseLoads loads(part.Frame(), part.Dofs(), Loads(m_now, Everything()));
    for (std::size_t own = 0; own < part.Frame().elements.size(); ++own) {
        const std::size_t e = part.Active().elements[own];
        m_tension[e] += loads.Axial(own) - m_clamped[e];
        m_clamped[e] = loads.Axial(own);
    }
}

/// Mean over the element, by all load cases together.
void CStagedRun::ReadTensions(const T_FIELD& displacement)
{
    const CStagePart& part = Part();
    const T_LOAD_CASE load = Loads(m_now, Everything());
    T_HISTORY history;
    history.birth = m_records.Births(part, {Everything()});
    history.axial = m_now.axial;
    const CCaseBlock block(part.Frame(), part.Dofs(), {&load, 1}, &history);
    std::vector<T_RESULT> results;
    block.Results({&displacement, 1}, results);
    for (std::size_t own = 0; own < part.Frame().elements.size(); ++own) {
        const ELEMENT_KIND kind = part.Frame().elements[own].kind;
        if (kind != ELEMENT_KIND::Beam && kind != ELEMENT_KIND::Truss) continue;
        const auto& force = results[0].force[own];
        m_tension[part.Active().elements[own]] = 0.5 * (force.front()[0] + force.back()[0]);
    }
}

/// first: nothing is known yet of a cable without tension; it starts without sag.
std::vector<T_AXIAL> CStagedRun::AxialState(bool first) const
{
    const T_FRAME& frame = Part().Frame();
    std::vector<T_AXIAL> axial(frame.elements.size());
    for (std::size_t own = 0; own < axial.size(); ++own) {
        const std::size_t e = Part().Active().elements[own];
        const ELEMENT_KIND kind = frame.elements[own].kind;
        if (kind != ELEMENT_KIND::Beam && kind != ELEMENT_KIND::Truss) continue;
        if (m_model.options.geometricStiffness) axial[own].tension = m_tension[e];
        const bool sags = m_model.options.cableSag && m_cable[e] && kind == ELEMENT_KIND::Truss;
        if (sags && !(first && m_tension[e] == 0.0))
            axial[own].modulus = SagFactor(frame, frame.elements[own], m_tension[e]);
    }
    return axial;
}

} // namespace solver
