#include "qm_db/membctrl.h"

#include <cmath>
#include <optional>

namespace {

std::optional<double> LengthOf(const T_MODEL& model, const T_ELEM_D& element)
{
    const auto i = model.nodes.find(element.nodeI);
    const auto j = model.nodes.find(element.nodeJ);
    if (i == model.nodes.end() || j == model.nodes.end()) return std::nullopt;
    const auto& a = i->second.xyz;
    const auto& b = j->second.xyz;
    return std::hypot(b[0] - a[0], b[1] - a[1], b[2] - a[2]);
}

} // namespace

int CMembCtrl::GetMembLengByIncludeElem(int element, double& length) const
{
    const T_MODEL& model = m_data.Model();
    const auto it = model.elements.find(element);
    if (it == model.elements.end()) return 0;
    const int member = it->second.member;
    double sum = 0.0; // m
    for (const auto& [id, other] : model.elements) {
        if (id != element && (member == 0 || other.member != member)) continue;
        const auto part = LengthOf(model, other);
        if (!part) return 0;
        sum += *part;
    }
    const double out = FromSi(sum, m_data.Units(), kDimLength);
    if (!std::isfinite(out)) return 0;
    length = out;
    return 1;
}
