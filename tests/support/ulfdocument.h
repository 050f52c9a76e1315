// A document with a beam of five spans that stands on props: nodes 1 to 6 at x = 0 to 5, beams 1 to
// 5 between them, a truss 6 from node 1 to node 6. Load case 1 "W" is a uniform load, 2 to 5 "P1"
// to "P4" are unit props at nodes 2 to 5. The results are closed-form simple-beam ones, with
// w = L = EI = 1: displacements DZ of the nodes and moments at the J-ends of beams 1 to 4.
#pragma once

#include "qm_db/dbdoc.h"
#include "qm_db/results/fingerprint.h"

namespace five {

constexpr double kDisplacement[4][4] = {{16. / 15, 3. / 2, 4. / 3, 23. / 30},
                                        {3. / 2, 12. / 5, 34. / 15, 4. / 3},
                                        {4. / 3, 34. / 15, 12. / 5, 3. / 2},
                                        {23. / 30, 4. / 3, 3. / 2, 16. / 15}};
constexpr double kSag[4] = {29. / 6, 31. / 4, 31. / 4, 29. / 6};
constexpr double kMoment[4][4] = {{4. / 5, 3. / 5, 2. / 5, 1. / 5},
                                  {3. / 5, 6. / 5, 4. / 5, 2. / 5},
                                  {2. / 5, 4. / 5, 6. / 5, 3. / 5},
                                  {1. / 5, 2. / 5, 3. / 5, 4. / 5}};
constexpr double kSimpleMoment[4] = {2, 3, 3, 2};
/// Continuous beam on six supports: reactions of the props, moments over them (three-moment
/// equations; textbooks print 1.132 and 0.974).
constexpr double kProps[4] = {43. / 38, 37. / 38, 37. / 38, 43. / 38};
constexpr double kSupportMoment[4] = {-2. / 19, -3. / 38, -3. / 38, -2. / 19};

inline T_ULFC_D Equal(const std::string& name, ULFC_TYPE type, int id, double value)
{
    T_ULFC_D c;
    c.name = name;
    c.type = type;
    c.id = id;
    c.position = type == ULFC_TYPE::Beam ? 4 : 0;
    c.component = type == ULFC_TYPE::Beam ? 4 : 2;
    c.value = value;
    return c;
}

inline T_ULFC_D Between(T_ULFC_D c, std::optional<double> upper, std::optional<double> lower)
{
    c.inequality = true;
    c.upper = upper;
    c.lower = lower;
    return c;
}

inline T_STATIC_DATA Results(std::uint64_t fingerprint, int loadCase)
{
    T_STATIC_DATA data;
    data.fingerprint = fingerprint;
    for (int node = 1; node <= 6; ++node) {
        T_DOF6 u{};
        const std::size_t at = static_cast<std::size_t>(node) - 2;
        if (node > 1 && node < 6)
            u[2] = loadCase == 1 ? -kSag[at]
                                 : kDisplacement[at][static_cast<std::size_t>(loadCase) - 2];
        data.nodes.push_back(node);
        data.displacement.push_back(u);
        data.reaction.push_back({});
    }
    for (int element = 1; element <= 6; ++element) {
        T_ELEM_FORCES f{};
        const std::size_t at = static_cast<std::size_t>(element) - 1;
        if (at < 4)
            f[4][4] = loadCase == 1 ? kSimpleMoment[at]
                                    : -kMoment[at][static_cast<std::size_t>(loadCase) - 2];
        data.elements.push_back(element);
        data.force.push_back(f);
    }
    return data;
}

/// SI units. Combination 1 "C1": W with factor 1, the props with 1. Constraints "D2" to "D5" (no
/// displacement over the props) and "M1" to "M4" (moments of the continuous beam). Item 1 "T1"
/// finds the props from D2 to D5.
inline void Fill(CDBDoc& doc)
{
    T_MODEL_CONTENT content;
    T_MODEL& m = content.model;
    m.styp.units = {FORCE_UNIT::N, LENGTH_UNIT::m};
    for (int i = 1; i <= 6; ++i) {
        m.nodes[i].id = i;
        m.nodes[i].xyz = {i - 1.0, 0, 0};
        T_ELEM_D& e = m.elements[i];
        e.id = i;
        e.nodeI = i == 6 ? 1 : i;
        e.nodeJ = i == 6 ? 6 : i + 1;
        e.kind = i == 6 ? ELEM_KIND::Truss : ELEM_KIND::Beam;
    }
    m.combinations[1].name = "C1";
    for (int i = 1; i <= 5; ++i) {
        m.loadCases[i].name = i == 1 ? "W" : "P" + std::to_string(i - 1);
        m.loadCases[i].selfWeight = {0, 0, double(i)};
        m.combinations[1].items.push_back({false, i, 1.0});
    }
    m.ulfItems[1] = {"T1", 1, 1, 1, false, {}, {}};
    for (int i = 1; i <= 4; ++i) {
        const std::size_t at = static_cast<std::size_t>(i) - 1;
        const std::string d = "D" + std::to_string(i + 1);
        m.ulfConstraints[i] = Equal(d, ULFC_TYPE::Displacement, i + 1, 0.0);
        m.ulfConstraints[i + 4] =
            Equal("M" + std::to_string(i), ULFC_TYPE::Beam, i, kSupportMoment[at]);
        m.ulfItems[1].unknowns.push_back({i + 1, 1.0});
        m.ulfItems[1].constraints.push_back(d);
    }
    const std::uint64_t structure = FingerprintOfStructure(m);
    for (int i = 1; i <= 5; ++i)
        content.staticResults[i] =
            MakeStaticResult(Results(FingerprintOfCase(structure, m.loadCases[i]), i));
    doc.Data().Assign(std::move(content));
}

} // namespace five
