// Iterative analysis for pretension: scale the pretension loads by their factors, analyse, solve
// again, until the factors are close to 1.
#pragma once

#include "qm_rps/factors/ulfiterationhost.h"

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

/// State: one run at a time. What was saved and reported before a failure stays.
class CUlfIteration {
public:
    /// Host and person are not owned and must outlive this object.
    CUlfIteration(IUlfIterationHost& host, IUlfIterationPerson& person,
                  T_ULF_ITER_SETTINGS settings)
        : m_host(host), m_person(person), m_settings(settings)
    {
    }

    /// 1: converged, or the required number is done, or the person wanted no more; 0: cancelled or
    /// failed. End() says which.
    [[nodiscard]] int Run();
    ULF_ITER_END End() const { return m_end; }

    /// Every solution so far, the first one first.
    const std::vector<T_ULF_ITER_STEP>& History() const { return m_history; }
    std::string ReportPath() const { return m_report; }
    /// What a solution has said last, or why the report could not be written.
    const std::optional<T_FINDING>& Said() const { return m_said; }

private:
    int Stop(ULF_ITER_END end);
    [[nodiscard]] int Solve(int iteration);
    [[nodiscard]] int WriteFirst();
    [[nodiscard]] int AddToReport(const std::string& text);
    int RefuseReport();
    [[nodiscard]] int AskForMore();
    [[nodiscard]] int SaveCopy(int iteration);
    [[nodiscard]] int Scale();
    [[nodiscard]] int Analyse(int iteration);
    /// 1 one more iteration is to follow; 0 stopped, m_end set.
    [[nodiscard]] int Iterate(int iteration);

    IUlfIterationHost& m_host;
    IUlfIterationPerson& m_person;
    T_ULF_ITER_SETTINGS m_settings;
    std::vector<T_ULF_ITER_STEP> m_history;
    std::optional<T_FINDING> m_said;
    bool m_asks = true;      // the person is asked before each iteration
    bool m_replaces = false; // copies may be written over models that are there
    std::string m_model;     // path at the start: copies are numbered from it
    std::string m_report;
    std::string m_reportText; // as in the file
    bool m_isPipe = false;    // the report; it gets each block once
    ULF_ITER_END m_end = ULF_ITER_END::Declined;
};
