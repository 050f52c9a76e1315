#include "qm_solver/frame/constraints.h"

#include "qm_solver/model/frameextent.h"

#include <algorithm>
#include <cmath>

namespace solver {

namespace {

constexpr double kDropped = 1e-12;  // factors below this, relative to the largest, are round-off
constexpr double kPivotShare = 0.1; // the first factor of at least this share becomes the pivot

void AddTerm(T_RELATION& sum, T_TERM term)
{
    const auto at = std::find_if(sum.begin(), sum.end(),
                                 [&](const T_TERM& t) { return t.index == term.index; });
    if (at == sum.end())
        sum.push_back(term);
    else
        at->factor += term.factor;
}

} // namespace

CConstraints::CConstraints(const T_FRAME& frame) : m_frame(frame), m_length(Extent(frame))
{
    for (const T_DIAPHRAGM& diaphragm : frame.diaphragms)
        AddDiaphragm(diaphragm);
    for (const T_EQUAL_DISPLACEMENT& equal : frame.equalDisplacements)
        AddEqual(equal);
}

const T_RELATION* CConstraints::Expression(int full) const
{
    const auto at = m_expression.find(full);
    return at == m_expression.end() ? nullptr : &at->second;
}

/// u_a = u_a0 - theta (b - b0), u_b = u_b0 + theta (a - a0), theta = theta0 for axes a, b in the
/// plane and the normal n = a x b; 0 marks the first node.
void CConstraints::AddDiaphragm(const T_DIAPHRAGM& diaphragm)
{
    const int n = diaphragm.normal, a = (n + 1) % 3, b = (n + 2) % 3;
    if (diaphragm.nodes.empty()) return;
    const int first = 6 * static_cast<int>(diaphragm.nodes[0]);
    const T_VEC3& origin = m_frame.nodes[diaphragm.nodes[0]].xyz;
    for (std::size_t k = 1; k < diaphragm.nodes.size(); ++k) {
        const int node = 6 * static_cast<int>(diaphragm.nodes[k]);
        const T_VEC3& at = m_frame.nodes[diaphragm.nodes[k]].xyz;
        const auto axis = [&](int d) { return static_cast<std::size_t>(d); };
        Eliminate({{node + 3 + n, 1.0}, {first + 3 + n, -1.0}});
        Eliminate(
            {{node + a, 1.0}, {first + a, -1.0}, {first + 3 + n, at[axis(b)] - origin[axis(b)]}});
        Eliminate(
            {{node + b, 1.0}, {first + b, -1.0}, {first + 3 + n, origin[axis(a)] - at[axis(a)]}});
    }
}

void CConstraints::AddEqual(const T_EQUAL_DISPLACEMENT& equal)
{
    for (std::size_t k = 1; k < equal.nodes.size(); ++k)
        for (int d = 0; d < 6; ++d)
            if (equal.directions[static_cast<std::size_t>(d)])
                Eliminate({{6 * static_cast<int>(equal.nodes[k]) + d, 1.0},
                           {6 * static_cast<int>(equal.nodes[0]) + d, -1.0}});
}

void CConstraints::Eliminate(const T_RELATION& relation)
{
    T_RELATION row = Substituted(relation);
    double largest = 0.0;
    for (const T_TERM& t : row)
        if (!IsFixed(t.index)) largest = std::max(largest, Size(t));
    if (largest == 0.0) {
        if (!row.empty()) m_demands.push_back(std::move(row));
        return;
    }
    const auto pivot = std::find_if(row.begin(), row.end(), [&](const T_TERM& t) {
        return !IsFixed(t.index) && Size(t) >= kPivotShare * largest;
    });
    const T_TERM out = *pivot;
    row.erase(pivot);
    for (T_TERM& t : row) {
        t.factor /= -out.factor;
        m_users[t.index].push_back(out.index);
    }
    m_expression[out.index] = std::move(row);

    const std::vector<int> users = std::move(m_users[out.index]);
    m_users.erase(out.index);
    for (const int user : users) {
        T_RELATION& expression = m_expression.at(user);
        expression = Substituted(expression);
        for (const T_TERM& t : expression) {
            std::vector<int>& list = m_users[t.index];
            if (std::find(list.begin(), list.end(), user) == list.end()) list.push_back(user);
        }
    }
}

T_RELATION CConstraints::Substituted(const T_RELATION& relation) const
{
    T_RELATION row;
    double largest = 0.0;
    for (const T_TERM& t : relation) {
        largest = std::max(largest, Size(t));
        if (const T_RELATION* made = Expression(t.index))
            for (const T_TERM& m : *made)
                AddTerm(row, {m.index, t.factor * m.factor});
        else
            AddTerm(row, t);
    }
    std::erase_if(row, [&](const T_TERM& t) { return Size(t) <= kDropped * largest; });
    return row;
}

double CConstraints::Size(const T_TERM& term) const
{
    return std::fabs(term.factor) / (term.index % 6 < 3 ? 1.0 : m_length);
}

bool CConstraints::IsFixed(int full) const
{
    return m_frame.nodes[static_cast<std::size_t>(full / 6)]
        .fixed[static_cast<std::size_t>(full % 6)];
}

} // namespace solver
