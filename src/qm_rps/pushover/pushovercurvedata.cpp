#include "qm_rps/pushover/pushovercurvedata.h"

#include "qm_base/msgfunction.h"
#include "qm_db/recordfacts.h"
#include "qm_db/storyload.h"
#include "qm_rps/pushover/adrsformulas.h"

#include <algorithm>
#include <cmath>
#include <numeric>

using zql::lib::MMSGFunction;

namespace {

constexpr int kDirectionZ = 3;
constexpr int kUniformAcceleration = 1, kModeShape = 2, kModeShapeStoreyMass = 3;
constexpr double kNoWeight = 1e-19, kNoHeight = 1e-19; // divisors where there is none
constexpr double kNoMass = 1e-15;
constexpr double kNoParticipation = 1e-12;

} // namespace

int CPushOverCurveData::Calc(const T_PUSH_CURVE_SETTINGS& settings)
{
    if (!BeforePreparePOCurveData(settings)) return 0;
    CalcConversion();
    return PreparePOCurveData();
}

/// The direction of control: an axis, of a turned push what its loads were turned to.
void CPushOverCurveData::FindDirection()
{
    m_along = {};
    m_factors.oblique = false;
    const IPushRun* const run =
        m_settings.turn > 0 ? m_doc.Post().RunOf(m_settings.pushover, m_settings.turn) : nullptr;
    if (!IsRotation() && !run) m_along[static_cast<std::size_t>(Direction())] = 1.0;
    if (IsRotation() || !run) return;
    m_polc.name = TurnedName(m_polc.name, run->Head().angle);
    std::copy_n(run->Head().control.begin(), 3, m_along.begin());
    const auto largest =
        std::ranges::max_element(m_along, {}, [](double c) { return std::fabs(c); });
    m_polc.direction = static_cast<int>(largest - m_along.begin()) + 1;
    m_factors.oblique = std::fabs(*largest) != 1.0;
}

double CPushOverCurveData::Along(const std::array<double, 3>& v) const
{
    return std::inner_product(v.begin(), v.end(), m_along.begin(), 0.0);
}

/// Of a direction between the axes: of each axis the share of its mass (e . M e).
double CPushOverCurveData::MassAlong(const std::array<double, 3>& mass) const
{
    double sum = 0.0;
    for (std::size_t d = 0; d < 3; ++d)
        sum += m_along[d] * m_along[d] * mass[d];
    return sum;
}

/// Participation along the direction: that of the axes adds up as their ground motion does.
double CPushOverCurveData::ModalFactor(const T_MPAF_D& factor) const
{
    if (IsRotation()) return factor.factor[static_cast<std::size_t>(Direction())];
    return Along({factor.factor[0], factor.factor[1], factor.factor[2]});
}

/// Effective mass along the direction, per cent: factor squared times the modal mass, which each
/// axis tells (mass times percent / factor squared); here the one with the largest factor.
double CPushOverCurveData::ModalPercent(const T_MPAF_D& factor, const T_MPAM_D& percent) const
{
    if (!m_factors.oblique) return percent.percent[static_cast<std::size_t>(Direction())];
    const auto first = factor.factor.begin();
    const auto largest =
        std::max_element(first, first + 3, [](double a, double b) { return a * a < b * b; });
    const auto d = static_cast<std::size_t>(largest - first);
    const double total = MassAlong(m_mass), along = ModalFactor(factor);
    if (*largest == 0.0 || total == 0.0) return 0.0;
    return percent.percent[d] * m_mass[d] / (*largest * *largest) * along * along / total;
}

double CPushOverCurveData::ControlShape() const
{
    T_DOF6 shape;
    m_doc.Post().GetEiMode(m_polc.controlNode, shape);
    if (IsRotation()) return shape[static_cast<std::size_t>(Direction())];
    return Along({shape[0], shape[1], shape[2]});
}

int CPushOverCurveData::BeforePreparePOCurveData(const T_PUSH_CURVE_SETTINGS& settings)
{
    m_settings = settings;
    m_plotType = settings.plotType;
    m_factors = {};
    m_factors.gravity = settings.gravity;
    m_factors.eigenBased = settings.eigenFactors;
    m_conversionError = m_storeyWithoutMass = false;
    m_error.clear();
    if (!m_doc.Attr().GetPolc(settings.pushover, m_polc)) {
        m_error = MMSGFunction::GetValue("IDS_QM_CURVE_NO_CASE");
        return 0;
    }
    FindDirection();
    if (IsControlNodeFound() && !FindControlNode()) return 0;
    if (m_polc.direction == kDirectionZ) m_plotType = PLOT_TYPE::LoadFactor;
    if (m_polc.patternKind == kUniformAcceleration && IsTargetType(m_plotType))
        m_factors.eigenBased = false;
    T_NODE_D node;
    if (!m_doc.Attr().GetNode(m_polc.controlNode, node)) {
        m_error = MMSGFunction::GetValue("IDS_QM_CURVE_NO_NODE");
        return 0;
    }
    m_controlHeight = std::fabs(node.xyz[2]);

    m_mass = {};
    m_massGamma = m_massAlpha = 0.0;
    CalcEigenMode();
    const double control = ControlShape();
    const bool massBased = IsSpectral(m_plotType) && !m_factors.eigenBased && control != 0.0;
    CalcMassFactors(massBased ? control : 0.0);
    if (IsSpectral(m_plotType) && !m_factors.eigenBased) CheckStoreyMasses();
    const double total = MassAlong(m_mass);
    m_massError = !(std::fabs(total) > kNoMass) || !massBased;
    m_factors.mass = total;
    m_factors.weight = m_mass[2] * settings.gravity;
    if (m_factors.weight == 0.0) m_factors.weight = settings.userWeight;
    return 1;
}

int CPushOverCurveData::FindControlNode()
{
    CPostCtrl& post = m_doc.Post();
    if (post.SelectPushover(m_settings.pushover, m_settings.turn) &&
        post.FindControlNode(m_polc.controlNode))
        return 1;
    m_error =
        post.Error().empty() ? MMSGFunction::GetValue("IDS_QM_CURVE_NO_RESULTS") : post.Error();
    return 0;
}

// The mode with the largest participation in the control direction, or the one that the load
// pattern names.
void CPushOverCurveData::CalcEigenMode()
{
    m_eigenError = false;
    CPostCtrl& post = m_doc.Post();
    m_noEigen = post.GetNumEigvPost() == 0;
    const auto factorOf = [&](int mode) {
        T_MPAF_D factor;
        return post.GetEiMpafNeutral(mode, factor) ? std::fabs(ModalFactor(factor)) : 0.0;
    };
    int chosen = 1;
    if (m_polc.patternKind == kModeShape || m_polc.patternKind == kModeShapeStoreyMass) {
        chosen = m_polc.modes.empty() ? 1 : m_polc.modes.front();
        m_eigenError = factorOf(chosen) < kNoParticipation;
    } else {
        double largest = factorOf(1);
        for (int mode = 2; mode <= post.GetNumEigvPost(); ++mode) {
            const double f = factorOf(mode);
            if (!(f > largest)) continue;
            largest = f;
            chosen = mode;
        }
        m_eigenError = largest == 0.0;
    }
    if (!post.SelectMode(chosen)) {
        m_eigenError = true;
        (void)post.SelectMode(0);
        chosen = 0;
    }
    m_factors.mode = chosen;
}

// Direction totals, and with a control component of the shape the mass-based factors:
// Gamma = S1 / S2, alpha = S1^2 / (M S2), the shape being 1 at the control node.
void CPushOverCurveData::CalcMassFactors(double control)
{
    const bool uniform = m_polc.patternKind == kUniformAcceleration;
    double S1 = 0.0, S2 = 0.0, terms = 0.0;
    for (const T_NODAL_MASS& nodal : CStoryLoad(m_doc.Data()).Calc_Nodal_Mass()) {
        for (std::size_t k = 0; k < 3; ++k)
            m_mass[k] += nodal.mass[k];
        if (control == 0.0 || IsRotation()) continue;
        T_DOF6 shape;
        m_doc.Post().GetEiMode(nodal.node, shape);
        const double phi = uniform ? 1.0 : Along({shape[0], shape[1], shape[2]}) / control;
        const double mass = MassAlong(nodal.mass);
        S1 += phi * mass;
        terms += std::fabs(phi * mass);
        S2 += phi * phi * mass;
    }
    const double total = MassAlong(m_mass);
    if (S2 == 0.0 || total == 0.0) return;
    if (std::fabs(S1) <= kNoParticipation * terms) return; // what is left is rounding
    m_massGamma = S1 / S2;
    m_massAlpha = S1 * S1 / (total * S2);
}

void CPushOverCurveData::CheckStoreyMasses()
{
    if (IsRotation()) return;
    const T_MODEL& model = m_doc.Data().Model();
    for (const auto& entry : model.storeys) {
        double mass = 0.0;
        for (const int id : entry.second.nodes) {
            const auto node = model.nodes.find(id);
            if (node == model.nodes.end()) continue;
            std::array<double, 3> free = node->second.mass;
            for (std::size_t d = 0; d < 3; ++d)
                if (node->second.restraint[d]) free[d] = 0.0;
            mass += MassAlong(free);
        }
        if (!(mass > 0.0)) m_storeyWithoutMass = true;
    }
}

void CPushOverCurveData::CalcConversion()
{
    if (!IsSpectral(m_plotType)) return;
    if (m_factors.eigenBased) {
        T_MPAF_D factor;
        T_MPAM_D percent;
        if (m_factors.mode > 0 && m_doc.Post().GetEiMpafNeutral(m_factors.mode, factor) &&
            m_doc.Post().GetEiMpam(m_factors.mode, percent)) {
            m_factors.gamma = std::fabs(ControlShape() * ModalFactor(factor));
            if (m_factors.gamma != 0.0) m_factors.alpha = ModalPercent(factor, percent) / 100.0;
        }
    } else {
        m_factors.gamma = m_massGamma; // keeps its sign, on purpose
        m_factors.alpha = m_massAlpha;
    }
    double forceScale = 0.0;
    if (m_polc.patternKind == kUniformAcceleration)
        forceScale = std::fabs(m_factors.mass);
    else if (m_factors.gamma != 0.0)
        forceScale = std::fabs(m_factors.mass * m_factors.alpha) / std::fabs(m_factors.gamma);
    m_conversionError = std::fabs(m_factors.gamma) < kNoParticipation || forceScale == 0.0 ||
                        m_factors.alpha == 0.0 || !std::isfinite(m_factors.gamma) ||
                        !std::isfinite(forceScale);
}

void CPushOverCurveData::TransformByPlotType(PLOT_TYPE type, double& displacement,
                                             double& force) const
{
    const double W = m_factors.weight != 0.0 ? m_factors.weight : kNoWeight;
    const auto ratio = [](double a, double b) { return b == 0.0 ? 0.0 : a / b; };
    switch (type) {
    case PLOT_TYPE::BaseReaction:
    case PLOT_TYPE::LoadFactor:
        return; // unchanged, not even made absolute
    case PLOT_TYPE::ShearCoeff:
        force /= W;
        break;
    case PLOT_TYPE::Drift:
        displacement /= m_controlHeight != 0.0 ? m_controlHeight : kNoHeight;
        force /= W;
        break;
    default:
        displacement = ratio(displacement, m_factors.gamma);
        force = ratio(force, m_factors.mass * m_factors.gravity * m_factors.alpha);
    }
    displacement = std::fabs(displacement);
    force = std::fabs(force);
}

void CPushOverCurveData::TransferToDispAndReac(double* displacement, double* reaction) const
{
    if (displacement) *displacement = std::fabs(*displacement * m_factors.gamma);
    if (reaction)
        *reaction = BaseShear(*reaction, m_factors.alpha, m_factors.mass, m_factors.gravity);
}

int CPushOverCurveData::PreparePOCurveData()
{
    m_x = {0.0};
    m_y = {0.0};
    m_steps = {0};
    m_maxX = m_maxY = 0.0;
    m_decreasingStep = 0;
    m_extra.fill({0.0});
    CPostCtrl& post = m_doc.Post();
    if (!post.SelectPushover(m_settings.pushover, m_settings.turn)) {
        m_error = MMSGFunction::GetValue("IDS_QM_CURVE_NO_RESULTS");
        return 0;
    }
    const int steps = post.GetStepCount();
    std::vector<T_RUN_STEP> ours;
    (void)post.GetRunSteps(ours); // empty: another program's
    for (int i = 1; i <= steps; ++i) {
        const auto at = static_cast<std::size_t>(i - 1);
        if ((at < ours.size() && ours[at].evaluated) || AppendStep(i)) continue;
        m_error = post.Error().empty() ? MMSGFunction::GetValue("IDS_QM_CURVE_NO_NODE_RESULTS")
                                       : post.Error();
        return 0;
    }
    return 1;
}

int CPushOverCurveData::AppendStep(int step)
{
    CPostCtrl& post = m_doc.Post();
    double force = 0.0, displacement = 0.0;
    const bool read = post.SelectStep(step) &&
                      (m_plotType == PLOT_TYPE::LoadFactor ? post.GetStepFactor_PO(force)
                                                           : post.GetReacNew(force)) &&
                      post.GetDispNew(m_polc.controlNode, displacement);
    if (!read) return 0;
    force = std::fabs(force);
    displacement = std::fabs(displacement);
    TransformByPlotType(m_plotType, displacement, force);
    if (!m_decreasingStep && m_steps.size() > 1 && displacement < m_x.back() * (1.0 - kSameOnCurve))
        m_decreasingStep = step;
    m_maxX = std::max(m_maxX, displacement);
    m_maxY = std::max(m_maxY, force);
    m_x.push_back(displacement);
    m_y.push_back(force);
    m_steps.push_back(step);
    if (m_steps.size() == 2) { // the curve starts at a tenth of its first step, on purpose
        m_x[0] = displacement / 10.0;
        m_y[0] = force / 10.0;
    }
    for (std::size_t k = 0; k < m_extra.size(); ++k) {
        const int node = static_cast<int>(m_settings.extraNodes[k]);
        double extra = 0.0, none = 0.0;
        if (node > 0 && post.ExistNodePost(node) && !post.GetDispNew(node, extra)) return 0;
        extra = std::fabs(extra);
        TransformByPlotType(m_plotType, extra, none);
        m_maxX = std::max(m_maxX, extra);
        m_extra[k].push_back(extra);
    }
    return 1;
}
