#include "hinge/sectionbars.h"

#include "hingetools.h"
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/sectiondlg.h"

#include <algorithm>

#ifdef QM_UI
#include "qm_ui/section/sectionbarsplot.h"
#endif

namespace {

/// "3x0.016"; of corners the diameter alone.
std::optional<T_BAR_GROUP> GroupOf(BAR_PLACE place, const std::string& word)
{
    const bool corners = place == BAR_PLACE::Corners;
    const std::size_t x = word.find('x');
    if (corners != (x == std::string::npos)) return std::nullopt;
    const auto count = corners ? std::optional(4.0) : ParseFinite(word.substr(0, x));
    const auto diameter = ParseFinite(corners ? word : word.substr(x + 1));
    constexpr double kMost = 1e6;
    if (!count || !diameter || *count != std::floor(*count) || std::fabs(*count) > kMost)
        return std::nullopt;
    return T_BAR_GROUP{place, static_cast<int>(*count), *diameter};
}

EXIT_CODE OpenSection(CDBDoc& doc, const T_SECTION_BARS_OPTIONS& o, OUTPUT_KIND kind, int& key)
{
    if (const EXIT_CODE code = CheckOutputs(o.file, {{o.out, kind}}, o.overwrite);
        code != EXIT_CODE::Done)
        return code;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    const auto& all = doc.Data().Model().sections;
    const auto at = std::ranges::find_if(
        all, [&](const auto& entry) { return entry.second.name == o.section; });
    if (at == all.end())
        return Complain(EXIT_CODE::Usage, o.file + ": " + Say("IDS_QM_CLI_NO_SECTION", o.section));
    key = at->first;
    return EXIT_CODE::Done;
}

EXIT_CODE Lay(CSectionDlg& dialog, const T_SECTION_BARS_OPTIONS& o)
{
    const auto refuse = [&](std::size_t place, const std::string& why) {
        return Complain(EXIT_CODE::Usage, o.file + ": " + o.section + ": --" +
                                              kBarPlaceNames[place] + ' ' + o.bars[place] + ": " +
                                              why);
    };
    if (!o.keep) dialog.OnClearBars();
    for (std::size_t i = 0; i < o.bars.size(); ++i) {
        if (o.bars[i].empty()) continue;
        const auto group = GroupOf(static_cast<BAR_PLACE>(i), o.bars[i]);
        if (!group)
            return refuse(i, Say(i == 0 ? "IDS_QM_CLI_BARS_CORNERS" : "IDS_QM_CLI_BARS_WORD"));
        dialog.m_group = *group;
        if (!dialog.OnAddBars()) return refuse(i, dialog.Messages().back().text);
    }
    return dialog.OnOK() ? EXIT_CODE::Done
                         : Complain(EXIT_CODE::Usage, o.file + ": " + o.section + ": " +
                                                          dialog.Messages().back().text);
}

} // namespace

EXIT_CODE RunSectionBars(const T_SECTION_BARS_OPTIONS& o)
{
    if (std::ranges::all_of(o.bars, &std::string::empty))
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_BARS_NONE"));
    CDBDoc doc;
    int key = 0;
    if (const EXIT_CODE code = OpenSection(doc, o, OUTPUT_KIND::Document, key);
        code != EXIT_CODE::Done)
        return code;
    CSectionDlg dialog(doc, key);
    if (const EXIT_CODE code = Lay(dialog, o); code != EXIT_CODE::Done) return code;
    if (const EXIT_CODE code = SaveDocument(doc, o.out); code != EXIT_CODE::Done) return code;
    using C = CSectionDlg::COLUMN;
    std::string text;
    for (int c = 0; c < C::Columns; ++c)
        text += FormatText("%16s", dialog.ColumnHead(static_cast<C>(c)).c_str());
    for (const T_REBAR& bar : dialog.m_section.bars)
        text += FormatText("\n%16.6g%16.6g%16.6g%16.6g", bar.y + 0.0, bar.z + 0.0, BarDiameter(bar),
                           bar.area);
    PrintLine(text + "\n" + dialog.BarsText());
    return EXIT_CODE::Done;
}

EXIT_CODE RunSectionPlot(const T_SECTION_BARS_OPTIONS& o)
{
    CDBDoc doc;
    int key = 0;
    if (const EXIT_CODE code = OpenSection(doc, o, OUTPUT_KIND::Picture, key);
        code != EXIT_CODE::Done)
        return code;
#ifdef QM_UI
    T_SECT_D section;
    if (!doc.Attr().GetSect(key, section)) return EXIT_CODE::NotFound;
    if (const EXIT_CODE code = WritePicture(SectionBarsPlot(section, doc.Unit().Units()), o.out);
        code != EXIT_CODE::Done)
        return code;
    PrintLine(Say("IDS_QM_CLI_HINGE_WRITTEN", o.out));
    return EXIT_CODE::Done;
#else
    return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_NO_PICTURES"));
#endif
}
