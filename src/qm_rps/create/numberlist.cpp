#include "qm_rps/create/numberlist.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"

#include <algorithm>
#include <cctype>

namespace {

constexpr std::size_t kMost = 1000; // numbers of a list

/// "3x5": how often, and what.
bool Append(const std::string& part, std::vector<double>& out)
{
    const std::size_t times = part.find_first_of("xX*");
    const std::optional<double> count = ParseFinite(part.substr(0, std::min(times, part.size())));
    if (times == part.npos) {
        if (count) out.push_back(*count);
        return count && out.size() <= kMost;
    }
    const std::optional<double> value = ParseFinite(part.substr(times + 1));
    if (!count || !value || !(*count >= 1.0 && *count <= kMost)) return false;
    const auto n = static_cast<std::size_t>(*count);
    if (static_cast<double>(n) != *count || out.size() + n > kMost) return false;
    out.insert(out.end(), n, *value);
    return true;
}

bool IsDigit(char c)
{
    return std::isdigit(static_cast<unsigned char>(c)) != 0;
}

/// Whether a comma between digits may be a decimal one as well: "3,5 3 3" beside blanks that part
/// numbers, "2x4,5". A decimal point or a semicolon tells.
bool IsInTwoWays(std::string_view text)
{
    constexpr std::string_view kBlanks = " \t\r\n";
    const std::size_t first = std::min(text.find_first_not_of(kBlanks), text.size());
    text = text.substr(first, text.find_last_not_of(kBlanks) + 1 - first);
    if (text.find_first_of(".;") != text.npos) return false;
    std::size_t tight = 0, at = 0;
    for (std::size_t i = 1; i + 1 < text.size(); ++i)
        if (text[i] == ',' && IsDigit(text[i - 1]) && IsDigit(text[i + 1])) ++tight, at = i;
    if (tight == 0) return false;
    const bool hasBlanks = text.find_first_of(kBlanks) != text.npos;
    const std::size_t times = text.find_first_of("xX*");
    return hasBlanks || (tight == 1 && times < at && text.find_first_of("xX*", at) == text.npos);
}

} // namespace

std::optional<std::vector<double>> ParseNumberList(std::string_view text, std::string& why)
{
    if (IsInTwoWays(text)) {
        why = Say("IDS_QM_NEW_LIST_EITHER", text);
        return std::nullopt;
    }
    std::string plain(text);
    const bool hasSemicolons = plain.find(';') != plain.npos;
    if (hasSemicolons) std::ranges::replace(plain, ',', '.');
    std::vector<double> out;
    constexpr std::string_view kParts = " \t\r\n,;";
    for (std::size_t at = plain.find_first_not_of(kParts); at < plain.size();) {
        const std::size_t end = std::min(plain.find_first_of(kParts, at), plain.size());
        const std::string part = plain.substr(at, end - at);
        if (!Append(part, out)) {
            why = Say("IDS_QM_NEW_LIST", part);
            return std::nullopt;
        }
        at = std::min(plain.find_first_not_of(kParts, end), plain.size());
    }
    return out;
}

std::string NumberListText(const std::vector<double>& numbers)
{
    std::string text;
    for (const double number : numbers)
        text += (text.empty() ? "" : ", ") + ShortestText(number);
    return text;
}
