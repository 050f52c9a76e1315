#include "json/jsontext.h"

#include "qm_base/textformat.h"

#include <cmath>
#include <nlohmann/json.hpp>

namespace {

std::string Quoted(std::string_view text)
{
    using json = nlohmann::json;
    return json(text).dump(-1, ' ', false, json::error_handler_t::replace);
}

} // namespace

void CJsonText::Break(int blanks)
{
    m_text += '\n';
    m_text.append(static_cast<std::size_t>(blanks), ' ');
}

void CJsonText::Before()
{
    const bool beside = std::exchange(m_beside, false);
    if (std::exchange(m_named, false) || m_open.empty()) return;
    T_OPEN& open = m_open.back();
    const bool oneLine = open.layout.item < 0;
    if (open.any) m_text += beside || oneLine ? ", " : ",";
    if (!beside && !oneLine) Break(open.layout.item);
    open.any = true;
}

void CJsonText::Open(char bracket, T_JSON_LAYOUT layout)
{
    Before();
    m_text += bracket;
    if (layout.item == kJsonNested.item) {
        const int depth = static_cast<int>(m_open.size());
        layout = {depth + 1, depth};
    }
    m_open.push_back({bracket == '{' ? '}' : ']', layout});
}

void CJsonText::End()
{
    const T_OPEN open = m_open.back();
    m_open.pop_back();
    if (open.layout.end >= 0 && (open.any || open.layout.breakEmpty)) Break(open.layout.end);
    m_text += open.close;
}

CJsonText& CJsonText::Key(std::string_view name)
{
    Before();
    m_text += Quoted(name) + ": ";
    m_named = true;
    return *this;
}

CJsonText& CJsonText::Beside()
{
    m_beside = true;
    return *this;
}

void CJsonText::Value(std::nullptr_t)
{
    Before();
    m_text += "null";
}

void CJsonText::Value(bool value)
{
    Before();
    m_text += value ? "true" : "false";
}

void CJsonText::Value(int value)
{
    Before();
    m_text += std::to_string(value);
}

void CJsonText::Value(std::size_t value)
{
    Before();
    m_text += std::to_string(value);
}

void CJsonText::Value(double value)
{
    Before();
    if (!std::isfinite(value))
        m_text += "null";
    else
        m_text +=
            m_reals == JSON_REALS::Shortest ? ShortestText(value) : nlohmann::json(value).dump();
}

void CJsonText::Value(std::string_view text)
{
    Before();
    m_text += Quoted(text);
}
