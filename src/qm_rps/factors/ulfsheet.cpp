#include "qm_rps/factors/ulfsheet.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"

#include <algorithm>
#include <cmath>

using zql::lib::MMSGFunction;

namespace {

// Rows and columns from 0: row 8 of the sheet is 7.
constexpr std::size_t kNoteRow = 2, kQuantityRow = 5, kUnitRow = 6, kNameRow = 7, kUpperRow = 8,
                      kLowerRow = 9, kValueRow = 10, kCaseRow = 11;
constexpr std::size_t kCaptionColumn = 1, kFirstColumn = 2;

struct T_LIMIT {
    int belowVersion;
    std::size_t constraints;
};
constexpr T_LIMIT kOldLimit{12, 230};
constexpr std::size_t kLimit = 16384;

class CWriter {
public:
    explicit CWriter(T_SHEET& sheet) : m_sheet(sheet) {}
    T_SHEET_CELL& Put(std::size_t row, std::size_t column, SHEET_VALUE value)
    {
        T_SHEET_CELL& cell = m_sheet.cells[{row, column}];
        cell.value = std::move(value);
        return cell;
    }
    void PutCentred(std::size_t row, std::size_t column, const std::string& text)
    {
        Put(row, column, text).style.centred = true;
    }

private:
    T_SHEET& m_sheet;
};

T_SHEET_FORMULA ValueFormula(const T_ULF_RESULT& r, std::size_t constraint)
{
    const std::string x = SheetColumn(kFirstColumn + constraint);
    const int last = static_cast<int>(r.cases.size() + kCaseRow);
    T_SHEET_FORMULA f;
    f.text = FormatText("=SUMPRODUCT(B12:B%d,%s12:%s%d)", last, x.c_str(), x.c_str(), last);
    f.value = UlfValue(r, constraint);
    if (const std::optional<double>& constant = r.constraints[constraint].constant) {
        const std::string shown = FormatText("%f", *constant);
        f.text += "+" + shown;
        f.value += ParseFinite(shown).value_or(0.0) - *constant; // as the formula gives it
    }
    return f;
}

void PutHead(CWriter& put, const T_ULF_RESULT& r, const T_ULF_SHEET_SETTINGS& s)
{
    put.Put(1, 0, "UnknownLoad Factor Result (Influence Matrix)");
    put.Put(3, 0, "File Name : ");
    if (!s.fileName.empty()) put.Put(3, 1, s.fileName);
    put.Put(3, 3, FormatText("Date : %d/%d/%d", s.year, s.month, s.day));
    put.Put(4, 0, FormatText("Number of Constraints : %d", static_cast<int>(r.constraints.size())));
    put.Put(4, 3, FormatText("Number of Load Cases : %d", static_cast<int>(r.cases.size())));
    if (r.linearForecast)
        put.Put(kNoteRow, 0, MMSGFunction::GetValue("IDS_QM_ULF_LINEAR_FORECAST"));
    put.PutCentred(kQuantityRow, kCaptionColumn, MMSGFunction::GetValue("IDS_QM_ULF_QUANTITY"));
    put.PutCentred(kUnitRow, kCaptionColumn, "Unit");
    put.PutCentred(kNameRow, kCaptionColumn, "Constraint");
    put.PutCentred(kUpperRow, kCaptionColumn, "Upper Bound");
    put.PutCentred(kLowerRow, kCaptionColumn, "Lower Bound");
    put.PutCentred(kValueRow, kCaptionColumn, "Value");
    put.PutCentred(kUpperRow, 0, "Factor");
}

/// A description without its bounds, which have rows of their own; what a quantity is compared with
/// belongs to it: "DZ of node 2 <=      0.0200" is "DZ of node 2".
std::string QuantityOf(const std::string& description)
{
    for (const std::string relation : {" <= ", " >= ", " = "}) {
        const std::size_t at = description.find(relation);
        if (at == std::string::npos) continue;
        const std::size_t from = description.find_first_not_of(' ', at + relation.size());
        const bool isBound =
            from != std::string::npos &&
            std::string("-.0123456789").find(description[from]) != std::string::npos;
        if (isBound) return description.substr(0, at);
    }
    return description;
}

void PutConstraint(CWriter& put, const T_ULF_RESULT& r, std::size_t i)
{
    const T_ULF_RESULT_CONSTRAINT& c = r.constraints[i];
    const std::size_t column = kFirstColumn + i;
    if (!c.description.empty()) put.PutCentred(kQuantityRow, column, QuantityOf(c.description));
    put.PutCentred(kUnitRow, column, c.unit.empty() ? "-" : c.unit);
    put.PutCentred(kNameRow, column, UlfNameAt(c.name, c.place));
    if (c.upper) put.Put(kUpperRow, column, *c.upper);
    if (c.lower) put.Put(kLowerRow, column, *c.lower);
    put.Put(kValueRow, column, ValueFormula(r, i));
    for (std::size_t j = 0; j < r.cases.size(); ++j)
        put.Put(kCaseRow + j, column, r.influence[i][j]);
}

/// Six significant digits of the largest number of a column: what rounding has left of smaller ones
/// is not shown. The stored values stay as they are.
std::string NumberFormat(double largest)
{
    constexpr int kDigits = 6, kMostDecimals = 12;
    const int whole = largest > 0.0 ? static_cast<int>(std::floor(std::log10(largest))) + 1 : 1;
    const int decimals = std::clamp(kDigits - whole, 0, kMostDecimals);
    return decimals == 0 ? "0" : "0." + std::string(static_cast<std::size_t>(decimals), '0');
}

double NumberOf(const SHEET_VALUE& value)
{
    if (const auto* number = std::get_if<double>(&value)) return *number;
    const auto* formula = std::get_if<T_SHEET_FORMULA>(&value);
    return formula ? formula->value : 0.0;
}

/// Every column of numbers in a format of its own.
void SetFormats(T_SHEET& sheet)
{
    std::map<std::size_t, double> largest; // by column
    for (const auto& [at, cell] : sheet.cells)
        largest[at.second] = std::max(largest[at.second], std::fabs(NumberOf(cell.value)));
    for (auto& [at, cell] : sheet.cells)
        if (std::holds_alternative<double>(cell.value) ||
            std::holds_alternative<T_SHEET_FORMULA>(cell.value))
            cell.style.numberFormat = NumberFormat(largest[at.second]);
}

/// Beside the frame, so that nothing in it moves; not where the sheet has no column left.
void PutMarks(CWriter& put, const T_ULF_RESULT& r, std::size_t column)
{
    if (column >= kSheetColumns) return;
    put.PutCentred(kNameRow, column, MMSGFunction::GetValue("IDS_QM_REPORT_KNOWN"));
    for (std::size_t j = 0; j < r.cases.size(); ++j)
        put.PutCentred(
            kCaseRow + j, column,
            MMSGFunction::GetValue(r.cases[j].unknown ? "IDS_QM_CLI_UNKNOWN" : "IDS_QM_CLI_KNOWN"));
}

void DrawFrame(T_SHEET& sheet, std::size_t lastRow, std::size_t lastColumn)
{
    FrameBlock(sheet, {kNameRow, 0, lastRow, lastColumn}, SHEET_EDGE::Thin);
    EdgeBelow(sheet, {kValueRow, 0, kValueRow, lastColumn}, SHEET_EDGE::Double);
    EdgeRight(sheet, {kNameRow, kCaptionColumn, lastRow, kCaptionColumn}, SHEET_EDGE::Double);
}

} // namespace

bool UlfSheetFits(std::size_t constraints, int applicationVersion)
{
    const std::size_t most =
        applicationVersion < kOldLimit.belowVersion ? kOldLimit.constraints : kLimit;
    return constraints <= most && constraints <= kSheetColumns - kFirstColumn;
}

int MakeUlfSheet(const T_ULF_RESULT& r, const T_ULF_SHEET_SETTINGS& settings, T_SHEET& sheet)
{
    if (!UlfSheetFits(r.constraints.size(), settings.applicationVersion)) return 0;
    T_SHEET made;
    CWriter put(made);
    PutHead(put, r, settings);
    for (std::size_t j = 0; j < r.cases.size(); ++j) {
        put.PutCentred(kCaseRow + j, 0, r.cases[j].name);
        put.Put(kCaseRow + j, kCaptionColumn, UlfShownFactor(r, j)).style.input = true;
    }
    for (std::size_t i = 0; i < r.constraints.size(); ++i)
        PutConstraint(put, r, i);
    DrawFrame(made, kValueRow + r.cases.size(), kCaptionColumn + r.constraints.size());
    PutMarks(put, r, kFirstColumn + r.constraints.size());
    SetFormats(made);
    constexpr double kWide = 18.0; // letters
    made.widths = {{0, std::min(kFirstColumn + r.constraints.size(), kSheetColumns - 1), kWide}};
    made.frozenRows = kCaseRow;
    made.frozenColumns = kFirstColumn;
    made.fitsWidth = true;
    sheet = std::move(made);
    return 1;
}
