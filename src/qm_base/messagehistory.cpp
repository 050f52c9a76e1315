#include "qm_base/messagehistory.h"

#include "qm_base/textformat.h"

#include <cstdarg>
#include <deque>
#include <mutex>
#include <utility>

namespace {

constexpr std::size_t kMostLines = 1000;

struct T_HISTORY {
    std::mutex lock;
    std::deque<std::string> lines;
    std::function<void(std::string_view)> sink;
};

T_HISTORY& History()
{
    static T_HISTORY history; // one history of the process, like the debug trace
    return history;
}

} // namespace

void GSaveHistoryFormatNF(const char* fmt, ...)
{
    std::va_list args;
    va_start(args, fmt);
    const std::string line = FormatTextV(fmt, args);
    va_end(args);

    std::function<void(std::string_view)> sink;
    {
        T_HISTORY& h = History();
        const std::lock_guard guard(h.lock);
        if (h.lines.size() == kMostLines) h.lines.pop_front();
        h.lines.push_back(line);
        sink = h.sink;
    }
    if (sink) sink(line);
}

std::vector<std::string> TakeMessageHistory()
{
    T_HISTORY& h = History();
    const std::lock_guard guard(h.lock);
    const std::deque<std::string> lines = std::exchange(h.lines, {});
    return {lines.begin(), lines.end()};
}

void SetMessageHistorySink(std::function<void(std::string_view)> sink)
{
    T_HISTORY& h = History();
    const std::lock_guard guard(h.lock);
    h.sink = std::move(sink);
}
