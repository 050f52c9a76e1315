#include "qm_ui/create/createfields.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"

#include <QFont>
#include <QPlainTextEdit>
#include <QSignalBlocker>

#include <algorithm>
#include <array>

namespace {

using EDIT = CSpectrumEdit;

class CPasteField : public CFormField {
public:
    CPasteField(T_BINDING<std::string> binding, ChangedFn changed, QWidget* parent)
        : m_binding(std::move(binding)), m_edit(new QPlainTextEdit(parent))
    {
        widget = m_edit;
        m_edit->setLineWrapMode(QPlainTextEdit::NoWrap);
        m_edit->setTabChangesFocus(true); // Tab leaves the field; pasted tabs stay
        QFont font("monospace");
        font.setStyleHint(QFont::Monospace);
        m_edit->setFont(font);
        QObject::connect(m_edit, &QPlainTextEdit::textChanged,
                         [this, changed = std::move(changed)] {
                             m_binding.set(m_edit->toPlainText().toStdString());
                             changed();
                         });
    }
    void Show() override
    {
        const QString text = QString::fromStdString(m_binding.get());
        if (text == m_edit->toPlainText()) return;
        const QSignalBlocker quiet(m_edit);
        m_edit->setPlainText(text);
    }

private:
    T_BINDING<std::string> m_binding;
    QPlainTextEdit* m_edit;
};

/// What adds fields that are shown for some kinds alone.
struct T_PLACE {
    CFormView& form;
    EDIT& edit;
    std::function<void()> tell;

    CFormField& Number(const char* key, double& value, const char* name,
                       std::initializer_list<int> kinds)
    {
        return Shown(form.Number(KeyText(key), Told(value, tell)), name, kinds);
    }
    CFormField& Optional(const char* key, std::optional<double>& value, const char* name,
                         std::initializer_list<int> kinds)
    {
        return Shown(form.Optional(KeyText(key), Told(value, tell)), name, kinds);
    }
    CFormField& Shown(CFormField& field, const char* name, std::initializer_list<int> kinds)
    {
        field.name = name;
        field.shown = [this_ = &edit, all = std::vector(kinds)] {
            return std::ranges::find(all, this_->m_kind) != all.end();
        };
        return field;
    }
};

void AddAtc(T_PLACE& at)
{
    EDIT& e = at.edit;
    at.Number("IDS_QM_NEW_CA", e.m_atc40.Ca, "Ca", {EDIT::Atc40});
    at.Number("IDS_QM_NEW_CV", e.m_atc40.Cv, "Cv", {EDIT::Atc40});
    at.Shown(at.form.Number(KeyText("IDS_QM_NEW_SXS"), {[&e] { return e.Sxs(); },
                                                        [&e, tell = at.tell](const double& v) {
                                                            e.OnSxs(v);
                                                            tell();
                                                        }}),
             "SXS", {EDIT::Atc40});
    at.Shown(at.form.Note(KeyText("IDS_QM_NEW_ATC_NOTE")), "atcNote", {EDIT::Atc40});
}

void AddSoil(T_PLACE& at)
{
    EDIT& e = at.edit;
    at.Shown(at.form.Choice(KeyText("IDS_QM_NEW_TYPE"),
                            {[&e] { return e.m_ec8.type - 1; },
                             [&e, tell = at.tell](const int& i) {
                                 e.m_ec8.type = i + 1;
                                 tell();
                             }},
                            [] {
                                return std::vector<std::string>{"1", "2"};
                            }),
             "type", {EDIT::Ec8});
    at.Shown(at.form.Choice(KeyText("IDS_QM_NEW_SOIL"),
                            {[&e] { return e.Soil(); },
                             [&e, tell = at.tell](const int& i) {
                                 e.OnSoil(i);
                                 tell();
                             }},
                            [&e] { return e.SoilTexts(); }),
             "soil", {EDIT::Ec8, EDIT::Ec8Old, EDIT::Ntc});
    at.Shown(at.form.Choice(KeyText("IDS_QM_NEW_TOPOGRAPHY"),
                            {[&e] { return e.m_ntc.topography - 1; },
                             [&e, tell = at.tell](const int& i) {
                                 e.m_ntc.topography = i + 1;
                                 tell();
                             }},
                            [] {
                                return std::vector<std::string>(kTopographies.begin(),
                                                                kTopographies.end());
                            }),
             "topography", {EDIT::Ntc});
    at.Shown(at.form.Number(KeyText("IDS_QM_NEW_AG"), {[&e] { return e.Ag(); },
                                                       [&e, tell = at.tell](const double& v) {
                                                           e.OnAg(v);
                                                           tell();
                                                       }}),
             "ag", {EDIT::Ec8, EDIT::Ec8Old});
    at.Shown(at.form.Number(KeyText("IDS_QM_NEW_DAMPING"), {[&e] { return e.Damping(); },
                                                            [&e, tell = at.tell](const double& v) {
                                                                e.OnDamping(v);
                                                                tell();
                                                            }}),
             "damping", {EDIT::Ec8, EDIT::Ec8Old, EDIT::Ntc});
}

/// Values that go before those of the table of EN 1998-1; empty: of the table.
void AddOverrides(T_PLACE& at)
{
    T_SPFC_EURO2003& r = at.edit.m_ec8;
    at.Optional("IDS_QM_NEW_OWN_S", r.S, "S", {EDIT::Ec8});
    at.Optional("IDS_QM_NEW_OWN_TB", r.TB, "TB", {EDIT::Ec8});
    at.Optional("IDS_QM_NEW_OWN_TC", r.TC, "TC", {EDIT::Ec8});
    at.Optional("IDS_QM_NEW_OWN_TD", r.TD, "TD", {EDIT::Ec8});
}

/// A row for each limit state: in use, ag, F0, TC*.
void AddStates(T_PLACE& at)
{
    using S = T_SPFC_NTC_STATE;
    static constexpr std::array<double S::*, 3> kMembers{&S::ag, &S::F0, &S::TCstar};
    EDIT& e = at.edit;
    T_GRID_BINDING grid;
    grid.columns = {{KeyText("IDS_QM_NEW_STATE_USED"), CELL_KIND::Flag, true, {}},
                    {PlainLabel("ag (g)"), CELL_KIND::Number, true, {}},
                    {PlainLabel("F0"), CELL_KIND::Number, true, {}},
                    {PlainLabel("TC* (s)"), CELL_KIND::Number, true, {}}};
    grid.rows = [] { return kLimitStateNames.size(); };
    grid.rowHead = [](std::size_t row) { return std::string(kLimitStateNames.at(row)); };
    grid.text = [&e](std::size_t row, std::size_t column) -> std::string {
        if (column == 0) return e.HasState(row) ? "1" : "0";
        const auto& state = e.m_ntc.states.at(row);
        return state ? ShortestText((*state).*kMembers.at(column - 1)) : std::string();
    };
    grid.set = [&e](std::size_t row, std::size_t column, const std::string& text) {
        if (column == 0) e.OnState(row, text == "1");
        const std::optional<double> value = column > 0 ? ParseFinite(text) : std::nullopt;
        auto& state = e.m_ntc.states.at(row);
        if (column > 0 && (!value || !state)) return 0;
        if (column > 0) (*state).*kMembers.at(column - 1) = *value;
        return 1;
    };
    TellWhenTaken(grid, at.tell);
    CFormField& table = at.Shown(at.form.Grid(std::move(grid)), "limit_states", {EDIT::Ntc});
    table.widget->setMinimumSize(300, 150);
    table.widget->setMaximumHeight(170);
}

/// The user table, typed or pasted.
void AddTable(T_PLACE& at)
{
    EDIT& e = at.edit;
    T_GRID_BINDING grid;
    grid.columns = {{PlainLabel("T (s)"), CELL_KIND::Number, true, {}},
                    {PlainLabel("Sa (g)"), CELL_KIND::Number, true, {}}};
    grid.rows = [&e] { return e.m_user.T.size(); };
    grid.text = [&e](std::size_t row, std::size_t column) { return e.Cell(row, column); };
    grid.set = [&e](std::size_t row, std::size_t column, const std::string& text) {
        return e.SetCell(row, column, text);
    };
    grid.paste = [&e](const std::string& text, const T_GRID_RANGE&) { return e.OnTable(text); };
    TellWhenTaken(grid, at.tell);
    CFormField& table = at.Shown(at.form.Grid(std::move(grid)), "T", {EDIT::User});
    table.widget->setMinimumSize(220, 140);
    at.Shown(at.form.Button(KeyText("IDS_QM_NEW_ADD_ROW"),
                            [&e, tell = at.tell] {
                                e.OnAddRow();
                                tell();
                            }),
             "addRow", {EDIT::User});
    at.Shown(at.form.Note(
                 [&e] { return e.Refusal().empty() ? Say("IDS_QM_NEW_TABLE_NOTE") : e.Refusal(); }),
             "tableNote", {EDIT::User});
}

} // namespace

std::unique_ptr<CFormField> MakePasteField(T_BINDING<std::string> binding, ChangedFn changed,
                                           QWidget* parent)
{
    return std::make_unique<CPasteField>(std::move(binding), std::move(changed), parent);
}

void AddSpectrumFields(CFormView& form, CSpectrumEdit& edit, const std::function<void()>& changed,
                       bool withTable)
{
    T_PLACE at{form, edit, [changed] {
                   if (changed) changed();
               }};
    form.Choice(KeyText("IDS_QM_NEW_KIND"),
                {[&edit] { return edit.m_kind; },
                 [&edit, tell = at.tell](const int& kind) {
                     edit.OnKind(kind);
                     tell();
                 }},
                [] { return EDIT::KindTexts(); })
        .name = "kind";
    form.Text(KeyText("IDS_QM_UI_HEAD_NAME"), Told(edit.m_name, at.tell)).name = "name";
    AddSoil(at);
    AddAtc(at);
    AddStates(at);
    if (withTable) AddOverrides(at);
    AddTable(at);
}

CFormField& AddReadTable(CFormView& form, std::function<T_TEXT_TABLE()> make, const char* name,
                         QSize least, int most)
{
    CFormField& field = form.Grid(GridOf(std::move(make)));
    field.name = name;
    field.widget->setMinimumSize(least);
    field.widget->setMaximumHeight(most);
    return field;
}
