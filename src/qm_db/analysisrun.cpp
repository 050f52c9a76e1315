#include "qm_db/analysisrun.h"

#include "qm_base/msgfunction.h"
#include "qm_db/analysis/analysismodel.h"
#include "qm_db/analysis/stagedanalysis.h"
#include "qm_db/editscope.h"
#include "qm_db/results/fingerprint.h"

#include <algorithm>
#include <span>

namespace {

constexpr std::size_t kBatch = 64; // load cases at a time: what the engine solves in one block

/// The progress of a part of the run as progress of the whole run.
solver::ProgressFn Part(const T_ANALYSIS_OPTIONS& options, std::size_t before, std::size_t total)
{
    if (!options.progress) return {};
    return [&options, before, total](std::size_t done, std::size_t) {
        return options.progress(std::min(before + done, total), total);
    };
}

/// The engine and what it works on.
struct T_RUN {
    const T_MODEL& model;
    const T_ANALYSIS_OPTIONS& options;
    CAnalysisModel frame;
    solver::CFrameSolver engine;
    std::vector<int> cases;
    std::size_t total = 0; // parts of the run: cases and modes
    std::vector<T_LOST_DIGITS> lost;

    void Note(int loadCase, const solver::T_ACCURACY& known)
    {
        if (known.unrefined > 0.0) lost.push_back({loadCase, known.unrefined, known.error});
    }

    int Fail(const solver::T_SOLVER_ERROR& fault, std::span<const int> keys,
             T_ANALYSIS_ERROR& error) const
    {
        error = frame.ErrorOf(fault, keys);
        return 0;
    }
};

int SolveBatch(T_RUN& run, std::size_t first, std::uint64_t structure,
               std::vector<std::shared_ptr<IStaticResult>>& out, T_ANALYSIS_ERROR& error)
{
    const std::span<const int> keys =
        std::span<const int>(run.cases).subspan(first, std::min(kBatch, run.cases.size() - first));
    std::vector<solver::T_LOAD_CASE> loads(keys.size());
    for (std::size_t i = 0; i < keys.size(); ++i) {
        if (!run.frame.BuildCase(keys[i], loads[i], error)) return 0;
    }
    std::vector<solver::T_RESULT> results;
    solver::T_SOLVER_ERROR fault;
    if (!run.engine.Solve(loads, results, fault, Part(run.options, first, run.total)))
        return run.Fail(fault, keys, error);
    for (std::size_t i = 0; i < keys.size(); ++i) {
        const std::uint64_t print = FingerprintOfCase(structure, run.model.loadCases.at(keys[i]));
        out.push_back(MakeStaticResult(run.frame.ResultOf(results[i], print)));
        run.Note(keys[i], results[i].accuracy);
        results[i] = {};
    }
    return 1;
}

/// The static load cases, in one factorisation with the modes.
int SolveStatic(T_RUN& run, std::vector<std::shared_ptr<IStaticResult>>& out,
                T_ANALYSIS_ERROR& error)
{
    solver::T_SOLVER_ERROR fault;
    if (!run.frame.BuildFrame(error)) return 0;
    if (!run.engine.Prepare(run.frame.Frame(), fault)) return run.Fail(fault, {}, error);
    const std::uint64_t structure = FingerprintOfStructure(run.model);
    for (std::size_t first = 0; first < run.cases.size(); first += kBatch) {
        if (!SolveBatch(run, first, structure, out, error)) return 0;
    }
    return 1;
}

int FindModes(T_RUN& run, std::vector<T_EIGV_D>& out, T_ANALYSIS_ERROR& error)
{
    std::vector<solver::T_MODE> modes;
    solver::T_SOLVER_ERROR fault;
    if (!run.engine.Modes(static_cast<std::size_t>(run.options.modes), modes, fault,
                          Part(run.options, run.cases.size(), run.total)))
        return run.Fail(fault, {}, error);
    for (const solver::T_MODE& mode : modes)
        out.push_back(run.frame.ModeOf(mode));
    return 1;
}

} // namespace

int CAnalysisRun::KeepModes(std::vector<T_EIGV_D> modes)
{
    CEditScope edit(m_doc, zql::lib::MMSGFunction::GetValue("IDS_QM_DB_STEP_MODES"),
                    EDIT_STEP::Join);
    for (const int key : m_doc.Attr().GetKeys<T_EIGV_D>())
        if (!edit.Erase<T_EIGV_D>(key)) return 0;
    for (std::size_t i = 0; i < modes.size(); ++i)
        if (!edit.Put(static_cast<int>(i) + 1, std::move(modes[i]))) return 0;
    return edit.Commit();
}

int CAnalysisRun::Keep(T_ANALYSIS_RESULTS results)
{
    if (results.staged) m_doc.Data().SetStagedResult(std::move(results.staged));
    for (auto& [key, result] : results.cases)
        m_doc.Data().SetStaticResult(key, std::move(result));
    return results.modes ? KeepModes(std::move(*results.modes)) : 1;
}

int CAnalysisRun::Compute(const T_MODEL& model, const T_ANALYSIS_OPTIONS& options,
                          const std::shared_ptr<IStagedResult>& before, T_ANALYSIS_RESULTS& out,
                          T_ANALYSIS_ERROR& error)
{
    T_RUN run{model, options, CAnalysisModel(model), {}, options.cases, 0, {}};
    if (options.allCases) {
        run.cases.clear();
        for (const auto& entry : model.loadCases)
            run.cases.push_back(entry.first);
    }
    const bool hasStages = options.stages && !model.stages.empty();
    CStagedAnalysis staged(model);
    const std::size_t parts =
        run.cases.size() + static_cast<std::size_t>(std::max(options.modes, 0));
    run.total = parts + (hasStages ? staged.StepCount() : 0);
    error = {};

    // Stages alone need not make a structure that stands as a whole.
    std::vector<std::shared_ptr<IStaticResult>> results;
    if ((parts > 0 || !hasStages) && !SolveStatic(run, results, error)) return 0;
    T_ANALYSIS_RESULTS found;
    if (options.modes > 0 && !FindModes(run, found.modes.emplace(), error)) return 0;
    if (hasStages && !staged.Run(Part(options, parts, run.total), before, found.staged, error))
        return 0;
    run.Note(0, staged.Accuracy());
    found.lost = std::move(run.lost);
    for (std::size_t i = 0; i < results.size(); ++i)
        found.cases[run.cases[i]] = std::move(results[i]);
    out = std::move(found);
    return 1;
}
