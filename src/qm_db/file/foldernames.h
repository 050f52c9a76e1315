// What lies in a folder.
#pragma once

#include <string>
#include <vector>

/// Names in the folder of this file, in any order; none where it can't be read. In place of
/// std::filesystem::directory_iterator, which ends the process where memory is short.
std::vector<std::string> NamesBeside(const std::string& path);

/// The folder of this file; "." for a bare name.
std::string FolderOf(const std::string& path);
