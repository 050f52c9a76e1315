// The iterative analysis for pretension through the program.
#include "program.h"
#include "stagecase.h"

#include <cmath>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

namespace {

using json = nlohmann::json;
using NAMES = std::vector<std::string>;

class Iterate : public testing::Test {
protected:
    Iterate() { WriteText(m_file, kStageCase); }
    T_RUN Run(const std::string& item, const std::vector<std::string>& more = {}) const
    {
        std::vector<std::string> arguments{"ulf", "iterate", m_file, "--item", item};
        arguments.insert(arguments.end(), more.begin(), more.end());
        return RunProgram(arguments);
    }
    /// Tension of load case T in a file of the folder.
    double Tension(const std::string& name) const
    {
        const json document = json::parse(ReadText(m_folder / name));
        return document.at("load_cases").at(1).at("pretension").at(0).at("force");
    }
    std::string Report() const { return ReadText(m_folder / "m.ulf"); }
    static std::size_t Count(const std::string& text, const std::string& piece)
    {
        std::size_t n = 0;
        for (auto at = text.find(piece); at != std::string::npos; at = text.find(piece, at + 1))
            ++n;
        return n;
    }
    std::size_t Blocks() const { return Count(Report(), "     Iteration = "); }

    const CTempFolder m_folder;
    const std::string m_file = m_folder / "m.json";
};

TEST_F(Iterate, HistoryIsTheHandCalculation)
{
    const T_RUN run = Run("STAY", {"--json", "-", "--tolerance", "1e-9"});
    ASSERT_EQ(0, run.code) << run.err;
    const json r = json::parse(run.out);
    EXPECT_EQ("converged", r.at("status"));
    EXPECT_EQ(m_folder / "m.ulf", r.at("report"));
    const double factors[] = {4.0, 1.0}, tolerances[] = {3.0, 0.0}; // T = 4 holds the node
    const char* const files[] = {"m.json", "m_01.json"};
    ASSERT_EQ(2U, r.at("history").size());
    for (std::size_t k = 0; k < 2; ++k) {
        const json& step = r.at("history").at(k);
        EXPECT_EQ(k, step.at("iteration"));
        EXPECT_EQ(m_folder / files[k], step.at("file"));
        ASSERT_EQ(1U, step.at("factors").size());
        EXPECT_EQ("S1/First Step", step.at("factors").at(0).at("place"));
        EXPECT_EQ(true, step.at("factors").at(0).at("pretension"));
        EXPECT_NEAR(factors[k], step.at("factors").at(0).at("factor").get<double>(), 1e-12);
        EXPECT_NEAR(tolerances[k], step.at("tolerance").get<double>(), 1e-12);
    }
    EXPECT_EQ((NAMES{"m.json", "m.ulf", "m_01.json"}), m_folder.Names());
    EXPECT_EQ(kStageCase, ReadText(m_file)) << "the file itself stays";
    EXPECT_NEAR(4.0, Tension("m_01.json"), 1e-12);
    EXPECT_EQ(2U, Blocks());
    // The copy, read anew, needs no change: its factor is 1.
    const T_RUN again =
        RunProgram({"ulf", "solve", m_folder / "m_01.json", "--item", "STAY", "--json", "-"});
    EXPECT_NEAR(1.0, json::parse(again.out).at("factors").at("S1/First Step T").get<double>(),
                1e-12);
}

TEST_F(Iterate, KeepsTheSignOfARestrictedFactor)
{
    const T_RUN run = Run("LEAST", {"--json", m_folder / "r.json", "--tolerance", "1e-6"});
    ASSERT_EQ(0, run.code) << run.err;
    const json history = json::parse(ReadText(m_folder / "r.json")).at("history");
    EXPECT_NEAR(2.0, history.at(0).at("factors").at(0).at("factor").get<double>(), 1e-9);
    EXPECT_NEAR(2.0, Tension("m_01.json"), 1e-9);
    EXPECT_NE(std::string::npos, run.out.find("S1/First Step")) << "the table is printed, too";
    // No negative tension holds the node: nothing is written.
    std::filesystem::remove(m_folder / "m.ulf");
    const T_RUN none = Run("SIGN");
    EXPECT_EQ(1, none.code);
    EXPECT_NE(std::string::npos, none.err.find("no factors found")) << none.err;
    EXPECT_FALSE(std::filesystem::exists(m_folder / "m.ulf"));
}

TEST_F(Iterate, ExistingReportIsOverwrittenOrAddedToOnlyWhenAsked)
{
    WriteText(m_folder / "m.ulf", "mine\n");
    const T_RUN refused = Run("STAY");
    EXPECT_EQ(4, refused.code);
    EXPECT_NE(std::string::npos, refused.err.find("--overwrite or --append")) << refused.err;
    EXPECT_EQ("mine\n", Report());
    EXPECT_EQ((NAMES{"m.json", "m.ulf"}), m_folder.Names());
    EXPECT_EQ(2, Run("STAY", {"--append", "--overwrite"}).code);
    EXPECT_EQ("mine\n", Report());
    EXPECT_EQ(0, Run("STAY", {"--append"}).code);
    EXPECT_TRUE(Report().starts_with("mine\n         +="));
    EXPECT_EQ(2U, Blocks());
    EXPECT_EQ(0, Run("STAY", {"--overwrite"}).code);
    EXPECT_TRUE(Report().starts_with("         +="));
    EXPECT_EQ(2U, Blocks());
}

TEST_F(Iterate, RunsAwayNoFurtherThanRequiredAndShowsHow)
{
    const T_RUN run =
        Run("WILD", {"--sum-stage-loads", "--iterations", "2", "--json", m_folder / "r.json"});
    EXPECT_EQ(1, run.code);
    EXPECT_NE(std::string::npos, run.err.find("not converged")) << run.err;
    const json r = json::parse(ReadText(m_folder / "r.json"));
    EXPECT_EQ("not converged", r.at("status"));
    const double factors[] = {4.0 / 3, 1.5, 2.0}, tolerances[] = {1.0 / 3, 0.5, 1.0};
    ASSERT_EQ(3U, r.at("history").size());
    for (std::size_t k = 0; k < 3; ++k) {
        const json& step = r.at("history").at(k);
        EXPECT_NEAR(factors[k], step.at("factors").at(0).at("factor").get<double>(), 1e-9);
        EXPECT_NEAR(tolerances[k], step.at("tolerance").get<double>(), 1e-9);
    }
    for (const char* text : {"0.333333", "0.5", "m_02.json", "S1/First Step"})
        EXPECT_NE(std::string::npos, run.out.find(text)) << run.out;
    EXPECT_NEAR(2.0, Tension("m_02.json"), 1e-9);
    EXPECT_FALSE(std::filesystem::exists(m_folder / "m_03.json"));
    EXPECT_EQ(3U, Blocks());
}

// T1 and T2 pull node 2 apart: of u = 0 and u = 0.2 both are missed by 0.1, with T1 = 1, T2 = -1.
TEST_F(Iterate, FactorsOfOneThatMissTheConstraintsAreNoSuccess)
{
    json document = json::parse(kStageCase);
    document.at("load_cases")
        .push_back({{"name", "T2"}, {"pretension", {{{"element", 2}, {"force", 1}}}}});
    document.at("stages").at(0).at("activate").at("loads").push_back({{"case", "T2"}});
    json& item = document.at("ulf_stage_items").at(0);
    item.at("unknown").push_back({{"stage", "S1"}, {"case", "T2"}, {"pretension", true}});
    item.at("constraints").push_back("U02");
    WriteText(m_file, document.dump());
    const T_RUN run = Run("STAY", {"--json", "-"});
    EXPECT_EQ(1, run.code);
    EXPECT_NE(std::string::npos, run.err.find("HOLD (S1/Last Step), U02")) << run.err;
    const json r = json::parse(run.out);
    EXPECT_EQ("constraints not met", r.at("status"));
    EXPECT_NEAR(0.0, r.at("history").back().at("tolerance").get<double>(), 1e-9);
}

TEST_F(Iterate, SolvesOnceWhenNoIterationIsRequired)
{
    const T_RUN run = Run("STAY", {"--iterations", "0", "--json", "-"});
    EXPECT_EQ(0, run.code) << run.err;
    const json r = json::parse(run.out);
    EXPECT_EQ("solved", r.at("status"));
    EXPECT_EQ(1U, r.at("history").size());
    EXPECT_EQ(1U, Blocks());
    EXPECT_EQ((NAMES{"m.json", "m.ulf"}), m_folder.Names());
}

TEST_F(Iterate, StopsWhereACopyCannotBeWritten)
{
    std::filesystem::create_directory(m_folder / "m_02.json");
    const T_RUN run = Run("DOUBLE", {"--json", m_folder / "r.json"});
    EXPECT_EQ(4, run.code);
    EXPECT_EQ(1U, Lines(run.err).size()) << run.err;
    EXPECT_NE(std::string::npos, run.err.find("m_02.json")) << run.err;
    EXPECT_EQ(kStageCase, ReadText(m_file));
    EXPECT_NEAR(2.0, Tension("m_01.json"), 1e-12) << "as after the iteration before";
    EXPECT_EQ(2U, Blocks());
    EXPECT_EQ(2U, json::parse(ReadText(m_folder / "r.json")).at("history").size());
    EXPECT_EQ((NAMES{"m.json", "m.ulf", "m_01.json", "m_02.json", "r.json"}), m_folder.Names());
}

TEST_F(Iterate, InterruptedItEndsAfterACompleteIteration)
{
    // The report is a pipe, so that the program waits for a reader with each block; it is
    // interrupted while it waits with a block of an iteration.
    const T_RUN run =
        RunShell("mkfifo m.ulf; qm-rps ulf iterate m.json --item DOUBLE --iterations 60 --append "
                 "--json r.json & pid=$!; (sleep 30; kill -KILL $pid) >/dev/null 2>&1 & guard=$!; "
                 "timeout 10 cat m.ulf > all; sleep 0.5; kill -INT $pid; "
                 "timeout 10 cat m.ulf >> all; wait $pid; code=$?; kill $guard; exit $code",
                 m_folder.Path());
    EXPECT_EQ(1, run.code) << run.err;
    EXPECT_NE(std::string::npos, run.err.find("cancelled")) << run.err;
    const json r = json::parse(ReadText(m_folder / "r.json"));
    EXPECT_EQ("cancelled", r.at("status"));
    const std::size_t last = r.at("history").size() - 1;
    ASSERT_GE(last, 1U);
    ASSERT_LT(last, 9U) << "it was not stopped by the interrupt";
    const std::string report = ReadText(m_folder / "all");
    EXPECT_EQ(last + 1, Count(report, "     Iteration = "));
    EXPECT_TRUE(report.ends_with("===\n\n\n")) << "its last block is complete";
    const std::string end = "m_0" + std::to_string(last) + ".json";
    EXPECT_NEAR(std::pow(2.0, double(last)), Tension(end), 1e-9);
    EXPECT_FALSE(std::filesystem::exists(m_folder / ("m_0" + std::to_string(last + 1) + ".json")));
    EXPECT_EQ(kStageCase, ReadText(m_file));
}

TEST_F(Iterate, RefusesBeforeAnythingIsWritten)
{
    const struct {
        std::string item;
        std::vector<std::string> more;
        int code;
        const char* says;
    } kRows[] = {
        {"NONE", {}, 2, "NONE"},
        {"STAY", {"--iterations", "100"}, 2, "0 to 99"},
        {"STAY", {"--tolerance", "-1"}, 2, "tolerance"},
        {"STAY", {"--plot", m_folder / "p.gif"}, 2, "picture"},
    };
    for (const auto& row : kRows) {
        const T_RUN run = Run(row.item, row.more);
        EXPECT_EQ(row.code, run.code) << row.says << run.err;
        EXPECT_NE(std::string::npos, run.err.find(row.says)) << run.err;
    }
    EXPECT_EQ(NAMES{"m.json"}, m_folder.Names());
}

#ifdef QM_UI
TEST_F(Iterate, PictureHasTitleAxesAndLegend)
{
    const std::string svg = m_folder / "p.svg";
    ASSERT_EQ(0, Run("STAY", {"--plot", svg}).code);
    const std::string text = ReadText(svg);
    for (const char* piece :
         {"Iterative analysis for pretension: STAY", ">Iteration<", "Factor, tolerance (-)",
          ">Tolerance<", ">Factor 1, S1/First Step T<", "convergence tolerance"})
        EXPECT_NE(std::string::npos, text.find(piece)) << piece;
}
#endif

} // namespace
