#include "qm_rps/hinge/axialforcelist.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"

#include <algorithm>
#include <cmath>

namespace {

/// These texts are the program's own literals; the literal stands for the key.
zql::frx::T_MESSAGE Refused(const char* literal, double axial)
{
    std::string text = literal;
    text.replace(text.find("%g"), 2, FormatText("%g", axial));
    return {literal, text};
}

constexpr const char* kExists = "Axial Force %g already exists!";
constexpr const char* kGone = "Axial Force %g does not exist!";
constexpr const char* kOldGone = "Old Axial Force %g does not exist!";

} // namespace

CAxialForceList::CAxialForceList(const std::vector<T_SKEL_AXIAL>& curves,
                                 std::optional<T_RANGE> range)
    : m_given(curves), m_range(range)
{
    for (std::size_t i = 0; i < curves.size(); ++i)
        m_rows.push_back({curves[i].axial, static_cast<int>(i)});
    Sort();
}

std::vector<T_SKEL_AXIAL> CAxialForceList::Curves(const T_SIDES<T_SKEL_SIDE>& fresh) const
{
    std::vector<T_SKEL_AXIAL> curves;
    curves.reserve(m_rows.size());
    for (const T_ROW& r : m_rows)
        curves.push_back(
            {r.axial, r.source < 0 ? fresh : m_given[static_cast<std::size_t>(r.source)].sides});
    return curves;
}

CAxialForceList::REFUSAL CAxialForceList::OutOfRange(double axial) const
{
    constexpr const char* key = "IDS_RPS_PO_FEMA_AXIALFORE_OUTOFRANGE";
    const bool inside = !m_range || (m_range->lowest <= axial && axial <= m_range->highest);
    if (std::isfinite(axial) && inside) return std::nullopt;
    std::string text = zql::lib::MMSGFunction::GetValue(key);
    if (m_range) text += FormatText(" [%g, %g]", m_range->lowest, m_range->highest);
    return zql::frx::T_MESSAGE{key, text};
}

CAxialForceList::REFUSAL CAxialForceList::Add(double axial)
{
    if (auto refusal = OutOfRange(axial)) return refusal;
    if (Find(axial) >= 0) return Refused(kExists, axial);
    m_rows.push_back({axial, -1});
    Sort();
    return std::nullopt;
}

CAxialForceList::REFUSAL CAxialForceList::Change(double oldAxial, double axial)
{
    const int at = Find(oldAxial);
    if (at < 0) return Refused(kOldGone, oldAxial);
    if (auto refusal = OutOfRange(axial)) return refusal;
    const int other = Find(axial);
    if (other >= 0 && other != at) return Refused(kExists, axial);
    m_rows[static_cast<std::size_t>(at)].axial = axial;
    Sort();
    return std::nullopt;
}

CAxialForceList::REFUSAL CAxialForceList::Remove(double axial)
{
    const int at = Find(axial);
    if (at < 0) return Refused(kGone, axial);
    m_rows.erase(m_rows.begin() + at);
    return std::nullopt;
}

int CAxialForceList::Find(double axial) const
{
    const auto at = std::ranges::find(m_rows, axial, &T_ROW::axial);
    return at == m_rows.end() ? -1 : static_cast<int>(at - m_rows.begin());
}

void CAxialForceList::Sort()
{
    std::ranges::stable_sort(m_rows, {}, &T_ROW::axial);
}
