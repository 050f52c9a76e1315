#include "qm_solver/checks/mechanism.h"

#include "frames.h"

#include <gtest/gtest.h>

#include <cmath>
#include <map>
#include <numeric>

namespace {

using namespace sample;

/// Springs in a row from the ground to node 1, 2, ...; a stiffness of 0 leaves the rest loose.
T_SYMMETRIC_MATRIX Chain(const std::vector<double>& spring)
{
    T_SYMMETRIC_MATRIX k;
    k.rowStart.push_back(0);
    for (std::size_t i = 0; i < spring.size(); ++i) {
        const bool last = i + 1 == spring.size();
        k.column.push_back(static_cast<int>(i));
        k.value.push_back(spring[i] + (last ? 0.0 : spring[i + 1]));
        if (!last) {
            k.column.push_back(static_cast<int>(i) + 1);
            k.value.push_back(-spring[i + 1]);
        }
        k.rowStart.push_back(static_cast<int>(k.column.size()));
    }
    return k;
}

/// The mechanism that a chain shows, if any.
std::optional<std::vector<double>> MechanismOf(const std::vector<double>& spring,
                                               std::size_t& alarms, PIVOTS pivots = PIVOTS::Watch)
{
    const T_SYMMETRIC_MATRIX k = Chain(spring);
    CSparseFactor factor;
    T_SOLVER_REASON reason;
    std::vector<int> block(k.Size());
    std::iota(block.begin(), block.end(), 0);
    EXPECT_EQ(1, factor.Analyse(k, block, reason)) << reason.Text();
    EXPECT_EQ(1, factor.Factor(k, reason, pivots)) << reason.Text();
    alarms = factor.Info().nullPivots.size();
    const auto strainless = [&](std::span<const double> v) {
        double energy = 0.0, apart = 0.0;
        for (std::size_t i = 0; i < v.size(); ++i) {
            const double before = i == 0 ? 0.0 : v[i - 1];
            energy += spring[i] * (v[i] - before) * (v[i] - before);
            apart += spring[i] * (v[i] * v[i] + before * before);
        }
        return energy <= 1e-20 * apart;
    };
    std::optional<std::vector<double>> shape;
    EXPECT_EQ(1, FindMechanism(k, factor, strainless, shape, reason)) << reason.Text();
    return shape;
}

TEST(Mechanism, HasNothingToSayOfStiffnessContrasts)
{
    for (double contrast : {1.0, 1e4, 1e8, 1e10, 1e12, 1e14, 1e15})
        for (std::size_t soft : {0u, 20u, 58u}) {
            SCOPED_TRACE(testing::Message() << contrast << " over spring " << soft);
            std::vector<double> spring(60, contrast);
            spring[soft] = 1.0;
            std::size_t alarms = 0;
            EXPECT_FALSE(MechanismOf(spring, alarms));
            if (contrast <= 1e10) {
                EXPECT_EQ(0u, alarms);
            }
        }
}

TEST(Mechanism, IsNoPivotThatVanishesForContrastAlone)
{
    std::vector<double> spring(5);
    for (std::size_t i = 0; i < spring.size(); ++i)
        spring[i] = 3.0e14 * (1.0 + 0.37 * static_cast<double>(i * 7 % 5));
    spring[1] = 1.0;
    std::size_t alarms = 0;
    EXPECT_FALSE(MechanismOf(spring, alarms));
    EXPECT_EQ(1u, alarms) << "no false alarm any more: this test needs another example";
}

TEST(Mechanism, IsTheLooseEndOfAChainWhetherAPivotShowsItOrNot)
{
    struct T_CASE {
        std::size_t gap;
        PIVOTS pivots;
    };
    // The gap of 0 leaves a pivot of rounding size; 59 a node without any stiffness.
    const T_CASE cases[] = {
        {0, PIVOTS::Watch}, {20, PIVOTS::Watch}, {59, PIVOTS::Watch}, {0, PIVOTS::AsTheyAre}};
    for (const T_CASE& c : cases) {
        SCOPED_TRACE(c.gap);
        std::vector<double> spring(60);
        for (std::size_t i = 0; i < spring.size(); ++i)
            spring[i] = i == c.gap ? 0.0 : 1.0e7 / 3.0 * (1.1 + std::sin(double(i)));
        std::size_t alarms = 0;
        const auto shape = MechanismOf(spring, alarms, c.pivots);
        ASSERT_TRUE(shape);
        ASSERT_NE(0.0, (*shape)[59]);
        for (std::size_t i = 0; i < spring.size(); ++i)
            EXPECT_NEAR(i < c.gap ? 0.0 : (*shape)[59], (*shape)[i], 1e-6);
    }
}

} // namespace
