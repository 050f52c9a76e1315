#include "qm_rps/pushover/answertrial.h"

#include <algorithm>
#include <cmath>

bool TriesFamily(const T_PUSH_EVALUATION& e)
{
    return e.eval.method == PUSH_METHOD::Atc40 && e.procedure == 'B';
}

const T_PERFPT_TRIAL* AnswerTrial(const T_PUSH_EVALUATION& e)
{
    if (e.trace.empty()) return nullptr;
    if (!TriesFamily(e)) return &e.trace.back();
    if (!e.point) return nullptr;
    return &*std::ranges::min_element(
        e.trace, {}, [&](const T_PERFPT_TRIAL& t) { return std::fabs(t.dpi - e.point->Sd); });
}
