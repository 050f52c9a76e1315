// The members of any record as rows that a window or a command shows and sets: one form for every
// kind of the registry, for the options of the model and for the control of the pushover analysis.
#pragma once

#include "qm_db/dbdoc.h"

#include <optional>
#include <span>
#include <string>
#include <vector>

/// Beside the kinds of the registry: the options of the model. Its only key is 0, as that of
/// kPushControlKind.
inline constexpr RECORD_KIND kModelOptionsKind{std::tuple_size_v<decltype(kRecords)> + 1};

enum class FIELD_KIND {
    Number,
    Integer,
    Text,      // where it has choices, they are proposals
    Flag,      // "true", "false"
    Choice,    // one of the choices
    Reference, // another record, by its name or its key
    List,      // its items are the rows below it
    Group      // its members are the rows below it
};

/// One member of a record. Values are in the document's current units.
struct T_FIELD_ROW {
    std::string path{}; // "nodal/0/load/2"
    std::string key{};  // the last word of the path
    FIELD_KIND kind = FIELD_KIND::Text;
    T_DIM dim = kDimNone;        // of a list: of all its numbers, where they have the same
    bool isAcceleration = false; // the dimension is per second squared
    std::vector<std::string> choices{};
    std::optional<RECORD_KIND> refers{};  // of a reference, or of the items of a list
    bool byKey = false;                   // a reference by key or id; else by name
    FIELD_KIND items = FIELD_KIND::Group; // of a list
    std::string text{};     // shortest that reads back as the same value; of a list or a group as
                            // in a case file, on one line; empty: it is left out
    std::string target{};   // name of the record that a key stands for
    int depth = 0;          // how many rows it stands in
    bool isThere = false;   // false: the case file would leave it out; it has its default
    bool canAdd = false;    // a list takes an item; a part that is left out can be made
    bool canRemove = false; // it may be left out, or is an item of a list
};

/// The records of one kind that are shown and set together. The document must outlive the form.
class CRecordForm {
public:
    CRecordForm(CDBDoc& doc, RECORD_KIND kind, std::vector<int> keys)
        : m_doc(doc), m_kind(kind), m_keys(std::move(keys))
    {
    }

    /// Rows of the record with the first key; of a list at most `mostItems` items. Empty: there is
    /// no such record, or it refers to what is missing (Reason says which).
    std::vector<T_FIELD_ROW> Rows(std::size_t mostItems = kMostItems);
    /// The row of a path; empty: it has none.
    std::optional<T_FIELD_ROW> Row(const std::string& path);
    /// Of several records, the paths whose texts differ.
    std::vector<std::string> Various(std::span<const T_FIELD_ROW> rows);

    /// Sets a member of all records in one step that can be undone. A list or a group takes JSON
    /// as a case file has it; a list of numbers, names or ids also "1, 2, 5-9". An empty text
    /// leaves an optional member out. 1 done; 0 Reason says what the rules refuse and where,
    /// nothing has changed.
    [[nodiscard]] int Set(const std::string& path, const std::string& text);
    /// Several members of one record after the other, judged together as one step.
    struct T_SETTING {
        std::string path, text;
    };
    [[nodiscard]] int Set(std::span<const T_SETTING> settings);
    /// Adds an item to a list, or makes a part that is left out, with its default values.
    [[nodiscard]] int Add(const std::string& path);
    [[nodiscard]] int Remove(const std::string& path);

    /// Why the last operation was refused, in the user's language.
    const std::string& Reason() const { return m_reason; }
    RECORD_KIND Kind() const { return m_kind; }
    const std::vector<int>& Keys() const { return m_keys; }

    static constexpr std::size_t kMostItems = 200;

private:
    template <class F>
    int Change(F change);

    CDBDoc& m_doc;
    RECORD_KIND m_kind;
    std::vector<int> m_keys;
    std::string m_reason;
};

/// A new record of the kind under the next key, with default values that keep the rules; `name`
/// empty: a free one. 1 done, `key` has it; 0 `reason` says why: what it must refer to has to be
/// made first.
[[nodiscard]] int MakeRecord(CDBDoc& doc, RECORD_KIND kind, const std::string& name, int& key,
                             std::string& reason);
/// The same with members that are set at once.
[[nodiscard]] int MakeRecord(CDBDoc& doc, RECORD_KIND kind, const std::string& name,
                             std::span<const CRecordForm::T_SETTING> settings, int& key,
                             std::string& reason);
/// A copy of a record under the next key and a free name.
[[nodiscard]] int DuplicateRecord(CDBDoc& doc, RECORD_KIND kind, int from, int& key,
                                  std::string& reason);
/// Deletes records in one step. 0: others use one of them, and are named; nothing has changed.
[[nodiscard]] int DeleteRecords(CDBDoc& doc, RECORD_KIND kind, std::span<const int> keys,
                                std::string& reason);

/// "node", "load_case", "pushover_control": how a command names a kind.
const char* KindWord(RECORD_KIND kind);
/// By that word or by the member of a case file ("nodes").
std::optional<RECORD_KIND> KindOfWord(std::string_view word);
/// Every kind, in the order of the case file; the options of the model first.
std::vector<RECORD_KIND> AllKinds();
/// Keys in ascending order; {0} for the two kinds that a model has once.
std::vector<int> KeysOf(const T_MODEL& model, RECORD_KIND kind);
/// Empty: the kind has no names.
std::string NameOfRecord(const T_MODEL& model, RECORD_KIND kind, int key);
/// By a name, or else by a key in digits.
std::optional<int> FindRecord(const T_MODEL& model, RECORD_KIND kind, const std::string& which);
/// What a member is called in the user's language; its key where no text is there for it.
std::string FieldLabel(const std::string& key);
