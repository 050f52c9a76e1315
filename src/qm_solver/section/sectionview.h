// A section seen along a direction of bending: s runs in the direction, t to its left. Strains are
// e0 + kappa s; forces are sums over the section.
#pragma once

#include "qm_solver/section/sectionshape.h"

namespace solver {

/// Sums of stress and of stress times s and t; with the tangent also those of the derivative times
/// 1, s, t, s2, s t, t2.
struct T_SUMS {
    double force = 0.0, overS = 0.0, overT = 0.0;
    std::array<double, 6> tangent{};
};

/// A strain that a fibre may reach: positive in compression, negative in tension.
struct T_MARK {
    double s = 0.0, strain = 0.0;
    T_FIBRE fibre;
    bool pivotC = false; // lies within its region, see PIVOT_RULE
};

class CSectionView {
public:
    /// The shape must outlive the view.
    explicit CSectionView(const T_SECTION_SHAPE& shape, double direction = 0.0);
    void Turn(double direction);

    T_SUMS Sums(double e0, double kappa);
    T_SUMS SumsAndTangent(double e0, double kappa);

    /// Limits of strain, and where yielding begins (steel at its yield strain, concrete that does
    /// not spall at its peak).
    const std::vector<T_MARK>& Limits() const { return m_limits; }
    const std::vector<T_MARK>& Yields() const { return m_yields; }
    double Top() const { return m_top; } // largest and smallest s
    double Bottom() const { return m_bottom; }
    double Direction() const { return m_direction; }
    const T_SECTION_SHAPE& Shape() const { return m_shape; }

    /// My and Mz of sums about s and t.
    double MomentY(const T_SUMS& sums) const { return m_cos * sums.overS + m_sin * sums.overT; }
    double MomentZ(const T_SUMS& sums) const { return m_sin * sums.overS - m_cos * sums.overT; }
    T_STRAIN_PLANE Plane(double e0, double kappa) const
    {
        return {e0, kappa * m_cos, kappa * m_sin};
    }

private:
    struct T_LINE {
        double s0, t0, s1, t1, sign;
        std::size_t law;
    };
    struct T_BOW {
        double s, t, radius, from, sweep, sign; // from: 0 along s
        std::size_t law;
    };
    struct T_POINT {
        double s, t, area;
        std::size_t law, host;
    };
    struct T_RANGE {
        double low, high;
    };

    void AddLine(const T_EDGE& edge);
    void AddBow(const T_ARC& arc);
    void Mark();
    void MarkRegion(std::size_t region);
    void MarkBars();
    template <bool kTangent>
    T_SUMS Add(double e0, double kappa);
    template <bool kTangent>
    void SumLine(const T_LINE& line, double e0, double kappa, T_SUMS& sums) const;
    template <bool kTangent>
    void SumBow(const T_BOW& bow, double e0, double kappa, T_SUMS& sums) const;
    template <bool kTangent>
    void SumPoint(const T_POINT& bar, double e0, double kappa, T_SUMS& sums) const;

    const T_SECTION_SHAPE& m_shape;
    double m_direction = 0.0, m_cos = 1.0, m_sin = 0.0;
    double m_top = 0.0, m_bottom = 0.0;
    double m_blockTop = 0.0; // of regions with a block; minus infinity without
    std::vector<CStressLaw> m_laws;
    std::vector<T_LINE> m_lines;
    std::vector<T_BOW> m_bows;
    std::vector<T_POINT> m_points;
    std::vector<T_RANGE> m_ranges; // of the regions
    std::vector<T_MARK> m_limits, m_yields;
};

} // namespace solver
