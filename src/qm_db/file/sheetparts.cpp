#include "qm_db/file/sheetparts.h"

#include "qm_base/textformat.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <vector>

// Names of the format; the longest ones are kept on lines of their own.
// clang-format off
const T_SHEET_PART kFixedSheetParts[3] = {
    {"[Content_Types].xml",
     R"(<?xml version="1.0" encoding="UTF-8" standalone="yes"?>
<Types xmlns="http://schemas.openxmlformats.org/package/2006/content-types">)"
     R"(<Default Extension="rels")"
     R"( ContentType="application/vnd.openxmlformats-package.relationships+xml"/>)"
     R"(<Default Extension="xml" ContentType="application/xml"/>)"
     R"(<Override PartName="/xl/workbook.xml" ContentType=)"
     R"("application/vnd.openxmlformats-officedocument.spreadsheetml.sheet.main+xml"/>)"
     R"(<Override PartName="/xl/styles.xml" ContentType=)"
     R"("application/vnd.openxmlformats-officedocument.spreadsheetml.styles+xml"/>)"
     R"(<Override PartName="/xl/worksheets/sheet1.xml" ContentType=)"
     R"("application/vnd.openxmlformats-officedocument.spreadsheetml.worksheet+xml"/>)"
     R"(</Types>)"},
    {"_rels/.rels",
     R"(<?xml version="1.0" encoding="UTF-8" standalone="yes"?>
<Relationships xmlns="http://schemas.openxmlformats.org/package/2006/relationships">)"
     R"(<Relationship Id="rId1" Target="xl/workbook.xml" Type=)"
     R"("http://schemas.openxmlformats.org/officeDocument/2006/relationships/officeDocument"/>)"
     R"(</Relationships>)"},
    {"xl/_rels/workbook.xml.rels",
     R"(<?xml version="1.0" encoding="UTF-8" standalone="yes"?>
<Relationships xmlns="http://schemas.openxmlformats.org/package/2006/relationships">)"
     R"(<Relationship Id="rId1" Target="worksheets/sheet1.xml" Type=)"
     R"("http://schemas.openxmlformats.org/officeDocument/2006/relationships/worksheet"/>)"
     R"(<Relationship Id="rId2" Target="styles.xml" Type=)"
     R"("http://schemas.openxmlformats.org/officeDocument/2006/relationships/styles"/>)"
     R"(</Relationships>)"}};
// clang-format on

namespace {

constexpr const char* kHead = "<?xml version=\"1.0\" encoding=\"UTF-8\" standalone=\"yes\"?>\n";
constexpr const char* kMain = "http://schemas.openxmlformats.org/spreadsheetml/2006/main";
constexpr const char* kInputColor = "FFFFF2CC";
constexpr std::size_t kFirstOwnFormat = 164; // numbers of number formats below are given

/// "_xHHHH_" stands for a character that XML has none for, so it is itself written that way.
bool IsCodeAt(std::string_view text, std::size_t at)
{
    constexpr std::size_t kLength = 7;
    const std::string_view code = text.substr(at, kLength);
    return code.size() == kLength && code.starts_with("_x") && code.back() == '_' &&
           code.find_first_not_of("0123456789abcdefABCDEF", 2) == kLength - 1;
}

std::string Escaped(std::string_view text)
{
    std::string out;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const char c = text[i];
        if (c == '&')
            out += "&amp;";
        else if (c == '<')
            out += "&lt;";
        else if (c == '>')
            out += "&gt;";
        else if (c == '"')
            out += "&quot;";
        else if (c == '\t' || c == '\n')
            out += c;
        else if (static_cast<unsigned char>(c) < 0x20)
            out += FormatText("_x%04X_", static_cast<unsigned>(c));
        else if (IsCodeAt(text, i))
            out += "_x005F_";
        else
            out += c;
    }
    return out;
}

/// 16 significant digits, whatever the locale.
std::string NumberText(double value)
{
    constexpr int kDigits = 16;
    std::array<char, 32> text{};
    const auto [end, fault] = std::to_chars(text.data(), text.data() + text.size(), value,
                                            std::chars_format::general, kDigits);
    return fault == std::errc{} ? std::string(text.data(), end) : std::string("0");
}

std::string CellText(SHEET_AT at, const SHEET_VALUE& value, std::size_t format)
{
    std::string text = "<c r=\"" + SheetAddress(at.first, at.second) + '"';
    if (format > 0) text += " s=\"" + std::to_string(format) + '"';
    if (const auto* words = std::get_if<std::string>(&value); words && !words->empty())
        return text + " t=\"inlineStr\"><is><t xml:space=\"preserve\">" + Escaped(*words) +
               "</t></is></c>";
    if (const auto* number = std::get_if<double>(&value))
        return text + "><v>" + NumberText(*number) + "</v></c>";
    if (const auto* formula = std::get_if<T_SHEET_FORMULA>(&value))
        return text + "><f>" + Escaped(std::string_view(formula->text).substr(1)) + "</f><v>" +
               NumberText(formula->value) + "</v></c>";
    return text + "/>";
}

/// Width of a column in the file, from its letters: 7 px a letter, 5 px of margin.
double FileWidth(double characters)
{
    constexpr double kLetterPx = 7.0, kMarginPx = 5.0, kParts = 256.0;
    return std::trunc((characters * kLetterPx + kMarginPx) / kLetterPx * kParts) / kParts;
}

std::string ColumnsText(const T_SHEET& sheet)
{
    if (sheet.widths.empty()) return {};
    std::vector<T_SHEET_WIDTH> widths = sheet.widths;
    std::ranges::sort(widths, {}, &T_SHEET_WIDTH::firstColumn);
    std::string text = "<cols>";
    for (const T_SHEET_WIDTH& w : widths)
        text += "<col min=\"" + std::to_string(w.firstColumn + 1) + "\" max=\"" +
                std::to_string(w.lastColumn + 1) + "\" width=\"" +
                NumberText(FileWidth(w.characters)) + "\" customWidth=\"1\"/>";
    return text + "</cols>";
}

/// The pane that scrolls begins behind what is frozen.
std::string FrozenText(const T_SHEET& sheet)
{
    const auto [rows, columns] = std::pair(sheet.frozenRows, sheet.frozenColumns);
    if (rows == 0 && columns == 0) return {};
    const char* const pane = columns == 0 ? "bottomLeft" : rows == 0 ? "topRight" : "bottomRight";
    std::string split;
    if (columns > 0) split += FormatText(" xSplit=\"%zu\"", columns);
    if (rows > 0) split += FormatText(" ySplit=\"%zu\"", rows);
    return "<sheetViews><sheetView workbookViewId=\"0\"><pane" + split + " topLeftCell=\"" +
           SheetAddress(rows, columns) + "\" activePane=\"" + pane +
           "\" state=\"frozen\"/></sheetView></sheetViews>";
}

/// The frozen rows head every printed page.
std::string PrintTitles(const T_SHEET& sheet)
{
    if (sheet.frozenRows == 0) return {};
    std::string name = "'";
    for (const char c : sheet.name)
        name += c == '\'' ? std::string("''") : std::string(1, c);
    return "<definedNames><definedName name=\"_xlnm.Print_Titles\" localSheetId=\"0\">" +
           Escaped(name) + FormatText("'!$1:$%zu", sheet.frozenRows) +
           "</definedName></definedNames>";
}

std::string EdgeText(const std::string& side, SHEET_EDGE edge)
{
    if (edge == SHEET_EDGE::None) return '<' + side + "/>";
    const char* const style = edge == SHEET_EDGE::Thin ? "thin" : "double";
    return '<' + side + " style=\"" + style + "\"><color auto=\"1\"/></" + side + '>';
}

std::string BorderText(const T_SHEET_STYLE& s)
{
    return "<border>" + EdgeText("left", s.left) + EdgeText("right", s.right) +
           EdgeText("top", s.top) + EdgeText("bottom", s.bottom) + "<diagonal/></border>";
}

/// Each format has a border of its own, and a number format where it names one.
std::string FormatLine(const T_SHEET_STYLE& s, std::size_t number)
{
    const std::size_t numberFormat = s.numberFormat.empty() ? 0 : kFirstOwnFormat + number;
    std::string text =
        FormatText("<xf numFmtId=\"%zu\" fontId=\"%d\" fillId=\"%d\" borderId=\"%zu\" xfId=\"0\" "
                   "applyNumberFormat=\"1\" applyFont=\"1\" applyFill=\"1\" applyBorder=\"1\"",
                   numberFormat, s.bold ? 1 : 0, s.input ? 2 : 0, number);
    return text +
           (s.centred ? " applyAlignment=\"1\"><alignment horizontal=\"center\"/></xf>" : "/>");
}

std::string Counted(const char* name, std::size_t count, const std::string& parts)
{
    return FormatText("<%s count=\"%zu\">", name, count) + parts + "</" + name + '>';
}

} // namespace

SHEET_FORMATS SheetFormats(const T_SHEET& sheet)
{
    SHEET_FORMATS formats{{T_SHEET_STYLE{}, 0}};
    for (const auto& entry : sheet.cells)
        formats.try_emplace(entry.second.style, formats.size());
    return formats;
}

std::string WorksheetPart(const T_SHEET& sheet, const SHEET_FORMATS& formats)
{
    std::string text =
        kHead + FormatText("<worksheet xmlns=\"%s\">", kMain) +
        (sheet.fitsWidth ? "<sheetPr><pageSetUpPr fitToPage=\"1\"/></sheetPr>" : "") +
        FrozenText(sheet) + "<sheetFormatPr defaultRowHeight=\"15\"/>" + ColumnsText(sheet) +
        "<sheetData>";
    for (auto it = sheet.cells.begin(); it != sheet.cells.end();) {
        const std::size_t row = it->first.first;
        text += "<row r=\"" + std::to_string(row + 1) + "\">";
        for (; it != sheet.cells.end() && it->first.first == row; ++it)
            text += CellText(it->first, it->second.value, formats.at(it->second.style));
        text += "</row>";
    }
    text += "</sheetData>";
    if (sheet.fitsWidth)
        text += "<pageSetup orientation=\"landscape\" fitToWidth=\"1\" fitToHeight=\"0\"/>";
    return text + "</worksheet>";
}

std::string StylesPart(const SHEET_FORMATS& formats)
{
    std::vector<const T_SHEET_STYLE*> styles(formats.size());
    for (const auto& [style, number] : formats)
        styles[number] = &style;
    std::string numberFormats, borders, lines;
    std::size_t own = 0;
    for (std::size_t i = 0; i < styles.size(); ++i) {
        borders += BorderText(*styles[i]);
        lines += FormatLine(*styles[i], i);
        if (styles[i]->numberFormat.empty()) continue;
        ++own;
        numberFormats += FormatText("<numFmt numFmtId=\"%zu\" formatCode=\"", kFirstOwnFormat + i) +
                         Escaped(styles[i]->numberFormat) + "\"/>";
    }
    const std::string font = "<sz val=\"11\"/><name val=\"Calibri\"/><family val=\"2\"/></font>";
    const std::string fill = "<fill><patternFill patternType=";
    return kHead + FormatText("<styleSheet xmlns=\"%s\">", kMain) +
           (own > 0 ? Counted("numFmts", own, numberFormats) : std::string()) +
           Counted("fonts", 2, "<font>" + font + "<font><b/>" + font) +
           Counted("fills", 3,
                   fill + "\"none\"/></fill>" + fill + "\"gray125\"/></fill>" + fill +
                       "\"solid\"><fgColor rgb=\"" + kInputColor +
                       "\"/><bgColor indexed=\"64\"/></patternFill></fill>") +
           Counted("borders", styles.size(), borders) +
           "<cellStyleXfs count=\"1\"><xf numFmtId=\"0\" fontId=\"0\" fillId=\"0\" "
           "borderId=\"0\"/></cellStyleXfs>" +
           Counted("cellXfs", styles.size(), lines) +
           "<cellStyles count=\"1\"><cellStyle name=\"Normal\" xfId=\"0\" builtinId=\"0\"/>"
           "</cellStyles></styleSheet>";
}

std::string WorkbookPart(const T_SHEET& sheet)
{
    return kHead +
           FormatText("<workbook xmlns=\"%s\" xmlns:r=\"%s\">", kMain,
                      "http://schemas.openxmlformats.org/officeDocument/2006/"
                      "relationships") +
           "<bookViews><workbookView/></bookViews><sheets><sheet name=\"" + Escaped(sheet.name) +
           "\" sheetId=\"1\" r:id=\"rId1\"/></sheets>" + PrintTitles(sheet) +
           "<calcPr fullCalcOnLoad=\"1\"/></workbook>";
}
