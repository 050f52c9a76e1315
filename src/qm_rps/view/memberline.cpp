#include "qm_rps/view/memberline.h"

#include <algorithm>
#include <cmath>

namespace {

/// A plane of bending: the moment that bends in it, the shear, and the sign of the rotation that
/// the slope of the deflection is: a turn about z moves x towards +y, one about y towards -z.
struct T_BENDING {
    std::size_t shear, moment, along, about;
    double sign;
};
constexpr std::array<T_BENDING, 2> kBending{{{1, 5, 1, 5, 1.0}, {2, 4, 2, 4, -1.0}}};

/// Takes off what a load takes from the forces behind it; per length, straight from a to b.
void TakeLoad(CMacaulay& force, const T_LINE_LOAD& load, std::size_t axis)
{
    const double w0 = load.w0[axis], w1 = load.w1[axis];
    if (load.type != solver::BEAM_LOAD::Distributed) return force.Add(0, load.a, -w0);
    if (!(load.b > load.a)) return;
    const double rise = (w1 - w0) / (load.b - load.a);
    force.Add(1, load.a, -w0);
    force.Add(2, load.a, -rise);
    force.Add(1, load.b, w1);
    force.Add(2, load.b, rise);
}

/// Bending moments follow from the shears: dMy/dx = +Vz, dMz/dx = -Vy (frameresult.h).
void AddMoments(std::array<CMacaulay, 6>& force)
{
    force[4].AddIntegral(force[2], 1.0);
    force[5].AddIntegral(force[1], -1.0);
}

/// Where a sum has its extremes between stations, at which alone its pieces end. A piece is a
/// cubic at most (straight loads, integrated twice): its slope is a parabola and may vanish twice,
/// so it is halved where the slope turns; in each half one change of sign at most is left.
void AddExtremes(const CMacaulay& force, double length, std::vector<double>& stations)
{
    constexpr int kHalvings = 60;
    const double step = 2e-6 * length;
    const auto slope = [&](double x) { return force.Integral(-1, x); };
    const auto search = [&](double a, double b) {
        const double atA = slope(a);
        if (!(b > a) || atA * slope(b) >= 0.0) return;
        for (int n = 0; n < kHalvings; ++n) {
            const double middle = 0.5 * (a + b);
            (slope(middle) * atA > 0.0 ? a : b) = middle;
        }
        stations.push_back(0.5 * (a + b));
    };
    const std::size_t count = stations.size();
    for (std::size_t i = 0; i + 1 < count; ++i) {
        const double a = stations[i] + step, b = stations[i + 1] - step;
        const double bendA = force.Integral(-2, a), bendB = force.Integral(-2, b);
        const bool turns = bendA * bendB < 0.0;
        const double middle = turns ? a + (b - a) * bendA / (bendA - bendB) : b;
        search(a, middle);
        search(middle, b);
    }
    std::ranges::sort(stations);
}

} // namespace

std::vector<double> StationsOf(const CMacaulay& force, double length, int parts)
{
    std::vector<double> out{0.0, length};
    force.Places(out);
    const bool curved = force.Degree() > 1;
    for (int i = 1; curved && i < parts; ++i)
        out.push_back(length * i / parts);
    std::erase_if(out, [&](double x) { return !(x >= 0.0 && x <= length); });
    std::ranges::sort(out);
    const auto same = [&](double a, double b) { return b - a <= 1e-9 * length; };
    out.erase(std::unique(out.begin(), out.end(), same), out.end());
    if (out.back() < length) out.back() = length;
    if (curved) AddExtremes(force, length, out);
    return out;
}

CMemberLine::CMemberLine(double length, const T_DOF6& atI, std::span<const T_LINE_LOAD> loads)
    : m_length(length)
{
    for (std::size_t c = 0; c < 6; ++c)
        m_force[c].AddBase(0, atI[c]);
    for (const T_LINE_LOAD& load : loads)
        for (std::size_t axis = 0; axis < 3; ++axis)
            TakeLoad(m_force[axis + (load.type == solver::BEAM_LOAD::Moment ? 3 : 0)], load, axis);
    AddMoments(m_force);
}

CMemberLine::CMemberLine(double length, const T_LINE_ENDS& ends, const T_LINE_STIFFNESS& stiffness)
    : m_length(length)
{
    const std::array<double, 2> EI{stiffness.EIz, stiffness.EIy}, GA{stiffness.GAy, stiffness.GAz};
    for (std::size_t p = 0; p < 2; ++p) {
        const T_BENDING& b = kBending[p];
        const double chord = b.sign * (ends.moved.J[b.along] - ends.moved.I[b.along]) / length;
        double i = ends.moved.I[b.about] - chord, j = ends.moved.J[b.about] - chord;
        const double phi = GA[p] > 0.0 ? 12.0 * EI[p] / (GA[p] * length * length) : 0.0;
        const double near = 4.0 + phi, far = 2.0 - phi;
        const bool freeI = ends.release.I[b.about], freeJ = ends.release.J[b.about];
        if (freeI && freeJ) continue;
        if (freeI) i = -far / near * j;
        if (freeJ) j = -far / near * i;
        const double k = EI[p] / (length * (1.0 + phi));
        // Of the ends on the member; the cut at I sees the opposite of the one there.
        const double atI = k * (near * i + far * j), atJ = k * (far * i + near * j);
        m_force[b.moment].AddBase(0, -atI);
        m_force[b.shear].AddBase(0, -b.sign * (atJ + atI) / length);
    }
    AddMoments(m_force);
}

double CMemberLine::Force(std::size_t component, double x, bool behind) const
{
    return m_force[component].At(x, behind || x >= m_length);
}

bool CMemberLine::FitTo(const T_ELEM_FORCES& analysed)
{
    constexpr double kRounding = 1e-7; // of the largest force, or moment
    std::array<double, 2> largest{};   // forces, moments
    for (const T_DOF6& at : analysed)
        for (std::size_t c = 0; c < 6; ++c)
            largest[c / 3] = std::max(largest[c / 3], std::fabs(at[c]));
    largest[1] = std::max(largest[1], largest[0] * m_length * 1e-3);
    bool same = true;
    const double part = m_length / static_cast<double>(analysed.size() - 1);
    for (std::size_t c = 0; c < 6; ++c) {
        std::array<double, kForcePositions> off{};
        bool fits = true;
        for (std::size_t p = 0; p < off.size(); ++p) {
            off[p] = analysed[p][c] - Force(c, part * static_cast<double>(p));
            fits = fits && std::fabs(off[p]) <= kRounding * largest[c / 3];
        }
        if (fits) continue;
        same = false;
        m_force[c].AddBase(0, off[0]);
        double before = 0.0;
        for (std::size_t p = 0; p + 1 < off.size(); ++p) {
            const double slope = (off[p + 1] - off[p]) / part;
            m_force[c].Add(1, part * static_cast<double>(p), slope - before);
            before = slope;
        }
    }
    return same;
}

std::vector<double> CMemberLine::Stations(std::size_t component, int parts) const
{
    return StationsOf(m_force[component], m_length, parts);
}

CDeflectedLine::CDeflectedLine(const CMemberLine& line, const T_LINE_ENDS& ends,
                               const T_LINE_STIFFNESS& stiffness)
    : m_length(line.Length()), m_axial{ends.moved.I[0], ends.moved.J[0]}
{
    if (ends.release.I[0]) m_axial[0] = m_axial[1];
    if (ends.release.J[0]) m_axial[1] = m_axial[0];
    const std::array<double, 2> EI{stiffness.EIz, stiffness.EIy}, GA{stiffness.GAy, stiffness.GAz};
    for (std::size_t p = 0; p < 2; ++p) {
        const T_BENDING& b = kBending[p];
        T_PLANE& plane = m_planes[p];
        if (EI[p] > 0.0) plane.turned.AddIntegral(line.Series(b.moment), b.sign / EI[p]);
        if (GA[p] > 0.0) plane.sheared.AddIntegral(line.Series(b.shear), 1.0 / GA[p]);
        Close(plane, b.along, b.about, b.sign, m_length, ends);
    }
}

/// Start and slope from two of: translation at I, at J, rotation at I, at J.
void CDeflectedLine::Close(T_PLANE& plane, std::size_t along, std::size_t about, double sign,
                           double length, const T_LINE_ENDS& ends)
{
    const double vI = ends.moved.I[along], vJ = ends.moved.J[along];
    const double rI = sign * ends.moved.I[about], rJ = sign * ends.moved.J[about];
    const double strained = plane.Strained(length), turned = plane.turned.At(length);
    const bool atI = !ends.release.I[along], atJ = !ends.release.J[along];
    plane.start = vI;
    if (atI && atJ) {
        plane.slope = (vJ - vI - strained) / length;
        return;
    }
    plane.slope = ends.release.I[about] ? rJ - turned : rI;
    if (!atI) plane.start = vJ - plane.slope * length - strained;
}

std::array<double, 3> CDeflectedLine::At(double x) const
{
    const double s = x / m_length;
    std::array<double, 3> out{(1.0 - s) * m_axial[0] + s * m_axial[1], 0.0, 0.0};
    for (std::size_t p = 0; p < 2; ++p)
        out[p + 1] = m_planes[p].start + m_planes[p].slope * x + m_planes[p].Strained(x);
    return out;
}
