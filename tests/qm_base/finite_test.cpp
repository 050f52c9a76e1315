#include "qm_base/finite.h"

#include <array>
#include <gtest/gtest.h>
#include <limits>
#include <optional>
#include <vector>

namespace {

constexpr double kInf = std::numeric_limits<double>::infinity();
constexpr double kNan = std::numeric_limits<double>::quiet_NaN();

struct T_POINT {
    double x = 0.0;
    std::optional<double> y;
    std::vector<std::array<double, 2>> rest;
};
auto Numbers(const T_POINT& p)
{
    return std::tie(p.x, p.y, p.rest);
}

TEST(IsFinite, LooksAtEveryNumberOfARecord)
{
    const T_POINT good{1.0, 2.0, {{3.0, 4.0}, {5.0, 6.0}}};
    EXPECT_TRUE(IsFinite(good));
    EXPECT_TRUE(IsFinite(T_POINT{}));
    for (const double bad : {kInf, -kInf, kNan}) {
        EXPECT_FALSE(IsFinite(bad));
        EXPECT_FALSE(IsFinite(T_POINT{bad, {}, {}}));
        EXPECT_FALSE(IsFinite(T_POINT{1.0, bad, {}}));
        EXPECT_FALSE(IsFinite(T_POINT{1.0, {}, {{1.0, 2.0}, {3.0, bad}}}));
        EXPECT_FALSE(IsFinite(std::vector<T_POINT>{good, T_POINT{bad, {}, {}}}));
    }
}

} // namespace
