#include "qm_base/say.h"
#include "qm_db/filectrl.h"
#include "qm_db/modelstore.h"

#include <algorithm>
#include <array>
#include <filesystem>
#include <iterator>
#include <sys/stat.h>
#include <vector>

namespace fs = std::filesystem;

namespace {

struct T_KIND {
    OUTPUT_KIND kind;
    const char* key;          // its words
    std::string_view endings; // each begins with a dot
    bool isStrict;            // no other ending
};

// clang-format off
constexpr std::array<T_KIND, 8> kKinds{{
    {OUTPUT_KIND::Model,    "IDS_QM_OUTPUT_MODEL",    ".qmdb",                         true},
    {OUTPUT_KIND::Document, "IDS_QM_OUTPUT_DOCUMENT", ".qmdb .json",                   true},
    {OUTPUT_KIND::Sheet,    "IDS_QM_OUTPUT_SHEET",    ".xlsx",                         true},
    {OUTPUT_KIND::Picture,  "IDS_QM_OUTPUT_PICTURE",  ".svg .pdf .png .jpg .jpeg .bmp", true},
    {OUTPUT_KIND::Html,     "IDS_QM_OUTPUT_HTML",     ".html .htm",                     true},
    {OUTPUT_KIND::Pdf,      "IDS_QM_OUTPUT_PDF",      ".pdf",                           true},
    {OUTPUT_KIND::Json,     "IDS_QM_OUTPUT_JSON",     ".json",                         false},
    {OUTPUT_KIND::Text,     "IDS_QM_OUTPUT_TEXT",     ".txt",                          false},
}};
// clang-format on

const T_KIND& KindOf(OUTPUT_KIND kind)
{
    return *std::ranges::find(kKinds, kind, &T_KIND::kind);
}

/// In lower case, with its dot; empty without one.
std::string EndingOf(const std::string& path)
{
    std::string ending = fs::path(path).extension().string();
    for (char& c : ending)
        if (c >= 'A' && c <= 'Z') c = static_cast<char>(c - 'A' + 'a');
    return ending;
}

bool Has(const T_KIND& kind, const std::string& ending)
{
    return !ending.empty() &&
           (std::string(kind.endings) + ' ').find(ending + ' ') != std::string::npos;
}

/// A device or a pipe.
bool IsSpecial(const std::string& path)
{
    struct stat status {};
    return path != "-" && stat(path.c_str(), &status) == 0 && !S_ISREG(status.st_mode) &&
           !S_ISDIR(status.st_mode);
}

bool IsFilled(const std::string& path)
{
    struct stat status {};
    return stat(path.c_str(), &status) == 0 && S_ISREG(status.st_mode) && status.st_size > 0;
}

/// By what the paths lead to where both are there, else by their names.
bool IsSameFile(const std::string& a, const std::string& b)
{
    std::error_code fault;
    if (a == b || (fs::equivalent(a, b, fault) && !fault)) return true;
    const fs::path first = fs::weakly_canonical(fs::absolute(a, fault), fault);
    return !fault && first == fs::weakly_canonical(fs::absolute(b, fault), fault) && !fault;
}

/// What is wrong with the name; empty when nothing is.
std::string EndingFault(const T_OUTPUT& output)
{
    const T_KIND& kind = KindOf(output.kind);
    const std::string ending = EndingOf(output.path);
    if (Has(kind, ending)) return {};
    if (kind.isStrict)
        return Say("IDS_QM_OUTPUT_ENDING", output.path, Say(kind.key), std::string(kind.endings));
    for (const T_KIND& other : kKinds)
        if (other.isStrict && Has(other, ending))
            return Say("IDS_QM_OUTPUT_ENDING_OF", output.path, Say(other.key));
    return {};
}

bool IsOfModelKind(OUTPUT_KIND kind)
{
    return kind == OUTPUT_KIND::Model || kind == OUTPUT_KIND::Document;
}

/// What can't be meant, whatever is there; empty when nothing is wrong.
std::string MisuseOf(std::span<const std::string> inputs, std::span<const T_OUTPUT> outputs,
                     std::size_t index)
{
    const T_OUTPUT& output = outputs[index];
    if (IsSpecial(output.path)) return {};
    const auto isSame = [&](const std::string& other) { return IsSameFile(other, output.path); };
    const auto before = outputs.first(index);
    if (std::ranges::any_of(before, isSame, &T_OUTPUT::path))
        return Say("IDS_QM_OUTPUT_TWICE", output.path);
    if (output.path == "-") return {};
    if (std::ranges::any_of(inputs, isSame)) return Say("IDS_QM_OUTPUT_OVER_INPUT", output.path);
    if (std::string fault = EndingFault(output); !fault.empty()) return fault;
    if (!IsOfModelKind(output.kind) && IsFilled(output.path) &&
        CModelStore::IsModelFile(output.path))
        return Say("IDS_QM_OUTPUT_MODEL_THERE", output.path);
    return {};
}

} // namespace

int CFileCtrl::CheckOutputs(std::span<const std::string> inputs, std::span<const T_OUTPUT> outputs,
                            bool overwrite, T_FILE_ERROR& error)
{
    std::vector<T_OUTPUT> asked;
    std::ranges::copy_if(outputs, std::back_inserter(asked),
                         [](const T_OUTPUT& output) { return !output.path.empty(); });
    for (std::size_t i = 0; i < asked.size(); ++i) {
        if (std::string text = MisuseOf(inputs, asked, i); !text.empty()) {
            error = {FILE_FAULT::Misuse, std::move(text)};
            return 0;
        }
    }
    for (const T_OUTPUT& output : asked) {
        if (overwrite || !IsFilled(output.path)) continue;
        error = {FILE_FAULT::NoAccess, Say("IDS_QM_OUTPUT_EXISTS", output.path)};
        return 0;
    }
    return 1;
}

bool CFileCtrl::IsModelName(const std::string& path)
{
    return EndingOf(path) == ".qmdb";
}

void CFileCtrl::MakeFilesLike(const std::string& path)
{
    static const mode_t usual = [] {
        const mode_t mask = umask(0);
        umask(mask);
        return mask;
    }();
    constexpr mode_t kOthers = S_IRGRP | S_IWGRP | S_IROTH | S_IWOTH;
    struct stat model {};
    const bool isThere = !path.empty() && stat(path.c_str(), &model) == 0;
    umask(usual | (isThere ? ~model.st_mode & kOthers : 0));
}
