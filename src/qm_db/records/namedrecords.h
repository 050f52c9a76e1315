// Sections and materials of a model from the names of shapes and grades.
#pragma once

#include "qm_db/records/structrecords.h"
#include "qm_db/stock/matgrades.h"
#include "qm_db/stock/steelshapes.h"

#include <sstream>

/// Shape, sizes, fillet and taper of a named steel shape; see FindShape.
inline std::optional<T_SECT_D> NamedShape(const std::string& name)
{
    constexpr std::array kShapes{SECT_SHAPE::IShape, SECT_SHAPE::Channel, SECT_SHAPE::Box,
                                 SECT_SHAPE::Pipe};
    const std::optional<T_STOCK_SHAPE> found = FindShape(name);
    if (!found) return {};
    T_SECT_D s;
    s.shape = kShapes[static_cast<std::size_t>(found->kind)];
    s.size = found->size;
    s.fillet = found->fillet;
    s.taper = found->taper;
    return s;
}

/// Fills what the material leaves at 0.
inline void FillFrom(const T_MATL_GRADE& grade, T_MATL_D& m)
{
    const auto fill = [](double& value, double by) {
        if (value == 0.0) value = by;
    };
    const bool bars = grade.of == GRADE_OF::Bars;
    fill(bars ? m.fyk : grade.of == GRADE_OF::Concrete ? m.fck : m.Fy, grade.strength);
    fill(bars ? m.Es : m.E, grade.modulus);
    if (bars) return;
    fill(m.nu, grade.nu);
    fill(m.density, grade.density);
    fill(m.alpha, grade.alpha);
}

/// From one grade or, of concrete, also from one of bars: "C25/30", "C25/30 B500B", "S355". False:
/// there is no such grade, or none for this class of material; the material is as it was. `typed`:
/// the class was given, else it follows the grade.
inline bool FillFromGrades(const std::string& names, bool typed, T_MATL_D& material)
{
    std::istringstream words(names);
    T_MATL_D filled = material;
    bool any = false, bars = false;
    for (std::string word; words >> word;) {
        const T_MATL_GRADE* const grade = FindGrade(word);
        if (!grade) return false;
        bool& seen = grade->of == GRADE_OF::Bars ? bars : any;
        if (seen) return false;
        seen = true;
        const MATL_CLASS type =
            grade->of == GRADE_OF::Steel ? MATL_CLASS::Steel : MATL_CLASS::Concrete;
        if (!typed && grade->of != GRADE_OF::Bars) filled.type = type;
        FillFrom(*grade, filled);
        if (grade->of != GRADE_OF::Bars && type != filled.type) return false;
    }
    // Bars stand in concrete; alone they need a material that is said to be of it.
    if (!(any || bars) || (bars && filled.type != MATL_CLASS::Concrete)) return false;
    material = filled;
    return true;
}
