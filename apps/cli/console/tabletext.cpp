#include "console/tabletext.h"

#include <algorithm>

namespace {

/// Letters of a UTF-8 text.
std::size_t Letters(const std::string& text)
{
    return static_cast<std::size_t>(std::ranges::count_if(
        text, [](char c) { return (static_cast<unsigned char>(c) & 0xC0) != 0x80; }));
}

} // namespace

std::string TableText(const T_TABLE_ROWS& rows)
{
    std::vector<std::size_t> width(rows.front().size());
    for (const auto& row : rows)
        for (std::size_t c = 0; c < row.size(); ++c)
            width[c] = std::max(width[c], Letters(row[c]));
    std::string text;
    for (const auto& row : rows) {
        for (std::size_t c = 0; c + 1 < row.size(); ++c)
            text += std::string(width[c] - Letters(row[c]), ' ') + row[c] + "  ";
        text += row.back() + '\n';
    }
    return text;
}
