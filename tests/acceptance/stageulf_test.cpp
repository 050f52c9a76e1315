// Unknown load factor items of construction stages through the program.
#include "office.h"
#include "program.h"
#include "stagecase.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

namespace {

using json = nlohmann::json;

class StageUlf : public testing::Test {
protected:
    StageUlf() { WriteText(m_file, kStageCase); }
    T_RUN Ulf(std::vector<std::string> arguments, const std::string& file = {}) const
    {
        arguments.insert(arguments.begin(), "ulf");
        arguments.insert(arguments.begin() + 2, file.empty() ? m_file : file);
        return RunProgram(arguments);
    }
    void Spoil(const std::function<void(json&)>& change) const
    {
        json document = json::parse(kStageCase);
        change(document);
        WriteText(m_file, document.dump());
    }
    const CTempFolder m_folder;
    const std::string m_file = m_folder / "c.json";
};

TEST_F(StageUlf, ListsAndChecksItemsOfStages)
{
    const T_RUN list = Ulf({"list"});
    EXPECT_EQ(0, list.code) << list.err;
    for (const char* text : {"STAY: construction stages, 1 of 2 loads unknown (1 scale pretension)",
                             "HOLD (S1/Last Step)", "5 items, 4 constraints"})
        EXPECT_NE(std::string::npos, list.out.find(text)) << list.out;
    EXPECT_EQ("5 items, 0 findings\n", Ulf({"check"}).out);
    Spoil([](json& d) { d.at("ulf_stage_items").at(0).at("unknown").at(0).at("case") = "G"; });
    const T_RUN check = Ulf({"check", "--item", "STAY"});
    EXPECT_EQ(1, check.code);
    EXPECT_NE(std::string::npos, check.out.find("rows[1].pretension")) << check.out;
    EXPECT_NE(std::string::npos, check.out.find("row 1 (S1/First Step G)")) << check.out;
    const T_RUN solve = Ulf({"solve", "--item", "STAY"});
    EXPECT_EQ(3, solve.code);
    EXPECT_EQ(1U, Lines(solve.err).size()) << solve.err;
    EXPECT_NE(std::string::npos, solve.err.find("row 1 (S1/First Step G)")) << solve.err;
}

TEST_F(StageUlf, SolvesFromACaseFileAndFromAModelFile)
{
    const std::string model = m_folder / "m.qmdb";
    ASSERT_EQ(0, RunProgram({"import", m_file, model}).code);
    for (const std::string& file : {m_file, model}) {
        const T_RUN run = Ulf({"solve", "--item", "STAY", "--json", "-"}, file);
        ASSERT_EQ(0, run.code) << run.err;
        const json r = json::parse(run.out);
        EXPECT_EQ("found", r.at("status"));
        EXPECT_EQ("[EXACT]", r.at("mode"));
        EXPECT_NEAR(4.0, r.at("factors").at("S1/First Step T").get<double>(), 1e-12);
        EXPECT_EQ(1.0, r.at("factors").at("S1/First Step G"));
        EXPECT_EQ("S1/Last Step", r.at("constraints").at(0).at("place"));
        EXPECT_NEAR(0.0, r.at("constraints").at(0).at("value").get<double>(), 1e-15);
    }
    const json square = json::parse(Ulf({"solve", "--item", "LEAST", "--json", "-"}).out);
    EXPECT_NEAR(4.0, square.at("objective").get<double>(), 1e-8); // the square of T = 2
    const T_RUN least = Ulf({"solve", "--item", "LEAST"});
    EXPECT_EQ(0, least.code) << least.err;
    EXPECT_NE(std::string::npos, least.out.find("stage/step case")) << least.out;
    // From all loads: u = (4 - T) / 20 = 3 / 20 at T = 1, so 0.2 is 4/3 of it; 1 from G alone.
    for (const auto& [flag, factor] : {std::pair{"--sum-stage-loads", 4.0 / 3}, {"", 1.0}}) {
        std::vector<std::string> arguments{"solve", "--item", "WILD", "--json", "-"};
        if (*flag) arguments.push_back(flag);
        const json r = json::parse(Ulf(arguments).out);
        EXPECT_NEAR(factor, r.at("factors").at("S1/First Step T").get<double>(), 1e-12) << flag;
    }
}

TEST_F(StageUlf, ExplainsWhatHoldsTheFactor)
{
    const T_RUN run = Ulf({"explain", "--item", "LEAST", "--json", "-"});
    ASSERT_EQ(0, run.code) << run.err;
    const json held = json::parse(run.out).at("held");
    ASSERT_EQ(1U, held.size());
    EXPECT_EQ("MOST", held.at(0).at("name"));
    // T = 4 - 20 u, objective T^2: d/du = -40 T = -80 at T = 2.
    EXPECT_NEAR(-80.0, held.at(0).at("multiplier").get<double>(), 1e-6);
    const T_RUN none = Ulf({"explain", "--item", "SIGN"});
    EXPECT_EQ(1, none.code);
    EXPECT_NE(std::string::npos, none.out.find("sign restriction")) << none.out;
    EXPECT_NE(std::string::npos, none.out.find("S1/First Step T = ")) << none.out;
}

TEST_F(StageUlf, SheetNamesStageAndStep)
{
    const std::string sheet = m_folder / "s.xlsx";
    const T_RUN run = Ulf({"export", "--item", "STAY", "-o", sheet});
    ASSERT_EQ(0, run.code) << run.err;
    if (!COffice::IsThere()) GTEST_SKIP() << "soffice or python3 is not installed";
    const OFFICE_CELLS cells = COffice().Recalculated(sheet);
    ASSERT_LE(13U, cells.size());
    EXPECT_EQ("HOLD (S1/Last Step)", cells[7][2]);
    EXPECT_EQ("S1/First Step T", cells[11][0]);
    EXPECT_NEAR(4.0, std::stod(cells[11][1]), 1e-12);
    EXPECT_NEAR(-0.05, std::stod(cells[11][2]), 1e-15);
    EXPECT_NEAR(0.0, std::stod(cells[10][2]), 1e-14);
}

TEST_F(StageUlf, RefusesWhatDoesNotExistAtStages)
{
    const std::string model = m_folder / "m.qmdb";
    ASSERT_EQ(0, RunProgram({"import", m_file, model}).code);
    const struct {
        std::vector<std::string> arguments;
        int code;
        const char* says;
    } kRows[] = {
        {{"combine", "--item", "STAY", "--name", "X"}, 2, "no combination of loads at stages"},
        {{"combine", "--item", "STAY", "--name", "X"}, 2, "ulf iterate"},
        {{"solve", "--item", "STAY", "--shape-plot", m_folder / "p.svg"}, 2, "--shape-plot"},
        {{"solve", "--item", "NONE"}, 2, "NONE"},
        {{"solve", "--item", "SIGN"}, 1, "(S1/First Step T)"},
    };
    const std::string before = ReadText(model);
    for (const auto& row : kRows)
        for (const std::string& file : {m_file, model}) {
            const T_RUN run = Ulf(row.arguments, file);
            EXPECT_EQ(row.code, run.code) << row.says << run.out;
            EXPECT_EQ(1U, Lines(run.err).size()) << run.err;
            EXPECT_NE(std::string::npos, run.err.find(row.says)) << run.err;
        }
    EXPECT_EQ(before, ReadText(model));
    EXPECT_EQ((std::vector<std::string>{"c.json", "m.qmdb"}), m_folder.Names());
}

TEST_F(StageUlf, RefusesANameOfBothKinds)
{
    Spoil([](json& d) {
        d["combinations"] = {{{"name", "C"}, {"items", {{{"case", "G"}, {"factor", 1}}}}}};
        d["ulf_items"] = {{{"name", "STAY"},
                           {"combination", "C"},
                           {"objective", "linear"},
                           {"unknown", {{{"case", "G"}}}},
                           {"constraints", {"U02"}}}};
    });
    const T_RUN solve = Ulf({"solve", "--item", "STAY"});
    EXPECT_EQ(3, solve.code);
    EXPECT_NE(std::string::npos, solve.err.find("another name")) << solve.err;
    const T_RUN check = Ulf({"check", "--item", "STAY"});
    EXPECT_EQ(1, check.code);
    EXPECT_NE(std::string::npos, check.out.find("2 items, 2 findings")) << check.out;
}

TEST_F(StageUlf, TellsWhyTheStagesCannotBeAnalysed)
{
    Spoil([](json& d) { d.at("stages").at(0).at("activate").at("supports") = {2}; });
    const T_RUN run = Ulf({"solve", "--item", "STAY"});
    EXPECT_EQ(3, run.code);
    EXPECT_EQ(1U, Lines(run.err).size()) << run.err;
    EXPECT_NE(std::string::npos, run.err.find("S1")) << run.err;
}

#ifdef QM_UI
TEST_F(StageUlf, PictureNamesStageAndStep)
{
    const std::string svg = m_folder / "b.svg";
    ASSERT_EQ(0, Ulf({"solve", "--item", "STAY", "--plot", svg}).code);
    const std::string text = ReadText(svg);
    EXPECT_NE(std::string::npos, text.find("HOLD (S1/Last Step)"));
    EXPECT_NE(std::string::npos, text.find("S1/First Step T = 4"));
}
#endif

} // namespace
