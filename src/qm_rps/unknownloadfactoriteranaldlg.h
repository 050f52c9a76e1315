// Model of the dialog of the settings of the iterative analysis.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_rps/unknownloadfactoriteranal.h"

class CUnknownLoadFactorIterAnalDlg : public zql::frx::MDialog {
public:
    /// `settings` is not owned and must outlive the dialog.
    explicit CUnknownLoadFactorIterAnalDlg(CUnknownLoadFactorIterAnal& settings);

    std::string m_required;  // edit fields, as typed
    std::string m_tolerance; // likewise

    /// The spin button beside the number: up or down by one, within 0 to 99; a text that is no
    /// number stays.
    void OnSpin(int by);
    int CheckData() override;
    /// Takes the settings over. 0: a message was shown, the settings as they were.
    int OnOK() override;

private:
    bool Read(T_ULF_ITER_SETTINGS& out) const;

    CUnknownLoadFactorIterAnal& m_settings;
};
