// The push against itself: the frame mirrored, sorted otherwise, in other units; the push in
// halves.
#include "pushcase.h"

#include <array>
#include <functional>
#include <map>

namespace {

class PushAgain : public CPushTest {};

/// Applies a change to the six components of every load at a node.
void EachNodalLoad(json& file, const std::function<void(json& six)>& change)
{
    for (json& loadCase : file["load_cases"])
        if (loadCase.contains("nodal"))
            for (json& load : loadCase["nodal"])
                change(load["load"]);
}

/// Mirrored at the plane X = 0: tension stays on the side of local z, which is mirrored too.
json Mirrored(json file)
{
    for (json& node : file["nodes"])
        node["xyz"][0] = -node["xyz"][0].get<double>();
    for (json& element : file["elements"]) {
        json ends[2];
        for (const json& node : file["nodes"])
            for (const std::size_t e : {0U, 1U})
                if (node["id"] == element["nodes"][e]) ends[e] = node["xyz"];
        if (ends[0][0] == ends[1][0]) element["z_axis"] = {-1, 0, 0}; // a column
    }
    EachNodalLoad(file, [](json& six) { // a force along X, moments about Y and Z turn
        for (const std::size_t k : {0U, 4U, 5U})
            six[k] = -six[k].get<double>();
    });
    json& target = file["pushover"][0]["control"]["master_max_displ"];
    target = -target.get<double>();
    return file;
}

void ExpectMirrored(const json& a, const json& b, double share)
{
    const double peak = 3.0, furthest = 0.6;
    T_VERTICES mirrored = Found(b.at("events"));
    for (T_VERTEX& v : mirrored)
        v.displacement = -v.displacement;
    ExpectVertices(Found(a.at("events")), mirrored, share * peak, share * furthest, 1e-9);
    for (std::size_t i = 0; i < a["load_factor"].size(); ++i)
        EXPECT_NEAR(a["load_factor"][i], b["load_factor"][i], share * peak) << i;
}

TEST_F(PushAgain, OfTheMirroredFrameIsMirrored)
{
    const json file = Data("f3s2b_cap_mode1");
    ExpectMirrored(Pushed(file), Pushed(Mirrored(file)), 1e-11);
}

TEST_F(PushAgain, DoesNotDependOnTheOrderOfNodesAndElements)
{
    const json file = Data("f3s2b_cap_mode1");
    json turned = file;
    for (const char* table : {"nodes", "elements", "hinges"})
        std::reverse(turned[table].begin(), turned[table].end());
    const json a = Pushed(file), b = Pushed(turned);
    ExpectVertices(Found(a["events"]), Found(b["events"]), 1e-12 * 3.0, 1e-12 * 0.6, 1e-9);
    for (std::size_t i = 0; i < a["load_factor"].size(); ++i)
        EXPECT_NEAR(a["load_factor"][i], b["load_factor"][i], 1e-12 * 3.0) << i;
}

TEST_F(PushAgain, InTwoHalvesIsTheWhole)
{
    for (const char* name : {"pc_two_storey", "f3s2b_cap_uniform"}) {
        const json file = Data(name);
        const double target = file["pushover"][0]["control"]["master_max_displ"];
        json halves = file;
        halves["pushover"][0]["name"] = "first";
        halves["pushover"][0]["control"]["master_max_displ"] = target / 2.0;
        halves["pushover"].push_back(file["pushover"][0]);
        halves["pushover"][1]["initial_case"] = "first";
        const json whole = Pushed(file), second = Pushed(halves);
        const auto later = [&](const json& push) {
            T_VERTICES out = Found(push.at("events"));
            std::erase_if(out, [&](const T_VERTEX& v) {
                return v.stage != "push" || v.displacement < target / 2.0;
            });
            return out;
        };
        // The second half starts with its load factor at 0 on top of the first one's loads; the sum
        // is that of the whole.
        const double base = whole.at("base_reaction").back(), half = second["base_reaction"].back();
        EXPECT_NEAR(base, half, 1e-9 * std::fabs(base)) << name;
        T_VERTICES a = later(whole), b = later(second);
        ASSERT_EQ(a.size(), b.size()) << name;
        EXPECT_LE(1U, a.size()) << name;
        for (std::size_t i = 0; i < a.size(); ++i) {
            EXPECT_EQ(a[i].hinge, b[i].hinge) << name;
            EXPECT_NEAR(a[i].displacement, b[i].displacement, 1e-9 * target) << name;
        }
    }
}

/// Powers of force and length of the members that a frame of the tests has.
const std::map<std::string, std::array<int, 2>> kDimensions = {{"xyz", {0, 1}},
                                                               {"mass", {1, -1}},
                                                               {"height", {0, 1}},
                                                               {"E", {1, -2}},
                                                               {"A", {0, 2}},
                                                               {"J", {0, 4}},
                                                               {"Iy", {0, 4}},
                                                               {"Iz", {0, 4}},
                                                               {"w", {1, -1}},
                                                               {"yield", {1, 1}},
                                                               {"user_stiffness", {1, 1}},
                                                               {"master_max_displ", {0, 1}},
                                                               {"gravity", {0, 1}}};

/// In other units; loads of nodes are three forces and three moments.
void Convert(json& value, double force, double length)
{
    if (!value.is_structured()) return;
    for (auto it = value.begin(); it != value.end(); ++it) {
        const std::string key = value.is_object() ? it.key() : "";
        const auto dim = kDimensions.find(key);
        const auto scaled = [&](double v, int f, int l) {
            return v * std::pow(force, f) * std::pow(length, l);
        };
        if (key == "load") {
            for (std::size_t k = 0; k < 6; ++k)
                (*it)[k] = scaled((*it)[k], 1, k < 3 ? 0 : 1);
        } else if (dim == kDimensions.end() || it->is_object()) {
            Convert(*it, force, length);
        } else if (it->is_array()) {
            for (json& v : *it)
                v = scaled(v, dim->second[0], dim->second[1]);
        } else {
            *it = scaled(*it, dim->second[0], dim->second[1]);
        }
    }
}

TEST_F(PushAgain, IsTheSameInOtherUnits)
{
    constexpr double kKips = 1.0 / 4.4482216152605, kInch = 1.0 / 0.0254; // of a kN, of a metre
    const json file = Data("f3s2b_cap_uniform");
    json other = file;
    Convert(other, kKips, kInch);
    other["units"] = {{"force", "kips"}, {"length", "in"}};
    const json a = Pushed(file), b = Pushed(other);
    T_VERTICES back = Found(b["events"]);
    for (T_VERTEX& v : back)
        v.displacement /= kInch;
    ExpectVertices(Found(a["events"]), back, 1e-10, 1e-10, 1e-8);
    const double base = a["base_reaction"].back();
    EXPECT_NEAR(base, b["base_reaction"].back().get<double>() / kKips, 1e-9 * std::fabs(base));
}

/// The forces of these frames are masses times the first mode, 1 at the control node, of another
/// eigenvalue solution.
TEST_F(PushAgain, ByAModeOfTheModelIsThatByItsForces)
{
    for (const char* name : {"f3s2b_rigid_mode1", "f3s2b_cap_mode1", "f9s5b_mode1"}) {
        const json file = Data(name);
        json byMode = file;
        const json row = {{"kind", "mode x story mass"}, {"number", 1}, {"factor", 1}};
        byMode["pushover"][0]["patterns"] = json::array({row});
        byMode["pushover"][0]["pattern"] = {{"kind", "mode x story mass"}, {"modes", {1}}};
        const json a = Pushed(file), b = Pushed(byMode);
        const double base = a["base_reaction"][0];
        ASSERT_EQ(a["base_reaction"].size(), b["base_reaction"].size()) << name;
        for (std::size_t i = 0; i < a["base_reaction"].size(); ++i)
            EXPECT_NEAR(a["base_reaction"][i], b["base_reaction"][i], 1e-9 * base) << name;
        EXPECT_EQ(Found(a["events"]).size(), Found(b["events"]).size()) << name;
    }
}

/// Area under a backbone of deformations and forces from 0 on, level beyond its end.
double Area(const std::vector<std::array<double, 2>>& backbone, double deformation)
{
    double area = 0.0;
    std::array<double, 2> last = backbone.front();
    for (const auto& point : backbone) {
        const double end = std::min(point[0], deformation);
        if (end <= last[0]) continue;
        const double share = (end - last[0]) / (point[0] - last[0]);
        const double force = last[1] + share * (point[1] - last[1]);
        area += 0.5 * (last[1] + force) * (end - last[0]);
        last = point;
    }
    return area + std::max(0.0, deformation - last[0]) * last[1];
}

/// Work is a sum of trapezia over the vertices of the path, between which all is straight. The
/// hinges dissipate what lies under their backbones; the rest is elastic: half of loads times
/// displacements less half of hinge forces times plastic deformations.
TEST_F(PushAgain, WorkOfTheLoadsIsElasticEnergyAndDissipation)
{
    json file = Data("bb_two_storey_unloading");
    json at = json::array(); // steps at the vertices
    for (const T_VERTEX& v : Found(Pushed(file)["events"]))
        if (at.empty() || v.displacement > at.back()) at.push_back(v.displacement);
    file["pushover"][0]["additional_displacements"] = at;
    const json push = Pushed(file, " --nodes 3,5");
    EXPECT_EQ(at.size(), push["additional"].size());

    double work = 0.0, before = 0.0, movedBefore = 0.0, dissipated = 0.0;
    for (std::size_t s = 0; s < push["load_factor"].size(); ++s) {
        // The pattern is 1 at node 5 and 0.2 at node 3.
        const json& nodes = push["nodes"];
        const double moved = nodes["5"][s][0].get<double>() + 0.2 * nodes["3"][s][0].get<double>();
        const double factor = push["load_factor"][s];
        work += 0.5 * (before + factor) * (moved - movedBefore);
        before = factor;
        movedBefore = moved;
        double elastic = 0.5 * factor * moved;
        dissipated = 0.0;
        for (const json& h : push["hinges"]) {
            const double turned = h["deformation"][s];
            elastic -= 0.5 * h["force"][s].get<double>() * turned;
            dissipated += h["element"] <= 2
                              ? Area({{0, 270}, {0.01, 285}, {0.03, 90}}, std::fabs(turned))
                              : Area({{0, 180}, {0.02, 240}}, std::fabs(turned));
        }
        EXPECT_NEAR(work, elastic + dissipated, 1e-9 * work) << s;
    }
    EXPECT_LT(0.5 * work, dissipated);
}

} // namespace
