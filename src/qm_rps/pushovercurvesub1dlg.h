// Page of the pushover curve window with the choice of load case, method, procedure and plot. It
// edits the evaluation of its window.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/dbdoc.h"

class CPushOverCurveSub1Dlg : public zql::frx::MDialog {
public:
    /// Document and evaluation must outlive the page.
    CPushOverCurveSub1Dlg(const CDBDoc& doc, T_EVAL_D& settings) : m_doc(doc), m_settings(settings)
    {
    }

    std::vector<std::string> LoadCases() const;
    /// Names of the methods, FEMA 440 first, in the order of their codes.
    static std::vector<std::string> Methods();
    std::vector<std::string> Procedures() const; // none for target displacements
    static std::vector<std::string> PlotTypes(); // by code 0 to 8
    bool IsTarget() const { return m_settings.method >= PUSH_METHOD::Ec8Opcm; }

    /// Another method: the procedure becomes one that it offers, the plot its own.
    void ChangeMethod(PUSH_METHOD method);

private:
    const CDBDoc& m_doc;
    T_EVAL_D& m_settings;
};
