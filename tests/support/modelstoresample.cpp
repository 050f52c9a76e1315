#include "modelstoresample.h"

#include <algorithm>
#include <bit>
#include <cstdint>
#include <limits>

using Limits = std::numeric_limits<double>;

namespace {

void AddFrame(T_MODEL& m)
{
    m.styp.title = "Frame \"A\" / größe \xF0\x9F\x8F\xA2";
    m.styp.units = {FORCE_UNIT::kips, LENGTH_UNIT::in};
    m.styp.gravity = 9.80665;
    m.nodes[1] = {1, {0, 0, 0}, {0, 0, 0}, {1, 1, 1, 1, 1, 1}};
    m.nodes[2] = {2, {0.1, -0.0, 3.0}, {12.5, 12.5, Limits::denorm_min()}, {0, 1, 0, 0, 0, 1}};
    m.nodes[7] = {7, {1e100, -1e-300, 6.0}, {-0.0, 1.0 / 3.0, 5.0}, {}};
    m.storeys[1] = {"1F", 3.0, {2, 1}};
    m.storeys[2] = {"Top", 1e-300, {}};
    T_EIGV_D bare;
    bare.period = 0.7;
    T_EIGV_D full{
        0.25, {{1, {1, 2, 3, 4, 5, 6}}, {2, {-0.0, 0, 0, 1e-9, 0, 0}}}, T_DOF6{}, T_DOF6{}};
    full.participation = T_DOF6{1.3, 0, -0.0, 0, 0, 0};
    full.massPercent = T_DOF6{81.5, 0, 0, 0, 0, 2};
    m.modes = {{1, bare}, {2, full}};
}

void AddSpectra(T_MODEL& m)
{
    T_SPFC_NTC ntc{'C', 3, 5.0, {}};
    ntc.states[1] = T_SPFC_NTC_STATE{0.06, 2.5, 0.28};
    ntc.states[3] = T_SPFC_NTC_STATE{0.1, 2.4, 0.35};
    m.spectra[1] = {"D1", T_SPFC_ATC40{0.4, 0.6, std::nullopt}};
    m.spectra[2] = {"D2", T_SPFC_ATC40{0.4, 1e-9, false}};
    m.spectra[3] = {"E4", T_SPFC_EURO2003{2, 'E', 0.25, 7.5, 1.1, 0.1, std::nullopt, 2.0}};
    T_SPFC_EURO2003 bare;
    bare.ag = 0.3;
    m.spectra[4] = {"E4b", bare};
    m.spectra[5] = {"E94", T_SPFC_EURO1996{'B', 0.35, std::nullopt}};
    m.spectra[6] = {"N", ntc};
    m.spectra[7] = {"N0", T_SPFC_NTC{}};
    m.spectra[9] = {"U", T_SPFC_USER{{0.0, 0.5, 4.0}, {0.3, 0.9, -0.0}, 386.0886}};
    m.spectra[10] = {"U2", T_SPFC_USER{{0.0, 1.0}, {1.0, 1.0}, std::nullopt}};
}

void AddEvaluations(T_MODEL& m)
{
    m.pushovers[1] = {"PX", 2, 1, 0, {}};
    m.pushovers[3] = {"PY mode", 7, 2, 3, {2, 1, 2}};
    T_EVAL_D& bare = m.evaluations[1];
    bare.name = "E1";
    bare.push = "PX";
    bare.spectrum = "D1";
    T_EVAL_D& full = m.evaluations[2];
    full = {"E2",
            "PY mode",
            PUSH_METHOD::Fema440,
            'C',
            "N",
            3,
            -0.0,
            {},
            false,
            true,
            2,
            8,
            true,
            T_EVAL_BILINEAR{"masonry", 0.7, 0.8, true}};
    full.userDamping = std::array<double, 4>{10.0, 1.0, 40.0, -0.0};
    T_EVAL_D& blank = m.evaluations[5];
    blank.name = "E 3";
    blank.method = PUSH_METHOD::Fema440;
    blank.bilinear = T_EVAL_BILINEAR{};
    m.poverSteps[1] = {std::array<int, 3>{12, -2, 40}, std::nullopt};
    m.poverSteps[3] = {std::nullopt, std::array<int, 3>{1, 2, -2}};
    m.poverSteps[4] = {};
}

bool SameBits(const std::vector<double>& a, const std::vector<double>& b)
{
    return std::equal(a.begin(), a.end(), b.begin(), b.end(), [](double x, double y) {
        return std::bit_cast<std::uint64_t>(x) == std::bit_cast<std::uint64_t>(y);
    });
}

bool SameResult(IPushResult& a, IPushResult& b)
{
    T_PUSH_DATA da, db;
    std::string error;
    if (!ReadWholeResult(a, da, error) || !ReadWholeResult(b, db, error)) return false;
    bool same = a.StepCount() == b.StepCount() && a.NodeIds() == b.NodeIds() &&
                SameBits(da.loadFactor, db.loadFactor) &&
                SameBits(da.baseReaction, db.baseReaction) &&
                da.displacement.size() == db.displacement.size();
    for (const auto& [node, series] : da.displacement)
        same = same && db.displacement.contains(node) && SameBits(series, db.displacement[node]);
    return same;
}

} // namespace

T_MODEL_CONTENT RichContent()
{
    T_MODEL_CONTENT content;
    AddFrame(content.model);
    AddSpectra(content.model);
    AddEvaluations(content.model);
    T_PUSH_DATA px;
    px.loadFactor = {0.5, 1.0, 1.25};
    px.baseReaction = {100.0, -0.0, Limits::max()};
    px.displacement = {{7, {1e-3, 1234.56789, -0.0}}, {2, {0.1, 0.2, Limits::denorm_min()}}};
    content.results[1] = MakePushResult(px);
    content.results[3] = MakePushResult({{1.0}, {2.0}, {}});
    T_RUN_DATA run;
    run.head = {2, 30.0, {0.5, -0.0, 0, 0, 0, 0}, 0.25, {1, 2, 3, 4}, {{}, 0, 1.0, 0.5, 4}};
    run.nodes = {2, 7};
    run.start = {{0.5, -0.0}, {}};
    run.hinges = {{4, 0.5, 5}};
    run.steps = {{0, 0.5, 0.1, 2, {1, 2, 3, 4, 5, 6}, 1e-15, false}, {0, 1, 0.5, 4, {}, 0, true}};
    run.displacement = {{{1}, {2}}, {{-0.0}, {Limits::max()}}};
    run.states = {{{0.01, 100, -5, 1}}, {{0.02, 110, -6, -2}}};
    run.events = {{0, 0.4, 0.05, 1, {}, {{0, {}, 1, false}}}};
    content.turnedResults[{1, 2}] = MakePushRun(run);
    return content;
}

double SampleDisplacement(int node, int step)
{
    return node / 7.0 + step * 10000.0;
}

T_MODEL_CONTENT GridContent(int nodes, int steps)
{
    T_MODEL_CONTENT content;
    T_PUSH_DATA data;
    for (int step = 0; step < steps; ++step) {
        data.loadFactor.push_back(0.1 * step);
        data.baseReaction.push_back(-5.0 * step);
    }
    for (int i = 1; i <= nodes; ++i) {
        const int id = 10 * i;
        content.model.nodes[id] = {id, {0.5 * i, 1.0 / i, 3.0}, {1, 2, 0}, {0, 0, i % 2, 0, 0, 0}};
        auto& series = data.displacement[id];
        for (int step = 0; step < steps; ++step)
            series.push_back(SampleDisplacement(id, step));
    }
    content.model.pushovers[1] = {"PX", 10, 1, 1, {}};
    content.results[1] = MakePushResult(std::move(data));
    return content;
}

bool SameContent(const T_MODEL_CONTENT& a, const T_MODEL_CONTENT& b)
{
    if (a.model != b.model || a.results.size() != b.results.size() ||
        a.turnedResults.size() != b.turnedResults.size())
        return false;
    for (const auto& [key, source] : a.turnedResults) {
        const auto other = b.turnedResults.find(key);
        T_RUN_DATA of[2];
        std::string error;
        if (other == b.turnedResults.end() || !ReadWholeRun(*source->Run(), of[0], error) ||
            !ReadWholeRun(*other->second->Run(), of[1], error) || of[0] != of[1])
            return false;
    }
    for (const auto& [key, source] : a.results) {
        const auto other = b.results.find(key);
        if (other == b.results.end() || !SameResult(*source, *other->second)) return false;
    }
    return true;
}
