// The JSON case file: the text form of a model with its results. Import and export are lossless.
#pragma once

#include "qm_db/fileerror.h"
#include "qm_db/modelstore.h"

#include <string>
#include <string_view>

class CCaseFile {
public:
    /// Whether recorder files may lie outside the folder of their case file (they may not, unless
    /// a program says so at its start). A case file from elsewhere can't make the program read what
    /// the person did not put beside it.
    static void SetAllowOutside(bool allow);

    /// Reads a case file; values are converted from the file's units to SI. Recorder files named
    /// by "steps": {"files": ...} are read relative to the case file. 1 done; 0 error filled with
    /// one line that names file and place (`pushover[0].steps.displacement."5": ...`), `out` as it
    /// was.
    [[nodiscard]] static int Read(const std::string& path, T_MODEL_CONTENT& out,
                                  T_FILE_ERROR& error);

    /// The same from text; `name` stands for the file in messages, `folder` for relative paths.
    [[nodiscard]] static int Parse(std::string_view text, const std::string& name,
                                   const std::string& folder, T_MODEL_CONTENT& out,
                                   T_FILE_ERROR& error);

    /// The model as case file text in the document's units: ordered keys, numbers shortest so
    /// that reading them back gives the same stored value. 1 done; 0 a result can't be read.
    [[nodiscard]] static int Print(const T_MODEL_CONTENT& content, std::string& text,
                                   T_FILE_ERROR& error);

    /// Prints to a file (written beside and renamed, so that nothing is half-written).
    [[nodiscard]] static int Write(const std::string& path, const T_MODEL_CONTENT& content,
                                   T_FILE_ERROR& error);
};
