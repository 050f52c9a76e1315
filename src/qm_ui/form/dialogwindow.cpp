#include "qm_ui/form/dialogwindow.h"

#include "qm_base/checkeddialog.h"
#include "qm_base/msgfunction.h"

#include <QCloseEvent>
#include <QDialogButtonBox>
#include <QKeyEvent>
#include <QPushButton>
#include <QScreen>
#include <QScrollArea>
#include <QVBoxLayout>

#include <algorithm>

namespace {

QString Text(const char* key)
{
    return QString::fromStdString(zql::lib::MMSGFunction::GetValue(key));
}

} // namespace

CDialogWindow::CDialogWindow(const CViewFactory& factory, const T_VIEW& view,
                             zql::frx::MDialog& model, QWidget* parent)
    : QDialog(parent), m_view(view), m_model(model), m_before(model.View()),
      m_dialogView(factory, this), m_form(new CFormView(this)), m_scroll(new QScrollArea(this)),
      m_buttons(new QDialogButtonBox(this))
{
    setWindowFlag(Qt::WindowMaximizeButtonHint);
    m_model.SetView(&m_dialogView);
    m_form->m_message = [this](const char* key) {
        m_dialogView.ShowMessage(key, zql::lib::MMSGFunction::GetValue(key));
    };
    if (auto* checked = dynamic_cast<CCheckedDialog*>(&model))
        m_form->SetFindings([checked] { return checked->Findings(); });
    m_view.build(*m_form, model);
    m_form->m_onChange = [this, before = m_form->m_onChange] {
        if (before) before();
        ShowTexts();
    };

    m_scroll->setWidget(m_form);
    m_scroll->setWidgetResizable(true);
    m_scroll->setFrameShape(QFrame::NoFrame);
    m_buttons->setStandardButtons(m_view.showsOnly
                                      ? QDialogButtonBox::StandardButtons(QDialogButtonBox::Close)
                                      : QDialogButtonBox::Ok | QDialogButtonBox::Cancel);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(m_scroll);
    layout->addWidget(m_buttons);
    connect(m_buttons, &QDialogButtonBox::accepted, this, &CDialogWindow::accept);
    connect(m_buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    m_form->Refresh();
    ShowTexts();
}

CDialogWindow::~CDialogWindow()
{
    m_form->m_onChange = nullptr; // the focus leaves the last field when the window goes
    m_model.SetView(m_before);
}

void CDialogWindow::accept()
{
    if (!m_form->Commit()) return;
    if (m_model.OnOK()) {
        QDialog::accept();
        return;
    }
    m_form->Refresh();
    m_form->ShowFirstMark();
}

void CDialogWindow::reject()
{
    if (!m_view.closes || m_view.closes(m_model)) QDialog::reject();
}

/// Cancel says what it does; Esc and the corner of the window are pressed by mistake.
bool CDialogWindow::MayDrop()
{
    if (m_view.showsOnly || !m_form->IsTouched()) return true;
    constexpr const char* kKey = "IDS_QM_UI_DROP_CHANGES";
    return m_dialogView.AskYesNo(kKey, zql::lib::MMSGFunction::GetValue(kKey));
}

/// Enter takes what is typed; a window without OK is not closed by it.
void CDialogWindow::keyPressEvent(QKeyEvent* event)
{
    const bool enter = event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter;
    if (enter && m_view.showsOnly && m_form->isAncestorOf(focusWidget())) return;
    if (event->matches(QKeySequence::Cancel) && !MayDrop()) return;
    QDialog::keyPressEvent(event);
}

void CDialogWindow::closeEvent(QCloseEvent* event)
{
    if (MayDrop())
        QDialog::closeEvent(event);
    else
        event->ignore();
}

void CDialogWindow::ShowTexts()
{
    setWindowTitle(m_view.title ? QString::fromStdString(m_view.title()) : QString());
    const auto name = [&](QDialogButtonBox::StandardButton which, const QString& text) {
        if (QPushButton* button = m_buttons->button(which)) button->setText(text);
    };
    name(QDialogButtonBox::Ok,
         m_view.accept ? QString::fromStdString(m_view.accept(m_model)) : Text("IDS_QM_UI_OK"));
    name(QDialogButtonBox::Cancel, Text("IDS_QM_UI_CANCEL"));
    name(QDialogButtonBox::Close, Text("IDS_QM_UI_CLOSE"));
}

void CDialogWindow::changeEvent(QEvent* event)
{
    QDialog::changeEvent(event);
    if (event->type() != QEvent::LanguageChange) return;
    ShowTexts();
    // The box of the buttons gets its own event after this one, and writes its own words.
    QMetaObject::invokeMethod(
        this, [this] { ShowTexts(); }, Qt::QueuedConnection);
}

/// What the form needs without scrolling, within nine tenths of the screen.
QSize CDialogWindow::WantedSize() const
{
    const QSize form = m_form->sizeHint();
    const int bar = m_scroll->verticalScrollBarPolicy() == Qt::ScrollBarAlwaysOff ? 0 : 24;
    const QSize need(form.width() + bar + 24, form.height() + m_buttons->sizeHint().height() + 36);
    const QSize most = screen()->availableSize() * 9 / 10;
    return need.expandedTo(m_view.size).boundedTo(most);
}

/// Right of the parent where there is room, else left of it, else at the screen's right edge.
void CDialogWindow::PutBeside()
{
    if (!parentWidget()) return;
    const QRect asks = parentWidget()->window()->frameGeometry();
    const QRect room = screen()->availableGeometry();
    const int right = asks.right() + 1, left = asks.left() - width();
    const int last = room.right() + 1 - width();
    const int x = right <= last ? right : left >= room.left() ? left : last;
    move(std::max(x, room.left()),
         std::clamp(asks.top(), room.top(), std::max(room.top(), room.bottom() + 1 - height())));
}

void CDialogWindow::showEvent(QShowEvent* event)
{
    if (!property(kPlacedProperty).toBool()) {
        resize(WantedSize());
        if (m_view.placement == PLACEMENT::Beside) PutBeside();
    }
    QDialog::showEvent(event);
}
