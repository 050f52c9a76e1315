// The iterative analysis for pretension through the program.
#include "program.h"
#include "stagecase.h"

#include <cmath>

namespace {

using NAMES = std::vector<std::string>;

class Iterate : public CProgramTest {
protected:
    Iterate() { Write("m.json", kStageCase); }
    T_RUN Item(const std::string& arguments) const
    {
        return Run("ulf iterate m.json --item " + arguments);
    }
    json Result() const { return json::parse(Text("r.json")); }
    /// Tension of load case T in a file of the folder.
    double Tension(const std::string& name) const
    {
        return json::parse(Text(name)).at("load_cases").at(1).at("pretension").at(0).at("force");
    }
    /// Iterations in the report.
    static std::size_t Blocks(const std::string& report)
    {
        const std::string head = "     Iteration = ";
        std::size_t n = 0;
        for (auto at = report.find(head); at != std::string::npos; at = report.find(head, at + 1))
            ++n;
        return n;
    }
    /// The only factor and the tolerance of each iteration.
    static void ExpectHistory(const json& result,
                              const std::vector<std::pair<double, double>>& expected)
    {
        const json& history = result.at("history");
        ASSERT_EQ(expected.size(), history.size());
        for (std::size_t k = 0; k < expected.size(); ++k) {
            EXPECT_EQ(k, history[k].at("iteration"));
            ASSERT_EQ(1U, history[k].at("factors").size());
            EXPECT_NEAR(expected[k].first, history[k].at("factors")[0].at("factor"), 1e-9) << k;
            EXPECT_NEAR(expected[k].second, history[k].at("tolerance"), 1e-9) << k;
        }
    }
};

TEST_F(Iterate, HistoryIsTheHandCalculation)
{
    const json r = Json("ulf iterate m.json --item STAY --tolerance 1e-9");
    EXPECT_EQ("converged", r.at("status"));
    EXPECT_EQ("m.ulf", r.at("report"));
    ExpectHistory(r, {{4.0, 3.0}, {1.0, 0.0}}); // T = 4 holds the node
    const json& first = r.at("history").at(0);
    EXPECT_EQ("m.json", first.at("file"));
    EXPECT_EQ("m_01.json", r.at("history").at(1).at("file"));
    EXPECT_EQ("S1/First Step", first.at("factors").at(0).at("place"));
    EXPECT_EQ(true, first.at("factors").at(0).at("pretension"));
    EXPECT_EQ((NAMES{"m.json", "m.ulf", "m_01.json"}), m_folder.Names());
    EXPECT_EQ(kStageCase, Text("m.json")) << "the file itself stays";
    EXPECT_NEAR(4.0, Tension("m_01.json"), 1e-12);
    EXPECT_EQ(2U, Blocks(Text("m.ulf")));
    // The copy, read anew, needs no change: its factor is 1.
    const json again = Json("ulf solve m_01.json --item STAY");
    EXPECT_NEAR(1.0, again.at("factors").at("S1/First Step T"), 1e-12);
}

TEST_F(Iterate, KeepsTheSignOfARestrictedFactor)
{
    const T_RUN run = Item("LEAST --json r.json --tolerance 1e-6");
    ASSERT_EQ(0, run.code) << run.err;
    EXPECT_NEAR(2.0, Result().at("history").at(0).at("factors").at(0).at("factor"), 1e-9);
    EXPECT_NEAR(2.0, Tension("m_01.json"), 1e-9);
    ExpectHolds(run.out, {"S1/First Step"});
    // No negative tension holds the node: nothing is written.
    std::filesystem::remove(m_folder / "m.ulf");
    const T_RUN none = Item("SIGN --overwrite");
    EXPECT_EQ(1, none.code);
    ExpectHolds(none.err, {"no factors found"});
    EXPECT_FALSE(std::filesystem::exists(m_folder / "m.ulf"));
}

TEST_F(Iterate, ExistingReportIsOverwrittenOrAddedToOnlyWhenAsked)
{
    Write("m.ulf", "mine\n");
    ExpectRefused("ulf iterate m.json --item STAY", 4, "--overwrite or --append");
    ExpectRefused("ulf iterate m.json --item STAY --append --overwrite", 2, "");
    EXPECT_EQ("mine\n", Text("m.ulf"));
    EXPECT_EQ((NAMES{"m.json", "m.ulf"}), m_folder.Names());
    for (const auto& [option, start] :
         {std::pair{"--append", "mine\n         +="}, std::pair{"--overwrite", "         +="}}) {
        EXPECT_EQ(0, Item(std::string("STAY ") + option).code);
        EXPECT_TRUE(Text("m.ulf").starts_with(start)) << option;
        EXPECT_EQ(2U, Blocks(Text("m.ulf"))) << option;
    }
}

TEST_F(Iterate, RunsAwayNoFurtherThanRequiredAndShowsHow)
{
    const T_RUN run = Item("WILD --iterations 2 --json r.json");
    EXPECT_EQ(1, run.code);
    ExpectHolds(run.err, {"not converged"});
    EXPECT_EQ("not converged", Result().at("status"));
    ExpectHistory(Result(), {{4.0 / 3, 1.0 / 3}, {1.5, 0.5}, {2.0, 1.0}});
    ExpectHolds(run.out, {"0.333333", "0.5", "m_02.json", "S1/First Step"});
    EXPECT_NEAR(2.0, Tension("m_02.json"), 1e-9);
    EXPECT_FALSE(std::filesystem::exists(m_folder / "m_03.json"));
    EXPECT_EQ(3U, Blocks(Text("m.ulf")));
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
    Write("m.json", document.dump());
    const T_RUN run = Item("STAY --json r.json");
    EXPECT_EQ(1, run.code);
    ExpectHolds(run.err, {"HOLD (S1/Last Step), U02"});
    EXPECT_EQ("constraints not met", Result().at("status"));
    EXPECT_NEAR(0.0, Result().at("history").back().at("tolerance"), 1e-9);
}

// By hand: u = (4 + Q - T f) / 20. The analysis takes what no row reads (Q = 2) and leaves what is
// no pretension (T stays 1): both runs forecast u = 0.
TEST_F(Iterate, TheAnalysedStructureStandsBesideTheForecast)
{
    const json good = Json("ulf iterate m.json --item STAY");
    const json& stay = good.at("stays").at(0);
    EXPECT_EQ(1, stay.at("element"));
    EXPECT_EQ("N", stay.at("unit"));
    EXPECT_NEAR(1.0, stay.at("start"), 1e-12);
    EXPECT_NEAR(4.0, stay.at("factor"), 1e-12);
    EXPECT_NEAR(4.0, stay.at("pretension"), 1e-12);
    EXPECT_NEAR(4.0, stay.at("force"), 1e-12) << "the node stays, so that nothing is added";
    const struct {
        void (*spoil)(json&);
        double analysed;
        const char* warning;
    } cases[] = {
        {[](json& d) {
             d.at("load_cases")
                 .push_back(
                     {{"name", "Q"}, {"nodal", {{{"node", 2}, {"load", {2, 0, 0, 0, 0, 0}}}}}});
             d.at("stages").at(0).at("activate").at("loads").push_back({{"case", "Q"}});
         },
         2.0 / 20, "load case Q"},
        {[](json& d) {
             d.at("ulf_stage_items").at(0).at("unknown").at(0).at("pretension") = false;
         },
         3.0 / 20, "row 1 (S1/First Step T)"},
    };
    for (const auto& c : cases) {
        json document = json::parse(kStageCase);
        c.spoil(document);
        Write("m.json", document.dump());
        ExpectHolds(Done("ulf check m.json --item STAY"), {"warning: ", c.warning, "1 warnings"});
        const T_RUN run = Item("STAY --overwrite --json r.json");
        EXPECT_EQ(1, run.code);
        ExpectHolds(run.err, {c.warning, "the analysed structure is not the one"});
        ExpectHolds(run.out, {"HOLD (S1/Last Step)", "differs"});
        EXPECT_EQ("analysed structure differs", Result().at("status"));
        const json row = Result().at("analysed").at(0);
        EXPECT_NEAR(0.0, row.at("forecast"), 1e-9);
        EXPECT_NEAR(c.analysed, row.at("analysed"), 1e-9);
        EXPECT_EQ("m", row.at("unit"));
    }
}

TEST_F(Iterate, ModelsThatAreThereAreNotOverwrittenUnasked)
{
    Write("m_02.json", "mine\n");
    ExpectRefused("ulf iterate m.json --item STAY", 4, "m_02.json");
    ExpectRefused("ulf iterate m.json --item STAY --append", 4, "--overwrite");
    EXPECT_EQ((NAMES{"m.json", "m_02.json"}), m_folder.Names());
    EXPECT_EQ(0, Item("STAY --iterations 1").code) << "it is not written then";
    EXPECT_EQ("mine\n", Text("m_02.json"));
    Write("case.ulf", kStageCase);
    ExpectRefused("ulf iterate case.ulf --item STAY --overwrite", 2, "over the model");
    EXPECT_EQ(kStageCase, Text("case.ulf"));
}

TEST_F(Iterate, StopsWhereACopyCannotBeWritten)
{
    std::filesystem::create_directory(m_folder / "m_02.json");
    const T_RUN run = Item("FADE --overwrite --json r.json");
    EXPECT_EQ(4, run.code);
    EXPECT_EQ(1U, Lines(run.err).size()) << run.err;
    ExpectHolds(run.err, {"m_02.json"});
    EXPECT_EQ(kStageCase, Text("m.json"));
    EXPECT_NEAR(2.0 / 3, Tension("m_01.json"), 1e-12) << "as after the iteration before";
    EXPECT_EQ(2U, Blocks(Text("m.ulf")));
    EXPECT_EQ(2U, Result().at("history").size());
    EXPECT_EQ((NAMES{"m.json", "m.ulf", "m_01.json", "m_02.json", "r.json"}), m_folder.Names());
}

TEST_F(Iterate, InterruptedItEndsAfterACompleteIteration)
{
    // The report is a pipe, so that the program waits for a reader with each block; it is
    // interrupted while it waits with a block of an iteration.
    const T_RUN run =
        RunShell("mkfifo m.ulf; qm-rps ulf iterate m.json --item FADE --iterations 60 --append "
                 "--json r.json & pid=$!; (sleep 30; kill -KILL $pid) >/dev/null 2>&1 & guard=$!; "
                 "timeout 10 cat m.ulf > all; sleep 0.5; kill -INT $pid; "
                 "timeout 10 cat m.ulf >> all; wait $pid; code=$?; kill $guard; exit $code",
                 m_folder.Path());
    EXPECT_EQ(1, run.code) << run.err;
    ExpectHolds(run.err, {"cancelled"});
    EXPECT_EQ("cancelled", Result().at("status"));
    const std::size_t last = Result().at("history").size() - 1;
    ASSERT_GE(last, 1U);
    ASSERT_LT(last, 9U) << "it was not stopped by the interrupt";
    EXPECT_EQ(last + 1, Blocks(Text("all")));
    EXPECT_TRUE(Text("all").ends_with("===\n\n\n")) << "its last block is complete";
    EXPECT_NEAR(2 / (1 + std::pow(2.0, double(last))),
                Tension("m_0" + std::to_string(last) + ".json"), 1e-9);
    EXPECT_FALSE(std::filesystem::exists(m_folder / ("m_0" + std::to_string(last + 1) + ".json")));
    EXPECT_EQ(kStageCase, Text("m.json"));
}

TEST_F(Iterate, RefusesBeforeAnythingIsWritten)
{
    ExpectRefused("ulf iterate m.json --item NONE", 2, "NONE");
    ExpectRefused("ulf iterate m.json --item STAY --iterations 100", 2, "0 to 99");
    ExpectRefused("ulf iterate m.json --item STAY --tolerance -1", 2, "tolerance");
    ExpectRefused("ulf iterate m.json --item STAY --plot p.gif", 2, "picture");
    EXPECT_EQ(NAMES{"m.json"}, m_folder.Names());
}

#ifdef QM_UI
TEST_F(Iterate, PictureHasTitleAxesAndLegend)
{
    Done("ulf iterate m.json --item STAY --plot p.svg");
    ExpectHolds(Text("p.svg"),
                {"Iterative analysis for pretension: STAY", ">Iteration<", "Factor, tolerance (-)",
                 ">Tolerance<", ">Factor 1, S1/First Step T<", "convergence tolerance"});
}
#endif

} // namespace
