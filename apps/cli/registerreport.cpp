// The arguments of the command that writes the report data set.
#include "registershared.h"
#include "registrations.h"
#include "reportcommand.h"

#ifdef QM_UI
#include "report/modelreportcommand.h"

namespace {

void AddModelReport(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("report", Say("IDS_QM_HELP_REPORT"));
    auto o = std::make_shared<T_MODEL_REPORT_OPTIONS>();
    AddFile(sub, o->file);
    sub->add_option("--html", o->html, Say("IDS_QM_HELP_REPORT_HTML"));
    sub->add_option("--pdf", o->pdf, Say("IDS_QM_HELP_REPORT_PDF"));
    sub->add_option("--only", o->only, Say("IDS_QM_HELP_REPORT_ONLY"));
    sub->add_option("--rows", o->rows, Say("IDS_QM_HELP_REPORT_ROWS"))
        ->check(CLI::Range(0, 1000000));
    sub->add_option("--project", o->project, Say("IDS_QM_HELP_REPORT_PROJECT"));
    sub->add_option("--author", o->author, Say("IDS_QM_HELP_REPORT_AUTHOR"));
    sub->add_option("--checker", o->checker, Say("IDS_QM_HELP_REPORT_CHECKER"));
    sub->add_option("--date", o->date, Say("IDS_QM_HELP_REPORT_DATE"));
    sub->add_flag("--keep", o->keep, Say("IDS_QM_HELP_REPORT_KEEP"));
    sub->add_option("-o", o->out, Say("IDS_QM_HELP_REPORT_OUT"));
    AddOverwrite(sub, o->overwrite);
    AddExample(sub, "report examples/rc-frame-3-storey/case.json --html report.html --pdf "
                    "report.pdf --author \"A. Engineer\" --date 2026-11-23");
    sub->callback([o, &code] { code = RunModelReport(*o); });
}

} // namespace
#endif

void AddReport(CLI::App& app, EXIT_CODE& code)
{
#ifdef QM_UI
    AddModelReport(app, code);
#endif
    auto* sub = app.add_subcommand("report-data", Say("IDS_QM_HELP_REPORT_DATA"));
    auto in = std::make_shared<std::string>(), out = std::make_shared<std::string>("-");
    AddFile(sub, *in);
    sub->add_option("--json", *out, Say("IDS_QM_HELP_REPORT_JSON"))->capture_default_str();
    auto overwrite = std::make_shared<bool>(false);
    AddOverwrite(sub, *overwrite);
    AddExample(sub, "report-data examples/rc-frame-3-storey/case.json --json report.json");
    sub->callback([=, &code] { code = RunReportData(*in, *out, *overwrite); });
}
