// Member ends judged through the program: the cantilever of tests/oracle/judgement.py, whose chord
// rotation is the displacement of its top over 3 m, and whose M / V is 3 m.
#include "office.h"
#include "program.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <functional>

namespace {

// theta_y, SD, NC; the two parts of VR, kN.
constexpr std::array kCapacity{0.011621170792608007, 0.75 * 0.03236395760998197,
                               0.03236395760998197};
constexpr double kAxial = 24.90940718540595, kCyclic = 80.49401005269928;

/// 0.40 x 0.40 with 8 bars of 18 mm under 640 kN, with a mass of 60 t and T = 0.82 s; an EN 1998-1
/// spectrum whose plateau ends at 0.6 s, so that displacements grow as the ground acceleration.
json Cantilever()
{
    json file = json::parse(R"({"format": "qm-rps case 1",
        "units": {"force": "kN", "length": "m"}, "plane": "XZ",
        "design_codes": {"concrete": "Eurocode2:04", "steel": "Eurocode3:05"},
        "nodes": [{"id": 1, "xyz": [0, 0, 0], "restraint": [1, 1, 1, 1, 1, 1]},
                  {"id": 2, "xyz": [0, 0, 3], "mass": [60, 0, 0]}],
        "storeys": [{"name": "1F", "height": 3, "nodes": [2]}],
        "modes": [{"period": 0.816, "shape": {"2": [1, 0, 0, 0, 0.5, 0]}}],
        "materials": [{"name": "C", "type": "concrete", "E": 15e6, "nu": 0.2, "fck": 20000,
                       "fyk": 400000, "Es": 2e8, "knowledge": "KL2",
                       "mean": {"fc": 28000, "fy": 450000}}],
        "sections": [{"name": "column", "shape": "rectangle", "size": [0.4, 0.4],
                      "detailing": {"cover": 0.03, "stirrup_diameter": 0.008,
                                    "stirrup_spacing": 0.15}}],
        "elements": [{"id": 1, "nodes": [1, 2], "material": "C", "section": "column"}],
        "load_cases": [{"name": "G", "nodal": [{"node": 2, "load": [0, 0, -640, 0, 0, 0]}]},
                       {"name": "X", "nodal": [{"node": 2, "load": [1, 0, 0, 0, 0, 0]}]}],
        "pushover_control": {"initial_loads": [{"case": "G", "factor": 1}]},
        "spectra": [{"name": "S", "kind": "ec8-2004", "type": 1, "soil": "C", "ag": 0.15}],
        "pushover": [{"name": "P", "control_node": 2, "direction": "DX",
            "pattern": {"kind": "static"},
            "patterns": [{"kind": "static", "number": 2, "factor": 1}],
            "control": {"increment_method": "displacement", "master_node_control": true,
                        "master_max_displ": 0.14}, "steps": 20}],
        "evaluations": [{"name": "E", "push": "P", "method": "EC8/OPCM", "spectrum": "S"}]})");
    for (const double y : {-0.153, 0.0, 0.153})
        for (const double z : {-0.153, 0.0, 0.153})
            if (y != 0.0 || z != 0.0)
                file["sections"][0]["bars"].push_back({{"y", y}, {"z", z}, {"area", 254.469e-6}});
    return file;
}

const json& EndOf(const json& state, const std::string& end)
{
    for (const json& row : state.at("ends"))
        if (row.at("end") == end) return row;
    throw std::out_of_range(end);
}

/// The cantilever in two halves with a beam of 2 m at half its height, from whose tip 40 kN hang:
/// M = 80 at the joint whatever the push does, V and N are those of the upper half.
json WithJoint()
{
    json file = Cantilever();
    file["nodes"].push_back({{"id", 3}, {"xyz", {2, 0, 1.5}}});
    file["nodes"].push_back({{"id", 4}, {"xyz", {0, 0, 1.5}}});
    file["modes"][0]["shape"]["4"] = {0.3, 0, 0, 0, 0.4, 0};
    json beam = file["sections"][0];
    beam["name"] = "beam";
    beam["size"] = {0.5, 0.3};
    beam["bars"] = json::array();
    for (const double z : {-0.203, 0.203})
        for (const double y : {-0.1, 0.1})
            beam["bars"].push_back({{"y", y}, {"z", z}, {"area", 254.469e-6}});
    file["sections"].push_back(beam);
    json column = file["elements"][0], upper = column, out = column;
    column["nodes"] = {1, 4};
    upper["id"] = 2;
    upper["nodes"] = {4, 2};
    out["id"] = 3;
    out["nodes"] = {4, 3};
    out["section"] = "beam";
    file["elements"] = {column, upper, out};
    file["load_cases"][0]["nodal"].push_back({{"node", 3}, {"load", {0, 0, -40, 0, 0, 0}}});
    return file;
}

/// The cantilever as a welded I of steel, pressed by `N`.
json OfSteel(double N)
{
    json file = Cantilever();
    file["materials"] = {{{"name", "C"},
                          {"type", "steel"},
                          {"E", 210e6},
                          {"nu", 0.3},
                          {"fy", 275000},
                          {"knowledge", "KL2"},
                          {"mean", {{"fy", 303000}}}}};
    file["sections"] = {{{"name", "column"}, {"shape", "I"}, {"size", {0.2, 0.2, 0.009, 0.015}}}};
    file["load_cases"][0]["nodal"][0]["load"][2] = -N;
    return file;
}

class Judge : public CProgramTest {
protected:
    /// The cantilever with the hinges of a code.
    void Generate(const std::string& code) const
    {
        Write("c.json", Cantilever().dump(1));
        Done("hinge generate c.json --code " + code + " --all -o g.json --overwrite");
    }
};

} // namespace

TEST_F(Judge, CantileverByHand)
{
    json weak = Cantilever(); // its hinge yields and keeps its strength up to these demands
    weak["spectra"][0]["ag"] = 0.11;
    Write("w.json", weak.dump(1));
    Done("hinge generate w.json --code EN1998-3 --all -o g.json");
    Write("c.json", Cantilever().dump(1));
    for (const char* const file : {"c.json", "g.json"}) {
        const json judged = Json("judge " + std::string(file) + " --code EN1998-3 --trace").at(0);
        ASSERT_EQ(3U, judged.at("limit_states").size());
        for (std::size_t i = 0; i < 3; ++i) {
            const json& state = judged["limit_states"][i];
            const double d = state.at("displacement");
            const json& foot = EndOf(state, "I");
            const double theta = d / 3.0; // the top alone moves
            const double V = std::fabs(foot.at("V").get<double>());
            EXPECT_NEAR(640.0, foot.at("N"), 1e-6);
            EXPECT_NEAR(3.0 * V, std::fabs(foot.at("M").get<double>()), 1e-6);
            EXPECT_NEAR(3.0, foot.at("LV"), 1e-9);
            EXPECT_NEAR(theta / kCapacity[i], foot.at("rotation").at("ratio"), 1e-6);
            const double mu = std::clamp(theta / kCapacity[0] - 1.0, 0.0, 5.0);
            EXPECT_NEAR(V, foot.at("shear").at("demand"), 1e-9);
            EXPECT_NEAR(V / (kAxial + (1.0 - 0.05 * mu) * kCyclic), foot.at("shear").at("ratio"),
                        1e-5);
            EXPECT_EQ("EN 1998-3 (A.12)", foot["shear"].at("clause"));
            EXPECT_FALSE(foot.at("rotation_trace").empty());
            EXPECT_NEAR(d / 3.0, state.at("drifts").at(0).at("drift"), 1e-9);
        }
    }
}

// Elastic: V reaches VR without plastic rotation at (24.909 + 80.494) (27 / (3 EI) + 3 / (G 5/6
// A)), G = E / 2.4; the rotations theta at 3 theta. Beyond TC displacements grow as the ground
// acceleration: that of an event is ag S times its displacement over the target, which is the
// demand of SD; demands of DL and NC are 1 / 2.5 and 1.5 of it, and so are their accelerations.
TEST_F(Judge, FirstPassesAndGroundAccelerationsByHand)
{
    Write("c.json", Cantilever().dump(1));
    const json judged = Json("judge c.json --code EN1998-3").at(0);
    const double bent = 27.0 / (3.0 * 15e6 * std::pow(0.4, 4) / 12.0);
    const double sheared = 3.0 / (15e6 / 2.4 * 5.0 / 6.0 * 0.16);
    const double shear = (kAxial + kCyclic) * (bent + sheared);
    ASSERT_EQ(6U, judged.at("first_passes").size());
    const double target = judged["first_passes"][2].at("demand_displacement");
    for (const json& pass : judged["first_passes"]) {
        const std::string name = pass.at("name");
        const double limit = 3.0 * kCapacity[name == "DL" ? 0 : name == "SD" ? 1 : 2];
        EXPECT_EQ("I", pass.at("end")) << name;
        EXPECT_NEAR(pass.at("mode") == "shear" ? shear : limit, pass.at("capacity_displacement"),
                    1e-7)
            << name;
        EXPECT_NEAR(pass.at("capacity_displacement").get<double>() /
                        pass.at("demand_displacement").get<double>(),
                    pass.at("pga_ratio"), 1e-5)
            << name;
        const double share = name == "DL" ? 0.4 : name == "SD" ? 1.0 : 1.5;
        const double capacity = pass.at("capacity_displacement");
        EXPECT_NEAR(share, pass.at("demand_displacement").get<double>() / target, 1e-9);
        EXPECT_NEAR(capacity / target, pass.at("spectrum_factor"), 1e-5) << name;
        EXPECT_NEAR(0.15 * 1.15 * capacity / target, pass.at("capacity_pga"), 1e-5) << name;
        EXPECT_NEAR(0.15 * 1.15 * share, pass.at("demand_pga"), 1e-6) << name; // ag S
    }
}

// Vj = |80 / 0.4077 + F|: the push to +X adds to what the bars of the beam do, the other way it
// takes from it. ASCE 41: gamma chi F + QG, for CP 1.3 F + QG.
TEST_F(Judge, JointByHand)
{
    const double held = 80.0 / 0.4077;
    const auto principal = [](double Vj) {
        return std::hypot(320.0 / 0.1224, Vj / 0.1224) - 320.0 / 0.1224;
    };
    const struct {
        const char* code;
        bool back;
        double onForce;                      // on F, at the last limit state
        double capacity;                     // tests/oracle/judgement.py
        std::function<double(double)> share; // of Vj
    } kCases[] = {
        {"EN1998-3", false, 1.0, 601.7127514426132, [](double Vj) { return Vj; }},
        {"EN1998-3", true, 1.0, 601.7127514426132, [](double Vj) { return Vj; }},
        {"Circolare2019", false, 1.0, 1183.2159566199232, principal},
        {"ASCE41-17", false, 1.3, 320.8397961700119, [](double Vj) { return Vj; }},
        // The initial loads have moved the control node against this push.
        {"ASCE41-17", true, 1.3, 320.8397961700119, [](double Vj) { return Vj; }},
    };
    for (const auto& c : kCases) {
        json file = WithJoint();
        if (c.back) {
            file["load_cases"][1]["nodal"][0]["load"][0] = -1;
            file["pushover"][0]["control"]["master_max_displ"] = -0.14;
        }
        Write("j.json", file.dump(1));
        const json judged = Json("judge j.json --trace --code " + std::string(c.code)).at(0);
        const json& state = judged.at("limit_states").at(2);
        const json* joint = nullptr;
        double F = 0.0;
        for (const json& row : state.at("ends")) {
            if (row.contains("node")) joint = &row;
            if (row.value("element", 0) == 2) F = std::fabs(row.at("V").get<double>());
        }
        ASSERT_TRUE(joint) << c.code;
        EXPECT_GT(F, 1.0);
        EXPECT_EQ(4, joint->at("node"));
        EXPECT_EQ("X", joint->at("axis"));
        EXPECT_NEAR(80.0, joint->at("M"), 1e-6) << c.code;
        EXPECT_NEAR(640.0, joint->at("N"), 1e-6) << c.code;
        const double demand = c.share(std::fabs(held + (c.back ? -F : F) * c.onForce));
        EXPECT_NEAR(demand, joint->at("joint").at("demand"), 1e-5 * demand) << c.code;
        EXPECT_NEAR(demand / c.capacity, joint->at("joint").at("ratio"), 1e-5) << c.code;
        EXPECT_FALSE(joint->at("joint_trace").empty());
        const json& storey = state.at("storeys").at(0);
        EXPECT_EQ(joint->at("storey"), storey.at("name"));
        EXPECT_EQ(1, storey.at("joints " + joint->at("verdict").get<std::string>()));
    }
}

// N / Npl = 0.21: chord rotation against 2, 7, 9 theta_y and N against buckling. 0.337: no plastic
// rotation is counted on, there is none; M / MN,y and 6.3.3 (lambda_y 0.387). ASCE 41 without
// hinges has no rotation, and factors on forces; N is that of gravity throughout.
TEST_F(Judge, SteelByHand)
{
    Write("a.json", OfSteel(400.0).dump(1));
    Write("b.json", OfSteel(640.0).dump(1));
    const double thetaY = 0.011884239958269004, buckled = 1445.0376424545257;
    const std::array multiple{2.0, 7.0, 9.0};
    const json rotates = Json("judge a.json --code EN1998-3").at(0).at("limit_states");
    const json presses = Json("judge b.json --code EN1998-3").at(0).at("limit_states");
    for (std::size_t i = 0; i < 3; ++i) {
        const json& foot = EndOf(rotates.at(i), "I");
        const double theta = rotates[i].at("displacement").get<double>() / 3.0;
        const double V = std::fabs(foot.at("V").get<double>());
        EXPECT_NEAR(theta / (multiple[i] * thetaY), foot.at("rotation").at("ratio"), 1e-6);
        EXPECT_NEAR(V / 223.04484274468217, foot.at("shear").at("ratio"), 1e-6);
        EXPECT_NEAR(400.0 / buckled, foot.at("axial_force").at("ratio"), 1e-6);
        const json& pressed = EndOf(presses.at(i), "I");
        EXPECT_EQ(0.0, pressed.at("rotation").at("demand"));
        const double M = std::fabs(pressed.at("M").get<double>());
        const double part = 0.9608260822323937 * M / 156.55631250; // kyy My / Mpl
        EXPECT_NEAR(std::max({M / 115.60281347006655, 0.3614727724340312 + part,
                              640.0 / buckled + 0.6 * part}),
                    pressed.at("axial_force").at("ratio"), 1e-6);
    }
    Write("d.json", OfSteel(2000.0).dump(1)); // beyond Npl
    const json crushed = Json("judge d.json --code EN1998-3").at(0).at("limit_states");
    EXPECT_NEAR(2000.0 / buckled, EndOf(crushed.at(0), "I").at("axial_force").at("ratio"), 1e-6);
    EXPECT_EQ("not fulfilled", EndOf(crushed.at(0), "I").at("verdict"));
    const json asce = Json("judge a.json --code ASCE41-17").at(0).at("limit_states");
    EXPECT_EQ("not checked", EndOf(asce.at(2), "I").at("verdict"));
    Write("c.json", OfSteel(400.0).dump(1));
    Done("hinge generate c.json --code ASCE41-17 --all -o g.json");
    const json forces = Json("judge g.json").at(0).at("limit_states").at(1);
    const json& foot = EndOf(forces, "I");
    EXPECT_NEAR(1.69 * std::fabs(foot.at("V").get<double>()) / 267.3, foot.at("shear").at("ratio"),
                1e-6);
    EXPECT_NEAR(400.0 / 1544.1436180212897, foot.at("axial_force").at("ratio"), 1e-6);
}

TEST_F(Judge, ReportOfAnEvaluationHasTheJudgement)
{
    Write("c.json", WithJoint().dump(1));
    Done("evaluate c.json --report bare.txt");
    EXPECT_EQ(std::string::npos, Text("bare.txt").find("Judgement of"));
    Done("evaluate c.json --report named.txt --code EN1998-3");
    ExpectHolds(Text("named.txt"), {"Judgement of E", "node 4", "PGA_C/PGA_D", "joint"});
    Generate("EN1998-3");
    Done("evaluate g.json --report own.txt");
    ExpectHolds(Text("own.txt"), {"Judgement of E", "SD: demand"});
    ExpectRefused("evaluate c.json --code EN1998-3", 2, "--report");
}

TEST_F(Judge, SaysWhatIsNotCheckedAndWhy)
{
    Write("c.json", Cantilever().dump(1));
    const json bare = Json("judge c.json").at(0);
    EXPECT_EQ("not checked", bare.at("verdict"));
    const json& end = bare.at("limit_states").at(0).at("ends").at(0);
    EXPECT_EQ("not checked", end.at("verdict"));
    EXPECT_NE("", end.at("rotation").at("reason"));
    // A code for all members: the elastic column has chord rotations.
    const json named = Json("judge c.json --code EN1998-3 --limit-state SD").at(0);
    ASSERT_EQ(1U, named.at("limit_states").size());
    EXPECT_EQ("SD", named["limit_states"][0].at("name"));
    EXPECT_NEAR(named["limit_states"][0].at("displacement").get<double>() / 3.0 / kCapacity[1],
                EndOf(named["limit_states"][0], "I").at("rotation").at("ratio"), 1e-6);
    json poor = Cantilever();
    poor["materials"][0].erase("knowledge");
    Write("p.json", poor.dump(1));
    const json lacks = Json("judge p.json --code EN1998-3").at(0);
    EXPECT_EQ("not checked", lacks.at("verdict"));
    ExpectHolds(lacks["limit_states"][0]["ends"][0]["rotation"]["reason"], {"knowledge"});
    ExpectRefused("judge c.json --evaluation NONE", 2, "NONE");
    ExpectRefused("judge c.json --level secondary", 2, "--code");
}

TEST_F(Judge, TableReportSheetAndPictureTellTheSame)
{
    Generate("ASCE41-17");
    const std::string table =
        Done("judge g.json --report r.txt --sheet s.xlsx --plot p.svg --trace");
    const json judged = Json("judge g.json").at(0);
    ExpectHolds(table, {"SD (LS)", "kappa", "not checked against the printed standard"});
    ExpectHolds(Text("r.txt"), {"SD (LS)", "PGA_C/PGA_D"});
    ExpectHolds(Text("p.svg"), {"<svg"});
    ExpectRefused("judge g.json --sheet s.xlsx", 4, "s.xlsx");
    if (!COffice::IsThere()) GTEST_SKIP() << "soffice or python3 is not installed";
    const OFFICE_CELLS cells = COffice().Recalculated(m_folder / "s.xlsx");
    ASSERT_LT(13U, cells.size()); // heads in row 8, six rows below: three states, two ends
    std::size_t rows = 0;
    for (const json& state : judged.at("limit_states"))
        for (const json& row : state.at("ends")) {
            const auto& line = cells.at(8 + rows++);
            EXPECT_EQ(row.at("end"), line.at(3));
            for (const auto& [mode, column] : {std::pair{"rotation", 14U}, {"shear", 17U}})
                EXPECT_NEAR(row.at(mode).at("ratio").get<double>(),
                            line.at(column).empty() ? 0.0 : std::stod(line.at(column)), 1e-9)
                    << mode;
        }
    const json& count = judged["limit_states"];
    double fulfilled = 0.0;
    for (const json& state : count)
        fulfilled += state.at("count").at("fulfilled").get<double>();
    EXPECT_EQ(fulfilled, std::stod(cells.at(2).at(1)));
}

// The column's concrete is another one since its hinges were generated.
TEST_F(Judge, StaleHingesAreSaidWithTheVerdict)
{
    Generate("EN1998-3");
    EXPECT_FALSE(Json("judge g.json").at(0).contains("stale_hinges"));
    json file = json::parse(Text("g.json"));
    file["materials"][0]["mean"]["fc"] = 20000;
    Write("old.json", file.dump(1));
    ExpectHolds(Json("judge old.json").at(0).at("stale_hinges"), {"1 element", "stale"});
    ExpectHolds(Done("judge old.json --report old.txt --csv old.csv"),
                {"by hinges that are stale"});
    ExpectHolds(Text("old.txt"), {"by hinges that are stale"});
    ExpectHolds(Text("old.csv"), {"E,SD,1,I,My", ",fulfilled"});
}

// Nothing is known of a spring to the ground, nor of a tie without a hinge; a beam of
// steel with pins at both ends has no axis about which it is bent.
TEST_F(Judge, WhatHasNoLimitsKeepsTheWholeFromBeingFulfilled)
{
    json file = Cantilever();
    file["spectra"][0]["ag"] = 0.01;
    Write("c.json", file.dump(1));
    EXPECT_EQ("fulfilled", Json("judge c.json --code EN1998-3").at(0).at("verdict"));
    file["materials"].push_back(
        {{"name", "S"}, {"type", "steel"}, {"E", 210e6}, {"nu", 0.3}, {"fy", 275000}});
    json spring = {
        {"id", 7}, {"kind", "spring"}, {"nodes", {2}}, {"stiffness", {1, 0, 0, 0, 0, 0}}};
    json with = file;
    with["elements"].push_back(spring);
    Write("s.json", with.dump(1));
    const json sprung = Json("judge s.json --code EN1998-3").at(0);
    EXPECT_EQ("not checked", sprung.at("verdict"));
    const json& last = sprung["limit_states"][0].at("ends").back();
    EXPECT_EQ(7, last.at("element"));
    EXPECT_TRUE(last.at("N").is_null());
    ExpectHolds(last.at("elongation").at("reason"), {"springs"});
    file["nodes"].push_back({{"id", 3}, {"xyz", {2, 0, 0}}, {"restraint", {1, 1, 1, 1, 1, 1}}});
    json pinned = file["elements"][0];
    pinned["id"] = 7;
    pinned["nodes"] = {1, 3};
    pinned["material"] = "S";
    pinned["release"] = {{"I", {"Ry", "Rz"}}, {"J", {"Ry", "Rz"}}};
    json tie = {
        {"id", 7}, {"kind", "truss"}, {"nodes", {1, 3}}, {"material", "S"}, {"section", "column"}};
    for (const json& element : {pinned, tie}) {
        with = file;
        with["elements"].push_back(element);
        Write("t.json", with.dump(1));
        const json judged = Json("judge t.json").at(0);
        std::size_t rows = 0;
        for (const json& row : judged["limit_states"][0].at("ends"))
            if (row.value("element", 0) == 7) {
                ++rows;
                ExpectHolds(row.at("elongation").at("reason"), {"no code is named"});
            }
        EXPECT_EQ(1U, rows);
    }
    ExpectRefused("judge c.json --code AISC342-22", 2, "--code");
}
