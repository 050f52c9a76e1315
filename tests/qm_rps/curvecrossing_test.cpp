#include "qm_rps/curvecrossing.h"

#include <algorithm>
#include <cmath>
#include <gtest/gtest.h>
#include <numbers>
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

TEST(CurveCrossing, HalfLineIsFreeOfScale)
{
    for (const double scale : {1e-15, 1.0, 25.4, 1e12}) {
        const T_CURVE c{{0.0, 2.0 * scale, 2.0 * scale}, {4.0, 4.0, 1.0}};
        const auto p = CCurveCrossing::HalfLine({scale, 1.0}, c.View());
        ASSERT_TRUE(p) << scale;
        EXPECT_NEAR(2.0 * scale, p->x, 1e-12 * scale);
        EXPECT_NEAR(2.0, p->y, 1e-12);
    }
}

TEST(CurveCrossing, HalfLineTakesTheFirstSegmentInWalkOrderPastTheOrigin)
{
    const T_CURVE fromOrigin{{0.0, 1.0, 2.0, 0.0}, {0.0, 2.0, 1.0, 4.0}};
    ExpectPoint(1.5, 1.5, CCurveCrossing::HalfLine({1.0, 1.0}, fromOrigin.View()));
    const T_CURVE along{{0.0, 1.0, 2.0, 3.0}, {0.0, 1.0, 2.0, 2.5}};
    // The segments along the line don't cross it; the one that leaves it touches it.
    ExpectPoint(2.0, 2.0, CCurveCrossing::HalfLine({1.0, 1.0}, along.View()));
    const T_CURVE onlyAlong{{0.0, 1.0, 2.0}, {0.0, 1.0, 2.0}};
    EXPECT_FALSE(CCurveCrossing::HalfLine({1.0, 1.0}, onlyAlong.View()));
    const T_CURVE beside{{1.0, 2.0}, {0.1, 0.2}};
    EXPECT_FALSE(CCurveCrossing::HalfLine({1.0, 1.0}, beside.View()));
}

TEST(CurveCrossing, PeriodLineHasTheSlopeOfItsPeriod)
{
    const double g = 4.0 * std::numbers::pi * std::numbers::pi; // slope 1 / T2
    const T_CURVE level{{0.0, 10.0}, {2.0, 2.0}};
    ExpectPoint(0.5, 2.0, CCurveCrossing::PeriodLine(0.5, g, level.View()));
    ExpectPoint(8.0, 2.0, CCurveCrossing::PeriodLine(2.0, g, level.View()));
    const T_CURVE constantSd{{4.0, 4.0}, {2.0, 0.5}}; // beyond TD
    ExpectPoint(4.0, 1.0, CCurveCrossing::PeriodLine(2.0, g, constantSd.View()));
    EXPECT_FALSE(CCurveCrossing::PeriodLine(0.0, g, level.View()));
    EXPECT_FALSE(CCurveCrossing::PeriodLine(std::nan(""), g, level.View()));
}

TEST(CurveCrossing, TouchesWithinABillionthOfTheSegmentCount)
{
    struct T_CASE {
        const char* label;
        double d;
        bool found;
    };
    const T_CASE cases[] = {{"inside", 1.5, true},
                            {"at the end", 2.0, true},
                            {"just beyond", 2.0 + 0.9e-9, true},
                            {"beyond", 2.0 + 1.2e-9, false},
                            {"just before", 1.0 - 0.9e-9, true},
                            {"before", 1.0 - 1.2e-9, false}};
    const T_CURVE c{{1.0, 2.0}, {1.0, 3.0}};
    for (const T_CASE& k : cases) {
        const auto p = CCurveCrossing::Vertical(k.d, c.View());
        ASSERT_EQ(k.found, p.has_value()) << k.label;
        if (!p) continue;
        EXPECT_EQ(std::clamp(k.d, 1.0, 2.0), p->x) << k.label << ": clamped to the segment";
        EXPECT_NEAR(1.0 + 2.0 * (p->x - 1.0), p->y, 1e-12) << k.label;
    }
}

TEST(CurveCrossing, ParallelAndOverlappingSegmentsDoNotCross)
{
    const T_CURVE c{{0.0, 2.0, 4.0}, {0.0, 2.0, 2.0}};
    EXPECT_FALSE(CCurveCrossing::Segment({0.5, 0.5}, {1.5, 1.5}, c.View())) << "overlapping";
    EXPECT_FALSE(CCurveCrossing::Segment({0.0, 0.5}, {1.0, 1.5}, c.View())) << "parallel";
    EXPECT_FALSE(CCurveCrossing::Segment({0.5, 0.5}, {1.5, 1.5 + 1e-10}, c.View())) << "nearly";
    EXPECT_FALSE(CCurveCrossing::Segment({2.5, 2.0}, {3.0, 2.0}, c.View())) << "along the plateau";
    EXPECT_FALSE(CCurveCrossing::Segment({1.0, 1.0}, {1.0, 1.0}, c.View())) << "a point";
    ExpectPoint(1.0, 1.0, CCurveCrossing::Segment({0.0, 2.0}, {2.0, 0.0}, c.View()));
    ExpectPoint(3.0, 2.0, CCurveCrossing::Segment({3.0, 1.0}, {3.0, 2.0}, c.View()), "a touch");
    EXPECT_FALSE(CCurveCrossing::Segment({3.0, 1.0}, {3.0, 1.9}, c.View())) << "too short";
}

TEST(CurveCrossing, CapacityOrderDecidesNotDemandOrder)
{
    const T_CURVE capacity{{0.0, 2.0, 4.0}, {0.0, 2.0, 2.0}};
    // The demand meets the plateau first, in its own order, and the rising branch later.
    const T_CURVE demand{{0.0, 3.0, 3.0, 0.2}, {3.0, 3.0, 1.5, 0.6}};
    ASSERT_EQ(1, demand.View().At(1).x > 2.0);
    const auto p = CCurveCrossing::CapacityWithDemand(capacity.View(), demand.View());
    ASSERT_TRUE(p);
    EXPECT_LT(p->x, 2.0) << "the first capacity segment";
    EXPECT_NEAR(p->x, p->y, 1e-12);
    EXPECT_NEAR(15.0 / 19.0, p->x, 1e-12); // x = 0.6 + (x - 0.2) 0.9 / 2.8
}

TEST(CurveCrossing, OnOneCapacitySegmentTheCrossingNearestItsStartWins)
{
    const T_CURVE rising{{0.0, 4.0}, {1.0, 1.0}};
    // A saw over ascending periods: crosses the level Sa = 1 three times.
    const T_CURVE saw{{0.5, 1.0, 2.0, 3.0}, {2.0, 0.5, 1.5, 0.2}};
    ExpectPoint(5.0 / 6.0, 1.0, CCurveCrossing::CapacityWithDemand(rising.View(), saw.View()));
    const T_CURVE falling{{4.0, 0.0}, {1.0, 1.0}}; // the same segment from its other end
    ExpectPoint(2.0 + 0.5 / 1.3, 1.0,
                CCurveCrossing::CapacityWithDemand(falling.View(), saw.View()));
}

TEST(CurveCrossing, CapacityAndDemandThatDoNotMeetGiveNothing)
{
    const T_CURVE demand{{0.0, 1.0, 2.0}, {1.0, 1.0, 0.5}};
    const T_CURVE low{{0.0, 0.5, 1.0}, {0.0, 0.1, 0.2}}, point{{0.0}, {0.0}}, none{};
    EXPECT_FALSE(CCurveCrossing::CapacityWithDemand(low.View(), demand.View()));
    EXPECT_FALSE(CCurveCrossing::CapacityWithDemand(point.View(), demand.View()));
    EXPECT_FALSE(CCurveCrossing::CapacityWithDemand(low.View(), none.View()));
    const T_CURVE along{{0.2, 0.8}, {1.0, 1.0}}; // on the demand's own level line
    EXPECT_FALSE(CCurveCrossing::CapacityWithDemand(along.View(), demand.View()));
    const T_CURVE touching{{0.0, 0.5}, {0.0, 1.0}}; // its last point on that line
    ExpectPoint(0.5, 1.0, CCurveCrossing::CapacityWithDemand(touching.View(), demand.View()));
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
