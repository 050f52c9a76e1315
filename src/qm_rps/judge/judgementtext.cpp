#include "qm_rps/judge/judgementtext.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/generate/codehingerows.h"
#include "qm_rps/push/pushatpointtext.h"

#include <algorithm>
#include <cmath>

namespace {

using T_LINES = std::vector<std::vector<std::string>>;

/// Letters, of which some have two bytes.
std::size_t Letters(const std::string& text)
{
    return static_cast<std::size_t>(std::ranges::count_if(
        text, [](char c) { return (static_cast<unsigned char>(c) & 0xC0U) != 0x80U; }));
}

/// Without the columns that have nothing but "-" below their heads, which are few things' own.
T_LINES WithoutEmpty(const T_LINES& lines, std::size_t from, std::size_t to)
{
    T_LINES out(lines.size());
    for (std::size_t c = 0; c < lines.front().size(); ++c) {
        const bool isEmpty = std::all_of(lines.begin() + 1, lines.end(),
                                         [&](const auto& line) { return line[c] == "-"; });
        if (isEmpty && c >= from && c < to) continue;
        for (std::size_t i = 0; i < lines.size(); ++i)
            out[i].push_back(lines[i][c]);
    }
    return out;
}

/// Columns under their heads, to the right but for the last one.
std::string Table(const T_LINES& lines)
{
    std::vector<std::size_t> width(lines.front().size());
    for (const auto& line : lines)
        for (std::size_t c = 0; c < line.size(); ++c)
            width[c] = std::max(width[c], Letters(line[c]));
    std::string text;
    for (const auto& line : lines) {
        std::string row = " ";
        for (std::size_t c = 0; c < line.size(); ++c) {
            const std::string gap(width[c] - Letters(line[c]), ' ');
            row += ' ' + (c + 1 < line.size() ? gap + line[c] + ' ' : line[c]);
        }
        row.erase(row.find_last_not_of(' ') + 1);
        text += row + '\n';
    }
    return text;
}

std::string Number(std::optional<double> value, const char* format = "%.4g")
{
    if (!value) return "-";
    const double shown = *value + 0.0;
    return format == std::string_view("%.3g") ? FormatText("%.3g", shown)
                                              : FormatText("%.4g", shown);
}

std::string CellText(const T_JUDGED_CELL& cell)
{
    if (cell.number) return Number(cell.number);
    return cell.text.empty() ? "-" : cell.text;
}

using C = JUDGED_COLUMN;
/// Columns of the terminal: what has a line of its own there is left out.
constexpr std::array kShown{C::Element,
                            C::End,
                            C::Axis,
                            C::N,
                            C::M,
                            C::V,
                            C::Span,
                            C::ThetaY,
                            C::Theta,
                            C::ThetaCapacity,
                            C::ThetaRatio,
                            C::Shear,
                            C::ShearCapacity,
                            C::ShearRatio,
                            C::Other,
                            C::OtherCapacity,
                            C::OtherUnit,
                            C::OtherRatio,
                            C::Governing,
                            C::Clause,
                            C::Verdict};

/// How many rows of a state are shown (0: all), and what is said of the others.
struct T_SHOWN_ROWS {
    std::size_t most = 0;
    const char* more = "IDS_QM_JUDGE_MORE_ROWS";
};

std::size_t ShownRows(const T_JUDGED_STATE& state, std::size_t most)
{
    return most == 0 ? state.rows.size() : std::min(most, state.rows.size());
}

/// The head, then the rows.
T_LINES RowsWithHead(const T_JUDGEMENT& j, const T_JUDGED_STATE& state, std::size_t most)
{
    const auto heads = JudgedHeads(j.units);
    T_LINES lines(1);
    for (const C column : kShown)
        lines.front().push_back(heads[static_cast<std::size_t>(column)]);
    for (std::size_t i = 0; i < ShownRows(state, most); ++i) {
        const T_JUDGED_CELLS cells = CellsOf(j, state, state.rows[i]);
        std::vector<std::string>& line = lines.emplace_back();
        for (const C column : kShown)
            line.push_back(CellText(At(cells, column)));
        const std::string& why = At(cells, C::Reason).text;
        if (!why.empty()) line.back() += " (" + why + ")";
    }
    const auto first = std::ranges::find(kShown, C::Other) - kShown.begin();
    const auto from = static_cast<std::size_t>(first);
    return WithoutEmpty(lines, from, from + 4);
}

std::string RowLines(const T_JUDGEMENT& j, const T_JUDGED_STATE& state, const T_SHOWN_ROWS& rows)
{
    const std::size_t shown = ShownRows(state, rows.most);
    std::string text = Table(RowsWithHead(j, state, rows.most));
    if (shown < state.rows.size())
        text += "  " + Say(rows.more, std::to_string(state.rows.size() - shown)) + '\n';
    return text;
}

std::string DriftLine(const T_JUDGED_STATE& state)
{
    std::string text;
    for (const T_STOREY_AT_POINT& storey : state.drifts)
        text += (text.empty() ? "" : ", ") + storey.name + FormatText(" %.4g", storey.drift);
    return text.empty() ? text : "  " + Say("IDS_QM_JUDGE_DRIFTS", text) + '\n';
}

std::string StateLines(const T_JUDGEMENT& j, const T_JUDGED_STATE& state, const T_SHOWN_ROWS& rows)
{
    const auto shown = [&](double si) {
        return Number(FromSi(si, j.units, kDimLength)) + " " + std::string(NameOf(j.units.length));
    };
    std::string text =
        "\n" + Say("IDS_QM_JUDGE_STATE", StateAtText(j, state), shown(state.point.displacement));
    // The push begins where the initial loads have moved the control node to.
    if (const std::string own = shown(std::fabs(state.point.displacement - j.start));
        own != shown(std::fabs(state.point.displacement)))
        text += " (" + Say("IDS_QM_JUDGE_FROM_START", own) + ")";
    if (state.found != AT_POINT::Reached)
        return text + ": " + VerdictText(VERDICT::NotChecked) + " (" + WhyNot(state.found) + ")\n";
    if (state.rows.empty())
        return text + ": " + VerdictText(VERDICT::NotChecked) + " (" + Say("IDS_QM_JUDGE_NO_END") +
               ")\n";
    text += ": " + VerdictCountText(state.all) + '\n';
    for (const T_VERDICT_COUNT& storey : state.storeys)
        if (!storey.storey.empty())
            text += "  " + storey.storey + ": " + VerdictCountText(storey) + '\n';
    text += DriftLine(state);
    if (!state.shearAt.empty()) text += "  ! " + state.shearAt + '\n';
    for (const std::string& reason : UncheckedTexts(state))
        text += "  " + VerdictText(VERDICT::NotChecked) + " " + reason + '\n';
    return text + RowLines(j, state, rows);
}

/// "0.123 m at 3 J My", or why not.
std::vector<std::string> LimitCells(const T_JUDGEMENT& j, const T_JUDGED_LIMIT& limit)
{
    const auto shown = [&](std::optional<double> si) {
        return Number(si ? std::optional(FromSi(*si, j.units, kDimLength)) : si);
    };
    const auto text = [](bool isKnown, double value) {
        return isKnown ? Number(value) : Number(std::nullopt);
    };
    const double demand = limit.demand.value_or(0.0);
    const std::string ratio =
        text(limit.capacity && demand > 0.0, limit.capacity.value_or(0.0) / demand);
    std::string remark = limit.why;
    if (limit.first.unchecked > 0 && limit.first.unchecked < limit.first.all)
        remark += (remark.empty() ? "" : "; ") +
                  Say("IDS_QM_JUDGE_UNCHECKED_ENDS", std::to_string(limit.first.unchecked));
    return {limit.state,
            ModeText(limit.first.mode),
            limit.first.end ? EndText(j.ends[*limit.first.end]) : "-",
            shown(limit.capacity),
            shown(limit.demand),
            ratio,
            Number(limit.PgaRatio()),
            Number(limit.CapacityPga()),
            Number(limit.DemandPga()),
            remark};
}

std::vector<std::string> LimitHeads(const T_UNITS& units)
{
    const std::string length = " (" + std::string(NameOf(units.length)) + ")";
    return {Say("IDS_QM_JUDGE_LIMIT_STATE"),
            Say("IDS_QM_JUDGE_GOVERNING"),
            Say("IDS_QM_JUDGE_FIRST_END"),
            Say("IDS_QM_JUDGE_CAPACITY") + length,
            Say("IDS_QM_JUDGE_DEMAND") + length,
            Say("IDS_QM_JUDGE_SHARE"),
            "PGA_C/PGA_D",
            "PGA_C (g)",
            "PGA_D (g)",
            ""};
}

/// A column of numbers has nothing else but dashes.
T_TEXT_TABLE AsTable(const T_LINES& lines)
{
    T_TEXT_TABLE table;
    for (std::size_t c = 0; c < lines.front().size(); ++c) {
        const bool isNumber = std::all_of(lines.begin() + 1, lines.end(), [c](const auto& line) {
            return line[c] == "-" || ParseFinite(line[c]);
        });
        table.columns.push_back({lines.front()[c], isNumber});
    }
    table.rows.assign(lines.begin() + 1, lines.end());
    return table;
}

std::string LimitLines(const T_JUDGEMENT& j)
{
    if (j.limits.empty()) return {};
    T_LINES lines{LimitHeads(j.units)};
    for (const T_JUDGED_LIMIT& limit : j.limits)
        lines.push_back(LimitCells(j, limit));
    return "\n" + Say("IDS_QM_JUDGE_LIMITS") + '\n' + Table(lines);
}

std::string TraceLines(const T_JUDGEMENT& j, const std::vector<T_CODE_TRACE>& trace)
{
    std::string text;
    for (const T_CODE_TRACE& line : trace) {
        const std::string unit = UnitText(line.dim, j.units);
        text += "    " + line.symbol + " = " +
                FormatText("%.6g", FromSi(line.value, j.units, line.dim)) +
                (unit.empty() ? "" : " " + unit);
        for (const std::string& part : {line.text, line.clause})
            if (!part.empty()) text += "  " + part;
        text += " [" + MarkText(line.mark) + "]\n";
    }
    return text;
}

std::string Whole(const T_JUDGEMENT& j, const T_SHOWN_ROWS& rows)
{
    std::string text =
        "\n[ " +
        Say("IDS_QM_JUDGE_TITLE", j.evaluation, j.push, std::string(NameOf(j.units.force)),
            std::string(NameOf(j.units.length))) +
        " ]\n";
    if (!j.note.empty()) return text + "  " + j.note + '\n';
    for (const T_JUDGED_STATE& state : j.states)
        text += StateLines(j, state, rows);
    text += LimitLines(j) + '\n' + WholeVerdictText(j) + '\n';
    for (const std::string& line : JudgementNotes(j))
        text += "! " + line + '\n';
    return text;
}

} // namespace

std::string JudgementText(const T_JUDGEMENT& j, std::size_t mostRows)
{
    return Whole(j, {mostRows});
}

std::string JudgementReport(const T_JUDGEMENT& j)
{
    constexpr std::size_t kWorst = 10;
    return Whole(j, {kWorst, "IDS_QM_JUDGE_MORE_REPORT"});
}

std::string JudgedLimitsText(const T_JUDGEMENT& j)
{
    std::string text;
    const std::string unit(NameOf(j.units.length));
    for (const T_JUDGED_LIMIT& limit : j.limits) {
        const std::vector<std::string> cells = LimitCells(j, limit);
        text += (text.empty() ? "" : "\n") + cells[0] + ", " + cells[1] + ": ";
        if (limit.first.end)
            text +=
                Say("IDS_QM_JUDGE_PASS", cells[2], cells[3] + " " + unit, cells[4] + " " + unit);
        if (limit.PgaRatio())
            text += "; PGA_C/PGA_D = " + cells[6] + ", PGA_C = " + cells[7] + " g";
        if (!cells[9].empty()) text += (limit.first.end ? "; " : "") + cells[9];
    }
    return text;
}

T_TEXT_TABLE JudgedLimitsTable(const T_JUDGEMENT& j)
{
    if (j.limits.empty()) return {};
    T_LINES lines{LimitHeads(j.units)};
    for (const T_JUDGED_LIMIT& limit : j.limits)
        lines.push_back(LimitCells(j, limit));
    return AsTable(lines);
}

std::string JudgementTrace(const T_JUDGEMENT& j)
{
    std::string text;
    for (const T_JUDGED_STATE& state : j.states)
        for (const T_JUDGED_ROW& row : state.rows) {
            std::string lines;
            for (const T_MODE_CHECK& check : row.checks.modes)
                lines += TraceLines(j, check.trace);
            if (!lines.empty())
                text +=
                    "\n  " + StateText(j, state) + ", " + EndText(j.ends[row.end]) + '\n' + lines;
        }
    return text;
}

std::vector<T_JUDGED_PART> JudgedParts(const T_JUDGEMENT& j, const T_JUDGED_STATE& state,
                                       std::size_t mostRows)
{
    constexpr std::array kPage{
        C::Element,    C::End,   C::Axis,          C::Verdict,    C::Governing,  C::N,
        C::M,          C::Theta, C::ThetaCapacity, C::ThetaRatio, C::Shear,      C::ShearCapacity,
        C::ShearRatio, C::Other, C::OtherCapacity, C::OtherUnit,  C::OtherRatio, C::Clause,
        C::Reason};
    const auto heads = JudgedHeads(j.units);
    std::vector<T_JUDGED_PART> parts;
    for (const bool others : {false, true}) {
        T_LINES lines(1);
        std::vector<VERDICT> verdicts;
        for (const C column : kPage)
            lines.front().push_back(heads[static_cast<std::size_t>(column)]);
        for (std::size_t i = 0; i < ShownRows(state, mostRows); ++i) {
            const T_JUDGED_CELLS cells = CellsOf(j, state, state.rows[i]);
            if (At(cells, C::Other).number.has_value() != others) continue;
            std::vector<std::string>& line = lines.emplace_back();
            for (const C column : kPage)
                line.push_back(CellText(At(cells, column)));
            verdicts.push_back(state.rows[i].verdict);
        }
        if (!verdicts.empty())
            parts.push_back({AsTable(WithoutEmpty(lines, 1, kPage.size())), std::move(verdicts)});
    }
    return parts;
}
