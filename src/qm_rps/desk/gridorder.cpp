#include "qm_rps/desk/gridorder.h"

#include "qm_base/textformat.h"

#include <algorithm>
#include <cctype>
#include <numeric>

void OrderKeys(std::vector<int>& keys, bool falling, const std::vector<std::string>& texts)
{
    std::vector<std::optional<double>> numbers;
    for (const std::string& text : texts)
        numbers.push_back(ParseFinite(text));
    const auto less = [&](std::size_t a, std::size_t b) {
        if (numbers[a] && numbers[b]) return *numbers[a] < *numbers[b];
        if (numbers[a].has_value() != numbers[b].has_value()) return numbers[a].has_value();
        return texts[a] < texts[b];
    };
    std::vector<std::size_t> order(keys.size());
    std::iota(order.begin(), order.end(), std::size_t{0});
    std::ranges::stable_sort(
        order, [&](std::size_t a, std::size_t b) { return falling ? less(b, a) : less(a, b); });
    std::vector<int> sorted;
    for (const std::size_t i : order)
        sorted.push_back(keys[i]);
    keys = std::move(sorted);
}

bool HoldsText(const std::string& text, const std::string& part)
{
    const auto same = [](char a, char b) {
        return std::tolower(static_cast<unsigned char>(a)) ==
               std::tolower(static_cast<unsigned char>(b));
    };
    return !std::ranges::search(text, part, same).empty() || part.empty();
}
