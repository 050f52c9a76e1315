#include "qm_rps/generate/generatedtypes.h"

#include "qm_base/say.h"

#include <set>

const CGeneratedTypes::T_FOUND& CGeneratedTypes::Find(int hingeType)
{
    const T_MODEL& model = m_doc.Data().Model();
    if (m_revision != m_doc.Data().Revision()) {
        m_revision = m_doc.Data().Revision();
        m_found.clear();
        CCodeHinges hinges(m_doc); // one analysis for all
        for (const auto& [key, type] : model.hingeTypes) {
            if (!type.generated) continue;
            T_FOUND& found = m_found[key];
            found.state = hinges.StateOf(key, found.fault);
        }
    }
    static const T_FOUND kNone;
    const auto at = m_found.find(hingeType);
    return at == m_found.end() ? kNone : at->second;
}

const std::string& CGeneratedTypes::Fault(int hingeType)
{
    return Find(hingeType).fault;
}

std::string CGeneratedTypes::CodeText(int hingeType) const
{
    const auto& types = m_doc.Data().Model().hingeTypes;
    const auto at = types.find(hingeType);
    if (at == types.end() || !at->second.generated) return {};
    const T_GENERATED& generated = *at->second.generated;
    return generated.secondary ? Say("IDS_QM_GEN_SECONDARY", generated.code) : generated.code;
}

std::vector<int> CGeneratedTypes::StaleElements()
{
    std::set<int> ids;
    for (const auto& [key, type] : m_doc.Data().Model().hingeTypes) {
        if (Find(key).state != CODE_TYPE_STATE::Stale) continue;
        const std::vector<int> of = ElementsWithHingeType(m_doc.Data().Model(), key);
        ids.insert(of.begin(), of.end());
    }
    return {ids.begin(), ids.end()};
}
