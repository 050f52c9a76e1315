// The evaluator's result: points, factors, curves for pictures and tables.
#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/pushover/adrsformulas.h"
#include "qm_rps/pushover/evaluation/pushevaluator.h"
#include "qm_rps/pushover/pushoverallpoints.h"

#include <algorithm>
#include <cmath>

using zql::lib::MMSGFunction;

namespace {

/// How Gamma is defined: by the mode as recorded, from the nodal masses, or for NTC.
const char* GammaKey(const T_EVAL_D& eval, const T_PUSH_FACTORS& factors)
{
    if (eval.method >= PUSH_METHOD::Ntc2008) return "IDS_RPS_PO_CURVE_GAMMA_NTC";
    return factors.eigenBased ? "IDS_RPS_PO_CURVE_GAMMA_FEMA" : "IDS_RPS_PO_CURVE_GAMMA_2D_FEMA";
}

/// Whether each step lies on the line through the first.
bool IsStraight(const T_ADRS_CURVE& curve)
{
    constexpr double kSameSlope = 1e-3; // relative
    const auto& [Sd, Sa] = curve;
    if (Sd.size() < 2 || !(Sd[1] > 0.0) || !(Sa[1] > 0.0)) return false;
    for (std::size_t i = 1; i < Sd.size(); ++i) {
        const double line = Sd[i] * Sa[1] / Sd[1];
        if (std::fabs(Sa[i] - line) > kSameSlope * line) return false;
    }
    return true;
}

} // namespace

T_PERF_POINT CPushEvaluator::MakePoint(double Dp, double Ap, std::optional<double> beta) const
{
    T_PERF_POINT p;
    p.Sd = p.D = Dp;
    p.Sa = p.V = Ap;
    TransferToDispAndReac(&p.D, &p.V);
    p.Teff = SecantPeriod(Dp, Ap, GetGravity(1));
    p.damping = beta;
    return p;
}

// The procedure's answer stays as it is; the note says how it lies to the balanced points.
void CPushEvaluator::KeepAllPoints()
{
    constexpr double kAway = 0.02; // of the point's displacement
    const bool fema440 = m_eval.method == PUSH_METHOD::Fema440;
    for (const T_BALANCED_POINT& b : CPushOverAllPoints(*this, fema440).Find())
        m_result.allPoints.push_back(MakePoint(b.Sd, b.Sa, b.betaEff));
    if (m_result.allPoints.empty()) return;
    if (!m_result.point) {
        m_result.pointNote = MMSGFunction::Format(
            "IDS_QM_POINT_EXISTS", {std::to_string(m_result.allPoints.size()),
                                    FormatText("%.6g", m_result.allPoints.front().D)});
        return;
    }
    const double D = m_result.point->D;
    const auto nearest = std::ranges::min_element(
        m_result.allPoints, {}, [D](const T_PERF_POINT& p) { return std::fabs(p.D - D); });
    const double away = std::fabs(nearest->D - D) / nearest->D;
    if (away > kAway)
        m_result.pointNote =
            MMSGFunction::Format("IDS_QM_POINT_AWAY", {FormatText("%.2g", 100.0 * away),
                                                       FormatText("%.6g", nearest->D)});
}

void CPushEvaluator::FillResult()
{
    m_result.loadCase = m_curve.LoadCase();
    m_result.factors = m_curve.Factors();
    if (m_result.factors.gamma != 0.0)
        m_result.mStar = m_result.factors.mass * m_result.factors.alpha / m_result.factors.gamma;
    m_result.capacity = Capacity();
    if (!m_result.capacity.Sd.empty()) m_result.steps = m_curve.Steps();
    m_result.demand = Demand();
    m_result.reduced = PerfPointSpectrum();
    m_result.working = WorkingDemand();
    if (m_result.locus.Sd.empty()) m_result.locus = PerfPointTrace();
    if (DesignSpectrum())
        m_result.shownOver = static_cast<SPECTRUM_SHOW>(DesignSpectrum()->GetShowMode());
    m_result.gammaNote = MMSGFunction::GetValue(GammaKey(m_eval, m_result.factors));
    m_result.elastic = m_result.IsTarget() && IsStraight(m_result.capacity);
    KeepStateDemands();
    m_result.teffs = Teffs();
    PlotCurve();
}

// NTC: one spectrum for each enabled limit state, for the picture.
void CPushEvaluator::KeepStateDemands()
{
    if (m_eval.method < PUSH_METHOD::Ntc2008 ||
        !std::holds_alternative<T_SPFC_NTC>(m_spectrumRecord.data))
        return;
    m_result.stateDemands.resize(kLimitStateNames.size());
    std::vector<double> T;
    for (std::size_t i = 0; i < kLimitStateNames.size(); ++i) {
        const auto spectrum = MakeDesignSpectrum(m_spectrumRecord, Damping().behaviorType,
                                                 static_cast<LIMIT_STATE>(i));
        if (!spectrum) continue;
        if (m_spectrumFactor != 1.0) spectrum->ScaleBy(m_spectrumFactor);
        T_ADRS_CURVE& curve = m_result.stateDemands[i];
        spectrum->CalcPOSpectrumSRaSRv(1.0, 1.0, T, curve.Sa);
        ToAdrs(T, curve.Sa, curve.Sd);
    }
}

// The curve that the report tabulates: the method's own, or of the plot type asked for.
void CPushEvaluator::PlotCurve()
{
    const auto type =
        static_cast<PLOT_TYPE>(m_eval.plotType.value_or(static_cast<int>(m_eval.method)));
    if (type == MethodPlotType()) {
        if (m_curveMade) TakePlot(m_curve);
        return;
    }
    CPushOverCurveData data(m_doc);
    const bool shear = type == PLOT_TYPE::ShearCoeff || type == PLOT_TYPE::Drift;
    const int made = data.Calc(CurveSettings(type));
    if (made && shear && data.Factors().weight == 0.0) Say("IDS_QM_WARN_NO_WEIGHT");
    if (made) TakePlot(data);
}

void CPushEvaluator::TakePlot(const CPushOverCurveData& data)
{
    T_PLOTTED_CURVE& c = m_result.curve;
    c = {data.PlotType(),        data.Displacement(), data.Force(),
         data.MaxDisplacement(), data.MaxForce(),     {}};
    for (std::size_t i = 0; i < m_eval.monitoredNodes.size(); ++i) {
        const int node = m_eval.monitoredNodes[i];
        c.monitored.push_back({node, m_doc.Post().ExistNodePost(node), data.ExtraDisplacement(i)});
    }
}
