#include "framepane.h"

#include "viewtools.h"

#include "qm_ui/view/viewpicture.h"

#include <QSlider>
#include <QVBoxLayout>

CFramePane::CFramePane(CDBDoc& doc, CFrameScene& scene, CSelection& selection, QWidget* parent)
    : QWidget(parent), m_doc(doc), m_scene(scene), m_selection(selection),
      m_shown(doc, scene, selection), m_view(new CFrameView(this)),
      m_bar(new CResultsBar(m_shown, this))
{
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->setSpacing(0);
    layout->addWidget(m_bar);
    layout->addWidget(m_view, 1);
    m_bar->m_onShown = [this] { ShowResults(); };
    m_view->m_onPick = [this](const T_PICK& pick) { Choose(pick); };
    m_view->m_onEscape = [this] { m_selection.Clear(); };
    m_view->m_onMenu = [this](QPoint at) { ShowViewMenu(*this, at); };
    m_selection.Watch(this, [this] { OnSelection(); });
    Refresh();
}

CFramePane::~CFramePane()
{
    m_bar->Play(false); // it draws from what goes before it does
    m_selection.Unwatch(this);
}

/// Nodes and elements of one pick are chosen together; a click beside everything clears.
void CFramePane::Choose(const T_PICK& pick)
{
    const T_FRAME_SCENE& scene = *m_view->Picture().scene;
    CSelection::T_KEYS elements, nodes;
    for (const std::size_t line : pick.lines)
        elements.insert(scene.lines.at(line).id);
    for (const std::size_t node : pick.nodes)
        nodes.insert(scene.nodes.at(node).id);
    if (pick.how == PICK::Toggle) {
        m_selection.Toggle(EXPLORER_TABLE::Elements, elements);
        m_selection.Toggle(EXPLORER_TABLE::Nodes, nodes);
        return;
    }
    if (pick.how == PICK::Add)
        m_selection.Add(EXPLORER_TABLE::Elements, elements);
    else if (elements.empty())
        return m_selection.Choose(EXPLORER_TABLE::Nodes, std::move(nodes));
    else
        m_selection.Choose(EXPLORER_TABLE::Elements, std::move(elements));
    m_selection.Add(EXPLORER_TABLE::Nodes, nodes);
}

void CFramePane::OnSelection()
{
    if (m_hidden != m_selection.Hidden()) {
        m_hidden = m_selection.Hidden();
        m_shown.OnHidden();
    }
    ShowPicture();
}

void CFramePane::Retranslate()
{
    m_bar->Retranslate();
    ShowPicture();
}

void CFramePane::Refresh()
{
    m_hidden = m_selection.Hidden();
    m_shown.Refresh();
    m_bar->Refresh();
    ShowResults();
}

int CFramePane::Show(const T_SHAPE_SOURCE& source, int step)
{
    if (!m_shown.OnShow(source, step)) return 0;
    m_bar->Refresh();
    ShowResults();
    return 1;
}

void CFramePane::SetStep(int step)
{
    Slider().setValue(step);
}

void CFramePane::SetChoice(const T_VIEW_CHOICE& choice)
{
    m_shown.OnChoice(choice);
    m_bar->Refresh();
    ShowPicture();
}

void CFramePane::ResetCamera()
{
    m_view->SetCamera(CameraFor(CFrameScene::FlatAxis(m_scene.Scene())));
}

void CFramePane::ShowPicture()
{
    m_view->SetPicture(PictureOf(m_shown, m_selection, m_bar->Phase()));
}

void CFramePane::ShowResults()
{
    ShowPicture();
    if (m_onResults && !m_bar->IsPlaying()) m_onResults();
}

T_DRAWING CFramePane::Drawing() const
{
    T_DRAWING drawing = DrawingOf(m_shown, m_selection, m_view->Camera(), m_view->Options());
    drawing.size = QSizeF(m_view->size());
    return drawing;
}
