#include "qm_rps/factors/ulfanalysis.h"

int RunWatchedAnalysis(CDBDoc& doc, T_ANALYSIS_OPTIONS options, const ULF_PROGRESS& progress,
                       T_ANALYSIS_ERROR& error)
{
    constexpr int kWaitMs = 5; // short enough for a window
    std::size_t done = 0, total = 0;
    options.progress = [&](std::size_t d, std::size_t t) {
        done = d;
        total = t;
        return true;
    };
    if (!doc.StartAnalysis(std::move(options), error)) return 0;
    while (doc.PollAnalysis(kWaitMs))
        if (progress && !progress(done, total)) doc.CancelAnalysis();
    return doc.AnalysisOutcome(error);
}
