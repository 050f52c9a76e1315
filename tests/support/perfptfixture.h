// Builds the record that a performance-point calculator works on, and runs a calculator on it.
#pragma once

#include "qm_rps/pushovercalcperfptfema440proca.h"
#include "qm_rps/pushovercalcperfptfema440procc.h"
#include "qm_rps/pushovercalcperfptproca.h"
#include "qm_rps/pushovercalcperfptprocb.h"

#include <numbers>
#include <utility>

using T_POINTS = std::vector<T_POINT2>; // (Sd, Sa in g)

constexpr double kGravityMm = 9806.65; // mm/s2
/// Gravity of the cases worked by hand: Sd = T2 Sa, so that a stiffness of 1 has a period of 1 s.
constexpr double kGravityUnit = 4.0 * std::numbers::pi * std::numbers::pi;

/// A thousandth of the first point as step 1, and a tenth of that before it, as the driver has it.
/// The equal-area rule starts at the first stored point: so near the origin
/// it misses 1e-8 of the elastic triangle.
inline T_POINTS WithTinyStart(T_POINTS points)
{
    const T_POINT2 step{points[0].x * 1e-3, points[0].y * 1e-3};
    points.insert(points.begin(), {{step.x / 10.0, step.y / 10.0}, step});
    return points;
}

/// Linear to (dy, ay), then a straight line of `hardening` times the stiffness to `end`.
inline T_POINTS Bilinear(double dy, double ay, double hardening, double end)
{
    return WithTinyStart({{dy, ay}, {end, ay + hardening * (end - dy) * ay / dy}});
}

class CTestRecord : public CPushOverPerfPtRecord {
public:
    CTestRecord(const T_POINTS& capacity, decltype(T_SPFC_D::data) spectrum,
                const T_DAMP_PARAM& damping = {}, double gravity = kGravityMm)
    {
        SetGravity(gravity, gravity);
        T_ADRS_CURVE curve;
        for (const T_POINT2& p : capacity) {
            curve.Sd.push_back(p.x);
            curve.Sa.push_back(p.y);
        }
        SetCapacity(curve);
        SetDamping(damping);
        SetDesignSpectrum(
            MakeDesignSpectrum({"D", std::move(spectrum)}, damping.behaviorType, LIMIT_STATE::SLV));
    }
};

/// The same acceleration at every period: worked by hand, its ADRS curve is one level line.
inline T_SPFC_USER Level(double Sa)
{
    return {{0.0, 100.0}, {Sa, Sa}, {}};
}

struct T_RUN {
    int result = 0;
    double D = -1.0, A = -2.0; // as they were before the run
    std::optional<double> beta;
    T_OUTCOME outcome;
    std::vector<T_PERFPT_TRIAL> trace;
};

template <class CALC, class... ARGS>
T_RUN RunPerfPt(CPushOverPerfPtRecord& record, ARGS... args)
{
    CALC calc(record, args...);
    T_RUN r;
    r.result = calc.CalcPerformancePoint(r.D, r.A, r.beta, nullptr);
    r.outcome = calc.Outcome();
    r.trace = calc.Trace();
    return r;
}

/// ATC-40 procedures 'A' and 'B', FEMA 440 procedures 'a', 'b' (MADRS crossing) and 'c' (locus).
inline T_RUN RunProcedure(CPushOverPerfPtRecord& record, char procedure)
{
    if (procedure == 'A') return RunPerfPt<CPushOverCalcPerfPtProcA>(record);
    if (procedure == 'B') return RunPerfPt<CPushOverCalcPerfPtProcB>(record);
    if (procedure == 'c') return RunPerfPt<CPushOverCalcPerfPtFEMA440ProcC>(record);
    return RunPerfPt<CPushOverCalcPerfPtFEMA440ProcA>(record, procedure - 'a');
}

inline T_SPFC_ATC40 Atc40(double Ca)
{
    return {Ca, Ca, {}};
}

/// The curve of the ATC-40 (1996) 8.3.3.3 example, its printed points in mm and m/s2.
inline T_POINTS Atc40ExampleCurve()
{
    T_POINTS points{{48.77, 2.49}, {71.37, 3.03}, {96.01, 3.39}, {199.14, 3.73}};
    for (T_POINT2& p : points)
        p.y *= 1000.0 / kGravityMm;
    return WithTinyStart(points);
}
constexpr double kMs2ToG = 1000.0 / kGravityMm;
inline const T_SPFC_ATC40 kExampleSb{0.4, 0.4, {}};   // serviceability level there
inline const T_SPFC_ATC40 kExampleSd{0.44, 0.64, {}}; // design level
