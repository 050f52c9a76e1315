#include "report/modelreportcommand.h"

#include "console/console.h"
#include "inputfile.h"
#include "output.h"
#include "push/pushfirst.h"
#include "qm_base/say.h"
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

int Parse(const T_MODEL_REPORT_OPTIONS& o, T_REPORT_OPTIONS& out)
{
    std::string unknown;
    const auto chapters = ChaptersNamed(o.only, unknown);
    if (!chapters) {
        std::string all;
        for (const char* const name : kReportChapterNames)
            all += (all.empty() ? "" : ", ") + std::string(name);
        Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_REPORT_CHAPTER", unknown, all));
        return 0;
    }
    out.only = *chapters;
    out.head = o.head;
    out.mostRows = o.rows;
    out.fileName = std::filesystem::path(o.file).filename().string();
    out.fileHash = FileHash(o.file);
    return 1;
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
    if (o.html.empty() && o.pdf.empty())
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_REPORT_NO_OUTPUT"));
    T_REPORT_OPTIONS options;
    if (!Parse(o, options)) return EXIT_CODE::Usage;
    if (const EXIT_CODE code = CheckOutputs(
            o.file, {{o.html, OUTPUT_KIND::Html}, {o.pdf, OUTPUT_KIND::Pdf}}, o.overwrite);
        code != EXIT_CODE::Done)
        return code;
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
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
