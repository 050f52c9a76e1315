#include "qm_base/textformat.h"
#include "qm_rps/materialdlg.h"
#include "qm_ui/section/structurefields.h"
#include "qm_ui/section/structureviews.h"

#include <algorithm>
#include <array>

namespace {

using CLASS = MATL_CLASS;

/// Whether the material is of one of these classes.
std::function<bool()> Is(const CMaterialDlg& d, std::initializer_list<CLASS> classes)
{
    return [&d, all = std::vector(classes)] {
        return std::ranges::find(all, d.m_material.type) != all.end();
    };
}

void AddGrades(CFormView& form, CMaterialDlg& d)
{
    const std::tuple<const char*, GRADE_OF, const char*> grades[] = {
        {"IDS_QM_UI_MATL_GRADE_STEEL", GRADE_OF::Steel, "gradeSteel"},
        {"IDS_QM_UI_MATL_GRADE_CONCRETE", GRADE_OF::Concrete, "gradeConcrete"},
        {"IDS_QM_UI_MATL_GRADE_BARS", GRADE_OF::Bars, "gradeBars"}};
    for (const auto& [key, of, name] : grades) {
        CFormField& field = form.Choice(KeyText(key),
                                        {[&d, of = of] { return d.GradeIndex(of); },
                                         [&d, of = of](const int& index) { d.OnGrade(of, index); }},
                                        [of = of] { return CMaterialDlg::GradeTexts(of); });
        field.name = name;
        field.shown = [&d, of = of] { return d.TakesGrades(of); };
    }
    CFormField& note = form.Note([&d] { return d.GradeNote(); });
    note.shown = [&d] { return !d.GradeNote().empty(); };
}

void AddValues(CFormView& form, CMaterialDlg& d)
{
    constexpr T_DIM kDensity{1, -4};
    T_MATL_D& m = d.m_material;
    form.Page(KeyText("IDS_QM_UI_MATL_VALUES"));
    AddGrades(form, d);
    form.Number(Head(d, "IDS_QM_UI_MATL_E", kDimStress), Ref(m.E)).name = "E";
    form.Number(KeyText("IDS_QM_UI_MATL_NU"), Ref(m.nu)).name = "nu";
    form.Optional(Head(d, "IDS_QM_UI_MATL_G", kDimStress), Ref(m.G)).name = "G";
    form.Number(Head(d, "IDS_QM_UI_MATL_DENSITY", kDensity), Ref(m.density)).name = "density";
    form.Number(KeyText("IDS_QM_UI_MATL_ALPHA"), Ref(m.alpha)).name = "alpha";
    const auto bars = Is(d, {CLASS::Concrete, CLASS::Composite});
    const std::tuple<const char*, double*, const char*, std::function<bool()>> strengths[] = {
        {"IDS_QM_UI_MATL_FY", &m.Fy, "fy", Is(d, {CLASS::Steel, CLASS::Composite})},
        {"IDS_QM_UI_MATL_FCK", &m.fck, "fck",
         Is(d, {CLASS::Concrete, CLASS::Composite, CLASS::Masonry})},
        {"IDS_QM_UI_MATL_FYK", &m.fyk, "fyk", bars},
        {"IDS_QM_UI_MATL_ES", &m.Es, "Es", bars}};
    for (const auto& [key, value, name, shown] : strengths) {
        CFormField& field = form.Number(Head(d, key, kDimStress), Ref(*value));
        field.name = name;
        field.shown = shown;
    }
    form.Space();
}

/// The same member is called otherwise in one class.
TextFn MeanHead(const CMaterialDlg& d, const char* key, const char* other, CLASS of)
{
    return [&d, key, other, of] {
        return HeadWithUnit(Say(d.m_material.type == of ? other : key), kDimStress, d.Units());
    };
}

void AddMeans(CFormView& form, CMaterialDlg& d)
{
    form.Flag(KeyText("IDS_QM_UI_MATL_HAS_MEAN"),
              {[&d] { return d.HasMean(); }, [&d](const bool& on) { d.OnMean(on); }})
        .name = "hasMean";
    using M = T_MATL_MEAN;
    const std::tuple<TextFn, double M::*, const char*, std::function<bool()>> means[] = {
        {MeanHead(d, "IDS_QM_UI_MATL_FCM", "IDS_QM_UI_MATL_FM", CLASS::Masonry), &M::fc, "mean.fc",
         Is(d, {CLASS::Concrete, CLASS::Composite, CLASS::Masonry})},
        {MeanHead(d, "IDS_QM_UI_MATL_FYM", "IDS_QM_UI_MATL_FYSM", CLASS::Steel), &M::fy, "mean.fy",
         Is(d, {CLASS::Concrete, CLASS::Composite, CLASS::Steel})},
        {Head(d, "IDS_QM_UI_MATL_FYWM", kDimStress), &M::fyw, "mean.fyw",
         Is(d, {CLASS::Concrete, CLASS::Composite})}};
    for (const auto& [head, member, name, shown] : means) {
        CFormField& field = form.Number(head, PartRef(d.m_material.mean, member));
        field.name = name;
        field.enabled = [&d] { return d.HasMean(); };
        field.shown = shown;
    }
}

void AddKnown(CFormView& form, CMaterialDlg& d)
{
    form.Page(KeyText("IDS_QM_UI_MATL_EXISTING"));
    AddMeans(form, d);
    auto& knowledge = d.m_material.knowledge;
    form.Choice(KeyText("IDS_QM_UI_MATL_KNOWLEDGE"),
                {[&knowledge] { return knowledge ? static_cast<int>(*knowledge) + 1 : 0; },
                 [&knowledge](const int& index) {
                     knowledge.reset();
                     if (index > 0) knowledge = static_cast<MATL_KNOWLEDGE>(index - 1);
                 }},
                [] {
                    std::vector<std::string> texts{Say("IDS_QM_UI_MATL_UNKNOWN")};
                    for (const char* key :
                         {"IDS_QM_UI_MATL_KL1", "IDS_QM_UI_MATL_KL2", "IDS_QM_UI_MATL_KL3"})
                        texts.push_back(Say(key));
                    return texts;
                })
        .name = "knowledge";
    form.Optional(KeyText("IDS_QM_UI_MATL_CF"), Ref(d.m_material.confidence)).name =
        "confidence_factor";
    form.Note([&d] {
        const std::optional<double> factor = d.Confidence();
        return factor ? Say("IDS_QM_UI_MATL_CF_USED", FormatText("%.4g", *factor))
                      : Say("IDS_QM_UI_MATL_CF_NONE");
    });
    form.Note(KeyText("IDS_QM_UI_MATL_NOTE"));
    form.Space();
}

void AddMasonry(CFormView& form, CMaterialDlg& d)
{
    form.Page(KeyText("IDS_QM_UI_MATL_MASONRY_SHEAR"), Is(d, {CLASS::Masonry}));
    form.Flag(KeyText("IDS_QM_UI_MATL_HAS_MASONRY"),
              {[&d] { return d.HasMasonry(); }, [&d](const bool& on) { d.OnMasonry(on); }})
        .name = "hasMasonry";
    using M = T_MATL_MASONRY;
    auto& masonry = d.m_material.masonry;
    const auto add = [&d](CFormField& field, const char* name) {
        field.name = std::string("masonry.") + name;
        field.enabled = [&d] { return d.HasMasonry(); };
    };
    const std::tuple<const char*, double M::*, const char*> strengths[] = {
        {"IDS_QM_UI_MATL_TAU0", &M::tau0, "tau0"},
        {"IDS_QM_UI_MATL_FV0", &M::fv0, "fv0"},
        {"IDS_QM_UI_MATL_FB", &M::fb, "fb"}};
    for (const auto& [key, member, name] : strengths)
        add(form.Number(Head(d, key, kDimStress), PartRef(masonry, member)), name);
    const T_BINDING<BOND_KIND> bond = PartRef(masonry, &M::bond);
    add(form.Choice(KeyText("IDS_QM_UI_MATL_BOND"),
                    {[bond] { return static_cast<int>(bond.get()); },
                     [bond](const int& index) { bond.set(static_cast<BOND_KIND>(index)); }},
                    KeyTexts({"IDS_QM_UI_MATL_BOND_IRREGULAR", "IDS_QM_UI_MATL_BOND_REGULAR"})),
        "bond");
    add(form.Number(KeyText("IDS_QM_UI_MATL_INTERLOCKING"), PartRef(masonry, &M::interlocking)),
        "interlocking");
    add(form.Flag(KeyText("IDS_QM_UI_MATL_HOLLOW"), PartRef(masonry, &M::hollowBlocks)),
        "hollow_blocks");
    form.Space();
}

void BuildMaterial(CFormView& form, CMaterialDlg& d)
{
    AddChoice(form, d, "IDS_QM_UI_HEAD_MATERIAL");
    form.Text(KeyText("IDS_QM_UI_HEAD_NAME"), Ref(d.m_material.name)).name = "name";
    form.Choice(KeyText("IDS_QM_UI_HEAD_CLASS"), IndexRef(d.m_material.type),
                KeyTexts({"IDS_QM_UI_MATL_CONCRETE", "IDS_QM_UI_MATL_STEEL",
                          "IDS_QM_UI_MATL_COMPOSITE", "IDS_QM_UI_MATL_MASONRY"}))
        .name = "type";
    AddValues(form, d);
    AddKnown(form, d);
    AddMasonry(form, d);
    form.EndPages();
    form.SetFindings([&d] { return d.Findings(); });
    form.m_isChanged = [&d] { return d.IsChanged(); };
}

} // namespace

void RegisterMaterialForm(CViewFactory& factory)
{
    factory.Register<CMaterialDlg>(KeyText("IDS_QM_UI_MATL_TITLE"), BuildMaterial,
                                   {.size = {560, 0}});
}
