// Every point of a capacity curve where the demand at that point's own effective damping (and, for
// FEMA 440, its own effective period) equals the capacity: the fixed points that the procedures
// look for, whether a procedure finds them or not.
#pragma once

#include "qm_rps/pushover/perfptoperations.h"

/// A point where demand equals capacity.
struct T_BALANCED_POINT {
    double Sd = 0.0, Sa = 0.0; // length, g
    double betaEff = 0.0;      // effective damping there, per cent
    bool operator==(const T_BALANCED_POINT&) const = default;
};

class CPushOverAllPoints {
public:
    /// Reads the owner's capacity, demand and damping; changes nothing in it. `fema440` chooses
    /// the effective damping and period of FEMA 440 chapter 6, else ATC-40 8.2.2.
    CPushOverAllPoints(const CPushOverPerfPtRecord& owner, bool fema440);

    /// All such points in the order of the curve, to 1e-10 of the displacement. Sign changes of
    /// demand - capacity are bracketed at about 2,000 points along the curve, at least four in each
    /// segment, so that two such points closer than that may go unseen; a jump
    /// (the damping sets in at a finite ductility) is no point.
    std::vector<T_BALANCED_POINT> Find();

private:
    struct T_BALANCE {
        double ratio = 0.0;   // Sd of the demand / Sd of the point - 1
        double betaEff = 0.0; // per cent
    };
    std::optional<T_BALANCE> At(const T_POINT2& p) const;
    std::optional<T_BALANCE> AtAtc40(const T_POINT2& p, double dy, double ay) const;
    std::optional<T_BALANCE> AtFema440(const T_POINT2& p, double dy, double ay) const;
    /// Demand point at period T, the ordinates of the grid points coming from `ordinate`.
    template <class F>
    std::optional<double> DemandSd(double T, F&& ordinate) const;
    void Refine(const T_POINT2& from, double ratioFrom, const T_POINT2& to,
                std::vector<T_BALANCED_POINT>& out) const;

    const CPushOverPerfPtRecord& m_owner;
    CPerfPtOperations m_operations; // bilinear form and damping of a point
    bool m_fema440;
    double m_T0 = 0.0;
};
