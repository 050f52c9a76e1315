// The push of load cases in a thread of its own.
#pragma once

#include "qm_rps/push/pushrun.h"

#include <condition_variable>
#include <mutex>
#include <thread>

/// A load case, and displacements of its control node (m) that are steps beside those of the
/// record.
struct T_PUSH_TASK {
    int key = 0;
    std::vector<double> extra{};
};

/// What has come of one load case.
struct T_PUSH_DONE {
    int key = 0;
    std::vector<T_PUSH_RUN> runs;
    std::string error; // not empty: what is wrong with model, hinges or load case
};

/// Pushes load cases one after the other from its making on. The document must stay as it is until
/// the end. The thread tells nobody: what it has done waits until somebody takes it. All operations
/// are for the thread that made it.
class CPushWorker {
public:
    /// Throws std::system_error when there is no thread to be had.
    CPushWorker(CDBDoc& doc, std::vector<T_PUSH_TASK> tasks);
    /// Cancels and waits for the end.
    ~CPushWorker();
    CPushWorker(const CPushWorker&) = delete;
    CPushWorker& operator=(const CPushWorker&) = delete;

    /// Ends the run with its next step, which stays; no further load case is begun.
    void Cancel();
    /// Waits with the next step, or goes on.
    void Pause(bool paused);

    /// Appends the steps done since the latest call, waiting up to waitMs for one or for the end.
    /// True: it has ended and these are the last ones.
    bool TakeSteps(int waitMs, std::vector<T_PUSH_PROGRESS>& out);
    /// Waits for the end; the load cases that were begun, in their order.
    std::vector<T_PUSH_DONE> Finish();

private:
    void Run();
    void PushOne(const T_PUSH_TASK& task);
    bool Tell(const T_PUSH_PROGRESS& step);

    std::vector<T_PUSH_TASK> m_tasks;
    std::mutex m_mutex; // of the five below
    std::condition_variable m_news, m_goOn;
    std::vector<T_PUSH_PROGRESS> m_steps;
    bool m_isPaused = false, m_isCancelled = false, m_isDone = false;
    CPushRun m_push;                 // of the thread until it has ended
    std::vector<T_PUSH_DONE> m_done; // likewise
    std::thread m_thread;            // the last one: it uses the others
};
