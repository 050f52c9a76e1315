#include "qm_ui/view/resultsbar.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_ui/form/localnumber.h"
#include "qm_ui/view/stepcurve.h"

#include <QComboBox>
#include <QDoubleSpinBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QSignalBlocker>
#include <QSlider>
#include <QToolButton>
#include <QVBoxLayout>

#include <cmath>
#include <numbers>

namespace {

constexpr int kSwingMs = 33, kStepMs = 80;
constexpr double kSwing = 2.0 * std::numbers::pi / 45.0; // a tick: a cycle takes 1.5 s
constexpr std::array<const char*, kViewLabels> kLabelTexts{
    "IDS_QM_VIEW_LABELS_NONE", "IDS_QM_VIEW_LABELS_LARGEST", "IDS_QM_VIEW_LABELS_MEMBER",
    "IDS_QM_VIEW_LABELS_ALL"};

QString Text(const char* key)
{
    return QString::fromStdString(Say(key));
}

bool Swings(const T_SHAPE_SOURCE& source)
{
    return source.kind == T_SHAPE_SOURCE::KIND::Mode;
}

} // namespace

CResultsBar::CResultsBar(CResultView& view, QWidget* parent)
    : QWidget(parent), m_view(view), m_source(new QComboBox(this)), m_what(new QComboBox(this)),
      m_labels(new QComboBox(this)), m_onDeformed(new QToolButton(this)),
      m_filled(new QToolButton(this)), m_play(new QToolButton(this)),
      m_slider(new QSlider(Qt::Horizontal, this)), m_curve(new CStepCurve(this)),
      m_step(new QLabel(this)), m_scaleLabel(new QLabel(this)), m_sizeLabel(new QLabel(this)),
      m_scale(new QLineEdit(this)), m_size(new QDoubleSpinBox(this))
{
    for (std::size_t w = 0; w < kViewWhats; ++w)
        m_what->addItem(QString());
    for (std::size_t l = 0; l < kViewLabels; ++l)
        m_labels->addItem(QString());
    m_source->setObjectName("view-source");
    m_what->setObjectName("view-what");
    m_play->setObjectName("view-play");
    m_play->setCheckable(true);
    m_onDeformed->setCheckable(true);
    m_filled->setCheckable(true);
    m_slider->setMinimum(1);
    m_slider->setMinimumWidth(120);
    m_scale->setMaximumWidth(80);
    m_size->setRange(0.1, 10.0);
    m_size->setSingleStep(0.25);
    m_size->setDecimals(2);
    // A long name must not make the window wider than a small screen.
    m_source->setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
    m_source->setMinimumContentsLength(16);
    MakeRows();
    Connect();
    Retranslate();
}

void CResultsBar::MakeRows()
{
    auto* choice = new QHBoxLayout;
    choice->addWidget(m_source, 2);
    choice->addWidget(m_what, 1);
    choice->addWidget(m_labels);
    choice->addWidget(m_filled);
    choice->addWidget(m_onDeformed);
    auto* step = new QHBoxLayout;
    step->addWidget(m_scaleLabel);
    step->addWidget(m_scale);
    step->addSpacing(8);
    step->addWidget(m_sizeLabel);
    step->addWidget(m_size);
    step->addSpacing(8);
    step->addWidget(m_play);
    step->addWidget(m_slider, 1);
    step->addWidget(m_step);
    step->addWidget(m_curve);
    step->addStretch();
    auto* rows = new QVBoxLayout(this);
    rows->setContentsMargins(4, 4, 4, 2);
    rows->setSpacing(4);
    rows->addLayout(choice);
    rows->addLayout(step);
}

void CResultsBar::Connect()
{
    connect(m_source, &QComboBox::currentIndexChanged, this, [this](int index) {
        Play(false);
        m_view.OnSource(static_cast<std::size_t>(std::max(index, 0)));
        Shown();
    });
    connect(m_what, &QComboBox::currentIndexChanged, this, [this](int index) {
        Choose([index](T_VIEW_CHOICE& c) { c.what = static_cast<VIEW_WHAT>(index); });
    });
    connect(m_labels, &QComboBox::currentIndexChanged, this, [this](int index) {
        Choose([index](T_VIEW_CHOICE& c) { c.labels = static_cast<VIEW_LABELS>(index); });
    });
    connect(m_onDeformed, &QToolButton::toggled, this,
            [this](bool on) { Choose([on](T_VIEW_CHOICE& c) { c.onDeformed = on; }); });
    connect(m_filled, &QToolButton::toggled, this,
            [this](bool on) { Choose([on](T_VIEW_CHOICE& c) { c.filled = on; }); });
    connect(m_size, &QDoubleSpinBox::valueChanged, this,
            [this](double size) { Choose([size](T_VIEW_CHOICE& c) { c.size = size; }); });
    connect(m_slider, &QSlider::valueChanged, this, [this](int step) {
        m_view.OnStep(step);
        Shown();
    });
    connect(m_scale, &QLineEdit::editingFinished, this, [this] { TakeScale(); });
    connect(m_play, &QToolButton::toggled, this, [this](bool on) { Play(on); });
    connect(&m_timer, &QTimer::timeout, this, [this] { Tick(); });
    m_curve->m_onStep = [this](int step) { m_slider->setValue(step); };
}

void CResultsBar::Retranslate()
{
    const auto name = [](QWidget* widget, const char* key) {
        widget->setAccessibleName(Text(key));
        widget->setToolTip(Text(key));
    };
    name(m_source, "IDS_QM_UI_SHAPE");
    name(m_what, "IDS_QM_VIEW_WHAT");
    name(m_labels, "IDS_QM_VIEW_LABELS");
    name(m_slider, "IDS_QM_UI_SHAPE_STEP");
    name(m_play, "IDS_QM_VIEW_PLAY_TIP");
    name(m_onDeformed, "IDS_QM_VIEW_ON_DEFORMED_TIP");
    name(m_filled, "IDS_QM_VIEW_FILLED_TIP");
    name(m_size, "IDS_QM_VIEW_SIZE_TIP");
    name(m_scale, "IDS_QM_UI_SHAPE_SCALE_TIP");
    m_curve->setAccessibleName(Text("IDS_QM_VIEW_CURVE"));
    m_onDeformed->setText(Text("IDS_QM_VIEW_ON_DEFORMED"));
    m_filled->setText(Text("IDS_QM_VIEW_FILLED"));
    m_play->setText(Text("IDS_QM_VIEW_PLAY"));
    m_scaleLabel->setText(Text("IDS_QM_UI_SHAPE_SCALE"));
    m_sizeLabel->setText(Text("IDS_QM_VIEW_SIZE"));
    const QSignalBlocker what(m_what), labels(m_labels);
    for (std::size_t w = 0; w < kViewWhats; ++w)
        m_what->setItemText(static_cast<int>(w),
                            QString::fromStdString(ViewWhatText(static_cast<VIEW_WHAT>(w))));
    for (std::size_t l = 0; l < kViewLabels; ++l)
        m_labels->setItemText(static_cast<int>(l), Text(kLabelTexts[l]));
    Refresh();
}

void CResultsBar::FillSources()
{
    const QSignalBlocker quiet(m_source);
    const auto& sources = m_view.Sources();
    while (m_source->count() > static_cast<int>(sources.size()))
        m_source->removeItem(m_source->count() - 1);
    for (std::size_t i = 0; i < sources.size(); ++i) {
        const QString text = QString::fromStdString(CResultView::NameOf(sources[i]));
        const int index = static_cast<int>(i);
        if (index == m_source->count())
            m_source->addItem(text);
        else if (m_source->itemText(index) != text)
            m_source->setItemText(index, text);
    }
    m_source->setCurrentIndex(static_cast<int>(m_view.SourceIndex()));
}

void CResultsBar::Refresh()
{
    FillSources();
    const T_VIEW_CHOICE& choice = m_view.Choice();
    const QSignalBlocker what(m_what), labels(m_labels), slider(m_slider), size(m_size),
        filled(m_filled), onDeformed(m_onDeformed), play(m_play);
    m_what->setCurrentIndex(static_cast<int>(choice.what));
    m_labels->setCurrentIndex(static_cast<int>(choice.labels));
    m_filled->setChecked(choice.filled);
    m_onDeformed->setChecked(choice.onDeformed);
    m_size->setValue(choice.size);
    m_play->setChecked(IsPlaying());
    const T_SHAPE_SOURCE& source = m_view.Source();
    const bool steps = source.steps > 1;
    m_slider->setMaximum(m_view.Steps());
    m_slider->setValue(m_view.Step());
    m_slider->setEnabled(steps);
    for (QWidget* widget : {static_cast<QWidget*>(m_slider), static_cast<QWidget*>(m_step)})
        widget->setVisible(source.steps > 0);
    m_play->setVisible(steps || Swings(source));
    m_step->setText(source.steps > 0
                        ? QStringLiteral("%1 / %2").arg(m_view.Step()).arg(source.steps)
                        : QString());
    m_curve->setVisible(!m_view.Curve().displacement.empty());
    m_curve->SetCurve(m_view.Curve(), m_view.Step());
    if (!m_scale->isModified()) m_scale->setText(LocalNumberText(ShortestText(m_view.Scale())));
}

void CResultsBar::Shown()
{
    Refresh();
    if (m_onShown) m_onShown();
}

void CResultsBar::Choose(const std::function<void(T_VIEW_CHOICE&)>& change)
{
    T_VIEW_CHOICE choice = m_view.Choice();
    change(choice);
    m_view.OnChoice(choice);
    Shown();
}

/// An empty field, or one that is no number, goes back to the scale that suits.
void CResultsBar::TakeScale()
{
    const std::optional<double> typed = ParseLocalNumber(m_scale->text());
    if (!m_scale->isModified()) return;
    m_scale->setModified(false);
    Choose([&](T_VIEW_CHOICE& c) { c.scale = typed; });
}

double CResultsBar::Phase() const
{
    return IsPlaying() && Swings(m_view.Source()) ? std::sin(m_angle) : 1.0;
}

void CResultsBar::Play(bool play)
{
    if (!play) {
        const bool was = IsPlaying();
        m_timer.stop();
        if (was) Shown();
        return;
    }
    if (!Swings(m_view.Source()) && m_view.Steps() < 2) return Refresh();
    if (m_view.Step() == m_view.Steps() && m_view.Steps() > 1) m_slider->setValue(1);
    m_angle = 0.0;
    m_timer.start(Swings(m_view.Source()) ? kSwingMs : kStepMs);
    Refresh();
}

/// A push or stage ends with its last step; a mode goes on.
void CResultsBar::Tick()
{
    if (Swings(m_view.Source())) {
        m_angle = std::fmod(m_angle + kSwing, 2.0 * std::numbers::pi);
        if (m_onShown) m_onShown();
        return;
    }
    if (m_view.Step() < m_view.Steps()) m_slider->setValue(m_view.Step() + 1);
    if (m_view.Step() >= m_view.Steps()) Play(false);
}

void CResultsBar::hideEvent(QHideEvent* event)
{
    Play(false);
    QWidget::hideEvent(event);
}
