// Two plane bridges against the results of an independent program, which gives 11 digits.
#include "frames.h"

#include "qm_solver/framesolver.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <cmath>
#include <fstream>
#include <map>
#include <sstream>

namespace {

using namespace sample;
using nlohmann::json;

constexpr double kAgree = 1e-10; // of the largest value of a case; the files have 11 digits

const std::map<std::string, std::size_t> kDirection{{"ux", 0}, {"uy", 1}, {"rz", 5},
                                                    {"FX", 0}, {"FY", 1}, {"MZ", 5}};

/// A model file as a frame in the plane X-Y, with its load cases.
struct T_BRIDGE {
    T_FRAME frame;
    std::vector<T_LOAD_CASE> cases;
    std::map<std::string, std::size_t> caseAt;
    std::map<int, std::size_t> nodeAt, elementAt;
};

void AddElements(const json& model, T_BRIDGE& bridge)
{
    T_FRAME& frame = bridge.frame;
    for (const json& e : model["elements"]) {
        T_MATERIAL material;
        material.E = e["E"];
        material.G = 0.4 * material.E; // no part in the plane
        T_SECTION section;
        section.A = e["A"];
        section.Iz = e.value("Iz", 0.0);
        section.Iy = section.J = section.Iz; // no part in the plane
        T_ELEMENT element;
        element.kind = e["type"] == "beam" ? ELEMENT_KIND::Beam : ELEMENT_KIND::Truss;
        element.i = bridge.nodeAt.at(e["nodes"][0]);
        element.j = bridge.nodeAt.at(e["nodes"][1]);
        element.zAxis = {0.0, 0.0, 1.0};
        element.material = element.section = frame.materials.size();
        bridge.elementAt[e["id"]] = frame.elements.size();
        frame.materials.push_back(material);
        frame.sections.push_back(section);
        frame.elements.push_back(element);
    }
}

T_LOAD_CASE CaseOf(const json& c, const T_BRIDGE& bridge)
{
    T_LOAD_CASE load;
    for (const json& l : c.value("nodal_loads", json::array())) {
        T_NODAL_LOAD nodal{bridge.nodeAt.at(l["node"]), {}};
        for (const auto& [name, value] : l["load"].items())
            nodal.load[kDirection.at(name)] = value;
        load.nodal.push_back(nodal);
    }
    for (const json& l : c.value("element_loads", json::array()))
        for (int d = 0; d < 2; ++d) {
            const double w = l[d == 0 ? "wx" : "wy"];
            load.beam.push_back({bridge.elementAt.at(l["element"]),
                                 BEAM_LOAD::Distributed,
                                 true,
                                 d,
                                 {w, w},
                                 {0.0, 1.0}});
        }
    for (const json& l : c.value("initial_forces", json::array()))
        load.pretension.push_back({bridge.elementAt.at(l["element"]), l["force"]});
    for (const json& l : c.value("settlements", json::array())) {
        T_SETTLEMENT settlement{bridge.nodeAt.at(l["node"]), {}};
        settlement.displacement[kDirection.at(l["dof"])] = l["value"];
        load.settlement.push_back(settlement);
    }
    return load;
}

T_BRIDGE ReadBridge(const std::string& name)
{
    T_BRIDGE bridge;
    std::ifstream file(std::string(QM_TEST_DATA) + "/linear/" + name + "/model.json");
    const json model = json::parse(file);
    for (const json& n : model["nodes"]) {
        bridge.nodeAt[n["id"]] = bridge.frame.nodes.size();
        AddNode(bridge.frame, {n["x"], n["y"], 0.0});
        Fix(bridge.frame, bridge.frame.nodes.size() - 1, {2, 3, 4});
    }
    for (const auto& [node, directions] : model["supports"].items())
        for (const std::string d : directions)
            Fix(bridge.frame, bridge.nodeAt.at(std::stoi(node)),
                {static_cast<int>(kDirection.at(d))});
    AddElements(model, bridge);
    for (const json& c : model["load_cases"]) {
        bridge.caseAt[c["id"]] = bridge.cases.size();
        bridge.cases.push_back(CaseOf(c, bridge));
    }
    return bridge;
}

/// What our result holds for one row of a file.
using RowFn = std::vector<double> (*)(const T_BRIDGE&, const T_RESULT&, int id);

std::vector<double> Displacement(const T_BRIDGE& b, const T_RESULT& r, int id)
{
    const T_VEC6& u = r.displacement[b.nodeAt.at(id)];
    return {u[0], u[1], u[5]};
}
std::vector<double> Reaction(const T_BRIDGE& b, const T_RESULT& r, int id)
{
    const T_VEC6& f = r.reaction[b.nodeAt.at(id)];
    return {f[0], f[1], f[5]};
}
std::vector<double> TrussForce(const T_BRIDGE& b, const T_RESULT& r, int id)
{
    return {r.force[b.elementAt.at(id)][0][0]};
}
/// Forces of the nodes on the beam: minus the internal forces at I, those at J.
std::vector<double> BeamEnds(const T_BRIDGE& b, const T_RESULT& r, int id)
{
    const auto& f = r.force[b.elementAt.at(id)];
    return {-f[0][0], -f[0][1], -f[0][5], f[4][0], f[4][1], f[4][5]};
}

/// Largest difference over the largest value of the case, over all cases of the file.
double WorstDifference(const T_BRIDGE& bridge, const std::vector<T_RESULT>& results,
                       const std::string& path, RowFn ours, std::size_t& rows)
{
    std::ifstream file(path);
    EXPECT_TRUE(file) << path;
    std::string line;
    std::getline(file, line);
    std::map<std::string, double> largest, off;
    while (std::getline(file, line)) {
        std::istringstream cells(line);
        std::string name, id, cell;
        std::getline(cells, name, ',');
        std::getline(cells, id, ',');
        const T_RESULT& result = results[bridge.caseAt.at(name)];
        const std::vector<double> values = ours(bridge, result, std::stoi(id));
        for (std::size_t k = 0; std::getline(cells, cell, ','); ++k) {
            const double expected = std::stod(cell);
            largest[name] = std::max(largest[name], std::fabs(expected));
            off[name] = std::max(off[name], std::fabs(expected - values.at(k)));
        }
        ++rows;
    }
    double worst = 0.0;
    for (const auto& [name, difference] : off)
        worst = std::max(worst, difference / largest[name]);
    return worst;
}

struct T_FILE {
    const char *bridge, *file;
    RowFn ours;
    std::size_t rows; // that the file has, so that none goes unread
};

TEST(Reference, EveryRecordedResultIsMet)
{
    const T_FILE files[] = {
        {"truss_arch", "displacements", Displacement, 442},
        {"truss_arch", "reactions", Reaction, 34},
        {"truss_arch", "truss_forces", TrussForce, 833},
        {"cable_stayed", "displacements", Displacement, 480},
        {"cable_stayed", "reactions", Reaction, 72},
        {"cable_stayed", "truss_forces", TrussForce, 216},
        {"cable_stayed", "beam_end_forces", BeamEnds, 432},
    };
    for (const T_FILE& f : files) {
        SCOPED_TRACE(std::string(f.bridge) + " " + f.file);
        const T_BRIDGE bridge = ReadBridge(f.bridge);
        CFrameSolver frameSolver;
        T_SOLVER_ERROR error;
        std::vector<T_RESULT> results;
        ASSERT_TRUE(frameSolver.Prepare(bridge.frame, error)) << error.reason.Text();
        ASSERT_TRUE(frameSolver.Solve(bridge.cases, results, error)) << error.reason.Text();
        std::size_t rows = 0;
        const std::string path =
            std::string(QM_TEST_DATA) + "/linear/" + f.bridge + "/" + f.file + ".csv";
        const double worst = WorstDifference(bridge, results, path, f.ours, rows);
        EXPECT_LE(worst, kAgree);
        EXPECT_EQ(f.rows, rows);
    }
}

} // namespace
