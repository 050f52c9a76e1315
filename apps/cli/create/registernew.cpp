// The arguments of the commands that make models.
#include "create/newcommands.h"
#include "create/partcommands.h"
#include "registershared.h"
#include "registrations.h"

#include <tuple>

namespace {

void AddCurveOptions(CLI::App* sub, T_NEW_CURVE_OPTIONS& o)
{
    sub->add_option("--curve", o.curve, Say("IDS_QM_HELP_NEW_CURVE"));
    sub->add_option("--units", o.units, Say("IDS_QM_HELP_NEW_UNITS"));
    sub->add_option("--columns", o.columns, Say("IDS_QM_HELP_NEW_COLUMNS"));
    sub->add_option("--decimal", o.decimal, Say("IDS_QM_HELP_NEW_DECIMAL"))->capture_default_str();
    sub->add_flag("--add-origin", o.addOrigin, Say("IDS_QM_HELP_NEW_ORIGIN"));
    sub->add_flag("--reverse-force", o.reverseForce, Say("IDS_QM_HELP_NEW_REVERSE"));
    sub->add_option("--height", o.heights, Say("IDS_QM_HELP_NEW_HEIGHT"));
    sub->add_option("--mass", o.masses, Say("IDS_QM_HELP_NEW_MASS"));
    sub->add_option("--total-mass", o.totalMass, Say("IDS_QM_HELP_NEW_TOTAL"));
    sub->add_option("--mass-unit", o.massUnit, Say("IDS_QM_HELP_NEW_MASS_UNIT"))
        ->capture_default_str();
    sub->add_option("--shape", o.shape, Say("IDS_QM_HELP_NEW_SHAPE"));
    sub->add_option("--spectrum", o.spectrum, Say("IDS_QM_HELP_NEW_SPECTRUM"));
    sub->add_option("--spectrum-table", o.spectrumTable, Say("IDS_QM_HELP_NEW_SPECTRUM_TABLE"));
    sub->add_option("--method", o.methods, Say("IDS_QM_HELP_NEW_METHOD"));
    sub->add_option("--title", o.title, Say("IDS_QM_HELP_NEW_TITLE"));
    sub->add_option("-o", o.out, Say("IDS_QM_HELP_NEW_OUT"));
    AddOverwrite(sub, o.overwrite);
}

void AddFrame(CLI::App* parent, EXIT_CODE& code)
{
    auto* sub = parent->add_subcommand("frame", Say("IDS_QM_HELP_FRAME"));
    auto o = std::make_shared<T_NEW_FRAME_OPTIONS>();
    sub->add_option("--units", o->units, Say("IDS_QM_HELP_FRAME_UNITS"))->capture_default_str();
    const std::tuple<const char*, std::string&, const char*> texts[] = {
        {"--bays-x", o->baysX, "IDS_QM_HELP_FRAME_BAYS_X"},
        {"--bays-y", o->baysY, "IDS_QM_HELP_FRAME_BAYS_Y"},
        {"--storeys", o->storeys, "IDS_QM_HELP_FRAME_STOREYS"},
        {"--columns", o->building.columns, "IDS_QM_HELP_FRAME_COLUMNS"},
        {"--beams", o->building.beams, "IDS_QM_HELP_FRAME_BEAMS"},
        {"--concrete,--steel", o->grade, "IDS_QM_HELP_FRAME_GRADE"},
        {"--column-grade", o->building.columnGrade, "IDS_QM_HELP_FRAME_COLUMN_GRADE"},
        {"--beam-grade", o->building.beamGrade, "IDS_QM_HELP_FRAME_BEAM_GRADE"},
        {"--braces", o->braces, "IDS_QM_HELP_FRAME_BRACES"},
        {"--brace-bays", o->braceBays, "IDS_QM_HELP_FRAME_BRACE_BAYS"},
        {"--brace-section", o->building.braceSection, "IDS_QM_HELP_FRAME_BRACE_SECTION"},
        {"--brace-grade", o->building.braceGrade, "IDS_QM_HELP_FRAME_BRACE_GRADE"},
        {"--load-beams", o->loaded, "IDS_QM_HELP_FRAME_LOADED"},
        {"--title", o->building.title, "IDS_QM_HELP_NEW_TITLE"},
        {"-o", o->out, "IDS_QM_HELP_NEW_OUT"}};
    for (const auto& [option, value, help] : texts)
        sub->add_option(option, value, Say(help));
    const std::tuple<const char*, double&, const char*> numbers[] = {
        {"--dead", o->building.dead, "IDS_QM_HELP_FRAME_DEAD"},
        {"--live", o->building.live, "IDS_QM_HELP_FRAME_LIVE"},
        {"--live-in-mass", o->building.liveInMass, "IDS_QM_HELP_FRAME_LIVE_IN_MASS"}};
    for (const auto& [option, value, help] : numbers)
        sub->add_option(option, value, Say(help));
    sub->add_option("--dead-roof", o->deadRoof, Say("IDS_QM_HELP_FRAME_DEAD_ROOF"));
    sub->add_option("--live-roof", o->liveRoof, Say("IDS_QM_HELP_FRAME_LIVE_ROOF"));
    sub->add_flag("--pinned", o->building.isPinned, Say("IDS_QM_HELP_FRAME_PINNED"));
    sub->add_flag("--no-diaphragms", o->noDiaphragms, Say("IDS_QM_HELP_FRAME_NO_DIAPHRAGMS"));
    sub->add_option("--modes", o->modes, Say("IDS_QM_HELP_FRAME_MODES"));
    sub->add_flag("--push", o->push, Say("IDS_QM_HELP_FRAME_PUSH"));
    AddOverwrite(sub, o->overwrite);
    AddExample(sub, "new frame --bays-x 3x5 --bays-y 2x4 --storeys 3.5,3,3 --columns 0.4x0.4 "
                    "--beams 0.3x0.5 --concrete C25/30 --dead 20 --live 8 --modes 6 --push "
                    "-o frame.json");
    sub->callback([=, &code] { code = RunNewFrame(*o); });
}

} // namespace

void AddNew(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("new", Say("IDS_QM_HELP_NEW"));
    auto curve = std::make_shared<T_NEW_CURVE_OPTIONS>();
    AddCurveOptions(sub, *curve);
    AddFrame(sub, code);
    AddExample(sub, "new --curve examples/first-steps/curve.txt --columns V,d,d1,d2 --units kN,m "
                    "--height 3x3 --mass 3x100 --spectrum ec8-2004:soil=C,ag=0.35 -o case.json");
    sub->callback([=, &code] {
        if (sub->get_subcommands().empty()) code = RunNewCurve(*curve);
    });
}

namespace {

void AddStoreys(CLI::App& app, EXIT_CODE& code)
{
    auto* storeys = app.add_subcommand("storeys", Say("IDS_QM_HELP_STOREYS"));
    auto s = std::make_shared<T_STOREYS_OPTIONS>();
    AddFile(storeys, s->file);
    storeys->add_option("--tolerance", s->tolerance, Say("IDS_QM_HELP_STOREYS_TOLERANCE"));
    storeys->add_option("-o", s->out, Say("IDS_QM_HELP_STOREYS_OUT"));
    AddOverwrite(storeys, s->overwrite);
    AddExample(storeys, "storeys examples/space-frame-3d/case.json --tolerance 0.1");
    storeys->callback([=, &code] { code = RunStoreys(*s); });
}

void AddSpectrum(CLI::App& app, EXIT_CODE& code)
{
    auto* spectrum = app.add_subcommand("spectrum", Say("IDS_QM_HELP_SPECTRUM"));
    auto o = std::make_shared<T_SPECTRUM_OPTIONS>();
    AddFile(spectrum, o->file);
    spectrum->add_option("--set", o->set, Say("IDS_QM_HELP_SPECTRUM_SET"));
    spectrum->add_option("--remove", o->remove, Say("IDS_QM_HELP_SPECTRUM_REMOVE"));
    spectrum->add_option("-o", o->out, Say("IDS_QM_HELP_NEW_OUT"));
    AddOverwrite(spectrum, o->overwrite);
    AddExample(spectrum, "spectrum examples/first-steps/case.json");
    spectrum->callback([=, &code] { code = RunSpectrum(*o); });
}

void AddModes(CLI::App& app, EXIT_CODE& code)
{
    auto* modes = app.add_subcommand("modes", Say("IDS_QM_HELP_MODES"));
    auto m = std::make_shared<T_MODES_OPTIONS>();
    AddFile(modes, m->file);
    modes->add_option("--find", m->find, Say("IDS_QM_HELP_MODES_FIND"));
    modes->add_option("--period", m->period, Say("IDS_QM_HELP_MODES_PERIOD"));
    modes->add_option("--direction", m->direction, Say("IDS_QM_HELP_MODES_DIRECTION"))
        ->capture_default_str();
    modes->add_option("--shape", m->shape, Say("IDS_QM_HELP_MODES_SHAPE"));
    modes->add_option("--delete", m->remove, Say("IDS_QM_HELP_MODES_DELETE"));
    modes->add_option("-o", m->out, Say("IDS_QM_HELP_NEW_OUT"));
    AddOverwrite(modes, m->overwrite);
    AddExample(modes, "modes examples/space-frame-3d/case.json --find 9 -o modes.json");
    modes->callback([=, &code] { code = RunModes(*m); });
}

} // namespace

void AddParts(CLI::App& app, EXIT_CODE& code)
{
    AddStoreys(app, code);
    AddSpectrum(app, code);
    AddModes(app, code);
}
