#include "qm_db/undoctrl.h"

#include "qm_db/editdata.h"

#include <ranges>
#include <type_traits>

namespace {

constexpr std::size_t kMaxSteps = 200;

template <class T>
void ApplyOne(T_MODEL& model, int key, const std::shared_ptr<const T>& value)
{
    if constexpr (std::is_same_v<T, T_STYP_D>) {
        if (value) model.styp = *value;
    } else if constexpr (std::is_same_v<T, T_POGC_D>) {
        if (value) model.pushControl = *value;
    } else if (value) {
        TableOf<T>(model).insert_or_assign(key, *value);
    } else {
        TableOf<T>(model).erase(key);
    }
}

} // namespace

void CUndoCtrl::Apply(T_MODEL& model, const T_CHANGE_ANY& change, bool forward)
{
    std::visit([&](const auto& c) { ApplyOne(model, c.key, forward ? c.after : c.before); },
               change);
}

int CUndoCtrl::Undo()
{
    if (m_done.empty() || m_data.IsLocked()) return 0;
    T_UNDO_STEP step = std::move(m_done.back());
    m_done.pop_back();
    T_MODEL& model = m_data.ModelForEdit();
    for (const T_CHANGE_ANY& change : step.changes | std::views::reverse)
        Apply(model, change, false);
    m_undone.push_back(std::move(step));
    m_data.ComeTo(Place());
    return 1;
}

int CUndoCtrl::Redo()
{
    if (m_undone.empty() || m_data.IsLocked()) return 0;
    T_UNDO_STEP step = std::move(m_undone.back());
    m_undone.pop_back();
    T_MODEL& model = m_data.ModelForEdit();
    for (const T_CHANGE_ANY& change : step.changes)
        Apply(model, change, true);
    m_done.push_back(std::move(step));
    m_data.ComeTo(Place());
    return 1;
}

int CUndoCtrl::StartEditDB(std::string title)
{
    CEditData* const editor = m_data.Editor();
    return editor ? editor->Begin(std::move(title)) : 0;
}

int CUndoCtrl::CloseEditDB()
{
    CEditData* const editor = m_data.Editor();
    return editor ? editor->Commit() : 0;
}

int CUndoCtrl::CancelEditDB()
{
    CEditData* const editor = m_data.Editor();
    if (!editor || !editor->IsOpen()) return 0;
    editor->Rollback();
    return 1;
}

void CUndoCtrl::Push(T_UNDO_STEP step)
{
    m_undone.clear();
    if (m_done.size() == kMaxSteps) {
        m_first = m_done.front().place;
        m_done.erase(m_done.begin());
    }
    step.place = ++m_last;
    m_done.push_back(std::move(step));
    m_data.SetPlace(m_last);
}

void CUndoCtrl::Clear()
{
    m_done.clear();
    m_undone.clear();
    m_first = m_last = 0;
}
