#include "shell/startpage.h"

#include "shell/cardgrid.h"
#include "shell/datafolder.h"
#include "shell/icons.h"
#include "shell/thumbnails.h"

#include "qm_base/say.h"

#include <QAction>
#include <QDir>
#include <QFileInfo>
#include <QLabel>
#include <QScrollArea>
#include <QTimer>
#include <QToolButton>
#include <QVBoxLayout>

#include <utility>

namespace {

constexpr int kButtonWidth = 220, kSpace = 24, kGap = 8; // px at 96 dpi

QString Text(const char* key)
{
    return QString::fromStdString(Say(key));
}

/// The example's name in the person's language; its folder where the catalogue has none.
QString NameOfExample(const QString& folder)
{
    const std::string key = "IDS_QM_EXAMPLE_" + folder.toUpper().replace('-', '_').toStdString();
    const std::string text = Say(key);
    return text == key ? folder : QString::fromStdString(text);
}

QLabel* Line(QWidget* parent, double size, bool bold)
{
    auto* label = new QLabel(parent);
    QFont font = label->font();
    font.setPointSizeF(font.pointSizeF() * size);
    font.setBold(bold);
    label->setFont(font);
    label->setWordWrap(true);
    return label;
}

} // namespace

CStartPage::CStartPage(T_START_CALLS calls, QWidget* parent)
    : QWidget(parent), m_calls(std::move(calls)), m_title(Line(this, 1.8, true)),
      m_subtitle(Line(this, 1.0, false)), m_drop(Line(this, 1.0, false)), m_buttons(new QVBoxLayout)
{
    auto* side = new QVBoxLayout;
    side->setSpacing(kGap);
    m_buttons->setSpacing(kGap);
    for (QLabel* label : {m_title, m_subtitle})
        side->addWidget(label);
    side->addSpacing(kSpace / 2);
    side->addLayout(m_buttons);
    side->addSpacing(kSpace / 2);
    m_drop->setAlignment(Qt::AlignCenter);
    m_drop->setMinimumHeight(96);
    m_drop->setFrameShape(QFrame::StyledPanel);
    side->addWidget(m_drop);
    side->addStretch(1);
    auto* scroll = new QScrollArea(this);
    auto* lists = new QWidget(scroll);
    m_recent = new CCardGrid(lists);
    m_examples = new CCardGrid(lists);
    auto* column = new QVBoxLayout(lists);
    column->setContentsMargins(0, 0, 0, 0);
    column->addWidget(m_recent);
    column->addSpacing(kSpace);
    column->addWidget(m_examples);
    column->addStretch(1);
    scroll->setWidget(lists);
    scroll->setWidgetResizable(true);
    scroll->setFrameShape(QFrame::NoFrame);
    scroll->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    scroll->setVerticalScrollBarPolicy(Qt::ScrollBarAlwaysOn); // columns don't come and go with it
    auto* layout = new QHBoxLayout(this);
    layout->setContentsMargins(kSpace, kSpace, kSpace, kSpace);
    layout->setSpacing(kSpace);
    layout->addLayout(side);
    layout->addWidget(scroll, 1);
    for (QLabel* label : {m_title, m_subtitle, m_drop})
        label->setFixedWidth(kButtonWidth);
}

/// Buttons take texts, icons and states of their actions.
void CStartPage::MakeButtons()
{
    if (!m_made.empty()) return;
    for (QAction* action : m_calls.begin()) {
        if (!action) continue;
        auto* button = new QToolButton(this);
        button->setToolButtonStyle(Qt::ToolButtonTextBesideIcon);
        button->setFixedWidth(kButtonWidth);
        button->setMinimumHeight(36);
        button->setFocusPolicy(Qt::StrongFocus);
        button->setObjectName("start/" + action->objectName());
        connect(button, &QToolButton::clicked, action, &QAction::trigger);
        button->setIcon(action->icon());
        button->setIconSize({24, 24});
        m_buttons->addWidget(button);
        m_made.push_back(button);
    }
}

void CStartPage::Refresh()
{
    MakeButtons();
    m_isStale = true;
    m_title->setText(Text("IDS_QM_PRODUCT"));
    m_subtitle->setText(Text("IDS_QM_START_SUBTITLE"));
    m_drop->setText(Text("IDS_QM_START_DROP"));
    std::size_t i = 0;
    for (const QAction* action : m_calls.begin()) {
        if (!action) continue;
        m_made[i]->setText("  " + action->iconText());
        m_made[i]->setToolTip(action->statusTip());
        m_made[i++]->setEnabled(action->isEnabled());
    }
    if (isVisible()) ShowCards();
}

/// Each time that the texts or the files may have changed, once the page is seen.
void CStartPage::ShowCards()
{
    if (!std::exchange(m_isStale, false)) return;
    ShowRecent();
    ShowExamples();
}

void CStartPage::ShowRecent()
{
    m_recent->Clear();
    m_recent->SetTitle(Text("IDS_QM_START_RECENT"));
    m_recent->SetNote(Text("IDS_QM_START_NO_RECENT"));
    for (const QString& path : m_calls.recent()) {
        const QFileInfo file(path);
        CModelCard& card = m_recent->Add(file.fileName(), QDir::toNativeSeparators(file.path()));
        if (!file.exists()) {
            card.SetGone(Text("IDS_QM_START_GONE"), Text("IDS_QM_START_REMOVE"), [this, path] {
                m_calls.forget(path);
                ShowRecent();
            });
            continue;
        }
        card.SetPicture(KeptThumbnail(path));
        connect(&card, &CModelCard::clicked, this, [this, path] { m_calls.open(path); });
    }
    m_recent->Arrange();
}

void CStartPage::ShowExamples()
{
    m_examples->Clear();
    m_missing.clear();
    m_examples->SetTitle(Text("IDS_QM_START_EXAMPLES"));
    m_examples->SetNote(Text("IDS_QM_START_NO_EXAMPLES"));
    const QString place = DataFolder("examples");
    const QStringList folders =
        place.isEmpty() ? QStringList() : QDir(place).entryList(QDir::Dirs | QDir::NoDotAndDotDot);
    for (const QString& folder : folders) {
        const QString path = place + "/" + folder + "/case.json";
        if (!QFileInfo::exists(path)) continue;
        CModelCard& card = m_examples->Add(NameOfExample(folder), folder);
        m_missing.push_back({m_examples->Cards().size() - 1, path});
        connect(&card, &CModelCard::clicked, this, [this, path] { m_calls.openCopy(path); });
    }
    m_examples->Arrange();
    DrawNext();
}

void CStartPage::showEvent(QShowEvent* event)
{
    QWidget::showEvent(event);
    constexpr int kAfterMs = 20; // the window can be used before its cards are made
    QTimer::singleShot(kAfterMs, this, [this] {
        if (isVisible()) ShowCards();
    });
}

/// One picture at a time, so that the window stays usable.
void CStartPage::DrawNext()
{
    if (m_missing.empty() || !isVisible()) return;
    const T_MISSING next = m_missing.front();
    m_missing.pop_front();
    QPixmap picture = KeptThumbnail(next.path);
    if (picture.isNull()) {
        picture = DrawCaseThumbnail(next.path);
        KeepThumbnail(next.path, picture);
    }
    m_examples->Cards().at(next.card)->SetPicture(picture);
    QTimer::singleShot(0, this, [this] { DrawNext(); });
}
