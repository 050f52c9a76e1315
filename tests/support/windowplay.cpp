#include "windowplay.h"

#include "qm_ui/plot/plotwidget.h"

#include <QApplication>
#include <QLabel>
#include <QProgressDialog>
#include <QPushButton>

#include <algorithm>
#include <utility>

namespace desktop_test {

void Later(QWidget* widget, std::function<void()> act)
{
    QMetaObject::invokeMethod(widget, std::move(act), Qt::QueuedConnection);
}

CPlay::CPlay(std::vector<T_SCENE> scenes) : m_scenes(std::move(scenes))
{
    connect(&m_timer, &QTimer::timeout, this, [this] { Look(); });
    m_timer.start(1);
    m_clock.start();
}

CPlay::~CPlay()
{
    EXPECT_EQ(m_scenes.size(), m_next) << "scenes that were not played";
}

void CPlay::Look()
{
    QWidget* window = QApplication::activeModalWidget();
    if (m_pending || !window || window == m_acting || !window->isVisible()) return;
    if (qobject_cast<QProgressDialog*>(window)) return; // goes by itself
    if (auto* box = qobject_cast<QMessageBox*>(window)) return Answer(*box);
    auto* dialog = dynamic_cast<CDialogWindow*>(window);
    constexpr int kMostMs = 60000;
    if (m_next >= m_scenes.size() || m_clock.elapsed() > kMostMs) {
        ADD_FAILURE() << "unexpected: " << window->windowTitle().toStdString();
        if (auto* any = qobject_cast<QDialog*>(window)) Later(any, [any] { any->reject(); });
        return;
    }
    const T_SCENE& scene = m_scenes[m_next];
    if (!dialog || dialog->windowTitle() != scene.title) return;
    if (scene.ready && !scene.ready(*dialog)) return;
    if (!dialog->isActiveWindow()) return dialog->activateWindow(); // after a box
    ++m_next;
    m_pending = true; // windows that the act opens have their own loop
    Later(dialog, [this, dialog, act = scene.act] {
        m_pending = false;
        const QWidget* const before = std::exchange(m_acting, dialog);
        act(*dialog);
        m_acting = before;
    });
}

void CPlay::Answer(QMessageBox& box)
{
    if (m_box != &box) m_texts << box.text(); // a click before the box is laid out misses
    m_box = &box;
    QAbstractButton* button = box.button(m_answer);
    Click(button ? button : box.button(QMessageBox::Ok));
}

ACT Press(const char* key)
{
    return [key](CDialogWindow& w) {
        auto* button = w.findChild<QPushButton*>(QLatin1String(key));
        ASSERT_NE(nullptr, button) << key;
        ASSERT_TRUE(button->isEnabled()) << key;
        Click(button);
    };
}

void Cancel(CDialogWindow& w)
{
    w.reject();
}

QAbstractItemModel& Table(CDialogWindow& w, int index)
{
    return w.findChildren<CGridView*>().at(index)->Model();
}

// The class has no meta object of its own to be found by.
const T_PLOT& Picture(CDialogWindow& w)
{
    static const T_PLOT none;
    for (QWidget* widget : w.findChildren<QWidget*>())
        if (auto* plot = dynamic_cast<CPlotWidget*>(widget)) return plot->Plot();
    return none;
}

bool Says(CDialogWindow& w, const QString& text)
{
    return std::ranges::any_of(w.findChildren<QLabel*>(),
                               [&](const QLabel* label) { return label->text().contains(text); });
}

void ChooseRow(CDialogWindow& w, int row)
{
    auto* view = w.findChildren<CGridView*>().at(0);
    view->setCurrentIndex(view->Model().index(row, 0));
}

} // namespace desktop_test
