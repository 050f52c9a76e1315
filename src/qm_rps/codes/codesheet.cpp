#include "qm_rps/codes/codesheet.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace {

struct T_REASON_TEXT {
    CODE_REASON reason;
    const char* key;
};
constexpr std::array<T_REASON_TEXT, 7> kReasonTexts{{
    {CODE_REASON::NotFinite, "IDS_QM_CODE_FAULT_NOT_FINITE"},
    {CODE_REASON::NotPositive, "IDS_QM_CODE_FAULT_NOT_POSITIVE"},
    {CODE_REASON::Negative, "IDS_QM_CODE_FAULT_NEGATIVE"},
    {CODE_REASON::OutOfRange, "IDS_QM_CODE_FAULT_RANGE"},
    {CODE_REASON::Missing, "IDS_QM_CODE_FAULT_MISSING"},
    {CODE_REASON::NoRow, "IDS_QM_CODE_FAULT_NO_ROW"},
    {CODE_REASON::Tension, "IDS_QM_CODE_FAULT_TENSION"},
}};

} // namespace

std::string WarningText(const T_CODE_WARNING& warning)
{
    const auto place = [&](std::size_t i) {
        return i < warning.places.size() ? warning.places[i] : std::string();
    };
    return Say(warning.key, place(0), place(1), place(2), place(3));
}

std::string FaultText(const T_CODE_FAULT& fault)
{
    const auto row = std::find_if(kReasonTexts.begin(), kReasonTexts.end(),
                                  [&](const auto& r) { return r.reason == fault.reason; });
    return Say(row->key, fault.member, fault.detail);
}

double CCodeSheet::Put(std::string_view symbol, double value, T_DIM dim, std::string_view clause,
                       std::string_view text, CODE_MARK mark)
{
    if (!std::isfinite(value)) Refuse(CODE_REASON::NotFinite, symbol, clause);
    if (mark == CODE_MARK::Recalled) Warn("IDS_QM_CODE_WARN_RECALLED", {std::string(clause)});
    m_trace.push_back(
        {std::string(symbol), value, dim, std::string(clause), std::string(text), mark});
    return value;
}

void CCodeSheet::Warn(const char* key, std::vector<std::string> places)
{
    T_CODE_WARNING warning{key, std::move(places)};
    if (std::find(m_warnings.begin(), m_warnings.end(), warning) == m_warnings.end())
        m_warnings.push_back(std::move(warning));
}

void CCodeSheet::WarnOutside(std::string_view clause, std::string_view symbol, double value,
                             double nearest)
{
    Warn("IDS_QM_CODE_WARN_OUTSIDE",
         {std::string(clause), std::string(symbol), CodeNumber(value), CodeNumber(nearest)});
}

void CCodeSheet::WarnConflict(std::string_view clause, std::string_view taken,
                              std::string_view others)
{
    Warn("IDS_QM_CODE_WARN_CONFLICT",
         {std::string(clause), std::string(taken), std::string(others)});
}

bool CCodeSheet::Positive(std::initializer_list<T_CODE_MEMBER> members)
{
    for (const T_CODE_MEMBER& m : members)
        if (Finite({m}) && !(m.value > 0.0)) Refuse(CODE_REASON::NotPositive, m.name);
    return Sound();
}

bool CCodeSheet::NotNegative(std::initializer_list<T_CODE_MEMBER> members)
{
    for (const T_CODE_MEMBER& m : members)
        if (Finite({m}) && !(m.value >= 0.0)) Refuse(CODE_REASON::Negative, m.name);
    return Sound();
}

bool CCodeSheet::Within(const char* name, double value, double low, double high)
{
    if (Finite({{name, value}}) && !(low <= value && value <= high))
        Refuse(CODE_REASON::OutOfRange, name, CodeNumber(low) + " ... " + CodeNumber(high));
    return Sound();
}

bool CCodeSheet::Finite(std::initializer_list<T_CODE_MEMBER> members)
{
    for (const T_CODE_MEMBER& m : members)
        if (!std::isfinite(m.value)) Refuse(CODE_REASON::NotFinite, m.name);
    return Sound();
}

bool CCodeSheet::Refuse(CODE_REASON reason, std::string_view member, std::string_view detail)
{
    if (!m_fault) m_fault = T_CODE_FAULT{reason, std::string(member), std::string(detail)};
    return false;
}

std::string CodeNumber(double value)
{
    return FormatText("%.4g", value);
}

double RootPsi(double strength)
{
    return std::sqrt(strength * kPascalsPerPsi);
}

double RootMpa(double strength)
{
    return std::sqrt(strength * kPascalsPerMpa);
}

double LinearClamped(double x, double x0, double y0, double x1, double y1)
{
    const double t = std::clamp((x - x0) / (x1 - x0), 0.0, 1.0);
    return y0 + t * (y1 - y0);
}
