#include "qm_db/file/foldernames.h"

#include <dirent.h>
#include <filesystem>
#include <memory>

namespace {

struct T_CLOSE {
    void operator()(DIR* folder) const { closedir(folder); }
};

} // namespace

std::vector<std::string> NamesBeside(const std::string& path)
{
    std::vector<std::string> names;
    const std::unique_ptr<DIR, T_CLOSE> folder(opendir(FolderOf(path).c_str()));
    while (const dirent* entry = folder ? readdir(folder.get()) : nullptr)
        names.emplace_back(entry->d_name);
    return names;
}

std::string FolderOf(const std::string& path)
{
    const std::string folder = std::filesystem::path(path).parent_path().string();
    return folder.empty() ? "." : folder;
}
