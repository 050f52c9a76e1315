// Single beams against closed forms. Each row runs along X, and turned in space with its local
// axes, so that supports are made of clamps and releases, which turn with the beam.
#include "solved.h"

#include "qm_solver/model/vec3.h"

#include <cmath>

namespace {

using namespace sample;

constexpr double kL = 4.0, kEIy = 7770.0, kEIz = 2730.0;
constexpr double kTolerance = 1e-10; // relative to the largest value of the beam's end

/// Where the beam lies: its direction and reference vector.
struct T_PLACE {
    const char* label;
    T_VEC3 direction, zAxis;
};
const T_PLACE kPlaces[] = {
    {"along X", {1, 0, 0}, {0, 0, 0}},
    {"along X, reference Y", {1, 0, 0}, {0, 1, 0}},
    {"upright", {0, 0, 1}, {0, 0, 0}},
    {"skew", {2.0 / 7, -3.0 / 7, 6.0 / 7}, {0.3, 0.5, -0.2}},
};

/// Clamped at I; J clamped or free. Asy, Asz so that phi = 12 EI / (G As L^2) is as given.
T_FRAME OneBeam(const T_PLACE& place, bool clampedJ, double phiY, double phiZ)
{
    T_FRAME frame = Empty();
    T_SECTION& s = frame.sections[0];
    const double G = frame.materials[0].G;
    if (phiY > 0.0) s.Asy = 12.0 * kEIz / (G * phiY * kL * kL);
    if (phiZ > 0.0) s.Asz = 12.0 * kEIy / (G * phiZ * kL * kL);
    AddNode(frame, {1.0, 2.0, 3.0});
    AddNode(frame, Plus({1.0, 2.0, 3.0}, Scaled(place.direction, kL)));
    FixAll(frame, 0);
    if (clampedJ) FixAll(frame, 1);
    Join(frame, ELEMENT_KIND::Beam, 0, 1);
    frame.elements[0].zAxis = place.zAxis;
    return frame;
}

struct T_ROW {
    const char* label;
    bool clampedJ;
    std::initializer_list<int> releaseI, releaseJ;
    double phiY, phiZ;
    T_BEAM_LOAD load;
    std::size_t component; // 0 axial, 1 shear y, 2 shear z, 3 torsion, 4 moment y, 5 moment z
    std::array<double, 5> expected;
};

constexpr auto kLine = BEAM_LOAD::Distributed;
constexpr auto kPoint = BEAM_LOAD::Point;
constexpr auto kMoment = BEAM_LOAD::Moment;

// Internal forces by statics; end moments of clamped and propped beams from the usual tables
// (w L^2 / 12, w L^2 / 8, P a b^2 / L^2, triangle w L^2 / 30 and 20, end moments M0 b (2a - b) /
// L^2 and M0 a (2b - a) / L^2 on the beam, in the sense of M0); with shear deformation the prop
// carries w L (3 + phi) / (8 + 2 phi), which follows from the cantilever's deflections w L^4 / 8EI
// + w L^2 / 2GAs and P L^3 / 3EI + P L / GAs. L = 4.
// clang-format off
const T_ROW kRows[] = {
    {"cantilever, load up z: moment y", false, {}, {}, 0, 0, {0, kLine, true, 2, {3, 3}, {0, 1}}, 4,
     {-24, -13.5, -6, -1.5, 0}},
    {"cantilever, load up z: shear z", false, {}, {}, 0, 0, {0, kLine, true, 2, {3, 3}, {0, 1}}, 2,
     {12, 9, 6, 3, 0}},
    {"cantilever, load up y: moment z", false, {}, {}, 0, 0, {0, kLine, true, 1, {3, 3}, {0, 1}}, 5,
     {24, 13.5, 6, 1.5, 0}},
    {"cantilever, load along x", false, {}, {}, 0, 0, {0, kLine, true, 0, {2, 4}, {0, 0.5}}, 0,
     {6, 3.5, 0, 0, 0}},
    {"cantilever, twist at 3/4", false, {}, {}, 0, 0, {0, kMoment, true, 0, {5, 0}, {0.75, 1}}, 3,
     {5, 5, 5, 5, 0}},
    {"cantilever, force at J counts before J", false, {}, {}, 0, 0,
     {0, kPoint, true, 2, {10, 0}, {1, 1}}, 2, {10, 10, 10, 10, 0}},
    {"two supports, own weight", true, {4, 5}, {4, 5}, 0, 0.7,
     {0, kLine, true, 2, {-3, -3}, {0, 1}}, 4, {0, -4.5, -6, -4.5, 0}},
    {"clamped, uniform y", true, {}, {}, 0, 0, {0, kLine, true, 1, {-3, -3}, {0, 1}}, 5,
     {-4, 0.5, 2, 0.5, -4}},
    {"clamped, force at 1/4: cut just before it", true, {}, {}, 0, 0,
     {0, kPoint, true, 1, {-16, 0}, {0.25, 1}}, 1, {-13.5, -13.5, 2.5, 2.5, 2.5}},
    {"clamped, moment at 1/4", true, {}, {}, 0, 0, {0, kMoment, true, 2, {16, 0}, {0.25, 1}}, 5,
     {3, 7.5, -4, 0.5, 5}},
    {"propped at J, uniform y, phi = 1", true, {}, {5}, 1, 0,
     {0, kLine, true, 1, {-8, -8}, {0, 1}}, 1, {-19.2, -11.2, -3.2, 4.8, 12.8}},
    {"propped at I, uniform z, phi = 1", true, {4}, {}, 0, 1,
     {0, kLine, true, 2, {-8, -8}, {0, 1}}, 2, {-12.8, -4.8, 3.2, 11.2, 19.2}},
    {"guided at J: no shear there", true, {}, {2}, 0, 0, {0, kLine, true, 2, {-3, -3}, {0, 1}}, 4,
     {16, 5.5, -2, -6.5, -8}},
    {"axial release at J", true, {}, {0}, 0, 0, {0, kLine, true, 0, {3, 3}, {0, 1}}, 0,
     {12, 9, 6, 3, 0}},
};
// clang-format on

T_FRAME FrameOf(const T_ROW& row, const T_PLACE& place)
{
    T_FRAME frame = OneBeam(place, row.clampedJ, row.phiY, row.phiZ);
    for (int d : row.releaseI)
        frame.elements[0].releaseI[static_cast<std::size_t>(d)] = true;
    for (int d : row.releaseJ)
        frame.elements[0].releaseJ[static_cast<std::size_t>(d)] = true;
    return frame;
}

TEST(BeamElement, InternalForcesAreThoseOfTheTables)
{
    for (const T_ROW& row : kRows)
        for (const T_PLACE& place : kPlaces) {
            SCOPED_TRACE(std::string(row.label) + ", " + place.label);
            T_LOAD_CASE load;
            load.beam.push_back(row.load);
            const T_RESULT result = Solved(FrameOf(row, place), load);
            for (std::size_t p = 0; p < kBeamPositions; ++p)
                EXPECT_NEAR(row.expected[p], result.force[0][p][row.component], 25 * kTolerance)
                    << "position " << p;
        }
}

/// Fixed-end forces in the plane x-y by brute force: the cantilever clamped at I and the two
/// redundants at J, virtual work integrated by Simpson's rule over short steps.
struct T_CLAMPED {
    double shearJ, momentJ; // forces of the end on the beam
};

T_CLAMPED ByForceMethod(const T_BEAM_LOAD& load, double EI, double GAs)
{
    constexpr int kSteps = 4000; // even in every part between fractions of 1/100
    const double h = kL / kSteps;
    const double a = load.at[0] * kL, b = load.at[1] * kL;
    double f11 = 0, f12 = 0, f22 = 0, d1 = 0, d2 = 0; // 1: force at J along y, 2: moment at J
    for (int k = 0; k < kSteps; ++k)
        for (int g = 0; g < 3; ++g) { // ends pulled inwards: jumps belong to their own side
            const double inward = g == 0 ? 1e-12 : g == 2 ? -1e-12 : 0.0;
            const double x = (k + 0.5 * g) * h + inward, weight = (g == 1 ? 4 : 1) * h / 6;
            double shear = 0, moment = 0; // of the load beyond x, about x
            if (load.type == BEAM_LOAD::Point && a > x) {
                shear = load.w[0];
                moment = load.w[0] * (a - x);
            } else if (load.type == BEAM_LOAD::Moment && a > x) {
                moment = load.w[0];
            } else if (load.type == BEAM_LOAD::Distributed && b > x) {
                const double from = std::max(a, x), run = b - from;
                const double slope = (load.w[1] - load.w[0]) / (b - a);
                const double w0 = load.w[0] + slope * (from - a);
                shear = w0 * run + 0.5 * slope * run * run;
                moment = w0 * run * (from - x + 0.5 * run) +
                         slope * run * run * (0.5 * (from - x) + run / 3);
            }
            const double m1 = kL - x;
            f11 += weight * (m1 * m1 / EI + (GAs > 0 ? 1 / GAs : 0));
            f12 += weight * m1 / EI;
            f22 += weight / EI;
            d1 += weight * (m1 * moment / EI + (GAs > 0 ? shear / GAs : 0));
            d2 += weight * moment / EI;
        }
    const double det = f11 * f22 - f12 * f12;
    return {-(f22 * d1 - f12 * d2) / det, -(f11 * d2 - f12 * d1) / det};
}

TEST(BeamElement, AnyLoadOnAClampedBeamMatchesTheForceMethod)
{
    const T_BEAM_LOAD loads[] = {
        {0, kLine, true, 1, {-3, 5}, {0.15, 0.8}}, {0, kLine, true, 1, {4, 0}, {0.0, 0.37}},
        {0, kPoint, true, 1, {11, 0}, {0.63, 1}},  {0, kMoment, true, 2, {9, 0}, {0.22, 1}},
        {0, kLine, true, 1, {1, 2}, {0.995, 1.0}},
    };
    const T_PLACE& place = kPlaces[0];
    for (const double phi : {0.0, 0.4, 3.0})
        for (T_BEAM_LOAD load : loads) {
            SCOPED_TRACE(phi);
            const double GAs = phi > 0.0 ? 12.0 * kEIz / (phi * kL * kL) : 0.0;
            const T_CLAMPED expected = ByForceMethod(load, kEIz, GAs);
            T_LOAD_CASE inY, inZ;
            inY.beam.push_back(load);
            T_FRAME frame = OneBeam(place, true, phi, 0.0);
            const T_VEC6 y = Solved(frame, inY).force[0][4];
            EXPECT_NEAR(expected.shearJ, y[1], 1e-8);
            EXPECT_NEAR(expected.momentJ, y[5], 1e-8);
            // The plane x-z mirrors it: a moment about y is one about -z.
            load.direction = load.type == kMoment ? 1 : 2;
            if (load.type == kMoment) load.w[0] = -load.w[0];
            inZ.beam.push_back(load);
            std::swap(frame.sections[0].Iy, frame.sections[0].Iz);
            std::swap(frame.sections[0].Asy, frame.sections[0].Asz);
            const T_VEC6 z = Solved(frame, inZ).force[0][4];
            EXPECT_NEAR(expected.shearJ, z[2], 1e-8);
            EXPECT_NEAR(-expected.momentJ, z[4], 1e-8);
        }
}

TEST(BeamElement, WeightAndLoadsInGlobalDirectionsAreThoseOfTheFlexibleLength)
{
    T_FRAME frame = OneBeam(kPlaces[3], true, 0.0, 0.0);
    frame.materials[0].density = 7.85;
    frame.elements[0].offsetI = Scaled(kPlaces[3].direction, 0.75);
    T_LOAD_CASE load;
    load.selfWeight = {0.1, 0.0, -1.0};
    load.beam.push_back({0, kLine, false, 1, {2, 4}, {0, 0.5}});
    const T_RESULT r = Solved(frame, load);
    const double weight = 7.85 * 5.4e-3 * 9.80665 * (kL - 0.75);
    EXPECT_NEAR(weight, r.reaction[0][2] + r.reaction[1][2], 1e-12);
    EXPECT_NEAR(-0.1 * weight, r.reaction[0][0] + r.reaction[1][0], 1e-12);
    EXPECT_NEAR(-3.0 * 0.5 * (kL - 0.75), r.reaction[0][1] + r.reaction[1][1], 1e-12);
}

} // namespace
