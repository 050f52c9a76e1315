// Model of the window that makes a model of a pasted capacity curve: the text, masses and heights,
// shape, spectrum and method; what was read and what follows, live.
#pragma once

#include "qm_base/checkeddialog.h"
#include "qm_db/dbdoc.h"
#include "qm_rps/create/curvecase.h"
#include "qm_rps/create/spectrumedit.h"

#include <functional>

class CCurveWizardDlg : public CCheckedDialog {
public:
    /// The document must outlive the dialog.
    explicit CCurveWizardDlg(CDBDoc& doc) : m_doc(doc) {}

    // ---- what is given; OnChange after each change ----
    T_CURVE_TEXT m_curve;
    std::string m_title;
    T_UNITS m_units;
    std::string m_masses, m_heights, m_typedShape; // lists: "100, 100, 90" or "3x100"
    MASS_GIVEN m_massGiven = MASS_GIVEN::Tonnes;
    bool m_isTotal = false;
    SHAPE_GIVEN m_shape = SHAPE_GIVEN::Heights;
    CSpectrumEdit m_spectrum;
    std::vector<T_CURVE_METHOD> m_methods; // empty: the one that goes with the spectrum
    void OnChange() { m_isRead = false; }

    /// The method that goes with the spectrum first, then every method with each procedure.
    static std::vector<std::string> MethodTexts();
    int MethodIndex() const; // of the first method
    void OnMethod(int index);
    /// What the numbers of the masses may be, with the units that were chosen.
    std::vector<std::string> MassTexts() const;
    /// Takes a file as the text. 0 with a message, or cancelled.
    int OnFile();
    std::function<std::string()> m_askFile; // set by the application; empty text: cancelled

    // ---- what follows ----
    /// Null while something is missing or wrong.
    const T_CURVE_FACTS* Facts();
    /// The curve as it was read, also where masses are missing; null: the text can't be read.
    const T_CURVE_READ* Read();
    /// Line, V, d and the storeys of each point, with units.
    T_TEXT_TABLE Points();
    /// Storey, height, mass, shape.
    T_TEXT_TABLE Storeys();
    /// How it was read and what follows; or what is missing.
    std::string NotesText();
    /// The command that makes the same case; empty while there is none.
    std::string CommandText();
    std::vector<T_FINDING> Findings() const override;

    /// Asked before the open model goes; 0: it stays. Set by the application.
    std::function<int()> m_mayReplace;
    /// Puts the case into the document in place of what it has. 0: refused, or the open model was
    /// to stay.
    int OnOK() override;
    /// The first evaluation of the case that was made; empty: none was.
    const std::string& Evaluation() const { return m_evaluation; }

private:
    [[nodiscard]] int Ask(T_CURVE_CASE& out, T_FINDING& fault) const;
    void Update() const;

    CDBDoc& m_doc;
    std::string m_evaluation, m_file;
    mutable bool m_isRead = false;
    mutable bool m_isMade = false;
    mutable T_CURVE_FACTS m_facts;
    mutable T_CURVE_CASE m_case;
    mutable T_MODEL_CONTENT m_content;
    mutable T_FINDING m_fault;
    mutable std::optional<T_CURVE_READ> m_read;
};
