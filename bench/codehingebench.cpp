// Hinges of a code for many members, against one integration of a section.
#include "qm_rps/generate/codehinges.h"
#include "ratios.h"

#include <benchmark/benchmark.h>

namespace {

constexpr int kMembers = 10000, kSections = 200;

/// A rectangle with eight bars and stirrups; the number changes its height.
T_SECT_D Section(int number)
{
    T_SECT_D s;
    s.name = "section " + std::to_string(number);
    s.shape = SECT_SHAPE::Rectangle;
    s.size = {0.4 + 0.001 * number, 0.4, 0.0, 0.0};
    const double z = s.size[0] / 2.0 - 0.047;
    for (const double across : {-0.153, 0.0, 0.153})
        for (const double along : {-z, 0.0, z})
            if (across != 0.0 || along != 0.0) s.bars.push_back({across, along, 254.469e-6});
    s.detailing = T_SECT_DETAIL{0.03, 0.008, 0.15};
    return s;
}

/// Members apart from each other, every other one upright; 50 of each section.
T_MODEL Model()
{
    T_MODEL m;
    T_MATL_D concrete;
    concrete.name = "C";
    concrete.type = MATL_CLASS::Concrete;
    concrete.E = 15e9, concrete.nu = 0.2;
    concrete.fck = 20e6, concrete.fyk = 400e6, concrete.Es = 200e9;
    concrete.mean = T_MATL_MEAN{28e6, 450e6, 0.0};
    m.materials.emplace(1, concrete);
    for (int i = 1; i <= kSections; ++i)
        m.sections.emplace(i, Section(i));
    for (int i = 0; i < kMembers; ++i) {
        const double x = 10.0 * i;
        for (const bool far : {false, true}) {
            T_NODE_D node;
            node.xyz = {x + (far && i % 2 ? 4.0 : 0.0), 0.0, far && i % 2 == 0 ? 3.0 : 0.0};
            m.nodes.emplace(2 * i + (far ? 2 : 1), node);
        }
        T_ELEM_D e;
        e.id = i + 1;
        e.nodeI = 2 * i + 1, e.nodeJ = 2 * i + 2;
        e.section = 1 + i / 2 % kSections, e.material = 1;
        m.elements.emplace(e.id, e);
    }
    return m;
}

void GenerateCodeHinges(benchmark::State& state)
{
    T_MODEL_CONTENT content;
    content.model = Model();
    for (auto _ : state) {
        state.PauseTiming();
        CDBDoc doc;
        doc.Data().Assign(content);
        state.ResumeTiming();
        T_CODE_HINGES out;
        T_HINGE_REFUSAL refusal;
        if (!CCodeHinges(doc).Generate({}, out, refusal)) state.SkipWithError(refusal.text.c_str());
        if (out.elements.size() != kMembers || out.types != 2 * kSections)
            state.SkipWithError("hinges missing");
    }
    state.SetItemsProcessed(state.iterations() * kMembers);
}
BENCHMARK(GenerateCodeHinges)->Unit(benchmark::kMicrosecond); // as the integration

[[maybe_unused]] const int kRatios[] = {
    AddRatio({"hinge of a code, 10,000 of 200 sections / one integration", "GenerateCodeHinges",
              "SectionIntegral", 1.0 / kMembers, 100.0}),
};

} // namespace
