// Helpers of the tests of what codes give.
#pragma once

#include "qm_rps/codes/codetable.h"

#include <gtest/gtest.h>

#include <array>
#include <cmath>
#include <string>
#include <type_traits>

constexpr double kMpa = kPascalsPerMpa;

/// Why a sheet has no answer, for messages of tests.
inline std::string Why(const CCodeSheet& sheet)
{
    return sheet.Fault() ? sheet.Fault()->member + " " + sheet.Fault()->detail : "sound";
}

inline void ExpectRel(double expected, double actual, double tol, const std::string& label)
{
    EXPECT_NEAR(expected, actual, tol * std::fabs(expected) + 1e-12) << label;
}

/// A sound record with one member as given.
template <class RECORD, class MEMBER>
RECORD With(RECORD record, MEMBER RECORD::*member, std::type_identity_t<MEMBER> value)
{
    record.*member = value;
    return record;
}

/// a, b, c, IO, LS, CP.
inline void ExpectPlastic(const std::array<double, 6>& expected,
                          const std::optional<T_CODE_PLASTIC>& p, double tol,
                          const std::string& label)
{
    ASSERT_TRUE(p) << label;
    const std::array<double, 6> actual{p->a, p->b, p->c, p->IO, p->LS, p->CP};
    for (std::size_t i = 0; i < actual.size(); ++i)
        ExpectRel(expected[i], actual[i], tol, label + " value " + std::to_string(i));
}

/// The line of a symbol; null: none.
inline const T_CODE_TRACE* LineOf(const CCodeSheet& sheet, std::string_view symbol)
{
    for (const T_CODE_TRACE& line : sheet.Trace())
        if (line.symbol == symbol) return &line;
    return nullptr;
}

inline bool Warns(const CCodeSheet& sheet, std::string_view key)
{
    for (const T_CODE_WARNING& w : sheet.Warnings())
        if (w.key == key) return true;
    return false;
}
