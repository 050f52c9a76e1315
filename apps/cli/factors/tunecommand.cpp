#include "factors/tunecommand.h"

#include "console/tabletext.h"
#include "inputfile.h"
#include "output.h"
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/factors/tuning/unknownname.h"
#include "qm_rps/section/sectionexport.h"
#include "qm_rps/ulftuningdlg.h"

#ifdef QM_UI
#include "qm_ui/factors/tuningplot.h"
#endif

#include <algorithm>
#include <cstdio>

namespace {

std::string TextOf(const T_TEXT_TABLE& table)
{
    T_TABLE_ROWS rows(1);
    for (const T_TEXT_COLUMN& column : table.columns)
        rows.front().push_back(column.head);
    rows.insert(rows.end(), table.rows.begin(), table.rows.end());
    return TableText(rows);
}

std::string ListOf(const std::vector<std::string>& names)
{
    std::string text;
    for (const std::string& name : names)
        text += (text.empty() ? "" : ", ") + name;
    return text;
}

/// "T101=1.2": the whole name of an unknown, or of its load case alone. Empty: taken; else why not.
std::string TakeFactor(CUlfTuningDlg& tuned, const std::string& text)
{
    std::vector<std::string> names;
    for (std::size_t u = 0; u < tuned.Unknowns(); ++u)
        names.push_back(tuned.NameOf(u));
    const std::size_t at = text.rfind('=');
    const std::optional<double> factor =
        at == std::string::npos ? std::nullopt : ParseFinite(text.substr(at + 1));
    const auto fits =
        factor ? UnknownsNamed(names, text.substr(0, at)) : std::vector<std::size_t>();
    if (fits.empty()) return Say("IDS_QM_CLI_TUNE_BAD_FACTOR", text, ListOf(names));
    if (fits.size() > 1) {
        std::vector<std::string> several;
        for (const std::size_t u : fits)
            several.push_back(names[u]);
        return Say("IDS_QM_CLI_TUNE_SEVERAL", text, ListOf(several));
    }
    if (tuned.OnFactor(fits.front(), *factor)) return {};
    return Say("IDS_QM_CLI_TUNE_LARGE", text, ShortestText(CUlfTuningDlg::kMostFactor));
}

EXIT_CODE Take(CUlfTuningDlg& tuned, const T_TUNE_OPTIONS& o)
{
    for (const std::string& factor : o.factors)
        if (const std::string why = TakeFactor(tuned, factor); !why.empty())
            return Complain(EXIT_CODE::Usage, o.file + ": " + why);
    return EXIT_CODE::Done;
}

EXIT_CODE Write(const CUlfTuningDlg& tuned, const T_TUNE_OPTIONS& o)
{
    EXIT_CODE code = EXIT_CODE::Done;
    const T_TEXT_TABLE deck = tuned.DeckCells();
    if (!o.deck.empty()) code = WriteOutput(o.deck, o.deck == "-" ? TextOf(deck) : TableCsv(deck));
#ifdef QM_UI
    if (code == EXIT_CODE::Done && !o.plot.empty())
        code = WritePicture(TuningDisplacementPlot(tuned), o.plot);
    if (code == EXIT_CODE::Done && !o.plotMoments.empty())
        code = WritePicture(TuningMomentPlot(tuned), o.plotMoments);
#endif
    return code;
}

} // namespace

EXIT_CODE RunUlfTune(const T_TUNE_OPTIONS& o)
{
    for (const std::string& plot : {o.plot, o.plotMoments})
        if (const EXIT_CODE code = CheckPlotName(plot); code != EXIT_CODE::Done) return code;
    if (const EXIT_CODE code = CheckOutputs(o.file,
                                            {{o.deck, OUTPUT_KIND::Text},
                                             {o.plot, OUTPUT_KIND::Picture},
                                             {o.plotMoments, OUTPUT_KIND::Picture}},
                                            o.overwrite);
        code != EXIT_CODE::Done)
        return code;
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    CUlfTuningDlg tuned(doc);
    if (!tuned.OnOpen(o.item))
        return Complain(EXIT_CODE::Usage, o.file + ": " + Say("IDS_QM_CLI_NO_ULF_ITEM", o.item));
    if (!tuned.IsSolved()) (void)tuned.OnSolve({});
    if (!tuned.IsSolved()) return Complain(EXIT_CODE::NotFound, o.file + ": " + tuned.StatusText());
    if (const EXIT_CODE code = Take(tuned, o); code != EXIT_CODE::Done) return code;
    if (const EXIT_CODE code = Write(tuned, o); code != EXIT_CODE::Done) return code;
    if (o.deck != "-")
        std::printf("%s\n\n%s\n%s", tuned.StatusText().c_str(), TextOf(tuned.StayCells()).c_str(),
                    TextOf(tuned.ConstraintCells()).c_str());
    return tuned.IsMet() ? EXIT_CODE::Done : EXIT_CODE::NotFound;
}
