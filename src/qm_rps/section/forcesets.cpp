#include "qm_rps/section/forcesets.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/dialog/unithead.h"
#include "qm_rps/push/law/lawaxial.h"

#include <algorithm>
#include <cmath>
#include <iterator>
#include <map>
#include <sstream>

namespace {

int Refuse(std::string& reason, std::string words)
{
    reason = std::move(words);
    return 0;
}

// ---- file ---------------------------------------------------------------------------------------

std::string Trimmed(std::string text)
{
    constexpr const char* kBlanks = " \t\r";
    text.erase(0, text.find_first_not_of(kBlanks));
    text.erase(text.find_last_not_of(kBlanks) + 1);
    return text;
}

/// Cells of a line; quotes keep a separator, two of them are one.
std::vector<std::string> CellsOf(const std::string& line, char separator)
{
    std::vector<std::string> cells(1);
    bool quoted = false;
    for (std::size_t i = 0; i < line.size(); ++i) {
        const bool twice = quoted && line.compare(i, 2, "\"\"") == 0;
        if (line[i] == '"' && !twice)
            quoted = !quoted;
        else if (line[i] == separator && !quoted)
            cells.emplace_back();
        else
            cells.back() += line[twice ? i++ : i];
    }
    for (std::string& cell : cells)
        cell = Trimmed(std::move(cell));
    return cells;
}

constexpr std::size_t kName = kSectionForces.size(); // the column of the names
constexpr const char* kNameHead = "name";

/// Which force each column has; kName: the name.
int ReadHead(const std::vector<std::string>& cells, const T_UNITS& units,
             std::vector<std::size_t>& columns, std::string& reason)
{
    for (const std::string& cell : cells) {
        const auto force = std::ranges::find_if(kSectionForces, [&](const T_SECTION_FORCE& f) {
            return cell == f.name || cell == HeadWithUnit(f.name, f.dim, units);
        });
        const auto column = static_cast<std::size_t>(force - kSectionForces.begin());
        if (column == kName && cell != kNameHead)
            return Refuse(reason, Say("IDS_QM_SECK_FILE_COLUMN", cell));
        if (std::ranges::count(columns, column) > 0)
            return Refuse(reason, Say("IDS_QM_SECK_FILE_TWICE", cell));
        columns.push_back(column);
    }
    return 1;
}

int ReadSet(const std::vector<std::string>& cells, const std::vector<std::size_t>& columns,
            const T_UNITS& units, T_SECTION_FORCES& set, std::string& reason)
{
    if (cells.size() != columns.size())
        return Refuse(reason, Say("IDS_QM_SECK_FILE_CELLS", std::to_string(cells.size()),
                                  std::to_string(columns.size())));
    for (std::size_t i = 0; i < cells.size(); ++i) {
        if (columns[i] == kName) {
            if (!cells[i].empty()) set.name = cells[i];
            continue;
        }
        const T_SECTION_FORCE& force = kSectionForces[columns[i]];
        const std::optional<double> value = ParseFinite(cells[i]);
        if (!value) return Refuse(reason, Say("IDS_QM_SECK_FILE_NUMBER", force.name, cells[i]));
        set.*force.value = ToSi(*value, units, force.dim);
    }
    return 1;
}

// ---- results ------------------------------------------------------------------------------------

constexpr std::array<const char*, kForcePositions> kPlaces{"I", "1/4", "1/2", "3/4", "J"};

/// Forces of an analysis with the signs of sections, in the document's units; Fx is positive in
/// tension there.
T_SECTION_FORCES OfSection(const T_DOF6& f)
{
    const auto signOf = [](HINGE_COMPONENT c) { return IsSectionSignOpposite(c) ? -1.0 : 1.0; };
    return {
        -f[0], signOf(HINGE_COMPONENT::My) * f[4], signOf(HINGE_COMPONENT::Mz) * f[5], f[1], f[2],
        f[3]};
}

int FindCase(CDBDoc& doc, const std::string& name, T_LCOM_D& out, std::string& reason)
{
    int key = 0;
    if (doc.Attr().FindStld(name, key)) {
        out = CPostCtrl::MakeLoadComb(key);
        return 1;
    }
    return doc.Attr().GetLcom_(name, out) ? 1 : Refuse(reason, Say("IDS_QM_CLI_NO_CASE", name));
}

/// The sets of an element; a truss has one.
int SetsOf(CPostCtrl& post, const T_ELEM_D& e, std::vector<T_SECTION_FORCES>& out)
{
    if (e.kind == ELEM_KIND::Truss) {
        double axial = 0.0;
        if (!post.GetStrtNew(e.id, axial)) return 0;
        out.push_back({-axial});
        return 1;
    }
    for (std::size_t p = 0; p < kForcePositions; ++p) {
        T_DOF6 forces{};
        if (!post.GetStrbNew(e.id, static_cast<int>(p), forces)) return 0;
        out.push_back(OfSection(forces));
        out.back().name = kPlaces[p];
    }
    return 1;
}

bool HasForce(const T_SECTION_FORCES& set)
{
    return std::ranges::any_of(
        kSectionForces, [&](const T_SECTION_FORCE& force) { return set.*force.value != 0.0; });
}

using T_JOBS_BY_PAIR = std::map<std::pair<int, int>, T_SECTION_JOB>;

/// The sets of an element in SI, with their names, among those of its section and material.
int AddElement(CDBDoc& doc, const std::string& loadCase, const T_ELEM_D& e, T_JOBS_BY_PAIR& jobs)
{
    std::vector<T_SECTION_FORCES> sets;
    if (!SetsOf(doc.Post(), e, sets)) return 0;
    T_SECTION_JOB& job = jobs[{e.section, e.material}];
    job.pair = {e.section, e.material};
    for (T_SECTION_FORCES& set : sets) {
        const std::string place = set.name.empty() ? std::string() : " " + set.name;
        set.name = loadCase + " " + std::to_string(e.id) + place;
        for (const T_SECTION_FORCE& force : kSectionForces)
            set.*force.value = ToSi(set.*force.value, doc.Unit().Units(), force.dim);
        job.forces.push_back(std::move(set));
    }
    return 1;
}

/// What is left of 0 by rounding, beside the largest force or moment of all sets; then the sets
/// without any.
void DropRounding(std::vector<T_SECTION_JOB>& jobs)
{
    constexpr double kRounding = 1e-9;
    std::array<double, 2> largest{}; // of forces, of moments
    const auto each = [&](const auto& what) {
        for (T_SECTION_JOB& job : jobs)
            for (T_SECTION_FORCES& set : job.forces)
                for (const T_SECTION_FORCE& force : kSectionForces)
                    what(set.*force.value, largest[force.dim == kDimForce ? 0 : 1]);
    };
    each([](double v, double& most) { most = std::max(most, std::fabs(v)); });
    each([](double& v, double most) {
        if (std::fabs(v) <= kRounding * most) v = 0.0;
    });
    for (T_SECTION_JOB& job : jobs)
        std::erase_if(job.forces, [](const T_SECTION_FORCES& set) { return !HasForce(set); });
    std::erase_if(jobs, [](const T_SECTION_JOB& job) { return job.forces.empty(); });
}

} // namespace

int ReadForceSets(const std::string& text, const T_UNITS& units, std::vector<T_SECTION_FORCES>& out,
                  std::string& reason)
{
    constexpr const char* kMark = "\xEF\xBB\xBF"; // of UTF-8
    std::istringstream lines(text.starts_with(kMark) ? text.substr(3) : text);
    std::vector<std::size_t> columns;
    std::vector<T_SECTION_FORCES> sets;
    char separator = ',';
    std::size_t number = 0;
    for (std::string line; std::getline(lines, line);) {
        ++number;
        if (Trimmed(line).empty()) continue;
        const bool isHead = columns.empty();
        if (isHead && line.find(';') != std::string::npos) separator = ';';
        const std::vector<std::string> cells = CellsOf(line, separator);
        std::string why;
        int done = 0;
        if (isHead) {
            done = ReadHead(cells, units, columns, why);
        } else {
            T_SECTION_FORCES& set = sets.emplace_back();
            set.name = std::to_string(sets.size());
            done = ReadSet(cells, columns, units, set, why);
        }
        if (!done) return Refuse(reason, Say("IDS_QM_SECK_FILE_LINE", std::to_string(number), why));
    }
    if (sets.empty()) return Refuse(reason, Say("IDS_QM_SECK_FILE_NONE"));
    out = std::move(sets);
    return 1;
}

int ForcesOfMembers(CDBDoc& doc, const std::string& loadCase, const std::vector<int>& elements,
                    std::vector<T_SECTION_JOB>& out, std::string& reason)
{
    const T_MODEL& model = doc.Data().Model();
    T_LCOM_D combination;
    if (!FindCase(doc, loadCase, combination, reason)) return 0;
    if (!doc.Post().SelectLoadCombNew(combination)) return Refuse(reason, doc.Post().Error());
    for (const int id : elements)
        if (!model.elements.contains(id))
            return Refuse(reason, Say("IDS_QM_ANALYSIS_NO_ELEMENT", std::to_string(id)));
    T_JOBS_BY_PAIR jobs;
    for (const auto& [id, e] : model.elements) {
        if (e.kind != ELEM_KIND::Beam && e.kind != ELEM_KIND::Truss) continue;
        if (!elements.empty() && std::ranges::find(elements, id) == elements.end()) continue;
        if (!AddElement(doc, loadCase, e, jobs)) return Refuse(reason, doc.Post().Error());
    }
    std::vector<T_SECTION_JOB> all;
    for (auto& entry : jobs)
        all.push_back(std::move(entry.second));
    DropRounding(all);
    if (all.empty()) return Refuse(reason, Say("IDS_QM_SECK_NO_RESULTS", loadCase));
    out.insert(out.end(), std::make_move_iterator(all.begin()), std::make_move_iterator(all.end()));
    return 1;
}
