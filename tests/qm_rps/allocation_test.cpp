// The trial loops work in the memory of their first trial. A program of its own, since it replaces
// the global operator new.
#include "perfptfixture.h"
#include "qm_rps/pushovercalcperfptfema440proca.h"
#include "qm_rps/pushovercalcperfptfema440procc.h"
#include "qm_rps/pushovercalcperfptproca.h"
#include "qm_rps/pushovercalcperfptprocb.h"

#include <atomic>
#include <cstdlib>
#include <gtest/gtest.h>
#include <new>

namespace {

std::atomic<std::size_t> g_all{0};      // allocations
std::atomic<std::size_t> g_spectrum{0}; // of them, arrays as long as the spectrum
std::atomic<std::size_t> g_bytes{0};    // size of such an array

} // namespace

// Not inlined: the compiler would see free() paired with its own operator new and complain.
[[gnu::noinline]] void* operator new(std::size_t size)
{
    ++g_all;
    if (size == g_bytes) ++g_spectrum;
    if (void* const p = std::malloc(size)) return p;
    throw std::bad_alloc();
}

[[gnu::noinline]] void operator delete(void* p) noexcept
{
    std::free(p);
}

[[gnu::noinline]] void operator delete(void* p, std::size_t) noexcept
{
    std::free(p);
}

namespace {

struct T_COUNT {
    std::size_t all = 0, spectrum = 0, trials = 0;
};

template <class CALC, class... ARGS>
T_COUNT Count(const T_POINTS& capacity, const T_SPFC_ATC40& spectrum, int type, ARGS... args)
{
    CTestRecord record(capacity, spectrum, {type});
    g_bytes = record.DemandPeriods().size() * sizeof(double);
    CALC calc(record, args...);
    double D = 0.0, A = 0.0;
    std::optional<double> beta;
    const std::size_t all = g_all, spectra = g_spectrum;
    EXPECT_NE(0, calc.CalcPerformancePoint(D, A, beta, nullptr));
    return {g_all - all, g_spectrum - spectra, calc.Trace().size()};
}

const T_POINTS kHard5 = Bilinear(10, 0.1, 0.05, 2000), kHard20 = Bilinear(10, 0.1, 0.2, 2000),
               kSoft = Bilinear(10, 0.1, -0.02, 400);

} // namespace

// The trace keeps 16 rows ready, so that up to there every allocation is the procedure's own.
TEST(Allocation, MoreTrialsAllocateNothingMore)
{
    const T_COUNT few = Count<CPushOverCalcPerfPtProcA>(Atc40ExampleCurve(), kExampleSd, 2);
    EXPECT_GT(few.spectrum, 0u) << "the counter sees them";
    const T_COUNT many = Count<CPushOverCalcPerfPtProcA>(Atc40ExampleCurve(), kExampleSd, 0);
    EXPECT_EQ(2u, few.trials);
    EXPECT_EQ(15u, many.trials);
    EXPECT_EQ(few.all, many.all);
    EXPECT_LE(many.spectrum, 5u) << "T, Sa, Sd and the stored pair";
    for (const int variant : {0, 1}) {
        using CALC = CPushOverCalcPerfPtFEMA440ProcA;
        const T_COUNT one = Count<CALC>(Atc40ExampleCurve(), kExampleSd, 1, variant);
        const T_COUNT three = Count<CALC>(kSoft, {0.3, 0.3, {}}, 2, variant);
        EXPECT_EQ(1u, one.trials);
        EXPECT_EQ(3u, three.trials);
        EXPECT_EQ(one.all, three.all) << variant;
    }
}

// These two also lengthen the locus; no trial may allocate a spectrum.
TEST(Allocation, MoreStepsOfALocusAllocateNoSpectrum)
{
    const T_COUNT b11 = Count<CPushOverCalcPerfPtProcB>(Atc40ExampleCurve(), kExampleSd, 1);
    const T_COUNT b45 = Count<CPushOverCalcPerfPtProcB>(kHard5, T_SPFC_ATC40{0.44, 0.44, {}}, 0);
    EXPECT_LT(b11.trials, b45.trials);
    EXPECT_EQ(b11.spectrum, b45.spectrum);
    using CALC = CPushOverCalcPerfPtFEMA440ProcC;
    const T_COUNT c1 = Count<CALC>(Atc40ExampleCurve(), kExampleSd, 1);
    const T_COUNT c10 = Count<CALC>(kHard20, kExampleSd, 1);
    EXPECT_LT(c1.trials, c10.trials);
    EXPECT_EQ(c1.spectrum, c10.spectrum);
}
