#include "qm_rps/hinge/hingepages.h"

#include "qm_base/msgfunction.h"

#include <algorithm>

std::vector<CHingePages::T_PAGE> CHingePages::All() const
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

int CHingePages::Shown() const
{
    return std::clamp(m_page, -1, static_cast<int>(All().size()) - 1);
}

void CHingePages::ShowFirstOf(HINGE_COMPONENT c)
{
    const std::vector<T_PAGE> pages = All();
    const auto at = std::ranges::find(pages, c, &T_PAGE::component);
    if (at != pages.end()) m_page = static_cast<int>(at - pages.begin());
}

const T_SKEL_CURVE* CHingePages::Curve() const
{
    const int index = Shown();
    if (index < 0) return nullptr;
    const T_PAGE page = All()[static_cast<std::size_t>(index)];
    const T_SKEL_CURVE* shown = nullptr;
    ForEachPage(At(m_type, page.component), [&](HINGE_END end, const T_SKEL_CURVE& curve) {
        if (end == page.end) shown = &curve;
    });
    return shown;
}
