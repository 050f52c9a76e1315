// The command that writes the report data set.
#include "inputfile.h"
#include "output.h"
#include "qm_rps/irpsinterfaceimpl.h"
#include "qm_rps/rpsmanager.h"
#include "registrations.h"
#include "json/reportjson.h"

#include <CLI/CLI.hpp>

#include <cstdio>

namespace {

EXIT_CODE RunReportData(const std::string& file, const std::string& out)
{
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, file); code != EXIT_CODE::Done) return code;
    IRPSInterfaceImpl report;
    if (!report.BuildReport()) return Complain(EXIT_CODE::BadInput, file + ": " + report.Error());
    const SSReportInfoRW& data = *CRPSManager::Current()->ReportInfo();
    const EXIT_CODE code = WriteOutput(out, ReportJson(data));
    if (code == EXIT_CODE::Done && out != "-") std::printf("%s\n", out.c_str());
    return code;
}

} // namespace

void AddReport(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand(
        "report-data", "Write storeys, masses, drifts, curves and results of all load cases");
    auto in = std::make_shared<std::string>(), out = std::make_shared<std::string>("-");
    sub->add_option("FILE", *in, "Model file (.qmdb) or case file (.json)")->required();
    sub->add_option("--json", *out, "JSON file to write, - for standard output")
        ->capture_default_str();
    sub->footer("Example:\n  qm-rps report-data examples/rc-frame-3-storey/case.json --json "
                "report.json");
    sub->callback([=, &code] { code = RunReportData(*in, *out); });
}
