#include "push/pushcommands.h"

#include "inputfile.h"
#include "output.h"
#include "push/pushfirst.h"
#include "push/pushtable.h"
#include "qm_base/say.h"
#include "qm_rps/desk/elementlist.h"
#include "qm_rps/push/pushresultlist.h"
#include "qm_rps/pushover/pushovertargetevaluation.h"
#include "json/pushjson.h"

#ifdef QM_UI
#include "push/pushpictures.h"
#include "qm_ui/push/pushcurveplot.h"
#endif

#include <algorithm>
#include <cstdio>
#include <unistd.h>

namespace {

constexpr std::size_t kRowsOnTerminal = 25;

/// Keys of the load cases that are asked for.
EXIT_CODE FindCases(CDBDoc& doc, const T_PUSH_OPTIONS& o, std::vector<int>& out)
{
    const T_MODEL& model = doc.Data().Model();
    for (const std::string& name : o.cases) {
        int key = 0;
        if (!doc.Attr().FindPolc(name, key))
            return Complain(EXIT_CODE::Usage, o.file + ": " + Say("IDS_QM_CLI_NO_PUSH", name));
        if (std::ranges::find(out, key) == out.end()) out.push_back(key);
    }
    if (!o.cases.empty()) return EXIT_CODE::Done;
    for (const auto& [key, record] : model.pushovers)
        if (o.all || record.control) out.push_back(key);
    if (!out.empty()) return EXIT_CODE::Done;
    return Complain(EXIT_CODE::BadInput, o.file + ": " + Say("IDS_QM_CLI_PUSH_NO_CASE"));
}

EXIT_CODE ReadNodes(CDBDoc& doc, const T_PUSH_OPTIONS& o, std::set<int>& out)
{
    if (o.nodes.empty()) return EXIT_CODE::Done;
    const auto ids = ParseElementList(o.nodes);
    if (!ids || ids->empty())
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_PUSH_NODE_LIST", o.nodes));
    for (const int id : *ids) {
        if (!doc.Data().Model().nodes.contains(id))
            return Complain(EXIT_CODE::Usage,
                            o.file + ": " + Say("IDS_QM_ANALYSIS_NO_NODE", std::to_string(id)));
        out.insert(id);
    }
    return EXIT_CODE::Done;
}

bool IsLimitState(const std::string& name)
{
    for (const PUSH_METHOD method : {PUSH_METHOD::Ntc2008, PUSH_METHOD::Ec8Opcm})
        for (const T_LIMIT_ROW& row : CPushOverTargetEvaluation::EmptyRows(method))
            if (row.name == name) return true;
    return false;
}

/// What chooses a step needs a picture of one; a step is chosen in one way.
EXIT_CODE CheckStepOptions(const T_PUSH_OPTIONS& o)
{
    const bool pictures = !o.plotHinges.empty() || !o.plotStoreys.empty();
    const bool chooses = o.step > 0 || !o.at.empty() || !o.of.empty() || !o.state.empty();
    if (chooses && !pictures) return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_PUSH_STEP_ALONE"));
    if (o.step > 0 && !o.at.empty())
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_SETUP_BOTH", "--step", "--at"));
    if (!o.of.empty() && !o.at.empty())
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_SETUP_BOTH", "--of", "--at"));
    if (!o.state.empty() && o.at.empty())
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_PUSH_STATE_ALONE"));
    if (!o.state.empty() && !IsLimitState(o.state))
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_PUSH_UNKNOWN_STATE", o.state));
    return EXIT_CODE::Done;
}

EXIT_CODE PrintTables(const T_PUSH_OPTIONS& o, const std::vector<T_PUSH_RUN>& runs,
                      const T_UNITS& units)
{
    for (const std::string& name : o.hinges)
        if (std::ranges::none_of(runs, [&](const T_PUSH_RUN& r) { return r.name == name; }))
            return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_NOT_SHOWN", name));
    const std::size_t rows = isatty(STDOUT_FILENO) ? kRowsOnTerminal : 0;
    for (const T_PUSH_RUN& run : runs) {
        std::string text = PushTable(run, units, rows);
        if (std::ranges::find(o.hinges, run.name) != o.hinges.end())
            text += PushHingeTable(run, units);
        std::fwrite(text.data(), 1, text.size(), stdout);
    }
    return EXIT_CODE::Done;
}

/// Steps of another solver stay in the file that is read, unless the user says otherwise.
EXIT_CODE KeepImported(CDBDoc& doc, const T_PUSH_OPTIONS& o, const std::vector<int>& keys)
{
    if (o.overwrite || o.noStore || !o.out.empty() || !IsModelFile(o.file)) return EXIT_CODE::Done;
    for (const int key : keys) {
        if (!HasImportedSteps(doc, key)) continue;
        const std::string& name = doc.Data().Model().pushovers.at(key).name;
        return Complain(EXIT_CODE::NoAccess, o.file + ": " + Say("IDS_QM_CLI_PUSH_IMPORTED", name));
    }
    return EXIT_CODE::Done;
}

/// A model file keeps the results; -o writes another file.
EXIT_CODE Store(CDBDoc& doc, const T_PUSH_OPTIONS& o)
{
    if (!o.out.empty()) return SaveDocument(doc, o.out);
    if (!IsModelFile(o.file) || o.noStore) return EXIT_CODE::Done;
    T_FILE_ERROR error;
    return doc.SaveModel(error) ? EXIT_CODE::Done : ReportFileError(error);
}

} // namespace

EXIT_CODE RunPush(const T_PUSH_OPTIONS& o)
{
    if (o.all && !o.cases.empty())
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_SETUP_BOTH", "--all", "--case"));
    if (!o.nodes.empty() && o.json.empty())
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_PUSH_NODES_JSON"));
    if (const EXIT_CODE code = CheckStepOptions(o); code != EXIT_CODE::Done) return code;
    for (const std::string& picture : {o.plot, o.plotHinges, o.plotStoreys})
        if (const EXIT_CODE code = CheckPlotName(picture); code != EXIT_CODE::Done) return code;
    if (const EXIT_CODE code = CheckOutputs(o.file,
                                            {{o.json, OUTPUT_KIND::Json},
                                             {o.plot, OUTPUT_KIND::Picture},
                                             {o.plotHinges, OUTPUT_KIND::Picture},
                                             {o.plotStoreys, OUTPUT_KIND::Picture},
                                             {o.out, OUTPUT_KIND::Model}},
                                            o.overwrite);
        code != EXIT_CODE::Done)
        return code;
    CDBDoc doc;
    std::vector<int> keys;
    std::set<int> nodes;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    if (const EXIT_CODE code = FindCases(doc, o, keys); code != EXIT_CODE::Done) return code;
    if (const EXIT_CODE code = ReadNodes(doc, o, nodes); code != EXIT_CODE::Done) return code;
    if (const EXIT_CODE code = KeepImported(doc, o, keys); code != EXIT_CODE::Done) return code;
#ifdef QM_UI
    if (const EXIT_CODE code = CheckSteps(doc, o, keys); code != EXIT_CODE::Done) return code;
#endif
    std::vector<T_PUSH_RUN> runs;
    const T_UNITS units = doc.Unit().Units();
    if (const EXIT_CODE code = PushCases(doc, o.file, keys, runs); code != EXIT_CODE::Done)
        return code;
    if (o.json != "-")
        if (const EXIT_CODE code = PrintTables(o, runs, units); code != EXIT_CODE::Done)
            return code;
    EXIT_CODE code = EXIT_CODE::Done;
    if (!o.json.empty()) code = WriteOutput(o.json, PushJson(runs, nodes, units));
#ifdef QM_UI
    if (code == EXIT_CODE::Done && !o.plot.empty())
        code = WritePicture(PushCurvePlot(runs, units, doc.Data().Model().styp.title), o.plot);
    if (code == EXIT_CODE::Done) code = DrawSteps(doc, o, runs);
#endif
    if (code == EXIT_CODE::Done) code = Store(doc, o);
    if (code != EXIT_CODE::Done) return code;
    const bool failed = std::ranges::any_of(
        runs, [](const T_PUSH_RUN& r) { return r.status == PUSH_STATUS::Failed; });
    return failed ? EXIT_CODE::NotFound : EXIT_CODE::Done;
}
