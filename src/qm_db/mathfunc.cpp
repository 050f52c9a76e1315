#include "qm_db/mathfunc.h"

#include <algorithm>
#include <cmath>

int CMathFunc::mathIntersectLine2(const T_POINT2& P1, const T_POINT2& P2, const T_POINT2& Q1,
                                  const T_POINT2& Q2, double tolerance, double& param,
                                  T_POINT2& point)
{
    constexpr double kRelative = 1e-9; // below this, rounding decides
    const double tol = std::max(tolerance, kRelative);
    const double rx = P2.x - P1.x, ry = P2.y - P1.y;
    const double sx = Q2.x - Q1.x, sy = Q2.y - Q1.y;
    const double cross = rx * sy - ry * sx;
    // Written so that a NaN counts as parallel.
    if (!(std::fabs(cross) > tol * (std::fabs(rx * sy) + std::fabs(ry * sx)))) return 0;

    const double dx = Q1.x - P1.x, dy = Q1.y - P1.y;
    const double t = (dx * sy - dy * sx) / cross; // along P
    const double u = (dx * ry - dy * rx) / cross; // along Q
    const auto inside = [tol](double v) { return v >= -tol && v <= 1.0 + tol; };
    if (!inside(t) || !inside(u)) return 0;

    param = std::clamp(u, 0.0, 1.0);
    point = {Q1.x + param * sx, Q1.y + param * sy};
    return 1;
}
