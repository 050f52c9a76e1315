#include "qm_rps/view/viewresults.h"

#include "qm_rps/view/resultgetters.h"

#include "qm_base/say.h"

#include <algorithm>
#include <cmath>

namespace {

using KIND = T_SHAPE_SOURCE::KIND;

class CReader {
public:
    CReader(CDBDoc& doc, const T_FRAME_SCENE& scene, const T_RESULT_GETTERS& get)
        : m_post(doc.Post()), m_units(doc.Unit().Units()), m_model(doc.Data().Model()),
          m_scene(scene), m_get(get)
    {
    }

    void ReadMoves(T_VIEW_RESULTS& out) const
    {
        for (const T_SCENE_NODE& node : m_scene.nodes) {
            T_DOF6 values{};
            if (!(m_post.*m_get.displacement)(node.id, values)) {
                out.moved.clear();
                out.noMoves = m_post.Error();
                return;
            }
            ToSi6(values, kDimLength, kDimNone);
            out.moved.push_back(values);
        }
    }

    void ReadForces(T_VIEW_RESULTS& out) const
    {
        for (const T_SCENE_LINE& line : m_scene.lines) {
            T_ELEM_FORCES forces{};
            if (!ReadLine(line, forces)) {
                out.force.clear();
                out.noForces = m_post.Error();
                return;
            }
            out.force.push_back(forces);
        }
    }

    void ReadReactions(T_VIEW_RESULTS& out) const
    {
        const std::set<int> held = HeldNodes(m_model);
        for (std::size_t n = 0; n < m_scene.nodes.size(); ++n) {
            if (!m_scene.nodes[n].shown || !held.contains(m_scene.nodes[n].id)) continue;
            T_NODE_VALUES at{n, {}};
            if (!(m_post.*m_get.reaction)(m_scene.nodes[n].id, at.values)) {
                out.reactions.clear();
                out.noReactions = m_post.Error();
                return;
            }
            ToSi6(at.values, kDimForce, kDimMoment);
            out.reactions.push_back(at);
        }
        if (out.reactions.empty()) out.noReactions = Say("IDS_QM_VIEW_NO_SUPPORTS");
    }

private:
    void ToSi6(T_DOF6& values, T_DIM linear, T_DIM angular) const
    {
        for (std::size_t i = 0; i < values.size(); ++i)
            values[i] = ToSi(values[i], m_units, i < 3 ? linear : angular);
    }

    /// A link has none along its length.
    int ReadLine(const T_SCENE_LINE& line, T_ELEM_FORCES& out) const
    {
        if (line.kind == ELEM_KIND::Truss) {
            double axial = 0.0;
            if (!(m_post.*m_get.truss)(line.id, axial)) return 0;
            for (T_DOF6& at : out)
                at[0] = ToSi(axial, m_units, kDimForce);
        }
        if (line.kind != ELEM_KIND::Beam) return 1;
        for (std::size_t p = 0; p < out.size(); ++p) {
            if (!(m_post.*m_get.beam)(line.id, static_cast<int>(p), out[p])) return 0;
            ToSi6(out[p], kDimForce, kDimMoment);
        }
        return 1;
    }

    CPostCtrl& m_post;
    T_UNITS m_units;
    const T_MODEL& m_model;
    const T_FRAME_SCENE& m_scene;
    const T_RESULT_GETTERS& m_get;
};

/// All that the source has of movements, and why it has no forces.
void ReadPush(CDBDoc& doc, const T_FRAME_SCENE& scene, const T_SHAPE_SOURCE& source, int step,
              T_VIEW_RESULTS& out)
{
    out.noForces = out.noReactions = Say("IDS_QM_VIEW_PUSH_NO_FORCES");
    IPushRun* const run = doc.Post().RunOf(source.key, source.turn);
    std::vector<T_DOF6> shape;
    if (!run || !run->ReadShape(step, shape)) {
        out.noMoves = run ? run->Error() : Say("IDS_QM_VIEW_ONE_DIRECTION");
        return;
    }
    const std::vector<int>& ids = run->NodeIds();
    for (const T_SCENE_NODE& node : scene.nodes) {
        const auto at = std::ranges::lower_bound(ids, node.id);
        const bool has = at != ids.end() && *at == node.id;
        out.moved.push_back(has ? shape.at(static_cast<std::size_t>(at - ids.begin())) : T_DOF6{});
    }
}

void ReadMode(CDBDoc& doc, const T_FRAME_SCENE& scene, int mode, T_VIEW_RESULTS& out)
{
    out.noForces = out.noReactions = Say("IDS_QM_VIEW_MODE_NO_FORCES");
    if (!doc.Post().SelectMode(mode)) {
        out.noMoves = Say("IDS_QM_VIEW_NOT_ANALYSED");
        return;
    }
    for (const T_SCENE_NODE& node : scene.nodes) {
        T_DOF6 values{};
        doc.Post().GetEiMode(node.id, values);
        out.moved.push_back(values);
    }
}

} // namespace

std::set<int> HeldNodes(const T_MODEL& model)
{
    std::set<int> held;
    for (const auto& [id, node] : model.nodes)
        if (std::ranges::any_of(node.restraint, [](int r) { return r != 0; })) held.insert(id);
    for (const auto& [id, e] : model.elements)
        if (e.kind == ELEM_KIND::Spring) held.insert(e.nodeI);
    return held;
}

T_VIEW_RESULTS ReadViewResults(CDBDoc& doc, const T_FRAME_SCENE& scene,
                               const T_SHAPE_SOURCE& source, int step, const T_VIEW_WANTED& wanted)
{
    T_VIEW_RESULTS out;
    out.noMoves = out.noForces = out.noReactions = Say("IDS_QM_VIEW_NO_SOURCE");
    if (source.kind == KIND::None) return out;
    out.noMoves.clear();
    if (source.kind == KIND::Pushover) {
        ReadPush(doc, scene, source, step, out);
        return out;
    }
    if (source.kind == KIND::Mode) {
        ReadMode(doc, scene, source.key, out);
        return out;
    }
    out.noForces.clear();
    out.noReactions.clear();
    CPostCtrl& post = doc.Post();
    const bool staged = source.kind == KIND::Stage;
    if (staged)
        post.SelectStage(source.key, step, kStageLoadSum);
    else if (!(source.kind == KIND::Static
                   ? post.SelectLoadCombNew(CPostCtrl::MakeLoadComb(source.key))
                   : post.SelectLoadCombNew(source.key))) {
        out.noMoves = out.noForces = out.noReactions = Say("IDS_QM_VIEW_NOT_ANALYSED");
        return out;
    }
    const CReader reader(doc, scene, staged ? kStageGetters : kStaticGetters);
    reader.ReadMoves(out);
    if (wanted.forces) reader.ReadForces(out);
    if (wanted.reactions) reader.ReadReactions(out);
    return out;
}

std::size_t CountInDiaphragms(const T_MODEL& model, const T_FRAME_SCENE& scene,
                              const std::set<int>& elements)
{
    constexpr double kFlat = 1e-6; // of the length of the line
    std::set<std::size_t> found;
    for (const auto& [key, diaphragm] : model.diaphragms) {
        const std::set<int> nodes(diaphragm.nodes.begin(), diaphragm.nodes.end());
        const auto normal = static_cast<std::size_t>(diaphragm.normal);
        for (std::size_t l = 0; l < scene.lines.size(); ++l) {
            const T_SCENE_LINE& line = scene.lines[l];
            const int i = scene.nodes[line.i].id, j = scene.nodes[line.j].id;
            if (line.kind == ELEM_KIND::Link || !nodes.contains(i) || !nodes.contains(j)) continue;
            if (!elements.empty() && !elements.contains(line.id)) continue;
            const auto &from = model.nodes.at(i).xyz, &to = model.nodes.at(j).xyz;
            const double length = std::hypot(to[0] - from[0], to[1] - from[1], to[2] - from[2]);
            if (length > 0.0 && std::fabs(to[normal] - from[normal]) <= kFlat * length)
                found.insert(l);
        }
    }
    return found.size();
}

std::string RigidFloorNote(std::size_t members)
{
    return Say("IDS_QM_VIEW_RIGID_FLOOR", std::to_string(members));
}
