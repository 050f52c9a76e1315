#include "qm_rps/pushover/loadcaserows.h"

#include "qm_base/msgfunction.h"

#include <algorithm>

std::vector<T_LOADCASE_ROW> LoadCaseRows(const CDBDoc& doc)
{
    std::vector<T_LOADCASE_ROW> rows;
    for (const auto& [key, record] : doc.Data().Model().pushovers) {
        const auto direction = static_cast<std::size_t>(record.direction - 1);
        rows.push_back({key,
                        {std::to_string(key), record.name, std::to_string(record.controlNode),
                         direction < kDirectionNames.size() ? kDirectionNames[direction] : "",
                         PatternKindText(record.patternKind)}});
    }
    return rows;
}

std::string PatternKindText(int kind)
{
    static constexpr std::array<const char*, 4> kKeys{
        "IDS_PUSHOVER_Static_Load_Cases", "IDS_PUSHOVER_Uniform_Acceleration",
        "IDS_PUSHOVER_Mode_Shape", "IDS_PUSHOVER_Mode_Shape_Story_Mass"};
    const auto at = static_cast<std::size_t>(kind);
    return at < kKeys.size() ? zql::lib::MMSGFunction::GetValue(kKeys[at]) : std::string();
}

int RowOfLoadCase(const std::vector<T_LOADCASE_ROW>& rows, int key)
{
    const auto it = std::ranges::find(rows, key, &T_LOADCASE_ROW::key);
    return it == rows.end() ? -1 : static_cast<int>(it - rows.begin());
}
