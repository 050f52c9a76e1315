#include "qm_base/messagetext.h"

#include <charconv>

namespace zql::lib {

namespace {

struct T_PLACE {
    std::size_t number = 0; // from 1; 0: no place stands here
    std::size_t length = 0; // characters with both braces
};

/// The place that starts at text[0], which is a brace.
T_PLACE ReadPlace(std::string_view text)
{
    const std::size_t close = text.find('}');
    if (close == std::string_view::npos) return {};
    T_PLACE place{0, close + 1};
    const char* const end = text.data() + close;
    const auto [stop, error] = std::from_chars(text.data() + 1, end, place.number);
    if (error != std::errc{} || stop != end) return {};
    return place;
}

/// Walks a text: plain(view) for what is copied, onPlace(number, view) for each place.
template <class T_PLAIN, class T_ON_PLACE>
void Walk(std::string_view text, T_PLAIN plain, T_ON_PLACE onPlace)
{
    while (!text.empty()) {
        const std::size_t brace = text.find('{');
        plain(text.substr(0, brace));
        if (brace == std::string_view::npos) return;
        text.remove_prefix(brace);

        const T_PLACE place = ReadPlace(text);
        std::size_t used = place.length;
        if (place.number > 0) {
            onPlace(place.number, text.substr(0, used));
        } else {
            used = text.starts_with("{{") ? 2 : 1;
            plain(text.substr(0, 1));
        }
        text.remove_prefix(used);
    }
}

} // namespace

std::string FillPlaces(std::string_view text, std::span<const std::string_view> args)
{
    std::string filled;
    Walk(
        text, [&](std::string_view part) { filled += part; },
        [&](std::size_t number, std::string_view place) {
            filled += number <= args.size() ? args[number - 1] : place;
        });
    return filled;
}

std::set<std::size_t> PlacesOf(std::string_view text)
{
    std::set<std::size_t> numbers;
    Walk(
        text, [](std::string_view) {},
        [&](std::size_t number, std::string_view) { numbers.insert(number); });
    return numbers;
}

} // namespace zql::lib
