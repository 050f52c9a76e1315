#include "qm_rps/pushover/evaluation/pushremarks.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_db/sectionproperties.h"
#include "qm_rps/pushover/adrsformulas.h"
#include "qm_rps/pushover/evaluation/missedvertex.h"

#include <algorithm>
#include <cmath>
#include <initializer_list>

namespace {

using zql::lib::MMSGFunction;

// Beyond these a unit, a mass or a mode is likelier to be wrong than the building to be so.
constexpr double kPeriodsApart = 0.30;       // of the mode's period
constexpr double kLargestDrift = 0.10;       // of the control node's height
constexpr double kLargestShear = 3.0;        // of the weight
constexpr double kParticipationApart = 0.01; // of what masses and shape give
constexpr double kCodeDamping = 5.0;         // per cent, of the spectra that are reduced
constexpr double kSameDamping = 1e-9;
constexpr double kMissedVertex = 0.01; // of the curve's largest force or displacement

class CRemarks {
public:
    CRemarks(CDBDoc& doc, const T_SPFC_D& spectrum, T_PUSH_EVALUATION& result)
        : m_doc(doc), m_spectrum(spectrum), m_result(result)
    {
    }

    void OnDamping();
    void OnSpectrum();
    void OnPeriods();
    void OnFigures();
    void OnParticipation();
    void OnSteps();
    void OnStiffness();

private:
    void Say(const char* key, std::initializer_list<std::string_view> values)
    {
        m_result.messages.push_back({key, MMSGFunction::Format(key, values)});
    }
    std::string Length(double v) const { return Number(v) + " " + Name(m_result.units.length); }
    std::string Force(double v) const { return Number(v) + " " + Name(m_result.units.force); }
    static std::string Number(double v) { return FormatText("%.4g", v); }
    static std::string Name(auto unit) { return std::string(NameOf(unit)); }
    std::string Method() const { return MethodName(m_result.eval.method); }

    void OnElasticPoint(double elastic);
    void OnEqualStates();
    std::optional<double> OwnDamping() const;
    double ControlHeight() const;
    double LargestAnswer() const;

    CDBDoc& m_doc;
    const T_SPFC_D& m_spectrum;
    T_PUSH_EVALUATION& m_result;
};

/// Damping that a record states, per cent; empty for kinds that state none.
std::optional<double> CRemarks::OwnDamping() const
{
    const auto stated = [](const auto& record) -> std::optional<double> {
        if constexpr (requires { record.damping; })
            return record.damping.value_or(kCodeDamping);
        else
            return std::nullopt;
    };
    return std::visit(stated, m_spectrum.data);
}

void CRemarks::OnElasticPoint(double elastic)
{
    constexpr double kSameAs5 = 0.001; // per cent: elastic without any setting
    const auto& p = m_result.point;
    if (m_result.result != 2 || !p || !p->damping || !(*p->damping < elastic)) return;
    if (std::fabs(*p->damping - kCodeDamping) < kSameAs5) return;
    Say("IDS_QM_WARN_ELASTIC_BY_DAMPING",
        {Number(*p->damping), Number(elastic), Length(p->D), Force(p->V)});
}

void CRemarks::OnDamping()
{
    const double elastic = m_result.eval.elasticDamping.value_or(kCodeDamping);
    const bool other = std::fabs(elastic - kCodeDamping) > kSameDamping;
    const std::optional<double> own = OwnDamping();
    if (m_result.IsTarget()) {
        const double used = own.value_or(kCodeDamping);
        if (m_result.eval.elasticDamping && std::fabs(elastic - used) > kSameDamping)
            Say("IDS_QM_WARN_DAMPING_UNUSED", {Number(elastic), Method(), Number(used)});
        return;
    }
    OnElasticPoint(elastic);
    if (m_result.eval.method == PUSH_METHOD::Fema440 && other)
        Say("IDS_QM_WARN_DAMPING_FEMA", {Number(elastic)});
    if (own && std::fabs(*own - kCodeDamping) > kSameDamping)
        Say("IDS_QM_WARN_REDUCED_TWICE", {m_spectrum.name, Number(*own), Method()});
}

// Kinds of record by the code that the method is of; a table of ordinates suits them all.
void CRemarks::OnSpectrum()
{
    enum { ATC40, EC8_2004, EC8_1994, NTC, USER }; // alternatives of T_SPFC_D::data
    const auto kind = m_spectrum.data.index();
    const PUSH_METHOD method = m_result.eval.method;
    const bool ntc = method >= PUSH_METHOD::Ntc2008;
    if (ntc && kind != NTC) OnEqualStates();
    const bool suits = kind == USER                     ? true
                       : ntc                            ? kind == NTC
                       : method == PUSH_METHOD::Ec8Opcm ? kind == EC8_2004 || kind == EC8_1994
                                                        : kind == ATC40;
    if (suits || m_result.demand.Sa.empty()) return;
    const char* const made = ntc                              ? kSpectrumKinds[NTC]
                             : method == PUSH_METHOD::Ec8Opcm ? kSpectrumKinds[EC8_2004]
                                                              : kSpectrumKinds[ATC40];
    Say("IDS_QM_WARN_SPECTRUM_KIND", {Method(), made, m_spectrum.name, kSpectrumKinds[kind],
                                      Number(*std::ranges::max_element(m_result.demand.Sa))});
    if (kind == NTC)
        if (const auto& slv = std::get<T_SPFC_NTC>(m_spectrum.data).states[2])
            Say("IDS_QM_WARN_ONE_STATE", {Method(), m_spectrum.name, Number(slv->ag)});
}

void CRemarks::OnEqualStates()
{
    const auto demanded = std::ranges::find_if(m_result.limitStates,
                                               [](const auto& r) { return r.demand.has_value(); });
    if (demanded == m_result.limitStates.end()) return;
    Say("IDS_QM_WARN_EQUAL_STATES", {m_spectrum.name, Method(), Length(*demanded->demand)});
}

// A table of ordinates keeps its first and last value outside its periods.
void CRemarks::OnPeriods()
{
    const auto* user = std::get_if<T_SPFC_USER>(&m_spectrum.data);
    if (!user || user->T.empty()) return;
    for (const T_TARGET_DISP& t : m_result.targets) {
        if (!t.found || (t.Tstar >= user->T.front() && t.Tstar <= user->T.back())) continue;
        Say("IDS_QM_WARN_OUTSIDE_PERIODS",
            {Number(t.Tstar), m_spectrum.name, Number(user->T.front()), Number(user->T.back()),
             Number(t.Se)});
        return; // all states have the same period
    }
}

/// Height of the control node above or below the node that is farthest from it; current units.
double CRemarks::ControlHeight() const
{
    const auto& nodes = m_doc.Data().Model().nodes;
    const auto control = nodes.find(m_result.loadCase.controlNode);
    if (control == nodes.end()) return 0.0;
    double height = 0.0;
    for (const auto& [id, node] : nodes)
        height = std::max(height, std::fabs(control->second.xyz[2] - node.xyz[2]));
    return FromSi(height, m_result.units, kDimLength);
}

/// Control displacement of the answer that lies on the curve; without one the end of the curve.
double CRemarks::LargestAnswer() const
{
    const double end =
        std::fabs(m_result.factors.gamma) * *std::ranges::max_element(m_result.capacity.Sd);
    if (m_result.point) return m_result.point->D;
    double largest = 0.0;
    for (const T_LIMIT_ROW& row : m_result.limitStates)
        largest = std::max(largest, std::fabs(row.demand.value_or(0.0)));
    return largest > 0.0 ? std::min(largest, end) : end;
}

void CRemarks::OnFigures()
{
    const auto& [Sd, Sa] = m_result.capacity;
    const T_PUSH_FACTORS& f = m_result.factors;
    if (m_result.loadCase.direction > 2) return;
    const auto mode = m_doc.Data().Model().modes.find(f.mode);
    const double T = mode == m_doc.Data().Model().modes.end() ? 0.0 : mode->second.period;
    const double T0 = Sa[1] > 0.0 ? SecantPeriod(Sd[1], Sa[1], f.gravity) : 0.0;
    if (T > 0.0 && T0 > 0.0 && std::fabs(T0 / T - 1.0) > kPeriodsApart)
        Say("IDS_QM_WARN_PERIODS",
            {Number(T0), std::to_string(f.mode), Number(T), FormatText("%.3g", T0 / T)});
    const double height = ControlHeight(), D = LargestAnswer();
    if (height > 0.0 && D > kLargestDrift * height)
        Say("IDS_QM_WARN_LARGE_DRIFT", {Length(D), Number(100.0 * D / height), Length(height)});
    const double W = f.weight != 0.0 ? f.weight : std::fabs(f.mass) * f.gravity;
    const double V = *std::ranges::max_element(Sa) * std::fabs(f.mass * f.alpha) * f.gravity;
    if (W > 0.0 && V > kLargestShear * W)
        Say("IDS_QM_WARN_LARGE_SHEAR", {Force(V), FormatText("%.3g", V / W), Force(W)});
}

// The recorded factor is of a shape in its own scale, so that products with the control node's
// component are compared.
void CRemarks::OnParticipation()
{
    const T_PUSH_FACTORS& f = m_result.factors;
    const int d = m_result.loadCase.direction - 1;
    T_MPAF_D factor;
    T_MPAM_D percent;
    const auto mode = m_doc.Data().Model().modes.find(f.mode);
    if (!f.eigenBased || f.oblique || d > 2 || mode == m_doc.Data().Model().modes.end() ||
        !m_doc.Post().CalcEiParticipation(f.mode, factor, percent))
        return;
    const auto shape = mode->second.shape.find(m_result.loadCase.controlNode);
    if (shape == mode->second.shape.end()) return;
    const auto at = static_cast<std::size_t>(d);
    const double gamma = std::fabs(shape->second[at] * factor.factor[at]);
    const double alpha = percent.percent[at] / 100.0;
    const auto apart = [](double recorded, double own) {
        return own > 0.0 && std::fabs(recorded / own - 1.0) > kParticipationApart;
    };
    if (apart(f.gamma, gamma) || apart(f.alpha, alpha))
        Say("IDS_QM_WARN_PARTICIPATION", {std::to_string(f.mode), Number(f.gamma), Number(f.alpha),
                                          Number(gamma), Number(alpha)});
}

// The curve of a push of our own is exact at its vertices; an evaluation reads its steps. How far
// the line through these misses a vertex is counted in the plane of the whole curve, 1 by 1.
void CRemarks::OnSteps()
{
    T_MISSED_VERTEX worst;
    const auto push = FindPush(m_doc.Data().Model(), m_result.eval.push);
    if (!push) return;
    IPushRun* const run = m_doc.Post().RunOf(push->key, push->turn);
    const int node = m_doc.Data().Model().pushovers.at(push->key).controlNode;
    if (!run || !FindMissedVertex(*run, node, worst) || !(worst.share > kMissedVertex)) return;
    const T_UNITS& units = m_result.units;
    const int direction = m_result.loadCase.direction;
    const double d = FromSi(worst.displacement, units, DisplacementDim(direction));
    const double V = FromSi(worst.baseReaction, units, ReactionDim(direction));
    Say("IDS_QM_WARN_COARSE_STEPS",
        {std::to_string(worst.steps), FormatText("%.2g", 100.0 * worst.share), Number(d),
         Number(V)});
}

/// Of a push of our own: another solver has its own stiffness.
void CRemarks::OnStiffness()
{
    const auto push = FindPush(m_doc.Data().Model(), m_result.eval.push);
    if (!push || !m_doc.Post().RunOf(push->key, push->turn)) return;
    const std::string text = StiffnessFactorText(m_doc.Data().Model());
    if (!text.empty()) m_result.messages.push_back({"IDS_QM_FACTORS_COUNT", text});
}

} // namespace

void AddRemarks(CDBDoc& doc, const T_SPFC_D& spectrum, T_PUSH_EVALUATION& result)
{
    if (result.capacity.Sd.size() < 2 || !(result.factors.gamma > 0.0)) return;
    CRemarks remarks(doc, spectrum, result);
    remarks.OnDamping();
    remarks.OnSpectrum();
    remarks.OnPeriods();
    remarks.OnFigures();
    remarks.OnParticipation();
    remarks.OnSteps();
    remarks.OnStiffness();
}
