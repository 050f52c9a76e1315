#include "qm_ui/factors/ulfconstraintview.h"

#include "qm_rps/unknownloadfactorconstraintdlg.h"
#include "qm_rps/unknowntabletabgrid1.h"

#include <algorithm>
#include <span>

namespace {

using EDITOR = CUnknownLoadFactorConstraintDlg;
using LIST = CUnknownTableTabGrid1;

std::function<std::vector<std::string>()> Keys(std::span<const char* const> keys)
{
    return KeyTexts(std::vector<std::string>(keys.begin(), keys.end()));
}

bool IsOfNode(const EDITOR& editor)
{
    return editor.m_constraint.type <= ULFC_TYPE::Displacement;
}

void AddQuantity(CFormView& form, EDITOR& editor)
{
    T_ULFC_D& c = editor.m_constraint;
    form.Choice(KeyText("IDS_QM_UI_ULF_TYPE"),
                {[&c] { return static_cast<int>(c.type); },
                 [&editor](const int& type) { editor.OnSelChangeType(type); }},
                Keys(EDITOR::kTypeKeys))
        .name = "type";
    const auto idCaption = [&editor] {
        return KeyText(IsOfNode(editor) ? "IDS_QM_UI_ULF_NODE" : "IDS_QM_UI_ULF_ELEMENT")();
    };
    form.Integer(idCaption, Ref(c.id)).name = "id";
    CFormField& position = form.Choice(KeyText("IDS_QM_UI_ULF_POSITION"), IndexRef(c.position),
                                       [] { return EDITOR::PositionTexts(); });
    position.name = "position";
    position.shown = [&c] { return c.type == ULFC_TYPE::Beam; };
    form.Choice(KeyText("IDS_QM_UI_ULF_COMPONENT"), IndexRef(c.component),
                [&editor] { return editor.ComponentTexts(); })
        .name = "component";
    form.Choice(KeyText("IDS_RPS_GXGRID_Stage"),
                {[&editor] { return editor.PlaceIndex(); },
                 [&editor](const int& index) { editor.OnSelChangePlace(index); }},
                [&editor] { return editor.PlaceTexts(); })
        .enabled = [&editor] { return editor.PlaceTexts().size() > 1; };
}

void AddRelation(CFormView& form, EDITOR& editor)
{
    T_ULFC_D& c = editor.m_constraint;
    const auto is = [&editor](EDITOR::RELATION relation) {
        return [&editor, relation] { return editor.Relation() == relation; };
    };
    const auto unit = [&editor] { return editor.UnitText(); };
    form.Choice(KeyText("IDS_QM_UI_ULF_RELATION"),
                {[&editor] { return static_cast<int>(editor.Relation()); },
                 [&editor](const int& relation) { editor.OnSelChangeRelation(relation); }},
                Keys(EDITOR::kRelationKeys));
    CFormField& value =
        form.Number(KeyText("IDS_RPS_UNKNOWN_LOAD_GXRESULT_Value"), Ref(c.value), unit);
    value.name = "value";
    value.enabled = is(EDITOR::EqualsValue);
    CFormField& other = form.Integer(
        [&c] { return KeyText(EDITOR::kOtherKeys[static_cast<std::size_t>(c.type)])(); },
        Ref(c.otherId));
    other.name = "otherId";
    other.enabled = is(EDITOR::EqualsOther);
    CFormField& upper =
        form.Optional(KeyText("IDS_RPS_UNKNOWN_LOAD_GXRESULT_Upper_Bound"), Ref(c.upper), unit);
    upper.name = "upper";
    upper.enabled = is(EDITOR::Bounds);
    CFormField& lower =
        form.Optional(KeyText("IDS_RPS_UNKNOWN_LOAD_GXRESULT_Lower_Bound"), Ref(c.lower), unit);
    lower.name = "lower";
    lower.enabled = is(EDITOR::Bounds);
}

void BuildEditor(CFormView& form, EDITOR& editor)
{
    form.Text(KeyText("IDS_QM_UI_HEAD_NAME"), Ref(editor.m_constraint.name)).name = "name";
    form.Group(KeyText("IDS_QM_UI_ULF_QUANTITY"));
    AddQuantity(form, editor);
    form.EndGroup();
    form.Group(KeyText("IDS_QM_UI_ULF_HELD_TO"));
    AddRelation(form, editor);
    form.EndGroup();
}

T_GRID_BINDING ListGrid(LIST& list)
{
    static constexpr std::array<const char*, 2> kHeads{"IDS_QM_UI_HEAD_NAME",
                                                       "IDS_QM_UI_ULF_QUANTITY"};
    // The rows are made once for each refresh: a model may have many.
    const auto rows = std::make_shared<std::vector<LIST::T_ROW>>();
    T_GRID_BINDING b;
    b.columns = UlfColumns(kHeads, {CELL_KIND::Text, CELL_KIND::Text});
    b.rows = [&list, rows] {
        *rows = list.Rows();
        return rows->size();
    };
    b.text = [rows](std::size_t row, std::size_t column) {
        return column == 0 ? rows->at(row).name : rows->at(row).description;
    };
    b.select = [&list, rows](int row) {
        const auto at = static_cast<std::size_t>(row);
        list.m_selected = at < rows->size() ? (*rows)[at].key : 0;
    };
    b.selected = [&list, rows] {
        const auto it = std::ranges::find(*rows, list.m_selected, &LIST::T_ROW::key);
        return it == rows->end() ? -1 : static_cast<int>(it - rows->begin());
    };
    b.open = [&list](std::size_t) { (void)list.OnModify(); };
    return b;
}

void BuildList(CFormView& form, LIST& list)
{
    AddUlfGrid(form, ListGrid(list), {620, 340});
    const auto chosen = [&list] { return list.m_selected != 0; };
    AddUlfButtons(form, {{"IDS_QM_UI_ULF_ADD", [&list] { (void)list.OnAdd(); }},
                         {"IDS_QM_UI_ULF_MODIFY", [&list] { (void)list.OnModify(); }, chosen},
                         {"IDS_QM_UI_ULF_DELETE", [&list] { (void)list.OnDelete(); }, chosen}});
}

} // namespace

void RegisterUlfConstraintViews(CViewFactory& factory)
{
    T_VIEW shows;
    shows.showsOnly = true;
    factory.Register<LIST>(KeyText("IDS_QM_UI_TABLE_CONSTRAINTS"), BuildList, shows);
    T_VIEW editor;
    editor.size = {520, 0};
    factory.Register<EDITOR>(KeyText("IDS_QM_UI_ULF_CONSTRAINT_TITLE"), BuildEditor, editor);
}
