// The arguments of the command that writes the report data set.
#include "registershared.h"
#include "registrations.h"
#include "reportcommand.h"

void AddReport(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand(
        "report-data", "Write storeys, masses, drifts, curves and results of all load cases");
    auto in = std::make_shared<std::string>(), out = std::make_shared<std::string>("-");
    AddFile(sub, *in);
    sub->add_option("--json", *out, "JSON file to write, - for standard output")
        ->capture_default_str();
    AddExample(sub, "report-data examples/rc-frame-3-storey/case.json --json "
                    "report.json");
    sub->callback([=, &code] { code = RunReportData(*in, *out); });
}
