// The arguments of the commands on model and case files.
#include "modelcommands.h"
#include "registershared.h"
#include "registrations.h"

namespace {

void AddImport(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("import", "Read a case file and write a model file");
    auto in = std::make_shared<std::string>(), out = std::make_shared<std::string>();
    sub->add_option("CASE", *in, "Case file (.json)")->required();
    sub->add_option("MODEL", *out, "Model file to write (.qmdb)")->required();
    AddExample(sub, "import examples/first-steps/case.json first-steps.qmdb");
    sub->callback([=, &code] { code = RunImport(*in, *out); });
}

void AddExport(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("export", "Write a model as a case file");
    auto in = std::make_shared<std::string>(), out = std::make_shared<std::string>("-");
    sub->add_option("MODEL", *in, "Model file (.qmdb) or case file")->required();
    sub->add_option("CASE", *out, "Case file to write, - for standard output")
        ->capture_default_str();
    AddExample(sub, "export examples/first-steps/case.json -");
    sub->callback([=, &code] { code = RunExport(*in, *out); });
}

void AddInfo(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("info", "Say what a model or case file holds");
    auto in = std::make_shared<std::string>();
    auto check = std::make_shared<bool>(false);
    AddFile(sub, *in);
    sub->add_flag("--check", *check, "Read the whole file and check every result block");
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
