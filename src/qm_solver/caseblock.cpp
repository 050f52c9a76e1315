#include "qm_solver/caseblock.h"

#include "qm_solver/beamelement.h"
#include "qm_solver/elementstiffness.h"

#include <algorithm>

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

} // namespace

CCaseBlock::CCaseBlock(const T_FRAME& frame, const CFrameDofs& dofs,
                       std::span<const T_LOAD_CASE> cases)
    : m_frame(frame), m_dofs(dofs)
{
    m_cases.reserve(cases.size());
    for (const T_LOAD_CASE& load : cases)
        m_cases.emplace_back(frame, dofs, load);
}

bool CCaseBlock::Acts(std::size_t e, std::size_t c) const
{
    const CCaseLoads& loads = m_cases[c];
    return !loads.OnSpan(e).empty() || loads.Axial(e) != 0.0 || !loads.Settled().empty();
}

template <class WANTED, class USE>
void CCaseBlock::ForElement(std::size_t e, std::span<const T_FIELD> displacement, WANTED&& wanted,
                            USE&& use) const
{
    const T_ELEMENT& element = m_frame.elements[e];
    const auto each = [&](auto&& forces) {
        for (std::size_t c = 0; c < m_cases.size(); ++c) {
            if (!wanted(c)) continue;
            T_POSITIONS positions{};
            use(c, forces(c, Gather(element, displacement[c]), positions), positions);
        }
    };
    switch (element.kind) {
    case ELEMENT_KIND::Beam: {
        const CBeamElement beam(m_frame, element);
        each([&](std::size_t c, const T_VEC12& u, T_POSITIONS& positions) {
            const auto loads = m_cases[c].OnSpan(e);
            const T_VEC12 ends = beam.EndForces(u, beam.FixedEndForces(loads, m_cases[c].Axial(e)));
            for (std::size_t p = 0; p < kBeamPositions; ++p)
                positions[p] = beam.InternalForces(ends, loads, 0.25 * static_cast<double>(p));
            return beam.AtNodes(ends);
        });
        break;
    }
    case ELEMENT_KIND::Truss: {
        double length = 0.0;
        const T_VEC3 direction = TrussDirection(m_frame, element, length);
        const double stiffness = TrussStiffness(m_frame, element, length);
        each([&](std::size_t c, const T_VEC12& u, T_POSITIONS& positions) {
            const double n =
                m_cases[c].Axial(e) + stiffness * Dot(direction, Minus(Part(u, 6), Part(u, 0)));
            for (T_VEC6& position : positions)
                position[0] = n;
            T_VEC12 forces{};
            AddPart(forces, 0, Scaled(direction, -n));
            AddPart(forces, 6, Scaled(direction, n));
            return forces;
        });
        break;
    }
    case ELEMENT_KIND::Link:
    case ELEMENT_KIND::Spring:
        each([&](std::size_t, const T_VEC12& u, T_POSITIONS& positions) {
            T_VEC6 own{};
            const T_VEC12 forces = SpringForces(element, u, own);
            if (element.kind == ELEMENT_KIND::Link) positions.fill(own);
            return forces;
        });
        break;
    }
}

std::vector<double> CCaseBlock::RightSides() const
{
    std::vector<T_FIELD> settled, loads;
    for (const CCaseLoads& c : m_cases) {
        settled.emplace_back(c.Settled().begin(), c.Settled().end());
        loads.emplace_back(c.Nodal().begin(), c.Nodal().end());
    }
    for (std::size_t e = 0; e < m_frame.elements.size(); ++e) {
        bool any = false;
        for (std::size_t c = 0; c < Size() && !any; ++c)
            any = Acts(e, c);
        if (!any) continue;
        ForElement(
            e, settled, [&](std::size_t c) { return Acts(e, c); },
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

void CCaseBlock::Recover(std::span<const double> unknowns, std::vector<T_RESULT>& out) const
{
    const std::size_t n = m_dofs.EquationCount(), first = out.size();
    std::vector<T_FIELD> displacement(Size(), T_FIELD(m_dofs.FullCount())), internal = displacement;
    for (std::size_t c = 0; c < Size(); ++c) {
        m_dofs.Expand(unknowns.subspan(c * n, n), displacement[c]);
        const auto settled = m_cases[c].Settled();
        for (std::size_t i = 0; i < settled.size(); ++i)
            displacement[c][i] += settled[i];
        out.emplace_back().force.resize(m_frame.elements.size());
    }
    for (std::size_t e = 0; e < m_frame.elements.size(); ++e)
        ForElement(
            e, displacement, [](std::size_t) { return true; },
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
    for (const T_ELEMENT& element : m_frame.elements)
        if (element.kind == ELEMENT_KIND::Spring)
            for (std::size_t d = 0; d < 6; ++d)
                result.reaction[element.i][d] -=
                    element.stiffness[d] * displacement[6 * element.i + d];
}

} // namespace solver
