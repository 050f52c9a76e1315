// Stages against the static analysis of the same frame.
#include "staged.h"

namespace {

using namespace sample;

constexpr auto kBeam = ELEMENT_KIND::Beam;

/// A little of everything: releases, offsets, a link, a spring, and ties whose first node is last.
T_FRAME Mixed()
{
    T_FRAME frame = Empty();
    frame.materials[0].density = 7.85;
    frame.materials[0].alpha = 1.2e-5;
    for (const T_VEC3 at : {T_VEC3{0, 0, 0}, {5, 0, 0}, {0, 4, 0}, {0, 0, 3}, {5, 0, 3}, {0, 4, 3}})
        AddNode(frame, at);
    for (const std::size_t n : {0, 1, 2})
        FixAll(frame, n);
    for (const std::size_t n : {0, 1, 2})
        Join(frame, kBeam, n, n + 3);
    Join(frame, kBeam, 3, 4);
    Join(frame, kBeam, 3, 5);
    frame.elements[3].releaseJ[4] = true;
    frame.elements[4].offsetI = {0, 0.2, 0};
    Join(frame, ELEMENT_KIND::Truss, 0, 4);
    Join(frame, ELEMENT_KIND::Link, 4, 5, {100, 200, 300, 4, 5, 6});
    Join(frame, ELEMENT_KIND::Spring, 5, 0, {10, 20, 30, 0, 0, 0});
    frame.diaphragms.push_back({{5, 3, 4}, 2});
    frame.equalDisplacements.push_back({{5, 4}, {false, false, true, false, false, false}});
    return frame;
}

std::vector<T_LOAD_CASE> MixedCases()
{
    T_LOAD_CASE strains = Tension(5, 30.0);
    strains.temperature.push_back({3, 25.0});
    strains.settlement.push_back({1, {0, 0, -0.01, 0, 0.002, 0}});
    T_LOAD_CASE spans = At(4, {5, 6, 7, 1, 2, 3});
    spans.beam.push_back({3, BEAM_LOAD::Distributed, true, 2, {-3, -5}, {0.1, 0.8}});
    spans.beam.push_back({4, BEAM_LOAD::Point, false, 0, {4, 0}, {0.3, 1}});
    return {Weight(), strains, spans};
}

TEST(StagedStatic, EverythingInOneStageIsTheStaticAnalysis)
{
    const std::vector<T_LOAD_CASE> cases = MixedCases();
    const std::vector<T_RESULT> plain = Solved(Mixed(), cases);
    CStagedSolver staged;
    Build(staged, OneStage(Mixed(), cases.size()), cases);
    ASSERT_EQ(cases.size(), plain.size());
    for (std::size_t c = 0; c < cases.size(); ++c)
        ExpectSame(plain[c], Case(staged, 0, c), 1e-12);
}

TEST(StagedStatic, LoadsAfterTheLastBirthAddTheStaticAnalysis)
{
    // Two columns move under their weight before the rest joins and their ties with it.
    T_STAGED_MODEL model = OneStage(Mixed(), 3);
    T_STAGE &first = model.stages[0], second;
    first.activateElements = {0, 1};
    first.activateSupports.pop_back(); // of the third column
    second.activateElements = {2, 3, 4, 5, 6, 7};
    second.activateSupports = {{2, {}}};
    first.activateLoads = {{0, kFirstStep}};
    second.steps = 2;
    second.activateLoads = {{1, 2}, {2, 2}};
    model.stages.push_back(second);
    const std::vector<T_LOAD_CASE> cases = MixedCases();
    CStagedSolver staged;
    Build(staged, model, cases);
    for (const std::size_t c : {1, 2})
        ExpectSame(Solved(Mixed(), cases[c]), Case(staged, 1, c), 1e-12);
    // What was born unstressed: its own weight is all that it carries of the first case.
    const T_RESULT weight = Case(staged, 1, 0, kFirstStep);
    const T_RESULT columns = Case(staged, 0, 0);
    T_FRAME whole = Mixed();
    T_LOAD_CASE own; // of a column, two beams and the truss
    const double w = whole.materials[0].density * whole.sections[0].A * whole.gravity;
    for (const std::size_t e : {2, 3, 4, 5})
        own.beam.push_back({e, BEAM_LOAD::Distributed, false, 2, {-w, -w}, {0, 1}});
    ExpectSame(Sum(columns, Solved(whole, own)), weight, 1e-12);
}

} // namespace
