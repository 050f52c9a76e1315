// Linear analysis through the program: both bridges against another solver's recorded results,
// tables, pictures, storing, refusals.
#include "program.h"

#include <cmath>
#include <fstream>
#include <functional>
#include <gtest/gtest.h>
#include <map>
#include <nlohmann/json.hpp>
#include <sstream>

namespace {

using json = nlohmann::json;

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
/// rotation about the source's axis is a negative one about Y. `place` gives the program's value
/// for a column of the file.
struct T_TABLE {
    const char* file;
    std::function<double(const json&, const T_ROW&, std::size_t column)> place;
};

double Plane(const json& six, std::size_t column)
{
    static constexpr std::size_t kAt[] = {0, 2, 4};
    const double value = six.at(kAt[column]).get<double>();
    return column == 2 ? -value : value;
}

/// Forces of the nodes on the element: minus the internal ones at I, those at J. Local z is the
/// source's y; local y points against the source's z.
double EndForce(const json& beam, std::size_t column)
{
    static constexpr std::size_t kAt[] = {0, 2, 4};
    const std::size_t component = column % 3;
    const double internal = beam.at(column < 3 ? 0 : 4).at(kAt[component]).get<double>();
    const double sign = (column < 3 ? -1.0 : 1.0) * (component == 2 ? -1.0 : 1.0);
    return sign * internal;
}

const T_TABLE kTables[] = {
    {"displacements",
     [](const json& r, const T_ROW& row, std::size_t c) {
         return Plane(r.at("displacements").at(row.loadCase).at(row.id), c);
     }},
    {"reactions",
     [](const json& r, const T_ROW& row, std::size_t c) {
         return Plane(r.at("reactions").at(row.loadCase).at(row.id), c);
     }},
    {"truss_forces",
     [](const json& r, const T_ROW& row, std::size_t) {
         return r.at("truss").at(row.loadCase).at(row.id).get<double>();
     }},
    {"beam_end_forces",
     [](const json& r, const T_ROW& row, std::size_t c) {
         return EndForce(r.at("beam").at(row.loadCase).at(row.id), c);
     }},
};

void ExpectRecorded(const std::string& example, const std::string& bridge, std::size_t atLeast)
{
    const T_RUN run = RunProgram({"analyse", ExampleCase(example), "--json", "-"});
    ASSERT_EQ(0, run.code) << run.err;
    const json results = json::parse(run.out);
    std::size_t compared = 0;
    for (const T_TABLE& table : kTables) {
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
                const double tolerance = 1e-8 * scale[{row.loadCase, c % 3 == 2}];
                EXPECT_NEAR(row.values[c], table.place(results, row, c), tolerance + 1e-10)
                    << example << " " << table.file << " " << row.loadCase << " " << row.id << " "
                    << c;
            }
    }
    EXPECT_GE(compared, atLeast);
}

TEST(Linear, CableStayedBridgeGivesTheRecordedResults)
{
    ExpectRecorded("cable-stayed-bridge", "cable_stayed", 24 * (20 * 3 + 3 * 3 + 9 + 18 * 6));
}

TEST(Linear, TrussArchGivesTheRecordedResults)
{
    ExpectRecorded("truss-arch", "truss_arch", 17 * (26 * 2 + 2 * 2 + 49));
}

TEST(Linear, NineModesOfThreeRigidFloorsTakeAllOfTheirMass)
{
    const CTempFolder folder;
    const T_RUN run = RunProgram(
        {"analyse", ExampleCase("space-frame-3d"), "--modes", "9", "--json", folder / "r.json"});
    ASSERT_EQ(0, run.code) << run.err;
    EXPECT_NE(std::string::npos, run.out.find("T (s)"));
    const json results = json::parse(ReadText(folder / "r.json"));
    const json& modes = results.at("modes");
    ASSERT_EQ(9U, modes.size());
    double sum[6] = {};
    for (std::size_t i = 0; i < modes.size(); ++i) {
        const json& mode = modes[i];
        EXPECT_LE(mode.at("period"), modes[i > 0 ? i - 1 : 0].at("period"));
        for (std::size_t k = 0; k < 6; ++k)
            sum[k] += mode.at("mass_percent").at(k).get<double>();
        // Nodes 101 and 107 stand 10 m apart in y on one floor: it moves as a rigid body.
        const json &a = mode.at("shape").at("101"), &b = mode.at("shape").at("107");
        const double rz = a.at(5), dx = b.at(0).get<double>() - a.at(0).get<double>();
        EXPECT_NEAR(-10.0 * rz, dx, 1e-10);
        EXPECT_NEAR(rz, b.at(5).get<double>(), 1e-10);
    }
    for (const std::size_t k : {0U, 1U, 5U}) // columns that stretch keep a trace for themselves
        EXPECT_NEAR(100.0, sum[k], 1e-3) << k;
    // By hand: warm girders between rigid floors are compressed with E A alpha 20 degrees.
    for (const json& row : results.at("beam").at("T").at("10"))
        EXPECT_NEAR(-3.3e7 * 0.165 * 1e-5 * 20.0, row.at(0).get<double>(), 1e-6);
}

TEST(Linear, CombinationsAreSuperposed)
{
    const T_RUN run = RunProgram({"analyse", ExampleCase("cable-stayed-bridge"), "--case",
                                  "SERVICE", "--case", "DEAD", "--json", "-"});
    ASSERT_EQ(0, run.code) << run.err;
    const json results = json::parse(run.out).at("displacements");
    ASSERT_EQ(2U, results.size());
    const std::vector<T_ROW> rows = ReadCsv("cable_stayed", "displacements");
    double sum = 0.0; // SERVICE: dead and live loads and 1 kN in each stay
    for (const T_ROW& row : rows)
        if (row.id == "10" && row.loadCase != "WIND" && row.loadCase[0] != 'P')
            sum += row.values[1];
    EXPECT_NEAR(sum, results.at("SERVICE").at("10").at(2).get<double>(), 1e-9);
}

TEST(Linear, TablesHaveUnitsAndColumnsThatStandApart)
{
    const T_RUN run = RunProgram({"analyse", ExampleCase("cable-stayed-bridge"), "--case", "DEAD"});
    ASSERT_EQ(0, run.code) << run.err;
    for (const char* head : {"DX (m)", "RY (rad)", "FZ (kN)", "MY (kN*m)", "Vz (kN)", "My (kN*m)",
                             "N (kN)", "== DEAD"})
        EXPECT_NE(std::string::npos, run.out.find(head)) << head;
    std::size_t rows = 0;
    for (const std::string& line : Lines(run.out)) {
        std::istringstream words(line);
        std::vector<std::string> all;
        for (std::string word; words >> word;)
            all.push_back(word);
        // A node's row: its number and six values.
        if (all.size() != 7 || all[0].find_first_not_of("0123456789") != std::string::npos)
            continue;
        ++rows;
        for (const std::string& word : all) {
            std::size_t used = 0;
            (void)std::stod(word, &used);
            EXPECT_EQ(word.size(), used) << line;
        }
    }
    EXPECT_EQ(20U + 3U, rows) << "nodes and supports";
}

TEST(Linear, AModelFileKeepsItsResultsUnlessToldNotTo)
{
    const CTempFolder folder;
    const std::string model = folder / "m.qmdb";
    ASSERT_EQ(0, RunProgram({"import", ExampleCase("tuned-beam"), model}).code);
    const std::string before = ReadText(model);
    ASSERT_EQ(0, RunProgram({"analyse", model, "--no-store"}).code);
    EXPECT_EQ(before, ReadText(model));
    EXPECT_EQ(3, RunProgram({"ulf", "solve", model, "--item", "PROPS"}).code) << "no results yet";
    ASSERT_EQ(0, RunProgram({"analyse", model, "--json", folder / "r.json"}).code);
    EXPECT_NE(before, ReadText(model));
    EXPECT_EQ(0, RunProgram({"ulf", "solve", model, "--item", "PROPS"}).code);
    const json memory =
        json::parse(RunProgram({"analyse", ExampleCase("tuned-beam"), "--json", "-"}).out);
    EXPECT_EQ(memory, json::parse(ReadText(folder / "r.json")));
}

#ifdef QM_UI
TEST(Linear, PictureOfTheDeformedShapeStatesItsScale)
{
    const CTempFolder folder;
    const T_RUN run =
        RunProgram({"analyse", ExampleCase("cable-stayed-bridge"), "--case", "DEAD", "--case",
                    "WIND", "--plot", folder / "s.svg", "--plot-case", "WIND"});
    ASSERT_EQ(0, run.code) << run.err;
    const std::string svg = ReadText(folder / "s.svg");
    for (const char* text : {"Undeformed", "WIND, displacements", "Z (m)", "largest displacement"})
        EXPECT_NE(std::string::npos, svg.find(text)) << text;
}
#endif

/// The tuned beam with one piece of text replaced.
std::string BeamWith(const std::string& from, const std::string& to)
{
    std::string text = ReadText(ExampleCase("tuned-beam"));
    const auto at = text.find(from);
    EXPECT_NE(std::string::npos, at) << from;
    return at == std::string::npos ? text : text.replace(at, from.size(), to);
}

TEST(Linear, BadModelsAreRefusedWithTheReason)
{
    const struct {
        const char* label;
        const char *from, *to;
        const char* says;
    } kRows[] = {
        {"mechanism", "\"restraint\": [1, 0, 1, 0, 0, 0]", "\"restraint\": [0, 0, 1, 0, 0, 0]",
         "X"},
        {"no section", "\"section\": \"HEB 800\", \"z_axis\"", "\"z_axis\"", "section"},
        {"zero length", "\"id\": 2, \"xyz\": [10, 0, 0]", "\"id\": 2, \"xyz\": [0, 0, 0]",
         "length"},
        {"negative area", "\"A\": 0.0334", "\"A\": -0.0334", "negative"},
        {"load on a missing node", "{\"node\": 3, \"load\"", "{\"node\": 33, \"load\"",
         "no such node"},
        {"missing case", "{\"case\": \"P3\", \"factor\": 1}", "{\"case\": \"P9\", \"factor\": 1}",
         "load case"},
        {"combination of itself", "{\"case\": \"P3\", \"factor\": 1}",
         "{\"combination\": \"ALL\", \"factor\": 1}", "ALL"},
    };
    const CTempFolder folder;
    for (const auto& row : kRows) {
        const std::string file = folder / "c.json";
        WriteText(file, BeamWith(row.from, row.to));
        const T_RUN run = RunProgram({"analyse", file, "--case", "ALL"});
        EXPECT_EQ(3, run.code) << row.label << run.out;
        EXPECT_EQ(1U, Lines(run.err).size()) << row.label << ": " << run.err;
        EXPECT_NE(std::string::npos, run.err.find(row.says)) << row.label << ": " << run.err;
    }
}

TEST(Linear, WrongUsageAndFilesHaveTheirExitCodes)
{
    const CTempFolder folder;
    const std::string file = ExampleCase("tuned-beam");
    EXPECT_EQ(2, RunProgram({"analyse", file, "--case", "none"}).code);
    EXPECT_EQ(2, RunProgram({"analyse", file, "--modes", "0"}).code);
    EXPECT_EQ(2, RunProgram({"analyse", file, "--plot", folder / "p.gif"}).code);
    EXPECT_EQ(4, RunProgram({"analyse", folder / "none.json"}).code);
    EXPECT_EQ(4, RunProgram({"analyse", file, "--json", folder / "no/such/folder.json"}).code);
    EXPECT_EQ(3, RunProgram({"analyse", ExampleCase("first-steps")}).code) << "no load cases";
}

} // namespace
