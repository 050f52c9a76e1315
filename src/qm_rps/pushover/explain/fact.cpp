#include "qm_rps/pushover/explain/fact.h"

#include "qm_base/textformat.h"

std::string T_FACT::ValueText() const
{
    if (!value) return text;
    return FormatText("%.6g", *value) + (unit.empty() ? "" : " " + unit);
}
