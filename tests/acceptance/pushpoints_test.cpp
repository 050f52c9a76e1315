// What the hinges do at the points of an evaluation, against the exact path of an independent
// calculation (tests/data/push).
#include "pushcase.h"

namespace {

/// The load factor of the frame at a displacement, straight between the vertices of its path.
double FactorAt(const json& path, double displacement)
{
    for (std::size_t i = 1; i < path.size(); ++i) {
        const double from = path[i - 1][1], to = path[i][1];
        if (displacement > to) continue;
        const double factor = path[i - 1][0];
        return factor + (path[i][0].get<double>() - factor) * (displacement - from) / (to - from);
    }
    return 0.0;
}

class PushPoints : public CPushTest {
protected:
    /// The two-storey frame with masses, one mode, and two evaluations; pushed to this side.
    static json Frame(double side)
    {
        json file = Data("pc_two_storey");
        for (json& node : file["nodes"])
            if (node["id"] == 3 || node["id"] == 6) node["mass"] = {20, 0, 0};
        for (json& load : file["load_cases"][0]["nodal"])
            for (json& value : load["load"])
                value = side * value.get<double>();
        file["pushover"][0]["control"]["master_max_displ"] = side * 0.35;
        file["modes"] = json::parse(
            R"([{"period": 0.6, "shape": {"3": [0.5, 0, 0, 0, 0, 0], "6": [1, 0, 0, 0, 0, 0]}}])");
        file["spectra"] = json::parse(R"([{"name": "S", "kind": "user", "T": [0, 0.5, 2, 10],
                                           "Sa": [0.8, 2, 0.5, 0.1]}])");
        file["evaluations"] = json::parse(R"([
            {"name": "A", "push": "P", "method": "ATC-40", "procedure": "B", "spectrum": "S"},
            {"name": "E", "push": "P", "method": "EC8/OPCM", "spectrum": "S"}])");
        return file;
    }

    json Evaluated(const json& file, int code) const
    {
        Write("c.json", file.dump(1));
        return Json("evaluate c.json", code);
    }
};

/// Storeys of 3.5 m, loads of 1 and 1.5 times the load factor; C lies at a rotation of 1.
void ExpectOnPath(const json& at, const json& expected, double side)
{
    const double d = side * at.at("displacement").get<double>();
    const double factor = FactorAt(expected["path"], d);
    const double close = 1e-9 * expected["peak"].get<double>();
    EXPECT_NEAR(factor, at.at("load_factor"), close) << d;
    const auto flowed = std::ranges::count_if(
        expected["events"], [&](const json& e) { return e[2].get<double>() <= d; });
    EXPECT_EQ(14 - flowed, at.at("states").at("elastic")) << d;
    EXPECT_EQ(flowed, at["states"].at("B-C")) << d;
    EXPECT_EQ(flowed, at.at("worst").size()) << d;
    double before = 1.0, below = 0.0;
    for (const json& hinge : at["worst"]) {
        EXPECT_NEAR(std::fabs(hinge.at("deformation").get<double>()), hinge.at("ratio"), 1e-12);
        EXPECT_EQ("C", hinge.at("ratio_of"));
        EXPECT_GE(before, hinge["ratio"].get<double>());
        before = hinge["ratio"];
    }
    for (const auto& [k, load] : {std::pair{0U, 2.5}, {1U, 1.5}}) {
        const json& storey = at.at("storeys").at(k);
        EXPECT_NEAR(side * load * factor, storey.at("shear"), 2.5 * close) << d;
        const double displacement = storey.at("displacement");
        EXPECT_NEAR((displacement - below) / 3.5, storey.at("drift"), 1e-12) << d;
        below = displacement;
    }
    EXPECT_NEAR(side * d, below, 1e-9) << d;
}

TEST_F(PushPoints, LieOnTheIndependentPath)
{
    const json expected =
        json::parse(ReadText(ProjectFolder() / "tests/data/push/pc_two_storey.expected.json"));
    for (const double side : {1.0, -1.0}) {
        const json all = Evaluated(Frame(side), 0);
        const json& point = all[0].at("hinges_at");
        ASSERT_EQ(1U, point.size());
        EXPECT_EQ("performance point", point[0].at("point"));
        EXPECT_NEAR(all[0]["performance_point"]["D"].get<double>(),
                    side * point[0]["displacement"].get<double>(), 1e-12);
        EXPECT_NEAR(all[0]["performance_point"]["V"].get<double>(),
                    side * point[0]["storeys"][0]["shear"].get<double>(), 1e-6);
        EXPECT_FALSE(all[0].contains("hinges_not_at"));
        const json& states = all[1].at("hinges_at");
        ASSERT_EQ(2U, states.size());
        for (const json& at : {point[0], states[0], states[1]})
            ExpectOnPath(at, expected, side);
        EXPECT_EQ("SD", states[1].at("point"));
        EXPECT_EQ("demand", states[1].at("of"));
        const json& beyond = all[1].at("hinges_not_at"); // the push ends at 0.35
        ASSERT_EQ(1U, beyond.size());
        EXPECT_EQ("NC", beyond[0].at("point"));
        EXPECT_LT(0.35, side * beyond[0].at("displacement").get<double>());
        EXPECT_EQ("beyond the push", beyond[0].at("reason"));
    }
}

TEST_F(PushPoints, StandInTableAndReport)
{
    Write("c.json", Frame(1.0).dump(1));
    const std::string table = Done("evaluate c.json --report r.txt"), report = Text("r.txt");
    for (const std::string& text : {table, report})
        ExpectHolds(text, {"Hinges at the points of A, push P (kN, m)", "performance point",
                           "NC: demand", "beyond the push", "8 J Mz, B-C"});
    EXPECT_EQ(std::string::npos, table.find("Storeys: displacement"));
    ExpectHolds(report, {"Storeys: displacement, drift, shear", "S2"});
}

// Pictures of a step name it, and count the hinges as the tables of the evaluation do.
TEST_F(PushPoints, ArePicturesOfTheFrameAndItsStoreys)
{
    const json all = Evaluated(Frame(1.0), 0);
    const json& demand = all[1].at("hinges_at").at(1); // SD
    const struct {
        const char* options;
        json at;
        const char* step;
    } pictures[] = {{"--at A", all[0]["hinges_at"][0], "(performance point of A)"},
                    {"--at E --state SD", demand, "(SD: demand of E)"}};
    for (const auto& p : pictures) {
        Done("push c.json --overwrite --plot-hinges h.svg --plot-storeys s.svg " +
             std::string(p.options));
        const std::string hinges = Text("h.svg"), storeys = Text("s.svg");
        for (const char* state : {"elastic", "B-C"}) {
            const std::string entry =
                std::string(state) + ": " + std::to_string(p.at["states"][state].get<int>());
            ExpectHolds(hinges, {entry.c_str(), p.step});
        }
        ExpectHolds(storeys, {"Displacement (m)", "Drift ratio", "Shear (kN)"});
    }
    Done("push c.json --overwrite --plot-hinges h.svg --step 1"); // elastic as yet
    ExpectHolds(Text("h.svg"), {"P, Step 1<", "elastic: 14", "B-C: 0"});
    const T_RUN beyond = Run("push c.json --overwrite --plot-hinges h.svg --step 9999");
    EXPECT_EQ(2, beyond.code);
    ExpectHolds(beyond.err, {"no step 9999", "20"});
    ExpectRefused("push c.json --overwrite --plot-hinges h.svg --at nobody", 2, "nobody");
    ExpectRefused("push c.json --overwrite --plot-hinges h.svg --at E --state XX", 2, "XX");
    ExpectRefused("push c.json --step 2", 2, "--plot-hinges");
}

TEST_F(PushPoints, AreStepsOfAPushByLoadToo)
{
    const json expected =
        json::parse(ReadText(ProjectFolder() / "tests/data/push/pc_two_storey.expected.json"));
    for (const double side : {1.0, -1.0}) { // backwards by the sign of the loads alone
        json byLoad = Frame(side);
        byLoad["pushover"][0]["control"] = {{"increment_method", "force"}};
        byLoad["pushover"][0]["patterns"][0]["factor"] = 85.0;
        byLoad["evaluations"].erase(0);
        const json all = Evaluated(byLoad, 0);
        const json& reached = all[0].at("hinges_at");
        ASSERT_EQ(1U, reached.size());
        EXPECT_EQ("DL", reached[0].at("point"));
        const double d = side * reached[0].at("displacement").get<double>();
        const double share = reached[0].at("load_factor"); // of 85 times the loads
        EXPECT_NEAR(FactorAt(expected["path"], d), 85.0 * share,
                    1e-9 * expected["peak"].get<double>());
        EXPECT_EQ(2U, all[0].at("hinges_not_at").size());
    }
}

TEST_F(PushPoints, StayWhereTheyWereWhenTheyAreSteps)
{
    json file = Frame(1.0);
    file["pushover"][0]["steps"] = 7;
    const json before = Evaluated(file, 0);
    file["pushover"][0]["additional_evaluations"] = true;
    Write("c.json", file.dump(1));
    Done("push c.json -o m.qmdb");
    for (int times = 1; times <= 3; ++times) {
        const json after = Json("evaluate m.qmdb");
        const double D = before[0].at("performance_point").at("D");
        EXPECT_NEAR(D, after[0].at("performance_point").at("D").get<double>(), 1e-12) << times;
        for (const std::size_t state : {0U, 1U})
            EXPECT_NEAR(before[1]["limit_states"][state].at("demand").get<double>(),
                        after[1]["limit_states"][state].at("demand").get<double>(), 1e-12);
        // steps are told by their numbers in the push, which has more of them
        const json run = Json("push m.qmdb")[0];
        ASSERT_EQ(3U, run.at("additional").size()); // the point and the demands of DL and SD
        const json& numbers = after[0].at("capacity").at("step");
        EXPECT_EQ(1U + 7U, numbers.size());
        for (const json& added : run["additional"])
            EXPECT_EQ(numbers.end(), std::find(numbers.begin(), numbers.end(), added));
        const auto near = after[1]["limit_states"][1].at("demand_step").get<std::size_t>();
        EXPECT_NEAR(0.3, run["displacement"].at(near - 1).get<double>(), 1e-9); // next to 0.28
    }
    const T_RUN listed = Run("evaluate m.qmdb --only A --add-step 3 --no-store");
    EXPECT_EQ(2, listed.code);
    ExpectHolds(listed.err, {"was added to the push"});
}

TEST_F(PushPoints, AreNotOfCurvesOfAnotherProgram)
{
    Write("imported.json", kSmallCase);
    EXPECT_FALSE(Json("evaluate imported.json")[0].contains("hinges_at"));
    EXPECT_EQ(std::string::npos, Done("evaluate imported.json").find("Hinges at"));
}

} // namespace
