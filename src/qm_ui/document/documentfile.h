// Writes a document as HTML or PDF.
#pragma once

#include "qm_db/dbdoc.h"
#include "qm_rps/document/document.h"

#include <string>

/// SHA-256 of a file in hexadecimal; empty: it can't be read.
std::string FileHash(const std::string& path);

/// One self-contained file. Needs no screen, as WritePictureFile. 1 done; 0 error names the file,
/// which is then as it was.
[[nodiscard]] int WriteDocumentHtml(CDBDoc& doc, const T_DOCUMENT& document,
                                    const std::string& path, std::string& error);
/// A4 pages with embedded fonts and bookmarks; the same document gives the same bytes.
[[nodiscard]] int WriteDocumentPdf(CDBDoc& doc, const T_DOCUMENT& document, const std::string& path,
                                   std::string& error);
