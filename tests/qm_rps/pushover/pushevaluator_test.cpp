#include "qm_rps/pushover/evaluation/pushevaluator.h"

#include "pushsample.h"
#include "qm_rps/pushovercalculators.h"

#include <gtest/gtest.h>

namespace {

// Three masses of 1.7e308 kg have no finite sum: M and m* are infinite, whatever the method.
TEST(PushEvaluator, GivesNothingWhereANumberIsNotFinite)
{
    for (const PUSH_METHOD method : {PUSH_METHOD::Atc40, PUSH_METHOD::Ec8Opcm}) {
        T_MODEL_CONTENT content = ThreeMasses({0.01, 0.02}, {100, 150});
        for (int node = 1; node <= 3; ++node)
            content.model.nodes[node].mass = {1.7e308, 0, 1.7e308};
        T_SPFC_EURO2003 spectrum;
        spectrum.ag = 0.3;
        content.model.spectra[1] = {"S", spectrum};
        T_EVAL_D eval;
        eval.name = "E";
        eval.push = "PX";
        eval.spectrum = "S";
        eval.method = method;
        CDBDoc doc;
        doc.Data().Assign(std::move(content));
        CPushEvaluator evaluator(doc, RunPerfPtProcedure);
        T_FINDING refusal;
        ASSERT_EQ(1, evaluator.SetEvaluation(eval, refusal)) << refusal.text;
        EXPECT_EQ(0, evaluator.Evaluate());
        const T_PUSH_EVALUATION& result = evaluator.Result();
        EXPECT_EQ(PUSH_OUTCOME::NotFinite, result.outcome.code);
        EXPECT_EQ(0.0, result.mStar);
        EXPECT_EQ(0.0, result.factors.mass);
        EXPECT_EQ("PX", result.loadCase.name);
    }
}

} // namespace
