#include "qm_base/textformat.h"

#include <clocale>
#include <cstdio>
#include <cstdlib>
#include <gtest/gtest.h>
#include <limits>

namespace {

/// Sets a process locale with a decimal comma, where the machine has one, and restores it.
class CCommaLocale {
public:
    CCommaLocale()
    {
        setenv("LOCPATH", QM_LOCALE_DIR, 1);
        for (const char* name : {"it_IT.UTF-8", "it_IT.utf8", "de_DE.UTF-8", "fr_FR.UTF-8"})
            m_active = m_active || std::setlocale(LC_ALL, name);
        unsetenv("LOCPATH");
    }
    ~CCommaLocale() { std::setlocale(LC_ALL, "C"); }

    bool IsActive() const { return m_active; }

private:
    bool m_active = false;
};

std::string ProcessText(double value)
{
    char buffer[32];
    std::snprintf(buffer, sizeof buffer, "%.1f", value);
    return buffer;
}

} // namespace

TEST(TextFormat, WritesAPointWhateverTheLocale)
{
    const CCommaLocale comma;
    RecordProperty("comma_locale", comma.IsActive() ? "yes" : "not on this machine");
    const std::string before = ProcessText(1.5);
    EXPECT_EQ(comma.IsActive() ? "1,5" : "1.5", before);

    EXPECT_EQ("1.5 -2.500e-03 7 ab", FormatText("%g %.3e %d %s", 1.5, -0.0025, 7, "ab"));
    EXPECT_EQ("0.1", ShortestText(0.1));
    EXPECT_EQ(1.5, ParseFinite("1.5"));
    EXPECT_EQ(std::nullopt, ParseFinite("1,5"));

    EXPECT_EQ(before, ProcessText(1.5)) << "the caller's locale must be left as it was";
}

TEST(TextFormat, ShortestTextReadsBackAsTheSameDouble)
{
    const std::pair<double, const char*> kCases[] = {
        {0.1, "0.1"},  {1e48, "1e+48"}, {-0.0, "-0"},
        {100., "100"}, {-2.5, "-2.5"},  {1.0 / 3.0, "0.3333333333333333"}};
    for (const auto& [value, text] : kCases) {
        EXPECT_EQ(text, ShortestText(value));
        EXPECT_EQ(value, ParseFinite(text));
    }
    using limits = std::numeric_limits<double>;
    for (const double v : {limits::max(), -limits::max(), limits::min(), limits::denorm_min()})
        EXPECT_EQ(v, ParseFinite(ShortestText(v)));
}

TEST(TextFormat, ParsesWholeFiniteNumbersOnly)
{
    // clang-format off
    const struct { const char* text; double value; } kNumbers[] = {
        {"12", 12.0}, {"+12", 12.0}, {"-1.25e2", -125.0}, {"1E+2", 100.0},
        {".5", 0.5}, {"5.", 5.0}, {"007", 7.0}, {"-0", 0.0},
    };
    const char* const kRefused[] = {
        "", "+", "-", ".", "+-1", "++1", "- 1", " 1", "1 ", "1\n", "1,5", "1e", "1.2.3", "12 kN",
        "0x10", "1d3", "nan", "-NaN", "nan(1)", "inf", "+Infinity", "1e999", "-1e999", "1e-999",
    };
    // clang-format on
    for (const auto& c : kNumbers)
        EXPECT_EQ(c.value, ParseFinite(c.text)) << c.text;
    for (const char* text : kRefused)
        EXPECT_EQ(std::nullopt, ParseFinite(text)) << '"' << text << '"';
    EXPECT_EQ(std::nullopt, ParseFinite(std::string_view("1\0", 2)));
    EXPECT_EQ(1.0, ParseFinite(std::string_view("12", 1))) << "reads past the end of the view";
}
