#include "qm_rps/push/pushpatterns.h"

#include "qm_base/say.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/push/loadalgebra.h"

#include <algorithm>
#include <cmath>

namespace {

using solver::T_VEC3;
using solver::T_VEC6;

/// Beside the largest force what rounding leaves of forces that cancel, of direction cosines
/// (1e-16) and of calculated shapes (1e-10).
constexpr double kRounding = 1e-9;

double LargestOf(const std::vector<T_VEC3>& forces)
{
    double most = 0.0;
    for (const T_VEC3& f : forces)
        for (const double v : f)
            most = std::max(most, std::fabs(v));
    return most;
}

/// Of the moments at nodes, summed.
double LargestMoment(const solver::T_LOAD_CASE& loads, std::size_t nodes)
{
    std::vector<T_VEC3> sums(nodes);
    for (const auto& l : loads.nodal)
        for (std::size_t d = 0; d < 3; ++d)
            sums[l.node][d] += l.load[d + 3];
    return LargestOf(sums);
}

bool HasStrain(const solver::T_LOAD_CASE& loads)
{
    return !loads.settlement.empty() || !loads.temperature.empty() || !loads.pretension.empty();
}

int Fail(std::string& error, std::string text)
{
    error = std::move(text);
    return 0;
}

/// One row of the list as loads.
class CRows {
public:
    CRows(const T_MODEL& model, const CAnalysisModel& frame, const MODE_SHAPE_FN& modeShape)
        : m_model(model), m_frame(frame), m_modeShape(modeShape)
    {
    }

    /// largest: becomes the largest force of a row.
    int Add(const T_POLC_PATTERN& row, solver::T_LOAD_CASE& to, double& largest,
            std::string& error) const
    {
        solver::T_LOAD_CASE one;
        int done = 0;
        if (row.kind == 0) {
            T_ANALYSIS_ERROR fault;
            done = m_frame.BuildCase(row.number, one, fault);
            if (!done) error = fault.text;
        } else {
            done = row.kind == 1 ? Acceleration(row, one, error) : Mode(row, one, error);
        }
        if (!done) return 0;
        if (row.factor == 0.0 || !HasLoad(one, m_frame.Frame()))
            return Fail(error, Say("IDS_QM_PUSH_PATTERN_EMPTY"));
        AddLoads(to, one, row.factor);
        largest =
            std::max(largest, std::fabs(row.factor) * LargestOf(NodeForces(one, m_frame.Frame())));
        return 1;
    }

private:
    int Acceleration(const T_POLC_PATTERN& row, solver::T_LOAD_CASE& to, std::string& error) const
    {
        const auto d = static_cast<std::size_t>(row.number - 1);
        if (d > 2) return Fail(error, Say("IDS_QM_PUSH_PATTERN_DIRECTION"));
        const std::vector<T_VEC3> mass = NodeMasses(m_frame.Frame());
        for (std::size_t i = 0; i < mass.size(); ++i) {
            T_VEC6 load{};
            load[d] = mass[i][d];
            if (load[d] != 0.0) to.nodal.push_back({i, load});
        }
        if (to.nodal.empty()) return Fail(error, Say("IDS_QM_PUSH_PATTERN_NO_MASS"));
        return 1;
    }

    std::vector<T_VEC6> Shape(int mode, std::string& error) const
    {
        const auto at = m_model.modes.find(mode);
        if (at == m_model.modes.end()) return m_modeShape(mode, error);
        std::vector<T_VEC6> shape;
        for (const int id : m_frame.NodeIds()) {
            const auto node = at->second.shape.find(id);
            shape.push_back(node == at->second.shape.end() ? T_VEC6{} : node->second);
        }
        return shape;
    }

    /// Mass times shape at every node. The masses of a storey stand at its nodes, so that the
    /// pattern by storey masses is the same.
    int Mode(const T_POLC_PATTERN& row, solver::T_LOAD_CASE& to, std::string& error) const
    {
        const std::vector<T_VEC6> shape = Shape(row.number, error);
        if (shape.empty()) return 0;
        const std::vector<T_VEC3> mass = NodeMasses(m_frame.Frame());
        for (std::size_t i = 0; i < shape.size(); ++i) {
            T_VEC6 load{};
            for (std::size_t d = 0; d < 3; ++d)
                if (!m_frame.Frame().nodes[i].fixed[d]) load[d] = shape[i][d] * mass[i][d];
            if (std::ranges::any_of(load, [](double v) { return v != 0.0; }))
                to.nodal.push_back({i, load});
        }
        const bool masses = std::ranges::any_of(
            mass, [](const T_VEC3& m) { return m[0] > 0.0 || m[1] > 0.0 || m[2] > 0.0; });
        if (!masses) return Fail(error, Say("IDS_QM_PUSH_PATTERN_NO_MASS"));
        return 1;
    }

    const T_MODEL& m_model;
    const CAnalysisModel& m_frame;
    const MODE_SHAPE_FN& m_modeShape;
};

/// Where the loads of a storey are turned about, and how far they reach.
struct T_FLOOR {
    T_VEC3 centre{};
    double inertia = 0.0; // sum of weight times distance squared, in plan
    double extent = 0.0;  // normal to the push
};

T_FLOOR FloorOf(const T_PUSH_STOREY& storey, const solver::T_FRAME& frame, std::size_t across)
{
    T_FLOOR floor;
    double low = 0.0, high = 0.0;
    for (std::size_t i = 0; i < storey.nodes.size(); ++i) {
        const T_VEC3& xyz = frame.nodes[storey.nodes[i]].xyz;
        for (std::size_t d = 0; d < 3; ++d)
            floor.centre[d] += storey.weights[i] * xyz[d];
        low = i == 0 ? xyz[across] : std::min(low, xyz[across]);
        high = i == 0 ? xyz[across] : std::max(high, xyz[across]);
    }
    floor.extent = high - low;
    for (std::size_t i = 0; i < storey.nodes.size(); ++i) {
        const T_VEC3& xyz = frame.nodes[storey.nodes[i]].xyz;
        const double x = xyz[0] - floor.centre[0], y = xyz[1] - floor.centre[1];
        floor.inertia += storey.weights[i] * (x * x + y * y);
    }
    return floor;
}

/// A torque about Z as forces at the nodes of a storey.
void AddTorque(const T_PUSH_STOREY& storey, const T_FLOOR& floor, const solver::T_FRAME& frame,
               double torque, solver::T_LOAD_CASE& to)
{
    for (std::size_t i = 0; i < storey.nodes.size(); ++i) {
        const std::size_t node = storey.nodes[i];
        const double share = storey.weights[i];
        if (!(floor.inertia > 0.0)) {
            to.nodal.push_back({node, {0, 0, 0, 0, 0, torque * share}});
            continue;
        }
        const double turn = torque * share / floor.inertia;
        const double x = frame.nodes[node].xyz[0] - floor.centre[0];
        const double y = frame.nodes[node].xyz[1] - floor.centre[1];
        if (turn != 0.0 && (x != 0.0 || y != 0.0))
            to.nodal.push_back({node, {-turn * y, turn * x, 0, 0, 0, 0}});
    }
}

int AddEccentricity(const T_MODEL& model, const CAnalysisModel& frame, const T_POLC_D& record,
                    solver::T_LOAD_CASE& loads, std::string& error)
{
    const auto direction = static_cast<std::size_t>(record.direction - 1);
    if (direction > 1) return Fail(error, Say("IDS_QM_PUSH_ECCENTRIC_DIRECTION"));
    const std::size_t across = 1 - direction;
    const std::vector<T_PUSH_STOREY> storeys = StoreysOf(model, frame, direction);
    const std::vector<T_VEC3> forces = NodeForces(loads, frame.Frame());
    bool any = false;
    for (const T_PUSH_STOREY& storey : storeys) {
        const T_FLOOR floor = FloorOf(storey, frame.Frame(), across);
        double force = 0.0;
        for (const std::size_t node : storey.nodes)
            force += forces[node][direction];
        // x Fy - y Fx of the storey's force moved by the eccentricity.
        const double lever = record.eccentricity * floor.extent;
        const double torque = (direction == 0 ? -1.0 : 1.0) * lever * force;
        any = any || torque != 0.0;
        if (torque != 0.0) AddTorque(storey, floor, frame.Frame(), torque, loads);
    }
    return any ? 1 : Fail(error, Say("IDS_QM_PUSH_ECCENTRIC_NONE"));
}

} // namespace

int BuildPattern(const T_MODEL& model, const CAnalysisModel& frame, const T_POLC_D& record,
                 const MODE_SHAPE_FN& modeShape, solver::T_LOAD_CASE& out, std::string& error)
{
    if (record.patterns.empty()) return Fail(error, Say("IDS_QM_PUSH_NO_PATTERN"));
    const CRows rows(model, frame, modeShape);
    solver::T_LOAD_CASE loads;
    double largest = 0.0;
    for (std::size_t i = 0; i < record.patterns.size(); ++i) {
        std::string why;
        if (!rows.Add(record.patterns[i], loads, largest, why))
            return Fail(error, Say("IDS_QM_PUSH_PATTERN_ROW", std::to_string(i + 1), why));
    }
    const double left = LargestOf(NodeForces(loads, frame.Frame()));
    const bool turns =
        !loads.beam.empty() || LargestMoment(loads, frame.Frame().nodes.size()) > 0.0;
    if (left <= kRounding * largest && (largest > 0.0 || !turns) && !HasStrain(loads))
        return Fail(error, Say("IDS_QM_PUSH_PATTERN_CANCELS"));
    if (record.eccentricity != 0.0 && !AddEccentricity(model, frame, record, loads, error))
        return 0;
    out = std::move(loads);
    return 1;
}

bool PushesAlong(const solver::T_LOAD_CASE& loads, const CAnalysisModel& frame,
                 std::size_t direction)
{
    const std::vector<T_VEC3> forces = NodeForces(loads, frame.Frame());
    const double largest = LargestOf(forces);
    if (direction > 2 || largest == 0.0 || HasStrain(loads)) return true;
    return std::ranges::any_of(
        forces, [&](const T_VEC3& f) { return std::fabs(f[direction]) > kRounding * largest; });
}

int BuildInitialLoads(const CAnalysisModel& frame, const std::vector<T_PUSH_INITIAL_LOAD>& loads,
                      solver::T_LOAD_CASE& out, std::string& error)
{
    solver::T_LOAD_CASE sum;
    for (const T_PUSH_INITIAL_LOAD& load : loads) {
        solver::T_LOAD_CASE one;
        T_ANALYSIS_ERROR fault;
        if (!frame.BuildCase(load.loadCase, one, fault)) return Fail(error, fault.text);
        AddLoads(sum, one, load.factor);
    }
    out = std::move(sum);
    return 1;
}
