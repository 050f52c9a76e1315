// Model of the comparison window: every method on one load case with one spectrum.
#pragma once

#include "qm_rps/dialog/texttable.h"
#include "qm_rps/pushover/evaluation/pushovercomparison.h"

#include <functional>

class CPushOverComparisonDlg : public zql::frx::MDialog {
public:
    /// The document must outlive the dialog.
    explicit CPushOverComparisonDlg(CDBDoc& doc) : m_doc(doc) {}

    std::string m_push, m_spectrum; // names; Update takes the first where there is none such
    int m_behavior = 0;             // 0 to 2: A, B, C

    std::vector<std::string> LoadCases() const;
    std::vector<std::string> Spectra() const;

    /// Compares again. 1 done; 0 refused (Error), comparison as it was.
    int Update();
    const T_PUSH_COMPARISON& Comparison() const { return m_comparison; }
    const std::string& Error() const { return m_error; }
    /// One row per method.
    T_TEXT_TABLE Cells() const;
    /// "2.1 to 3.4 in, mean 2.9, largest / smallest 1.6", and the remarks on it as further lines.
    std::string SpreadText() const;

    /// Says that the picture could not be written, and why.
    void SayNotWritten(const std::string& why) { ShowMessage("IDS_QM_UI_FILE_REFUSED", why); }
    /// Asks for the name of a picture file; empty: cancelled.
    std::function<std::string()> m_askPath;

private:
    CDBDoc& m_doc;
    T_PUSH_COMPARISON m_comparison;
    std::string m_error;
};
