#include "qm_rps/create/buildingparts.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/sectionproperties.h"
#include "qm_rps/create/createfault.h"

#include <algorithm>
#include <cmath>
#include <tuple>

namespace {

constexpr std::size_t kMostLines = 200; // bays or storeys one way
constexpr double kMostNodes = 2e5;      // more are no model that analyses take

/// "0.4x0.6": width and height, in SI.
std::optional<T_SECT_D> RectangleOf(const std::string& text, const T_UNITS& units)
{
    const std::size_t mark = text.find_first_of("xX*");
    if (mark == text.npos) return std::nullopt;
    const auto width = ParseFinite(text.substr(0, mark));
    const auto height = ParseFinite(text.substr(mark + 1));
    if (!width || !height || !(*width > 0.0) || !(*height > 0.0)) return std::nullopt;
    T_SECT_D section;
    section.shape = SECT_SHAPE::Rectangle;
    section.size = {ToSi(*height, units, kDimLength), ToSi(*width, units, kDimLength), 0.0, 0.0};
    return section;
}

} // namespace

int ReadBuildingPart(const std::string& field, const std::string& section, const std::string& grade,
                     const T_UNITS& units, T_BUILDING_PART& out, T_FINDING& fault)
{
    T_BUILDING_PART part;
    const std::optional<T_SECT_D> rectangle = RectangleOf(section, units);
    const std::optional<T_SECT_D> shape = rectangle ? rectangle : NamedShape(section);
    if (!shape)
        return CreateFault(fault, field.c_str(), "IDS_QM_NEW_NO_SECTION", section,
                           NoShapeText(section));
    part.section = *shape;
    part.section.name = rectangle ? section + " " + std::string(NameOf(units.length)) : section;
    T_SECT_D full;
    SECT_FAULT why = SECT_FAULT::None;
    if (!CSectionProperties::Calc(part.section, full, why))
        return CreateFault(fault, field.c_str(), MessageKeyOf(why));
    part.area = full.area;
    const std::string gradeField = "grade." + field;
    if (!FillFromGrades(grade, false, part.material))
        return CreateFault(fault, gradeField.c_str(), "IDS_QM_NEW_NO_GRADE", grade);
    if (!rectangle && part.material.type != MATL_CLASS::Steel)
        return CreateFault(fault, gradeField.c_str(), "IDS_QM_NEW_STEEL_SHAPE", section, grade);
    part.density = part.material.density;
    part.material.density = 0.0; // weight stands in SELF, mass in the nodes
    part.material.name = grade + " (" + kBuildingCases[0] + ")";
    out = std::move(part);
    return 1;
}

int CheckBuilding(const T_BUILDING& in, T_FINDING& fault)
{
    const std::tuple<const char*, const std::vector<double>&, bool> lists[] = {
        {"baysX", in.baysX, true}, {"baysY", in.baysY, false}, {"storeys", in.storeys, true}};
    const auto isAbove0 = [](double v) { return v > 0.0 && std::isfinite(v); };
    for (const auto& [field, list, isNeeded] : lists)
        if ((isNeeded && list.empty()) || list.size() > kMostLines ||
            !std::ranges::all_of(list, isAbove0))
            return CreateFault(fault, field, "IDS_QM_NEW_LENGTHS", std::to_string(kMostLines));
    const std::pair<const char*, double> values[] = {{"dead", in.dead},
                                                     {"live", in.live},
                                                     {"roofDead", in.deadRoof},
                                                     {"roofLive", in.liveRoof},
                                                     {"massLive", in.liveInMass}};
    for (const auto& [field, value] : values)
        if (!std::isfinite(value)) return CreateFault(fault, field, "IDS_QM_NEW_NOT_FINITE");
    for (const auto& [field, value] : values)
        if (value < 0.0) return CreateFault(fault, field, "IDS_QM_NEW_NOT_NEGATIVE");
    if (in.liveInMass > 1.0)
        return CreateFault(fault, "massLive", "IDS_QM_NEW_SHARE", ShortestText(in.liveInMass));
    const double nodes = static_cast<double>(in.baysX.size() + 1) *
                         static_cast<double>(in.baysY.size() + 1) *
                         static_cast<double>(in.storeys.size() + 1);
    if (nodes > kMostNodes)
        return CreateFault(fault, "storeys", "IDS_QM_NEW_MANY_NODES", FormatText("%.0f", nodes),
                           FormatText("%.0f", kMostNodes));
    if (in.baysY.empty() && in.loaded == LOADED_BEAMS::AlongY)
        return CreateFault(fault, "loaded", "IDS_QM_NEW_NO_Y_BEAMS");
    return 1;
}

std::string BuildingDoubt(const T_BUILDING& in)
{
    constexpr double kLeastStorey = 1.5, kMostStorey = 20.0, kLeastBay = 0.5, kMostBay = 100.0; // m
    const auto isOutside = [&in](const std::vector<double>& lengths, double least, double most) {
        return std::ranges::any_of(lengths, [&](double value) {
            const double metres = ToSi(value, in.units, kDimLength);
            return metres < least || metres > most;
        });
    };
    const bool isOdd = isOutside(in.storeys, kLeastStorey, kMostStorey) ||
                       isOutside(in.baysX, kLeastBay, kMostBay) ||
                       isOutside(in.baysY, kLeastBay, kMostBay);
    return isOdd ? Say("IDS_QM_NEW_ODD_LENGTHS") : "";
}

bool IsUsualPeriod(double period)
{
    constexpr double kLeast = 0.02, kMost = 10.0; // s
    return period >= kLeast && period <= kMost;
}
