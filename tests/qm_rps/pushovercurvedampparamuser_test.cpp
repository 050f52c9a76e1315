#include "qm_rps/pushovercurvedampparamuser.h"

#include "numbers.h"

#include <gtest/gtest.h>

TEST(CurveDampParamUser, AcceptsAscendingPositiveDampingAndRefusesTheRest)
{
    const struct {
        std::array<double, 4> in; // beta1, kappa1, beta2, kappa2
        bool accepted;
    } cases[] = {
        {{10, 0.9, 30, 0.5}, true},    {{20, 0.9, 20, 0.5}, true},    {{10, -1.0, 30, 0.0}, true},
        {{30, 0.9, 10, 0.5}, false},   {{0, 0.9, 30, 0.5}, false},    {{-2, 0.9, -1, 0.5}, false},
        {{kNan, 0.9, 30, 0.5}, false}, {{10, 0.9, kNan, 0.5}, false}, {{10, 1, kInf, 1}, false},
        {{10, kNan, 30, 0.5}, false},  {{10, 0.9, 30, kNan}, false},
    };
    for (const auto& c : cases) {
        const std::string label = testing::PrintToString(c.in);
        CPushOverCurveDampParamUser dlg;
        dlg.Data2Dlg(c.in);
        EXPECT_EQ(c.accepted, dlg.OnOK() == 1) << label;
        std::array<double, 4> out{};
        dlg.Dlg2Data(out);
        EXPECT_TRUE(!c.accepted || c.in == out) << label;
        ASSERT_EQ(c.accepted ? 0u : 1u, dlg.Messages().size()) << label;
        EXPECT_TRUE(c.accepted || dlg.Messages()[0].key == "IDS_PUSHOVER_Wrong_Input_") << label;
    }
}

TEST(CurveDampParamUser, TheCurveOfItsPictureIsLevelOutsideThePoints)
{
    CPushOverCurveDampParamUser points;
    points.Data2Dlg({10, 0.9, 30, 0.5});
    const auto curve = points.Curve();
    ASSERT_EQ(4U, curve.size());
    EXPECT_EQ((std::pair{0.0, 0.9}), (std::pair{curve[0].x, curve[0].y}));
    EXPECT_EQ((std::pair{63.7, 0.5}), (std::pair{curve[3].x, curve[3].y})); // a rectangular loop
}
