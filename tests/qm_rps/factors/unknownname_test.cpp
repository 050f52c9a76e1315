// Unknowns by whole name or load case.
#include "qm_rps/factors/tuning/unknownname.h"

#include <gtest/gtest.h>

TEST(UnknownName, TheWholeNameGoesBeforeTheLoadCase)
{
    const std::vector<std::string> names{"stage 1 P2", "P2", "stage 1 P3", "stage 2 P3"};
    using L = std::vector<std::size_t>;
    const std::pair<const char*, L> rows[] = {
        {"P2", {1}}, {"stage 1 P2", {0}}, {"P3", {2, 3}}, {"stage 2 P3", {3}}, {"3", {}}, {"", {}}};
    for (const auto& [name, fits] : rows)
        EXPECT_EQ(fits, UnknownsNamed(names, name)) << name;
}
