#include "qm_rps/push/pushatpoint.h"

#include <gtest/gtest.h>

namespace {

/// A component with CP at 0.02, or without criteria and C at 0.05, in one step.
T_PUSH_HINGE_SERIES Hinge(int element, double deformation, PUSH_STATE state, bool criteria = true)
{
    T_PUSH_HINGE_SERIES hinge;
    hinge.place.element = element;
    hinge.place.criteria = criteria;
    hinge.place.letters = {"BC", "BC"};
    hinge.law.positive.points = {{0.0, 1.0}, {0.05, 1.0}};
    hinge.law.positive.marks = {0.005, 0.01, 0.02};
    hinge.law.negative = hinge.law.positive;
    hinge.law.negative.marks = {0.005, 0.01, 0.04};
    hinge.deformation = {deformation};
    hinge.force = {1.0};
    hinge.state = {state};
    return hinge;
}

} // namespace

// Ratios 0.5 but for the last digits: element and component order them, not the units of the file.
TEST(PushAtPoints, EqualRatiosStandByPlace)
{
    T_PUSH_RUN run;
    run.loadFactor = run.displacement = {0.1};
    run.hinges = {Hinge(3, 0.01 * (1 + 1e-14), PUSH_STATE::IOtoLS),
                  Hinge(2, 0.01, PUSH_STATE::IOtoLS), Hinge(1, 0.0099, PUSH_STATE::IOtoLS),
                  Hinge(2, 0.01 * (1 + 2e-14), PUSH_STATE::IOtoLS)};
    run.hinges[3].place.component = HINGE_COMPONENT::Fx;
    const auto points = PushAtPoints(run, {{PUSH_POINT::Performance, "", 0.1}});
    std::string order;
    for (const T_HINGE_AT_POINT& h : points.at(0).worst)
        order += std::to_string(h.place.element) +
                 (h.place.component == HINGE_COMPONENT::Fx ? "x " : "y ");
    EXPECT_EQ("2x 2y 3y 1y ", order);
}

TEST(PushAtPoints, ListsLostStrengthBeforeRatiosAndThoseBeforeUnknownOnes)
{
    T_PUSH_RUN run;
    run.loadFactor = run.displacement = {0.1};
    T_PUSH_HINGE_SERIES endless = Hinge(5, 0.09, PUSH_STATE::BtoC, false);
    endless.place.letters = {"B", "B"}; // its force stays for ever
    run.hinges = {Hinge(1, 0.0, PUSH_STATE::Elastic), endless, Hinge(2, -0.03, PUSH_STATE::LStoCP),
                  Hinge(3, 0.01, PUSH_STATE::DtoE), Hinge(4, 0.04, PUSH_STATE::BtoC, false)};
    const auto points =
        PushAtPoints(run, {{PUSH_POINT::Performance, "", 0.1}, {PUSH_POINT::Demand, "SD", 0.2}});
    ASSERT_EQ(2U, points.size());
    ASSERT_EQ(AT_POINT::Reached, points[0].found);
    EXPECT_EQ(AT_POINT::Beyond, points[1].found);
    const struct {
        int element;
        std::optional<double> ratio;
    } expected[] = {{3, 0.5}, {4, 0.8}, {2, 0.75}, {5, {}}}; // 0.01/0.02, 0.04/0.05, 0.03/0.04
    ASSERT_EQ(std::size(expected), points[0].worst.size());
    for (std::size_t i = 0; i < std::size(expected); ++i) {
        EXPECT_EQ(expected[i].element, points[0].worst[i].place.element);
        ASSERT_EQ(expected[i].ratio.has_value(), points[0].worst[i].ratio.has_value());
        if (expected[i].ratio) {
            EXPECT_DOUBLE_EQ(*expected[i].ratio, *points[0].worst[i].ratio);
        }
    }
}
