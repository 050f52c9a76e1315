#include "view/viewcommands.h"

#include "inputfile.h"
#include "output.h"
#include "qm_base/say.h"
#include "qm_ui/view/viewpicture.h"

#include <algorithm>
#include <cstdio>

namespace {

struct T_LOOK_NAME {
    const char* name;
    T_CAMERA camera;
};
constexpr std::array<T_LOOK_NAME, 4> kLooks{
    {{"iso", kIsometric}, {"xz", kElevationXZ}, {"yz", kElevationYZ}, {"xy", kPlanXY}}};

/// Index in a list of names; the parser has judged them.
template <class NAMES>
std::size_t IndexOf(const NAMES& names, const std::string& name)
{
    return static_cast<std::size_t>(
        std::ranges::find_if(names, [&](const char* n) { return name == n; }) - names.begin());
}

T_CAMERA CameraOf(const T_PICTURE_OPTIONS& o, const T_FRAME_SCENE& scene)
{
    const auto* const look =
        std::ranges::find_if(kLooks, [&](const T_LOOK_NAME& l) { return o.look == l.name; });
    T_CAMERA camera = look == kLooks.end() ? CameraFor(CFrameScene::FlatAxis(scene)) : look->camera;
    camera.perspective = o.perspective;
    return camera;
}

} // namespace

EXIT_CODE RunPicture(const T_PICTURE_OPTIONS& o)
{
    if (const EXIT_CODE code = CheckPlotName(o.out); code != EXIT_CODE::Done) return code;
    if (const EXIT_CODE code = CheckOutputs(o.file, {{o.out, OUTPUT_KIND::Picture}}, o.overwrite);
        code != EXIT_CODE::Done)
        return code;
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    CFrameScene scene(doc);
    CSelection selection;
    std::set<int> elements;
    if (const EXIT_CODE code = ReadElementIds(doc, o, elements); code != EXIT_CODE::Done)
        return code;
    if (!elements.empty()) selection.ShowOnly(doc.Data().Model(), elements);
    std::vector<T_SHAPE_SOURCE> sources;
    if (const EXIT_CODE code = FindSources(doc, o, scene, sources); code != EXIT_CODE::Done)
        return code;
    CResultView view(doc, scene, selection);
    const int steps = std::max(sources.front().steps, 1);
    if (o.step > steps)
        return Complain(EXIT_CODE::Usage,
                        Say("IDS_QM_VIEW_NO_STEP", std::to_string(o.step), std::to_string(steps)));
    T_VIEW_CHOICE choice;
    choice.what = static_cast<VIEW_WHAT>(IndexOf(kViewWhatNames, o.what));
    choice.labels = static_cast<VIEW_LABELS>(IndexOf(kViewLabelNames, o.labels));
    choice.onDeformed = o.onDeformed;
    choice.filled = !o.outline;
    choice.size = o.size;
    if (o.scale != 0.0) choice.scale = o.scale;
    view.OnChoice(choice);
    (void)view.OnShow(sources.front(), o.step > 0 ? o.step : steps);
    if (!view.Missing().empty())
        return Complain(EXIT_CODE::NotFound,
                        o.file + ": " + view.Subtitle() + ": " + view.Missing());
    T_FRAME_OPTIONS options;
    options.nodeNumbers = options.elementNumbers = o.numbers;
    std::string error;
    if (!WritePictureFile(DrawingOf(view, selection, CameraOf(o, view.Scene()), options), o.out,
                          error))
        return Complain(EXIT_CODE::NoAccess, error);
    const std::string note = view.Note();
    std::printf("%s: %s%s%s\n", o.out.c_str(), view.Subtitle().c_str(), note.empty() ? "" : "; ",
                note.c_str());
    return EXIT_CODE::Done;
}
