#include "qm_rps/pushovercalcperfptbase.h"

#include "qm_base/debugout.h"
#include "qm_base/logfile.h"
#include "qm_base/testenvmgr.h"
#include "qm_base/textformat.h"
#include "qm_rps/pushover/fema440coefficients.h"
#include "qm_rps/pushover/releaseassert.h"

namespace {

constexpr const char* kSource = "src/qm_rps/pushovercalcperfptbase";

} // namespace

CPushOverCalcPerfPtBase::CPushOverCalcPerfPtBase(CPushOverPerfPtRecord& owner)
    : m_owner(owner), m_operations(owner)
{
    m_trace.reserve(16);
}

int CPushOverCalcPerfPtBase::CalcPerformancePoint(double& Dp, double& Ap,
                                                  std::optional<double>& beta,
                                                  T_POINT2* slopeChange)
{
    m_trace.clear();
    if (Capacity().Sd.size() < 2) return End(PUSH_OUTCOME::NoCapacity, kPerfPtNone);
    double dpi = 0.0, api = 0.0, Dd = 0.0, Ad = 0.0;
    if (!FindInitialTrialPoint(Capacity().Sd[1], Capacity().Sa[1], dpi, api, Dd, Ad)) {
        ReleaseAssert(kSource, __LINE__);
        return kPerfPtNone;
    }
    T_POINT2 change;
    // A curve without a change of slope is evaluated all the same.
    const int changes = FindFirstSlopeChange(change.x, change.y);
    GDebugOut("slope change %d at %g, %g", changes, change.x, change.y);
    if (slopeChange) *slopeChange = change;
    m_iteration = 0;
    return IteratePerformancePoint(Dp, Ap, beta, dpi, api, change.x, Dd, Ad);
}

// The intersections are free of scale, so lengths stay in current units throughout.
int CPushOverCalcPerfPtBase::FindInitialTrialPoint(double D1, double A1, double& dpi, double& api,
                                                   double& Dd, double& Ad)
{
    m_outcome = {PUSH_OUTCOME::NoTrialPoint, 0};
    const auto demand = CCurveCrossing::HalfLine({D1, A1}, m_owner.Demand().View());
    if (!demand) return 0;
    m_outcome = {PUSH_OUTCOME::TrialBeyond, 0};
    const auto trial = CCurveCrossing::Vertical(demand->x, Capacity().View());
    if (!trial) return 0;
    Dd = demand->x;
    Ad = demand->y;
    dpi = trial->x;
    api = trial->y;
    return 1;
}

int CPushOverCalcPerfPtBase::FindFirstSlopeChange(double& D, double& A)
{
    m_slopeChange.reset();
    if (!m_operations.FindFirstSlopeChange(D, A)) return 0;
    m_slopeChange = {D, A};
    return 1;
}

int CPushOverCalcPerfPtBase::IntersectSegmentWithCapacity(T_POINT2 P1, T_POINT2 P2,
                                                          T_POINT2& point) const
{
    const auto crossing = CCurveCrossing::Segment(P1, P2, Capacity().View());
    if (!crossing) return 0;
    point = *crossing;
    return 1;
}

int CPushOverCalcPerfPtBase::IntersectPeriodLineWithCurve(const std::vector<double>& Sd,
                                                          const std::vector<double>& Sa, double T,
                                                          double& D, double& A) const
{
    D = A = 0.0;
    const auto crossing = CCurveCrossing::PeriodLine(T, m_owner.GetGravity(1), {Sd, Sa});
    if (!crossing) return 0;
    D = crossing->x;
    A = crossing->y;
    return 1;
}

int CPushOverCalcPerfPtBase::CalcSpectralReductionFactors(double dy, double ay, double dpi,
                                                          double api, double& SRa, double& SRv,
                                                          double& betaEff)
{
    T_PERFPT_REDUCTION r;
    const int done = m_operations.CalcReduction(dy, ay, dpi, api, r);
    m_last.kappa = r.kappa;
    if (!done) return 0;
    SRa = r.factors.SRa;
    SRv = r.factors.SRv;
    betaEff = r.betaEff;
    return 1;
}

int CPushOverCalcPerfPtBase::CalcFema440EffectivePeriod(double T0, double mu, double alpha,
                                                        int range, double& Teff)
{
    const int row = m_operations.CoefficientRow(alpha);
    m_last.row = row;
    if (CalcFema440Period(Fema440Row(row), range, T0, mu, Teff)) return 1;
    ReleaseAssert(kSource, __LINE__);
    return 0;
}

int CPushOverCalcPerfPtBase::CalcFema440EffectiveDamping(double T0, double Teff, double mu,
                                                         double alpha, int range, double& betaPct)
{
    const int row = m_operations.CoefficientRow(alpha);
    if (CalcFema440Damping(Fema440Row(row), range, T0, Teff, mu, betaPct)) return 1;
    ReleaseAssert(kSource, __LINE__);
    return 0;
}

int CPushOverCalcPerfPtBase::WriteIterationLog(const T_LOG_RECORD& r) const
{
    if (!CTestEnvMgr::IsTestEnvST("FEMA440", "yes")) return 1;
    if (m_owner.ModelPath().empty()) return 0;
    std::string head =
        FormatText("%10s, %5s, %10s, %10s, %10s, %10s", "Type", "Step", "dpi", "api", "dy", "ay");
    const char* const kind = r.kind == 0 ? "A" : r.kind == 1 ? "B" : "C";
    std::string row =
        FormatText("%10s, %5d, %10g, %10g, %10g, %10g", kind, r.step, r.dpi, r.api, r.dy, r.ay);
    const auto add = [&](const char* label, double value) {
        head += FormatText(", %10s", label);
        row += FormatText(", %10g", value);
    };
    if (r.kind == 2) add("Myu", r.mu);
    add("T_eff", r.Teff);
    add("Beta_eff", r.betaEff);
    if (r.kind >= 1) add("M", r.M);
    if (r.kind == 2) add("Tsec", r.Tsec);
    return CLogFile(m_owner.ModelPath() + "_Pushover.txt").Write(head + "\n" + row + "\n\n");
}

T_PERFPT_TRIAL& CPushOverCalcPerfPtBase::StartTrial(int trial, double dpi, double api)
{
    T_PERFPT_TRIAL& row = m_trace.emplace_back();
    row.trial = trial;
    row.dpi = dpi;
    row.api = api;
    m_last = {};
    return row;
}

int CPushOverCalcPerfPtBase::RepeatsAfter(double dpi, double api) const
{
    for (std::size_t i = m_trace.size(); i-- > 0;) {
        if (m_trace[i].dpi == dpi && m_trace[i].api == api)
            return static_cast<int>(m_trace.size() - i);
    }
    return 0;
}

int CPushOverCalcPerfPtBase::End(PUSH_OUTCOME code, int result, int count)
{
    m_outcome = {code, count};
    return result;
}
