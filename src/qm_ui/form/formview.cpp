#include "qm_ui/form/formview.h"

#include "qm_ui/form/formletters.h"
#include "qm_ui/form/gridview.h"

#include <QEvent>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QTabWidget>
#include <QVBoxLayout>

#include <algorithm>

namespace {

constexpr int kLabel = 0, kWidget = 1, kUnit = 2, kWidth = 3; // columns of a form's grid
constexpr const char* kStyle = "[finding=\"true\"] { border: 1px solid #c62828;"
                               " background-color: #fff1f0; color: #7f0000; }";

QString Plain(const TextFn& text)
{
    return text ? QString::fromStdString(text()) : QString();
}

/// Tables and pictures take the room that is left.
bool Grows(const QWidget* widget)
{
    return (widget->sizePolicy().verticalPolicy() & QSizePolicy::ExpandFlag) != 0;
}

class CGridField : public CFormField {
public:
    explicit CGridField(CGridView* view) : m_view(view) { widget = view; }
    void Show() override { m_view->Refresh(); }

private:
    CGridView* m_view;
};

} // namespace

CFormView::CFormView(QWidget* parent) : QWidget(parent)
{
    setStyleSheet(kStyle);
    m_boxes.push_back(NewBox(this));
}

/// Children outlive the fields and may still lose the focus then: nothing listens any more.
CFormView::~CFormView()
{
    for (const auto& field : m_fields)
        if (field->widget) field->widget->disconnect();
}

CFormView::T_BOX CFormView::NewBox(QWidget* host)
{
    T_BOX box;
    box.grid = new QGridLayout(host);
    box.grid->setColumnStretch(kWidget, 1);
    return box;
}

void CFormView::AddWide(QWidget* widget)
{
    T_BOX& box = m_boxes.back();
    box.grid->addWidget(widget, box.row, kLabel, 1, kWidth);
    box.grid->setRowStretch(box.row++, Grows(widget) ? 1 : 0);
}

void CFormView::Group(TextFn title)
{
    auto* group = new QGroupBox(this);
    AddWide(group);
    m_titles.push_back({std::move(title), [group](const QString& t) { group->setTitle(t); }});
    m_boxes.push_back(NewBox(group));
}

void CFormView::EndGroup()
{
    const bool grows = BoxGrows();
    m_boxes.pop_back();
    if (grows) LetGrow();
}

void CFormView::Columns(int stretch)
{
    auto* row = new QWidget(this);
    AddWide(row);
    T_BOX box;
    box.columns = new QHBoxLayout(row);
    box.columns->setContentsMargins(0, 0, 0, 0);
    m_boxes.push_back(box);
    m_boxes.push_back({});
    NextColumn(stretch);
}

/// Whether something in the innermost box takes the room that is left.
bool CFormView::BoxGrows() const
{
    const QGridLayout* const grid = m_boxes.back().grid;
    for (int row = 0; grid && row < grid->rowCount(); ++row)
        if (grid->rowStretch(row) > 0) return true;
    return false;
}

/// What holds a box that grows has to grow with it.
void CFormView::LetGrow()
{
    T_BOX& box = m_boxes.back();
    if (box.grid) box.grid->setRowStretch(box.row - 1, 1);
}

/// Fields stay together at the top where nothing grows.
void CFormView::CloseColumn()
{
    const bool grows = BoxGrows();
    if (QGridLayout* grid = m_boxes.back().grid; grid && !grows)
        grid->setRowStretch(m_boxes.back().row, 1);
    m_boxes.pop_back();
    m_boxes.back().grows = m_boxes.back().grows || grows;
}

void CFormView::NextColumn(int stretch)
{
    CloseColumn();
    auto* column = new QWidget(this);
    m_boxes.back().columns->addWidget(column, stretch);
    m_boxes.push_back(NewBox(column));
    m_boxes.back().grid->setContentsMargins(0, 0, 0, 0);
}

void CFormView::EndColumns()
{
    CloseColumn();
    const bool grows = m_boxes.back().grows;
    m_boxes.pop_back();
    if (grows) LetGrow();
}

void CFormView::Space()
{
    T_BOX& box = m_boxes.back();
    box.grid->setRowStretch(box.row++, 1);
}

void CFormView::Page(TextFn title, std::function<bool()> shown)
{
    if (!m_boxes.back().tabs && m_boxes.size() > 1 && m_boxes[m_boxes.size() - 2].tabs)
        CloseColumn(); // the page before
    if (!m_boxes.back().tabs) {
        auto* tabs = new QTabWidget(this);
        AddWide(tabs);
        T_BOX box;
        box.tabs = tabs;
        m_boxes.push_back(box);
    }
    QTabWidget* tabs = m_boxes.back().tabs;
    auto* page = new QWidget(tabs);
    tabs->addTab(page, QString());
    m_titles.push_back(
        {std::move(title),
         [tabs, page](const QString& t) { tabs->setTabText(tabs->indexOf(page), t); }, tabs, page,
         std::move(shown)});
    m_boxes.push_back(NewBox(page));
}

void CFormView::EndPages()
{
    CloseColumn();
    m_boxes.pop_back();
}

void CFormView::Cells(std::vector<TextFn> heads)
{
    auto* table = new QWidget(this);
    AddWide(table);
    T_BOX box = NewBox(table);
    box.grid->setContentsMargins(0, 0, 0, 0);
    for (TextFn& head : heads) {
        auto* label = new QLabel(table);
        box.grid->addWidget(label, 0, box.cells);
        box.grid->setColumnStretch(box.cells, box.cells > 0 ? 1 : 0);
        m_titles.push_back({std::move(head), [label](const QString& t) { label->setText(t); }});
        ++box.cells;
    }
    box.row = 1;
    m_boxes.push_back(box);
}

void CFormView::EndCells()
{
    m_boxes.pop_back();
}

CFormField& CFormView::Add(TextFn caption, std::unique_ptr<CFormField> field, const TextFn& unit)
{
    QWidget* const widget = field->widget;
    field->caption = std::move(caption);
    if (T_BOX& table = m_boxes.back(); table.cells > 0) {
        table.grid->addWidget(widget, table.row + table.cell / table.cells,
                              table.cell % table.cells);
        ++table.cell;
        widget->setAccessibleName(Plain(field->caption));
    } else if (!field->caption) {
        AddWide(widget);
    } else {
        T_BOX& box = m_boxes.back();
        field->label = new QLabel(this);
        field->label->setBuddy(widget);
        box.grid->addWidget(field->label, box.row, kLabel);
        box.grid->addWidget(widget, box.row, kWidget);
        if (unit) {
            auto* label = new QLabel(this);
            box.grid->addWidget(label, box.row, kUnit);
            field->unit = label;
            m_titles.push_back({unit, [label](const QString& t) { label->setText(t); }});
        }
        box.grid->setRowStretch(box.row++, Grows(widget) ? 1 : 0);
    }
    m_fields.push_back(std::move(field));
    return *m_fields.back();
}

ChangedFn CFormView::Changed(bool edits)
{
    return [this, edits] {
        if (m_refreshing) return;
        m_touched = m_touched || edits;
        if (m_onChange) m_onChange();
        Refresh();
    };
}

bool CFormView::IsTouched() const
{
    const bool changed = m_isChanged ? m_isChanged() : m_touched;
    return changed || std::ranges::any_of(findChildren<QLineEdit*>(), &QLineEdit::isModified);
}

CFormField& CFormView::Number(TextFn caption, T_BINDING<double> binding, TextFn unit)
{
    return Add(std::move(caption), MakeNumberField(std::move(binding), Changed(true), this), unit);
}

CFormField& CFormView::Optional(TextFn caption, T_BINDING<std::optional<double>> binding,
                                TextFn unit)
{
    return Add(std::move(caption), MakeOptionalField(std::move(binding), Changed(true), this),
               unit);
}

CFormField& CFormView::Integer(TextFn caption, T_BINDING<int> binding, TextFn unit)
{
    return Add(std::move(caption), MakeIntegerField(std::move(binding), Changed(true), this), unit);
}

CFormField& CFormView::Text(TextFn caption, T_BINDING<std::string> binding)
{
    ReadTextFn read = [set = binding.set](const QString& typed) {
        set(typed.toStdString());
        return QString();
    };
    if (!binding.set) read = nullptr;
    return Add(std::move(caption),
               MakeTextField([get = binding.get] { return QString::fromStdString(get()); },
                             std::move(read), Changed(true), this));
}

CFormField& CFormView::Choice(TextFn caption, T_BINDING<int> binding,
                              std::function<std::vector<std::string>()> texts)
{
    return Add(std::move(caption),
               MakeChoiceField(std::move(binding), std::move(texts), Changed(true), this));
}

CFormField& CFormView::Flag(TextFn caption, T_BINDING<bool> binding)
{
    return Add({}, MakeFlagField(std::move(binding), std::move(caption), Changed(true), this));
}

CFormField& CFormView::Note(TextFn text)
{
    return Add({}, MakeNote(std::move(text), this));
}

CFormField& CFormView::Button(TextFn caption, std::function<void()> pressed)
{
    return Add({}, MakeButton(std::move(caption), std::move(pressed), Changed(), this));
}

CFormField& CFormView::Picture(std::function<T_PLOT()> plot)
{
    return Add({}, MakePicture(std::move(plot), this));
}

CFormField& CFormView::Grid(T_GRID_BINDING binding)
{
    TellWhenTaken(binding, [this] { m_touched = true; });
    auto* view = new CGridView(std::move(binding), Changed(), this);
    view->m_refuse = [this](const char* key) {
        if (m_message) m_message(key);
    };
    return Add({}, std::make_unique<CGridField>(view));
}

CFormField& CFormView::Custom(TextFn caption, std::unique_ptr<CFormField> field)
{
    return Add(std::move(caption), std::move(field));
}

void CFormView::SetFindings(std::function<std::vector<T_FINDING>()> findings)
{
    m_findings = std::move(findings);
}

void CFormView::ShowTitles()
{
    for (const T_TITLE& title : m_titles) {
        title.show(Plain(title.text));
        if (title.page && title.shown)
            title.tabs->setTabVisible(title.tabs->indexOf(title.page), title.shown());
    }
}

/// A field is marked by the first finding that names it, or a part of it.
void CFormView::MarkFindings()
{
    const std::vector<T_FINDING> findings = m_findings ? m_findings() : std::vector<T_FINDING>();
    for (const auto& field : m_fields) {
        const auto names = [&](const T_FINDING& f) {
            return !field->name.empty() && f.field.starts_with(field->name);
        };
        const auto it = std::ranges::find_if(findings, names);
        field->Mark(it == findings.end() ? std::string() : it->text);
    }
}

void CFormView::Refresh()
{
    if (m_refreshing) return;
    m_refreshing = true;
    ShowTitles();
    for (const auto& field : m_fields) {
        field->ShowState();
        field->Show();
    }
    ShowLetters(m_fields);
    MarkFindings();
    m_refreshing = false;
}

bool CFormView::Commit()
{
    for (const auto& field : m_fields) {
        if (field->Commit()) continue;
        Reveal(field->widget);
        return false;
    }
    Refresh();
    return true;
}

void CFormView::Reveal(QWidget* widget)
{
    for (QWidget* at = widget; at && at != this; at = at->parentWidget())
        for (const T_TITLE& title : m_titles)
            if (title.page == at) title.tabs->setCurrentWidget(at);
    widget->setFocus();
}

void CFormView::ShowFirstMark()
{
    for (const auto& field : m_fields)
        if (field->IsMarked() && field->widget) return Reveal(field->widget);
}

int CFormView::Marks() const
{
    return static_cast<int>(
        std::ranges::count_if(m_fields, [](const auto& field) { return field->IsMarked(); }));
}

CFormField* CFormView::Find(const std::string& name)
{
    const auto it =
        std::ranges::find_if(m_fields, [&](const auto& field) { return field->name == name; });
    return it == m_fields.end() ? nullptr : it->get();
}

void CFormView::changeEvent(QEvent* event)
{
    QWidget::changeEvent(event);
    if (event->type() != QEvent::LanguageChange) return;
    for (const auto& field : m_fields)
        field->Retranslate();
    Refresh();
}
