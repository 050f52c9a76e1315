#include "qm_rps/push/pushworker.h"

#include "qm_base/say.h"

#include <chrono>
#include <exception>
#include <new>
#include <utility>

CPushWorker::CPushWorker(CDBDoc& doc, std::vector<T_PUSH_TASK> tasks)
    : m_tasks(std::move(tasks)), m_push(doc), m_thread([this] { Run(); })
{
}

CPushWorker::~CPushWorker()
{
    Cancel();
    if (m_thread.joinable()) m_thread.join();
}

void CPushWorker::Cancel()
{
    const std::lock_guard lock(m_mutex);
    m_isCancelled = true;
    m_goOn.notify_all();
}

void CPushWorker::Pause(bool paused)
{
    const std::lock_guard lock(m_mutex);
    m_isPaused = paused;
    m_goOn.notify_all();
}

bool CPushWorker::TakeSteps(int waitMs, std::vector<T_PUSH_PROGRESS>& out)
{
    std::unique_lock lock(m_mutex);
    m_news.wait_for(lock, std::chrono::milliseconds(waitMs),
                    [this] { return m_isDone || !m_steps.empty(); });
    out.insert(out.end(), m_steps.begin(), m_steps.end());
    m_steps.clear();
    return m_isDone;
}

std::vector<T_PUSH_DONE> CPushWorker::Finish()
{
    if (m_thread.joinable()) m_thread.join();
    return std::move(m_done);
}

/// In the thread: keeps the step for who takes it; waits while there is a pause. False: cancelled.
bool CPushWorker::Tell(const T_PUSH_PROGRESS& step)
{
    std::unique_lock lock(m_mutex);
    m_steps.push_back(step);
    m_news.notify_all();
    m_goOn.wait(lock, [this] { return !m_isPaused || m_isCancelled; });
    return !m_isCancelled;
}

void CPushWorker::PushOne(const T_PUSH_TASK& task)
{
    T_PUSH_DONE done{task.key, {}, {}};
    try {
        const auto tell = [this](const T_PUSH_PROGRESS& step) { return Tell(step); };
        if (!m_push.Run(task.key, tell, done.runs, done.error, task.extra) && done.error.empty())
            done.error = Say("IDS_QM_PUSH_NO_RUN");
    } catch (const std::bad_alloc&) { // a thread must not throw
        done.runs.clear();
        done.error = Say("IDS_QM_NO_MEMORY");
    } catch (const std::exception& e) {
        done.runs.clear();
        done.error = e.what();
    }
    m_done.push_back(std::move(done));
}

void CPushWorker::Run()
{
    for (const T_PUSH_TASK& task : m_tasks) {
        {
            const std::lock_guard lock(m_mutex);
            if (m_isCancelled) break;
        }
        PushOne(task);
    }
    const std::lock_guard lock(m_mutex);
    m_isDone = true;
    m_news.notify_all();
}
