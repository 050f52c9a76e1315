#include "qm_rps/preferencesdlg.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"

#include <cmath>

namespace {

using zql::lib::MMSGFunction;

constexpr std::array<const char*, 2> kLanguages{"en", "it"};

template <class E>
std::vector<std::string> NamesUpTo(E last)
{
    std::vector<std::string> names;
    for (int i = 0; i <= static_cast<int>(last); ++i)
        names.emplace_back(NameOf(static_cast<E>(i)));
    return names;
}

T_FINDING Finding(std::string field, const char* key, const std::string& least,
                  const std::string& most)
{
    T_FINDING finding;
    finding.field = std::move(field);
    finding.messageKey = finding.ruleText = key;
    finding.text = MMSGFunction::Format(key, {least, most});
    return finding;
}

bool IsAllowed(const std::optional<double>& decimals)
{
    return !decimals ||
           (*decimals >= 0.0 && *decimals <= kMostDecimals && *decimals == std::floor(*decimals));
}

} // namespace

CPreferencesDlg::CPreferencesDlg(IPreferenceStore& store)
    : m_now(ReadPreferences(store)), m_store(store)
{
    for (std::size_t q = 0; q < kQuantities; ++q)
        if (m_now.decimals[q] != kAllDigits) m_decimals[q] = m_now.decimals[q];
}

std::optional<double> CPreferencesDlg::Decimals(QUANTITY quantity) const
{
    return m_decimals.at(static_cast<std::size_t>(quantity));
}

void CPreferencesDlg::SetDecimals(QUANTITY quantity, const std::optional<double>& decimals)
{
    const auto q = static_cast<std::size_t>(quantity);
    m_decimals.at(q) = decimals;
    if (IsAllowed(decimals))
        m_now.decimals[q] = decimals ? static_cast<int>(*decimals) : kAllDigits;
}

std::vector<std::string> CPreferencesDlg::LanguageTexts()
{
    return {"English", "Italiano"};
}

int CPreferencesDlg::Language() const
{
    return m_now.language == kLanguages[1] ? 1 : 0;
}

void CPreferencesDlg::SetLanguage(int index)
{
    m_now.language = kLanguages.at(static_cast<std::size_t>(index));
}

std::vector<std::string> CPreferencesDlg::ThemeTexts()
{
    return {MMSGFunction::GetValue("IDS_QM_PREF_THEME_SYSTEM"),
            MMSGFunction::GetValue("IDS_QM_PREF_THEME_LIGHT"),
            MMSGFunction::GetValue("IDS_QM_PREF_THEME_DARK")};
}

std::vector<std::string> CPreferencesDlg::ForceTexts()
{
    return NamesUpTo(FORCE_UNIT::kips);
}

std::vector<std::string> CPreferencesDlg::LengthTexts()
{
    return NamesUpTo(LENGTH_UNIT::ft);
}

std::string CPreferencesDlg::Sample() const
{
    constexpr double kForce = 1234.56789, kLength = 0.012345678;
    const auto shown = [this](double value, QUANTITY quantity) {
        return WithDecimals(ShortestText(value),
                            m_now.decimals[static_cast<std::size_t>(quantity)]);
    };
    return MMSGFunction::Format("IDS_QM_PREF_SAMPLE", {shown(kForce, QUANTITY::Force),
                                                       shown(kLength, QUANTITY::Displacement)});
}

std::vector<T_FINDING> CPreferencesDlg::Findings() const
{
    std::vector<T_FINDING> out;
    for (std::size_t q = 0; q < kQuantities; ++q)
        if (!IsAllowed(m_decimals[q]))
            out.push_back(Finding("decimals." + std::to_string(q), "IDS_QM_PREF_BAD_DECIMALS", "0",
                                  std::to_string(kMostDecimals)));
    if (!(m_now.autosaveS >= kLeastAutosaveS && m_now.autosaveS <= kMostAutosaveS))
        out.push_back(Finding("autosave", "IDS_QM_PREF_BAD_AUTOSAVE", ShortestText(kLeastAutosaveS),
                              ShortestText(kMostAutosaveS)));
    return out;
}

int CPreferencesDlg::OnOK()
{
    if (!CheckData()) return 0;
    WritePreferences(m_store, m_now);
    if (m_apply) m_apply(m_now);
    return 1;
}
