#include "qm_db/records/pushnames.h"

#include "qm_base/textformat.h"

#include <algorithm>

std::string TurnedName(const std::string& name, double angleDegrees)
{
    return name + "@" + FormatText("%g", angleDegrees);
}

bool IsTurnOf(const std::string& turned, const std::string& name)
{
    return turned.size() > name.size() && turned.starts_with(name) && turned[name.size()] == '@';
}

std::vector<std::string> TurnedNames(const T_POLC_D& record)
{
    std::vector<std::string> names;
    constexpr double kLeast = 1.0; // degrees; below it a load case is not pushed
    if (!record.control || !record.control->generateStaticAngle) return names;
    const double angle = record.control->staticAngle;
    for (int i = 1; angle >= kLeast && i * angle < 360.0; ++i)
        names.push_back(TurnedName(record.name, i * angle));
    return names;
}

std::optional<T_PUSH_NAME> FindPush(const T_MODEL& model, const std::string& name)
{
    for (const auto& [key, record] : model.pushovers)
        if (record.name == name) return T_PUSH_NAME{key, 0};
    for (const auto& [key, record] : model.pushovers) {
        if (!IsTurnOf(name, record.name)) continue;
        const std::vector<std::string> names = TurnedNames(record);
        const auto at = std::ranges::find(names, name);
        if (at != names.end()) return T_PUSH_NAME{key, static_cast<int>(at - names.begin()) + 1};
    }
    return std::nullopt;
}

std::vector<std::string> PushNames(const T_MODEL& model)
{
    std::vector<std::string> names;
    for (const auto& [key, record] : model.pushovers) {
        names.push_back(record.name);
        for (std::string& turned : TurnedNames(record))
            names.push_back(std::move(turned));
    }
    return names;
}
