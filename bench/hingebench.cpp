// Checking a library of hinge types against parsing it.
#include "qm_db/casefile.h"
#include "qm_rps/hinge/hingetypefindings.h"
#include "ratios.h"

#include <benchmark/benchmark.h>

namespace {

constexpr int kTypes = 10000;

/// A case file with 10,000 hinge types: FEMA curves in My and Mz, a bilinear curve in Fx.
const std::string& Library()
{
    static const std::string text = [] {
        const std::string sides =
            R"("positive":{"yield":250,"yield_deform":0.004,)"
            R"("B":{"deform":1,"strength":1},"C":{"deform":6,"strength":1.2},)"
            R"("D":{"deform":6,"strength":0.2},"E":{"deform":8,"strength":0.2},)"
            R"("IO":2,"LS":4,"CP":6},"negative":{"yield":250,)"
            R"("yield_deform":0.004,"B":{"deform":-1,"strength":-1},)"
            R"("C":{"deform":-6,"strength":-1.2},)"
            R"("D":{"deform":-6,"strength":-0.2},)"
            R"("E":{"deform":-8,"strength":-0.2},"IO":-2,"LS":-4,"CP":-6})";
        const std::string fema =
            R"({"type":"FEMA","curve":{"symmetric":false,"auto_yield":false,)" + sides + "}}";
        std::string all =
            R"({"format":"qm-rps case 1","units":{"force":"kN","length":"m"},"nodes":[],)"
            R"("hinge_types":[)";
        for (int i = 0; i < kTypes; ++i) {
            all += i ? "," : "";
            all += R"({"name":"type )" + std::to_string(i) +
                   R"(","element":"beam-column","components":{"Fx":{"type":)" +
                   R"("bilinear","curve":{"auto_yield":false,"positive":{"P1":100},)" +
                   R"("negative":{"P1":100}}},"My":)" + fema + R"(,"Mz":)" + fema + "}}";
        }
        return all + "]}";
    }();
    return text;
}

void ParseHingeTypes(benchmark::State& state)
{
    for (auto _ : state) {
        T_MODEL_CONTENT content;
        T_FILE_ERROR error;
        if (!CCaseFile::Parse(Library(), "library", ".", content, error))
            state.SkipWithError(error.text.c_str());
        if (content.model.hingeTypes.size() != kTypes) state.SkipWithError("types missing");
    }
}
BENCHMARK(ParseHingeTypes)->Unit(benchmark::kMillisecond);

void CheckHingeTypes(benchmark::State& state)
{
    T_MODEL_CONTENT content;
    T_FILE_ERROR error;
    if (!CCaseFile::Parse(Library(), "library", ".", content, error))
        state.SkipWithError(error.text.c_str());
    const T_HINGE_CONTEXT context;
    for (auto _ : state) {
        std::size_t findings = 0;
        for (const auto& entry : content.model.hingeTypes)
            findings += HingeTypeFindings(entry.second, context).size();
        if (findings != 0) state.SkipWithError("unexpected finding");
    }
}
BENCHMARK(CheckHingeTypes)->Unit(benchmark::kMillisecond);

[[maybe_unused]] const int kRatios[] = {
    AddRatio({"check 10,000 hinge types / parse them from JSON", "CheckHingeTypes",
              "ParseHingeTypes", 1.0, 3.0}),
};

} // namespace
