#include "qm_ui/form/formletters.h"

#include "qm_rps/shell/letters.h"

#include <QAbstractButton>
#include <QLabel>
#include <QVariant>

namespace {

constexpr const char *kPlain = "plainText", *kLettered = "letteredText";

template <class WIDGET>
std::string PlainOf(const WIDGET& widget)
{
    const QVariant lettered = widget.property(kLettered);
    const bool isSame = lettered.isValid() && lettered.toString() == widget.text();
    return (isSame ? widget.property(kPlain).toString() : widget.text()).toStdString();
}

template <class WIDGET>
void Show(WIDGET& widget, const std::string& plain, const std::string& lettered)
{
    const QString text = QString::fromStdString(lettered);
    widget.setProperty(kPlain, QString::fromStdString(plain));
    widget.setProperty(kLettered, text);
    if (widget.text() != text) widget.setText(text);
}

/// Calls with the label or the button that carries the field's letter.
template <class F>
void VisitText(const CFormField& field, F visit)
{
    if (field.shown && !field.shown()) return;
    if (field.label)
        visit(*field.label);
    else if (auto* button = qobject_cast<QAbstractButton*>(field.widget))
        visit(*button);
}

} // namespace

void ShowLetters(const std::vector<std::unique_ptr<CFormField>>& fields)
{
    std::vector<std::string> plain;
    for (const auto& field : fields)
        VisitText(*field, [&](const auto& widget) { plain.push_back(PlainOf(widget)); });
    const std::vector<std::string> lettered = WithLetters(plain);
    std::size_t i = 0;
    for (const auto& field : fields)
        VisitText(*field, [&](auto& widget) {
            Show(widget, plain[i], lettered[i]);
            ++i;
        });
}

void ShowLabel(QLabel& label, const QString& text)
{
    if (QString::fromStdString(PlainOf(label)) != text) label.setText(text);
}
