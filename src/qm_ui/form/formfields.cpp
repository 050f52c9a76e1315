#include "qm_ui/form/formfields.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_ui/form/localnumber.h"
#include "qm_ui/plot/plotwidget.h"

#include <QCheckBox>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSignalBlocker>

#include <array>
#include <charconv>
#include <cmath>

namespace {

using zql::lib::MMSGFunction;

QString Fault(const char* key)
{
    return QString::fromStdString(MMSGFunction::GetValue(key));
}

/// All digits, and no exponent where a person would not write one.
QString NumberText(double value)
{
    constexpr double kLeast = 1e-4, kMost = 1e9;
    const double size = std::fabs(value);
    if (!(size >= kLeast && size < kMost)) return LocalNumberText(ShortestText(value));
    std::array<char, 32> buffer; // at most 17 digits, a sign, a point and 4 zeros before them
    const auto end = std::to_chars(buffer.data(), buffer.data() + buffer.size(), value,
                                   std::chars_format::fixed);
    return LocalNumberText({buffer.data(), end.ptr});
}

class CTextField : public CFormField {
public:
    CTextField(std::function<QString()> text, ReadTextFn read, const ChangedFn& changed,
               QWidget* parent)
        : m_text(std::move(text)), m_read(std::move(read)), m_edit(new QLineEdit(parent))
    {
        widget = m_edit;
        m_edit->setReadOnly(!m_read);
        QObject::connect(m_edit, &QLineEdit::editingFinished, [this, changed] {
            if (Commit()) changed();
        });
    }
    void Show() override
    {
        if (m_edit->isModified()) return; // typed and not taken yet
        m_edit->setText(m_text());
        m_edit->setCursorPosition(0);
    }
    /// What is shown and was not touched is not read: digits that a text lacks are not lost.
    bool Commit() override
    {
        if (!m_edit->isModified() || !m_read) return true;
        const QString fault = m_edit->text() == m_text() ? QString() : m_read(m_edit->text());
        SetFault(fault);
        if (!fault.isEmpty()) return false;
        m_edit->setModified(false);
        Show();
        return true;
    }

private:
    std::function<QString()> m_text;
    ReadTextFn m_read;
    QLineEdit* m_edit;
};

class CChoiceField : public CFormField {
public:
    CChoiceField(T_BINDING<int> binding, std::function<std::vector<std::string>()> texts,
                 const ChangedFn& changed, QWidget* parent)
        : m_binding(std::move(binding)), m_texts(std::move(texts)), m_box(new QComboBox(parent))
    {
        widget = m_box;
        QObject::connect(m_box, &QComboBox::activated, [this, changed](int index) {
            m_binding.set(index);
            changed();
        });
    }
    void Show() override
    {
        const QSignalBlocker quiet(m_box);
        if (const std::vector<std::string> texts = m_texts(); texts != m_shown) ShowTexts(texts);
        const int index = m_binding.get();
        m_box->setCurrentIndex(index < m_box->count() ? index : -1);
    }

private:
    void ShowTexts(const std::vector<std::string>& texts)
    {
        m_shown = texts;
        while (m_box->count() > static_cast<int>(texts.size()))
            m_box->removeItem(m_box->count() - 1);
        for (int i = 0; i < static_cast<int>(texts.size()); ++i) {
            const QString text = QString::fromStdString(texts[static_cast<std::size_t>(i)]);
            if (i < m_box->count())
                m_box->setItemText(i, text);
            else
                m_box->addItem(text);
        }
        // Changing the policy measures the texts anew. It must not stay at AdjustToContents, which
        // resizes the box 20 ms after each change, past the layout that has placed it.
        m_box->setSizeAdjustPolicy(QComboBox::AdjustToContents);
        m_box->setSizeAdjustPolicy(QComboBox::AdjustToContentsOnFirstShow);
    }

    T_BINDING<int> m_binding;
    std::function<std::vector<std::string>()> m_texts;
    std::vector<std::string> m_shown;
    QComboBox* m_box;
};

class CFlagField : public CFormField {
public:
    CFlagField(T_BINDING<bool> binding, TextFn text, const ChangedFn& changed, QWidget* parent)
        : m_binding(std::move(binding)), m_text(std::move(text)), m_box(new QCheckBox(parent))
    {
        widget = m_box;
        QObject::connect(m_box, &QCheckBox::clicked, [this, changed](bool on) {
            m_binding.set(on);
            changed();
        });
        Retranslate();
    }
    void Show() override
    {
        const QSignalBlocker quiet(m_box);
        m_box->setChecked(m_binding.get());
    }
    void Retranslate() override { m_box->setText(QString::fromStdString(m_text())); }

private:
    T_BINDING<bool> m_binding;
    TextFn m_text;
    QCheckBox* m_box;
};

class CNote : public CFormField {
public:
    CNote(TextFn text, QWidget* parent) : m_text(std::move(text)), m_label(new QLabel(parent))
    {
        widget = m_label;
        m_label->setWordWrap(true);
        m_label->setTextFormat(Qt::PlainText);
        m_label->setTextInteractionFlags(Qt::TextSelectableByMouse);
    }
    void Show() override { m_label->setText(QString::fromStdString(m_text())); }

private:
    TextFn m_text;
    QLabel* m_label;
};

class CButton : public CFormField {
public:
    CButton(TextFn text, std::function<void()> pressed, const ChangedFn& changed, QWidget* parent)
        : m_text(std::move(text)), m_button(new QPushButton(parent))
    {
        widget = m_button;
        m_button->setAutoDefault(false);
        QObject::connect(m_button, &QPushButton::clicked, [pressed = std::move(pressed), changed] {
            pressed();
            changed();
        });
        Retranslate();
    }
    void Show() override {}
    void Retranslate() override { m_button->setText(QString::fromStdString(m_text())); }

private:
    TextFn m_text;
    QPushButton* m_button;
};

class CPicture : public CFormField {
public:
    CPicture(std::function<T_PLOT()> plot, QWidget* parent)
        : m_plot(std::move(plot)), m_view(new CPlotWidget(parent))
    {
        widget = m_view;
    }
    /// A part that the person has zoomed to stays.
    void Show() override { m_view->UpdatePlot(m_plot()); }

private:
    std::function<T_PLOT()> m_plot;
    CPlotWidget* m_view;
};

} // namespace

std::unique_ptr<CFormField> MakeTextField(std::function<QString()> text, ReadTextFn read,
                                          ChangedFn changed, QWidget* parent)
{
    return std::make_unique<CTextField>(std::move(text), std::move(read), changed, parent);
}

std::unique_ptr<CFormField> MakeNumberField(T_BINDING<double> b, ChangedFn changed, QWidget* parent)
{
    ReadTextFn read = [set = b.set](const QString& typed) {
        const std::optional<double> number = ParseLocalNumber(typed);
        if (number) set(*number);
        return number ? QString() : Fault("IDS_QM_UI_NOT_A_NUMBER");
    };
    if (!b.set) read = nullptr;
    return MakeTextField([get = b.get] { return NumberText(get()); }, std::move(read),
                         std::move(changed), parent);
}

std::unique_ptr<CFormField> MakeOptionalField(T_BINDING<std::optional<double>> b, ChangedFn changed,
                                              QWidget* parent)
{
    ReadTextFn read = [set = b.set](const QString& typed) {
        const bool none = typed.trimmed().isEmpty();
        const std::optional<double> number = ParseLocalNumber(typed);
        if (none || number) set(none ? std::nullopt : number);
        return none || number ? QString() : Fault("IDS_QM_UI_NOT_A_NUMBER");
    };
    if (!b.set) read = nullptr;
    return MakeTextField(
        [get = b.get] {
            const std::optional<double> value = get();
            return value ? NumberText(*value) : QString();
        },
        std::move(read), std::move(changed), parent);
}

std::unique_ptr<CFormField> MakeIntegerField(T_BINDING<int> b, ChangedFn changed, QWidget* parent)
{
    ReadTextFn read = [set = b.set](const QString& typed) {
        bool whole = false;
        const int number = typed.trimmed().toInt(&whole);
        if (whole) set(number);
        return whole ? QString() : Fault("IDS_QM_UI_NOT_WHOLE");
    };
    if (!b.set) read = nullptr;
    return MakeTextField([get = b.get] { return QString::number(get()); }, std::move(read),
                         std::move(changed), parent);
}

std::unique_ptr<CFormField> MakeChoiceField(T_BINDING<int> binding,
                                            std::function<std::vector<std::string>()> texts,
                                            ChangedFn changed, QWidget* parent)
{
    return std::make_unique<CChoiceField>(std::move(binding), std::move(texts), changed, parent);
}

std::unique_ptr<CFormField> MakeFlagField(T_BINDING<bool> binding, TextFn caption,
                                          ChangedFn changed, QWidget* parent)
{
    return std::make_unique<CFlagField>(std::move(binding), std::move(caption), changed, parent);
}

std::unique_ptr<CFormField> MakeNote(TextFn text, QWidget* parent)
{
    return std::make_unique<CNote>(std::move(text), parent);
}

std::unique_ptr<CFormField> MakeButton(TextFn caption, std::function<void()> pressed,
                                       ChangedFn changed, QWidget* parent)
{
    return std::make_unique<CButton>(std::move(caption), std::move(pressed), changed, parent);
}

std::unique_ptr<CFormField> MakePicture(std::function<T_PLOT()> plot, QWidget* parent)
{
    return std::make_unique<CPicture>(std::move(plot), parent);
}
