#include "qm_rps/unknownloadfactoritemdlg.h"

#include "qm_base/textformat.h"
#include "qm_rps/factors/checks/ulfitemchecks.h"
#include "qm_rps/factors/ulfcombination.h"
#include "qm_rps/factors/ulfstore.h"
#include "qm_rps/ulfcalculation.h"

#include <algorithm>

CUnknownLoadFactorItemDlg::CUnknownLoadFactorItemDlg(CDBDoc& doc, int key)
    : CUlfItemDialog(doc), m_key(key), m_source(doc),
      m_cache(m_source, [this] { return m_doc.Post().StaticRevision(); })
{
    T_ULFI_D item;
    if (!m_doc.Attr().GetUlfi(key, item)) {
        m_key = 0;
        const std::vector<int> combinations = m_doc.Attr().GetLcomKeys();
        if (!combinations.empty()) item.combination = combinations.front();
    }
    Data2Dlg(item);
}

void CUnknownLoadFactorItemDlg::Data2Dlg(const T_ULFI_D& item)
{
    m_name = item.name;
    m_objective = item.objective;
    m_sign = item.sign;
    m_solveByEquations = item.solveByEquations;
    m_cases.clear();
    m_strangers = item.unknowns;
    OnSelChangeCombination(item.combination);

    SetChecks(item.constraints, false);
}

void CUnknownLoadFactorItemDlg::OnSelChangeCombination(int key)
{
    std::vector<T_ULFI_UNKNOWN> before = Record().unknowns;
    m_combination = key;
    m_cases.clear();
    if (const std::optional<T_LCOM_D> flat = FlatCombination(m_doc.Data(), key))
        for (const T_LCOM_ITEM& entry : flat->items) {
            T_STLD_D loadCase;
            if (!m_doc.Attr().GetStld(entry.key, loadCase)) continue;
            T_ULF_CASE row{entry.key, loadCase.name, entry.factor};
            const auto it = std::find_if(before.begin(), before.end(),
                                         [&](const auto& u) { return u.loadCase == entry.key; });
            if (it != before.end()) {
                row.unknown = true;
                row.weight = it->weight;
                before.erase(it);
            }
            m_cases.push_back(std::move(row));
        }
    m_strangers = std::move(before);
}

T_ULFI_D CUnknownLoadFactorItemDlg::Record() const
{
    T_ULFI_D item{m_name, m_combination, m_objective, m_sign, m_solveByEquations, {}, {}};
    for (const T_ULF_CASE& c : m_cases)
        if (c.unknown) item.unknowns.push_back({c.key, c.weight});
    item.unknowns.insert(item.unknowns.end(), m_strangers.begin(), m_strangers.end());
    item.constraints = CheckedNames();
    return item;
}

int CUnknownLoadFactorItemDlg::Dlg2Data(T_ULFI_D& item)
{
    if (!CheckData()) return 0;
    item = Record();
    return 1;
}

std::string CUnknownLoadFactorItemDlg::CellText(std::size_t row, COLUMN column) const
{
    if (row >= m_cases.size()) return {};
    const T_ULF_CASE& c = m_cases[row];
    switch (column) {
    case LoadCase:
        return c.name;
    case Unknown:
        return Flag(c.unknown);
    case Known:
        return Flag(!c.unknown);
    case Factor:
        return FormatText("%.3f", c.factor);
    default:
        return FormatText("%.6f", c.weight);
    }
}

int CUnknownLoadFactorItemDlg::SetCell(std::size_t row, COLUMN column, const std::string& text)
{
    if (row >= m_cases.size()) return 0;
    T_ULF_CASE& c = m_cases[row];
    if (column == Unknown && (text == "0" || text == "1")) {
        c.unknown = text == "1";
        return 1;
    }
    const std::optional<double> number = ParseFinite(text);
    if (column != Weight || !number) return 0;
    // The shown text handed back keeps the digits that it does not show.
    if (text != CellText(row, Weight)) c.weight = *number;
    return 1;
}

std::vector<T_FINDING> CUnknownLoadFactorItemDlg::Findings() const
{
    return CheckUlfItem(Record(), m_key, m_doc.Data());
}

int CUnknownLoadFactorItemDlg::OnOK()
{
    T_ULFI_D item;
    return Dlg2Data(item) ? StoreRecord(m_doc, m_key, item) : 0;
}

std::optional<T_ANALYSIS_OPTIONS> CUnknownLoadFactorItemDlg::MissingResults() const
{
    T_ANALYSIS_OPTIONS options;
    options.allCases = options.stages = false;
    for (const T_ULF_CASE& c : m_cases)
        if (!m_doc.Post().CheckStaticResult(c.key)) options.cases.push_back(c.key);
    return options.cases.empty() ? std::nullopt : std::optional(options);
}

std::vector<std::string> CUnknownLoadFactorItemDlg::CombinationTexts() const
{
    std::vector<std::string> names;
    for (const auto& entry : m_doc.Data().Model().combinations)
        names.push_back(entry.second.name);
    return names;
}

int CUnknownLoadFactorItemDlg::CombinationIndex() const
{
    const std::vector<int> keys = m_doc.Attr().GetLcomKeys();
    const auto it = std::ranges::find(keys, m_combination);
    return it == keys.end() ? -1 : static_cast<int>(it - keys.begin());
}

void CUnknownLoadFactorItemDlg::OnSelChangeCombinationIndex(int index)
{
    const std::vector<int> keys = m_doc.Attr().GetLcomKeys();
    if (index >= 0 && index < static_cast<int>(keys.size()))
        OnSelChangeCombination(keys[static_cast<std::size_t>(index)]);
}

T_ULF_CALCULATION CUnknownLoadFactorItemDlg::Calculated()
{
    return CalculateUlf(m_doc, Record(), m_cases, m_cache, Dump());
}
