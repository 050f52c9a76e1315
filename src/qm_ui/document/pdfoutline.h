// What the writer of pages can't put into a PDF: bookmarks, and bytes that do not change.
#pragma once

#include "qm_ui/document/documentpages.h"

#include <string>

/// The PDF with the marks as bookmarks, without its time of making and with an identifier that
/// follows from its content. Throws std::exception on bytes that are no PDF.
std::string FinishPdf(const std::string& pdf, const std::vector<T_PAGE_MARK>& marks,
                      const std::string& program);
