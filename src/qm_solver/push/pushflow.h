// Yield conditions of the hinges: what flows, when, and in which direction.
#pragma once

#include "qm_solver/push/hingebackbone.h"
#include "qm_solver/push/pushstructure.h"

#include <array>

namespace solver {

/// A factor at a row of the structure.
struct T_FLOW_TERM {
    std::size_t row = 0;
    double factor = 0.0;
};

/// A strength by axial force, straight between its points, and the part that counts now. At a
/// corner the direction in which the axial force goes decides.
class CAxialLine {
public:
    struct T_POINT {
        double axial, strength;
    };
    CAxialLine() = default;
    explicit CAxialLine(std::vector<T_POINT> points);

    bool IsGiven() const { return m_points.size() > 1; }
    /// Takes the part that holds `axial`; at a corner that into which `rate` leads.
    void Choose(double axial, double rate);
    double Value(double axial) const;
    double Slope() const;
    /// Axial force at which the part ends in the direction of `rate`; infinite with rate 0.
    double Corner(double rate) const;
    /// The corner of that direction is the end of the line.
    bool IsLast(double rate) const;
    /// What axial forces are compared with: the range in which the strength changes.
    double Width() const { return m_width; }

private:
    std::vector<T_POINT> m_points;
    std::size_t m_part = 0;
    double m_width = 1.0;
};

/// One condition: phi = value - scale * resistance <= 0. Of a side of a law the value is its force,
/// the scale the strength at the present axial force over that of its backbone. Of a face of a
/// biaxial hinge value = Sl(N) (c My / Sy(N) + s Mz / Sz(N)), l the axis nearer to its normal:
/// about one axis alone it is the condition of that side. The scale has the face's distance in it,
/// too.
class CPushFlow {
public:
    std::size_t hinge = 0, law = 0; // law: the one whose backbone it follows
    bool positive = true;
    std::size_t backbone = 0; // several faces share none: one each
    /// Faces whose flow counts for this one, too, by the part of it that goes its way.
    struct T_MATE {
        std::size_t flow;
        double share;
    };
    std::vector<T_MATE> mates;
    double force = 1.0;     // of reference: strength of the backbone
    double stiffness = 1.0; // elastic, of the element with its nodes held
    bool associated = false;

    /// A side of a law: row of its force; axial row and line of strength over that of the backbone.
    void SetSide(std::size_t row, bool isPositive, std::size_t axialRow, CAxialLine ratio);
    /// A face: rows of My and Mz, direction cosines of its normal, strengths by axial force.
    void SetFace(std::array<std::size_t, 2> rows, std::array<double, 2> normal, double distance,
                 std::array<double, 2> strength, std::size_t axialRow,
                 std::array<CAxialLine, 2> ratios);
    /// Another normal of the face, its distance kept; by axial force where a line is given.
    void SetNormal(std::array<double, 2> normal, std::array<CAxialLine, 2> byAxial);

    double Value(std::span<const double> s) const;
    double Scale(std::span<const double> s) const;
    /// Derivatives of phi by the forces of rows, the resistance given. Holds until the next call.
    std::span<const T_FLOW_TERM> Gradient(std::span<const double> s, double resistance) const;
    /// Plastic deformation of rows by unit flow.
    std::span<const T_FLOW_TERM> Direction(std::span<const double> s, double resistance) const;

    /// Strengths over those of the backbones, then parts of the normal.
    using T_LINES = std::array<CAxialLine, 4>;
    bool HangsOnAxial() const { return m_hangs; }
    std::size_t AxialRow() const { return m_axialRow; }
    T_LINES& Lines() { return m_lines; }
    const T_LINES& Lines() const { return m_lines; }
    /// Slopes of the parts of the lines that count now.
    std::array<double, 4> Slopes() const;
    std::span<const std::size_t> Rows() const { return {m_rows.data(), m_count}; }

private:
    double Normal(std::size_t k, double axial) const;
    double Strengths(std::size_t k, double axial) const;
    double Weight(std::size_t k, double axial) const;
    double WeightSlope(std::size_t k, double axial) const;
    double Axial(std::span<const double> s) const { return HangsOnAxial() ? s[m_axialRow] : 0.0; }

    std::array<std::size_t, 2> m_rows{};
    std::size_t m_count = 1, m_axialRow = 0;
    std::size_t m_leading = 0; // the component whose strength the condition is measured by
    std::array<double, 2> m_normal{1.0, 0.0}, m_strength{1.0, 1.0};
    double m_distance = 1.0;
    T_LINES m_lines;
    bool m_hangs = false;
    mutable std::array<T_FLOW_TERM, 3> m_gradient{}, m_direction{}; // of the last call
};

/// The flows of all hinges of a model, with their backbones.
struct T_PUSH_FLOWS {
    std::vector<CPushFlow> flows;
    std::vector<CHingeBackbone> backbones;
};
T_PUSH_FLOWS MakeFlows(const T_PUSH_MODEL& model, const CPushStructure& structure);

/// A face of the polygon of a biaxial hinge: angle of its normal, from the axis of My to that of
/// Mz, distance from the centre.
struct T_FACE {
    double angle, distance;
};
/// Faces for strengths of 1: across the axes, so that bending about one axis alone flows about it
/// alone, with its full strength; between them chords of the ellipse. Within +0.14 and -1.6 % of
/// it. Face k lies between the corners k - 1 and k.
std::vector<T_FACE> BiaxialFaces();
/// Normal of face k over its distance, for corners at these shares of the ellipse.
std::array<double, 2> FaceNormal(std::size_t k, const std::array<double, kBiaxialCorners>& share);

} // namespace solver
