#include "qm_rps/pushover/loadcaserows.h"

#include "qm_rps/po_loadcasedlg.h"

#include <algorithm>

std::vector<T_LOADCASE_ROW> LoadCaseRows(const CDBDoc& doc)
{
    std::vector<T_LOADCASE_ROW> rows;
    for (const auto& [key, record] : doc.Data().Model().pushovers) {
        const auto direction = static_cast<std::size_t>(record.direction - 1);
        rows.push_back({key,
                        {std::to_string(key), record.name, std::to_string(record.controlNode),
                         direction < kDirectionNames.size() ? kDirectionNames[direction] : "",
                         CPO_LoadCaseDlg::KindText(record.patternKind)}});
    }
    return rows;
}

int RowOfLoadCase(const std::vector<T_LOADCASE_ROW>& rows, int key)
{
    const auto it = std::ranges::find(rows, key, &T_LOADCASE_ROW::key);
    return it == rows.end() ? -1 : static_cast<int>(it - rows.begin());
}
