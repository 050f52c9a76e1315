#include "qm_rps/view/stress.h"

#include "qm_db/sectionproperties.h"

#include <algorithm>
#include <cmath>

namespace {

/// A section with its fibres: half widths from the centroid along y (both sides) and z.
struct T_FIBRES {
    double area = 0.0, Iyy = 0.0, Izz = 0.0;
    double left = 0.0, right = 0.0, half = 0.0; // along -y, +y, z
    bool round = false, bends = true;
};

std::optional<T_FIBRES> FibresOf(const T_SECT_D& record, bool bends)
{
    T_SECT_D s;
    SECT_FAULT fault{};
    if (!CSectionProperties::Calc(record, s, fault) || !(s.area > 0.0)) return {};
    T_FIBRES f{s.area, s.Iyy, s.Izz, 0.0, 0.0, 0.0, false, bends};
    if (!bends) return f;
    switch (s.shape) {
    case SECT_SHAPE::Value:
        return {};
    case SECT_SHAPE::Circle:
    case SECT_SHAPE::Pipe:
        f.round = true;
        f.half = f.left = f.right = 0.5 * s.size[0];
        break;
    case SECT_SHAPE::Channel:
        f.left = ChannelProperties(s).centroid;
        f.right = s.size[1] - f.left;
        f.half = 0.5 * s.size[0];
        break;
    default:
        f.half = 0.5 * s.size[0];
        f.left = f.right = 0.5 * s.size[1];
    }
    return f;
}

/// The stress with the largest magnitude, with its sign.
double Extreme(const T_FIBRES& f, double N, double My, double Mz)
{
    const double axial = N / f.area;
    if (!f.bends) return axial;
    if (f.round) {
        const double bending = std::hypot(My, Mz) * f.half / f.Iyy;
        return axial < 0.0 ? axial - bending : axial + bending;
    }
    double worst = axial;
    for (const double z : {-f.half, f.half})
        for (const double y : {-f.left, f.right}) {
            const double at = axial + My * z / f.Iyy - Mz * y / f.Izz;
            if (std::fabs(at) > std::fabs(worst)) worst = at;
        }
    return worst;
}

/// The largest magnitude along a member: at every extreme of N, My and Mz, on both sides, and of
/// the sum in each corner of the section, which may lie elsewhere. Round sections bend about both
/// axes with no such sum: there in many parts, too.
double LargestAlong(const T_FIBRES& f, const CMemberLine& member)
{
    constexpr int kRoundParts = 64;
    const int parts = f.round ? kRoundParts : 1;
    std::vector<double> places;
    const auto take = [&places](const std::vector<double>& more) {
        places.insert(places.end(), more.begin(), more.end());
    };
    for (const std::size_t c : {0U, 4U, 5U})
        take(member.Stations(c, parts));
    for (const double z : {-f.half, f.half})
        for (const double y : {-f.left, f.right}) {
            if (!f.bends || f.round) continue;
            CMacaulay corner;
            corner.AddScaled(member.Series(0), 1.0 / f.area);
            corner.AddScaled(member.Series(4), z / f.Iyy);
            corner.AddScaled(member.Series(5), -y / f.Izz);
            take(StationsOf(corner, member.Length(), parts));
        }
    double largest = 0.0;
    for (const double x : places)
        for (const bool behind : {false, true})
            largest = std::max(largest, std::fabs(Extreme(f, member.Force(0, x, behind),
                                                          member.Force(4, x, behind),
                                                          member.Force(5, x, behind))));
    return largest;
}

} // namespace

T_STRESS_PICTURE StressesOf(const CViewFrame& frame, const T_MODEL& model,
                            const T_FRAME_SCENE& scene, const T_VIEW_RESULTS& results,
                            const solver::T_LOAD_CASE& loads, const T_UNITS& units)
{
    T_STRESS_PICTURE out;
    out.unit = std::string(NameOf(units.force)) + "/" + std::string(NameOf(units.length)) + "2";
    if (results.force.size() != scene.lines.size()) return out;
    const auto lineLoads = frame.LineLoads(loads);
    std::map<std::pair<int, bool>, std::optional<T_FIBRES>> fibres;
    for (std::size_t l = 0; l < scene.lines.size(); ++l) {
        const T_SCENE_LINE& line = scene.lines[l];
        const long at = frame.ElementAt(line.id);
        if (at < 0 || line.kind == ELEM_KIND::Link) continue;
        const auto e = static_cast<std::size_t>(at);
        if (!frame.Axes(e)) continue;
        const bool beam = line.kind == ELEM_KIND::Beam;
        const int section = model.elements.at(line.id).section;
        const auto [known, isNew] = fibres.try_emplace({section, beam});
        if (isNew) known->second = FibresOf(model.sections.at(section), beam);
        T_LINE_STRESS& shown = out.lines.emplace_back();
        shown.line = l;
        if (!known->second) {
            ++out.unchecked;
            continue;
        }
        const double length = frame.Axes(e)->length;
        CMemberLine member(length, results.force[l][0],
                           beam ? std::span<const T_LINE_LOAD>(lineLoads[e])
                                : std::span<const T_LINE_LOAD>());
        (void)member.FitTo(results.force[l]);
        for (std::size_t p = 0; p < kStressPlaces; ++p) {
            const double x = length * static_cast<double>(p) / (kStressPlaces - 1);
            const double value =
                Extreme(*known->second, member.Force(0, x), member.Force(4, x), member.Force(5, x));
            shown.value.push_back(FromSi(value, units, kDimStress));
        }
        const double largest = LargestAlong(*known->second, member);
        out.largest = std::max(out.largest, FromSi(largest, units, kDimStress));
    }
    return out;
}
