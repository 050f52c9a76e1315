#include "qm_rps/codehingedlg.h"

#include "qm_base/say.h"
#include "qm_rps/desk/elementlist.h"
#include "qm_rps/desk/tracetable.h"

#include <algorithm>

CCodeHingeDlg::CCodeHingeDlg(CDBDoc& doc) : m_options(doc), m_doc(doc), m_scene(doc), m_types(doc)
{
    m_status = Say("IDS_QM_UI_GEN_CHOOSE");
}

// ---- members ------------------------------------------------------------------------------------

bool CCodeHingeDlg::IsChosen(std::size_t line)
{
    return line < Scene().lines.size() && m_elements.contains(Scene().lines[line].id);
}

void CCodeHingeDlg::OnLine(std::size_t line)
{
    if (line >= Scene().lines.size()) return;
    const int id = Scene().lines[line].id;
    if (m_elements.erase(id) == 0) m_elements.insert(id);
    Forget();
}

void CCodeHingeDlg::OnLines(const std::vector<std::size_t>& lines)
{
    for (const std::size_t line : lines)
        if (line < Scene().lines.size()) m_elements.insert(Scene().lines[line].id);
    Forget();
}

void CCodeHingeDlg::OnAll()
{
    const T_MODEL& model = m_doc.Data().Model();
    const auto isSteel = [&model](const T_ELEM_D& element) {
        const auto material = model.materials.find(element.material);
        return material != model.materials.end() && material->second.type == MATL_CLASS::Steel;
    };
    for (const auto& [id, element] : model.elements)
        if (element.kind == ELEM_KIND::Beam ||
            (element.kind == ELEM_KIND::Truss && isSteel(element)))
            m_elements.insert(id);
    Forget();
}

void CCodeHingeDlg::OnNone()
{
    m_elements.clear();
    Forget();
}

void CCodeHingeDlg::OnStale()
{
    const std::vector<int> stale = m_types.StaleElements();
    m_elements = {stale.begin(), stale.end()};
    m_options.TakeStale(stale);
    Forget();
}

std::string CCodeHingeDlg::ElementsText() const
{
    return ElementListText(Chosen());
}

int CCodeHingeDlg::OnElements(const std::string& text)
{
    const std::optional<std::vector<int>> ids = ParseElementList(text);
    if (!ids) {
        ShowMessage("IDS_QM_CLI_HINGE_ELEMENT_LIST", Say("IDS_QM_CLI_HINGE_ELEMENT_LIST", text));
        return 0;
    }
    for (const int id : *ids)
        if (!m_doc.Data().Model().elements.contains(id)) {
            ShowMessage("IDS_QM_UI_GEN_NO_ELEMENT",
                        Say("IDS_QM_UI_GEN_NO_ELEMENT", std::to_string(id)));
            return 0;
        }
    m_elements = {ids->begin(), ids->end()};
    Forget();
    return 1;
}

// ---- code ---------------------------------------------------------------------------------------

std::vector<std::string> CCodeHingeDlg::CodeTexts()
{
    std::vector<std::string> texts(kHingeCodeNames.begin(), kHingeCodeNames.end());
    texts.at(static_cast<std::size_t>(HINGE_CODE::Aisc342)) +=
        " (" + Say("IDS_QM_UI_GEN_STEEL_COLUMNS") + ")";
    return texts;
}

// ---- what they would get ------------------------------------------------------------------------

/// A preview of another choice is none.
void CCodeHingeDlg::Forget()
{
    m_hinges = {};
    m_firsts.clear();
    m_type = m_side = -1;
    m_shown.reset();
    m_status = m_elements.empty() ? Say("IDS_QM_UI_GEN_CHOOSE")
                                  : Say("IDS_QM_UI_GEN_CHOSEN", std::to_string(m_elements.size()));
}

void CCodeHingeDlg::Take(T_CODE_HINGES hinges)
{
    Forget();
    m_hinges = std::move(hinges);
    m_firsts = FirstsOfTypes(m_hinges);
    OnType(m_firsts.empty() ? -1 : 0);
}

/// Hinges without a push are there at once.
int CCodeHingeDlg::WithProgress(const std::function<int(const PUSH_PROGRESS_FN&)>& work) const
{
    if (m_options.PushedCase() == 0 || !m_withProgress) return work({});
    return m_withProgress([&](TELL_FN tell) {
        return work([&tell](const T_PUSH_PROGRESS& at) { return tell(at.done, at.total); });
    });
}

int CCodeHingeDlg::OnPreview()
{
    if (m_elements.empty()) return 0;
    T_CODE_REQUEST request;
    T_CODE_HINGES hinges;
    T_HINGE_REFUSAL refusal;
    if (!m_options.Read(Chosen(), request, refusal.text) ||
        !WithProgress([&](const PUSH_PROGRESS_FN& progress) {
            return m_options.Preview(request, progress, hinges, refusal);
        })) {
        Forget();
        m_status = Say("IDS_QM_UI_GEN_NO_HINGES", refusal.text);
        return 0;
    }
    Take(std::move(hinges));
    m_status = Say("IDS_QM_UI_GEN_WOULD", std::to_string(m_hinges.elements.size()),
                   std::to_string(m_hinges.types), std::to_string(m_hinges.skipped.size()));
    return 1;
}

T_TEXT_TABLE CCodeHingeDlg::Types() const
{
    constexpr std::array<const char*, kMemberKindNames.size()> kKinds{
        "IDS_QM_UI_GEN_BEAM",  "IDS_QM_UI_GEN_COLUMN", "IDS_QM_UI_GEN_WALL",
        "IDS_QM_UI_GEN_BRACE", "IDS_QM_UI_GEN_PIER",   "IDS_QM_UI_GEN_SPANDREL"};
    T_TEXT_TABLE table;
    table.columns = {{Say("IDS_QM_UI_HEAD_SECTION")},
                     {Say("IDS_QM_UI_GEN_MEMBER")},
                     {Say("IDS_QM_UI_GEN_ELEMENTS")}};
    for (const T_CODE_ELEMENT* first : m_firsts) {
        std::vector<int> ids;
        for (const T_CODE_ELEMENT& element : m_hinges.elements)
            if (element.hinge == first->hinge) ids.push_back(element.member.element);
        std::ranges::sort(ids);
        const auto& sections = m_doc.Data().Model().sections;
        const auto section = sections.find(first->member.section);
        table.rows.push_back({section == sections.end() ? std::string() : section->second.name,
                              Say(kKinds[static_cast<std::size_t>(first->member.kind)]),
                              ElementListText(ids)});
    }
    return table;
}

std::vector<T_CODE_ROW_OF_HINGE> CCodeHingeDlg::Rows() const
{
    if (m_type < 0) return {};
    return HingeRows(*m_firsts.at(static_cast<std::size_t>(m_type)));
}

bool CCodeHingeDlg::IsChord() const
{
    const auto rows = Rows();
    return rows.empty() ? IsChordCode(m_options.m_code)
                        : rows.front().of->bone.levels == CODE_LEVELS::DlSdNc;
}

T_TEXT_TABLE CCodeHingeDlg::Sides() const
{
    const T_UNITS units = m_doc.Unit().Units();
    constexpr std::size_t kWords = 3; // columns before the numbers
    T_TEXT_TABLE table;
    for (const std::string& head : HingeRowHeads(m_hinges, IsChord(), units))
        table.columns.push_back({head, table.columns.size() >= kWords});
    // The number of columns stays: a chord has two levels less.
    while (table.columns.size() < HingeRowHeads(m_hinges, false, units).size())
        table.columns.push_back({});
    for (const T_CODE_ROW_OF_HINGE& row : Rows()) {
        table.rows.push_back(HingeRowCells(row, IsChord(), units));
        table.rows.back().resize(table.columns.size());
    }
    return table;
}

void CCodeHingeDlg::OnType(int row)
{
    if (row >= std::ssize(m_firsts)) return;
    m_type = row;
    m_side = row < 0 ? -1 : 0;
    Show();
}

void CCodeHingeDlg::OnSide(int row)
{
    if (row < 0 || row >= std::ssize(Rows())) return;
    m_side = row;
    Show();
}

void CCodeHingeDlg::Show()
{
    m_shown.reset();
    const auto rows = Rows();
    if (m_side < 0 || m_side >= std::ssize(rows)) return;
    const T_CODE_ROW_OF_HINGE& row = rows[static_cast<std::size_t>(m_side)];
    T_SHOWN shown;
    shown.type = m_firsts[static_cast<std::size_t>(m_type)]->hinge->type;
    if (shown.type.name.empty())
        shown.type.name = Types().rows[static_cast<std::size_t>(m_type)].front();
    RecordFromSi(shown.type, m_doc.Unit().Units());
    shown.component = row.component;
    const auto& curves = shown.type.components[static_cast<std::size_t>(row.component)].curves;
    shown.curve = row.end == "J" ? curves.J : curves.I;
    shown.page = row.end;
    m_shown = std::move(shown);
}

T_TEXT_TABLE CCodeHingeDlg::Trace() const
{
    const auto rows = Rows();
    const bool any = m_side >= 0 && m_side < std::ssize(rows);
    return TraceTable(any ? rows[static_cast<std::size_t>(m_side)].of->trace
                          : std::vector<T_CODE_TRACE>(),
                      m_options.Units());
}

std::string CCodeHingeDlg::WarningsText() const
{
    std::string text = CodeIterationsText(m_hinges, m_options.Units());
    if (!text.empty()) text.pop_back(); // the last end of a line
    const auto add = [&text](const std::string& line) {
        text += (text.empty() ? "" : "\n") + line;
    };
    const T_CODE_ELEMENT* const shown =
        m_type < 0 ? nullptr : m_firsts[static_cast<std::size_t>(m_type)];
    for (const auto& [warning, elements] : HingeWarnings(m_hinges))
        if (elements.empty() || std::ranges::find(elements, shown) != elements.end())
            add("! " + warning);
    for (const T_HINGE_REFUSAL& refusal : m_hinges.skipped)
        add(Say("IDS_QM_GEN_SKIPPED", refusal.text));
    return text;
}

// ---- the hinges themselves ----------------------------------------------------------------------

int CCodeHingeDlg::Refuse(const T_HINGE_REFUSAL& refusal)
{
    ShowMessage("IDS_QM_UI_GEN_REFUSED", Say("IDS_QM_UI_GEN_REFUSED", refusal.text));
    return 0;
}

int CCodeHingeDlg::OnApply()
{
    if (m_elements.empty()) {
        ShowMessage("IDS_QM_UI_GEN_CHOOSE");
        return 0;
    }
    T_CODE_REQUEST request;
    T_CODE_HINGES hinges;
    T_HINGE_REFUSAL refusal;
    if (!m_options.Read(Chosen(), request, refusal.text) ||
        !WithProgress([&](const PUSH_PROGRESS_FN& progress) {
            return m_options.Generate(request, progress, hinges, refusal);
        }))
        return Refuse(refusal);
    Take(std::move(hinges));
    m_status = Say("IDS_QM_GEN_DONE", std::to_string(m_hinges.elements.size()),
                   std::to_string(m_hinges.types));
    return 1;
}

int CCodeHingeDlg::OnRegenerate()
{
    T_CODE_HINGES hinges;
    T_HINGE_REFUSAL refusal;
    if (!CCodeHinges(m_doc).Regenerate(hinges, refusal)) return Refuse(refusal);
    m_elements.clear();
    for (const T_CODE_ELEMENT& element : hinges.elements)
        m_elements.insert(element.member.element);
    Take(std::move(hinges));
    m_status = Say("IDS_QM_GEN_DONE", std::to_string(m_hinges.elements.size()),
                   std::to_string(m_hinges.types));
    return 1;
}
