#include "qm_rps/dialog/gridblock.h"

#include <algorithm>

T_GRID_BLOCK BlockOfText(std::string text)
{
    std::erase(text, '\r');
    if (!text.empty() && text.back() == '\n') text.pop_back();
    T_GRID_BLOCK block;
    if (text.empty()) return block;
    block.push_back({std::string()});
    for (const char c : text) {
        if (c == '\n')
            block.push_back({std::string()});
        else if (c == '\t')
            block.back().emplace_back();
        else
            block.back().back() += c;
    }
    return block;
}

/// The first of what keeps the block out; null when it fits.
const char* WrongShape(const T_GRID_BLOCK& block, const T_GRID_RANGE& r, std::size_t rows,
                       std::size_t columns)
{
    constexpr const char* kMismatch = "IDS_CMD_PASTE_RANGE_MISMATCH";
    const auto ragged = [&](const auto& row) { return row.size() != block.front().size(); };
    if (block.empty() || std::ranges::any_of(block, ragged) || r.row >= rows || r.column >= columns)
        return kMismatch;
    const std::size_t height = block.size(), width = block.front().size();
    const bool oneCell = r.rows == 1 && r.columns == 1;
    if (!oneCell && (height != r.rows || width != r.columns)) return kMismatch;
    if (width > columns - r.column) return "IDS_CMD_PASTE_EXCEED_COLUMN";
    if (height > rows - r.row) return "IDS_CMD_PASTE_EXCEED_ROW";
    return nullptr;
}
