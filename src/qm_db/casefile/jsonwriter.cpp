#include "qm_db/casefile/jsonwriter.h"

#include "qm_db/casefile/jsonnumber.h"
#include "qm_db/file/jsonplace.h"

#include <nlohmann/json.hpp>

namespace {

constexpr std::size_t kLineWidth = 100;

} // namespace

void CJsonWriter::FailWith(const std::string& words)
{
    if (Failed()) return;
    std::string place;
    for (const T_LEVEL& level : m_levels) {
        if (!level.isArray && level.count == 0) break; // an object that has just begun
        place = level.isArray ? ItemPlace(place, level.count - 1) : MemberPlace(place, level.key);
    }
    m_error = {FILE_FAULT::BadInput, place.empty() ? words : place + ": " + words};
}

void CJsonWriter::NewLine(std::size_t indent)
{
    m_text += '\n';
    m_lineStart = m_text.size();
    m_text.append(indent, ' ');
}

void CJsonWriter::Separate()
{
    T_LEVEL& level = m_levels.back();
    if (level.count > 0) m_text += level.oneLine ? ", " : ",";
    if (!level.oneLine) NewLine(m_levels.size());
    ++level.count;
}

void CJsonWriter::Key(std::string_view key)
{
    Separate();
    m_levels.back().key = key;
    AppendText(key);
    m_text += ": ";
}

void CJsonWriter::BeforeValue()
{
    if (!m_levels.empty() && m_levels.back().isArray) Separate();
}

void CJsonWriter::Begin(char bracket, bool oneLine)
{
    BeforeValue();
    m_text += bracket;
    const bool inOneLine = !m_levels.empty() && m_levels.back().oneLine;
    m_levels.push_back({oneLine || inOneLine, bracket == '[', 0, {}});
}

void CJsonWriter::End(char bracket)
{
    const T_LEVEL level = std::move(m_levels.back());
    m_levels.pop_back();
    if (level.count > 0 && !level.oneLine) NewLine(m_levels.size());
    m_text += bracket;
    if (m_levels.empty()) m_text += '\n';
}

void CJsonWriter::Value(double value, T_DIM dim)
{
    BeforeValue();
    const auto text = SiText(value, m_units, dim);
    if (!text) return Fail("IDS_QM_JSON_NOT_FINITE");
    m_text += *text;
}

void CJsonWriter::Value(int value)
{
    BeforeValue();
    m_text += std::to_string(value);
}

void CJsonWriter::Value(bool value)
{
    BeforeValue();
    m_text += value ? "true" : "false";
}

void CJsonWriter::Value(std::string_view value)
{
    BeforeValue();
    AppendText(value);
}

void CJsonWriter::Value(std::span<const double> values, T_DIM dim)
{
    Value(values, std::span<const T_DIM>(&dim, 1));
}

void CJsonWriter::Value(std::span<const double> values, std::span<const T_DIM> dims)
{
    BeforeValue();
    std::string joined;
    for (std::size_t i = 0; i < values.size(); ++i) {
        const auto text = SiText(values[i], m_units, dims.size() == 1 ? dims[0] : dims[i]);
        if (!text) return Fail("IDS_QM_JSON_ITEM_NOT_FINITE", std::to_string(i));
        joined += i == 0 ? *text : ", " + *text;
    }
    AppendNumbers(joined);
}

void CJsonWriter::Value(std::span<const std::string> values)
{
    BeforeValue();
    m_text += '[';
    for (std::size_t i = 0; i < values.size(); ++i) {
        if (i > 0) m_text += ", ";
        AppendText(values[i]);
    }
    m_text += ']';
}

void CJsonWriter::Value(std::span<const int> values)
{
    BeforeValue();
    std::string joined;
    for (const int value : values)
        joined += (joined.empty() ? "" : ", ") + std::to_string(value);
    AppendNumbers(joined);
}

/// Numbers separated by ", " in brackets: on this line when they fit, else filled lines below.
void CJsonWriter::AppendNumbers(const std::string& joined)
{
    m_text += '[';
    const bool fits = m_text.size() - m_lineStart + joined.size() + 2 <= kLineWidth;
    if (fits || m_levels.empty() || m_levels.back().oneLine) {
        m_text += joined + ']';
        return;
    }
    NewLine(m_levels.size() + 1);
    for (std::size_t from = 0; from < joined.size();) {
        const std::size_t comma = std::min(joined.find(',', from), joined.size());
        const std::size_t length = comma - from + (comma < joined.size() ? 1 : 0);
        const bool first = m_text.size() == m_lineStart + m_levels.size() + 1;
        if (!first && m_text.size() - m_lineStart + 1 + length > kLineWidth)
            NewLine(m_levels.size() + 1);
        else if (!first)
            m_text += ' ';
        m_text.append(joined, from, length);
        from = comma + 2;
    }
    NewLine(m_levels.size());
    m_text += ']';
}

void CJsonWriter::AppendText(std::string_view text)
{
    try {
        m_text += nlohmann::json(text).dump();
    } catch (const nlohmann::json::type_error&) { // the only refusal of a text
        Fail("IDS_QM_JSON_NOT_UTF8");
    }
}
