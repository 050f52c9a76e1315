#include "view/viewcommands.h"

#include "console/tabletext.h"
#include "inputfile.h"
#include "output.h"
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/desk/elementlist.h"
#include "qm_rps/view/resulttable.h"
#include "json/jsontext.h"

#include <algorithm>
#include <cstdio>

namespace {

std::string JsonOf(const T_RESULT_TABLE& table)
{
    CJsonText w(JSON_REALS::Shortest);
    w.Object();
    if (!table.notes.empty()) w.Items("notes", table.notes, kJsonOneLine);
    w.Items("columns", table.heads, kJsonOneLine);
    w.Key("rows").List();
    for (const auto& row : table.rows) {
        w.List(kJsonOneLine);
        for (const T_RESULT_CELL& cell : row) {
            if (cell.number)
                w.Value(*cell.number);
            else
                w.Value(cell.text);
        }
        w.End();
    }
    w.End();
    w.End();
    return w.Text();
}

/// Six digits; the files have all of them.
std::string TerminalText(const T_RESULT_TABLE& table)
{
    T_TABLE_ROWS rows{table.heads};
    for (const auto& row : table.rows) {
        auto& texts = rows.emplace_back();
        for (const T_RESULT_CELL& cell : row)
            texts.push_back(cell.number ? FormatText("%.6g", *cell.number) : cell.text);
    }
    return TableText(rows);
}

EXIT_CODE ReadNodeIds(CDBDoc& doc, const T_RESULTS_OPTIONS& o, std::set<int>& out)
{
    if (o.nodes.empty()) return EXIT_CODE::Done;
    const std::optional<std::vector<int>> ids = ParseElementList(o.nodes);
    if (!ids || ids->empty())
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_PUSH_NODE_LIST", o.nodes));
    for (const int id : *ids)
        if (!doc.Data().Model().nodes.contains(id))
            return Complain(EXIT_CODE::Usage,
                            o.file + ": " + Say("IDS_QM_ANALYSIS_NO_NODE", std::to_string(id)));
    out.insert(ids->begin(), ids->end());
    return EXIT_CODE::Done;
}

/// Nodes are those of displacements and reactions, elements those of forces: what would have no
/// effect is refused.
EXIT_CODE CheckFilters(const T_RESULTS_OPTIONS& o, RESULT_TABLE what)
{
    const bool forces = what == RESULT_TABLE::Forces;
    if ((forces ? o.nodes : o.elements).empty()) return EXIT_CODE::Done;
    return Complain(EXIT_CODE::Usage, Say("IDS_QM_VIEW_NO_EFFECT",
                                          forces ? "--nodes" : "--elements", "--what " + o.what));
}

EXIT_CODE WriteTable(const T_RESULTS_OPTIONS& o, const T_RESULT_TABLE& table)
{
    EXIT_CODE code = EXIT_CODE::Done;
    if (!o.csv.empty()) code = WriteOutput(o.csv, CsvText(table));
    if (code == EXIT_CODE::Done && !o.json.empty()) code = WriteOutput(o.json, JsonOf(table));
    T_FILE_ERROR error;
    if (code == EXIT_CODE::Done && !o.xlsx.empty() && !WriteSheet(o.xlsx, SheetOf(table), error))
        code = ReportFileError(error);
    if (code != EXIT_CODE::Done || o.csv == "-" || o.json == "-") return code;
    for (const std::string& note : table.notes)
        std::printf("%s\n", note.c_str());
    for (const std::string* file : {&o.csv, &o.json, &o.xlsx})
        if (!file->empty())
            std::printf("%s: %s\n", file->c_str(),
                        Say("IDS_QM_VIEW_ROWS", std::to_string(table.rows.size())).c_str());
    if (o.csv.empty() && o.json.empty() && o.xlsx.empty())
        std::printf("%s", TerminalText(table).c_str());
    return code;
}

} // namespace

EXIT_CODE RunResults(const T_RESULTS_OPTIONS& o)
{
    if (const EXIT_CODE code = CheckOutputs(
            o.file,
            {{o.csv, OUTPUT_KIND::Text}, {o.json, OUTPUT_KIND::Json}, {o.xlsx, OUTPUT_KIND::Sheet}},
            o.overwrite);
        code != EXIT_CODE::Done)
        return code;
    T_RESULT_TABLE_CHOICE choice;
    choice.envelope = o.envelope;
    choice.what = static_cast<RESULT_TABLE>(
        std::ranges::find_if(kResultTableNames, [&](const char* n) { return o.what == n; }) -
        kResultTableNames.begin());
    if (const EXIT_CODE code = CheckFilters(o, choice.what); code != EXIT_CODE::Done) return code;
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    CFrameScene scene(doc);
    if (const EXIT_CODE code = ReadElementIds(doc, o, choice.elements); code != EXIT_CODE::Done)
        return code;
    if (const EXIT_CODE code = ReadNodeIds(doc, o, choice.nodes); code != EXIT_CODE::Done)
        return code;
    std::vector<T_SHAPE_SOURCE> sources;
    if (const EXIT_CODE code = FindSources(doc, o, scene, sources); code != EXIT_CODE::Done)
        return code;
    for (const T_SHAPE_SOURCE& source : sources) {
        const int steps = std::max(source.steps, 1);
        if (o.step > steps)
            return Complain(EXIT_CODE::Usage, Say("IDS_QM_VIEW_NO_STEP", std::to_string(o.step),
                                                  std::to_string(steps)));
        choice.sources.emplace_back(source, o.step > 0 ? o.step : steps);
    }
    T_RESULT_TABLE table;
    std::string why;
    if (!MakeResultTable(doc, scene, choice, table, why))
        return Complain(EXIT_CODE::NotFound, o.file + ": " + why);
    return WriteTable(o, table);
}
