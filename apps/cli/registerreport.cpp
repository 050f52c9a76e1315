// The arguments of the command that writes the report data set.
#include "registershared.h"
#include "registrations.h"
#include "reportcommand.h"

void AddReport(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("report-data", Say("IDS_QM_HELP_REPORT_DATA"));
    auto in = std::make_shared<std::string>(), out = std::make_shared<std::string>("-");
    AddFile(sub, *in);
    sub->add_option("--json", *out, Say("IDS_QM_HELP_REPORT_JSON"))->capture_default_str();
    auto overwrite = std::make_shared<bool>(false);
    AddOverwrite(sub, *overwrite);
    AddExample(sub, "report-data examples/rc-frame-3-storey/case.json --json report.json");
    sub->callback([=, &code] { code = RunReportData(*in, *out, *overwrite); });
}
