// A frame of two storeys whose hinges lose their strength one after the other until, near 0.205, no
// equilibrium leads on. Lengths in m, forces in kN.
#include "pushframes.h"

#include <gtest/gtest.h>

#include <cmath>

namespace {

using namespace sample;
using T_POINTS = std::vector<T_BACKBONE_POINT>;

// Of both ends of the four columns and the two beams, lower storey first.
const std::vector<std::array<T_POINTS, 2>> kLaws{
    {{{{0, 298}, {0.0148, 334}, {0.0148, 49.5}}, {{0, 298}, {0.0148, 334}, {0.0148, 49.5}}}},
    {{{{0, 248}}, {{0, 274}, {0.018, 310}, {0.0219, 90.9}}}},
    {{{{0, 322}, {0.0179, 370}, {0.0239, 91.8}}, {{0, 286}, {0.0147, 340}, {0.0149, 52.5}}}},
    {{{{0, 296}}, {{0, 296}}}},
    {{{{0, 263}, {0.0224, 301}, {0.0224, 31.3}}, {{0, 263}, {0.0224, 301}, {0.0224, 31.3}}}},
    {{{{0, 307}, {0.0271, 320}, {0.0271, 113}}, {{0, 307}, {0.0271, 320}, {0.0271, 113}}}},
    {{{{0, 319}, {0.01, 328}, {0.0144, 8.78}}, {{0, 319}, {0.01, 328}, {0.0144, 8.78}}}},
    {{{{0, 308}, {0.0298, 329}, {0.0298, 98.9}}, {{0, 308}, {0.0298, 329}, {0.0298, 98.9}}}},
    {{{{0, 166}}, {{0, 207}, {0.0395, 222}, {0.0395, 50.9}}}},
    {{{{0, 173}, {0.0107, 183}, {0.014, 21.9}}, {{0, 173}, {0.0107, 183}, {0.014, 21.9}}}},
    {{{{0, 239}, {0.0224, 271}, {0.0224, 93.3}}, {{0, 142}, {0.0109, 160}, {0.0109, 49.8}}}},
    {{{{0, 225}, {0.0234, 260}, {0.0234, 69.1}}, {{0, 225}, {0.0234, 260}, {0.0234, 69.1}}}},
};

void AddMember(T_PUSH_MODEL& model, std::size_t i, std::size_t j, std::size_t section)
{
    T_FRAME& frame = model.frame;
    const T_VEC3 a = frame.nodes[i].xyz, b = frame.nodes[j].xyz;
    const double length = std::hypot(b[0] - a[0], b[2] - a[2]);
    Join(frame, ELEMENT_KIND::Beam, i, j);
    frame.elements.back().section = section;
    frame.elements.back().zAxis = {(b[2] - a[2]) / length, 0.0, (a[0] - b[0]) / length};
    for (const double at : {0.0, 1.0}) {
        const auto& [positive, negative] = kLaws[model.hinges.size()];
        T_PUSH_HINGE hinge;
        hinge.element = frame.elements.size() - 1;
        hinge.at = at;
        hinge.laws.push_back({4, Side(positive), Side(negative), 0.0, {}});
        model.hinges.push_back(hinge);
    }
}

T_PUSH_MODEL BrittleFrame()
{
    T_PUSH_MODEL model;
    model.frame = Empty();
    model.frame.materials[0].E = 3e7;
    model.frame.sections.push_back(model.frame.sections[0]);
    model.frame.sections[0].A = 0.16;
    model.frame.sections[0].Iy = 0.002;
    model.frame.sections[1].A = 0.15;
    model.frame.sections[1].Iy = 0.003;
    for (const double z : {0.0, 3.2, 6.4})
        for (const double x : {0.0, 5.0}) {
            AddNode(model.frame, {x, 0, z});
            Fix(model.frame, model.frame.nodes.size() - 1, {1, 3, 5});
        }
    for (const std::size_t n : {0u, 1u})
        Fix(model.frame, n, {0, 1, 2, 3, 4, 5});
    for (const std::size_t n : {0u, 1u, 2u, 3u})
        AddMember(model, n, n + 2, 0);
    AddMember(model, 2, 3, 1);
    AddMember(model, 4, 5, 1);
    const double weights[] = {83.5, 54.5, 135.0, 133.0};
    for (std::size_t n = 0; n < 4; ++n)
        model.initial.nodal.push_back({n + 2, {0, 0, -weights[n], 0, 0, 0}});
    for (const std::size_t e : {4u, 5u}) {
        T_BEAM_LOAD load;
        load.element = e;
        load.direction = 2;
        load.w = {-13.3, -13.3};
        model.initial.beam.push_back(load);
    }
    return model;
}

T_PUSH_STAGE Push(bool leaps)
{
    T_PUSH_STAGE stage = PushTo(0.32, 4);
    stage.loads.nodal[0].load[0] = 2.0;
    stage.loads.nodal.push_back({2, {1, 0, 0, 0, 0, 0}});
    for (int k = 1; k <= 100; ++k)
        stage.steps.push_back(k / 100.0);
    stage.leaps = leaps;
    return stage;
}

/// The largest force of a side from this deformation on.
double MostBeyond(const T_POINTS& points, double deformation)
{
    double most = points.back().force;
    for (std::size_t k = 1; k < points.size(); ++k) {
        const T_BACKBONE_POINT &a = points[k - 1], &b = points[k];
        if (b.deformation < deformation) continue;
        const double from = std::max(a.deformation, deformation), width = b.deformation - from;
        const double slope = (b.force - a.force) / (b.deformation - a.deformation);
        most = std::max(most, width > 0.0 ? a.force + slope * (from - a.deformation) : b.force);
        most = std::max(most, b.force);
    }
    return most;
}

TEST(PushLeap, GoesOnWhereNoPathLeadsOnAndHoldsEveryLaw)
{
    const T_PUSH_MODEL model = BrittleFrame();
    const T_PUSHED ends = Pushed(model, {Push(false)}), leaps = Pushed(model, {Push(true)});
    ASSERT_TRUE(ends.done && leaps.done);
    EXPECT_EQ(ends.end.outcome, PUSH_OUTCOME::NoPath);
    EXPECT_EQ(leaps.end.outcome, PUSH_OUTCOME::ReachedByLeaps);
    ASSERT_LT(ends.steps.size(), leaps.steps.size());
    EXPECT_NEAR(leaps.steps.back().displacement, 0.32, 1e-12);
    for (std::size_t s = 0; s < ends.steps.size(); ++s)
        EXPECT_EQ(ends.steps[s].loadFactor, leaps.steps[s].loadFactor);
    std::size_t leapt = 0;
    for (const T_PUSH_EVENT& event : leaps.events)
        for (const T_HINGE_EVENT& h : event.hinges)
            if (h.turn == HINGE_TURN::Leap) {
                ++leapt;
                EXPECT_GE(event.displacement, ends.end.displacement);
            }
    EXPECT_GT(leapt, 0u);
    // What a hinge carries is not more than its law allows for the furthest that it was seen at.
    std::vector<std::array<double, 2>> furthest(kLaws.size(), {0.0, 0.0});
    for (const T_PUSH_STEP& step : leaps.steps) {
        EXPECT_LE(step.residual, 1e-10);
        for (std::size_t h = 0; h < kLaws.size(); ++h) {
            const auto& [deformation, force, place] = step.hinges[h];
            for (const std::size_t side : {0u, 1u}) {
                const double sign = side == 0 ? 1.0 : -1.0;
                furthest[h][side] = std::max(furthest[h][side], sign * deformation);
                EXPECT_LE(sign * force, MostBeyond(kLaws[h][side], furthest[h][side]) + 1e-5)
                    << "hinge " << h << " at " << step.displacement;
            }
        }
    }
}

TEST(PushLeap, LeavesAPushWithAPathAsItIs)
{
    T_PUSH_MODEL model = Column();
    AddHinge(model, Side({{0, 100}, {0.2, 120}, {0.2, 30}}));
    T_PUSH_STAGE stage = PushTo(3.0);
    const T_PUSHED plain = Pushed(model, {stage});
    stage.leaps = true;
    const T_PUSHED leaps = Pushed(model, {stage});
    EXPECT_EQ(leaps.end.outcome, PUSH_OUTCOME::Reached);
    EXPECT_EQ(plain.steps.back().loadFactor, leaps.steps.back().loadFactor);
}

} // namespace
