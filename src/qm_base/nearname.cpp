#include "qm_base/nearname.h"

#include <algorithm>
#include <vector>

namespace {

constexpr std::size_t kPart = 3; // letters that stand for a whole name

/// ASCII letters in lower case.
std::string Plain(std::string_view name)
{
    std::string plain(name);
    for (char& c : plain) {
        if (c >= 'A' && c <= 'Z') c = static_cast<char>(c - 'A' + 'a');
        if (c == '-') c = '_';
    }
    return plain;
}

/// Letters to change, insert, leave out or swap with their neighbour (optimal string alignment).
std::size_t Distance(const std::string& a, const std::string& b)
{
    std::vector<std::size_t> before, last(b.size() + 1), now(b.size() + 1);
    for (std::size_t j = 0; j <= b.size(); ++j)
        last[j] = j;
    for (std::size_t i = 1; i <= a.size(); ++i) {
        now[0] = i;
        for (std::size_t j = 1; j <= b.size(); ++j) {
            const std::size_t change = last[j - 1] + (a[i - 1] == b[j - 1] ? 0 : 1);
            now[j] = std::min({last[j] + 1, now[j - 1] + 1, change});
            if (i > 1 && j > 1 && a[i - 1] == b[j - 2] && a[i - 2] == b[j - 1])
                now[j] = std::min(now[j], before[j - 2] + 1);
        }
        before = last;
        std::swap(last, now);
    }
    return last.back();
}

} // namespace

std::string NearestName(std::string_view typed, std::span<const std::string_view> known)
{
    const std::string plain = Plain(typed);
    if (plain.size() < 2) return {};
    std::size_t best = std::max<std::size_t>(1, plain.size() / 3) + 1;
    std::string_view nearest;
    for (const std::string_view name : known) {
        const std::size_t distance = Distance(plain, Plain(name));
        if (distance >= best) continue;
        best = distance;
        nearest = name;
    }
    if (!nearest.empty() || plain.size() < kPart) return std::string(nearest);
    for (const std::string_view name : known) {
        const std::size_t at = Plain(name).find(plain);
        if (at == 0) return std::string(name);
        if (at != std::string::npos && nearest.empty()) nearest = name;
    }
    return std::string(nearest);
}
