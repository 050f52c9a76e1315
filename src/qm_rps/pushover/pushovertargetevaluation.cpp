#include "qm_rps/pushover/pushovertargetevaluation.h"

#include "qm_rps/pushover/adrsformulas.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr double kDamageDrift = 0.003; // masonry DL
constexpr double kSldDrift = 0.005;    // NTC 7.3.6.1: infills that take part in the deformation
constexpr double kStrengthLeft = 0.8;  // masonry SD
constexpr double kLimitQ = 3.0;        // masonry q*
constexpr int kMaxFits = 50;
constexpr double kSameDm = 1e-6; // relative

std::vector<T_LIMIT_ROW> NamedRows(std::initializer_list<const char*> names)
{
    std::vector<T_LIMIT_ROW> rows;
    for (const char* name : names)
        rows.push_back({name, {}, {}, {}, {}, {}});
    return rows;
}

} // namespace

std::vector<T_LIMIT_ROW> CPushOverTargetEvaluation::EmptyRows(PUSH_METHOD method)
{
    return method == PUSH_METHOD::Ec8Opcm ? NamedRows({"DL", "SD", "NC"})
                                          : NamedRows({"SLO", "SLD", "SLV", "SLC"});
}

CPushOverTargetEvaluation::CPushOverTargetEvaluation(T_TARGET_INPUT input) : m_in(std::move(input))
{
    m_fromOrigin = m_in.capacity;
    m_fromOrigin.Sd.insert(m_fromOrigin.Sd.begin(), 0.0);
    m_fromOrigin.Sa.insert(m_fromOrigin.Sa.begin(), 0.0);
}

T_TARGET_DISP CPushOverTargetEvaluation::CalcTarget(const T_TARGET_SPECTRUM& spectrum,
                                                    bool capAt3) const
{
    T_BILINEAR b = *m_bilinear;
    const double T = SecantPeriod(b.dy, b.ay, m_in.gravity);
    T_TARGET_DISP t = CalcTargetDisp(b, m_in.gravity, spectrum.SaAt(T), spectrum.Tc, capAt3);
    t.mStar = m_in.mStar;
    t.Fy = b.ay * m_in.gravity * m_in.mStar;
    t.iterations = m_fits;
    return t;
}

// EN 1998-1 B.3: the displacement of the plastic mechanism is first that of the peak, then, where
// iteration is asked for, the target displacement found with it.
int CPushOverTargetEvaluation::IterateBilinear()
{
    const T_ADRS_VIEW curve = m_fromOrigin.View();
    const double last = *std::ranges::max_element(curve.Sd);
    T_CURVE_PLACE dm = PlaceAt(curve, FirstMaximum(m_fromOrigin.Sa));
    if (!FitEc8(dm)) return 0;
    while (m_in.options.iterate && m_in.spectra[0].SaAt) {
        const T_TARGET_DISP t = CalcTarget(m_in.spectra[0], true);
        if (!t.found) break;
        const T_CURVE_PLACE next = FirstPlaceAt(curve, std::min(t.dt, last));
        if (std::fabs(next.Sd - dm.Sd) < kSameDm * std::fabs(next.Sd)) break;
        if (m_fits > kMaxFits) {
            m_bilinear.reset();
            m_outcome = {PUSH_OUTCOME::TargetCycles, 0, {dm.Sd, next.Sd}};
            return 0;
        }
        dm = next;
        if (!FitEc8(dm)) return 0;
    }
    return 1;
}

int CPushOverTargetEvaluation::FitEc8(const T_CURVE_PLACE& dm)
{
    m_bilinear.reset();
    T_BILINEAR b;
    if (!CalcBilinearEc8(m_fromOrigin.View(), dm, m_in.options.peak, b)) return 0;
    m_bilinear = b;
    ++m_fits;
    return 1;
}

int CPushOverTargetEvaluation::CalcBilinear()
{
    m_bilinear.reset();
    m_fits = 0;
    m_outcome = {PUSH_OUTCOME::BilinearTooShort, 0};
    if (m_in.capacity.Sd.size() < 2) return 0;
    if (m_in.options.rule == BILINEAR_RULE::Ec8) return IterateBilinear();
    T_BILINEAR b;
    if (!CalcBilinearNtc(m_fromOrigin.View(), m_in.options, b)) return 0;
    m_bilinear = b;
    m_fits = 1;
    return 1;
}

void CPushOverTargetEvaluation::FindSteps(std::span<const double> demands)
{
    m_demandSteps = FindNearestSteps(m_in.capacity.Sd, demands);
    for (std::size_t i = 0; i < demands.size(); ++i) {
        if (m_demandSteps[i] >= -1) m_rows[i].demandStep = m_demandSteps[i];
    }
}

void CPushOverTargetEvaluation::SetDemand(std::size_t row, double dt)
{
    m_rows[row].demand = m_in.gamma * dt;
    AddGuide(T_GUIDE_LINE::KIND::Demand, dt, m_rows[row].name + "(Dem.)");
}

void CPushOverTargetEvaluation::AddGuide(T_GUIDE_LINE::KIND kind, double Sd,
                                         const std::string& label)
{
    m_guides.push_back({kind, Sd, label});
}

void CPushOverTargetEvaluation::FinishOutcome()
{
    const auto found = std::ranges::find_if(m_targets, [](const auto& t) { return t.found; });
    if (found == m_targets.end()) {
        m_outcome = {PUSH_OUTCOME::NoTarget, 0};
        for (const T_TARGET_DISP& t : m_targets) {
            if (t.outcome.code != PUSH_OUTCOME::None) m_outcome = t.outcome;
        }
        return;
    }
    const auto& d = m_in.capacity.Sd;
    const double last = m_in.gamma * *std::ranges::max_element(d);
    const auto off = [&](bool beyond) {
        return std::ranges::any_of(m_rows, [&](const T_LIMIT_ROW& r) {
            return r.demand && !r.demandStep && (std::fabs(*r.demand) > std::fabs(last)) == beyond;
        });
    };
    const bool zero = std::ranges::any_of(
        m_targets, [](const T_TARGET_DISP& t) { return t.found && t.Se == 0.0; });
    m_outcome = {zero         ? PUSH_OUTCOME::ZeroDemand
                 : off(true)  ? PUSH_OUTCOME::TargetBeyond
                 : off(false) ? PUSH_OUTCOME::TargetBelow
                              : PUSH_OUTCOME::TargetFound,
                 0};
}

int CPushOverTargetEvaluation::UpdateTargetDispDataEC8()
{
    m_rows = NamedRows({"DL", "SD", "NC"});
    m_demandSteps.assign(3, kStepNone);
    if (!CalcBilinear()) return 0;
    if (!m_in.spectra[0].SaAt) {
        m_outcome = {PUSH_OUTCOME::NoTarget, 0};
        return 0;
    }
    m_targets = {CalcTarget(m_in.spectra[0], true)};
    const T_TARGET_DISP& t = m_targets.front();
    if (t.found) { // EN 1998-3: damage limitation, significant damage, near collapse
        const std::array<double, 3> demands{t.dt / 2.5, t.dt, t.dt * 1.5};
        for (std::size_t i = 0; i < demands.size(); ++i)
            SetDemand(i, demands[i]);
        FindDlSdNcSteps(demands);
    }
    FinishOutcome();
    return t.found ? 1 : 0;
}

int CPushOverTargetEvaluation::UpdateTargetDispDataMasonry()
{
    const int found = UpdateTargetDispDataEC8();
    m_rows.push_back({"q*=3", {}, {}, {}, {}, {}});
    const int capacities = UpdateTargetDispDataCapacity();
    m_noDrop = m_noDrop && capacities;
    return found;
}

// Capacity side of masonry: drift-based DL, strength-based SD, displacement where q* reaches 3.
int CPushOverTargetEvaluation::UpdateTargetDispDataCapacity()
{
    if (!m_bilinear) return 0;
    const auto& [d, V] = m_in.capacity;
    const int last = static_cast<int>(d.size()) - 1;
    const int peak = static_cast<int>(FirstMaximum(V));
    const std::optional<int> driftStep = FindDriftStep(peak, last, kDamageDrift, m_in.drift);
    const int dlStep = driftStep.value_or(last);
    const double dl = d[static_cast<std::size_t>(dlStep)];
    const auto drop = FindStrengthDrop(d, V, peak, kStrengthLeft * m_bilinear->ay, m_bilinear->du);
    m_noDrop = !drop;
    const T_LEVEL_CROSSING sd = drop.value_or(T_LEVEL_CROSSING{d.back(), last});

    // Gamma twice where q* is not computed below: kept as it stands, on purpose.
    double dq = m_in.gamma * std::max(dl, sd.d);
    int dqStep = last;
    if (!m_targets.empty() && m_targets.front().Tstar != 0.0) {
        const T_TARGET_DISP& t = m_targets.front();
        dq = CalcBehaviourDisp(*m_bilinear, m_in.gravity, t.Tstar, t.Tc, kLimitQ);
        const int step = FindNearestSteps(d, std::array{dq}).front();
        if (step != kStepNone) dqStep = step;
    }
    const std::array<std::pair<double, int>, 4> found{
        {{dl, dlStep}, {sd.d, sd.step}, {0.0, 0}, {dq, dqStep}}};
    for (const std::size_t row : {0U, 1U, 3U}) {
        if (row == 0 && !driftStep) continue;
        m_rows[row].capacity = m_in.gamma * found[row].first;
        m_rows[row].capacityStep = found[row].second;
    }
    if (driftStep) AddGuide(T_GUIDE_LINE::KIND::Capacity, dl, "DL(Cap.)");
    AddGuide(T_GUIDE_LINE::KIND::Capacity, sd.d, "SD(Cap.)");
    AddGuide(T_GUIDE_LINE::KIND::Qstar3, dq, "q*=3(Displ.)");
    if (!m_rows[0].demand) return 1;
    const auto remark = [](bool ok) { return ok ? "OK" : "N/A"; };
    m_rows[0].remark = driftStep ? remark(*m_rows[0].capacity > *m_rows[0].demand) : kNotChecked;
    m_rows[1].remark =
        remark(std::min(*m_rows[1].capacity, *m_rows[3].capacity) > *m_rows[1].demand);
    return 1;
}

int CPushOverTargetEvaluation::UpdateTargetDispDataNTC(PUSH_METHOD code)
{
    m_rows = NamedRows({"SLO", "SLD", "SLV", "SLC"});
    m_demandSteps.assign(4, kStepNone);
    m_targets.assign(4, {});
    if (!CalcBilinear()) return 0;
    std::array<double, 4> demands{};
    for (std::size_t i = 0; i < demands.size(); ++i) {
        demands[i] = -1.0; // lies on no curve: a state without a target finds no step
        if (!m_in.spectra[i].SaAt) continue;
        m_targets[i] = CalcTarget(m_in.spectra[i], false); // no limit of 3 det here, on purpose
        if (!m_targets[i].found) continue;
        demands[i] = m_targets[i].dt;
        SetDemand(i, demands[i]);
    }
    FindNTC2008Steps(demands);
    FinishOutcome();

    const int last = static_cast<int>(m_in.capacity.Sd.size()) - 1;
    const auto peak = static_cast<int>(FirstMaximum(m_in.capacity.Sa));
    const auto driftStep = FindDriftStep(peak, last, kSldDrift, m_in.drift);
    if (driftStep) m_rows[1].capacityStep = m_rows[2].capacityStep = *driftStep;
    for (const std::size_t row : {0U, 1U}) // both follow from the drift
        if (!driftStep && m_rows[row].demand) m_rows[row].remark = kNotChecked;
    if (code == PUSH_METHOD::Ntc2018)
        UpdateTargetDispDataCapacity_NTC2018(driftStep);
    else if (driftStep)
        UpdateTargetDispDataCapacity_NTC2008(*driftStep);
    return std::ranges::any_of(m_targets, [](const auto& t) { return t.found; }) ? 1 : 0;
}

void CPushOverTargetEvaluation::SetCapacity(std::size_t row, double mdof, const char* failing)
{
    m_rows[row].capacity = mdof;
    if (m_rows[row].demand) m_rows[row].remark = mdof > *m_rows[row].demand ? "OK" : failing;
    if (m_in.gamma != 0.0)
        AddGuide(T_GUIDE_LINE::KIND::Capacity, mdof / m_in.gamma, m_rows[row].name + "(Cap.)");
}

void CPushOverTargetEvaluation::UpdateTargetDispDataCapacity_NTC2008(int driftStep)
{
    const double sld = m_in.gamma * m_in.capacity.Sd[static_cast<std::size_t>(driftStep)];
    SetCapacity(0, 0.67 * sld, "NG");
    SetCapacity(1, sld, "NG");
}

void CPushOverTargetEvaluation::UpdateTargetDispDataCapacity_NTC2018(std::optional<int> driftStep)
{
    const auto& [d, V] = m_in.capacity;
    if (driftStep) {
        const double level = 0.75 * V[static_cast<std::size_t>(*driftStep)];
        // No Gamma on the SLD capacity, on purpose.
        const double sld = std::min(FindRise(d, V, level), m_bilinear->dy);
        SetCapacity(0, 0.67 * sld, "NG");
        SetCapacity(1, sld, "NG");
    }
    const double slc = m_in.gamma * m_bilinear->du;
    SetCapacity(2, 0.75 * slc, "NG");
    SetCapacity(3, slc, "NG");
}
