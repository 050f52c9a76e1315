#include "qm_db/dbdoc.h"

#include "qm_db/casefile.h"

#include <algorithm>
#include <filesystem>
#include <utility>

namespace {

CDBDoc*& CurrentDoc()
{
    static CDBDoc* current = nullptr; // the documented switch: which document is current
    return current;
}

} // namespace

CDBDoc::CDBDoc()
{
    SetDocPoint(this);
}

CDBDoc::~CDBDoc()
{
    if (GetDocPoint() == this) SetDocPoint(nullptr);
}

CDBDoc* CDBDoc::GetDocPoint()
{
    return CurrentDoc();
}
void CDBDoc::SetDocPoint(CDBDoc* doc)
{
    CurrentDoc() = doc;
}

void CDBDoc::Reset(T_MODEL_CONTENT content, const std::string& path)
{
    m_data.Assign(std::move(content));
    m_undo.Clear();
    m_path = path;
}

void CDBDoc::NewModel()
{
    m_store.Close();
    Reset({}, {});
}

int CDBDoc::OpenModel(const std::string& path, OPEN_MODE mode, T_FILE_ERROR& error)
{
    T_MODEL_CONTENT content;
    if (!m_store.Open(path, mode, content, error)) return 0;
    Reset(std::move(content), path);
    return 1;
}

int CDBDoc::ImportCase(const std::string& path, T_FILE_ERROR& error)
{
    T_MODEL_CONTENT content;
    if (!CCaseFile::Read(path, content, error)) return 0;
    m_store.Close();
    Reset(std::move(content), path);
    return 1;
}

int CDBDoc::SaveModel(T_FILE_ERROR& error)
{
    return SaveModelAs(m_path, error);
}

int CDBDoc::SaveModelAs(const std::string& path, T_FILE_ERROR& error)
{
    if (!m_store.Save(path, m_data.Content(), error)) return 0;
    m_path = path;
    m_data.SetModified(false);
    return 1;
}

int CDBDoc::ExportCase(const std::string& path, T_FILE_ERROR& error) const
{
    return CCaseFile::Write(path, m_data.Content(), error);
}

int CDBDoc::SaveAs(const std::string& path, T_FILE_ERROR& error)
{
    if (std::filesystem::path(path).extension() != ".json") return SaveModelAs(path, error);
    if (!ExportCase(path, error)) return 0;
    m_path = path;
    m_data.SetModified(false);
    return 1;
}

int CDBDoc::RunAnalysis(const T_ANALYSIS_OPTIONS& options, T_ANALYSIS_ERROR& error)
{
    if (m_running.exchange(true)) {
        error = {};
        error.fault = ANALYSIS_FAULT::Failed;
        error.text = "an analysis of this model is running already";
        return 0;
    }
    struct T_END {
        std::atomic<bool>& running;
        ~T_END() { running = false; }
    } const end{m_running};
    return CAnalysisRun(m_data, m_edit).Run(options, error);
}

bool CDBDoc::IsPostMode()
{
    if (!m_data.Model().stages.empty()) return m_post.CheckStagedResult() != 0;
    const std::vector<int> cases = m_attr.GetStldKeys();
    return std::any_of(cases.begin(), cases.end(),
                       [&](int key) { return m_post.CheckStaticResult(key) != 0; });
}
