#include "qm_solver/element/beamelement.h"

#include "qm_solver/model/fine.h"

#include <algorithm>

namespace solver {

namespace {

constexpr double kVertical = 1e-6; // sine of the angle to the global Z under which a beam is so
constexpr double kParallel = 1e-6; // sine of the angle between a beam and its reference vector
constexpr double kLoose = 1e-11;   // stiffness left of a diagonal that has been condensed away

double Largest(const T_VEC3& v)
{
    return std::max({std::fabs(v[0]), std::fabs(v[1]), std::fabs(v[2])});
}

double ShearParameter(double EI, double GAs, double length)
{
    return GAs > 0.0 ? 12.0 * EI / (GAs * length * length) : 0.0;
}

void PutPair(T_MATRIX12& k, std::size_t i, std::size_t j, double value)
{
    k[i][i] = k[j][j] = value;
    k[i][j] = k[j][i] = -value;
}

/// Bending in one plane: v1, r1, v2, r2 and the sign of the slope.
void PutBending(T_MATRIX12& k, const std::array<std::size_t, 4>& at, double sign, double EI,
                double phi, double L)
{
    const double c = EI / (L * L * L * (1.0 + phi));
    const double t = sign * 6.0 * L * c;
    const std::array<std::array<double, 4>, 4> block{{
        {12.0 * c, t, -12.0 * c, t},
        {t, (4.0 + phi) * L * L * c, -t, (2.0 - phi) * L * L * c},
        {-12.0 * c, -t, 12.0 * c, -t},
        {t, (2.0 - phi) * L * L * c, -t, (4.0 + phi) * L * L * c},
    }};
    for (std::size_t i = 0; i < 4; ++i)
        for (std::size_t j = 0; j < 4; ++j)
            k[at[i]][at[j]] = block[i][j];
}

} // namespace

bool BeamAxes(const T_FRAME& frame, const T_ELEMENT& element, T_AXES& axes, double& length)
{
    const T_VEC3 i = Plus(frame.nodes[element.i].xyz, element.offsetI);
    const T_VEC3 j = Plus(frame.nodes[element.j].xyz, element.offsetJ);
    const T_VEC3 along = Minus(j, i);
    length = Norm(along);
    // Coordinates that differ by their round-off alone are the same point.
    if (!(length > 1e-12 * std::max(Largest(i), Largest(j)))) return false;
    axes[0] = Scaled(along, 1.0 / length);

    T_VEC3 reference = element.zAxis;
    if (Largest(reference) == 0.0) {
        const bool vertical = std::hypot(axes[0][0], axes[0][1]) < kVertical;
        reference = vertical ? T_VEC3{1.0, 0.0, 0.0} : T_VEC3{0.0, 0.0, 1.0};
    }
    reference = Scaled(reference, 1.0 / Largest(reference));
    reference = Scaled(reference, 1.0 / Norm(reference));
    const T_VEC3 y = Cross(reference, axes[0]);
    if (Norm(y) < kParallel) return false;
    axes[1] = Scaled(y, 1.0 / Norm(y));
    axes[2] = Cross(axes[0], axes[1]);
    return true;
}

CBeamElement::CBeamElement(const T_FRAME& frame, const T_ELEMENT& element, double tension)
    : m_offsetI(element.offsetI), m_offsetJ(element.offsetJ), m_tension(tension)
{
    if (!BeamAxes(frame, element, m_axes, m_shape.length)) return; // not of a checked frame
    m_hasOffset = Largest(m_offsetI) > 0.0 || Largest(m_offsetJ) > 0.0;
    MakeLocalStiffness(frame.materials[element.material], frame.sections[element.section]);
    if (tension != 0.0) AddGeometricStiffness(m_shape, tension, m_local);
    T_VEC12 diagonal;
    for (std::size_t d = 0; d < 12; ++d)
        diagonal[d] = m_local[d][d];
    for (std::size_t d = 0; d < 12; ++d)
        if (d < 6 ? element.releaseI[d] : element.releaseJ[d - 6]) Release(d, diagonal[d]);
}

void CBeamElement::MakeLocalStiffness(const T_MATERIAL& material, const T_SECTION& section)
{
    const double L = m_shape.length, E = material.E, G = material.G;
    m_shape.phiY = ShearParameter(E * section.Iz, G * section.Asy, L);
    m_shape.phiZ = ShearParameter(E * section.Iy, G * section.Asz, L);
    PutPair(m_local, 0, 6, E * section.StiffA() / L);
    PutPair(m_local, 3, 9, G * section.J / L);
    PutBending(m_local, {1, 5, 7, 11}, 1.0, E * section.Iz, m_shape.phiY, L);
    PutBending(m_local, {2, 4, 8, 10}, -1.0, E * section.Iy, m_shape.phiZ, L);
}

/// diagonal: the stiffness of this displacement before any release.
void CBeamElement::Release(std::size_t at, double diagonal)
{
    if (diagonal <= 0.0) return; // carries nothing anyway
    const double pivot = m_local[at][at];
    if (pivot <= kLoose * diagonal) {
        m_loose = static_cast<int>(at);
        return;
    }
    T_RELEASE release{at, {}, pivot};
    for (std::size_t i = 0; i < 12; ++i)
        release.gain[i] = m_local[i][at] / pivot;
    const T_VEC12 row = m_local[at];
    for (std::size_t i = 0; i < 12; ++i)
        for (std::size_t j = 0; j < 12; ++j)
            m_local[i][j] -= release.gain[i] * row[j];
    for (std::size_t i = 0; i < 12; ++i)
        m_local[i][at] = m_local[at][i] = 0.0; // exactly
    m_releases.push_back(release);
}

void CBeamElement::ToNodes(const T_MATRIX12& local, T_MATRIX12& global) const
{
    for (std::size_t bi = 0; bi < 12; bi += 3)
        for (std::size_t bj = bi; bj < 12; bj += 3) {
            double half[3][3]; // local block times axes
            for (std::size_t i = 0; i < 3; ++i)
                for (std::size_t c = 0; c < 3; ++c)
                    half[i][c] = local[bi + i][bj] * m_axes[0][c] +
                                 local[bi + i][bj + 1] * m_axes[1][c] +
                                 local[bi + i][bj + 2] * m_axes[2][c];
            for (std::size_t r = 0; r < 3; ++r)
                for (std::size_t c = 0; c < 3; ++c) {
                    const double k = m_axes[0][r] * half[0][c] + m_axes[1][r] * half[1][c] +
                                     m_axes[2][r] * half[2][c];
                    global[bi + r][bj + c] = k;
                    global[bj + c][bi + r] = k;
                }
        }
    if (!m_hasOffset) return;
    MoveToNodes(global, 0, m_offsetI);
    MoveToNodes(global, 6, m_offsetJ);
}

/// The end of the beam moves by u + theta x r with its node: columns and rows of theta get r x
/// those of u.
void CBeamElement::MoveToNodes(T_MATRIX12& global, std::size_t first, const T_VEC3& offset) const
{
    for (std::size_t i = 0; i < 12; ++i)
        AddPart(global[i], first + 3, Cross(offset, Part(global[i], first)));
    for (std::size_t j = 0; j < 12; ++j) {
        const T_VEC3 column{global[first][j], global[first + 1][j], global[first + 2][j]};
        const T_VEC3 moved = Cross(offset, column);
        for (std::size_t r = 0; r < 3; ++r)
            global[first + 3 + r][j] += moved[r];
    }
}

T_VEC12 CBeamElement::FixedEndForces(std::span<const T_SPAN_LOAD> loads, double axial) const
{
    T_VEC12 forces{};
    for (const T_SPAN_LOAD& load : loads)
        AddFixedEndForces(m_shape, load, forces);
    forces[0] -= axial;
    forces[6] += axial;
    for (const T_RELEASE& release : m_releases) {
        const double given = forces[release.at];
        for (std::size_t i = 0; i < 12; ++i)
            forces[i] -= release.gain[i] * given;
        forces[release.at] = 0.0;
    }
    return forces;
}

T_VEC12 CBeamElement::EndDisplacements(const T_VEC12& displacement) const
{
    T_VEC12 local;
    for (std::size_t end = 0; end < 12; end += 6) {
        const T_VEC3 rotation = Part(displacement, end + 3);
        T_VEC3 moved = Part(displacement, end);
        if (m_hasOffset) moved = Plus(moved, Cross(rotation, end == 0 ? m_offsetI : m_offsetJ));
        const T_VEC3 u = ToLocal(m_axes, moved), r = ToLocal(m_axes, rotation);
        std::copy(u.begin(), u.end(), local.begin() + static_cast<long>(end));
        std::copy(r.begin(), r.end(), local.begin() + static_cast<long>(end) + 3);
    }
    return local;
}

/// In twice the digits: a stiff beam that turns with a soft one strains by what is left of its
/// movement when that of a rigid body is taken off.
CBeamElement::T_DEFORMATION CBeamElement::Deformation(const T_VEC12& displacement,
                                                      const T_VEC12& rest) const
{
    std::array<CFine, 12> u;
    for (std::size_t i = 0; i < 12; ++i)
        u[i] = CFine(displacement[i]) + rest[i];
    const auto turned = [&](std::size_t first, const T_VEC3& arm, std::size_t d) {
        const std::size_t a = (d + 1) % 3, b = (d + 2) % 3;
        return u[first + a] * arm[b] - u[first + b] * arm[a];
    };
    std::array<CFine, 3> drift, twist; // of J against I
    for (std::size_t d = 0; d < 3; ++d) {
        twist[d] = u[9 + d] - u[3 + d];
        drift[d] = u[6 + d] - u[d];
        if (m_hasOffset) drift[d] = drift[d] + turned(9, m_offsetJ, d) - turned(3, m_offsetI, d);
    }
    const auto along = [&](std::size_t axis, const CFine* of) {
        const T_VEC3& e = m_axes[axis];
        return of[0] * e[0] + of[1] * e[1] + of[2] * e[2];
    };
    const CFine chordY = -along(2, drift.data()) / m_shape.length;
    const CFine chordZ = along(1, drift.data()) / m_shape.length;
    T_DEFORMATION d;
    d.chordY = chordY.Value();
    d.chordZ = chordZ.Value();
    d.strain[4] = (along(1, &u[3]) - chordY).Value();
    d.strain[5] = (along(2, &u[3]) - chordZ).Value();
    d.strain[6] = along(0, drift.data()).Value();
    d.strain[9] = along(0, twist.data()).Value();
    d.strain[10] = (along(1, &u[9]) - chordY).Value();
    d.strain[11] = (along(2, &u[9]) - chordZ).Value();
    return d;
}

T_VEC12 CBeamElement::StrainsOfEnds(const T_VEC12& ends) const
{
    const double chordY = -(ends[8] - ends[2]) / m_shape.length;
    const double chordZ = (ends[7] - ends[1]) / m_shape.length;
    T_VEC12 strain{};
    strain[4] = ends[4] - chordY;
    strain[5] = ends[5] - chordZ;
    strain[6] = ends[6] - ends[0];
    strain[9] = ends[9] - ends[3];
    strain[10] = ends[10] - chordY;
    strain[11] = ends[11] - chordZ;
    return strain;
}

double CBeamElement::StrainEnergy(const T_VEC12& displacement) const
{
    const T_DEFORMATION d = Deformation(displacement, {});
    double energy = 0.0;
    for (std::size_t i = 0; i < 12; ++i)
        for (std::size_t j = 0; j < 12; ++j)
            energy += d.strain[i] * m_local[i][j] * d.strain[j];
    return energy + m_tension * m_shape.length * (d.chordY * d.chordY + d.chordZ * d.chordZ);
}

T_VEC12 CBeamElement::DeformationForces(const T_VEC12& displacement, const T_VEC12& rest) const
{
    const T_DEFORMATION d = Deformation(displacement, rest);
    T_VEC12 forces{};
    for (const std::size_t i : {4u, 5u, 6u, 9u, 10u, 11u})
        for (std::size_t j = 0; j < 12; ++j)
            forces[i] += m_local[i][j] * d.strain[j];
    forces[0] = -forces[6];
    forces[3] = -forces[9];
    forces[1] = (forces[5] + forces[11]) / m_shape.length - m_tension * d.chordZ;
    forces[7] = -forces[1];
    forces[2] = m_tension * d.chordY - (forces[4] + forces[10]) / m_shape.length;
    forces[8] = -forces[2];
    return forces;
}

T_VEC12 CBeamElement::EndForces(const T_VEC12& displacement, const T_VEC12& fixedEnd) const
{
    const T_VEC12 local = EndDisplacements(displacement);
    T_VEC12 forces = fixedEnd;
    for (std::size_t i = 0; i < 12; ++i)
        for (std::size_t j = 0; j < 12; ++j)
            forces[i] += m_local[i][j] * local[j];
    return forces;
}

T_VEC12 CBeamElement::AtNodes(const T_VEC12& endForces) const
{
    T_VEC12 out{};
    for (std::size_t end = 0; end < 12; end += 6) {
        const T_VEC3 force = ToGlobal(m_axes, Part(endForces, end));
        AddPart(out, end, force);
        AddPart(out, end + 3, ToGlobal(m_axes, Part(endForces, end + 3)));
        if (m_hasOffset) AddPart(out, end + 3, Cross(end == 0 ? m_offsetI : m_offsetJ, force));
    }
    return out;
}

T_VEC6 CBeamElement::InternalForces(const T_VEC12& endForces, std::span<const T_SPAN_LOAD> loads,
                                    double s) const
{
    const double x = s * m_shape.length;
    const T_VEC3 force = Part(endForces, 0);
    T_VEC6 sum{};
    AddPart(sum, 0, force);
    AddPart(sum, 3, Part(endForces, 3));
    AddPart(sum, 3, Cross({-x, 0.0, 0.0}, force));
    for (const T_SPAN_LOAD& load : loads)
        AddResultantBefore(load, x, s >= 1.0, sum);
    for (double& value : sum)
        value = -value;
    return sum;
}

/// The release that was condensed last knows the movement of its end by the nodes alone, the ones
/// before it also by those after.
T_VEC12 CBeamElement::MovedEnds(const T_VEC12& displacement,
                                std::span<const T_SPAN_LOAD> loads) const
{
    T_VEC12 ends = EndDisplacements(displacement), forces{};
    for (const T_SPAN_LOAD& load : loads)
        AddFixedEndForces(m_shape, load, forces);
    for (const T_RELEASE& release : m_releases) {
        ends[release.at] = -forces[release.at] / release.pivot;
        const double given = forces[release.at];
        for (std::size_t i = 0; i < 12; ++i)
            forces[i] -= release.gain[i] * given;
    }
    for (auto release = m_releases.rbegin(); release != m_releases.rend(); ++release)
        for (std::size_t i = 0; i < 12; ++i)
            if (i != release->at) ends[release->at] -= release->gain[i] * ends[i];
    return ends;
}

void CBeamElement::AddDeflectionMoments(const T_VEC12& movedEnds, double s, T_VEC6& internal) const
{
    const auto cut = DeflectionAt(m_shape, s * m_shape.length, movedEnds);
    internal[4] -= m_tension * (cut[1] - movedEnds[2]);
    internal[5] += m_tension * (cut[0] - movedEnds[1]);
}

} // namespace solver
