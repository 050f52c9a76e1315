// Displaced states of a push: displacements, reactions, forces, and the balance of all of them.
#include "qm_solver/push/pushstructure.h"

#include <algorithm>
#include <cmath>

namespace solver {

namespace {

T_VEC12 Gather(const T_ELEMENT& element, std::span<const double> full)
{
    T_VEC12 u{};
    for (std::size_t k = 0; k < ElementSize(element); ++k)
        u[k] = full[ElementIndex(element, k)];
    return u;
}

T_VEC12 Gather(const T_ELEMENT& element, std::span<const T_VEC6> nodes)
{
    T_VEC12 u{};
    for (std::size_t k = 0; k < ElementSize(element); ++k) {
        const std::size_t full = ElementIndex(element, k);
        u[k] = nodes[full / 6][full % 6];
    }
    return u;
}

/// Rises by less than a thousandth of its length.
bool IsLevel(const T_FRAME& frame, const T_ELEMENT& element, int vertical)
{
    const T_VEC3 along = Minus(frame.nodes[element.j].xyz, frame.nodes[element.i].xyz);
    return std::fabs(along[static_cast<std::size_t>(vertical)]) < 1e-3 * Norm(along);
}

} // namespace

std::span<const double> CPushStructure::PlasticOf(std::size_t element,
                                                  std::span<const double> plastic) const
{
    return plastic.subspan(m_firstRow[element], m_elements[element].Size());
}

T_VEC12 CPushStructure::ElementLoads(std::size_t element, std::span<const double> factors) const
{
    T_VEC12 ends{};
    for (std::size_t l = 0; l < factors.size(); ++l)
        for (std::size_t k = 0; k < 12; ++k)
            ends[k] += factors[l] * m_loads[l].element[element].ends[k];
    return ends;
}

/// Reactions and, over the unknowns, the loads less the forces of the elements.
void CPushStructure::Balance(const T_PUSH_STATE& state, std::span<const double> full,
                             T_PUSH_STEP& step, std::vector<double>& left,
                             std::vector<double>& tension)
{
    const T_FRAME& frame = m_model.frame;
    std::vector<double> held(m_dofs.FullCount()), rows(RowCount());
    double largest = 0.0;
    const auto measure = [&](std::size_t index, double force) {
        largest = std::max(largest, std::fabs(force) / (index % 6 < 3 ? 1.0 : m_extent));
    };
    for (std::size_t l = 0; l < state.factors.size(); ++l) {
        const auto nodal = m_loads[l].loads->Nodal();
        for (std::size_t i = 0; i < held.size(); ++i)
            held[i] -= state.factors[l] * nodal[i];
    }
    for (std::size_t i = 0; i < held.size(); ++i)
        measure(i, held[i]);
    step.base = {};
    const auto addBase = [&](std::size_t index, double force) {
        const std::size_t d = index % 6;
        step.base[d] += force;
        if (d > 2) return;
        T_VEC3 f{};
        f[d] = force;
        AddPart(step.base, 3, Cross(frame.nodes[index / 6].xyz, f));
    };
    for (std::size_t e = 0; e < frame.elements.size(); ++e) {
        const T_ELEMENT& element = frame.elements[e];
        T_VEC12 forces =
            m_elements[e].AtNodes(Gather(element, full), PlasticOf(e, state.plastic),
                                  m_tension.empty() ? 0.0 : m_tension[e], tension[e],
                                  std::span(rows).subspan(m_firstRow[e], m_elements[e].Size()));
        for (std::size_t l = 0; l < state.factors.size(); ++l) {
            const T_ELEMENT_LOADS& own = m_loads[l].element[e];
            if (!own.acts) continue;
            tension[e] += state.factors[l] * own.tension;
            for (std::size_t c = 0; c < own.force.size(); ++c)
                rows[m_firstRow[e] + c] += state.factors[l] * own.force[c];
            for (std::size_t k = 0; k < 12; ++k)
                forces[k] += state.factors[l] * own.nodes[k];
        }
        for (std::size_t k = 0; k < ElementSize(element); ++k) {
            held[ElementIndex(element, k)] += forces[k];
            measure(k, forces[k]);
            if (element.kind == ELEMENT_KIND::Spring) addBase(ElementIndex(element, k), -forces[k]);
        }
    }
    left.assign(m_dofs.EquationCount(), 0.0);
    for (std::size_t i = 0; i < held.size(); ++i)
        for (const T_TERM& t : m_dofs.FixedTerms(i))
            addBase(static_cast<std::size_t>(t.index), t.factor * held[i]);
    for (double& h : held)
        h = -h;
    m_dofs.Reduce(held, left);
    double worst = 0.0;
    for (std::size_t i = 0; i < left.size(); ++i) {
        const bool turns = m_dofs.Owner(i) % 6 > 2;
        worst = std::max(worst, std::fabs(left[i]) / (turns ? m_extent : 1.0));
    }
    // The forces that the path has told its hinges are those of the displaced elements.
    std::size_t law = 0;
    for (std::size_t h = 0; h < m_model.hinges.size() && !step.hinges.empty(); ++h)
        for (std::size_t l = 0; l < m_model.hinges[h].laws.size(); ++l, ++law) {
            const double apart = rows[m_lawRow[h][l]] - step.hinges[law].force;
            const bool turns = m_model.hinges[h].laws[l].component > 2;
            worst = std::max(worst, std::fabs(apart) / (turns ? m_extent : 1.0));
        }
    m_largest = std::max(m_largest, largest);
    step.residual = m_largest > 0.0 ? worst / m_largest : worst;
}

void CPushStructure::AddSides(const T_PUSH_STATE& state, std::span<double> side) const
{
    for (std::size_t l = 0; l < state.factors.size(); ++l)
        for (std::size_t i = 0; i < side.size(); ++i)
            side[i] += state.factors[l] * m_loads[l].side[i];
    for (std::size_t r = 0; r < RowCount(); ++r)
        if (const double q = state.plastic[r]; q != 0.0)
            for (std::size_t k = m_termFrom[r]; k < m_termFrom[r + 1]; ++k)
                side[static_cast<std::size_t>(m_terms[k].index)] += q * m_terms[k].factor;
}

void CPushStructure::TakeDisplacements(const T_PUSH_STATE& state, std::span<const double> unknowns,
                                       std::span<double> full) const
{
    m_dofs.Expand(unknowns, full);
    for (std::size_t l = 0; l < state.factors.size(); ++l)
        if (const auto settled = m_loads[l].loads->Settled(); !settled.empty())
            for (std::size_t i = 0; i < full.size(); ++i)
                full[i] += state.factors[l] * settled[i];
}

CPushStructure::T_FAULT CPushStructure::Solve(const T_PUSH_STATE& state,
                                              std::vector<double>& unknowns,
                                              std::vector<double>& forces)
{
    const T_FRAME& frame = m_model.frame;
    unknowns.assign(m_dofs.EquationCount(), 0.0);
    AddSides(state, unknowns);
    if (auto fault = Solve(unknowns, 1)) return fault;
    std::vector<double> full(m_dofs.FullCount());
    TakeDisplacements(state, unknowns, full);
    forces.assign(RowCount(), 0.0);
    double tension = 0.0;
    for (std::size_t e = 0; e < frame.elements.size(); ++e) {
        const std::size_t count = m_elements[e].Size();
        if (count == 0) continue;
        const auto own = std::span(forces).subspan(m_firstRow[e], count);
        (void)m_elements[e].AtNodes(Gather(frame.elements[e], full), PlasticOf(e, state.plastic),
                                    m_tension.empty() ? 0.0 : m_tension[e], tension, own);
        for (std::size_t l = 0; l < state.factors.size(); ++l)
            for (std::size_t c = 0; c < count; ++c)
                own[c] += state.factors[l] * m_loads[l].element[e].force[c];
    }
    return {};
}

CPushStructure::T_FAULT CPushStructure::Displace(std::span<const T_PUSH_STATE> states,
                                                 std::span<T_PUSH_STEP> steps,
                                                 std::vector<double>& tension)
{
    tension.assign(m_model.frame.elements.size(), 0.0);
    constexpr double kRefine = 1e-11; // residual from which a solution is refined
    const std::size_t n = m_dofs.EquationCount();
    std::vector<double> x(n * states.size(), 0.0);
    for (std::size_t s = 0; s < states.size(); ++s)
        AddSides(states[s], std::span(x).subspan(s * n, n));
    if (auto fault = Solve(x, states.size())) return fault;
    std::vector<double> full(m_dofs.FullCount()), left;
    for (std::size_t s = 0; s < states.size(); ++s) {
        const std::span<double> own(x.data() + s * n, n);
        const auto take = [&] {
            TakeDisplacements(states[s], own, full);
            Balance(states[s], full, steps[s], left, tension);
        };
        take();
        if (steps[s].residual > kRefine && n > 0) {
            if (auto fault = Solve(left, 1)) return fault;
            for (std::size_t i = 0; i < n; ++i)
                own[i] += left[i];
            take();
        }
        steps[s].axial.clear();
        for (const T_PUSH_HINGE& hinge : m_model.hinges)
            steps[s].axial.push_back(tension[hinge.element]);
        steps[s].nodes.resize(m_model.frame.nodes.size());
        for (std::size_t i = 0; i < full.size(); ++i)
            steps[s].nodes[i / 6][i % 6] = full[i];
    }
    return {};
}

void CPushStructure::Inside(const T_PUSH_STATE& state, const T_PUSH_STEP& step, T_RESULT& out) const
{
    const T_FRAME& frame = m_model.frame;
    out.displacement = step.nodes;
    out.force.assign(frame.elements.size(), {});
    for (std::size_t e = 0; e < frame.elements.size(); ++e) {
        std::vector<T_SPAN_LOAD> span;
        for (std::size_t l = 0; l < state.factors.size(); ++l)
            for (T_SPAN_LOAD load : m_loads[l].loads->OnSpan(e)) {
                load.w0 = Scaled(load.w0, state.factors[l]);
                load.w1 = Scaled(load.w1, state.factors[l]);
                span.push_back(load);
            }
        const T_VEC12 u = Gather(frame.elements[e], step.nodes);
        for (std::size_t p = 0; p < kBeamPositions; ++p)
            out.force[e][p] = m_elements[e].Inside(
                u, PlasticOf(e, state.plastic), m_tension.empty() ? 0.0 : m_tension[e],
                ElementLoads(e, state.factors), span, 0.25 * static_cast<double>(p));
    }
}

std::vector<double> CPushStructure::Coupled(std::vector<double> tension) const
{
    for (std::size_t e = 0; e < tension.size(); ++e)
        if (IsLevel(m_model.frame, m_model.frame.elements[e], m_model.vertical)) tension[e] = 0.0;
    return tension;
}

} // namespace solver
