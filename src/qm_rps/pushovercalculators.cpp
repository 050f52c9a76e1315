#include "qm_rps/pushovercalculators.h"

#include "qm_rps/pushover/releaseassert.h"
#include "qm_rps/pushovercalcperfptfema440proca.h"
#include "qm_rps/pushovercalcperfptfema440procc.h"
#include "qm_rps/pushovercalcperfptproca.h"
#include "qm_rps/pushovercalcperfptprocb.h"

std::unique_ptr<CPushOverCalcPerfPtBase> MakePerfPtCalculator(PUSH_METHOD method, int procedure,
                                                              CPushOverPerfPtRecord& owner)
{
    if (method == PUSH_METHOD::Atc40) {
        if (procedure == 0) return std::make_unique<CPushOverCalcPerfPtProcA>(owner);
        if (procedure == 1) return std::make_unique<CPushOverCalcPerfPtProcB>(owner);
    } else if (method == PUSH_METHOD::Fema440) {
        if (procedure == 0 || procedure == 1)
            return std::make_unique<CPushOverCalcPerfPtFEMA440ProcA>(owner, procedure);
        if (procedure == 2) return std::make_unique<CPushOverCalcPerfPtFEMA440ProcC>(owner);
    }
    ReleaseAssert("src/qm_rps/pushovercurvedlg", __LINE__); // the driver's choice is wrong
    return nullptr;
}

std::optional<T_PERFPT_ANSWER> RunPerfPtProcedure(PUSH_METHOD method, int procedure,
                                                  CPushOverPerfPtRecord& record)
{
    const auto calculator = MakePerfPtCalculator(method, procedure, record);
    if (!calculator) return std::nullopt;
    T_PERFPT_ANSWER answer;
    answer.result = calculator->CalcPerformancePoint(answer.Sd, answer.Sa, answer.betaEff, nullptr);
    answer.trace = calculator->Trace();
    answer.outcome = calculator->Outcome();
    answer.slopeChange = calculator->SlopeChange();
    if (const auto* c = dynamic_cast<const CPushOverCalcPerfPtFEMA440ProcC*>(calculator.get()))
        answer.locus = c->Locus();
    return answer;
}
