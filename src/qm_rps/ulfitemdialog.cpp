#include "qm_rps/ulfitemdialog.h"

#include "qm_base/messagehistory.h"
#include "qm_base/msgfunction.h"
#include "qm_rps/factors/ulfchecks.h"
#include "qm_rps/factors/ulfstageplace.h"
#include "qm_rps/ulfexplanationdlg.h"
#include "qm_rps/unknownloadfactorresultdlg.h"

#include <algorithm>

using zql::lib::MMSGFunction;

namespace {

void WriteHistory(const char* key)
{
    GSaveHistoryFormatNF("%s", MMSGFunction::GetValue(key).c_str());
}

} // namespace

void CUlfItemDialog::SetChecks(const std::vector<std::string>& names, bool itemsFirst)
{
    const T_MODEL& model = m_doc.Data().Model();
    m_checks.clear();
    m_missing.clear();
    for (const std::string& name : names) {
        if (FindUlfConstraint(model, name) == 0)
            m_missing.push_back(name);
        else if (itemsFirst)
            m_checks.push_back({name, true});
    }
    for (const auto& [key, constraint] : model.ulfConstraints) {
        const bool checked = std::ranges::find(names, constraint.name) != names.end();
        if (!checked || !itemsFirst) m_checks.push_back({constraint.name, checked});
    }
}

std::vector<std::string> CUlfItemDialog::CheckedNames() const
{
    std::vector<std::string> names;
    for (const T_CHECK& check : m_checks)
        if (check.checked) names.push_back(check.name);
    names.insert(names.end(), m_missing.begin(), m_missing.end());
    return names;
}

int CUlfItemDialog::ReadConstraints(T_ULF_RUN& run) const
{
    for (const std::string& name : run.item.constraints) {
        T_ULFC_D constraint;
        if (!m_doc.Attr().GetUlfc_(name, constraint)) return 0;
        run.constraints.push_back(std::move(constraint));
    }
    return 1;
}

std::string CUlfItemDialog::CheckText(std::size_t check) const
{
    T_ULFC_D constraint;
    return check < m_checks.size() && m_doc.Attr().GetUlfc_(m_checks[check].name, constraint)
               ? UlfConstraintText(m_doc.Data(), constraint)
               : std::string();
}

int CUlfItemDialog::OnAnalyse(const ULF_PROGRESS& progress, std::string& error)
{
    error.clear();
    if (!Findings().empty()) return 1;
    std::optional<T_ANALYSIS_OPTIONS> missing = MissingResults();
    T_ANALYSIS_ERROR fault;
    if (!missing || RunWatchedAnalysis(m_doc, std::move(*missing), progress, fault)) return 1;
    if (fault.fault != ANALYSIS_FAULT::Cancelled) error = fault.text;
    return 0;
}

int CUlfItemDialog::OnSolve()
{
    if (!OnCalculate()) return 0;
    CUnknownLoadFactorResultDlg dialog(m_doc, *m_result);
    dialog.SetView(View());
    (void)dialog.DoModal();
    return 1;
}

int CUlfItemDialog::OnExplain(const std::function<bool(int, int)>& progress)
{
    m_explained.reset();
    const std::size_t before = Messages().size();
    zql::frx::IDialogView* const view = View();
    SetView(nullptr); // the message of a calculation without a solution is told with the rest
    (void)OnCalculate();
    SetView(view);
    const bool told = Messages().size() > before;
    m_explainedMessage = told ? Messages().back().text : std::string();
    T_ULF_EXPLAINED explained;
    if (!m_run || !ExplainUlf(*m_run, m_doc.Unit().Units(), explained, progress)) return 0;
    m_explained = std::move(explained);
    return 1;
}

void CUlfItemDialog::ShowExplanation()
{
    if (!m_explained) {
        if (!m_explainedMessage.empty())
            ShowMessage("IDS_RPS_Unknown_Load_Factor_Item_has_an_error", m_explainedMessage);
        return;
    }
    CUlfExplanationDlg dialog(m_name, m_explainedMessage, *m_explained);
    dialog.SetView(View());
    (void)dialog.DoModal();
}

void CUlfItemDialog::Forget()
{
    m_result.reset();
    m_run.reset();
}

int CUlfItemDialog::Finish(T_ULF_RUN run, bool solved, const std::string& sourceError)
{
    m_run = std::move(run);
    if (!solved) {
        constexpr const char* key = "IDS_RPS_Unknown_Load_Factor_Item_has_an_error";
        ShowMessage(key, MMSGFunction::Format(key, {m_name, FailureText(*m_run, sourceError)}));
        WriteHistory("IDS_RPS_Unknown_CANNOT_FIND_OPTIMIZED_SOLUTION");
        return 0;
    }
    m_result = UlfResultOf(*m_run, m_run->answer.factors);
    WriteHistory("IDS_RPS_Unknown_CAN_FIND_OPTIMIZED_SOLUTION");
    ReportMisses();
    return 1;
}

/// The optimizer's message with the name of the constraint or load case that it numbers.
std::string CUlfItemDialog::FailureText(const T_ULF_RUN& run, const std::string& sourceError)
{
    const T_OPT_ANSWER& a = run.answer;
    if (a.message.empty()) return sourceError;
    std::string name;
    if (a.constraint > 0)
        name = run.constraints[run.formed.owner[static_cast<std::size_t>(a.constraint - 1)]].name;
    else if (a.factor > 0)
        name = run.cases[run.formed.unknowns[static_cast<std::size_t>(a.factor - 1)]].name;
    return name.empty() ? a.message : a.message + " (" + name + ")";
}

void CUlfItemDialog::ReportMisses()
{
    std::string names;
    for (const T_ULF_RESULT_ROW& row : UlfResultRows(*m_result))
        if (!row.met) names += (names.empty() ? "" : ", ") + UlfNameAt(row.name, row.place);
    if (names.empty()) return;
    constexpr const char* key = "IDS_QM_ULF_NOT_MET";
    const std::string text = MMSGFunction::Format(key, {names});
    ShowMessage(key, text);
    GSaveHistoryFormatNF("%s", text.c_str());
}
