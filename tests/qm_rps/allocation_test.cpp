// The trial loops work in the memory of their first trial. A program of its own, since it replaces
// the global operator new.
#include "perfptfixture.h"

#include <atomic>
#include <cstdlib>
#include <gtest/gtest.h>
#include <new>

namespace {

std::atomic<std::size_t> g_spectrum{0}; // allocations of arrays as long as the spectrum
std::atomic<std::size_t> g_bytes{0};    // size of such an array

} // namespace

// Not inlined: the compiler would see free() paired with its own operator new and complain.
[[gnu::noinline]] void* operator new(std::size_t size)
{
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

/// Trials of a procedure, and arrays as long as the spectrum that it allocates.
std::pair<std::size_t, std::size_t> Count(char procedure, const T_JOB& job)
{
    CTestRecord record(job.capacity, job.spectrum, {job.type});
    g_bytes = record.DemandPeriods().size() * sizeof(double);
    const std::size_t before = g_spectrum;
    const T_RUN run = RunProcedure(record, procedure);
    EXPECT_NE(0, run.result) << procedure;
    return {run.trace.size(), g_spectrum - before};
}

} // namespace

TEST(Allocation, MoreTrialsAllocateNoMoreSpectra)
{
    const T_POINTS example = Atc40ExampleCurve();
    const T_JOB soft{Bilinear(10, 0.1, -0.02, 400), Atc40(0.3), 2};
    const struct {
        char procedure;
        T_JOB few, many;
    } cases[] = {
        {'A', {example, kExampleSd, 2}, {example, kExampleSd, 0}},
        {'B', {example, kExampleSd, 1}, {Bilinear(10, 0.1, 0.05, 2000), Atc40(0.44), 0}},
        {'a', {example, kExampleSd, 1}, soft},
        {'b', {example, kExampleSd, 1}, soft},
        {'c', {example, kExampleSd, 1}, {Bilinear(10, 0.1, 0.2, 2000), kExampleSd, 1}},
    };
    for (const auto& c : cases) {
        const auto [fewTrials, few] = Count(c.procedure, c.few);
        const auto [manyTrials, many] = Count(c.procedure, c.many);
        EXPECT_LT(fewTrials, manyTrials) << c.procedure;
        EXPECT_GT(few, 0u) << "the counter sees them";
        EXPECT_EQ(few, many) << c.procedure;
    }
}
