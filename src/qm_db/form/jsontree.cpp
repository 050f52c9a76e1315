#include "qm_db/form/jsontree.h"

#include "qm_db/casefile/jsonnumber.h"
#include "qm_db/casefile/jsonwriter.h"

#include <algorithm>
#include <charconv>
#include <span>

namespace {

constexpr std::size_t kMostPadded = 100; // zeros that an index may lead over

std::optional<std::size_t> IndexOf(const std::string& word)
{
    std::size_t index = 0;
    const char* const end = word.data() + word.size();
    const auto [stop, fault] = std::from_chars(word.data(), end, index);
    if (fault != std::errc() || stop != end) return {};
    return index;
}

template <class MEMBERS>
auto* FindMember(MEMBERS& members, const std::string& key)
{
    const auto it = std::ranges::find(members, key, &T_JSON_MEMBER::key);
    return it == members.end() ? nullptr : &it->value;
}

/// A packed array as one of items, and back where all are numbers.
T_JSON_ITEMS Unpacked(T_JSON& array)
{
    if (auto* items = std::get_if<T_JSON_ITEMS>(&array.data)) return std::move(*items);
    T_JSON_ITEMS items;
    if (const auto* numbers = std::get_if<T_JSON_NUMBERS>(&array.data))
        for (const double number : *numbers)
            items.push_back({number});
    return items;
}
void Pack(T_JSON_ITEMS items, T_JSON& array)
{
    T_JSON_NUMBERS numbers;
    for (const T_JSON& item : items)
        if (const auto* number = std::get_if<double>(&item.data)) numbers.push_back(*number);
    if (numbers.size() == items.size())
        array.data = std::move(numbers);
    else
        array.data = std::move(items);
}

bool IsArray(const T_JSON& value)
{
    return std::holds_alternative<T_JSON_ITEMS>(value.data) ||
           std::holds_alternative<T_JSON_NUMBERS>(value.data);
}

bool Put(T_JSON& at, std::span<const std::string> path, T_JSON& value)
{
    if (path.empty()) {
        at = std::move(value);
        return true;
    }
    const std::optional<std::size_t> index = IndexOf(path.front());
    const bool blank = std::holds_alternative<std::monostate>(at.data);
    if (index && (blank || IsArray(at))) {
        T_JSON_ITEMS items = Unpacked(at);
        if (*index > items.size() + kMostPadded) return false;
        while (items.size() <= *index)
            items.push_back(path.size() == 1 ? T_JSON{0.0} : T_JSON{});
        const bool done = Put(items[*index], path.subspan(1), value);
        Pack(std::move(items), at);
        return done;
    }
    if (blank) at.data = T_JSON_MEMBERS();
    auto* members = std::get_if<T_JSON_MEMBERS>(&at.data);
    if (!members) return false;
    if (T_JSON* member = FindMember(*members, path.front()))
        return Put(*member, path.subspan(1), value);
    members->push_back({path.front(), {}});
    return Put(members->back().value, path.subspan(1), value);
}

bool Remove(T_JSON& at, std::span<const std::string> path)
{
    if (IsArray(at)) {
        const std::optional<std::size_t> index = IndexOf(path.front());
        T_JSON_ITEMS items = Unpacked(at);
        bool done = index && *index < items.size();
        if (done && path.size() > 1)
            done = Remove(items[*index], path.subspan(1));
        else if (done)
            items.erase(items.begin() + static_cast<std::ptrdiff_t>(*index));
        Pack(std::move(items), at);
        return done;
    }
    auto* members = std::get_if<T_JSON_MEMBERS>(&at.data);
    T_JSON* const member = members ? FindMember(*members, path.front()) : nullptr;
    if (!member) return false;
    if (path.size() > 1) return Remove(*member, path.subspan(1));
    std::erase_if(*members, [&](const T_JSON_MEMBER& m) { return m.key == path.front(); });
    return true;
}

std::string Joined(const auto& values, const auto& text)
{
    std::string all;
    for (const auto& value : values)
        all += (all.empty() ? "" : ", ") + text(value);
    return all;
}

struct T_LINE {
    std::string operator()(std::monostate) const { return "null"; }
    std::string operator()(bool value) const { return value ? "true" : "false"; }
    std::string operator()(double value) const { return NumberText(value); }
    std::string operator()(const std::string& value) const
    {
        CJsonWriter out({});
        out.Value(std::string_view(value));
        return out.TakeText();
    }
    std::string operator()(const T_JSON_NUMBERS& values) const
    {
        return '[' + Joined(values, NumberText) + ']';
    }
    std::string operator()(const T_JSON_ITEMS& values) const
    {
        return '[' + Joined(values, JsonLine) + ']';
    }
    std::string operator()(const T_JSON_MEMBERS& values) const
    {
        const auto text = [](const T_JSON_MEMBER& m) {
            return T_LINE()(m.key) + ": " + JsonLine(m.value);
        };
        return '{' + Joined(values, text) + '}';
    }
};

} // namespace

T_PATH SplitPath(const std::string& path)
{
    T_PATH words(1);
    for (const char c : path) {
        if (c == '/')
            words.emplace_back();
        else
            words.back() += c;
    }
    return words;
}

std::string JoinPath(const std::string& place, const std::string& key)
{
    return place.empty() ? key : place + '/' + key;
}

std::optional<T_JSON> JsonAt(const T_JSON& at, const std::string& path)
{
    T_JSON found = {};
    const T_JSON* now = &at;
    for (const std::string& word : SplitPath(path)) {
        const std::optional<std::size_t> index = IndexOf(word);
        if (const auto* members = std::get_if<T_JSON_MEMBERS>(&now->data)) {
            now = FindMember(*members, word);
        } else if (const auto* items = std::get_if<T_JSON_ITEMS>(&now->data)) {
            now = index && *index < items->size() ? &(*items)[*index] : nullptr;
        } else if (const auto* numbers = std::get_if<T_JSON_NUMBERS>(&now->data)) {
            if (!index || *index >= numbers->size()) return {};
            found.data = (*numbers)[*index];
            now = &found;
        } else {
            return {};
        }
        if (!now) return {};
    }
    return *now;
}

bool PutJson(T_JSON& at, const std::string& path, T_JSON value)
{
    const T_PATH words = SplitPath(path);
    return Put(at, words, value);
}

bool RemoveJson(T_JSON& at, const std::string& path)
{
    const T_PATH words = SplitPath(path);
    return Remove(at, words);
}

std::string JsonLine(const T_JSON& value)
{
    return std::visit(T_LINE(), value.data);
}
