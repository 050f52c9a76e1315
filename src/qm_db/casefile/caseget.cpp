#include "qm_db/casefile/caseget.h"

const char* CCaseGet::OptOr(const char* key, const char* old, double& out, double missing,
                            T_DIM dim)
{
    const bool older = old && Has(old);
    if (older && Has(key)) m_in.FailAt(key, "IDS_QM_CASE_SAME_AS", old);
    Opt(older ? old : key, out, missing, dim);
    return older ? old : key;
}

void CCaseGet::Texts(const char* key, std::vector<std::string>& out)
{
    if (!Has(key)) return;
    m_in.Member(key).ForEachItem(
        [&](CJsonReader& item, std::size_t) { item.Read(out.emplace_back()); });
}

void CCaseGet::NeedRef(const char* key, int& out, RECORD_KIND kind)
{
    if (!Take(key)) return;
    CJsonReader member = m_in.Member(key);
    ReadRef(member, out, kind, kind == KindOf<T_MATL_D>() || kind == KindOf<T_SECT_D>());
}

void CCaseGet::ReadRef(CJsonReader& in, int& out, RECORD_KIND kind, bool mayBeKey) const
{
    if (!m_names || (mayBeKey && !in.IsText())) {
        in.Read(out);
        if (m_names && out != 0 && !m_names->HasKey(kind, out)) FailRef(in, kind);
        return;
    }
    std::string name;
    in.Read(name);
    const std::optional<int> found = m_names->KeyOf(kind, name);
    if (!found) FailRef(in, kind);
    out = found.value_or(0);
}

void CCaseGet::Refs(const char* key, std::vector<int>& out, RECORD_KIND kind)
{
    out.clear();
    if (!Has(key)) return;
    m_in.Member(key).ForEachItem([&](CJsonReader& item, std::size_t) {
        ReadRef(item, out.emplace_back(), kind, true);
        if (m_names && !m_names->HasKey(kind, out.back())) FailRef(item, kind);
    });
}

void CCaseGet::KeyRef(const char* key, int& out, RECORD_KIND kind)
{
    if (!Take(key)) return;
    CJsonReader member = m_in.Member(key);
    member.Read(out);
    if (m_names && !m_names->HasKey(kind, out)) FailRef(member, kind);
}

void CCaseGet::NodePair(const char* key, int& nodeI, int& nodeJ, std::size_t count,
                        const char* reason)
{
    std::vector<int> nodes;
    NodeList(key, nodes);
    Rule(key, nodes.size() == count, reason);
    nodes.resize(2);
    nodeI = nodes[0];
    nodeJ = nodes[1];
}

void CCaseGet::StageStep(const char* key, int& step, int missing)
{
    step = missing;
    if (!Has(key)) return;
    CJsonReader member = m_in.Member(key);
    if (member.IsText()) {
        step = member.Choice(kStageStepNames, "IDS_QM_CHOICE_STEP") == 0 ? kStageFirstStep
                                                                         : kStageLastStep;
        return;
    }
    member.Read(step);
    if (step < kStageFirstStep) member.Fail("IDS_QM_CASE_STEPS_FROM_1");
}

void CCaseGet::NodeTable(const char* key, std::map<int, T_DOF6>& out)
{
    if (!Take(key)) return;
    m_in.Member(key).ForEachNode([&](CJsonReader& values, int node) {
        if (m_names && !m_names->HasNode(node)) values.Fail("IDS_QM_CASE_NO_NODE");
        values.Read(out[node]);
    });
}

void CCaseGet::OptElements(const char* key, std::vector<int>& ids)
{
    ids.clear();
    if (!Has(key)) return;
    Need(key, ids);
    CheckIds(
        key, ids, [&](int id) { return m_names->HasElement(id); }, "IDS_QM_CASE_NO_ELEMENT",
        "IDS_QM_CASE_ELEMENT_TWICE");
}

void CCaseGet::FailRef(CJsonReader& in, RECORD_KIND kind)
{
    WithKind(kind, [&](const auto& row) { in.Fail("IDS_QM_CASE_NO_RECORD", Say(row.noun)); });
}
