#include "qm_rps/shell/decimals.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_db/unitctrl.h"

#include <algorithm>
#include <cctype>
#include <cmath>

namespace {

/// The text in the last brackets, round or square; empty: none.
std::string_view UnitOf(std::string_view head)
{
    for (const auto& [open, close] : {std::pair{'(', ')'}, std::pair{'[', ']'}}) {
        if (head.empty() || head.back() != close) continue;
        const std::size_t at = head.rfind(open);
        if (at != std::string_view::npos) return head.substr(at + 1, head.size() - at - 2);
    }
    return {};
}

template <class UNIT>
bool IsUnit(std::string_view text, UNIT last)
{
    for (int i = 0; i <= static_cast<int>(last); ++i)
        if (NameOf(static_cast<UNIT>(i)) == text) return true;
    return false;
}

bool IsForce(std::string_view text)
{
    return IsUnit(text, FORCE_UNIT::kips);
}

bool IsLength(std::string_view text)
{
    return IsUnit(text, LENGTH_UNIT::ft);
}

/// Force and length with a mark between them, "kN m" or "kN/m2"; length is cut by its power.
bool IsPair(std::string_view unit, char mark, std::string_view power)
{
    const std::size_t at = unit.find(mark);
    if (at == std::string_view::npos || !unit.ends_with(power)) return false;
    return IsForce(unit.substr(0, at)) &&
           IsLength(unit.substr(at + 1, unit.size() - at - 1 - power.size()));
}

bool SaysDisplacement(std::string_view head)
{
    const std::string words = zql::lib::MMSGFunction::GetValue("IDS_QM_PREF_DISPLACEMENT_WORDS");
    std::string text(head);
    std::ranges::transform(text, text.begin(), [](unsigned char c) { return std::tolower(c); });
    for (std::size_t from = 0; from < words.size();) {
        const std::size_t end = std::min(words.find(' ', from), words.size());
        if (end > from && text.find(words.substr(from, end - from)) != std::string::npos)
            return true;
        from = end + 1;
    }
    return false;
}

} // namespace

QUANTITY QuantityOf(std::string_view head)
{
    const std::string_view unit = UnitOf(head);
    if (IsForce(unit)) return QUANTITY::Force;
    if (IsLength(unit)) return SaysDisplacement(head) ? QUANTITY::Displacement : QUANTITY::Length;
    if (unit == "%" || unit == "-") return QUANTITY::Ratio;
    if (unit == "MPa" || unit == "kPa" || unit == "Pa" || IsPair(unit, '/', "2"))
        return QUANTITY::Stress;
    return IsPair(unit, ' ', "") ? QUANTITY::Moment : QUANTITY::Count;
}

std::string WithDecimals(const std::string& number, int decimals)
{
    const std::optional<double> value = ParseFinite(number);
    if (decimals < 0 || !value) return number;
    const double half = 0.5 * std::pow(10.0, -decimals);
    if (*value != 0.0 && std::fabs(*value) < half) return FormatText("%.1e", *value);
    return FormatText("%.*f", std::min(decimals, kMostDecimals), *value + 0.0);
}
