#include "framepane.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_ui/form/localnumber.h"

#include <QComboBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QSignalBlocker>
#include <QSlider>
#include <QVBoxLayout>

#include <algorithm>

using zql::lib::MMSGFunction;
using S = T_SHAPE_SOURCE;

namespace {

QString Text(const char* key)
{
    return QString::fromStdString(MMSGFunction::GetValue(key));
}

const char* KindKey(S::KIND kind)
{
    switch (kind) {
    case S::KIND::Static:
        return "IDS_QM_UI_SHAPE_CASE";
    case S::KIND::Stage:
        return "IDS_QM_UI_SHAPE_STAGE";
    case S::KIND::Pushover:
        return "IDS_QM_UI_SHAPE_PUSHOVER";
    case S::KIND::Mode:
        return "IDS_QM_UI_SHAPE_MODE";
    case S::KIND::None:
        break;
    }
    return "IDS_QM_UI_SHAPE_NONE";
}

} // namespace

CFramePane::CFramePane(CDBDoc& doc, CFrameScene& scene, CSelection& selection, QWidget* parent)
    : QWidget(parent), m_scene(scene), m_selection(selection), m_hinges(doc),
      m_view(new CFrameView(this)), m_source(new QComboBox(this)),
      m_slider(new QSlider(Qt::Horizontal, this)), m_step(new QLabel(this)),
      m_scaleLabel(new QLabel(this)), m_sourceLabel(new QLabel(this)),
      m_scaleEdit(new QLineEdit(this))
{
    m_scaleEdit->setMaximumWidth(90);
    m_slider->setMinimum(1);
    m_step->setMinimumWidth(80);
    auto* bar = new QHBoxLayout;
    for (QWidget* widget : {static_cast<QWidget*>(m_sourceLabel), static_cast<QWidget*>(m_source)})
        bar->addWidget(widget);
    bar->addWidget(m_slider, 1);
    bar->addWidget(m_step);
    bar->addStretch();
    bar->addWidget(m_scaleLabel);
    bar->addWidget(m_scaleEdit);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addLayout(bar);
    layout->addWidget(m_view, 1);
    m_source->setMinimumContentsLength(24);
    connect(m_source, &QComboBox::currentIndexChanged, this, [this] { ShowSource(); });
    connect(m_slider, &QSlider::valueChanged, this, [this] { ShowStep(); });
    connect(m_scaleEdit, &QLineEdit::editingFinished, this, [this] { TakeScale(); });
    m_view->m_onLine = [this](std::size_t line) { Choose({line}); };
    m_view->m_onLines = [this](const std::vector<std::size_t>& lines) { Choose(lines); };
    m_selection.Watch(this, [this] { MarkChosen(); });
    Retranslate();
    Refresh();
}

CFramePane::~CFramePane()
{
    m_selection.Unwatch(this);
}

/// Elements that are clicked or lie in a box take the place of those chosen before.
void CFramePane::Choose(const std::vector<std::size_t>& lines)
{
    CSelection::T_KEYS ids;
    for (const std::size_t line : lines)
        ids.insert(m_view->Picture().scene->lines.at(line).id);
    m_selection.Choose(EXPLORER_TABLE::Elements, std::move(ids));
}

void CFramePane::MarkChosen()
{
    ShowStep();
}

QString CFramePane::NameOf(const S& source) const
{
    return QString::fromStdString(MMSGFunction::Format(KindKey(source.kind), {source.name}));
}

void CFramePane::Retranslate()
{
    m_sourceLabel->setText(Text("IDS_QM_UI_SHAPE"));
    m_scaleLabel->setText(Text("IDS_QM_UI_SHAPE_SCALE"));
    m_scaleEdit->setToolTip(Text("IDS_QM_UI_SHAPE_SCALE_TIP"));
    m_source->setAccessibleName(m_sourceLabel->text());
    m_slider->setAccessibleName(Text("IDS_QM_UI_SHAPE_STEP"));
    for (int i = 0; i < m_source->count(); ++i)
        m_source->setItemText(i, NameOf(m_sources[static_cast<std::size_t>(i)]));
    if (!m_sources.empty()) ShowStep();
}

void CFramePane::Refresh()
{
    const int before = m_source->currentIndex();
    const S chosen = before < 0 ? S{} : m_sources[static_cast<std::size_t>(before)];
    const int step = m_slider->value();
    m_sources = m_scene.Sources();
    {
        const QSignalBlocker quiet(m_source);
        m_source->clear();
        for (const S& source : m_sources)
            m_source->addItem(NameOf(source));
        const auto it = std::ranges::find_if(m_sources, [&](const S& source) {
            return source.kind == chosen.kind && source.key == chosen.key &&
                   source.turn == chosen.turn;
        });
        m_source->setCurrentIndex(it == m_sources.end() ? 0
                                                        : static_cast<int>(it - m_sources.begin()));
    }
    ShowSource();
    SetStep(step);
}

int CFramePane::Show(const S& source, int step)
{
    const auto it = std::ranges::find(m_sources, source);
    if (it == m_sources.end()) return 0;
    m_source->setCurrentIndex(static_cast<int>(it - m_sources.begin()));
    SetStep(step);
    return 1;
}

void CFramePane::SetStep(int step)
{
    m_slider->setValue(step);
}

void CFramePane::ResetCamera()
{
    m_view->SetCamera(CameraFor(CFrameScene::FlatAxis(m_scene.Scene())));
}

/// The last step of the chosen source, in a scale that suits it.
void CFramePane::ShowSource()
{
    const S& source = m_sources[static_cast<std::size_t>(std::max(m_source->currentIndex(), 0))];
    const bool steps = source.steps > 1;
    m_slider->setEnabled(steps);
    {
        const QSignalBlocker quiet(m_slider);
        m_slider->setMaximum(std::max(source.steps, 1));
        m_slider->setValue(m_slider->maximum());
    }
    if (!m_ownScale && m_scene.Read(source, m_slider->value(), m_moves))
        m_scale = CFrameScene::RoundScale(m_scene.Scene(), m_moves);
    ShowStep();
}

void CFramePane::ShowStep()
{
    const S& source = m_sources[static_cast<std::size_t>(std::max(m_source->currentIndex(), 0))];
    const int step = m_slider->value();
    T_FRAME_PICTURE picture;
    picture.scene = &m_scene.SceneOf(source);
    picture.subtitle = NameOf(source).toStdString();
    if (m_scene.Read(source, step, m_moves)) {
        if (source.kind != S::KIND::None) picture.displacement = &m_moves;
    } else {
        picture.note = m_scene.Error();
    }
    if (source.steps > 0)
        picture.subtitle +=
            ", " + MMSGFunction::Format("IDS_QM_UI_SHAPE_STEP_OF",
                                        {std::to_string(step), std::to_string(source.steps)});
    const std::string scale = LocalNumberText(ShortestText(m_scale)).toStdString();
    if (picture.displacement)
        picture.note =
            MMSGFunction::Format("IDS_QM_UI_SHAPE_NOTE", {scale, picture.scene->lengthUnit});
    picture.scale = m_scale;
    const CSelection::T_KEYS& chosen = m_selection.Chosen(EXPLORER_TABLE::Elements);
    if (!chosen.empty())
        for (const T_SCENE_LINE& line : picture.scene->lines)
            picture.chosen.push_back(chosen.contains(line.id));
    picture.drifts = m_scene.Drifts(source, step);
    picture.marks = m_hinges.Marks(source, step, *picture.scene);
    m_step->setText(source.steps > 0 ? QStringLiteral("%1 / %2").arg(step).arg(source.steps)
                                     : QString());
    if (!m_scaleEdit->isModified()) m_scaleEdit->setText(QString::fromStdString(scale));
    m_view->SetPicture(std::move(picture));
}

/// An empty field, or one that is no number, goes back to the scale that suits.
void CFramePane::TakeScale()
{
    const std::optional<double> typed = ParseLocalNumber(m_scaleEdit->text());
    m_ownScale = typed.has_value();
    m_scaleEdit->setModified(false);
    m_scale = typed ? *typed : CFrameScene::RoundScale(m_scene.Scene(), m_moves);
    ShowStep();
}

T_DRAWING CFramePane::Drawing() const
{
    const auto draw = [picture = m_view->Picture(), camera = m_view->Camera(),
                       options = m_view->Options()](QPainter& painter, const QRectF& rect) {
        CFramePainter().Draw(painter, rect, picture, camera, options);
    };
    return {draw, QSizeF(m_view->size()), m_scene.Scene().title, m_view->Picture().subtitle};
}
