#include "qm_rps/pushovercurvedampparamuser.h"

#include <gtest/gtest.h>
#include <limits>
#include <vector>

TEST(CurveDampParamUser, AcceptsAscendingPositiveDampingAndRefusesTheRest)
{
    constexpr double kNan = std::numeric_limits<double>::quiet_NaN();
    constexpr double kInf = std::numeric_limits<double>::infinity();
    struct T_CASE {
        const char* label;
        double beta1, kappa1, beta2, kappa2;
        int accepted;
    };
    const T_CASE cases[] = {
        {"ascending", 10, 0.9, 30, 0.5, 1},     {"equal", 20, 0.9, 20, 0.5, 1},
        {"any kappa", 10, -1.0, 30, 0.0, 1},    {"falling", 30, 0.9, 10, 0.5, 0},
        {"beta1 zero", 0, 0.9, 30, 0.5, 0},     {"beta1 negative", -1, 0.9, 30, 0.5, 0},
        {"both negative", -2, 0.9, -1, 0.5, 0}, {"as created", 0, 0, 0, 0, 0},
        {"beta1 NaN", kNan, 0.9, 30, 0.5, 0},   {"beta2 NaN", 10, 0.9, kNan, 0.5, 0},
        {"beta2 infinite", 10, 1, kInf, 1, 0},  {"kappa1 NaN", 10, kNan, 30, 0.5, 0},
        {"kappa2 NaN", 10, 0.9, 30, kNan, 0},
    };
    for (const T_CASE& c : cases) {
        CPushOverCurveDampParamUser dlg;
        const std::array<double, 4> in{c.beta1, c.kappa1, c.beta2, c.kappa2};
        dlg.Data2Dlg(in);
        if (c.accepted) {
            std::array<double, 4> out{};
            dlg.Dlg2Data(out);
            EXPECT_EQ(in, out) << c.label;
        }
        EXPECT_EQ(c.accepted, dlg.OnOK()) << c.label;
        ASSERT_EQ(c.accepted ? 0u : 1u, dlg.Messages().size()) << c.label;
        for (const zql::frx::T_MESSAGE& m : dlg.Messages())
            EXPECT_EQ("IDS_PUSHOVER_Wrong_Input_", m.key) << c.label;
    }
}
