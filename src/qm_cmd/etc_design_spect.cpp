#include "qm_cmd/etc_design_spect.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr double kSamePeriod = 1e-9; // s; closer periods are one grid point
constexpr double kFarLeft = 1e300;   // velocity branch at T = 0, where 1/T has no value

/// 0, 0.01 ... 10 s and the corner periods, ascending, each once.
std::vector<double> CodeGrid(const T_SPECT_SHAPE& shape)
{
    std::vector<double> T;
    T.reserve(1004);
    for (const double corner : {shape.TB, shape.TC, shape.TD}) {
        if (std::isfinite(corner)) T.push_back(corner);
    }
    const std::vector<double> corners = T;
    for (int i = 0; i <= 1000; ++i) {
        const double t = i / 100.0;
        const auto same = [t](double c) { return std::fabs(c - t) < kSamePeriod; };
        if (std::ranges::none_of(corners, same)) T.push_back(t);
    }
    std::ranges::sort(T);
    T.erase(std::unique(T.begin(), T.end(),
                        [](double a, double b) { return std::fabs(a - b) < kSamePeriod; }),
            T.end());
    return T;
}

} // namespace

CETC_DESIGN_SPECT::CETC_DESIGN_SPECT(const T_SPFC_D& record, int behaviorType, int limitState,
                                     int showMode, zql::frx::MDialog* /*parent*/)
    : m_record(record), m_behaviorType(behaviorType), m_limitState(limitState), m_showMode(showMode)
{
    // A derived spectrum computes its own branches at the end of its constructor.
    if (std::holds_alternative<T_SPFC_ATC40>(m_record.data))
        CETC_DESIGN_SPECT::CalcCurrentPOSpectra();
}

// ATC-40 (1996) 4.4.3: Ts = Cv / (2.5 Ca), T0 = 0.2 Ts. The shape has no damping of its own.
T_SPECT_SHAPE CETC_DESIGN_SPECT::CalcShape(double) const
{
    const auto& r = std::get<T_SPFC_ATC40>(m_record.data);
    const double Ts = r.Cv / (2.5 * r.Ca);
    T_SPECT_SHAPE s;
    s.a0 = r.Ca;
    s.plateau = 2.5 * r.Ca;
    s.TB = 0.2 * Ts;
    s.TC = Ts;
    return s;
}

bool CETC_DESIGN_SPECT::HasFloors() const
{
    const auto* r = std::get_if<T_SPFC_ATC40>(&m_record.data);
    return r && r->floors.value_or(true);
}

void CETC_DESIGN_SPECT::SetBranches(const T_SPECT_SHAPE& shape)
{
    m_shape = shape;
    m_shape.a0 *= m_factor;
    m_shape.plateau *= m_factor;
    m_T = CodeGrid(m_shape);
    m_A.resize(m_T.size());
    m_V.resize(m_T.size());
    for (std::size_t i = 0; i < m_T.size(); ++i) {
        m_A[i] = m_shape.AccelAt(m_T[i]);
        m_V[i] = m_T[i] > 0.0 ? m_shape.VelocityAt(m_T[i]) : kFarLeft;
    }
}

void CETC_DESIGN_SPECT::CalcCurrentPOSpectra()
{
    SetBranches(CalcShape(OwnDamping()));
}

void CETC_DESIGN_SPECT::CalcPOSpectrumSRaSRv(double SRa, double SRv, std::vector<double>& T,
                                             std::vector<double>& Sa) const
{
    T_SPEC_REDUCTION f{SRa, SRv};
    if (HasFloors()) ApplyReductionFloors(m_behaviorType, f);
    T = m_T;
    Sa.resize(m_T.size());
    for (std::size_t i = 0; i < m_T.size(); ++i)
        Sa[i] = std::min(f.SRa * m_A[i], f.SRv * m_V[i]);
}

double CETC_DESIGN_SPECT::CalcPOOrdinate(double SRa, double SRv, std::size_t i) const
{
    T_SPEC_REDUCTION f{SRa, SRv};
    if (HasFloors()) ApplyReductionFloors(m_behaviorType, f);
    return std::min(f.SRa * m_A[i], f.SRv * m_V[i]);
}

int CETC_DESIGN_SPECT::CalcPOSpectrumByDamping(double betaPct, std::vector<double>& T,
                                               std::vector<double>& Sa) const
{
    T_SPEC_REDUCTION f;
    if (!CalcSpectralReduction(betaPct, f)) return 0;
    if (HasDampingRule()) {
        const T_SPECT_SHAPE shape = CalcShape(betaPct);
        T = m_T;
        Sa.resize(T.size());
        std::ranges::transform(T, Sa.begin(), [&](double t) { return m_factor * shape.SaAt(t); });
        return 1;
    }
    CalcPOSpectrumSRaSRv(f.SRa, f.SRv, T, Sa);
    return 1;
}

void CETC_DESIGN_SPECT::ScaleBy(double factor)
{
    m_factor = factor;
    CalcCurrentPOSpectra();
}

double CETC_DESIGN_SPECT::CalcSaAt(double T) const
{
    return m_shape.SaAt(T);
}

std::unique_ptr<CETC_DESIGN_SPECT> MakeDesignSpectrum(const T_SPFC_D& record, int behaviorType,
                                                      LIMIT_STATE state)
{
    if (std::holds_alternative<T_SPFC_EURO2003>(record.data))
        return std::make_unique<CETC_GDS_EURO2003>(record, nullptr, 0);
    if (std::holds_alternative<T_SPFC_EURO1996>(record.data))
        return std::make_unique<CETC_GDS_EURO1996_ELA>(record);
    if (std::holds_alternative<T_SPFC_USER>(record.data))
        return std::make_unique<CETC_GDS_USER>(record);
    if (const auto* ntc = std::get_if<T_SPFC_NTC>(&record.data)) {
        if (!ntc->states[static_cast<std::size_t>(state)]) return nullptr;
        return std::make_unique<CETC_GDS_NTC>(record, state);
    }
    return std::make_unique<CETC_DESIGN_SPECT>(record, behaviorType, static_cast<int>(state), 0);
}
