#include "qm_rps/hinge/hingetable.h"

#include "qm_db/editscope.h"

namespace {

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

} // namespace

T_TABLE<T_PHGT_D> HingeTypesOf(CDBDoc& doc)
{
    T_TABLE<T_PHGT_D> types;
    for (const int key : doc.Attr().GetKeys<T_PHGT_D>())
        if (T_PHGT_D type; doc.Attr().GetPhgt(key, type)) types.emplace(key, std::move(type));
    return types;
}

T_TABLE<T_PHGE_D> HingesOf(CDBDoc& doc)
{
    T_TABLE<T_PHGE_D> hinges;
    for (const int key : doc.Attr().GetKeys<T_PHGE_D>())
        if (T_PHGE_D hinge; doc.Attr().GetPhge(key, hinge)) hinges.emplace(key, hinge);
    return hinges;
}

int StoreHingeType(CDBDoc& doc, int key, const T_PHGT_D& type)
{
    CEditScope edit(doc, "hinge type");
    return edit.Put(key, type) && edit.Commit();
}

int EraseHingeType(CDBDoc& doc, int key)
{
    CEditScope edit(doc, "hinge type");
    std::vector<int> users;
    return edit.ErasePhgt(key, users) && edit.Commit();
}

int EraseHinge(CDBDoc& doc, int key)
{
    CEditScope edit(doc, "hinge");
    return edit.Erase<T_PHGE_D>(key) && edit.Commit();
}

std::optional<HINGE_ELEMENT> HingeElementOf(CDBDoc& doc, int element)
{
    T_ELEM_D e;
    if (!doc.Attr().GetElem(element, e)) return std::nullopt;
    return KindOf(e.kind);
}

std::vector<int> ElementsForHinges(CDBDoc& doc, HINGE_ELEMENT kind)
{
    const HINGE_ELEMENT wanted = kind == HINGE_ELEMENT::Wall ? HINGE_ELEMENT::BeamColumn : kind;
    std::vector<int> ids;
    for (const auto& [id, e] : doc.Data().Model().elements)
        if (KindOf(e.kind) == wanted) ids.push_back(id);
    return ids;
}

T_YIELD_CALC_ELEM YieldCalcElemOf(CDBDoc& doc, int element)
{
    T_YIELD_CALC_ELEM found;
    T_ELEM_D e;
    if (!doc.Attr().GetElem(element, e)) return found;
    if (T_SECT_D s; doc.Attr().GetSect(e.section, s)) found.section = s;
    if (T_MATL_D m; doc.Attr().GetMatl(e.material, m)) found.material = m;
    return found;
}
