#include "qm_rps/pushover/report/pushoverreport.h"

#include "pushsample.h"
#include "tempfolder.h"

#include <gtest/gtest.h>

namespace {

using EVALUATION = T_PUSH_EVALUATION;
using enum PUSH_METHOD;

EVALUATION Base(PUSH_METHOD method)
{
    EVALUATION e;
    e.eval.method = method;
    e.loadCase = PushX("PX", 5);
    e.units = {FORCE_UNIT::kN, LENGTH_UNIT::m};
    e.factors.gamma = 1.25;
    e.factors.mode = 2;
    e.mStar = 123456789.0;
    e.curve = {static_cast<PLOT_TYPE>(static_cast<int>(method)),
               {0.001, 0.01, 0.02, 0.04},
               {0.02, 0.2, 0.25, 0.1875}};
    return e;
}

T_PERF_POINT Point(std::optional<double> damping)
{
    return {0.015625, 0.25, 0.0195312, 1234.5, 0.5, damping};
}

T_TARGET_DISP Target(double det, double dt, std::optional<double> qu)
{
    T_TARGET_DISP t;
    t.found = true;
    t.mStar = 0.000015;
    t.Fy = 1e6;
    t.Tstar = 0.75;
    t.Tc = 0.5;
    t.Se = 0.3;
    t.det = det;
    t.dt = dt;
    t.qu = qu;
    return t;
}

void NotFound(EVALUATION& e)
{
    e.loadCase = PushX("Push 2", 7);
    e.loadCase.direction = 5;
    e.loadCase.patternKind = 2;
    e.units = {FORCE_UNIT::kips, LENGTH_UNIT::in};
}

void WithoutDamping(EVALUATION& e)
{
    e.result = 1;
    e.point = Point({});
    e.curve = {PLOT_TYPE::LoadFactor, {}, {}};
}

void Elastic(EVALUATION& e)
{
    e.result = 2;
    e.loadCase.direction = 2;
    e.loadCase.patternKind = 1;
    e.point = Point(5.0);
    e.loadCase.controlOption = 2;
    e.messages = {{"K", "First."},
                  {"IDS_RPS_FAILED_FINDING_PERFORMANCE_POINT", "stands above"},
                  {"L", "Second."}};
}

void Masonry(EVALUATION& e)
{
    e.result = 1;
    e.loadCase.patternKind = 3;
    e.targets = {Target(0.016, 0.04, 1.5)};
    e.limitStates = {{"DL", 0.02, 0.025, 2, 2, "OK"},
                     {"SD", 0.05, 0.045, 3, 3, "N/A"},
                     {"NC", 0.075, {}, {}, {}, ""},
                     {"q*=3", {}, 0.0625, {}, 3, ""}};
}

void Ec8NotFoundDrift(EVALUATION& e)
{
    for (const char* state : {"DL", "SD", "NC"})
        e.limitStates.push_back({state, {}, {}, {}, {}, ""});
    e.curve = {PLOT_TYPE::Drift, {0.0, 0.004, 0.003}, {-0.5, 0.25, 0.125}};
    e.curve.monitored = {{7, true, {}}, {9, false, {}}};
    e.elastic = true;
}

void Ntc(EVALUATION& e)
{
    e.result = 1;
    e.targets = {Target(0.008, 0.008, {}), {}, Target(0.016, 0.04, 1.5), Target(0.02, 0.02, {})};
    e.limitStates = {{"SLO", 0.01, 0.005, 1, {}, "NG"},
                     {"SLD", {}, 0.0125, {}, 1, ""},
                     {"SLV", 0.05, {}, 3, 1, ""},
                     {"SLC", 0.025, {}, 3, {}, ""}};
}

const struct {
    const char* file; // written by hand from the formats of the report
    PUSH_METHOD method;
    void (*make)(EVALUATION&);
} kGolden[] = {{"atc40_not_found", Atc40, NotFound},
               {"atc40_no_damping", Atc40, WithoutDamping},
               {"fema440_elastic", Fema440, Elastic},
               {"ec8_masonry", Ec8Opcm, Masonry},
               {"ec8_not_found_drift", Ec8Opcm, Ec8NotFoundDrift},
               {"ntc2008", Ntc2008, Ntc}};

} // namespace

TEST(PushoverReport, IsTheGoldenTextToTheByte)
{
    for (const auto& g : kGolden) {
        const std::string text = ReadText(std::string(QM_RPS_GOLDEN) + "/" + g.file + ".txt");
        ASSERT_FALSE(text.empty()) << g.file;
        EVALUATION e = Base(g.method);
        g.make(e);
        EXPECT_EQ(text, PushoverReportText(e)) << g.file;
    }
}
