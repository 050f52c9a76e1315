#include "qm_ui/pushover/pushoverfields.h"

#include "qm_ui/plot/plotwidget.h"

#include <QFontDatabase>
#include <QHBoxLayout>
#include <QPlainTextEdit>
#include <QSignalBlocker>
#include <QSlider>
#include <QSpinBox>

#include <algorithm>

namespace {

class CStepField : public CFormField {
public:
    CStepField(T_BINDING<int> binding, std::function<int()> most, ChangedFn changed,
               QWidget* parent)
        : m_binding(std::move(binding)), m_most(std::move(most)), m_changed(std::move(changed)),
          m_slider(new QSlider(Qt::Horizontal)), m_number(new QSpinBox)
    {
        widget = new QWidget(parent);
        auto* row = new QHBoxLayout(widget);
        row->setContentsMargins(0, 0, 0, 0);
        row->addWidget(m_slider, 1);
        row->addWidget(m_number);
        m_number->setKeyboardTracking(false);
        widget->setFocusProxy(m_number);
        QObject::connect(m_slider, &QSlider::valueChanged, widget, [this](int v) { Take(v); });
        QObject::connect(m_number, &QSpinBox::valueChanged, widget, [this](int v) { Take(v); });
    }
    void Show() override
    {
        const QSignalBlocker quietSlider(m_slider), quietNumber(m_number);
        const int most = m_most(), value = m_binding.get();
        m_slider->setRange(0, most);
        m_number->setRange(0, most);
        m_slider->setValue(value);
        m_number->setValue(value);
        widget->setEnabled(most > 0);
    }

private:
    void Take(int value)
    {
        m_binding.set(value);
        m_changed();
    }

    T_BINDING<int> m_binding;
    std::function<int()> m_most;
    ChangedFn m_changed;
    QSlider* m_slider;
    QSpinBox* m_number;
};

class CTextPage : public CFormField {
public:
    CTextPage(TextFn text, QWidget* parent)
        : m_text(std::move(text)), m_page(new QPlainTextEdit(parent))
    {
        widget = m_page;
        m_page->setReadOnly(true);
        m_page->setLineWrapMode(QPlainTextEdit::NoWrap);
        m_page->setFont(QFontDatabase::systemFont(QFontDatabase::FixedFont));
    }
    void Show() override
    {
        const QString text = QString::fromStdString(m_text());
        if (text != m_page->toPlainText()) m_page->setPlainText(text);
    }

private:
    TextFn m_text;
    QPlainTextEdit* m_page;
};

} // namespace

T_BINDING<int> NameRef(std::string& value, std::function<std::vector<std::string>()> names)
{
    return {[&value, names] {
                const auto list = names();
                const auto it = std::ranges::find(list, value);
                return it == list.end() ? -1 : static_cast<int>(it - list.begin());
            },
            [&value, names](const int& i) {
                const auto list = names();
                if (i >= 0 && i < static_cast<int>(list.size()))
                    value = list[static_cast<std::size_t>(i)];
            }};
}

std::unique_ptr<CFormField> MakeStepField(T_BINDING<int> binding, std::function<int()> most,
                                          ChangedFn changed, QWidget* parent)
{
    return std::make_unique<CStepField>(std::move(binding), std::move(most), std::move(changed),
                                        parent);
}

CFormField& AddPicture(CFormView& form, std::function<T_PLOT()> plot, const QSize& size)
{
    CFormField& field = form.Picture(std::move(plot));
    if (auto* widget = dynamic_cast<CPlotWidget*>(field.widget)) widget->SetSizeHint(size);
    return field;
}

std::unique_ptr<CFormField> MakeTextPage(TextFn text, QWidget* parent)
{
    return std::make_unique<CTextPage>(std::move(text), parent);
}
