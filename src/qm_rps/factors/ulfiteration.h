// Iterative analysis for pretension: scale the pretension loads by their factors, analyse, solve
// again, until the factors are close to 1.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_rps/factors/ulfiterationhost.h"

#include <functional>

enum class ULF_ITER_END {
    Converged,
    Required,         // the required number of iterations is done
    Declined,         // the person did not ask for (more) iterations
    Cancelled,        // between iterations, or while an analysis ran
    NotSolved,        // the optimizer found no factors
    ReportNotWritten, // a block of the report
    NotSaved,         // the numbered copy
    NotScaled,        // a pretension load: the edit was cancelled
    NotAnalysed,      // the analysis did not start, or left no results: its loads were taken back
};

struct T_ULF_ITER_SETTINGS {
    int required = 5;         // iterations after the first solution
    double tolerance = 0.001; // of UlfIterTolerance
    bool operator==(const T_ULF_ITER_SETTINGS&) const = default;
};

/// The run. The result dialog (CUlfIterationResultDlg) and the question about an existing report
/// go through the view; without a view nothing is accepted, so only the first solution is made.
/// State: one run at a time. What was saved and reported before a failure stays.
class CUlfIteration : public zql::frx::MDialog {
public:
    /// `host` is not owned and must outlive this object.
    CUlfIteration(IUlfIterationHost& host, T_ULF_ITER_SETTINGS settings)
        : m_host(host), m_settings(settings)
    {
    }

    /// Told before each iteration, and again and again while its analysis runs, with the number of
    /// those done; false cancels the run, the model and its file being as after the last complete
    /// iteration. Empty: goes on.
    std::function<bool(int done, int required)> m_progress;

    /// Told after each solution. Empty: nobody.
    std::function<void()> m_solved;

    /// 1: converged, or the required number is done, or the person wanted no more; 0: cancelled or
    /// failed. End() says which.
    [[nodiscard]] int Run();
    ULF_ITER_END End() const { return m_end; }

    /// Every solution so far, the first one first.
    const std::vector<T_ULF_ITER_STEP>& History() const { return m_history; }
    std::string ReportPath() const { return m_report; }

private:
    int Stop(ULF_ITER_END end);
    [[nodiscard]] int Solve(int iteration);
    [[nodiscard]] int WriteFirst();
    [[nodiscard]] int AskForMore();
    [[nodiscard]] int Scale();
    [[nodiscard]] int Analyse(int iteration);
    /// 1 one more iteration is to follow; 0 stopped, m_end set.
    [[nodiscard]] int Iterate(int iteration);

    IUlfIterationHost& m_host;
    T_ULF_ITER_SETTINGS m_settings;
    std::vector<T_ULF_ITER_STEP> m_history;
    bool m_asks = true;  // the result dialog comes before each iteration
    std::string m_model; // path at the start: copies are numbered from it
    std::string m_report;
    ULF_ITER_END m_end = ULF_ITER_END::Declined;
};
