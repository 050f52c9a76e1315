#include "qm_base/msgfunction.h"
#include "qm_rps/preferencesdlg.h"

#include <gtest/gtest.h>

#include <map>

namespace {

class CMapStore : public IPreferenceStore {
public:
    std::map<std::string, std::string> m_kept;
    std::string Get(const std::string& key) const override
    {
        const auto it = m_kept.find(key);
        return it == m_kept.end() ? std::string() : it->second;
    }
    void Set(const std::string& key, const std::string& value) override { m_kept[key] = value; }
};

} // namespace

TEST(Preferences, WhatIsKeptComesBackAndRubbishIsAsInANewInstallation)
{
    CMapStore store;
    EXPECT_EQ(T_PREFERENCES(), ReadPreferences(store));
    T_PREFERENCES chosen;
    chosen.language = "it";
    chosen.newUnits = {FORCE_UNIT::kips, LENGTH_UNIT::ft};
    chosen.decimals = {0, 1, 2, 3, kAllDigits, kMostDecimals};
    chosen.theme = THEME::Dark;
    chosen.autosaveS = 7.5;
    WritePreferences(store, chosen);
    EXPECT_EQ(chosen, ReadPreferences(store));
    for (auto& [key, value] : store.m_kept)
        value = "nan";
    EXPECT_EQ(T_PREFERENCES(), ReadPreferences(store));
    store.m_kept = {{"autosave", "1e9"}, {"decimals/force", "99"}, {"theme", "pink"}};
    EXPECT_EQ(T_PREFERENCES(), ReadPreferences(store));
}

TEST(Preferences, ARefusedValueIsNamedAndNothingIsKept)
{
    CMapStore store;
    CPreferencesDlg dialog(store);
    int applied = 0;
    dialog.m_apply = [&](const T_PREFERENCES&) { ++applied; };
    dialog.SetDecimals(QUANTITY::Stress, 2.5);
    dialog.m_now.autosaveS = 1.0;
    const std::vector<T_FINDING> findings = dialog.Findings();
    ASSERT_EQ(2U, findings.size());
    EXPECT_EQ("decimals.4", findings[0].field);
    EXPECT_EQ("autosave", findings[1].field);
    EXPECT_EQ(0, dialog.OnOK());
    EXPECT_TRUE(store.m_kept.empty());
    dialog.SetDecimals(QUANTITY::Stress, 2.0);
    dialog.m_now.autosaveS = 5.0;
    EXPECT_EQ(1, dialog.OnOK());
    EXPECT_EQ(1, applied);
    EXPECT_EQ(2, ReadPreferences(store).decimals[static_cast<std::size_t>(QUANTITY::Stress)]);
}

TEST(Decimals, TheHeadSaysWhatANumberIsOf)
{
    const std::pair<const char*, QUANTITY> cases[] = {
        {"V (kN)", QUANTITY::Force},
        {"Base reaction [kips]", QUANTITY::Force},
        {"My (kN m)", QUANTITY::Moment},
        {"X (m)", QUANTITY::Length},
        {"Displacement of the control node (in)", QUANTITY::Displacement},
        {"E (kN/m2)", QUANTITY::Stress},
        {"fy (MPa)", QUANTITY::Stress},
        {"Damping (%)", QUANTITY::Ratio},
        {"q (kN/m)", QUANTITY::Count},
        {"I (m4)", QUANTITY::Count},
        {"Name", QUANTITY::Count},
        {"", QUANTITY::Count},
    };
    for (const auto& [head, quantity] : cases)
        EXPECT_EQ(quantity, QuantityOf(head)) << head;
    ASSERT_TRUE(zql::lib::MMSGFunction::SetLanguage("it"));
    EXPECT_EQ(QUANTITY::Displacement, QuantityOf("Spostamento (mm)"));
    (void)zql::lib::MMSGFunction::SetLanguage("en");
}

TEST(Decimals, NothingIsShownAsZeroThatIsNot)
{
    struct T_CASE {
        const char* number;
        int decimals;
        const char* shown;
    };
    const T_CASE cases[] = {
        {"1234.5678", 2, "1234.57"},
        {"1234.5678", 0, "1235"},
        {"-0.5", 1, "-0.5"},
        {"0.00042", 2, "4.2e-04"},
        {"-0.00042", 2, "-4.2e-04"},
        {"0", 2, "0.00"},
        {"-0", 1, "0.0"},
        {"2", kAllDigits, "2"},
        {"text", 2, "text"},
        {"nan", 2, "nan"},
        {"0.0050", 2, "0.01"},
        {"1e-30", 12, "1.0e-30"},
    };
    for (const T_CASE& c : cases)
        EXPECT_EQ(c.shown, WithDecimals(c.number, c.decimals)) << c.number;
}
