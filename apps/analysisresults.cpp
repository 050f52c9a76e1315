#include "analysisresults.h"

#include <algorithm>
#include <set>

namespace {

/// No "-0" in tables and files.
T_DOF6 Tidy(T_DOF6 v)
{
    for (double& x : v)
        x += 0.0;
    return v;
}

/// Nodes that the ground holds: restrained by themselves (not by the model's plane) or by springs.
std::set<int> HeldNodes(const T_MODEL& model)
{
    std::set<int> held;
    for (const auto& [id, node] : model.nodes) {
        if (std::ranges::any_of(node.restraint, [](int r) { return r != 0; })) held.insert(id);
    }
    for (const auto& [id, e] : model.elements) {
        if (e.kind == ELEM_KIND::Spring) held.insert(e.nodeI);
    }
    return held;
}

bool ReadNodes(CDBDoc& doc, T_CASE_RESULTS& out)
{
    const std::set<int> held = HeldNodes(doc.Data().Model());
    for (const auto& entry : doc.Data().Model().nodes) {
        const int id = entry.first;
        T_DOF6 value{};
        if (!doc.Post().GetDispNew(id, value)) return false;
        out.displacements.push_back({id, Tidy(value)});
        if (!held.contains(id)) continue;
        if (!doc.Post().GetReacNew(id, value)) return false;
        out.reactions.push_back({id, Tidy(value)});
    }
    return true;
}

bool ReadElements(CDBDoc& doc, T_CASE_RESULTS& out)
{
    for (const auto& [id, e] : doc.Data().Model().elements) {
        if (e.kind == ELEM_KIND::Truss) {
            double axial = 0.0;
            if (!doc.Post().GetStrtNew(id, axial)) return false;
            out.trusses.push_back({id, axial + 0.0});
        }
        if (e.kind != ELEM_KIND::Beam) continue;
        T_BEAM_ROWS rows{};
        for (std::size_t p = 0; p < rows.size(); ++p) {
            if (!doc.Post().GetStrbNew(id, static_cast<int>(p), rows[p])) return false;
            rows[p] = Tidy(rows[p]);
        }
        out.beams.push_back({id, rows});
    }
    return true;
}

} // namespace

bool FindShownCases(CDBDoc& doc, const std::vector<std::string>& names,
                    std::vector<T_SHOWN_CASE>& out, std::string& error)
{
    if (names.empty()) {
        for (const auto& [key, record] : doc.Data().Model().loadCases)
            out.push_back({record.name, CPostCtrl::MakeLoadComb(key)});
        if (out.empty()) error = "no load cases";
        return !out.empty();
    }
    for (const std::string& name : names) {
        int key = 0;
        T_LCOM_D combination;
        if (doc.Attr().FindStld(name, key))
            out.push_back({name, CPostCtrl::MakeLoadComb(key)});
        else if (doc.Attr().GetLcom_(name, combination))
            out.push_back({name, combination});
        else
            error = "no load case or combination named \"" + name + "\"";
    }
    return error.empty();
}

bool LoadCasesOf(CDBDoc& doc, const std::vector<T_SHOWN_CASE>& shown, std::vector<int>& out,
                 std::string& error)
{
    std::set<int> keys;
    for (const T_SHOWN_CASE& s : shown) {
        T_LCOM_D flat;
        if (!doc.Attr().NormalizeLcom(s.combination, flat, error)) return false;
        for (const T_LCOM_ITEM& item : flat.items)
            keys.insert(item.key);
    }
    out.assign(keys.begin(), keys.end());
    return true;
}

bool ReadCaseResults(CDBDoc& doc, const T_SHOWN_CASE& shown, T_CASE_RESULTS& out,
                     std::string& error)
{
    if (doc.Post().SelectLoadCombNew(shown.combination) && ReadNodes(doc, out) &&
        ReadElements(doc, out))
        return true;
    error = doc.Post().Error();
    return false;
}

std::vector<T_MODE_RESULTS> ReadModes(CDBDoc& doc)
{
    std::vector<T_MODE_RESULTS> out;
    const int count = doc.Post().GetNumEigvPost();
    for (int mode = 1; mode <= count; ++mode) {
        T_MODE_RESULTS& m = out.emplace_back();
        T_MPAF_D factor;
        T_MPAM_D percent;
        if (!doc.Post().SelectMode(mode) || !doc.Post().GetEiMpafNeutral(mode, factor) ||
            !doc.Post().GetEiMpam(mode, percent))
            continue;
        m.period = doc.Data().Model().modes.at(mode).period;
        m.participation = Tidy(factor.factor);
        m.massPercent = Tidy(percent.percent);
        for (const auto& entry : doc.Data().Model().nodes) {
            T_DOF6 shape{};
            doc.Post().GetEiMode(entry.first, shape);
            m.shape.push_back({entry.first, Tidy(shape)});
        }
    }
    return out;
}
