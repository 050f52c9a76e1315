#include "qm_rps/push/casegenerator.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/push/loadalgebra.h"
#include "qm_rps/push/pushrun.h"
#include "qm_rps/push/pushstoreys.h"
#include "qm_solver/framesolver.h"

#include <algorithm>
#include <cmath>
#include <ranges>

namespace {

constexpr std::array<const char*, 2> kAxes{"X", "Y"};
constexpr double kTargetOfHeight = 0.02;
constexpr int kUniform = 1, kModeTimesMass = 3; // kinds of pattern rows

int Fail(std::string& error, std::string text)
{
    error = std::move(text);
    return 0;
}

/// One case of the choice.
struct T_WANTED {
    std::size_t direction = 0; // 0 X, 1 Y
    int sign = 1;
    bool uniform = true;
    int eccentric = 0; // sign; 0: none
};

std::vector<T_WANTED> WantedOf(const T_CASE_CHOICE& choice)
{
    std::vector<int> eccentric;
    if (choice.eccentricity == 0.0) eccentric = {0};
    if (choice.eccentricity != 0.0 && choice.plus) eccentric.push_back(1);
    if (choice.eccentricity != 0.0 && choice.minus) eccentric.push_back(-1);
    std::vector<T_WANTED> out;
    for (std::size_t d = 0; d < 2; ++d)
        for (const bool uniform : {true, false})
            for (const int sign : {1, -1})
                for (const int e : eccentric)
                    if (choice.directions[d] && (uniform ? choice.uniform : choice.mode))
                        out.push_back({d, sign, uniform, e});
    return out;
}

std::string NameOf(const T_WANTED& w)
{
    const auto sign = [](int s) { return std::string(s > 0 ? "+" : "-"); };
    return std::string("P") + kAxes[w.direction] + sign(w.sign) +
           (w.uniform ? " uniform" : " mode") + (w.eccentric ? " e" + sign(w.eccentric) : "");
}

double MassAlong(const CAnalysisModel& frame, std::size_t direction)
{
    double sum = 0.0;
    for (const solver::T_VEC3& mass : NodeMasses(frame.Frame()))
        sum += mass[direction];
    return sum;
}

bool IsFree(const CAnalysisModel& frame, std::size_t node, std::size_t direction)
{
    return !frame.Frame().nodes[node].fixed[direction];
}

/// Of the top storey the node nearest to the centre of mass; without storeys the highest node.
std::size_t TopNodeOf(const T_MODEL& model, const CAnalysisModel& frame, std::size_t direction)
{
    const auto& nodes = frame.Frame().nodes;
    const std::vector<T_PUSH_STOREY> storeys = StoreysOf(model, frame, direction);
    const std::size_t vertical = VerticalAxis(model);
    if (storeys.empty()) {
        const auto top = std::ranges::max_element(
            nodes, {}, [&](const auto& node) { return node.xyz[vertical]; });
        return static_cast<std::size_t>(top - nodes.begin());
    }
    const T_PUSH_STOREY& top = storeys.back();
    solver::T_VEC3 centre{};
    for (std::size_t i = 0; i < top.nodes.size(); ++i)
        for (std::size_t d = 0; d < 3; ++d)
            centre[d] += top.weights[i] * nodes[top.nodes[i]].xyz[d];
    const auto distance = [&](std::size_t node) {
        const solver::T_VEC3& at = nodes[node].xyz;
        return std::hypot(at[0] - centre[0], at[1] - centre[1], at[2] - centre[2]);
    };
    constexpr double kAlike = 1e-9; // of nodes that are equally far the first one counts
    std::size_t nearest = top.nodes.front();
    for (const std::size_t node : top.nodes)
        if (distance(node) < distance(nearest) * (1.0 - kAlike)) nearest = node;
    return nearest;
}

/// Makes the cases of one document.
class CGenerator {
public:
    CGenerator(CDBDoc& doc, const T_CASE_CHOICE& choice)
        : m_doc(doc), m_model(doc.Data().Model()), m_choice(choice), m_frame(m_model)
    {
    }

    int Run(std::vector<T_POLC_D>& out, T_CASE_BASIS& basis, std::string& error)
    {
        const std::vector<T_WANTED> wanted = WantedOf(m_choice);
        if (!CheckChoice(wanted, error)) return 0;
        T_ANALYSIS_ERROR fault;
        if (!m_frame.BuildFrame(fault)) return Fail(error, fault.text);
        if (!FindNode(error) || !FindTarget(error)) return 0;
        std::vector<T_POLC_D> cases;
        for (const T_WANTED& w : wanted) {
            if (!MakeCase(w, cases.emplace_back(), error)) return 0;
            RecordFromSi(cases.back(), m_doc.Unit().Units());
        }
        m_basis.height = FromSi(m_basis.height, m_doc.Unit().Units(), kDimLength);
        m_basis.target = FromSi(m_basis.target, m_doc.Unit().Units(), kDimLength);
        out = std::move(cases);
        basis = m_basis;
        return 1;
    }

private:
    int CheckChoice(const std::vector<T_WANTED>& wanted, std::string& error) const
    {
        if (!(std::fabs(m_choice.eccentricity) < 0.5))
            return Fail(error, Say("IDS_QM_PUSH_ECCENTRICITY"));
        if (m_choice.target && !(std::isfinite(*m_choice.target) && *m_choice.target > 0.0))
            return Fail(error, Say("IDS_QM_PUSH_GEN_TARGET"));
        if (!m_choice.directions[0] && !m_choice.directions[1])
            return Fail(error, Say("IDS_QM_PUSH_GEN_NO_DIRECTION"));
        if (wanted.empty()) return Fail(error, Say("IDS_QM_PUSH_GEN_NOTHING"));
        for (const T_WANTED& w : wanted)
            for (const auto& [key, other] : m_model.pushovers)
                if (other.name == NameOf(w))
                    return Fail(error, Say("IDS_QM_PUSH_GEN_NAME_TAKEN", other.name));
        return 1;
    }

    int FindNode(std::string& error)
    {
        const std::vector<int>& ids = m_frame.NodeIds();
        if (ids.empty()) return Fail(error, Say("IDS_QM_UI_POLC_NO_NODE"));
        if (m_choice.controlNode != 0) {
            const auto at = std::ranges::lower_bound(ids, m_choice.controlNode);
            if (at == ids.end() || *at != m_choice.controlNode)
                return Fail(error, Say("IDS_QM_UI_POLC_NO_NODE"));
            m_node = static_cast<std::size_t>(at - ids.begin());
        } else {
            m_node = TopNodeOf(m_model, m_frame, m_choice.directions[0] ? 0 : 1);
        }
        m_basis.controlNode = ids[m_node];
        for (std::size_t d = 0; d < 2; ++d) {
            if (!m_choice.directions[d]) continue;
            if (!IsFree(m_frame, m_node, d) || d == VerticalAxis(m_model))
                return Fail(error, Say("IDS_QM_PUSH_CASE_FIXED", std::to_string(ids[m_node]),
                                       kDirectionNames[d]));
            if (!(MassAlong(m_frame, d) > 0.0))
                return Fail(error, Say("IDS_QM_PUSH_GEN_NO_MASS", kAxes[d]));
        }
        return 1;
    }

    int FindTarget(std::string& error)
    {
        const auto& nodes = m_frame.Frame().nodes;
        const std::size_t vertical = VerticalAxis(m_model);
        const auto lowest = std::ranges::min_element(
            nodes, {}, [&](const auto& node) { return node.xyz[vertical]; });
        m_basis.height = nodes[m_node].xyz[vertical] - lowest->xyz[vertical];
        m_basis.target = m_choice.target ? ToSi(*m_choice.target, m_doc.Unit().Units(), kDimLength)
                                         : kTargetOfHeight * m_basis.height;
        return m_basis.target > 0.0 ? 1 : Fail(error, Say("IDS_QM_PUSH_GEN_NO_HEIGHT"));
    }

    /// Takes the mode with the largest mass in the direction; the first of equal ones.
    template <class PERCENT>
    void TakeMode(std::size_t direction, int mode, const PERCENT& percent)
    {
        constexpr double kAlike = 1e-9, kLeast = 1e-3; // per cent: less is noise
        double& best = m_basis.massPercent[direction];
        if (!(percent[direction] > std::max(kLeast, best * (1.0 + kAlike)))) return;
        best = percent[direction];
        m_basis.mode[direction] = mode;
    }

    int FindMode(std::size_t direction, std::string& error)
    {
        if (m_basis.mode[direction] != 0) return 1;
        m_basis.ownModes = !m_model.modes.empty();
        T_MPAM_D percent;
        for (const auto& [mode, record] : m_model.modes)
            if (m_doc.Post().GetEiMpam(mode, percent)) TakeMode(direction, mode, percent.percent);
        if (!m_basis.ownModes) {
            if (!ComputeModes(error)) return 0;
            for (std::size_t i = 0; i < m_modes.size(); ++i)
                TakeMode(direction, static_cast<int>(i) + 1, m_modes[i].massPercent);
        }
        if (m_basis.mode[direction] != 0) return 1;
        return Fail(error, Say("IDS_QM_PUSH_GEN_NO_MODE", kAxes[direction]));
    }

    int ComputeModes(std::string& error)
    {
        constexpr std::size_t kCount = 12;
        std::string why;
        if (!m_modes.empty() || CPushRun(m_doc).Modes(kCount, m_modes, why)) return 1;
        solver::CFrameSolver solver; // hinges that can't be pushed yet: the elastic frame
        solver::T_SOLVER_ERROR fault;
        if (solver.Prepare(m_frame.Frame(), fault) && solver.Modes(kCount, m_modes, fault))
            return 1;
        return Fail(error, m_frame.ErrorOf(fault, {}).text);
    }

    /// Which way the pattern has to go for a push to the plus side: the push scales a mode that it
    /// computes to +1 at the control node. 0: the mode leaves that node at rest.
    int SenseOf(int mode, std::size_t direction) const
    {
        const auto sense = [direction](const T_DOF6& control, const auto& all) {
            constexpr double kStill = 1e-9; // of the largest movement
            double largest = 0.0;
            for (const T_DOF6& at : all)
                for (const double x : at)
                    largest = std::max(largest, std::fabs(x));
            const double moves = control[direction];
            return std::fabs(moves) > kStill * largest ? (moves > 0.0 ? 1 : -1) : 0;
        };
        if (!m_basis.ownModes) {
            const auto& shape = m_modes[static_cast<std::size_t>(mode - 1)].shape;
            return std::abs(sense(shape[m_node], shape));
        }
        const auto& shape = m_model.modes.at(mode).shape;
        const auto at = shape.find(m_basis.controlNode);
        return at == shape.end() ? 0 : sense(at->second, std::views::values(shape));
    }

    int MakePattern(const T_WANTED& w, T_POLC_PATTERN& row, std::string& error)
    {
        row = {kUniform, static_cast<int>(w.direction) + 1, static_cast<double>(w.sign)};
        if (w.uniform) return 1;
        if (!FindMode(w.direction, error)) return 0;
        const int mode = m_basis.mode[w.direction];
        const int sense = SenseOf(mode, w.direction);
        if (sense == 0)
            return Fail(error, Say("IDS_QM_PUSH_PATTERN_MODE_STILL", std::to_string(mode)));
        row = {kModeTimesMass, mode, sense * row.factor};
        return 1;
    }

    int MakeCase(const T_WANTED& w, T_POLC_D& out, std::string& error)
    {
        out.name = NameOf(w);
        out.controlNode = m_basis.controlNode;
        out.direction = static_cast<int>(w.direction) + 1;
        out.eccentricity = w.eccentric * std::fabs(m_choice.eccentricity);
        out.control.emplace().masterMaxDispl = w.sign * m_basis.target;
        if (!MakePattern(w, out.patterns.emplace_back(), error)) return 0;
        TakeMasterPattern(out);
        if (out.eccentricity == 0.0) return 1;
        T_POLC_D probe = out; // whether the storeys give the eccentricity an effect
        probe.patterns = {{kUniform, out.direction, static_cast<double>(w.sign)}};
        solver::T_LOAD_CASE loads;
        return BuildPattern(m_model, m_frame, probe, {}, loads, error);
    }

    CDBDoc& m_doc;
    const T_MODEL& m_model;
    const T_CASE_CHOICE& m_choice;
    CAnalysisModel m_frame;
    std::size_t m_node = 0;
    std::vector<solver::T_MODE> m_modes;
    T_CASE_BASIS m_basis; // lengths in SI
};

} // namespace

namespace {

constexpr double kLowMass = 50.0; // per cent: most of the mass does not follow such a mode

bool IsLow(const T_CASE_BASIS& basis, std::size_t direction)
{
    return basis.mode[direction] != 0 && basis.massPercent[direction] < kLowMass;
}

} // namespace

std::string ModeBasisText(const T_CASE_BASIS& basis)
{
    std::string text;
    for (std::size_t d = 0; d < basis.mode.size(); ++d) {
        if (basis.mode[d] == 0) continue;
        const std::string mode = std::to_string(basis.mode[d]);
        const std::string percent = FormatText("%.1f", basis.massPercent[d]);
        text += (text.empty() ? "" : "\n") +
                Say(basis.ownModes ? "IDS_QM_PUSH_GEN_MODE" : "IDS_QM_PUSH_GEN_MODE_COMPUTED",
                    kAxes[d], mode, percent);
        if (IsLow(basis, d)) text += "\n" + Say("IDS_QM_PUSH_GEN_LOW_MASS", kAxes[d], mode);
    }
    return text;
}

bool HasLowMass(const T_CASE_BASIS& basis)
{
    return IsLow(basis, 0) || IsLow(basis, 1);
}

std::array<bool, 2> PushableDirections(const T_MODEL& model)
{
    std::array<bool, 2> out{};
    CAnalysisModel frame(model);
    T_ANALYSIS_ERROR fault;
    if (!frame.BuildFrame(fault) || frame.NodeIds().empty()) return out;
    for (std::size_t d = 0; d < 2; ++d)
        out[d] = d != VerticalAxis(model) && MassAlong(frame, d) > 0.0 &&
                 IsFree(frame, TopNodeOf(model, frame, d), d);
    return out;
}

std::vector<std::string> CaseNames(const T_CASE_CHOICE& choice)
{
    std::vector<std::string> names;
    for (const T_WANTED& w : WantedOf(choice))
        names.push_back(NameOf(w));
    return names;
}

int GenerateCases(CDBDoc& doc, const T_CASE_CHOICE& choice, std::vector<T_POLC_D>& out,
                  T_CASE_BASIS& basis, std::string& error)
{
    return CGenerator(doc, choice).Run(out, basis, error);
}
