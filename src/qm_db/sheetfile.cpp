#include "qm_db/sheetfile.h"

#include "qm_base/msgfunction.h"
#include "qm_base/neutrallocale.h"
#include "qm_db/file/storefault.h"
#include "qm_db/filectrl.h"

#include <algorithm>
#include <cerrno>
#include <cmath>
#include <cstdlib>
#include <filesystem>
#include <memory>
#include <unistd.h>
#include <xlsxwriter.h>

namespace fs = std::filesystem;

namespace {

constexpr std::size_t kMaxText = 32767;
constexpr std::size_t kMaxFormula = 8192;
constexpr std::time_t kDate = 946684800; // 2000-01-01: the same file whenever it is written
constexpr lxw_color_t kInputColor = 0xFFF2CC;
constexpr const char* kCantWrite = "IDS_QM_DB_FILE_CANT_WRITE";

/// A new empty file in the system's folder for such files, removed at the end.
class CScratchFile {
public:
    CScratchFile() : m_path((fs::temp_directory_path() / "qm-sheet-XXXXXX").string())
    {
        const int descriptor = ::mkstemp(m_path.data());
        if (descriptor < 0) ThrowSystem(kCantWrite, errno);
        ::close(descriptor);
    }
    CScratchFile(const CScratchFile&) = delete;
    CScratchFile& operator=(const CScratchFile&) = delete;
    ~CScratchFile() { ::unlink(m_path.c_str()); }
    const std::string& Path() const { return m_path; }

private:
    std::string m_path;
};

struct T_CLOSE_BOOK {
    void operator()(lxw_workbook* book) const { lxw_workbook_free(book); }
};
using BOOK = std::unique_ptr<lxw_workbook, T_CLOSE_BOOK>;

std::uint8_t EdgeCode(SHEET_EDGE edge)
{
    switch (edge) {
    case SHEET_EDGE::None:
        break;
    case SHEET_EDGE::Thin:
        return LXW_BORDER_THIN;
    case SHEET_EDGE::Double:
        return LXW_BORDER_DOUBLE;
    }
    return LXW_BORDER_NONE;
}

/// Formats of a workbook, one for each style.
class CFormats {
public:
    explicit CFormats(lxw_workbook* book) : m_book(book) {}
    lxw_format* Get(const T_SHEET_STYLE& style)
    {
        if (style == T_SHEET_STYLE{}) return nullptr;
        lxw_format*& format = m_formats[style];
        if (!format) format = Make(style);
        return format;
    }

private:
    lxw_format* Make(const T_SHEET_STYLE& style) const
    {
        lxw_format* format = workbook_add_format(m_book);
        if (style.centred) format_set_align(format, LXW_ALIGN_CENTER);
        if (style.bold) format_set_bold(format);
        if (style.input) format_set_bg_color(format, kInputColor);
        if (!style.numberFormat.empty()) format_set_num_format(format, style.numberFormat.c_str());
        format_set_left(format, EdgeCode(style.left));
        format_set_right(format, EdgeCode(style.right));
        format_set_top(format, EdgeCode(style.top));
        format_set_bottom(format, EdgeCode(style.bottom));
        return format;
    }

    lxw_workbook* m_book;
    std::map<T_SHEET_STYLE, lxw_format*> m_formats;
};

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

lxw_error PutCell(lxw_worksheet* page, SHEET_AT at, const SHEET_VALUE& value, lxw_format* format)
{
    const auto row = static_cast<lxw_row_t>(at.first);
    const auto column = static_cast<lxw_col_t>(at.second);
    if (const auto* text = std::get_if<std::string>(&value); text && !text->empty())
        return worksheet_write_string(page, row, column, text->c_str(), format);
    if (const auto* number = std::get_if<double>(&value))
        return worksheet_write_number(page, row, column, *number, format);
    if (const auto* formula = std::get_if<T_SHEET_FORMULA>(&value))
        return worksheet_write_formula_num(page, row, column, formula->text.c_str(), format,
                                           formula->value);
    return worksheet_write_blank(page, row, column, format);
}

void Require(lxw_error code)
{
    if (code == LXW_NO_ERROR) return;
    throw CStoreFault(FILE_FAULT::NoAccess, kCantWrite, lxw_strerror(code));
}

void FillBook(lxw_workbook* book, const T_SHEET& sheet)
{
    lxw_doc_properties properties{};
    properties.created = kDate;
    Require(workbook_set_properties(book, &properties));
    lxw_worksheet* page = workbook_add_worksheet(book, sheet.name.c_str());
    if (!page) throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_SHEET_NAME", sheet.name);
    for (const T_SHEET_WIDTH& w : sheet.widths)
        Require(worksheet_set_column(page, static_cast<lxw_col_t>(w.firstColumn),
                                     static_cast<lxw_col_t>(w.lastColumn), w.characters, nullptr));
    CFormats formats(book);
    for (const auto& [at, cell] : sheet.cells)
        Require(PutCell(page, at, cell.value, formats.Get(cell.style)));
}

std::string BytesOf(const T_SHEET& sheet)
{
    const CScratchFile scratch;
    BOOK book(workbook_new(scratch.Path().c_str()));
    if (!book) ThrowSystem(kCantWrite, ENOMEM);
    FillBook(book.get(), sheet);
    Require(workbook_close(book.release())); // it frees the book whatever happens
    std::string bytes;
    T_FILE_ERROR error;
    if (!CFileCtrl::ReadWholeFile(scratch.Path(), bytes, error)) ThrowSystem(kCantWrite, EIO);
    return bytes;
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
    try {
        if (!CFileCtrl::CheckOutput({path, OUTPUT_KIND::Sheet}, error)) return 0;
        CheckSheet(sheet);
        CheckNotOpen(path);
        const CNeutralLocale neutral; // the library formats numbers by the locale
        return CFileCtrl::WriteWholeFile(path, BytesOf(sheet), error);
    } catch (const CStoreFault& fault) {
        error = fault.ForFile(path);
    } catch (const std::exception& fault) {
        error = {FILE_FAULT::NoAccess, path + ": " + fault.what()};
    }
    return 0;
}
