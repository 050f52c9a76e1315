// The report that an engineer hands in: the whole model, what was computed, and what was found.
#pragma once

#include "qm_db/dbdoc.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/document/document.h"
#include "qm_rps/document/reportdata.h"

#include <functional>

/// Chapters by kReportChapterNames.
enum class REPORT_CHAPTER {
    Model,
    Loads,
    Modes,
    Hinges,
    Pushes,
    Evaluations,
    Judgement,
    Factors,
    Stages,
    Remarks
};
/// Key of a chapter's title.
const char* ChapterKey(REPORT_CHAPTER chapter);

struct T_REPORT_OPTIONS {
    T_REPORT_D head;
    std::vector<REPORT_CHAPTER> only; // empty: those of the head
    std::size_t mostRows = 200;       // of a table; 0: all
    std::string fileName;             // of the model, as it is shown
    std::string fileHash;             // SHA-256 of the file; empty: it is not known
    /// Told what is being made; false: no more is wanted.
    std::function<bool(const std::string&)> progress{};
};

/// Chapters of a comma-separated list of their names. None: `unknown` is not one.
std::optional<std::vector<REPORT_CHAPTER>> ChaptersNamed(const std::string& list,
                                                         std::string& unknown);

/// The chapters that are asked for.
std::vector<REPORT_CHAPTER> ChosenChapters(const T_REPORT_OPTIONS& options);

/// Writes the report. Chapters without anything in model and data are left out.
T_DOCUMENT WriteReport(CDBDoc& doc, const T_REPORT_DATA& data, const T_REPORT_OPTIONS& options);
