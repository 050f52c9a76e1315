// An edit of a document as a scope: one undoable step, taken back unless it is committed.
#pragma once

#include "qm_db/dbdoc.h"

/// Key of a new record: one more than the last.
template <class R>
int NextKey(const std::map<int, R>& table)
{
    return table.empty() ? 1 : table.rbegin()->first + 1;
}

/// Where a step is open already: the scope is refused, or becomes a part of it.
enum class EDIT_STEP { Own, Join };

/// Changes go through the scope, each as CEditData has it; a refused one refuses the commit too:
///     CEditScope edit(doc, "Assign hinges");
///     return edit.Put(key, hinge) && edit.Commit();
class CEditScope {
public:
    CEditScope(CDBDoc& doc, std::string title, EDIT_STEP step = EDIT_STEP::Own)
        : CEditScope(doc.Edit(), std::move(title), step)
    {
    }
    CEditScope(CEditData& edit, std::string title, EDIT_STEP step = EDIT_STEP::Own)
        : m_edit(edit), m_isJoined(step == EDIT_STEP::Join && edit.IsOpen()),
          m_isOpen(m_isJoined || edit.Begin(std::move(title)))
    {
    }
    CEditScope(const CEditScope&) = delete;
    CEditScope& operator=(const CEditScope&) = delete;
    ~CEditScope()
    {
        if (m_isOpen && !m_isJoined) m_edit.Rollback();
    }

    /// False where another step was open or the data are locked: nothing can be changed then.
    bool IsOpen() const { return m_isOpen; }
    /// Ends the step and makes it undoable; a joined one goes on. 1 done; 0 the scope is not open,
    /// or a change was refused.
    [[nodiscard]] int Commit()
    {
        if (!m_isOpen || m_isRefused) return 0;
        m_isOpen = false;
        return m_isJoined ? 1 : m_edit.Commit();
    }

    template <class R>
    [[nodiscard]] int Put(int key, R record)
    {
        return Take(m_isOpen && m_edit.Put(key, std::move(record)));
    }
    template <class R>
    [[nodiscard]] int Erase(int key, T_RECORD_USERS& users)
    {
        return Take(m_isOpen && m_edit.Erase<R>(key, users));
    }
    template <class R>
    [[nodiscard]] int Erase(int key)
    {
        T_RECORD_USERS users;
        return Erase<R>(key, users);
    }
    [[nodiscard]] int PutStyp(T_STYP_D styp)
    {
        return Take(m_isOpen && m_edit.PutStyp(std::move(styp)));
    }
    [[nodiscard]] int ErasePhgt(int key, std::vector<int>& users)
    {
        return Take(m_isOpen && m_edit.ErasePhgt(key, users));
    }

private:
    int Take(bool isDone)
    {
        m_isRefused = m_isRefused || !isDone;
        return isDone ? 1 : 0;
    }

    CEditData& m_edit;
    bool m_isJoined = false;
    bool m_isOpen = false;
    bool m_isRefused = false;
};
