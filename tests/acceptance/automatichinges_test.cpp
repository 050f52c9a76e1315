// Automatic moments at the axial force of the loads that stand before the push.
#include "program.h"

namespace {

/// A cantilever of steel (235 MPa) of 3 m, 0.30 x 0.20: N = 14100 kN, M = 1057.5 kNm about y and
/// 705 kNm about z, under N M (1 - n^2). G presses with n = 0.3, H with 0.15, K with 1.1.
json Case()
{
    return json::parse(R"({"format": "qm-rps case 1",
        "units": {"force": "kN", "length": "m"},
        "nodes": [{"id": 1, "xyz": [0, 0, 0], "restraint": [1, 1, 1, 1, 1, 1]},
                  {"id": 2, "xyz": [0, 0, 3]}],
        "materials": [{"name": "S", "type": "steel", "E": 210e6, "nu": 0.3, "Fy": 235000}],
        "sections": [{"name": "bar", "shape": "rectangle", "size": [0.3, 0.2]}],
        "elements": [{"id": 1, "nodes": [1, 2], "material": "S", "section": "bar"}],
        "load_cases": [{"name": "G", "nodal": [{"node": 2, "load": [0, 0, -4230, 0, 0, 0]}]},
                       {"name": "H", "nodal": [{"node": 2, "load": [0, 0, -2115, 0, 0, 0]}]},
                       {"name": "K", "nodal": [{"node": 2, "load": [0, 0, -15510, 0, 0, 0]}]}],
        "pushover_control": {"initial_loads": [{"case": "G", "factor": 1}]},
        "hinge_types": [{"name": "t", "element": "beam-column", "material": "steel",
            "components": {"My": {"type": "bilinear", "curve": {"positive": {"alpha1": 0.01}}},
                           "Mz": {"type": "bilinear", "curve": {"positive": {"alpha1": 0.01}}}}}]
        })");
}

using CAutomaticHinges = CProgramTest;

TEST_F(CAutomaticHinges, TakeTheirMomentsAtTheAxialForceOfTheInitialLoads)
{
    const struct {
        const char* loads; // of the control
        const char* option;
        const char* interaction;
        double part; // 1 - n^2
    } rows[] = {{R"([{"case": "G", "factor": 1}])", "", "P", 0.91},
                {R"([{"case": "G", "factor": -1}])", "", "P", 0.91},
                {R"([{"case": "G", "factor": 1}])", " --axial-case H", "P", 0.9775},
                {"[]", "", "P", 1.0},
                {R"([{"case": "G", "factor": 1}])", "", "PMM", 1.0}};
    for (const auto& row : rows) {
        SCOPED_TRACE(std::string(row.loads) + row.option + row.interaction);
        json file = Case();
        file["pushover_control"]["initial_loads"] = json::parse(row.loads);
        file["hinge_types"][0]["interaction"] = row.interaction;
        Write("c.json", file.dump(1));
        Done("hinge assign c.json --type t --elements 1 -o g.json --overwrite" +
             std::string(row.option));
        const json yield = json::parse(Text("g.json")).at("hinges")[0].at("yield");
        EXPECT_NEAR(1057.5 * row.part, yield.at("My").at("positive").get<double>(), 1e-6);
        EXPECT_NEAR(705.0 * row.part, yield.at("Mz").at("negative").get<double>(), 1e-6);
    }
}

TEST_F(CAutomaticHinges, AreStaleWithOtherLoadsAndRefusedBeyondWhatTheSectionCarries)
{
    json file = Case();
    Write("c.json", file.dump(1));
    Done("hinge assign c.json --type t --elements 1 -o g.json");
    file = json::parse(Text("g.json"));
    file["pushover_control"]["initial_loads"][0]["factor"] = 0.5;
    Write("half.json", file.dump(1));
    const T_RUN check = Run("hinge check half.json");
    EXPECT_EQ(1, check.code);
    ExpectHolds(check.out, {"My(+) 962.325, now 1033.71"});
    ExpectRefused("hinge assign c.json --type t --elements 1 --axial-case K -o k.json", 3,
                  "Element 1: The axial force 15510");
}

} // namespace
