#include "qm_rps/mainframe.h"

#include "qm_base/messagehistory.h"
#include "qm_base/msgfunction.h"
#include "qm_db/casefile.h"
#include "qm_db/filectrl.h"
#include "qm_db/sectionproperties.h"

#include <filesystem>
#include <memory>

namespace {

using zql::frx::ANSWER;
using zql::lib::MMSGFunction;

constexpr const char* kExtension = ".qmdb";

std::string NameOfFile(const std::string& path)
{
    return path.empty() ? MMSGFunction::GetValue("IDS_QM_UI_UNTITLED")
                        : std::filesystem::path(path).filename().string();
}

void Note(const char* key, const std::string& what)
{
    GSaveHistoryFormatNF("%s", MMSGFunction::Format(key, {what}).c_str());
}

} // namespace

CMainFrame::CMainFrame(CDBDoc& doc, const std::string& untitled) : m_doc(doc), m_untitled(untitled)
{
    FollowDocument();
}

std::string CMainFrame::CopiedFile() const
{
    if (m_readOnly) return {};
    return m_doc.Path().empty() ? m_untitled : m_doc.Path();
}

/// The copies of the document go beside its file.
void CMainFrame::FollowDocument()
{
    m_autosave.Follow(CopiedFile());
    m_autosaveFailed = false;
}

/// The document may also be saved by others than this window, under another name too: an iteration
/// does.
void CMainFrame::FollowSaves()
{
    const bool isMoved = m_autosave.File() != CopiedFile();
    if (isMoved || !m_doc.Data().IsModified()) m_autosave.Remove();
    if (isMoved) FollowDocument();
}

int CMainFrame::OfferRecovery(const std::string& file)
{
    T_AUTOSAVE_COPY copy;
    if (file.empty() || !CAutosave::Newest(file, copy)) return 0;
    constexpr const char* kKey = "IDS_QM_UI_RECOVER";
    const ANSWER answer =
        AskYesNoCancel(kKey, MMSGFunction::Format(kKey, {NameOfFile(file == m_untitled ? "" : file),
                                                         std::to_string(copy.sequence)}));
    if (answer == ANSWER::Cancel) return 0;
    auto ended = std::make_unique<CAutosave>(m_doc);
    ended->Follow(file);
    if (!ended->TakeOver(copy)) return 0; // another window was faster
    if (answer == ANSWER::No) {           // the person gives the changes up
        ended->Remove();
        return 0;
    }
    T_FILE_ERROR error;
    if (!m_doc.RecoverModel(copy.path, file == m_untitled ? std::string() : file, error))
        return Refuse(error.text);
    m_readOnly = false;
    FollowDocument();
    ended.reset();
    (void)!m_autosave.TakeOver(copy); // else another window has them, and removes them
    Note("IDS_QM_UI_RECOVERED", copy.path);
    return 1;
}

int CMainFrame::OnStart(const std::vector<std::string>& files)
{
    for (const std::string& file : files)
        if (OfferRecovery(file)) return 1;
    return OfferRecovery(m_untitled);
}

void CMainFrame::OnTick(double nowS)
{
    FollowSaves();
    T_FILE_ERROR error;
    switch (m_autosave.Tick(nowS, error)) {
    case AUTOSAVE::Written:
        m_autosaveFailed = false;
        break;
    case AUTOSAVE::Failed:
        if (!m_autosaveFailed) Note("IDS_QM_UI_AUTOSAVE_FAILED", error.text);
        m_autosaveFailed = true;
        break;
    case AUTOSAVE::Nothing:
        break;
    }
}

int CMainFrame::Refuse(const std::string& text)
{
    constexpr const char* kKey = "IDS_QM_UI_FILE_REFUSED";
    ShowMessage(kKey, MMSGFunction::Format(kKey, {text}));
    return 0;
}

std::string CMainFrame::Title() const
{
    std::string title = NameOfFile(m_doc.Path());
    if (m_doc.Data().IsModified()) title += "*";
    if (m_readOnly) title += " " + MMSGFunction::GetValue("IDS_QM_UI_READ_ONLY");
    return title;
}

std::string CMainFrame::SavePath() const
{
    return m_readOnly || !CFileCtrl::IsModelName(m_doc.Path()) ? std::string() : m_doc.Path();
}

/// Edits are saved or given up; false: the person wants to go on with the document.
bool CMainFrame::MayReplace()
{
    if (m_mayLeave && !m_mayLeave()) return false;
    FollowSaves();
    if (!m_doc.Data().IsModified()) return true;
    constexpr const char* kKey = "IDS_QM_UI_SAVE_CHANGES";
    switch (AskYesNoCancel(kKey, MMSGFunction::Format(kKey, {NameOfFile(m_doc.Path())}))) {
    case ANSWER::Yes: {
        const std::string path = SavePath().empty() && m_askPath ? m_askPath() : SavePath();
        return !path.empty() && OnSaveAs(path) != 0;
    }
    case ANSWER::No:
        m_autosave.Remove();
        return true;
    default:
        return false;
    }
}

int CMainFrame::OnNew()
{
    if (!MayReplace()) return 0;
    T_MODEL_CONTENT content;
    content.model.styp.units = m_newUnits;
    m_doc.NewModel();
    m_doc.Data().Assign(std::move(content));
    m_readOnly = false;
    FollowDocument();
    return 1;
}

int CMainFrame::OnOpenCopy(const std::string& path)
{
    T_MODEL_CONTENT content;
    T_FILE_ERROR error;
    if (!CCaseFile::Read(path, content, error)) return Refuse(error.text);
    if (!MayReplace()) return 0;
    m_doc.NewModel();
    m_doc.Data().Assign(std::move(content));
    m_readOnly = false;
    Note("IDS_QM_UI_OPENED_COPY", path);
    FollowDocument();
    return 1;
}

int CMainFrame::OpenModel(const std::string& path)
{
    T_FILE_ERROR error;
    if (m_doc.OpenModel(path, OPEN_MODE::Edit, error)) {
        m_readOnly = false;
        return 1;
    }
    if (error.fault != FILE_FAULT::NoAccess) return Refuse(error.text);
    constexpr const char* kKey = "IDS_QM_UI_OPEN_READ_ONLY";
    T_FILE_ERROR again;
    if (!std::filesystem::exists(path) || !AskYesNo(kKey, MMSGFunction::Format(kKey, {error.text})))
        return Refuse(error.text);
    if (!m_doc.OpenModel(path, OPEN_MODE::ReadOnly, again)) return Refuse(again.text);
    m_readOnly = true;
    return 1;
}

int CMainFrame::OnOpen(const std::string& path)
{
    if (!MayReplace()) return 0;
    if (CModelStore::IsModelFile(path)) {
        if (!OpenModel(path)) return 0;
    } else {
        T_FILE_ERROR error;
        if (!m_doc.ImportCase(path, error)) return Refuse(error.text);
        m_readOnly = false;
    }
    Note("IDS_QM_UI_OPENED", path);
    FollowDocument();
    if (!m_readOnly) (void)OfferRecovery(path);
    return 1;
}

int CMainFrame::OnSave()
{
    return SavePath().empty() ? 0 : OnSaveAs(SavePath());
}

/// Where another program has changed the file meanwhile the person decides.
int CMainFrame::Save(const std::string& path, T_FILE_ERROR& error)
{
    if (m_doc.SaveAs(path, error)) return 1;
    constexpr const char* kKey = "IDS_QM_UI_SAVE_OVER_CHANGES";
    if (error.fault != FILE_FAULT::Changed ||
        !AskYesNo(kKey, MMSGFunction::Format(kKey, {error.text})))
        return 0;
    m_doc.AcceptChanges();
    return m_doc.SaveAs(path, error);
}

int CMainFrame::OnSaveAs(const std::string& path)
{
    std::string to = path;
    if (std::filesystem::path(to).extension().empty()) {
        to += kExtension; // a name that the person was not asked about
        constexpr const char* kKey = "IDS_QM_UI_REPLACE";
        if (std::filesystem::exists(to) && !AskYesNo(kKey, MMSGFunction::Format(kKey, {to})))
            return 0;
    }
    T_FILE_ERROR error;
    if (!Save(to, error)) return Refuse(error.text);
    m_readOnly = false;
    m_autosave.Remove(); // what they held is in the file now
    FollowDocument();
    Note("IDS_QM_UI_SAVED", to);
    return 1;
}

int CMainFrame::OnExportCase(const std::string& path)
{
    T_FILE_ERROR error;
    if (!CFileCtrl::CheckOutput({path, OUTPUT_KIND::Json}, error) || !m_doc.ExportCase(path, error))
        return Refuse(error.text);
    Note("IDS_QM_UI_SAVED", path);
    return 1;
}

int CMainFrame::OnClose()
{
    return MayReplace() ? 1 : 0;
}

int CMainFrame::OnAnalyse(int modes, std::function<bool(std::size_t, std::size_t)> progress)
{
    T_ANALYSIS_OPTIONS options;
    options.modes = modes;
    options.progress = std::move(progress);
    T_ANALYSIS_ERROR error;
    if (!m_doc.RunAnalysis(options, error)) {
        if (error.fault == ANALYSIS_FAULT::Cancelled) return 0;
        return Refuse(error.text);
    }
    for (const T_LOST_DIGITS& lost : m_doc.LostDigits())
        GSaveHistoryFormatNF("%s", m_doc.TextOf(lost).c_str());
    if (const std::string text = StiffnessFactorText(m_doc.Data().Model()); !text.empty())
        GSaveHistoryFormatNF("%s", text.c_str());
    Note("IDS_QM_UI_ANALYSED", NameOfFile(m_doc.Path()));
    return 1;
}
