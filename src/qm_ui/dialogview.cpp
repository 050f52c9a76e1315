#include "qm_ui/dialogview.h"

#include "qm_base/messagehistory.h"
#include "qm_base/msgfunction.h"
#include "qm_ui/dialogwindow.h"

#include <QCoreApplication>
#include <QEvent>
#include <QMessageBox>

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

bool CDialogView::AskYesNo(const std::string&, const std::string& text)
{
    QMessageBox box(QMessageBox::Question, Product(), QString::fromStdString(text),
                    QMessageBox::Yes | QMessageBox::No, m_parent);
    box.setTextFormat(Qt::PlainText);
    box.setDefaultButton(QMessageBox::No);
    return box.exec() == QMessageBox::Yes;
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
