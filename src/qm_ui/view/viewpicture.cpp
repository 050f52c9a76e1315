#include "qm_ui/view/viewpicture.h"

namespace {

void MarkChosen(const CSelection& selection, T_FRAME_PICTURE& picture)
{
    const CSelection::T_KEYS& elements = selection.Chosen(EXPLORER_TABLE::Elements);
    if (!elements.empty())
        for (const T_SCENE_LINE& line : picture.scene->lines)
            picture.chosen.push_back(elements.contains(line.id));
    const CSelection::T_KEYS& nodes = selection.Chosen(EXPLORER_TABLE::Nodes);
    for (std::size_t n = 0; !nodes.empty() && n < picture.scene->nodes.size(); ++n)
        if (picture.scene->nodes[n].shown && nodes.contains(picture.scene->nodes[n].id))
            picture.chosenNodes.push_back(n);
}

} // namespace

T_FRAME_PICTURE PictureOf(const CResultView& view, const CSelection& selection, double phase)
{
    const T_VIEW_CHOICE& choice = view.Choice();
    T_FRAME_PICTURE picture;
    picture.scene = &view.Scene();
    picture.displacement = view.Moves();
    picture.scale = phase * view.Scale();
    picture.subtitle = view.Subtitle();
    picture.note = view.Note();
    picture.drifts = view.Drifts();
    const bool states = choice.what == VIEW_WHAT::Deformed || choice.what == VIEW_WHAT::Hinges;
    picture.marks = states ? view.Hinges() : nullptr;
    picture.results = {view.Bent(),   view.Diagram(), view.Marks(), view.Stress(),
                       choice.labels, choice.filled,  choice.size};
    MarkChosen(selection, picture);
    return picture;
}

T_DRAWING DrawingOf(const CResultView& view, const CSelection& selection, const T_CAMERA& camera,
                    const T_FRAME_OPTIONS& options)
{
    T_DRAWING drawing;
    drawing.title = view.Scene().title;
    drawing.subtitle = view.Subtitle();
    drawing.draw = [picture = PictureOf(view, selection), camera, options](QPainter& painter,
                                                                           const QRectF& rect) {
        T_FRAME_OPTIONS still = options;
        still.quick = false;
        CFramePainter().Draw(painter, rect, picture, camera, still);
    };
    return drawing;
}
