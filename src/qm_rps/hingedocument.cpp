#include "qm_rps/hingedocument.h"

#include "qm_rps/hinge/hingegenerator.h"

namespace {

T_TABLE<T_PHGT_D> TypesOf(CDBDoc& doc)
{
    T_TABLE<T_PHGT_D> types;
    for (const int key : doc.Attr().GetKeys<T_PHGT_D>())
        if (T_PHGT_D type; doc.Attr().GetPhgt(key, type)) types.emplace(key, std::move(type));
    return types;
}

/// One step of edits, whole or not at all.
template <class EDIT>
int Step(CDBDoc& doc, const char* title, EDIT edit)
{
    if (!doc.Edit().Begin(title)) return 0;
    if (edit() && doc.Edit().Commit()) return 1;
    doc.Edit().Rollback();
    return 0;
}

int StoreType(CDBDoc& doc, int key, const T_PHGT_D& type)
{
    return Step(doc, "hinge type", [&] { return doc.Edit().Put(key, type); });
}

/// Beams carry hinges of columns and of walls.
HINGE_ELEMENT KindOf(ELEM_KIND kind)
{
    switch (kind) {
    case ELEM_KIND::Truss:
        return HINGE_ELEMENT::Truss;
    case ELEM_KIND::Link:
        return HINGE_ELEMENT::GeneralLink;
    case ELEM_KIND::Spring:
        return HINGE_ELEMENT::PointSpring;
    case ELEM_KIND::Beam:
        break;
    }
    return HINGE_ELEMENT::BeamColumn;
}

T_YIELD_CALC_ELEM LookUp(CDBDoc& doc, int element)
{
    T_YIELD_CALC_ELEM found;
    T_ELEM_D e;
    if (!doc.Attr().GetElem(element, e)) return found;
    if (T_SECT_D s; doc.Attr().GetSect(e.section, s)) found.section = s;
    if (T_MATL_D m; doc.Attr().GetMatl(e.material, m)) found.material = m;
    return found;
}

} // namespace

T_HINGE_LIST_ACCESS HingeTypesOf(CDBDoc& doc)
{
    T_HINGE_LIST_ACCESS access;
    access.types = [&doc] { return TypesOf(doc); };
    access.users = [&doc](int key) { return doc.Attr().GetElemsByPhgt(key); };
    access.erase = [&doc](int key) {
        return Step(doc, "hinge type", [&] {
            std::vector<int> users;
            return doc.Edit().ErasePhgt(key, users);
        });
    };
    access.store = [&doc](int key, const T_PHGT_D& type) { return StoreType(doc, key, type); };
    access.context = [&doc] { return HingeContextOf(doc); };
    return access;
}

void ConnectHinges(CDBDoc& doc, CPushOverHingeListDlg& list)
{
    list.m_units = doc.Unit().Units();
    list.m_types = [&doc] { return TypesOf(doc); };
    list.m_hinges = [&doc] {
        T_TABLE<T_PHGE_D> hinges;
        for (const int key : doc.Attr().GetKeys<T_PHGE_D>())
            if (T_PHGE_D hinge; doc.Attr().GetPhge(key, hinge)) hinges.emplace(key, hinge);
        return hinges;
    };
    list.m_generate = [&doc](int type, const std::vector<int>& elements, std::string& refusal) {
        T_HINGE_REFUSAL why;
        if (CHingeGenerator(doc).Generate(type, elements, why)) return 1;
        refusal = why.text;
        return 0;
    };
    list.m_erase = [&doc](int key) {
        return Step(doc, "hinge", [&] { return doc.Edit().Erase<T_PHGE_D>(key); });
    };
    list.m_kindOf = [&doc](int id) -> std::optional<HINGE_ELEMENT> {
        T_ELEM_D e;
        if (!doc.Attr().GetElem(id, e)) return std::nullopt;
        return KindOf(e.kind);
    };
    list.m_elements = [&doc](HINGE_ELEMENT element) {
        const HINGE_ELEMENT wanted =
            element == HINGE_ELEMENT::Wall ? HINGE_ELEMENT::BeamColumn : element;
        std::vector<int> ids;
        for (const auto& [id, e] : doc.Data().Model().elements)
            if (KindOf(e.kind) == wanted) ids.push_back(id);
        return ids;
    };
    list.m_lookup = [&doc](int element) { return LookUp(doc, element); };
}

void ConnectHinges(CDBDoc& doc, CPushOverHingeDataType& table)
{
    table.m_units = doc.Unit().Units();
    table.m_types = [&doc] { return TypesOf(doc); };
    table.m_find = [&doc](int key) -> std::optional<T_PHGT_D> {
        T_PHGT_D type;
        if (!doc.Attr().GetPhgt(key, type)) return std::nullopt;
        return type;
    };
    table.m_store = [&doc](int key, const T_PHGT_D& type) { return StoreType(doc, key, type); };
}
