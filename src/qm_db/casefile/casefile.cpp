#include "qm_db/casefile.h"

#include "qm_db/casefile/casereader.h"
#include "qm_db/casefile/casewriter.h"
#include "qm_db/casefile/jsonparser.h"
#include "qm_db/filectrl.h"

#include <atomic>
#include <filesystem>

namespace {

std::atomic<bool> g_allowOutside = false; // see SetAllowOutside()

} // namespace

void CCaseFile::SetAllowOutside(bool allow)
{
    g_allowOutside = allow;
}

int CCaseFile::Read(const std::string& path, T_MODEL_CONTENT& out, T_FILE_ERROR& error)
{
    std::string text;
    if (!CFileCtrl::ReadWholeFile(path, text, error)) return 0;
    return Parse(text, path, std::filesystem::path(path).parent_path().string(), out, error);
}

int CCaseFile::Parse(std::string_view text, const std::string& name, const std::string& folder,
                     T_MODEL_CONTENT& out, T_FILE_ERROR& error)
{
    T_JSON document;
    T_FILE_ERROR fault;
    T_MODEL_CONTENT content;
    if (ParseJson(text, document, fault)) {
        CJsonReader root(&document, {}, fault);
        ReadCase(root, {folder, g_allowOutside}, content);
    }
    if (fault.fault != FILE_FAULT::None) {
        error = {fault.fault, name + ": " + fault.text};
        return 0;
    }
    out = std::move(content);
    return 1;
}

int CCaseFile::Print(const T_MODEL_CONTENT& content, std::string& text, T_FILE_ERROR& error)
{
    CJsonWriter writer(content.model.styp.units);
    WriteCase(writer, content);
    if (writer.Failed()) {
        error = writer.Error();
        return 0;
    }
    text = writer.TakeText();
    return 1;
}

int CCaseFile::Write(const std::string& path, const T_MODEL_CONTENT& content, T_FILE_ERROR& error)
{
    std::string text;
    if (!Print(content, text, error)) {
        error.text = path + ": " + error.text;
        return 0;
    }
    return CFileCtrl::WriteWholeFile(path, text, error);
}
