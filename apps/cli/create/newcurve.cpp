#include "create/newcommands.h"

#include "create/unitwords.h"
#include "output.h"
#include "qm_base/say.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/create/spectrumtext.h"
#include "qm_rps/curvewizarddlg.h"

#include <algorithm>
#include <array>
#include <cstdio>
#include <utility>

namespace {

EXIT_CODE Refuse(const std::string& why)
{
    return Complain(EXIT_CODE::Usage, "new: " + why);
}

/// The index of a word; -1: it is none of them.
template <std::size_t N>
int IndexOf(const std::string& word, const std::array<const char*, N>& words)
{
    const auto at = std::ranges::find(words, word);
    return at == words.end() ? -1 : static_cast<int>(at - words.begin());
}

EXIT_CODE ReadText(const std::string& path, std::string& text)
{
    if (path == "-") {
        for (int c = std::getchar(); c != EOF && text.size() < CFileCtrl::kMostRead;
             c = std::getchar())
            text += static_cast<char>(c);
        return EXIT_CODE::Done;
    }
    T_FILE_ERROR error;
    if (CFileCtrl::ReadWholeFile(path, text, error)) return EXIT_CODE::Done;
    return Complain(EXIT_CODE::NoAccess, error.text);
}

/// The choices of the options that are words.
EXIT_CODE TakeWords(const T_NEW_CURVE_OPTIONS& o, CCurveWizardDlg& dialog)
{
    constexpr std::array<const char*, 3> kDecimals{"auto", "point", "comma"};
    constexpr std::array<const char*, 4> kMasses{"model", "t", "kg", "weight"};
    if (!ParseUnits(o.units, dialog.m_units))
        return Refuse(Say("IDS_QM_CLI_NEW_UNITS", o.units, UnitWords()));
    const int decimal = IndexOf(o.decimal, kDecimals);
    if (decimal < 0) return Refuse(Say("IDS_QM_CLI_NEW_WORD", "--decimal", o.decimal));
    dialog.m_curve.decimal = static_cast<PASTED_DECIMAL>(decimal);
    const int mass = IndexOf(o.massUnit, kMasses);
    if (mass < 0) return Refuse(Say("IDS_QM_CLI_NEW_WORD", "--mass-unit", o.massUnit));
    dialog.m_massGiven = static_cast<MASS_GIVEN>(mass);
    if (o.masses.empty() == o.totalMass.empty()) return Refuse(Say("IDS_QM_CLI_NEW_ONE_MASS"));
    dialog.m_isTotal = !o.totalMass.empty();
    dialog.m_masses = dialog.m_isTotal ? o.totalMass : o.masses;
    for (const std::string& word : o.methods) {
        T_CURVE_METHOD method;
        if (!ParseCurveMethod(word, method))
            return Refuse(Say("IDS_QM_CLI_NEW_WORD", "--method", word));
        dialog.m_methods.push_back(method);
    }
    return EXIT_CODE::Done;
}

EXIT_CODE TakeSpectrum(const T_NEW_CURVE_OPTIONS& o, CCurveWizardDlg& dialog)
{
    if (o.spectrum.empty() == o.spectrumTable.empty())
        return Refuse(Say("IDS_QM_CLI_NEW_ONE_SPECTRUM"));
    T_FINDING fault;
    T_SPFC_D spectrum;
    if (!o.spectrum.empty() && !ParseSpectrum(o.spectrum, spectrum, fault))
        return Refuse("--spectrum: " + fault.text);
    if (!o.spectrumTable.empty()) {
        std::string text;
        if (const EXIT_CODE code = ReadText(o.spectrumTable, text); code != EXIT_CODE::Done)
            return code;
        T_SPFC_USER table;
        if (!UserSpectrum(text, table, fault))
            return Complain(EXIT_CODE::BadInput, o.spectrumTable + ": " + fault.text);
        spectrum = {SpectrumNameOf(CSpectrumEdit::User), table};
    }
    dialog.m_spectrum.Take(spectrum);
    return EXIT_CODE::Done;
}

/// "curve", a list of numbers, or nothing: the heights.
void TakeShape(const std::string& shape, CCurveWizardDlg& dialog)
{
    dialog.m_shape = shape.empty() || shape == "height" ? SHAPE_GIVEN::Heights
                     : shape == "curve"                 ? SHAPE_GIVEN::Curve
                                                        : SHAPE_GIVEN::Typed;
    dialog.m_typedShape = shape;
}

/// Faults of the table are of the file; the others of the command.
EXIT_CODE RefuseFinding(const T_NEW_CURVE_OPTIONS& o, const T_FINDING& fault)
{
    if (fault.field == "text") return Complain(EXIT_CODE::BadInput, o.curve + ": " + fault.text);
    return Refuse(fault.text);
}

} // namespace

EXIT_CODE RunNewCurve(const T_NEW_CURVE_OPTIONS& o)
{
    for (const auto& [value, option] : {std::pair(&o.curve, "--curve"),
                                        {&o.units, "--units"},
                                        {&o.heights, "--height"},
                                        {&o.out, "-o"}})
        if (value->empty()) return Refuse(Say("IDS_QM_CLI_NEW_MISSING", option));
    if (const EXIT_CODE code = CheckOutputs(o.curve, {{o.out, OUTPUT_KIND::Document}}, o.overwrite);
        code != EXIT_CODE::Done)
        return code;
    CDBDoc doc;
    CCurveWizardDlg dialog(doc);
    dialog.m_title = o.title;
    dialog.m_curve.columns = o.columns;
    dialog.m_curve.addOrigin = o.addOrigin;
    dialog.m_curve.reverseForce = o.reverseForce;
    dialog.m_heights = o.heights;
    TakeShape(o.shape, dialog);
    if (const EXIT_CODE code = TakeWords(o, dialog); code != EXIT_CODE::Done) return code;
    if (const EXIT_CODE code = TakeSpectrum(o, dialog); code != EXIT_CODE::Done) return code;
    if (const EXIT_CODE code = ReadText(o.curve, dialog.m_curve.text); code != EXIT_CODE::Done)
        return code;
    if (const auto findings = dialog.Findings(); !findings.empty())
        return RefuseFinding(o, findings.front());
    if (!dialog.OnOK()) return Refuse(dialog.Messages().back().text);
    if (const EXIT_CODE code = SaveDocument(doc, o.out); code != EXIT_CODE::Done) return code;
    std::printf("%s\n%s\n", dialog.NotesText().c_str(),
                Say("IDS_QM_CLI_NEW_NEXT", "evaluate " + o.out).c_str());
    return EXIT_CODE::Done;
}
