#include "qm_db/recordform.h"

#include "qm_base/say.h"
#include "qm_db/form/recordedit.h"

#include <algorithm>

namespace {

/// A name by which others refer to the record stays while they do.
std::string RenameFault(const T_MODEL& model, RECORD_KIND kind, int key, const std::string& name)
{
    const bool byName = kind == KindOf<T_SPFC_D>() || kind == KindOf<T_ULFC_D>();
    const std::string before = NameOfRecord(model, kind, key);
    if (!byName || before.empty() || before == name) return {};
    const T_RECORD_USERS users = UsersOf(model, kind, key);
    return users.empty() ? std::string()
                         : Say("IDS_QM_FORM_NAME_USED", before, UsersText(model, users));
}

/// Puts the record into the step.
int Store(CDBDoc& doc, CEditScope& step, const CRecordEdit& edit, int key, std::string& reason)
{
    T_ANY_RECORD record = edit.Record();
    if (const std::string* const name = NameIn(record))
        reason = RenameFault(doc.Data().Model(), edit.Kind(), key, *name);
    if (!reason.empty()) return 0;
    if (PutAny(doc, step, key, record)) return 1;
    reason = Say("IDS_QM_UI_EDIT_BUSY");
    return 0;
}

/// One more than the last key; of a push also than those of results that are left. Limit-state
/// steps belong to a load case: the first one that has none, 0 when all have some.
int NextKeyOf(const T_MODEL_CONTENT& content, RECORD_KIND kind)
{
    const T_MODEL& model = content.model;
    if (kind == KindOf<T_POVR_D>()) {
        for (const auto& entry : model.pushovers)
            if (!model.poverSteps.contains(entry.first)) return entry.first;
        return 0;
    }
    const std::vector<int> keys = KeysOf(model, kind);
    int last = keys.empty() ? 0 : keys.back();
    if (kind == KindOf<T_POLC_D>()) {
        if (!content.results.empty()) last = std::max(last, content.results.rbegin()->first);
        if (!model.poverSteps.empty()) last = std::max(last, model.poverSteps.rbegin()->first);
        if (!content.turnedResults.empty())
            last = std::max(last, content.turnedResults.rbegin()->first.first);
    }
    return last + 1;
}

std::string FreeNameOf(const T_MODEL& model, RECORD_KIND kind, int number)
{
    for (;; ++number) {
        std::string name = Say("IDS_QM_UI_NEW_NAME", std::to_string(number));
        if (!FindRecord(model, kind, name)) return name;
    }
}

struct T_NEW {
    RECORD_KIND kind;
    std::string name;
    std::span<const CRecordForm::T_SETTING> settings{};
};

/// The record under the next key; of a node or an element under the id that is set.
int StoreNew(CDBDoc& doc, const T_NEW& wanted, T_ANY_RECORD record, int& key, std::string& reason)
{
    const T_MODEL& model = doc.Data().Model();
    const int next = NextKeyOf(doc.Data().Content(), wanted.kind);
    if (int* const id = IdIn(record)) *id = next;
    if (std::string* const name = NameIn(record))
        *name = wanted.name.empty() ? FreeNameOf(model, wanted.kind, next) : wanted.name;
    CRecordEdit edit(model, wanted.kind, 0, std::move(record));
    if (!edit.Set(wanted.settings) || !edit.Check()) {
        reason = edit.Reason();
        return 0;
    }
    T_ANY_RECORD made = edit.Record();
    const int* const id = IdIn(made);
    const int at = id ? *id : next;
    if (FindAny(model, wanted.kind, at).index() != 0) {
        reason = Say("IDS_QM_FORM_ID_TAKEN", std::to_string(at));
        return 0;
    }
    CEditScope step(doc, Say("IDS_QM_FORM_MADE"));
    if (!Store(doc, step, edit, at, reason) || !step.Commit()) return 0;
    key = at;
    return 1;
}

template <class R>
int EraseOne(CDBDoc& doc, CEditScope& step, int key, std::string& reason)
{
    const T_MODEL& model = doc.Data().Model();
    // Modes are known by their place: one in the middle would rename those behind it.
    if (std::is_same_v<R, T_EIGV_D> && !model.modes.empty() && key != model.modes.rbegin()->first) {
        reason = Say("IDS_QM_FORM_LAST_MODE", std::to_string(model.modes.rbegin()->first));
        return 0;
    }
    T_RECORD_USERS users;
    if (std::is_same_v<R, T_POLC_D> && model.poverSteps.contains(key) && !step.Erase<T_POVR_D>(key))
        return 0;
    if (step.Erase<R>(key, users)) return 1;
    reason = users.empty()
                 ? Say("IDS_QM_FORM_NO_RECORD", KindWord(KindOf<R>()), std::to_string(key))
                 : Say("IDS_QM_UI_RECORD_USED", std::to_string(key), UsersText(model, users));
    return 0;
}

} // namespace

// ---- rows ---------------------------------------------------------------------------------------

std::vector<T_FIELD_ROW> CRecordForm::Rows(std::size_t mostItems)
{
    const T_MODEL& model = m_doc.Data().Model();
    std::vector<T_FIELD_ROW> rows;
    if (m_keys.empty()) return rows;
    const T_ANY_RECORD record = FindAny(model, m_kind, m_keys.front());
    if (record.index() == 0) {
        m_reason = Say("IDS_QM_FORM_NO_RECORD", KindWord(m_kind), std::to_string(m_keys.front()));
        return rows;
    }
    CRecordEdit edit(model, m_kind, m_keys.front(), record);
    if (!edit.Rows(rows, mostItems)) m_reason = edit.Reason();
    return rows;
}

std::optional<T_FIELD_ROW> CRecordForm::Row(const std::string& path)
{
    for (T_FIELD_ROW& row : Rows())
        if (row.path == path) return std::move(row);
    return {};
}

std::vector<std::string> CRecordForm::Various(std::span<const T_FIELD_ROW> rows)
{
    std::vector<bool> differ(rows.size(), false);
    for (std::size_t i = 1; i < m_keys.size(); ++i) {
        const std::vector<T_FIELD_ROW> others = CRecordForm(m_doc, m_kind, {m_keys[i]}).Rows();
        for (std::size_t r = 0, o = 0; r < rows.size(); ++r) {
            // Rows of the records come in the same order; lists may be longer or shorter.
            auto other = std::ranges::find(others.begin() + static_cast<std::ptrdiff_t>(o),
                                           others.end(), rows[r].path, &T_FIELD_ROW::path);
            differ[r] = differ[r] || other == others.end() || other->text != rows[r].text;
            if (other != others.end()) o = static_cast<std::size_t>(other - others.begin());
        }
    }
    std::vector<std::string> paths;
    for (std::size_t r = 0; r < rows.size(); ++r)
        if (differ[r]) paths.push_back(rows[r].path);
    return paths;
}

// ---- changes ------------------------------------------------------------------------------------

template <class F>
int CRecordForm::Change(F change)
{
    m_reason.clear();
    CEditScope step(m_doc, Say("IDS_QM_FORM_CHANGED"));
    if (!step.IsOpen()) m_reason = Say("IDS_QM_UI_EDIT_BUSY");
    for (const int key : m_keys) {
        if (!m_reason.empty()) return 0;
        const T_ANY_RECORD before = FindAny(m_doc.Data().Model(), m_kind, key);
        if (before.index() == 0) {
            m_reason = Say("IDS_QM_FORM_NO_RECORD", KindWord(m_kind), std::to_string(key));
            return 0;
        }
        CRecordEdit edit(m_doc.Data().Model(), m_kind, key, before);
        if (!change(edit)) {
            m_reason = edit.Reason();
            return 0;
        }
        if (edit.Record() == before) continue;
        if (!Store(m_doc, step, edit, key, m_reason)) return 0;
    }
    return step.Commit();
}

int CRecordForm::Set(const std::string& path, const std::string& text)
{
    const T_SETTING setting{path, text};
    return Set(std::span(&setting, 1));
}

int CRecordForm::Set(std::span<const T_SETTING> settings)
{
    return Change([&](CRecordEdit& edit) { return edit.Set(settings); });
}

int CRecordForm::Add(const std::string& path)
{
    return Change([&](CRecordEdit& edit) { return edit.Add(path); });
}

int CRecordForm::Remove(const std::string& path)
{
    return Change([&](CRecordEdit& edit) { return edit.Remove(path); });
}

// ---- records ------------------------------------------------------------------------------------

int MakeRecord(CDBDoc& doc, RECORD_KIND kind, const std::string& name,
               std::span<const CRecordForm::T_SETTING> settings, int& key, std::string& reason)
{
    reason.clear();
    const T_MODEL& model = doc.Data().Model();
    T_ANY_RECORD record = BlankAny(kind);
    const int next = NextKeyOf(doc.Data().Content(), kind);
    if (kind == KindOf<T_POVR_D>() && next == 0) reason = NeedsFirst(KindOf<T_POLC_D>());
    if (kind == kModelOptionsKind || kind == kPushControlKind)
        reason = Say("IDS_QM_FORM_ONCE", KindWord(kind));
    if (!reason.empty()) return 0;
    PresetAny(model, next, record);
    if (const std::optional<RECORD_KIND> missing = FillAny(model, record)) {
        reason = NeedsFirst(*missing);
        return 0;
    }
    return StoreNew(doc, {kind, name, settings}, std::move(record), key, reason);
}

int MakeRecord(CDBDoc& doc, RECORD_KIND kind, const std::string& name, int& key,
               std::string& reason)
{
    return MakeRecord(doc, kind, name, {}, key, reason);
}

int DuplicateRecord(CDBDoc& doc, RECORD_KIND kind, int from, int& key, std::string& reason)
{
    reason.clear();
    T_ANY_RECORD record = FindAny(doc.Data().Model(), kind, from);
    if (record.index() == 0 || kind == kModelOptionsKind || kind == kPushControlKind) {
        reason = Say("IDS_QM_FORM_NO_RECORD", KindWord(kind), std::to_string(from));
        return 0;
    }
    return StoreNew(doc, {kind, {}}, std::move(record), key, reason);
}

int DeleteRecords(CDBDoc& doc, RECORD_KIND kind, std::span<const int> keys, std::string& reason)
{
    reason.clear();
    CEditScope step(doc, Say("IDS_QM_FORM_DELETED"));
    if (!step.IsOpen()) reason = Say("IDS_QM_UI_EDIT_BUSY");
    if (kind == kModelOptionsKind || kind == kPushControlKind)
        reason = Say("IDS_QM_FORM_ONCE", KindWord(kind));
    std::vector<int> falling(keys.begin(), keys.end()); // the last mode goes first
    std::ranges::sort(falling, std::greater());
    for (const int key : falling) {
        int done = 0;
        if (reason.empty())
            WithKind(kind, [&]<class R>(const T_RECORD_ROW<R>&) {
                done = EraseOne<R>(doc, step, key, reason);
            });
        if (!done) return 0;
    }
    return step.Commit();
}

std::string FieldLabel(const std::string& key)
{
    const std::string text = std::string("IDS") + "_QM_FIELD_" + key; // no key by itself
    const std::string label = Say(text);
    return label == text ? key : label;
}
