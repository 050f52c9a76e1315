// Construction stages through the program: tables, JSON, results in the model file, refusals.
#include "program.h"

namespace {

// A cantilever that grows from 2 m to 4 m, first order: 12 kN at 2 m in stage 1, 6 kN at the tip in
// the last of three steps of stage 2; E I = 1e4 kNm2. The stay of stage 3 has 10 kN at first.
constexpr double kEI = 1e4;
constexpr double kDownG = 12 * 8 / (3 * kEI);           // P L3 / (3 E I)
constexpr double kDownE = 6 * 4 * (12 - 2) / (6 * kEI); // P x2 (3 L - x) / (6 E I) at x = 2
constexpr double kTipE = 6 * 64 / (3 * kEI);

class Staged : public CProgramTest {
protected:
    Staged()
    {
        json c = json::parse(ReadText(QM_TEST_DATA "/cases/stage_all_members.json"));
        c.erase("stage_control");
        c["stages"][2].erase("deactivate");
        Write("case.json", c.dump());
    }
};

TEST_F(Staged, JsonHasEveryStageWithWhatStands)
{
    const json all = Json("analyse case.json"), &stages = all.at("stages");
    ASSERT_EQ(3U, stages.size());
    const json &first = stages.at("S1"), &second = stages.at("S2");
    EXPECT_EQ(1, first.at("step"));
    EXPECT_EQ("sum", first.at("load"));
    EXPECT_EQ(1, first.at("elements"));
    EXPECT_EQ(2U, first.at("displacements").size());
    EXPECT_EQ(3, second.at("step"));
    EXPECT_EQ(2, second.at("elements"));
    EXPECT_NEAR(18.0, second.at("reactions").at("1").at(2), 1e-9);
    EXPECT_NEAR(12 * 2 + 6 * 4, std::abs(second.at("beam").at("1")[0][4].get<double>()), 1e-9);
    EXPECT_EQ(0U, second.at("truss").size());
    EXPECT_EQ(1U, stages.at("S3").at("truss").size());
    EXPECT_TRUE(all.at("displacements").contains("G")); // the static cases are there as well
}

TEST_F(Staged, OptionsChooseStageStepAndLoad)
{
    const struct {
        const char* options;
        const char* node;
        double down;
    } kRows[] = {
        {"--step 1", "2", kDownG},    {"", "2", kDownG + kDownE},
        {"--load dead", "2", kDownG}, {"--load erection", "2", kDownE},
        {"--load E", "3", kTipE},     {"--step 2 --load E", "3", 0.0},
    };
    for (const auto& row : kRows) {
        const json found = Json(std::string("analyse case.json --stage S2 ") + row.options);
        EXPECT_EQ(1U, found.at("stages").size());
        EXPECT_TRUE(found.at("displacements").empty()); // no static case was asked for
        EXPECT_NEAR(-row.down, found.at("stages").at("S2").at("displacements").at(row.node).at(2),
                    1e-12)
            << row.options;
    }
}

TEST_F(Staged, TextGivesALineForEachStageAndTablesForOne)
{
    // kDownG = 0.0032 m; the tip at the last step of S2: E alone, as element 2 is born straight.
    ExpectHolds(Done("analyse case.json"),
                {"stage \"S1\", step 1 of 1, sum, 1 elements: largest displacement 0.0032 m at "
                 "node 2; sum of reactions X 0, Y 0, Z 12 kN",
                 "stage \"S2\", step 3 of 3, sum, 2 elements: largest displacement 0.0128 m at "
                 "node 3; sum of reactions X 0, Y 0, Z 18 kN"});
    const std::string one = Done("analyse case.json --stage S1");
    ExpectHolds(one, {"== stage \"S1\", step 1 of 1, sum, 1 elements",
                      "reactions (forces of the supports"});
    EXPECT_EQ(std::string::npos, one.find("S2"));
}

TEST_F(Staged, AModelFileKeepsTheResultsOfItsStages)
{
    Done("import case.json m.qmdb");
    const std::uintmax_t before = std::filesystem::file_size(m_folder / "m.qmdb");
    Done("analyse m.qmdb --stage S2");
    EXPECT_GT(std::filesystem::file_size(m_folder / "m.qmdb"), before);
    Done("info m.qmdb --check");
}

TEST_F(Staged, RefusesWhatIsNotThere)
{
    const auto refused = [&](const char* options, int code, const char* says) {
        ExpectRefused(std::string("analyse case.json ") + options, code, says);
    };
    refused("--stage S9", 2, "no construction stage named \"S9\"");
    refused("--stage S2 --step 4", 2, "stage \"S2\" has no step 4");
    refused("--stage S2 --step 0", 2, "--step");
    refused("--step 1", 2, "--stage");
    refused("--load Q", 2, "no load case named \"Q\"");
    refused("--load idle", 3, "acts in no construction stage");
}

} // namespace
