// A model document: records, results, units, undo, file.
#pragma once

#include "qm_base/dynmodule.h"
#include "qm_db/analysis/analysisworker.h"
#include "qm_db/attrctrl.h"
#include "qm_db/dblib.h"
#include "qm_db/editdata.h"
#include "qm_db/initctrl.h"
#include "qm_db/membctrl.h"
#include "qm_db/postctrl.h"
#include "qm_db/unitctrl.h"

#include <cstdint>
#include <optional>

/// A model in memory with its controllers, which live as long as it does.
class CDBDoc {
public:
    CDBDoc();
    ~CDBDoc();
    CDBDoc(const CDBDoc&) = delete;
    CDBDoc& operator=(const CDBDoc&) = delete;

    /// The current document, or null. A document is current from its making until it ends or
    /// another one is made current.
    static CDBDoc* GetDocPoint();
    /// Makes a document the current one; null: none is.
    static void SetDocPoint(CDBDoc* doc);

    /// The records in SI, and whether they are saved.
    CDataCtrl& Data() { return m_data; }
    const CDataCtrl& Data() const { return m_data; }
    /// Records in current units.
    CAttrCtrl& Attr() { return m_attr; }
    /// Results in current units.
    CPostCtrl& Post() { return m_post; }
    /// Current units and conversions.
    CUnitCtrl& Unit() { return m_unit; }
    CInitCtrl& Init() { return m_init; }
    CDBLib& Lib() { return m_lib; }
    CMembCtrl& Memb() { return m_memb; }
    /// Edits that can be taken back.
    CUndoCtrl& Undo() { return m_undo; }
    CEditData& Edit() { return m_edit; }
    CDynModuleMgr& DynModules() { return m_modules; }

    /// An empty model without a path.
    void NewModel();
    /// Opens a model file (see CModelStore::Open) or reads a case file. 1 done; 0 error filled
    /// and the document as it was.
    [[nodiscard]] int OpenModel(const std::string& path, OPEN_MODE mode, T_FILE_ERROR& error);
    /// Takes a model from a copy of its file (CAutosave), unsaved, and the writer's lock of the
    /// file itself where that can be opened; a damaged or missing one does not matter. 1 done; 0
    /// error filled: the copy can't be read, or another program has the file open.
    [[nodiscard]] int RecoverModel(const std::string& copy, const std::string& path,
                                   T_FILE_ERROR& error);
    /// Reads a case file and the recorder files that it names. 1 done; 0 error filled, the document
    /// as it was.
    [[nodiscard]] int ImportCase(const std::string& path, T_FILE_ERROR& error);
    /// Saves to the file it was opened from, or to another one. 1 done; 0 error filled, the file
    /// on disk as it was: also when another program has changed it meanwhile (fault Changed).
    [[nodiscard]] int SaveModel(T_FILE_ERROR& error);
    [[nodiscard]] int SaveModelAs(const std::string& path, T_FILE_ERROR& error);
    /// Writes a case file; the document keeps its path. 1 done; 0 error filled, as above.
    [[nodiscard]] int ExportCase(const std::string& path, T_FILE_ERROR& error) const;

    /// Saves as a model file (.qmdb) or as a case file (.json); the document then belongs to that
    /// path. 1 done; 0 error filled, the file on disk as it was.
    [[nodiscard]] int SaveAs(const std::string& path, T_FILE_ERROR& error);
    /// The next save replaces what is there, whoever has changed it.
    void AcceptChanges();

    /// Starts an analysis of static load cases, construction stages and eigen modes (see
    /// CAnalysisRun::Compute) of a copy of the model in a thread of its own. Until PollAnalysis
    /// says that it has ended, the document refuses edits; opening another model cancels it, as the
    /// end of the document does. 1 started; 0 error filled: another run is under way.
    [[nodiscard]] int StartAnalysis(T_ANALYSIS_OPTIONS options, T_ANALYSIS_ERROR& error);
    /// Waits up to waitMs for news of the run, tells options.progress of them one after the other
    /// (in this thread), and at the end puts the results into the document. True: the run goes on.
    bool PollAnalysis(int waitMs = 0);
    /// Ends the run as soon as the engine comes to a next part; without results, whatever it has
    /// got done by then. Nothing happens when there is none.
    void CancelAnalysis();
    /// How the latest run has ended. 1 its results are in the document; 0 error says why not, and
    /// neither results nor modes have changed. Also 0 when the model was changed in spite of all.
    [[nodiscard]] int AnalysisOutcome(T_ANALYSIS_ERROR& error) const;
    /// The load cases of the latest run that had lost digits, in the order of the run.
    const std::vector<T_LOST_DIGITS>& LostDigits() const { return m_lost; }
    /// One line that says of a case how much it had lost and what is left.
    std::string TextOf(const T_LOST_DIGITS& lost) const;
    /// Starts a run and waits for its end, progress being told meanwhile. Outcome as above; 0 also
    /// while another run is under way. What the progress throws cancels the run.
    [[nodiscard]] int RunAnalysis(const T_ANALYSIS_OPTIONS& options, T_ANALYSIS_ERROR& error);
    /// Whether a run is under way: from its start until its results are in the document.
    bool IsExcuted() const { return m_worker != nullptr; }
    /// Whether there are results of the model as it is: of its construction stages where it has
    /// any, else of a static load case.
    bool IsPostMode();

    /// Path of the model or case file; empty for a new document.
    const std::string& Path() const { return m_path; }

private:
    void Reset(T_MODEL_CONTENT content, const std::string& path);
    void EndAnalysis();
    void AbandonAnalysis();

    CDataCtrl m_data;
    CAttrCtrl m_attr{m_data};
    CPostCtrl m_post{m_data};
    CUnitCtrl m_unit{m_data};
    CInitCtrl m_init{m_data};
    CDBLib m_lib{m_data};
    CMembCtrl m_memb{m_data};
    CUndoCtrl m_undo{m_data};
    CEditData m_edit{m_data, m_undo};
    CDynModuleMgr m_modules;
    CModelStore m_store;
    std::string m_path;
    std::optional<std::uint64_t> m_caseSum; // of the case file that was read or saved last

    /// The run that is under way, and how the latest one has ended.
    std::shared_ptr<CAnalysisWorker> m_worker;
    decltype(T_ANALYSIS_OPTIONS::progress) m_progress;
    long m_revisionAtStart = 0;
    bool m_isTelling = false; // the progress
    T_ANALYSIS_ERROR m_outcome;
    std::vector<T_LOST_DIGITS> m_lost;
};
