// Records of the structure: materials, sections, elements, nodes that move together. Plain data; in
// the store every quantity is in SI.
#pragma once

#include <algorithm>
#include <array>
#include <cmath>
#include <numbers>
#include <optional>
#include <string>
#include <utility>
#include <vector>

/// One value for either end of an element.
template <class T>
struct T_ENDS {
    T I{}, J{};
    bool operator==(const T_ENDS&) const = default;
};

// ---- section and material ---------------------------------------------------------------------

enum class MATL_CLASS { Concrete, Steel, Composite, Masonry };

/// Mean or expected strengths of an existing material, as tests or its age give them.
struct T_MATL_MEAN {
    double fc = 0.0;  // of concrete or masonry
    double fy = 0.0;  // of the bars, or of steel
    double fyw = 0.0; // of the stirrups; 0: as the bars
    bool operator==(const T_MATL_MEAN&) const = default;
};
enum class MATL_KNOWLEDGE { KL1, KL2, KL3 };

enum class BOND_KIND { Irregular, Regular };
/// Mean strengths of existing masonry in shear.
struct T_MATL_MASONRY {
    double tau0 = 0.0; // of an irregular bond, diagonal cracks
    double fv0 = 0.0;  // of the joints without compression; 0: not given
    double fb = 0.0;   // compressive, of the blocks; 0: not given
    BOND_KIND bond = BOND_KIND::Irregular;
    double interlocking = 1.0; // phi of a regular bond: height of a course over the overlap
    bool hollowBlocks = false; // modern ones
    bool operator==(const T_MATL_MASONRY&) const = default;
};

struct T_MATL_D {
    std::string name;
    MATL_CLASS type = MATL_CLASS::Steel;
    double E = 0.0;            // elastic modulus
    double nu = 0.0;           // Poisson's ratio
    double Fy = 0.0;           // yield strength of steel
    double fck = 0.0;          // compressive strength of concrete or masonry
    double fyk = 0.0;          // yield strength of the bars of concrete
    double Es = 0.0;           // elastic modulus of the bars
    std::optional<double> G{}; // shear modulus; absent: E / (2 (1 + nu))
    double density = 0.0;      // mass per volume
    double alpha = 0.0;        // thermal expansion, 1 / degree
    std::optional<T_MATL_MEAN> mean{};
    std::optional<MATL_KNOWLEDGE> knowledge{};
    std::optional<double> confidence{}; // goes before that of the knowledge
    std::optional<T_MATL_MASONRY> masonry{};
    bool operator==(const T_MATL_D&) const = default;
};

enum class SECT_SHAPE { Value, Rectangle, Circle, Pipe, Box, IShape, Channel };

/// A reinforcing bar in section coordinates, from the centroid.
struct T_REBAR {
    double y = 0.0, z = 0.0, area = 0.0;
    bool operator==(const T_REBAR&) const = default;
};

enum class STIRRUP_HOOKS { Hooks135, Hooks90, None };

/// How the bars of a section are held.
struct T_SECT_DETAIL {
    double cover = 0.0; // clear, to the stirrup
    double stirrupDiameter = 0.0, stirrupSpacing = 0.0;
    int legsY = 2, legsZ = 2; // legs along y and along z, which resist shear that way
    STIRRUP_HOOKS hooks = STIRRUP_HOOKS::Hooks135;
    double lapLength = 0.0;  // of the bars at the ends of the member; 0: no laps
    bool tiesInCore = true;  // stirrups are anchored in the core
    bool poorSplice = false; // bars slip in laps or anchorages before they yield
    bool operator==(const T_SECT_DETAIL&) const = default;
};

/// Stiffness factors of a section at one end.
struct T_SECT_FACTORS {
    double area = 1.0, Asy = 1.0, Asz = 1.0, J = 1.0, Iyy = 1.0, Izz = 1.0;
    bool operator==(const T_SECT_FACTORS&) const = default;
};

struct T_SECT_D {
    std::string name;
    SECT_SHAPE shape = SECT_SHAPE::Value;
    /// Rectangle: height, width. Circle: diameter. Pipe: diameter, wall. Box: height, width, web,
    /// flange. I: height, flange width, web, flange. Channel: the same, its web at -y; a tapered
    /// flange by its thickness at the middle of what stands out from the web. Height is along z,
    /// width along y.
    std::array<double, 4> size{};
    double area = 0.0, Asy = 0.0, Asz = 0.0; // area, shear areas
    double J = 0.0, Iyy = 0.0, Izz = 0.0;    // second moments
    double Zy = 0.0, Zz = 0.0;               // plastic moduli
    T_SECT_FACTORS factorsI, factorsJ;
    std::vector<T_REBAR> bars; // concrete
    std::optional<T_SECT_DETAIL> detailing{};
    /// I, channel: radius where flange and web meet. Box: outer radius of the corners; the inner
    /// one is less by the wall, at least the wall. 0: sharp (welded).
    double fillet = 0.0;
    /// Channel: slope of the inner faces of the flanges; 0: parallel ones.
    double taper = 0.0;
    bool operator==(const T_SECT_D&) const = default;
};

/// Inner radius of a box with rounded corners, see T_SECT_D::fillet.
inline double InnerRadius(const T_SECT_D& box)
{
    const double wall = std::max(box.size[2], box.size[3]);
    return box.fillet > 0.0 ? std::max(box.fillet - wall, wall) : 0.0;
}
/// Thickness of the flanges of a channel at the web and at the tip.
inline std::pair<double, double> FlangeEnds(const T_SECT_D& channel)
{
    const double change = 0.5 * channel.taper * (channel.size[1] - channel.size[2]);
    return {channel.size[3] + change, channel.size[3] - change};
}
/// The tips of tapered flanges are rounded with half the fillet, as DIN 1026-1 has it.
inline double ToeRadius(const T_SECT_D& channel)
{
    return channel.taper > 0.0 ? 0.5 * channel.fillet : 0.0;
}
/// A part of its side that an arc between a face of the flange and the web or the tip takes.
inline double ArcTangent(const T_SECT_D& channel, double radius)
{
    return radius * std::tan(0.25 * std::numbers::pi - 0.5 * std::atan(channel.taper));
}
/// Only the flanges of a channel are tapered; something is left of their tips.
inline bool TaperFits(const T_SECT_D& s)
{
    return s.taper == 0.0 ||
           (s.taper > 0.0 && s.shape == SECT_SHAPE::Channel && FlangeEnds(s).second > 0.0);
}
/// Fillets and rounded tips have room on web, faces and tips.
inline bool ArcsFit(const T_SECT_D& channel)
{
    const double root = ArcTangent(channel, channel.fillet);
    const double toe = ArcTangent(channel, ToeRadius(channel));
    const double face = std::hypot(1.0, channel.taper) * (channel.size[1] - channel.size[2]);
    const auto [thick, thin] = FlangeEnds(channel);
    return thick + root <= 0.5 * channel.size[0] && root + toe <= face && toe <= thin;
}
/// The fillet has room; only an I, a channel and a box have one.
inline bool FilletFits(const T_SECT_D& s)
{
    if (s.fillet == 0.0) return true;
    const auto& [a, b, c, d] = s.size;
    if (!(s.fillet > 0.0)) return false;
    if (s.shape == SECT_SHAPE::IShape) return s.fillet <= 0.5 * (b - c) && s.fillet <= 0.5 * a - d;
    if (s.shape == SECT_SHAPE::Channel) return ArcsFit(s);
    if (s.shape != SECT_SHAPE::Box) return false;
    return 2.0 * s.fillet <= std::min(a, b) &&
           2.0 * InnerRadius(s) <= std::min(b - 2.0 * c, a - 2.0 * d);
}
/// Of a rectangle with detailing: the stirrups leave a core within the cover.
inline bool LeavesCore(const T_SECT_D& s)
{
    if (!s.detailing || s.shape != SECT_SHAPE::Rectangle) return true;
    const double edge = s.detailing->cover + s.detailing->stirrupDiameter;
    return 2.0 * edge < std::min(s.size[0], s.size[1]);
}
/// Likewise: the centre of every bar lies within the stirrups.
inline bool HoldsBars(const T_SECT_D& s)
{
    if (!s.detailing || s.shape != SECT_SHAPE::Rectangle) return true;
    const double edge = s.detailing->cover + s.detailing->stirrupDiameter;
    return std::ranges::all_of(s.bars, [&](const T_REBAR& bar) {
        return std::fabs(bar.z) < 0.5 * s.size[0] - edge &&
               std::fabs(bar.y) < 0.5 * s.size[1] - edge;
    });
}

// ---- elements and constraints -------------------------------------------------------------------

enum class ELEM_KIND {
    Beam,   // between two nodes, with shear deformation where the section has shear areas
    Truss,  // axial force alone
    Link,   // six springs between two nodes, global axes
    Spring, // six springs between a node and the ground, global axes
};

/// Which of the six directions, in the order X, Y, Z, RX, RY, RZ.
using T_DIRS6 = std::array<bool, 6>;

struct T_ELEM_D {
    int id = 0;
    int nodeI = 0, nodeJ = 0;      // of a spring nodeI alone
    int section = 0, material = 0; // keys
    int member = 0;                // elements of one member share the number; 0: alone
    ELEM_KIND kind = ELEM_KIND::Beam;
    /// Local z is the part of this vector normal to the element; zero: global Z, global X for a
    /// vertical element. Local x runs from I to J.
    std::array<double, 3> zAxis{};
    T_ENDS<T_DIRS6> release{};              // of a beam, local axes: no force is carried there
    T_ENDS<std::array<double, 3>> offset{}; // of a beam, rigid, from the node to the end, global
    std::array<double, 6> stiffness{};      // of a link or spring: 3 force / length, 3 moment
    bool operator==(const T_ELEM_D&) const = default;
};

/// Nodes that move as one rigid body in the plane normal to an axis.
struct T_DIAP_D {
    std::vector<int> nodes;
    int normal = 2; // 0 X, 1 Y, 2 Z
    bool operator==(const T_DIAP_D&) const = default;
};

/// Nodes whose displacements in these directions are equal.
struct T_EQDS_D {
    std::vector<int> nodes;
    T_DIRS6 directions{};
    bool operator==(const T_EQDS_D&) const = default;
};
