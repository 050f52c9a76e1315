// The code spectra of Europe and Italy, and the user table.
#include "qm_cmd/etc_design_spect.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace {

struct T_SOIL_ROW {
    int type;
    char soil;
    double S, TB, TC, TD;
};

// EN 1998-1:2004 Tables 3.2 (type 1) and 3.3 (type 2).
// clang-format off
constexpr std::array<T_SOIL_ROW, 10> kEuro2003{{
    {1, 'A', 1.00, 0.15, 0.40, 2.0},
    {1, 'B', 1.20, 0.15, 0.50, 2.0},
    {1, 'C', 1.15, 0.20, 0.60, 2.0},
    {1, 'D', 1.35, 0.20, 0.80, 2.0},
    {1, 'E', 1.40, 0.15, 0.50, 2.0},
    {2, 'A', 1.00, 0.05, 0.25, 1.2},
    {2, 'B', 1.35, 0.05, 0.25, 1.2},
    {2, 'C', 1.50, 0.10, 0.25, 1.2},
    {2, 'D', 1.80, 0.10, 0.30, 1.2},
    {2, 'E', 1.60, 0.05, 0.25, 1.2},
}};

// ENV 1998-1-1:1994 Table 4.1; beta0 = 2.5, k1 = 1, k2 = 2.
constexpr std::array<T_SOIL_ROW, 3> kEuro1996{{
    {0, 'A', 1.0, 0.10, 0.40, 3.0},
    {0, 'B', 1.0, 0.15, 0.60, 3.0},
    {0, 'C', 0.9, 0.20, 0.80, 3.0},
}};

struct T_NTC_ROW {
    char soil;
    double ssMin, ssMax, ss0, ss1; // SS = ss0 - ss1 F0 ag within the bounds
    double cc, ccExp;              // CC = cc TC*^ccExp
};

// NTC 2018 Table 3.2.IV (NTC 2008 Table 3.2.V).
constexpr std::array<T_NTC_ROW, 5> kNtc{{
    {'A', 1.00, 1.00, 1.00, 0.00, 1.00,  0.00},
    {'B', 1.00, 1.20, 1.40, 0.40, 1.10, -0.20},
    {'C', 1.00, 1.50, 1.70, 0.60, 1.05, -0.33},
    {'D', 0.90, 1.80, 2.40, 1.50, 1.25, -0.50},
    {'E', 1.00, 1.60, 2.00, 1.10, 1.15, -0.40},
}};

// NTC 2018 Table 3.2.V: amplification of topography T1 to T4.
constexpr std::array<double, 4> kTopography{1.0, 1.2, 1.2, 1.4};
// clang-format on

/// EN 1998-1:2004 (3.6), NTC (3.2.4): eta = sqrt(10 / (5 + damping)) >= 0.55.
double Eta(double dampingPct)
{
    return std::max(0.55, std::sqrt(10.0 / (5.0 + dampingPct)));
}

/// ENV 1998-1-1:1994 (4.3): eta = sqrt(7 / (2 + damping)) >= 0.7.
double Eta1996(double dampingPct)
{
    return std::max(0.7, std::sqrt(7.0 / (2.0 + dampingPct)));
}

} // namespace

CETC_GDS_EURO2003::CETC_GDS_EURO2003(const T_SPFC_D& record, zql::frx::MDialog* parent,
                                     int showMode)
    : CETC_DESIGN_SPECT(record, 3, 0, showMode, parent)
{
    CETC_DESIGN_SPECT::SetBranches(CETC_GDS_EURO2003::CalcShape(CETC_GDS_EURO2003::OwnDamping()));
}

double CETC_GDS_EURO2003::OwnDamping() const
{
    return std::get<T_SPFC_EURO2003>(m_record.data).damping.value_or(5.0);
}

// EN 1998-1:2004 (3.2) to (3.5).
T_SPECT_SHAPE CETC_GDS_EURO2003::CalcShape(double dampingPct) const
{
    const auto& r = std::get<T_SPFC_EURO2003>(m_record.data);
    const auto* row = std::ranges::find_if(
        kEuro2003, [&](const T_SOIL_ROW& x) { return x.type == r.type && x.soil == r.soil; });
    const T_SOIL_ROW base = row == kEuro2003.end() ? T_SOIL_ROW{} : *row;
    const double agS = r.ag * r.S.value_or(base.S);
    T_SPECT_SHAPE s;
    s.a0 = agS;
    s.plateau = agS * Eta(dampingPct) * 2.5;
    s.TB = r.TB.value_or(base.TB);
    s.TC = r.TC.value_or(base.TC);
    s.TD = r.TD.value_or(base.TD);
    return s;
}

CETC_GDS_EURO1996_ELA::CETC_GDS_EURO1996_ELA(const T_SPFC_D& record, zql::frx::MDialog* parent)
    : CETC_DESIGN_SPECT(record, 3, 0, 0, parent)
{
    SetBranches(CETC_GDS_EURO1996_ELA::CalcShape(CETC_GDS_EURO1996_ELA::OwnDamping()));
}

double CETC_GDS_EURO1996_ELA::OwnDamping() const
{
    return std::get<T_SPFC_EURO1996>(m_record.data).damping.value_or(5.0);
}

// ENV 1998-1-1:1994 (4.1) to (4.4).
T_SPECT_SHAPE CETC_GDS_EURO1996_ELA::CalcShape(double dampingPct) const
{
    const auto& r = std::get<T_SPFC_EURO1996>(m_record.data);
    const auto* row = std::ranges::find(kEuro1996, r.soil, &T_SOIL_ROW::soil);
    const T_SOIL_ROW base = row == kEuro1996.end() ? T_SOIL_ROW{} : *row;
    T_SPECT_SHAPE s;
    s.a0 = r.ag * base.S;
    s.plateau = r.ag * base.S * Eta1996(dampingPct) * 2.5;
    s.TB = base.TB;
    s.TC = base.TC;
    s.TD = base.TD;
    return s;
}

CETC_GDS_NTC::CETC_GDS_NTC(const T_SPFC_D& record, LIMIT_STATE state, zql::frx::MDialog* parent)
    : CETC_DESIGN_SPECT(record, 3, static_cast<int>(state), 0, parent)
{
    SetBranches(CETC_GDS_NTC::CalcShape(CETC_GDS_NTC::OwnDamping()));
}

double CETC_GDS_NTC::OwnDamping() const
{
    return std::get<T_SPFC_NTC>(m_record.data).damping.value_or(5.0);
}

// NTC 2018 (3.2.2) to (3.2.8); NTC 2008 has the same ordinates.
T_SPECT_SHAPE CETC_GDS_NTC::CalcShape(double dampingPct) const
{
    const auto& r = std::get<T_SPFC_NTC>(m_record.data);
    const auto& state = r.states[static_cast<std::size_t>(m_limitState)];
    const auto* row = std::ranges::find(kNtc, r.soil, &T_NTC_ROW::soil);
    if (!state || row == kNtc.end()) return {};
    const double SS =
        std::clamp(row->ss0 - row->ss1 * state->F0 * state->ag, row->ssMin, row->ssMax);
    const double CC = row->cc * std::pow(state->TCstar, row->ccExp);
    const double agS = state->ag * SS * kTopography[static_cast<std::size_t>(r.topography - 1)];
    T_SPECT_SHAPE s;
    s.a0 = agS;
    s.plateau = agS * Eta(dampingPct) * state->F0;
    s.TC = CC * state->TCstar;
    s.TB = s.TC / 3.0;
    s.TD = 4.0 * state->ag + 1.6;
    return s;
}

CETC_GDS_USER::CETC_GDS_USER(const T_SPFC_D& record, zql::frx::MDialog* parent)
    : CETC_DESIGN_SPECT(record, 3, 0, 0, parent)
{
    CETC_GDS_USER::CalcCurrentPOSpectra();
}

std::optional<double> CETC_GDS_USER::GravitySi() const
{
    return std::get<T_SPFC_USER>(m_record.data).gravity;
}

// The corner is the last period with the largest ordinate; left of it the table is the
// acceleration branch, right of it the velocity branch, each continued beyond the corner.
void CETC_GDS_USER::CalcCurrentPOSpectra()
{
    const auto& r = std::get<T_SPFC_USER>(m_record.data);
    std::size_t corner = 0;
    for (std::size_t i = 0; i < r.Sa.size(); ++i) {
        if (r.Sa[i] >= r.Sa[corner]) corner = i;
    }
    m_T = r.T;
    m_A = r.Sa;
    for (double& Sa : m_A)
        Sa *= m_factor;
    m_V = m_A;
    const double largest = r.Sa.empty() ? 0.0 : m_A[corner];
    for (std::size_t i = 0; i < r.T.size(); ++i) {
        if (i > corner) m_A[i] = largest;
        if (i < corner) m_V[i] = r.T[i] > 0.0 ? largest * r.T[corner] / r.T[i] : 1e300;
    }
    m_shape.TC = r.T.empty() ? 0.0 : r.T[corner];
}

double CETC_GDS_USER::CalcSaAt(double T) const
{
    const auto& r = std::get<T_SPFC_USER>(m_record.data);
    if (T <= r.T.front()) return m_factor * r.Sa.front();
    if (T >= r.T.back()) return m_factor * r.Sa.back();
    const auto it = std::ranges::upper_bound(r.T, T);
    const auto i = static_cast<std::size_t>(it - r.T.begin());
    const double w = (T - r.T[i - 1]) / (r.T[i] - r.T[i - 1]);
    return m_factor * (r.Sa[i - 1] + w * (r.Sa[i] - r.Sa[i - 1]));
}
