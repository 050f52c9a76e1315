#include "qm_db/store/runblocks.h"

#include "qm_db/file/checksum.h"
#include "qm_db/file/storefault.h"
#include "qm_db/store/modelschema.h"
#include "qm_db/store/recordcodecrow.h"
#include "qm_db/store/sqlitedb.h"
#include "qm_solver/pushresult.h"

#include <algorithm>
#include <bit>
#include <set>

namespace {

constexpr const char* kTable = "push_results";

/// Words of the file for the ends of a run, which outlive a change of the enumeration.
struct T_OUTCOME_WORD {
    solver::PUSH_OUTCOME outcome;
    const char* word;
};
using O = solver::PUSH_OUTCOME;
constexpr T_OUTCOME_WORD kOutcomes[] = {{O::Reached, "reached"},
                                        {O::NoEquilibrium, "no equilibrium"},
                                        {O::DriftStop, "drift stop"},
                                        {O::PeakFractionStop, "peak fraction stop"},
                                        {O::StiffnessStop, "stiffness stop"},
                                        {O::MarkStop, "mark stop"},
                                        {O::StrengthLossStop, "strength loss stop"},
                                        {O::LastPointStop, "last point stop"},
                                        {O::InitialLoads, "initial loads"},
                                        {O::NoPath, "no path"},
                                        {O::SnapBack, "snap-back"},
                                        {O::AxialStrength, "axial strength"},
                                        {O::TooManyEvents, "too many events"},
                                        {O::OutOfBalance, "out of balance"},
                                        {O::Cancelled, "cancelled"},
                                        {O::Mechanism, "mechanism elsewhere"},
                                        {O::ReachedByLeaps, "reached by leaps"}};
static_assert(std::size(kOutcomes) == static_cast<std::size_t>(O::ReachedByLeaps) + 1);

/// Members of "push_results" that are whole numbers, and those that are not.
struct T_WHOLE {
    const char* column;
    int& (*member)(T_RUN_ROW&);
};
constexpr T_WHOLE kWhole[] = {
    {"pushover", [](T_RUN_ROW& r) -> int& { return r.pushover; }},
    {"turn", [](T_RUN_ROW& r) -> int& { return r.head.turn; }},
    {"nodes", [](T_RUN_ROW& r) -> int& { return r.nodes; }},
    {"hinges", [](T_RUN_ROW& r) -> int& { return r.hinges; }},
    {"steps", [](T_RUN_ROW& r) -> int& { return r.steps; }},
    {"events", [](T_RUN_ROW& r) -> int& { return r.events; }},
    {"turns", [](T_RUN_ROW& r) -> int& { return r.turns; }},
    {"end_stage", [](T_RUN_ROW& r) -> int& { return r.head.end.stage; }},
    {"end_element", [](T_RUN_ROW& r) -> int& { return r.head.end.element; }},
    {"end_hinge", [](T_RUN_ROW& r) -> int& { return r.head.end.hinge; }},
    {"end_storey", [](T_RUN_ROW& r) -> int& { return r.head.end.storey; }},
};
struct T_REAL {
    const char* column;
    double& (*member)(T_RUN_ROW&);
};
constexpr T_REAL kReal[] = {
    {"angle", [](T_RUN_ROW& r) -> double& { return r.head.angle; }},
    {"control_x", [](T_RUN_ROW& r) -> double& { return r.head.control[0]; }},
    {"control_y", [](T_RUN_ROW& r) -> double& { return r.head.control[1]; }},
    {"control_z", [](T_RUN_ROW& r) -> double& { return r.head.control[2]; }},
    {"control_rx", [](T_RUN_ROW& r) -> double& { return r.head.control[3]; }},
    {"control_ry", [](T_RUN_ROW& r) -> double& { return r.head.control[4]; }},
    {"control_rz", [](T_RUN_ROW& r) -> double& { return r.head.control[5]; }},
    {"start_reaction", [](T_RUN_ROW& r) -> double& { return r.head.startReaction; }},
    {"end_load_factor", [](T_RUN_ROW& r) -> double& { return r.head.end.loadFactor; }},
    {"end_displacement", [](T_RUN_ROW& r) -> double& { return r.head.end.displacement; }},
};
struct T_PRINT_COLUMN {
    const char* column;
    std::uint64_t T_RUN_PRINT::*member;
};
constexpr T_PRINT_COLUMN kPrints[] = {{"structure_print", &T_RUN_PRINT::structure},
                                      {"hinge_print", &T_RUN_PRINT::hinges},
                                      {"load_print", &T_RUN_PRINT::loads},
                                      {"setup_print", &T_RUN_PRINT::setup}};

/// The same numbers without their grouping.
template <class T, std::size_t N>
std::span<const T> Flat(const std::vector<std::array<T, N>>& values)
{
    return {reinterpret_cast<const T*>(values.data()), values.size() * N};
}

T_HINGE_NUMBERS NumbersOf(const T_RUN_HINGE& h)
{
    return {1.0 * h.element, h.at, 1.0 * h.component};
}
T_STEP_NUMBERS NumbersOf(const T_RUN_STEP& s)
{
    return {1.0 * s.stage,  s.loadFactor, s.displacement,
            s.baseReaction, s.base[0],    s.base[1],
            s.base[2],      s.base[3],    s.base[4],
            s.base[5],      s.residual,   s.evaluated ? 2.0 : s.additional ? 1.0 : 0.0};
}
T_EVENT_NUMBERS NumbersOf(const T_RUN_EVENT& e)
{
    return {1.0 * e.stage,
            e.loadFactor,
            e.displacement,
            e.baseReaction,
            e.base[0],
            e.base[1],
            e.base[2],
            e.base[3],
            e.base[4],
            e.base[5],
            1.0 * static_cast<double>(e.turns.size())};
}
T_TURN_NUMBERS NumbersOf(const T_RUN_TURN& t)
{
    return {t.hinge, static_cast<int>(t.turn), t.point, t.positive ? 1 : 0};
}
T_STATE_NUMBERS NumbersOf(const T_RUN_STATE& s)
{
    return {s.deformation, s.force, s.axial, 1.0 * s.place};
}
const T_DOF6& NumbersOf(const T_DOF6& u)
{
    return u;
}

template <class T>
auto ListOf(const std::vector<T>& all)
{
    std::vector<std::decay_t<decltype(NumbersOf(all[0]))>> numbers;
    for (const T& one : all)
        numbers.push_back(NumbersOf(one));
    return numbers;
}

/// One run: reads its source and writes its row and blocks.
class CRunWriter {
public:
    CRunWriter(const CSqliteDb& db, CBlockWriter& blocks, IPushRun& source, T_RUN_ROW row)
        : m_db(db), m_blocks(blocks), m_source(source), m_row(std::move(row))
    {
        m_row.head = source.Head();
    }

    void Write()
    {
        std::vector<T_RUN_STEP> steps;
        std::vector<T_RUN_HINGE> hinges;
        std::vector<T_RUN_EVENT> events;
        std::vector<T_RUN_TURN> turns;
        std::vector<T_DOF6> start;
        const std::vector<int> nodes = m_source.NodeIds();
        if (!m_source.Error().empty() || !m_source.ReadSteps(steps) ||
            !m_source.ReadHinges(hinges) || !m_source.ReadEvents(events) ||
            !m_source.ReadStart(start))
            ThrowSource();
        for (const T_RUN_EVENT& e : events)
            turns.insert(turns.end(), e.turns.begin(), e.turns.end());
        m_row.nodes = static_cast<int>(nodes.size());
        m_row.hinges = static_cast<int>(hinges.size());
        m_row.steps = static_cast<int>(steps.size());
        m_row.events = static_cast<int>(events.size());
        m_row.turns = static_cast<int>(turns.size());
        WriteHead();
        m_blocks.Write(RunKey(m_row, BLOCK_PART::RunNodes), std::span<const int>(nodes));
        WriteList(BLOCK_PART::RunHinges, Flat(ListOf(hinges)));
        WriteList(BLOCK_PART::RunSteps, Flat(ListOf(steps)));
        WriteList(BLOCK_PART::RunEvents, Flat(ListOf(events)));
        m_blocks.Write(RunKey(m_row, BLOCK_PART::RunTurns), Flat(ListOf(turns)));
        WriteBySteps(BLOCK_PART::RunDisplacement, &IPushRun::ReadShape);
        WriteBySteps(BLOCK_PART::RunState, &IPushRun::ReadStates);
        WriteList(BLOCK_PART::RunStart, Flat(start));
    }

private:
    [[noreturn]] void ThrowSource() const
    {
        throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_RESULT_SOURCE",
                          std::to_string(m_row.pushover), m_source.Error());
    }
    void CheckFinite(std::span<const double> values) const
    {
        if (!std::ranges::all_of(values, [](double v) { return std::isfinite(v); }))
            throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_NOT_FINITE",
                              std::string(kTable) + ' ' + std::to_string(m_row.pushover));
    }

    void WriteHead()
    {
        CRecordRow row(kTable, m_row.row);
        for (const T_WHOLE& w : kWhole)
            row.Put(w.column, std::int64_t{w.member(m_row)});
        for (const T_REAL& r : kReal)
            row.Put(r.column, r.member(m_row));
        for (const T_PRINT_COLUMN& p : kPrints)
            row.Put(p.column, std::bit_cast<std::int64_t>(m_row.head.print.*p.member));
        row.Put("outcome",
                std::string(kOutcomes[static_cast<std::size_t>(m_row.head.end.outcome)].word));
        row.Insert(m_db);
    }

    void WriteList(BLOCK_PART part, std::span<const double> values)
    {
        CheckFinite(values);
        m_blocks.Write(RunKey(m_row, part), values);
    }

    template <class T>
    void WriteBySteps(BLOCK_PART partKey, int (IPushRun::*read)(int, std::vector<T>&))
    {
        const T_RUN_PART& part = RunPartOf(partKey);
        std::vector<T> values;
        for (int step = 0; step < m_row.steps; ++step) {
            if (!(m_source.*read)(step + 1, values)) ThrowSource();
            if (values.size() != static_cast<std::size_t>(m_row.*part.count))
                throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_RESULT_LENGTH",
                                  std::string(kTable) + ' ' + std::to_string(m_row.pushover),
                                  std::to_string(values.size()), std::to_string(m_row.*part.count));
            const auto numbers = ListOf(values);
            const std::span<const double> all = Flat(numbers);
            CheckFinite(all);
            for (int chunk = 0; chunk < RunChunks(m_row, part); ++chunk) {
                const auto from = static_cast<std::size_t>(chunk * part.block * part.width);
                const auto size = static_cast<std::size_t>(RunChunkNumbers(m_row, part, chunk));
                m_blocks.Write(RunKey(m_row, partKey, chunk, step), all.subspan(from, size));
            }
        }
    }

    const CSqliteDb& m_db;
    CBlockWriter& m_blocks;
    IPushRun& m_source;
    T_RUN_ROW m_row;
};

T_RUN_ROW RowOf(const CRecordRow& row)
{
    T_RUN_ROW out;
    out.row = static_cast<int>(row.Key());
    if (out.row != row.Key() || out.row < 1) row.ThrowBadCell("key");
    for (const T_WHOLE& w : kWhole)
        w.member(out) = HeadField(row, w.column);
    for (const T_REAL& r : kReal) {
        const auto* const value = std::get_if<double>(&row.Get(r.column));
        if (!value || !std::isfinite(*value)) row.ThrowBadCell(r.column);
        r.member(out) = *value;
    }
    for (const T_PRINT_COLUMN& p : kPrints) {
        const auto* const print = std::get_if<std::int64_t>(&row.Get(p.column));
        if (!print) row.ThrowBadCell(p.column);
        out.head.print.*p.member = std::bit_cast<std::uint64_t>(*print);
    }
    const auto* const word = std::get_if<std::string>(&row.Get("outcome"));
    const auto known = std::ranges::find_if(
        kOutcomes, [&](const T_OUTCOME_WORD& w) { return word && *word == w.word; });
    if (known == std::end(kOutcomes)) row.ThrowBadCell("outcome");
    out.head.end.outcome = known->outcome;
    return out;
}

} // namespace

int RunChunks(const T_RUN_ROW& row, const T_RUN_PART& part)
{
    return part.block == 0 ? 1 : (row.*part.count + part.block - 1) / part.block;
}

int RunChunkNumbers(const T_RUN_ROW& row, const T_RUN_PART& part, int chunk)
{
    const int left = row.*part.count - chunk * part.block;
    return (part.block == 0 ? left : std::min(left, part.block)) * part.width;
}

void WriteRuns(const CSqliteDb& db, const T_MODEL& model, const T_RESULT_MAP& results,
               const T_TURNED_MAP& turned)
{
    CBlockWriter blocks(db);
    int next = 1;
    const auto write = [&](int pushover, int turn, const std::shared_ptr<IPushResult>& source) {
        IPushRun* const run = source ? source->Run() : nullptr;
        if (!run || !model.pushovers.contains(pushover) || run->Head().turn != turn) return;
        T_RUN_ROW row;
        row.row = next++;
        row.pushover = pushover;
        CRunWriter(db, blocks, *run, std::move(row)).Write();
    };
    for (const auto& [pushover, source] : results)
        write(pushover, 0, source);
    for (const auto& [key, source] : turned)
        write(key.first, key.second, source);
}

std::vector<T_RUN_ROW> ReadRunRows(const CSqliteDb& db, T_TABLE_SUMS& sums)
{
    std::vector<T_RUN_ROW> rows;
    CChecksum sum;
    std::set<std::pair<int, int>> seen;
    for (const CRecordRow& row : CRecordRow::ReadAll(db, kTable, sum)) {
        rows.push_back(RowOf(row));
        if (!seen.emplace(rows.back().pushover, rows.back().head.turn).second)
            row.ThrowBadCell("turn");
    }
    sums[kTable] = sum.Value();
    return rows;
}

double BytesOf(const T_RUN_ROW& row)
{
    double bytes = 0.0;
    for (const T_RUN_PART& part : kRunParts)
        bytes += 1.0 * (row.*part.count) * part.width * part.bytes *
                 (part.block == 0 ? 1.0 : 1.0 * row.steps);
    return bytes;
}

void CheckRunBlocks(const CSqliteDb& db, const std::vector<T_RUN_ROW>& rows)
{
    CSqliteStmt stmt(db, std::string("SELECT ") + kBlockColumns + " FROM " + kBlockTable +
                             " WHERE part >= ?1 ORDER BY pushover, part, chunk, step");
    stmt.Bind(1, std::int64_t{static_cast<int>(BLOCK_PART::RunNodes)});
    for (const T_RUN_ROW& row : rows) // in the order of their keys
        for (const T_RUN_PART& part : kRunParts)
            for (int chunk = 0; chunk < RunChunks(row, part); ++chunk)
                for (int step = 0; step < (part.block == 0 ? 1 : row.steps); ++step) {
                    const T_BLOCK_KEY key = RunKey(row, part.part, chunk, step);
                    if (!stmt.Step()) ThrowBadBlock(key);
                    CheckedBlock(stmt, key, RunChunkNumbers(row, part, chunk));
                }
    if (stmt.Step()) ThrowDamaged(kBlockTable);
}
