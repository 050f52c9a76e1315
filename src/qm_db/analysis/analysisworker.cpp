#include "qm_db/analysis/analysisworker.h"

#include "qm_base/say.h"

#include <chrono>
#include <exception>
#include <new>

CAnalysisWorker::CAnalysisWorker(JobFn job) : m_job(std::move(job)), m_thread([this] { Run(); }) {}

CAnalysisWorker::~CAnalysisWorker()
{
    Cancel();
    if (m_thread.joinable()) m_thread.join();
}

bool CAnalysisWorker::Tell(std::size_t done, std::size_t total)
{
    {
        const std::lock_guard<std::mutex> lock(m_mutex);
        m_parts.push_back({done, total});
    }
    m_news.notify_one();
    return !m_isCancelled;
}

void CAnalysisWorker::Run()
{
    const auto fail = [&](const std::string& reason,
                          ANALYSIS_FAULT fault = ANALYSIS_FAULT::Failed) {
        m_error = {};
        m_error.fault = fault;
        m_error.text = Say("IDS_QM_ANALYSIS_FAILED", reason);
    };
    try {
        m_hasResults =
            m_job([this](std::size_t done, std::size_t total) { return Tell(done, total); },
                  m_results, m_error);
    } catch (const std::bad_alloc&) {
        fail(Say("IDS_QM_NO_MEMORY"), ANALYSIS_FAULT::NoMemory);
    } catch (const std::exception& fault) {
        fail(fault.what());
    } catch (...) {
        fail(Say("IDS_QM_ANALYSIS_UNKNOWN"));
    }
    const std::lock_guard<std::mutex> lock(m_mutex);
    m_isDone = true;
    m_news.notify_one();
}

bool CAnalysisWorker::TakeParts(int waitMs, std::vector<T_PART>& out)
{
    std::unique_lock<std::mutex> lock(m_mutex);
    m_news.wait_for(lock, std::chrono::milliseconds(waitMs),
                    [this] { return m_isDone || !m_parts.empty(); });
    out.insert(out.end(), m_parts.begin(), m_parts.end());
    m_parts.clear();
    return m_isDone;
}

int CAnalysisWorker::Finish(T_ANALYSIS_RESULTS& results, T_ANALYSIS_ERROR& error)
{
    if (m_thread.joinable()) m_thread.join();
    results = std::move(m_results);
    error = std::move(m_error);
    return m_hasResults;
}
