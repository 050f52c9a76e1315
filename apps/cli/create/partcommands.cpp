#include "create/partcommands.h"

#include "console/tabletext.h"
#include "inputfile.h"
#include "output.h"
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/editscope.h"
#include "qm_rps/create/spectrumtext.h"
#include "qm_rps/desk/elementlist.h"
#include "qm_rps/modesdlg.h"
#include "qm_rps/spectrumdlg.h"
#include "qm_rps/storeyguidedlg.h"

#include <cstdio>

namespace {

EXIT_CODE Open(CDBDoc& doc, const std::string& file, const std::string& out, bool overwrite)
{
    if (const EXIT_CODE code = CheckOutputs(file, {{out, OUTPUT_KIND::Document}}, overwrite);
        code != EXIT_CODE::Done)
        return code;
    return OpenInput(doc, file);
}

/// A spectrum with its name takes the place of the one that has it, else it is a new one.
EXIT_CODE SetSpectrum(CDBDoc& doc, const T_SPECTRUM_OPTIONS& o)
{
    T_SPFC_D record;
    T_FINDING fault;
    if (!ParseSpectrum(o.set, record, fault))
        return Complain(EXIT_CODE::Usage, "--set: " + fault.text);
    int key = 0;
    CSpectrumDlg dialog(doc, doc.Attr().FindSpfc(record.name, key) ? key : 0);
    if (key == 0) dialog.OnNew();
    dialog.m_edit.Take(record);
    if (dialog.OnOK()) return EXIT_CODE::Done;
    return Complain(EXIT_CODE::Usage, "--set: " + dialog.Messages().back().text);
}

EXIT_CODE RemoveSpectrum(CDBDoc& doc, const std::string& name)
{
    int key = 0;
    CEditScope edit(doc, name);
    if (doc.Attr().FindSpfc(name, key) && edit.Erase<T_SPFC_D>(key) && edit.Commit())
        return EXIT_CODE::Done;
    return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_SPECTRUM_USED", name));
}

} // namespace

EXIT_CODE RunStoreys(const T_STOREYS_OPTIONS& o)
{
    CDBDoc doc;
    if (const EXIT_CODE code = Open(doc, o.file, o.out, o.overwrite); code != EXIT_CODE::Done)
        return code;
    CStoreyGuideDlg dialog(doc);
    if (o.tolerance) dialog.OnTolerance(*o.tolerance);
    if (!dialog.OnOK()) return Complain(EXIT_CODE::BadInput, dialog.Messages().back().text);
    const std::string unit(NameOf(doc.Unit().Units().length));
    for (const int key : doc.Attr().GetKeys<T_STOR_D>()) {
        T_STOR_D storey;
        if (!doc.Attr().Get(key, storey)) continue;
        std::printf("%s\n",
                    Say("IDS_QM_CLI_NEW_STOREY", storey.name, FormatText("%.6g", storey.height),
                        unit, ElementListText(storey.nodes))
                        .c_str());
    }
    if (const std::string doubt = dialog.DoubtText(); !doubt.empty())
        std::fprintf(stderr, "%s\n", doubt.c_str());
    return o.out.empty() ? EXIT_CODE::Done : SaveDocument(doc, o.out);
}

EXIT_CODE RunSpectrum(const T_SPECTRUM_OPTIONS& o)
{
    if ((o.set.empty() && o.remove.empty()) != o.out.empty())
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_SPECTRUM_OUT"));
    CDBDoc doc;
    if (const EXIT_CODE code = Open(doc, o.file, o.out, o.overwrite); code != EXIT_CODE::Done)
        return code;
    EXIT_CODE code = o.remove.empty() ? EXIT_CODE::Done : RemoveSpectrum(doc, o.remove);
    if (code == EXIT_CODE::Done && !o.set.empty()) code = SetSpectrum(doc, o);
    if (code == EXIT_CODE::Done && !o.out.empty()) code = SaveDocument(doc, o.out);
    if (code != EXIT_CODE::Done) return code;
    for (const int key : doc.Attr().GetKeys<T_SPFC_D>()) {
        T_SPFC_D record;
        if (!doc.Attr().GetSpfc(key, record)) continue;
        const T_TEXT_TABLE values = SpectrumValues(record);
        T_TABLE_ROWS rows(1);
        for (const T_TEXT_COLUMN& column : values.columns)
            rows.front().push_back(column.head);
        rows.insert(rows.end(), values.rows.begin(), values.rows.end());
        std::printf("%s: %s\n%s", record.name.c_str(), SpectrumText(record).c_str(),
                    TableText(rows).c_str());
        if (const std::string doubt = SpectrumDoubt(record); !doubt.empty())
            std::fprintf(stderr, "%s: %s\n", record.name.c_str(), doubt.c_str());
    }
    return EXIT_CODE::Done;
}

EXIT_CODE RunModes(const T_MODES_OPTIONS& o)
{
    const int edits = (o.find > 0) + (o.remove > 0) + (o.period.has_value() ? 1 : 0);
    if (edits > 1 || (edits == 1) != !o.out.empty())
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_MODES_OUT"));
    if (o.direction != "X" && o.direction != "Y")
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_NEW_WORD", "--direction", o.direction));
    CDBDoc doc;
    if (const EXIT_CODE code = Open(doc, o.file, o.out, o.overwrite); code != EXIT_CODE::Done)
        return code;
    CModesDlg dialog(doc);
    dialog.m_count = o.find;
    dialog.m_period = o.period.value_or(0.0);
    dialog.m_direction = o.direction == "Y" ? 1 : 0;
    dialog.m_shape = o.shape;
    dialog.OnChoose(o.remove - 1);
    const int done = o.find > 0     ? dialog.OnFind()
                     : o.remove > 0 ? dialog.OnDelete()
                     : o.period     ? dialog.OnAdd()
                                    : 1;
    if (!done) return Complain(EXIT_CODE::BadInput, o.file + ": " + dialog.Messages().back().text);
    if (!o.out.empty())
        if (const EXIT_CODE code = SaveDocument(doc, o.out); code != EXIT_CODE::Done) return code;
    const T_TEXT_TABLE modes = dialog.Table();
    T_TABLE_ROWS rows(1);
    for (const T_TEXT_COLUMN& column : modes.columns)
        rows.front().push_back(column.head);
    rows.insert(rows.end(), modes.rows.begin(), modes.rows.end());
    std::printf("%s", TableText(rows).c_str());
    if (const std::string pushes = dialog.PushesText(); o.find > 0 && !pushes.empty())
        std::fprintf(stderr, "%s\n", pushes.c_str());
    return EXIT_CODE::Done;
}
