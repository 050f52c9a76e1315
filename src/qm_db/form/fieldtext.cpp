#include "qm_db/form/fieldtext.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/casefile/jsonparser.h"
#include "qm_db/form/jsontree.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace {

std::string Quoted(const std::string& text)
{
    return '"' + text + '"';
}

std::string NumberOf(const std::string& text, T_JSON& out)
{
    const std::optional<double> number = ParseFinite(text);
    if (!number) return Say("IDS_QM_FORM_NO_NUMBER", Quoted(text));
    out.data = *number;
    return {};
}

/// The key of a record, given by it or by its name.
std::string KeyOf(const T_MODEL& model, const T_FIELD_ROW& row, const std::string& text,
                  T_JSON& out)
{
    const std::optional<int> key =
        row.refers ? FindRecord(model, *row.refers, text) : std::optional<int>();
    if (!key) return NumberOf(text, out); // the rules say that there is none
    out.data = static_cast<double>(*key);
    return {};
}

/// Where a person may write a value by itself: "1, 2; 3".
std::vector<std::string> WordsOf(const std::string& text, std::string_view ends)
{
    std::vector<std::string> words;
    std::string word;
    const auto take = [&] {
        const std::size_t from = word.find_first_not_of(' ');
        if (from != std::string::npos)
            words.push_back(word.substr(from, word.find_last_not_of(' ') - from + 1));
        word.clear();
    };
    for (const char c : text) {
        if (ends.find(c) != std::string_view::npos)
            take();
        else
            word += c;
    }
    take();
    return words;
}

/// "7" or "5-9".
std::string AddIds(const std::string& word, T_JSON_NUMBERS& ids)
{
    constexpr int kMostAtOnce = 1000000;
    const std::size_t dash = word.find('-', 1);
    const std::optional<double> first = ParseFinite(word.substr(0, dash));
    const std::optional<double> last =
        dash == std::string::npos ? first : ParseFinite(word.substr(dash + 1));
    const auto isId = [](double value) {
        return std::fabs(value) <= std::numeric_limits<int>::max() && value == std::floor(value);
    };
    if (!first || !last || !isId(*first) || !isId(*last) || *last < *first ||
        *last - *first > kMostAtOnce)
        return Say("IDS_QM_FORM_NO_NUMBER", Quoted(word));
    for (long id = std::lround(*first); id <= std::lround(*last); ++id)
        ids.push_back(static_cast<double>(id));
    return {};
}

std::string ListOfText(const T_FIELD_ROW& row, const std::string& text, T_JSON& out)
{
    const bool ids = row.items == FIELD_KIND::Reference && row.byKey;
    const bool numbers = row.items == FIELD_KIND::Number || row.items == FIELD_KIND::Integer;
    if (!ids && !numbers) { // names may have blanks
        T_JSON_ITEMS items;
        for (const std::string& word : WordsOf(text, ",;"))
            items.push_back({word});
        out.data = std::move(items);
        return {};
    }
    T_JSON_NUMBERS values;
    for (const std::string& word : WordsOf(text, ",; \t")) {
        T_JSON number;
        const std::string fault = ids ? AddIds(word, values) : NumberOf(word, number);
        if (!fault.empty()) return fault;
        if (!ids) values.push_back(std::get<double>(number.data));
    }
    out.data = std::move(values);
    return {};
}

/// Members of one object of which one group stands in place of the others.
struct T_EITHER {
    RECORD_KIND kind;
    std::string_view under; // the first word of the path; empty: the record itself
    std::vector<std::vector<std::string>> groups;
};
const std::vector<T_EITHER>& Eithers()
{
    static const std::vector<T_EITHER> all{
        {KindOf<T_ULFC_D>(), "", {{"equal"}, {"upper", "lower"}, {"same_as"}}},
        {KindOf<T_LCOM_D>(), "items", {{"case"}, {"combination"}}}};
    return all;
}

constexpr std::array<std::pair<const char*, const char*>, 2> kTwins{
    {{"T", "Sa"}, {"step", "factor"}}};

} // namespace

std::string ValueOfText(const T_MODEL& model, const T_FIELD_ROW& row, const std::string& text,
                        bool toSi, T_JSON& out)
{
    switch (row.kind) {
    case FIELD_KIND::Number: {
        const std::string fault = NumberOf(text, out);
        if (fault.empty() && toSi)
            out.data = ToSi(std::get<double>(out.data), model.styp.units, row.dim);
        return fault;
    }
    case FIELD_KIND::Integer:
        return NumberOf(text, out);
    case FIELD_KIND::Flag:
        if (text != "true" && text != "false" && text != "1" && text != "0")
            return Say("IDS_QM_FORM_NO_FLAG", Quoted(text));
        out.data = text == "true" || text == "1";
        return {};
    case FIELD_KIND::Reference:
        if (row.byKey) return KeyOf(model, row, text, out);
        break;
    case FIELD_KIND::Text:
        // "first", "last" or a number.
        if (!row.choices.empty() && ParseFinite(text)) return NumberOf(text, out);
        break;
    default:
        break;
    }
    out.data = text;
    return {};
}

std::string PartOfText(const std::optional<T_FIELD_ROW>& row, const std::string& text, T_JSON& out)
{
    const bool json = text.starts_with('[') || text.starts_with('{');
    if (row && row->kind == FIELD_KIND::List && !json) return ListOfText(*row, text, out);
    T_JSON wrapped; // a document is an object or an array
    T_FILE_ERROR error;
    if (ParseJson('[' + text + ']', wrapped, error)) {
        if (std::optional<T_JSON> value = JsonAt(wrapped, "0"); value && !JsonAt(wrapped, "1")) {
            out = std::move(*value);
            return {};
        }
    }
    if (json || row) return Say("IDS_QM_FORM_NO_JSON", Quoted(text));
    out.data = text;
    return {};
}

void DropOthers(RECORD_KIND kind, const std::string& path, T_JSON& object)
{
    const T_PATH words = SplitPath(path);
    const std::string place = path.substr(0, path.size() - words.back().size());
    for (const T_EITHER& either : Eithers()) {
        const bool under = either.under.empty() ? words.size() == 1 : words.front() == either.under;
        if (either.kind != kind || !under) continue;
        const auto has = [&](const auto& group) {
            return std::ranges::find(group, words.back()) != group.end();
        };
        if (std::ranges::none_of(either.groups, has)) continue;
        for (const auto& group : either.groups)
            for (const std::string& other : group)
                if (!has(group)) (void)RemoveJson(object, place + other);
    }
}

std::string TwinOf(const std::string& path, const T_JSON& object)
{
    const T_PATH words = SplitPath(path);
    const std::string place = path.substr(0, path.size() - words.back().size());
    for (const auto& [a, b] : kTwins)
        for (const auto& [one, other] : {std::pair(a, b), std::pair(b, a)})
            if (words.back() == one && JsonAt(object, place + other)) return place + other;
    return {};
}

std::size_t CountAt(const T_JSON& object, const std::string& path)
{
    std::size_t count = 0;
    while (JsonAt(object, JoinPath(path, std::to_string(count))))
        ++count;
    return count;
}

bool NewValue(const T_MODEL& model, const T_FIELD_ROW& list, T_JSON& out)
{
    if (list.kind == FIELD_KIND::Group) {
        out.data = T_JSON_NUMBERS(T_DOF6{}.size(), 0.0);
        return true;
    }
    T_JSON now;
    T_FILE_ERROR error;
    if (!list.text.empty() && !ParseJson(list.text, now, error)) return false;
    const auto* numbers = std::get_if<T_JSON_NUMBERS>(&now.data);
    if (list.refers && list.byKey) {
        for (const int key : KeysOf(model, *list.refers)) {
            if (numbers && std::ranges::find(*numbers, key) != numbers->end()) continue;
            out.data = static_cast<double>(key);
            return true;
        }
        return false;
    }
    if (list.items == FIELD_KIND::Number || list.items == FIELD_KIND::Integer) {
        const double last = numbers && !numbers->empty() ? numbers->back() : 0.0;
        const double step = numbers && numbers->size() > 1 ? last - numbers->end()[-2] : 1.0;
        out.data = numbers && !numbers->empty() ? last + step : 1.0;
        return true;
    }
    for (const std::string& choice : list.choices) {
        if (list.text.find('"' + choice + '"') != std::string::npos) continue;
        out.data = choice;
        return true;
    }
    return false;
}

std::string FreeNode(const T_MODEL& model, const T_JSON& object, const std::string& path)
{
    for (const auto& entry : model.nodes)
        if (!JsonAt(object, JoinPath(path, std::to_string(entry.first))))
            return std::to_string(entry.first);
    return "0";
}

std::string UsersText(const T_MODEL& model, const T_RECORD_USERS& users)
{
    constexpr std::size_t kNamed = 10;
    std::string names;
    for (std::size_t i = 0; i < users.size() && i < kNamed; ++i)
        names += (i ? ", " : "") + DescribeUser(model, users[i]);
    return names + (users.size() > kNamed ? ", ..." : "");
}
