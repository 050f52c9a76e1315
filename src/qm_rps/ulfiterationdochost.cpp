#include "qm_rps/ulfiterationdochost.h"

#include "qm_base/messagehistory.h"
#include "qm_base/msgfunction.h"
#include "qm_rps/factors/ulfstageplace.h"
#include "qm_rps/factors/ulfstageproblem.h"
#include "qm_rps/factors/ulfstageresults.h"

#include <set>

using zql::lib::MMSGFunction;

CUlfIterationDocHost::CUlfIterationDocHost(CDBDoc& doc, T_ULSI_D item)
    : m_doc(doc), m_item(std::move(item)), m_start(PretensionOf(m_item, doc.Data()))
{
}

std::vector<T_ULF_ANALYSED> CUlfIterationDocHost::Analysed(double tolerance)
{
    CUlfStageResults results(m_doc);
    std::vector<T_ULF_ANALYSED> all;
    if (m_result &&
        !CompareWithAnalysis(*m_run, *m_result, m_item, m_doc.Data(), results, tolerance, all))
        all.clear();
    return all;
}

std::vector<T_ULF_STAY> CUlfIterationDocHost::Stays()
{
    CUlfStageResults results(m_doc);
    return StaysOf(m_start, m_doc.Data(), results);
}

int CUlfIterationDocHost::Refuse(const std::string& text)
{
    m_error = text;
    GSaveHistoryFormatNF("%s", text.c_str());
    return 0;
}

std::vector<T_ULF_ITER_ROW> CUlfIterationDocHost::RowsOf(const T_ULF_RUN& run) const
{
    std::vector<T_ULF_ITER_ROW> rows;
    for (std::size_t i = 0; i < m_unknowns.size(); ++i) {
        const T_ULSI_ROW& row = m_item.rows[m_unknowns[i]];
        rows.push_back({UlfPlaceText(m_doc.Data(), row.stage, row.step), run.answer.factors[i],
                        row.pretension, m_doc.Data().Model().loadCases.at(row.loadCase).name});
    }
    return rows;
}

int CUlfIterationDocHost::Solve(std::vector<T_ULF_ITER_ROW>& rows, std::optional<T_FINDING>& said)
{
    CUlfStageResults results(m_doc);
    CUlfStageResponse source(results);
    T_ULF_CALCULATION calculation = CalculateUlfStages(m_doc, m_item, source);
    said = calculation.said;
    m_unknowns = calculation.run->formed.unknowns;
    if (!calculation.result) {
        m_error = said->text;
        return 0;
    }
    rows = RowsOf(*calculation.run);
    m_result = std::move(calculation.result);
    m_run = std::move(calculation.run);
    return 1;
}

int CUlfIterationDocHost::SaveCopy(const std::string& path)
{
    T_FILE_ERROR error;
    m_isSaveRefused = !m_doc.SaveAs(path, error);
    return m_isSaveRefused ? Refuse(error.text) : 1;
}

int CUlfIterationDocHost::StartEdit(const std::string& title)
{
    m_isScaled = false;
    m_before = m_doc.Data().StagedResult();
    return m_doc.Undo().StartEditDB(title);
}

int CUlfIterationDocHost::ScaleLoad(int loadCase, double factor)
{
    T_STLD_D load;
    if (!m_doc.Attr().GetStld(loadCase, load)) return 0;
    std::set<int> elements; // several tensions of one element are read and written as one
    for (const T_PTNS_D& p : load.pretension)
        elements.insert(p.element);
    for (const int element : elements) {
        T_PTNS_D pretension;
        bool done = m_doc.Attr().GetPtns(loadCase, element, pretension) != 0;
        pretension.force *= factor;
        done = done && m_doc.Edit().AddPtns(loadCase, pretension);
        if (!done)
            return Refuse(MMSGFunction::Format("IDS_QM_ULF_PRETENSION_NOT_CHANGED",
                                               {std::to_string(element), load.name}));
        m_isScaled = true;
    }
    return 1;
}

int CUlfIterationDocHost::ScalePretension(std::size_t unknown, double factor)
{
    const T_ULSI_ROW& row = m_item.rows[m_unknowns[unknown]];
    for (const int loadCase : LoadsScaledBy(m_doc.Data().Model(), row))
        if (!ScaleLoad(loadCase, factor)) return 0;
    return 1;
}

int CUlfIterationDocHost::CloseEdit()
{
    return m_doc.Undo().CloseEditDB();
}

void CUlfIterationDocHost::CancelEdit()
{
    if (m_doc.Edit().IsOpen()) (void)m_doc.Undo().CancelEditDB();
    m_isScaled = false;
}

void CUlfIterationDocHost::UndoEdit()
{
    if (m_isScaled && m_doc.Undo().Undo()) m_doc.Data().SetStagedResult(m_before);
    m_isScaled = false;
}

int CUlfIterationDocHost::StartAnalysis()
{
    T_ANALYSIS_OPTIONS options;
    options.allCases = false;
    T_ANALYSIS_ERROR error;
    m_isAnalysed = false;
    return m_doc.StartAnalysis(options, error) ? 1 : Refuse(error.text);
}

int CUlfIterationDocHost::EndAnalysis()
{
    T_ANALYSIS_ERROR error;
    if (m_doc.AnalysisOutcome(error)) return SaveCopy(m_doc.Path());
    return error.fault == ANALYSIS_FAULT::Cancelled ? 0 : Refuse(error.text);
}

void CUlfIterationDocHost::Wait()
{
    constexpr int kWaitMs = 2; // short enough for a window
    if (!m_doc.IsExcuted() || m_doc.PollAnalysis(kWaitMs)) return;
    m_isAnalysed = EndAnalysis() != 0;
    if (m_isAnalysed) m_before = nullptr;
}
