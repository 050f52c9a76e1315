// What the windows on the results of a push have in common: the result and the step that are shown.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_rps/evaluatedsteps.h"
#include "qm_rps/push/pushresultlist.h"

class CPushOverResultDlg : public zql::frx::MDialog {
public:
    /// Shows the last step of the first result, where there is one.
    explicit CPushOverResultDlg(CDBDoc& doc);

    std::vector<std::string> ResultTexts() const;
    int ResultIndex() const { return m_index; } // -1: none
    /// Another result, at its last step.
    void OnSelChangeResult(int index);
    /// 1 shown; 0 there is no such result.
    [[nodiscard]] int OnOpen(const std::string& name);

    /// The push of an evaluation with its points as steps, beside the stored results: pushed again,
    /// so that nothing is interpolated. At the performance point, else at the first demand that the
    /// push has reached. 1 shown; 0 `error` says why not, what is shown stays.
    [[nodiscard]] int OnShowPoints(const T_PUSH_EVALUATION& result,
                                   const PUSH_PROGRESS_FN& progress, std::string& error);
    /// Points of the shown result: "performance point", "SD: demand"; none of a stored one.
    std::vector<std::string> PointTexts() const;
    int PointIndex() const; // -1: the step is none
    void OnSelChangePoint(int index);
    /// The step of the demand of a limit state. 1 shown; 0 the result has no such point.
    [[nodiscard]] int OnShowState(const std::string& state);

    const T_PUSH_RUN& Run() const { return m_run; } // empty: none could be read
    /// The results are older than the model: only curve and displacements are shown.
    bool IsOld() const { return !m_old.empty(); }
    /// How the push has ended; of an old result what has changed; else why none is shown.
    std::string StatusText() const;
    /// "PX" or "PX, out of date"
    std::string TitleText() const;

    int Steps() const { return static_cast<int>(m_run.loadFactor.size()); }
    int Step() const { return m_step; } // from 1; 0: there is none
    /// Beyond the ends: the nearest one.
    void OnStep(int step);
    /// "performance point of PX ATC": what the step is; empty: no point.
    std::string PointText() const;
    /// "Step 12"; of a push to points, whose steps have other numbers than the stored ones, "at
    /// 0.1338 m".
    std::string MarkName() const;
    /// "Step 12", at a point "at 0.1338 m (performance point of PX ATC)".
    std::string StepName() const;
    /// Load factor, displacement and base reaction of the step.
    std::string StepText() const;
    T_UNITS Units() const { return m_doc.Data().Units(); }

protected:
    /// Another result, or another step, is shown.
    virtual void OnShown(bool anotherResult) = 0;
    /// For the ends of constructors.
    void ShowFirst() { OnSelChangeResult(m_results.empty() ? -1 : 0); }

    CDBDoc& m_doc;

private:
    const T_PUSH_AT_POINT& FirstPoint() const;
    std::string DisplacementText() const;
    bool ShowsPoints() const { return m_index == std::ssize(m_results); }

    std::vector<T_PUSH_RESULT_ID> m_results;
    T_HINGES_AT m_points; // reached ones alone; no evaluation: there are none
    T_PUSH_RUN m_pointsRun;
    CPushRun m_reader;
    int m_index = -1, m_step = 0;
    T_PUSH_RUN m_run;
    std::string m_old, m_error;
};
