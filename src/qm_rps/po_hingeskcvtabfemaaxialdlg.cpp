#include "qm_rps/po_hingeskcvtabfemaaxialdlg.h"

#include <algorithm>
#include <cmath>

namespace {
constexpr const char* kFull = "IDS_RPS_PUSHOVER_Maxnum_reached";
}

/// The list shows its messages where this dialog shows its own.
CPO_HingeSkcvTabFemaAxialGrid& CPO_HingeSkcvTabFemaAxialDlg::List()
{
    m_list.SetView(View());
    return m_list;
}

int CPO_HingeSkcvTabFemaAxialDlg::Data2Dlg(const std::vector<T_SKEL_AXIAL>& rows)
{
    if (rows.size() > kMaxKeys) {
        ShowMessage(kFull);
        return 0;
    }
    T_VALUES given;
    for (const T_SKEL_AXIAL& row : rows) {
        if (std::isfinite(row.axial) && given.emplace(row.axial, row.sides).second) continue;
        ShowMessage("IDS_QM_UI_AXIAL_ROWS");
        return 0;
    }
    m_given = std::move(given);
    m_values.clear();
    List().Data2Dlg(rows);
    return 1;
}

std::vector<double> CPO_HingeSkcvTabFemaAxialDlg::Keys() const
{
    std::vector<double> keys;
    for (const auto& row : m_list.Rows())
        keys.push_back(row.axial);
    return keys;
}

const T_SIDES<T_SKEL_SIDE>& CPO_HingeSkcvTabFemaAxialDlg::SidesOf(double axial) const
{
    static const T_SIDES<T_SKEL_SIDE> none;
    if (const auto it = m_values.find(axial); it != m_values.end()) return it->second;
    const auto it = m_given.find(axial);
    return it == m_given.end() ? none : it->second;
}

int CPO_HingeSkcvTabFemaAxialDlg::PutValue(double axial, const T_SIDES<T_SKEL_SIDE>& sides)
{
    if (!m_values.contains(axial) && m_values.size() >= kMaxValues) return 0;
    m_values[axial] = sides;
    return 1;
}

int CPO_HingeSkcvTabFemaAxialDlg::AddForce(double axial)
{
    const std::vector<double> keys = Keys();
    if (keys.size() >= kMaxKeys) {
        ShowMessage(kFull);
        return 0;
    }
    if (!List().AddForce(axial)) return 0;
    const auto nearest =
        std::ranges::min_element(keys, {}, [&](double key) { return std::abs(key - axial); });
    return PutValue(axial, nearest == keys.end() ? T_SIDES<T_SKEL_SIDE>() : SidesOf(*nearest));
}

int CPO_HingeSkcvTabFemaAxialDlg::ChangeForce(double oldAxial, double axial)
{
    if (!List().ChangeForce(oldAxial, axial)) return 0;
    if (oldAxial == axial) return 1;
    const T_SIDES<T_SKEL_SIDE> sides = SidesOf(oldAxial);
    const int done = PutValue(axial, sides);
    m_values.erase(oldAxial);
    return done;
}

int CPO_HingeSkcvTabFemaAxialDlg::RemoveForce(double axial)
{
    if (!List().RemoveForce(axial)) return 0;
    m_values.erase(axial);
    return 1;
}

int CPO_HingeSkcvTabFemaAxialDlg::SetYield(double axial, HINGE_SIDE side, double yield)
{
    if (!std::isfinite(yield) || yield < 0.0) {
        ShowMessage("IDS_QM_UI_AXIAL_YIELD");
        return 0;
    }
    T_SIDES<T_SKEL_SIDE> sides = SidesOf(axial);
    (side == HINGE_SIDE::Negative ? sides.neg : sides.pos).yield = yield;
    return PutValue(axial, sides);
}
