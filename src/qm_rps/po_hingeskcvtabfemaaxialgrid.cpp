#include "qm_rps/po_hingeskcvtabfemaaxialgrid.h"

#include "qm_base/textformat.h"

#include <algorithm>
#include <cmath>

void CPO_HingeSkcvTabFemaAxialGrid::Data2Dlg(const std::vector<T_SKEL_AXIAL>& curves)
{
    m_given = curves;
    m_rows.clear();
    for (std::size_t i = 0; i < curves.size(); ++i)
        m_rows.push_back({curves[i].axial, static_cast<int>(i)});
    Sort();
}

void CPO_HingeSkcvTabFemaAxialGrid::Dlg2Data(std::vector<T_SKEL_AXIAL>& curves,
                                             const T_SIDES<T_SKEL_SIDE>& fresh) const
{
    std::vector<T_SKEL_AXIAL> list;
    for (const T_ROW& r : m_rows)
        list.push_back(
            {r.axial, r.source < 0 ? fresh : m_given[static_cast<std::size_t>(r.source)].sides});
    curves = std::move(list);
}

int CPO_HingeSkcvTabFemaAxialGrid::AddForce(double axial)
{
    if (!CheckFinite(axial)) return 0;
    if (Find(axial) >= 0) {
        Refuse("Axial Force %g already exists!", axial);
        return 0;
    }
    m_rows.push_back({axial, -1});
    Sort();
    return 1;
}

int CPO_HingeSkcvTabFemaAxialGrid::ChangeForce(double oldAxial, double axial)
{
    const int at = Find(oldAxial);
    if (at < 0) {
        Refuse("Old Axial Force %g does not exist!", oldAxial);
        return 0;
    }
    if (!CheckFinite(axial)) return 0;
    const int other = Find(axial);
    if (other >= 0 && other != at) {
        Refuse("Axial Force %g already exists!", axial);
        return 0;
    }
    m_rows[static_cast<std::size_t>(at)].axial = axial;
    Sort();
    return 1;
}

int CPO_HingeSkcvTabFemaAxialGrid::RemoveForce(double axial)
{
    const int at = Find(axial);
    if (at < 0) {
        Refuse("Axial Force %g does not exist!", axial);
        return 0;
    }
    m_rows.erase(m_rows.begin() + at);
    return 1;
}

int CPO_HingeSkcvTabFemaAxialGrid::OnRemove()
{
    if (m_selected < 0 || m_selected >= static_cast<int>(m_rows.size())) return 0;
    return RemoveForce(m_rows[static_cast<std::size_t>(m_selected)].axial);
}

int CPO_HingeSkcvTabFemaAxialGrid::Find(double axial) const
{
    for (std::size_t i = 0; i < m_rows.size(); ++i)
        if (m_rows[i].axial == axial) return static_cast<int>(i);
    return -1;
}

bool CPO_HingeSkcvTabFemaAxialGrid::CheckFinite(double axial)
{
    if (std::isfinite(axial)) return true;
    ShowMessage("IDS_RPS_PO_FEMA_AXIALFORE_OUTOFRANGE");
    return false;
}

void CPO_HingeSkcvTabFemaAxialGrid::Sort()
{
    std::stable_sort(m_rows.begin(), m_rows.end(),
                     [](const T_ROW& a, const T_ROW& b) { return a.axial < b.axial; });
}

/// These texts are the program's own literals; the literal stands for the key.
void CPO_HingeSkcvTabFemaAxialGrid::Refuse(const char* literal, double axial)
{
    std::string text = literal;
    text.replace(text.find("%g"), 2, FormatText("%g", axial));
    ShowMessage(literal, text);
}
