#include "qm_solver/frame/caseblock.h"

#include "qm_solver/element/beamelement.h"
#include "qm_solver/element/elementstiffness.h"

#include <algorithm>
#include <optional>

namespace solver {

namespace {

using T_POSITIONS = std::array<T_VEC6, kBeamPositions>;

T_VEC12 Gather(const T_ELEMENT& element, std::span<const double> field)
{
    T_VEC12 u{};
    if (field.empty()) return u;
    std::copy_n(field.begin() + static_cast<long>(6 * element.i), 6, u.begin());
    if (element.kind != ELEMENT_KIND::Spring)
        std::copy_n(field.begin() + static_cast<long>(6 * element.j), 6, u.begin() + 6);
    return u;
}

void Scatter(const T_ELEMENT& element, const T_VEC12& forces, double sign, std::span<double> field)
{
    for (std::size_t k = 0; k < ElementSize(element); ++k)
        field[ElementIndex(element, k)] += sign * forces[k];
}

/// Forces of the nodes on a link or spring; the link's own forces go to `own`.
T_VEC12 SpringForces(const T_ELEMENT& element, const T_VEC12& u, T_VEC6& own)
{
    T_VEC12 forces{};
    for (std::size_t d = 0; d < 6; ++d) {
        own[d] = element.stiffness[d] * (u[6 + d] - u[d]); // of a spring u[6 + d] is the ground, 0
        forces[d] = -own[d];
        forces[6 + d] = own[d];
    }
    return forces;
}

T_VEC12 Less(T_VEC12 a, const T_VEC12& b)
{
    for (std::size_t i = 0; i < a.size(); ++i)
        a[i] -= b[i];
    return a;
}

void BeamInside(const CBeamElement& beam, double tension, const T_VEC12& u, const T_VEC12& ends,
                std::span<const T_SPAN_LOAD> loads, T_POSITIONS& positions)
{
    for (std::size_t p = 0; p < kBeamPositions; ++p)
        positions[p] = beam.InternalForces(ends, loads, 0.25 * static_cast<double>(p));
    if (tension == 0.0) return;
    const T_VEC12 moved = beam.MovedEnds(u, loads);
    for (std::size_t p = 0; p < kBeamPositions; ++p)
        beam.AddDeflectionMoments(moved, 0.25 * static_cast<double>(p), positions[p]);
}

} // namespace

CCaseBlock::CCaseBlock(const T_FRAME& frame, const CFrameDofs& dofs,
                       std::span<const T_LOAD_CASE> cases, const T_HISTORY* history)
    : m_frame(frame), m_dofs(dofs), m_history(history)
{
    m_cases.reserve(cases.size());
    for (const T_LOAD_CASE& load : cases)
        m_cases.emplace_back(frame, dofs, load);
}

T_AXIAL CCaseBlock::Axial(std::size_t e) const
{
    return m_history && !m_history->axial.empty() ? m_history->axial[e] : T_AXIAL{};
}

bool CCaseBlock::Birth(std::size_t e, std::size_t c, T_VEC12& displacement) const
{
    return m_history && m_history->birth && m_history->birth(e, c, displacement);
}

/// Displacements that are known before the solution: settlements and what the history holds.
CCaseBlock::T_FIELD CCaseBlock::Held(std::size_t c) const
{
    const auto settled = m_cases[c].Settled();
    T_FIELD held(settled.begin(), settled.end());
    if (!m_history || m_history->held.empty() || m_history->held[c].empty()) return held;
    held.resize(m_dofs.FullCount());
    for (std::size_t i = 0; i < held.size(); ++i)
        held[i] += m_history->held[c][i];
    return held;
}

bool CCaseBlock::Acts(std::size_t e, std::size_t c, const T_FIELD& held) const
{
    const CCaseLoads& loads = m_cases[c];
    if (!loads.OnSpan(e).empty() || loads.Axial(e) != 0.0) return true;
    const T_VEC12 moved = Gather(m_frame.elements[e], held);
    T_VEC12 birth;
    return std::any_of(moved.begin(), moved.end(), [](double u) { return u != 0.0; }) ||
           Birth(e, c, birth);
}

template <class WANTED, class USE>
void CCaseBlock::ForElement(std::size_t e, std::span<const T_FIELD> displacement, INSIDE inside,
                            WANTED&& wanted, USE&& use) const
{
    const T_ELEMENT& element = m_frame.elements[e];
    const T_AXIAL axial = Axial(e);
    const auto each = [&](auto&& forces) {
        for (std::size_t c = 0; c < m_cases.size(); ++c) {
            if (!wanted(c)) continue;
            T_POSITIONS positions{};
            T_VEC12 birth{};
            const bool born = Birth(e, c, birth);
            use(c, forces(c, Gather(element, displacement[c]), born ? &birth : nullptr, positions),
                positions);
        }
    };
    switch (element.kind) {
    case ELEMENT_KIND::Beam: {
        const CBeamElement beam(m_frame, element, axial.tension);
        std::optional<CBeamElement> other;
        const CBeamElement& straight = // of first order, for the forces spared at birth
            axial.tension == 0.0 ? beam : other.emplace(m_frame, element);
        each([&](std::size_t c, const T_VEC12& u, const T_VEC12* birth, T_POSITIONS& positions) {
            const auto loads = m_cases[c].OnSpan(e);
            T_VEC12 fixedEnd = beam.FixedEndForces(loads, m_cases[c].Axial(e));
            if (birth) fixedEnd = Less(fixedEnd, straight.EndForces(*birth, {}));
            const T_VEC12 ends = beam.EndForces(u, fixedEnd);
            if (inside == INSIDE::Give) BeamInside(beam, axial.tension, u, ends, loads, positions);
            return beam.AtNodes(ends);
        });
        break;
    }
    case ELEMENT_KIND::Truss: {
        double length = 0.0;
        const T_VEC3 direction = TrussDirection(m_frame, element, length);
        const double stiffness = axial.modulus * TrussStiffness(m_frame, element, length);
        each([&](std::size_t c, const T_VEC12& u, const T_VEC12* birth, T_POSITIONS& positions) {
            const T_VEC3 drift = Minus(Part(u, 6), Part(u, 0));
            const double stretch = Dot(direction, drift);
            const double before =
                birth ? Dot(direction, Minus(Part(*birth, 6), Part(*birth, 0))) : 0.0;
            const double n = m_cases[c].Axial(e) + stiffness * (stretch - before);
            for (T_VEC6& position : positions)
                position[0] = n;
            const double across = axial.tension / length;
            const T_VEC3 atJ = Plus(Scaled(direction, n - across * stretch), Scaled(drift, across));
            T_VEC12 forces{};
            AddPart(forces, 0, Scaled(atJ, -1.0));
            AddPart(forces, 6, atJ);
            return forces;
        });
        break;
    }
    case ELEMENT_KIND::Link:
    case ELEMENT_KIND::Spring:
        each([&](std::size_t, const T_VEC12& u, const T_VEC12* birth, T_POSITIONS& positions) {
            T_VEC6 own{};
            const T_VEC12 forces = SpringForces(element, birth ? Less(u, *birth) : u, own);
            if (element.kind == ELEMENT_KIND::Link) positions.fill(own);
            return forces;
        });
        break;
    }
}

std::vector<double> CCaseBlock::RightSides() const
{
    std::vector<T_FIELD> held, loads;
    for (std::size_t c = 0; c < Size(); ++c) {
        held.push_back(Held(c));
        loads.emplace_back(m_cases[c].Nodal().begin(), m_cases[c].Nodal().end());
    }
    std::vector<char> acts(Size());
    for (std::size_t e = 0; e < m_frame.elements.size(); ++e) {
        for (std::size_t c = 0; c < Size(); ++c)
            acts[c] = Acts(e, c, held[c]);
        if (std::none_of(acts.begin(), acts.end(), [](char a) { return a != 0; })) continue;
        ForElement(
            e, held, INSIDE::Leave, [&](std::size_t c) { return acts[c] != 0; },
            [&](std::size_t c, const T_VEC12& forces, const T_POSITIONS&) {
                Scatter(m_frame.elements[e], forces, -1.0, loads[c]);
            });
    }
    const std::size_t n = m_dofs.EquationCount();
    std::vector<double> sides(n * Size(), 0.0);
    for (std::size_t c = 0; c < Size(); ++c)
        m_dofs.Reduce(loads[c], std::span(sides).subspan(c * n, n));
    return sides;
}

std::vector<CCaseBlock::T_FIELD> CCaseBlock::Displacements(std::span<const double> unknowns) const
{
    const std::size_t n = m_dofs.EquationCount();
    std::vector<T_FIELD> displacement(Size(), T_FIELD(m_dofs.FullCount()));
    for (std::size_t c = 0; c < Size(); ++c) {
        m_dofs.Expand(unknowns.subspan(c * n, n), displacement[c]);
        const T_FIELD held = Held(c);
        for (std::size_t i = 0; i < held.size(); ++i)
            displacement[c][i] += held[i];
    }
    return displacement;
}

void CCaseBlock::Recover(std::span<const double> unknowns, std::vector<T_RESULT>& out) const
{
    Results(Displacements(unknowns), out);
}

void CCaseBlock::Results(std::span<const T_FIELD> displacement, std::vector<T_RESULT>& out) const
{
    const std::size_t first = out.size();
    std::vector<T_FIELD> internal(Size(), T_FIELD(m_dofs.FullCount()));
    for (std::size_t c = 0; c < Size(); ++c)
        out.emplace_back().force.resize(m_frame.elements.size());
    for (std::size_t e = 0; e < m_frame.elements.size(); ++e)
        ForElement(
            e, displacement, INSIDE::Give, [](std::size_t) { return true; },
            [&](std::size_t c, const T_VEC12& forces, const T_POSITIONS& positions) {
                Scatter(m_frame.elements[e], forces, 1.0, internal[c]);
                out[first + c].force[e] = positions;
            });
    for (std::size_t c = 0; c < Size(); ++c)
        Finish(c, displacement[c], internal[c], out[first + c]);
}

/// Displacements and reactions by node.
void CCaseBlock::Finish(std::size_t c, const T_FIELD& displacement, const T_FIELD& internal,
                        T_RESULT& result) const
{
    const std::size_t nodes = m_frame.nodes.size();
    const auto nodal = m_cases[c].Nodal();
    result.displacement.resize(nodes);
    result.reaction.resize(nodes);
    for (std::size_t i = 0; i < internal.size(); ++i) {
        result.displacement[i / 6][i % 6] = displacement[i];
        const double held = internal[i] - nodal[i]; // what the node needs from outside
        // A slave of a support hands its force on to it.
        for (const T_TERM& t : m_dofs.FixedTerms(i))
            result.reaction[static_cast<std::size_t>(t.index) / 6]
                           [static_cast<std::size_t>(t.index) % 6] += t.factor * held;
    }
    for (std::size_t e = 0; e < m_frame.elements.size(); ++e) {
        const T_ELEMENT& element = m_frame.elements[e];
        if (element.kind != ELEMENT_KIND::Spring) continue;
        T_VEC12 birth{};
        if (!Birth(e, c, birth)) birth = {};
        for (std::size_t d = 0; d < 6; ++d)
            result.reaction[element.i][d] -=
                element.stiffness[d] * (displacement[6 * element.i + d] - birth[d]);
    }
}

} // namespace solver
