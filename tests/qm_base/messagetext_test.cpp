#include "qm_base/messagetext.h"

#include <array>
#include <gtest/gtest.h>

using namespace zql::lib;

TEST(MessageText, FillsPlacesInTheOrderOfTheText)
{
    const std::array<std::string_view, 2> args{"A", "{1}"};
    const std::pair<const char*, const char*> kCases[] = {
        {"", ""},         {"plain", "plain"}, {"{2} then {1}", "{1} then A"},
        {"{1}{1}", "AA"}, {"{3}", "{3}"},     {"{{1}", "{1}"},
        {"{{{1}", "{A"},  {"{{", "{"},        {"{", "{"},
        {"{1", "{1"},     {"{}", "{}"},       {"{0}", "{0}"},
        {"{-1}", "{-1}"}, {"{1 }", "{1 }"},   {"{x}{1}", "{x}A"},
        {"a}b", "a}b"},   {"{01}", "A"},      {"{99999999999999999999}", "{99999999999999999999}"},
    };
    for (const auto& [text, filled] : kCases)
        EXPECT_EQ(filled, FillPlaces(text, args)) << text;
}
