// What the chapters of a report share while it is made.
#pragma once

#include "qm_rps/document/docparts.h"
#include "qm_rps/document/report.h"

/// A warning and the places that it is about.
struct T_REPORT_REMARK {
    std::string text;
    std::vector<std::string> where;
};

/// The report as far as it has come.
struct T_REPORT_WORK {
    CDBDoc& doc;
    const T_REPORT_DATA& data;
    const T_REPORT_OPTIONS& options;
    T_TABLE_LIMIT limit;
    std::vector<T_REPORT_REMARK> remarks{}; // of all chapters, each once, in their order

    const T_MODEL& Model() const { return doc.Data().Model(); }
    const T_UNITS& Units() const { return doc.Data().Units(); }
    /// For the page of remarks.
    void Remark(const std::string& where, const std::string& text);
};

/// A table of all records of the kind; nothing where there are none.
void AddRecords(T_REPORT_WORK& work, EXPLORER_TABLE kind, T_DOC_CHAPTER& to);

/// Each fills one chapter; nothing in it: the model has nothing of the kind.
void FillModelChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter);
void FillLoadsChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter);
void FillModesChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter);
void FillHingesChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter);
void FillPushesChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter);
void FillEvaluationsChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter);
void FillJudgementChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter);
void FillFactorsChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter);
void FillStagesChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter);
void FillRemarksChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter);
