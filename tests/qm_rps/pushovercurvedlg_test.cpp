#include "qm_rps/pushovercurvedlg.h"

#include "pushsample.h"
#include "qm_base/appbase.h"
#include "qm_rps/pushover/report/pushovercells.h"

#include <algorithm>
#include <gtest/gtest.h>

namespace {

/// Elastic-perfectly plastic push of the sample: Sd = 0.03/Gamma, Sa = 10/(alpha W) at yield, so
/// dy/ay = 0.09 and, with g = 10, det = Se * 0.09. "U": Se = 0.5 to 0.1 s, 0.45 beyond, Tc = 0.1;
/// "S": constant 0.5, Tc = 4; "N": an NTC record with SLV alone; "0": an NTC record without states.
T_MODEL_CONTENT Plastic()
{
    T_MODEL_CONTENT c = ThreeMasses({0.03, 0.06, 0.09, 0.12}, {10, 10, 10, 10});
    c.model.spectra[1] = {"U", T_SPFC_USER{{0, 0.1, 0.2, 4}, {0.5, 0.5, 0.45, 0.45}, {}}};
    c.model.spectra[2] = {"S", T_SPFC_USER{{0, 4}, {0.5, 0.5}, {}}};
    T_SPFC_NTC ntc;
    c.model.spectra[4] = {"0", ntc};
    ntc.states[2] = T_SPFC_NTC_STATE{0.2, 2.5, 0.1};
    c.model.spectra[3] = {"N", ntc};
    return c;
}

T_EVAL_D Eval(PUSH_METHOD method, const char* spectrum = "U")
{
    T_EVAL_D e;
    e.name = "E";
    e.push = "PX";
    e.method = method;
    e.spectrum = spectrum;
    return e;
}

std::string Cell(const T_PUSH_EVALUATION& e)
{
    return PerfPointPair(e, &T_PERF_POINT::Sd, &T_PERF_POINT::Sa);
}

/// A driver with its document, evaluated once.
struct T_RUN {
    CDBDoc doc;
    CPushOverCurveDlg dlg{doc};
    int result = -1;

    T_RUN(const T_MODEL_CONTENT& content, const T_EVAL_D& eval)
    {
        doc.Data().Assign(content);
        EXPECT_EQ(1, dlg.SetEvaluation(eval)) << dlg.Refusal().text;
        CAppBase::TakeAssertions_ST();
        result = dlg.Evaluate();
    }
    const T_PUSH_EVALUATION& R() const { return dlg.Result(); }
    bool Said(const char* key) const
    {
        return std::ranges::any_of(R().messages, [&](const auto& m) { return m.key == key; });
    }
    std::vector<int> Steps(bool ntc)
    {
        std::array<int, 3> s{};
        CPoverInfo* info = doc.Post().GetPoverInfo();
        if (!(ntc ? info->GetStepNTC2008(1, s) : info->GetStepEC8(1, s))) return {};
        return {s.begin(), s.end()};
    }
};

constexpr const char* kNoPoint = "IDS_RPS_FAILED_FINDING_PERFORMANCE_POINT";
constexpr const char* kNoConversion = "IDS_QM_NO_CONVERSION";

void OtherMode(T_MODEL& m)
{
    m.pushovers[1].patternKind = 2;
    m.pushovers[1].modes = {1};
}
void NoMass(T_MODEL& m)
{
    for (auto& entry : m.nodes)
        entry.second.mass = {};
}
/// The control node 3 moves against the others.
void Against(T_MODEL& m)
{
    m.modes[1].shape = {{1, {-1.0}}, {2, {-0.5}}, {3, {0.1}}};
}

const struct {
    PUSH_METHOD method;
    bool eigen;
    void (*change)(T_MODEL&);
    PUSH_OUTCOME outcome;
    const char* key;
} kFails[] = {
    {PUSH_METHOD::Atc40, true, [](T_MODEL& m) { m.pushovers[1].direction = 3; },
     PUSH_OUTCOME::ConversionFailed, "IDS_QM_VERTICAL_PUSH"},
    {PUSH_METHOD::Fema440, true, [](T_MODEL& m) { m.modes.clear(); }, PUSH_OUTCOME::NoEigen,
     "IDS_PUSHOVER_The_eigen_value_analysis_is_not_perfor"},
    {PUSH_METHOD::Ec8Opcm, true, OtherMode, PUSH_OUTCOME::EigenError,
     "IDS_RPS_PO_CURVE_ERROR_EIGEN"},
    {PUSH_METHOD::Atc40, true, OtherMode, PUSH_OUTCOME::ConversionFailed, kNoConversion},
    {PUSH_METHOD::Atc40, false, NoMass, PUSH_OUTCOME::ConversionFailed, kNoConversion},
    {PUSH_METHOD::Ec8Opcm, false, Against, PUSH_OUTCOME::NegativeGamma,
     "IDS_QM_ADVICE_NEGATIVE_GAMMA"},
};

} // namespace

// A constant demand of 0.2 crosses the elastic branch (0.09 length per g). At 5 % the reduction
// formulas do not give exactly 1: ATC-40 (8-9) (3.21 - 0.68 ln 5)/2.12, FEMA 440 (5.6 - ln 5)/4.
TEST(PushOverCurveDlg, ElasticPointByHand)
{
    T_MODEL_CONTENT c = Plastic();
    c.model.spectra[1] = {"U", T_SPFC_USER{{0, 4}, {0.2, 0.2}, {}}};
    for (const bool atc : {true, false}) {
        const double log5 = std::log(5.0);
        const double Sa = 0.2 * (atc ? (3.21 - 0.68 * log5) / 2.12 : (5.6 - log5) / 4.0);
        T_RUN run(c, Eval(atc ? PUSH_METHOD::Atc40 : PUSH_METHOD::Fema440));
        ASSERT_EQ(2, run.result) << atc;
        const T_PERF_POINT& p = run.R().point.value();
        EXPECT_NEAR(0.09 * Sa, p.Sd, 1e-12) << atc;
        EXPECT_NEAR(0.09 * Sa * kGamma, p.D, 1e-12) << atc;
        EXPECT_NEAR(Sa * kWeightStar, p.V, 1e-10) << atc;
        EXPECT_NEAR(2 * std::acos(-1.0) * std::sqrt(0.009), p.Teff, 1e-10) << atc;
        EXPECT_NEAR(5.0, p.damping.value(), 1e-9) << atc;
        EXPECT_NEAR(3.0, run.R().mStar, 1e-14) << "S1 of the three masses";
        // 0.0179625 and 0.199583, 0.0179575 and 0.199528 to four digits
        EXPECT_EQ(atc ? "Elastic(0.01796,  0.1996)" : "Elastic(0.01796,  0.1995)", Cell(run.R()));
    }
}

// Se(T*) = 0.45 on the long branch: dt* = 0.0405; control displacements 0.0230, 0.0576, 0.0863.
TEST(PushOverCurveDlg, Ec8StoresTheStepsOfItsLimitStates)
{
    T_RUN run(Plastic(), Eval(PUSH_METHOD::Ec8Opcm));
    ASSERT_EQ(1, run.result);
    ASSERT_EQ(3U, run.R().limitStates.size());
    const double factors[] = {1 / 2.5, 1.0, 1.5};
    for (std::size_t i = 0; i < 3; ++i)
        EXPECT_NEAR(0.0405 * kGamma * factors[i], run.R().limitStates[i].demand.value(), 1e-12);
    EXPECT_EQ((std::vector<int>{1, 2, 3}), run.Steps(false));
    EXPECT_EQ(std::vector<int>{}, run.Steps(true));
    EXPECT_TRUE(run.R().messages.empty());
    EXPECT_EQ("NC(Dem.)", run.R().guideLines.at(2).label);
}

// Short branch, limited to 3 det = 3 * 0.5 * 0.09: only DL = 0.0767 lies on the curve.
TEST(PushOverCurveDlg, StepsThatAreNotFoundAreStoredAsMinusTwo)
{
    T_RUN run(Plastic(), Eval(PUSH_METHOD::Ec8Opcm, "S"));
    EXPECT_EQ(1, run.result);
    EXPECT_TRUE(run.R().targets.at(0).capped);
    EXPECT_NEAR(0.135 * kGamma, run.R().limitStates[1].demand.value(), 1e-12);
    EXPECT_EQ((std::vector<int>{3, -2, -2}), run.Steps(false));
    EXPECT_EQ(PUSH_OUTCOME::TargetBeyond, run.R().outcome.code);
}

TEST(PushOverCurveDlg, NtcUsesOneSpectrumForAllStatesAndNeverStoresSlo)
{
    T_RUN run(Plastic(), Eval(PUSH_METHOD::Ntc2008));
    ASSERT_EQ(1, run.result);
    for (const T_LIMIT_ROW& row : run.R().limitStates) {
        EXPECT_NEAR(0.0405 * kGamma, row.demand.value(), 1e-12) << row.name;
        EXPECT_EQ(2, row.demandStep) << row.name;
    }
    EXPECT_EQ((std::vector<int>{2, 2, 2}), run.Steps(true));
    // 0.03 m over 9 m is a drift of 0.0033 in every storey at the peak, step 1
    EXPECT_NEAR(0.03, run.R().limitStates[1].capacity.value(), 1e-12);
}

TEST(PushOverCurveDlg, AStateWithoutDataIsLeftOutAndTheOthersGoOn)
{
    T_RUN run(Plastic(), Eval(PUSH_METHOD::Ntc2018, "N"));
    ASSERT_EQ(1, run.result);
    for (std::size_t i = 0; i < 4; ++i)
        EXPECT_EQ(i == 2, run.R().limitStates[i].demand.has_value()) << i;
    EXPECT_EQ(-2, run.Steps(true)[2]);

    T_RUN none(Plastic(), Eval(PUSH_METHOD::Ntc2018, "0"));
    EXPECT_TRUE(none.Said("IDS_RPS_FAILED_FINDING_TARGET_DISPLACEMENT"));
    T_RUN point(Plastic(), Eval(PUSH_METHOD::Atc40, "0")); // other methods use SLV
    EXPECT_TRUE(point.Said("IDS_RPS_FAILED_FINDING_PERFORMANCE_POINT"));
    EXPECT_EQ("-", Cell(point.R()));
}

// One driver serves many evaluations: a failed one must not show the spectrum of the one before.
TEST(PushOverCurveDlg, AFailedEvaluationKeepsNothingOfTheOneBefore)
{
    T_MODEL_CONTENT c = Plastic();
    c.model.pushovers[2] = PushX("P0", 3);
    T_RUN run(c, Eval(PUSH_METHOD::Atc40));
    const T_ADRS_CURVE demand = run.R().demand;
    T_EVAL_D none = Eval(PUSH_METHOD::Ec8Opcm, "S");
    none.push = "P0"; // no results
    ASSERT_EQ(1, run.dlg.SetEvaluation(none));
    EXPECT_EQ(0, run.dlg.Evaluate());
    EXPECT_EQ(PUSH_OUTCOME::NoCapacity, run.R().outcome.code);
    EXPECT_TRUE(run.Said("IDS_QM_CURVE_NOT_READ"));
    EXPECT_NE(demand, run.R().demand); // its own or none
    EXPECT_TRUE(run.R().capacity.Sd.empty() && run.R().trace.empty() && !run.R().point);
}

TEST(PushOverCurveDlg, EveryFailureHasItsOutcomeAndMessage)
{
    for (const auto& f : kFails) {
        T_MODEL_CONTENT c = Plastic();
        c.model.poverSteps[1].ec8 = {1, 2, 3};
        f.change(c.model);
        T_EVAL_D eval = Eval(f.method);
        eval.eigenFactors = f.eigen;
        T_RUN run(c, eval);
        EXPECT_EQ(0, run.result) << f.key;
        EXPECT_EQ(f.outcome, run.R().outcome.code) << f.key;
        EXPECT_TRUE(run.Said(f.key)) << f.key;
        EXPECT_FALSE(run.R().point) << f.key;
        EXPECT_EQ(f.method != PUSH_METHOD::Ec8Opcm, run.Said(kNoPoint)) << f.key;
        const bool target = f.method == PUSH_METHOD::Ec8Opcm; // those of an earlier one go
        EXPECT_EQ(target ? -2 : 3, run.Steps(false).back()) << f.key;
        for (const auto& m : run.R().messages)
            EXPECT_NE(m.key, m.text) << f.key; // every key has a text
    }
}

TEST(PushOverCurveDlg, WarnsAndGoesOn)
{
    T_MODEL_CONTENT c = Plastic();
    T_PUSH_DATA data;
    data.loadFactor = {1, 2, 3, 4};
    data.baseReaction = {10e3, 10e3, 10e3, 10e3};
    data.displacement[3] = {0.03, 0.06, 0.05, 0.12};
    c.results[1] = MakePushResult(data);
    c.model.storeys.clear();
    T_RUN run(c, Eval(PUSH_METHOD::Ntc2008));
    EXPECT_EQ(1, run.result);
    EXPECT_TRUE(run.Said("IDS_QM_WARN_DECREASING_DISPLACEMENT"));
    EXPECT_TRUE(run.Said("IDS_QM_WARN_NO_DRIFT"));
    EXPECT_EQ("not checked", run.R().limitStates[1].remark);

    c = Plastic(); // listed from top to bottom
    for (const auto& [key, storey] : c.model.storeys)
        for (const int id : storey.nodes)
            c.model.nodes[id].xyz[2] = -key;
    T_RUN falls(c, Eval(PUSH_METHOD::Ntc2008));
    EXPECT_TRUE(falls.Said("IDS_QM_WARN_STOREY_ORDER"));
    EXPECT_EQ("not checked", falls.R().limitStates[1].remark);

    c = Plastic();
    c.model.nodes[1].mass[0] = 0.0;
    T_EVAL_D eval = Eval(PUSH_METHOD::Ec8Opcm);
    EXPECT_FALSE(T_RUN(c, eval).Said("IDS_RPS_ERROR_DIAPHRAGM_MASS"));
    eval.eigenFactors = false;
    T_RUN mass(c, eval);
    EXPECT_TRUE(mass.Said("IDS_RPS_ERROR_DIAPHRAGM_MASS"));
    EXPECT_EQ(1, mass.result);
}

TEST(PushOverCurveDlg, GravityOfSpectrumThenModelThenStandard)
{
    T_MODEL_CONTENT c = Plastic();
    c.model.styp.units = {FORCE_UNIT::N, LENGTH_UNIT::mm};
    std::get<T_SPFC_USER>(c.model.spectra[1].data).gravity = 9.0;
    T_RUN run(c, Eval(PUSH_METHOD::Ec8Opcm));
    EXPECT_DOUBLE_EQ(9000.0, run.dlg.GetGravity(1));
    EXPECT_DOUBLE_EQ(10000.0, run.dlg.GetGravity(0));
    // It serves the curve too: a smaller gravity gives a larger Sa, 10 kN / (5 * 9 * alpha).
    EXPECT_NEAR(10.0 / 9.0 * 10.0 / kWeightStar, run.R().capacity.Sa[1], 1e-14);
    EXPECT_NEAR(30.0 / kGamma, run.R().capacity.Sd[1], 1e-12);
    ASSERT_EQ(1, run.dlg.SetEvaluation(Eval(PUSH_METHOD::Ec8Opcm, "S")));
    EXPECT_DOUBLE_EQ(10000.0, run.dlg.GetGravity(1));
    c.model.styp.gravity.reset();
    run.doc.Data().Assign(c);
    EXPECT_DOUBLE_EQ(9806.65, run.dlg.GetGravity(1));
}

TEST(PushOverCurveDlg, AnAnswerOnMasonryHoldsAgainstTheHingeTypes)
{
    T_MODEL_CONTENT c = Plastic();
    c.model.hingeTypes[1].masonry = T_MASONRY_HINGE{};
    T_EVAL_D eval = Eval(PUSH_METHOD::Ec8Opcm);
    const T_RUN open(c, eval);
    EXPECT_TRUE(open.R().IsMasonry() && open.Said("IDS_QM_MASONRY_BY_HINGES"));
    eval.masonry = false;
    const T_RUN answered(c, eval);
    EXPECT_TRUE(!answered.R().IsMasonry() && answered.Said("IDS_QM_MASONRY_OFF"));
}
