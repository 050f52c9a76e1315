#include "qm_solver/checks/stabilitycheck.h"

#include "qm_base/textformat.h"
#include "qm_solver/checks/movement.h"
#include "qm_solver/frame/framedofs.h"

#include <algorithm>
#include <cmath>
#include <numeric>
#include <span>

#include <Eigen/Dense>

namespace solver {

namespace {

using Row6 = Eigen::Matrix<double, 1, 6>;
using Eigen::Matrix3Xd;
using Eigen::MatrixXd;
using Eigen::Vector3d;

constexpr double kRankTolerance = 1.0e-8; // of rows of size 1
constexpr double kAxisTolerance = 1.0e-6; // a direction this near a global axis is called by it

/// Which directions of the nodes belong to the part, springs to the ground left aside.
using TiedDirections = std::vector<T_DIRS6>;

class CParts {
public:
    explicit CParts(std::size_t nodes) : m_parent(nodes)
    {
        std::iota(m_parent.begin(), m_parent.end(), std::size_t{0});
    }
    std::size_t Root(std::size_t i)
    {
        while (m_parent[i] != i)
            i = m_parent[i] = m_parent[m_parent[i]];
        return i;
    }
    void Join(std::size_t i, std::size_t j)
    {
        const std::size_t a = Root(i), b = Root(j);
        m_parent[std::max(a, b)] = std::min(a, b);
    }

private:
    std::vector<std::size_t> m_parent;
};

T_DIRS6 ActsOn(const T_DIAPHRAGM& diaphragm)
{
    const auto normal = static_cast<std::size_t>(diaphragm.normal);
    T_DIRS6 acts{true, true, true, false, false, false};
    acts[normal] = false;
    acts[3 + normal] = true;
    return acts;
}

bool Any(const T_DIRS6& directions)
{
    return std::any_of(directions.begin(), directions.end(), [](bool d) { return d; });
}

void Connect(std::span<const std::size_t> nodes, const T_DIRS6& acts, CParts& parts,
             TiedDirections& tied)
{
    if (!Any(acts)) return;
    for (std::size_t node : nodes) {
        parts.Join(nodes.front(), node);
        for (std::size_t d = 0; d < 6; ++d)
            tied[node][d] = tied[node][d] || acts[d];
    }
}

Vector3d Place(const T_NODE& node)
{
    return {node.xyz[0], node.xyz[1], node.xyz[2]};
}

/// Displacement in direction d at lever `arm` under the six motions, rotations scaled by the size.
Row6 MotionRow(std::size_t d, const Vector3d& arm)
{
    Row6 row = Row6::Zero();
    row(static_cast<Eigen::Index>(d)) = 1.0;
    if (d >= 3) return row;
    const Vector3d axis = Vector3d::Unit(static_cast<Eigen::Index>(d));
    row.tail<3>() = arm.cross(axis).transpose(); // e . (w x arm) = w . (arm x e)
    return row;
}

/// One connected part: its place and the rows that its motions and supports give.
struct T_PART {
    std::vector<std::size_t> nodes;
    Vector3d centre = Vector3d::Zero();
    double size = 0.0; // largest distance of a node from the centre
    std::vector<Row6> motion, support;

    Vector3d Arm(const T_NODE& node) const { return (Place(node) - centre) / size; }
};

void Locate(const T_FRAME& frame, T_PART& part)
{
    for (std::size_t n : part.nodes)
        part.centre += Place(frame.nodes[n]) / static_cast<double>(part.nodes.size());
    for (std::size_t n : part.nodes)
        part.size = std::max(part.size, (Place(frame.nodes[n]) - part.centre).norm());
    if (!(part.size > 0.0)) part.size = 1.0; // all nodes in one place
}

void AddNodes(const T_FRAME& frame, const TiedDirections& tied, T_PART& part)
{
    for (std::size_t n : part.nodes)
        for (std::size_t d = 0; d < 6; ++d) {
            if (!tied[n][d]) continue;
            part.motion.push_back(MotionRow(d, part.Arm(frame.nodes[n])));
            if (frame.nodes[n].fixed[d]) part.support.push_back(part.motion.back());
        }
}

/// Resistance of a difference of displacements: only turning makes one.
void AddDifference(const T_FRAME& frame, std::size_t i, std::size_t j, const T_DIRS6& acts,
                   T_PART& part)
{
    const Vector3d arm = part.Arm(frame.nodes[j]) - part.Arm(frame.nodes[i]);
    for (std::size_t d = 0; d < 3; ++d) {
        if (!acts[d]) continue;
        Row6 row = MotionRow(d, arm);
        row.head<3>().setZero();
        part.support.push_back(row);
    }
}

/// In a diaphragm, nodes of other heights along the normal resist turning out of its plane.
void AddDiaphragm(const T_FRAME& frame, const T_DIAPHRAGM& diaphragm, T_PART& part)
{
    const auto normal = static_cast<Eigen::Index>(diaphragm.normal);
    const Vector3d first = part.Arm(frame.nodes[diaphragm.nodes[0]]);
    for (const std::size_t node : diaphragm.nodes) {
        const Vector3d height =
            (part.Arm(frame.nodes[node]) - first)(normal)*Vector3d::Unit(normal);
        for (Eigen::Index d = 0; d < 3; ++d) {
            if (d == normal) continue;
            Row6 row = MotionRow(static_cast<std::size_t>(d), height);
            row.head<3>().setZero();
            part.support.push_back(row);
        }
    }
}

void AddTies(const T_FRAME& frame, const TiedDirections& tied, CParts& parts,
             std::vector<T_PART*>& partOf)
{
    for (const T_ELEMENT& e : frame.elements) {
        T_PART& part = *partOf[parts.Root(e.i)];
        const T_DIRS6 acts = ActsOn(e);
        if (e.kind == ELEMENT_KIND::Link) AddDifference(frame, e.i, e.j, acts, part);
        if (e.kind != ELEMENT_KIND::Spring) continue;
        for (std::size_t d = 0; d < 6; ++d)
            if (acts[d] && tied[e.i][d])
                part.support.push_back(MotionRow(d, part.Arm(frame.nodes[e.i])));
    }
    for (const T_EQUAL_DISPLACEMENT& equal : frame.equalDisplacements)
        for (std::size_t k = 1; k < equal.nodes.size(); ++k)
            AddDifference(frame, equal.nodes[0], equal.nodes[k], equal.directions,
                          *partOf[parts.Root(equal.nodes[0])]);
    for (const T_DIAPHRAGM& diaphragm : frame.diaphragms)
        if (!diaphragm.nodes.empty())
            AddDiaphragm(frame, diaphragm, *partOf[parts.Root(diaphragm.nodes[0])]);
}

MatrixXd Stacked(const std::vector<Row6>& rows, const MatrixXd& basis)
{
    MatrixXd m = MatrixXd::Zero(std::max<Eigen::Index>(6, static_cast<Eigen::Index>(rows.size())),
                                basis.cols());
    for (std::size_t i = 0; i < rows.size(); ++i)
        m.row(static_cast<Eigen::Index>(i)) = rows[i] * basis;
    return m;
}

/// Splits the space of `basis` by what the rows see of it: `seen` and `unseen` span the two parts.
void Split(const std::vector<Row6>& rows, const MatrixXd& basis, MatrixXd& seen, MatrixXd& unseen)
{
    const Eigen::JacobiSVD<MatrixXd> svd(Stacked(rows, basis),
                                         Eigen::ComputeThinU | Eigen::ComputeThinV);
    const Eigen::Index rank = (svd.singularValues().array() > kRankTolerance).count();
    const MatrixXd turned = basis * svd.matrixV();
    seen = turned.leftCols(rank);
    unseen = turned.rightCols(turned.cols() - rank);
}

/// The motions that move the part and that nothing resists; columns, 6 x k.
MatrixXd FreeMotions(const T_PART& part)
{
    MatrixXd motions, nothing, held, loose;
    Split(part.motion, MatrixXd::Identity(6, 6), motions, nothing);
    if (motions.cols() == 0) return motions;
    Split(part.support, motions, held, loose);
    return loose;
}

/// Orthonormal basis of the columns' space.
Matrix3Xd Basis(const MatrixXd& columns)
{
    if (columns.cols() == 0) return Matrix3Xd(3, 0);
    const Eigen::JacobiSVD<MatrixXd> svd(columns, Eigen::ComputeThinU);
    const Eigen::Index rank = (svd.singularValues().array() > kAxisTolerance).count();
    return svd.matrixU().leftCols(rank);
}

struct T_FREE_AXIS {
    Vector3d axis;
    int direction; // of a global axis, -1 otherwise
};

/// Axes that span a space of directions: global ones first, inclined ones for the rest.
std::vector<T_FREE_AXIS> Axes(Matrix3Xd space)
{
    std::vector<T_FREE_AXIS> axes;
    for (int d = 0; d < 3; ++d) {
        const Vector3d unit = Vector3d::Unit(d);
        if ((space * (space.transpose() * unit) - unit).norm() > kAxisTolerance) continue;
        axes.push_back({unit, d});
    }
    for (const T_FREE_AXIS& a : axes)
        space -= a.axis * (a.axis.transpose() * space);
    const Matrix3Xd inclined = Basis(space);
    for (Eigen::Index k = 0; k < inclined.cols(); ++k) {
        Eigen::Index largest = 0;
        inclined.col(k).cwiseAbs().maxCoeff(&largest);
        const double sign = inclined(largest, k) < 0.0 ? -1.0 : 1.0;
        axes.push_back({sign * inclined.col(k), -1});
    }
    return axes;
}

std::string Triple(const Vector3d& v)
{
    const auto clean = [](double x) { return std::fabs(x) < 1.0e-9 ? 0.0 : x; };
    return FormatText("(%.6g, %.6g, %.6g)", clean(v(0)), clean(v(1)), clean(v(2)));
}

/// Translation that goes with turning about the axis; the free translations taken out of it.
Vector3d TranslationOf(const Vector3d& axis, const MatrixXd& motions, const Matrix3Xd& moves)
{
    const MatrixXd turning = motions.bottomRows(3);
    const Eigen::VectorXd mix = turning.completeOrthogonalDecomposition().solve(axis);
    const Vector3d move = motions.topRows(3) * mix;
    return move - moves * (moves.transpose() * move);
}

/// What the part is free to do along or about an axis: `first` is the direction of axis X, `other`
/// the key for an inclined one.
T_SOLVER_REASON MotionWords(const T_FREE_AXIS& free, std::size_t first, const char* other)
{
    if (free.direction < 0) return {other, {Triple(free.axis)}};
    return kMotionKeys[first + static_cast<std::size_t>(free.direction)];
}

T_SOLVER_REASON TurnWords(const T_FREE_AXIS& free, const Vector3d& move, const T_PART& part)
{
    const T_SOLVER_REASON words = MotionWords(free, 3, "IDS_QM_ENGINE_TURN_ABOUT");
    if (move.norm() < kAxisTolerance) return {"IDS_QM_ENGINE_AXIS_CENTRE", {words}};
    const Vector3d through = part.centre + part.size * free.axis.cross(move);
    return {"IDS_QM_ENGINE_AXIS_THROUGH", {words, Triple(through)}};
}

T_SOLVER_ERROR Describe(T_PART& part, const MatrixXd& motions)
{
    // Free motions without turning: the combinations whose lower half vanishes.
    const Eigen::JacobiSVD<MatrixXd> svd(motions.bottomRows(3), Eigen::ComputeFullV);
    const Eigen::Index turns = (svd.singularValues().array() > kAxisTolerance).count();
    const Matrix3Xd moves =
        Basis(motions.topRows(3) * svd.matrixV().rightCols(motions.cols() - turns));

    T_SOLVER_ERROR error;
    error.fault = SOLVER_FAULT::Mechanism;
    error.node = static_cast<long>(part.nodes.front());
    std::vector<T_SOLVER_REASON> words;
    const auto name = [&](int direction, T_SOLVER_REASON motion) {
        if (words.empty()) error.direction = direction;
        words.push_back(std::move(motion));
    };
    for (const T_FREE_AXIS& a : Axes(moves))
        name(a.direction, MotionWords(a, 0, "IDS_QM_ENGINE_MOVE_ALONG"));
    for (const T_FREE_AXIS& a : Axes(Basis(motions.bottomRows(3))))
        name(a.direction >= 0 ? 3 + a.direction : -1,
             TurnWords(a, TranslationOf(a.axis, motions, moves), part));
    T_SOLVER_REASON all = words[0];
    for (std::size_t i = 1; i < words.size(); ++i)
        all = {i + 1 < words.size() ? "IDS_QM_ENGINE_LIST_NEXT" : "IDS_QM_ENGINE_LIST_LAST",
               {all, words[i]}};
    error.reason = {"IDS_QM_ENGINE_PART_FREE", {all}};
    error.part = std::move(part.nodes);
    return error;
}

std::vector<T_PART> Parts(const T_FRAME& frame, CParts& parts, std::vector<T_PART*>& partOf)
{
    std::vector<T_PART> all;
    std::vector<std::size_t> index(frame.nodes.size());
    for (std::size_t n = 0; n < frame.nodes.size(); ++n) {
        const std::size_t root = parts.Root(n); // the lowest node of the part
        if (root == n) {
            index[n] = all.size();
            all.emplace_back();
        }
        all[index[root]].nodes.push_back(n);
    }
    partOf.resize(frame.nodes.size());
    for (std::size_t n = 0; n < frame.nodes.size(); ++n)
        partOf[n] = &all[index[parts.Root(n)]];
    return all;
}

} // namespace

std::optional<T_SOLVER_ERROR> CheckRigidBodies(const T_FRAME& frame)
{
    CParts parts(frame.nodes.size());
    TiedDirections tied(frame.nodes.size());
    for (const T_ELEMENT& e : frame.elements)
        if (e.kind != ELEMENT_KIND::Spring) Connect(std::array{e.i, e.j}, ActsOn(e), parts, tied);
    for (const T_DIAPHRAGM& d : frame.diaphragms)
        if (!d.nodes.empty()) Connect(d.nodes, ActsOn(d), parts, tied);
    for (const T_EQUAL_DISPLACEMENT& e : frame.equalDisplacements)
        if (!e.nodes.empty()) Connect(e.nodes, e.directions, parts, tied);

    std::vector<T_PART*> partOf;
    std::vector<T_PART> all = Parts(frame, parts, partOf);
    for (T_PART& part : all) {
        Locate(frame, part);
        AddNodes(frame, tied, part);
    }
    AddTies(frame, tied, parts, partOf);
    for (T_PART& part : all)
        if (const MatrixXd motions = FreeMotions(part); motions.cols() > 0)
            return Describe(part, motions);
    return std::nullopt;
}

} // namespace solver
