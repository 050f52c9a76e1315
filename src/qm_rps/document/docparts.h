// Parts that chapters of a report are made of.
#pragma once

#include "qm_db/dbdoc.h"
#include "qm_rps/desk/recordgrid.h"
#include "qm_rps/document/document.h"

/// The same settings for every table of a report.
struct T_TABLE_LIMIT {
    std::size_t most = 200; // rows of a table; 0: all
    std::size_t last = 0;   // of these, rows from the end of the table
};

/// Seven significant digits: what a person reads, not what is stored.
std::string ReportNumber(double value);

/// With a large first letter, where that is a plain one.
std::string Capital(std::string text);
T_DOC_TEXT DocText(std::string text, DOC_TONE tone = DOC_TONE::Plain);

/// Cuts a table that is too long and says so in its caption: "(rows 1 to 200 of 4000)".
T_DOC_TABLE DocTable(std::string caption, T_TEXT_TABLE table, T_TABLE_LIMIT limit);
/// The records of one kind, without the columns in which no record has anything.
T_DOC_TABLE RecordsTable(CDBDoc& doc, EXPLORER_TABLE kind, T_TABLE_LIMIT limit);
/// Traces of a code as facts; values and units in those of the model.
std::vector<T_FACT> FactsOf(const std::vector<T_CODE_TRACE>& trace, const T_UNITS& units);
