#include "qm_ui/form/dialogview.h"

#include "qm_base/messagehistory.h"
#include "qm_base/msgfunction.h"
#include "qm_ui/form/dialogwindow.h"

#include <QCoreApplication>
#include <QEvent>
#include <QPushButton>

using zql::lib::MMSGFunction;

namespace {

QString Product()
{
    return QString::fromStdString(MMSGFunction::GetValue("IDS_QM_PRODUCT"));
}

/// While it lives, no window of the application closes.
class CCloseGuard : public QObject {
public:
    CCloseGuard() { QCoreApplication::instance()->installEventFilter(this); }

protected:
    bool eventFilter(QObject*, QEvent* event) override
    {
        if (event->type() != QEvent::Close) return false;
        event->ignore();
        return true;
    }
};

} // namespace

CDialogView::CDialogView(const CViewFactory& factory, QWidget* parent)
    : m_factory(factory), m_parent(parent)
{
}

void CDialogView::ShowMessage(const std::string&, const std::string& text)
{
    GSaveHistoryFormatNF("%s", text.c_str());
    QMessageBox box(QMessageBox::Warning, Product(), QString::fromStdString(text), QMessageBox::Ok,
                    m_parent);
    box.setTextFormat(Qt::PlainText);
    box.exec();
}

int CDialogView::Ask(const std::string& text, QMessageBox::StandardButtons buttons,
                     QMessageBox::StandardButton preset)
{
    QMessageBox box(QMessageBox::Question, Product(), QString::fromStdString(text), buttons,
                    m_parent);
    box.setTextFormat(Qt::PlainText);
    box.setDefaultButton(preset);
    const std::pair<QMessageBox::StandardButton, const char*> names[] = {
        {QMessageBox::Yes, "IDS_QM_UI_YES"},
        {QMessageBox::No, "IDS_QM_UI_NO"},
        {QMessageBox::Cancel, "IDS_QM_UI_CANCEL"}};
    for (const auto& [which, key] : names)
        if (QAbstractButton* button = box.button(which))
            button->setText(QString::fromStdString(MMSGFunction::GetValue(key)));
    return box.exec();
}

bool CDialogView::AskYesNo(const std::string&, const std::string& text)
{
    return Ask(text, QMessageBox::Yes | QMessageBox::No, QMessageBox::No) == QMessageBox::Yes;
}

zql::frx::ANSWER CDialogView::AskYesNoCancel(const std::string&, const std::string& text)
{
    const int answer =
        Ask(text, QMessageBox::Yes | QMessageBox::No | QMessageBox::Cancel, QMessageBox::Yes);
    return answer == QMessageBox::Yes  ? zql::frx::ANSWER::Yes
           : answer == QMessageBox::No ? zql::frx::ANSWER::No
                                       : zql::frx::ANSWER::Cancel;
}

int CDialogView::RunModal(zql::frx::MDialog& child)
{
    const T_VIEW* const view = m_factory.Find(child);
    if (!view) {
        ShowMessage("IDS_QM_UI_NO_VIEW", MMSGFunction::GetValue("IDS_QM_UI_NO_VIEW"));
        return 0;
    }
    CDialogWindow window(m_factory, *view, child, m_parent);
    return window.exec() == QDialog::Accepted ? 1 : 0;
}

void CDialogView::DispatchEvents()
{
    const CCloseGuard guard;
    QCoreApplication::processEvents();
}
