#include "qm_base/nearname.h"

#include <array>
#include <gtest/gtest.h>

TEST(NearName, ProposesWhatWasMeantAndNothingFarAway)
{
    constexpr std::array<std::string_view, 6> known{"hinge_types", "hinges",     "My",
                                                    "nodes",       "load_cases", "check"};
    const std::pair<const char*, const char*> rows[] = {
        {"hinge_type", "hinge_types"},
        {"Hinge-Types", "hinge_types"},
        {"hignes", "hinges"},
        {"nods", "nodes"},
        {"nodse", "nodes"},
        {"my", "My"},
        {"load", "load_cases"},
        {"chek", "check"},
        {"sections", ""},
        {"w", ""},
        {"", ""},
        {"loads", ""},
        {"cases", "load_cases"},
    };
    for (const auto& [typed, meant] : rows)
        EXPECT_EQ(meant, NearestName(typed, known)) << typed;
    EXPECT_EQ("", NearestName("nodes", {}));
}
