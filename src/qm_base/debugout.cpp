#include "qm_base/debugout.h"

#include "qm_base/textformat.h"

#include <atomic>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <memory>
#include <mutex>

namespace {

using Sink = std::function<void(std::string_view)>;

struct T_TRACE {
    std::atomic<bool> installed = false; // a sink is there: spares the lock where there is none
    std::mutex guard;
    std::shared_ptr<const Sink> sink; // null: default
};

T_TRACE& Trace()
{
    static T_TRACE trace;
    return trace;
}

std::shared_ptr<const Sink> InstalledSink()
{
    T_TRACE& trace = Trace();
    if (!trace.installed) return nullptr;
    const std::lock_guard lock(trace.guard);
    return trace.sink;
}

bool IsAskedForByEnvironment()
{
    const char* const value = std::getenv("QM_DEBUG");
    return value && std::string_view(value) == "1";
}

} // namespace

void GDebugOut(const char* fmt, ...)
{
    const std::shared_ptr<const Sink> sink = InstalledSink(); // called unlocked: it may trace too
    if (!sink && !IsAskedForByEnvironment()) return;

    std::va_list args;
    va_start(args, fmt);
    std::string line = FormatTextV(fmt, args);
    va_end(args);
    if (sink) {
        (*sink)(line);
        return;
    }
    if (!line.ends_with('\n')) line += '\n';
    std::fputs(line.c_str(), stderr);
}

void SetDebugSink(std::function<void(std::string_view)> sink)
{
    std::shared_ptr<const Sink> next;
    if (sink) next = std::make_shared<const Sink>(std::move(sink));
    T_TRACE& trace = Trace();
    const std::lock_guard lock(trace.guard);
    trace.sink.swap(next);
    trace.installed = trace.sink != nullptr;
}
