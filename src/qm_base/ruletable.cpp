#include "qm_base/ruletable.h"

#include "qm_base/msgfunction.h"

using zql::lib::MMSGFunction;

T_FINDING FindingOf(const T_RULE_HEAD& head, const T_RULE_PLACE& place)
{
    const std::string rule = head.key ? head.key : head.text ? head.text : head.message;
    const std::string shown = head.key ? MMSGFunction::GetValue(head.key) + head.suffix : rule;
    T_FINDING f;
    f.field = place.prefix + head.field;
    f.ruleText = rule;
    f.messageKey = head.message;
    f.text = MMSGFunction::Format(head.message, {place.name, shown});
    f.point = *head.point ? head.point : place.point;
    f.part = place.part;
    f.page = place.page;
    return f;
}
