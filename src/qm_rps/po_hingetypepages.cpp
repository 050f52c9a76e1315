// What the hinge type editor previews, and its findings.
#include "qm_base/msgfunction.h"
#include "qm_rps/hinge/hingetypefindings.h"
#include "qm_rps/po_hingetypedlg.h"
#include "qm_rps/pushoverhingelistdlg.h"

#include <algorithm>

namespace {

/// A part of the type with an editor of its own.
struct T_PART_EDITOR {
    const char* prefix; // of the fields of its findings
    int (CPO_HingeTypeDlg::*open)();
};
constexpr T_PART_EDITOR kParts[] = {{"yieldSurface.", &CPO_HingeTypeDlg::OnYieldSurfaceDlgDlg},
                                    {"pmm.", &CPO_HingeTypeDlg::OnUserInteractionDlg},
                                    {"masonry.", &CPO_HingeTypeDlg::OnMasonryPropDlg}};

const T_PART_EDITOR* PartOf(const T_FINDING& f)
{
    const auto at = std::ranges::find_if(
        kParts, [&](const T_PART_EDITOR& p) { return f.field.starts_with(p.prefix); });
    return at == std::end(kParts) ? nullptr : at;
}

} // namespace

std::vector<std::string> CPO_HingeTypeDlg::InteractionTexts()
{
    std::vector<std::string> texts;
    for (const HINGE_INTERACTION i : kBendingInteractions)
        texts.push_back(CPushOverHingeListDlg::InteractionText(static_cast<int>(i)));
    return texts;
}

std::string CPO_HingeTypeDlg::FieldOf(const T_FINDING& f)
{
    if (f.part < 0 || PartOf(f)) return f.field;
    const std::string name = kComponentNames.at(static_cast<std::size_t>(f.part));
    return name + (f.field == "type" ? ".type" : ".curve");
}

int CPO_HingeTypeDlg::OnFinding(const T_FINDING& f)
{
    if (const T_PART_EDITOR* part = PartOf(f)) return (this->*part->open)();
    if (f.part < 0) return 0;
    ShowPageOf(ComponentOf(f));
    return OnBtnSkcvProp(ComponentOf(f));
}

std::vector<CPO_HingeTypeDlg::T_PAGE> CPO_HingeTypeDlg::Pages() const
{
    std::vector<T_PAGE> pages;
    for (std::size_t i = 0; i < m_type.components.size(); ++i) {
        const T_HINGE_COMPONENT& c = m_type.components[i];
        if (!c.active) continue;
        ForEachPage(c, [&](HINGE_END end, const T_SKEL_CURVE&) {
            const std::string title = zql::lib::MMSGFunction::GetValue(PageTitleKey(c, end));
            pages.push_back({static_cast<HINGE_COMPONENT>(i), end,
                             std::string(kComponentNames[i]) + ": " + title});
        });
    }
    return pages;
}

int CPO_HingeTypeDlg::Page() const
{
    return std::clamp(m_page, -1, static_cast<int>(Pages().size()) - 1);
}

void CPO_HingeTypeDlg::ShowPageOf(HINGE_COMPONENT c)
{
    const std::vector<T_PAGE> pages = Pages();
    const auto at = std::ranges::find(pages, c, &T_PAGE::component);
    if (at != pages.end()) m_page = static_cast<int>(at - pages.begin());
}

const T_SKEL_CURVE* CPO_HingeTypeDlg::PageCurve() const
{
    const int index = Page();
    if (index < 0) return nullptr;
    const T_PAGE page = Pages()[static_cast<std::size_t>(index)];
    const T_SKEL_CURVE* shown = nullptr;
    ForEachPage(m_type.components[static_cast<std::size_t>(page.component)],
                [&](HINGE_END end, const T_SKEL_CURVE& curve) {
                    if (end == page.end) shown = &curve;
                });
    return shown;
}

std::vector<T_FINDING> CPO_HingeTypeDlg::Findings() const
{
    std::vector<T_FINDING> out;
    if (std::ranges::find(m_otherNames, m_type.name) != m_otherNames.end())
        out.push_back(
            FindingOf({.message = "IDS_QM_UI_HINGE_NAME_TAKEN", .field = "name"}, T_RULE_PLACE{}));
    for (T_FINDING& f : TypeFindings(m_type, m_context))
        out.push_back(std::move(f));
    return out;
}

CPO_HingeTypeDlg::T_REF_LIST CPO_HingeTypeDlg::InitPropCombo_Matl() const
{
    T_REF_LIST list;
    if (!m_context.sources) return list;
    for (const auto& [key, material] : m_context.sources->Materials())
        list.push_back({key, std::to_string(key) + " : " + material.name});
    return list;
}
