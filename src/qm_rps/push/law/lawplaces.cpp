#include "qm_rps/push/law/lawplaces.h"

#include "qm_base/say.h"
#include "qm_rps/hinge/hingefindings.h"

#include <cmath>
#include <numbers>

namespace {

constexpr int kMostPoints = 20;

/// Legendre polynomials of degree n and n - 1 at x.
struct T_LEGENDRE {
    double now = 1.0, before = 0.0;
};
T_LEGENDRE Legendre(int n, double x)
{
    T_LEGENDRE p;
    for (int k = 1; k <= n; ++k) {
        const double next = ((2 * k - 1) * x * p.now - (k - 1) * p.before) / k;
        p.before = p.now;
        p.now = next;
    }
    return p;
}

/// Points of the locations of a beam.
std::vector<T_HINGE_SPOT> Ends(const T_HINGE_COMPONENT& c, HINGE_COMPONENT component, bool isLoaded)
{
    const T_HINGE_SPOT i{0.0, "I"}, center{0.5, "C"};
    T_HINGE_SPOT j{1.0, "J"};
    j.pageJ = !c.sameEnds;
    const bool shear = component == HINGE_COMPONENT::Fy || component == HINGE_COMPONENT::Fz;
    const bool alike = !IsBending(component) && (!shear || !isLoaded);
    switch (c.location) {
    case HINGE_LOCATION::IEnd:
        return {i};
    case HINGE_LOCATION::JEnd:
        return {j};
    case HINGE_LOCATION::BothEnds:
        if (alike && c.sameEnds) return {center};
        return {i, j};
    case HINGE_LOCATION::Center:
        break;
    }
    return {center};
}

int Distributed(const T_PHGT_D& type, const T_HINGE_COMPONENT& c, double length,
                std::vector<T_HINGE_SPOT>& out, std::string& reason)
{
    const int n = type.length.integrationPoints;
    if (n < 2 || n > kMostPoints) {
        reason = Say("IDS_QM_PUSH_LAW_POINTS", std::to_string(n));
        return 0;
    }
    int number = 0;
    for (const T_LOBATTO_POINT& p : LobattoPoints(n))
        out.push_back(
            {p.at, std::to_string(++number), p.at > 0.5 && NeedsIJPages(c), p.weight * length});
    return 1;
}

} // namespace

std::vector<T_LOBATTO_POINT> LobattoPoints(int n)
{
    std::vector<T_LOBATTO_POINT> points(static_cast<std::size_t>(n));
    const int m = n - 1; // degree
    for (int i = 0; i < n; ++i) {
        double x = -std::cos(std::numbers::pi * i / m);
        // Newton on P_m - x P_(m-1), whose zeros are those of (1 - x2) P'_m.
        for (int k = 0; k < 50; ++k) {
            const T_LEGENDRE p = Legendre(m, x);
            const double step = (x * p.now - p.before) / (n * p.now);
            x -= step;
            if (std::fabs(step) < 1e-15) break;
        }
        if (i == 0 || i == m) x = i == 0 ? -1.0 : 1.0;
        const double p = Legendre(m, x).now;
        points[static_cast<std::size_t>(i)] = {0.5 * (1.0 + x), 1.0 / (n * m * p * p)};
    }
    return points;
}

int HingeSpots(const T_PHGT_D& type, HINGE_COMPONENT component, const T_HINGE_SPAN& span,
               std::vector<T_HINGE_SPOT>& out, std::string& reason)
{
    const T_HINGE_COMPONENT& c = At(type, component);
    std::vector<T_HINGE_SPOT> spots;
    if (span.kind != ELEM_KIND::Beam) {
        const double at = span.kind == ELEM_KIND::Truss ? 0.5 : 0.0; // links have no length
        spots = {{at, "C", c.location == HINGE_LOCATION::JEnd && !c.sameEnds}};
    } else if (type.definition == HINGE_DEFINITION::CurvatureDistributed) {
        if (!Distributed(type, c, span.length, spots, reason)) return 0;
        out = std::move(spots);
        return 1;
    } else {
        spots = Ends(c, component, span.isLoaded);
    }
    if (type.definition != HINGE_DEFINITION::MomentRotation && HasLineElement(type)) {
        const auto index = static_cast<std::size_t>(component);
        for (T_HINGE_SPOT& spot : spots) {
            const auto& lengths = type.length.components;
            const double length = (spot.end == "J" ? lengths.J : lengths.I)[index];
            spot.length = type.length.relative ? length * span.memberLength : length;
            if (!(spot.length > 0.0) || !std::isfinite(spot.length)) {
                reason = Say("IDS_QM_PUSH_LAW_LENGTH", spot.end);
                return 0;
            }
        }
    }
    out = std::move(spots);
    return 1;
}
