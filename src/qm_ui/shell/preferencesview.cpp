#include "qm_ui/shell/preferencesview.h"

#include "qm_base/msgfunction.h"
#include "qm_rps/preferencesdlg.h"

namespace {

using DLG = CPreferencesDlg;

void AddDecimals(CFormView& form, DLG& dlg)
{
    constexpr std::array<const char*, kQuantities> kKeys{
        "IDS_QM_PREF_FORCE",        "IDS_QM_PREF_MOMENT", "IDS_QM_PREF_LENGTH",
        "IDS_QM_PREF_DISPLACEMENT", "IDS_QM_PREF_STRESS", "IDS_QM_PREF_RATIO"};
    form.Group(KeyText("IDS_QM_PREF_DECIMALS"));
    form.Note(KeyText("IDS_QM_PREF_DECIMALS_NOTE"));
    for (std::size_t q = 0; q < kQuantities; ++q) {
        const auto quantity = static_cast<QUANTITY>(q);
        form.Optional(KeyText(kKeys[q]),
                      {[&dlg, quantity] { return dlg.Decimals(quantity); },
                       [&dlg, quantity](const auto& d) { dlg.SetDecimals(quantity, d); }})
            .name = "decimals." + std::to_string(q);
    }
    form.Note([&dlg] { return dlg.Sample(); }).name = "sample";
    form.EndGroup();
}

void Build(CFormView& form, DLG& dlg)
{
    form.Group(KeyText("IDS_QM_PREF_LOOK"));
    form.Choice(KeyText("IDS_QM_PREF_LANGUAGE"),
                {[&dlg] { return dlg.Language(); }, [&dlg](const int& i) { dlg.SetLanguage(i); }},
                DLG::LanguageTexts)
        .name = "language";
    form.Choice(KeyText("IDS_QM_PREF_THEME"), IndexRef(dlg.m_now.theme), DLG::ThemeTexts).name =
        "theme";
    form.EndGroup();
    form.Group(KeyText("IDS_QM_PREF_NEW_UNITS"));
    form.Choice(KeyText("IDS_QM_PREF_FORCE"), IndexRef(dlg.m_now.newUnits.force), DLG::ForceTexts)
        .name = "newForce";
    form.Choice(KeyText("IDS_QM_PREF_LENGTH"), IndexRef(dlg.m_now.newUnits.length),
                DLG::LengthTexts)
        .name = "newLength";
    form.Note(KeyText("IDS_QM_PREF_NEW_UNITS_NOTE"));
    form.EndGroup();
    AddDecimals(form, dlg);
    form.Group(KeyText("IDS_QM_PREF_SAFETY"));
    form.Number(KeyText("IDS_QM_PREF_AUTOSAVE"), Ref(dlg.m_now.autosaveS), PlainLabel("s")).name =
        "autosave";
    form.EndGroup();
    form.Space();
}

} // namespace

void RegisterPreferencesView(CViewFactory& factory)
{
    factory.Register<DLG>(KeyText("IDS_QM_PREF_TITLE"), Build, {.size = {480, 0}});
}
