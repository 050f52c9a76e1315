// A truss arch built in stages, against an incremental analysis written for this test: dense, what
// is out of balance is solved and added up at each step. The engine keeps total displacements and
// those at birth instead, so that the two share no formula.
#include "staged.h"

#include <Eigen/Dense>

#include <cmath>

namespace {

using namespace sample;

constexpr std::size_t kPanels = 8;
constexpr std::size_t kCases = 5;

/// Lower chord nodes 2 i on a parabola, upper ones 2 i + 1 on a line above; plane X-Z. The last two
/// nodes are feet of a tie-back and of a prop.
T_FRAME Arch()
{
    T_FRAME frame = Empty();
    frame.materials[0].density = 7.85;
    for (std::size_t i = 0; i <= kPanels; ++i) {
        const double x = 5.0 * double(i), s = double(i) / kPanels;
        AddNode(frame, {x, 0, 24.0 * s * (1 - s)});
        AddNode(frame, {x, 0, 9.0});
    }
    AddNode(frame, {-12, 0, 9}); // 18
    AddNode(frame, {15, 0, -4}); // 19
    for (T_NODE& node : frame.nodes)
        node.fixed[1] = true;
    for (std::size_t i = 0; i <= kPanels; ++i) {
        Join(frame, ELEMENT_KIND::Truss, 2 * i, 2 * i + 1);
        if (i == 0) continue;
        Join(frame, ELEMENT_KIND::Truss, 2 * i - 2, 2 * i);
        Join(frame, ELEMENT_KIND::Truss, 2 * i - 1, 2 * i + 1);
        Join(frame, ELEMENT_KIND::Truss, 2 * i - 1, 2 * i);
    }
    Join(frame, ELEMENT_KIND::Truss, 18, 1); // 33: tie-back
    Join(frame, ELEMENT_KIND::Truss, 19, 6); // 34: prop
    return frame;
}

/// Cases: weight, initial tension of the tie-back, of a diagonal, a crane, a load on the whole.
T_STAGED_MODEL Stages()
{
    T_STAGED_MODEL model;
    model.frame = Arch();
    model.groups = {LOAD_GROUP::Dead, LOAD_GROUP::Erection, LOAD_GROUP::Dead, LOAD_GROUP::Erection,
                    LOAD_GROUP::Rest};
    const auto panels = [](std::size_t from, std::size_t to) {
        return Range(from == 0 ? 0 : 4 * from - 3, 4 * to + 1);
    };
    T_STAGE s;
    s.activateElements = panels(0, 2);
    s.activateElements.push_back(33);
    for (std::size_t n = 0; n < model.frame.nodes.size(); ++n)
        s.activateSupports.push_back({n, {}}); // the plane
    for (const std::size_t n : {0, 16, 18, 19})
        s.activateSupports.push_back({n, {true, false, true, false, false, false}});
    s.steps = 2;
    s.activateLoads = {{0, 1}, {1, kLastStep}};
    model.stages.push_back(s);
    s = {};
    s.activateElements = panels(3, 4);
    s.activateElements.push_back(34);
    s.activateLoads = {{3, 1}, {2, 1}};
    model.stages.push_back(s);
    s = {};
    s.activateElements = panels(5, 8);
    s.steps = 3;
    s.deactivateLoads = {{3, 2}};
    s.activateLoads = {{4, kLastStep}};
    model.stages.push_back(s);
    s = {};
    s.deactivateElements = {33};
    s.deactivateSupports = {{19, {true, false, true, false, false, false}}};
    s.deactivateElements.push_back(34);
    model.stages.push_back(s);
    s = {};
    s.activateSupports = {{9, {false, false, true, false, false, false}}};
    s.deactivateLoads = {{4, 1}};
    model.stages.push_back(s);
    return model;
}

std::vector<T_LOAD_CASE> Cases()
{
    std::vector<T_LOAD_CASE> cases(kCases);
    cases[0].selfWeight = {0, 0, -1};
    cases[1].pretension.push_back({33, 120.0});
    cases[2].pretension.push_back({8, -15.0}); // a diagonal of the second panel
    cases[3].nodal.push_back({5, {3, 0, -20, 0, 0, 0}});
    for (const std::size_t n : {4, 7, 8, 11, 12})
        cases[4].nodal.push_back({n, {0, 0, -5, 0, 0, 0}});
    return cases;
}

/// One load case, step by step. Index 2 node is X, 2 node + 1 is Z.
class CIncremental {
public:
    explicit CIncremental(const T_FRAME& frame)
        : m_frame(frame), u(Zero()), reaction(Zero()), force(frame.elements.size(), 0.0),
          active(frame.elements.size(), 0), held(2 * frame.nodes.size(), 0)
    {
    }

    Eigen::VectorXd Zero() const
    {
        return Eigen::VectorXd::Zero(static_cast<Eigen::Index>(2 * m_frame.nodes.size()));
    }

    /// Nodal forces of a unit tension.
    Eigen::VectorXd Pull(std::size_t e, double& length) const
    {
        const T_ELEMENT& element = m_frame.elements[e];
        const T_VEC3 &i = m_frame.nodes[element.i].xyz, &j = m_frame.nodes[element.j].xyz;
        const Eigen::Vector2d along(j[0] - i[0], j[2] - i[2]);
        length = along.norm();
        Eigen::VectorXd pull = Zero();
        pull.segment<2>(static_cast<Eigen::Index>(2 * element.i)) = -along / length;
        pull.segment<2>(static_cast<Eigen::Index>(2 * element.j)) = along / length;
        return pull;
    }

    void Balance(const Eigen::VectorXd& nodal, bool weight)
    {
        Eigen::VectorXd load = nodal, inner = Zero();
        Eigen::MatrixXd k = Zero() * Zero().transpose();
        const double ea = m_frame.materials[0].E * m_frame.sections[0].A;
        double length = 0.0;
        for (std::size_t e = 0; e < force.size(); ++e) {
            if (!active[e]) continue;
            const Eigen::VectorXd pull = Pull(e, length);
            inner += force[e] * pull;
            k += ea / length * pull * pull.transpose();
            const double half = 0.5 * length * m_frame.materials[0].density *
                                m_frame.sections[0].A * m_frame.gravity;
            for (const std::size_t n : {m_frame.elements[e].i, m_frame.elements[e].j})
                if (weight) load(static_cast<Eigen::Index>(2 * n + 1)) -= half;
        }
        Eigen::MatrixXd blocked = k;
        Eigen::VectorXd rest = load - inner;
        for (Eigen::Index i = 0; i < rest.size(); ++i) {
            if (!held[static_cast<std::size_t>(i)] && k(i, i) > 0.0) continue;
            blocked.row(i).setZero();
            blocked.col(i).setZero();
            blocked(i, i) = 1.0;
            rest(i) = 0.0;
        }
        const Eigen::VectorXd du = blocked.ldlt().solve(rest);
        u += du;
        for (std::size_t e = 0; e < force.size(); ++e)
            if (active[e]) {
                const Eigen::VectorXd pull = Pull(e, length);
                force[e] += ea / length * pull.dot(du);
            }
        reaction = inner + k * du - load;
        for (Eigen::Index i = 0; i < u.size(); ++i)
            if (!held[static_cast<std::size_t>(i)]) reaction(i) = 0.0;
    }

    const T_FRAME& m_frame;
    Eigen::VectorXd u, reaction;
    std::vector<double> force;
    std::vector<char> active, held;
};

/// Follows the stages and calls check(stage, step, state) after each step.
template <class CHECK>
void Follow(const T_STAGED_MODEL& model, const T_LOAD_CASE& load, std::size_t loadCase,
            const CHECK& check)
{
    CIncremental state(model.frame);
    bool on = false;
    const auto hold = [&](const T_STAGE_SUPPORT& s, char how) {
        const bool named = s.directions != T_DIRS6{};
        for (const std::size_t d : {0, 2})
            if (named && s.directions[d]) state.held[2 * s.node + d / 2] = how;
    };
    for (std::size_t s = 0; s < model.stages.size(); ++s) {
        const T_STAGE& stage = model.stages[s];
        for (const std::size_t e : stage.deactivateElements)
            state.active[e] = 0;
        for (const std::size_t e : stage.activateElements)
            state.active[e] = 1;
        for (const T_STAGE_SUPPORT& support : stage.deactivateSupports)
            hold(support, 0);
        for (const T_STAGE_SUPPORT& support : stage.activateSupports)
            hold(support, 1);
        for (int step = 1; step <= stage.steps; ++step) {
            const auto changes = [&](const std::vector<T_STAGE_LOAD>& loads) {
                for (const T_STAGE_LOAD& l : loads)
                    if (l.loadCase == loadCase &&
                        (l.step == kLastStep ? stage.steps : l.step) == step)
                        return true;
                return false;
            };
            const bool was = on;
            if (changes(stage.deactivateLoads)) on = false;
            if (changes(stage.activateLoads)) on = true;
            for (const T_PRETENSION& p : load.pretension)
                state.force[p.element] += (double(on) - double(was)) * p.force;
            Eigen::VectorXd nodal = state.Zero();
            for (const T_NODAL_LOAD& l : load.nodal)
                if (on)
                    nodal.segment<2>(static_cast<Eigen::Index>(2 * l.node)) +=
                        Eigen::Vector2d(l.load[0], l.load[2]);
            state.Balance(nodal, on && load.selfWeight[2] != 0.0);
            check(s, step, state);
        }
    }
}

TEST(StagedArch, EveryCaseFollowsTheIncrementalAnalysis)
{
    const T_STAGED_MODEL model = Stages();
    const std::vector<T_LOAD_CASE> cases = Cases();
    CStagedSolver staged;
    Build(staged, model, cases);
    double crane = 0.0; // what the crane leaves behind when it has gone
    for (std::size_t c = 0; c < kCases; ++c)
        Follow(model, cases[c], c, [&](std::size_t stage, int step, const CIncremental& state) {
            const T_RESULT r = Case(staged, stage, c, step);
            std::vector<std::array<double, 2>> u, uFound, held, heldFound;
            for (std::size_t n = 0; n < model.frame.nodes.size(); ++n) {
                const auto i = static_cast<Eigen::Index>(2 * n);
                u.push_back({state.u(i), state.u(i + 1)});
                uFound.push_back({r.displacement[n][0], r.displacement[n][2]});
                held.push_back({state.reaction(i), state.reaction(i + 1)});
                heldFound.push_back({r.reaction[n][0], r.reaction[n][2]});
            }
            ExpectRows(u, uFound, 1e-9, "displacement", 1e-6);
            ExpectRows(held, heldFound, 1e-9, "reaction", 1.0);
            std::vector<std::array<double, 1>> n, nFound;
            for (std::size_t e = 0; e < state.force.size(); ++e) {
                n.push_back({state.active[e] ? state.force[e] : 0.0});
                nFound.push_back({r.force[e][2][0]});
            }
            ExpectRows(n, nFound, 1e-9, "force", 1.0);
            if (c == 3 && stage == 2 && step == 2) crane = LargestOf(u);
        });
    EXPECT_GT(crane, 1e-5);
}

TEST(StagedArch, SumsOfGroupsSuperpose)
{
    CStagedSolver staged;
    Build(staged, Stages(), Cases());
    T_RESULT dead, all;
    for (std::size_t stage = 0; stage < staged.StageCount(); ++stage) {
        ASSERT_TRUE(staged.ReadSum(stage, kLastStep, STAGE_SUM::Dead, dead));
        ASSERT_TRUE(staged.ReadSum(stage, kLastStep, STAGE_SUM::All, all));
        ExpectSame(Sum(Case(staged, stage, 0), Case(staged, stage, 2)), dead, 1e-12);
        T_RESULT sum = dead;
        for (const std::size_t c : {1, 3, 4})
            sum = Sum(sum, Case(staged, stage, c));
        ExpectSame(sum, all, 1e-12);
    }
}

} // namespace
