// The push of frames with plastic hinges against the exact paths of an independent calculation
// (tests/data/push).
#include "pushcase.h"

#include <array>
#include <fstream>
#include <limits>
#include <map>
#include <set>
#include <sstream>

namespace {

using T_POINTS = std::vector<std::array<double, 2>>; // displacement, load factor, over the largest

/// Distance of a point from a chain of lines.
double Distance(const std::array<double, 2>& p, const T_POINTS& chain)
{
    double least = std::numeric_limits<double>::infinity();
    for (std::size_t i = 0; i + 1 < chain.size(); ++i) {
        const double dx = chain[i + 1][0] - chain[i][0], dy = chain[i + 1][1] - chain[i][1];
        const double px = p[0] - chain[i][0], py = p[1] - chain[i][1];
        const double length2 = dx * dx + dy * dy;
        const double t = length2 > 0.0 ? std::clamp((px * dx + py * dy) / length2, 0.0, 1.0) : 0.0;
        least = std::min(least, std::hypot(px - t * dx, py - t * dy));
    }
    return least;
}

/// Pairs of load factor and displacement.
T_POINTS Chain(const json& pairs, double peak, double furthest)
{
    T_POINTS out;
    for (const json& p : pairs)
        out.push_back({p[1].get<double>() / furthest, p[0].get<double>() / peak});
    return out;
}
T_POINTS Steps(const json& push, double peak, double furthest)
{
    T_POINTS out;
    for (std::size_t i = 0; i < push.at("load_factor").size(); ++i)
        out.push_back({push["displacement"][i].get<double>() / furthest,
                       push["load_factor"][i].get<double>() / peak});
    return out;
}

double Furthest(const json& expected)
{
    return std::fabs(expected.at("last")[1].get<double>());
}

/// Six displacements by node at the end: translations and rotations to a share of their largest.
void ExpectDisplacements(const json& expected, const json& nodes, double share)
{
    double largest[2] = {};
    for (const json& six : expected)
        for (std::size_t k = 0; k < 6; ++k)
            largest[k / 3] = std::max(largest[k / 3], std::fabs(six[k].get<double>()));
    for (const auto& [id, six] : expected.items())
        for (std::size_t k = 0; k < 6; ++k)
            EXPECT_NEAR(six[k].get<double>(), nodes.at(id).back()[k].get<double>(),
                        share * largest[k / 3])
                << "node " << id << " direction " << k;
}

/// Deformation and force at the end, {"3I My": [deformation, force]}.
void ExpectHinges(const json& expected, const json& hinges, double share)
{
    double largest[2] = {};
    for (const json& pair : expected)
        for (std::size_t k = 0; k < 2; ++k)
            largest[k] = std::max(largest[k], std::fabs(pair[k].get<double>()));
    std::map<std::string, const json*> byName;
    for (const json& h : hinges) {
        std::string name = HingeName(h);
        byName[name.erase(name.find(' '), 1)] = &h;
    }
    for (const auto& [name, pair] : expected.items()) {
        ASSERT_TRUE(byName.contains(name)) << name;
        const json& h = *byName[name];
        EXPECT_NEAR(pair[0].get<double>(), h.at("deformation").back().get<double>(),
                    share * largest[0])
            << name;
        EXPECT_NEAR(pair[1].get<double>(), h.at("force").back().get<double>(), share * largest[1])
            << name;
    }
}

/// "1,2,5": what --nodes takes.
std::string NodeList(const json& byNode)
{
    std::string out;
    for (const auto& [id, unused] : byNode.items())
        out += (out.empty() ? "" : ",") + id;
    return out;
}

// ---- exact paths --------------------------------------------------------------------------------

/// How closely a path must follow, as shares of the largest value of their kind.
struct T_CLOSE {
    double events, steps, peak;
    bool inOrder = true; // the events; else the same ones in any order
};
/// Without P-Delta the path is piecewise linear and both are exact; the tables have ten digits.
constexpr T_CLOSE kExact{1e-9, 1e-9, 1e-9};
/// The axial forces of the day, as in the independent calculation.
constexpr T_CLOSE kUpdated{1e-6, 1e-6, 1e-6};
/// Those of the initial loads instead: what is left out by the day's changes of axial force. They
/// move the peak by 3e-5 at most, late points and events by more, and may exchange two events.
constexpr T_CLOSE kInitial{1.0, 5e-4, 1e-4, false};

struct T_PATH {
    const char* name;
    const char* pDelta; // "" as in the file
    T_CLOSE close;
    double recorded = 0.0; // the finite-element program, of the peak; 0: has no curve
};
std::string PrintToString(const T_PATH& row)
{
    return std::string(row.name) + " " + row.pDelta;
}

// clang-format off
const T_PATH kPaths[] = {
    {"pc_propped_point",            "", kExact},
    {"pc_clamped_udl",              "", kExact},
    {"pc_portal_combined",          "", kExact},
    {"pc_two_storey",               "", kExact},
    {"bb_cantilever_abcde",         "", kExact},
    {"bb_cantilever_snapback",      "", kExact},
    {"bb_cantilever_unsym_plus",    "", kExact},
    {"bb_two_storey_unloading",     "", kExact},
    {"gr_two_storey_gravity_yield", "", kExact},
    {"pm_portal_linear",            "", kExact},
    {"pm_portal_concrete",          "", kExact},
    {"f3s2b_rigid_mode1",           "", kExact, 4e-4}, // springs of 1e4 EI/L there
    {"f3s2b_hard_uniform",          "", kExact, 1e-9},
    {"f3s2b_trilinear_uniform",     "", kExact, 1.5e-7},
    {"f3d_hard_x",                  "", kExact, 1e-6},
    {"pd_cantilever",        "initial", kExact}, // its axial force never changes
    {"pd_cantilever",        "updated", kExact},
    {"pd_portal_leaning",    "initial", kExact}, // the frame's axial forces make no couple here
    {"pd_two_storey",        "initial", kUpdated},
    {"pd_two_storey",        "updated", kUpdated},
    {"f3s2b_cap_mode1",      "initial", kInitial, 1e-4},
    {"f3s2b_cap_mode1",      "updated", kUpdated, 4e-5},
    {"f3s2b_cap_uniform",    "initial", kInitial, 1e-4},
    {"f3s2b_cap_uniform",    "updated", kUpdated, 1e-5},
    {"f9s5b_mode1",          "initial", kInitial, 5e-4},
    {"f9s5b_mode1",          "updated", kUpdated, 1e-5},
    {"f3d_cap_x",            "initial", kInitial, 1e-4},
    {"f3d_cap_x",            "updated", kUpdated, 4e-6},
    {"f3d_cap_mode",         "initial", kInitial, 1e-4},
    {"f3d_cap_mode",         "updated", kUpdated, 8e-5},
};
// clang-format on

class PushPath : public CPushTest, public testing::WithParamInterface<T_PATH> {};

/// Every step lies on the path, and the points of the other program lie on ours.
void ExpectOnPath(const json& push, const json& expected, const T_PATH& row)
{
    const double peak = expected.at("peak"), furthest = Furthest(expected);
    const T_POINTS path = Chain(expected.at("path"), peak, furthest);
    T_POINTS ours = Steps(push, peak, furthest);
    for (const auto& p : ours)
        EXPECT_GE(row.close.steps, Distance(p, path)) << p[0] * furthest << ", " << p[1] * peak;
    for (const T_VERTEX& v : Found(push["events"]))
        if (v.stage == "push") ours.push_back({v.displacement / furthest, v.loadFactor / peak});
    ours.push_back(path.front());
    std::ranges::stable_sort(ours, {}, [](const auto& p) { return p[0]; });
    for (const auto& p : Chain(expected.value("recorded", json::array()), peak, furthest))
        EXPECT_GE(row.recorded, Distance(p, ours)) << p[0] * furthest << ", " << p[1] * peak;
}

TEST_P(PushPath, IsThatOfTheIndependentCalculation)
{
    const T_PATH& row = GetParam();
    json file = Data(row.name);
    const json expected = Data(row.name + std::string(".expected"));
    if (*row.pDelta) file["pushover_control"]["p_delta"] = row.pDelta;
    const json final = expected.value("final", json::object());
    const json push = Pushed(file, final.empty() ? "" : " --nodes " + NodeList(final));

    const double peak = expected.at("peak"), furthest = Furthest(expected);
    T_VERTICES wanted = Expected(expected.at("events")), found = Found(push.at("events"));
    double highest = push["load_factor"].back();
    for (const T_VERTEX& v : found)
        if (v.stage == "push") highest = std::max(highest, v.loadFactor);
    EXPECT_NEAR(peak, highest, row.close.peak * peak);
    EXPECT_EQ(file["pushover"][0]["steps"], push.at("load_factor").size());
    ExpectOnPath(push, expected, row);
    const double width = row.close.inOrder ? 1e-6 * peak : std::numeric_limits<double>::infinity();
    ExpectVertices(wanted, found, row.close.events * peak, row.close.events * furthest, width);
    EXPECT_NEAR(expected["last"][0], push["load_factor"].back(), row.close.steps * peak);
    EXPECT_NEAR(expected["last"][1], push["displacement"].back(), 1e-9 * furthest);
    const double ends = row.close.inOrder ? row.close.events : 2.0 * row.close.steps;
    ExpectDisplacements(final, push.value("nodes", json::object()), ends);
    ExpectHinges(expected.value("hinges", json::object()), push.at("hinges"), ends);
}

INSTANTIATE_TEST_SUITE_P(Frames, PushPath, testing::ValuesIn(kPaths), [](const auto& test) {
    return std::string(test.param.name) + (*test.param.pDelta ? "_" : "") + test.param.pDelta;
});

// ---- load control -------------------------------------------------------------------------------

class PushByLoad : public CPushTest, public testing::WithParamInterface<const char*> {};

/// Up to its peak the path does not depend on the control; there a push by load ends, with a hinge
/// that makes a mechanism, loses strength or leaves P-Delta too little.
TEST_P(PushByLoad, EndsAtThePeakWithTheSameEvents)
{
    json file = Data(GetParam());
    const json expected = Data(GetParam() + std::string(".expected"));
    const double peak = expected.at("peak"), beyond = 1.5 * peak; // of the pattern at load factor 1
    json& push = file["pushover"][0];
    push["patterns"][0]["factor"] = beyond;
    push["control"] = {{"increment_method", "force"}, {"master_node_control", true}};
    if (file.contains("pushover_control") && file["pushover_control"].contains("p_delta"))
        file["pushover_control"]["p_delta"] = "updated";
    Write("c.json", file.dump(1));
    const json run = Json("push c.json --all", 1).at(0);
    EXPECT_EQ("failed", run.at("status"));
    EXPECT_EQ("largest load reached", run.at("outcome").at("name"));

    T_VERTICES wanted = Expected(expected.at("events")), found = Found(run.at("events"));
    const auto top = std::ranges::find_if(wanted, [&](const T_VERTEX& v) {
        return v.stage == "push" && v.loadFactor > peak * (1.0 - 1e-6);
    });
    ASSERT_NE(wanted.end(), top);
    wanted.erase(top + 1, wanted.end());
    double highest = 0.0;
    for (T_VERTEX& v : found) {
        if (v.stage != "push") continue;
        v.loadFactor *= beyond;
        highest = std::max(highest, v.loadFactor);
    }
    for (const json& factor : run["load_factor"])
        highest = std::max(highest, factor.get<double>() * beyond);
    EXPECT_NEAR(peak, highest, 1e-6 * peak);
    SortTies(wanted, 1e-6 * peak);
    SortTies(found, 1e-6 * peak);
    ASSERT_LE(wanted.size(), found.size());
    for (std::size_t i = 0; i < wanted.size(); ++i)
        EXPECT_NEAR(wanted[i].loadFactor, found[i].loadFactor, 1e-6 * peak) << wanted[i].hinge;
    for (const T_VERTEX& v : found)
        EXPECT_GE(1.5 * Furthest(expected), std::fabs(v.displacement)) << v.hinge;
}

INSTANTIATE_TEST_SUITE_P(Frames, PushByLoad,
                         testing::Values("pc_propped_point", "pc_portal_combined", "pc_two_storey",
                                         "gr_two_storey_gravity_yield", "pm_portal_linear",
                                         "pm_portal_concrete", "bb_cantilever_abcde",
                                         "pd_two_storey", "f3s2b_cap_uniform"),
                         [](const auto& test) { return std::string(test.param); });

// ---- a frame of the examples against its recorded curve -----------------------------------------

/// Columns 1 (load factor) and 4 (control displacement) of a recorder table, row by row.
std::vector<std::array<double, 2>> Recorded(const std::string& path)
{
    std::ifstream in(ProjectFolder() / "examples" / path);
    std::vector<std::array<double, 2>> rows;
    for (std::string line; std::getline(in, line);) {
        std::istringstream cells(line);
        double loadFactor = 0.0, other = 0.0, displacement = 0.0;
        if (cells >> loadFactor >> other >> other >> displacement)
            rows.push_back({loadFactor, displacement});
    }
    return rows;
}

using PushExample = CPushTest;

TEST_F(PushExample, SteelFrameFollowsItsRecordedCurveThroughTheLossOfStrength)
{
    const json push = Json("push @steel-frame-2-storey --case PX_HINGES").at(0);
    const auto rows = Recorded("steel-frame-2-storey/recorders/mode1/disp_floors.out");
    ASSERT_EQ(649U, rows.size()); // the state before the push first, then steps of 0.05 in
    ASSERT_EQ(108U, push.at("load_factor").size());
    for (std::size_t step = 0; step < 108; ++step) {
        const auto& row = rows[6 * (step + 1)];
        EXPECT_NEAR(row[1], push["displacement"][step], 1e-6) << step;
        EXPECT_NEAR(row[0], push["load_factor"][step], 1e-5 * 143.2) << step; // of its peak
    }
}

// By virtual work (README of the example): feet, girders of the first floor, heads of the second
// storey; 1225 kN with P-Delta. Strengths are automatic, those of the columns follow N.
TEST_F(PushExample, SpaceFrameComesToTheMechanismByHand)
{
    const json push = Json("push @space-frame-3d --case PX").at(0);
    double peak = 0.0;
    for (const json& v : push.at("base_reaction"))
        peak = std::max(peak, v.get<double>());
    EXPECT_NEAR(1225.0, peak, 0.03 * 1225.0);
    std::set<std::string> flowed;
    for (const json& h : push.at("hinges"))
        if (h.at("state").back() != "elastic") flowed.insert(HingeName(h));
    for (int column = 1; column <= 9; ++column)
        EXPECT_TRUE(flowed.contains(std::to_string(column) + " I My")) << column;
    for (int girder = 10; girder <= 15; ++girder)
        for (const char* end : {" I My", " J My"})
            EXPECT_TRUE(flowed.contains(std::to_string(girder) + end)) << girder << end;
    for (int column = 22; column <= 30; ++column)
        EXPECT_TRUE(flowed.contains(std::to_string(column) + " J My")) << column;
}

} // namespace
