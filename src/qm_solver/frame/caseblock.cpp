#include "qm_solver/frame/caseblock.h"

#include "qm_solver/element/beamelement.h"
#include "qm_solver/element/elementstiffness.h"
#include "qm_solver/model/fine.h"

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

/// Displacements of an element's nodes, and what doubles round away of them where that is known.
struct T_MOVED {
    T_VEC12 u{}, rest{};
    bool fine = false;

    /// Of node j against node i, and how much of it is along a direction.
    T_VEC3 Drift(const T_VEC3& direction, double& stretch) const
    {
        T_VEC3 drift{};
        CFine along;
        for (std::size_t d = 0; d < 3; ++d) {
            const CFine moved = CFine(u[6 + d]) + rest[6 + d] - (CFine(u[d]) + rest[d]);
            drift[d] = moved.Value();
            along = along + moved * direction[d];
        }
        stretch = along.Value();
        return drift;
    }
};

/// Forces of the nodes on a link or spring; the link's own forces go to `own`.
T_VEC12 SpringForces(const T_ELEMENT& element, const T_MOVED& moved, T_VEC6& own)
{
    const T_VEC12 &u = moved.u, &rest = moved.rest;
    T_VEC12 forces{};
    for (std::size_t d = 0; d < 6; ++d) {
        // of a spring u[6 + d] is the ground, 0
        own[d] = element.stiffness[d] * ((u[6 + d] - u[d]) + (rest[6 + d] - rest[d]));
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

T_VEC12 Sum(T_VEC12 a, const T_VEC12& b)
{
    for (std::size_t i = 0; i < a.size(); ++i)
        a[i] += b[i];
    return a;
}

/// Of displacements without their rest by the stiffness over the nodes, else by deformations.
T_VEC12 BeamEnds(const CBeamElement& beam, const T_MOVED& moved, const T_VEC12& fixedEnd)
{
    if (!moved.fine) return beam.EndForces(moved.u, fixedEnd);
    return Sum(fixedEnd, beam.DeformationForces(moved.u, moved.rest));
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
void CCaseBlock::ForElement(std::size_t e, const T_FIELDS& fields, INSIDE inside, WANTED&& wanted,
                            USE&& use) const
{
    const T_ELEMENT& element = m_frame.elements[e];
    const T_AXIAL axial = Axial(e);
    const auto each = [&](auto&& forces) {
        for (std::size_t c = 0; c < m_cases.size(); ++c) {
            if (!wanted(c)) continue;
            T_POSITIONS positions{};
            T_VEC12 birth{};
            const bool born = Birth(e, c, birth);
            T_MOVED moved{Gather(element, fields.displacement[c])};
            moved.fine = c < fields.rest.size() && !fields.rest[c].empty();
            if (moved.fine) moved.rest = Gather(element, fields.rest[c]);
            use(c, forces(c, moved, born ? &birth : nullptr, positions), positions);
        }
    };
    switch (element.kind) {
    case ELEMENT_KIND::Beam: {
        const CBeamElement beam(m_frame, element, axial.tension);
        std::optional<CBeamElement> other;
        const CBeamElement& straight = // of first order, for the forces spared at birth
            axial.tension == 0.0 ? beam : other.emplace(m_frame, element);
        each(
            [&](std::size_t c, const T_MOVED& moved, const T_VEC12* birth, T_POSITIONS& positions) {
                const auto loads = m_cases[c].OnSpan(e);
                T_VEC12 fixedEnd = beam.FixedEndForces(loads, m_cases[c].Axial(e));
                if (birth) {
                    const T_MOVED before{*birth, {}, moved.fine};
                    fixedEnd = Less(fixedEnd, BeamEnds(straight, before, {}));
                }
                const T_VEC12 ends = BeamEnds(beam, moved, fixedEnd);
                if (inside == INSIDE::Give)
                    BeamInside(beam, axial.tension, moved.u, ends, loads, positions);
                return beam.AtNodes(ends);
            });
        break;
    }
    case ELEMENT_KIND::Truss: {
        double length = 0.0;
        const T_VEC3 direction = TrussDirection(m_frame, element, length);
        const double stiffness = axial.modulus * TrussStiffness(m_frame, element, length);
        each([&](std::size_t c, const T_MOVED& moved, const T_VEC12* birth,
                 T_POSITIONS& positions) {
            double stretch = 0.0;
            const T_VEC3 drift = moved.Drift(direction, stretch);
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
        each([&](std::size_t, T_MOVED moved, const T_VEC12* birth, T_POSITIONS& positions) {
            T_VEC6 own{};
            if (birth) moved.u = Less(moved.u, *birth);
            const T_VEC12 forces = SpringForces(element, moved, own);
            if (element.kind == ELEMENT_KIND::Link) positions.fill(own);
            return forces;
        });
        break;
    }
}

std::vector<double> CCaseBlock::RightSides() const
{
    T_FIELDS held;
    std::vector<T_FIELD> loads;
    for (std::size_t c = 0; c < Size(); ++c) {
        held.displacement.push_back(Held(c));
        loads.emplace_back(m_cases[c].Nodal().begin(), m_cases[c].Nodal().end());
    }
    std::vector<char> acts(Size());
    for (std::size_t e = 0; e < m_frame.elements.size(); ++e) {
        for (std::size_t c = 0; c < Size(); ++c)
            acts[c] = Acts(e, c, held.displacement[c]);
        if (std::none_of(acts.begin(), acts.end(), [](char a) { return a != 0; })) continue;
        ForElement(
            e, held, INSIDE::Leave, [&](std::size_t c) { return acts[c] != 0; },
            [&](std::size_t c, const T_VEC12& forces, const T_POSITIONS&) {
                Scatter(m_frame.elements[e], forces, -1.0, loads[c]);
            });
    }
    return Reduced(loads);
}

std::vector<double> CCaseBlock::Reduced(std::span<const T_FIELD> full) const
{
    const std::size_t n = m_dofs.EquationCount();
    std::vector<double> columns(n * Size(), 0.0);
    for (std::size_t c = 0; c < Size(); ++c)
        if (!full[c].empty()) m_dofs.Reduce(full[c], std::span(columns).subspan(c * n, n));
    return columns;
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

CCaseBlock::T_FIELDS CCaseBlock::FineFields(const T_SOLUTION& solution,
                                            std::span<const char> wanted) const
{
    const std::size_t n = m_dofs.EquationCount();
    T_FIELDS fields{Displacements(solution.x), {}};
    if (solution.rest.empty()) return fields;
    fields.rest.resize(Size());
    for (std::size_t c = 0; c < Size(); ++c) {
        if (!wanted[c]) continue;
        T_FIELD &moved = fields.displacement[c], &left = fields.rest[c];
        left.resize(m_dofs.FullCount());
        m_dofs.Expand(std::span(solution.x).subspan(c * n, n),
                      std::span(solution.rest).subspan(c * n, n), moved, left);
        const T_FIELD held = Held(c);
        for (std::size_t i = 0; i < held.size(); ++i) {
            const CFine sum = CFine(moved[i]) + held[i] + left[i];
            moved[i] = sum.Value();
            left[i] = sum.Rest();
        }
    }
    return fields;
}

std::vector<double> CCaseBlock::Unbalanced(const T_SOLUTION& solution,
                                           std::span<const char> wanted) const
{
    const T_FIELDS fields = FineFields(solution, wanted);
    std::vector<T_FIELD> left(Size());
    for (std::size_t c = 0; c < Size(); ++c)
        if (wanted[c]) left[c].assign(m_cases[c].Nodal().begin(), m_cases[c].Nodal().end());
    for (std::size_t e = 0; e < m_frame.elements.size(); ++e)
        ForElement(
            e, fields, INSIDE::Leave, [&](std::size_t c) { return wanted[c] != 0; },
            [&](std::size_t c, const T_VEC12& forces, const T_POSITIONS&) {
                Scatter(m_frame.elements[e], forces, -1.0, left[c]);
            });
    return Reduced(left);
}

void CCaseBlock::Recover(const T_SOLUTION& solution, std::vector<T_RESULT>& out) const
{
    const std::size_t first = out.size();
    Results(FineFields(solution, solution.fine), out);
    for (std::size_t c = 0; c < Size(); ++c)
        out[first + c].accuracy = solution.accuracy[c];
}

void CCaseBlock::Results(std::span<const T_FIELD> displacement, std::vector<T_RESULT>& out) const
{
    Results(T_FIELDS{{displacement.begin(), displacement.end()}, {}}, out);
}

void CCaseBlock::Results(const T_FIELDS& fields, std::vector<T_RESULT>& out) const
{
    const std::size_t first = out.size();
    std::vector<T_FIELD> internal(Size(), T_FIELD(m_dofs.FullCount()));
    for (std::size_t c = 0; c < Size(); ++c)
        out.emplace_back().force.resize(m_frame.elements.size());
    for (std::size_t e = 0; e < m_frame.elements.size(); ++e)
        ForElement(
            e, fields, INSIDE::Give, [](std::size_t) { return true; },
            [&](std::size_t c, const T_VEC12& forces, const T_POSITIONS& positions) {
                Scatter(m_frame.elements[e], forces, 1.0, internal[c]);
                out[first + c].force[e] = positions;
            });
    for (std::size_t c = 0; c < Size(); ++c)
        Finish(c, fields.displacement[c], internal[c], out[first + c]);
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
