// The help in the user's language: what the argument parser itself says, and its labels.
#include "qm_rps/pushover/pushoverreport.h"
#include "registershared.h"
#include "registrations.h"

namespace {

/// The parser's formatter, which has labels for all but the heads of groups.
class CHelpFormatter : public CLI::Formatter {
public:
    CHelpFormatter()
    {
        label("Usage", Say("IDS_QM_HELP_LABEL_USAGE"));
        label("OPTIONS", Say("IDS_QM_HELP_LABEL_OPTIONS_BADGE"));
        label("Options", Say("IDS_QM_HELP_LABEL_OPTIONS"));
        label("Positionals", Say("IDS_QM_HELP_LABEL_POSITIONALS"));
        label("SUBCOMMAND", Say("IDS_QM_HELP_LABEL_SUBCOMMAND"));
        label("REQUIRED", Say("IDS_QM_HELP_LABEL_REQUIRED"));
        label("Needs", Say("IDS_QM_HELP_LABEL_NEEDS"));
        label("Excludes", Say("IDS_QM_HELP_LABEL_EXCLUDES"));
    }
    std::string make_group(std::string group, bool isPositional,
                           std::vector<const CLI::Option*> options) const override
    {
        return CLI::Formatter::make_group(get_label(group), isPositional, options);
    }
};

} // namespace

void AddHelp(CLI::App& app)
{
    app.description(Say("IDS_QM_HELP_PROGRAM"));
    app.formatter(std::make_shared<CHelpFormatter>());
    app.group(Say("IDS_QM_HELP_LABEL_SUBCOMMANDS"));
    app.set_help_flag("-h,--help", Say("IDS_QM_HELP_HELP"));
    app.set_version_flag("--version", ProductText(), Say("IDS_QM_HELP_VERSION"));
    app.footer(Say("IDS_QM_HELP_EXIT_CODES") + '\n' +
               Example("evaluate examples/first-steps/case.json"));
}
