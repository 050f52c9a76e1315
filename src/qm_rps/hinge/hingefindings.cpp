#include "qm_rps/hinge/hingefindings.h"

#include "qm_base/msgfunction.h"

namespace {

using zql::lib::MMSGFunction;

std::string WithSymbol(std::string text, const char* symbol)
{
    for (std::size_t at = 0; (at = text.find("%s", at)) != std::string::npos; ++at)
        text.replace(at, 2, symbol);
    return text;
}

const char* SymbolOf(RULE_TEXT kind, int component)
{
    if (kind == RULE_TEXT::Deform) return "D";
    return IsMoment(component) ? "M" : "F";
}

} // namespace

T_FINDING FindingOf(const T_HINGE_HEAD& head, const T_HINGE_PLACE& place)
{
    const int component = head.component >= 0 ? head.component : place.component;
    const char* symbol = SymbolOf(head.kind, component);
    const char* text = IsMoment(component) && head.textMoment ? head.textMoment : head.text;
    const std::string list =
        place.curve < 0 ? std::string() : "curves[" + std::to_string(place.curve) + "].";

    T_FINDING f;
    f.field = place.prefix + list + head.field;
    f.messageKey = head.messageKey;
    f.part = component;
    f.page = static_cast<int>(place.end);
    f.point = *head.point ? head.point : place.point;
    if (!text)
        f.ruleText = head.messageKey;
    else
        f.ruleText = head.kind == RULE_TEXT::Key ? text : WithSymbol(text, symbol);
    const std::string shown = head.kind == RULE_TEXT::Key && text
                                  ? MMSGFunction::GetValue(text) + head.suffix
                                  : f.ruleText;
    const char* name =
        component >= 0 && component < 6 ? kComponentNames[static_cast<std::size_t>(component)] : "";
    f.text = MMSGFunction::Format(head.messageKey, {name, shown});
    if (head.wordingKey)
        f.wording = MMSGFunction::Format(
            head.wordingKey, {WithSymbol(head.left, symbol), WithSymbol(head.right, symbol)});
    return f;
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

std::vector<const char*> PageTitleKeys(const T_HINGE_COMPONENT& c)
{
    std::vector<const char*> titles;
    ForEachPage(
        c, [&](HINGE_END end, const T_SKEL_CURVE&) { titles.push_back(PageTitleKey(c, end)); });
    return titles;
}
