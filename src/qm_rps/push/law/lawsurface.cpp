#include "qm_rps/push/law/lawsurface.h"

#include "qm_base/say.h"

#include <cmath>
#include <numbers>

namespace {

using T_SHARES = std::array<double, solver::kBiaxialCorners>;

constexpr std::size_t kOfQuadrant = solver::kBiaxialCorners / 4;
constexpr double kAside = 0.07; // of 1: what the shares beside an axis may differ from it
constexpr double kMoved = 0.03; // of a share: how far a corner may be moved out
constexpr double kSettled = 1e-10;
constexpr int kMostPasses = 200;

bool IsBesideAxis(std::size_t corner)
{
    return corner % kOfQuadrant == 0 || corner % kOfQuadrant == kOfQuadrant - 1;
}

/// The directions of the engine's corners by the signs of sections: My the other way round.
T_SHARES Directions()
{
    T_SHARES angles = solver::BiaxialCorners();
    for (double& a : angles)
        a = std::numbers::pi - a;
    return angles;
}

/// Moves corners that lie within the line of their neighbours out to it.
void MakeConvex(T_SHARES& share)
{
    static const T_SHARES corners = solver::BiaxialCorners();
    bool moved = true;
    for (int pass = 0; moved && pass < kMostPasses; ++pass) {
        moved = false;
        for (std::size_t k = 0; k < share.size(); ++k) {
            const std::size_t a = (k + share.size() - 1) % share.size();
            const std::size_t b = (k + 1) % share.size();
            const double line =
                std::sin(corners[b] - corners[a]) / (std::sin(corners[b] - corners[k]) / share[a] +
                                                     std::sin(corners[k] - corners[a]) / share[b]);
            if (share[k] >= line * (1.0 - kSettled)) continue;
            share[k] = line;
            moved = true;
        }
    }
}

/// False where the section bends aside, or the surface is far from convex.
bool ShapeOf(const T_SURFACE_ROW& row, T_SHARES& out)
{
    for (std::size_t k = 0; k < out.size(); ++k) {
        out[k] = IsBesideAxis(k) ? 1.0 : row.share[k];
        if (std::fabs(row.share[k] - out[k]) > kAside) return false;
    }
    const T_SHARES exact = out;
    MakeConvex(out);
    for (std::size_t k = 0; k < out.size(); ++k)
        if (out[k] > exact[k] * (1.0 + kMoved)) return false;
    return true;
}

} // namespace

int SurfaceShape(const CHingeSources& sources, int section, int material,
                 const solver::T_HINGE_LAW& law, std::vector<solver::T_AXIAL_SHAPE>& out,
                 std::string& reason)
{
    static const T_SHARES directions = Directions();
    const std::vector<T_SURFACE_ROW>& rows = sources.Surface(section, material, directions);
    if (rows.empty() || law.byAxial.empty()) {
        reason = Say("IDS_QM_PUSH_LAW_NO_SURFACE");
        return 0;
    }
    std::vector<solver::T_AXIAL_SHAPE> shape;
    for (auto row = rows.rbegin(); row != rows.rend(); ++row) {
        solver::T_AXIAL_SHAPE& made = shape.emplace_back();
        made.axial = -row->axial;
        if (!ShapeOf(*row, made.share)) {
            reason = Say("IDS_QM_PUSH_LAW_SURFACE_ASIDE");
            return 0;
        }
    }
    const auto stretch = [](solver::T_AXIAL_SHAPE row, double axial) {
        row.axial = axial;
        return row;
    };
    const double low = law.byAxial.front().axial, high = law.byAxial.back().axial;
    if (low < shape.front().axial) shape.insert(shape.begin(), stretch(shape.front(), low));
    if (high > shape.back().axial) shape.push_back(stretch(shape.back(), high));
    out = std::move(shape);
    return 1;
}
