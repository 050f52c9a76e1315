// An analysis in a thread of its own.
#pragma once

#include "qm_db/analysisrun.h"

#include <atomic>
#include <condition_variable>
#include <functional>
#include <mutex>
#include <thread>
#include <vector>

/// Runs one job from its making on. The thread calls nothing but the job: the parts that it has
/// done wait until somebody takes them. All operations are for the thread that made it.
class CAnalysisWorker {
public:
    struct T_PART {
        std::size_t done = 0, total = 0;
    };
    using ProgressFn = std::function<bool(std::size_t done, std::size_t total)>;
    /// 1 done; 0 error filled. What it throws becomes the error Failed.
    using JobFn =
        std::function<int(const ProgressFn& progress, T_ANALYSIS_RESULTS&, T_ANALYSIS_ERROR&)>;

    /// Throws std::system_error when there is no thread to be had.
    explicit CAnalysisWorker(JobFn job);
    /// Cancels and waits for the job's end.
    ~CAnalysisWorker();
    CAnalysisWorker(const CAnalysisWorker&) = delete;
    CAnalysisWorker& operator=(const CAnalysisWorker&) = delete;

    /// The job is told with its next part.
    void Cancel() { m_isCancelled = true; }
    bool IsCancelled() const { return m_isCancelled; }

    /// Appends the parts done since the latest call, waiting up to waitMs for one or for the end.
    /// True: the job has ended and these are the last ones.
    bool TakeParts(int waitMs, std::vector<T_PART>& out);
    /// Waits for the end. 1 results; 0 error.
    [[nodiscard]] int Finish(T_ANALYSIS_RESULTS& results, T_ANALYSIS_ERROR& error);

private:
    void Run();
    bool Tell(std::size_t done, std::size_t total);

    JobFn m_job;
    std::atomic<bool> m_isCancelled = false;
    std::mutex m_mutex; // of the parts and of m_isDone
    std::condition_variable m_news;
    std::vector<T_PART> m_parts;
    bool m_isDone = false;
    // Of the thread until it has ended.
    T_ANALYSIS_RESULTS m_results;
    T_ANALYSIS_ERROR m_error;
    int m_hasResults = 0;
    std::thread m_thread; // the last one: it uses the others
};
