#include "qm_db/sheetfile.h"

#include "qm_base/msgfunction.h"
#include "qm_db/file/sheetparts.h"
#include "qm_db/file/storedzip.h"
#include "qm_db/file/storefault.h"
#include "qm_db/filectrl.h"

#include <algorithm>
#include <cerrno>
#include <cmath>
#include <filesystem>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

namespace fs = std::filesystem;

namespace {

constexpr std::size_t kMaxText = 32767;
constexpr std::size_t kMaxFormula = 8192;

[[noreturn]] void RefuseCell(SHEET_AT at, const char* reason)
{
    throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_SHEET_CELL",
                      SheetAddress(at.first, at.second), zql::lib::MMSGFunction::GetValue(reason));
}

bool IsNameValid(const std::string& name)
{
    const auto letters = std::count_if(name.begin(), name.end(), [](char c) {
        return (static_cast<unsigned char>(c) & 0xC0) != 0x80; // first byte of a UTF-8 letter
    });
    return letters > 0 && letters <= 31 && name.find_first_of("[]:*?/\\") == std::string::npos &&
           name.front() != '\'' && name.back() != '\'';
}

void CheckCell(SHEET_AT at, const SHEET_VALUE& value)
{
    const auto* formula = std::get_if<T_SHEET_FORMULA>(&value);
    const auto* number = std::get_if<double>(&value);
    const auto* text = std::get_if<std::string>(&value);
    if ((number && !std::isfinite(*number)) || (formula && !std::isfinite(formula->value)))
        RefuseCell(at, "IDS_QM_DB_SHEET_NOT_FINITE");
    if (text && text->size() > kMaxText) RefuseCell(at, "IDS_QM_DB_SHEET_LONG");
    if (formula && (formula->text.size() < 2 || formula->text.size() > kMaxFormula))
        RefuseCell(at, "IDS_QM_DB_SHEET_LONG_FORMULA");
}

void CheckSheet(const T_SHEET& sheet)
{
    if (!IsNameValid(sheet.name))
        throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_SHEET_NAME", sheet.name);
    for (const auto& [at, cell] : sheet.cells) {
        if (at.first >= kSheetRows || at.second >= kSheetColumns)
            throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_SHEET_TOO_LARGE",
                              SheetAddress(at.first, at.second), std::to_string(kSheetRows),
                              std::to_string(kSheetColumns));
        CheckCell(at, cell.value);
    }
}

/// Office programs leave a mark beside a file that they have open.
void CheckNotOpen(const std::string& path)
{
    const fs::path file(path);
    for (const std::string& mark :
         {".~lock." + file.filename().string() + "#", "~$" + file.filename().string()}) {
        std::error_code ignored;
        const fs::path beside = file.parent_path() / mark;
        if (fs::exists(beside, ignored))
            throw CStoreFault(FILE_FAULT::NoAccess, "IDS_QM_DB_SHEET_OPEN", beside.string());
    }
}

/// In memory: a disk can be full only while the file itself is written, which says so.
std::string BytesOf(const T_SHEET& sheet)
{
    const SHEET_FORMATS formats = SheetFormats(sheet);
    CStoredZip zip;
    bool fits = true;
    for (const T_SHEET_PART& part : kFixedSheetParts)
        fits = fits && zip.Add(part.name, part.text);
    fits = fits && zip.Add("xl/workbook.xml", WorkbookPart(sheet)) &&
           zip.Add("xl/styles.xml", StylesPart(formats)) &&
           zip.Add("xl/worksheets/sheet1.xml", WorksheetPart(sheet, formats));
    if (!fits) ThrowSystem("IDS_QM_DB_FILE_CANT_WRITE", EFBIG);
    return zip.Take();
}

void Mark(T_SHEET& sheet, const T_SHEET_BLOCK& b, SHEET_EDGE T_SHEET_STYLE::*side, SHEET_EDGE edge)
{
    for (std::size_t row = b.top; row <= b.bottom; ++row)
        for (std::size_t column = b.left; column <= b.right; ++column)
            sheet.cells[{row, column}].style.*side = edge;
}

} // namespace

std::string SheetColumn(std::size_t column)
{
    std::string letters;
    for (std::size_t rest = column + 1; rest > 0; rest = (rest - 1) / 26)
        letters.insert(letters.begin(), static_cast<char>('A' + (rest - 1) % 26));
    return letters;
}

std::string SheetAddress(std::size_t row, std::size_t column)
{
    return SheetColumn(column) + std::to_string(row + 1);
}

void FrameBlock(T_SHEET& sheet, const T_SHEET_BLOCK& block, SHEET_EDGE edge)
{
    const auto& [top, left, bottom, right] = block;
    Mark(sheet, {top, left, top, right}, &T_SHEET_STYLE::top, edge);
    Mark(sheet, {top, left, bottom, left}, &T_SHEET_STYLE::left, edge);
    EdgeBelow(sheet, block, edge);
    EdgeRight(sheet, block, edge);
}

void EdgeBelow(T_SHEET& sheet, const T_SHEET_BLOCK& block, SHEET_EDGE edge)
{
    Mark(sheet, {block.bottom, block.left, block.bottom, block.right}, &T_SHEET_STYLE::bottom,
         edge);
}

void EdgeRight(T_SHEET& sheet, const T_SHEET_BLOCK& block, SHEET_EDGE edge)
{
    Mark(sheet, {block.top, block.right, block.bottom, block.right}, &T_SHEET_STYLE::right, edge);
}

int WriteSheet(const std::string& path, const T_SHEET& sheet, T_FILE_ERROR& error)
{
    std::string bytes;
    T_FILE_ERROR refusal;
    const int isTried = Guarded(path, error, [&] {
        if (!CFileCtrl::CheckOutput({path, OUTPUT_KIND::Sheet}, refusal)) return;
        CheckSheet(sheet);
        CheckNotOpen(path);
        bytes = BytesOf(sheet);
    });
    if (isTried && bytes.empty()) error = std::move(refusal);
    return bytes.empty() ? 0 : CFileCtrl::WriteWholeFile(path, bytes, error);
}

int OpenSheetFile(const std::string& path)
{
    std::string program = "xdg-open", file = path;
    char* const arguments[] = {program.data(), file.data(), nullptr};
    pid_t child = 0;
    if (posix_spawnp(&child, program.c_str(), nullptr, nullptr, arguments, environ) != 0) return 0;
    int status = 0; // it starts the program and ends
    return waitpid(child, &status, 0) == child && WIFEXITED(status) && WEXITSTATUS(status) == 0;
}
