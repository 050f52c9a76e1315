// The records and result sources of one document, in SI. Controllers read; CEditData writes.
#pragma once

#include "qm_db/modelstore.h"
#include "qm_db/records/tables.h"
#include "qm_db/results/stagedresult.h"

class CEditData;

class CDataCtrl {
public:
    const T_MODEL& Model() const { return m_content.model; }
    const T_MODEL_CONTENT& Content() const { return m_content; }
    const T_UNITS& Units() const { return m_content.model.styp.units; }

    /// Replaces the whole content; the document counts as unmodified.
    void Assign(T_MODEL_CONTENT content);

    /// Replaces or adds the results of one static load case; null removes them.
    void SetStaticResult(int loadCase, std::shared_ptr<IStaticResult> result);

    /// The first record that a file could not hold, in words; empty: all can.
    std::string Fault() const;
    /// Puts the runs of one pushover load case, one for each turn of its loads, in place of all
    /// that it has; results of another solver go when there is one that is not turned.
    void SetPushRuns(int pushover, const std::vector<std::shared_ptr<IPushRun>>& runs);

    /// Results of the construction stages; null where there are none.
    const std::shared_ptr<IStagedResult>& StagedResult() const { return m_content.stagedResult; }
    void SetStagedResult(std::shared_ptr<IStagedResult> result);

    /// Adds a general combination under the next key, as an edit: within the open step, else as a
    /// step of its own that can be undone. Factors have no units. Non-zero added; 0 refused: the
    /// name is empty or taken, or an item refers to nothing.
    [[nodiscard]] int AddLcom(const T_LCOM_D& combination);
    /// For CEditData only, which makes itself known.
    void SetEditor(CEditData* editor) { m_editor = editor; }
    CEditData* Editor() const { return m_editor; }

    bool IsModified() const { return m_modified; }
    /// False: the document is saved as it is. True: it differs from any file, whatever is undone.
    void SetModified(bool modified);
    /// For CUndoCtrl: the place in its steps that undo or redo has come to. That of the saved
    /// document is unmodified again, where nothing but steps has changed it.
    void ComeTo(long place);
    /// For CUndoCtrl: a new step leads to this place.
    void SetPlace(long place) { m_place = place; }
    /// Grows with every change; lets readers keep derived values until something changed.
    long Revision() const { return m_revision; }

    /// Stores the limit-state steps of a load case. They derive from the rest, so the revision
    /// stays; the document counts as modified only when they differ from what is stored.
    void SetPoverSteps(int pushover, const T_POVR_D& steps);

    /// While it is locked (an analysis is under way) no edit begins, changes a record, is undone or
    /// done again.
    void SetLocked(bool locked) { m_isLocked = locked; }
    bool IsLocked() const { return m_isLocked; }

    /// For CEditData and CUndoCtrl only: the model to change; marks the document modified.
    T_MODEL& ModelForEdit();

private:
    void ChangeForGood();

    T_MODEL_CONTENT m_content;
    bool m_modified = false;
    static constexpr long kNowhere = -1;
    long m_place = 0, m_saved = 0; // in the steps of CUndoCtrl: now, and as it was saved
    bool m_isLocked = false;
    long m_revision = 0;
    CEditData* m_editor = nullptr;
};
