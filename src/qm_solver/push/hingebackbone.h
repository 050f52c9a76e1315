// One side of a hinge's law as plastic flow: the backbone in plastic deformations, and where on it
// the side is.
#pragma once

#include "qm_solver/pushmodel.h"

#include <algorithm>
#include <limits>

namespace solver {

/// Plastic deformation p >= 0 is what the hinge deforms beyond its spring (if it has one): total
/// deformation - force / stiffness. Forces are magnitudes, of the side's own direction. A side is
///   Locked  it does not flow: its force is free between Lower and Upper;
///   Virgin  it flows along the backbone, forwards alone;
///   Back    it moves along a reversible branch, both ways: the gap, the line to the origin, or the
///           backbone of a nonlinear elastic side;
///   Drop    its force falls at the same deformation, down to Force.
class CHingeBackbone {
public:
    enum class ON { Locked, Virgin, Back, Drop };
    static constexpr double kFar = std::numeric_limits<double>::infinity();

    CHingeBackbone() = default;
    /// spring: stiffness in series, 0 none. The side is a checked one: plastic deformations do not
    /// fall (IsFlowing).
    CHingeBackbone(const T_HINGE_SIDE& side, double spring);
    /// Plastic deformations of the vertices exist and do not fall.
    static bool IsFlowing(const T_HINGE_SIDE& side, double spring);

    ON On() const { return m_on; }
    /// It moves a part of its way without force.
    bool HasGap() const { return m_gap > 0.0 || m_slips; }
    double Flowed() const { return m_flowed; }
    /// Number of vertices of the law that have been passed, and how many it has.
    int Vertex() const { return static_cast<int>(m_vertex - std::min(m_vertex, m_start)); }
    int VertexCount() const { return static_cast<int>(m_points.size() - m_start); }
    /// Largest force of the side; what tolerances are compared with.
    double Strength() const;
    /// The force falls from here on, or did just before.
    bool LosesStrength() const { return m_on == ON::Drop || (m_on == ON::Virgin && Slope() < 0.0); }

    double Force() const; // on the branch, or the end of a drop
    double Slope() const; // of the branch: force by plastic deformation; 0 while locked
    double Upper() const; // Locked: force at which it begins to flow forwards
    double Lower() const; // Locked: ... backwards; -kFar: it does not
    /// Plastic deformation to the end of the branch; kFar: it has none that way.
    double Room(bool forwards) const;
    void Flow(double by);
    /// Locked: what flow of a neighbouring face adds to its deformation, up to its next vertex.
    void Share(double by);
    /// ... room for it, and the change of Upper by it.
    double ShareRoom() const;
    double ShareSlope() const;
    /// Faces that go with each other: those that unload elastically.
    bool CanShare() const { return !IsReversible(); }
    /// It has begun to flow itself, not by its neighbours alone.
    bool HasBegun() const { return m_begun; }

    /// Begins to move from Locked (at Upper or Lower), or turns from Back into what lies beyond.
    void Start(bool forwards);
    /// Came to the end of the branch.
    void End(bool forwards);
    /// Flow stops in the midst of the backbone: locked, or on the way back.
    void Unload();
    /// The force has come down to the end of the drop.
    void EndDrop();

private:
    struct T_POINT {
        double flowed = 0.0, force = 0.0;
    };
    bool IsReversible() const { return HasGap() || Way() != UNLOADING::Elastic; }
    UNLOADING Way() const
    {
        return m_broken && m_unloading == UNLOADING::Backbone ? UNLOADING::Elastic : m_unloading;
    }
    double Floor() const;  // lowest plastic deformation of the way back
    double Summit() const; // force of the backbone at the furthest deformation
    std::size_t PartAt(double flowed) const;
    double OnBackbone(double flowed) const;
    double SlopeOf(std::size_t part) const;
    void EnterVirgin();

    std::vector<T_POINT> m_points;
    double m_gap = 0.0;
    bool m_slips = false;
    UNLOADING m_unloading = UNLOADING::Elastic;
    ON m_on = ON::Locked;
    double m_flowed = 0.0;
    double m_furthest = 0.0; // of the backbone; with a gap its end at first
    std::size_t m_vertex = 0;
    std::size_t m_start = 0; // 1: the first point is the origin, not a vertex of the law
    bool m_begun = false;
    bool m_broken = false;  // a drop lies behind: there is no way back along the backbone
    std::size_t m_back = 0; // part of the backbone on the way back of a nonlinear elastic side
};

} // namespace solver
