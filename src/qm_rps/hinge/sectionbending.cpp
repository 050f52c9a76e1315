#include "qm_rps/hinge/sectionbending.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace {

// ---- steel: plastic neutral axis at +-a --------------------------------------------------------

/// Area of a piece within |t| <= a.
double AreaWithin(const T_SECT_PIECE& p, double a)
{
    const double r = p.depth / 2.0, b = std::min(a, r);
    if (!p.round) return p.width * 2.0 * b;
    return 2.0 * (b * std::sqrt(r * r - b * b) + r * r * std::asin(b / r));
}

/// First moment of a piece beyond |t| >= a, both sides added.
double MomentBeyond(const T_SECT_PIECE& p, double a)
{
    const double r = p.depth / 2.0, b = std::min(a, r);
    const double rest = r * r - b * b;
    return p.round ? 4.0 / 3.0 * rest * std::sqrt(rest) : p.width * rest;
}

class CSteelBending : public ISectionBending {
public:
    CSteelBending(std::vector<T_SECT_PIECE> pieces, double fy)
        : m_pieces(std::move(pieces)), m_fy(fy), m_depth(m_pieces.front().depth)
    {
    }
    T_AXIAL_MOMENT At(double u) const override
    {
        const double a = std::fabs(u - 1.0) * m_depth / 2.0;
        T_AXIAL_MOMENT r;
        for (const T_SECT_PIECE& p : m_pieces) {
            r.axial += p.sign * m_fy * AreaWithin(p, a);
            r.moment += p.sign * m_fy * MomentBeyond(p, a);
        }
        if (u < 1.0) r.axial = -r.axial;
        return r;
    }

private:
    std::vector<T_SECT_PIECE> m_pieces; // the first one is the deepest
    double m_fy, m_depth;
};

/// Straight interaction of a section without a shape.
class CLinearBending : public ISectionBending {
public:
    CLinearBending(double axial, double moment) : m_axial(axial), m_moment(moment) {}
    T_AXIAL_MOMENT At(double u) const override
    {
        return {(u - 1.0) * m_axial, (1.0 - std::fabs(u - 1.0)) * m_moment};
    }

private:
    double m_axial, m_moment;
};

// ---- concrete: strain compatibility ------------------------------------------------------------

/// Gauss-Legendre points and weights on -1 ... 1, exact to degree 9.
constexpr std::array<std::array<double, 2>, 5> kGauss{{{0.0, 0.5688888888888889},
                                                       {-0.5384693101056831, 0.4786286704993665},
                                                       {0.5384693101056831, 0.4786286704993665},
                                                       {-0.9061798459386640, 0.2369268850561891},
                                                       {0.9061798459386640, 0.2369268850561891}}};
/// Panels per piece (plateau, parabola): measured against adaptive quadrature with 30 digits (C30
/// to C90, circle and rectangle, neutral axis in and outside), forces and moments agree to 1e-9 of
/// the force and force times depth. A rectangle of concrete up to C50 is exact.
constexpr int kPanels = 8;

class CConcreteBending : public ISectionBending {
public:
    CConcreteBending(const T_SECT_D& section, const T_MATL_D& material, const T_CONCRETE_LAW& law,
                     bool aboutY, bool positive)
        : m_law(law), m_fck(material.fck), m_fyk(material.fyk), m_Es(material.Es),
          m_round(section.shape == SECT_SHAPE::Circle)
    {
        m_depth = aboutY || m_round ? section.size[0] : section.size[1];
        m_width = aboutY ? section.size[1] : section.size[0];
        for (const T_REBAR& b : section.bars)
            m_bars.push_back({(positive ? 1.0 : -1.0) * (aboutY ? b.z : b.y), b.area});
    }

    T_AXIAL_MOMENT At(double u) const override
    {
        const double x = u <= 1.0 ? u * m_depth : m_depth; // compressed depth within the section
        const double peak = Pivot() * x;
        T_AXIAL_MOMENT r;
        AddConcrete(u, 0.0, peak, r);
        AddConcrete(u, peak, x, r);
        for (const T_BAR& b : m_bars)
            AddBar(u, b, r);
        return r;
    }

private:
    struct T_BAR {
        double lever = 0.0, area = 0.0; // lever from the centroid towards the compressed edge
    };

    /// Depth of the peak strain / x where the edge crushes.
    double Pivot() const { return 1.0 - m_law.peakStrain / m_law.crushStrain; }

    /// Strain at depth t under the compressed edge, compression positive.
    double Strain(double u, double t) const
    {
        if (u <= 1.0) return m_law.crushStrain * (1.0 - t / (u * m_depth));
        const double q = 2.0 - u; // depth / neutral axis depth
        return m_law.peakStrain * (1.0 - q * t / m_depth) / (1.0 - q * Pivot());
    }

    double ConcreteStress(double strain) const
    {
        if (!(strain > 0.0)) return 0.0;
        if (strain >= m_law.peakStrain) return m_fck;
        return m_fck * (1.0 - std::pow(1.0 - strain / m_law.peakStrain, m_law.n));
    }

    void Add(double force, double t, T_AXIAL_MOMENT& r) const
    {
        r.axial += force;
        r.moment += force * (m_depth / 2.0 - t);
    }

    /// Concrete between the depths t0 and t1. A circle is integrated over the angle from the edge
    /// (t = R (1 - cos)), where the chord has no steep end. The points gather at t0 (as the square
    /// of w): there begins the fall from the peak, whose broken power n no polynomial follows.
    void AddConcrete(double u, double t0, double t1, T_AXIAL_MOMENT& r) const
    {
        const double radius = m_depth / 2.0;
        const double from = m_round ? std::acos(1.0 - t0 / radius) : t0;
        const double to = m_round ? std::acos(std::max(-1.0, 1.0 - t1 / radius)) : t1;
        for (int i = 0; i < kPanels; ++i)
            for (const auto& [point, weight] : kGauss) {
                const double w = (2.0 * i + 1.0 + point) / (2.0 * kPanels);
                const double s = from + (to - from) * w * w;
                const double ds = (to - from) * w / kPanels; // 2 w dw, half a panel
                const double chord = 2.0 * radius * std::sin(s);
                const double t = m_round ? radius * (1.0 - std::cos(s)) : s;
                const double area = m_round ? chord * radius * std::sin(s) : m_width;
                Add(weight * ds * area * ConcreteStress(Strain(u, t)), t, r);
            }
    }

    void AddBar(double u, const T_BAR& b, T_AXIAL_MOMENT& r) const
    {
        const double t = m_depth / 2.0 - b.lever;
        const double strain = Strain(u, t);
        const double stress = std::clamp(m_Es * strain, -m_fyk, m_fyk);
        Add(b.area * (stress - ConcreteStress(strain)), t, r);
    }

    T_CONCRETE_LAW m_law;
    double m_fck, m_fyk, m_Es;
    bool m_round;
    double m_depth = 0.0, m_width = 0.0;
    std::vector<T_BAR> m_bars;
};

} // namespace

std::unique_ptr<ISectionBending> MakeSteelBending(const T_SECT_D& section, double fy, bool aboutY)
{
    std::vector<T_SECT_PIECE> pieces = CSectionProperties::Pieces(section, aboutY);
    if (!pieces.empty()) return std::make_unique<CSteelBending>(std::move(pieces), fy);
    return std::make_unique<CLinearBending>(section.area * fy,
                                            (aboutY ? section.Zy : section.Zz) * fy);
}

std::unique_ptr<ISectionBending> MakeConcreteBending(const T_SECT_D& section,
                                                     const T_MATL_D& material,
                                                     const T_CONCRETE_LAW& law, bool aboutY,
                                                     bool positive)
{
    return std::make_unique<CConcreteBending>(section, material, law, aboutY, positive);
}
