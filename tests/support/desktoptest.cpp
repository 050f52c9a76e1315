#include "desktoptest.h"

#include "qm_base/msgfunction.h"

#include <QAction>
#include <QApplication>
#include <QComboBox>
#include <QDialog>
#include <QDir>
#include <QKeyEvent>
#include <QLineEdit>
#include <QLocale>
#include <QMessageBox>
#include <QMouseEvent>
#include <QPointer>
#include <QProcess>
#include <QPushButton>
#include <QSettings>
#include <QStandardPaths>
#include <QTabWidget>
#include <QTimer>

#include <clocale>

namespace desktop_test {

QString Example(const char* name)
{
    return QStringLiteral(QM_PROJECT "/examples/%1/case.json").arg(name);
}

QByteArray Program(const QStringList& arguments)
{
    QProcess process;
    process.start(QM_RPS_PROGRAM, arguments);
    EXPECT_TRUE(process.waitForFinished());
    EXPECT_EQ(0, process.exitCode()) << process.readAllStandardError().toStdString();
    return process.readAllStandardOutput();
}

void Settle()
{
    for (int i = 0; i < 5; ++i)
        QApplication::processEvents();
}

void Key(QWidget* widget, int key, const QString& text, Qt::KeyboardModifiers with)
{
    QKeyEvent press(QEvent::KeyPress, key, with, text), release(QEvent::KeyRelease, key, with);
    QApplication::sendEvent(widget, &press);
    QApplication::sendEvent(widget, &release);
}

void Type(QWidget* field, const QString& text)
{
    auto* edit = qobject_cast<QLineEdit*>(field);
    ASSERT_NE(nullptr, edit);
    edit->setFocus();
    edit->selectAll();
    if (text.isEmpty())
        Key(edit, Qt::Key_Delete);
    else
        Key(edit, 0, text);
    Key(edit, Qt::Key_Tab);
}

void Click(QWidget* widget)
{
    const QPointF at = QRectF(widget->rect()).center();
    const QPointF global = widget->mapToGlobal(at);
    QMouseEvent press(QEvent::MouseButtonPress, at, global, Qt::LeftButton, Qt::LeftButton,
                      Qt::NoModifier);
    QMouseEvent release(QEvent::MouseButtonRelease, at, global, Qt::LeftButton, Qt::NoButton,
                        Qt::NoModifier);
    QApplication::sendEvent(widget, &press);
    QApplication::sendEvent(widget, &release);
}

void ChooseIndex(QWidget* box, int index)
{
    auto* list = qobject_cast<QComboBox*>(box);
    ASSERT_NE(nullptr, list);
    for (int i = list->currentIndex(); i != index; i += i < index ? 1 : -1)
        Key(list, i < index ? Qt::Key_Down : Qt::Key_Up);
}

QWidget* Field(CDialogWindow& window, const std::string& name)
{
    CFormField* field = window.Form().Find(name);
    EXPECT_NE(nullptr, field) << name;
    if (!field) return nullptr;
    for (QWidget* page = field->widget; page; page = page->parentWidget())
        if (QWidget* stack = page->parentWidget())
            if (auto* tabs = qobject_cast<QTabWidget*>(stack->parentWidget()))
                tabs->setCurrentWidget(page);
    return field->widget;
}

CGridView& Grid(CDialogWindow& window, const std::string& name)
{
    return dynamic_cast<CGridView&>(*Field(window, name));
}

bool IsMarked(CDialogWindow& window, const std::string& name)
{
    const CFormField* field = window.Form().Find(name);
    return field && field->IsMarked();
}

QString TextAt(CDialogWindow& window, const std::string& name)
{
    auto* edit = qobject_cast<QLineEdit*>(Field(window, name));
    return edit ? edit->text() : QString();
}

void Enter(CDialogWindow& window, const std::string& name, const QString& text)
{
    QWidget* field = Field(window, name);
    ASSERT_TRUE(field && field->isEnabled()) << name;
    QApplication::setActiveWindow(&window); // also after a message
    Type(field, text);
}

void Push(CDialogWindow& window, const std::string& name)
{
    QWidget* button = Field(window, name);
    ASSERT_TRUE(button && button->isEnabled()) << name;
    Key(button, Qt::Key_Space);
}

QString Cell(QAbstractItemModel& table, int row, int column)
{
    return table.index(row, column).data().toString();
}

bool SetCell(QAbstractItemModel& table, int row, int column, const QVariant& value)
{
    const bool flag = table.index(row, column).data(Qt::CheckStateRole).isValid();
    return table.setData(table.index(row, column), value, flag ? Qt::CheckStateRole : Qt::EditRole);
}

CAnswers::CAnswers(std::vector<STEP> steps) : m_steps(std::move(steps)), m_timer(new QTimer(this))
{
    connect(m_timer, &QTimer::timeout, this, [this] { Look(); });
    m_timer->start(1);
}

CAnswers::~CAnswers()
{
    EXPECT_EQ(0U, Left()) << "windows that did not come up";
}

void CAnswers::Look()
{
    QWidget* window = QApplication::activeModalWidget();
    if (!window || !window->isVisible() || window == m_at) return;
    if (auto* box = qobject_cast<QMessageBox*>(window)) m_texts << box->text();
    if (m_next < m_steps.size()) {
        // Later, so that the timer goes on to answer what comes up over the window meanwhile.
        QTimer::singleShot(0, this, [this, step = m_next++, before = m_at, at = QPointer(window)] {
            if (at) m_steps[step](*at);
            m_at = before;
        });
        m_at = window;
        return;
    }
    ADD_FAILURE() << "unexpected window: " << window->windowTitle().toStdString() << ": "
                  << (m_texts.isEmpty() ? std::string() : m_texts.back().toStdString());
    if (auto* dialog = qobject_cast<QDialog*>(window)) dialog->reject();
}

CAnswers::STEP CAnswers::Press(QMessageBox::StandardButton button)
{
    return [button](QWidget& window) {
        auto* box = qobject_cast<QMessageBox*>(&window);
        ASSERT_NE(nullptr, box);
        ASSERT_NE(nullptr, box->button(button));
        Click(box->button(button));
    };
}

CAnswers::STEP CAnswers::Accept()
{
    return [](QWidget& window) {
        if (auto* dialog = qobject_cast<QDialog*>(&window)) dialog->accept();
    };
}

CAnswers::STEP CAnswers::Reject()
{
    return [](QWidget& window) {
        if (auto* dialog = qobject_cast<QDialog*>(&window)) dialog->reject();
    };
}

CAnswers::STEP CAnswers::Fill(std::function<void(CDialogWindow&)> fill, bool accept)
{
    return [fill = std::move(fill), accept](QWidget& window) {
        auto* dialog = dynamic_cast<CDialogWindow*>(&window);
        ASSERT_NE(nullptr, dialog);
        QApplication::setActiveWindow(dialog); // a window over another one, too, has the keyboard
        fill(*dialog);
        if (accept) dialog->accept();
    };
}

DesktopTest::DesktopTest()
{
    const auto* info = testing::UnitTest::GetInstance()->current_test_info();
    m_folder = QDir::tempPath() + "/qm_desktop_" + info->test_suite_name() + "_" + info->name();
    QDir(m_folder).removeRecursively();
    QDir().mkpath(m_folder);
    QSettings::setDefaultFormat(QSettings::IniFormat);
    QSettings::setPath(QSettings::IniFormat, QSettings::UserScope, m_folder + "/settings");
    QStandardPaths::setTestModeEnabled(true);
    QLocale::setDefault(QLocale::c());
    (void)zql::lib::MMSGFunction::SetLanguage("en");
    m_main = std::make_unique<CMainWindow>();
    m_main->show();
    m_main->activateWindow();
    Settle();
}

DesktopTest::~DesktopTest()
{
    m_main.reset();
    QDir(m_folder).removeRecursively();
}

void DesktopTest::Run(const char* key)
{
    QAction* action = m_main->Action(key);
    ASSERT_NE(nullptr, action) << key;
    ASSERT_TRUE(action->isEnabled()) << key;
    action->trigger();
    Settle();
}

} // namespace desktop_test

int main(int argc, char** argv)
{
    qputenv("QT_QPA_PLATFORM", "offscreen");
    testing::InitGoogleTest(&argc, argv);
    QApplication app(argc, argv);
    std::setlocale(LC_NUMERIC, "C");
    QCoreApplication::setOrganizationName("qm-rps-tests");
    QCoreApplication::setApplicationName("qm-rps-desktop");
    return RUN_ALL_TESTS();
}
