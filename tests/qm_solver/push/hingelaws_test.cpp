// Hinge laws on structures of one or two members, against forces worked out by hand.
#include "pushframes.h"

#include <gtest/gtest.h>

#include <algorithm>

#include <cmath>

namespace {

using namespace sample;

/// A bar along X with axial stiffness 1000, node 1 free along X; its law in plastic deformations.
T_PUSH_MODEL Bar(T_HINGE_SIDE positive, T_HINGE_SIDE negative, double spring = 0.0)
{
    T_PUSH_MODEL model;
    model.frame = Empty();
    AddNode(model.frame, {0, 0, 0});
    AddNode(model.frame, {2, 0, 0});
    Fix(model.frame, 0, {0, 1, 2, 3, 4, 5});
    Fix(model.frame, 1, {1, 2, 3, 4, 5});
    Join(model.frame, ELEMENT_KIND::Truss, 0, 1);
    model.frame.materials[0].E = 2000.0;
    model.frame.sections[0].A = 1.0;
    T_PUSH_HINGE hinge;
    hinge.laws.push_back({0, std::move(positive), std::move(negative), spring, {}});
    model.hinges.push_back(hinge);
    return model;
}

/// Forces of the first hinge at the ends of pushes to these displacements, one after the other.
std::vector<double> Forces(const T_PUSH_MODEL& model, std::span<const double> places)
{
    std::vector<T_PUSH_STAGE> stages;
    for (const double u : places)
        stages.push_back(PushTo(u));
    const T_PUSHED run = Pushed(model, stages);
    EXPECT_TRUE(run.done) << run.error.reason.key;
    EXPECT_EQ(run.end.outcome, PUSH_OUTCOME::Reached)
        << run.end.displacement << " stage " << run.end.stage;
    std::vector<double> forces;
    for (const T_PUSH_STEP& step : run.steps) {
        forces.push_back(step.hinges[0].force);
        EXPECT_LE(step.residual, 1e-10);
    }
    return forces;
}

struct T_LAW_CASE {
    const char* name;
    T_PUSH_MODEL model;
    std::vector<double> places, forces;
};

void ExpectForces(const T_LAW_CASE& c)
{
    SCOPED_TRACE(c.name);
    const std::vector<double> forces = Forces(c.model, c.places);
    ASSERT_EQ(forces.size(), c.forces.size());
    for (std::size_t k = 0; k < forces.size(); ++k)
        EXPECT_NEAR(forces[k], c.forces[k], 1e-9) << "at " << c.places[k];
}

TEST(PushLaws, FollowsEveryLawForwardsAndBack)
{
    const T_HINGE_SIDE ideal = Side({{0, 100}}), weak = Side({{0, 40}});
    T_HINGE_SIDE gap = ideal, slip = ideal, free;
    gap.gap = 0.02;
    slip.slips = true;
    free.free = true;
    const std::vector<T_BACKBONE_POINT> curve{{0, 100}, {0.1, 200}, {0.1, 50}, {0.2, 50}};
    const T_LAW_CASE cases[] = {
        // 1000 u up to 100, level, back elastically, other side from there: -40, and again 100
        {"unequal strengths",
         Bar(ideal, weak),
         {0.05, 0.3, 0.25, 0.1, 0.24, 0.4},
         {50, 100, 50, -40, 100, 100}},
        // hardening 1000: half of what is added after yield
        {"hardening", Bar(Side({{0, 100}, {1, 1100}}), ideal), {0.3, 0.2, 0.5}, {200, 100, 300}},
        // spring 1000 in series: 500 u to 100 at 0.2; the law's points hold the spring's part
        {"spring in series",
         Bar(Side({{0.1, 100}, {0.3, 200}}), Side({{0.1, 100}}), 1000.0),
         {0.1, 0.2, 0.5},
         {50, 100, 200}},
        // C at u = 0.3 (200 and 0.1), drop to 50 with u back to 0.15, then level
        {"drop", Bar(Side(curve), ideal), {0.3, 0.301, 0.26}, {200, 50, 9}},
        // no force from 0.2 down to 0.18, where the gap is as wide as at first
        {"gap", Bar(gap, ideal), {0.01, 0.03, 0.3, 0.21, 0.19, 0.17}, {0, 10, 100, 10, 0, -10}},
        // what has flowed is slipped through without force, to the origin and on to the other side
        {"slip", Bar(slip, ideal), {0.3, 0.2, 0.1, -0.05}, {100, 0, 0, -50}},
        {"no tension", Bar(free, ideal), {0.2, -0.05, 0.1}, {0, -50, 0}},
        // the line from (0.3, 100) to the origin, down and up; the other side from the origin
        {"origin",
         Bar(Side({{0, 100}}, UNLOADING::Origin), ideal),
         {0.3, 0.15, 0.24, 0.4, -0.03},
         {100, 50, 80, 100, -30}},
        // down the backbone: 100 + 500 (u - 0.1), then 1000 u
        {"nonlinear elastic",
         Bar(Side({{0, 100}, {1, 1100}}, UNLOADING::Backbone), ideal),
         {0.5, 0.3, 0.05, -0.02},
         {300, 200, 50, -20}},
    };
    for (const T_LAW_CASE& c : cases)
        ExpectForces(c);
}

/// The path has its corners where a gap closes and where a slip begins and ends.
TEST(PushLaws, TellsWhereAGapClosesAndASlipBegins)
{
    using TURN = HINGE_TURN;
    T_HINGE_SIDE gap = Side({{0, 100}}), slip = gap;
    gap.gap = 0.02;
    slip.slips = true;
    struct T_CASE {
        T_PUSH_MODEL model;
        std::vector<double> places, corners;
        std::vector<TURN> turns;
    };
    const T_CASE cases[] = {
        {Bar(gap, gap), {0.3}, {0.02, 0.12}, {TURN::Contact, TURN::Point}},
        {Bar(slip, slip),
         {0.3, -0.2},
         {0.1, 0.3, 0.2, 0.0, -0.1},
         {TURN::Point, TURN::Unload, TURN::Slip, TURN::Contact, TURN::Point}},
    };
    for (const T_CASE& c : cases) {
        std::vector<T_PUSH_STAGE> stages;
        for (const double u : c.places)
            stages.push_back(PushTo(u));
        const T_PUSHED run = Pushed(c.model, stages);
        ASSERT_EQ(run.events.size(), c.corners.size());
        for (std::size_t k = 0; k < c.corners.size(); ++k) {
            EXPECT_NEAR(run.events[k].displacement, c.corners[k], 1e-9);
            EXPECT_EQ(run.events[k].hinges[0].turn, c.turns[k]) << k;
        }
    }
}

TEST(PushLaws, BendsAboutBothAxesWithinOnePolygon)
{
    // Faces across the axes reach 3 degrees to both sides; four chords of 21 degrees lie between
    // their corners, on the circle of radius 100 / cos(3 degrees): 45 degrees is a corner, too.
    const double degree = std::acos(-1.0) / 180.0, corner = 100.0 / std::cos(3.0 * degree);
    for (const auto& [angle, moment] : {std::pair{45.0 * degree, corner},
                                        {0.0, 100.0},
                                        {13.5 * degree, corner * std::cos(10.5 * degree)}}) {
        T_PUSH_MODEL model = Column();
        T_PUSH_HINGE hinge;
        for (const int component : {4, 5})
            hinge.laws.push_back({component, Side({{0, 100}}), Side({{0, 100}}), 0.0, {}});
        hinge.biaxial = true;
        model.hinges.push_back(hinge);
        T_PUSH_STAGE stage = PushTo(3.0);
        stage.loads.nodal[0].load = {std::cos(angle), std::sin(angle), 0, 0, 0, 0};
        const T_PUSHED run = Pushed(model, {stage});
        ASSERT_TRUE(run.done) << run.error.reason.key;
        ASSERT_EQ(run.steps.size(), 1u);
        EXPECT_NEAR(2.0 * run.steps[0].loadFactor, moment, 1e-8) << angle;
    }
}

T_PUSH_MODEL BiaxialColumn(const T_HINGE_SIDE& side, bool biaxial)
{
    T_PUSH_MODEL model = Column();
    T_PUSH_HINGE hinge;
    for (const int component : {4, 5})
        hinge.laws.push_back(
            {component, side, side, 0.0, {{-200, 50, 50}, {0, 100, 100}, {200, 0, 0}}});
    hinge.biaxial = biaxial;
    model.hinges.push_back(hinge);
    return model;
}

/// C, drop, residual: about one axis the hinge is the one of that axis alone.
TEST(PushLaws, BiaxialHingeTurnsAboutOneAxisAsOneOfThatAxis)
{
    const T_HINGE_SIDE side = Side({{0, 100}, {0.1, 120}, {0.1, 40}, {0.3, 40}});
    for (const int direction : {0, 1})
        for (const double sign : {1.0, -1.0}) {
            T_PUSH_STAGE stage = PushTo(2.0 * sign, 1, direction);
            stage.loads.nodal[0].load[2] = -0.5 * sign;
            for (int k = 1; k <= 40; ++k)
                stage.steps.push_back(k / 40.0);
            const T_PUSHED both = Pushed(BiaxialColumn(side, true), {stage});
            const T_PUSHED one = Pushed(BiaxialColumn(side, false), {stage});
            ASSERT_EQ(both.steps.size(), 40u) << direction;
            ASSERT_EQ(one.steps.size(), 40u);
            for (std::size_t k = 0; k < 40; ++k)
                EXPECT_NEAR(both.steps[k].loadFactor, one.steps[k].loadFactor, 1e-8) << k;
            ASSERT_EQ(both.events.size(), one.events.size());
            for (std::size_t k = 0; k < one.events.size(); ++k)
                EXPECT_NEAR(both.events[k].displacement, one.events[k].displacement, 1e-9);
        }
}

/// Shares 1, 0.886, 0.85, 0.886, 1 in each quadrant at a compression of 200, the ellipse at a
/// tension of 200, their inverses straight between.
TEST(PushLaws, BiaxialHingeHasTheSurfaceThatIsGiven)
{
    const double degree = std::acos(-1.0) / 180.0, cos3 = std::cos(3.0 * degree);
    T_AXIAL_SHAPE low{-200.0, {}}, high{200.0, {}};
    for (std::size_t k = 0; k < kBiaxialCorners; ++k) {
        low.share[k] = std::array{1.0, 0.886, 0.85, 0.886, 1.0}[k % 5];
        high.share[k] = 1.0;
    }
    const auto inverse = [](double share, double axial) {
        const double part = (axial + 200.0) / 400.0;
        return (1.0 - part) / share + part;
    };
    struct T_CASE {
        double angle, initial, vertical; // vertical: part of the pushing loads
    };
    for (const T_CASE& c : {T_CASE{45.0, -100.0, 0.0},
                            {225.0, -100.0, 0.0},
                            {13.5, -100.0, 0.0},
                            {0.0, -100.0, 0.0},
                            {45.0, 0.0, 0.5},
                            {135.0, -40.0, -0.5},
                            {45.0, -40.0, -0.5}})
        for (const HINGE_FLOW flow : {HINGE_FLOW::Rotations, HINGE_FLOW::Associated}) {
            T_PUSH_MODEL model = BiaxialColumn(Side({{0, 100}}), true);
            model.hinges[0].shape = {low, high};
            model.hinges[0].flow = flow;
            model.initial.nodal = {{1, {0, 0, c.initial, 0, 0, 0}}};
            const double angle = c.angle * degree;
            T_PUSH_STAGE stage = PushTo(std::cos(angle) < 0.0 ? -3.0 : 3.0);
            stage.loads.nodal[0].load = {std::cos(angle), std::sin(angle), c.vertical, 0, 0, 0};
            const T_PUSHED run = Pushed(model, {stage});
            ASSERT_TRUE(run.done) << run.error.reason.key;
            const double axial = c.initial + c.vertical * run.end.loadFactor;
            const double strength = 100.0 - (axial > 0.0 ? 0.5 : -0.25) * axial;
            double over = inverse(0.85, axial) * cos3; // strength over moment
            if (c.angle == 0.0) over = 1.0;
            if (c.angle == 13.5) // on the chord between the corners at 3 and 24 degrees
                over = (1.0 + inverse(0.886, axial)) * cos3 / (2.0 * std::cos(10.5 * degree));
            EXPECT_NEAR(2.0 * run.end.loadFactor * over, strength, 1e-7) << c.angle;
        }
    T_PUSH_MODEL dented = BiaxialColumn(Side({{0, 100}}), true);
    low.share[2] = 0.8; // within the line between its neighbours, 0.886 cos 21 = 0.827
    dented.hinges[0].shape = {low, high};
    EXPECT_EQ(Pushed(dented, {PushTo(1.0)}).error.reason.key, "IDS_QM_ENGINE_HINGE_SHAPE");
}

/// Across both axes two faces flow alike; each takes its part of the whole rotation, so that C is
/// there at 0.1 / cos(10.5 degrees), half a chord away from both normals, and not at twice 0.1.
TEST(PushLaws, FacesOfABiaxialHingeShareItsRotation)
{
    T_PUSH_MODEL model = BiaxialColumn(Side({{0, 100}, {0.1, 120}, {0.1, 40}, {0.3, 40}}), true);
    for (T_HINGE_LAW& law : model.hinges[0].laws)
        law.byAxial.clear();
    T_PUSH_STAGE stage = PushTo(1.5);
    stage.loads.nodal[0].load = {1.0, 1.0, 0, 0, 0, 0};
    const double degree = std::acos(-1.0) / 180.0, rotation = 0.1 / std::cos(10.5 * degree);
    const T_PUSHED run = Pushed(model, {stage});
    ASSERT_TRUE(run.done);
    const auto peak = std::max_element(
        run.events.begin(), run.events.end(),
        [](const T_PUSH_EVENT& a, const T_PUSH_EVENT& b) { return a.loadFactor < b.loadFactor; });
    ASSERT_NE(peak, run.events.end());
    const double force = peak->loadFactor,
                 turned = 0.5 * (peak->displacement - force * 8.0 / 300.0);
    EXPECT_NEAR(force * 2.0 * std::sqrt(2.0), 120.0 / std::cos(3.0 * degree), 1e-7);
    EXPECT_NEAR(turned * std::sqrt(2.0), rotation, 1e-9);
}

TEST(PushLaws, StrengthFollowsTheAxialForce)
{
    // 100 at no axial force, 0 at 200 of tension or compression. Pushed by (1, 0.5): the moment is
    // 2 f, the compression of the column -0.5 f (a pull): 2 f = 100 - 0.25 f.
    T_PUSH_MODEL model = Column();
    T_PUSH_HINGE hinge;
    hinge.laws.push_back(
        {4, Side({{0, 100}}), Side({{0, 100}}), 0.0, {{-200, 0, 0}, {0, 100, 100}, {200, 0, 0}}});
    for (const HINGE_FLOW flow : {HINGE_FLOW::Rotations, HINGE_FLOW::Associated}) {
        hinge.flow = flow;
        model.hinges = {hinge};
        T_PUSH_STAGE stage = PushTo(3.0);
        stage.loads.nodal[0].load = {1.0, 0, 0.5, 0, 0, 0};
        const T_PUSHED run = Pushed(model, {stage});
        ASSERT_TRUE(run.done) << run.error.reason.key;
        EXPECT_NEAR(run.end.loadFactor, 100.0 / 2.25, 1e-8);
        // Flow in rotations leaves the column its elastic length; normal flow lengthens it by the
        // slope 100 / 200 of the line times the rotation.
        const double rotation = std::fabs(run.steps[0].hinges[0].deformation);
        const double stretch = run.steps[0].nodes[1][2] - 0.5 * run.end.loadFactor * 2.0 / 1e6;
        EXPECT_NEAR(stretch, flow == HINGE_FLOW::Associated ? 0.5 * rotation : 0.0, 1e-9);
        // Hardening, 50 a radian times the present strength over 100:
        model.hinges[0].laws[0].positive = model.hinges[0].laws[0].negative =
            Side({{0, 100}, {10, 600}});
        const T_PUSHED hard = Pushed(model, {stage});
        const double axial = 0.5 * hard.end.loadFactor;
        const double turned = std::fabs(hard.steps[0].hinges[0].deformation);
        EXPECT_NEAR(2.0 * hard.end.loadFactor, (1.0 - axial / 200.0) * (100.0 + 50.0 * turned),
                    1e-7);
    }
}

TEST(PushLaws, SpreadsPlasticityOverTheIntegrationPoints)
{
    // Gauss-Lobatto, three points: weights 1/6, 4/6, 1/6. Tip load P, moments 2 P, P, 0; strength
    // 30, hardening 20 of curvature: at P = 40 curvatures 2.5 and 0.5 beyond.
    T_PUSH_MODEL model = Column();
    const double weights[] = {1.0 / 6.0, 4.0 / 6.0, 1.0 / 6.0};
    for (std::size_t k = 0; k < 3; ++k) {
        T_PUSH_HINGE hinge;
        hinge.at = 0.5 * static_cast<double>(k);
        const double length = 2.0 * weights[k];
        const T_HINGE_SIDE side = Side({{0, 30}, {100.0 * length, 30 + 20 * 100.0}});
        hinge.laws.push_back({4, side, side, 0.0, {}});
        model.hinges.push_back(hinge);
    }
    const double turned[] = {2.5 / 3.0, 0.5 * 4.0 / 3.0};
    const double tip = 40.0 * 8.0 / 300.0 + turned[0] * 2.0 + turned[1] * 1.0;
    const T_PUSHED run = Pushed(model, {PushTo(tip)});
    ASSERT_TRUE(run.done) << run.error.reason.key;
    EXPECT_NEAR(run.end.loadFactor, 40.0, 1e-9);
    EXPECT_NEAR(std::fabs(run.steps[0].hinges[0].deformation), turned[0], 1e-10);
    EXPECT_NEAR(std::fabs(run.steps[0].hinges[1].deformation), turned[1], 1e-10);
    EXPECT_EQ(run.steps[0].hinges[2].place, 0);
}

TEST(PushLaws, SpringsAndLinksYield)
{
    // A link of 300 that yields at 30 and a spring of 200 to the ground: pushed 0.4 along X.
    T_PUSH_MODEL model;
    model.frame = Empty();
    AddNode(model.frame, {0, 0, 0});
    AddNode(model.frame, {1, 0, 0});
    Fix(model.frame, 0, {0, 1, 2, 3, 4, 5});
    Fix(model.frame, 1, {1, 2, 3, 4, 5});
    Join(model.frame, ELEMENT_KIND::Link, 0, 1, {300, 0, 0, 0, 0, 0});
    Join(model.frame, ELEMENT_KIND::Spring, 1, 0, {200, 0, 0, 0, 0, 0});
    T_HINGE_SIDE free;
    free.free = true;
    T_PUSH_HINGE link, spring;
    link.laws.push_back({0, Side({{0, 30}}), Side({{0, 30}}), 0.0, {}});
    spring.element = 1;
    spring.laws.push_back({0, Side({{0, 50}}), free, 0.0, {}});
    model.hinges = {link, spring};
    const T_PUSHED there = Pushed(model, {PushTo(0.4), PushTo(-0.2)});
    ASSERT_TRUE(there.done) << there.error.reason.key;
    ASSERT_EQ(there.steps.size(), 2u);
    EXPECT_NEAR(there.steps[0].loadFactor, 80.0, 1e-9); // both have yielded
    EXPECT_NEAR(there.steps[0].base[0], -80.0, 1e-9);
    EXPECT_NEAR(there.steps[1].hinges[0].force, -30.0, 1e-9);
    EXPECT_NEAR(there.steps[1].hinges[1].force, 0.0, 1e-9); // the spring has opened
    EXPECT_NEAR(there.steps[1].loadFactor, -110.0, 1e-9);   // of the second stage alone
}

} // namespace
