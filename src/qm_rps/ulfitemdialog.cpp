#include "qm_rps/ulfitemdialog.h"

#include "qm_rps/factors/checks/ulfconstraintchecks.h"
#include "qm_rps/factors/ulfstageplace.h"
#include "qm_rps/ulfexplanationdlg.h"
#include "qm_rps/unknownloadfactorresultdlg.h"

#include <algorithm>

void CUlfItemDialog::SetChecks(const std::vector<std::string>& names, bool itemsFirst)
{
    const T_MODEL& model = m_doc.Data().Model();
    m_checks.clear();
    m_missing.clear();
    const auto times = [&](const std::string& name) {
        return static_cast<int>(std::ranges::count(names, name));
    };
    for (const std::string& name : names) {
        const bool isThere = std::ranges::find(m_checks, name, &T_CHECK::name) != m_checks.end();
        if (FindUlfConstraint(model, name) == 0)
            m_missing.push_back(name);
        else if (itemsFirst && !isThere)
            m_checks.push_back({name, true, times(name)});
    }
    for (const auto& [key, constraint] : model.ulfConstraints) {
        const int count = times(constraint.name);
        if (count == 0 || !itemsFirst)
            m_checks.push_back({constraint.name, count > 0, std::max(count, 1)});
    }
}

std::vector<std::string> CUlfItemDialog::CheckedNames() const
{
    std::vector<std::string> names;
    for (const T_CHECK& check : m_checks)
        if (check.checked)
            names.insert(names.end(), static_cast<std::size_t>(check.times), check.name);
    names.insert(names.end(), m_missing.begin(), m_missing.end());
    return names;
}

std::string CUlfItemDialog::CheckText(std::size_t check) const
{
    T_ULFC_D constraint;
    return check < m_checks.size() && m_doc.Attr().GetUlfc_(m_checks[check].name, constraint)
               ? UlfConstraintText(m_doc.Data(), constraint)
               : std::string();
}

T_OPT_DUMP CUlfItemDialog::Dump()
{
    return {m_dump, m_doc.Path(), [this] { return AskYesNo("IDS_QM_ULF_DUMP_EXISTS"); }};
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

const T_ULF_CALCULATION& CUlfItemDialog::Calculate()
{
    const std::vector<T_FINDING> found = Findings();
    m_calculation = found.empty() ? Calculated() : T_ULF_CALCULATION{{}, {}, found.front()};
    return m_calculation;
}

int CUlfItemDialog::OnCalculate()
{
    Calculate();
    if (const auto& said = m_calculation.said) ShowMessage(said->messageKey, said->text);
    return Result() ? 1 : 0;
}

int CUlfItemDialog::OnSolve()
{
    if (!OnCalculate()) return 0;
    CUnknownLoadFactorResultDlg dialog(m_doc, *Result());
    dialog.SetView(View());
    (void)dialog.DoModal();
    return 1;
}

int CUlfItemDialog::OnExplain(const std::function<bool(int, int)>& progress)
{
    m_explained.reset();
    Calculate();
    T_ULF_EXPLAINED explained;
    const auto& run = m_calculation.run;
    if (!run || !ExplainUlf(*run, m_doc.Unit().Units(), explained, progress)) return 0;
    m_explained = std::move(explained);
    return 1;
}

void CUlfItemDialog::ShowExplanation()
{
    const std::string said = m_calculation.said ? m_calculation.said->text : std::string();
    if (!m_explained) {
        if (!said.empty()) ShowMessage("IDS_RPS_Unknown_Load_Factor_Item_has_an_error", said);
        return;
    }
    CUlfExplanationDlg dialog(m_name, said, *m_explained);
    dialog.SetView(View());
    (void)dialog.DoModal();
}
