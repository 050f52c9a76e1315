#include "qm_rps/generate/steelmember.h"

#include "qm_rps/codes/asce41strength.h"
#include "qm_rps/codes/slenderplates.h"
#include "qm_rps/generate/rcmember.h"

#include <cmath>

namespace {

constexpr auto K = CODE_MARK::Computed;

/// Yield strength that counts, on its sheet; `lower` where the code has one.
std::optional<double> Yield(const T_MEMBER_END& end, double& lower, CCodeSheet& sheet)
{
    const T_MATL_D& m = end.material;
    if (m.type != MATL_CLASS::Steel) {
        sheet.Refuse(CODE_REASON::Missing, "type: steel", m.name);
        return {};
    }
    const double mean = m.mean ? m.mean->fy : 0.0;
    if (!(mean > 0.0) && !sheet.Positive({{"Fy", m.Fy}})) return {};
    if (IsChordCode(end.code)) {
        if (!(mean > 0.0)) sheet.Warn("IDS_QM_GEN_WARN_NO_MEAN", {m.name});
        const std::optional<double> factor = ConfidenceOf(m, sheet);
        if (!factor || !sheet.Positive({{"confidence_factor", *factor}})) return {};
        return sheet.Put("fy", (mean > 0.0 ? mean : m.Fy) / *factor, kDimStress,
                         "EN 1998-3 Annex B", mean > 0.0 ? "mean.fy/CF" : "Fy/CF",
                         CODE_MARK::SightedOnce);
    }
    if (mean > 0.0) {
        lower = sheet.Put("Fy", m.Fy > 0.0 ? m.Fy : mean, kDimStress, "", "lower bound", K);
        return sheet.Put("Fye", mean, kDimStress, "", "mean", K);
    }
    const double factor = AsceExpectedFactor(ASCE_MATERIAL::Steel, sheet);
    lower = sheet.Put("Fy", m.Fy, kDimStress, "", "lower bound", K);
    return sheet.Put("Fye", factor * m.Fy, kDimStress, "ASCE 41-17 Table 9-3",
                     "Fy x " + CodeNumber(factor), CODE_MARK::Recalled);
}

} // namespace

std::optional<T_STEEL_SHAPE> SteelShapeOf(const T_SECT_D& s, CCodeSheet& sheet)
{
    const auto& [a, b, c, d] = s.size;
    const double r = s.fillet;
    switch (s.shape) {
    case SECT_SHAPE::IShape:
        return T_STEEL_SHAPE{
            r > 0.0 ? STEEL_SHAPE::RolledI : STEEL_SHAPE::WeldedI, s.area, a, b, d, c, r};
    case SECT_SHAPE::Box:
        return T_STEEL_SHAPE{STEEL_SHAPE::RectangularTube, s.area, a, b, d, c, InnerRadius(s)};
    case SECT_SHAPE::Pipe:
        return T_STEEL_SHAPE{STEEL_SHAPE::CircularTube, s.area, a, a, b, b, 0.0};
    case SECT_SHAPE::Channel:
        return T_STEEL_SHAPE{STEEL_SHAPE::Channel, s.area, a, b, d, c, r};
    default:
        sheet.Refuse(CODE_REASON::Missing, "shape: I, box, pipe, channel", s.name);
        return {};
    }
}

T_STEEL_MEMBER T_STEEL_BASIS::Member() const
{
    T_STEEL_MEMBER m;
    m.Fye = fy;
    m.E = E;
    m.Z = Z;
    m.I = I;
    m.A = shape.A;
    m.length = end.clear;
    m.bf = shape.b;
    m.tf = shape.tf;
    m.h = shape.h - 2.0 * (shape.tf + shape.r);
    m.tw = shape.tw;
    m.ry = Least();
    m.axial = axial;
    return m;
}

std::optional<T_STEEL_BASIS> SteelBasis(const T_MEMBER_END& end, CCodeSheet& sheet)
{
    double lower = 0.0;
    const std::optional<double> fy = Yield(end, lower, sheet);
    // Their tables have no such row, and such members twist when they buckle.
    if (end.section.shape == SECT_SHAPE::Channel) {
        sheet.Refuse(CODE_REASON::NoRow, "shape: channel", "ASCE 41, AISC 342, EN 1998-3");
        return {};
    }
    const auto shape = fy ? SteelShapeOf(end.section, sheet) : std::nullopt;
    const T_SECT_D& s = end.section;
    if (!shape || !sheet.Positive({{"E", end.material.E}, {"clear length", end.clear}})) return {};
    T_STEEL_BASIS in{end, *shape, {s.area * *fy, s.Zy * *fy, s.Zz * *fy}, *fy, lower};
    in.E = end.material.E;
    in.Z = end.aboutY ? s.Zy : s.Zz;
    in.I = end.aboutY ? s.Iyy : s.Izz;
    if (!sheet.Positive({{"A", s.area}, {"Iy", s.Iyy}, {"Iz", s.Izz}})) return {};
    in.iy = std::sqrt(s.Iyy / s.area);
    in.iz = std::sqrt(s.Izz / s.area);
    in.axial = end.HasAxial() ? end.axial : 0.0;
    return in;
}

ASCE_EDITION SteelEdition(const T_MEMBER_END& end)
{
    switch (end.code) {
    case HINGE_CODE::Asce13:
        return ASCE_EDITION::Asce13;
    case HINGE_CODE::Fema356:
        return end.secondary ? ASCE_EDITION::Fema356Secondary : ASCE_EDITION::Fema356Primary;
    default:
        return ASCE_EDITION::Asce17;
    }
}

std::optional<double> SteelMoment(const T_STEEL_BASIS& in, double axial, CCodeSheet& sheet)
{
    if (!IsChordCode(in.end.code)) {
        T_STEEL_MEMBER m = in.Member();
        m.axial = axial;
        return AsceSteelMoment(m, SteelEdition(in.end), sheet);
    }
    const auto reduced = EnAxialBending(in.shape, in.strength, {axial, 0.0, 0.0}, sheet);
    if (!reduced) return {};
    return in.end.aboutY ? reduced->MNy : reduced->MNz;
}

std::optional<double> SteelShear(const T_STEEL_BASIS& in, double fy, CCodeSheet& sheet)
{
    if (IsChordCode(in.end.code)) return EnShearStrength(in.shape, in.end.aboutY, fy, sheet);
    return AiscShapeShear(in.shape, in.end.aboutY, fy, in.E, sheet);
}
