#include "qm_rps/desk/elementlist.h"

#include <algorithm>
#include <charconv>

namespace {

constexpr std::size_t kMost = 1000000; // numbers, each time that one is named

/// "7" or "5-9" into the list. False: neither.
bool AddPart(std::string_view part, std::vector<int>& ids)
{
    const char* const end = part.data() + part.size();
    int from = 0, to = 0;
    auto read = std::from_chars(part.data(), end, from);
    if (read.ec != std::errc() || from <= 0) return false;
    to = from;
    if (read.ptr != end) {
        if (*read.ptr != '-') return false;
        read = std::from_chars(read.ptr + 1, end, to);
        if (read.ec != std::errc() || read.ptr != end) return false;
    }
    if (to < from || ids.size() + static_cast<std::size_t>(to - from) >= kMost) return false;
    for (int i = 0; i <= to - from; ++i) // to may be the largest number
        ids.push_back(from + i);
    return true;
}

} // namespace

std::optional<std::vector<int>> ParseElementList(const std::string& text)
{
    std::string plain;
    for (const char c : text)
        if (c != ' ' && c != '\t') plain += c;
    std::vector<int> ids;
    for (std::size_t at = 0; !plain.empty() && at <= plain.size();) {
        const std::size_t comma = std::min(plain.find(',', at), plain.size());
        if (!AddPart(std::string_view(plain).substr(at, comma - at), ids)) return std::nullopt;
        at = comma + 1;
    }
    std::ranges::sort(ids);
    ids.erase(std::ranges::unique(ids).begin(), ids.end());
    return ids;
}

std::string ElementListText(const std::vector<int>& ids)
{
    std::string text;
    for (std::size_t i = 0; i < ids.size();) {
        std::size_t last = i;
        while (last + 1 < ids.size() && ids[last + 1] == ids[last] + 1)
            ++last;
        text += (text.empty() ? "" : ", ") + std::to_string(ids[i]);
        if (last > i) text += (last == i + 1 ? ", " : "-") + std::to_string(ids[last]);
        i = last + 1;
    }
    return text;
}
