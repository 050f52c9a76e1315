// Model of the main window: one document, opened, edited, analysed, saved and closed.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/autosave.h"
#include "qm_db/dbdoc.h"

class CMainFrame : public zql::frx::MDialog {
public:
    /// The document must outlive the frame.
    /// untitled: the file that copies of a document without a path go beside; empty: none are made.
    explicit CMainFrame(CDBDoc& doc, const std::string& untitled = {});

    /// "frame.qmdb", with a star while there are unsaved edits and a note where it is read only.
    std::string Title() const;
    /// Of a file that a save without a name goes to; empty: none yet, or it may not be written.
    std::string SavePath() const;

    // Each is 1 done; 0 refused with a message, or cancelled, and the document as it was.
    // What replaces or ends the document asks to save its edits first.

    [[nodiscard]] int OnNew();
    /// A model file, or a case file, which is saved as a model file later. A model file that is
    /// open elsewhere or may not be written is opened for reading, if the person wants that.
    [[nodiscard]] int OnOpen(const std::string& path);
    /// A case file as a model of its own without a path: the file itself is never written.
    [[nodiscard]] int OnOpenCopy(const std::string& path);
    /// To SavePath; 0 also where that is empty (the caller asks for a name).
    [[nodiscard]] int OnSave();
    /// A path without extension gets that of a model file; ".json" writes a case file.
    [[nodiscard]] int OnSaveAs(const std::string& path);
    [[nodiscard]] int OnExportCase(const std::string& path);
    /// May the window close? Edits are saved, given up, or the answer is no.
    [[nodiscard]] int OnClose();

    /// Looks at these files, and the one for documents without a path, for copies of a session that
    /// ended without saving; asks about the first that has one. 1 recovered.
    [[nodiscard]] int OnStart(const std::vector<std::string>& files);
    /// To be called every second or so: copies for the case of a crash, see CAutosave::Tick. A copy
    /// that can't be written is told once.
    void OnTick(double nowS);

    [[nodiscard]] int OnUndo() { return m_doc.Undo().Undo(); }
    [[nodiscard]] int OnRedo() { return m_doc.Undo().Redo(); }

    /// Every load case, the construction stages, and the eigen modes that are asked for.
    [[nodiscard]] int OnAnalyse(int modes, std::function<bool(std::size_t, std::size_t)> progress);

    /// Least time between two copies for the case of a crash, s.
    void SetAutosaveInterval(double seconds) { m_autosave.SetInterval(seconds); }
    /// Units of a model that OnNew makes.
    T_UNITS m_newUnits{};

    /// Asks for the name of a file to save to; empty: cancelled.
    std::function<std::string()> m_askPath;
    /// Asked before the document goes or the program ends: windows with something that is not in
    /// the document offer to store it. False: the person wants to go on with them.
    std::function<bool()> m_mayLeave;

private:
    int Refuse(const std::string& text);
    bool MayReplace();
    [[nodiscard]] int Save(const std::string& path, T_FILE_ERROR& error);
    int OpenModel(const std::string& path);
    int OfferRecovery(const std::string& file);
    void FollowDocument();
    void FollowSaves();
    std::string CopiedFile() const;

    CDBDoc& m_doc;
    std::string m_untitled;
    CAutosave m_autosave{m_doc};
    bool m_autosaveFailed = false; // and the person knows
    bool m_readOnly = false;
};
