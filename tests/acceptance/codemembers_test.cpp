// Hinges that a code gives to steel, round columns and walls, through the program. The numbers come
// from tests/oracle/codemembers.py, which shares no line with the program.
#include "hingejson.h"

#include <algorithm>
#include <cmath>

namespace {

const double kPi = std::acos(-1.0);

/// Members apart from each other in the plane XZ, cantilevers of 3 m under their axial force, beams
/// of 6 m and a brace of 5 m between supports.
json Case()
{
    json file = json::parse(R"({"format": "qm-rps case 1",
        "units": {"force": "kN", "length": "m"}, "plane": "XZ",
        "design_codes": {"concrete": "Eurocode2:04", "steel": "Eurocode3:05"},
        "nodes": [{"id": 1, "xyz": [0, 0, 0]}, {"id": 2, "xyz": [0, 0, 3]},
                  {"id": 3, "xyz": [10, 0, 0]}, {"id": 4, "xyz": [16, 0, 0]},
                  {"id": 5, "xyz": [20, 0, 0]}, {"id": 6, "xyz": [23, 0, 4]},
                  {"id": 7, "xyz": [30, 0, 0]}, {"id": 8, "xyz": [30, 0, 3]},
                  {"id": 9, "xyz": [40, 0, 0]}, {"id": 10, "xyz": [40, 0, 3]}],
        "materials": [{"name": "S", "type": "steel", "E": 210e6, "nu": 0.3, "fy": 275000,
                       "knowledge": "KL2", "mean": {"fy": 303000}},
                      {"name": "C", "type": "concrete", "E": 15e6, "nu": 0.2, "fck": 20000,
                       "fyk": 400000, "Es": 2e8, "knowledge": "KL2",
                       "mean": {"fc": 28000, "fy": 450000}}],
        "sections": [{"name": "H", "shape": "I", "size": [0.2, 0.2, 0.009, 0.015]},
                     {"name": "I", "shape": "I", "size": [0.3, 0.15, 0.0071, 0.0107]},
                     {"name": "tube", "shape": "pipe", "size": [0.1397, 0.005]},
                     {"name": "disc", "shape": "circle", "size": [0.5]},
                     {"name": "wall", "shape": "rectangle", "size": [2.0, 0.25]}],
        "elements": [{"id": 1, "nodes": [1, 2], "material": "S", "section": "H"},
                     {"id": 2, "nodes": [3, 4], "material": "S", "section": "I"},
                     {"id": 3, "nodes": [5, 6], "kind": "truss", "material": "S",
                      "section": "tube"},
                     {"id": 4, "nodes": [7, 8], "material": "C", "section": "disc"},
                     {"id": 5, "nodes": [9, 10], "material": "C", "section": "wall"}],
        "load_cases": [{"name": "G", "nodal": [{"node": 2, "load": [0, 0, -400, 0, 0, 0]},
                                               {"node": 8, "load": [0, 0, -500, 0, 0, 0]},
                                               {"node": 10, "load": [0, 0, -1000, 0, 0, 0]}]}],
        "pushover_control": {"initial_loads": [{"case": "G", "factor": 1}]}})");
    for (const int fixed : {0, 2, 3, 4, 5, 6, 8})
        file["nodes"][fixed]["restraint"] = {1, 1, 1, 1, 1, 1};
    const double a = 254.469e-6;
    for (int k = 0; k < 8; ++k)
        file["sections"][3]["bars"].push_back(
            {{"y", 0.2 * std::sin(kPi / 4 * k)}, {"z", 0.2 * std::cos(kPi / 4 * k)}, {"area", a}});
    for (int k = 0; k < 20; ++k)
        file["sections"][4]["bars"].push_back(
            {{"y", k % 2 ? 0.075 : -0.075}, {"z", -0.95 + 1.9 * (k / 2) / 9}, {"area", a}});
    file["sections"][3]["detailing"] = {
        {"cover", 0.03}, {"stirrup_diameter", 0.008}, {"stirrup_spacing", 0.1}};
    file["sections"][4]["detailing"] = {
        {"cover", 0.03}, {"stirrup_diameter", 0.008}, {"stirrup_spacing", 0.2}};
    return file;
}

/// Two storeys of 3.5 m on one side of a beam of 6 m, one on the other.
json Frame()
{
    json file = Case();
    file.erase("load_cases");
    file.erase("pushover_control");
    file["nodes"] = json::parse(R"([{"id": 1, "xyz": [0, 0, 0], "restraint": [1, 1, 1, 1, 1, 1]},
        {"id": 2, "xyz": [0, 0, 3.5]}, {"id": 3, "xyz": [0, 0, 7]}, {"id": 4, "xyz": [6, 0, 3.5]},
        {"id": 5, "xyz": [6, 0, 0], "restraint": [1, 1, 1, 1, 1, 1]}])");
    file["elements"] = json::array();
    const int nodes[][2] = {{1, 2}, {2, 3}, {5, 4}, {2, 4}};
    for (int k = 0; k < 4; ++k)
        file["elements"].push_back({{"id", k + 1},
                                    {"nodes", {nodes[k][0], nodes[k][1]}},
                                    {"material", "S"},
                                    {"section", k == 3 ? "I" : "H"}});
    return file;
}

class CodeMembers : public CProgramTest {
protected:
    json Generated(const std::string& code, const std::string& elements) const
    {
        Write("c.json", Case().dump(1));
        return Json("hinge generate c.json --code " + code + " --elements " + elements +
                    " -o g.json --overwrite");
    }
};

// By hand: beam 300 deep, Z 602.098e-6 m3, Fye 303 MPa; Vpz = M 6/5.8/0.3 (3.5 - 0.3)/3.5, Vye =
// 0.55 303e6 0.2 0.009: 1.917, so 0.8; tcf 15 < 150/7, so 0.8 without plates; L/d 20. RBS: 0.050 -
// 0.0003 11.811, 0.070 - 0.0003 11.811.
TEST_F(CodeMembers, SteelBeamsTakeTheirConnections)
{
    const auto made = [&](const json& file, const std::string& more) {
        Write("f.json", file.dump(1));
        return Json("hinge generate f.json --code ASCE41-17 --elements 4 --connection RBS" + more +
                    " -o g.json --overwrite");
    };
    json r = made(Frame(), "");
    ExpectHinge(HingeOf(r, "My", "+-"),
                {{"moment", 182.43580883699996},
                 {"Vpz/Vye", 1.9174153483604517},
                 {"a", 0.029732283464566935},
                 {"b", 0.042532283464566945},
                 {"c", 0.2}},
                1e-9, "RBS");
    EXPECT_FALSE(HingeOf(r, "My", "+-").at("backbone").contains("IO"));
    r = made(Frame(), " --continuity-plate 0.0107 --panel-ratio 0.75");
    ExpectHinge(HingeOf(r, "My", "+-"), {{"a", 0.04645669291338583}, {"b", 0.06645669291338584}},
                1e-9, "all serve");
    // Another panel: the type is stale, and regenerated with the same connection.
    (void)made(Frame(), "");
    json changed = json::parse(Text("g.json"));
    EXPECT_EQ("RBS", changed["hinge_types"][0]["generated"]["connection"]["kind"]);
    changed["sections"][0]["size"][2] = 0.022; // 0.7844
    Write("s.json", changed.dump(1));
    r = Json("hinge generate s.json --stale -o t.json --overwrite");
    ExpectHinge(HingeOf(r, "My", "+-"), {{"a", 0.037165354330708666}}, 1e-9, "again");

    json lone = Frame();
    lone["elements"][2]["section"] = "tube";
    Write("f.json", lone.dump(1));
    ExpectRefused("hinge generate f.json --code ASCE41-17 --elements 4 --connection RBS -o x.json",
                  3, "node 4");
    ExpectRefused("hinge generate f.json --code EN1998-3 --all --connection RBS -o x.json", 2,
                  "ASCE41-17");
    ExpectRefused("hinge generate f.json --code ASCE41-17 --all --panel-ratio 0.7 -o x.json", 2,
                  "--connection");
    ExpectRefused("hinge generate f.json --code AISC342-22 --elements 4 -o x.json", 3,
                  "AISC342-22");
}

// p = 400/(A Fye) with A = 7530 mm2: a = 5.5 (h/tw)^-0.95 (L/ry)^-0.5 (1 - p)^2.4.
TEST_F(CodeMembers, DuctileSteelColumnsOfAisc342)
{
    const json r = Generated("AISC342-22", "1");
    const double A = 2 * 0.2 * 0.015 + 0.17 * 0.009, p = 400e3 / (A * 303e6);
    const double Iz = 2 * 0.015 * std::pow(0.2, 3) / 12 + 0.17 * std::pow(0.009, 3) / 12;
    const double web = 0.17 / 0.009, length = 3.0 / std::sqrt(Iz / A);
    ExpectHinge(HingeOf(r, "My", "+-"),
                {{"a", std::min(0.07, 5.5 * std::pow(web, -0.95) * std::pow(length, -0.5) *
                                          std::pow(1 - p, 2.4))},
                 {"b", std::min(0.07, 20 * std::pow(web, -0.9) * std::pow(length, -0.5) *
                                          std::pow(1 - p, 3.4))},
                 {"c", 0.4 - 0.4 * p}},
                1e-6, "AISC 342");
}

TEST_F(CodeMembers, SteelBends)
{
    json r = Generated("ASCE41-17", "1");
    ExpectHinge(HingeOf(r, "My", "+-"),
                {{"moment", 171.39944750996017},
                 {"y", 0.007401755202349916},
                 {"a", 0.021511439021795906},
                 {"b", 0.05063131902644269},
                 {"c", 0.7422152972269339},
                 {"C", 1.0871878565301636},
                 {"shear", 114.26629833997345},
                 {"shear_strength", 327.24},
                 {"CP", 0.05063131902644269}},
                1e-9, "ASCE 41-17 column");
    const json type = json::parse(Text("g.json")).at("hinge_types")[0];
    EXPECT_EQ("user", type.at("interaction")); // follows the axial force: 9/8 (1 - p) from 0.2 on
    double atLoad = 0.0, atFifth = 0.0, largest = 0.0;
    const json& curve = type.at("pmm").at("curve_1");
    for (std::size_t i = 0; i < curve.at("p").size(); ++i) {
        const double p = curve["p"][i];
        if (std::fabs(p - 0.17531633641451794) < 1e-9) atLoad = curve["m"][i];
        if (std::fabs(p + 0.2) < 1e-9) atFifth = curve["m"][i];
        largest = std::max(largest, curve["m"][i].get<double>());
    }
    EXPECT_DOUBLE_EQ(1.0, largest);
    EXPECT_NEAR(1.0 - 0.17531633641451794 / 2.0, atLoad, 1e-9);
    EXPECT_NEAR(0.9, atFifth, 1e-9); // in tension, too

    r = Generated("ASCE41-13", "1"); // P/P_CL 0.233: between the ladders
    ExpectHinge(HingeOf(r, "My", "+-"),
                {{"moment", 182.81895762350598},
                 {"P_CL", 1715.7151311347664},
                 {"theta_y", 0.006690591601222902},
                 {"a", 11 * (1 - 5.0 / 3.0 * 0.23313893591148885) * 0.006690591601222902}},
                1e-9, "ASCE 41-13 column");
    r = Generated("ASCE41-17", "2");
    ExpectHinge(HingeOf(r, "My", "+-"),
                {{"moment", 182.43580883699997},
                 {"a", 0.09774584674362159},
                 {"b", 0.11946714601998194},
                 {"shear", 60.81193627899999}},
                1e-9, "beam");
    r = Generated("EN1998-3", "1");
    ExpectHinge(HingeOf(r, "My", "+-"),
                {{"moment", 137.59926579822618},
                 {"y", 0.005942119979134502},
                 {"DL", 0.011884239958269004},
                 {"SD", 0.04159483985394151},
                 {"NC", 0.05347907981221052},
                 {"class", 1.0},
                 {"shear_strength", 223.04484274468217}},
                1e-9, "EN 1998-3 column");
}

TEST_F(CodeMembers, BracesBuckleAndYield)
{
    json r = Generated("ASCE41-17", "3");
    ExpectHinge(HingeOf(r, "Fx", "+"),
                {{"force", 641.1063836143963}, {"y", 0.007214285714285714}, {"c", 0.8}}, 1e-9, "T");
    ExpectHinge(HingeOf(r, "Fx", "-"),
                {{"force", 326.8979636674534},
                 {"y", 0.003678539739410328},
                 {"a", 0.0020273208933940384},
                 {"b", 0.032354653559937455},
                 {"c", 0.3204484428072558}},
                1e-9, "C");
    EXPECT_EQ("truss", json::parse(Text("g.json")).at("hinge_types")[0].at("element"));
    r = Generated("EN1998-3", "3");
    ExpectHinge(HingeOf(r, "Fx", "-"), {{"force", 242.7050331329081}, {"NC", 0.019117894450078957}},
                1e-9, "EN C");
    ExpectHinge(HingeOf(r, "Fx", "+"), {{"NC", 0.06011904761904762}}, 1e-9, "EN T");
}

TEST_F(CodeMembers, RoundColumnsHaveTheirOwnRows)
{
    json r = Generated("ASCE41-17", "4");
    const double rho = 2 * kPi / 4 * 0.008 * 0.008 / (0.5 * 0.1);
    ExpectHinge(HingeOf(r, "My", "+-"),
                {{"moment", 250.29466403528002},
                 {"shear_strength", 336.2087712356714},
                 {"a", 0.03879366746398221},
                 {"b", 0.06630812684848503},
                 {"c", 0.20362172729328104},
                 {"LS", 0.5 * (0.65 / (5 + 0.1 / 0.8 / rho * 28 / 450) - 0.01)}}, // nu >= 0.1
                2e-5, "ASCE 41-17");
    r = Generated("EN1998-3", "4");
    const double phiY = 0.007426079734614177, phiU = 0.12933107325352466, lpl = 0.3037121033435094;
    // VRd,c = 224 is above My / LV = 147: no shear cracks, aV = 0.
    const double thetaY =
        phiY * 1.5 / 3 + 0.0014 * (1 + 1.5 * 0.5 / 1.5) + phiY * 1.3973827576682671 / 8;
    ExpectHinge(HingeOf(r, "My", "+-"),
                {{"moment", 219.97703453102233},
                 {"phi_y", phiY},
                 {"phi_u", phiU},
                 {"x", 0.1975114640641673},
                 {"y", thetaY},
                 {"NC", (thetaY + (phiU - phiY) * lpl * (1 - 0.5 * lpl / 1.5)) / 1.7}},
                1e-4, "EN 1998-3");
}

TEST_F(CodeMembers, WallsFailInShearWhereItComesFirst)
{
    json r = Generated("ASCE41-17", "5");
    EXPECT_EQ("wall", r["types"][0]["member"]);
    ExpectHinge(HingeOf(r, "My", "+-"),
                {{"moment", 2698.0805792377823},
                 {"shear", 1798.7203861585215},
                 {"shear_strength", 891.7675439074878},
                 {"a", 0.006},
                 {"b", 0.010},
                 {"c", 0.30}},
                2e-5, "bending, Table 10-19");
    // Table 10-20, x = 0.071: drifts 0.4, 0.75 and 1.0 % of 3 m, nothing is left.
    ExpectHinge(HingeOf(r, "Fz", "+-"),
                {{"force", 891.7675439074878}, {"y", 0.012}, {"a", 0.0105}, {"CP", 0.018}}, 1e-9,
                "shear");
    int metres = 0;
    for (const json& line : HingeOf(r, "Fz", "+-").at("trace"))
        metres += line.at("symbol") == "D(B)" && line.at("unit") == "m" ? 1 : 0;
    EXPECT_EQ(1, metres); // beside the rotation of bending
    ExpectHolds(r["types"][0]["hinges"][0]["warnings"].dump(),
                {"not confined", "this storey alone"});
    EXPECT_EQ("center",
              json::parse(Text("g.json")).at("hinge_types")[0]["components"]["Fz"]["location"]);
}

TEST_F(CodeMembers, CurvesByAxialForceAreThoseAtTheirForces)
{
    Write("c.json", Case().dump(1));
    (void)Done("hinge generate c.json --elements 1 --code ASCE41-17 --axial-range -400..400"
               " -o g.json");
    const json type = json::parse(Text("g.json")).at("hinge_types")[0];
    EXPECT_FALSE(type.contains("pmm"));
    const json& curves = type["components"]["My"]["curve"]["axial_curves"];
    ASSERT_EQ(7u, curves.size()); // -400, -240, -80, 0, 80, 240, 400
    const json& first = curves[0];
    const json& last = curves[6];
    EXPECT_NEAR(-400.0, first["axial"], 1e-9);
    EXPECT_NEAR(171.39944750996017, first["positive"]["yield"], 1e-6); // tension bends as much
    EXPECT_NEAR(171.39944750996017, last["positive"]["yield"], 1e-6);
    EXPECT_NEAR(0.021511439021795906, last["positive"]["C"]["deform"], 1e-11);
    EXPECT_NEAR(1.0, curves[3]["positive"]["yield"].get<double>() / 187.87, 1e-4); // Z Fye
    EXPECT_EQ(std::string::npos, Done("hinge check g.json").find("generated"));
    (void)ExpectRefused("hinge generate c.json --elements 1 --code EN1998-3 --axial-range 0..9"
                        " -o no.json",
                        2, "ASCE 41 and FEMA 356 alone");
    (void)ExpectRefused("hinge generate c.json --elements 1 --code ASCE41-17 --axial-range 9..0"
                        " -o no.json",
                        2, "expected two forces");
    (void)ExpectRefused("hinge generate c.json --elements 1 --code ASCE41-13 --axial-range 0..1600"
                        " -o no.json",
                        3, "at N = ");
}

TEST_F(CodeMembers, EditsOfWhatATypeWasAskedForAreTold)
{
    Write("f.json", Frame().dump(1));
    (void)Done("hinge generate f.json --code ASCE41-17 --elements 4 --connection RBS -o g.json"
               " --overwrite");
    const json made = json::parse(Text("g.json"));
    const json& generated = made.at("hinge_types").at(0).at("generated");
    const struct {
        const char *place, *value;
        bool edited;
    } kEdits[] = {
        {"code", "\"ASCE41-17\"", false},
        {"code", "\"ASCE41-13\"", true}, // the same row
        {"secondary", "true", true},
        {"axial_I", "5", true},
        {"tie", "5", true},
        {"axial_range", "[0, 5]", true},
        {"connection/kind", "\"WUF-B\"", true},
        {"connection/panel_ratio", "0.75", true},
    };
    for (const auto& e : kEdits) {
        json file = made;
        file[json::json_pointer("/hinge_types/0/generated/" + std::string(e.place))] =
            json::parse(e.value);
        Write("e.json", file.dump(1));
        const std::string said = Done("hinge check e.json");
        EXPECT_EQ(e.edited, said.find("generated, and edited since") != std::string::npos)
            << e.place << " of " << generated << "\n"
            << said;
    }
}

TEST_F(CodeMembers, AreRefusedWhereTheCodeHasNoRow)
{
    const struct {
        const char *pointer, *value, *says, *options;
    } bad[] = {
        {"/sections/0/shape", "\"box\"", "Element 1: shape: I", "ASCE41-17 --elements 1"},
        {"/sections/0/size", "[0.2, 0.4, 0.009, 0.008]", "Element 1: sectionClass",
         "EN1998-3 --elements 1"},
        {"/load_cases/0/nodal/0/load/2", "-1200", "force-controlled", "ASCE41-13 --elements 1"},
        {"/load_cases/0/nodal/0/load/2", "-1200", "axialRatio: must lie within",
         "EN1998-3 --elements 1"},
        {"/load_cases/0/nodal/0/load/2", "-2500", "does not carry the axial force",
         "ASCE41-17 --elements 1"},
        {"/materials/0/knowledge", "null", "Element 1: knowledge", "EN1998-3 --elements 1"},
        {"/materials/1/type", "\"masonry\"", "Element 4: ", "ASCE41-17 --elements 4"},
        {"/materials/0/fy", "0", "Fy: must be above 0", "ASCE41-17 --elements 3"},
        {"/elements/4/nodes", "[9, 10]", "wall: FEMA356 has no row", "FEMA356 --elements 5"},
    };
    for (const auto& b : bad) {
        json file = Case();
        const json::json_pointer at(b.pointer);
        const json value = json::parse(b.value);
        if (value.is_null())
            file[at.parent_pointer()].erase(at.back());
        else
            file[at] = value;
        if (std::string(b.says).starts_with("Fy")) file["materials"][0].erase("mean");
        Write("bad.json", file.dump(1));
        (void)ExpectRefused(std::string("hinge generate bad.json -o no.json --code ") + b.options,
                            3, b.says);
    }
    // Without a mean the characteristic value counts, and that is said.
    json file = Case();
    file["materials"][0].erase("mean");
    Write("c.json", file.dump(1));
    const json r = Json("hinge generate c.json --code EN1998-3 --elements 2 -o g.json --overwrite");
    ExpectHolds(r.dump(), {"no mean value is given for S"});
    ExpectHinge(HingeOf(r, "My", "+-"), {{"moment", 182.43580883699997 / 303 * 275 / 1.2}}, 1e-9,
                "Fy/CF");
}

TEST_F(CodeMembers, CarryTheSteelExampleToItsTarget)
{
    for (const char* const code : {"ASCE41-17", "EN1998-3", "Circolare2019", "FEMA356"}) {
        const std::string said =
            Done(std::string("hinge generate @steel-frame-code-hinges --all -o g.json"
                             " --overwrite --code ") +
                 code);
        ExpectHolds(said, {"18 elements have hinges of 6 types"});
        EXPECT_EQ(std::string::npos, Done("hinge check g.json").find("generated")) << code;
        EXPECT_EQ("reached", Json("push g.json --case PX").at(0).at("status")) << code;
    }
}

} // namespace
