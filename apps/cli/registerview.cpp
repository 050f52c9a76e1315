// The arguments of pictures and tables of results.
#include "registerrange.h"
#include "registershared.h"
#include "registrations.h"
#include "view/viewcommands.h"

namespace {

void AddSources(CLI::App* sub, T_SOURCE_OPTIONS& o, bool several)
{
    AddFile(sub, o.file);
    auto* cases = sub->add_option("--case", o.cases, Say("IDS_QM_HELP_VIEW_CASE"));
    auto* stages = sub->add_option("--stage", o.stages, Say("IDS_QM_HELP_VIEW_STAGE"));
    auto* pushes = sub->add_option("--push", o.pushes, Say("IDS_QM_HELP_VIEW_PUSH"));
    auto* modes = sub->add_option("--mode", o.modes, Say("IDS_QM_HELP_VIEW_MODE"))
                      ->check(CLI::Range(1, 1000000));
    sub->add_option("--step", o.step, Say("IDS_QM_HELP_VIEW_STEP"))->check(CLI::Range(1, 1000000));
    sub->add_option("--elements", o.elements, Say("IDS_QM_HELP_ANALYSE_ELEMENT"));
    AddOverwrite(sub, o.overwrite);
    if (several) return;
    CLI::Option* const all[] = {cases, stages, pushes, modes};
    for (CLI::Option* one : all) {
        one->expected(1);
        for (CLI::Option* other : all)
            if (one != other) one->excludes(other);
    }
}

#ifdef QM_UI
void AddPicture(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("picture", Say("IDS_QM_HELP_PICTURE_COMMAND"));
    auto o = std::make_shared<T_PICTURE_OPTIONS>();
    AddSources(sub, *o, false);
    sub->add_option("--what", o->what, Say("IDS_QM_HELP_PICTURE_WHAT"))
        ->check(
            CLI::IsMember(std::vector<std::string>(kViewWhatNames.begin(), kViewWhatNames.end())));
    sub->add_option("--labels", o->labels, Say("IDS_QM_HELP_PICTURE_LABELS"))
        ->check(CLI::IsMember(
            std::vector<std::string>(kViewLabelNames.begin(), kViewLabelNames.end())));
    sub->add_option("--look", o->look, Say("IDS_QM_HELP_PICTURE_LOOK"))
        ->check(CLI::IsMember({"auto", "iso", "xz", "yz", "xy"}));
    sub->add_flag("--perspective", o->perspective, Say("IDS_QM_HELP_PICTURE_PERSPECTIVE"));
    sub->add_flag("--on-deformed", o->onDeformed, Say("IDS_QM_HELP_PICTURE_ON_DEFORMED"));
    sub->add_flag("--outline", o->outline, Say("IDS_QM_HELP_PICTURE_OUTLINE"));
    sub->add_flag("--numbers", o->numbers, Say("IDS_QM_HELP_PICTURE_NUMBERS"));
    sub->add_option("--scale", o->scale, Say("IDS_QM_HELP_PICTURE_SCALE"))
        ->check(FiniteRange(1e-9, 1e9));
    sub->add_option("--size", o->size, Say("IDS_QM_HELP_PICTURE_SIZE"))
        ->check(FiniteRange(0.1, 10.0));
    sub->add_option("-o", o->out, Say("IDS_QM_HELP_PICTURE_OUT"))->required();
    AddExample(sub, "picture examples/rc-frame-code-hinges/case.json --case G --what My -o my.svg");
    sub->callback([o, &code] { code = RunPicture(*o); });
}
#endif

} // namespace

void AddViews(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("results", Say("IDS_QM_HELP_RESULTS"));
    auto o = std::make_shared<T_RESULTS_OPTIONS>();
    AddSources(sub, *o, true);
    sub->add_option("--what", o->what, Say("IDS_QM_HELP_RESULTS_WHAT"))
        ->check(CLI::IsMember({"displacements", "reactions", "forces"}));
    sub->add_option("--nodes", o->nodes, Say("IDS_QM_HELP_ANALYSE_NODE"));
    sub->add_flag("--envelope", o->envelope, Say("IDS_QM_HELP_RESULTS_ENVELOPE"));
    sub->add_option("--csv", o->csv, Say("IDS_QM_HELP_RESULTS_CSV"));
    sub->add_option("--xlsx", o->xlsx, Say("IDS_QM_HELP_RESULTS_XLSX"));
    AddJson(sub, o->json);
    AddExample(sub,
               "results examples/tuned-beam/case.json --case ALL --what forces --csv forces.csv");
    sub->callback([o, &code] { code = RunResults(*o); });
#ifdef QM_UI
    AddPicture(app, code);
#endif
}
