#include "qm_rps/create/building.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/create/buildinggrid.h"
#include "qm_rps/create/buildingparts.h"
#include "qm_rps/create/createfault.h"
#include "qm_rps/dialog/unithead.h"

#include <algorithm>
#include <cmath>
#include <map>

namespace {

constexpr double kGravity = 9.80665; // m/s2

/// Makes the model in SI, part after part.
class CBuildingMaker {
public:
    CBuildingMaker(const T_BUILDING& in, T_FINDING& fault) : m_in(in), m_grid(in), m_fault(fault) {}

    int Make(T_MODEL_CONTENT& out, T_BUILDING_FACTS& facts)
    {
        if (!CheckBuilding(m_in, m_fault) || !AddProperties()) return 0;
        AddNodes();
        AddMembers();
        if (!AddBraces()) return 0;
        AddLoads();
        AddMasses();
        AddStoreys();
        AddCombinations();
        if (const std::string why = ModelFault(m_model); !why.empty())
            return CreateFault(m_fault, "", "IDS_QM_NEW_REFUSED", why);
        FillFacts(facts);
        out = {};
        out.model = std::move(m_model);
        return 1;
    }

private:
    enum PROPERTY { Column = 1, Beam = 2, Brace = 3 }; // keys of sections and materials

    int AddProperties()
    {
        m_model.styp.title = m_in.title;
        m_model.styp.units = m_in.units;
        if (m_grid.IsPlane()) m_model.styp.plane = MODEL_PLANE::XZ;
        const std::tuple<PROPERTY, const char*, const std::string&, const std::string&> parts[] = {
            {Column, "columns", m_in.columns, m_in.columnGrade},
            {Beam, "beams", m_in.beams, m_in.beamGrade},
            {Brace, "braceSection", m_in.braceSection, m_in.braceGrade}};
        for (const auto& [key, field, section, grade] : parts) {
            if (key == Brace && m_in.braces == BUILDING_BRACES::None) continue;
            T_BUILDING_PART part;
            if (!ReadBuildingPart(field, section, grade, m_in.units, part, m_fault)) return 0;
            m_linear[key] = part.area * part.density; // mass per length
            // One name stands once: the same grade or section serves again.
            m_sections[key] = KeyOf(m_model.sections, part.section);
            m_materials[key] = KeyOf(m_model.materials, part.material);
        }
        return 1;
    }

    template <class R>
    static int KeyOf(T_TABLE<R>& table, const R& record)
    {
        for (const auto& [key, other] : table)
            if (other.name == record.name) return key;
        const int key = static_cast<int>(table.size()) + 1;
        table[key] = record;
        return key;
    }

    void AddNodes()
    {
        for (std::size_t level = 0; level < m_grid.Levels(); ++level)
            for (std::size_t iy = 0; iy < m_grid.LinesY(); ++iy)
                for (std::size_t ix = 0; ix < m_grid.LinesX(); ++ix) {
                    const int id = m_grid.Id(ix, iy, level);
                    T_NODE_D node{id, m_grid.At(ix, iy, level), {}, {}};
                    if (level == 0) node.restraint = {1, 1, 1, 0, 0, 0};
                    // A plane frame turns about Y alone; twisting of pinned feet is held.
                    if (level == 0) node.restraint[5] = 1;
                    if (level == 0 && !m_in.isPinned) node.restraint = {1, 1, 1, 1, 1, 1};
                    m_model.nodes[id] = node;
                }
    }

    void AddElement(int i, int j, PROPERTY property, ELEM_KIND kind = ELEM_KIND::Beam)
    {
        T_ELEM_D e;
        e.id = static_cast<int>(m_model.elements.size()) + 1;
        e.nodeI = i;
        e.nodeJ = j;
        e.section = m_sections[property];
        e.material = m_materials[property];
        e.kind = kind;
        m_model.elements[e.id] = e;
        m_property[e.id] = property;
    }

    void AddMembers()
    {
        const auto each = [this](auto add) {
            for (std::size_t level = 1; level < m_grid.Levels(); ++level)
                for (std::size_t iy = 0; iy < m_grid.LinesY(); ++iy)
                    for (std::size_t ix = 0; ix < m_grid.LinesX(); ++ix)
                        add(ix, iy, level);
        };
        each([this](std::size_t ix, std::size_t iy, std::size_t level) {
            AddElement(m_grid.Id(ix, iy, level - 1), m_grid.Id(ix, iy, level), Column);
        });
        each([this](std::size_t ix, std::size_t iy, std::size_t level) {
            if (ix == 0) return;
            AddElement(m_grid.Id(ix - 1, iy, level), m_grid.Id(ix, iy, level), Beam);
            m_beams[level].push_back({static_cast<int>(m_model.elements.size()), true});
        });
        each([this](std::size_t ix, std::size_t iy, std::size_t level) {
            if (iy == 0) return;
            AddElement(m_grid.Id(ix, iy - 1, level), m_grid.Id(ix, iy, level), Beam);
            m_beams[level].push_back({static_cast<int>(m_model.elements.size()), false});
        });
    }

    /// Members that carry axial force alone, in the outer frames, in every storey.
    int AddBraces()
    {
        if (m_in.braces == BUILDING_BRACES::None) return 1;
        std::vector<T_BRACED_BAY> bays;
        if (!m_grid.ReadBays(m_in.braceBays, bays, m_fault)) return 0;
        for (const T_BRACED_BAY& bay : bays)
            for (std::size_t level = 1; level < m_grid.Levels(); ++level) {
                AddElement(m_grid.IdOf(bay.from, level - 1), m_grid.IdOf(bay.to, level), Brace,
                           ELEM_KIND::Truss);
                if (m_in.braces == BUILDING_BRACES::Cross)
                    AddElement(m_grid.IdOf(bay.to, level - 1), m_grid.IdOf(bay.from, level), Brace,
                               ELEM_KIND::Truss);
            }
        return 1;
    }

    // ---- loads and masses ----

    double LengthOf(const T_ELEM_D& e) const
    {
        const auto& a = m_model.nodes.at(e.nodeI).xyz;
        const auto& b = m_model.nodes.at(e.nodeJ).xyz;
        return std::hypot(b[0] - a[0], b[1] - a[1], b[2] - a[2]);
    }

    /// Half of a load to the level of each end, and to its nodes.
    void Spread(const T_ELEM_D& e, double weight, double T_BUILDING_LEVEL::*part, double factor)
    {
        for (const int id : {e.nodeI, e.nodeJ}) {
            m_facts.levels[m_grid.LevelOf(id)].*part += 0.5 * weight;
            m_weight[id] += 0.5 * factor * weight;
        }
    }

    void AddBeamLoad(T_STLD_D& loads, int element, double w) const
    {
        T_BEAM_LOAD load;
        load.element = element;
        load.axes = BEAM_LOAD_AXES::Global;
        load.direction = 2;
        load.w = {-w, -w};
        loads.beam.push_back(load);
    }

    void AddLoads()
    {
        m_facts.levels.resize(m_grid.Levels());
        for (std::size_t i = 0; i < kBuildingCases.size(); ++i)
            m_model.loadCases[static_cast<int>(i) + 1].name = kBuildingCases[i];
        T_STLD_D &self = m_model.loadCases[1], &dead = m_model.loadCases[2],
                 &live = m_model.loadCases[3];
        self.group = dead.group = kLoadGroupDead;
        for (const auto& [id, e] : m_model.elements) {
            const double w = m_linear[m_property[id]] * kGravity, length = LengthOf(e);
            const bool isTruss = e.kind == ELEM_KIND::Truss; // its weight goes to its nodes
            for (const int node : {e.nodeI, e.nodeJ})
                if (isTruss)
                    self.nodal.push_back({node, {0.0, 0.0, -0.5 * w * length, 0.0, 0.0, 0.0}});
            if (!isTruss) AddBeamLoad(self, id, w);
            Spread(e, w * length, &T_BUILDING_LEVEL::self, 1.0);
        }
        for (const auto& [level, beams] : m_beams) {
            const bool isRoof = level + 1 == m_grid.Levels();
            const double g = LineLoad(isRoof ? m_in.deadRoof : m_in.dead);
            const double q = LineLoad(isRoof ? m_in.liveRoof : m_in.live);
            for (const auto& [id, alongX] : beams)
                if (IsLoaded(alongX)) LoadBeam(id, g, q, dead, live);
        }
    }

    void LoadBeam(int id, double g, double q, T_STLD_D& dead, T_STLD_D& live)
    {
        const T_ELEM_D& e = m_model.elements.at(id);
        if (g > 0.0) AddBeamLoad(dead, id, g);
        if (q > 0.0) AddBeamLoad(live, id, q);
        Spread(e, g * LengthOf(e), &T_BUILDING_LEVEL::dead, 1.0);
        Spread(e, q * LengthOf(e), &T_BUILDING_LEVEL::live, m_in.liveInMass);
    }

    bool IsLoaded(bool alongX) const
    {
        return m_in.loaded == LOADED_BEAMS::All || alongX == (m_in.loaded == LOADED_BEAMS::AlongX);
    }
    double LineLoad(double value) const { return ToSi(value, m_in.units, {1, -1}); }

    /// Of the ground nothing moves: its mass is left out.
    void AddMasses()
    {
        for (const auto& [id, weight] : m_weight) {
            const double mass = weight / kGravity;
            if (m_grid.LevelOf(id) == 0) continue;
            m_model.nodes[id].mass = {mass, m_grid.IsPlane() ? 0.0 : mass, mass};
            m_facts.levels[m_grid.LevelOf(id)].mass += mass;
        }
    }

    // ---- storeys and combinations ----

    void AddStoreys()
    {
        for (std::size_t level = 1; level < m_grid.Levels(); ++level) {
            std::vector<int> nodes;
            for (std::size_t iy = 0; iy < m_grid.LinesY(); ++iy)
                for (std::size_t ix = 0; ix < m_grid.LinesX(); ++ix)
                    nodes.push_back(m_grid.Id(ix, iy, level));
            const int key = static_cast<int>(level);
            if (m_in.hasDiaphragms && nodes.size() > 1) m_model.diaphragms[key] = {nodes, 2};
            m_model.storeys[key] = {std::to_string(level) + "F",
                                    ToSi(m_in.storeys[level - 1], m_in.units, kDimLength), nodes};
        }
    }

    // EN 1990 6.4.3.2 (6.10) with the factors of Annex A1, and 6.4.3.4 (6.12b).
    void AddCombinations()
    {
        const auto combine = [](const char* name, double self, double live) {
            return T_LCOM_D{name, {{false, 1, self}, {false, 2, self}, {false, 3, live}}};
        };
        m_model.combinations[1] = combine("ULS", 1.35, 1.5);
        m_model.combinations[2] = combine("G+psi2Q", 1.0, m_in.liveInMass);
        m_model.pushControl.initialLoads = {{1, 1.0}, {2, 1.0}};
        if (m_in.liveInMass != 0.0)
            m_model.pushControl.initialLoads.push_back({3, m_in.liveInMass});
    }

    void FillFacts(T_BUILDING_FACTS& facts)
    {
        const auto force = [this](double v) { return FromSi(v, m_in.units, kDimForce); };
        for (std::size_t i = 0; i < m_facts.levels.size(); ++i) {
            T_BUILDING_LEVEL& level = m_facts.levels[i];
            level.name = i == 0 ? Say("IDS_QM_NEW_GROUND") : std::to_string(i) + "F";
            level.elevation = FromSi(m_grid.At(0, 0, i)[2], m_in.units, kDimLength);
            level.dead = force(level.dead);
            level.live = force(level.live);
            level.self = force(level.self);
            level.mass = FromSi(level.mass, m_in.units, kDimMass);
        }
        m_facts.nodes = m_model.nodes.size();
        m_facts.elements = m_model.elements.size();
        m_facts.plan = m_grid.PlanText();
        facts = std::move(m_facts);
    }

    const T_BUILDING& m_in;
    const CBuildingGrid m_grid;
    T_FINDING& m_fault;
    T_MODEL m_model;
    std::map<int, double> m_linear;             // mass per length, by property
    std::map<int, int> m_sections, m_materials; // keys, by property
    std::map<int, PROPERTY> m_property;         // of each element
    std::map<std::size_t, std::vector<std::pair<int, bool>>> m_beams; // of a level; along X
    std::map<int, double> m_weight;                                   // of the masses, by node
    T_BUILDING_FACTS m_facts;
};

} // namespace

int MakeBuilding(const T_BUILDING& in, T_MODEL_CONTENT& out, T_BUILDING_FACTS& facts,
                 T_FINDING& fault)
{
    return CBuildingMaker(in, fault).Make(out, facts);
}

std::vector<std::string> BuildingHeads(const T_UNITS& units)
{
    const auto force = [&units](const char* key) {
        return HeadWithUnit(Say(key), kDimForce, units);
    };
    return {
        Say("IDS_QM_NEW_HEAD_LEVEL"),  HeadWithUnit("Z", kDimLength, units),
        force("IDS_QM_NEW_HEAD_SELF"), force("IDS_QM_NEW_HEAD_DEAD"),
        force("IDS_QM_NEW_HEAD_LIVE"), HeadWithUnit(Say("IDS_QM_NEW_HEAD_MASS"), kDimMass, units)};
}

std::vector<std::vector<std::string>> BuildingRows(const T_BUILDING_FACTS& facts)
{
    std::vector<std::vector<std::string>> rows;
    T_BUILDING_LEVEL sum;
    const auto number = [](double value) { return FormatText("%.6g", value); };
    const auto add = [&](const T_BUILDING_LEVEL& l, const std::string& elevation) {
        rows.push_back(
            {l.name, elevation, number(l.self), number(l.dead), number(l.live), number(l.mass)});
    };
    for (const T_BUILDING_LEVEL& level : facts.levels) {
        add(level, number(level.elevation));
        sum.self += level.self;
        sum.dead += level.dead;
        sum.live += level.live;
        sum.mass += level.mass;
    }
    sum.name = Say("IDS_QM_NEW_SUM");
    add(sum, "");
    return rows;
}
