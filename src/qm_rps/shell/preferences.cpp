#include "qm_rps/shell/preferences.h"

#include "qm_base/textformat.h"

#include <array>
#include <optional>

namespace {

constexpr std::array<const char*, kQuantities> kDecimalKeys{
    "decimals/force",        "decimals/moment", "decimals/length",
    "decimals/displacement", "decimals/stress", "decimals/ratio"};
constexpr std::array<const char*, 3> kThemes{"system", "light", "dark"};

/// The value whose name is kept; `out` stays where there is none.
template <class E, class F>
void ReadName(const std::string& kept, E last, F nameOf, E& out)
{
    for (int i = 0; i <= static_cast<int>(last); ++i)
        if (kept == nameOf(static_cast<E>(i))) out = static_cast<E>(i);
}

const char* NameOfTheme(THEME theme)
{
    return kThemes[static_cast<std::size_t>(theme)];
}

std::string_view ForceName(FORCE_UNIT unit)
{
    return NameOf(unit);
}

std::string_view LengthName(LENGTH_UNIT unit)
{
    return NameOf(unit);
}

} // namespace

T_PREFERENCES ReadPreferences(const IPreferenceStore& store)
{
    T_PREFERENCES out;
    if (store.Get("language") == "it") out.language = "it";
    ReadName(store.Get("newUnits/force"), FORCE_UNIT::kips, ForceName, out.newUnits.force);
    ReadName(store.Get("newUnits/length"), LENGTH_UNIT::ft, LengthName, out.newUnits.length);
    ReadName(store.Get("theme"), THEME::Dark, NameOfTheme, out.theme);
    for (std::size_t q = 0; q < kQuantities; ++q) {
        const std::optional<double> kept = ParseFinite(store.Get(kDecimalKeys[q]));
        if (kept && *kept >= 0.0 && *kept <= kMostDecimals)
            out.decimals[q] = static_cast<int>(*kept);
    }
    const std::optional<double> autosave = ParseFinite(store.Get("autosave"));
    if (autosave && *autosave >= kLeastAutosaveS && *autosave <= kMostAutosaveS)
        out.autosaveS = *autosave;
    return out;
}

void WritePreferences(IPreferenceStore& store, const T_PREFERENCES& preferences)
{
    store.Set("language", preferences.language);
    store.Set("newUnits/force", std::string(NameOf(preferences.newUnits.force)));
    store.Set("newUnits/length", std::string(NameOf(preferences.newUnits.length)));
    store.Set("theme", NameOfTheme(preferences.theme));
    for (std::size_t q = 0; q < kQuantities; ++q)
        store.Set(kDecimalKeys[q], std::to_string(preferences.decimals[q]));
    store.Set("autosave", ShortestText(preferences.autosaveS));
}
