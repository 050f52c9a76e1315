// Load patterns as loads of the engine, by hand.
#include "qm_rps/push/loadalgebra.h"
#include "qm_rps/push/pushcases.h"

#include <gtest/gtest.h>

#include <cmath>

namespace {

/// Two storeys of 3 m on one line: 30 kg of steel each, 2 and 1 kg at the nodes; the base is held.
T_MODEL Tower()
{
    T_MODEL m;
    m.nodes[1] = {1, {0, 0, 0}, {5, 5, 5}, {1, 1, 1, 1, 1, 1}};
    m.nodes[2] = {2, {0, 0, 3}, {2, 0, 0}};
    m.nodes[3] = {3, {0, 0, 6}, {1, 0, 0}};
    m.materials[1].E = 2e11, m.materials[1].density = 1000;
    T_SECT_D& s = m.sections[1];
    s.area = 0.01, s.J = s.Iyy = s.Izz = 1e-5;
    m.elements[1] = {1, 1, 2, 1, 1};
    m.elements[2] = {2, 2, 3, 1, 1};
    m.storeys[1] = {"S1", 3, {2}};
    m.storeys[2] = {"S2", 3, {3}};
    m.modes[1].shape = {{2, {0.4, 0, 0.1}}, {3, {1, 0, 0}}};
    m.loadCases[1].name = "W";
    m.loadCases[1].nodal = {{3, {7, 0, 0, 0, 0, 0}}};
    m.loadCases[2].name = "nothing";
    m.loadCases[3].nodal = {{3, {0, 0, 0, 0, 4, 0}}};
    return m;
}

/// A floor of 10 by 6 m, a mass of 1 at each corner.
T_MODEL Floor()
{
    T_MODEL m;
    int id = 0;
    for (const auto& [x, y] : {std::pair{0, 0}, {10, 0}, {10, 6}, {0, 6}}) {
        ++id;
        m.nodes[id] = {id, {1.0 * x, 1.0 * y, 3}, {1, 1, 0}};
        m.storeys[1].nodes.push_back(id);
    }
    m.storeys[1].height = 3;
    return m;
}

std::vector<solver::T_VEC6> NoShape(int mode, std::string& error)
{
    error = "no mode " + std::to_string(mode);
    return {};
}

T_POLC_D Case(std::vector<T_POLC_PATTERN> rows)
{
    T_POLC_D c;
    c.name = "P";
    c.controlNode = 3;
    c.patterns = std::move(rows);
    return c;
}

/// The loads of a case by node; or what is wrong with it.
std::vector<solver::T_VEC3> Forces(const T_MODEL& model, const T_POLC_D& record, std::string& error)
{
    CAnalysisModel frame(model);
    T_ANALYSIS_ERROR fault;
    EXPECT_EQ(1, frame.BuildFrame(fault)) << fault.text;
    solver::T_LOAD_CASE loads;
    if (!BuildPattern(model, frame, record, NoShape, loads, error)) return {};
    return NodeForces(loads, frame.Frame());
}

} // namespace

TEST(PushPatterns, RowsAddUpTimesTheirFactors)
{
    const struct {
        const char* label;
        std::vector<T_POLC_PATTERN> rows;
        double x2, x3, z2; // node 2 and 3
    } cases[] = {
        {"static", {{0, 1, 3}}, 0, 21, 0},
        {"acceleration", {{1, 1, 2}}, 64, 32, 0},  // 2 + 30 and 1 + 15 kg
        {"mode", {{2, 1, 10}}, 128, 160, 30},      // 10 times mass times shape
        {"mode x mass", {{3, 1, 1}}, 12.8, 16, 3}, // 30 kg move along Z
        {"two", {{0, 1, 1}, {1, 1, 0.5}}, 16, 15, 0},
    };
    for (const auto& c : cases) {
        std::string error;
        const auto forces = Forces(Tower(), Case(c.rows), error);
        ASSERT_EQ(3u, forces.size()) << c.label << error;
        EXPECT_NEAR(c.x2, forces[1][0], 1e-12) << c.label;
        EXPECT_NEAR(c.x3, forces[2][0], 1e-12) << c.label;
        EXPECT_NEAR(c.z2, forces[1][2], 1e-12) << c.label;
        EXPECT_EQ(0.0, forces[0][0]) << c.label; // the support keeps its mass
    }
}

TEST(PushPatterns, RefusesWhatHoldsNoForce)
{
    T_MODEL massless = Tower();
    massless.materials[1].density = 0;
    for (auto& [id, node] : massless.nodes)
        node.mass = {};
    T_POLC_D eccentric = Case({{0, 1, 1}});
    eccentric.eccentricity = 0.05; // one node to a storey
    const struct {
        T_MODEL model;
        T_POLC_D record;
        const char* text;
    } cases[] = {
        {Tower(), Case({}), "no load pattern"},
        {Tower(), Case({{0, 1, 1}, {0, 2, 1}}), "Row 2 of the load pattern: there is no force"},
        {Tower(), Case({{0, 1, 1}, {1, 1, 0}}), "Row 2 of the load pattern: there is no force"},
        {Tower(), Case({{0, 3, 1}, {0, 3, -1}}), "cancel each other"}, // moments
        {Tower(), Case({{0, 9, 1}}), "Row 1"},
        {Tower(), Case({{2, 4, 1}}), "no mode 4"},
        {massless, Case({{1, 1, 1}}), "no mass"},
        {massless, Case({{3, 1, 1}}), "no mass"},
        {Tower(), eccentric, "eccentricity has no effect"},
    };
    for (const auto& c : cases) {
        std::string error;
        EXPECT_TRUE(Forces(c.model, c.record, error).empty());
        EXPECT_NE(std::string::npos, error.find(c.text)) << error;
    }
}

// 4 N along X at 5 % of 6 m: moved towards +Y they turn by -1.2 Nm; each corner, 34 m2 from the
// centre, takes -1.2 / (4 * 34) times its distance.
TEST(PushPatterns, EccentricityIsATorqueAboutTheCentreOfMass)
{
    T_POLC_D record = Case({{1, 1, 1}});
    record.eccentricity = 0.05;
    std::string error;
    auto forces = Forces(Floor(), record, error);
    ASSERT_EQ(4u, forces.size()) << error;
    const double turn = -1.2 / 136;
    EXPECT_NEAR(1 + 3 * turn, forces[0][0], 1e-14); // at (-5, -3) from the centre
    EXPECT_NEAR(-5 * turn, forces[0][1], 1e-14);
    EXPECT_NEAR(1 - 3 * turn, forces[2][0], 1e-14);
    // Along Y towards +X: 4 N at 0.5 m turn by +2.
    record.patterns[0].number = record.direction = 2;
    forces = Forces(Floor(), record, error);
    EXPECT_NEAR(1 + 5 * 2.0 / 136, forces[1][1], 1e-14);
}

TEST(PushPatterns, TurningMovesWhatIsLateral)
{
    const T_MODEL model = Tower();
    CAnalysisModel frame(model);
    T_ANALYSIS_ERROR fault;
    ASSERT_EQ(1, frame.BuildFrame(fault));
    solver::T_LOAD_CASE loads;
    loads.nodal = {{2, {3, 0, -4, 0, 5, 0}}};
    // Local y of a column is -Y (z along X): 2 N/m turn to +X.
    loads.beam = {{1, solver::BEAM_LOAD::Distributed, true, 1, {2, 2}}};
    const auto turned = TurnedAboutZ(loads, frame.Frame(), 90);
    EXPECT_EQ((solver::T_VEC6{0, 3, -4, -5, 0, 0}), turned.nodal[0].load);
    const auto forces = NodeForces(turned, frame.Frame());
    EXPECT_NEAR(3, forces[1][0], 1e-12);
    EXPECT_EQ((solver::T_VEC3{3, 3, -4}), forces[2]);
    EXPECT_NEAR(3 * std::sqrt(0.5), TurnedAboutZ(loads, frame.Frame(), 45).nodal[0].load[1], 1e-12);
}

TEST(PushCases, StagesFollowRecordAndControl)
{
    T_MODEL model = Tower();
    T_POLC_D first = Case({{0, 1, 1}}), second = first;
    first.name = "G";
    first.control = T_POLC_CONTROL{.incrementMethod = 2};
    second.control = T_POLC_CONTROL{.masterMaxDispl = -0.2};
    second.initialCase = "G";
    second.control->incrementOption = 2, second.control->incrementFunction = 1;
    second.stops.state = PUSH_STATE_STOP::CP, second.onFailure = PUSH_FAILURE::Stop;
    model.incrementFunctions[1] = {"F", {2, 3}, {0.4, 0.5}};
    model.pushControl.steps = 4;
    model.pushovers = {{1, second}, {2, first}};
    CAnalysisModel frame(model);
    T_ANALYSIS_ERROR fault;
    ASSERT_EQ(1, frame.BuildFrame(fault));
    std::vector<int> chain;
    std::vector<T_PUSH_CASE> cases;
    std::string error;
    ASSERT_EQ(1, PushChainOf(model, 1, chain, error)) << error;
    EXPECT_EQ((std::vector<int>{2, 1}), chain);
    ASSERT_EQ(1, BuildPushCases(model, frame, chain, NoShape, cases, error)) << error;
    ASSERT_EQ(1u, cases.size());
    const auto& stages = cases[0].stages;
    EXPECT_EQ(solver::PUSH_CONTROL::LoadFactor, stages[0].control);
    EXPECT_EQ(1.0, stages[0].target);
    EXPECT_EQ((std::vector<double>{0.25, 0.5, 0.75, 1}), stages[0].steps);
    // Steps 1, 2 and 3 of the function are 0.2, 0.4 and 0.5 of -0.2.
    EXPECT_EQ(-0.1, stages[1].target);
    ASSERT_EQ(3u, stages[1].steps.size());
    EXPECT_NEAR(0.4, stages[1].steps[0], 1e-15);
    EXPECT_NEAR(0.8, stages[1].steps[1], 1e-15);
    EXPECT_EQ(2, stages[1].stops.mark);
    EXPECT_TRUE(stages[1].stops.strengthLoss);

    model.pushovers[2].control->generateStaticAngle = true;
    model.pushovers[2].control->staticAngle = 90;
    ASSERT_EQ(1, BuildPushCases(model, frame, {2}, NoShape, cases, error)) << error;
    ASSERT_EQ(3u, cases.size());
    EXPECT_EQ("G@180", cases[1].name);
    EXPECT_EQ((solver::T_VEC3{0, -1, 0}), cases[2].along);
    EXPECT_EQ(1, cases[2].stages[0].direction);
    EXPECT_EQ(-7, cases[2].stages[0].loads.nodal[0].load[1]);
    model.pushovers[2].initialCase = "P";
    EXPECT_EQ(0, PushChainOf(model, 1, chain, error));
    model.pushovers[1].controlNode = 1;
    EXPECT_EQ(0, BuildPushCases(model, frame, {1}, NoShape, cases, error));
    EXPECT_NE(std::string::npos, error.find("control node 1 is restrained")) << error;
}
