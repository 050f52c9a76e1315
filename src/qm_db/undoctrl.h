// Undo and redo of committed edits. A step holds the records before and after, nothing else.
#pragma once

#include "qm_db/datactrl.h"

#include <memory>
#include <string>
#include <variant>
#include <vector>

/// One record before and after; null means that it did not exist.
template <class T>
struct T_CHANGE {
    int key = 0;
    std::shared_ptr<const T> before; // apart, so that a change of a node is not as large as one
    std::shared_ptr<const T> after;  // of a hinge type
};

template <class... R>
std::variant<T_CHANGE<T_STYP_D>, T_CHANGE<T_POGC_D>, T_CHANGE<R>...>
ChangeOf(const std::tuple<T_RECORD_ROW<R>...>&);
using T_CHANGE_ANY = decltype(ChangeOf(kRecords)); // of any record

/// What one command of the user changed.
struct T_UNDO_STEP {
    std::string title;
    std::vector<T_CHANGE_ANY> changes;
    long place = 0; // that it leads to: a number of its own in the document
};

class CUndoCtrl {
public:
    explicit CUndoCtrl(CDataCtrl& data) : m_data(data) {}

    bool CanUndo() const { return !m_done.empty(); }
    bool CanRedo() const { return !m_undone.empty(); }
    std::string UndoTitle() const { return CanUndo() ? m_done.back().title : std::string(); }

    /// Takes back the latest step, or applies it again. 1 done; 0 there is none, or the
    /// data are locked.
    [[nodiscard]] int Undo();
    [[nodiscard]] int Redo();

    /// One undoable command of the document, by its editor: begins, ends and keeps, or takes back.
    /// 1 done; 0 another step is open, or none is.
    [[nodiscard]] int StartEditDB(std::string title);
    [[nodiscard]] int CloseEditDB();
    [[nodiscard]] int CancelEditDB();

    /// For CEditData: keeps a committed step (at most 200) and forgets what was undone.
    void Push(T_UNDO_STEP step);
    void Clear();

    /// Applies a change forwards or backwards to the model.
    static void Apply(T_MODEL& model, const T_CHANGE_ANY& change, bool forward);

private:
    long Place() const { return m_done.empty() ? m_first : m_done.back().place; }

    CDataCtrl& m_data;
    long m_first = 0; // place before the oldest step that is kept
    long m_last = 0;  // place of the newest step there ever was
    std::vector<T_UNDO_STEP> m_done;
    std::vector<T_UNDO_STEP> m_undone;
};
