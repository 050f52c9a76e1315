// Cost of the analysis engine on a frame of about 100,000 unknowns, against its own factorisation
// and against the sparse library called directly.
#include "qm_solver/checks/balance.h"
#include "qm_solver/checks/mechanism.h"
#include "qm_solver/frame/caseblock.h"
#include "qm_solver/frame/frameassembly.h"
#include "qm_solver/framesolver.h"
#include "qm_solver/model/frameextent.h"
#include "ratios.h"

#include <benchmark/benchmark.h>

#include <chrono>
#include <cmath>
#include <cstdio>
#include <fstream>
#include <functional>
#include <memory>

#include <dmumps_c.h>
#include <metis.h>
#include <unistd.h>

namespace {

using namespace solver;

constexpr std::size_t kBays = 24, kStoreys = 29; // 24 x 24 columns, 29 storeys: 100,224 unknowns

std::size_t NodeAt(std::size_t x, std::size_t y, std::size_t z)
{
    return (z * kBays + y) * kBays + x;
}

/// Columns and beams along X and Y, clamped at the foot.
T_FRAME Building()
{
    T_FRAME frame;
    frame.materials.push_back({2.1e8, 8.1e7, 7.85, 1.2e-5});
    frame.sections.push_back({1.5e-2, 5e-3, 5e-3, 3e-6, 2.5e-4, 8e-5});
    const auto join = [&](std::size_t i, std::size_t j) {
        T_ELEMENT e;
        e.i = i;
        e.j = j;
        frame.elements.push_back(e);
    };
    for (std::size_t z = 0; z <= kStoreys; ++z)
        for (std::size_t y = 0; y < kBays; ++y)
            for (std::size_t x = 0; x < kBays; ++x) {
                T_NODE node;
                node.xyz = {6.0 * double(x), 5.0 * double(y), 3.2 * double(z)};
                node.fixed.fill(z == 0);
                frame.nodes.push_back(node);
                if (z == 0) continue;
                join(NodeAt(x, y, z - 1), NodeAt(x, y, z));
                if (x > 0) join(NodeAt(x - 1, y, z), NodeAt(x, y, z));
                if (y > 0) join(NodeAt(x, y - 1, z), NodeAt(x, y, z));
            }
    return frame;
}

/// Wind on one column line and the weight.
T_LOAD_CASE Load(std::size_t line)
{
    T_LOAD_CASE load;
    load.selfWeight = {0.0, 0.0, -1.0};
    for (std::size_t z = 1; z <= kStoreys; ++z)
        load.nodal.push_back({NodeAt(0, line % kBays, z), {10.0, 0, 0, 0, 0, 0}});
    return load;
}

const T_FRAME& Frame()
{
    static const T_FRAME frame = Building();
    return frame;
}

double Seconds(const std::function<void()>& work)
{
    const auto from = std::chrono::steady_clock::now();
    work();
    return std::chrono::duration<double>(std::chrono::steady_clock::now() - from).count();
}

/// Analysed and assembled once for all benchmarks.
struct T_READY {
    CFrameDofs dofs{Frame()};
    CFrameAssembly assembly;
    CSparseFactor factor;
    T_SOLVER_REASON reason;
    bool good = false;
    T_READY()
    {
        if (!assembly.Prepare(Frame(), dofs, reason)) return;
        assembly.Assemble(Frame());
        good = factor.Analyse(assembly.Matrix(), dofs.Blocks(), reason) &&
               factor.Factor(assembly.Matrix(), reason);
    }
};
T_READY& Ready()
{
    static T_READY ready;
    return ready;
}

void AssembleFirst(benchmark::State& state)
{
    T_SOLVER_REASON reason;
    for (auto _ : state) {
        const CFrameDofs dofs(Frame());
        CFrameAssembly assembly;
        if (!assembly.Prepare(Frame(), dofs, reason)) state.SkipWithError(reason.Text().c_str());
        assembly.Assemble(Frame());
        if (dofs.EquationCount() != 100224) state.SkipWithError("unknowns missing");
    }
}
BENCHMARK(AssembleFirst)->Unit(benchmark::kMillisecond);

void AssembleAgain(benchmark::State& state)
{
    T_READY& ready = Ready();
    for (auto _ : state)
        ready.assembly.Assemble(Frame());
}
BENCHMARK(AssembleAgain)->Unit(benchmark::kMillisecond);

void FactoriseMatrix(benchmark::State& state)
{
    T_READY& ready = Ready();
    for (auto _ : state)
        if (!ready.good || !ready.factor.Factor(ready.assembly.Matrix(), ready.reason))
            state.SkipWithError(ready.reason.Text().c_str());
}
BENCHMARK(FactoriseMatrix)->Unit(benchmark::kMillisecond)->Iterations(2);

void SolveOneSide(benchmark::State& state)
{
    T_READY& ready = Ready();
    for (auto _ : state) {
        std::vector<double> side(ready.dofs.EquationCount(), 1.0);
        if (!ready.good || !ready.factor.Solve(side, 1, ready.reason))
            state.SkipWithError(ready.reason.Text().c_str());
    }
}
BENCHMARK(SolveOneSide)->Unit(benchmark::kMillisecond)->Iterations(5);

/// Everything that a change of stiffness needs: assembly, factorisation with the search for
/// mechanisms, one load case from loads to member forces.
void EngineNumeric(benchmark::State& state)
{
    T_READY& ready = Ready();
    const std::vector<T_LOAD_CASE> load{Load(0)};
    for (auto _ : state) {
        ready.assembly.Assemble(Frame());
        T_SOLVER_ERROR error;
        if (!FactorStable(Frame(), ready.dofs, ready.assembly.Matrix(), ready.factor, error))
            state.SkipWithError(error.reason.Text().c_str());
        const CCaseBlock block(Frame(), ready.dofs, load);
        T_SOLUTION solution;
        std::size_t column = 0;
        if (!SolveBalanced(block, ready.dofs, Extent(Frame()), ready.assembly.Matrix(),
                           ready.factor, solution, column, ready.reason))
            state.SkipWithError(ready.reason.Text().c_str());
        std::vector<T_RESULT> results;
        block.Recover(solution, results);
        if (!(results[0].displacement.back()[2] < 0.0)) state.SkipWithError("no settlement");
    }
}
BENCHMARK(EngineNumeric)->Unit(benchmark::kMillisecond)->Iterations(2);

// ---- the library alone --------------------------------------------------------------------------

/// Nested dissection of the graph of all equations: position of each in the order, from 1.
std::vector<int> LibraryOrder(const T_SYMMETRIC_MATRIX& m)
{
    idx_t n = static_cast<idx_t>(m.Size());
    std::vector<std::vector<idx_t>> joined(m.Size());
    for (std::size_t i = 0; i < m.Size(); ++i)
        for (int k = m.rowStart[i]; k < m.rowStart[i + 1]; ++k) {
            const std::size_t j = static_cast<std::size_t>(m.column[static_cast<std::size_t>(k)]);
            if (i == j) continue;
            joined[i].push_back(static_cast<idx_t>(j));
            joined[j].push_back(static_cast<idx_t>(i));
        }
    std::vector<idx_t> start{0}, edge, order(m.Size()), place(m.Size());
    for (const auto& row : joined) {
        edge.insert(edge.end(), row.begin(), row.end());
        start.push_back(static_cast<idx_t>(edge.size()));
    }
    METIS_NodeND(&n, start.data(), edge.data(), nullptr, nullptr, order.data(), place.data());
    std::vector<int> position(place.begin(), place.end());
    for (int& p : position)
        ++p;
    return position;
}

void LibraryNumeric(benchmark::State& state)
{
    const T_SYMMETRIC_MATRIX& m = Ready().assembly.Matrix();
    std::vector<int> rows, columns, position = LibraryOrder(m);
    std::vector<double> values = m.value, side(m.Size(), 1.0);
    for (std::size_t i = 0; i < m.Size(); ++i)
        for (int k = m.rowStart[i]; k < m.rowStart[i + 1]; ++k) {
            rows.push_back(static_cast<int>(i) + 1);
            columns.push_back(m.column[static_cast<std::size_t>(k)] + 1);
        }
    DMUMPS_STRUC_C id{};
    const auto run = [&](int job) {
        id.job = job;
        dmumps_c(&id);
        if (id.infog[0] < 0) state.SkipWithError("the library failed");
    };
    id.par = 1;
    id.sym = 2;
    id.comm_fortran = -987654;
    run(-1);
    for (int k = 0; k < 4; ++k)
        id.icntl[k] = k < 3 ? -1 : 0; // silent
    id.icntl[6] = 1;                  // the given order
    id.perm_in = position.data();
    id.n = static_cast<int>(m.Size());
    id.nnz = static_cast<MUMPS_INT8>(values.size());
    id.irn = rows.data();
    id.jcn = columns.data();
    id.a = values.data();
    run(1);
    for (auto _ : state) {
        run(2);
        id.rhs = side.data();
        run(3);
    }
    run(-2);
}
BENCHMARK(LibraryNumeric)->Unit(benchmark::kMillisecond)->Iterations(2);

// ---- further cases and memory -------------------------------------------------------------------

/// Resident memory of this process in bytes.
double Resident()
{
    std::ifstream file("/proc/self/statm");
    double total = 0.0, resident = 0.0;
    file >> total >> resident;
    return resident * static_cast<double>(sysconf(_SC_PAGESIZE));
}

/// The time is that of each of 32 further cases, results included.
void FurtherCase(benchmark::State& state)
{
    constexpr std::size_t kFurther = 32;
    CFrameSolver engine;
    T_SOLVER_ERROR error;
    if (!engine.Prepare(Frame(), error)) state.SkipWithError(error.reason.Text().c_str());
    std::vector<T_LOAD_CASE> cases{Load(0)};
    for (std::size_t c = 0; c < kFurther; ++c)
        cases.push_back(Load(c + 1));
    for (auto _ : state) {
        std::vector<T_RESULT> results;
        const auto solve = [&](std::size_t count) {
            return Seconds([&] {
                if (!engine.Solve(std::span(cases).first(count), results, error))
                    state.SkipWithError(error.reason.Text().c_str());
            });
        };
        const double one = solve(1), all = solve(cases.size());
        state.SetIterationTime((all - one) / kFurther);
    }
}
BENCHMARK(FurtherCase)->Unit(benchmark::kMillisecond)->UseManualTime()->Iterations(3);

/// Bytes as nanoseconds, so that they become a ratio like the others.
void EngineMemory(benchmark::State& state)
{
    Ready(); // its own memory is no part of what follows
    for (auto _ : state) {
        const double before = Resident();
        CFrameSolver engine;
        T_SOLVER_ERROR error;
        std::vector<T_RESULT> results;
        if (!engine.Prepare(Frame(), error) ||
            !engine.Solve(std::vector<T_LOAD_CASE>{Load(0)}, results, error))
            state.SkipWithError(error.reason.Text().c_str());
        state.SetIterationTime((Resident() - before) * 1e-9);
    }
}
BENCHMARK(EngineMemory)->UseManualTime()->Iterations(1);

void FactorMemory(benchmark::State& state)
{
    for (auto _ : state)
        state.SetIterationTime(Ready().factor.Info().factorBytes * 1e-9);
}
BENCHMARK(FactorMemory)->UseManualTime()->Iterations(1);

/// What the library itself takes while it factorises.
void LibraryMemory(benchmark::State& state)
{
    for (auto _ : state)
        state.SetIterationTime(Ready().factor.Info().peakBytes * 1e-9);
}
BENCHMARK(LibraryMemory)->UseManualTime()->Iterations(1);

[[maybe_unused]] const int kRatios[] = {
    AddRatio({"assembly with its pattern / factorisation", "AssembleFirst", "FactoriseMatrix", 1.0,
              0.25}),
    AddRatio({"assembly again / factorisation", "AssembleAgain", "FactoriseMatrix", 1.0, 0.01}),
    AddRatio({"assembly, factorisation, a case / the library's own", "EngineNumeric",
              "LibraryNumeric", 1.0, 1.3}),
    AddRatio(
        {"each further load case / one triangular solve", "FurtherCase", "SolveOneSide", 1.0, 1.5}),
    AddRatio({"memory of a solved model / factor", "EngineMemory", "FactorMemory", 1.0, 1.5}),
    AddRatio({"memory of a solved model / the library's own need", "EngineMemory", "LibraryMemory",
              1.0, 1.5}),
};

} // namespace
