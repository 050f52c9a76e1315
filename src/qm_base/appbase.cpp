#include "qm_base/appbase.h"

#include "qm_base/debugout.h"

#include <deque>
#include <mutex>

namespace {

constexpr std::size_t kKeptAssertions = 1000;

struct T_ASSERTION_LIST {
    std::mutex guard;
    std::deque<T_ASSERTION> kept;
};

T_ASSERTION_LIST& List()
{
    static T_ASSERTION_LIST list;
    return list;
}

} // namespace

void CAppBase::ReleaseAssertion_ST(const char* source, int line)
{
    if (!source) source = "";
    GDebugOut("release assertion: %s(%d)", source, line);

    T_ASSERTION_LIST& list = List();
    const std::lock_guard lock(list.guard);
    if (list.kept.size() == kKeptAssertions) list.kept.pop_front();
    list.kept.push_back({source, line});
}

std::vector<T_ASSERTION> CAppBase::TakeAssertions_ST()
{
    T_ASSERTION_LIST& list = List();
    const std::lock_guard lock(list.guard);
    std::vector<T_ASSERTION> taken(list.kept.begin(), list.kept.end());
    list.kept.clear();
    return taken;
}
