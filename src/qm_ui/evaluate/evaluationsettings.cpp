#include "qm_ui/evaluate/evaluationdeskview.h"

#include "qm_base/msgfunction.h"
#include "qm_db/recordfacts.h"
#include "qm_ui/pushover/pushoverfields.h"

#include <algorithm>

namespace {

using MODEL = CEvaluationDeskDlg;

void BuildMethod(CFormView& form, MODEL& m)
{
    T_EVAL_D& s = m.m_settings;
    const auto pushes = [&m] { return m.m_methodPage.LoadCases(); };
    const auto spectra = [&m] { return m.m_demandPage.Spectra(); };
    form.Choice(KeyText("IDS_QM_UI_HEAD_PUSHOVER"), NameRef(s.push, pushes), pushes).name = "push";
    form.Choice(
            KeyText("IDS_QM_UI_HEAD_METHOD"),
            {[&s] { return static_cast<int>(s.method) - static_cast<int>(PUSH_METHOD::Fema440); },
             [&m](const int& i) {
                 m.m_methodPage.ChangeMethod(
                     static_cast<PUSH_METHOD>(i + static_cast<int>(PUSH_METHOD::Fema440)));
             }},
            CPushOverCurveSub1Dlg::Methods)
        .name = "method";
    auto& procedure =
        form.Choice(KeyText("IDS_QM_UI_PUSH_PROCEDURE"),
                    {[&s] { return s.procedure.value_or('A') - 'A'; },
                     [&s](const int& i) { s.procedure = static_cast<char>('A' + i); }},
                    [&m] { return m.m_methodPage.Procedures(); });
    procedure.name = "procedure";
    procedure.shown = [&m] { return !m.m_methodPage.IsTarget(); };
    form.Choice(KeyText("IDS_QM_UI_HEAD_SPECTRUM"), NameRef(s.spectrum, spectra), spectra).name =
        "spectrum";
    form.Button(KeyText("IDS_QM_EVAL_SPECTRUM"), [&m] { (void)m.OnSpectrum(); }).name =
        "editSpectrum";
    form.Choice(KeyText("IDS_QM_UI_PUSH_PLOT"),
                {[&s] { return s.plotType.value_or(static_cast<int>(s.method)); },
                 [&s](const int& i) { s.plotType = i; }},
                CPushOverCurveSub1Dlg::PlotTypes)
        .name = "plotType";
}

void BuildDamping(CFormView& form, MODEL& m)
{
    T_EVAL_D& s = m.m_settings;
    auto& behavior =
        form.Choice([&m] { return m.m_demandPage.BehaviorLabel(); }, OrDefault(s.behavior, 0),
                    [&m] { return m.m_demandPage.Behaviors(); });
    behavior.name = "behavior";
    behavior.shown = [&m] { return !m.m_methodPage.IsTarget(); };
    auto& damping = form.Number(KeyText("IDS_QM_UI_PUSH_ELASTIC_DAMPING"),
                                OrDefault(s.elasticDamping, 5.0), PlainLabel("%"));
    damping.name = "elasticDamping";
    damping.shown = [&m] { return !m.m_methodPage.IsTarget(); };
    auto& user = form.Button(KeyText("IDS_QM_UI_PUSH_USER_DAMPING"), [&m] { m.OnUserDamping(); });
    user.name = "userDamping";
    user.shown = [&m] { return m.m_demandPage.HasUserDamping(); };
    form.Flag(KeyText("IDS_QM_UI_PUSH_EIGEN"), OrDefault(s.eigenFactors, true)).name = "eigen";
    auto& percent =
        form.Flag(KeyText("IDS_QM_UI_PUSH_ALPHA_PCT"), OrDefault(s.alphaInPercent, false));
    percent.name = "alphaInPercent";
    percent.shown = [&m] { return m.m_settings.method == PUSH_METHOD::Fema440; };
    auto& drift = form.Choice(
        KeyText("IDS_QM_UI_PUSH_DRIFT_KIND"),
        {[&s] { return s.driftKind.value_or(1) - 1; }, [&s](const int& i) { s.driftKind = i + 1; }},
        KeyTexts({"IDS_QM_UI_PUSH_DRIFT_1", "IDS_QM_UI_PUSH_DRIFT_2"}));
    drift.name = "driftKind";
    form.Button(KeyText("IDS_QM_UI_PUSH_CONTROL"), [&m] { (void)m.OnControl(); }).name = "control";
    drift.shown = [&m] { return m.m_methodPage.IsTarget(); };
    auto& masonry = form.Flag(KeyText("IDS_QM_UI_PUSH_MASONRY"), {[&m] { return m.IsMasonry(); },
                                                                  [&m, &s](const bool& on) {
                                                                      if (on != m.IsMasonry())
                                                                          s.masonry = on;
                                                                  }});
    masonry.name = "masonry";
    masonry.shown = [&m] { return m.m_settings.method == PUSH_METHOD::Ec8Opcm; };
}

void BuildBilinear(CFormView& form, MODEL& model)
{
    CPushOverCurveSub4Dlg& m = model.m_bilinearPage;
    const auto value = [&m](auto member) {
        using T = std::remove_reference_t<decltype(m.Options().*member)>;
        return T_BINDING<T>{[&m, member] { return m.Options().*member; },
                            [&m, member](const T& v) { m.Options().*member = v; }};
    };
    static const std::vector<std::string> rules{"", "ec8", "ntc", "masonry"};
    form.Choice(KeyText(CPushOverCurveSub4Dlg::kLabels[0]),
                {[&m] {
                     const auto it = std::ranges::find(rules, m.Options().rule.value_or(""));
                     return static_cast<int>(it - rules.begin());
                 },
                 [&m](const int& i) {
                     if (i == 0)
                         m.Options().rule.reset();
                     else
                         m.Options().rule = rules[static_cast<std::size_t>(i)];
                 }},
                KeyTexts({"IDS_QM_UI_PUSH_RULE_OWN", "IDS_QM_UI_PUSH_RULE_EC8",
                          "IDS_QM_UI_PUSH_RULE_NTC", "IDS_QM_UI_PUSH_RULE_MASONRY"}))
        .name = "bilinear.rule";
    form.Note(KeyText(CPushOverCurveSub4Dlg::kLabels[1]));
    form.Optional(KeyText("IDS_QM_UI_PUSH_FRACTION"), value(&T_EVAL_BILINEAR::secant)).name =
        "bilinear.secant";
    form.Choice(KeyText(CPushOverCurveSub4Dlg::kLabels[2]),
                {[&m] { return m.Options().strength == "peak" ? 1 : 0; },
                 [&m](const int& i) {
                     if (i == 1)
                         m.Options().strength = "peak";
                     else
                         m.Options().strength.reset();
                 }},
                KeyTexts({"IDS_QM_UI_PUSH_STRENGTH_RULE", "IDS_QM_UI_PUSH_STRENGTH_PEAK"}))
        .name = "bilinear.strength";
    form.Note(KeyText(CPushOverCurveSub4Dlg::kLabels[3]));
    form.Optional(KeyText("IDS_QM_UI_PUSH_FRACTION"), value(&T_EVAL_BILINEAR::drop)).name =
        "bilinear.drop";
    auto& iterate = form.Flag(KeyText("IDS_QM_UI_PUSH_ITERATE"),
                              {[&m] { return m.Options().iterate.value_or(false); },
                               [&m](const bool& on) { m.Options().iterate = on; }});
    iterate.name = "bilinear.iterate";
    iterate.enabled = [&model] { return model.m_settings.method == PUSH_METHOD::Ec8Opcm; };
}

void BuildShown(CFormView& form, MODEL& m)
{
    T_PUSH_SHOW& s = m.m_show;
    const auto lines = [&s] { return s.guideLines; };
    form.Flag(KeyText("IDS_QM_UI_PUSH_SHOW_LINES"), Ref(s.guideLines)).name = "guideLines";
    form.Flag(KeyText("IDS_QM_UI_PUSH_SHOW_DEMAND"), Ref(s.demandLines)).enabled = lines;
    form.Flag(KeyText("IDS_QM_UI_PUSH_SHOW_CAPACITY"), Ref(s.capacityLines)).enabled = lines;
    form.Flag(KeyText("IDS_QM_UI_PUSH_SHOW_QSTAR"), Ref(s.qStarLine)).enabled = lines;
    form.Flag(KeyText("IDS_QM_UI_PUSH_SHOW_SYMBOLS"), Ref(s.symbols)).name = "symbols";
}

/// A unit of the picture as the position in a list that begins with that of the model.
template <class UNIT, std::size_t N>
CFormField& AddUnit(CFormView& form, const char* caption, std::optional<UNIT>& unit,
                    const std::array<const char*, N>& names)
{
    const auto texts = [&names] {
        std::vector<std::string> all{zql::lib::MMSGFunction::GetValue("IDS_QM_EVAL_OF_MODEL")};
        all.insert(all.end(), names.begin(), names.end());
        return all;
    };
    return form.Choice(KeyText(caption),
                       {[&unit] { return unit ? static_cast<int>(*unit) + 1 : 0; },
                        [&unit](const int& i) {
                            unit = i > 0 ? std::optional(static_cast<UNIT>(i - 1)) : std::nullopt;
                        }},
                       texts);
}

/// Ranges and units of the picture, by the person.
void BuildAxes(CFormView& form, MODEL& m)
{
    struct T_END {
        const char *caption, *name;
        std::optional<double> T_DESK_AXES::*end;
    };
    constexpr T_END kEnds[] = {{"IDS_QM_EVAL_X_FROM", "xFrom", &T_DESK_AXES::xFrom},
                               {"IDS_QM_EVAL_X_TO", "axes.x", &T_DESK_AXES::xTo},
                               {"IDS_QM_EVAL_Y_FROM", "yFrom", &T_DESK_AXES::yFrom},
                               {"IDS_QM_EVAL_Y_TO", "axes.y", &T_DESK_AXES::yTo}};
    form.Note(KeyText("IDS_QM_EVAL_AXES_NOTE"));
    for (const T_END& end : kEnds)
        form.Optional(KeyText(end.caption), Ref(m.m_axes.*end.end)).name = end.name;
    AddUnit(form, "IDS_QM_EVAL_LENGTH", m.m_axes.length, kLengthNames).name = "lengthUnit";
    AddUnit(form, "IDS_QM_EVAL_FORCE", m.m_axes.force, kForceNames).name = "forceUnit";
    form.Button(KeyText("IDS_QM_EVAL_AXES_RESET"), [&m] { m.m_axes = {}; }).name = "resetAxes";
}

} // namespace

void BuildEvaluationSettings(CFormView& form, CEvaluationDeskDlg& m)
{
    form.Page(KeyText("IDS_QM_UI_PUSH_PAGE_METHOD"));
    BuildMethod(form, m);
    BuildDamping(form, m);
    form.Space();
    form.Page(KeyText("IDS_QM_UI_PUSH_PAGE_BILINEAR"), [&m] { return m.m_methodPage.IsTarget(); });
    BuildBilinear(form, m);
    form.Space();
    form.Page(KeyText("IDS_QM_UI_PUSH_PAGE_SHOWN"));
    BuildShown(form, m);
    form.Space();
    form.Page(KeyText("IDS_QM_EVAL_AXES"));
    BuildAxes(form, m);
    form.Space();
    form.EndPages();
}
