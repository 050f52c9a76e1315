// Construction stages through the program: tables, JSON, results in the model file, refusals.
#include "program.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

namespace {

using json = nlohmann::json;

// A cantilever that grows from 2 m to 4 m, first order: 12 kN at 2 m in stage 1, 6 kN at the tip in
// the last of three steps of stage 2; E I = 1e4 kNm2. The stay of stage 3 has 10 kN at first.
constexpr double kEI = 1e4;
constexpr double kDownG = 12 * 8 / (3 * kEI);           // P L3 / (3 E I)
constexpr double kDownE = 6 * 4 * (12 - 2) / (6 * kEI); // P x2 (3 L - x) / (6 E I) at x = 2
constexpr double kTipE = 6 * 64 / (3 * kEI);

/// The case file of that cantilever.
std::string StagedCase(const CTempFolder& folder)
{
    json c = json::parse(ReadText(ProjectFolder() / "tests/data/cases/stage_all_members.json"));
    c.erase("stage_control");
    c["stages"][2].erase("deactivate");
    WriteText(folder / "case.json", c.dump());
    return folder / "case.json";
}

json JsonOf(std::vector<std::string> arguments)
{
    arguments.insert(arguments.end(), {"--json", "-"});
    const T_RUN run = RunProgram(arguments);
    EXPECT_EQ(0, run.code) << run.err;
    return run.code == 0 ? json::parse(run.out) : json{};
}

} // namespace

TEST(Staged, JsonHasEveryStageWithWhatStands)
{
    const CTempFolder folder;
    const json all = JsonOf({"analyse", StagedCase(folder)});
    ASSERT_EQ(3U, all["stages"].size());
    const json& first = all["stages"]["S1"];
    EXPECT_EQ(1, first["step"]);
    EXPECT_EQ("sum", first["load"]);
    EXPECT_EQ(1, first["elements"]);
    EXPECT_EQ(2U, first["displacements"].size());
    EXPECT_NEAR(-kDownG, first["displacements"]["2"][2].get<double>(), 1e-12);
    const json& second = all["stages"]["S2"];
    EXPECT_EQ(3, second["step"]);
    EXPECT_EQ(2, second["elements"]);
    EXPECT_NEAR(-kDownG - kDownE, second["displacements"]["2"][2].get<double>(), 1e-12);
    EXPECT_NEAR(18.0, second["reactions"]["1"][2].get<double>(), 1e-9);
    EXPECT_NEAR(12 * 2 + 6 * 4, std::abs(second["beam"]["1"][0][4].get<double>()), 1e-9);
    EXPECT_EQ(0U, second["truss"].size());
    EXPECT_EQ(1U, all["stages"]["S3"]["truss"].size());
    EXPECT_TRUE(all["displacements"].contains("G")); // the static cases are there as well
}

TEST(Staged, OptionsChooseStageStepAndLoad)
{
    const CTempFolder folder;
    const std::string file = StagedCase(folder);
    struct T_ROW {
        std::vector<std::string> options;
        const char* node;
        double down;
    };
    const T_ROW rows[] = {
        {{"--step", "1"}, "2", kDownG},    {{}, "2", kDownG + kDownE},
        {{"--load", "dead"}, "2", kDownG}, {{"--load", "erection"}, "2", kDownE},
        {{"--load", "E"}, "3", kTipE},     {{"--step", "2", "--load", "E"}, "3", 0.0},
    };
    for (const T_ROW& row : rows) {
        std::vector<std::string> arguments{"analyse", file, "--stage", "S2"};
        arguments.insert(arguments.end(), row.options.begin(), row.options.end());
        const json found = JsonOf(arguments);
        EXPECT_EQ(1U, found["stages"].size());
        EXPECT_TRUE(found["displacements"].empty()); // no static case was asked for
        EXPECT_NEAR(-row.down, found["stages"]["S2"]["displacements"][row.node][2].get<double>(),
                    1e-12)
            << row.down;
    }
}

TEST(Staged, TextGivesALineForEachStageAndTablesForOne)
{
    const CTempFolder folder;
    const std::string file = StagedCase(folder);
    const T_RUN brief = RunProgram({"analyse", file});
    ASSERT_EQ(0, brief.code) << brief.err;
    // kDownG = 0.0032 m; the tip at the last step of S2: E alone, as element 2 is born straight.
    EXPECT_NE(std::string::npos,
              brief.out.find("stage \"S1\", step 1 of 1, sum, 1 elements: largest displacement "
                             "0.0032 m at node 2; sum of reactions X 0, Y 0, Z 12 kN"))
        << brief.out;
    EXPECT_NE(std::string::npos,
              brief.out.find("stage \"S2\", step 3 of 3, sum, 2 elements: largest displacement "
                             "0.0128 m at node 3; sum of reactions X 0, Y 0, Z 18 kN"))
        << brief.out;
    const T_RUN one = RunProgram({"analyse", file, "--stage", "S1"});
    EXPECT_NE(std::string::npos, one.out.find("== stage \"S1\", step 1 of 1, sum, 1 elements"));
    EXPECT_NE(std::string::npos, one.out.find("reactions (forces of the supports"));
    EXPECT_EQ(std::string::npos, one.out.find("S2"));
}

TEST(Staged, AModelFileKeepsTheResultsOfItsStages)
{
    const CTempFolder folder;
    const std::string model = folder / "m.qmdb";
    ASSERT_EQ(0, RunProgram({"import", StagedCase(folder), model}).code);
    const std::uintmax_t before = std::filesystem::file_size(model);
    ASSERT_EQ(0, RunProgram({"analyse", model, "--stage", "S2"}).code);
    EXPECT_GT(std::filesystem::file_size(model), before);
    EXPECT_EQ(0, RunProgram({"info", model, "--check"}).code);
}

TEST(Staged, RefusesWhatIsNotThere)
{
    const CTempFolder folder;
    const std::string file = StagedCase(folder);
    const struct {
        std::vector<std::string> options;
        const char* text;
    } rows[] = {
        {{"--stage", "S9"}, "no construction stage named \"S9\""},
        {{"--stage", "S2", "--step", "4"}, "stage \"S2\" has no step 4"},
        {{"--stage", "S2", "--step", "0"}, "--step"},
        {{"--step", "1"}, "--stage"},
        {{"--load", "Q"}, "no load case named \"Q\""},
    };
    for (const auto& row : rows) {
        std::vector<std::string> arguments{"analyse", file};
        arguments.insert(arguments.end(), row.options.begin(), row.options.end());
        const T_RUN run = RunProgram(arguments);
        EXPECT_EQ(2, run.code) << row.text;
        EXPECT_NE(std::string::npos, run.err.find(row.text)) << run.err;
    }
    const T_RUN idle = RunProgram({"analyse", file, "--load", "idle"}); // acts in no stage
    EXPECT_EQ(3, idle.code);
    EXPECT_NE(std::string::npos, idle.err.find("acts in no construction stage")) << idle.err;
}
