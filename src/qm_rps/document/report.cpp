#include "qm_rps/document/report.h"

#include "qm_base/msgfunction.h"
#include "qm_base/say.h"
#include "qm_rps/document/reportmaker.h"
#include "qm_rps/pushover/report/pushoverreport.h"

#include <algorithm>

namespace {

struct T_CHAPTER_ROW {
    const char* key;
    void (*fill)(T_REPORT_WORK&, T_DOC_CHAPTER&);
};
/// By REPORT_CHAPTER.
constexpr std::array<T_CHAPTER_ROW, kReportChapterNames.size()> kChapters{
    {{"IDS_QM_REPORT_MODEL", FillModelChapter},
     {"IDS_QM_REPORT_LOADS", FillLoadsChapter},
     {"IDS_QM_REPORT_MODES", FillModesChapter},
     {"IDS_QM_REPORT_HINGES", FillHingesChapter},
     {"IDS_QM_REPORT_PUSHES", FillPushesChapter},
     {"IDS_QM_REPORT_EVALUATIONS", FillEvaluationsChapter},
     {"IDS_QM_REPORT_JUDGEMENT", FillJudgementChapter},
     {"IDS_QM_REPORT_FACTORS", FillFactorsChapter},
     {"IDS_QM_REPORT_STAGES", FillStagesChapter},
     {"IDS_QM_REPORT_WARNINGS", FillRemarksChapter}}};

const T_CHAPTER_ROW& RowOf(REPORT_CHAPTER chapter)
{
    return kChapters[static_cast<std::size_t>(chapter)];
}

/// Rows of the title block.
std::vector<T_DOC_HEAD_ROW> HeadRows(const T_REPORT_WORK& work)
{
    const T_STYP_D& styp = work.Model().styp;
    const T_REPORT_OPTIONS& o = work.options;
    std::vector<T_DOC_HEAD_ROW> rows{
        {Say("IDS_QM_REPORT_PROJECT"), o.head.project},
        {Say("IDS_QM_REPORT_AUTHOR"), o.head.author},
        {Say("IDS_QM_REPORT_CHECKER"), o.head.checker},
        {Say("IDS_QM_REPORT_DATE"), o.head.date},
        {Say("IDS_QM_REPORT_FILE"), o.fileName},
        {Say("IDS_QM_REPORT_HASH"), o.fileHash.empty() ? Say("IDS_QM_REPORT_NO_HASH") : o.fileHash},
        {Say("IDS_QM_REPORT_UNITS"), std::string(NameOf(styp.units.force)) + ", " +
                                         std::string(NameOf(styp.units.length)) + ", s"},
        {Say("IDS_QM_REPORT_PROGRAM"), ProductText()}};
    return rows;
}

void FillHead(const T_REPORT_WORK& work, T_DOCUMENT& out)
{
    const T_STYP_D& styp = work.Model().styp;
    out.language = zql::lib::MMSGFunction::GetLanguage();
    out.title = styp.title.empty() ? Say("IDS_QM_REPORT_TITLE") : styp.title;
    out.subtitle = styp.title.empty() ? std::string() : Say("IDS_QM_REPORT_TITLE");
    out.program = ProductText();
    out.head = HeadRows(work);
    out.contents = Say("IDS_QM_REPORT_CONTENTS");
    out.signOffTitle = Say("IDS_QM_REPORT_SIGN_OFF");
    out.words = {{Say("IDS_QM_REPORT_FACT_SYMBOL"), Say("IDS_QM_REPORT_FACT_WHAT"),
                  Say("IDS_QM_REPORT_FACT_VALUE"), Say("IDS_QM_REPORT_FACT_HOW"),
                  Say("IDS_QM_REPORT_FACT_SOURCE")},
                 zql::lib::MMSGFunction::GetValue("IDS_QM_REPORT_PAGE"),
                 zql::lib::MMSGFunction::GetValue("IDS_QM_REPORT_CUT")};
    out.signOff = {Say("IDS_QM_REPORT_AUTHOR"), Say("IDS_QM_REPORT_CHECKER"),
                   Say("IDS_QM_REPORT_APPROVED")};
}

} // namespace

const char* ChapterKey(REPORT_CHAPTER chapter)
{
    return RowOf(chapter).key;
}

std::string ChapterNumber(const std::vector<std::size_t>& place)
{
    std::string text;
    for (const std::size_t i : place)
        text += (text.empty() ? "" : ".") + std::to_string(i);
    return text;
}

std::optional<std::vector<REPORT_CHAPTER>> ChaptersNamed(const std::string& list,
                                                         std::string& unknown)
{
    std::vector<REPORT_CHAPTER> out;
    for (std::size_t from = 0; from <= list.size() && !list.empty();) {
        const std::size_t to = std::min(list.find(',', from), list.size());
        std::string name = list.substr(from, to - from);
        std::erase(name, ' ');
        const auto at = std::ranges::find(kReportChapterNames, name);
        if (at == kReportChapterNames.end()) {
            unknown = name;
            return std::nullopt;
        }
        out.push_back(static_cast<REPORT_CHAPTER>(at - kReportChapterNames.begin()));
        from = to + 1;
    }
    std::ranges::sort(out);
    out.erase(std::unique(out.begin(), out.end()), out.end());
    return out;
}

void T_REPORT_WORK::Remark(const std::string& where, const std::string& text)
{
    auto at = std::ranges::find(remarks, text, &T_REPORT_REMARK::text);
    if (at == remarks.end()) at = remarks.insert(at, {text, {}});
    if (!where.empty() && std::ranges::count(at->where, where) == 0) at->where.push_back(where);
}

void AddRecords(T_REPORT_WORK& work, EXPLORER_TABLE kind, T_DOC_CHAPTER& to)
{
    if (RecordCount(work.doc, kind) > 0)
        to.blocks.emplace_back(RecordsTable(work.doc, kind, work.limit));
}

std::vector<REPORT_CHAPTER> ChosenChapters(const T_REPORT_OPTIONS& options)
{
    if (!options.only.empty()) return options.only;
    std::vector<REPORT_CHAPTER> all;
    for (std::size_t i = 0; i < kReportChapterNames.size(); ++i)
        if (options.head.chapters.empty() ||
            std::ranges::count(options.head.chapters, kReportChapterNames[i]) > 0)
            all.push_back(static_cast<REPORT_CHAPTER>(i));
    return all;
}

T_DOCUMENT WriteReport(CDBDoc& doc, const T_REPORT_DATA& data, const T_REPORT_OPTIONS& options)
{
    T_REPORT_WORK work{doc, data, options, {options.mostRows}};
    T_DOCUMENT out;
    FillHead(work, out);
    for (const REPORT_CHAPTER chapter : ChosenChapters(options)) {
        T_DOC_CHAPTER filled{Say(ChapterKey(chapter))};
        RowOf(chapter).fill(work, filled);
        if (!filled.blocks.empty() || !filled.parts.empty())
            out.chapters.push_back(std::move(filled));
    }
    return out;
}
