// File names and whole-file writing.
#pragma once

#include "qm_db/fileerror.h"

#include <string>
#include <string_view>

class CFileCtrl {
public:
    /// "/a/b/frame.v2.qmdb" gives "/a/b/frame.v2"; a path without an extension stays as it is.
    static std::string GetFilePathAndNameWithoutExtension(const std::string& path);

    /// Replaces the file by `text`: written beside it, fsynced and renamed over, so that a failure
    /// leaves the old file. 1 done; 0 error filled (fault NoAccess, names the file and the reason).
    [[nodiscard]] static int WriteWholeFile(const std::string& path, std::string_view text,
                                            T_FILE_ERROR& error);
    /// Reads the whole file. 1 done; 0 error filled.
    [[nodiscard]] static int ReadWholeFile(const std::string& path, std::string& text,
                                           T_FILE_ERROR& error);
};
