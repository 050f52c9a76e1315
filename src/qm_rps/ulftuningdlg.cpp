#include "qm_rps/ulftuningdlg.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/desk/recordnames.h"
#include "qm_rps/factors/ulfstageproblem.h"
#include "qm_rps/factors/ulfstageresults.h"
#include "qm_rps/factors/ulfstaticresponse.h"
#include "qm_rps/unknownloadfactoritemdlg.h"
#include "qm_rps/unknownstageitemdlg.h"

#include <algorithm>
#include <cmath>

namespace {

std::string Number(double value)
{
    return FormatText("%.7g", value + 0.0); // a negative zero as 0
}

std::string Number(const std::optional<double>& value)
{
    return value ? Number(*value) : "-";
}

} // namespace

CUlfTuningDlg::CUlfTuningDlg(CDBDoc& doc) : m_doc(doc)
{
    OnSelChangeItem(0);
}

// ---- the item -----------------------------------------------------------------------------------

std::vector<std::string> CUlfTuningDlg::ItemTexts() const
{
    const T_MODEL& model = m_doc.Data().Model();
    std::vector<std::string> names = NamesOf(model.ulfItems);
    for (std::string& name : NamesOf(model.ulfStageItems))
        names.push_back(std::move(name));
    return names;
}

void CUlfTuningDlg::Clear()
{
    m_result.reset();
    m_unknowns.clear();
    m_found.clear();
    m_factors.clear();
    m_stays.clear();
    m_deck = {};
    m_values = {};
    m_chosen = 0;
}

void CUlfTuningDlg::OnSelChangeItem(int index)
{
    if (IsRunning()) return;
    Clear();
    m_run.reset();
    m_item.reset();
    const T_MODEL& model = m_doc.Data().Model();
    m_statics = static_cast<int>(model.ulfItems.size());
    const int count = m_statics + static_cast<int>(model.ulfStageItems.size());
    m_index = index >= 0 && index < count ? index : -1;
    m_why = m_index < 0 ? Say("IDS_QM_TUNE_NO_ITEM") : std::string();
    if (m_index < 0) return;
    if (IsStage()) {
        const int key = std::next(model.ulfStageItems.begin(), m_index - m_statics)->first;
        auto item = std::make_unique<CUnknownStageItemDlg>(m_doc, key);
        m_stageItem = item->Record();
        m_item = std::move(item);
    } else {
        const int key = std::next(model.ulfItems.begin(), m_index)->first;
        m_item = std::make_unique<CUnknownLoadFactorItemDlg>(m_doc, key);
    }
    (void)Solve();
}

int CUlfTuningDlg::OnOpen(const std::string& item)
{
    const std::vector<std::string> names = ItemTexts();
    const auto it = std::ranges::find(names, item);
    if (it == names.end()) return 0;
    OnSelChangeItem(static_cast<int>(it - names.begin()));
    return 1;
}

int CUlfTuningDlg::OnSolve(const ULF_PROGRESS& progress)
{
    if (!m_item || IsRunning()) return 0;
    std::string error;
    if (!m_item->OnAnalyse(progress, error)) {
        m_why = error;
        return 0;
    }
    return Solve();
}

int CUlfTuningDlg::Solve()
{
    Clear();
    const T_ULF_CALCULATION& calculation = m_item->Calculate();
    m_why = calculation.said ? calculation.said->text : std::string();
    if (!calculation.result) return 0;
    m_result = calculation.result;
    for (std::size_t j = 0; j < m_result->cases.size(); ++j)
        if (m_result->cases[j].unknown) {
            m_unknowns.push_back(j);
            m_found.push_back(m_result->factors[j]);
        }
    m_factors = m_found;
    ReadStays();
    return ReadValues();
}

T_STLD_D CUlfTuningDlg::LoadOf(int key) const
{
    T_STLD_D load; // in current units; empty where there is none
    (void)m_doc.Attr().GetStld(key, load);
    return load;
}

void CUlfTuningDlg::ReadStays()
{
    const auto add = [this](const std::vector<int>& loads, std::size_t unknown) {
        const std::size_t before = m_stays.size();
        for (const int key : loads) {
            const T_STLD_D load = LoadOf(key);
            for (const auto& [element, start] : PretensionByElement(load))
                m_stays.push_back({element, load.name, start, unknown});
        }
        if (m_stays.size() == before) m_stays.push_back({0, NameOf(unknown), 0.0, unknown});
    };
    std::size_t unknown = 0;
    if (IsStage()) {
        for (const T_ULSI_ROW& row : m_stageItem.rows)
            if (row.unknown) add(LoadsScaledBy(m_doc.Data().Model(), row), unknown++);
        return;
    }
    for (const std::size_t j : m_unknowns)
        add({m_result->cases[j].key}, unknown++);
}

int CUlfTuningDlg::ReadValues()
{
    std::vector<int> elements;
    for (const T_STAY& stay : m_stays)
        if (stay.element != 0) elements.push_back(stay.element);
    const T_MODEL& model = m_doc.Data().Model();
    m_deck = DeckOf(model, Units(), elements);
    std::string error;
    int done = 0;
    if (IsStage()) {
        CUlfStageResults results(m_doc);
        done = m_values.Read(m_deck, m_stageItem, model, results);
        if (!done) error = results.Error();
    } else {
        CUlfStaticResponse source(m_doc);
        done = m_values.Read(m_deck, *m_result, source);
        if (!done) error = source.Error();
    }
    if (!done) {
        Clear();
        m_why = error;
    }
    return done;
}

// ---- the factors --------------------------------------------------------------------------------

const std::string& CUlfTuningDlg::NameOf(std::size_t unknown) const
{
    return m_result->cases.at(m_unknowns.at(unknown)).name;
}

int CUlfTuningDlg::OnFactor(std::size_t unknown, double factor)
{
    if (unknown >= m_factors.size() || !(std::fabs(factor) <= kMostFactor)) return 0;
    m_factors[unknown] = factor;
    m_result->factors[m_unknowns[unknown]] = factor;
    return 1;
}

/// From the factor that was found as far as its size (at least 0.5) to either side.
int CUlfTuningDlg::SliderPosition() const
{
    const auto u = static_cast<std::size_t>(m_chosen);
    if (u >= m_factors.size()) return 0;
    const double reach = std::max(std::fabs(m_found[u]), 0.5);
    const double part = (m_factors[u] - m_found[u] + reach) / (2.0 * reach);
    return static_cast<int>(std::lround(kSlider * std::clamp(part, 0.0, 1.0)));
}

void CUlfTuningDlg::OnSlider(int position)
{
    const auto u = static_cast<std::size_t>(m_chosen);
    if (u >= m_factors.size() || position == SliderPosition()) return;
    const double reach = std::max(std::fabs(m_found[u]), 0.5);
    (void)OnFactor(u, m_found[u] + reach * (2.0 * position / kSlider - 1.0));
}

void CUlfTuningDlg::OnReset()
{
    for (std::size_t u = 0; u < m_found.size(); ++u)
        (void)OnFactor(u, m_found[u]);
}

// ---- what follows from them ---------------------------------------------------------------------

T_TEXT_TABLE CUlfTuningDlg::StayCells() const
{
    const std::string unit = " (" + std::string(::NameOf(Units().force)) + ")";
    T_TEXT_TABLE t{{{Say("IDS_QM_TUNE_STAY"), true},
                    {Say("IDS_RPS_GXGRID_LCase")},
                    {Say("IDS_QM_TUNE_START") + unit, true},
                    {Say("IDS_RPS_GXGRID_Factor"), true},
                    {Say("IDS_QM_TUNE_FINAL") + unit, true},
                    {Say("IDS_QM_TUNE_FORCE") + unit, true}},
                   {}};
    const std::vector<double> forces = Values().stays;
    std::size_t next = 0; // force
    for (const T_STAY& stay : m_stays) {
        const double factor = m_factors[stay.unknown];
        if (stay.element == 0)
            t.rows.push_back({"-", stay.load, "-", Number(factor), "-", "-"});
        else
            t.rows.push_back({std::to_string(stay.element), stay.load, Number(stay.start),
                              Number(factor), Number(factor * stay.start),
                              Number(forces.at(next++))});
    }
    return t;
}

int CUlfTuningDlg::UnknownOfRow(int row) const
{
    return row >= 0 && row < std::ssize(m_stays)
               ? static_cast<int>(m_stays[static_cast<std::size_t>(row)].unknown)
               : -1;
}

int CUlfTuningDlg::RowOfUnknown(int unknown) const
{
    const auto it = std::ranges::find(m_stays, static_cast<std::size_t>(unknown), &T_STAY::unknown);
    return it == m_stays.end() ? -1 : static_cast<int>(it - m_stays.begin());
}

T_TEXT_TABLE CUlfTuningDlg::ConstraintCells() const
{
    T_TEXT_TABLE t{{{Say("IDS_QM_CLI_CONSTRAINT")},
                    {Say("IDS_QM_CLI_VALUE"), true},
                    {Say("IDS_QM_CLI_LOWER"), true},
                    {Say("IDS_QM_CLI_UPPER"), true},
                    {Say("IDS_QM_UI_ULF_UNIT")},
                    {Say("IDS_QM_UI_ULF_STATE")}},
                   {}};
    if (!m_result) return t;
    const std::vector<T_ULF_RESULT_ROW> rows = UlfResultRows(*m_result);
    for (std::size_t i = 0; i < rows.size(); ++i) {
        const T_ULF_RESULT_ROW& row = rows[i];
        const char* const state = !row.met     ? "IDS_QM_UI_ULF_NOT_MET"
                                  : row.active ? "IDS_QM_UI_ULF_AT_BOUND"
                                               : "IDS_QM_UI_ULF_WITHIN";
        t.rows.push_back({UlfNameAt(row.name, row.place),
                          Number(UlfShown(row.value, UlfScale(*m_result, i))), Number(row.lower),
                          Number(row.upper), row.unit, Say(state)});
    }
    return t;
}

bool CUlfTuningDlg::IsMet() const
{
    return m_result && std::ranges::all_of(UlfResultRows(*m_result), &T_ULF_RESULT_ROW::met);
}

T_TEXT_TABLE CUlfTuningDlg::DeckCells() const
{
    const std::string L(::NameOf(Units().length)), F(::NameOf(Units().force));
    T_TEXT_TABLE t{{{Say("IDS_QM_TUNE_ALONG") + " (" + L + ")", true},
                    {Say("IDS_QM_UI_ULF_QUANTITY")},
                    {Say("IDS_QM_TUNE_BEFORE"), true},
                    {Say("IDS_QM_TUNE_NOW"), true},
                    {Say("IDS_QM_UI_ULF_UNIT")}},
                   {}};
    const CUlfDeckValues::T_VALUES before = ValuesBefore(), now = Values();
    const auto add = [&t](const std::vector<T_DECK_STATION>& at, const std::vector<double>& was,
                          const std::vector<double>& is, const std::string& unit,
                          const auto& name) {
        for (std::size_t i = 0; i < std::min(at.size(), is.size()); ++i)
            t.rows.push_back(
                {Number(at[i].along), name(at[i].what), Number(was[i]), Number(is[i]), unit});
    };
    add(m_deck.displacements, before.displacements, now.displacements, L,
        [](const T_OPT_QUANTITY& q) { return Say("IDS_QM_TUNE_NODE", std::to_string(q.id)); });
    add(m_deck.moments, before.moments, now.moments, F + " " + L, [](const T_OPT_QUANTITY& q) {
        return Say("IDS_QM_TUNE_BEAM", std::to_string(q.id), std::to_string(q.position));
    });
    return t;
}

CUlfDeckValues::T_VALUES CUlfTuningDlg::ValuesBefore() const
{
    if (!IsStage()) return m_values.At(m_found);
    return m_values.At(std::vector<double>(m_factors.size(), 1.0));
}

std::string CUlfTuningDlg::StatusText() const
{
    std::string text = IsRunning() ? m_run->StatusText() : m_why;
    if (!m_result || IsRunning()) return text;
    const bool analysed = IsStage() && std::ranges::all_of(m_factors, [](double factor) {
                              constexpr double kSame = 1e-9;
                              return std::fabs(factor - 1.0) <= kSame;
                          });
    const char* const how = analysed    ? "IDS_QM_TUNE_ANALYSED"
                            : IsStage() ? "IDS_QM_TUNE_SUPERPOSED"
                                        : "IDS_QM_TUNE_LINEAR";
    return Say(how) + (text.empty() ? "" : "\n" + text);
}

// ---- iteration ----------------------------------------------------------------------------------

int CUlfTuningDlg::OnIterate()
{
    if (!IsStage() || m_index < 0 || IsRunning()) return 0;
    const T_MODEL& model = m_doc.Data().Model();
    const int key = std::next(model.ulfStageItems.begin(), m_index - m_statics)->first;
    m_run = std::make_unique<CUlfIterationRunDlg>(m_doc, key);
    m_run->SetView(View());
    m_run->m_changed = m_changed;
    const int done = m_run->OnRun();
    const std::string status = m_run->StatusText();
    if (m_doc.Post().CheckStagedResult()) (void)Solve();
    m_why = m_why.empty() ? status : status + "\n" + m_why;
    return done;
}

void CUlfTuningDlg::OnStop()
{
    if (IsRunning()) m_run->OnCancelRun();
}

bool CUlfTuningDlg::OnClose()
{
    OnStop();
    return !IsRunning();
}
