#include "qm_ui/form/formfield.h"

#include "qm_ui/form/formletters.h"

#include <QLabel>
#include <QStyle>
#include <QVariant>
#include <QWidget>

void CFormField::Mark(const std::string& text)
{
    m_finding = QString::fromStdString(text);
    ShowMark();
}

void CFormField::SetFault(const QString& fault)
{
    m_fault = fault;
    ShowMark();
}

void CFormField::ShowMark()
{
    const QString text = m_fault.isEmpty() ? m_finding : m_fault;
    m_marked = !text.isEmpty();
    if (!widget) return;
    widget->setToolTip(text);
    widget->setAccessibleDescription(text);
    if (widget->property("finding").toBool() == m_marked) return;
    widget->setProperty("finding", m_marked);
    widget->style()->unpolish(widget);
    widget->style()->polish(widget);
    widget->update();
}

void CFormField::ShowState()
{
    const bool on = !shown || shown();
    const bool usable = !enabled || enabled();
    if (label) {
        ShowLabel(*label, caption ? QString::fromStdString(caption()) : QString());
        label->setVisible(on);
        label->setEnabled(usable);
    }
    if (unit) unit->setVisible(on);
    if (!widget) return;
    widget->setVisible(on);
    widget->setEnabled(usable);
}
