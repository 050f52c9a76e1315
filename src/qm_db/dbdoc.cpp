#include "qm_db/dbdoc.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/casefile.h"
#include "qm_db/filectrl.h"

#include <algorithm>
#include <filesystem>
#include <utility>

namespace {

CDBDoc*& CurrentDoc()
{
    static CDBDoc* current = nullptr; // the documented switch: which document is current
    return current;
}

T_ANALYSIS_ERROR Failure(ANALYSIS_FAULT fault, const std::string& text)
{
    T_ANALYSIS_ERROR error;
    error.fault = fault;
    error.text = text;
    return error;
}

} // namespace

CDBDoc::CDBDoc()
{
    SetDocPoint(this);
}

CDBDoc::~CDBDoc()
{
    if (GetDocPoint() == this) SetDocPoint(nullptr);
}

CDBDoc* CDBDoc::GetDocPoint()
{
    return CurrentDoc();
}
void CDBDoc::SetDocPoint(CDBDoc* doc)
{
    CurrentDoc() = doc;
}

void CDBDoc::Reset(T_MODEL_CONTENT content, const std::string& path)
{
    AbandonAnalysis();
    m_data.Assign(std::move(content));
    m_undo.Clear();
    m_path = path;
    m_caseSum.reset();
    CFileCtrl::MakeFilesLike(path);
}

void CDBDoc::NewModel()
{
    m_store.Close();
    Reset({}, {});
}

int CDBDoc::OpenModel(const std::string& path, OPEN_MODE mode, T_FILE_ERROR& error)
{
    T_MODEL_CONTENT content;
    if (!m_store.Open(path, mode, content, error)) return 0;
    Reset(std::move(content), path);
    return 1;
}

int CDBDoc::RecoverModel(const std::string& copy, const std::string& path, T_FILE_ERROR& error)
{
    T_MODEL_CONTENT content, saved;
    if (!CModelStore().Open(copy, OPEN_MODE::ReadOnly, content, error)) return 0;
    T_FILE_ERROR fault;
    const bool isModel = std::filesystem::exists(path) && CModelStore::IsModelFile(path);
    if (!isModel || !m_store.Open(path, OPEN_MODE::Edit, saved, fault)) {
        if (fault.fault == FILE_FAULT::NoAccess) {
            error = fault;
            return 0;
        }
        m_store.Close();
    }
    Reset(std::move(content), path);
    m_data.SetModified(true);
    return 1;
}

int CDBDoc::ImportCase(const std::string& path, T_FILE_ERROR& error)
{
    T_MODEL_CONTENT content;
    CFileCtrl::SweepBeside(path);
    std::string text;
    const std::string folder = std::filesystem::path(path).parent_path().string();
    if (!CFileCtrl::ReadWholeFile(path, text, error) ||
        !CCaseFile::Parse(text, path, folder, content, error))
        return 0;
    m_store.Close();
    Reset(std::move(content), path);
    m_caseSum = CFileCtrl::SumOf(text);
    return 1;
}

int CDBDoc::SaveModel(T_FILE_ERROR& error)
{
    return SaveModelAs(m_path, error);
}

int CDBDoc::SaveModelAs(const std::string& path, T_FILE_ERROR& error)
{
    std::string saved = path;
    if (!m_store.Save(path, m_data.Content(), error)) return 0;
    m_caseSum.reset();
    m_path = std::move(saved);
    m_data.SetModified(false);
    return 1;
}

int CDBDoc::ExportCase(const std::string& path, T_FILE_ERROR& error) const
{
    return CCaseFile::Write(path, m_data.Content(), error);
}

int CDBDoc::SaveAs(const std::string& path, T_FILE_ERROR& error)
{
    if (!CFileCtrl::CheckOutput({path, OUTPUT_KIND::Document}, error)) return 0;
    if (CFileCtrl::IsModelName(path)) return SaveModelAs(path, error);
    std::string text;
    if (!CCaseFile::Print(m_data.Content(), text, error)) {
        error.text = path + ": " + error.text;
        return 0;
    }
    const bool isKnown = m_caseSum && path == m_path;
    if (!(isKnown ? CFileCtrl::UpdateWholeFile(path, text, *m_caseSum, error)
                  : CFileCtrl::WriteWholeFile(path, text, error)))
        return 0;
    m_path = path;
    m_caseSum = CFileCtrl::SumOf(text);
    m_data.SetModified(false);
    return 1;
}

void CDBDoc::AcceptChanges()
{
    m_store.AcceptChanges();
    m_caseSum.reset();
}

int CDBDoc::StartAnalysis(T_ANALYSIS_OPTIONS options, T_ANALYSIS_ERROR& error)
{
    if (m_worker) {
        error = Failure(ANALYSIS_FAULT::Failed, Say("IDS_QM_ANALYSIS_RUNNING"));
        return 0;
    }
    error = {};
    m_progress = std::exchange(options.progress, {});
    m_revisionAtStart = m_data.Revision();
    auto job = [model = m_data.Model(), options = std::move(options),
                before = m_data.StagedResult()](const auto& progress, T_ANALYSIS_RESULTS& out,
                                                T_ANALYSIS_ERROR& fault) {
        T_ANALYSIS_OPTIONS told = options;
        told.progress = progress;
        return CAnalysisRun::Compute(model, told, before, out, fault);
    };
    try {
        m_worker = std::make_shared<CAnalysisWorker>(std::move(job));
    } catch (const std::exception& fault) { // no thread
        error = Failure(ANALYSIS_FAULT::NoMemory, fault.what());
        return 0;
    }
    m_data.SetLocked(true);
    return 1;
}

bool CDBDoc::PollAnalysis(int waitMs)
{
    if (!m_worker || m_isTelling) return IsExcuted();
    const std::shared_ptr<CAnalysisWorker> worker = m_worker; // the progress may abandon the run
    std::vector<CAnalysisWorker::T_PART> parts;
    const bool isDone = worker->TakeParts(waitMs, parts);
    struct T_TELLING {
        bool& flag;
        explicit T_TELLING(bool& f) : flag(f) { flag = true; }
        ~T_TELLING() { flag = false; }
    } const telling(m_isTelling);
    for (const auto& [done, total] : parts) {
        if (m_worker != worker || worker->IsCancelled() || !m_progress) break;
        if (!m_progress(done, total)) worker->Cancel();
    }
    if (isDone && m_worker == worker) EndAnalysis();
    return IsExcuted();
}

void CDBDoc::EndAnalysis()
{
    const std::shared_ptr<CAnalysisWorker> worker = std::exchange(m_worker, nullptr);
    m_progress = {};
    m_data.SetLocked(false);
    T_ANALYSIS_RESULTS results;
    const int done = worker->Finish(results, m_outcome);
    m_lost = results.lost;
    if (worker->IsCancelled())
        m_outcome = Failure(ANALYSIS_FAULT::Cancelled, Say("IDS_QM_ENGINE_CANCELLED"));
    else if (done && m_data.Revision() != m_revisionAtStart)
        m_outcome = Failure(ANALYSIS_FAULT::Failed, Say("IDS_QM_ANALYSIS_CHANGED"));
    else if (done && !CAnalysisRun(*this).Keep(std::move(results)))
        m_outcome = Failure(ANALYSIS_FAULT::Failed, Say("IDS_QM_ANALYSIS_MODES"));
}

void CDBDoc::AbandonAnalysis()
{
    if (!m_worker) return;
    m_worker->Cancel();
    EndAnalysis();
}

void CDBDoc::CancelAnalysis()
{
    if (m_worker) m_worker->Cancel();
}

int CDBDoc::AnalysisOutcome(T_ANALYSIS_ERROR& error) const
{
    error = m_outcome;
    return error.fault == ANALYSIS_FAULT::None ? 1 : 0;
}

std::string CDBDoc::TextOf(const T_LOST_DIGITS& lost) const
{
    const auto at = m_data.Model().loadCases.find(lost.loadCase);
    const std::string where =
        at == m_data.Model().loadCases.end() ? Say("IDS_QM_ANALYSIS_STAGES_ALL") : at->second.name;
    return Say("IDS_QM_ANALYSIS_REFINED", where, FormatText("%.0e", lost.unrefined),
               FormatText("%.0e", lost.error));
}

int CDBDoc::RunAnalysis(const T_ANALYSIS_OPTIONS& options, T_ANALYSIS_ERROR& error)
{
    constexpr int kWaitMs = 1000; // news come at once
    if (!StartAnalysis(options, error)) return 0;
    try {
        while (PollAnalysis(kWaitMs)) {
        }
    } catch (...) {
        AbandonAnalysis();
        throw;
    }
    return AnalysisOutcome(error);
}

bool CDBDoc::IsPostMode()
{
    if (!m_data.Model().stages.empty()) return m_post.CheckStagedResult() != 0;
    const std::vector<int> cases = m_attr.GetStldKeys();
    return std::any_of(cases.begin(), cases.end(),
                       [&](int key) { return m_post.CheckStaticResult(key) != 0; });
}
