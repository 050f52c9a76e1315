#include "qm_db/store/recordcodec.h"

#include "qm_db/file/checksum.h"
#include "qm_db/file/storefault.h"
#include "qm_db/store/recordcodecelements.h"
#include "qm_db/store/recordcodecfields.h"

#include <algorithm>
#include <cstring>

namespace {

constexpr std::size_t kChunkNodes = 512; // nodes that are packed together
constexpr const char* kNodes = "nodes";  // owner of their arrays; the key is the chunk

// One Fields() per record: each names its columns once, for writing and for reading.

template <class V>
void Fields(V& v, typename V::template Ref<T_STYP_D> r)
{
    v("title", r.title);
    v("force_unit", r.units.force);
    v("length_unit", r.units.length);
    v("gravity", r.gravity);
    v("concrete_code", r.designCodes.concrete);
    v("steel_code", r.designCodes.steel);
    v("alternative_hysteresis", r.alternativeHysteresis);
    v("wall_strength_degradation", r.wallStrengthDegradation);
    v("gsd", r.gsd);
    v("plane", r.plane);
    v.BodyIf(r.stageControl, r.stageControl != T_STCT_D{});
}

template <class V>
void Fields(V& v, typename V::template Ref<T_STOR_D> r)
{
    v("name", r.name);
    v("height", r.height);
    v.Array("nodes", r.nodes);
}

template <class V>
void Fields(V& v, typename V::template Ref<T_SPFC_ATC40> r)
{
    v("Ca", r.Ca);
    v("Cv", r.Cv);
    v("floors", r.floors);
}

template <class V>
void Fields(V& v, typename V::template Ref<T_SPFC_EURO2003> r)
{
    v("type", r.type);
    v("soil", r.soil);
    v("ag", r.ag);
    v("damping", r.damping);
    v("S", r.S);
    v("TB", r.TB);
    v("TC", r.TC);
    v("TD", r.TD);
}

template <class V>
void Fields(V& v, typename V::template Ref<T_SPFC_EURO1996> r)
{
    v("soil", r.soil);
    v("ag", r.ag);
    v("damping", r.damping);
}

template <class V>
void Fields(V& v, typename V::template Ref<T_SPFC_NTC> r)
{
    v("soil", r.soil);
    v("topography", r.topography);
    v("damping", r.damping);
    for (std::size_t i = 0; i < r.states.size(); ++i) {
        const std::string state = kLimitStateNames[i];
        if (!v.Part(state + "_ag", r.states[i])) continue;
        v(state + "_ag", r.states[i]->ag);
        v(state + "_F0", r.states[i]->F0);
        v(state + "_TCstar", r.states[i]->TCstar);
    }
}

template <class V>
void Fields(V& v, typename V::template Ref<T_SPFC_USER> r)
{
    v.Array("T", r.T);
    v.Array("Sa", r.Sa);
    v("gravity", r.gravity);
}

template <class V>
void Fields(V& v, typename V::template Ref<T_SPFC_D> r)
{
    v("name", r.name);
    v.Kind(r);
    std::visit([&](auto& data) { Fields(v, data); }, r.data);
}

template <class V>
void Fields(V& v, typename V::template Ref<T_POLC_D> r)
{
    v("name", r.name);
    v("control_node", r.controlNode);
    v("direction", r.direction);
    v("pattern_kind", r.patternKind);
    v.Array("modes", r.modes);
    v.BodyIf(r, r.control || !r.patterns.empty());
}

template <class V>
void Fields(V& v, typename V::template Ref<T_POFC_D> r)
{
    v("name", r.name);
    v.Array("step", r.step);
    v.Array("factor", r.factor);
}

// Records with a name and a body.
template <class V>
void Fields(V& v, typename V::template Ref<T_MATL_D> r)
{
    v("name", r.name);
    v.Body(r);
}
template <class V>
void Fields(V& v, typename V::template Ref<T_SECT_D> r)
{
    v("name", r.name);
    v.Body(r);
}
template <class V>
void Fields(V& v, typename V::template Ref<T_PHGT_D> r)
{
    v("name", r.name);
    v.Body(r);
}
template <class V>
void Fields(V& v, typename V::template Ref<T_IEHP_D> r)
{
    v("name", r.name);
    v.Body(r);
}

template <class V>
void Fields(V& v, typename V::template Ref<T_STLD_D> r)
{
    v("name", r.name);
    v.Body(r);
}
template <class V>
void Fields(V& v, typename V::template Ref<T_LCOM_D> r)
{
    v("name", r.name);
    v.Body(r);
}
template <class V>
void Fields(V& v, typename V::template Ref<T_ULFC_D> r)
{
    v("name", r.name);
    v.Body(r);
}
template <class V>
void Fields(V& v, typename V::template Ref<T_ULFI_D> r)
{
    v("name", r.name);
    v.Body(r);
}
template <class V>
void Fields(V& v, typename V::template Ref<T_STAG_D> r)
{
    v("name", r.name);
    v.Body(r);
}
template <class V>
void Fields(V& v, typename V::template Ref<T_ULSI_D> r)
{
    v("name", r.name);
    v.Body(r);
}
template <class V>
void Fields(V& v, typename V::template Ref<T_DIAP_D> r)
{
    v.Body(r);
}
template <class V>
void Fields(V& v, typename V::template Ref<T_EQDS_D> r)
{
    v.Body(r);
}

template <class V>
void Fields(V& v, typename V::template Ref<T_EVAL_BILINEAR> r)
{
    v("bilinear_rule", r.rule);
    v("bilinear_secant", r.secant);
    v("bilinear_drop", r.drop);
    v("bilinear_iterate", r.iterate);
}

template <class V>
void Fields(V& v, typename V::template Ref<T_EVAL_D> r)
{
    v("name", r.name);
    v("push", r.push);
    v("method", r.method);
    v("procedure", r.procedure);
    v("spectrum", r.spectrum);
    v("behavior", r.behavior);
    v("elastic_damping", r.elasticDamping);
    v.Array("user_damping", r.userDamping);
    v("eigen_factors", r.eigenFactors);
    v("masonry", r.masonry);
    v("drift_kind", r.driftKind);
    v("plot_type", r.plotType);
    v("alpha_in_percent", r.alphaInPercent);
    v.Flag("has_bilinear", r.bilinear);
    if (r.bilinear) Fields(v, *r.bilinear);
}

template <class V>
void Fields(V& v, typename V::template Ref<T_POVR_D> r)
{
    v.Array("ec8", r.ec8);
    v.Array("ntc", r.ntc);
}

/// A mode's shape is two arrays: node ids, and six components per node.
void PutShape(const T_EIGV_D& mode, std::int64_t key, CPackedArrays& arrays)
{
    std::vector<int> nodes;
    std::vector<double> shape;
    for (const auto& [node, components] : mode.shape) {
        nodes.push_back(node);
        shape.insert(shape.end(), components.begin(), components.end());
    }
    arrays.Put("modes", key, "shape_nodes", nodes);
    arrays.Put("modes", key, "shape", shape);
}

void GetShape(T_EIGV_D& mode, const CRecordRow& row, const CPackedArrays& arrays)
{
    const std::vector<int> nodes = arrays.Ints("modes", row.Key(), "shape_nodes");
    const std::vector<double> shape = arrays.Doubles("modes", row.Key(), "shape");
    if (shape.size() != nodes.size() * std::tuple_size_v<T_DOF6>) row.ThrowBadCell("shape");
    auto from = shape.begin();
    for (const int node : nodes) {
        T_DOF6& components = mode.shape.emplace_hint(mode.shape.end(), node, T_DOF6{})->second;
        std::copy_n(from, components.size(), components.begin());
        from += static_cast<std::ptrdiff_t>(components.size());
    }
}

void Fields(CFieldPut& v, const T_EIGV_D& r)
{
    v("period", r.period);
    v.Array("participation", r.participation);
    v.Array("mass_percent", r.massPercent);
    PutShape(r, v.Row().Key(), v.Arrays());
}

void Fields(CFieldGet& v, T_EIGV_D& r)
{
    v("period", r.period);
    v.Array("participation", r.participation);
    v.Array("mass_percent", r.massPercent);
    GetShape(r, v.Row(), v.Arrays());
}

template <class R>
void WriteRecord(const CSqliteDb& db, const char* table, int key, const R& record,
                 CPackedArrays& arrays)
{
    CRecordRow row(table, key);
    CFieldPut put(row, arrays);
    Fields(put, record);
    row.Insert(db);
}

template <class R>
void WriteTable(const CSqliteDb& db, const char* table, const T_TABLE<R>& records,
                CPackedArrays& arrays)
{
    for (const auto& [key, record] : records)
        WriteRecord(db, table, key, record, arrays);
}

template <class R>
T_TABLE<R> ReadTable(const CSqliteDb& db, const char* table, const CPackedArrays& arrays,
                     T_TABLE_SUMS& sums)
{
    T_TABLE<R> records;
    CChecksum sum;
    for (const CRecordRow& row : CRecordRow::ReadAll(db, table, sum)) {
        const auto key = static_cast<int>(row.Key());
        if (key != row.Key()) row.ThrowBadCell("key");
        CFieldGet get(row, arrays);
        Fields(get, records[key]);
    }
    sums[table] = sum.Value();
    return records;
}

void PutNodes(const T_TABLE<T_NODE_D>& nodes, CPackedArrays& arrays)
{
    auto node = nodes.begin();
    for (std::int64_t chunk = 0; node != nodes.end(); ++chunk) {
        std::vector<int> ids, restraint;
        std::vector<double> xyz, mass;
        for (; node != nodes.end() && ids.size() < kChunkNodes; ++node) {
            const T_NODE_D& n = node->second;
            ids.push_back(n.id);
            xyz.insert(xyz.end(), n.xyz.begin(), n.xyz.end());
            mass.insert(mass.end(), n.mass.begin(), n.mass.end());
            restraint.insert(restraint.end(), n.restraint.begin(), n.restraint.end());
        }
        arrays.Put(kNodes, chunk, "id", ids);
        arrays.Put(kNodes, chunk, "xyz", xyz);
        arrays.Put(kNodes, chunk, "mass", mass);
        // Most nodes have no restraint: a chunk without any has no array of them.
        if (std::any_of(restraint.begin(), restraint.end(), [](int flag) { return flag != 0; }))
            arrays.Put(kNodes, chunk, "restraint", restraint);
    }
}

/// Takes the n-th group of as many packed numbers as `to` has.
template <class T, std::size_t N>
void TakeGroup(std::span<const std::byte> from, std::size_t n, std::array<T, N>& to)
{
    std::memcpy(to.data(), from.data() + n * sizeof to, sizeof to);
}

void GetNodeChunk(const CPackedArrays& arrays, std::int64_t chunk, T_TABLE<T_NODE_D>& nodes)
{
    if (static_cast<std::size_t>(chunk) * kChunkNodes != nodes.size())
        ThrowDamaged(kNodes + (' ' + std::to_string(chunk)));
    const std::vector<int> ids = arrays.Ints(kNodes, chunk, "id");
    const auto xyz = arrays.Bytes(kNodes, chunk, "xyz", 'f');
    const auto mass = arrays.Bytes(kNodes, chunk, "mass", 'f');
    const auto restraint = arrays.Bytes(kNodes, chunk, "restraint", 'i');
    if (xyz.size() != ids.size() * sizeof(T_NODE_D::xyz) ||
        mass.size() != ids.size() * sizeof(T_NODE_D::mass) ||
        (!restraint.empty() && restraint.size() != ids.size() * sizeof(T_NODE_D::restraint)))
        ThrowDamaged(kNodes + (' ' + std::to_string(chunk)));
    for (std::size_t i = 0; i < ids.size(); ++i) {
        T_NODE_D& node = nodes.try_emplace(nodes.end(), ids[i])->second;
        node.id = ids[i];
        TakeGroup(xyz, i, node.xyz);
        TakeGroup(mass, i, node.mass);
        if (!restraint.empty()) TakeGroup(restraint, i, node.restraint);
    }
}

// Generated hinges are many and small: a few packed lists for all of them.
constexpr const char* kHinges = "hinges";
constexpr std::size_t kHingeWidth = 3; // key, element, type
constexpr std::size_t kStrengthWidth = sizeof(T_PHGE_D::crack) / sizeof(double); // crack; yield

void PutHinges(const T_TABLE<T_PHGE_D>& hinges, CPackedArrays& arrays)
{
    std::vector<int> refs;
    std::vector<double> crack, yield;
    for (const auto& [key, hinge] : hinges) {
        refs.insert(refs.end(), {key, hinge.element, hinge.hingeType});
        for (std::size_t i = 0; i < hinge.crack.size(); ++i) {
            crack.insert(crack.end(), {hinge.crack[i].pos, hinge.crack[i].neg});
            yield.insert(yield.end(), {hinge.yield[i].pos, hinge.yield[i].neg});
        }
    }
    if (refs.empty()) return;
    arrays.Put(kHinges, 0, "refs", refs);
    arrays.Put(kHinges, 0, "crack", crack);
    arrays.Put(kHinges, 0, "yield", yield);
}

void GetHinges(const CPackedArrays& arrays, T_TABLE<T_PHGE_D>& hinges)
{
    const std::vector<int> refs = arrays.Ints(kHinges, 0, "refs");
    const std::vector<double> crack = arrays.Doubles(kHinges, 0, "crack");
    const std::vector<double> yield = arrays.Doubles(kHinges, 0, "yield");
    const std::size_t count = refs.size() / kHingeWidth;
    if (refs.size() % kHingeWidth != 0 || crack.size() != count * kStrengthWidth ||
        yield.size() != crack.size())
        ThrowDamaged(kHinges);
    for (std::size_t i = 0; i < count; ++i) {
        const int* const from = &refs[i * kHingeWidth];
        T_PHGE_D& hinge = hinges.try_emplace(hinges.end(), from[0])->second;
        hinge.element = from[1];
        hinge.hingeType = from[2];
        for (std::size_t c = 0; c < hinge.crack.size(); ++c) {
            const std::size_t at = i * kStrengthWidth + 2 * c;
            hinge.crack[c] = {crack[at], crack[at + 1]};
            hinge.yield[c] = {yield[at], yield[at + 1]};
        }
    }
}

} // namespace

void WriteModel(const CSqliteDb& db, const T_MODEL& model)
{
    CPackedArrays arrays;
    PutNodes(model.nodes, arrays);
    PutElements(model.elements, arrays);
    PutHinges(model.hinges, arrays);
    WriteRecord(db, "model", 1, model.styp, arrays);
    WriteTable(db, "storeys", model.storeys, arrays);
    WriteTable(db, "modes", model.modes, arrays);
    WriteTable(db, "spectra", model.spectra, arrays);
    WriteTable(db, "pushovers", model.pushovers, arrays);
    WriteTable(db, "evaluations", model.evaluations, arrays);
    WriteTable(db, "limit_state_steps", model.poverSteps, arrays);
    WriteTable(db, "materials", model.materials, arrays);
    WriteTable(db, "sections", model.sections, arrays);
    WriteTable(db, "hinge_types", model.hingeTypes, arrays);
    WriteTable(db, "inelastic_hinges", model.inelasticHinges, arrays);
    WriteTable(db, "increment_functions", model.incrementFunctions, arrays);
    WriteTable(db, "diaphragms", model.diaphragms, arrays);
    WriteTable(db, "equal_displacements", model.equalDisplacements, arrays);
    WriteTable(db, "load_cases", model.loadCases, arrays);
    WriteTable(db, "combinations", model.combinations, arrays);
    WriteTable(db, "ulf_constraints", model.ulfConstraints, arrays);
    WriteTable(db, "ulf_items", model.ulfItems, arrays);
    WriteTable(db, "stages", model.stages, arrays);
    WriteTable(db, "ulf_stage_items", model.ulfStageItems, arrays);
    arrays.Write(db);
}

T_MODEL ReadModel(const CSqliteDb& db, T_TABLE_SUMS& sums)
{
    T_MODEL model;
    CChecksum arraySum;
    const CPackedArrays arrays = CPackedArrays::Read(
        db, arraySum, kNodes, [&](const CPackedArrays& some, std::int64_t chunk) {
            GetNodeChunk(some, chunk, model.nodes);
        });
    sums["arrays"] = arraySum.Value();

    const T_TABLE<T_STYP_D> styp = ReadTable<T_STYP_D>(db, "model", arrays, sums);
    if (styp.size() != 1 || styp.begin()->first != 1) ThrowDamaged("model");
    model.styp = styp.begin()->second;
    model.storeys = ReadTable<T_STOR_D>(db, "storeys", arrays, sums);
    model.modes = ReadTable<T_EIGV_D>(db, "modes", arrays, sums);
    model.spectra = ReadTable<T_SPFC_D>(db, "spectra", arrays, sums);
    model.pushovers = ReadTable<T_POLC_D>(db, "pushovers", arrays, sums);
    model.evaluations = ReadTable<T_EVAL_D>(db, "evaluations", arrays, sums);
    model.poverSteps = ReadTable<T_POVR_D>(db, "limit_state_steps", arrays, sums);
    model.materials = ReadTable<T_MATL_D>(db, "materials", arrays, sums);
    model.sections = ReadTable<T_SECT_D>(db, "sections", arrays, sums);
    model.hingeTypes = ReadTable<T_PHGT_D>(db, "hinge_types", arrays, sums);
    model.inelasticHinges = ReadTable<T_IEHP_D>(db, "inelastic_hinges", arrays, sums);
    model.incrementFunctions = ReadTable<T_POFC_D>(db, "increment_functions", arrays, sums);
    model.diaphragms = ReadTable<T_DIAP_D>(db, "diaphragms", arrays, sums);
    model.equalDisplacements = ReadTable<T_EQDS_D>(db, "equal_displacements", arrays, sums);
    model.loadCases = ReadTable<T_STLD_D>(db, "load_cases", arrays, sums);
    model.combinations = ReadTable<T_LCOM_D>(db, "combinations", arrays, sums);
    model.ulfConstraints = ReadTable<T_ULFC_D>(db, "ulf_constraints", arrays, sums);
    model.ulfItems = ReadTable<T_ULFI_D>(db, "ulf_items", arrays, sums);
    model.stages = ReadTable<T_STAG_D>(db, "stages", arrays, sums);
    model.ulfStageItems = ReadTable<T_ULSI_D>(db, "ulf_stage_items", arrays, sums);
    GetElements(arrays, model.elements);
    GetHinges(arrays, model.hinges);
    return model;
}
