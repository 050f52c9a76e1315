// The arguments of the commands on the curves of sections.
#include "registershared.h"
#include "registrations.h"
#include "section/sectioncheckcommand.h"
#include "section/sectionlibrary.h"

namespace {

template <std::size_t N>
CLI::IsMember OneOf(const std::array<const char*, N>& names)
{
    return CLI::IsMember(std::vector<std::string>(names.begin(), names.end()));
}

void AddStrengths(CLI::App* sub, T_SECTION_COMMAND& o)
{
    sub->add_option("--section", o.sections, Say("IDS_QM_HELP_SECC_SECTION"));
    sub->add_option("--material", o.material, Say("IDS_QM_HELP_SECC_MATERIAL"));
    sub->add_option("--values", o.values, Say("IDS_QM_HELP_SECC_VALUES"))
        ->check(OneOf(kSectionValueNames));
    sub->add_option("--law", o.law, Say("IDS_QM_HELP_SECC_LAW"))->check(OneOf(kSectionLawNames));
    sub->add_option("--confined", o.confined, Say("IDS_QM_HELP_SECC_CONFINED"))
        ->check(OneOf(kSectionCoreNames));
    sub->add_option("--alpha-cc", o.options.alphaCc, Say("IDS_QM_HELP_SECC_ALPHA"));
    sub->add_option("--steel-strain", o.options.steelStrain, Say("IDS_QM_HELP_SECC_STEEL_STRAIN"));
    sub->add_option("--hardening", o.options.hardening, Say("IDS_QM_HELP_SECC_HARDENING"));
    sub->add_option("--hoop-strain", o.options.hoopStrain, Say("IDS_QM_HELP_SECC_HOOP"));
}

void AddPlaces(CLI::App* sub, T_SECTION_COMMAND& o)
{
    const bool surface = o.task == SECTION_TASK::Surface;
    const bool interaction = o.task == SECTION_TASK::Interaction;
    if (!surface) sub->add_option("--direction", o.directions, Say("IDS_QM_HELP_SECC_DIRECTION"));
    if (!interaction)
        sub->add_option("--axial", o.axial,
                        Say(surface ? "IDS_QM_HELP_SECC_AXIAL_SURFACE" : "IDS_QM_HELP_SECC_AXIAL"));
    if (!surface && !interaction)
        sub->add_flag("--of-moment", o.ofMoment, Say("IDS_QM_HELP_SECC_OF_MOMENT"));
    if (o.task == SECTION_TASK::Curvature)
        sub->add_option("--max-curvature", o.maxCurvature, Say("IDS_QM_HELP_SECC_MAX"));
    if (o.task == SECTION_TASK::Capacity) return;
    sub->add_option("--points", o.points,
                    surface ? Say("IDS_QM_HELP_SECC_DIRECTIONS")
                            : Say("IDS_QM_HELP_SECC_POINTS", std::to_string(o.points)));
    if (o.task == SECTION_TASK::Curvature)
        sub->add_flag("--table", o.table, Say("IDS_QM_HELP_SECC_TABLE"));
}

void AddTask(const T_GROUP& group, SECTION_TASK task, const char* help, const char* example)
{
    const auto o = std::make_shared<T_SECTION_COMMAND>();
    o->task = task;
    if (task == SECTION_TASK::Curvature) o->points = static_cast<int>(kCurvaturePoints);
    auto* sub = AddOne(group, kSectionTaskNames[static_cast<std::size_t>(task)], Say(help), example,
                       o, RunSection);
    AddStrengths(sub, *o);
    AddPlaces(sub, *o);
    AddJson(sub, o->json);
    sub->add_option("--csv", o->csv, Say("IDS_QM_HELP_SECC_CSV"));
    sub->add_option("--sheet", o->sheet, Say("IDS_QM_HELP_SECC_SHEET"));
#ifdef QM_UI
    sub->add_option("--plot", o->plot, Say("IDS_QM_HELP_SECC_PLOT"));
#endif
    AddOverwrite(sub, o->overwrite);
}

void AddCheck(const T_GROUP& group)
{
    const auto o = std::make_shared<T_SECTION_CHECK_COMMAND>();
    auto* sub = AddOne(group, "check", Say("IDS_QM_HELP_SECK"),
                       " --section \"column 40x40\" --axial 400 800 --my 100 --mz 50 --vz 80", o,
                       RunSectionCheck);
    AddStrengths(sub, *o);
    constexpr std::array<const char*, 6> kHelp{"IDS_QM_HELP_SECK_AXIAL", "IDS_QM_HELP_SECK_MY",
                                               "IDS_QM_HELP_SECK_MZ",    "IDS_QM_HELP_SECK_VY",
                                               "IDS_QM_HELP_SECK_VZ",    "IDS_QM_HELP_SECK_T"};
    for (std::size_t i = 0; i < kHelp.size(); ++i)
        sub->add_option(std::string("--") + kSectionForceNames[i], o->forces[i], Say(kHelp[i]));
    sub->add_option("--forces", o->forcesFile, Say("IDS_QM_HELP_SECK_FORCES"));
    sub->add_option("--case", o->cases, Say("IDS_QM_HELP_SECK_CASE"));
    sub->add_option("--elements", o->elements, Say("IDS_QM_HELP_SECK_ELEMENTS"));
    sub->add_flag("--by-ratio", o->byRatio, Say("IDS_QM_HELP_SECK_BY_RATIO"));
    sub->add_option("--code", o->codes, Say("IDS_QM_HELP_SECK_CODE"))
        ->check(OneOf(kSectionCheckCodeNames));
    sub->add_option("--cot-theta", o->cotTheta, Say("IDS_QM_HELP_SECK_COT"));
    sub->add_flag("--trace", o->trace, Say("IDS_QM_HELP_HINGE_TRACE"));
    AddJson(sub, o->json);
    sub->add_option("--csv", o->csv, Say("IDS_QM_HELP_SECK_CSV"));
    sub->add_option("--sheet", o->sheet, Say("IDS_QM_HELP_SECK_SHEET"));
    AddOverwrite(sub, o->overwrite);
}

void AddLibrary(CLI::App* section, EXIT_CODE& code)
{
    auto* shapes = section->add_subcommand("shapes", Say("IDS_QM_HELP_SECC_SHAPES"));
    const auto find = std::make_shared<std::string>();
    shapes->add_option("--find", *find, Say("IDS_QM_HELP_SECC_FIND"));
    AddExample(shapes, "section shapes --find \"IPE 3\"");
    shapes->callback([find, &code] { code = RunSectionShapes(*find); });
    auto* grades = section->add_subcommand("grades", Say("IDS_QM_HELP_SECC_GRADES"));
    AddExample(grades, "section grades");
    grades->callback([&code] { code = RunSectionGrades(); });
}

} // namespace

void AddSection(CLI::App& app, EXIT_CODE& code)
{
    auto* section = app.add_subcommand("section", Say("IDS_QM_HELP_SECC"));
    section->require_subcommand(1);
    const T_GROUP group{section, "examples/rc-frame-code-hinges/case.json", code};
    AddExample(section, std::string("section curvature ") + group.caseFile);
    AddTask(group, SECTION_TASK::Capacity, "IDS_QM_HELP_SECC_CAPACITY",
            " --direction 0 30 90 --axial 0 400 --of-moment");
    AddTask(group, SECTION_TASK::Curvature, "IDS_QM_HELP_SECC_CURVATURE",
            " --section \"column 40x40\" --values mean --confined mander --axial 0 400");
    AddTask(group, SECTION_TASK::Interaction, "IDS_QM_HELP_SECC_INTERACTION",
            " --section \"column 40x40\" --values design");
    AddTask(group, SECTION_TASK::Surface, "IDS_QM_HELP_SECC_SURFACE",
            " --section \"column 40x40\" --axial 0 400 800 --json -");
    AddCheck(group);
    AddLibrary(section, code);
    AddSectionBars(*section, code);
}
