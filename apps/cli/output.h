// What all commands do with their results: complaints, texts, pictures, model files.
#pragma once

#include "exitcodes.h"
#include "qm_db/dbdoc.h"
#include "qm_db/filectrl.h"

#include <string>
#include <string_view>
#include <vector>

struct T_PLOT;

/// One line on stderr; gives the code back.
EXIT_CODE Complain(EXIT_CODE code, const std::string& text);

/// A line on the terminal that the next call writes over; the last one ends it.
void ShowOnTerminal(const std::string& text, bool last);

/// Done for no name or one that ends in a picture format that this program can draw; else a
/// message and Usage.
EXIT_CODE CheckPlotName(const std::string& path);

/// The rule of all outputs (CFileCtrl::CheckOutputs) for a command that reads this file. Done, or
/// the code to exit with after one line on stderr.
EXIT_CODE CheckOutputs(const std::string& input, const std::vector<T_OUTPUT>& outputs,
                       bool overwrite);

/// Writes to a file, or to standard output for "-".
EXIT_CODE WriteOutput(const std::string& path, std::string_view text);

/// The path itself for one result; for several a number before the extension.
std::string NumberedPath(const std::string& path, std::size_t index, std::size_t count);

/// Draws the plot; nothing for an empty path.
EXIT_CODE WritePicture(const T_PLOT& plot, const std::string& path);

/// Writes the document as a model file (.qmdb) or as a case file, told by the name.
EXIT_CODE SaveDocument(CDBDoc& doc, const std::string& path);
