#include "qm_rps/pushover/overview/plotregion.h"

#include "qm_rps/pushover/answertrial.h"

#include "qm_rps/pushover/overview/evaluationentry.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr double kRoomRight = 1.6, kRoomAbove = 1.12; // factors on what is to be seen

struct T_EXTENT {
    double Sd = 0.0, Sa = 0.0;

    void Take(double d, double a)
    {
        if (std::isfinite(d)) Sd = std::max(Sd, d);
        if (std::isfinite(a)) Sa = std::max(Sa, a);
    }
};

/// Points that must be seen.
void TakePoints(T_EXTENT& extent, const T_PUSH_EVALUATION& e)
{
    if (const auto answer = AnswerOf(e)) extent.Take(answer->Sd, answer->Sa.value_or(0.0));
    for (const T_PERF_POINT& p : e.allPoints)
        extent.Take(p.Sd, p.Sa);
    for (const T_ADDITIONAL_POINT& p : e.additionalPoints)
        if (p.point) extent.Take(p.point->Sd, p.point->Sa);
    for (const T_ADDITIONAL_STEP& s : e.additionalSteps)
        extent.Take(s.Sd, s.Sa);
    for (const T_GUIDE_LINE& line : e.guideLines)
        if (line.kind == T_GUIDE_LINE::KIND::Demand) extent.Take(line.Sd, 0.0);
    if (e.bilinear) extent.Take(e.bilinear->dy, e.bilinear->ay);
    if (const T_PERFPT_TRIAL* const trial = AnswerTrial(e)) extent.Take(trial->dpi, trial->api);
}

/// The heights that a curve reaches up to Sd.
void TakeHeights(T_EXTENT& extent, const T_ADRS_CURVE& curve, double Sd)
{
    for (std::size_t i = 0; i < std::min(curve.Sd.size(), curve.Sa.size()); ++i)
        if (curve.Sd[i] <= Sd) extent.Take(0.0, curve.Sa[i]);
}

} // namespace

std::optional<T_PLOT_REGION> RegionOf(std::span<const T_PUSH_EVALUATION* const> evaluations)
{
    T_EXTENT extent;
    for (const T_PUSH_EVALUATION* e : evaluations)
        if (AnswerOf(*e)) TakePoints(extent, *e);
    if (!(extent.Sd > 0.0)) return std::nullopt;
    const double right = kRoomRight * extent.Sd;
    for (const T_PUSH_EVALUATION* e : evaluations) {
        for (const T_ADRS_CURVE* curve : {&e->capacity, &e->demand, &e->reduced, &e->working})
            TakeHeights(extent, *curve, right);
        for (const T_ADRS_CURVE& curve : e->stateDemands)
            TakeHeights(extent, curve, right);
    }
    if (!(extent.Sa > 0.0)) return std::nullopt;
    return T_PLOT_REGION{right, kRoomAbove * extent.Sa};
}
