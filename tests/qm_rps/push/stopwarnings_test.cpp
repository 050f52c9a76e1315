#include "qm_rps/push/stopwarnings.h"

#include <gtest/gtest.h>

TEST(StopWarnings, AreOfStopsThatNothingInTheModelCanReach)
{
    using S = PUSH_STATE_STOP;
    const struct {
        std::optional<double> drift;
        std::optional<S> state;
        bool storeys, criteria, fails; // of one hinge of two
        const char* fields;
    } kRows[] = {{{}, {}, false, false, false, ""},
                 {0.02, {}, true, false, false, ""},
                 {0.02, {}, false, true, true, "stops.drift "},
                 {{}, S::LS, false, true, false, ""},
                 {{}, S::CP, true, false, true, "stops.state "},
                 {{}, S::Failed, false, false, true, ""},
                 {0.02, S::Failed, false, true, false, "stops.drift stops.state "}};
    for (const auto& row : kRows) {
        std::vector<T_PUSH_LAW_PLACE> laws(2);
        laws[1].criteria = row.criteria;
        laws[1].fails = row.fails;
        std::string fields;
        for (const T_FINDING& f : StopWarnings({row.drift, row.state, {}}, row.storeys, laws))
            fields += f.field + " ";
        EXPECT_EQ(row.fields, fields) << &row - kRows;
    }
}
