#include "qm_rps/dialog/unithead.h"

#include "qm_base/msgfunction.h"

std::string HeadWithUnit(const std::string& head, const std::optional<T_DIM>& dim,
                         const T_UNITS& units)
{
    const std::string text = zql::lib::MMSGFunction::GetValue(head); // a symbol stays
    if (!dim || *dim == kDimNone) return text;
    const auto part = [](std::string_view unit, int exponent) {
        return exponent == 1 ? std::string(unit) : std::string(unit) + std::to_string(exponent);
    };
    const std::string force(NameOf(units.force)), length(NameOf(units.length));
    std::string unit;
    if (*dim == kDimMass)
        unit = force + " s2/" + length;
    else if (dim->force == 1 && dim->length == -4)
        unit = force + " s2/" + part(length, 4);
    else if (dim->force == 0)
        unit = part(length, dim->length);
    else
        unit = dim->length < 0 ? force + "/" + part(length, -dim->length)
                               : force + (dim->length ? " " + part(length, dim->length) : "");
    return text + " (" + unit + ")";
}
