// A document as one HTML file: no script, nothing loaded from elsewhere, readable in light and
// dark, ready to be printed.
#pragma once

#include "qm_rps/document/document.h"

#include <functional>

/// A picture as the text of an <svg> element; empty: there is none.
using DOC_SVG_FN = std::function<std::string(const T_DOC_PICTURE&)>;

/// The whole file, UTF-8. Every text is escaped. The same document gives the same bytes.
std::string HtmlOf(const T_DOCUMENT& document, const DOC_SVG_FN& svg);

/// CleanText between tags: &, <, > and quotes are written as entities.
std::string HtmlText(std::string_view text);
