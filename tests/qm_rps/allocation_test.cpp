// The trial loops work in the memory of their first trial. A program of its own, since it replaces
// the global operator new.
#include "perfptfixture.h"

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

struct T_JOB {
    T_POINTS capacity;
    T_SPFC_ATC40 spectrum;
    int type;
};

struct T_COUNT {
    std::size_t trials = 0, all = 0, spectrum = 0;
};

T_COUNT Count(char procedure, const T_JOB& job)
{
    CTestRecord record(job.capacity, job.spectrum, {job.type});
    g_bytes = record.DemandPeriods().size() * sizeof(double);
    const std::size_t all = g_all, spectra = g_spectrum;
    const T_RUN run = RunProcedure(record, procedure);
    EXPECT_NE(0, run.result) << procedure;
    return {run.trace.size(), g_all - all, g_spectrum - spectra};
}

} // namespace

// The trace keeps 16 rows ready, so that up to there every allocation is the procedure's own. Those
// that lengthen a locus or a trace beyond may do so, but allocate no spectrum.
TEST(Allocation, MoreTrialsAllocateNothingMore)
{
    const T_POINTS example = Atc40ExampleCurve();
    const T_JOB soft{Bilinear(10, 0.1, -0.02, 400), Atc40(0.3), 2};
    const auto expect = [](char procedure, const T_JOB& fewer, const T_JOB& more) {
        const T_COUNT few = Count(procedure, fewer), many = Count(procedure, more);
        EXPECT_LT(few.trials, many.trials) << procedure;
        EXPECT_GT(few.spectrum, 0u) << "the counter sees them";
        EXPECT_EQ(few.spectrum, many.spectrum) << procedure;
        EXPECT_TRUE(few.all == many.all || procedure == 'B' || procedure == 'c') << procedure;
    };
    expect('A', {example, kExampleSd, 2}, {example, kExampleSd, 0});
    expect('B', {example, kExampleSd, 1}, {Bilinear(10, 0.1, 0.05, 2000), Atc40(0.44), 0});
    expect('a', {example, kExampleSd, 1}, soft);
    expect('b', {example, kExampleSd, 1}, soft);
    expect('c', {example, kExampleSd, 1}, {Bilinear(10, 0.1, 0.2, 2000), kExampleSd, 1});
}
