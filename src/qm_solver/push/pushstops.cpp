// Where the stored steps of a push lie, and where it stops before its target.
#include "qm_solver/push/pushrun.h"

#include <algorithm>
#include <cmath>

namespace solver {

namespace {

constexpr double kOnTarget = 1e-12; // of the way to the target

double Along(const T_VEC6& way, const T_VEC6& what)
{
    double sum = 0.0;
    for (std::size_t d = 0; d < way.size(); ++d)
        sum += way[d] * what[d];
    return sum;
}

} // namespace

/// The control displacement: of several nodes that of the one furthest on the way.
std::size_t CPushRun::PresentWatch() const
{
    return *std::max_element(m_nodeWatch.begin(), m_nodeWatch.end(),
                             [&](std::size_t a, std::size_t b) {
                                 return m_sign * m_path->Watched(a) < m_sign * m_path->Watched(b);
                             });
}

double CPushRun::Present(const T_PUSH_STAGE& stage) const
{
    if (stage.control == PUSH_CONTROL::LoadFactor) return m_path->Factor();
    return m_path->Watched(PresentWatch());
}

void CPushRun::MakeTargets(const T_PUSH_STAGE& stage)
{
    const bool byLoad = stage.control == PUSH_CONTROL::LoadFactor;
    m_sign = byLoad || stage.target >= 0.0 ? 1.0 : -1.0;
    m_start = Present(stage);
    if (m_isFirst) m_origin = m_start;
    m_isFirst = false;
    if (!byLoad && stage.target < m_start) m_sign = -1.0;
    m_peak = {};
    m_far = m_start;
    m_stored = 0.0;
    m_storedAt.reset();
    m_targets.clear();
    m_target = 0;
    const double way = stage.target - m_start;
    for (const double fraction : stage.steps)
        m_targets.push_back({fraction == 1.0 ? stage.target : m_start + fraction * way, false});
    if (m_targets.empty()) m_targets.push_back({stage.target, false});
    m_extra.clear();
    if (stage.control == PUSH_CONTROL::Displacement)
        for (const double value : stage.additional)
            m_targets.push_back({value, true});
    else
        m_extra = stage.additional;
    const auto before = [&](const T_TARGET& a, const T_TARGET& b) {
        return m_sign * a.value < m_sign * b.value;
    };
    std::stable_sort(m_targets.begin(), m_targets.end(), before);
    const double same = kOnTarget * std::fabs(way);
    std::vector<T_TARGET> apart;
    for (const T_TARGET& t : m_targets) {
        if (m_sign * (t.value - m_start) <= same || m_sign * (t.value - stage.target) > same)
            continue; // behind the start, beyond the end
        if (!apart.empty() && std::fabs(t.value - apart.back().value) <= same)
            apart.back().additional |= t.additional;
        else
            apart.push_back(t);
    }
    m_targets = std::move(apart);
}

/// The path stands where the last step was stored: a stop there is that step.
bool CPushRun::IsStored(double displacement) const
{
    constexpr double kSame = 1e-12; // of the value: rounding of the way to it
    const auto same = [](double a, double b) {
        return std::fabs(a - b) <= kSame * std::max(std::fabs(a), std::fabs(b));
    };
    return m_storedAt && same(*m_storedAt, displacement) && same(m_stored, m_path->Factor());
}

/// Along the rates, to the next stored step; infinite where the path leads away from it.
double CPushRun::ToTarget(const T_PUSH_STAGE& stage) const
{
    const double target = m_targets[m_target].value;
    double first = CHingeBackbone::kFar;
    const auto take = [&](double value, double rate) {
        if (m_sign * rate > 0.0)
            first = std::min(first, std::max(0.0, m_sign * (target - value)) / (m_sign * rate));
    };
    if (stage.control == PUSH_CONTROL::LoadFactor)
        take(m_path->Factor(), m_path->Rate().factor);
    else
        for (const std::size_t w : m_nodeWatch)
            take(m_path->Watched(w), m_path->WatchRate(w));
    return first;
}

/// Along the rates, to the furthest displacement so far, where the path has gone back from it: a
/// drop takes displacement and load back until the structure has shed what the hinge has lost. What
/// is held by its displacement jumps over that way, so nothing stops on it.
double CPushRun::ToReturn(const T_PUSH_STAGE& stage) const
{
    const double rate = m_sign * m_path->Rate().control;
    return rate > 0.0 ? m_sign * (m_far - Present(stage)) / rate : CHingeBackbone::kFar;
}

bool CPushRun::IsBehind(const T_PUSH_STAGE& stage) const
{
    if (stage.control == PUSH_CONTROL::LoadFactor) return false;
    return m_sign * m_path->Rate().control < 0.0 ||
           m_sign * (m_far - Present(stage)) > kOnTarget * std::fabs(stage.target - m_start);
}

/// Along the rates, to the next of the displacements of the control node that are steps although
/// something else controls; `found` is its place.
double CPushRun::ToExtra(std::size_t& found) const
{
    double first = CHingeBackbone::kFar;
    if (m_extra.empty()) return first;
    const double at = m_path->Watched(m_controlWatch), rate = m_path->WatchRate(m_controlWatch);
    for (std::size_t k = 0; k < m_extra.size(); ++k) {
        const double by = (m_extra[k] - at) / rate;
        if (rate == 0.0 || !(by >= 0.0) || by >= first) continue;
        first = by;
        found = k;
    }
    return first;
}

double CPushRun::Reaction(const T_PUSH_STAGE& stage) const
{
    return -Along(WayOf(stage), Base());
}

double CPushRun::ReactionRate(const T_PUSH_STAGE& stage) const
{
    const T_VEC6& sum = m_structure.Loads(m_structure.LoadCount() - 1).sum;
    return m_path->Rate().factor * Along(WayOf(stage), sum);
}

/// What the supports give, from the loads.
T_VEC6 CPushRun::Base() const
{
    T_VEC6 base{};
    for (std::size_t l = 0; l < m_path->Factors().size(); ++l)
        for (std::size_t d = 0; d < 6; ++d)
            base[d] -= m_path->Factors()[l] * m_structure.Loads(l).sum[d];
    return base;
}

/// Along the rates, to the first of the stops that were asked for; `end` is filled for it.
double CPushRun::ToStop(const T_PUSH_STAGE& stage, T_PUSH_END& end) const
{
    double first = CHingeBackbone::kFar;
    const auto take = [&](double distance, double rate, PUSH_OUTCOME outcome, long hinge,
                          long drift) {
        const bool isBeyond = distance < 0.0; // passed on a way back, found on the return
        if (!isBeyond && !(rate > 0.0)) return;
        const double by = isBeyond ? 0.0 : distance / rate;
        if (by >= first) return;
        first = by;
        end.outcome = outcome;
        end.hinge = hinge;
        end.drift = drift;
    };
    const T_PUSH_STOPS& stops = stage.stops;
    for (std::size_t d = 0; d < m_driftWatch.size() && stops.drift > 0.0; ++d) {
        const auto [top, below] = m_driftWatch[d];
        const bool onGround = below == T_PUSH_DRIFT::kGround;
        const double height = m_model.drifts[d].height;
        const double drift =
            (m_path->Watched(top) - (onGround ? 0.0 : m_path->Watched(below))) / height;
        const double rate =
            (m_path->WatchRate(top) - (onGround ? 0.0 : m_path->WatchRate(below))) / height;
        for (const double sign : {1.0, -1.0})
            take(stops.drift - sign * drift, sign * rate, PUSH_OUTCOME::DriftStop, -1,
                 static_cast<long>(d));
    }
    for (std::size_t h = 0; h < m_model.hinges.size() && stops.mark >= 0; ++h)
        for (std::size_t l = 0; l < m_model.hinges[h].laws.size(); ++l) {
            const T_HINGE_LAW& law = m_model.hinges[h].laws[l];
            double rate = 0.0;
            const double deformation = m_path->Deformation(h, l, rate);
            for (const double sign : {1.0, -1.0}) {
                const auto& marks = (sign > 0.0 ? law.positive : law.negative).marks;
                if (marks.size() > static_cast<std::size_t>(stops.mark))
                    take(marks[static_cast<std::size_t>(stops.mark)] - sign * deformation,
                         sign * rate, PUSH_OUTCOME::MarkStop, static_cast<long>(h), -1);
            }
        }
    if (stops.fractionOfPeak > 0.0 && m_peak.reaction > 0.0) {
        const double sign = m_sign;
        take(sign * Reaction(stage) - stops.fractionOfPeak * m_peak.reaction,
             -sign * ReactionRate(stage), PUSH_OUTCOME::PeakFractionStop, -1, -1);
    }
    return first;
}

/// A hinge that begins to lose its strength, or came beyond its last vertex: at once, wherever the
/// path goes from there.
bool CPushRun::StopsAtHinge(const T_PUSH_STOPS& stops, T_PUSH_END& end) const
{
    if (!stops.strengthLoss && !stops.lastPoint) return false;
    for (const CPushFlow& flow : m_path->Flows().flows) {
        const CHingeBackbone& backbone = m_path->Flows().backbones[flow.backbone];
        const bool lost = stops.strengthLoss && backbone.LosesStrength();
        const bool beyond = stops.lastPoint && backbone.VertexCount() > 1 &&
                            backbone.Vertex() >= backbone.VertexCount();
        if (!lost && !beyond) continue;
        end.outcome = lost ? PUSH_OUTCOME::StrengthLossStop : PUSH_OUTCOME::LastPointStop;
        end.hinge = static_cast<long>(flow.hinge);
        return true;
    }
    return false;
}

/// Stops that a change of direction brings, and those of hinges that have just turned.
bool CPushRun::StopsHere(const T_PUSH_STAGE& stage, T_PUSH_END& end)
{
    if (StopsAtHinge(stage.stops, end)) return true;
    if (IsBehind(stage)) return false;
    const T_PUSH_STOPS& stops = stage.stops;
    const double moved = m_path->WatchRate(PresentWatch());
    if (moved != 0.0) {
        const double tangent = ReactionRate(stage) / moved;
        if (m_peak.first == 0.0) m_peak.first = tangent;
        const bool isForwards = stage.control == PUSH_CONTROL::LoadFactor || m_sign * moved > 0.0;
        if (stops.stiffnessRatio > 0.0 && isForwards &&
            tangent <= stops.stiffnessRatio * m_peak.first) {
            end.outcome = PUSH_OUTCOME::StiffnessStop;
            return true;
        }
    }
    return false;
}

} // namespace solver
