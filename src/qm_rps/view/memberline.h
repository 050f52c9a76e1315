// A straight prismatic member between its ends: internal forces and deflections at any place,
// exact under its loads. Local axes and signs of forces are those of an analysis (frameresult.h);
// one consistent set of units.
#pragma once

#include "qm_db/dbdoc.h"
#include "qm_rps/view/macaulay.h"
#include "qm_solver/framemodel.h"

#include <span>

/// A load in local axes. Distributed: per length, straight from w0 at a to w1 at b. Point and
/// moment: w0 at a. Places are lengths from the I-end.
struct T_LINE_LOAD {
    solver::BEAM_LOAD type = solver::BEAM_LOAD::Distributed;
    std::array<double, 3> w0{}, w1{};
    double a = 0.0, b = 0.0;
};

/// Bending about y and about z; of shear along y and along z, 0: no deformation.
struct T_LINE_STIFFNESS {
    double EIy = 0.0, EIz = 0.0, GAy = 0.0, GAz = 0.0;
};

/// Displacements and rotations of what the ends are joined to, local axes, and where they are
/// released.
struct T_LINE_ENDS {
    T_ENDS<T_DOF6> moved;
    T_ENDS<T_DIRS6> release;
};

/// Places of a sum from 0 to the length, cubic at most between its terms: the ends, where it leaps
/// or bends, all its extremes, and `parts` equal parts where it is curved. Ascending; between two
/// neighbours it only rises or only falls.
[[nodiscard]] std::vector<double> StationsOf(const CMacaulay& force, double length, int parts);

class CMemberLine {
public:
    /// From the forces of the cut at the I-end.
    CMemberLine(double length, const T_DOF6& atI, std::span<const T_LINE_LOAD> loads);
    /// Without loads, from the ends' displacements alone: slope and deflection of a Timoshenko
    /// beam. Released rotations carry no moment; other releases count as none.
    CMemberLine(double length, const T_LINE_ENDS& ends, const T_LINE_STIFFNESS& stiffness);

    double Length() const { return m_length; }
    /// Axial, shear y, shear z, torsion, moment y, moment z at x. Where it leaps, before the leap
    /// or behind it; at the J-end all loads lie before the cut.
    [[nodiscard]] double Force(std::size_t component, double x, bool behind = false) const;
    const CMacaulay& Series(std::size_t component) const { return m_force[component]; }

    /// Compares with the forces of an analysis at its five positions. True: they are the same
    /// within rounding. Else the differences (of second order, of loads that are not known) are
    /// added, straight between the positions, so that the values there are those of the analysis.
    bool FitTo(const T_ELEM_FORCES& analysed);

    /// Where to take values of a component, see StationsOf.
    [[nodiscard]] std::vector<double> Stations(std::size_t component, int parts) const;

private:
    double m_length = 0.0;
    std::array<CMacaulay, 6> m_force;
};

/// The member as it is deflected: curvatures M / EI and shear strains V / GA integrated along it
/// and closed with the displacements of the ends: translations where they are not released, else
/// rotations. Exact for a prismatic beam; along its axis straight between the ends.
class CDeflectedLine {
public:
    CDeflectedLine(const CMemberLine& line, const T_LINE_ENDS& ends,
                   const T_LINE_STIFFNESS& stiffness);
    /// Displacements along x, y, z at x.
    [[nodiscard]] std::array<double, 3> At(double x) const;

private:
    struct T_PLANE {
        CMacaulay turned, sheared; // slope by curvatures, deflection by shear strains
        double start = 0.0, slope = 0.0;
        [[nodiscard]] double Strained(double x) const
        {
            return turned.Integral(1, x) + sheared.At(x);
        }
    };
    static void Close(T_PLANE& plane, std::size_t along, std::size_t about, double sign,
                      double length, const T_LINE_ENDS& ends);

    double m_length = 0.0;
    std::array<double, 2> m_axial{}; // at I, at J
    std::array<T_PLANE, 2> m_planes; // deflection along y, along z
};
