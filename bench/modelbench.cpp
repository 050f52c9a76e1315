// Cost of the model file and of many evaluations in one process.
#include "qm_db/casefile.h"
#include "qm_rps/pushovercalculators.h"
#include "qm_rps/pushovercurvedlg.h"
#include "ratios.h"

#include <benchmark/benchmark.h>

#include <cmath>
#include <cstdio>
#include <filesystem>
#include <memory>

namespace {

namespace fs = std::filesystem;

constexpr int kNodes = 100000;
constexpr int kSteps = 200;

/// 100,000 nodes in 100 storeys, one pushover case of 200 steps with every node's displacement.
T_MODEL_CONTENT BigModel()
{
    T_MODEL_CONTENT content;
    T_MODEL& m = content.model;
    m.styp.title = "large";
    T_PUSH_DATA data;
    for (int i = 1; i <= kNodes; ++i) {
        T_NODE_D node;
        node.id = i;
        node.xyz = {0.5 * (i % 1000), 0.0, 3.0 * (1 + (i - 1) / 1000)};
        node.mass = {1000.0, 1000.0, 1000.0};
        m.nodes.emplace_hint(m.nodes.end(), i, node);
        std::vector<double>& u = data.displacement[i];
        for (int s = 1; s <= kSteps; ++s)
            u.push_back(1e-5 * s * (1 + (i - 1) / 1000));
    }
    for (int s = 1; s <= kSteps; ++s) {
        data.loadFactor.push_back(0.01 * s);
        data.baseReaction.push_back(1e6 * s);
    }
    T_POLC_D polc;
    polc.name = "PX";
    polc.controlNode = kNodes;
    m.pushovers[1] = polc;
    content.results[1] = MakePushResult(std::move(data));
    return content;
}

/// The big model as a file, made once.
const std::string& BigFile()
{
    static const std::string path = [] {
        const std::string p = (fs::temp_directory_path() / "qm_bench_large.qmdb").string();
        CModelStore store;
        T_FILE_ERROR error;
        if (!store.Save(p, BigModel(), error)) std::fprintf(stderr, "%s\n", error.text.c_str());
        return p;
    }();
    return path;
}

void OpenLargeModel(benchmark::State& state)
{
    const std::string& path = BigFile();
    for (auto _ : state) {
        state.PauseTiming();
        auto store = std::make_unique<CModelStore>();
        auto content = std::make_unique<T_MODEL_CONTENT>();
        T_FILE_ERROR error;
        state.ResumeTiming();
        if (!store->Open(path, OPEN_MODE::ReadOnly, *content, error))
            state.SkipWithError(error.text.c_str());
        state.PauseTiming(); // giving the memory back is no part of opening
        if (content->model.nodes.size() != kNodes) state.SkipWithError("nodes missing");
        content.reset();
        store.reset();
        state.ResumeTiming();
    }
}
BENCHMARK(OpenLargeModel)->Unit(benchmark::kMillisecond);

/// Every node of every step, read and checked.
void ReadLargeModelWhole(benchmark::State& state)
{
    const std::string& path = BigFile();
    for (auto _ : state) {
        CModelStore store;
        T_MODEL_CONTENT content;
        T_FILE_ERROR error;
        T_PUSH_DATA data;
        std::string why;
        if (!store.Open(path, OPEN_MODE::ReadOnly, content, error) ||
            !ReadWholeResult(*content.results.at(1), data, why))
            state.SkipWithError("not read");
        if (data.displacement.size() != kNodes) state.SkipWithError("nodes missing");
    }
    fs::remove(path);
}
BENCHMARK(ReadLargeModelWhole)->Unit(benchmark::kMillisecond)->Iterations(1);

constexpr const char* kCase = QM_EXAMPLES "/first-steps/case.json";

/// The driver with its model: what a batch of evaluations in one process costs each.
void EvaluateByDriver(benchmark::State& state)
{
    CDBDoc doc;
    T_FILE_ERROR error;
    if (!doc.ImportCase(kCase, error)) state.SkipWithError(error.text.c_str());
    CPushOverCurveDlg driver(doc);
    driver.SetFindAllPoints(false); // what the procedure alone costs
    T_EVAL_D eval;
    (void)doc.Attr().GetEval(1, eval);
    int result = 0;
    for (auto _ : state) {
        if (!driver.SetEvaluation(eval)) state.SkipWithError("settings");
        result = driver.Evaluate();
    }
    if (result != kPerfPtFound) state.SkipWithError("not found");
}
BENCHMARK(EvaluateByDriver);

/// The calculator alone on the same arrays, with the spectrum object and its 5 % curve.
void EvaluateByKernel(benchmark::State& state)
{
    CDBDoc doc;
    T_FILE_ERROR error;
    if (!doc.ImportCase(kCase, error)) state.SkipWithError(error.text.c_str());
    CPushEvaluator driver(doc, RunPerfPtProcedure);
    T_EVAL_D eval;
    T_FINDING refusal;
    (void)doc.Attr().GetEval(1, eval);
    (void)driver.SetEvaluation(eval, refusal);
    driver.Evaluate();
    T_SPFC_D spectrum;
    int key = 0;
    (void)doc.Attr().FindSpfc(eval.spectrum, key);
    (void)doc.Attr().GetSpfc(key, spectrum);
    int result = 0;
    for (auto _ : state) {
        driver.SetDesignSpectrum(MakeDesignSpectrum(spectrum, 0, LIMIT_STATE::SLV));
        const auto calculator =
            MakePerfPtCalculator(eval.method, eval.procedure.value_or('A') - 'A', driver);
        double Dp = 0.0, Ap = 0.0;
        std::optional<double> beta;
        result = calculator->CalcPerformancePoint(Dp, Ap, beta, nullptr);
        benchmark::DoNotOptimize(Dp);
    }
    if (result != kPerfPtFound) state.SkipWithError("not found");
}
BENCHMARK(EvaluateByKernel);

[[maybe_unused]] const int kRatios[] = {
    AddRatio({"open 100,000 nodes, 200 steps / read the whole file, %", "OpenLargeModel",
              "ReadLargeModelWhole", 100.0, 5.0}),
    AddRatio({"1,000 evaluations by the driver / by the kernel", "EvaluateByDriver",
              "EvaluateByKernel", 1.0, 1.1}),
};

} // namespace
