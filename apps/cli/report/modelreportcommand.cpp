#include "report/modelreportcommand.h"

#include "console/console.h"
#include "inputfile.h"
#include "output.h"
#include "push/pushfirst.h"
#include "qm_base/say.h"
#include "qm_db/editscope.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/modelreport.h"
#include "qm_ui/document/documentfile.h"

#include <cstdio>
#include <filesystem>
#include <unistd.h>

namespace {

/// Load cases that the evaluations rest on.
EXIT_CODE PushEvaluated(CDBDoc& doc, const std::string& file)
{
    std::set<int> keys;
    for (const T_EVAL_D& eval : EvaluationsOf(doc))
        if (const auto push = FindPush(doc.Data().Model(), eval.push)) keys.insert(push->key);
    return PushWhereMissing(doc, file, keys);
}

/// The settings of the model with those that are given. 0: a chapter has another name.
int TakeSettings(const T_MODEL_REPORT_OPTIONS& o, T_REPORT_D& settings)
{
    const std::pair<const std::optional<std::string>&, std::string&> texts[] = {
        {o.project, settings.project},
        {o.author, settings.author},
        {o.checker, settings.checker},
        {o.date, settings.date}};
    for (const auto& [given, text] : texts)
        if (given) text = *given;
    if (o.rows) settings.rows = *o.rows;
    if (!o.only) return 1;
    std::string unknown;
    const auto chapters = ChaptersNamed(*o.only, unknown);
    if (!chapters) {
        std::string all;
        for (const char* const name : kReportChapterNames)
            all += (all.empty() ? "" : ", ") + std::string(name);
        Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_REPORT_CHAPTER", unknown, all));
        return 0;
    }
    settings.chapters.clear();
    for (const REPORT_CHAPTER chapter : *chapters)
        settings.chapters.emplace_back(kReportChapterNames[static_cast<std::size_t>(chapter)]);
    return 1;
}

/// Where the model goes that keeps the settings; empty: nowhere.
std::string KeptFile(const T_MODEL_REPORT_OPTIONS& o)
{
    return !o.out.empty() ? o.out : o.keep ? o.file : std::string();
}

EXIT_CODE CheckFiles(const T_MODEL_REPORT_OPTIONS& o)
{
    if (o.html.empty() && o.pdf.empty() && KeptFile(o).empty())
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_REPORT_NO_OUTPUT"));
    if (o.keep && o.out.empty() && !IsModelFile(o.file))
        return Complain(EXIT_CODE::Usage, o.file + ": " + Say("IDS_QM_CLI_CASE_NOT_CHANGED"));
    return CheckOutputs(
        o.file,
        {{o.html, OUTPUT_KIND::Html}, {o.pdf, OUTPUT_KIND::Pdf}, {o.out, OUTPUT_KIND::Document}},
        o.overwrite);
}

EXIT_CODE Keep(CDBDoc& doc, const T_REPORT_D& settings, const std::string& path)
{
    T_STYP_D styp = doc.Data().Model().styp;
    styp.report = settings;
    CEditScope edit(doc, Say("IDS_QM_REPORT_SETTINGS"));
    if (!edit.PutStyp(std::move(styp)) || !edit.Commit())
        return Complain(EXIT_CODE::BadInput, path + ": " + Say("IDS_QM_CLI_REFUSED"));
    const EXIT_CODE code = SaveDocument(doc, path);
    if (code == EXIT_CODE::Done) std::printf("%s\n", path.c_str());
    return code;
}

EXIT_CODE Write(CDBDoc& doc, const T_DOCUMENT& document, const T_MODEL_REPORT_OPTIONS& o)
{
    std::string error;
    if (!o.html.empty() && !WriteDocumentHtml(doc, document, o.html, error))
        return Complain(EXIT_CODE::NoAccess, error);
    if (!o.pdf.empty() && !WriteDocumentPdf(doc, document, o.pdf, error))
        return Complain(EXIT_CODE::NoAccess, error);
    for (const std::string& path : {o.html, o.pdf})
        if (!path.empty()) std::printf("%s\n", path.c_str());
    return EXIT_CODE::Done;
}

} // namespace

EXIT_CODE RunModelReport(const T_MODEL_REPORT_OPTIONS& o)
{
    if (const EXIT_CODE code = CheckFiles(o); code != EXIT_CODE::Done) return code;
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    T_REPORT_OPTIONS options;
    options.head = doc.Data().Model().styp.report;
    if (!TakeSettings(o, options.head)) return EXIT_CODE::Usage;
    const std::string kept = KeptFile(o);
    if (!kept.empty())
        if (const EXIT_CODE code = Keep(doc, options.head, kept); code != EXIT_CODE::Done)
            return code;
    if (o.html.empty() && o.pdf.empty()) return EXIT_CODE::Done;
    options.mostRows = static_cast<std::size_t>(options.head.rows);
    options.fileName = std::filesystem::path(kept.empty() ? o.file : kept).filename().string();
    options.fileHash = FileHash(kept.empty() ? o.file : kept);
    if (const EXIT_CODE code = PushEvaluated(doc, o.file); code != EXIT_CODE::Done) return code;
    const CInterrupt interrupt;
    options.progress = [&](const std::string& what) {
        if (isatty(STDERR_FILENO)) ShowOnTerminal(Say("IDS_QM_CLI_REPORTING", what), false);
        return !CInterrupt::IsAsked();
    };
    T_DOCUMENT document;
    if (!MakeModelReport(doc, options, document))
        return Complain(EXIT_CODE::NotFound, o.file + ": " + Say("IDS_QM_CLI_CANCELLED"));
    if (isatty(STDERR_FILENO)) ShowOnTerminal({}, true);
    return Write(doc, document, o);
}
