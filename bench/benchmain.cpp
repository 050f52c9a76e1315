// Runs the benchmarks and prints the ratios that the project holds itself to.
#include "ratios.h"

#ifdef QM_UI
#include "benchapp.h"
#endif

#include <benchmark/benchmark.h>

#include <cstdio>
#include <map>
#include <vector>

namespace {

std::vector<T_RATIO>& Ratios()
{
    static std::vector<T_RATIO> ratios;
    return ratios;
}

/// Console output, and the smallest time of each benchmark in nanoseconds.
class CCollector : public benchmark::ConsoleReporter {
public:
    CCollector() : ConsoleReporter(OO_Tabular) {}

    void ReportRuns(const std::vector<Run>& runs) override
    {
        for (const Run& run : runs) {
            if (run.error_occurred || run.run_type != Run::RT_Iteration) continue;
            const double ns = run.GetAdjustedRealTime();
            const auto [it, isNew] = m_times.emplace(run.run_name.function_name, ns);
            if (!isNew && ns < it->second) it->second = ns;
        }
        ConsoleReporter::ReportRuns(runs);
    }
    const std::map<std::string, double>& Times() const { return m_times; }

private:
    std::map<std::string, double> m_times;
};

} // namespace

int AddRatio(T_RATIO ratio)
{
    Ratios().push_back(std::move(ratio));
    return 0;
}

int main(int argc, char** argv)
{
    benchmark::Initialize(&argc, argv);
    CCollector collector;
    benchmark::RunSpecifiedBenchmarks(&collector);
    std::printf("\n%-58s %9s %9s\n", "ratio (smallest times of this run)", "measured", "limit");
    for (const T_RATIO& r : Ratios()) {
        const auto a = collector.Times().find(r.numerator);
        const auto b = collector.Times().find(r.denominator);
        if (a == collector.Times().end() || b == collector.Times().end()) continue;
        const double value = a->second / b->second * r.scale;
        std::printf("%-58s %9.3f %9.3f %s\n", r.what.c_str(), value, r.limit,
                    value <= r.limit ? "" : "  <-- over");
    }
#ifdef QM_UI
    EndBenchApp();
#endif
    return 0;
}
