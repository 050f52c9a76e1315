// The arguments of the judgement.
#include "judge/judgecommand.h"
#include "registerrange.h"
#include "registershared.h"
#include "registrations.h"

void AddJudge(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("judge", Say("IDS_QM_HELP_JUDGE"));
    auto o = std::make_shared<T_JUDGE_COMMAND>();
    AddFile(sub, o->file);
    sub->add_option("--evaluation", o->evaluations, Say("IDS_QM_HELP_JUDGE_EVALUATION"));
    auto* const by = sub->add_option("--code", o->code, Say("IDS_QM_HELP_JUDGE_CODE"))
                         ->check(CLI::IsMember(JudgedCodeNames()));
    sub->add_option("--level", o->members, Say("IDS_QM_HELP_JUDGE_MEMBERS"))
        ->check(CLI::IsMember({"primary", "secondary"}))
        ->needs(by);
    sub->add_option("--limit-state", o->level, Say("IDS_QM_HELP_JUDGE_LEVEL"))
        ->check(CLI::IsMember(JudgedLevelNames()));
    const CLI::Validator factor = FiniteRange(1.0, 10.0);
    sub->add_option("--gamma-c", o->factors.gammaC, Say("IDS_QM_HELP_JUDGE_GAMMA_C"))
        ->check(factor)
        ->capture_default_str();
    sub->add_option("--gamma-s", o->factors.gammaS, Say("IDS_QM_HELP_JUDGE_GAMMA_S"))
        ->check(factor)
        ->capture_default_str();
    sub->add_option("--gamma", o->factors.gamma, Say("IDS_QM_HELP_JUDGE_GAMMA"))
        ->check(factor)
        ->capture_default_str();
    sub->add_flag("--all-rows", o->all, Say("IDS_QM_HELP_JUDGE_ROWS"));
    sub->add_flag("--trace", o->trace, Say("IDS_QM_HELP_JUDGE_TRACE"));
    AddJson(sub, o->json);
    auto* const report = sub->add_option("--report", o->report, Say("IDS_QM_HELP_JUDGE_REPORT"));
    sub->add_flag("--plain", o->plain, Say("IDS_QM_HELP_PLAIN"))->needs(report);
    sub->add_option("--sheet", o->sheet, Say("IDS_QM_HELP_JUDGE_SHEET"));
    sub->add_option("--csv", o->csv, Say("IDS_QM_HELP_JUDGE_CSV"));
    sub->add_option("--plot", o->plot, Say("IDS_QM_HELP_JUDGE_PLOT"));
    AddOverwrite(sub, o->overwrite);
    sub->add_flag("--no-store", o->noStore, Say("IDS_QM_HELP_ANALYSE_NO_STORE"));
    AddExample(sub, "judge examples/rc-frame-code-hinges/case.json --code EN1998-3");
    sub->callback([=, &code] { code = RunJudge(*o); });
}
