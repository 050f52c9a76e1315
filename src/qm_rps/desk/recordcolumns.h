// Columns of the tables of records: how a record's members are shown and taken.
#pragma once

#include "qm_base/textformat.h"
#include "qm_rps/desk/recordgrid.h"

#include <functional>

/// A column over records of one type. Values are in the document's current units.
template <class R>
struct T_RECORD_COLUMN {
    std::string head; // key of a text, or a symbol
    CELL_KIND kind = CELL_KIND::Text;
    std::optional<T_DIM> dim{}; // has a unit in the head
    std::function<std::string(const T_MODEL&, int key, const R&)> get{};
    /// Empty: fixed. False: the text is no value of the member.
    std::function<bool(const T_MODEL&, R&, const std::string&)> set{};
    std::function<std::vector<std::string>(const T_MODEL&)> choices{};
};
template <class R>
using T_RECORD_COLUMNS = std::vector<T_RECORD_COLUMN<R>>;

/// The key or id of a record.
template <class R>
T_RECORD_COLUMN<R> KeyColumn(const char* head)
{
    T_RECORD_COLUMN<R> c{head, CELL_KIND::Number};
    c.get = [](const T_MODEL&, int key, const R&) { return std::to_string(key); };
    return c;
}

/// A number, by a function that finds it in the record. `least`: values below are refused.
template <class R, class F>
T_RECORD_COLUMN<R> NumberColumn(const char* head, T_DIM dim, F find,
                                std::optional<double> least = {})
{
    T_RECORD_COLUMN<R> c{head, CELL_KIND::Number};
    if (dim != kDimNone) c.dim = dim;
    c.get = [find](const T_MODEL&, int, const R& r) {
        R copy = r;
        return ShortestText(find(copy));
    };
    c.set = [find, least](const T_MODEL&, R& r, const std::string& text) {
        const std::optional<double> value = ParseFinite(text);
        if (!value || (least && *value < *least)) return false;
        find(r) = *value;
        return true;
    };
    return c;
}

/// A whole number that `accept` takes.
template <class R, class F>
T_RECORD_COLUMN<R> IntegerColumn(const char* head, F find,
                                 std::function<bool(const T_MODEL&, int)> accept)
{
    T_RECORD_COLUMN<R> c{head, CELL_KIND::Number};
    c.get = [find](const T_MODEL&, int, const R& r) {
        R copy = r;
        return std::to_string(find(copy));
    };
    c.set = [find, accept](const T_MODEL& model, R& r, const std::string& text) {
        const std::optional<double> value = ParseFinite(text);
        constexpr double kMost = 2e9;
        if (!value || !(std::abs(*value) < kMost)) return false;
        const int whole = static_cast<int>(*value);
        if (whole != *value || !accept(model, whole)) return false;
        find(r) = whole;
        return true;
    };
    return c;
}

template <class R, class F>
T_RECORD_COLUMN<R> FlagColumn(const char* head, F find)
{
    T_RECORD_COLUMN<R> c{head, CELL_KIND::Flag};
    c.get = [find](const T_MODEL&, int, const R& r) {
        R copy = r;
        return std::string(find(copy) ? "1" : "0");
    };
    c.set = [find](const T_MODEL&, R& r, const std::string& text) {
        if (text != "0" && text != "1") return false;
        find(r) = text == "1";
        return true;
    };
    return c;
}

/// One of the keys' texts, by index.
template <class R, class F>
T_RECORD_COLUMN<R> IndexColumn(const char* head, F find, std::vector<const char*> keys,
                               std::string (*textOf)(const char*))
{
    T_RECORD_COLUMN<R> c{head, CELL_KIND::Choice};
    c.choices = [keys, textOf](const T_MODEL&) {
        std::vector<std::string> texts;
        for (const char* key : keys)
            texts.push_back(textOf(key));
        return texts;
    };
    c.get = [find, keys, textOf](const T_MODEL&, int, const R& r) {
        R copy = r;
        const auto index = static_cast<std::size_t>(find(copy));
        return index < keys.size() ? textOf(keys[index]) : std::string();
    };
    c.set = [find, keys, textOf](const T_MODEL&, R& r, const std::string& text) {
        for (std::size_t i = 0; i < keys.size(); ++i) {
            if (textOf(keys[i]) != text) continue;
            find(r) = static_cast<std::remove_cvref_t<decltype(find(r))>>(i);
            return true;
        }
        return false;
    };
    return c;
}

/// The name of another record, whose key the member holds. Empty text: 0.
template <class R, class OTHER, class F>
T_RECORD_COLUMN<R> NameOfColumn(const char* head, T_TABLE<OTHER> T_MODEL::*table, F find)
{
    T_RECORD_COLUMN<R> c{head, CELL_KIND::Choice};
    c.choices = [table](const T_MODEL& model) {
        std::vector<std::string> names;
        for (const auto& entry : model.*table)
            names.push_back(entry.second.name);
        return names;
    };
    c.get = [table, find](const T_MODEL& model, int, const R& r) {
        R copy = r;
        const auto it = (model.*table).find(find(copy));
        return it == (model.*table).end() ? std::string() : it->second.name;
    };
    c.set = [table, find](const T_MODEL& model, R& r, const std::string& text) {
        for (const auto& [key, record] : model.*table) {
            if (record.name != text) continue;
            find(r) = key;
            return true;
        }
        return false;
    };
    return c;
}

/// A name: not empty, and unlike every other of its table.
template <class R>
T_RECORD_COLUMN<R> NameColumn(T_TABLE<R> T_MODEL::*table, bool fixed = false)
{
    T_RECORD_COLUMN<R> c{"IDS_QM_UI_HEAD_NAME"};
    c.get = [](const T_MODEL&, int, const R& r) { return r.name; };
    if (fixed) return c;
    c.set = [table](const T_MODEL& model, R& r, const std::string& text) {
        const auto taken = [&](const auto& entry) { return entry.second.name == text; };
        if (text != r.name &&
            (text.empty() || std::any_of((model.*table).begin(), (model.*table).end(), taken)))
            return false;
        r.name = text;
        return true;
    };
    return c;
}

/// A text that can't be edited here.
template <class R, class F>
T_RECORD_COLUMN<R> FixedColumn(const char* head, F text)
{
    T_RECORD_COLUMN<R> c{head};
    c.get = [text](const T_MODEL& model, int, const R& r) { return text(model, r); };
    return c;
}
