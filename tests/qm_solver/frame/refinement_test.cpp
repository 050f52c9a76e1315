// Models whose direct solution loses digits: forces are known by statics, displacements by beam
// theory.
#include "solved.h"

#include <cmath>

namespace {

using namespace sample;

TEST(Refinement, LongCantileverOfManyElements)
{
    constexpr std::size_t kCount = 2000;
    constexpr double kLength = 40.0, kForce = 12.0;
    T_FRAME frame = Empty();
    for (std::size_t n = 0; n <= kCount; ++n)
        AddNode(frame, {kLength * double(n) / double(kCount), 0, 0});
    for (std::size_t n = 0; n < kCount; ++n)
        Join(frame, ELEMENT_KIND::Beam, n, n + 1);
    FixAll(frame, 0);
    T_LOAD_CASE load;
    load.nodal.push_back({kCount, {0, 0, -kForce, 0, 0, 0}});
    const T_RESULT r = Solved(frame, load);
    const double EI = frame.materials[0].E * frame.sections[0].Iy;
    const double tip = kForce * std::pow(kLength, 3) / (3 * EI);
    EXPECT_NEAR(-tip, r.displacement[kCount][2], 1e-10 * tip);
    for (std::size_t e = 0; e < kCount; ++e) {
        const double left = kLength * (1.0 - double(e) / double(kCount));
        ASSERT_NEAR(kForce, std::fabs(r.force[e][2][2]), 1e-9 * kForce) << e;
        ASSERT_NEAR(kForce * left, std::fabs(r.force[e][0][4]), 1e-10 * kForce * kLength) << e;
    }
    EXPECT_GT(r.accuracy.unrefined, 0.0);
    EXPECT_LT(r.accuracy.error, 1e-10);
}

TEST(Refinement, StiffArmOnASoftColumn)
{
    // The arm is 1e10 times as stiff as the column; its forces are those of a cantilever.
    T_FRAME frame = Empty();
    T_SECTION stiff = frame.sections[0];
    for (double* value : {&stiff.A, &stiff.J, &stiff.Iy, &stiff.Iz})
        *value *= 1e10;
    frame.sections.push_back(stiff);
    for (const T_VEC3& at : {T_VEC3{0, 0, 0}, {0, 0, 4}, {1.7, 0.9, 5.1}})
        AddNode(frame, at);
    Join(frame, ELEMENT_KIND::Beam, 0, 1);
    Join(frame, ELEMENT_KIND::Beam, 1, 2);
    frame.elements[1].section = 1;
    FixAll(frame, 0);
    T_LOAD_CASE load;
    load.nodal.push_back({2, {3, -2, -7, 0, 0, 0}});
    const T_RESULT r = Solved(frame, load);
    const double length = std::sqrt(1.7 * 1.7 + 0.9 * 0.9 + 1.1 * 1.1);
    const double axial = (3 * 1.7 - 2 * 0.9 - 7 * 1.1) / length;
    const double moment =
        std::sqrt(std::pow(-2 * 1.1 + 7 * 0.9, 2) + std::pow(3 * 1.1 + 7 * 1.7, 2) +
                  std::pow(3 * 0.9 + 2 * 1.7, 2));
    EXPECT_NEAR(axial, r.force[1][2][0], 1e-7 * std::fabs(axial));
    EXPECT_NEAR(moment, std::hypot(r.force[1][0][4], r.force[1][0][5]), 1e-7 * moment);
    EXPECT_NEAR(7.0, r.reaction[0][2], 1e-9);
    EXPECT_GT(r.accuracy.unrefined, 0.0);
    EXPECT_LT(r.accuracy.error, 1e-10);
}

} // namespace
