// Linear analysis through the program: both bridges against another solver's recorded results,
// tables, pictures, storing, refusals.
#include "program.h"

#include <algorithm>
#include <cmath>
#include <fstream>
#include <map>
#include <regex>
#include <sstream>

namespace {

struct T_ROW {
    std::string loadCase, id;
    std::vector<double> values;
};

/// case,id,value,... with a head; ten digits.
std::vector<T_ROW> ReadCsv(const std::string& bridge, const std::string& file)
{
    std::ifstream in(ProjectFolder() / "tests/data/linear" / bridge / (file + ".csv"));
    std::vector<T_ROW> rows;
    std::string line;
    std::getline(in, line);
    while (std::getline(in, line)) {
        std::istringstream cells(line);
        T_ROW row;
        std::getline(cells, row.loadCase, ',');
        std::getline(cells, row.id, ',');
        for (std::string cell; std::getline(cells, cell, ',');)
            row.values.push_back(std::stod(cell));
        rows.push_back(std::move(row));
    }
    return rows;
}

/// The source's plane is X, Y with its rotation about Z; the examples stand in X, Z, and a positive
/// rotation about the source's axis is a negative one about Y.
double Plane(const json& six, std::size_t column)
{
    static constexpr std::size_t kAt[] = {0, 2, 4};
    return six.at(kAt[column]).get<double>() * (column == 2 ? -1.0 : 1.0);
}

double Single(const json& force, std::size_t)
{
    return force;
}

/// Forces of the nodes on the element: minus the internal ones at I, those at J. Local z is the
/// source's y; local y points against the source's z.
double EndForce(const json& beam, std::size_t column)
{
    return Plane(beam.at(column < 3 ? 0 : 4), column % 3) * (column < 3 ? -1.0 : 1.0);
}

const struct {
    const char* file;
    const char* key; // in the program's results
    double (*value)(const json& found, std::size_t column);
} kTables[] = {{"displacements", "displacements", Plane},
               {"reactions", "reactions", Plane},
               {"truss_forces", "truss", Single},
               {"beam_end_forces", "beam", EndForce}};

class Linear : public CProgramTest {
protected:
    void ExpectRecorded(const std::string& example, const std::string& bridge,
                        std::size_t atLeast) const
    {
        const json results = Json("analyse @" + example);
        std::size_t compared = 0;
        for (const auto& table : kTables) {
            const std::vector<T_ROW> rows = ReadCsv(bridge, table.file);
            // Translations and rotations, forces and moments: each has its own largest value.
            std::map<std::pair<std::string, bool>, double> scale;
            for (const T_ROW& row : rows)
                for (std::size_t c = 0; c < row.values.size(); ++c) {
                    double& largest = scale[{row.loadCase, c % 3 == 2}];
                    largest = std::max(largest, std::fabs(row.values[c]));
                }
            for (const T_ROW& row : rows)
                for (std::size_t c = 0; c < row.values.size(); ++c, ++compared) {
                    const json& found = results.at(table.key).at(row.loadCase).at(row.id);
                    const double largest = scale[{row.loadCase, c % 3 == 2}];
                    EXPECT_NEAR(row.values[c], table.value(found, c), 1e-8 * largest + 1e-10)
                        << table.file << " " << row.loadCase << " " << row.id << " " << c;
                }
        }
        EXPECT_GE(compared, atLeast);
    }
};

TEST_F(Linear, BridgesGiveTheRecordedResults)
{
    ExpectRecorded("cable-stayed-bridge", "cable_stayed", 24 * (20 * 3 + 3 * 3 + 9 + 18 * 6));
    ExpectRecorded("truss-arch", "truss_arch", 17 * (26 * 2 + 2 * 2 + 49));
}

TEST_F(Linear, NineModesOfThreeRigidFloorsTakeAllOfTheirMass)
{
    const json results = Json("analyse @space-frame-3d --modes 9");
    const json& modes = results.at("modes");
    ASSERT_EQ(9U, modes.size());
    double sum[6] = {};
    for (std::size_t i = 0; i < modes.size(); ++i) {
        const json& mode = modes[i];
        EXPECT_LE(mode.at("period"), modes[i > 0 ? i - 1 : 0].at("period"));
        for (std::size_t k = 0; k < 6; ++k)
            sum[k] += mode.at("mass_percent").at(k).get<double>();
        // Node 107 stands 10 m from node 101 in y on one floor: it moves as a rigid body.
        const json &a = mode.at("shape").at("101"), &b = mode.at("shape").at("107");
        EXPECT_NEAR(-10.0 * a[5].get<double>(), b[0].get<double>() - a[0].get<double>(), 1e-10);
    }
    for (const std::size_t k : {0U, 1U, 5U}) // columns that stretch keep a trace for themselves
        EXPECT_NEAR(100.0, sum[k], 1e-3) << k;
    // By hand: warm girders between rigid floors are compressed with E A alpha 20 degrees.
    for (const json& row : results.at("beam").at("T").at("10"))
        EXPECT_NEAR(-3.3e7 * 0.165 * 1e-5 * 20.0, row.at(0), 1e-6);
}

TEST_F(Linear, TablesHaveUnitsAndColumnsThatStandApart)
{
    const std::string out = Done("analyse @cable-stayed-bridge --case DEAD");
    ExpectHolds(out, {"DX (m)", "RY (rad)", "FZ (kN)", "MY (kN*m)", "Vz (kN)", "My (kN*m)",
                      "N (kN)", "== DEAD"});
    const std::regex nodeRow(R"( *\d+(  +-?[\d.]+(e[-+]\d+)?){6} *)");
    EXPECT_EQ(20 + 3, std::ranges::count_if(
                          Lines(out),
                          [&](const std::string& line) { return std::regex_match(line, nodeRow); }))
        << "nodes and supports";
}

TEST_F(Linear, ShowsWhatIsChosenAndTheEnvelopeOfTheCases)
{
    const std::string file = "analyse @cable-stayed-bridge --case DEAD --case SERVICE --case WIND";
    const json all = Json(file).at("displacements");
    const json some = Json(file + " --node 3,5-6").at("displacements").at("DEAD");
    EXPECT_EQ((json{{"3", all.at("DEAD").at("3")},
                    {"5", all.at("DEAD").at("5")},
                    {"6", all.at("DEAD").at("6")}}),
              some);
    std::map<double, std::string> byValue; // DZ of node 5
    for (const auto& [name, nodes] : all.items())
        byValue[nodes.at("5").at(2)] = name;
    const std::vector<std::string> lines = Lines(Done(file + " --envelope --node 5"));
    const auto row = std::ranges::find_if(lines, [](const std::string& line) {
        return std::regex_search(line, std::regex(R"(^ +5  DZ )"));
    });
    ASSERT_NE(lines.end(), row);
    std::istringstream cells(*row);
    std::string id, component, unit, at, atMax;
    double min = 0.0, max = 0.0;
    cells >> id >> component >> unit >> min >> at >> max >> atMax;
    EXPECT_NEAR(byValue.begin()->first, min, 1e-5 * std::fabs(min));
    EXPECT_NEAR(byValue.rbegin()->first, max, 1e-5 * std::fabs(max));
    EXPECT_EQ(byValue.begin()->second + " " + byValue.rbegin()->second, at + " " + atMax);

    // The beam of the largest bending moment stands alone, and is the one that the summary names.
    const std::string top = Done("analyse @cable-stayed-bridge --case DEAD --top 1");
    EXPECT_EQ(1, std::ranges::count_if(Lines(top), [](const std::string& line) {
                  return std::regex_search(line, std::regex(R"(^ *\d+   I )"));
              }));
    ExpectRefused("analyse @cable-stayed-bridge --node 999", 2, "999");
}

TEST_F(Linear, AModelFileKeepsItsResultsUnlessToldNotTo)
{
    Done("import @tuned-beam m.qmdb");
    const std::string before = Text("m.qmdb");
    Done("analyse m.qmdb --no-store");
    EXPECT_EQ(before, Text("m.qmdb"));
    ExpectRefused("ulf solve m.qmdb --item PROPS", 3, "\"W\""); // no results of that case yet
    Done("analyse m.qmdb --json r.json");
    EXPECT_NE(before, Text("m.qmdb"));
    Done("ulf solve m.qmdb --item PROPS");
    EXPECT_EQ(Json("analyse @tuned-beam"), json::parse(Text("r.json")));
}

#ifdef QM_UI
TEST_F(Linear, PictureOfTheDeformedShapeStatesItsScale)
{
    Done("analyse @cable-stayed-bridge --case DEAD --case WIND --plot s.svg --plot-case WIND");
    ExpectHolds(Text("s.svg"),
                {"Undeformed", "WIND, displacements", "Z (m)", "largest displacement"});
}
#endif

// By hand: L 2 m, mean Iy factor 0.4, area factor 0.5: UZ = 12 L3/(3 E 0.4 Iy), UX = 100 L/(E 0.5
// A); warmed by 50 degrees alpha 50 L whatever EA is; weight density g A L of the whole area.
TEST_F(Linear, StiffnessFactorsOfSectionsCountAndNotInTheWeight)
{
    json file = json::parse(R"({"format": "qm-rps case 1",
        "units": {"force": "kN", "length": "m"}, "plane": "XZ",
        "nodes": [{"id": 1, "xyz": [0, 0, 0], "restraint": [1, 1, 1, 1, 1, 1]},
                  {"id": 2, "xyz": [2, 0, 0]}],
        "materials": [{"name": "S", "E": 200e6, "nu": 0.3, "density": 7.85, "alpha": 1.2e-5}],
        "sections": [{"name": "cracked", "A": 0.02, "Iy": 8e-5, "Iz": 4e-5, "J": 1e-5,
                      "factors_I": {"area": 0.5, "Iyy": 0.3},
                      "factors_J": {"area": 0.5, "Iyy": 0.5}}],
        "elements": [{"id": 1, "nodes": [1, 2], "material": "S", "section": "cracked"}],
        "load_cases": [{"name": "P", "nodal": [{"node": 2, "load": [100, 0, -12, 0, 0, 0]}]},
                       {"name": "T", "temperature": [{"element": 1, "change": 50}]},
                       {"name": "W", "self_weight": [0, 0, -1]}]})");
    Write("c.json", file.dump(1));
    const json r = Json("analyse c.json");
    const json& moved = r.at("displacements").at("P").at("2");
    EXPECT_NEAR(-0.005, moved[2], 1e-12);
    EXPECT_NEAR(1e-4, moved[0], 1e-14);
    EXPECT_NEAR(1.2e-3, r["displacements"]["T"]["2"][0], 1e-13);
    EXPECT_NEAR(7.85 * 9.80665 * 0.02 * 2, r["reactions"]["W"]["1"][2], 1e-9);
    ExpectHolds(Run("analyse c.json").err, {"cracked: area 0.5, Iyy 0.4 (0.3 at I, 0.5 at J)"});
    file["sections"][0]["factors_J"]["Iyy"] = 0;
    Write("c.json", file.dump(1));
    (void)ExpectRefused("analyse c.json", 3, "stiffness factor");
}

TEST_F(Linear, BadModelsAreRefusedWithTheReason)
{
    const struct {
        const char *from, *to;
        const char* says;
    } kRows[] = {
        {"\"restraint\": [1, 0, 1, 0, 0, 0]", "\"restraint\": [0, 0, 1, 0, 0, 0]", "X"},
        {"\"section\": \"HEB 800\", \"z_axis\"", "\"z_axis\"", "section"},
        {"\"id\": 2, \"xyz\": [10, 0, 0]", "\"id\": 2, \"xyz\": [0, 0, 0]", "length"},
        {"{\"case\": \"P3\", \"factor\": 1}", "{\"case\": \"P9\", \"factor\": 1}", "load case"},
        {"{\"case\": \"P3\", \"factor\": 1}", "{\"combination\": \"ALL\", \"factor\": 1}", "ALL"},
    };
    for (const auto& row : kRows) {
        Write("c.json", With(ReadText(ExampleCase("tuned-beam")), row.from, row.to));
        ExpectRefused("analyse c.json --case ALL", 3, row.says);
    }
}

} // namespace
