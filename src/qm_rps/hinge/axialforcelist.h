// The axial forces of a FEMA curve that has one backbone per axial force, as they are edited.
// Units: the curve's. Forces are compared exactly.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/records.h"

#include <optional>
#include <vector>

class CAxialForceList {
public:
    using REFUSAL = std::optional<zql::frx::T_MESSAGE>;

    /// A force, with the index of the curve that it had when it was taken (-1: new).
    struct T_ROW {
        double axial = 0.0;
        int source = -1;
    };

    /// Forces that a section can carry, compression positive.
    struct T_RANGE {
        double lowest = 0.0, highest = 0.0;
    };

    CAxialForceList() = default;
    /// Without a range every finite force is taken.
    explicit CAxialForceList(const std::vector<T_SKEL_AXIAL>& curves,
                             std::optional<T_RANGE> range = {});

    /// Ascending.
    const std::vector<T_ROW>& Rows() const { return m_rows; }
    /// Curves of kept or changed forces as they were, new forces with `fresh`.
    std::vector<T_SKEL_AXIAL> Curves(const T_SIDES<T_SKEL_SIDE>& fresh) const;

    /// Each returns why it is refused, the list as it was then; nothing: done.
    [[nodiscard]] REFUSAL Add(double axial);
    [[nodiscard]] REFUSAL Change(double oldAxial, double axial);
    [[nodiscard]] REFUSAL Remove(double axial);

private:
    REFUSAL OutOfRange(double axial) const;
    int Find(double axial) const; // index or -1
    void Sort();

    std::vector<T_SKEL_AXIAL> m_given;
    std::vector<T_ROW> m_rows;
    std::optional<T_RANGE> m_range;
};
