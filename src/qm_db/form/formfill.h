// Visitor of CaseFields: references that must be there and are blank get the first record of their
// kind.
#pragma once

#include "qm_db/records/hingefields.h"
#include "qm_db/records/pushfields.h"
#include "qm_db/records/stagefields.h"

class CFormFill : public CFieldLook<CFormFill> {
public:
    template <class T>
    using Ref = T&;

    explicit CFormFill(const T_MODEL& model) : m_model(model) {}

    /// The first kind of which there is no record to refer to.
    const std::optional<RECORD_KIND>& Missing() const { return m_missing; }

    void NeedRef(const char*, int& target, RECORD_KIND kind)
    {
        if (target == 0) target = First(kind);
    }
    void KeyRef(const char* key, int& target, RECORD_KIND kind) { NeedRef(key, target, kind); }
    void FreeKeyRef(const char* key, int& target, RECORD_KIND kind) { NeedRef(key, target, kind); }
    void OptRef(const char*, int, RECORD_KIND) const {}
    void OptKeyRef(const char*, int, RECORD_KIND) const {}
    void NameRef(const char*, std::string& target, RECORD_KIND kind)
    {
        if (!target.empty()) return;
        if (kind == KindOf<T_POLC_D>()) target = FirstName(m_model.pushovers, kind);
        if (kind == KindOf<T_SPFC_D>()) target = FirstName(m_model.spectra, kind);
    }
    void Node(const char* key, int& id) { NeedRef(key, id, KindOf<T_NODE_D>()); }
    void Element(const char* key, int& id) { NeedRef(key, id, KindOf<T_ELEM_D>()); }
    void NodePair(const char* key, int& nodeI, int& nodeJ, std::size_t count, const char*)
    {
        Node(key, nodeI);
        if (count > 1 && nodeJ == 0) nodeJ = Second(nodeI);
    }
    /// Two nodes at least: what they share needs that.
    void NodeList(const char*, std::vector<int>& ids)
    {
        if (!ids.empty()) return;
        ids = {First(KindOf<T_NODE_D>())};
        ids.push_back(Second(ids.front()));
    }

private:
    int First(RECORD_KIND kind)
    {
        int key = 0;
        WithKind(kind, [&](const auto& row) {
            if (!(m_model.*row.table).empty()) key = (m_model.*row.table).begin()->first;
        });
        if (key == 0 && !m_missing) m_missing = kind;
        return key;
    }
    template <class R>
    std::string FirstName(const T_TABLE<R>& table, RECORD_KIND kind)
    {
        if (!table.empty()) return table.begin()->second.name;
        if (!m_missing) m_missing = kind;
        return {};
    }
    /// A node that is another one.
    int Second(int first)
    {
        for (const auto& entry : m_model.nodes)
            if (entry.first != first) return entry.first;
        if (!m_missing) m_missing = KindOf<T_NODE_D>();
        return 0;
    }

    const T_MODEL& m_model;
    std::optional<RECORD_KIND> m_missing;
};
