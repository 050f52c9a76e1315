#include "evaluate/overviewoutput.h"

#include "console/tabletext.h"
#include "output.h"
#include "qm_rps/pushover/overview/evaluationcards.h"
#include "qm_rps/pushover/overview/plotregion.h"
#include "qm_rps/section/sectionexport.h"

#ifdef QM_UI
#include "qm_ui/evaluate/overlayplot.h"
#endif

#include <algorithm>

namespace {

EXIT_CODE WriteSummary(const std::string& path, std::span<const T_EVALUATION_ENTRY> entries)
{
    const T_TEXT_TABLE table = OverviewCells(entries);
    if (path != "-") return WriteOutput(path, TableCsv(table));
    T_TABLE_ROWS rows(1);
    for (const T_TEXT_COLUMN& column : table.columns)
        rows.front().push_back(column.head);
    rows.insert(rows.end(), table.rows.begin(), table.rows.end());
    return WriteOutput(path, TableText(rows));
}

#ifdef QM_UI
EXIT_CODE WriteOverlay(const T_EVALUATE_OPTIONS& o, const std::vector<T_PUSH_EVALUATION>& results)
{
    std::vector<const T_PUSH_EVALUATION*> shown;
    for (const T_PUSH_EVALUATION& e : results)
        if (e.capacity.Sd.size() > 1) shown.push_back(&e);
    return WritePicture(OverlayPlot(shown, o.whole ? std::nullopt : RegionOf(shown)), o.overlay);
}

EXIT_CODE WriteBars(const T_EVALUATE_OPTIONS& o, std::span<const T_EVALUATION_ENTRY> entries)
{
    const auto named =
        std::ranges::find(kCardNames, o.barsOf, [](const char* name) { return std::string(name); });
    return WritePicture(BarsPlot(entries, static_cast<CARD>(named - kCardNames.begin())), o.bars);
}
#endif

} // namespace

std::vector<T_OUTPUT> OverviewOutputs(const T_EVALUATE_OPTIONS& o)
{
    return {{o.overlay, OUTPUT_KIND::Picture},
            {o.bars, OUTPUT_KIND::Picture},
            {o.summary, OUTPUT_KIND::Text}};
}

EXIT_CODE WriteOverview(CDBDoc& doc, const T_EVALUATE_OPTIONS& o,
                        const std::vector<T_PUSH_EVALUATION>& results)
{
    EXIT_CODE code = EXIT_CODE::Done;
    if (o.summary.empty() && o.bars.empty() && o.overlay.empty()) return code;
    std::vector<T_EVALUATION_ENTRY> entries;
    for (const T_PUSH_EVALUATION& e : results)
        entries.push_back(EntryOf(doc, e.eval, e, {}));
    if (!o.summary.empty()) code = WriteSummary(o.summary, entries);
#ifdef QM_UI
    if (code == EXIT_CODE::Done && !o.overlay.empty()) code = WriteOverlay(o, results);
    if (code == EXIT_CODE::Done && !o.bars.empty()) code = WriteBars(o, entries);
#endif
    return code;
}
