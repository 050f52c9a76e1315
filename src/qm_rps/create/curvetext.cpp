#include "qm_rps/create/curvetext.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/create/createfault.h"

#include <algorithm>
#include <array>
#include <cctype>
#include <optional>
#include <set>

namespace {

constexpr const char* kText = "text";
constexpr const char* kColumns = "columns";

enum class COLUMN { Force, Displacement, Storey, None };
struct T_COLUMN {
    COLUMN kind = COLUMN::None;
    std::size_t storey = 0; // from 0
};
using T_COLUMNS = std::vector<T_COLUMN>;

std::vector<std::string> WordsOf(const std::string& text, bool keepsMinus)
{
    std::vector<std::string> words(1);
    for (const char c : text) {
        const auto u = static_cast<unsigned char>(c);
        if (std::isalnum(u) || u >= 0x80 || (keepsMinus && c == '-'))
            words.back() += static_cast<char>(u < 0x80 ? std::tolower(u) : c);
        else if (!words.back().empty())
            words.emplace_back();
    }
    if (words.back().empty()) words.pop_back();
    return words;
}

std::optional<T_COLUMN> ColumnOf(const std::string& word)
{
    if (word == "-") return T_COLUMN{};
    if (word == "v") return T_COLUMN{COLUMN::Force};
    if (word == "d") return T_COLUMN{COLUMN::Displacement};
    const std::optional<double> storey =
        word.starts_with('d') ? ParseFinite(word.substr(1)) : std::nullopt;
    constexpr double kMostStoreys = 1000.0;
    if (!storey || !(*storey >= 1.0 && *storey <= kMostStoreys)) return std::nullopt;
    return T_COLUMN{COLUMN::Storey, static_cast<std::size_t>(*storey) - 1};
}

/// One V, one d, each storey once from the first on.
bool AreSound(const T_COLUMNS& columns)
{
    std::set<std::size_t> storeys;
    std::size_t counted = 0, forces = 0, displacements = 0;
    for (const T_COLUMN& column : columns) {
        forces += column.kind == COLUMN::Force ? 1U : 0U;
        displacements += column.kind == COLUMN::Displacement ? 1U : 0U;
        if (column.kind != COLUMN::Storey) continue;
        ++counted;
        storeys.insert(column.storey);
    }
    const bool gaps = !storeys.empty() && *storeys.rbegin() + 1 != storeys.size();
    return forces == 1 && displacements == 1 && counted == storeys.size() && !gaps;
}

std::optional<T_COLUMNS> ColumnsFromText(const std::string& text)
{
    T_COLUMNS columns;
    for (const std::string& word : WordsOf(text, true)) {
        const std::optional<T_COLUMN> column = ColumnOf(word);
        if (!column) return std::nullopt;
        columns.push_back(*column);
    }
    return AreSound(columns) ? std::optional(columns) : std::nullopt;
}

/// What a name of a column says; None: nothing, or both.
COLUMN KindOfName(const std::string& name)
{
    static const std::set<std::string> kForce{
        "v", "f",  "force", "shear", "base", "reaction", "forza", "taglio", "kn",
        "n", "mn", "kips",  "kip",   "lbf",  "tonf",     "kgf",   "vb"};
    static const std::set<std::string> kMoves{
        "d",     "u",  "disp", "displ", "displacement", "ux", "uy", "dx",    "spostamento",
        "spost", "mm", "cm",   "m",     "in",           "ft", "dy", "delta", "drift"};
    bool force = false, moves = false;
    for (const std::string& word : WordsOf(name, false)) {
        force = force || kForce.contains(word);
        moves = moves || kMoves.contains(word);
    }
    if (force == moves) return COLUMN::None;
    return force ? COLUMN::Force : COLUMN::Displacement;
}

bool Rises(const T_PASTED_TABLE& table, std::size_t column)
{
    const auto falls = [column](const T_PASTED_ROW& a, const T_PASTED_ROW& b) {
        return b.cells[column] < a.cells[column];
    };
    return std::ranges::adjacent_find(table.rows, falls) == table.rows.end();
}

/// Two columns: by their names, else by which of them alone never falls.
std::optional<T_COLUMNS> GuessColumns(const T_PASTED_TABLE& table, T_CURVE_READ& out)
{
    if (table.rows[0].cells.size() != 2) return std::nullopt;
    const T_COLUMNS forceFirst{{COLUMN::Force}, {COLUMN::Displacement}};
    const T_COLUMNS forceLast{{COLUMN::Displacement}, {COLUMN::Force}};
    if (table.names.size() == 2) {
        const COLUMN a = KindOfName(table.names[0]), b = KindOfName(table.names[1]);
        out.columnsFromHeader = a != b;
        if (a != b && (a == COLUMN::Force || b == COLUMN::Displacement)) return forceFirst;
        if (a != b) return forceLast;
    }
    const bool first = Rises(table, 0), second = Rises(table, 1);
    if (first == second) return std::nullopt;
    out.columnsFromNumbers = true;
    return first ? forceLast : forceFirst;
}

std::string TextOf(const T_COLUMNS& columns)
{
    std::string text;
    for (const T_COLUMN& column : columns) {
        constexpr std::array<const char*, 4> kNames{"V", "d", "d", "-"};
        text += (text.empty() ? "" : ",") +
                std::string(kNames[static_cast<std::size_t>(column.kind)]) +
                (column.kind == COLUMN::Storey ? std::to_string(column.storey + 1) : "");
    }
    return text;
}

int FindColumns(const T_CURVE_TEXT& in, T_CURVE_READ& out, T_COLUMNS& columns, T_FINDING& fault)
{
    const std::size_t width = out.table.rows[0].cells.size();
    const bool isAsked = !WordsOf(in.columns, true).empty();
    const std::optional<T_COLUMNS> found =
        isAsked ? ColumnsFromText(in.columns) : GuessColumns(out.table, out);
    if (!found && isAsked) return CreateFault(fault, kColumns, "IDS_QM_NEW_COLUMNS", in.columns);
    if (!found && width < 2) return CreateFault(fault, kText, "IDS_QM_NEW_ONE_COLUMN");
    if (!found)
        return CreateFault(fault, kColumns, "IDS_QM_NEW_COLUMNS_OPEN", std::to_string(width));
    if (found->size() != width)
        return CreateFault(fault, kColumns, "IDS_QM_NEW_COLUMNS_COUNT",
                           std::to_string(found->size()), std::to_string(width));
    columns = *found;
    out.columns = TextOf(columns);
    return 1;
}

T_CURVE_POINT PointOf(const T_PASTED_ROW& row, const T_COLUMNS& columns, bool reverse)
{
    T_CURVE_POINT point;
    point.line = row.line;
    for (std::size_t i = 0; i < columns.size(); ++i) {
        const double value = row.cells[i];
        if (columns[i].kind == COLUMN::Displacement) point.displacement = value;
        if (columns[i].kind == COLUMN::Force)
            point.force = reverse && value != 0.0 ? -value : value;
        if (columns[i].kind != COLUMN::Storey) continue;
        point.storeys.resize(std::max(point.storeys.size(), columns[i].storey + 1));
        point.storeys[columns[i].storey] = value;
    }
    return point;
}

bool IsOrigin(const T_CURVE_POINT& point)
{
    const auto moved = [](double value) { return value != 0.0; };
    return point.force == 0.0 && point.displacement == 0.0 &&
           std::ranges::none_of(point.storeys, moved);
}

/// The origin is given, or added where the person says so.
int TakeOrigin(const T_CURVE_TEXT& in, T_CURVE_READ& out, T_FINDING& fault)
{
    const T_CURVE_POINT& first = out.points.front();
    if (IsOrigin(first)) return 1;
    if (!in.addOrigin)
        return CreateFault(fault, kText, "IDS_QM_NEW_NO_ORIGIN", std::to_string(first.line));
    T_CURVE_POINT origin;
    origin.storeys.assign(out.storeys, 0.0);
    out.points.insert(out.points.begin(), std::move(origin));
    return 1;
}

int CheckPoints(const std::vector<T_CURVE_POINT>& points, T_FINDING& fault)
{
    constexpr std::size_t kLeast = 3; // with the origin
    for (std::size_t i = 1; i < points.size(); ++i) {
        const std::string line = std::to_string(points[i].line);
        if (points[i].force < 0.0)
            return CreateFault(fault, kText, "IDS_QM_NEW_NEGATIVE_FORCE", line);
        if (points[i].displacement < points[i - 1].displacement)
            return CreateFault(fault, kText, "IDS_QM_NEW_FALLING", line,
                               ShortestText(points[i].displacement),
                               ShortestText(points[i - 1].displacement));
        if (i == 1 && !(points[i].displacement > 0.0 && points[i].force > 0.0))
            return CreateFault(fault, kText, "IDS_QM_NEW_FIRST_STEP", line);
    }
    if (points.size() < kLeast)
        return CreateFault(fault, kText, "IDS_QM_NEW_FEW_POINTS",
                           std::to_string(points.back().line), std::to_string(points.size()));
    return 1;
}

} // namespace

int ReadCurve(const T_CURVE_TEXT& in, T_CURVE_READ& out, T_FINDING& fault)
{
    T_CURVE_READ read;
    T_PASTED_FAULT why;
    if (!ReadPastedTable(in.text, in.decimal, read.table, why)) {
        if (why.line == 0) return CreateFault(fault, kText, "IDS_QM_NEW_TEXT", why.text);
        return CreateFault(fault, kText, "IDS_QM_NEW_LINE", std::to_string(why.line), why.text);
    }
    T_COLUMNS columns;
    if (!FindColumns(in, read, columns, fault)) return 0;
    for (const T_PASTED_ROW& row : read.table.rows)
        read.points.push_back(PointOf(row, columns, in.reverseForce));
    read.storeys = read.points.front().storeys.size();
    if (!TakeOrigin(in, read, fault) || !CheckPoints(read.points, fault)) return 0;
    out = std::move(read);
    return 1;
}

std::vector<std::string> CurveReadNotes(const T_CURVE_READ& read)
{
    constexpr std::array<const char*, 3> kParted{"IDS_QM_NEW_BY_BLANKS", "IDS_QM_NEW_BY_COMMAS",
                                                 "IDS_QM_NEW_BY_SEMICOLONS"};
    const T_PASTED_TABLE& table = read.table;
    std::vector<std::string> notes;
    notes.push_back(Say("IDS_QM_NEW_READ", std::to_string(read.points.size()), read.columns,
                        Say(kParted[static_cast<std::size_t>(table.separator)])));
    if (table.hasPoint)
        notes.push_back(Say(table.isDecimalComma ? "IDS_QM_NEW_COMMA" : "IDS_QM_NEW_POINT"));
    if (read.points.front().line == 0) notes.push_back(Say("IDS_QM_NEW_ORIGIN_ADDED"));
    if (!table.headers.empty())
        notes.push_back(Say("IDS_QM_NEW_HEADERS", std::to_string(table.headers.size()),
                            std::to_string(table.headers.back())));
    if (read.columnsFromHeader) notes.push_back(Say("IDS_QM_NEW_COLUMNS_HEADER"));
    if (read.columnsFromNumbers) notes.push_back(Say("IDS_QM_NEW_COLUMNS_NUMBERS"));
    return notes;
}
