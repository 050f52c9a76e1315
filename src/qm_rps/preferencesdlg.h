// Model of the dialog of the preferences: what holds for every model, not kept in any.
#pragma once

#include "qm_base/checkeddialog.h"
#include "qm_rps/shell/preferences.h"

#include <functional>
#include <optional>

class CPreferencesDlg : public CCheckedDialog {
public:
    /// The store must outlive the dialog.
    explicit CPreferencesDlg(IPreferenceStore& store);

    T_PREFERENCES m_now; // as the dialog has them

    /// Decimals of a quantity; empty: all digits.
    std::optional<double> Decimals(QUANTITY quantity) const;
    void SetDecimals(QUANTITY quantity, const std::optional<double>& decimals);
    /// Languages that can be chosen, in their own words, and the position of the one chosen.
    static std::vector<std::string> LanguageTexts();
    int Language() const;
    void SetLanguage(int index);
    static std::vector<std::string> ThemeTexts();
    static std::vector<std::string> ForceTexts();
    static std::vector<std::string> LengthTexts();
    /// A number as a table would show it, "1234.5678 kN -> 1234.57".
    std::string Sample() const;

    /// Decimals are whole numbers from 0 to 12, the time between copies 5 s to an hour.
    std::vector<T_FINDING> Findings() const override;
    /// Checks, keeps and applies them. 0: refused, nothing changed.
    int OnOK() override;
    /// Called with what was kept; the application follows at once.
    std::function<void(const T_PREFERENCES&)> m_apply;

private:
    IPreferenceStore& m_store;
    std::array<std::optional<double>, kQuantities> m_decimals; // as typed
};
