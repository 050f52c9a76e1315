// Hinges that a code gives with the shear of a push, through the program.
#include "hingejson.h"

#include <algorithm>
#include <cmath>
#include <map>

namespace {

using CodePush = CProgramTest;

} // namespace

// By hand from the end moments of the push, at the first step where the end flows: V = (MI - MJ)/L
// of column 2 (no load along it), -+ w L/2 of beam 11 under w = 32.6 kN/m between the rigid
// offsets: a push along +X makes its end I sag, which the load relieves, and J hog. M/V within
// min(0.5; 2.3) and, of the beam, 4.6 m.
TEST_F(CodePush, ShearOfAPushIsThatOfItsState)
{
    const json r = Json("hinge generate @rc-frame-code-hinges --all --code ASCE41-17 --push PX"
                        " -o g.json --overwrite");
    ASSERT_LE(2u, r.at("pushes").size());
    EXPECT_LT(r["pushes"].back()["change"], 0.01);
    EXPECT_EQ("target reached", r["pushes"][0]["outcome"]);
    const json push = Json("push g.json --case PX").at(0);
    const struct {
        int element;
        const char* end;
        double clear, load; // along local z
    } kEnds[] = {{2, "I", 2.95, 0.0}, {11, "I", 4.6, -32.6}, {11, "J", 4.6, -32.6}};
    for (const auto& e : kEnds) {
        std::map<std::string, json> ends;
        for (const json& hinge : push.at("hinges"))
            if (hinge.at("element") == e.element) ends[hinge.at("end")] = hinge;
        std::size_t at = 0;
        while (ends[e.end].at("state")[at] == "elastic")
            ++at;
        const double own = ends[e.end].at("force")[at], I = ends["I"].at("force")[at],
                     J = ends["J"].at("force")[at];
        const double sign = std::string(e.end) == "I" ? 1.0 : -1.0;
        const double V = std::fabs((J - I) / e.clear + sign * e.load * e.clear / 2.0);
        const double longest = e.load == 0.0 ? 1e9 : e.clear;
        for (const json& type : r.at("types")) {
            const std::vector<int> elements = type.at("elements");
            if (std::ranges::count(elements, e.element) == 0) continue;
            for (const json& hinge : type.at("hinges")) {
                if (hinge.at("end") != e.end) continue;
                const std::string label = std::to_string(e.element) + e.end;
                ExpectHinge(hinge, {{"V", V}}, 0.01, label);
                ExpectHinge(hinge, {{"LV", std::min(std::fabs(own) / V, longest)}}, 0.02, label);
            }
        }
    }
    ExpectHolds(r.dump(), {"end I: the push has V = ", "pushed the other way this end has more"});
    EXPECT_EQ(std::string::npos, Done("hinge check g.json").find("generated"));
    (void)ExpectRefused("hinge generate @rc-frame-code-hinges --all --code ASCE41-17 --push NO"
                        " -o no.json",
                        3, "there is no pushover load case NO");
}
