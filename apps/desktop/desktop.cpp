#include "desktop.h"

#include "qm_base/msgfunction.h"

#include <QCoreApplication>
#include <QFileDialog>
#include <QProgressDialog>

namespace {

QString& NextFileName()
{
    static QString next; // answers of a script, one at a time
    return next;
}

} // namespace

void AnswerFileName(const QString& path)
{
    NextFileName() = path;
}

QString AskFileName(QWidget* parent, bool save, const QString& title, const QString& filters)
{
    if (!NextFileName().isEmpty()) return std::exchange(NextFileName(), QString());
    return save ? QFileDialog::getSaveFileName(parent, title, QString(), filters)
                : QFileDialog::getOpenFileName(parent, title, QString(), filters);
}

int RunWithProgress(QWidget* parent, const QString& title,
                    const std::function<int(std::function<bool(std::size_t, std::size_t)>)>& work)
{
    constexpr int kParts = 1000, kWaitMs = 300;
    const auto cancel =
        QString::fromStdString(zql::lib::MMSGFunction::GetValue("IDS_QM_UI_CANCEL"));
    QProgressDialog window(title, cancel, 0, kParts, parent);
    window.setWindowModality(Qt::ApplicationModal);
    window.setMinimumDuration(kWaitMs);
    window.setValue(0);
    // The window comes up after a while; until then nothing else may be clicked either.
    struct T_DISABLED {
        explicit T_DISABLED(QWidget* of) : widget(of) { widget->setEnabled(false); }
        ~T_DISABLED() { widget->setEnabled(true); }
        T_DISABLED(const T_DISABLED&) = delete;
        T_DISABLED& operator=(const T_DISABLED&) = delete;
        QWidget* widget;
    } const disabled(parent);
    return work([&window](std::size_t done, std::size_t total) {
        const double part = total ? static_cast<double>(done) / static_cast<double>(total) : 0.0;
        window.setValue(static_cast<int>(part * (kParts - 1)));
        QCoreApplication::processEvents();
        return !window.wasCanceled();
    });
}
