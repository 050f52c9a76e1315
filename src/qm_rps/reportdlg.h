// Model of the window of the report: title block, chapters, preview, files. It opens with the
// settings that the model keeps, and keeps them there when a report is made.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_rps/modelreport.h"

class CReportDlg : public zql::frx::MDialog {
public:
    /// The document must outlive the dialog.
    explicit CReportDlg(CDBDoc& doc);

    T_REPORT_D m_head; // its chapters and rows are those below
    std::array<bool, kReportChapterNames.size()> m_chosen{};
    int m_rows = 200; // of a table at most; 0: all
    std::string m_fileHash;

    static std::string ChapterText(std::size_t chapter);

    /// Runs a long task and tells what is being made; set by the application. Empty: it just runs.
    using TELL_FN = std::function<bool(const std::string&)>;
    std::function<int(const std::function<int(const TELL_FN&)>&)> m_run;
    /// Asks for the file to write; set by the application. Empty text: cancelled.
    std::function<std::string(bool pdf)> m_askFile;
    /// Writes the document as a page or as a PDF; set by the view. 1 done; 0 error says why not.
    std::function<int(bool pdf, const std::string& path, std::string& error)> m_write;

    /// Keeps the present settings in the model, as one step that can be undone, and makes the
    /// document of them. 1 made; 0 cancelled, or with a message: no chapter is chosen, the number
    /// of rows is negative (nothing is kept then), or the model can't be changed now. What was made
    /// before stays.
    int OnMake();
    /// Writes a file of the present settings. 1 written; 0 cancelled, or with a message.
    int OnWrite(bool pdf);
    /// The latest one, also where settings have changed since.
    const T_DOCUMENT& Document() const { return m_document; }
    bool IsMade() const { return m_times > 0; }
    /// How often one was made.
    int Times() const { return m_times; }
    CDBDoc& Doc() { return m_doc; }
    /// "12 pages; not of the present settings".
    std::string StateText(std::size_t pages) const;

private:
    T_REPORT_OPTIONS Options() const;
    T_REPORT_D Settings() const;
    [[nodiscard]] int Keep();
    bool IsCurrent() const;

    CDBDoc& m_doc;
    T_DOCUMENT m_document;
    T_REPORT_D m_madeHead;
    std::array<bool, kReportChapterNames.size()> m_madeChosen{};
    int m_madeRows = 0;
    long m_hashRevision = -1; // of the document that differs from its file by settings alone
    long m_madeRevision = -1;
    int m_times = 0;
};
