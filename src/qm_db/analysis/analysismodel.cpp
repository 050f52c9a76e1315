#include "qm_db/analysis/analysismodel.h"

#include "qm_base/say.h"
#include "qm_db/sectionproperties.h"

#include <algorithm>

namespace {

constexpr double kStandardGravity = 9.80665; // m/s2

// By MODEL_PLANE: the directions out of the plane.
constexpr std::array<solver::T_DIRS6, 3> kOutOfPlane{{{false, false, true, true, true, false},
                                                      {false, true, false, true, false, true},
                                                      {true, false, false, false, true, true}}};

constexpr long kAbsent = -1;

// Enumerations that are converted by number.
static_assert(static_cast<int>(ELEM_KIND::Beam) == static_cast<int>(solver::ELEMENT_KIND::Beam) &&
              static_cast<int>(ELEM_KIND::Truss) == static_cast<int>(solver::ELEMENT_KIND::Truss) &&
              static_cast<int>(ELEM_KIND::Link) == static_cast<int>(solver::ELEMENT_KIND::Link) &&
              static_cast<int>(ELEM_KIND::Spring) ==
                  static_cast<int>(solver::ELEMENT_KIND::Spring));
static_assert(static_cast<int>(BEAM_LOAD_TYPE::Point) ==
                  static_cast<int>(solver::BEAM_LOAD::Point) &&
              static_cast<int>(BEAM_LOAD_TYPE::Moment) ==
                  static_cast<int>(solver::BEAM_LOAD::Moment));
static_assert(static_cast<int>(ANALYSIS_FAULT::Mechanism) ==
                  static_cast<int>(solver::SOLVER_FAULT::Mechanism) &&
              static_cast<int>(ANALYSIS_FAULT::Failed) ==
                  static_cast<int>(solver::SOLVER_FAULT::Failed));

/// Index of an id in an ascending list.
long IndexOf(const std::vector<int>& ids, int id)
{
    const auto it = std::lower_bound(ids.begin(), ids.end(), id);
    return it == ids.end() || *it != id ? kAbsent : static_cast<long>(it - ids.begin());
}

template <class T>
std::vector<int> KeysOf(const T_TABLE<T>& table)
{
    std::vector<int> keys;
    for (const auto& entry : table)
        keys.push_back(entry.first);
    return keys;
}

int Refuse(T_ANALYSIS_ERROR error, std::string text, T_ANALYSIS_ERROR& out)
{
    out = std::move(error);
    out.fault = ANALYSIS_FAULT::BadModel;
    out.text = std::move(text);
    return 0;
}

std::string ElementText(const T_ELEM_D& e)
{
    constexpr const char* kKinds[] = {"IDS_QM_ANALYSIS_BEAM", "IDS_QM_ANALYSIS_TRUSS",
                                      "IDS_QM_ANALYSIS_LINK", "IDS_QM_ANALYSIS_SPRING"};
    return Say(kKinds[static_cast<std::size_t>(e.kind)], std::to_string(e.id));
}

std::string CaseText(const T_STLD_D& record)
{
    return Say("IDS_QM_ANALYSIS_CASE", record.name);
}

std::string NoNode(int id)
{
    return Say("IDS_QM_ANALYSIS_NO_NODE", std::to_string(id));
}

solver::T_NODE NodeOf(const T_NODE_D& record, const solver::T_DIRS6& outOfPlane)
{
    solver::T_NODE node;
    node.xyz = record.xyz;
    node.mass = record.mass;
    for (std::size_t d = 0; d < node.fixed.size(); ++d)
        node.fixed[d] = outOfPlane[d] || record.restraint[d] != 0;
    return node;
}

solver::T_MATERIAL MaterialOf(const T_MATL_D& m)
{
    return {m.E, ShearModulus(m), m.density, m.alpha};
}

/// Of a shape with dimensions, what follows from these; zero for a section that is wrong.
solver::T_SECTION SectionOf(const T_SECT_D& record)
{
    T_SECT_D s, stiff;
    SECT_FAULT fault{};
    if (!CSectionProperties::Calc(record, s, fault) || !CalcStiffness(record, stiff, fault))
        return {};
    return {s.area, stiff.Asy, stiff.Asz, stiff.J, stiff.Iyy, stiff.Izz, stiff.area};
}

/// What is wrong with a section, empty for nothing.
std::string SectionFault(const T_SECT_D& record)
{
    T_SECT_D ignored;
    SECT_FAULT fault{};
    if (CalcStiffness(record, ignored, fault)) return {};
    return Say("IDS_QM_ANALYSIS_SECTION", record.name, Say(MessageKeyOf(fault)));
}

std::vector<std::size_t> IndicesOf(const std::vector<int>& all, const std::vector<int>& ids)
{
    std::vector<std::size_t> out;
    for (const int id : ids)
        out.push_back(static_cast<std::size_t>(IndexOf(all, id)));
    return out;
}

// One load of each kind; its node or element is set by the caller.
solver::T_NODAL_LOAD LoadOf(const T_NODAL_LOAD& l)
{
    return {0, l.load};
}
solver::T_SETTLEMENT LoadOf(const T_SETTLEMENT& l)
{
    return {0, l.displacement};
}
solver::T_BEAM_LOAD LoadOf(const T_BEAM_LOAD& l)
{
    return {0,
            static_cast<solver::BEAM_LOAD>(l.type),
            l.axes == BEAM_LOAD_AXES::Local,
            l.direction,
            l.w,
            l.at};
}
solver::T_TEMPERATURE LoadOf(const T_TEMPERATURE_LOAD& l)
{
    return {0, l.change};
}
solver::T_PRETENSION LoadOf(const T_PTNS_D& l)
{
    return {0, l.force};
}

} // namespace

solver::T_DIRS6 CAnalysisModel::OutOfPlane() const
{
    const auto& plane = m_model.styp.plane;
    return plane ? kOutOfPlane[static_cast<std::size_t>(*plane)] : solver::T_DIRS6{};
}

int CAnalysisModel::FailElement(const T_ELEM_D& e, const std::string& reason,
                                T_ANALYSIS_ERROR& error) const
{
    T_ANALYSIS_ERROR place;
    place.element = e.id;
    return Refuse(place, ElementText(e) + ": " + reason, error);
}

int CAnalysisModel::AddElement(const T_ELEM_D& e, T_ANALYSIS_ERROR& error)
{
    solver::T_ELEMENT out;
    out.kind = static_cast<solver::ELEMENT_KIND>(e.kind);
    const bool spring = e.kind == ELEM_KIND::Spring;
    const long i = IndexOf(m_nodes, e.nodeI), j = spring ? i : IndexOf(m_nodes, e.nodeJ);
    if (i == kAbsent || j == kAbsent) {
        const int node = i == kAbsent ? e.nodeI : e.nodeJ;
        return FailElement(e, NoNode(node), error);
    }
    out.i = static_cast<std::size_t>(i);
    out.j = static_cast<std::size_t>(j);
    if (e.kind == ELEM_KIND::Beam || e.kind == ELEM_KIND::Truss) {
        const long material = IndexOf(m_materials, e.material);
        const long section = IndexOf(m_sections, e.section);
        if (material == kAbsent) return FailElement(e, Say("IDS_QM_ENGINE_NO_MATERIAL"), error);
        if (section == kAbsent) return FailElement(e, Say("IDS_QM_ENGINE_NO_SECTION"), error);
        const std::string fault = SectionFault(m_model.sections.at(e.section));
        if (!fault.empty()) return FailElement(e, fault, error);
        out.material = static_cast<std::size_t>(material);
        out.section = static_cast<std::size_t>(section);
    }
    out.zAxis = e.zAxis;
    out.releaseI = e.release.I;
    out.releaseJ = e.release.J;
    out.offsetI = e.offset.I;
    out.offsetJ = e.offset.J;
    out.stiffness = e.stiffness;
    m_frame.elements.push_back(out);
    return 1;
}

int CAnalysisModel::BuildFrame(T_ANALYSIS_ERROR& error)
{
    m_frame = {};
    m_frame.gravity = m_model.styp.gravity.value_or(kStandardGravity);
    m_nodes = KeysOf(m_model.nodes);
    m_elements = KeysOf(m_model.elements);
    m_materials = KeysOf(m_model.materials);
    m_sections = KeysOf(m_model.sections);
    for (const auto& entry : m_model.nodes)
        m_frame.nodes.push_back(NodeOf(entry.second, OutOfPlane()));
    for (const auto& entry : m_model.materials)
        m_frame.materials.push_back(MaterialOf(entry.second));
    for (const auto& entry : m_model.sections)
        m_frame.sections.push_back(SectionOf(entry.second));
    for (const auto& entry : m_model.elements) {
        if (!AddElement(entry.second, error)) return 0;
    }
    const auto known = [&](const std::vector<int>& ids, const char* what, int key) {
        for (const int id : ids) {
            T_ANALYSIS_ERROR place;
            place.node = id;
            if (IndexOf(m_nodes, id) == kAbsent)
                return Refuse(place, Say(what, std::to_string(key)) + ": " + NoNode(id), error);
        }
        return 1;
    };
    for (const auto& [key, d] : m_model.diaphragms) {
        if (!known(d.nodes, "IDS_QM_DB_USER_DIAPHRAGM", key)) return 0;
        m_frame.diaphragms.push_back({IndicesOf(m_nodes, d.nodes), d.normal});
    }
    for (const auto& [key, e] : m_model.equalDisplacements) {
        if (!known(e.nodes, "IDS_QM_DB_USER_EQUAL", key)) return 0;
        m_frame.equalDisplacements.push_back({IndicesOf(m_nodes, e.nodes), e.directions});
    }
    return 1;
}

template <class L, class T>
int CAnalysisModel::AddNodeLoads(const T_STLD_D& record, const std::vector<L>& from,
                                 std::vector<T>& to, T_ANALYSIS_ERROR& error) const
{
    for (const L& load : from) {
        const long index = IndexOf(m_nodes, load.node);
        if (index == kAbsent) {
            T_ANALYSIS_ERROR place;
            place.node = load.node;
            return Refuse(place, CaseText(record) + ": " + NoNode(load.node), error);
        }
        to.push_back(LoadOf(load));
        to.back().node = static_cast<std::size_t>(index);
    }
    return 1;
}

template <class L, class T>
int CAnalysisModel::AddElementLoads(const T_STLD_D& record, const std::vector<L>& from,
                                    std::vector<T>& to, T_ANALYSIS_ERROR& error) const
{
    for (const L& load : from) {
        const long index = IndexOf(m_elements, load.element);
        if (index == kAbsent) {
            T_ANALYSIS_ERROR place;
            place.element = load.element;
            const std::string id = std::to_string(load.element);
            return Refuse(place, CaseText(record) + ": " + Say("IDS_QM_ANALYSIS_NO_ELEMENT", id),
                          error);
        }
        to.push_back(LoadOf(load));
        to.back().element = static_cast<std::size_t>(index);
    }
    return 1;
}

int CAnalysisModel::BuildCase(int key, solver::T_LOAD_CASE& out, T_ANALYSIS_ERROR& error) const
{
    const auto it = m_model.loadCases.find(key);
    T_ANALYSIS_ERROR place;
    place.loadCase = key;
    if (it == m_model.loadCases.end())
        return Refuse(place, Say("IDS_QM_ANALYSIS_NO_CASE", std::to_string(key)), error);
    const T_STLD_D& record = it->second;
    solver::T_LOAD_CASE loads;
    loads.selfWeight = record.selfWeight;
    const bool done = AddNodeLoads(record, record.nodal, loads.nodal, error) &&
                      AddNodeLoads(record, record.settlement, loads.settlement, error) &&
                      AddElementLoads(record, record.beam, loads.beam, error) &&
                      AddElementLoads(record, record.temperature, loads.temperature, error) &&
                      AddElementLoads(record, record.pretension, loads.pretension, error);
    if (done)
        out = std::move(loads);
    else
        error.loadCase = key;
    return done ? 1 : 0;
}

T_STATIC_DATA CAnalysisModel::ResultOf(const solver::T_RESULT& result,
                                       std::uint64_t fingerprint) const
{
    return {fingerprint, m_nodes, result.displacement, result.reaction, m_elements, result.force};
}

T_EIGV_D CAnalysisModel::ModeOf(const solver::T_MODE& mode) const
{
    T_EIGV_D out;
    out.period = mode.period;
    for (std::size_t i = 0; i < m_nodes.size(); ++i)
        out.shape.emplace_hint(out.shape.end(), m_nodes[i], mode.shape[i]);
    out.participation = mode.participation;
    out.massPercent = mode.massPercent;
    return out;
}

T_ANALYSIS_ERROR CAnalysisModel::ErrorOf(const solver::T_SOLVER_ERROR& error,
                                         std::span<const int> cases) const
{
    T_ANALYSIS_ERROR out;
    out.fault = static_cast<ANALYSIS_FAULT>(error.fault);
    out.direction = error.direction;
    for (const std::size_t index : error.part)
        out.part.push_back(m_nodes[index]);
    const auto add = [&](const std::string& place) {
        out.text += (out.text.empty() ? "" : ", ") + place;
    };
    if (error.loadCase >= 0 && static_cast<std::size_t>(error.loadCase) < cases.size()) {
        out.loadCase = cases[static_cast<std::size_t>(error.loadCase)];
        add(CaseText(m_model.loadCases.at(out.loadCase)));
    }
    if (error.element >= 0) {
        out.element = m_elements[static_cast<std::size_t>(error.element)];
        add(ElementText(m_model.elements.at(out.element)));
    }
    if (error.node >= 0) {
        out.node = m_nodes[static_cast<std::size_t>(error.node)];
        const std::string node = std::to_string(out.node);
        add(out.part.size() > 1 ? Say("IDS_QM_ANALYSIS_PART", std::to_string(out.part.size()), node)
                                : Say("IDS_QM_ANALYSIS_NODE", node));
    }
    out.text += (out.text.empty() ? "" : ": ") + error.reason.Text();
    return out;
}
