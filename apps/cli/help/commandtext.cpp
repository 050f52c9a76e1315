#include "help/commandtext.h"

#include <algorithm>
#include <array>
#include <string_view>

namespace {

constexpr std::array<std::string_view, 12> kEndings{"qmdb", "json", "xlsx", "csv",  "svg", "pdf",
                                                    "png",  "jpg",  "bmp",  "html", "txt", "dxf"};

/// What options name whose help tells no ending.
struct T_NAMED_FILE {
    std::string_view part; // of the long name
    std::array<std::string_view, 3> endings;
};
constexpr T_NAMED_FILE kNamed[] = {
    {"--json", {"json"}},  {"--csv", {"csv"}},          {"--forces", {"csv", "txt"}},
    {"--report", {"txt"}}, {"--curve", {"txt", "csv"}}, {"plot", {"svg", "png", "pdf"}},
};

/// Whether `word` stands in `text` as an ending: ".svg", not as the start of a longer word.
bool HasEnding(std::string_view text, std::string_view word)
{
    const std::string ending = "." + std::string(word);
    for (auto at = text.find(ending); at != text.npos; at = text.find(ending, at + 1)) {
        const char next = at + ending.size() < text.size() ? text[at + ending.size()] : ' ';
        if (next < 'a' || next > 'z') return true;
    }
    return false;
}

} // namespace

std::vector<std::string> FileEndings(const T_OPTION_TEXT& option)
{
    std::vector<std::string> endings;
    if (option.value.empty() || !option.choices.empty() || !option.limits.empty()) return endings;
    const auto add = [&](std::string_view ending) {
        if (!ending.empty() && std::ranges::find(endings, ending) == endings.end())
            endings.emplace_back(ending);
    };
    for (const std::string_view ending : kEndings)
        if (HasEnding(option.about, ending)) add(ending);
    if (HasEnding(option.about, "qmdb") && !option.about.ends_with("(.qmdb)"))
        add("json"); // "or a case file"
    if (!endings.empty()) return endings;
    for (const T_NAMED_FILE& named : kNamed)
        if (option.value == "TEXT" && option.longName.find(named.part) != std::string::npos)
            std::ranges::for_each(named.endings, add);
    if (option.IsPlace() && option.value == "CASE") add("json");
    return endings;
}

bool NamesFolder(const T_OPTION_TEXT& option)
{
    return option.value == "FOLDER";
}
