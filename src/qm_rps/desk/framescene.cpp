#include "qm_rps/desk/framescene.h"

#include "qm_base/say.h"
#include "qm_rps/push/pushresultlist.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace {

using S = T_SHAPE_SOURCE;

double Length(const std::array<double, 3>& v)
{
    return std::hypot(v[0], v[1], v[2]);
}

double SizeOf(const T_FRAME_SCENE& scene)
{
    constexpr double kFar = std::numeric_limits<double>::infinity();
    std::array<double, 3> low{kFar, kFar, kFar}, high{-kFar, -kFar, -kFar};
    for (const T_SCENE_NODE& node : scene.nodes)
        for (std::size_t d = 0; d < 3; ++d) {
            low[d] = std::min(low[d], node.xyz[d]);
            high[d] = std::max(high[d], node.xyz[d]);
        }
    return scene.nodes.empty() ? 0.0
                               : Length({high[0] - low[0], high[1] - low[1], high[2] - low[2]});
}

/// Takes off what holds every node, as it does in a plane model: that is no support.
void KeepSupports(std::vector<T_SCENE_NODE>& nodes)
{
    T_DIRS6 all{true, true, true, true, true, true};
    for (const T_SCENE_NODE& node : nodes)
        for (std::size_t d = 0; d < all.size(); ++d)
            all[d] = all[d] && node.held[d];
    for (T_SCENE_NODE& node : nodes)
        for (std::size_t d = 0; d < all.size(); ++d)
            node.held[d] = node.held[d] && !all[d];
}

/// Ends of elements with generated hinges, by element.
std::map<int, T_ENDS<bool>> HingedEnds(const T_MODEL& model)
{
    std::map<int, T_ENDS<bool>> ends;
    for (const auto& entry : model.hinges) {
        T_ENDS<bool>& at = ends[entry.second.element];
        const auto type = model.hingeTypes.find(entry.second.hingeType);
        if (type == model.hingeTypes.end()) continue;
        for (const T_HINGE_COMPONENT& c : type->second.components) {
            at.I = at.I || (c.active && c.location != HINGE_LOCATION::JEnd);
            at.J = at.J || (c.active && c.location != HINGE_LOCATION::IEnd);
        }
    }
    return ends;
}

} // namespace

std::vector<std::array<double, 3>> MovesOf(const T_FRAME_SCENE& scene, const std::vector<int>& ids,
                                           const std::vector<T_DOF6>& displacement,
                                           const T_UNITS& units)
{
    std::vector<std::array<double, 3>> moves(scene.nodes.size());
    for (std::size_t n = 0; n < moves.size(); ++n) {
        const auto at = std::ranges::lower_bound(ids, scene.nodes[n].id);
        if (at == ids.end() || *at != scene.nodes[n].id) continue;
        const T_DOF6& u = displacement.at(static_cast<std::size_t>(at - ids.begin()));
        for (std::size_t d = 0; d < 3; ++d)
            moves[n][d] = FromSi(u[d], units, kDimLength);
    }
    return moves;
}

void CFrameScene::Build()
{
    const T_MODEL& model = m_doc.Data().Model();
    m_scene = {};
    m_stages.clear();
    m_shownOf = nullptr;
    m_scene.title = model.styp.title;
    m_scene.lengthUnit = NameOf(m_doc.Unit().Units().length);
    std::map<int, std::size_t> at;
    for (const auto& entry : model.nodes) {
        T_SCENE_NODE node{entry.first, entry.second.xyz, {}};
        for (double& x : node.xyz)
            x = m_doc.Unit().ConvertUnitLengthOut(x);
        for (std::size_t d = 0; d < node.held.size(); ++d)
            node.held[d] = entry.second.restraint[d] != 0;
        at[entry.first] = m_scene.nodes.size();
        m_scene.nodes.push_back(node);
    }
    KeepSupports(m_scene.nodes);
    const auto hinged = HingedEnds(model);
    for (const auto& [id, e] : model.elements) {
        if (e.kind == ELEM_KIND::Spring || !at.contains(e.nodeI) || !at.contains(e.nodeJ)) continue;
        const auto ends = hinged.find(id);
        const T_ENDS<bool> has = ends == hinged.end() ? T_ENDS<bool>{} : ends->second;
        T_SCENE_LINE line{id, at[e.nodeI], at[e.nodeJ], e.kind, has.I, has.J};
        for (std::size_t d = 0; d < 3; ++d) {
            line.offsetI[d] = m_doc.Unit().ConvertUnitLengthOut(e.offset.I[d]);
            line.offsetJ[d] = m_doc.Unit().ConvertUnitLengthOut(e.offset.J[d]);
        }
        m_scene.lines.push_back(line);
    }
    m_revision = m_scene.revision = m_doc.Data().Revision();
    m_pushover = 0;
}

const T_FRAME_SCENE& CFrameScene::Scene()
{
    if (m_revision != m_doc.Data().Revision()) Build();
    return m_scene;
}

const T_FRAME_SCENE& CFrameScene::SceneOf(const T_SHAPE_SOURCE& source)
{
    const T_FRAME_SCENE& whole = Scene();
    if (source.kind != S::KIND::Stage) return whole;
    const auto [at, isNew] = m_stages.try_emplace(source.key, whole);
    T_FRAME_SCENE& stage = at->second;
    if (!isNew) return stage;
    const std::set<int> standing = StandingElements(m_doc.Data().Model(), source.key);
    std::erase_if(stage.lines,
                  [&](const T_SCENE_LINE& line) { return !standing.contains(line.id); });
    std::vector<char> holds(stage.nodes.size(), 0);
    for (const T_SCENE_LINE& line : stage.lines)
        holds[line.i] = holds[line.j] = 1;
    for (std::size_t n = 0; n < holds.size(); ++n)
        if (!holds[n]) stage.nodes[n].held = {};
    return stage;
}

const T_FRAME_SCENE& CFrameScene::Shown(const T_SHAPE_SOURCE& source, const std::set<int>& hidden)
{
    const T_FRAME_SCENE& of = SceneOf(source);
    if (hidden.empty()) return of;
    if (m_shownOf == &of && m_hidden == hidden) return m_shown;
    m_shown = of;
    m_shownOf = &of;
    m_hidden = hidden;
    m_shown.variant = ++m_variant;
    std::erase_if(m_shown.lines,
                  [&](const T_SCENE_LINE& line) { return hidden.contains(line.id); });
    std::vector<char> hides(m_shown.nodes.size(), 0), shows(hides);
    for (const T_SCENE_LINE& line : of.lines)
        hides[line.i] = hides[line.j] = 1;
    for (const T_SCENE_LINE& line : m_shown.lines)
        shows[line.i] = shows[line.j] = 1;
    for (std::size_t n = 0; n < shows.size(); ++n)
        m_shown.nodes[n].shown = shows[n] || !hides[n];
    return m_shown;
}

/// Load cases, then combinations: those have results that all their cases have.
void CFrameScene::AddStatic(std::vector<T_SHAPE_SOURCE>& sources)
{
    std::set<int> analysed;
    for (const auto& [key, load] : m_doc.Data().Model().loadCases) {
        const bool has = m_doc.Post().CheckStaticResult(key) != 0;
        if (has) analysed.insert(key);
        sources.push_back({S::KIND::Static, key, load.name, 0, 0, has});
    }
    for (const auto& [key, combination] : m_doc.Data().Model().combinations) {
        T_LCOM_D flat;
        const bool has = m_doc.Attr().NormalizeLcom(combination, flat) != 0 &&
                         std::ranges::all_of(flat.items, [&](const T_LCOM_ITEM& item) {
                             return analysed.contains(item.key);
                         });
        sources.push_back({S::KIND::Combination, key, combination.name, 0, 0, has});
    }
}

/// Every load case that has steps, and every direction of its static angle that has.
void CFrameScene::AddPushes(std::vector<T_SHAPE_SOURCE>& sources)
{
    CPostCtrl& post = m_doc.Post();
    std::vector<T_PUSH_RESULT_ID> results = PushResultsOf(m_doc);
    for (const auto& [key, push] : m_doc.Data().Model().pushovers)
        if (HasImportedSteps(m_doc, key)) results.push_back({key, 0, push.name});
    std::ranges::sort(results, {},
                      [](const T_PUSH_RESULT_ID& id) { return std::pair(id.key, id.turn); });
    for (const T_PUSH_RESULT_ID& id : results) {
        std::string why;
        if (!post.SelectPushover(id.key, id.turn) || post.GetStepCount() == 0) continue;
        const bool old = post.IsStale(id.key, why, id.turn);
        sources.push_back({S::KIND::Pushover, id.key,
                           old ? Say("IDS_QM_UI_PUSH_OLD_NAME", id.name) : id.name,
                           post.GetStepCount(), id.turn});
    }
}

std::vector<T_SHAPE_SOURCE> CFrameScene::Sources()
{
    const T_MODEL& model = m_doc.Data().Model();
    std::vector<S> sources{{}};
    AddStatic(sources);
    const bool staged = !model.stages.empty() && m_doc.Post().CheckStagedResult();
    for (const auto& [key, stage] : model.stages)
        sources.push_back({S::KIND::Stage, key, stage.name, stage.steps, 0, staged});
    AddPushes(sources);
    for (const auto& entry : model.modes)
        sources.push_back({S::KIND::Mode, entry.first, std::to_string(entry.first), 0});
    return sources;
}

/// read(node, values) gives 1, or 0 with the reason in the post-processor.
template <class F>
int CFrameScene::ReadNodes(F read, T_MOVES& out)
{
    T_MOVES moves(m_scene.nodes.size());
    for (std::size_t n = 0; n < moves.size(); ++n) {
        T_DOF6 values{};
        if (!read(m_scene.nodes[n].id, values)) {
            m_error = m_doc.Post().Error();
            return 0;
        }
        moves[n] = {values[0], values[1], values[2]};
    }
    out = std::move(moves);
    return 1;
}

int CFrameScene::FlatAxis(const T_FRAME_SCENE& scene)
{
    for (const int d : {1, 0, 2}) { // frames usually stand in XZ
        const auto axis = static_cast<std::size_t>(d);
        const auto same = [&](const T_SCENE_NODE& node) {
            return node.xyz[axis] == scene.nodes.front().xyz[axis];
        };
        if (scene.nodes.size() > 1 && std::ranges::all_of(scene.nodes, same)) return d;
    }
    return -1;
}

/// All steps at once: a slider then reads no file.
int CFrameScene::ReadSeries(int key)
{
    if (m_pushover == key) return 1;
    const auto result = m_doc.Data().Content().results.find(key);
    if (result == m_doc.Data().Content().results.end()) return 0;
    const T_UNITS units = m_doc.Unit().Units();
    std::vector<std::vector<double>> series(m_scene.nodes.size());
    for (std::size_t n = 0; n < series.size(); ++n) {
        if (!result->second->HasNode(m_scene.nodes[n].id)) continue;
        if (!result->second->ReadDisplacements(m_scene.nodes[n].id, series[n])) {
            m_error = result->second->Error();
            return 0;
        }
        for (double& u : series[n])
            u = FromSi(u, units, kDimLength);
    }
    m_series = std::move(series);
    m_pushover = key;
    return 1;
}

int CFrameScene::ReadPushover(const T_SHAPE_SOURCE& source, int step, T_MOVES& out)
{
    const int key = source.key;
    const auto push = m_doc.Data().Model().pushovers.find(key);
    if (push == m_doc.Data().Model().pushovers.end() || step < 1) return 0;
    if (IPushRun* const run = m_doc.Post().RunOf(key, source.turn)) {
        std::vector<T_DOF6> shape;
        if (run->ReadShape(step, shape)) {
            out = MovesOf(m_scene, run->NodeIds(), shape, m_doc.Unit().Units());
            return 1;
        }
        m_error = run->Error();
        return 0;
    }
    const auto direction = static_cast<std::size_t>(push->second.direction - 1);
    if (direction < 3 && !ReadSeries(key)) return 0;
    out.assign(m_scene.nodes.size(), {});
    const auto index = static_cast<std::size_t>(step - 1);
    for (std::size_t n = 0; direction < 3 && n < out.size(); ++n) // a rotation moves no node
        if (index < m_series[n].size()) out[n][direction] = m_series[n][index];
    return 1;
}

int CFrameScene::Read(const T_SHAPE_SOURCE& source, int step, T_MOVES& out)
{
    (void)Scene();
    m_error.clear();
    CPostCtrl& post = m_doc.Post();
    switch (source.kind) {
    case S::KIND::Static:
        if (!post.SelectLoadCombNew(CPostCtrl::MakeLoadComb(source.key))) return 0;
        return ReadNodes([&](int node, T_DOF6& v) { return post.GetDispNew(node, v); }, out);
    case S::KIND::Combination:
        if (!post.SelectLoadCombNew(source.key)) return 0;
        return ReadNodes([&](int node, T_DOF6& v) { return post.GetDispNew(node, v); }, out);
    case S::KIND::Stage:
        post.SelectStage(source.key, step, kStageLoadSum);
        return ReadNodes([&](int node, T_DOF6& v) { return post.GetDspcNew(node, v); }, out);
    case S::KIND::Pushover:
        return ReadPushover(source, step, out);
    case S::KIND::Mode: {
        if (!post.SelectMode(source.key)) return 0;
        return ReadNodes(
            [&](int node, T_DOF6& v) {
                post.GetEiMode(node, v);
                return 1;
            },
            out);
    }
    case S::KIND::None:
        break;
    }
    out.assign(m_scene.nodes.size(), {});
    return 1;
}

std::vector<T_SCENE_DRIFT> CFrameScene::Drifts(const T_SHAPE_SOURCE& source, int step)
{
    std::vector<T_SCENE_DRIFT> out;
    std::vector<T_STOREY_DRIFT> drifts;
    if (source.kind != S::KIND::Pushover ||
        !m_doc.Post().GetPushoverStoryDrifts(source.key, step, drifts, source.turn))
        return out;
    const auto& storeys = m_doc.Data().Model().storeys;
    double base = std::numeric_limits<double>::infinity();
    for (const T_SCENE_NODE& node : Scene().nodes)
        base = std::min(base, node.xyz[2]);
    double bottom = base, top = base;
    std::size_t next = 0;
    for (const auto& [key, storey] : storeys) {
        top += m_doc.Unit().ConvertUnitLengthOut(storey.height);
        if (next == drifts.size() || drifts[next].storey != key) continue;
        out.push_back({storey.name, bottom, top, drifts[next++].plain});
        bottom = top;
    }
    return out;
}

double CFrameScene::RoundScale(const T_FRAME_SCENE& scene, const T_MOVES& displacement)
{
    double largest = 0.0;
    for (const auto& move : displacement)
        largest = std::max(largest, Length(move));
    const double wanted = kShown * SizeOf(scene);
    if (!(largest > 0.0) || !(wanted > 0.0)) return 1.0;
    const double scale = wanted / largest;
    const double power = std::pow(10.0, std::floor(std::log10(scale)));
    for (const double digit : {5.0, 2.0})
        if (scale >= digit * power) return digit * power;
    return power;
}
