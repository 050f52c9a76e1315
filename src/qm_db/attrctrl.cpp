#include "qm_db/attrctrl.h"

#include "qm_db/recordunits.h"

namespace {

template <class T>
int Get(const T_TABLE<T>& table, int key, const T_UNITS& units, T& out)
{
    const auto it = table.find(key);
    if (it == table.end()) return 0;
    out = it->second;
    RecordFromSi(out, units);
    return 1;
}

template <class T>
int FindByName(const T_TABLE<T>& table, std::string_view name, int& key)
{
    for (const auto& [k, record] : table) {
        if (record.name != name) continue;
        key = k;
        return 1;
    }
    return 0;
}

} // namespace

int CAttrCtrl::GetStyp(T_STYP_D& out) const
{
    out = m_data.Model().styp;
    RecordFromSi(out, m_data.Units());
    return 1;
}

int CAttrCtrl::GetNode(int id, T_NODE_D& out) const
{
    return Get(m_data.Model().nodes, id, m_data.Units(), out);
}

int CAttrCtrl::GetConsNode(int id, std::array<int, 6>& out) const
{
    const auto it = m_data.Model().nodes.find(id);
    if (it == m_data.Model().nodes.end()) return 0;
    out = it->second.restraint;
    return 1;
}

int CAttrCtrl::GetPolc(int key, T_POLC_D& out) const
{
    return Get(m_data.Model().pushovers, key, m_data.Units(), out);
}

int CAttrCtrl::GetSpfc(int key, T_SPFC_D& out) const
{
    return Get(m_data.Model().spectra, key, m_data.Units(), out);
}

int CAttrCtrl::GetEval(int key, T_EVAL_D& out) const
{
    return Get(m_data.Model().evaluations, key, m_data.Units(), out);
}

int CAttrCtrl::FindPolc(std::string_view name, int& key) const
{
    return FindByName(m_data.Model().pushovers, name, key);
}

int CAttrCtrl::FindSpfc(std::string_view name, int& key) const
{
    return FindByName(m_data.Model().spectra, name, key);
}
