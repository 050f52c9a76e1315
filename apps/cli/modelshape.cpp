#include "modelshape.h"

#include "analysis/analysistext.h"

#include <algorithm>
#include <map>

namespace {

/// Free to turn in bending: no moment is carried about y or z.
bool IsPinned(const T_DIRS6& release)
{
    return release[4] || release[5];
}

} // namespace

T_SHAPE ShapeOfModel(CDBDoc& doc)
{
    const T_MODEL& model = doc.Data().Model();
    T_SHAPE shape;
    shape.title = model.styp.title;
    shape.lengthUnit = LengthName(doc.Unit().Units());
    std::map<int, std::size_t> at;
    for (const auto& entry : model.nodes) {
        T_NODE_D node;
        if (!doc.Attr().GetNode(entry.first, node)) continue;
        at[entry.first] = shape.nodes.size();
        const bool support = std::any_of(node.restraint.begin(), node.restraint.begin() + 3,
                                         [](int r) { return r != 0; });
        shape.nodes.push_back({entry.first, node.xyz, support});
    }
    for (const auto& entry : model.elements) {
        T_ELEM_D e;
        if (!doc.Attr().GetElem(entry.first, e)) continue;
        if (e.kind == ELEM_KIND::Spring || !at.contains(e.nodeI) || !at.contains(e.nodeJ)) continue;
        shape.members.push_back({at[e.nodeI], at[e.nodeJ], e.kind == ELEM_KIND::Beam,
                                 IsPinned(e.release.I), IsPinned(e.release.J), e.offset.I,
                                 e.offset.J});
    }
    return shape;
}

T_SHAPE_STATE StateOf(const std::string& name, const std::vector<T_BY_ID<T_DOF6>>& displacements)
{
    T_SHAPE_STATE state{name, {}};
    for (const auto& row : displacements)
        state.displacement.push_back(row.value);
    return state;
}
