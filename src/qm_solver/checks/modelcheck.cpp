#include "qm_solver/checks/modelcheck.h"

#include "qm_solver/element/beamelement.h"

#include <algorithm>
#include <cmath>
#include <set>
#include <tuple>

namespace solver {

namespace {

using T_FAULT = std::optional<T_SOLVER_ERROR>;

T_SOLVER_ERROR Bad(T_SOLVER_REASON reason)
{
    T_SOLVER_ERROR error;
    error.fault = SOLVER_FAULT::BadModel;
    error.reason = std::move(reason);
    return error;
}
T_SOLVER_ERROR BadNode(std::size_t node, T_SOLVER_REASON reason)
{
    T_SOLVER_ERROR error = Bad(std::move(reason));
    error.node = static_cast<long>(node);
    return error;
}
T_SOLVER_ERROR BadElement(std::size_t element, T_SOLVER_REASON reason)
{
    T_SOLVER_ERROR error = Bad(std::move(reason));
    error.element = static_cast<long>(element);
    return error;
}

template <class R>
bool Finite(const R& values)
{
    return std::all_of(values.begin(), values.end(), [](double v) { return std::isfinite(v); });
}
template <class R>
bool NotNegative(const R& values)
{
    return std::all_of(values.begin(), values.end(),
                       [](double v) { return std::isfinite(v) && v >= 0.0; });
}
template <class R>
bool AllZero(const R& values)
{
    return std::all_of(values.begin(), values.end(), [](double v) { return v == 0.0; });
}
template <class R>
bool AnyTrue(const R& values)
{
    return std::any_of(values.begin(), values.end(), [](bool v) { return v; });
}

bool HasSection(const T_ELEMENT& element)
{
    return element.kind == ELEMENT_KIND::Beam || element.kind == ELEMENT_KIND::Truss;
}

T_FAULT CheckNodes(const T_FRAME& frame)
{
    for (std::size_t n = 0; n < frame.nodes.size(); ++n) {
        const T_NODE& node = frame.nodes[n];
        if (!Finite(node.xyz)) return BadNode(n, "IDS_QM_ENGINE_COORDINATE");
        if (!NotNegative(node.mass)) return BadNode(n, "IDS_QM_ENGINE_MASS");
    }
    return {};
}

/// What a beam or truss needs of its material and section; empty if all is there.
T_SOLVER_REASON SectionFault(const T_FRAME& frame, const T_ELEMENT& element)
{
    if (element.material >= frame.materials.size()) return "IDS_QM_ENGINE_NO_MATERIAL";
    if (element.section >= frame.sections.size()) return "IDS_QM_ENGINE_NO_SECTION";
    const T_MATERIAL& m = frame.materials[element.material];
    const T_SECTION& s = frame.sections[element.section];
    if (!(std::isfinite(m.E) && m.E > 0.0)) return "IDS_QM_ENGINE_MODULUS_E";
    if (!NotNegative(std::array{m.G, m.density})) return "IDS_QM_ENGINE_MODULUS_G";
    if (!std::isfinite(m.alpha)) return "IDS_QM_ENGINE_EXPANSION";
    for (const double area : {s.A, s.StiffA()})
        if (!(std::isfinite(area) && area > 0.0)) return "IDS_QM_ENGINE_AREA";
    if (!NotNegative(std::array{s.Asy, s.Asz})) return "IDS_QM_ENGINE_SHEAR_AREA";
    if (!NotNegative(std::array{s.J, s.Iy, s.Iz})) return "IDS_QM_ENGINE_INERTIA";
    if (element.kind == ELEMENT_KIND::Beam && m.G == 0.0 && (s.J > 0.0 || s.Asy + s.Asz > 0.0))
        return "IDS_QM_ENGINE_NEEDS_G";
    return {};
}

T_SOLVER_REASON ShapeFault(const T_FRAME& frame, const T_ELEMENT& element)
{
    if (!Finite(element.zAxis) || !Finite(element.offsetI) || !Finite(element.offsetJ))
        return "IDS_QM_ENGINE_REFERENCE";
    const bool extras = !AllZero(element.offsetI) || !AllZero(element.offsetJ) ||
                        AnyTrue(element.releaseI) || AnyTrue(element.releaseJ);
    if (extras && element.kind != ELEMENT_KIND::Beam) return "IDS_QM_ENGINE_BEAMS_ALONE";
    if (!HasSection(element)) {
        if (!NotNegative(element.stiffness)) return "IDS_QM_ENGINE_STIFFNESS";
        return AllZero(element.stiffness) ? "IDS_QM_ENGINE_NO_STIFFNESS" : "";
    }
    T_AXES axes;
    double length = 0.0;
    if (BeamAxes(frame, element, axes, length)) return {};
    const T_ELEMENT plain{element.kind, element.i,       element.j,       0, 0, {}, {},
                          {},           element.offsetI, element.offsetJ, {}};
    if (element.kind == ELEMENT_KIND::Truss && BeamAxes(frame, plain, axes, length)) return {};
    return BeamAxes(frame, plain, axes, length) ? "IDS_QM_ENGINE_PARALLEL"
                                                : "IDS_QM_ENGINE_ZERO_LENGTH";
}

T_FAULT CheckReleases(const T_FRAME& frame, std::size_t e)
{
    const T_ELEMENT& element = frame.elements[e];
    if (!AnyTrue(element.releaseI) && !AnyTrue(element.releaseJ)) return {};
    const int loose = CBeamElement(frame, element).Loose();
    if (loose < 0) return {};
    const char* const key = loose % 6 < 3 ? "IDS_QM_ENGINE_LOOSE_MOVE" : "IDS_QM_ENGINE_LOOSE_TURN";
    T_SOLVER_ERROR error = BadElement(e, {key, {std::string(1, "xyz"[loose % 3])}});
    error.fault = SOLVER_FAULT::Mechanism;
    error.direction = loose % 6;
    return error;
}

/// Two elements that no difference tells apart.
T_FAULT CheckDuplicates(const T_FRAME& frame)
{
    using T_KEY = std::tuple<ELEMENT_KIND, std::size_t, std::size_t, std::size_t, std::size_t,
                             T_VEC3, T_VEC3, T_VEC6>;
    std::set<T_KEY> seen;
    for (std::size_t e = 0; e < frame.elements.size(); ++e) {
        const T_ELEMENT& el = frame.elements[e];
        if (el.kind == ELEMENT_KIND::Spring) continue; // springs in parallel are meant
        const bool turned = el.j < el.i, section = HasSection(el);
        const T_KEY key{el.kind,
                        turned ? el.j : el.i,
                        turned ? el.i : el.j,
                        section ? el.material : 0,
                        section ? el.section : 0,
                        turned ? el.offsetJ : el.offsetI,
                        turned ? el.offsetI : el.offsetJ,
                        section ? T_VEC6{} : el.stiffness};
        if (!seen.insert(key).second) return BadElement(e, "IDS_QM_ENGINE_TWICE");
    }
    return {};
}

T_FAULT CheckElements(const T_FRAME& frame)
{
    for (std::size_t e = 0; e < frame.elements.size(); ++e) {
        const T_ELEMENT& element = frame.elements[e];
        const bool one = element.kind == ELEMENT_KIND::Spring;
        if (element.i >= frame.nodes.size() || (!one && element.j >= frame.nodes.size()))
            return BadElement(e, "IDS_QM_ENGINE_NO_NODE");
        if (!one && element.i == element.j) return BadElement(e, "IDS_QM_ENGINE_ONE_NODE");
        T_SOLVER_REASON reason;
        if (HasSection(element)) reason = SectionFault(frame, element);
        if (reason.empty()) reason = ShapeFault(frame, element);
        if (!reason.empty()) return BadElement(e, reason);
        if (T_FAULT fault = CheckReleases(frame, e)) return fault;
    }
    return CheckDuplicates(frame);
}

T_FAULT CheckTies(const T_FRAME& frame)
{
    const auto missing = [&](const std::vector<std::size_t>& nodes) {
        return std::any_of(nodes.begin(), nodes.end(),
                           [&](std::size_t n) { return n >= frame.nodes.size(); });
    };
    for (const T_DIAPHRAGM& d : frame.diaphragms) {
        if (missing(d.nodes)) return Bad("IDS_QM_ENGINE_DIAPHRAGM_NODE");
        if (d.normal < 0 || d.normal > 2) return Bad("IDS_QM_ENGINE_DIAPHRAGM_NORMAL");
    }
    for (const T_EQUAL_DISPLACEMENT& d : frame.equalDisplacements)
        if (missing(d.nodes)) return Bad("IDS_QM_ENGINE_EQUAL_NODE");
    return {};
}

// ---- load cases ---------------------------------------------------------------------------------

constexpr const char* kNotFinite = "IDS_QM_ENGINE_LOAD_NOT_FINITE";

/// A load on a direction that nothing holds, of a node.
T_FAULT CheckHeld(const CFrameDofs& dofs, std::size_t node, const T_VEC6& load)
{
    for (std::size_t d = 0; d < 6; ++d) {
        if (load[d] == 0.0 || !dofs.Inactive(6 * node + d)) continue;
        T_SOLVER_ERROR error = BadNode(node, {"IDS_QM_ENGINE_LOAD_UNHELD", {DirectionName(d)}});
        error.direction = static_cast<int>(d);
        return error;
    }
    return {};
}

T_FAULT CheckNodal(const T_FRAME& frame, const CFrameDofs& dofs, const T_LOAD_CASE& load)
{
    for (const T_NODAL_LOAD& l : load.nodal) {
        if (l.node >= frame.nodes.size()) return BadNode(l.node, "IDS_QM_ENGINE_LOAD_NO_NODE");
        if (!Finite(l.load)) return BadNode(l.node, kNotFinite);
        if (T_FAULT fault = CheckHeld(dofs, l.node, l.load)) return fault;
    }
    return {};
}

T_SOLVER_REASON BeamLoadFault(const T_FRAME& frame, const T_BEAM_LOAD& l)
{
    if (l.element >= frame.elements.size()) return "IDS_QM_ENGINE_LOAD_NO_ELEMENT";
    const ELEMENT_KIND kind = frame.elements[l.element].kind;
    if (!HasSection(frame.elements[l.element])) return "IDS_QM_ENGINE_LOAD_ON_LINK";
    if (l.direction < 0 || l.direction > 2) return "IDS_QM_ENGINE_LOAD_DIRECTION";
    if (!Finite(l.w) || !Finite(l.at)) return kNotFinite;
    const bool distributed = l.type == BEAM_LOAD::Distributed;
    if (!(l.at[0] >= 0.0 && l.at[0] <= 1.0 && (!distributed || l.at[1] <= 1.0)))
        return "IDS_QM_ENGINE_LOAD_OUTSIDE";
    if (distributed && !(l.at[1] > l.at[0])) return "IDS_QM_ENGINE_LOAD_NO_EXTENT";
    if (kind == ELEMENT_KIND::Truss && l.local) return "IDS_QM_ENGINE_TRUSS_LOCAL";
    if (kind == ELEMENT_KIND::Truss && l.type == BEAM_LOAD::Moment)
        return "IDS_QM_ENGINE_TRUSS_MOMENT";
    return {};
}

T_FAULT CheckElementLoads(const T_FRAME& frame, const T_LOAD_CASE& load)
{
    for (const T_BEAM_LOAD& l : load.beam)
        if (T_SOLVER_REASON reason = BeamLoadFault(frame, l); !reason.empty())
            return BadElement(l.element, reason);
    const auto check = [&](std::size_t e, double value, const char* refusal) -> T_FAULT {
        if (e >= frame.elements.size()) return BadElement(e, "IDS_QM_ENGINE_LOAD_NO_ELEMENT");
        if (!std::isfinite(value)) return BadElement(e, kNotFinite);
        if (HasSection(frame.elements[e])) return {};
        return BadElement(e, refusal);
    };
    for (const T_TEMPERATURE& t : load.temperature)
        if (T_FAULT fault = check(t.element, t.change, "IDS_QM_ENGINE_LINK_TEMPERATURE"))
            return fault;
    for (const T_PRETENSION& t : load.pretension)
        if (T_FAULT fault = check(t.element, t.force, "IDS_QM_ENGINE_LINK_TENSION")) return fault;
    return {};
}

T_FAULT CheckSettlements(const T_FRAME& frame, const CFrameDofs& dofs, const T_LOAD_CASE& load)
{
    std::vector<double> given(dofs.FullCount(), 0.0);
    for (const T_SETTLEMENT& s : load.settlement) {
        if (s.node >= frame.nodes.size())
            return BadNode(s.node, "IDS_QM_ENGINE_SETTLEMENT_NO_NODE");
        if (!Finite(s.displacement)) return BadNode(s.node, "IDS_QM_ENGINE_SETTLEMENT_NOT_FINITE");
        for (std::size_t d = 0; d < 6; ++d) {
            given[6 * s.node + d] += s.displacement[d];
            if (s.displacement[d] == 0.0 || frame.nodes[s.node].fixed[d]) continue;
            T_SOLVER_ERROR error =
                BadNode(s.node, {"IDS_QM_ENGINE_SETTLEMENT_FREE", {DirectionName(d)}});
            error.direction = static_cast<int>(d);
            return error;
        }
    }
    constexpr double kAgree = 1e-9; // of the largest displacement in the relation
    for (const T_RELATION& demand : dofs.Demands()) {
        double sum = 0.0, largest = 0.0;
        for (const T_TERM& t : demand) {
            const double part = t.factor * given[static_cast<std::size_t>(t.index)];
            sum += part;
            largest = std::max(largest, std::fabs(part));
        }
        if (std::fabs(sum) > kAgree * largest)
            return BadNode(static_cast<std::size_t>(demand[0].index) / 6,
                           "IDS_QM_ENGINE_SETTLEMENT_FORBIDDEN");
    }
    return {};
}

} // namespace

std::optional<T_SOLVER_ERROR> CheckModel(const T_FRAME& frame)
{
    if (frame.nodes.empty() || frame.elements.empty()) return Bad("IDS_QM_ENGINE_NO_NODES");
    if (!(std::isfinite(frame.gravity) && frame.gravity >= 0.0))
        return Bad("IDS_QM_ENGINE_GRAVITY");
    for (const auto& check : {CheckNodes, CheckElements, CheckTies})
        if (T_FAULT fault = check(frame)) return fault;
    return {};
}

std::optional<T_SOLVER_ERROR> CheckCase(const T_FRAME& frame, const CFrameDofs& dofs,
                                        const T_LOAD_CASE& load, std::size_t loadCase)
{
    T_FAULT fault;
    if (!Finite(load.selfWeight)) fault = Bad(kNotFinite);
    if (!fault) fault = CheckNodal(frame, dofs, load);
    if (!fault) fault = CheckElementLoads(frame, load);
    if (!fault) fault = CheckSettlements(frame, dofs, load);
    if (fault) fault->loadCase = static_cast<long>(loadCase);
    return fault;
}

const char* DirectionName(std::size_t direction)
{
    constexpr std::array<const char*, 6> kNames{"X", "Y", "Z", "RX", "RY", "RZ"};
    return direction < kNames.size() ? kNames[direction] : "?";
}

} // namespace solver
