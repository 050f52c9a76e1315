// Tables of documents as pieces of pages. A cell higher than half a page is cut and says so.
#pragma once

#include "qm_ui/document/pageflow.h"

/// Columns as wide as their texts where they fit; else texts wrap, the font gets smaller, and what
/// then is still too wide goes on in further tables with the first column repeated.
void AddTable(const T_DOC_TABLE& table, const T_DOC_WORDS& words, double width,
              std::vector<T_FLOW_PIECE>& out);
/// Symbol, definition, value, formula with its numbers, clause, under their heads; inputs as name
/// and value.
void AddFacts(const T_DOC_FACTS& facts, const T_DOC_WORDS& words, double width,
              std::vector<T_FLOW_PIECE>& out);
/// Name and value, without a head; empty values are lines to write on.
void AddPairs(const std::vector<T_DOC_HEAD_ROW>& rows, const T_DOC_WORDS& words, double width,
              double rowHeight, std::vector<T_FLOW_PIECE>& out);
