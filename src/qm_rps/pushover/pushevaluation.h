// The finished result of one evaluation: what reports, pictures, JSON and windows read.
// Lengths, forces and masses in the model's current units; Sa in g, periods in s, damping in per
// cent. MDOF values are SDOF values times Gamma.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/pushover/pushovercurvedata.h"
#include "qm_rps/pushover/pushovertargetdisp.h"

/// A performance point.
struct T_PERF_POINT {
    double Sd = 0.0, Sa = 0.0;     // SDOF
    double D = 0.0, V = 0.0;       // control displacement, base shear
    double Teff = 0.0;             // secant period 2 pi sqrt(Sd / (Sa g))
    std::optional<double> damping; // where the procedure sets one
};
inline auto Numbers(const T_PERF_POINT& p)
{
    return std::tie(p.Sd, p.Sa, p.D, p.V, p.Teff, p.damping);
}

/// One row of the limit-state table; what the window shows as "-" is empty.
struct T_LIMIT_ROW {
    std::string name;
    std::optional<double> demand, capacity; // MDOF
    std::optional<int> demandStep, capacityStep;
    std::string remark; // "OK", "N/A", "NG", kNotChecked or empty
    /// As tables show it, in the chosen language; "-" without one.
    std::string RemarkText() const;
};
inline auto Numbers(const T_LIMIT_ROW& r)
{
    return std::tie(r.demand, r.capacity);
}

/// What stands for a capacity on a curve that stays elastic; in every language.
inline constexpr const char* kElasticText = "Elastic";
/// Remark of a state whose capacity rests on data that are missing.
inline constexpr const char* kNotChecked = "not checked";

/// A vertical guide line on the capacity spectrum.
struct T_GUIDE_LINE {
    enum class KIND { Demand, Capacity, Qstar3 };
    KIND kind = KIND::Demand;
    double Sd = 0.0; // SDOF
    std::string label;
};

/// A step that the engineer asked for: MDOF values.
struct T_ADDITIONAL_STEP {
    int step = 0;
    double D = 0.0, V = 0.0;   // control displacement, base shear
    double Sd = 0.0, Sa = 0.0; // SDOF
};

/// A performance point for another spectrum on the same curve.
struct T_ADDITIONAL_POINT {
    std::string spectrum;
    int result = 0;
    std::optional<T_PERF_POINT> point;
    T_OUTCOME outcome;
};

/// Displacement of a further node, in the coordinates of a plot type; 0 where it has no results.
struct T_MONITORED_NODE {
    int node = 0;
    bool hasResults = false;
    std::vector<double> x; // by index of the steps
};

/// What a picture of the demand spectrum alone stands over; the show modes of the spectrum object.
enum class SPECTRUM_SHOW { Displacement = 0, Period = 1 };

/// A curve in the coordinates of a plot type.
struct T_PLOTTED_CURVE {
    PLOT_TYPE type = PLOT_TYPE::Atc40;
    std::vector<double> x, y;                  // by index of the steps
    double largestX = 0.0, largestY = 0.0;     // of its nodes and forces
    std::vector<T_MONITORED_NODE> monitored{}; // further nodes, as the evaluation names them
};

/// Key of the message that the results of the push are older than the model.
inline constexpr const char* kResultsAreOld = "IDS_QM_DB_PUSH_OLD";

/// Ductilities of T_PUSH_EVALUATION::teffs; 1 stands for T0.
inline constexpr std::array<double, 5> kTeffDuctilities{1.0, 2.0, 4.0, 6.0, 8.0};

struct T_PUSH_EVALUATION {
    T_EVAL_D eval; // as asked for
    char procedure = 'A';
    int result = 0; // 0 not found, 1 found, 2 found and elastic
    T_POLC_D loadCase;
    T_UNITS units;
    T_PUSH_FACTORS factors;
    double mStar = 0.0; // mass of the equivalent system

    T_ADRS_CURVE capacity;                  // by index of `steps`; 0 is a tenth of the first step
    std::vector<int> steps{};               // their numbers; empty: the index is the number
    T_ADRS_CURVE demand;                    // the record at its own damping; NTC: SLV
    std::vector<T_ADRS_CURVE> stateDemands; // NTC: SLO, SLD, SLV, SLC; empty where not enabled
    SPECTRUM_SHOW shownOver = SPECTRUM_SHOW::Displacement; // as the spectrum is set to show itself
    std::string gammaNote;                                 // how Gamma is defined for this method
    T_ADRS_CURVE reduced;                                  // at the performance point, may be empty
    T_ADRS_CURVE working;      // FEMA 440: the last reduced or modified spectrum, may be empty
    T_ADRS_CURVE locus;        // ATC-40 B, FEMA 440 C: demand points, may be empty
    std::vector<double> teffs; // ATC-40 B: T0 and Teff at kTeffDuctilities, as far as it came
    std::optional<T_POINT2> slopeChange; // Sd, Sa of the first change of slope, where there is one
    std::optional<T_PERF_POINT> point;
    std::vector<T_PERFPT_TRIAL> trace;
    std::vector<T_PERF_POINT> allPoints; // where demand equals capacity, in the curve's order
    std::string pointNote; // how the procedure's answer lies to those points, where that matters
    std::vector<T_ADDITIONAL_STEP> additionalSteps;
    std::vector<T_ADDITIONAL_POINT> additionalPoints;

    std::optional<T_BILINEAR> bilinear;
    std::vector<T_TARGET_DISP> targets; // one; NTC: SLO, SLD, SLV, SLC
    std::vector<T_LIMIT_ROW> limitStates;
    std::vector<T_GUIDE_LINE> guideLines;

    T_PLOTTED_CURVE curve; // the one that the report tabulates
    bool elastic = false;  // a target displacement on a curve that never leaves its first line
    T_OUTCOME outcome;
    std::vector<zql::frx::T_MESSAGE> messages;

    /// Number of the step at an index of the curve, and the index of a step; empty: it is not on
    /// it.
    int StepAt(std::size_t index) const
    {
        return index < steps.size() ? steps[index] : static_cast<int>(index);
    }
    std::optional<std::size_t> IndexOf(int step) const
    {
        for (std::size_t i = 0; i < capacity.Sd.size(); ++i)
            if (StepAt(i) == step) return i;
        return std::nullopt;
    }

    /// 0 not found, 1 found, 2 elastic, 3 beyond the push: each demand is larger than the curve's
    /// largest displacement, so that nothing on the curve belongs to it.
    int Status() const;
    /// The results of the push are older than the model: every picture and table says so.
    bool IsOld() const;
    bool IsTarget() const { return eval.method >= PUSH_METHOD::Ec8Opcm; }
    bool IsMasonry() const
    {
        return eval.method == PUSH_METHOD::Ec8Opcm && eval.masonry.value_or(false);
    }
};
/// What a reader takes from the result.
inline auto Numbers(const T_PUSH_EVALUATION& e)
{
    return std::tie(e.factors, e.mStar, e.capacity, e.point, e.allPoints, e.bilinear, e.targets,
                    e.limitStates);
}
