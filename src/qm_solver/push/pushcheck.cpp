#include "qm_solver/push/pushcheck.h"

#include "qm_solver/push/hingebackbone.h"

#include <algorithm>
#include <cmath>
#include <set>
#include <tuple>

namespace solver {

namespace {

using T_REASON = std::optional<T_SOLVER_REASON>;

bool Allows(const T_ELEMENT& element, int component, double at)
{
    if (component < 0 || component > 5) return false;
    const auto d = static_cast<std::size_t>(component);
    switch (element.kind) {
    case ELEMENT_KIND::Beam:
        return true;
    case ELEMENT_KIND::Truss:
        return component == 0;
    case ELEMENT_KIND::Link:
    case ELEMENT_KIND::Spring:
        return at == 0.0 && element.stiffness[d] > 0.0;
    }
    return false;
}

/// A release anywhere along the beam carries no force of an axial or torsional hinge.
bool IsReleased(const T_ELEMENT& element, int component, double at)
{
    if (element.kind != ELEMENT_KIND::Beam) return false;
    const auto d = static_cast<std::size_t>(component);
    const bool i = element.releaseI[d], j = element.releaseJ[d];
    if (component == 0 || component == 3) return i || j;
    return (at <= 0.0 && i) || (at >= 1.0 && j);
}

T_REASON SideFault(const T_HINGE_SIDE& side, double spring)
{
    if (side.free) return {};
    if (side.points.empty()) return "IDS_QM_ENGINE_HINGE_NO_STRENGTH";
    for (const T_BACKBONE_POINT& p : side.points) {
        if (!std::isfinite(p.deformation) || !std::isfinite(p.force))
            return "IDS_QM_ENGINE_NOT_A_NUMBER";
        if (p.force < 0.0 || p.deformation < 0.0) return "IDS_QM_ENGINE_HINGE_NEGATIVE";
    }
    if (!(side.points[0].force > 0.0)) return "IDS_QM_ENGINE_HINGE_NO_STRENGTH";
    if (!(side.gap >= 0.0) || !std::isfinite(side.gap)) return "IDS_QM_ENGINE_HINGE_NEGATIVE";
    if (!CHingeBackbone::IsFlowing(side, spring)) return "IDS_QM_ENGINE_HINGE_FALLS";
    return {};
}

T_REASON LawFault(const T_HINGE_LAW& law)
{
    if (!(law.stiffness >= 0.0) || !std::isfinite(law.stiffness))
        return "IDS_QM_ENGINE_HINGE_NEGATIVE";
    for (const T_HINGE_SIDE* side : {&law.positive, &law.negative})
        if (T_REASON fault = SideFault(*side, law.stiffness)) return fault;
    for (std::size_t k = 0; k < law.byAxial.size(); ++k) {
        const T_AXIAL_STRENGTH& row = law.byAxial[k];
        const bool isNumber = std::isfinite(row.axial) && row.positive >= 0.0 &&
                              std::isfinite(row.positive) && row.negative >= 0.0 &&
                              std::isfinite(row.negative);
        if (!isNumber || (k > 0 && !(row.axial > law.byAxial[k - 1].axial)))
            return "IDS_QM_ENGINE_HINGE_AXIAL_ROWS";
    }
    if (law.byAxial.size() == 1 || (!law.byAxial.empty() && law.component == 0))
        return "IDS_QM_ENGINE_HINGE_AXIAL_ROWS";
    return {};
}

/// Rows ascend, every corner stands out beyond the line between its neighbours.
bool IsShape(const std::vector<T_AXIAL_SHAPE>& rows)
{
    const auto corners = BiaxialCorners();
    constexpr double kStraight = 1e-9;
    for (std::size_t r = 0; r < rows.size(); ++r) {
        if (!std::isfinite(rows[r].axial) || (r > 0 && !(rows[r].axial > rows[r - 1].axial)))
            return false;
        for (std::size_t k = 0; k < kBiaxialCorners; ++k) {
            const std::size_t a = (k + kBiaxialCorners - 1) % kBiaxialCorners;
            const std::size_t b = (k + 1) % kBiaxialCorners;
            const auto& share = rows[r].share;
            if (!(share[k] > 0.0) || !std::isfinite(share[k])) return false;
            const double line = std::sin(corners[b] - corners[k]) / share[a] +
                                std::sin(corners[k] - corners[a]) / share[b];
            if (std::sin(corners[b] - corners[a]) / share[k] > line * (1.0 + kStraight))
                return false;
        }
    }
    return true;
}

} // namespace

std::optional<T_SOLVER_ERROR> CheckHinges(const T_PUSH_MODEL& model)
{
    std::set<std::tuple<std::size_t, double, int>> taken;
    for (std::size_t h = 0; h < model.hinges.size(); ++h) {
        const T_PUSH_HINGE& hinge = model.hinges[h];
        T_REASON reason;
        const bool isThere = hinge.element < model.frame.elements.size();
        if (!isThere || !(hinge.at >= 0.0 && hinge.at <= 1.0)) reason = "IDS_QM_ENGINE_HINGE_PLACE";
        if (!reason && !IsShape(hinge.shape)) reason = "IDS_QM_ENGINE_HINGE_SHAPE";
        for (std::size_t l = 0; l < hinge.laws.size() && !reason; ++l) {
            const T_HINGE_LAW& law = hinge.laws[l];
            const T_ELEMENT& element = model.frame.elements[hinge.element];
            if (!Allows(element, law.component, hinge.at))
                reason = "IDS_QM_ENGINE_HINGE_PLACE";
            else if (IsReleased(element, law.component, hinge.at))
                reason = "IDS_QM_ENGINE_HINGE_RELEASED";
            else if (!taken.emplace(hinge.element, hinge.at, law.component).second)
                reason = "IDS_QM_ENGINE_HINGE_TWICE";
            else
                reason = LawFault(law);
        }
        if (!reason) continue;
        T_SOLVER_ERROR error;
        error.fault = SOLVER_FAULT::BadModel;
        if (isThere) error.element = static_cast<long>(hinge.element);
        error.reason = *reason;
        return error;
    }
    return {};
}

std::optional<T_SOLVER_ERROR> CheckStage(const T_PUSH_MODEL& model, const CFrameDofs& dofs,
                                         const T_PUSH_STAGE& stage, std::size_t number)
{
    T_SOLVER_ERROR error;
    error.fault = SOLVER_FAULT::BadModel;
    error.stage = static_cast<long>(number);
    const auto fail = [&](T_SOLVER_REASON reason) {
        error.reason = std::move(reason);
        return error;
    };
    if (stage.node >= model.frame.nodes.size() || stage.direction < 0 || stage.direction > 5)
        return fail("IDS_QM_ENGINE_PUSH_NO_NODE");
    const T_VEC6 way = WayOf(stage);
    bool moves = false;
    for (std::size_t d = 0; d < way.size(); ++d)
        moves |= way[d] != 0.0 && !dofs.Terms(6 * stage.node + d).empty();
    if (stage.control == PUSH_CONTROL::Displacement && !moves) {
        error.node = static_cast<long>(stage.node);
        error.direction = stage.direction;
        return fail("IDS_QM_ENGINE_PUSH_CONTROL_FIXED");
    }
    if (!std::isfinite(stage.target) || stage.target == 0.0)
        return fail("IDS_QM_ENGINE_PUSH_NO_TARGET");
    double before = 0.0;
    for (const double fraction : stage.steps) {
        if (!(fraction > before && fraction <= 1.0)) return fail("IDS_QM_ENGINE_PUSH_STEPS");
        before = fraction;
    }
    if (!stage.steps.empty() && before != 1.0) return fail("IDS_QM_ENGINE_PUSH_STEPS");
    return {};
}

} // namespace solver
