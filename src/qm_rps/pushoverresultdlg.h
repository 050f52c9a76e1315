// What the windows on the results of a push have in common: the result and the step that are shown.
#pragma once

#include "qm_base/mdialog.h"
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
    std::vector<T_PUSH_RESULT_ID> m_results;
    CPushRun m_reader;
    int m_index = -1, m_step = 0;
    T_PUSH_RUN m_run;
    std::string m_old, m_error;
};
