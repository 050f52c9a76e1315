// Hinges that a code gives to masonry, through the program. Values by hand.
#include "hingejson.h"

namespace {

/// A pier of a published set of inputs (1.5 x 0.3 x 3.0 m, fm 4, tau0 0.08, fv0 0.12 MPa, CF 1.2)
/// under 300 kN, and a spandrel 0.8 x 0.5 m, 1.5 m long, tied by 50 kN.
json Masonry()
{
    json file = json::parse(R"({"format": "qm-rps case 1",
        "units": {"force": "kN", "length": "m"}, "plane": "XZ",
        "design_codes": {"concrete": "Eurocode2:04", "steel": "Eurocode3:05"},
        "nodes": [{"id": 1, "xyz": [0, 0, 0], "restraint": [1, 1, 1, 1, 1, 1]},
                  {"id": 2, "xyz": [0, 0, 3]},
                  {"id": 3, "xyz": [9, 0, 0], "restraint": [1, 1, 1, 1, 1, 1]},
                  {"id": 4, "xyz": [10.5, 0, 0]}],
        "materials": [{"name": "M", "type": "masonry", "E": 2e6, "G": 7e5, "mean": {"fc": 4000},
                       "masonry": {"tau0": 80, "fv0": 120}, "confidence_factor": 1.2},
                      {"name": "B", "type": "masonry", "E": 1.5e6, "G": 5e5,
                       "mean": {"fc": 3450}, "masonry": {"tau0": 90}, "confidence_factor": 1}],
        "sections": [{"name": "pier", "shape": "rectangle", "size": [1.5, 0.3]},
                     {"name": "band", "shape": "rectangle", "size": [0.8, 0.5]}],
        "elements": [{"id": 1, "nodes": [1, 2], "material": "M", "section": "pier"},
                     {"id": 2, "nodes": [3, 4], "material": "B", "section": "band"}],
        "load_cases": [{"name": "G", "nodal": [{"node": 2, "load": [0, 0, -300, 0, 0, 0]}]}],
        "pushover_control": {"initial_loads": [{"case": "G", "factor": 1}]}})");
    return file;
}

class CodeMasonry : public CProgramTest {};

TEST_F(CodeMasonry, MasonryTurnsAndSlides)
{
    Write("c.json", Masonry().dump(1));
    const auto generate = [&](const std::string& options) {
        return Json("hinge generate c.json -o g.json --overwrite --code " + options);
    };
    json r = generate("Circolare2019 --elements 1");
    EXPECT_EQ("pier", r["types"][0]["member"]);
    // V L^3/(12 EI) + V L/(GA'): I = 0.3 1.5^3/12, A' = 5/6 0.45.
    const double v = 83.066, sway = v * 27 / (12 * 2e6 * 0.084375) + v * 3 / (7e5 * 0.375);
    ExpectHinge(HingeOf(r, "My", "+-"),
                {{"moment", 172.059},
                 {"shear", 2 * 172.059 / 3},
                 {"shear_strength", v},
                 {"y", 172.059 * 3 / (6 * 2e6 * 0.084375)},
                 {"SD", 0.0075},
                 {"NC", 0.01}},
                1e-4, "flexure");
    ExpectHinge(HingeOf(r, "Fz", "+-"),
                {{"force", v}, {"y", sway}, {"SD", 0.75 * 0.015}, {"NC", 0.015}}, 1e-4, "diagonal");
    r = generate("EN1998-3 --elements 1");
    // nu_d = 300/(0.45 3333.3) = 0.2: 1.5 300/2 (1 - 0.23); SD 0.008 1.5/1.5.
    // Sliding: (1.5 0.45 100 + 0.4 300)/(1 + 3 1.5 0.3 100/300) = 129.3; 0.065 fm = 216.67 kPa:
    // 1.5 0.45 216.67/(1 + 1.35 216.67/300) = 74.05.
    ExpectHinge(HingeOf(r, "My", "+-"), {{"moment", 173.25}, {"SD", 0.008}, {"NC", 0.032 / 3}},
                1e-9, "EN flexure");
    ExpectHinge(HingeOf(r, "Fz", "+-"), {{"force", 146.25 / 1.975}, {"SD", 0.012}, {"NC", 0.016}},
                1e-9, "EN sliding");
    r = generate("Circolare2019 --elements 2 --tie 50");
    EXPECT_EQ("spandrel", r["types"][0]["member"]);
    ExpectHinge(HingeOf(r, "My", "+-"),
                {{"moment", 50 * 0.4 * (1 - 50 / (0.85 * 3450 * 0.4))}, {"NC", 0.02}}, 1e-9, "tie");
    // 0.4 135/1.5; 0.005 of 1.5 m.
    ExpectHinge(HingeOf(r, "Fz", "+-"), {{"force", 36.0}, {"NC", 0.0075}}, 1e-9, "h t ftd/b");
    EXPECT_EQ(std::string::npos, Done("hinge check g.json").find("generated"));
    const std::string no = " -o no.json --code ";
    (void)ExpectRefused("hinge generate c.json --elements 2" + no + "Circolare2019", 3,
                        "Element 2: tie: must be above 0");
    (void)ExpectRefused("hinge generate c.json --elements 2 --tie 50" + no + "EN1998-3", 3,
                        "Element 2: spandrel");
    (void)ExpectRefused("hinge generate c.json --elements 1" + no + "ASCE41-17", 3,
                        "Element 1: masonry: ASCE41-17 has no row");
}

TEST_F(CodeMasonry, BlocksLimitSlidingAndOffsetsDoNotBend)
{
    json file = Masonry();
    // Rigid ends leave the spandrel 1.5 m and the pier 3.0 m, whatever lies between their nodes.
    file["nodes"][1]["xyz"] = {0, 0, 4};
    file["nodes"][3]["xyz"] = {12, 0, 0};
    file["elements"][0]["offset"] = {{"I", {0, 0, 0.3}}, {"J", {0, 0, -0.7}}};
    file["elements"][1]["offset"] = {{"I", {0.5, 0, 0}}, {"J", {-1, 0, 0}}};
    const auto generate = [&](const std::string& options) {
        Write("c.json", file.dump(1));
        return Json("hinge generate c.json -o g.json --overwrite --code Circolare2019 " + options);
    };
    json r = generate("--elements 2 --tie 50");
    const double tied = 50 * 0.4 * (1 - 50 / (0.85 * 3450 * 0.4));
    ExpectHinge(HingeOf(r, "My", "+-"),
                {{"moment", tied}, {"y", tied * 1.5 / (6 * 1.5e6 * 0.5 * 0.512 / 12)}}, 1e-9,
                "spandrel");
    r = generate("--elements 1");
    ExpectHinge(HingeOf(r, "My", "+-"), {{"y", 172.059 * 3 / (6 * 2e6 * 0.084375)}}, 1e-4, "pier");
    EXPECT_EQ(3.0, json::parse(Text("g.json"))["hinge_types"][0]["length"]["span"]);
    EXPECT_EQ(std::string::npos, Done("hinge check g.json").find("generated"));
    ExpectHolds(
        Done("hinge generate c.json --elements 1 --code Circolare2019 -o g.json --overwrite"),
        {"fb of the blocks is not given"});
    // 0.065 1000/(0.7 1.2) = 77.38 kPa over the whole length, 0.45 77.38: M/N is less than l/6.
    file["materials"][0]["masonry"]["fb"] = 1000;
    r = generate("--elements 1");
    const double limit = 65 / 0.84;
    ExpectHinge(HingeOf(r, "Fz", "+-"), {{"force", 0.45 * limit}}, 1e-9, "blocks");
}

} // namespace
