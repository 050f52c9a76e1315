#include "qm_base/msgfunction.h"
#include "qm_rps/hingeoptionsdlg.h"
#include "qm_ui/hinge/hingefieldsview.h"
#include "qm_ui/hinge/hingeviews.h"

#include <algorithm>

namespace {

using DLG = CHingeOptionsDlg;

/// A design code among those offered.
CFormField& AddCode(CFormView& form, const char* key, std::string& code,
                    std::vector<std::string> (*offered)(const std::string&))
{
    return form.Choice(
        KeyText(key),
        {[&code, offered] {
             const auto codes = offered(code);
             return static_cast<int>(std::ranges::find(codes, code) - codes.begin());
         },
         [&code, offered](const int& i) { code = offered(code).at(static_cast<std::size_t>(i)); }},
        [&code, offered] {
            std::vector<std::string> texts = offered(code);
            texts.front() = zql::lib::MMSGFunction::GetValue("IDS_QM_UI_HINGE_NONE");
            return texts;
        });
}

void BuildOptions(CFormView& form, DLG& dlg)
{
    form.SetFindings([&dlg] { return dlg.Findings(); });
    form.Group(KeyText("IDS_QM_UI_HINGE_CODES"));
    AddCode(form, "IDS_QM_UI_HINGE_CODE_CONCRETE", dlg.m_concreteCode, DLG::ConcreteCodes).name =
        "concrete";
    AddCode(form, "IDS_QM_UI_HINGE_CODE_STEEL", dlg.m_steelCode, DLG::SteelCodes).name = "steel";
    form.Note([&dlg] { return dlg.ModeText(); }).name = "mode";
    form.EndGroup();
    form.Group(KeyText("IDS_QM_UI_HINGE_MODELS"));
    form.Flag(KeyText("IDS_QM_UI_HINGE_ALT"), Ref(dlg.m_alternativeHysteresis)).name =
        "alternativeHysteresis";
    const auto alternative = [&dlg] { return dlg.m_alternativeHysteresis; };
    Set(form.Flag(KeyText("IDS_QM_UI_HINGE_WALL_DEG"), Ref(dlg.m_wallStrengthDegradation)),
        "wallStrengthDegradation", alternative);
    Set(form.Flag(KeyText("IDS_QM_UI_HINGE_GSD"), Ref(dlg.m_gsd)), "gsd", alternative);
    form.EndGroup();
    form.Group(KeyText("IDS_QM_UI_HINGE_DEFAULT_RATIOS"));
    form.Cells({{}, PlainLabel("(+)"), PlainLabel("(-)")});
    const std::pair<const char*, std::array<double, 2>*> rows[] = {
        {"IDS_QM_UI_HINGE_ALPHA1", &dlg.m_alpha1}, {"IDS_QM_UI_HINGE_ALPHA2", &dlg.m_alpha2}};
    for (const auto& [key, values] : rows) {
        const std::string field = values == &dlg.m_alpha1 ? "alpha1." : "alpha2.";
        form.Note(KeyText(key));
        form.Number(KeyText(key), Ref((*values)[0])).name = field + "pos";
        form.Number(KeyText(key), Ref((*values)[1])).name = field + "neg";
    }
    form.EndCells();
    form.EndGroup();
}

} // namespace

void RegisterHingeOptionsView(CViewFactory& factory)
{
    factory.Register<DLG>(KeyText("IDS_QM_UI_HINGE_OPTIONS_TITLE"), BuildOptions,
                          {.size = {520, 0}});
}
