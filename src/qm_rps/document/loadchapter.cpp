// Loads and modes.
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/desk/elementlist.h"
#include "qm_rps/document/reportmaker.h"

#include <algorithm>
#include <cmath>
#include <map>
#include <span>

namespace {

constexpr std::array kLoadTexts{"IDS_QM_REPORT_LOAD_DISTRIBUTED", "IDS_QM_REPORT_LOAD_POINT",
                                "IDS_QM_REPORT_LOAD_MOMENT"};
constexpr std::array kAxesTexts{"IDS_QM_REPORT_LOAD_LOCAL", "IDS_QM_REPORT_LOAD_GLOBAL"};

/// The loads of a case, those of one kind and value in one row.
class CLoadRows {
public:
    CLoadRows(const T_UNITS& units, T_TEXT_TABLE& table)
        : m_length(NameOf(units.length)), m_force(NameOf(units.force)), m_table(table)
    {
    }

    void Add(const T_STLD_D& c)
    {
        for (const T_NODAL_LOAD& l : c.nodal)
            Put("IDS_QM_REPORT_NODAL_LOAD", true, l.node,
                List(l.load, kReactionNames, m_force, m_force + " " + m_length));
        for (const T_BEAM_LOAD& l : c.beam)
            Put("IDS_QM_REPORT_BEAM_LOAD", false, l.element, BeamText(l));
        for (const T_SETTLEMENT& l : c.settlement)
            Put("IDS_QM_REPORT_SETTLEMENT", true, l.node,
                List(l.displacement, kDirectionNames, m_length, "rad"));
        for (const T_TEMPERATURE_LOAD& l : c.temperature)
            Put("IDS_QM_REPORT_TEMPERATURE", false, l.element, ReportNumber(l.change) + " K");
        for (const T_PTNS_D& l : c.pretension)
            Put("IDS_QM_REPORT_PRETENSION", false, l.element,
                ReportNumber(l.force) + " " + m_force);
        WriteRows(c.name);
    }

private:
    struct T_ROW {
        const char* what;
        bool ofNodes;
        std::string values;
        std::vector<int> ids;
    };

    void Put(const char* what, bool ofNodes, int id, std::string values)
    {
        const auto [at, isNew] =
            m_found.try_emplace(std::pair{std::string(what), values}, m_rows.size());
        if (isNew) m_rows.push_back({what, ofNodes, std::move(values), {}});
        m_rows[at->second].ids.push_back(id);
    }

    void WriteRows(const std::string& name)
    {
        for (T_ROW& row : m_rows) {
            std::map<int, std::size_t> times; // equal loads on one element count each
            for (const int id : row.ids)
                ++times[id];
            std::map<std::size_t, std::vector<int>> ids;
            for (const auto& [id, count] : times)
                ids[count].push_back(id);
            for (const auto& [count, some] : ids)
                m_table.rows.push_back(
                    {name, Say(row.what),
                     Say(row.ofNodes ? "IDS_QM_REPORT_AT_NODES" : "IDS_QM_REPORT_AT_ELEMENTS",
                         ElementListText(some)),
                     row.values + (count > 1 ? " (" + std::to_string(count) + " x)" : "")});
        }
        m_rows.clear();
        m_found.clear();
    }

    /// "FX 10 kN, MY 2 kN m"; the first three have the one unit, the others the other.
    static std::string List(std::span<const double> values, std::span<const char* const> names,
                            const std::string& linear, const std::string& angular)
    {
        std::string text;
        for (std::size_t i = 0; i < values.size(); ++i)
            if (values[i] != 0.0)
                text += (text.empty() ? "" : ", ") + std::string(names[i]) + " " +
                        ReportNumber(values[i]) + " " + (i < 3 ? linear : angular);
        return text.empty() ? std::string("0") : text;
    }

    std::string BeamText(const T_BEAM_LOAD& l) const
    {
        const bool spread = l.type == BEAM_LOAD_TYPE::Distributed;
        const std::string unit = spread                             ? m_force + "/" + m_length
                                 : l.type == BEAM_LOAD_TYPE::Moment ? m_force + " " + m_length
                                                                    : m_force;
        std::string text = Say(kLoadTexts[static_cast<std::size_t>(l.type)]) + ", " +
                           Say(kAxesTexts[static_cast<std::size_t>(l.axes)]) + " " +
                           kLoadDirectionNames[static_cast<std::size_t>(l.direction)] + ": " +
                           ReportNumber(l.w[0]);
        if (spread && l.w[1] != l.w[0]) text += " ... " + ReportNumber(l.w[1]);
        text += " " + unit;
        if (!spread)
            text += FormatText(" (x/L = %.4g)", l.at[0]);
        else if (l.at[0] != 0.0 || l.at[1] != 1.0)
            text += FormatText(" (x/L = %.4g ... %.4g)", l.at[0], l.at[1]);
        return text;
    }

    std::string m_length, m_force;
    T_TEXT_TABLE& m_table;
    std::vector<T_ROW> m_rows; // of the case at hand
    std::map<std::pair<std::string, std::string>, std::size_t> m_found;
};

/// Shares that rounding has left are 0.
std::string PercentText(double percent)
{
    constexpr double kNothing = 1e-6;
    return FormatText("%.4g", std::fabs(percent) < kNothing ? 0.0 : percent);
}

using T_MASSES = std::array<std::optional<double>, 6>;

/// Effective masses as recorded, else of translations from masses and shape; none without a shape.
T_MASSES MassesOf(CDBDoc& doc, int number, const T_EIGV_D& mode)
{
    T_MASSES out;
    T_MPAM_D masses;
    if (mode.massPercent)
        std::ranges::copy(*mode.massPercent, out.begin());
    else if (!mode.shape.empty() && doc.Post().GetEiMpam(number, masses) &&
             std::ranges::any_of(masses.percent, [](double p) { return p > 0.0; }))
        std::copy_n(masses.percent.begin(), 3, out.begin());
    return out;
}

} // namespace

void FillLoadsChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter)
{
    AddRecords(work, EXPLORER_TABLE::LoadCases, chapter);
    T_TEXT_TABLE table{{{Say("IDS_QM_FACT_LOAD_CASE")},
                        {Say("IDS_QM_REPORT_LOAD")},
                        {Say("IDS_QM_REPORT_LOAD_AT")},
                        {Say("IDS_QM_REPORT_LOAD_VALUES")}},
                       {}};
    CLoadRows rows(work.Units(), table);
    for (const int key : work.doc.Attr().GetStldKeys()) {
        T_STLD_D c;
        if (work.doc.Attr().GetStld(key, c)) rows.Add(c);
    }
    if (!table.rows.empty())
        chapter.blocks.emplace_back(
            DocTable(Say("IDS_QM_REPORT_ALL_LOADS"), std::move(table), work.limit));
    AddRecords(work, EXPLORER_TABLE::Combinations, chapter);
}

void FillModesChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter)
{
    if (work.Model().modes.empty()) return;
    T_TEXT_TABLE table{{{Say("IDS_QM_REPORT_MODE")}, {"T (s)", true}, {"f (Hz)", true}}, {}};
    for (const char* const direction : kDirectionNames)
        table.columns.push_back({std::string("m ") + direction + " (%)", true});
    const auto textOf = [](const std::optional<double>& percent) {
        return percent ? PercentText(*percent) : "-";
    };
    bool worked = false, missing = false;
    T_MASSES sum;
    sum.fill(0.0);
    for (const auto& [number, mode] : work.Model().modes) {
        auto& row = table.rows.emplace_back(std::vector<std::string>{
            std::to_string(number), FormatText("%.5g", mode.period),
            mode.period > 0.0 ? FormatText("%.5g", 1.0 / mode.period) : "-"});
        const T_MASSES masses = MassesOf(work.doc, number, mode);
        worked = worked || (masses.front() && !mode.massPercent);
        missing = missing || !masses.front();
        for (std::size_t d = 0; d < sum.size(); ++d) {
            row.push_back(textOf(masses[d]));
            sum[d] = sum[d] && masses[d] ? std::optional(*sum[d] + *masses[d]) : std::nullopt;
        }
    }
    auto& last =
        table.rows.emplace_back(std::vector<std::string>{Say("IDS_QM_REPORT_MODES_SUM"), "", ""});
    for (const std::optional<double>& percent : sum)
        last.push_back(textOf(percent));
    chapter.blocks.emplace_back(
        DocTable(Say("IDS_QM_REPORT_MODES_TABLE"), std::move(table), work.limit));
    if (worked) chapter.blocks.emplace_back(DocText(Say("IDS_QM_REPORT_MODAL_MASS_WORKED")));
    if (missing) chapter.blocks.emplace_back(DocText(Say("IDS_QM_REPORT_NO_MODAL_MASS")));
}
