#include "qm_solver/frame/framedofs.h"

#include "qm_solver/model/fine.h"

#include <algorithm>

namespace solver {

namespace {

void Touch(std::vector<char>& touched, std::size_t node, const T_DIRS6& directions)
{
    for (std::size_t d = 0; d < 6; ++d)
        if (directions[d]) touched[6 * node + d] = 1;
}

/// By full index: 1 where an attached element can give stiffness.
std::vector<char> Touched(const T_FRAME& frame)
{
    std::vector<char> touched(6 * frame.nodes.size(), 0);
    for (const T_ELEMENT& element : frame.elements) {
        const T_DIRS6 acts = ActsOn(element);
        Touch(touched, element.i, acts);
        if (element.kind != ELEMENT_KIND::Spring) Touch(touched, element.j, acts);
    }
    return touched;
}

} // namespace

T_DIRS6 ActsOn(const T_ELEMENT& element)
{
    switch (element.kind) {
    case ELEMENT_KIND::Beam:
        return {true, true, true, true, true, true};
    case ELEMENT_KIND::Truss:
        return {true, true, true, false, false, false};
    case ELEMENT_KIND::Link:
    case ELEMENT_KIND::Spring:
        break;
    }
    T_DIRS6 acts{};
    for (std::size_t d = 0; d < 6; ++d)
        acts[d] = element.stiffness[d] > 0.0;
    return acts;
}

CFrameDofs::CFrameDofs(const T_FRAME& frame) : m_nodes(frame.nodes.size())
{
    const CConstraints constraints(frame);
    m_demands = constraints.Demands();
    const auto fixed = [&](std::size_t full) { return frame.nodes[full / 6].fixed[full % 6]; };

    // An independent direction is active when a touched displacement depends on it.
    const std::vector<char> touched = Touched(frame);
    std::vector<char> active = touched;
    for (std::size_t full = 0; full < FullCount(); ++full)
        if (const T_RELATION* made = constraints.Expression(static_cast<int>(full))) {
            active[full] = 0;
            for (const T_TERM& t : *made)
                if (touched[full]) active[static_cast<std::size_t>(t.index)] = 1;
        }
    std::vector<int> equation(FullCount(), -1);
    for (std::size_t full = 0; full < FullCount(); ++full) {
        if (!active[full] || fixed(full) || constraints.Expression(static_cast<int>(full)))
            continue;
        equation[full] = static_cast<int>(m_owner.size());
        const bool sameNode = !m_owner.empty() && m_owner.back() / 6 == full / 6;
        m_block.push_back(m_block.empty() ? 0 : m_block.back() + (sameNode ? 0 : 1));
        m_owner.push_back(full);
    }

    m_inactive.assign(FullCount(), 0);
    for (std::size_t full = 0; full < FullCount(); ++full) {
        const T_RELATION self{{static_cast<int>(full), 1.0}};
        const T_RELATION* made = constraints.Expression(static_cast<int>(full));
        for (const T_TERM& t : made ? *made : self) {
            const std::size_t source = static_cast<std::size_t>(t.index);
            if (fixed(source))
                m_fixedTerms.terms.push_back(t);
            else if (equation[source] >= 0)
                m_terms.terms.push_back({equation[source], t.factor});
            else
                m_inactive[full] = 1;
        }
        m_terms.Close();
        m_fixedTerms.Close();
    }
}

void CFrameDofs::Expand(std::span<const double> q, std::span<double> full) const
{
    for (std::size_t i = 0; i < FullCount(); ++i) {
        double sum = 0.0;
        for (const T_TERM& t : Terms(i))
            sum += t.factor * q[static_cast<std::size_t>(t.index)];
        full[i] = sum;
    }
}

void CFrameDofs::Expand(std::span<const double> q, std::span<const double> rest,
                        std::span<double> full, std::span<double> fullRest) const
{
    for (std::size_t i = 0; i < FullCount(); ++i) {
        CFine sum;
        for (const T_TERM& t : Terms(i)) {
            const auto at = static_cast<std::size_t>(t.index);
            sum = sum + (CFine(q[at]) + rest[at]) * t.factor;
        }
        full[i] = sum.Value();
        fullRest[i] = sum.Rest();
    }
}

void CFrameDofs::Reduce(std::span<const double> full, std::span<double> q) const
{
    for (std::size_t i = 0; i < FullCount(); ++i)
        for (const T_TERM& t : Terms(i))
            q[static_cast<std::size_t>(t.index)] += t.factor * full[i];
}

} // namespace solver
