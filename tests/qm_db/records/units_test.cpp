#include "qm_db/records/units.h"

#include <cmath>
#include <gtest/gtest.h>

namespace {

using F = FORCE_UNIT;
using L = LENGTH_UNIT;

struct T_CASE {
    const char* label;
    T_UNITS units;
    T_DIM dim;
    double si;  // SI value of one unit
    double tol; // relative: half of the last printed digit
};

// NIST SP 811 (2008) appendix B.8, and exact definitions.
// clang-format off
const T_CASE kFactors[] = {
    { "N",            {F::N,    L::m},  kDimForce,  1.0,            0.0  },
    { "kN",           {F::kN,   L::m},  kDimForce,  1e3,            0.0  },
    { "kgf",          {F::kgf,  L::m},  kDimForce,  9.80665,        0.0  },
    { "tonf metric",  {F::tonf, L::m},  kDimForce,  9806.65,        0.0  },
    { "lbf",          {F::lbf,  L::m},  kDimForce,  4.448222,       2e-7 },
    { "kip",          {F::kips, L::m},  kDimForce,  4448.222,       2e-7 },
    { "mm",           {F::N,    L::mm}, kDimLength, 1e-3,           0.0  },
    { "in",           {F::N,    L::in}, kDimLength, 0.0254,         0.0  },
    { "ft",           {F::N,    L::ft}, kDimLength, 0.3048,         0.0  },
    { "lbf ft",       {F::lbf,  L::ft}, kDimMoment, 1.355818,       4e-7 },
    { "kip in",       {F::kips, L::in}, kDimMoment, 112.9848,       5e-7 },
    { "ksi",          {F::kips, L::in}, kDimStress, 6.894757e6,     1e-7 },
    { "N/mm2",        {F::N,    L::mm}, kDimStress, 1e6,            1e-15 },
    { "slug",         {F::lbf,  L::ft}, kDimMass,   14.59390,       4e-7 },
    { "kip s2/in",    {F::kips, L::in}, kDimMass,   175126.8,       3e-7 },
    { "N s2/mm: t",   {F::N,    L::mm}, kDimMass,   1e3,            1e-15 },
    { "in/s2",        {F::kips, L::in}, kDimAccel,  0.0254,         0.0  },
};
// clang-format on

} // namespace

TEST(Units, FactorsAreThePublishedOnes)
{
    for (const T_CASE& c : kFactors)
        EXPECT_NEAR(c.si, SiFactor(c.units, c.dim), c.tol * c.si) << c.label;
}

// Values that a person enters have few digits: they come back as entered in every pair of units.
TEST(Units, EnteredDigitsComeBack)
{
    for (const double entered : {0.137, 1.2467, 10.0, 1e-7, 123456.789}) {
        for (const LENGTH_UNIT length : {LENGTH_UNIT::mm, LENGTH_UNIT::in, LENGTH_UNIT::ft}) {
            for (const FORCE_UNIT force : {FORCE_UNIT::kips, FORCE_UNIT::kgf, FORCE_UNIT::lbf}) {
                const T_UNITS units{force, length};
                for (const T_DIM dim : {kDimLength, kDimForce, kDimMoment, kDimStress})
                    EXPECT_EQ(entered, ShortFromSi(ToSi(entered, units, dim), units, dim));
            }
        }
    }
}
