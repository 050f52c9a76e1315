#include "qm_rps/create/numberlist.h"

#include "qm_base/textformat.h"

#include <algorithm>

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

} // namespace

std::optional<std::vector<double>> ParseNumberList(std::string_view text, std::string& bad)
{
    std::string plain(text);
    const bool hasSemicolons = plain.find(';') != plain.npos;
    if (hasSemicolons) std::ranges::replace(plain, ',', '.');
    std::vector<double> out;
    constexpr std::string_view kParts = " \t\r\n,;";
    for (std::size_t at = plain.find_first_not_of(kParts); at < plain.size();) {
        const std::size_t end = std::min(plain.find_first_of(kParts, at), plain.size());
        const std::string part = plain.substr(at, end - at);
        if (!Append(part, out)) {
            bad = part;
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
