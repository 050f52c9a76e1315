#include "qm_rps/pushover/curvecrossing.h"

#include <algorithm>
#include <cmath>
#include <gtest/gtest.h>
#include <random>
#include <vector>

namespace {

struct T_CURVE {
    std::vector<double> Sd, Sa;
    T_ADRS_VIEW View() const { return {Sd, Sa}; }
};

void ExpectPoint(double Sd, double Sa, const std::optional<T_POINT2>& p, const char* label = "")
{
    ASSERT_TRUE(p) << label;
    EXPECT_NEAR(Sd, p->x, 1e-12 * (1.0 + std::fabs(Sd))) << label;
    EXPECT_NEAR(Sa, p->y, 1e-12 * (1.0 + std::fabs(Sa))) << label;
}

/// Crossing of two segments by Cramer's rule in long double: the parameter on a-b, or none.
std::optional<long double> Cross(T_POINT2 a, T_POINT2 b, T_POINT2 c, T_POINT2 d)
{
    const long double ux = b.x - a.x, uy = b.y - a.y, vx = c.x - d.x, vy = c.y - d.y;
    const long double wx = c.x - a.x, wy = c.y - a.y, det = ux * vy - vx * uy;
    if (std::fabs(det) <= 1e-9L * (std::fabs(ux * vy) + std::fabs(vx * uy))) return std::nullopt;
    const long double s = (wx * vy - vx * wy) / det, t = (ux * wy - wx * uy) / det;
    const long double lo = -1e-9L, hi = 1.0L + 1e-9L;
    if (s < lo || s > hi || t < lo || t > hi) return std::nullopt;
    return std::clamp(s, 0.0L, 1.0L);
}

/// The rule as it reads: first capacity segment with any crossing, on it the one nearest its start.
std::optional<T_POINT2> BruteForce(const T_ADRS_VIEW& capacity, const T_ADRS_VIEW& demand)
{
    for (std::size_t i = 0; i + 1 < capacity.Size(); ++i) {
        const T_POINT2 a = capacity.At(i), b = capacity.At(i + 1);
        std::optional<long double> best;
        for (std::size_t k = 0; k + 1 < demand.Size(); ++k) {
            const auto s = Cross(a, b, demand.At(k), demand.At(k + 1));
            if (s && (!best || *s < *best)) best = s;
        }
        if (best)
            return T_POINT2{static_cast<double>(a.x + *best * (b.x - a.x)),
                            static_cast<double>(a.y + *best * (b.y - a.y))};
    }
    return std::nullopt;
}

class CRandom {
public:
    explicit CRandom(unsigned seed) : m_engine(seed) {}
    double Between(double a, double b)
    {
        return a + (b - a) * static_cast<double>(m_engine()) / 4294967295.0;
    }
    bool Chance(double p) { return Between(0.0, 1.0) < p; }

private:
    std::mt19937 m_engine;
};

/// Rough ordinates over ascending periods, with repeated values and, at times, zeros.
T_CURVE RandomDemand(CRandom& random, bool withZeros)
{
    T_CURVE c;
    double T = random.Chance(0.5) ? 0.0 : 0.05, a = random.Between(0.3, 1.0);
    const int n = static_cast<int>(random.Between(2, 60));
    for (int i = 0; i < n; ++i, T += random.Between(0.01, 0.3)) {
        if (random.Chance(0.7)) a = random.Between(0.2, 1.2) / (1.0 + T);
        if (withZeros && random.Chance(0.1)) a = 0.0;
        c.Sa.push_back(a);
        c.Sd.push_back(T * T * a);
    }
    return c;
}

/// A capacity that may wiggle, stand still, drop, turn back and leave the quadrant.
T_CURVE RandomCapacity(CRandom& random, double first)
{
    T_CURVE c;
    double d = first, a = first;
    const int n = static_cast<int>(random.Between(2, 40));
    for (int i = 0; i < n; ++i) {
        c.Sd.push_back(d);
        c.Sa.push_back(a);
        d += random.Chance(0.15) ? random.Between(-0.2, 0.0) : random.Between(0.0, 0.3);
        a += random.Chance(0.2) ? 0.0 : random.Between(-0.12, 0.2);
        if (random.Chance(0.1)) d = c.Sd.back();
    }
    return c;
}

} // namespace

TEST(CurveCrossing, HalfLineTakesTheFirstSegmentInWalkOrderPastTheOrigin)
{
    const T_CURVE fromOrigin{{0.0, 1.0, 2.0, 0.0}, {0.0, 2.0, 1.0, 4.0}};
    ExpectPoint(1.5, 1.5, CCurveCrossing::HalfLine({1.0, 1.0}, fromOrigin.View()));
    const T_CURVE along{{0.0, 1.0, 2.0, 3.0}, {0.0, 1.0, 2.0, 2.5}};
    // The segments along the line don't cross it; the one that leaves it touches it.
    ExpectPoint(2.0, 2.0, CCurveCrossing::HalfLine({1.0, 1.0}, along.View()));
}

TEST(CurveCrossing, TouchesWithinABillionthOfTheSegmentCount)
{
    const T_CURVE c{{1.0, 2.0}, {1.0, 3.0}};
    for (const double d : {1.5, 2.0, 2.0 + 0.9e-9, 1.0 - 0.9e-9}) {
        const double x = std::clamp(d, 1.0, 2.0);
        ExpectPoint(x, 2.0 * x - 1.0, CCurveCrossing::Vertical(d, c.View()));
    }
    for (const double d : {2.0 + 1.2e-9, 1.0 - 1.2e-9})
        EXPECT_FALSE(CCurveCrossing::Vertical(d, c.View())) << d;
}

TEST(CurveCrossing, ParallelAndOverlappingSegmentsDoNotCross)
{
    const T_CURVE c{{0.0, 2.0, 4.0}, {0.0, 2.0, 2.0}};
    EXPECT_FALSE(CCurveCrossing::Segment({0.5, 0.5}, {1.5, 1.5}, c.View())) << "overlapping";
    EXPECT_FALSE(CCurveCrossing::Segment({0.5, 0.5}, {1.5, 1.5 + 1e-10}, c.View())) << "nearly";
    EXPECT_FALSE(CCurveCrossing::Segment({1.0, 1.0}, {1.0, 1.0}, c.View())) << "a point";
    ExpectPoint(3.0, 2.0, CCurveCrossing::Segment({3.0, 1.0}, {3.0, 2.0}, c.View()), "a touch");
    EXPECT_FALSE(CCurveCrossing::Segment({3.0, 1.0}, {3.0, 1.9}, c.View())) << "too short";
}

TEST(CurveCrossing, CapacityWithDemandCountsATouchLikeAnyOtherCrossing)
{
    // The demand ends within a billionth of its last segment, 0.5 long, or not.
    for (const double gap : {0.0, 4e-10, 6e-10}) {
        const T_CURVE upright{{0.0, 1.0, 1.0}, {0.2, 0.2, 2.0}};
        const T_CURVE level{{0.0, 0.5, 1.0 - gap}, {1.0, 1.0, 1.0}};
        const auto p = CCurveCrossing::CapacityWithDemand(upright.View(), level.View());
        EXPECT_EQ(gap < 5e-10, p.has_value()) << "upright capacity " << gap;
        const T_CURVE flat{{0.0, 0.5, 3.0}, {0.0, 1.0, 1.0}};
        const T_CURVE drop{{1.0, 2.0, 2.0}, {2.0, 1.5, 1.0 + gap}};
        const auto q = CCurveCrossing::CapacityWithDemand(flat.View(), drop.View());
        EXPECT_EQ(gap < 5e-10, q.has_value()) << "level capacity " << gap;
    }
}

TEST(CurveCrossing, WalkByAngleFindsWhatTheDoubleLoopFinds)
{
    int crossings = 0;
    for (unsigned seed = 1; seed <= 500; ++seed) {
        SCOPED_TRACE("seed " + std::to_string(seed));
        CRandom random(seed);
        const bool withZeros = seed % 5 == 0; // a zero ordinate lies at the origin
        const T_CURVE demand = RandomDemand(random, withZeros);
        T_CURVE capacity = RandomCapacity(random, !withZeros && seed % 2 == 0 ? 0.0 : 0.01);
        if (seed % 7 == 0 && capacity.Sd.size() > 2) { // a vertex of one curve on the other
            capacity.Sd[2] = demand.Sd.back();
            capacity.Sa[2] = demand.Sa.back();
        }
        const auto expected = BruteForce(capacity.View(), demand.View());
        const auto found = CCurveCrossing::CapacityWithDemand(capacity.View(), demand.View());
        ASSERT_EQ(expected.has_value(), found.has_value());
        if (!expected) continue;
        ++crossings;
        EXPECT_NEAR(expected->x, found->x, 1e-9);
        EXPECT_NEAR(expected->y, found->y, 1e-9);
    }
    EXPECT_GT(crossings, 250) << "the cases are not worth much";
    EXPECT_LT(crossings, 500);
}
