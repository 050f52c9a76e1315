// Hinges that a code gives, through the program. The numbers of the column and the beam come from
// tests/oracle/codehinges.py, which shares no line with the program.
#include "program.h"

#include <algorithm>
#include <cmath>

namespace {

/// A cantilever of 3 m under 640 kN, 0.40 x 0.40 with 8 bars of 18 mm, and a beam between two
/// supports 4.6 m apart, 0.30 x 0.50 with 4 bars of 18 mm above and 3 below; stirrups of 8 mm.
json Case()
{
    const double a = 254.469e-6;
    json file = json::parse(R"({"format": "qm-rps case 1",
        "units": {"force": "kN", "length": "m"},
        "design_codes": {"concrete": "Eurocode2:04", "steel": "Eurocode3:05"},
        "nodes": [{"id": 1, "xyz": [0, 0, 0], "restraint": [1, 1, 1, 1, 1, 1]},
                  {"id": 2, "xyz": [0, 0, 3]},
                  {"id": 3, "xyz": [10, 0, 0], "restraint": [1, 1, 1, 1, 1, 1]},
                  {"id": 4, "xyz": [14.6, 0, 0], "restraint": [1, 1, 1, 1, 1, 1]}],
        "materials": [{"name": "C", "type": "concrete", "E": 15e6, "nu": 0.2, "fck": 20000,
                       "fyk": 400000, "Es": 2e8, "knowledge": "KL2",
                       "mean": {"fc": 28000, "fy": 450000}}],
        "sections": [{"name": "column", "shape": "rectangle", "size": [0.4, 0.4]},
                     {"name": "beam", "shape": "rectangle", "size": [0.5, 0.3]}],
        "elements": [{"id": 1, "nodes": [1, 2], "material": "C", "section": "column"},
                     {"id": 2, "nodes": [3, 4], "material": "C", "section": "beam"}],
        "load_cases": [{"name": "G", "nodal": [{"node": 2, "load": [0, 0, -640, 0, 0, 0]}]}],
        "pushover_control": {"initial_loads": [{"case": "G", "factor": 1}]}})");
    for (json& section : file["sections"])
        section["detailing"] = {
            {"cover", 0.03}, {"stirrup_diameter", 0.008}, {"stirrup_spacing", 0.15}};
    for (const double y : {-0.153, 0.0, 0.153})
        for (const double z : {-0.153, 0.0, 0.153})
            if (y != 0.0 || z != 0.0)
                file["sections"][0]["bars"].push_back({{"y", y}, {"z", z}, {"area", a}});
    for (const double y : {-0.103, -0.034, 0.034, 0.103})
        file["sections"][1]["bars"].push_back({{"y", y}, {"z", 0.203}, {"area", a}});
    for (const double y : {-0.103, 0.0, 0.103})
        file["sections"][1]["bars"].push_back({{"y", y}, {"z", -0.203}, {"area", a}});
    return file;
}

class CodeHinges : public CProgramTest {
protected:
    json Generated(const std::string& code, const std::string& more = "") const
    {
        Write("c.json", Case().dump(1));
        return Json("hinge generate c.json --code " + code + " --all -o g.json --overwrite" + more);
    }
};

/// The hinge of a type about an axis, on a side.
const json& HingeOf(const json& result, const std::string& section, const std::string& component,
                    const std::string& side)
{
    for (const json& type : result.at("types")) {
        if (type.at("name").get<std::string>().find(section) == std::string::npos) continue;
        for (const json& hinge : type.at("hinges"))
            if (hinge.at("component") == component && hinge.at("side") == side) return hinge;
    }
    ADD_FAILURE() << section << " " << component << side << ": not there";
    return result;
}

/// Within what the strips of the independent calculation leave open.
void ExpectClose(double expected, double actual, const std::string& what)
{
    EXPECT_NEAR(expected, actual, 2e-6 * std::fabs(expected)) << what;
}

// Table 10-5: P/(Ag f'cE) = 1/7, 0.342857 EcE Ig with EcE = 57000 sqrt(4061.06 psi); beam 0.3 EcE
// Ig.
TEST_F(CodeHinges, TellTheStiffnessOfTheCodeBesideTheModels)
{
    const auto line = [](const json& hinge, const char* symbol) -> double {
        for (const json& l : hinge.at("trace"))
            if (l.at("symbol") == symbol) return l.at("value");
        return 0.0;
    };
    const json result = Generated("ASCE41-17");
    const json& column = HingeOf(result, "column", "My", "+-");
    EXPECT_NEAR(18318.304915793764, line(column, "EI (code)"), 1e-6);
    EXPECT_NEAR(32000.0, line(column, "EI (model)"), 1e-6);
    EXPECT_NE(std::string::npos, result.dump().find("EI of the model is 1.747"));
    EXPECT_NEAR(23479.272658182923, line(HingeOf(result, "beam", "My", "+"), "EI (code)"), 1e-6);
}

TEST_F(CodeHinges, OfAColumnAreThoseOfAsce41)
{
    const json result = Generated("ASCE41-17");
    for (const char* const component : {"My", "Mz"}) { // a square with even bars
        const json& h = HingeOf(result, "column", component, "+-");
        const json& bone = h.at("backbone");
        const double y = bone.at("yield_rotation");
        EXPECT_DOUBLE_EQ(640.0, std::round(1e9 * h.at("axial").get<double>()) / 1e9);
        ExpectClose(241.6680493, h.at("moment"), "M");
        ExpectClose(161.1120328, h.at("shear"), "V = 2 M / 3.0");
        ExpectClose(240.6449933, h.at("shear_strength"), "Eq. (10-3)");
        // 6 EI / L = 6 x 15e6 x 0.4^4 / 12 / 3
        ExpectClose(241.6680493 / 64000.0, y, "theta_y");
        ExpectClose(0.0215141979, bone.at("C")[0].get<double>() - y, "a");
        ExpectClose(0.0329868799, bone.at("E")[0].get<double>() - y, "b");
        ExpectClose(0.1828571429, bone.at("D")[1], "c = 0.24 - 0.4 x 640/4480");
        ExpectClose(0.0032271297, bone.at("IO").get<double>() - y, "IO");
        ExpectClose(0.0164934399, bone.at("LS").get<double>() - y, "LS");
        ExpectClose(0.0230908159, bone.at("CP").get<double>() - y, "CP");
    }
    const json type = json::parse(Text("g.json")).at("hinge_types")[0];
    EXPECT_EQ("user", type.at("interaction"));
    const json& table = type.at("pmm").at("curve_1");
    // The strength follows the axial force, and has the calculated values at 0 and at 640 kN.
    ExpectClose(152.1937164, type["components"]["My"]["curve"]["positive"]["yield"], "M at N = 0");
    double atZero = 0.0, atLoad = 0.0;
    for (std::size_t i = 0; i < table.at("p").size(); ++i) {
        const double force = table["p"][i].get<double>() * type["pmm"]["Pmax"].get<double>();
        if (std::fabs(force) < 1e-6) atZero = table["m"][i];
        if (std::fabs(force - 640.0) < 1e-6) atLoad = table["m"][i];
    }
    ExpectClose(241.6680493 / 152.1937164, atLoad / atZero, "M(640) / M(0)");
}

TEST_F(CodeHinges, OfABeamHaveASideForEachRowOfBars)
{
    const json result = Generated("ASCE41-17");
    // An analysis calls a moment negative that compresses +z: sagging, 3 bars in tension, level
    // 1.25 sqrt(psi), (rho - rho') < 0; hogging, 4 bars, 0.0732 of rho_bal.
    const struct {
        const char* side;
        double moment, a, b, IO;
    } expected[] = {{"-", 148.3088551, 0.025, 0.05, 0.010},
                    {"+", 194.9934424, 0.0242684690, 0.0470738761, 0.0092684690}};
    for (const auto& e : expected) {
        const json& h = HingeOf(result, "beam", "My", e.side);
        const json& bone = h.at("backbone");
        const double y = bone.at("yield_rotation");
        ExpectClose(e.moment, h.at("moment"), e.side);
        ExpectClose(74.63093424, h.at("shear"), "V = (148.31 + 194.99) / 4.6");
        ExpectClose(e.a, bone.at("C")[0].get<double>() - y, "a");
        ExpectClose(e.b, bone.at("E")[0].get<double>() - y, "b");
        ExpectClose(e.IO, bone.at("IO").get<double>() - y, "IO");
    }
}

TEST_F(CodeHinges, OfAColumnAreThoseOfEn1998)
{
    const json result = Generated("EN1998-3");
    const json& h = HingeOf(result, "column", "My", "+-");
    const json& bone = h.at("backbone");
    ExpectClose(214.9566074, h.at("moment"), "M with 28/1.2 and 450/1.2 MPa");
    ExpectClose(0.0076697072, bone.at("yield_rotation"), "theta_y");
    ExpectClose(0.0076697072, bone.at("DL"), "DL");
    ExpectClose(0.0190441849, bone.at("SD"), "3/4 theta_um");
    ExpectClose(0.0253922465, bone.at("NC"), "theta_um");
    bool found = false;
    for (const json& line : h.at("trace"))
        found = found || (line["symbol"] == "theta_um" && line["clause"] == "EN 1998-3 (A.1)" &&
                          line["mark"] == "sighted twice");
    EXPECT_TRUE(found);
    // A secondary member keeps the mean: 1.5 times as much.
    const json other = Generated("EN1998-3", " --level secondary");
    ExpectClose(1.5 * 0.0253922465, HingeOf(other, "column", "My", "+-")["backbone"]["NC"], "1.0");
}

TEST_F(CodeHinges, ComeBackFromBothFilesAndTellWhatHasChanged)
{
    (void)Generated("ASCE41-17");
    (void)Done("import g.json m.qmdb");
    (void)Done("export m.qmdb back.json");
    EXPECT_EQ(json::parse(Text("g.json")), json::parse(Text("back.json")));
    EXPECT_EQ(std::string::npos, Done("hinge check m.qmdb").find("generated"));

    json stale = json::parse(Text("g.json"));
    stale["sections"][0]["detailing"]["stirrup_spacing"] = 0.1;
    stale["hinge_types"][1]["components"]["My"]["curve"]["positive"]["LS"] = 0.02;
    Write("stale.json", stale.dump(1));
    ExpectHolds(Done("hinge check stale.json"),
                {"column 1", "stale: section, material, member or initial loads of element 1",
                 "beam 1", "generated, and edited since"});
    // The stale one alone is made again, by its own code; the edited one stays.
    const json fresh = Json("hinge generate stale.json --stale -o fresh.json");
    ASSERT_EQ(1U, fresh.at("types").size());
    EXPECT_EQ("ASCE41-17", fresh.at("code"));
    EXPECT_EQ(json::array({1}), fresh["types"][0]["elements"]);
    const std::string said = Done("hinge check fresh.json");
    EXPECT_EQ(std::string::npos, said.find("stale: section")) << said;
    ExpectHolds(said, {"generated, and edited since"});
    ExpectHolds(Done("hinge generate fresh.json --stale -o none.json"), {"0 elements"});
    (void)ExpectRefused("hinge generate stale.json --stale --all -o no.json", 2, "--stale");
    (void)ExpectRefused("hinge generate stale.json --all -o no.json", 2, "--code");
    // Once more: the types of before are replaced, not added to.
    const json again = Json("hinge generate stale.json --code ASCE41-17 --all -o again.json");
    EXPECT_EQ(2u, json::parse(Text("again.json")).at("hinge_types").size());
    EXPECT_EQ(std::string::npos, Done("hinge check again.json").find("generated"));
}

/// Bars of a section, sorted.
std::vector<std::array<double, 3>> BarsOf(const json& file, std::size_t section)
{
    std::vector<std::array<double, 3>> bars;
    for (const json& bar : file.at("sections").at(section).at("bars"))
        bars.push_back({bar.at("y"), bar.at("z"), bar.at("area")});
    std::ranges::sort(bars);
    return bars;
}

TEST_F(CodeHinges, BarsOfASectionAreLaidByARule)
{
    const json byHand = Case();
    json bare = byHand;
    bare["sections"][0].erase("bars");
    Write("c.json", bare.dump(1));
    ExpectHolds(Done("section bars c.json --section column --around 8x0.018 -o b.json"),
                {"8 bars, 0.0020358 m2: 1.27 %"});
    const auto expected = BarsOf(byHand, 0), laid = BarsOf(json::parse(Text("b.json")), 0);
    ASSERT_EQ(expected.size(), laid.size());
    for (std::size_t i = 0; i < laid.size(); ++i)
        for (std::size_t k = 0; k < 3; ++k)
            EXPECT_NEAR(expected[i][k], laid[i][k], 1e-9) << i;
    (void)Done("section bars b.json --section column --keep --top 2x0.01 -o more.json");
    EXPECT_EQ(10U, BarsOf(json::parse(Text("more.json")), 0).size());
    const std::pair<const char*, const char*> bad[] = {
        {"--section column --around 7x0.018", "even"},
        {"--section column --corners 4x0.018", "diameter alone"},
        {"--section column --top 0.018", "number x diameter"},
        {"--section column", "say which bars"},
        {"--section none --corners 0.018", "no section \"none\""}};
    for (const auto& [arguments, says] : bad)
        (void)ExpectRefused(std::string("section bars b.json ") + arguments + " -o no.json", 2,
                            says);
    EXPECT_EQ("", Text("no.json"));
#ifdef QM_UI
    (void)Done("section plot b.json --section column -o s.svg");
    ExpectHolds(Text("s.svg"), {"stirrup", "8 bars"});
#endif
}

TEST_F(CodeHinges, AreRefusedWithTheMemberAndTheReason)
{
    const struct {
        const char *pointer, *value, *says, *code;
    } bad[] = {
        {"/sections/0/detailing", "null", "detailing", "ASCE41-17"},
        {"/sections/0/detailing/stirrup_spacing", "0", "must be above 0", "ASCE41-17"},
        {"/sections/0/detailing/cover", "0.195", "no core", "ASCE41-17"},
        {"/sections/0/bars/0/z", "-0.19", "outside the stirrups", "ASCE41-17"},
        {"/sections/0/shape", "\"circle\"", "Element 1: The bars are wrong", "ASCE41-17"},
        {"/materials/0/mean", "null", "Element 1: mean.fc", "EN1998-3"},
        {"/materials/0/knowledge", "null", "Element 1: knowledge", "Circolare2019"},
        {"/materials/0/confidence_factor", "0.9", "at least 1", "EN1998-3"},
        {"/materials/0/type", "\"steel\"", "Element 1: shape: I, box, pipe", "ASCE41-17"},
        {"/load_cases/0/nodal/0/load/2", "-9000", "does not carry the axial force", "ASCE41-17"},
        {"/elements/1/offset", R"({"I": [2.3, 0, 0], "J": [-2.3, 0, 0]})", "beam 2: zero length",
         "ASCE41-17"},
        {"/design_codes", "null", "Eurocode", "EN1998-3"},
    };
    for (const auto& b : bad) {
        json file = Case();
        const json value = json::parse(b.value);
        const json::json_pointer at(b.pointer);
        if (value.is_null())
            file[at.parent_pointer()].erase(at.back());
        else
            file[at] = value;
        Write("bad.json", file.dump(1));
        (void)ExpectRefused(
            std::string("hinge generate bad.json --all -o no.json --code ") + b.code, 3, b.says);
        EXPECT_EQ("", Text("no.json")) << b.pointer;
    }
    Write("c.json", Case().dump(1));
    (void)ExpectRefused("hinge generate c.json --code FEMA356 -o no.json", 2, "--elements");
    (void)ExpectRefused("hinge generate c.json --code FEMA356 --elements 7 -o no.json", 3, "7");
}

TEST_F(CodeHinges, LeaveOutWhatCantHaveOneOnlyWhereAsked)
{
    json file = Case();
    file["sections"][1].erase("detailing");
    Write("c.json", file.dump(1));
    const T_RUN run = Run("hinge generate c.json --code ASCE41-17 --all --keep-going -o g.json");
    EXPECT_EQ(1, run.code);
    ExpectHolds(run.err, {"left out", "Element 2: detailing"});
    const json made = json::parse(Text("g.json"));
    EXPECT_EQ(1u, made.at("hinges").size());
    EXPECT_EQ(1, made["hinges"][0]["element"]);
}

TEST_F(CodeHinges, CarryTheExampleToItsTarget)
{
    const auto generate = [&](const std::string& code) {
        return Done("hinge generate @rc-frame-code-hinges --all -o g.json --overwrite --code " +
                    code);
    };
    for (const char* const code : {"ASCE41-17", "EN1998-3"}) {
        (void)generate(code);
        EXPECT_EQ("reached", Json("push g.json --case PX").at(0).at("status")) << code;
    }
    for (const char* const code : {"ASCE41-13", "FEMA356", "Circolare2019"})
        ExpectHolds(generate(code), {code, "10 elements have hinges of"});
}

} // namespace
