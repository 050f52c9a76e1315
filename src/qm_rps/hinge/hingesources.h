// Sections and materials by key, and the strengths calculated from a pair of them.
#pragma once

#include "qm_db/records.h"
#include "qm_rps/hinge/axialforcelist.h"
#include "qm_rps/hinge/sectionstrength.h"

#include <algorithm>
#include <map>
#include <utility>

/// Interaction curves about y and z as lines of points.
struct T_PM_LINES {
    T_SIDES<std::vector<T_PM_POINT>> y, z;
};

/// Values in the units given. A strength is calculated when it is first asked for and
/// kept, so one object serves one thread.
class CHingeSources {
public:
    struct T_RESULT {
        SECT_FAULT fault = SECT_FAULT::None; // None: strength holds
        T_SECTION_STRENGTH strength;
    };

    CHingeSources(T_TABLE<T_SECT_D> sections, T_TABLE<T_MATL_D> materials, const T_UNITS& units)
        : m_sections(std::move(sections)), m_materials(std::move(materials)), m_units(units)
    {
    }

    const T_TABLE<T_SECT_D>& Sections() const { return m_sections; }
    const T_TABLE<T_MATL_D>& Materials() const { return m_materials; }
    /// Null where there is none of that key.
    const T_SECT_D* Section(int key) const;
    const T_MATL_D* Material(int key) const;
    /// Null where the section or the material is missing.
    const T_RESULT* Strength(int section, int material) const;

    /// The whole interaction curves of the same pair, see CSectionStrength::CalcCurve. Empty where
    /// the strengths can't be calculated.
    T_PM_LINES Lines(int section, int material) const;

    /// Rows of the surface of the same pair, see CSectionStrength::CalcSurface; kept for these
    /// directions. Empty where it can't be calculated.
    const std::vector<T_SURFACE_ROW>& Surface(int section, int material,
                                              std::span<const double> directions) const;

    /// Axial forces that the pair can carry, compression positive: from minus the strength in
    /// tension to that in compression. Empty where they can't be calculated.
    std::optional<CAxialForceList::T_RANGE> AxialRange(int section, int material) const;

    /// True for a section whose fibres a frame can have: one with dimensions.
    static bool HasFibres(const T_SECT_D& section) { return section.shape != SECT_SHAPE::Value; }
    /// True for a section that a wall can have: a rectangle.
    static bool IsWall(const T_SECT_D& section) { return section.shape == SECT_SHAPE::Rectangle; }
    /// Thickness of a wall: the smaller side of its rectangle.
    static double Thickness(const T_SECT_D& wall) { return std::min(wall.size[0], wall.size[1]); }

private:
    T_TABLE<T_SECT_D> m_sections;
    T_TABLE<T_MATL_D> m_materials;
    T_UNITS m_units;
    mutable std::map<std::pair<int, int>, T_RESULT> m_results;
    struct T_SURFACE {
        std::vector<double> directions;
        std::vector<T_SURFACE_ROW> rows;
    };
    mutable std::map<std::pair<int, int>, T_SURFACE> m_surfaces;
};
