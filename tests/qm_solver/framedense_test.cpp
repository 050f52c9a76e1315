// Random frames in space against a dense calculation that is written in another way: beams from
// their flexibility, releases as slips of their own, supports and ties as Lagrange multipliers.
#include "solved.h"

#include <Eigen/Dense>

#include <random>

namespace {

using namespace sample;
using Matrix = Eigen::MatrixXd;
using Vector = Eigen::VectorXd;
using Vec3 = Eigen::Vector3d;

constexpr double kAgree = 1e-8; // of the largest value; the dense system mixes 1 and 1e6

constexpr T_VEC6 kSpring{2e4, 3e4, 1e4, 5e3, 0, 7e3};

Vec3 Of(const T_VEC3& v)
{
    return {v[0], v[1], v[2]};
}
Matrix Skew(const Vec3& r)
{
    Matrix s(3, 3);
    s << 0, -r[2], r[1], r[2], 0, -r[0], -r[1], r[0], 0;
    return s;
}
/// Displacements of a point at r from a body's displacement: u - r x theta, theta.
Matrix Lever(const Vec3& r)
{
    Matrix m = Matrix::Identity(6, 6);
    m.topRightCorner(3, 3) = -Skew(r);
    return m;
}

/// A random frame with a load case: 3 x 2 x 3 nodes on a crooked grid, every kind of element.
struct T_SAMPLE {
    T_FRAME frame;
    T_LOAD_CASE load;
};

class CMaker {
public:
    explicit CMaker(unsigned seed) : m_random(seed) {}

    T_SAMPLE Make(bool ties)
    {
        T_SAMPLE s;
        for (int k = 0; k < 3; ++k) {
            s.frame.materials.push_back({Real(1e6, 3e6), Real(4e5, 1e6), Real(1, 3), 1e-5});
            s.frame.sections.push_back({Real(0.05, 0.2), k == 1 ? Real(0.02, 0.1) : 0.0,
                                        k > 0 ? Real(0.02, 0.1) : 0.0, Real(0.01, 0.05),
                                        Real(0.01, 0.05), Real(0.01, 0.05)});
        }
        for (std::size_t n = 0; n < 18; ++n) {
            AddNode(s.frame, {4.0 * double(n % 3) + Real(-0.5, 0.5),
                              5.0 * double(n / 3 % 2) + Real(-0.5, 0.5),
                              3.0 * double(n / 6) + Real(-0.5, 0.5)});
            if (n < 6) FixAll(s.frame, n);
        }
        s.frame.nodes[2].fixed = {true, true, true, false, false, true};
        for (std::size_t n = 6; n < 18; ++n) {
            AddBeam(s.frame, n - 6, n);
            if (n % 3 > 0) AddBeam(s.frame, n - 1, n);
            if (n / 3 % 2 > 0) AddBeam(s.frame, n, n - 3);
        }
        AddOthers(s.frame, ties);
        AddLoads(s);
        return s;
    }

private:
    double Real(double low, double high)
    {
        return std::uniform_real_distribution<double>(low, high)(m_random);
    }
    std::size_t Below(std::size_t end)
    {
        return std::uniform_int_distribution<std::size_t>(0, end - 1)(m_random);
    }
    T_VEC3 Vector3(double size)
    {
        return {Real(-size, size), Real(-size, size), Real(-size, size)};
    }
    T_VEC6 Vector6(double size)
    {
        T_VEC6 v;
        for (double& x : v)
            x = Real(-size, size);
        return v;
    }
    void AddBeam(T_FRAME& frame, std::size_t i, std::size_t j)
    {
        Join(frame, ELEMENT_KIND::Beam, i, j);
        T_ELEMENT& e = frame.elements.back();
        e.material = Below(3);
        e.section = Below(3);
        if (Below(2)) e.zAxis = Vector3(1.0);
        if (Below(3) == 0) e.offsetI = Vector3(0.4);
        if (Below(3) == 0) e.offsetJ = Vector3(0.4);
        const bool hinged = i != 2 && Below(3) == 0; // node 2 turns with its column alone
        if (hinged) e.releaseI[4] = e.releaseI[5] = true;
        if (Below(3) == 0) e.releaseJ[hinged ? 3 * Below(2) : Below(6)] = true;
    }
    void AddOthers(T_FRAME& frame, bool ties)
    {
        Join(frame, ELEMENT_KIND::Truss, 0, 7);
        Join(frame, ELEMENT_KIND::Truss, 8, 16);
        const std::size_t hung = AddNode(frame, {3, 2, 11}); // met by trusses alone
        for (std::size_t n : {12, 13, 15, 17})
            Join(frame, ELEMENT_KIND::Truss, n, hung);
        Join(frame, ELEMENT_KIND::Spring, 9, 0, kSpring);
        if (!ties) return;
        Join(frame, ELEMENT_KIND::Link, 10, 17, {1e4, 2e4, 0, 3e3, 1e3, 0});
        frame.diaphragms.push_back({{12, 14, 17, 18}, 2});
        frame.diaphragms.push_back({{6, 9, 13}, 0});
        frame.equalDisplacements.push_back({{7, 10, 15}, {false, true, false, false, true, false}});
        // The first node of a diaphragm tied to another one afterwards, and a support that leads.
        frame.equalDisplacements.push_back({{16, 12}, {true, false, false, false, false, true}});
        frame.diaphragms.push_back({{8, 2}, 2});
    }
    void AddLoads(T_SAMPLE& s)
    {
        for (int k = 0; k < 5; ++k)
            s.load.nodal.push_back({Below(18), Vector6(50)});
        s.load.nodal.push_back({18, {10, 20, 30, 0, 0, 0}});
        s.load.settlement.push_back({1, Vector6(0.01)});
        s.load.settlement.push_back({2, {Real(-0.01, 0.01), 0.004, -0.003, 0, 0, 0.002}});
        s.load.temperature.push_back({Below(30), Real(10, 30)});
        s.load.pretension.push_back({Below(30), Real(10, 30)});
    }
    std::mt19937 m_random;
};

/// The dense system over node displacements, slips of releases and multipliers.
class CDense {
public:
    CDense(const T_FRAME& frame, const T_LOAD_CASE& load) : m_frame(frame)
    {
        m_size = static_cast<long>(6 * frame.nodes.size());
        for (const T_ELEMENT& e : frame.elements)
            m_size += Slips(e).cols();
        m_k = Matrix::Zero(m_size, m_size);
        m_f = Vector::Zero(m_size);
        m_axial.assign(frame.elements.size(), 0.0);
        for (const T_PRETENSION& p : load.pretension)
            m_axial[p.element] += p.force;
        for (const T_TEMPERATURE& t : load.temperature) {
            const T_ELEMENT& e = frame.elements[t.element];
            const T_MATERIAL& m = frame.materials[e.material];
            m_axial[t.element] -= m.E * frame.sections[e.section].A * m.alpha * t.change;
        }
        long slip = static_cast<long>(6 * frame.nodes.size());
        for (std::size_t e = 0; e < frame.elements.size(); ++e)
            AddElement(e, slip);
        for (const T_NODAL_LOAD& l : load.nodal)
            for (std::size_t d = 0; d < 6; ++d)
                m_f[At(l.node, d)] += l.load[d];
        AddRows(load);
        Solve();
    }

    double Displacement(std::size_t node, std::size_t d) const { return m_x[At(node, d)]; }
    double Reaction(std::size_t node, std::size_t d) const
    {
        const auto row = m_fixedRow.find(At(node, d));
        return row == m_fixedRow.end() ? 0.0 : -m_x[m_size + row->second];
    }
    /// Local forces on the element at I and at J.
    Vector EndForces(std::size_t e) const
    {
        return m_law[e] * (m_path[e] * m_x.head(m_size)) + Initial(e);
    }

private:
    static long At(std::size_t node, std::size_t d) { return static_cast<long>(6 * node + d); }

    static Matrix Slips(const T_ELEMENT& e)
    {
        Matrix b(12, 0);
        for (std::size_t d = 0; d < 12; ++d) {
            if (!(d < 6 ? e.releaseI[d] : e.releaseJ[d - 6])) continue;
            b.conservativeResize(12, b.cols() + 1);
            b.col(b.cols() - 1) = Vector::Unit(12, static_cast<long>(d));
        }
        return b;
    }

    Vector Initial(std::size_t e) const
    {
        return m_axial[e] * (Vector::Unit(12, 6) - Vector::Unit(12, 0));
    }

    /// Forces at both ends from the inverse of the tip flexibility of a cantilever.
    static Matrix BeamLaw(const T_MATERIAL& m, const T_SECTION& s, double L, bool truss)
    {
        Matrix k = Matrix::Zero(6, 6);
        if (truss) {
            k(0, 0) = m.E * s.A / L;
        } else {
            Matrix f = Matrix::Zero(6, 6);
            f(0, 0) = L / (m.E * s.A);
            f(3, 3) = L / (m.G * s.J);
            f(1, 1) = L * L * L / (3 * m.E * s.Iz) + (s.Asy > 0 ? L / (m.G * s.Asy) : 0);
            f(2, 2) = L * L * L / (3 * m.E * s.Iy) + (s.Asz > 0 ? L / (m.G * s.Asz) : 0);
            f(5, 5) = L / (m.E * s.Iz);
            f(4, 4) = L / (m.E * s.Iy);
            f(1, 5) = f(5, 1) = L * L / (2 * m.E * s.Iz);
            f(2, 4) = f(4, 2) = -L * L / (2 * m.E * s.Iy);
            k = f.inverse();
        }
        Matrix tip(6, 12); // displacement of J less what the body of I carries there
        tip << -Lever({L, 0, 0}), Matrix::Identity(6, 6);
        return tip.transpose() * k * tip;
    }

    void AddElement(std::size_t index, long& slip)
    {
        const T_ELEMENT& e = m_frame.elements[index];
        Matrix path = Matrix::Zero(12, m_size), law = Matrix::Zero(12, 12);
        Matrix turn = Matrix::Identity(6, 6);
        if (e.kind == ELEMENT_KIND::Beam || e.kind == ELEMENT_KIND::Truss) {
            const Vec3 along = Of(m_frame.nodes[e.j].xyz) + Of(e.offsetJ) -
                               Of(m_frame.nodes[e.i].xyz) - Of(e.offsetI);
            const Vec3 x = along.normalized();
            Vec3 z = Of(e.zAxis);
            if (z.norm() == 0.0) z = Vec3(0, 0, 1);
            z = (z - x * x.dot(z)).normalized();
            Matrix axes(3, 3);
            axes << x.transpose(), z.cross(x).transpose(), z.transpose();
            turn.topLeftCorner(3, 3) = turn.bottomRightCorner(3, 3) = axes;
            law = BeamLaw(m_frame.materials[e.material], m_frame.sections[e.section], along.norm(),
                          e.kind == ELEMENT_KIND::Truss);
        } else {
            Matrix tip(6, 12);
            tip << -Matrix::Identity(6, 6), Matrix::Identity(6, 6);
            const Vector k = Eigen::Map<const Vector>(e.stiffness.data(), 6);
            law = tip.transpose() * k.asDiagonal() * tip;
        }
        path.block(0, At(e.i, 0), 6, 6) = turn * Lever(Of(e.offsetI));
        if (e.kind != ELEMENT_KIND::Spring)
            path.block(6, At(e.j, 0), 6, 6) = turn * Lever(Of(e.offsetJ));
        const Matrix slips = Slips(e);
        path.middleCols(slip, slips.cols()) = -slips;
        slip += slips.cols();
        m_k += path.transpose() * law * path;
        m_f -= path.transpose() * Initial(index);
        m_path.push_back(path);
        m_law.push_back(law);
    }

    void AddRow(std::initializer_list<std::pair<long, double>> terms, double value)
    {
        Vector row = Vector::Zero(m_size);
        for (const auto& [at, factor] : terms)
            row[at] += factor;
        m_rows.push_back(row);
        m_values.push_back(value);
    }
    void AddRows(const T_LOAD_CASE& load)
    {
        std::map<long, double> settled;
        for (const T_SETTLEMENT& s : load.settlement)
            for (std::size_t d = 0; d < 6; ++d)
                settled[At(s.node, d)] = s.displacement[d];
        for (std::size_t n = 0; n < m_frame.nodes.size(); ++n)
            for (std::size_t d = 0; d < 6; ++d)
                if (m_frame.nodes[n].fixed[d]) {
                    m_fixedRow[At(n, d)] = static_cast<long>(m_rows.size());
                    AddRow({{At(n, d), 1.0}}, settled[At(n, d)]);
                }
        for (const T_DIAPHRAGM& d : m_frame.diaphragms)
            for (std::size_t k = 1; k < d.nodes.size(); ++k)
                AddDiaphragmRows(d, d.nodes[0], d.nodes[k]);
        for (const T_EQUAL_DISPLACEMENT& q : m_frame.equalDisplacements)
            for (std::size_t k = 1; k < q.nodes.size(); ++k)
                for (std::size_t d = 0; d < 6; ++d)
                    if (q.directions[d])
                        AddRow({{At(q.nodes[k], d), 1.0}, {At(q.nodes[0], d), -1.0}}, 0.0);
    }
    /// The displacement of b less what the body of a carries there, in the plane.
    void AddDiaphragmRows(const T_DIAPHRAGM& diaphragm, std::size_t a, std::size_t b)
    {
        const Vec3 r = Of(m_frame.nodes[b].xyz) - Of(m_frame.nodes[a].xyz);
        const Matrix lever = Lever(r);
        const long n = diaphragm.normal;
        for (const long d : {(n + 1) % 3, (n + 2) % 3, n + 3})
            AddRow({{At(b, 0) + d, 1.0},
                    {At(a, 0) + d, -1.0},
                    {At(a, 0) + 3 + n, d < 3 ? -lever(d, 3 + n) : 0.0}},
                   0.0);
    }
    void Solve()
    {
        const long rows = static_cast<long>(m_rows.size());
        const double scale = m_k.diagonal().maxCoeff();
        Matrix k = Matrix::Zero(m_size + rows, m_size + rows);
        Vector f = Vector::Zero(m_size + rows);
        k.topLeftCorner(m_size, m_size) = m_k;
        f.head(m_size) = m_f;
        for (long r = 0; r < rows; ++r) {
            k.row(m_size + r).head(m_size) = scale * m_rows[static_cast<std::size_t>(r)];
            k.col(m_size + r).head(m_size) = scale * m_rows[static_cast<std::size_t>(r)];
            f[m_size + r] = scale * m_values[static_cast<std::size_t>(r)];
        }
        m_x = k.completeOrthogonalDecomposition().solve(f);
        m_x.tail(rows) *= scale;
    }

    const T_FRAME& m_frame;
    long m_size = 0;
    Matrix m_k;
    Vector m_f, m_x;
    std::vector<double> m_axial, m_values;
    std::vector<Matrix> m_path, m_law;
    std::vector<Vector> m_rows;
    std::map<long, long> m_fixedRow;
};

TEST(FrameDense, RandomFramesAgreeWithTheDenseSolution)
{
    for (unsigned seed = 1; seed <= 12; ++seed) {
        SCOPED_TRACE(seed);
        const T_SAMPLE s = CMaker(seed).Make(seed % 2 == 0);
        const CDense dense(s.frame, s.load);
        const T_RESULT r = Solved(s.frame, s.load);
        double forces = 0.0, moves = 0.0;
        for (std::size_t n = 0; n < s.frame.nodes.size(); ++n)
            for (std::size_t d = 0; d < 6; ++d) {
                moves = std::max(moves, std::fabs(r.displacement[n][d]));
                forces = std::max(forces, std::fabs(r.reaction[n][d]));
            }
        ASSERT_GT(forces, 10.0);
        for (std::size_t n = 0; n < s.frame.nodes.size(); ++n)
            for (std::size_t d = 0; d < 6; ++d) {
                EXPECT_NEAR(dense.Displacement(n, d), r.displacement[n][d], kAgree * moves);
                // Node 9 has a spring and no other support.
                const double spring = n == 9 ? -kSpring[d] * dense.Displacement(n, d) : 0.0;
                EXPECT_NEAR(dense.Reaction(n, d) + spring, r.reaction[n][d], kAgree * forces);
            }
        for (std::size_t e = 0; e < s.frame.elements.size(); ++e) {
            const Vector ends = dense.EndForces(e);
            const ELEMENT_KIND kind = s.frame.elements[e].kind;
            for (std::size_t d = 0; d < 6 && kind != ELEMENT_KIND::Spring; ++d) {
                const long at = static_cast<long>(d);
                EXPECT_NEAR(ends[6 + at], r.force[e][4][d], kAgree * forces) << e << " " << d;
                if (kind != ELEMENT_KIND::Beam) continue;
                EXPECT_NEAR(-ends[at], r.force[e][0][d], kAgree * forces) << e << " " << d;
            }
        }
    }
}

} // namespace
