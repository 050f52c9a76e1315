// The states of capacity of a section for one direction of bending: for each place of the neutral
// axis the curvature grows until the first fibre is at its limit.
#pragma once

#include "qm_solver/section/sectionview.h"

#include <optional>

namespace solver {

/// Why the section has no capacity: a fault with its law, or None. Steel that hardens without a
/// limit, or no compressed fibre that ends.
T_SECTION_ERROR CapacityFault(const T_SECTION_SHAPE& shape);

class CUltimateStates {
public:
    /// Nothing of CapacityFault may hold. The shape must outlive this.
    CUltimateStates(const T_SECTION_SHAPE& shape, double direction);
    void Turn(double direction);

    double First() const { return m_first; } // places of uniform tension and compression
    double Last() const { return m_last; }
    T_CAPACITY At(double place);
    /// Along the direction of bending.
    double Moment(const T_CAPACITY& c) const;
    /// Place of the largest moment.
    double Peak();
    /// Compression first where an axial force has several states.
    std::optional<T_CAPACITY> AtAxial(double axial);
    /// The bar furthest in tension at its yield strain; none without bars or without such a state.
    std::optional<T_CAPACITY> Balanced();
    struct T_RANGE {
        double low, high;
    };
    T_RANGE AxialRange();

private:
    struct T_STRAINS {
        double e0 = 0.0, kappa = 0.0;
        T_FIBRE governs;
    };
    T_STRAINS Strains(double place) const;
    T_STRAINS PlasticStrains(double place) const;
    T_STRAINS Uniform(bool compression) const;
    T_CAPACITY Of(const T_STRAINS& strains);
    double PlaceOf(std::size_t sample) const;
    const std::vector<T_CAPACITY>& Samples();
    T_CAPACITY Between(double axial, double a, const T_CAPACITY& atA, double b,
                       const T_CAPACITY& atB);

    CSectionView m_view;
    double m_top = 0.0, m_depth = 0.0; // from the highest fibre that a limit in compression is on
    double m_first = 0.0, m_last = 0.0;
    bool m_tensionEnds = false; // by a limit of the steel
    T_CAPACITY m_tension, m_compression;
    std::vector<T_CAPACITY> m_samples; // on demand
};

} // namespace solver
