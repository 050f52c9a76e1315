// What stands around the panes: menus, start page, preferences, theme, help, places of windows.
#include "desktoptest.h"
#include "explorerpane.h"
#include "shell/cardgrid.h"
#include "shell/helptopics.h"
#include "shell/helpwindow.h"
#include "shell/shell.h"
#include "shell/startpage.h"
#include "shell/theme.h"
#include "shell/thumbnails.h"
#include "shell/windowkeeper.h"
#include "tempfolder.h"

#include "qm_base/msgfunction.h"
#include "qm_ui/shown/showndecimals.h"

#include <QAction>
#include <QApplication>
#include <QClipboard>
#include <QDockWidget>
#include <QElapsedTimer>
#include <QFileInfo>
#include <QImage>
#include <QMenu>
#include <QMenuBar>
#include <QMimeData>
#include <QSettings>
#include <QTextBlock>
#include <QTextBrowser>
#include <QToolButton>

#include <filesystem>

using namespace desktop_test;
using zql::lib::MMSGFunction;

namespace {

class Shell : public DesktopTest {
protected:
    ~Shell() override
    {
        ApplyTheme(THEME::Light);
        SetShownDecimals(kAsStored);
    }
    CStartPage& Start() { return m_main->Shell().Start(); }
    bool IsDocked() { return !m_main->findChild<QDockWidget*>("IDS_QM_UI_EXPLORER")->isHidden(); }
    static const CModelCard* CardOf(const CCardGrid& cards, const QString& place)
    {
        for (const CModelCard* card : cards.Cards())
            if (card->toolTip().contains(place)) return card;
        return nullptr;
    }
    /// The number of cards once they are made.
    std::size_t Cards(const CCardGrid& cards)
    {
        QElapsedTimer clock;
        constexpr int kMostMs = 10000;
        for (clock.start(); clock.elapsed() < kMostMs && Start().IsDrawing();)
            Settle();
        return cards.Cards().size();
    }
    int Darkness(QWidget& widget)
    {
        return 255 - widget.grab().toImage().pixelColor(3, widget.height() / 2).lightness();
    }
};

std::vector<QMenu*> MenusOf(const QMainWindow& window)
{
    std::vector<QMenu*> menus;
    for (const QAction* action : window.menuBar()->actions())
        menus.push_back(action->menu());
    return menus;
}

/// Shortcuts that tables, fields and windows take by themselves.
QStringList StandardKeys()
{
    QStringList keys;
    for (const auto key : {QKeySequence::Copy, QKeySequence::Paste, QKeySequence::Cut,
                           QKeySequence::SelectAll, QKeySequence::Cancel, QKeySequence::Delete,
                           QKeySequence::NextChild, QKeySequence::Find, QKeySequence::Close})
        keys << QKeySequence(key).toString();
    keys.removeAll(QString());
    return keys;
}

QString LetterOf(const QString& text)
{
    const qsizetype at = text.indexOf('&');
    return at < 0 ? QString() : text.mid(at + 1, 1).toLower();
}

} // namespace

TEST_F(Shell, EveryMenuHasWordsTipsAndKeysOfItsOwnInBothLanguages)
{
    for (const std::string language : {"en", "it"}) {
        m_main->SetLanguage(language);
        QStringList keys = StandardKeys(), bar;
        for (QMenu* menu : MenusOf(*m_main)) {
            emit menu->aboutToShow();
            bar << LetterOf(menu->title());
            QStringList letters;
            for (const QAction* action : menu->actions()) {
                if (action->isSeparator()) continue;
                const std::string key = action->objectName().toStdString();
                const std::string place = language + " " + key;
                EXPECT_FALSE(MMSGFunction::GetValueOf(language, key).empty()) << place;
                EXPECT_FALSE(MMSGFunction::GetValueOf(language, key + "_TIP").empty()) << place;
                EXPECT_FALSE(action->statusTip().isEmpty()) << place;
                if (!action->shortcut().isEmpty()) keys << action->shortcut().toString();
                letters << LetterOf(action->text());
            }
            EXPECT_FALSE(letters.contains(QString())) << menu->title().toStdString();
            EXPECT_EQ(0, letters.removeDuplicates()) << menu->title().toStdString();
        }
        EXPECT_FALSE(bar.contains(QString()));
        EXPECT_EQ(0, bar.removeDuplicates()) << language;
        const QStringList all = keys;
        EXPECT_EQ(0, keys.removeDuplicates()) << all.join(' ').toStdString();
    }
    m_main->SetLanguage("en");
}

TEST_F(Shell, MenusStandInTheOrderOfTheWork)
{
    QStringList titles;
    for (const QMenu* menu : MenusOf(*m_main))
        titles << menu->title().remove('&');
    QStringList wanted{"File",     "Edit",         "Model",   "Loads", "Analysis", "Hinges",
                       "Pushover", "Load factors", "Results", "View",  "Window",   "Help"};
    if (!titles.contains("Loads")) wanted.removeAll("Loads"); // of a tool that may be missing
    EXPECT_EQ(wanted, titles);
    const std::pair<const char*, const char*> places[] = {{"IDS_QM_UI_SECT_MENU", "Model"},
                                                          {"IDS_QM_UI_PUSH_STATES", "Results"},
                                                          {"IDS_QM_UI_MESSAGES", "Window"},
                                                          {"IDS_QM_UI_PREFERENCES", "Edit"}};
    for (const auto& [key, title] : places) {
        const auto menu = MenusOf(*m_main).at(static_cast<std::size_t>(titles.indexOf(title)));
        EXPECT_TRUE(menu->actions().contains(m_main->Action(key))) << key;
    }
}

TEST_F(Shell, AnExampleOpensAsACopyWhoseFileIsNeverWritten)
{
    ASSERT_TRUE(m_main->Shell().IsAtStart());
    EXPECT_FALSE(IsDocked());
    EXPECT_EQ(16U, Cards(Start().Examples())) << "folders of examples with a case.json";
    const CModelCard* card = CardOf(Start().Examples(), "first-steps");
    ASSERT_TRUE(card);
    Key(const_cast<CModelCard*>(card), Qt::Key_Return);
    Settle();
    EXPECT_FALSE(m_main->Shell().IsAtStart());
    EXPECT_TRUE(IsDocked());
    EXPECT_EQ(Model().nodes.size(), 4U); // three storeys on a base
    EXPECT_EQ("", m_main->Doc().Path());
    EXPECT_FALSE(m_main->windowTitle().contains('*'));
    const std::string before = ReadText(Example("first-steps").toStdString());
    AnswerFileName(File("mine.json"));
    Run("IDS_QM_UI_SAVE");
    EXPECT_TRUE(QFileInfo::exists(File("mine.json")));
    EXPECT_EQ(before, ReadText(Example("first-steps").toStdString()));
}

TEST_F(Shell, RecentFilesHaveTheirPictureAndThoseThatAreGoneCanBeRemoved)
{
    for (const char* name : {"kept.qmdb", "gone.qmdb"}) {
        ASSERT_TRUE(Open("truss-arch"));
        AnswerFileName(File(name));
        Run("IDS_QM_UI_SAVE_AS");
    }
    QFile::remove(File("gone.qmdb"));
    KeepThumbnail(File("kept.qmdb"), DrawThumbnail(m_main->Doc()));
    Run("IDS_QM_UI_START_PAGE");
    EXPECT_EQ(3U, Cards(Start().Recent())) << "an example and its two copies";
    const CModelCard* gone = CardOf(Start().Recent(), "gone.qmdb");
    EXPECT_FALSE(gone); // its tip is where it lay
    for (const CModelCard* card : Start().Recent().Cards())
        if (card->IsGone()) gone = card;
    ASSERT_TRUE(gone);
    Click(gone->RemoveButton());
    EXPECT_EQ(2U, Start().Recent().Cards().size());
    EXPECT_FALSE(QSettings().value("recent").toStringList().contains(File("gone.qmdb")));
    EXPECT_FALSE(KeptThumbnail(File("kept.qmdb")).isNull());
}

TEST_F(Shell, DroppedFilesAreOpenedAndATableIsToldFromAModel)
{
    QMimeData data;
    data.setUrls({QUrl::fromLocalFile(Example("tuned-beam"))});
    const auto drop = [&] {
        QDragEnterEvent enter({5, 5}, Qt::CopyAction, &data, Qt::LeftButton, Qt::NoModifier);
        QApplication::sendEvent(m_main.get(), &enter);
        if (!enter.isAccepted()) return false;
        QDropEvent event({5, 5}, Qt::CopyAction, &data, Qt::LeftButton, Qt::NoModifier);
        QApplication::sendEvent(m_main.get(), &event);
        Settle();
        return event.isAccepted();
    };
    EXPECT_TRUE(drop());
    EXPECT_FALSE(Model().nodes.empty());
    data.setUrls({QUrl::fromLocalFile("/x/picture.png")});
    EXPECT_FALSE(drop());
    if (m_main->Action((std::string("IDS_QM_") + "NEW_CURVE_MENU").c_str()))
        return; // the wizard takes tables
    data.setUrls({QUrl::fromLocalFile("/x/push.csv")});
    CAnswers answers({CAnswers::Accept()});
    EXPECT_TRUE(drop());
    EXPECT_TRUE(answers.m_texts.value(0).contains("push.csv"));
}

TEST_F(Shell, PreferencesHoldAtOnceAndAreKept)
{
    ASSERT_TRUE(Open("tuned-beam"));
    m_main->Explorer().Choose(EXPLORER_TABLE::Nodes);
    CGridView& nodes = m_main->Explorer().Table();
    const QString whole = nodes.Model().index(1, 1).data(Qt::EditRole).toString();
    EXPECT_LT(Darkness(m_main->Frame().View()), 5);
    CAnswers answers({CAnswers::Fill([](CDialogWindow& window) {
        ChooseIndex(Field(window, "language"), 1);
        ChooseIndex(Field(window, "theme"), 2);
        ChooseIndex(Field(window, "newForce"), 0); // N
        Enter(window, "decimals.2", "3");
        Enter(window, "autosave", "60");
    })});
    Run("IDS_QM_UI_PREFERENCES");
    EXPECT_EQ("it", MMSGFunction::GetLanguage());
    EXPECT_TRUE(IsDark());
    EXPECT_GT(Darkness(m_main->Frame().View()), 200);
    EXPECT_EQ(3, Cell(nodes.Model(), 1, 1).section('.', 1).size()) << "shown";
    EXPECT_EQ(whole, nodes.Model().index(1, 1).data(Qt::EditRole).toString()) << "edited";
    nodes.setCurrentIndex(nodes.Model().index(1, 1));
    EXPECT_EQ(whole, nodes.ChosenText()) << "copied";
    Run("IDS_QM_UI_NEW");
    EXPECT_EQ(FORCE_UNIT::N, m_main->Doc().Unit().Units().force);
    EXPECT_FALSE(m_main->Doc().Data().IsModified());
    m_main = std::make_unique<CMainWindow>(); // the next session
    EXPECT_TRUE(m_main->Action("IDS_QM_UI_SAVE")->text().contains("Salva"));
    m_main->SetLanguage("en");
}

TEST_F(Shell, F1OpensTheSectionOnTheWindowInUse)
{
    ASSERT_TRUE(Open("rc-frame-code-hinges"));
    CAnswers answers({CAnswers::Fill(
        [&](CDialogWindow& window) {
            Key(&window, Qt::Key_F1);
            CHelpWindow* help = m_main->Shell().Help();
            ASSERT_TRUE(help && help->isVisible());
            const QTextBlock at = help->Browser().textCursor().block();
            EXPECT_EQ("Hinges that a code gives", at.text());
        },
        true)});
    Run("IDS_QM_UI_GEN_MENU");
    EXPECT_FALSE(m_main->Shell().Help()) << "it went with the window that it stood over";
    Run("IDS_QM_UI_HELP");
    ASSERT_TRUE(m_main->Shell().Help());
    EXPECT_EQ("The desktop", m_main->Shell().Help()->Browser().textCursor().block().text());
}

TEST(HelpTopics, EveryTopicIsASectionOfTheGuide)
{
    for (const QString& topic : HelpTopics())
        EXPECT_FALSE(PageWith(topic).isEmpty()) << topic.toStdString();
    EXPECT_EQ("whats-this-r-and-x", AnchorOf("What's this: R and X?"));
}

TEST(Places, AWindowOffTheScreensComesBackOntoOne)
{
    const std::vector<QRect> screens{{0, 0, 1000, 800}, {1000, 0, 1920, 1080}};
    struct T_CASE {
        const char* name;
        QRect before, after;
    };
    const T_CASE cases[] = {
        {"stays", {100, 100, 400, 300}, {100, 100, 400, 300}},
        {"over two screens: the one with most of it", {900, 50, 400, 300}, {1000, 50, 400, 300}},
        {"right of all", {5000, 100, 400, 300}, {600, 100, 400, 300}},
        {"above", {10, -900, 400, 300}, {10, 0, 400, 300}},
        {"larger than the screen", {-50, 20, 1500, 900}, {0, 0, 1000, 800}},
    };
    for (const T_CASE& c : cases)
        EXPECT_EQ(c.after, OntoScreens(c.before, screens)) << c.name;
}

TEST_F(Shell, WindowsComeUpAsTheyWereLeft)
{
    const CWindowKeeper keeper(nullptr);
    ASSERT_TRUE(Open("rc-frame-code-hinges"));
    QSize left;
    CAnswers answers(
        {CAnswers::Fill([&](CDialogWindow& window) {
             window.resize(window.width() - 60, window.height() - 40);
             left = window.size();
         }),
         CAnswers::Fill([&](CDialogWindow& window) { EXPECT_EQ(left, window.size()); })});
    Run("IDS_QM_UI_HINGE_OPTIONS_CMD");
    Run("IDS_QM_UI_HINGE_OPTIONS_CMD");
}

TEST(Theme, LightnessTurnsOverAndHueStays)
{
    QImage image(3, 1, QImage::Format_RGB32);
    image.setPixel(0, 0, 0xffffffff);
    image.setPixel(1, 0, 0xff000000);
    image.setPixel(2, 0, 0xff0a3c8c); // dark blue
    const int hue = image.pixelColor(2, 0).hslHue();
    TurnLightness(image);
    EXPECT_LT(image.pixelColor(0, 0).lightness(), 40);
    EXPECT_EQ(255, image.pixelColor(1, 0).lightness());
    EXPECT_NEAR(hue, image.pixelColor(2, 0).hslHue(), 2);
    EXPECT_GT(image.pixelColor(2, 0).lightness(), 150);
}

namespace {

/// Counts how often a widget is painted.
class CPaints : public QObject {
public:
    explicit CPaints(QWidget& widget) { widget.installEventFilter(this); }
    bool eventFilter(QObject*, QEvent* event) override
    {
        m_count += event->type() == QEvent::Paint ? 1 : 0;
        return false;
    }
    int m_count = 0;
};

} // namespace

TEST_F(Shell, AChangeRepaintsTheFrameTwiceAtMost)
{
    ASSERT_TRUE(Open("space-frame-3d"));
    m_main->Explorer().Choose(EXPLORER_TABLE::Nodes);
    Settle();
    CPaints paints(m_main->Frame().View());
    ASSERT_TRUE(SetCell(m_main->Explorer().Table().Model(), 1, 1, "6.5"));
    Settle();
    EXPECT_GE(paints.m_count, 1);
    EXPECT_LE(paints.m_count, 2);
    EXPECT_TRUE(m_main->windowTitle().contains('*'));
    paints.m_count = 0;
    Run("IDS_QM_UI_UNDO");
    EXPECT_GE(paints.m_count, 1);
    EXPECT_LE(paints.m_count, 2);
    EXPECT_FALSE(m_main->windowTitle().contains('*')) << "as it was opened";
}

TEST_F(Shell, EscapeAndClosingAskWhereChangesWouldBeLost)
{
    ASSERT_TRUE(Open("rc-frame-code-hinges"));
    const auto step = [](std::function<void(CDialogWindow&)> act) {
        return CAnswers::Fill(std::move(act), false);
    };
    CAnswers answers({step([](CDialogWindow& window) { Key(&window, Qt::Key_Escape); }),
                      step([](CDialogWindow& window) {
                          Enter(window, "alpha1.pos", "0.25");
                          Key(&window, Qt::Key_Escape); // asked: no
                          EXPECT_TRUE(window.isVisible());
                          window.close(); // asked: yes
                          EXPECT_FALSE(window.isVisible());
                      }),
                      CAnswers::Press(QMessageBox::No), CAnswers::Press(QMessageBox::Yes)});
    Run("IDS_QM_UI_HINGE_OPTIONS_CMD"); // nothing typed: it closes at once
    Run("IDS_QM_UI_HINGE_OPTIONS_CMD");
    EXPECT_EQ(2, answers.m_texts.size());
}
