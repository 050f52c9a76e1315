#include "qm_rps/create/headerunits.h"

#include "qm_db/recordfacts.h"
#include "qm_rps/create/createfault.h"

#include <algorithm>
#include <array>
#include <cctype>
#include <optional>
#include <set>

namespace {

struct T_WORD {
    std::string text; // small letters
    bool isBracketed = false;
};

/// Words of letters and digits, and "%".
std::vector<T_WORD> WordsOf(const std::string& text)
{
    std::vector<T_WORD> words(1);
    bool inBrackets = false;
    const auto end = [&words] {
        if (!words.back().text.empty()) words.emplace_back();
    };
    for (const char c : text) {
        const auto u = static_cast<unsigned char>(c);
        if (std::isalnum(u) || u >= 0x80) {
            words.back().text += static_cast<char>(u < 0x80 ? std::tolower(u) : c);
            words.back().isBracketed = inBrackets;
            continue;
        }
        end();
        if (c == '(' || c == '[') inBrackets = true;
        if (c == ')' || c == ']') inBrackets = false;
        if (c != '%') continue;
        words.back() = {"%", true};
        end();
    }
    words.pop_back();
    return words;
}

/// Which of the names a word is; "kip" is written for kips.
template <std::size_t N>
std::optional<std::size_t> IndexOf(const T_WORD& word, const std::array<const char*, N>& names)
{
    static const std::set<std::string> kAlsoWords{"n", "m", "in"}; // alone no unit for sure
    if (!word.isBracketed && kAlsoWords.contains(word.text)) return std::nullopt;
    const auto isSame = [&word](std::string name) {
        std::ranges::transform(name, name.begin(), [](unsigned char c) { return std::tolower(c); });
        return word.text == name || (name == "kips" && word.text == "kip");
    };
    const auto at = std::ranges::find_if(names, isSame);
    if (at == names.end()) return std::nullopt;
    return static_cast<std::size_t>(at - names.begin());
}

/// The names of the columns that are read; of all where the header has others than the table.
std::string HeaderOf(const T_CURVE_READ& read)
{
    const std::vector<std::string>& names = read.table.names;
    const bool fits = names.size() == read.table.rows.front().cells.size();
    std::string text;
    std::size_t at = 0;
    for (const std::string& name : names) {
        const std::size_t end = std::min(read.columns.find(',', at), read.columns.size());
        const bool isRead = !fits || read.columns.substr(at, end - at) != "-";
        if (isRead) text += name + " ";
        at = std::min(end + 1, read.columns.size());
    }
    return text;
}

} // namespace

int CheckHeaderUnits(const T_CURVE_READ& read, const T_UNITS& units, T_FINDING& fault)
{
    if (read.table.headers.empty()) return 1;
    const std::string line = std::to_string(read.table.headers.back());
    const std::string wanted =
        std::string(NameOf(units.force)) + ", " + std::string(NameOf(units.length));
    for (const T_WORD& word : WordsOf(HeaderOf(read))) {
        if (word.text == "%") return CreateFault(fault, "text", "IDS_QM_NEW_HEADER_PERCENT", line);
        const auto force = IndexOf(word, kForceNames);
        const auto length = IndexOf(word, kLengthNames);
        const bool isOther = (force && *force != static_cast<std::size_t>(units.force)) ||
                             (length && *length != static_cast<std::size_t>(units.length));
        if (isOther)
            return CreateFault(fault, "text", "IDS_QM_NEW_HEADER_UNITS", line, word.text, wanted);
    }
    return 1;
}
