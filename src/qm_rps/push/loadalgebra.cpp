#include "qm_rps/push/loadalgebra.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace {

using solver::T_VEC3;
using solver::T_VEC6;

T_VEC3 Minus(const T_VEC3& a, const T_VEC3& b)
{
    return {a[0] - b[0], a[1] - b[1], a[2] - b[2]};
}
double Dot(const T_VEC3& a, const T_VEC3& b)
{
    return a[0] * b[0] + a[1] * b[1] + a[2] * b[2];
}
T_VEC3 Cross(const T_VEC3& a, const T_VEC3& b)
{
    return {a[1] * b[2] - a[2] * b[1], a[2] * b[0] - a[0] * b[2], a[0] * b[1] - a[1] * b[0]};
}
T_VEC3 Unit(const T_VEC3& v)
{
    const double length = std::sqrt(Dot(v, v));
    return length > 0.0 ? T_VEC3{v[0] / length, v[1] / length, v[2] / length} : T_VEC3{};
}

T_VEC3 Along(const solver::T_FRAME& frame, const solver::T_ELEMENT& e)
{
    T_VEC3 v = Minus(frame.nodes[e.j].xyz, frame.nodes[e.i].xyz);
    for (std::size_t d = 0; d < 3; ++d)
        v[d] += e.offsetJ[d] - e.offsetI[d];
    return v;
}

/// Local axes by rows, as solver::T_SECTION has them.
std::array<T_VEC3, 3> LocalAxes(const solver::T_FRAME& frame, const solver::T_ELEMENT& e)
{
    constexpr double kVertical = 1e-9;
    const T_VEC3 x = Unit(Along(frame, e));
    T_VEC3 z = e.zAxis;
    if (Dot(z, z) == 0.0)
        z = std::hypot(x[0], x[1]) > kVertical ? T_VEC3{0, 0, 1} : T_VEC3{1, 0, 0};
    const double along = Dot(z, x);
    z = Unit({z[0] - along * x[0], z[1] - along * x[1], z[2] - along * x[2]});
    return {x, Cross(z, x), z};
}

/// Direction of a beam load in global axes.
T_VEC3 DirectionOf(const solver::T_BEAM_LOAD& load, const solver::T_FRAME& frame)
{
    const auto d = static_cast<std::size_t>(load.direction);
    if (load.local) return LocalAxes(frame, frame.elements[load.element])[d];
    T_VEC3 v{};
    v[d] = 1.0;
    return v;
}

struct T_TURN {
    double c = 1.0, s = 0.0;
    explicit T_TURN(double degrees)
    {
        // Whole quarters are exact: no load is left in the direction across.
        constexpr double kQuarters[][2]{{1, 0}, {0, 1}, {-1, 0}, {0, -1}};
        const double quarter = degrees / 90.0;
        if (quarter == std::floor(quarter)) {
            const auto at = ((static_cast<long>(quarter) % 4) + 4) % 4;
            c = kQuarters[at][0];
            s = kQuarters[at][1];
            return;
        }
        c = std::cos(degrees * std::numbers::pi / 180.0);
        s = std::sin(degrees * std::numbers::pi / 180.0);
    }
    T_VEC3 operator()(const T_VEC3& v) const
    {
        return {c * v[0] - s * v[1], s * v[0] + c * v[1], v[2]};
    }
};

/// Resultant of a force load over the length, and the fraction where it acts.
struct T_RESULTANT {
    double force = 0.0, at = 0.5;
};
T_RESULTANT ResultantOf(const solver::T_BEAM_LOAD& load, double length)
{
    if (load.type == solver::BEAM_LOAD::Moment) return {};
    if (load.type == solver::BEAM_LOAD::Point) return {load.w[0], load.at[0]};
    const double width = load.at[1] - load.at[0], sum = load.w[0] + load.w[1];
    const double lever = sum != 0.0 ? (load.w[0] + 2.0 * load.w[1]) / (3.0 * sum) : 0.5;
    return {0.5 * sum * width * length, load.at[0] + lever * width};
}

double HalfMass(const solver::T_FRAME& frame, const solver::T_ELEMENT& e)
{
    if (e.kind != solver::ELEMENT_KIND::Beam && e.kind != solver::ELEMENT_KIND::Truss) return 0.0;
    const T_VEC3 v = Along(frame, e);
    return 0.5 * frame.materials[e.material].density * frame.sections[e.section].A *
           std::sqrt(Dot(v, v));
}

void AddTimes(T_VEC3& to, const T_VEC3& v, double factor)
{
    for (std::size_t d = 0; d < 3; ++d)
        to[d] += factor * v[d];
}

} // namespace

void AddLoads(solver::T_LOAD_CASE& to, const solver::T_LOAD_CASE& from, double factor)
{
    AddTimes(to.selfWeight, from.selfWeight, factor);
    for (solver::T_NODAL_LOAD load : from.nodal) {
        for (double& v : load.load)
            v *= factor;
        to.nodal.push_back(load);
    }
    for (solver::T_BEAM_LOAD load : from.beam) {
        for (double& w : load.w)
            w *= factor;
        to.beam.push_back(load);
    }
    for (solver::T_SETTLEMENT load : from.settlement) {
        for (double& v : load.displacement)
            v *= factor;
        to.settlement.push_back(load);
    }
    for (solver::T_TEMPERATURE load : from.temperature) {
        load.change *= factor;
        to.temperature.push_back(load);
    }
    for (solver::T_PRETENSION load : from.pretension) {
        load.force *= factor;
        to.pretension.push_back(load);
    }
}

solver::T_LOAD_CASE TurnedAboutZ(const solver::T_LOAD_CASE& loads, const solver::T_FRAME& frame,
                                 double degrees)
{
    const T_TURN turn(degrees);
    solver::T_LOAD_CASE out = loads;
    out.selfWeight = turn(loads.selfWeight);
    for (solver::T_NODAL_LOAD& load : out.nodal) {
        const T_VEC3 f = turn({load.load[0], load.load[1], load.load[2]});
        const T_VEC3 m = turn({load.load[3], load.load[4], load.load[5]});
        load.load = {f[0], f[1], f[2], m[0], m[1], m[2]};
    }
    out.beam.clear();
    for (const solver::T_BEAM_LOAD& load : loads.beam) {
        const T_VEC3 v = turn(DirectionOf(load, frame));
        for (int d = 0; d < 3; ++d) {
            const double part = v[static_cast<std::size_t>(d)];
            if (part == 0.0) continue;
            solver::T_BEAM_LOAD& turned = out.beam.emplace_back(load);
            turned.local = false;
            turned.direction = d;
            for (double& w : turned.w)
                w *= part;
        }
    }
    return out;
}

std::vector<T_VEC3> NodeForces(const solver::T_LOAD_CASE& loads, const solver::T_FRAME& frame)
{
    std::vector<T_VEC3> out(frame.nodes.size());
    for (const solver::T_NODAL_LOAD& load : loads.nodal)
        AddTimes(out[load.node], {load.load[0], load.load[1], load.load[2]}, 1.0);
    for (const solver::T_BEAM_LOAD& load : loads.beam) {
        const solver::T_ELEMENT& e = frame.elements[load.element];
        const T_VEC3 along = Along(frame, e);
        const T_RESULTANT r = ResultantOf(load, std::sqrt(Dot(along, along)));
        const T_VEC3 direction = DirectionOf(load, frame);
        AddTimes(out[e.i], direction, r.force * (1.0 - r.at));
        AddTimes(out[e.j], direction, r.force * r.at);
    }
    for (const solver::T_ELEMENT& e : frame.elements) {
        const double half = HalfMass(frame, e) * frame.gravity;
        if (half == 0.0) continue;
        AddTimes(out[e.i], loads.selfWeight, half);
        AddTimes(out[e.j], loads.selfWeight, half);
    }
    return out;
}

std::vector<T_VEC3> NodeMasses(const solver::T_FRAME& frame)
{
    std::vector<T_VEC3> mass;
    for (const solver::T_NODE& node : frame.nodes)
        mass.push_back(node.mass);
    for (const solver::T_ELEMENT& e : frame.elements) {
        const double half = HalfMass(frame, e);
        if (half == 0.0) continue;
        AddTimes(mass[e.i], {1, 1, 1}, half);
        AddTimes(mass[e.j], {1, 1, 1}, half);
    }
    for (std::size_t i = 0; i < mass.size(); ++i)
        for (std::size_t d = 0; d < 3; ++d)
            if (frame.nodes[i].fixed[d]) mass[i][d] = 0.0;
    return mass;
}

bool HasLoad(const solver::T_LOAD_CASE& loads, const solver::T_FRAME& frame)
{
    const auto any = [](const auto& values) {
        return std::ranges::any_of(values, [](double v) { return v != 0.0; });
    };
    for (const T_VEC3& f : NodeForces(loads, frame))
        if (any(f)) return true;
    return std::ranges::any_of(loads.nodal, [&](const auto& l) { return any(l.load); }) ||
           std::ranges::any_of(loads.beam, [&](const auto& l) { return any(l.w); }) ||
           std::ranges::any_of(loads.settlement,
                               [&](const auto& l) { return any(l.displacement); }) ||
           std::ranges::any_of(loads.temperature, [](const auto& l) { return l.change != 0.0; }) ||
           std::ranges::any_of(loads.pretension, [](const auto& l) { return l.force != 0.0; });
}
