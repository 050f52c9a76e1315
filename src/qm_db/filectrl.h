// File names and whole-file writing.
#pragma once

#include "qm_db/fileerror.h"

#include <cstddef>
#include <cstdint>
#include <span>
#include <string>
#include <string_view>

/// What a command or a window writes; the ending of the name goes with it.
enum class OUTPUT_KIND {
    Model,    // .qmdb
    Document, // .qmdb, or a case file, .json
    Sheet,    // .xlsx
    Picture,  // .svg .pdf .png .jpg .jpeg .bmp
    Html,     // .html .htm
    Pdf,      // .pdf
    Json,     // any ending but one of the other kinds
    Text      // likewise
};

struct T_OUTPUT {
    std::string path; // empty: not asked for; "-": standard output
    OUTPUT_KIND kind{};
};

class CFileCtrl {
public:
    static constexpr std::size_t kMostRead = std::size_t{1} << 30; // bytes

    /// "/a/b/frame.v2.qmdb" gives "/a/b/frame.v2"; a path without an extension stays as it is.
    static std::string GetFilePathAndNameWithoutExtension(const std::string& path);

    /// Replaces the file by `text`: written beside it, fsynced and renamed over, so that a failure
    /// leaves the old file. 1 done; 0 error filled (fault NoAccess, names the file and the reason).
    [[nodiscard]] static int WriteWholeFile(const std::string& path, std::string_view text,
                                            T_FILE_ERROR& error);
    /// The same over a file that was read before: refused (fault Changed) where its content has
    /// another sum by now, and while another writer has it.
    [[nodiscard]] static int UpdateWholeFile(const std::string& path, std::string_view text,
                                             std::uint64_t sumBefore, T_FILE_ERROR& error);
    /// Of the bytes of a file.
    static std::uint64_t SumOf(std::string_view text);
    /// The rule of all outputs of one run, to be asked before anything is written. Refused: a name
    /// whose ending does not go with the kind, an output over one of the inputs, two outputs to one
    /// file, a model file that something else would replace (Misuse); and, unless `overwrite`, a
    /// file that is there already and not empty (NoAccess). Devices and pipes may be named freely.
    [[nodiscard]] static int CheckOutputs(std::span<const std::string> inputs,
                                          std::span<const T_OUTPUT> outputs, bool overwrite,
                                          T_FILE_ERROR& error);

    /// The rule for one output that a person has chosen in a window, who was asked there already.
    [[nodiscard]] static int CheckOutput(const T_OUTPUT& output, T_FILE_ERROR& error)
    {
        return CheckOutputs({}, std::span(&output, 1), true, error);
    }

    /// Whether the ending is that of a model file; an output without that ending is a case file.
    static bool IsModelName(const std::string& path);

    /// New files of this process are from now on no more open to others than this file, from which
    /// they are made; for no or a missing file as the process was started.
    static void MakeFilesLike(const std::string& path);

    /// Removes what killed writers have left in the folder of this file.
    static void SweepBeside(const std::string& path);

    /// Reads the whole file: a regular one (no pipe, no device) of up to kMostRead bytes. 1 done;
    /// 0 error filled.
    [[nodiscard]] static int ReadWholeFile(const std::string& path, std::string& text,
                                           T_FILE_ERROR& error);
};
