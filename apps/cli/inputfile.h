// Opening of the file that a command names: a case file or a model file.
#pragma once

#include "exitcodes.h"
#include "qm_db/dbdoc.h"

#include <string>

/// True for a model file: by its extension, or by what it starts with.
bool IsModelFile(const std::string& path);

/// Opens the file into the document. Done, or the code to exit with after one line on stderr.
EXIT_CODE OpenInput(CDBDoc& doc, const std::string& path);

/// Prints the error as one line on stderr and gives the code to exit with.
EXIT_CODE ReportFileError(const T_FILE_ERROR& error);
