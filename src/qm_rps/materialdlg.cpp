#include "qm_rps/materialdlg.h"

#include "qm_base/say.h"
#include "qm_db/editscope.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/codes/en1998rotation.h"
#include "qm_rps/desk/freename.h"

#include <algorithm>

namespace {

using MEMBER = double T_MATL_D::*;
constexpr std::array<MEMBER, 8> kOfGrades{&T_MATL_D::E,       &T_MATL_D::nu,   &T_MATL_D::Fy,
                                          &T_MATL_D::fck,     &T_MATL_D::fyk,  &T_MATL_D::Es,
                                          &T_MATL_D::density, &T_MATL_D::alpha};

std::vector<const T_MATL_GRADE*> GradesOf(GRADE_OF of)
{
    std::vector<const T_MATL_GRADE*> grades;
    for (const T_MATL_GRADE& grade : MaterialGrades())
        if (grade.of == of) grades.push_back(&grade);
    return grades;
}

/// What a grade gives, the rest at 0.
T_MATL_D ValuesOf(const T_MATL_GRADE& grade, const T_UNITS& units)
{
    T_MATL_D values;
    FillFrom(grade, values);
    RecordFromSi(values, units);
    return values;
}

} // namespace

CMaterialDlg::CMaterialDlg(CDBDoc& doc, int key) : m_doc(doc)
{
    const auto& materials = doc.Data().Model().materials;
    if (key == 0 && !materials.empty()) key = materials.begin()->first;
    Read(key);
}

void CMaterialDlg::Read(int key)
{
    T_MATL_D material;
    m_key = m_doc.Attr().GetMatl(key, material) ? key : 0;
    if (m_key == 0) {
        const auto& all = m_doc.Data().Model().materials;
        material.name = FreeName(all, NextKey(all));
        material.type = MATL_CLASS::Concrete;
    }
    m_material = m_read = std::move(material);
    m_mean = m_material.mean.value_or(T_MATL_MEAN{});
    m_masonry = m_material.masonry.value_or(T_MATL_MASONRY{});
    m_grades = {};
}

std::vector<std::string> CMaterialDlg::Names() const
{
    std::vector<std::string> names;
    for (const auto& [key, material] : m_doc.Data().Model().materials)
        names.push_back(material.name);
    return names;
}

int CMaterialDlg::Index() const
{
    const auto& all = m_doc.Data().Model().materials;
    const auto at = all.find(m_key);
    return at == all.end() ? -1 : static_cast<int>(std::distance(all.begin(), at));
}

bool CMaterialDlg::MayLeave()
{
    constexpr const char* kAsk = "IDS_QM_UI_SECT_KEEP";
    return m_material == m_read || !AskYesNo(kAsk, Say(kAsk, m_material.name)) || Store();
}

void CMaterialDlg::OnSelChange(int index)
{
    const auto& all = m_doc.Data().Model().materials;
    if (index < 0 || index >= std::ssize(all) || index == Index()) return;
    const int key = std::next(all.begin(), index)->first;
    if (MayLeave()) Read(key);
}

void CMaterialDlg::OnNew()
{
    if (MayLeave()) Read(0);
}

void CMaterialDlg::OnMean(bool on)
{
    if (on == HasMean()) return;
    if (!on) m_mean = *m_material.mean;
    m_material.mean = on ? std::optional(m_mean) : std::nullopt;
}

void CMaterialDlg::OnMasonry(bool on)
{
    if (on == HasMasonry()) return;
    if (!on) m_masonry = *m_material.masonry;
    m_material.masonry = on ? std::optional(m_masonry) : std::nullopt;
}

// ---- grades -------------------------------------------------------------------------------------

bool CMaterialDlg::TakesGrades(GRADE_OF of) const
{
    return m_material.type == (of == GRADE_OF::Steel ? MATL_CLASS::Steel : MATL_CLASS::Concrete);
}

std::vector<std::string> CMaterialDlg::GradeTexts(GRADE_OF of)
{
    std::vector<std::string> texts{Say("IDS_QM_UI_MATL_GRADE_NONE")};
    for (const T_MATL_GRADE* grade : GradesOf(of))
        texts.push_back(grade->name);
    return texts;
}

int CMaterialDlg::GradeIndex(GRADE_OF of) const
{
    const T_MATL_GRADE* const taken = m_grades[static_cast<std::size_t>(of)];
    if (!taken || !TakesGrades(of)) return 0;
    const T_MATL_D values = ValuesOf(*taken, Units());
    constexpr std::array<MEMBER, 5> kTold{&T_MATL_D::E, &T_MATL_D::Fy, &T_MATL_D::fck,
                                          &T_MATL_D::fyk, &T_MATL_D::Es};
    for (const MEMBER member : kTold)
        if (values.*member != 0.0 && values.*member != m_material.*member) return 0;
    const auto grades = GradesOf(of);
    return static_cast<int>(std::ranges::find(grades, taken) - grades.begin()) + 1;
}

void CMaterialDlg::OnGrade(GRADE_OF of, int index)
{
    const auto grades = GradesOf(of);
    if (index < 1 || index > std::ssize(grades) || !TakesGrades(of)) return;
    const T_MATL_GRADE* const taken = grades[static_cast<std::size_t>(index) - 1];
    const T_MATL_D values = ValuesOf(*taken, Units());
    for (const MEMBER member : kOfGrades)
        if (values.*member != 0.0) m_material.*member = values.*member;
    m_grades[static_cast<std::size_t>(of)] = taken;
}

std::string CMaterialDlg::GradeNote() const
{
    std::string text;
    for (const GRADE_OF of : {GRADE_OF::Steel, GRADE_OF::Concrete, GRADE_OF::Bars})
        if (GradeIndex(of) > 0) {
            const T_MATL_GRADE& grade = *m_grades[static_cast<std::size_t>(of)];
            text += grade.name + ": " + grade.clause + ". ";
        }
    return text.empty() ? text : text + Say("IDS_QM_SECC_GRADES_NOTE");
}

std::optional<double> CMaterialDlg::Confidence() const
{
    if (m_material.confidence || !m_material.knowledge) return m_material.confidence;
    CCodeSheet sheet;
    return ConfidenceFactor(static_cast<int>(*m_material.knowledge) + 1, sheet);
}

std::vector<T_FINDING> CMaterialDlg::Findings() const
{
    return RecordFindings(m_doc.Data().Model(), m_material, m_key);
}

int CMaterialDlg::Store()
{
    if (!CheckData()) return 0;
    const int key = m_key ? m_key : NextKey(m_doc.Data().Model().materials);
    CEditScope edit(m_doc, m_material.name);
    if (edit.Put(key, m_material) && edit.Commit()) {
        m_key = key;
        m_read = m_material;
        return 1;
    }
    ShowMessage("IDS_QM_UI_EDIT_BUSY");
    return 0;
}

int CMaterialDlg::OnOK()
{
    return m_key != 0 && m_material == m_read ? 1 : Store();
}
