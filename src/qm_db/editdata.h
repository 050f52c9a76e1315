// Edits of records: gathered in a step, committed as one undoable command or rolled back whole.
#pragma once

#include "qm_db/attrctrl.h"
#include "qm_db/records/recordfit.h"
#include "qm_db/records/recordunits.h"
#include "qm_db/records/recorduse.h"
#include "qm_db/undoctrl.h"

class CEditData {
public:
    CEditData(CDataCtrl& data, CUndoCtrl& undo) : m_data(data), m_undo(undo)
    {
        data.SetEditor(this);
    }
    CEditData(const CEditData&) = delete;
    CEditData& operator=(const CEditData&) = delete;
    ~CEditData() { m_data.SetEditor(nullptr); }

    /// Starts a step. 1 started; 0 another one is open, or the data are locked (then nothing in an
    /// open step changes either).
    [[nodiscard]] int Begin(std::string title);
    /// Ends the step and makes it undoable. 1 done; 0 none was open.
    [[nodiscard]] int Commit();
    /// Takes every change of the open step back.
    void Rollback();
    bool IsOpen() const { return m_open; }

    /// Adds or replaces the record with that key; quantities in the document's current units.
    /// Members that the record does not use get their defaults (FitRecord). What refers to a
    /// pushover load case by its name follows it to a new one. 1 done; 0 no step is
    /// open, or the record is a combination that would contain itself.
    template <class T>
    [[nodiscard]] int Put(int key, T record)
    {
        FitRecord(record);
        if constexpr (std::is_same_v<T, T_LCOM_D>) {
            if (ContainsItself(key, record)) return 0;
        }
        RecordToSi(record, m_data.Units());
        if constexpr (std::is_same_v<T, T_POLC_D>) {
            if (!RenamePush(key, record.name)) return 0;
        }
        return Change<T>(key, std::make_shared<const T>(std::move(record)));
    }
    /// Deletes the record. 1 done; 0 no step is open, there is no such record, or other records
    /// refer to it: `users` then has them.
    template <class T>
    [[nodiscard]] int Erase(int key, T_RECORD_USERS& users)
    {
        users = UsersOf(m_data.Model(), KindOf<T>(), key);
        if (!m_open || !users.empty() || !TableOf<T>(m_data.Model()).contains(key)) return 0;
        return Change<T>(key, nullptr);
    }
    template <class T>
    [[nodiscard]] int Erase(int key)
    {
        T_RECORD_USERS users;
        return Erase<T>(key, users);
    }
    /// Deletes a hinge type. 1 done; 0 no step is open, there is no such type, or hinges use it:
    /// `users` then has the ids of their elements, ascending.
    [[nodiscard]] int ErasePhgt(int key, std::vector<int>& users);
    /// Replaces the initial tension of an element in a load case by this one, in current units, or
    /// adds it. 1 done; 0 no step is open, there is no such load case, the element is neither a
    /// beam nor a truss, or the force is not finite.
    [[nodiscard]] int AddPtns(int loadCase, const T_PTNS_D& pretension);
    /// Title, current units and gravity (in the units that the record itself names). Changing
    /// the units changes no stored quantity.
    [[nodiscard]] int PutStyp(T_STYP_D styp);
    /// Global control of the pushover analysis. 1 done; 0 no step is open.
    [[nodiscard]] int PutPogc(T_POGC_D control);

private:
    template <class T>
    int Change(int key, std::shared_ptr<const T> after)
    {
        if (!m_open) return 0;
        const auto& table = TableOf<T>(m_data.Model());
        T_CHANGE<T> change{key, nullptr, std::move(after)};
        if (const auto it = table.find(key); it != table.end())
            change.before = std::make_shared<const T>(it->second);
        return Record(std::move(change));
    }
    int Record(T_CHANGE_ANY change);
    /// What names the load case of this key follows it to its new name.
    int RenamePush(int key, const std::string& name);
    bool ContainsItself(int key, const T_LCOM_D& record) const;

    CDataCtrl& m_data;
    CUndoCtrl& m_undo;
    T_UNDO_STEP m_step;
    bool m_open = false;
    bool m_wasModified = false; // when the step began
};
