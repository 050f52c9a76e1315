#include "pushoverwindow.h"

#include "windowpictures.h"

#include "qm_base/msgfunction.h"

#include <QEvent>
#include <QPushButton>
#include <QTimer>

#include <cassert>

namespace {

constexpr int kLookMs = 250; // between looks at the document
constexpr const char* kName = "pushover curve window";

QString Text(const char* key)
{
    return QString::fromStdString(zql::lib::MMSGFunction::GetValue(key));
}

} // namespace

CPushOverWindow::CPushOverWindow(T_DESKTOP& desktop, const T_VIEW& view, CPushOverCurveEdit& edit,
                                 QWidget* parent)
    : CDialogWindow(desktop.factory, view, edit, parent), m_edit(edit)
{
    setObjectName(QLatin1String(kName));
    setModal(false);
    // Enter takes a value; it does not press a button that happens to be there.
    for (QPushButton* button : findChildren<QPushButton*>())
        button->setAutoDefault(false);
    m_edit.m_changed = desktop.changed;
    m_edit.m_askPath = [this](const char* filterKey) {
        return AskFileName(this, true, windowTitle(), Text(filterKey)).toStdString();
    };
    m_edit.m_withProgress = [this](const CPushOverCurveEdit::PUSHING_FN& pushing) {
        (void)RunWithProgress(this, Text("IDS_QM_UI_PUSH_POINTS_TITLE"), [&](auto tell) {
            pushing([&](const T_PUSH_PROGRESS& p) { return tell(p.done, p.total); });
            return 1;
        });
    };
    auto* timer = new QTimer(this);
    connect(timer, &QTimer::timeout, this, [this] { LookAtDocument(); });
    timer->start(kLookMs);
}

std::unique_ptr<CPushOverWindow> CPushOverWindow::Make(T_DESKTOP& desktop, QWidget* parent)
{
    auto edit = std::make_unique<CPushOverCurveEdit>(desktop.doc);
    const T_VIEW* view = desktop.factory.Find(*edit);
    assert(view);
    std::unique_ptr<CPushOverWindow> window(new CPushOverWindow(desktop, *view, *edit, parent));
    (void)KeepWith(*window, std::move(edit));
    return window;
}

CPushOverWindow& CPushOverWindow::Show(T_DESKTOP& desktop)
{
    auto* window =
        dynamic_cast<CPushOverWindow*>(desktop.window->findChild<QWidget*>(QLatin1String(kName)));
    if (!window) {
        window = Make(desktop, desktop.window).release(); // the main window owns it
        window->setAttribute(Qt::WA_DeleteOnClose);
    }
    window->LookAtDocument();
    window->show();
    window->raise();
    window->activateWindow();
    return *window;
}

void CPushOverWindow::LookAtDocument()
{
    if (m_edit.OnDocumentChanged()) Form().Refresh();
}

void CPushOverWindow::changeEvent(QEvent* event)
{
    // Texts of the result are made by the evaluation.
    if (event->type() == QEvent::LanguageChange) m_edit.Update();
    CDialogWindow::changeEvent(event);
    if (event->type() == QEvent::ActivationChange && isActiveWindow()) LookAtDocument();
}
