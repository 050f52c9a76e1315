#include "pushoverwindow.h"

#include "windowpictures.h"

#include "qm_base/msgfunction.h"

#include <QApplication>
#include <QEvent>
#include <QLineEdit>
#include <QPushButton>
#include <QSettings>
#include <QTimer>

#include <cassert>

namespace {

constexpr int kLookMs = 250;   // between looks at the document
constexpr int kTypingMs = 400; // after the last key, until what is typed is evaluated
constexpr const char* kName = "pushover curve window";

QString Text(const char* key)
{
    return QString::fromStdString(zql::lib::MMSGFunction::GetValue(key));
}

// ---- how the picture is seen is kept with the person's settings, not with the model ----------

struct T_KEPT_END {
    const char* key;
    std::optional<double> T_DESK_AXES::*end;
};
constexpr T_KEPT_END kEnds[] = {{"evaluation/xFrom", &T_DESK_AXES::xFrom},
                                {"evaluation/xTo", &T_DESK_AXES::xTo},
                                {"evaluation/yFrom", &T_DESK_AXES::yFrom},
                                {"evaluation/yTo", &T_DESK_AXES::yTo}};
constexpr const char *kLength = "evaluation/length", *kForce = "evaluation/force",
                     *kWhole = "evaluation/whole";

void Keep(const char* key, const std::optional<double>& value)
{
    if (value)
        QSettings().setValue(key, *value);
    else
        QSettings().remove(key);
}

template <class UNIT>
std::optional<double> NumberOf(const std::optional<UNIT>& unit)
{
    return unit ? std::optional(static_cast<double>(*unit)) : std::nullopt;
}

std::optional<double> Kept(const char* key)
{
    bool isNumber = false;
    const double value = QSettings().value(key).toDouble(&isNumber);
    return isNumber && std::isfinite(value) ? std::optional(value) : std::nullopt;
}

/// A unit of an older or newer program that this one does not know is left out.
template <class UNIT>
std::optional<UNIT> KeptUnit(const char* key, UNIT last)
{
    const std::optional<double> value = Kept(key);
    if (!value || *value < 0.0 || *value > static_cast<double>(last)) return std::nullopt;
    return static_cast<UNIT>(static_cast<int>(*value));
}

void KeepAxes(const T_DESK_AXES& axes)
{
    for (const T_KEPT_END& end : kEnds)
        Keep(end.key, axes.*end.end);
    Keep(kLength, NumberOf(axes.length));
    Keep(kForce, NumberOf(axes.force));
    QSettings().setValue(kWhole, axes.whole);
}

T_DESK_AXES KeptAxes()
{
    T_DESK_AXES axes;
    for (const T_KEPT_END& end : kEnds)
        axes.*end.end = Kept(end.key);
    axes.length = KeptUnit(kLength, LENGTH_UNIT::ft);
    axes.force = KeptUnit(kForce, FORCE_UNIT::kips);
    axes.whole = QSettings().value(kWhole, false).toBool();
    return axes;
}

} // namespace

CPushOverWindow::CPushOverWindow(T_DESKTOP& desktop, const T_VIEW& view, CEvaluationDeskDlg& desk,
                                 QWidget* parent)
    : CDialogWindow(desktop.factory, view, desk, parent), m_desk(desk), m_typing(new QTimer(this))
{
    setObjectName(QLatin1String(kName));
    setModal(false);
    // Enter takes a value; it does not press a button that happens to be there.
    for (QPushButton* button : findChildren<QPushButton*>())
        button->setAutoDefault(false);
    m_desk.m_changed = desktop.changed;
    m_desk.m_askPath = [this](const char* filterKey) {
        return AskFileName(this, true, windowTitle(), Text(filterKey)).toStdString();
    };
    m_desk.m_axes = KeptAxes();
    m_desk.m_withProgress = [this](const CPushOverCurveEdit::PUSHING_FN& pushing) {
        (void)RunWithProgress(this, Text("IDS_QM_UI_PUSH_POINTS_TITLE"), [&](auto tell) {
            pushing([&](const T_PUSH_PROGRESS& p) { return tell(p.done, p.total); });
            return 1;
        });
    };
    m_typing->setSingleShot(true);
    m_typing->setInterval(kTypingMs);
    connect(m_typing, &QTimer::timeout, this, &CPushOverWindow::TakeTyped);
    for (QLineEdit* edit : Form().findChildren<QLineEdit*>())
        connect(edit, &QLineEdit::textEdited, m_typing, qOverload<>(&QTimer::start));
    Form().Refresh();
    auto* timer = new QTimer(this);
    connect(timer, &QTimer::timeout, this, [this] { LookAtDocument(); });
    timer->start(kLookMs);
}

std::unique_ptr<CPushOverWindow> CPushOverWindow::Make(T_DESKTOP& desktop, QWidget* parent)
{
    auto desk = std::make_unique<CEvaluationDeskDlg>(desktop.doc);
    const T_VIEW* view = desktop.factory.Find(*desk);
    assert(view);
    std::unique_ptr<CPushOverWindow> window(new CPushOverWindow(desktop, *view, *desk, parent));
    (void)KeepWith(*window, std::move(desk));
    return window;
}

CPushOverWindow::~CPushOverWindow()
{
    KeepAxes(m_desk.m_axes);
}

bool CPushOverWindow::MayLeave(const QWidget& mainWindow)
{
    auto* window =
        dynamic_cast<CPushOverWindow*>(mainWindow.findChild<QWidget*>(QLatin1String(kName)));
    return !window || !window->isVisible() || !window->m_desk.HasUnsaved() || window->close();
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
    if (m_desk.Follow()) Form().Refresh();
}

/// Evaluates what is being typed without keeping it; the person goes on typing where he was.
void CPushOverWindow::TakeTyped()
{
    auto* const edit = qobject_cast<QLineEdit*>(QApplication::focusWidget());
    if (!edit || !isAncestorOf(edit) || !edit->isModified()) return;
    const QString typed = edit->text();
    const int place = edit->cursorPosition();
    const bool read = Form().Commit();
    if (read) m_desk.OnEdited();
    if (edit->text() != typed) edit->setText(typed);
    edit->setModified(true); // it is kept when the field is left
    edit->setCursorPosition(place);
    if (read) Form().Refresh();
}

void CPushOverWindow::reject()
{
    if (Form().Commit())
        m_desk.OnTaken();
    else if (!m_desk.OnDropTyped())
        return;
    CDialogWindow::reject();
}

void CPushOverWindow::changeEvent(QEvent* event)
{
    // Texts of the result are made by the evaluation.
    if (event->type() == QEvent::LanguageChange) m_desk.Update();
    CDialogWindow::changeEvent(event);
    if (event->type() == QEvent::ActivationChange && isActiveWindow()) LookAtDocument();
}
