// The arguments of the commands on model and case files.
#include "modelcommands.h"
#include "registershared.h"
#include "registrations.h"

namespace {

void AddImport(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("import", Say("IDS_QM_HELP_IMPORT"));
    auto in = std::make_shared<std::string>(), out = std::make_shared<std::string>();
    sub->add_option("CASE", *in, Say("IDS_QM_HELP_IMPORT_CASE"))->required();
    sub->add_option("MODEL", *out, Say("IDS_QM_HELP_IMPORT_MODEL"))->required();
    auto overwrite = std::make_shared<bool>(false);
    AddOverwrite(sub, *overwrite);
    AddExample(sub, "import examples/first-steps/case.json first-steps.qmdb");
    sub->callback([=, &code] { code = RunImport(*in, *out, *overwrite); });
}

void AddExport(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("export", Say("IDS_QM_HELP_EXPORT"));
    auto in = std::make_shared<std::string>(), out = std::make_shared<std::string>("-");
    sub->add_option("MODEL", *in, Say("IDS_QM_HELP_EXPORT_MODEL"))->required();
    sub->add_option("CASE", *out, Say("IDS_QM_HELP_EXPORT_CASE"))->capture_default_str();
    auto overwrite = std::make_shared<bool>(false);
    AddOverwrite(sub, *overwrite);
    AddExample(sub, "export examples/first-steps/case.json -");
    sub->callback([=, &code] { code = RunExport(*in, *out, *overwrite); });
}

void AddInfo(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("info", Say("IDS_QM_HELP_INFO"));
    auto in = std::make_shared<std::string>();
    auto check = std::make_shared<bool>(false);
    AddFile(sub, *in);
    sub->add_flag("--check", *check, Say("IDS_QM_HELP_INFO_CHECK"));
    AddExample(sub, "info examples/first-steps/case.json");
    sub->callback([=, &code] { code = RunInfo(*in, *check); });
}

} // namespace

void AddModel(CLI::App& app, EXIT_CODE& code)
{
    AddImport(app, code);
    AddExport(app, code);
    AddInfo(app, code);
}
