#include "qm_solver/sectionsolver.h"

#include "qm_base/finite.h"
#include "qm_solver/section/capacitycurve.h"
#include "qm_solver/section/curvaturepath.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace solver {

struct CSectionSolver::T_STATE {
    T_SECTION_SHAPE shape;
    T_SECTION_ERROR capacity; // why there is none
    T_SECTION_ERROR path;     // why there is no moment-curvature
};

namespace {

int Fail(T_SECTION_ERROR& error, SECTION_FAULT fault)
{
    error = {};
    error.fault = fault;
    return 0;
}

/// Writes a result whose numbers are finite.
template <class T>
int Give(T&& result, T& out, T_SECTION_ERROR& error)
{
    if (!IsFinite(result)) return Fail(error, SECTION_FAULT::NotConverged);
    out = std::move(result);
    error = {};
    return 1;
}

T_SECTION_ERROR PathFault(const T_SECTION_SHAPE& shape)
{
    T_SECTION_ERROR error;
    const T_SECTION_MODEL& model = shape.model;
    if (model.plastic) error.fault = SECTION_FAULT::NoLimit;
    for (std::size_t i = 0; i < model.laws.size(); ++i)
        if (model.laws[i].kind == STRESS_LAW::Block) {
            error.fault = SECTION_FAULT::BlockCurvature;
            error.law = static_cast<long>(i);
        }
    return error;
}

/// Whether an operation may start: the fault of the section that stands against it, the numbers
/// of the request.
template <class... T>
int Ready(const T_SECTION_ERROR* fault, T_SECTION_ERROR& error, T... numbers)
{
    if (!fault) return Fail(error, SECTION_FAULT::NoRegion);
    if (fault->fault != SECTION_FAULT::None) {
        error = *fault;
        return 0;
    }
    return (std::isfinite(numbers) && ...) ? 1 : Fail(error, SECTION_FAULT::NotFinite);
}

int AxialBeyond(CUltimateStates& states, T_SECTION_ERROR& error)
{
    error = {};
    error.fault = SECTION_FAULT::AxialBeyond;
    const CUltimateStates::T_RANGE range = states.AxialRange();
    error.axialMin = range.low, error.axialMax = range.high;
    return 0;
}

} // namespace

CSectionSolver::CSectionSolver() = default;
CSectionSolver::~CSectionSolver() = default;
CSectionSolver::CSectionSolver(CSectionSolver&&) noexcept = default;
CSectionSolver& CSectionSolver::operator=(CSectionSolver&&) noexcept = default;

int CSectionSolver::Prepare(const T_SECTION_MODEL& model, T_SECTION_ERROR& error)
{
    m_state.reset();
    auto state = std::make_unique<T_STATE>();
    if (!MakeShape(model, state->shape, error)) return 0;
    state->capacity = solver::CapacityFault(state->shape);
    state->path = PathFault(state->shape);
    m_state = std::move(state);
    return 1;
}

int CSectionSolver::Respond(const T_STRAIN_PLANE& plane, T_SECTION_RESPONSE& out,
                            T_SECTION_ERROR& error) const
{
    if (!m_state) return Fail(error, SECTION_FAULT::NoRegion);
    if (!IsFinite(plane)) return Fail(error, SECTION_FAULT::NotFinite);
    const double direction = std::atan2(plane.overY, plane.overZ);
    CSectionView view(m_state->shape, direction);
    const T_SUMS sums = view.SumsAndTangent(plane.axial, std::hypot(plane.overY, plane.overZ));
    // z = c s + d t, y = d s - c t.
    const double c = std::cos(direction), d = std::sin(direction);
    const auto& [k, ks, kt, kss, kst, ktt] = sums.tangent;
    T_SECTION_RESPONSE r;
    r.axial = sums.force, r.My = view.MomentY(sums), r.Mz = view.MomentZ(sums);
    const double kz = c * ks + d * kt, ky = d * ks - c * kt;
    const double kzz = c * c * kss + 2.0 * c * d * kst + d * d * ktt;
    const double kyy = d * d * kss - 2.0 * c * d * kst + c * c * ktt;
    const double kzy = c * d * (kss - ktt) + (d * d - c * c) * kst;
    r.tangent = {{{k, kz, ky}, {kz, kzz, kzy}, {ky, kzy, kyy}}};
    return Give(std::move(r), out, error);
}

int CSectionSolver::Capacity(double direction, double place, T_CAPACITY& out,
                             T_SECTION_ERROR& error) const
{
    if (!Ready(m_state ? &m_state->capacity : nullptr, error, direction, place)) return 0;
    return Give(CUltimateStates(m_state->shape, direction).At(place), out, error);
}

int CSectionSolver::Largest(double direction, T_CAPACITY& out, double& place,
                            T_SECTION_ERROR& error) const
{
    if (!Ready(m_state ? &m_state->capacity : nullptr, error, direction)) return 0;
    CUltimateStates states(m_state->shape, direction);
    const double peak = states.Peak();
    if (!Give(states.At(peak), out, error)) return 0;
    place = peak;
    return 1;
}

int CSectionSolver::AtAxial(double direction, double axial, T_CAPACITY& out,
                            T_SECTION_ERROR& error) const
{
    if (!Ready(m_state ? &m_state->capacity : nullptr, error, direction, axial)) return 0;
    CUltimateStates states(m_state->shape, direction);
    auto found = states.AtAxial(axial);
    return found ? Give(std::move(*found), out, error) : AxialBeyond(states, error);
}

int CSectionSolver::TowardsMoment(double direction, double axial, T_CAPACITY& out,
                                  T_SECTION_ERROR& error) const
{
    if (!Ready(m_state ? &m_state->capacity : nullptr, error, direction, axial)) return 0;
    CUltimateStates states(m_state->shape, direction);
    error = {};
    auto found = solver::TowardsMoment(states, direction, axial, error);
    return found ? Give(std::move(*found), out, error) : 0;
}

int CSectionSolver::Curve(double direction, std::size_t points, T_AXIAL_CURVE& out,
                          T_SECTION_ERROR& error) const
{
    if (!Ready(m_state ? &m_state->capacity : nullptr, error, direction)) return 0;
    if (points < kFewestPoints) return Fail(error, SECTION_FAULT::PointsTooFew);
    CUltimateStates states(m_state->shape, direction);
    T_AXIAL_CURVE curve = CurveOf(states, points);
    if (curve.points.empty() || !IsFinite(curve.points))
        return Fail(error, SECTION_FAULT::NotConverged);
    out = std::move(curve);
    error = {};
    return 1;
}

int CSectionSolver::Surface(std::size_t directions, std::size_t points,
                            std::vector<T_CAPACITY>& out, T_SECTION_ERROR& error) const
{
    if (!Ready(m_state ? &m_state->capacity : nullptr, error)) return 0;
    if (directions == 0 || points < kFewestPoints) return Fail(error, SECTION_FAULT::PointsTooFew);
    std::vector<T_CAPACITY> all;
    all.reserve(directions * points);
    CUltimateStates states(m_state->shape, 0.0);
    for (std::size_t d = 0; d < directions; ++d) {
        states.Turn(2.0 * std::numbers::pi * double(d) / double(directions));
        const T_CAPACITY first = states.At(states.Last()), last = states.At(states.First());
        all.push_back(first);
        for (std::size_t i = 1; i + 1 < points; ++i) {
            const double way = double(i) / double(points - 1);
            const auto at = states.AtAxial(first.axial + way * (last.axial - first.axial));
            if (!at) return AxialBeyond(states, error);
            all.push_back(*at);
        }
        all.push_back(last);
    }
    return Give(std::move(all), out, error);
}

int CSectionSolver::MomentCurvature(const T_CURVATURE_REQUEST& request, T_MOMENT_CURVATURE& out,
                                    T_SECTION_ERROR& error) const
{
    if (!Ready(m_state ? &m_state->path : nullptr, error, request.axial, request.direction,
               request.maxCurvature))
        return 0;
    // Something must end the path: a limit of strain, or what was asked for.
    if (!(request.maxCurvature > 0.0) && CSectionView(m_state->shape).Limits().empty())
        return Fail(error, SECTION_FAULT::NoLimit);
    T_MOMENT_CURVATURE result;
    if (!CCurvaturePath(m_state->shape, request).Run(result, error)) return 0;
    return Give(std::move(result), out, error);
}

} // namespace solver
