#include "qm_rps/view/resulttable.h"

#include "qm_rps/dialog/csvcell.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/view/memberplaces.h"
#include "qm_rps/view/resultview.h"

#include <algorithm>
#include <cmath>
#include <map>

namespace {

constexpr std::array<const char*, 6> kMoves{"DX", "DY", "DZ", "RX", "RY", "RZ"};
constexpr std::array<const char*, 6> kReactions{"FX", "FY", "FZ", "MX", "MY", "MZ"};
constexpr std::array<const char*, kForcePositions> kPositions{"I", "1/4", "2/4", "3/4", "J"};

struct T_COMPONENTS {
    const std::array<const char*, 6>& names;
    T_DIM linear, angular;
};
constexpr std::array<T_COMPONENTS, 3> kComponents{{{kMoves, kDimLength, kDimNone},
                                                   {kReactions, kDimForce, kDimMoment},
                                                   {kMemberForceNames, kDimForce, kDimMoment}}};

using KIND = T_SHAPE_SOURCE::KIND;
using T_AT_STEP = std::pair<T_SHAPE_SOURCE, int>;

bool IsCase(const T_SHAPE_SOURCE& source)
{
    return source.kind == KIND::Static || source.kind == KIND::Combination;
}

T_RESULT_CELL Number(double value)
{
    return {{}, value};
}

std::string UnitOf(T_DIM dim, const T_UNITS& units)
{
    if (dim == kDimNone) return "rad";
    const std::string force(NameOf(units.force)), length(NameOf(units.length));
    if (dim == kDimLength) return length;
    return dim == kDimForce ? force : force + "*" + length;
}

/// Values at a place of a source.
struct T_LINE_VALUES {
    std::size_t source = 0;
    int id = 0;
    std::string position;   // of forces
    T_DOF6 values{};        // SI
    T_DOF6 least{}, most{}; // over the member, where it stands for all of it
    bool whole = false;
};

class CTableMaker {
public:
    CTableMaker(CDBDoc& doc, CFrameScene& scene, const T_RESULT_TABLE_CHOICE& choice)
        : m_doc(doc), m_scene(scene), m_choice(choice), m_frame(doc), m_units(doc.Unit().Units()),
          m_components(kComponents[static_cast<std::size_t>(choice.what)])
    {
    }

    int Read(std::string& why)
    {
        if (!JudgeModes(why)) return 0;
        if (m_choice.what == RESULT_TABLE::Forces && !m_frame.Refresh(why)) return 0;
        for (std::size_t s = 0; s < m_choice.sources.size(); ++s)
            if (!ReadSource(s, why)) return 0;
        DropRounding();
        return 1;
    }

    void Write(T_RESULT_TABLE& out) const
    {
        out.notes = Notes();
        out.title =
            Say("IDS_QM_VIEW_TABLE", kResultTableNames[static_cast<std::size_t>(m_choice.what)]);
        m_choice.envelope ? WriteEnvelope(out) : WriteRows(out);
    }

private:
    bool HasForces() const { return m_choice.what == RESULT_TABLE::Forces; }
    const std::string& NameOf(std::size_t source) const
    {
        return m_choice.sources[source].first.name;
    }

    /// Shapes of modes have no unit of length: they share no column with displacements.
    int JudgeModes(std::string& why)
    {
        const auto modes = std::ranges::count_if(
            m_choice.sources, [](const auto& s) { return s.first.kind == KIND::Mode; });
        m_shape = modes > 0;
        if (modes == 0 || static_cast<std::size_t>(modes) == m_choice.sources.size()) return 1;
        why = Say("IDS_QM_VIEW_MODES_APART");
        return 0;
    }

    std::vector<std::string> Notes() const
    {
        std::vector<std::string> notes;
        if (m_choice.envelope && std::ranges::all_of(m_choice.sources, IsCase, &T_AT_STEP::first))
            notes.push_back(Say("IDS_QM_VIEW_TABLE_OVER", std::to_string(m_choice.sources.size())));
        if (m_rigid > 0) notes.push_back(RigidFloorNote(m_rigid));
        if (m_shape) notes.push_back(Say("IDS_QM_VIEW_MODE_SCALE"));
        return notes;
    }

    /// What is far below the largest of its kind is 0.
    void DropRounding()
    {
        constexpr double kRounding = 1e-12;
        std::array<double, 2> largest{};
        for (const T_LINE_VALUES& line : m_lines)
            for (std::size_t c = 0; c < 6; ++c)
                largest[c / 3] = std::max(largest[c / 3], std::fabs(line.values[c]));
        for (T_LINE_VALUES& line : m_lines)
            for (T_DOF6* values : {&line.values, &line.least, &line.most})
                for (std::size_t c = 0; c < 6; ++c)
                    if (std::fabs((*values)[c]) <= kRounding * largest[c / 3]) (*values)[c] = 0.0;
    }

    int ReadSource(std::size_t index, std::string& why)
    {
        const auto& [source, step] = m_choice.sources[index];
        if (!source.analysed) {
            why = CResultView::NameOf(source) + ": " + Say("IDS_QM_VIEW_NOT_ANALYSED");
            return 0;
        }
        const T_FRAME_SCENE& scene = m_scene.SceneOf(source);
        const T_VIEW_RESULTS results = ReadViewResults(
            m_doc, scene, source, step, {HasForces(), m_choice.what == RESULT_TABLE::Reactions});
        const std::string& missing = HasForces() ? results.noForces
                                     : m_choice.what == RESULT_TABLE::Reactions
                                         ? results.noReactions
                                         : results.noMoves;
        if (!missing.empty()) {
            why = CResultView::NameOf(source) + ": " + missing;
            return 0;
        }
        if (HasForces()) return ReadForces(index, scene, results, step, why);
        const auto wanted = [&](int id) {
            return m_choice.nodes.empty() || m_choice.nodes.contains(id);
        };
        if (m_choice.what == RESULT_TABLE::Reactions) {
            for (const T_NODE_VALUES& at : results.reactions)
                if (wanted(scene.nodes[at.node].id))
                    m_lines.push_back({index, scene.nodes[at.node].id, {}, at.values, {}, {}});
            return 1;
        }
        for (std::size_t n = 0; n < scene.nodes.size(); ++n)
            if (wanted(scene.nodes[n].id))
                m_lines.push_back({index, scene.nodes[n].id, {}, results.moved[n], {}, {}});
        return 1;
    }

    int ReadForces(std::size_t index, const T_FRAME_SCENE& scene, const T_VIEW_RESULTS& results,
                   int step, std::string& why)
    {
        solver::T_LOAD_CASE loads;
        if (!m_frame.LoadsOf(m_choice.sources[index].first, step, loads, why)) return 0;
        m_rigid = CountInDiaphragms(m_doc.Data().Model(), scene, m_choice.elements);
        const auto lineLoads = m_frame.LineLoads(loads);
        for (std::size_t l = 0; l < scene.lines.size(); ++l) {
            const T_SCENE_LINE& line = scene.lines[l];
            if (!m_choice.elements.empty() && !m_choice.elements.contains(line.id)) continue;
            const long at = m_frame.ElementAt(line.id);
            const auto e = static_cast<std::size_t>(at);
            if (at < 0 || line.kind == ELEM_KIND::Link || !m_frame.Axes(e)) continue;
            const bool beam = line.kind == ELEM_KIND::Beam;
            CMemberLine member(m_frame.Axes(e)->length, results.force[l][0],
                               beam ? std::span<const T_LINE_LOAD>(lineLoads[e])
                                    : std::span<const T_LINE_LOAD>());
            (void)member.FitTo(results.force[l]);
            AddMember(index, line.id, results.force[l], member, beam);
        }
        return 1;
    }

    void AddMember(std::size_t source, int id, const T_ELEM_FORCES& analysed,
                   const CMemberLine& member, bool beam)
    {
        for (std::size_t p = 0; p < analysed.size(); ++p)
            m_lines.push_back({source, id, kPositions[p], analysed[p], {}, {}});
        if (!beam) return;
        if (!m_choice.envelope) return AddBetween(source, id, PlacesBetween(member), member);
        T_LINE_VALUES whole{source, id, Say("IDS_QM_VIEW_WHOLE_MEMBER"), {}, {}, {}, true};
        whole.least = whole.most = analysed[0];
        for (std::size_t c = 0; c < 6; ++c) {
            const auto take = [&](double value) {
                whole.least[c] = std::min(whole.least[c], value);
                whole.most[c] = std::max(whole.most[c], value);
            };
            for (const T_DOF6& at : analysed)
                take(at[c]);
            for (const T_STATION& at : StationsAlong(member, c)) {
                take(at.before);
                take(at.behind);
            }
        }
        m_lines.push_back(whole);
    }

    /// A place has one row, or where something leaps one for each side of it.
    void AddBetween(std::size_t source, int id, const std::map<double, bool>& places,
                    const CMemberLine& member)
    {
        for (const auto& [x, leaps] : places)
            for (const bool behind : {false, true}) {
                if (behind && !leaps) continue;
                T_LINE_VALUES at{source, id, {}, {}, {}, {}};
                at.position = "x = " + FormatText("%.6g", FromSi(x, m_units, kDimLength));
                if (leaps) at.position += behind ? "+" : "-";
                for (std::size_t c = 0; c < 6; ++c)
                    at.values[c] = member.Force(c, x, behind);
                m_lines.push_back(at);
            }
    }

    T_DIM Dim(std::size_t c) const { return c < 3 ? m_components.linear : m_components.angular; }
    /// A mode keeps its own normalisation, that of lengths in m.
    std::string Unit(std::size_t c) const
    {
        if (m_shape) return c < 3 ? "-" : "rad/m";
        return UnitOf(Dim(c), m_units);
    }
    double Shown(const T_DOF6& values, std::size_t c) const
    {
        return (m_shape ? values[c] : FromSi(values[c], m_units, Dim(c))) + 0.0;
    }

    void WriteRows(T_RESULT_TABLE& out) const
    {
        out.heads = {Say("IDS_QM_VIEW_HEAD_SOURCE"),
                     Say(HasForces() ? "IDS_QM_VIEW_HEAD_ELEMENT" : "IDS_QM_VIEW_HEAD_NODE")};
        if (HasForces()) out.heads.push_back(Say("IDS_QM_VIEW_HEAD_POSITION"));
        for (std::size_t c = 0; c < 6; ++c)
            out.heads.push_back(std::string(m_components.names[c]) + " (" + Unit(c) + ")");
        for (const T_LINE_VALUES& line : m_lines) {
            auto& row = out.rows.emplace_back();
            row.push_back({NameOf(line.source)});
            row.push_back(Number(line.id));
            if (HasForces()) row.push_back({line.position});
            for (std::size_t c = 0; c < 6; ++c)
                row.push_back(Number(Shown(line.values, c)));
        }
    }

    void WriteEnvelope(T_RESULT_TABLE& out) const
    {
        out.heads = {Say(HasForces() ? "IDS_QM_VIEW_HEAD_ELEMENT" : "IDS_QM_VIEW_HEAD_NODE")};
        if (HasForces()) out.heads.push_back(Say("IDS_QM_VIEW_HEAD_POSITION"));
        for (const char* head :
             {"IDS_QM_VIEW_HEAD_COMPONENT", "IDS_QM_VIEW_HEAD_UNIT", "IDS_QM_VIEW_HEAD_LEAST",
              "IDS_QM_VIEW_HEAD_LEAST_OF", "IDS_QM_VIEW_HEAD_MOST", "IDS_QM_VIEW_HEAD_MOST_OF"})
            out.heads.push_back(Say(head));
        // Lines of one place, in the order in which places come first.
        std::map<std::pair<int, std::string>, std::vector<const T_LINE_VALUES*>> places;
        std::vector<std::pair<int, std::string>> order;
        for (const T_LINE_VALUES& line : m_lines) {
            const std::pair key(line.id, line.position);
            auto& at = places[key];
            if (at.empty()) order.push_back(key);
            at.push_back(&line);
        }
        for (const auto& key : order)
            for (std::size_t c = 0; c < 6; ++c)
                AddEnvelopeRow(key, c, places.at(key), out);
    }

    void AddEnvelopeRow(const std::pair<int, std::string>& place, std::size_t c,
                        const std::vector<const T_LINE_VALUES*>& lines, T_RESULT_TABLE& out) const
    {
        const auto least = [&](const T_LINE_VALUES* line) {
            return Shown(line->whole ? line->least : line->values, c);
        };
        const auto most = [&](const T_LINE_VALUES* line) {
            return Shown(line->whole ? line->most : line->values, c);
        };
        const T_LINE_VALUES* const low = *std::ranges::min_element(lines, {}, least);
        const T_LINE_VALUES* const high = *std::ranges::max_element(lines, {}, most);
        if (least(low) == 0.0 && most(high) == 0.0)
            return; // as envelopes of `analyse` leave it out
        auto& row = out.rows.emplace_back();
        row.push_back(Number(place.first));
        if (HasForces()) row.push_back({place.second});
        row.push_back({m_components.names[c]});
        row.push_back({Unit(c)});
        row.push_back(Number(least(low)));
        row.push_back({NameOf(low->source)});
        row.push_back(Number(most(high)));
        row.push_back({NameOf(high->source)});
    }

    CDBDoc& m_doc;
    CFrameScene& m_scene;
    const T_RESULT_TABLE_CHOICE& m_choice;
    CViewFrame m_frame;
    T_UNITS m_units;
    const T_COMPONENTS& m_components;
    std::vector<T_LINE_VALUES> m_lines;
    bool m_shape = false;    // of modes
    std::size_t m_rigid = 0; // members in diaphragms
};

std::string TextOf(const T_RESULT_CELL& cell)
{
    return cell.number ? ShortestText(*cell.number) : CsvCell(cell.text);
}

} // namespace

std::vector<T_SHAPE_SOURCE> EnvelopeSources(const std::vector<T_SHAPE_SOURCE>& all)
{
    std::vector<T_SHAPE_SOURCE> out;
    std::ranges::copy_if(all, std::back_inserter(out),
                         [](const auto& source) { return source.analysed && IsCase(source); });
    return out;
}

int MakeResultTable(CDBDoc& doc, CFrameScene& scene, const T_RESULT_TABLE_CHOICE& choice,
                    T_RESULT_TABLE& out, std::string& why)
{
    CTableMaker maker(doc, scene, choice);
    if (!maker.Read(why)) return 0;
    out = {};
    maker.Write(out);
    return 1;
}

std::string CsvText(const T_RESULT_TABLE& table)
{
    std::string text;
    for (std::size_t c = 0; c < table.heads.size(); ++c)
        text += (c ? "," : "") + CsvCell(table.heads[c]);
    text += "\n";
    for (const auto& row : table.rows) {
        for (std::size_t c = 0; c < row.size(); ++c)
            text += (c ? "," : "") + TextOf(row[c]);
        text += "\n";
    }
    return text;
}

T_SHEET SheetOf(const T_RESULT_TABLE& table)
{
    constexpr double kWidth = 14.0; // characters
    T_SHEET sheet;
    T_SHEET_STYLE head;
    head.bold = head.centred = true;
    head.bottom = SHEET_EDGE::Thin;
    for (std::size_t c = 0; c < table.heads.size(); ++c)
        sheet.cells[{0, c}] = {table.heads[c], head};
    for (std::size_t r = 0; r < table.rows.size(); ++r)
        for (std::size_t c = 0; c < table.rows[r].size(); ++c) {
            T_SHEET_CELL cell;
            const T_RESULT_CELL& from = table.rows[r][c];
            cell.value = from.text;
            if (from.number) cell.value = *from.number;
            sheet.cells[{r + 1, c}] = cell;
        }
    sheet.widths.push_back({0, table.heads.size(), kWidth});
    return sheet;
}
