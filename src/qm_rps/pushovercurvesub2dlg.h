// Page of the pushover curve window with the demand: its spectrum, the structure's behaviour and
// its damping. It edits the evaluation of its window.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/dbdoc.h"

class CPushOverCurveSub2Dlg : public zql::frx::MDialog {
public:
    /// Document and evaluation must outlive the page.
    CPushOverCurveSub2Dlg(const CDBDoc& doc, T_EVAL_D& settings) : m_doc(doc), m_settings(settings)
    {
    }

    std::vector<std::string> Spectra() const;
    /// ATC-40: structural behaviour; FEMA 440: hysteresis model.
    std::vector<std::string> Behaviors() const;
    /// What of the two it is, for the label.
    std::string BehaviorLabel() const;
    /// Kappa by the person's own points: ATC-40 with the user-defined behaviour.
    bool HasUserDamping() const;

    /// The points of kappa in their own window. 1 taken.
    [[nodiscard]] int OnUserDamping();

private:
    bool IsFema440() const { return m_settings.method == PUSH_METHOD::Fema440; }

    const CDBDoc& m_doc;
    T_EVAL_D& m_settings;
};
