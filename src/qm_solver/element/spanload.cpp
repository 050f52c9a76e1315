#include "qm_solver/element/spanload.h"

#include <algorithm>

namespace solver {

namespace {

// Gauss-Legendre on [0, 1], exact up to degree 5: a cubic shape times a linear load has 4.
struct T_GAUSS {
    double at, weight;
};
constexpr double kGaussArm = 0.38729833462074168852; // sqrt(0.6) / 2
constexpr std::array<T_GAUSS, 3> kGauss{
    {{0.5 - kGaussArm, 5.0 / 18.0}, {0.5, 8.0 / 18.0}, {0.5 + kGaussArm, 5.0 / 18.0}}};

/// One plane of bending: where its four end displacements stand, and the sign of the slope.
struct T_PLANE {
    std::size_t direction, rotation; // of a load component: force 0 to 2, moment 0 to 2
    std::size_t v1, r1, v2, r2;
    double sign; // rotation about z is +dv/dx, about y it is -dw/dx
};
constexpr std::array<T_PLANE, 2> kPlanes{{{1, 2, 1, 5, 7, 11, 1.0}, {2, 1, 2, 4, 8, 10, -1.0}}};

double Phi(const T_BEAM_SHAPE& shape, const T_PLANE& plane)
{
    return plane.direction == 1 ? shape.phiY : shape.phiZ;
}

void AddForceAt(const T_BEAM_SHAPE& shape, double x, const T_VEC3& force, T_VEC12& out)
{
    const double L = shape.length, s = x / L, s2 = s * s, s3 = s2 * s;
    out[0] -= (1.0 - s) * force[0];
    out[6] -= s * force[0];
    for (const T_PLANE& plane : kPlanes) {
        const double phi = Phi(shape, plane), p = force[plane.direction] / (1.0 + phi);
        out[plane.v1] -= p * (1.0 - 3.0 * s2 + 2.0 * s3 + phi * (1.0 - s));
        out[plane.r1] -= plane.sign * p * L * (s - 2.0 * s2 + s3 + 0.5 * phi * (s - s2));
        out[plane.v2] -= p * (3.0 * s2 - 2.0 * s3 + phi * s);
        out[plane.r2] -= plane.sign * p * L * (s3 - s2 + 0.5 * phi * (s2 - s));
    }
}

void AddMomentAt(const T_BEAM_SHAPE& shape, double x, const T_VEC3& moment, T_VEC12& out)
{
    const double L = shape.length, s = x / L, s2 = s * s;
    out[3] -= (1.0 - s) * moment[0];
    out[9] -= s * moment[0];
    for (const T_PLANE& plane : kPlanes) {
        const double phi = Phi(shape, plane), m = moment[plane.rotation] / (1.0 + phi);
        out[plane.v1] -= plane.sign * m * 6.0 / L * (s2 - s);
        out[plane.r1] -= m * (1.0 - 4.0 * s + 3.0 * s2 + phi * (1.0 - s));
        out[plane.v2] -= plane.sign * m * 6.0 / L * (s - s2);
        out[plane.r2] -= m * (3.0 * s2 - 2.0 * s + phi * s);
    }
}

/// Calls use(position, force) for forces that stand for the distributed load between a and `end`.
template <class F>
void ForGaussForces(const T_SPAN_LOAD& load, double end, F&& use)
{
    const double length = end - load.a;
    for (const T_GAUSS& g : kGauss) {
        const double x = load.a + g.at * length;
        const double t = (x - load.a) / (load.b - load.a);
        const T_VEC3 w = Plus(Scaled(load.w0, 1.0 - t), Scaled(load.w1, t));
        use(x, Scaled(w, g.weight * length));
    }
}

} // namespace

void AddFixedEndForces(const T_BEAM_SHAPE& shape, const T_SPAN_LOAD& load, T_VEC12& forces)
{
    switch (load.type) {
    case BEAM_LOAD::Point:
        AddForceAt(shape, load.a, load.w0, forces);
        break;
    case BEAM_LOAD::Moment:
        AddMomentAt(shape, load.a, load.w0, forces);
        break;
    case BEAM_LOAD::Distributed:
        ForGaussForces(load, load.b,
                       [&](double x, const T_VEC3& p) { AddForceAt(shape, x, p, forces); });
        break;
    }
}

std::array<double, 2> DeflectionAt(const T_BEAM_SHAPE& shape, double x, const T_VEC12& ends)
{
    std::array<double, 2> deflection{};
    for (const T_PLANE& plane : kPlanes) {
        T_VEC3 unit{};
        unit[plane.direction] = 1.0;
        T_VEC12 forces{}; // minus the shapes, by Betti
        AddForceAt(shape, x, unit, forces);
        for (const std::size_t i : {plane.v1, plane.r1, plane.v2, plane.r2})
            deflection[plane.direction - 1] -= forces[i] * ends[i];
    }
    return deflection;
}

void AddGeometricStiffness(const T_BEAM_SHAPE& shape, double tension, T_MATRIX12& stiffness)
{
    const double L = shape.length;
    for (const T_PLANE& plane : kPlanes) {
        const double phi = Phi(shape, plane);
        const std::array<std::size_t, 4> at{plane.v1, plane.r1, plane.v2, plane.r2};
        for (const T_GAUSS& g : kGauss) {
            const double s = g.at, chord = (6.0 * (s * s - s) - phi) / L;
            const double shear = 0.5 * phi * (1.0 - 2.0 * s);
            const std::array<double, 4> slope{chord,
                                              plane.sign * (1.0 - 4.0 * s + 3.0 * s * s + shear),
                                              -chord, plane.sign * (3.0 * s * s - 2.0 * s - shear)};
            const double weight = tension * L * g.weight / ((1.0 + phi) * (1.0 + phi));
            for (std::size_t i = 0; i < 4; ++i)
                for (std::size_t j = 0; j < 4; ++j)
                    stiffness[at[i]][at[j]] += weight * slope[i] * slope[j];
        }
    }
}

void AddResultantBefore(const T_SPAN_LOAD& load, double x, bool whole, T_VEC6& resultant)
{
    const auto addForce = [&](double at, const T_VEC3& p) {
        AddPart(resultant, 0, p);
        AddPart(resultant, 3, Cross({at - x, 0.0, 0.0}, p));
    };
    if (!whole && load.a >= x) return;
    switch (load.type) {
    case BEAM_LOAD::Point:
        addForce(load.a, load.w0);
        break;
    case BEAM_LOAD::Moment:
        AddPart(resultant, 3, load.w0);
        break;
    case BEAM_LOAD::Distributed:
        ForGaussForces(load, std::min(load.b, x), addForce);
        break;
    }
}

} // namespace solver
