#include "modelcommands.h"

#include "inputfile.h"
#include "output.h"
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/casefile.h"
#include "qm_db/modelstore.h"
#include "qm_rps/push/pushended.h"
#include "qm_rps/push/pushresultlist.h"

#include <cstdio>

namespace {

/// A text of the catalogue on a line of its own, behind so many blanks.
template <class... ARGS>
std::string Line(std::size_t blanks, std::string_view key, const ARGS&... args)
{
    return std::string(blanks, ' ') + Say(key, args...) + "\n";
}

/// A stored step; "-" where it was not found.
std::string StepText(int step)
{
    return step >= 0 ? std::to_string(step) : "-";
}

/// How the pushes of a load case have ended, and whether the model has been changed since.
std::string PushLines(CDBDoc& doc, int pushover)
{
    std::string text, why;
    for (const T_PUSH_RESULT_ID& id : PushResultsOf(doc)) {
        const auto ended = id.key == pushover ? PushEndedOf(doc, id.key, id.turn) : std::nullopt;
        if (!ended) continue;
        text += Line(4, "IDS_QM_CLI_INFO_PUSH_END", id.name,
                     FormatText("%.6g", ended->displacement) + " " + ended->unit,
                     PushStatusText(ended->status), PushOutcomeText(ended->outcome));
        if (doc.Post().IsStale(id.key, why, id.turn)) text += "    ! " + why + "\n";
    }
    return text;
}

/// What a document holds: title, units, counts, load cases, evaluations, stored steps.
std::string InfoText(CDBDoc& doc)
{
    const T_MODEL& m = doc.Data().Model();
    std::string text =
        doc.Path() + "\n" + Line(2, "IDS_QM_CLI_INFO_TITLE", m.styp.title) +
        Line(2, "IDS_QM_CLI_INFO_UNITS", NameOf(m.styp.units.force), NameOf(m.styp.units.length)) +
        Line(2, "IDS_QM_CLI_INFO_COUNTS", std::to_string(m.nodes.size()),
             std::to_string(m.storeys.size()), std::to_string(m.modes.size()),
             std::to_string(m.spectra.size()), std::to_string(m.evaluations.size()));
    for (const auto& [key, polc] : m.pushovers) {
        const bool isTurned = !doc.Post().SelectPushover(key);
        const bool any = !isTurned || doc.Post().SelectPushover(key, 1);
        const int steps = any ? doc.Post().GetStepCount() : 0;
        text += Line(2, "IDS_QM_CLI_INFO_PUSH", polc.name, std::to_string(steps),
                     std::to_string(polc.controlNode),
                     kDirectionNames[static_cast<std::size_t>(polc.direction - 1)],
                     kPatternNames[static_cast<std::size_t>(polc.patternKind)]);
        text += PushLines(doc, key);
        std::array<int, 3> s{};
        if (doc.Post().GetPoverInfo()->GetStepEC8(key, s))
            text += Line(4, "IDS_QM_CLI_INFO_EC8", StepText(s[0]), StepText(s[1]), StepText(s[2]));
        if (doc.Post().GetPoverInfo()->GetStepNTC2008(key, s))
            text += Line(4, "IDS_QM_CLI_INFO_NTC", StepText(s[0]), StepText(s[1]), StepText(s[2]));
    }
    for (const auto& [key, spectrum] : m.spectra)
        text += Line(2, "IDS_QM_CLI_SPECTRUM", spectrum.name);
    for (const auto& [key, eval] : m.evaluations)
        text += Line(2, "IDS_QM_CLI_INFO_EVALUATION", eval.name, MethodName(eval.method), eval.push,
                     eval.spectrum);
    return text;
}

} // namespace

EXIT_CODE RunImport(const std::string& caseFile, const std::string& modelFile, bool overwrite)
{
    if (const EXIT_CODE code = CheckOutputs(caseFile, {{modelFile, OUTPUT_KIND::Model}}, overwrite);
        code != EXIT_CODE::Done)
        return code;
    CDBDoc doc;
    T_FILE_ERROR error;
    if (!doc.ImportCase(caseFile, error)) return ReportFileError(error);
    if (!doc.SaveModelAs(modelFile, error)) return ReportFileError(error);
    std::printf("%s", InfoText(doc).c_str());
    return EXIT_CODE::Done;
}

EXIT_CODE RunExport(const std::string& modelFile, const std::string& caseFile, bool overwrite)
{
    if (const EXIT_CODE code = CheckOutputs(modelFile, {{caseFile, OUTPUT_KIND::Json}}, overwrite);
        code != EXIT_CODE::Done)
        return code;
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, modelFile); code != EXIT_CODE::Done) return code;
    T_FILE_ERROR error;
    std::string text;
    if (!CCaseFile::Print(doc.Data().Content(), text, error)) return ReportFileError(error);
    return WriteOutput(caseFile, text);
}

EXIT_CODE RunInfo(const std::string& file, bool check)
{
    if (check && IsModelFile(file)) {
        T_FILE_ERROR error;
        if (!CModelStore::CheckWhole(file, error)) return ReportFileError(error);
    }
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, file); code != EXIT_CODE::Done) return code;
    std::printf("%s", InfoText(doc).c_str());
    if (check) std::printf("  %s\n", Say("IDS_QM_CLI_INFO_WHOLE").c_str());
    return EXIT_CODE::Done;
}
