#include "qm_db/sectionproperties.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/records.h"

#include <array>
#include <cmath>
#include <numbers>
#include <set>

namespace {

using std::numbers::pi;

bool Positive(double v)
{
    return v > 0.0 && std::isfinite(v);
}

bool SoundSize(const T_SECT_D& s)
{
    const auto& [a, b, c, d] = s.size;
    if (!FilletFits(s) || !TaperFits(s)) return false;
    switch (s.shape) {
    case SECT_SHAPE::Value:
        return true;
    case SECT_SHAPE::Rectangle:
        return Positive(a) && Positive(b);
    case SECT_SHAPE::Circle:
        return Positive(a);
    case SECT_SHAPE::Pipe:
        return Positive(a) && Positive(b) && 2.0 * b < a;
    case SECT_SHAPE::Box:
        return Positive(a) && Positive(b) && Positive(c) && Positive(d) && 2.0 * c < b &&
               2.0 * d < a;
    case SECT_SHAPE::IShape:
        return Positive(a) && Positive(b) && Positive(c) && Positive(d) && c <= b && 2.0 * d < a;
    case SECT_SHAPE::Channel:
        return Positive(a) && Positive(b) && Positive(c) && Positive(d) && c < b &&
               2.0 * FlangeEnds(s).first < a;
    }
    return false;
}

bool SoundValues(const T_SECT_D& s)
{
    for (double v : {s.area, s.Asy, s.Asz, s.J, s.Iyy, s.Izz, s.Zy, s.Zz})
        if (!(v >= 0.0) || !std::isfinite(v)) return false;
    return true;
}

struct T_MOMENTS {
    double area = 0.0, I = 0.0, Z = 0.0;
};

/// Area, second moment and plastic modulus: textbook values of rectangle and circle (bd, bd3/12,
/// bd2/4; pi d2/4, pi d4/64, d3/6). The pieces share one centroid, so that they simply add.
T_MOMENTS Sum(const std::vector<T_SECT_PIECE>& pieces)
{
    T_MOMENTS m;
    for (const T_SECT_PIECE& p : pieces) {
        const double d = p.depth, d2 = d * d;
        m.area += p.sign * (p.round ? pi * d2 / 4.0 : p.width * d);
        m.I += p.sign * (p.round ? pi * d2 * d2 / 64.0 : p.width * d2 * d / 12.0);
        m.Z += p.sign * (p.round ? d2 * d / 6.0 : p.width * d2 / 4.0);
    }
    return m;
}

/// What lies between the two sides of a right angle and a quarter circle that touches both: area,
/// distance of its centroid from the sides, second moment about the centroid.
struct T_SPANDREL {
    explicit T_SPANDREL(double r)
        : area((1.0 - pi / 4.0) * r * r), place((10.0 - 3.0 * pi) / (12.0 - 3.0 * pi) * r),
          own((1.0 / 3.0 - pi / 16.0 - 1.0 / (9.0 * (4.0 - pi))) * std::pow(r, 4))
    {
    }
    double area, place, own;
};

/// Adds four spandrels whose centroids lie at this distance from the axis, or takes them off.
void AddFour(const T_SPANDREL& piece, double distance, double sign, T_MOMENTS& m)
{
    m.area += sign * 4.0 * piece.area;
    m.I += sign * 4.0 * (piece.own + piece.area * distance * distance);
    m.Z += sign * 4.0 * piece.area * distance;
}

/// Fillets of an I; corners of a box, whose outer ones are missing.
void AddFillets(const T_SECT_D& s, T_MOMENTS& y, T_MOMENTS& z)
{
    const auto& [a, b, c, d] = s.size;
    const T_SPANDREL outer(s.fillet);
    if (s.shape == SECT_SHAPE::IShape) {
        AddFour(outer, a / 2.0 - d - outer.place, 1.0, y);
        AddFour(outer, c / 2.0 + outer.place, 1.0, z);
    }
    if (s.shape == SECT_SHAPE::Box) {
        const T_SPANDREL inner(InnerRadius(s));
        AddFour(outer, a / 2.0 - outer.place, -1.0, y);
        AddFour(outer, b / 2.0 - outer.place, -1.0, z);
        AddFour(inner, a / 2.0 - d - inner.place, 1.0, y);
        AddFour(inner, b / 2.0 - c - inner.place, 1.0, z);
    }
}

/// Saint-Venant torsion of a solid rectangle, Timoshenko and Goodier (1970) section 109: series;
/// five terms leave an error under 1e-5.
double RectangleTorsion(double h, double w)
{
    const double a = std::max(h, w), b = std::min(h, w);
    double sum = 0.0;
    for (int n = 1; n <= 9; n += 2)
        sum += std::tanh(n * pi * a / (2.0 * b)) / std::pow(n, 5);
    return a * b * b * b / 3.0 * (1.0 - 192.0 / std::pow(pi, 5) * b / a * sum);
}

/// Torsion constant. Circle and pipe: polar second moment. Box: Bredt on the wall centre lines.
/// I, channel: sum of b t3 / 3 of the plates, web between the flanges.
double Torsion(const T_SECT_D& s)
{
    const auto& [a, b, c, d] = s.size;
    switch (s.shape) {
    case SECT_SHAPE::Rectangle:
        return RectangleTorsion(a, b);
    case SECT_SHAPE::Circle:
        return pi * std::pow(a, 4) / 32.0;
    case SECT_SHAPE::Pipe:
        return pi * (std::pow(a, 4) - std::pow(a - 2.0 * b, 4)) / 32.0;
    case SECT_SHAPE::Box: {
        const double h = a - d, w = b - c;
        return 2.0 * h * h * w * w / (h / c + w / d);
    }
    case SECT_SHAPE::IShape:
    case SECT_SHAPE::Channel:
        return (2.0 * b * std::pow(d, 3) + (a - 2.0 * d) * std::pow(c, 3)) / 3.0;
    case SECT_SHAPE::Value:
        break;
    }
    return s.J;
}

/// Shear areas of stiffness. Rectangle 5/6 A and circle 9/10 A: energy of the parabolic shear
/// stress (Timoshenko, Strength of Materials I). Pipe A/2: thin wall. Box: two webs or two flanges
/// over the full outside. I, channel: web over the full height; flanges as rectangles.
void ShearAreas(T_SECT_D& s)
{
    const auto& [a, b, c, d] = s.size;
    switch (s.shape) {
    case SECT_SHAPE::Rectangle:
        s.Asy = s.Asz = 5.0 / 6.0 * s.area;
        break;
    case SECT_SHAPE::Circle:
        s.Asy = s.Asz = 0.9 * s.area;
        break;
    case SECT_SHAPE::Pipe:
        s.Asy = s.Asz = 0.5 * s.area;
        break;
    case SECT_SHAPE::Box:
        s.Asz = 2.0 * a * c;
        s.Asy = 2.0 * b * d;
        break;
    case SECT_SHAPE::IShape:
    case SECT_SHAPE::Channel:
        s.Asz = a * c;
        s.Asy = 5.0 / 6.0 * 2.0 * b * d;
        break;
    case SECT_SHAPE::Value:
        break;
    }
}

/// Of a shape that is symmetric about both axes.
void TakeSymmetric(T_SECT_D& s)
{
    T_MOMENTS y = Sum(CSectionProperties::Pieces(s, true));
    T_MOMENTS z = Sum(CSectionProperties::Pieces(s, false));
    if (s.fillet > 0.0) AddFillets(s, y, z);
    s.area = y.area;
    s.Iyy = y.I;
    s.Izz = z.I;
    s.Zy = y.Z;
    s.Zz = z.Z;
}

void TakeChannel(T_SECT_D& s)
{
    const T_CHANNEL c = ChannelProperties(s);
    s.area = c.area;
    s.Iyy = c.Iyy;
    s.Izz = c.Izz;
    s.Zy = c.Zy;
    s.Zz = c.Zz;
}

} // namespace

const char* MessageKeyOf(SECT_FAULT fault)
{
    switch (fault) {
    case SECT_FAULT::None:
        return "";
    case SECT_FAULT::Dimensions:
        return "IDS_QM_SECT_DIMENSIONS";
    case SECT_FAULT::Values:
        return "IDS_QM_SECT_VALUES";
    case SECT_FAULT::Factors:
        return "IDS_QM_SECT_FACTORS";
    case SECT_FAULT::Material:
        return "IDS_QM_SECT_MATERIAL";
    case SECT_FAULT::Class:
        return "IDS_QM_SECT_CLASS";
    case SECT_FAULT::Shape:
        return "IDS_QM_SECT_SHAPE";
    case SECT_FAULT::NoBars:
        return "IDS_CMD_IEHP_NO_RBAR";
    case SECT_FAULT::ConcreteClass:
        return "IDS_QM_SECT_CONCRETE_CLASS";
    case SECT_FAULT::Bars:
        return "IDS_QM_SECT_BARS";
    case SECT_FAULT::NotConverged:
        return "IDS_QM_SECT_NOT_CONVERGED";
    }
    return "";
}

int CSectionProperties::Calc(const T_SECT_D& in, T_SECT_D& out, SECT_FAULT& fault)
{
    fault = SECT_FAULT::None;
    if (!SoundSize(in)) fault = SECT_FAULT::Dimensions;
    if (in.shape == SECT_SHAPE::Value && !SoundValues(in)) fault = SECT_FAULT::Values;
    if (fault != SECT_FAULT::None) return 0;
    T_SECT_D s = in;
    if (s.shape != SECT_SHAPE::Value) {
        s.shape == SECT_SHAPE::Channel ? TakeChannel(s) : TakeSymmetric(s);
        s.J = Torsion(s);
        ShearAreas(s);
    }
    out = s;
    return 1;
}

T_SHEAR_AREAS CSectionProperties::StrengthShearAreas(const T_SECT_D& section)
{
    const auto& [a, b, c, d] = section.size;
    switch (section.shape) {
    case SECT_SHAPE::Rectangle:
        return {2.0 / 3.0 * section.area, 2.0 / 3.0 * section.area};
    case SECT_SHAPE::Circle:
        return {0.75 * section.area, 0.75 * section.area};
    case SECT_SHAPE::Pipe:
        return {2.0 / pi * section.area, 2.0 / pi * section.area};
    case SECT_SHAPE::Box: {
        if (section.fillet > 0.0) return {section.area * b / (a + b), section.area * a / (a + b)};
        const double webs = 2.0 * (a - 2.0 * d) * c;
        return {section.area - webs, webs};
    }
    case SECT_SHAPE::IShape: {
        const double web = (a - 2.0 * d) * c;
        if (section.fillet == 0.0) return {section.area - web, web};
        const double rolled = section.area - 2.0 * b * d + (c + 2.0 * section.fillet) * d;
        return {section.area - web, std::max(rolled, web)};
    }
    case SECT_SHAPE::Channel: {
        const double web = (a - 2.0 * d) * c;
        if (section.fillet == 0.0) return {section.area - web, web};
        return {section.area - web, section.area - 2.0 * b * d + (c + section.fillet) * d};
    }
    case SECT_SHAPE::Value:
        break;
    }
    return {section.Asy, section.Asz};
}

std::vector<T_SECT_PIECE> CSectionProperties::Pieces(const T_SECT_D& section, bool aboutY)
{
    const auto& [a, b, c, d] = section.size;
    const double depth = aboutY ? a : b, width = aboutY ? b : a;
    const double side = aboutY ? d : c, wall = aboutY ? c : d; // of a box
    switch (section.shape) {
    case SECT_SHAPE::Rectangle:
        return {{1.0, false, width, depth}};
    case SECT_SHAPE::Circle:
        return {{1.0, true, 0.0, a}};
    case SECT_SHAPE::Pipe:
        return {{1.0, true, 0.0, a}, {-1.0, true, 0.0, a - 2.0 * b}};
    case SECT_SHAPE::Box:
        return {{1.0, false, width, depth}, {-1.0, false, width - 2.0 * wall, depth - 2.0 * side}};
    case SECT_SHAPE::IShape:
        if (aboutY) return {{1.0, false, b, a}, {-1.0, false, b - c, a - 2.0 * d}};
        return {{1.0, false, 2.0 * d, b}, {1.0, false, a - 2.0 * d, c}};
    case SECT_SHAPE::Channel: // not symmetric
    case SECT_SHAPE::Value:
        break;
    }
    return {};
}

// ---- stiffness
// -----------------------------------------------------------------------------------

namespace {

/// A property and its factor.
struct T_FACTORED {
    const char* name;
    double T_SECT_FACTORS::*factor;
    double T_SECT_D::*property;
};
constexpr std::array<T_FACTORED, 6> kFactored{{{"area", &T_SECT_FACTORS::area, &T_SECT_D::area},
                                               {"Asy", &T_SECT_FACTORS::Asy, &T_SECT_D::Asy},
                                               {"Asz", &T_SECT_FACTORS::Asz, &T_SECT_D::Asz},
                                               {"J", &T_SECT_FACTORS::J, &T_SECT_D::J},
                                               {"Iyy", &T_SECT_FACTORS::Iyy, &T_SECT_D::Iyy},
                                               {"Izz", &T_SECT_FACTORS::Izz, &T_SECT_D::Izz}}};

bool IsFactor(double v)
{
    return v > 0.0 && std::isfinite(v);
}

/// Empty: all factors are 1.
std::string FactorsOf(const T_SECT_D& section)
{
    const T_SECT_FACTORS mean = MeanFactors(section);
    std::string text;
    for (const T_FACTORED& f : kFactored) {
        const double I = section.factorsI.*f.factor, J = section.factorsJ.*f.factor;
        if (I == 1.0 && J == 1.0) continue;
        text += std::string(text.empty() ? "" : ", ") + f.name + " " + ShortestText(mean.*f.factor);
        if (I != J) text += Say("IDS_QM_FACTORS_OF_ENDS", ShortestText(I), ShortestText(J));
    }
    return text;
}

} // namespace

double ShearModulus(const T_MATL_D& m)
{
    return m.G.value_or(m.E / (2.0 * (1.0 + m.nu)));
}

T_SECT_FACTORS MeanFactors(const T_SECT_D& section)
{
    T_SECT_FACTORS mean;
    for (const T_FACTORED& f : kFactored)
        mean.*f.factor = 0.5 * (section.factorsI.*f.factor + section.factorsJ.*f.factor);
    return mean;
}

int CalcStiffness(const T_SECT_D& in, T_SECT_D& out, SECT_FAULT& fault)
{
    T_SECT_D s;
    if (!CSectionProperties::Calc(in, s, fault)) return 0;
    const T_SECT_FACTORS mean = MeanFactors(in);
    for (const T_FACTORED& f : kFactored) {
        if (!IsFactor(in.factorsI.*f.factor) || !IsFactor(in.factorsJ.*f.factor)) {
            fault = SECT_FAULT::Factors;
            return 0;
        }
        s.*f.property *= mean.*f.factor;
    }
    out = std::move(s);
    return 1;
}

std::string StiffnessFactorText(const T_MODEL& model)
{
    std::set<int> used;
    for (const auto& [id, element] : model.elements)
        if (element.kind == ELEM_KIND::Beam || element.kind == ELEM_KIND::Truss)
            used.insert(element.section);
    std::string list;
    for (const int key : used) {
        const auto section = model.sections.find(key);
        if (section == model.sections.end()) continue;
        const std::string factors = FactorsOf(section->second);
        if (factors.empty()) continue;
        list += (list.empty() ? "" : "; ") + section->second.name + ": " + factors;
    }
    return list.empty() ? list : Say("IDS_QM_FACTORS_COUNT", list);
}
