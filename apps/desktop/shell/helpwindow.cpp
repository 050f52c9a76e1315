#include "shell/helpwindow.h"

#include "shell/helptopics.h"
#include "shell/icons.h"

#include "qm_base/say.h"

#include <QAbstractTextDocumentLayout>
#include <QAction>
#include <QDesktopServices>
#include <QFile>
#include <QFileInfo>
#include <QLineEdit>
#include <QListWidget>
#include <QScrollBar>
#include <QShortcut>
#include <QSplitter>
#include <QTextBlock>
#include <QTextBrowser>
#include <QTimer>
#include <QToolBar>

namespace {

QString Text(const char* key)
{
    return QString::fromStdString(Say(key));
}

/// The first heading of a page, without marks.
QString TitleOf(const QString& page)
{
    QFile file(page);
    if (!file.open(QIODevice::ReadOnly)) return QFileInfo(page).baseName();
    const QString first = QString::fromUtf8(file.readLine()).trimmed();
    return first.startsWith("# ") ? first.mid(2) : QFileInfo(page).baseName();
}

} // namespace

CHelpWindow::CHelpWindow(QWidget* parent)
    : QMainWindow(parent, Qt::Window), m_pages(new QListWidget), m_text(new QTextBrowser),
      m_search(new QLineEdit)
{
    setObjectName("help");
    auto* parts = new QSplitter(this);
    parts->setObjectName("parts");
    parts->addWidget(m_pages);
    parts->addWidget(m_text);
    parts->setStretchFactor(1, 1);
    parts->setSizes({260, 720});
    m_pages->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    m_pages->setTextElideMode(Qt::ElideRight);
    setCentralWidget(parts);
    m_text->setOpenLinks(false);
    m_text->document()->setDocumentMargin(18);
    MakeBar();
    connect(m_pages, &QListWidget::itemActivated, this,
            [this](QListWidgetItem* item) { ShowPage(item->data(Qt::UserRole).toString(), {}); });
    connect(m_pages, &QListWidget::itemClicked, this,
            [this](QListWidgetItem* item) { ShowPage(item->data(Qt::UserRole).toString(), {}); });
    connect(m_text, &QTextBrowser::anchorClicked, this, [this](const QUrl& link) {
        const QUrl target = m_text->source().resolved(link);
        if (!target.isLocalFile())
            (void)QDesktopServices::openUrl(target);
        else if (target.path().endsWith(".md"))
            ShowPage(target.toLocalFile(), target.fragment());
    });
    connect(m_text, &QTextBrowser::sourceChanged, this, [this] { FollowPage(); });
    Retranslate();
    resize(980, 700);
}

void CHelpWindow::MakeBar()
{
    QToolBar* bar = addToolBar(QString());
    bar->setObjectName("helpBar");
    bar->setMovable(false);
    m_back = bar->addAction(DrawnIcon("undo"), QString(), m_text, &QTextBrowser::backward);
    m_forward = bar->addAction(DrawnIcon("redo"), QString(), m_text, &QTextBrowser::forward);
    m_back->setShortcut(QKeySequence::Back);
    m_forward->setShortcut(QKeySequence::Forward);
    m_search->setClearButtonEnabled(true);
    m_search->setMaximumWidth(280);
    bar->addWidget(m_search);
    connect(m_search, &QLineEdit::returnPressed, this, [this] { Find(); });
    connect(m_text, &QTextBrowser::backwardAvailable, m_back, &QAction::setEnabled);
    connect(m_text, &QTextBrowser::forwardAvailable, m_forward, &QAction::setEnabled);
    m_back->setEnabled(false);
    m_forward->setEnabled(false);
    auto* find = new QShortcut(QKeySequence::Find, this);
    connect(find, &QShortcut::activated, m_search, [this] { m_search->setFocus(); });
    auto* close = new QShortcut(QKeySequence::Cancel, this);
    connect(close, &QShortcut::activated, this, [this] { this->close(); });
}

void CHelpWindow::Retranslate()
{
    setWindowTitle(Text("IDS_QM_HELP_TITLE"));
    m_back->setText(Text("IDS_QM_HELP_BACK"));
    m_forward->setText(Text("IDS_QM_HELP_FORWARD"));
    m_search->setPlaceholderText(Text("IDS_QM_HELP_SEARCH"));
    m_search->setAccessibleName(Text("IDS_QM_HELP_SEARCH"));
    m_pages->setAccessibleName(Text("IDS_QM_HELP_PAGES"));
    m_pages->clear();
    for (const QString& page : GuidePages()) {
        auto* item = new QListWidgetItem(TitleOf(page), m_pages);
        item->setData(Qt::UserRole, page);
    }
}

bool CHelpWindow::ShowTopic(const QString& anchor)
{
    const QString page = PageWith(anchor);
    const QStringList all = GuidePages();
    if (page.isEmpty() && all.isEmpty()) {
        m_text->setPlainText(Text("IDS_QM_HELP_MISSING"));
        return false;
    }
    ShowPage(page.isEmpty() ? all.front() : page, page.isEmpty() ? QString() : anchor);
    return true;
}

void CHelpWindow::ShowPage(const QString& path, const QString& anchor)
{
    QUrl url = QUrl::fromLocalFile(path);
    if (!anchor.isEmpty()) url.setFragment(anchor);
    m_text->setSource(url, QTextDocument::MarkdownResource);
    FollowPage();
}

/// Headings of a page have no marks of their own to go to: the one with the anchor is looked for.
void CHelpWindow::GoTo(const QString& anchor)
{
    for (QTextBlock at = m_text->document()->begin(); at.isValid(); at = at.next()) {
        if (at.blockFormat().headingLevel() == 0 || AnchorOf(at.text()) != anchor) continue;
        m_text->setTextCursor(QTextCursor(at));
        // The page is laid out when the window has come up.
        QTimer::singleShot(0, this, [this] {
            const QAbstractTextDocumentLayout& layout = *m_text->document()->documentLayout();
            const QRectF heading = layout.blockBoundingRect(m_text->textCursor().block());
            m_text->verticalScrollBar()->setValue(static_cast<int>(heading.top()));
        });
        return;
    }
}

void CHelpWindow::FollowPage()
{
    const QUrl at = m_text->source();
    for (int i = 0; i < m_pages->count(); ++i)
        if (m_pages->item(i)->data(Qt::UserRole).toString() == at.toLocalFile())
            m_pages->setCurrentRow(i);
    if (!at.fragment().isEmpty()) GoTo(at.fragment());
}

/// The next place with the text, on this page, then on the pages that follow.
void CHelpWindow::Find()
{
    const QString wanted = m_search->text();
    if (wanted.isEmpty() || m_text->find(wanted)) return;
    const int pages = m_pages->count(), from = std::max(m_pages->currentRow(), 0);
    for (int i = 1; i <= pages; ++i) {
        const QString page = m_pages->item((from + i) % pages)->data(Qt::UserRole).toString();
        QFile file(page);
        if (!file.open(QIODevice::ReadOnly)) continue;
        if (!QString::fromUtf8(file.readAll()).contains(wanted, Qt::CaseInsensitive)) continue;
        ShowPage(page, {});
        m_text->moveCursor(QTextCursor::Start);
        if (m_text->find(wanted)) return;
    }
}
