#include "qm_solver/push/pushelement.h"

#include <algorithm>
#include <cmath>

namespace solver {

namespace {

T_VEC12 Times(const T_MATRIX12& a, const T_VEC12& x)
{
    T_VEC12 y{};
    for (std::size_t i = 0; i < 12; ++i)
        for (std::size_t j = 0; j < 12; ++j)
            y[i] += a[i][j] * x[j];
    return y;
}

double Product(const T_VEC12& a, const T_VEC12& b)
{
    double sum = 0.0;
    for (std::size_t i = 0; i < 12; ++i)
        sum += a[i] * b[i];
    return sum;
}

void Add(T_VEC12& a, const T_VEC12& b, double factor)
{
    for (std::size_t i = 0; i < 12; ++i)
        a[i] += factor * b[i];
}

bool IsAtJ(double at)
{
    return at >= 1.0;
}

} // namespace

CPushElement::CPushElement(const T_FRAME& frame, std::size_t element,
                           std::vector<T_PLACED_COMPONENT> components)
    : m_element(frame.elements[element]), m_components(std::move(components))
{
    if (m_element.kind == ELEMENT_KIND::Beam) {
        m_beam.emplace(frame, m_element);
        m_stiffness = m_beam->Local();
        m_length = m_beam->Length();
        MeasureArms(frame);
    } else {
        ElementStiffness(frame, m_element, {}, m_stiffness);
        if (m_element.kind == ELEMENT_KIND::Truss)
            m_direction = TrussDirection(frame, m_element, m_length);
    }
    for (const T_PLACED_COMPONENT& c : m_components)
        m_motion.push_back(Motion(c));
    CondenseSprings();
    MakeInfluence();
    MakeBasic();
}

/// Rigid ends lengthen the chord: the axial force turns with them about the nodes.
void CPushElement::MeasureArms(const T_FRAME& frame)
{
    const T_VEC3& i = frame.nodes[m_element.i].xyz;
    const T_VEC3& j = frame.nodes[m_element.j].xyz;
    for (std::size_t d = 0; d < 3; ++d)
        m_direction[d] = (j[d] + m_element.offsetJ[d] - i[d] - m_element.offsetI[d]) / m_length;
    m_arms = {Dot(m_element.offsetI, m_direction), -Dot(m_element.offsetJ, m_direction)};
}

/// Motion of the ends that strains the element as a unit jump at the place does. Told at the end
/// that is nearer, so that forces there follow without the loads on the span.
T_VEC12 CPushElement::Motion(const T_PLACED_COMPONENT& c) const
{
    T_VEC12 motion{};
    const auto d = static_cast<std::size_t>(c.component);
    switch (m_element.kind) {
    case ELEMENT_KIND::Beam:
        if (IsAtJ(c.at)) {
            motion[6 + d] = -1.0;
            break;
        }
        motion[d] = 1.0;
        if (d > 3) { // the part before a kink turns about it: rotation x (-x, 0, 0)
            const double x = c.at * m_length;
            motion[d == 4 ? 2 : 1] = d == 4 ? x : -x;
        }
        break;
    case ELEMENT_KIND::Truss:
        AddPart(motion, 0, m_direction);
        break;
    case ELEMENT_KIND::Link:
        motion[d] = 1.0;
        break;
    case ELEMENT_KIND::Spring: // the force of the node on the ground, positive as it moves
        motion[d] = -1.0;
        break;
    }
    return motion;
}

/// One spring after the other; each finds the element as the springs before it have left it.
void CPushElement::CondenseSprings()
{
    if (std::none_of(m_components.begin(), m_components.end(),
                     [](const T_PLACED_COMPONENT& c) { return c.spring > 0.0; }))
        return;
    m_spring.resize(Size());
    for (std::size_t c = 0; c < Size(); ++c) {
        if (m_components[c].spring <= 0.0) continue;
        const T_VEC12 forces = Times(m_stiffness, m_motion[c]);
        const double pivot = m_components[c].spring + Product(m_motion[c], forces);
        for (std::size_t i = 0; i < 12; ++i)
            m_spring[c][i] = forces[i] / pivot;
        for (std::size_t i = 0; i < 12; ++i)
            for (std::size_t j = 0; j < 12; ++j)
                m_stiffness[i][j] -= m_spring[c][i] * forces[j];
    }
}

void CPushElement::MakeInfluence()
{
    m_own.resize(Size() * Size());
    for (std::size_t c = 0; c < Size(); ++c) {
        T_VEC12 forces = Times(m_stiffness, m_motion[c]);
        for (std::size_t d = 0; d < Size(); ++d)
            m_own[d * Size() + c] = Product(m_motion[d], forces);
        for (double& f : forces)
            f = -f;
        m_influence.push_back(m_beam ? m_beam->AtNodes(forces) : forces);
    }
}

/// Of fraction s, by a unit kink at component d.
double CPushElement::OffChord(double s, std::size_t d) const
{
    const T_PLACED_COMPONENT& kink = m_components[d];
    if (!m_beam || kink.component < 4) return 0.0;
    return m_length * std::min(s, kink.at) * (1.0 - std::max(s, kink.at));
}

double CPushElement::Kink(std::size_t c, std::size_t d) const
{
    return m_components[c].component == m_components[d].component ? OffChord(m_components[c].at, d)
                                                                  : 0.0;
}

void CPushElement::Stiffness(double tension, T_MATRIX12& global) const
{
    if (!m_beam) {
        global = m_stiffness;
        if (m_element.kind != ELEMENT_KIND::Truss || tension == 0.0) return;
        const double across = tension / m_length;
        for (std::size_t r = 0; r < 3; ++r)
            for (std::size_t c = 0; c < 3; ++c) {
                const double value =
                    across * ((r == c ? 1.0 : 0.0) - m_direction[r] * m_direction[c]);
                global[r][c] += value;
                global[6 + r][6 + c] += value;
                global[r][6 + c] -= value;
                global[6 + r][c] -= value;
            }
        return;
    }
    T_MATRIX12 local = m_stiffness;
    const double across = tension / m_length;
    for (const std::size_t d : {1u, 2u}) {
        local[d][d] += across;
        local[6 + d][6 + d] += across;
        local[d][6 + d] -= across;
        local[6 + d][d] -= across;
    }
    m_beam->ToNodes(local, global);
    for (std::size_t end = 0; end < 2; ++end)
        for (std::size_t r = 0; r < 3; ++r)
            for (std::size_t c = 0; c < 3; ++c)
                global[6 * end + 3 + r][6 * end + 3 + c] +=
                    tension * m_arms[end] *
                    ((r == c ? 1.0 : 0.0) - m_direction[r] * m_direction[c]);
}

/// Between clamped ends the spring of a hinge deforms by what the loads do at its place.
T_ELEMENT_LOADS CPushElement::Loads(std::span<const T_SPAN_LOAD> loads, double axial) const
{
    T_ELEMENT_LOADS out;
    out.force.resize(Size());
    if (m_beam) {
        out.ends = m_beam->FixedEndForces(loads, axial);
    } else if (m_element.kind == ELEMENT_KIND::Truss) {
        AddPart(out.ends, 0, Scaled(m_direction, -axial));
        AddPart(out.ends, 6, Scaled(m_direction, axial));
    }
    std::vector<double> inside(Size()); // of the loads on the span alone
    for (std::size_t c = 0; c < Size(); ++c)
        if (m_beam && !IsAtJ(m_components[c].at))
            inside[c] = m_beam->InternalForces(
                {}, loads, m_components[c].at)[static_cast<std::size_t>(m_components[c].component)];
    const auto force = [&](std::size_t c) { return inside[c] - Product(m_motion[c], out.ends); };
    // The gain of a spring was made for k as the earlier springs left it: so are the loads.
    for (std::size_t c = 0; c < m_spring.size(); ++c)
        if (m_components[c].spring > 0.0) Add(out.ends, m_spring[c], force(c));
    for (std::size_t c = 0; c < Size(); ++c)
        out.force[c] = force(c);
    out.nodes = LoadsAtNodes(out.ends);
    out.tension = Tension(out.ends);
    out.acts = std::any_of(out.nodes.begin(), out.nodes.end(), [](double f) { return f != 0.0; });
    return out;
}

/// What the nodes give to the element, from its deformations: a rigid-body motion leaves nothing.
T_VEC12 CPushElement::Ends(const T_VEC12& displacement, std::span<const double> plastic,
                           const T_VEC12& loads) const
{
    T_VEC12 motion = m_beam ? m_beam->Strains(displacement) : displacement;
    for (std::size_t c = 0; c < Size(); ++c)
        if (plastic[c] != 0.0) Add(motion, m_motion[c], plastic[c]);
    T_VEC12 forces = Times(m_stiffness, motion);
    Add(forces, loads, 1.0);
    return forces;
}

T_VEC12 CPushElement::Across(const T_VEC12& displacement, double tension) const
{
    T_VEC12 forces{};
    const double across = tension / m_length;
    if (m_beam) {
        const T_VEC12 ends = m_beam->EndDisplacements(displacement);
        for (const std::size_t d : {1u, 2u}) {
            forces[d] = across * (ends[d] - ends[6 + d]);
            forces[6 + d] = -forces[d];
        }
        forces = m_beam->AtNodes(forces);
        for (const std::size_t turn : {3u, 9u}) { // of the arm at I, at J
            const T_VEC3 rotation = Part(displacement, turn);
            const T_VEC3 bent = Minus(rotation, Scaled(m_direction, Dot(rotation, m_direction)));
            AddPart(forces, turn, Scaled(bent, tension * m_arms[turn / 6]));
        }
        return forces;
    }
    const T_VEC3 drift = Minus(Part(displacement, 0), Part(displacement, 6));
    const T_VEC3 sideways = Minus(drift, Scaled(m_direction, Dot(drift, m_direction)));
    AddPart(forces, 0, Scaled(sideways, across));
    AddPart(forces, 6, Scaled(sideways, -across));
    return forces;
}

/// The six strains of a beam are those of CBeamElement, that of a truss is its elongation, those of
/// a link or spring its deformations; forces that go with them are the entries of the stiffness.
void CPushElement::MakeBasic()
{
    constexpr std::array<std::size_t, 6> kBeam{4, 5, 6, 9, 10, 11};
    const ELEMENT_KIND kind = m_element.kind;
    m_strains = kind == ELEMENT_KIND::Truss ? 1 : 6;
    m_jump.resize(Size());
    for (std::size_t k = 0; k < 12; ++k) {
        T_VEC12 unit{};
        unit[k] = 1.0;
        if (m_beam) {
            const T_VEC12 strains = m_beam->Strains(unit);
            for (std::size_t i = 0; i < 6; ++i)
                m_strainOf[i][k] = strains[kBeam[i]];
        } else if (kind == ELEMENT_KIND::Truss && k % 6 < 3) {
            m_strainOf[0][k] = (k < 6 ? -1.0 : 1.0) * m_direction[k % 6];
        } else if (kind != ELEMENT_KIND::Truss) {
            m_strainOf[k % 6][k] = k < 6 ? -1.0 : 1.0;
        }
    }
    for (std::size_t i = 0; i < m_strains; ++i)
        for (std::size_t j = 0; j < m_strains; ++j) {
            if (m_beam)
                m_basic[i][j] = m_stiffness[kBeam[i]][kBeam[j]];
            else if (kind == ELEMENT_KIND::Truss)
                m_basic[i][j] = AxialStiffness();
            else
                m_basic[i][j] = m_stiffness[i][j];
        }
    // Of beams motions are local already; what they strain has no rigid-body part left.
    for (std::size_t c = 0; c < Size(); ++c) {
        if (m_beam) {
            const T_VEC12 strains = m_beam->StrainsOfEnds(m_motion[c]);
            for (std::size_t i = 0; i < 6; ++i)
                m_jump[c][i] = strains[kBeam[i]];
            continue;
        }
        for (std::size_t i = 0; i < m_strains; ++i)
            m_jump[c][i] = Product(m_strainOf[i], m_motion[c]);
    }
}

double CPushElement::AxialStiffness() const
{
    T_VEC12 along{};
    AddPart(along, 6, m_direction);
    return Product(along, Times(m_stiffness, along));
}

T_VEC12 CPushElement::LoadsAtNodes(const T_VEC12& loads) const
{
    return m_beam ? m_beam->AtNodes(loads) : loads;
}

T_VEC12 CPushElement::AtNodes(const T_VEC12& displacement, std::span<const double> plastic,
                              double coupled, double& tension, std::span<double> own) const
{
    T_STRAIN strain{}, force{};
    for (std::size_t i = 0; i < m_strains; ++i)
        strain[i] = Product(m_strainOf[i], displacement);
    for (std::size_t c = 0; c < Size(); ++c)
        for (std::size_t i = 0; i < m_strains && plastic[c] != 0.0; ++i)
            strain[i] += plastic[c] * m_jump[c][i];
    T_VEC12 out{};
    for (std::size_t i = 0; i < m_strains; ++i) {
        for (std::size_t j = 0; j < m_strains; ++j)
            force[i] += m_basic[i][j] * strain[j];
        Add(out, m_strainOf[i], force[i]);
    }
    for (std::size_t c = 0; c < own.size(); ++c) {
        own[c] = 0.0;
        for (std::size_t i = 0; i < m_strains; ++i)
            own[c] -= m_jump[c][i] * force[i];
        for (std::size_t d = 0; d < Size() && coupled != 0.0; ++d)
            if (plastic[d] != 0.0) own[c] -= coupled * Kink(c, d) * plastic[d];
    }
    tension = m_beam ? force[2] : m_element.kind == ELEMENT_KIND::Truss ? force[0] : 0.0;
    if (coupled != 0.0) Add(out, Across(displacement, coupled), 1.0);
    return out;
}

double CPushElement::Tension(const T_VEC12& loads) const
{
    if (m_beam) return 0.5 * (loads[6] - loads[0]);
    if (m_element.kind != ELEMENT_KIND::Truss) return 0.0;
    return 0.5 * Dot(m_direction, Minus(Part(loads, 6), Part(loads, 0)));
}

T_VEC6 CPushElement::Inside(const T_VEC12& displacement, std::span<const double> plastic,
                            double coupled, const T_VEC12& loads, std::span<const T_SPAN_LOAD> span,
                            double s) const
{
    const T_VEC12 ends = Ends(displacement, plastic, loads);
    T_VEC6 inside{};
    if (m_beam) {
        inside = m_beam->InternalForces(ends, span, s);
        for (std::size_t d = 0; d < Size(); ++d)
            inside[static_cast<std::size_t>(m_components[d].component)] -=
                coupled * OffChord(s, d) * plastic[d];
        return inside;
    }
    if (m_element.kind == ELEMENT_KIND::Truss) {
        inside[0] = Dot(m_direction, Part(ends, 6));
    } else if (m_element.kind == ELEMENT_KIND::Link) {
        std::copy_n(ends.begin() + 6, 6, inside.begin());
    } else {
        std::copy_n(ends.begin(), 6, inside.begin());
    }
    return inside;
}

} // namespace solver
