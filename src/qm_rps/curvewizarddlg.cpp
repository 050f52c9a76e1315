#include "qm_rps/curvewizarddlg.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/filectrl.h"
#include "qm_db/recordfacts.h"
#include "qm_db/spectrumrules.h"
#include "qm_rps/create/createfault.h"
#include "qm_rps/create/numberlist.h"
#include "qm_rps/create/spectrumtext.h"
#include "qm_rps/dialog/unithead.h"

#include <algorithm>

namespace {

/// Every method with each of its procedures.
std::vector<T_CURVE_METHOD> AllMethods()
{
    std::vector<T_CURVE_METHOD> all;
    for (int code = kFirstMethod; code < kFirstMethod + std::ssize(kMethodNames); ++code) {
        const auto method = static_cast<PUSH_METHOD>(code);
        const auto procedures = ProceduresOf(method);
        if (procedures.empty()) all.push_back({method});
        for (const char* const procedure : procedures)
            all.push_back({method, *procedure});
    }
    return all;
}

/// A list that was typed. 0: it can't be read.
int ReadList(const std::string& text, const char* field, std::vector<double>& out, T_FINDING& fault)
{
    std::string why;
    const auto list = ParseNumberList(text, why);
    if (!list) return CreateFault(fault, field, "IDS_QM_NEW_TEXT", why);
    out = *list;
    return 1;
}

/// A word of a command in quotes where a shell would part it.
std::string Quoted(const std::string& text)
{
    constexpr std::string_view kPlain =
        "abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ0123456789_-+=:,./";
    if (!text.empty() && text.find_first_not_of(kPlain) == text.npos) return text;
    std::string out = "'";
    for (const char c : text)
        out += c == '\'' ? "'\\''" : std::string(1, c);
    return out + "'";
}

constexpr std::array<const char*, 4> kMassWords{"model", "t", "kg", "weight"};
constexpr std::array<const char*, 3> kDecimalWords{"auto", "point", "comma"};

} // namespace

// ---- choices ------------------------------------------------------------------------------------

std::vector<std::string> CCurveWizardDlg::MethodTexts()
{
    std::vector<std::string> texts{Say("IDS_QM_NEW_METHOD_OWN")};
    for (const T_CURVE_METHOD& method : AllMethods())
        texts.push_back(CurveMethodText(method));
    return texts;
}

int CCurveWizardDlg::MethodIndex() const
{
    if (m_methods.empty()) return 0;
    const auto texts = MethodTexts();
    const auto at = std::ranges::find(texts, CurveMethodText(m_methods.front()));
    return at == texts.end() ? 0 : static_cast<int>(at - texts.begin());
}

void CCurveWizardDlg::OnMethod(int index)
{
    m_methods.clear();
    const auto all = AllMethods();
    if (index > 0 && index <= std::ssize(all))
        m_methods.push_back(all[static_cast<std::size_t>(index) - 1]);
}

std::vector<std::string> CCurveWizardDlg::MassTexts() const
{
    const std::string force(NameOf(m_units.force)), length(NameOf(m_units.length));
    return {Say("IDS_QM_NEW_MASS_MODEL", force + " s2/" + length), Say("IDS_QM_NEW_MASS_T"),
            Say("IDS_QM_NEW_MASS_KG"), Say("IDS_QM_NEW_MASS_WEIGHT", force)};
}

int CCurveWizardDlg::OnFile()
{
    const std::string path = m_askFile ? m_askFile() : std::string();
    if (path.empty()) return 0;
    T_FILE_ERROR error;
    std::string text;
    if (!CFileCtrl::ReadWholeFile(path, text, error)) {
        ShowMessage("IDS_QM_UI_FILE_REFUSED", error.text);
        return 0;
    }
    m_curve.text = std::move(text);
    m_file = path;
    OnChange();
    return 1;
}

// ---- what follows -------------------------------------------------------------------------------

int CCurveWizardDlg::Ask(T_CURVE_CASE& out, T_FINDING& fault) const
{
    T_CURVE_CASE in;
    in.title = m_title;
    in.units = m_units;
    in.curve = m_curve;
    in.massGiven = m_massGiven;
    in.isTotal = m_isTotal;
    in.shape = m_shape;
    in.methods = m_methods;
    in.spectrum = m_spectrum.Record();
    if (!ReadList(m_heights, "heights", in.heights, fault) ||
        !ReadList(m_masses, "masses", in.masses, fault) ||
        (m_shape == SHAPE_GIVEN::Typed &&
         !ReadList(m_typedShape, "typedShape", in.typedShape, fault)))
        return 0;
    out = std::move(in);
    return 1;
}

void CCurveWizardDlg::Update() const
{
    if (m_isRead) return;
    m_isRead = true;
    m_isMade = false;
    m_read.reset();
    T_CURVE_READ read;
    if (!ReadCurve(m_curve, read, m_fault)) return;
    m_read = std::move(read);
    const auto ofSpectrum = RecordFindings({}, m_spectrum.Record(), 0);
    if (!ofSpectrum.empty()) {
        m_fault = ofSpectrum.front();
        return;
    }
    m_isMade = Ask(m_case, m_fault) && MakeCurveCase(m_case, m_content, m_facts, m_fault);
}

const T_CURVE_FACTS* CCurveWizardDlg::Facts()
{
    Update();
    return m_isMade ? &m_facts : nullptr;
}

const T_CURVE_READ* CCurveWizardDlg::Read()
{
    Update();
    return m_read ? &*m_read : nullptr;
}

T_TEXT_TABLE CCurveWizardDlg::Points()
{
    T_TEXT_TABLE table;
    table.columns = {{Say("IDS_QM_NEW_HEAD_LINE"), true},
                     {HeadWithUnit("V", kDimForce, m_units), true},
                     {HeadWithUnit("d", kDimLength, m_units), true},
                     {HeadWithUnit(Say("IDS_QM_NEW_HEAD_STOREYS"), kDimLength, m_units)}};
    const T_CURVE_READ* const read = Read();
    if (!read) return table;
    for (const T_CURVE_POINT& point : read->points)
        table.rows.push_back({point.line ? std::to_string(point.line) : "",
                              ShortestText(point.force), ShortestText(point.displacement),
                              NumberListText(point.storeys)});
    return table;
}

T_TEXT_TABLE CCurveWizardDlg::Storeys()
{
    T_TEXT_TABLE table;
    table.columns = {{Say("IDS_QM_NEW_HEAD_STOREY")},
                     {HeadWithUnit(Say("IDS_QM_NEW_HEAD_HEIGHT"), kDimLength, m_units), true},
                     {HeadWithUnit(Say("IDS_QM_NEW_HEAD_MASS"), kDimMass, m_units), true},
                     {Say("IDS_QM_NEW_HEAD_SHAPE"), true}};
    if (!Facts()) return table;
    for (std::size_t i = 0; i < m_facts.mass.size(); ++i)
        table.rows.push_back({std::to_string(i + 1) + "F", ShortestText(m_case.heights[i]),
                              FormatText("%.6g", m_facts.mass[i]),
                              FormatText("%.4f", m_facts.shape[i])});
    return table;
}

std::string CCurveWizardDlg::NotesText()
{
    Update();
    std::string text = m_isMade ? "" : m_fault.text;
    const std::vector<std::string> notes = m_isMade ? CurveCaseNotes(m_case, m_facts)
                                           : m_read ? CurveReadNotes(*m_read)
                                                    : std::vector<std::string>();
    for (const std::string& note : notes)
        text += (text.empty() ? "" : "\n") + note;
    return text;
}

std::string CCurveWizardDlg::CommandText()
{
    Update();
    if (!m_isMade) return {};
    std::string text = "qm-rps new --curve " + Quoted(m_file.empty() ? "curve.txt" : m_file) +
                       " --units " + std::string(NameOf(m_units.force)) + "," +
                       std::string(NameOf(m_units.length));
    const auto add = [&text](const char* option, const std::string& value) {
        if (!value.empty()) text += std::string(" ") + option + " " + Quoted(value);
    };
    const auto plain = [](const std::vector<double>& list) {
        std::string joined = NumberListText(list);
        std::erase(joined, ' ');
        return joined;
    };
    add("--title", m_title);
    add("--columns", m_facts.read.columns);
    if (m_curve.decimal != PASTED_DECIMAL::Auto)
        add("--decimal", kDecimalWords[static_cast<std::size_t>(m_curve.decimal)]);
    if (m_curve.addOrigin) text += " --add-origin";
    if (m_curve.reverseForce) text += " --reverse-force";
    add(m_isTotal ? "--total-mass" : "--mass", plain(m_case.masses));
    add("--mass-unit", kMassWords[static_cast<std::size_t>(m_massGiven)]);
    add("--height", plain(m_case.heights));
    if (m_shape == SHAPE_GIVEN::Curve) add("--shape", "curve");
    if (m_shape == SHAPE_GIVEN::Typed) add("--shape", plain(m_case.typedShape));
    add("--spectrum", SpectrumText(m_case.spectrum));
    for (const T_CURVE_METHOD& method : m_methods)
        add("--method", CurveMethodText(method));
    return text + " -o case.json";
}

std::vector<T_FINDING> CCurveWizardDlg::Findings() const
{
    Update();
    return m_isMade ? std::vector<T_FINDING>() : std::vector{m_fault};
}

int CCurveWizardDlg::OnOK()
{
    if (!CheckData() || (m_mayReplace && !m_mayReplace())) return 0;
    m_evaluation = m_content.model.evaluations.at(1).name;
    m_doc.NewModel();
    m_doc.Data().Assign(m_content);
    m_doc.Data().SetModified(true);
    return 1;
}
