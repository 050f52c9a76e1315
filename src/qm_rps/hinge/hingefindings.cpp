#include "qm_rps/hinge/hingefindings.h"

std::string FieldOn(HINGE_SIDE side, std::string field)
{
    const std::size_t at = side == HINGE_SIDE::Negative ? field.find(".pos") : std::string::npos;
    if (at != std::string::npos) field.replace(at, 4, ".neg");
    return field;
}

T_FINDING FindingOf(const T_HINGE_HEAD& head, const T_HINGE_PLACE& place)
{
    const bool known = place.component >= 0;
    const auto component = static_cast<HINGE_COMPONENT>(place.component);
    const T_SIDE_KEY& key =
        known && IsMoment(component) && head.momentKey.pos ? head.momentKey : head.key;
    const std::string field = FieldOn(place.side, head.field);
    const std::string list =
        place.curve < 0 ? std::string() : "curves[" + std::to_string(place.curve) + "].";
    T_RULE_HEAD words;
    words.message = head.message;
    words.text = head.text;
    words.key = place.side == HINGE_SIDE::Negative && key.neg ? key.neg : key.pos;
    words.suffix = head.suffix;
    words.field = field.c_str();
    words.point = head.point;
    T_RULE_PLACE at;
    if (known) at.name = kComponentNames.at(static_cast<std::size_t>(component));
    at.prefix = place.prefix + list;
    at.point = place.point;
    at.part = place.component;
    at.page = static_cast<int>(place.end);
    return FindingOf(words, at);
}

std::string PathOnPages(const T_FINDING& f)
{
    return EndOf(f) == HINGE_END::J ? "J." + f.field : f.field;
}

std::string PathInType(const T_FINDING& f)
{
    if (f.part < 0) return f.field;
    return std::string(kComponentNames.at(static_cast<std::size_t>(f.part))) + "." + PathOnPages(f);
}

const char* PageTitleKey(const T_HINGE_COMPONENT& c, HINGE_END end)
{
    if (NeedsIJPages(c))
        return end == HINGE_END::J ? "IDS_RPS_PO_DOF_PropertiesJ" : "IDS_RPS_PO_DOF_PropertiesI";
    return c.location == HINGE_LOCATION::BothEnds ? "IDS_RPS_PO_DOF_PropertiesIJ"
                                                  : "IDS_RPS_PO_DOF_Properties";
}
