#include "qm_solver/frame/frameassembly.h"

#include <algorithm>
#include <limits>

namespace solver {

/// Which blocks share an element, and where a block's columns begin in the rows of another.
class CFrameAssembly::CPattern {
public:
    CPattern(std::span<const int> block, std::span<const int> unknowns,
             std::span<const std::size_t> listFrom)
        : m_block(block)
    {
        for (std::size_t i = 0; i < block.size(); ++i)
            if (i == 0 || block[i] != block[i - 1]) m_first.push_back(static_cast<int>(i));
        m_first.push_back(static_cast<int>(block.size()));
        std::vector<std::pair<int, int>> pairs = Pairs(unknowns, listFrom);
        std::sort(pairs.begin(), pairs.end());
        pairs.erase(std::unique(pairs.begin(), pairs.end()), pairs.end());
        m_start.assign(m_first.size(), 0);
        for (const auto& [row, column] : pairs) {
            ++m_start[static_cast<std::size_t>(row) + 1];
            m_neighbour.push_back(column);
        }
        for (std::size_t b = 1; b < m_start.size(); ++b)
            m_start[b] += m_start[b - 1];
    }

    /// Row starts and columns; false if they can't be counted by an int.
    bool Fill(T_SYMMETRIC_MATRIX& matrix)
    {
        matrix.rowStart.assign(1, 0);
        matrix.column.clear();
        for (std::size_t b = 0; b + 1 < m_first.size(); ++b)
            for (int row = m_first[b]; row < m_first[b + 1]; ++row) {
                AddRun(matrix, row, m_first[b + 1]);
                for (std::size_t k = m_start[b]; k < m_start[b + 1]; ++k) {
                    const std::size_t n = static_cast<std::size_t>(m_neighbour[k]);
                    AddRun(matrix, m_first[n], m_first[n + 1]);
                }
                if (matrix.column.size() > std::numeric_limits<int>::max()) return false;
                matrix.rowStart.push_back(static_cast<int>(matrix.column.size()));
            }
        MakeOffsets();
        m_rowStart = matrix.rowStart;
        return true;
    }

    int Place(int row, int column) const
    {
        const std::size_t rb = Block(row), cb = Block(column);
        const int start = m_rowStart[static_cast<std::size_t>(row)];
        if (rb == cb) return start + column - row;
        const auto from = m_neighbour.begin() + static_cast<long>(m_start[rb]);
        const auto to = m_neighbour.begin() + static_cast<long>(m_start[rb + 1]);
        const auto at = std::lower_bound(from, to, static_cast<int>(cb)) - m_neighbour.begin();
        return start + m_first[rb + 1] - row + m_offset[static_cast<std::size_t>(at)] + column -
               m_first[cb];
    }

private:
    std::size_t Block(int equation) const
    {
        return static_cast<std::size_t>(m_block[static_cast<std::size_t>(equation)]);
    }
    static void AddRun(T_SYMMETRIC_MATRIX& matrix, int from, int to)
    {
        for (int c = from; c < to; ++c)
            matrix.column.push_back(c);
    }
    std::vector<std::pair<int, int>> Pairs(std::span<const int> unknowns,
                                           std::span<const std::size_t> listFrom) const
    {
        std::vector<std::pair<int, int>> pairs;
        std::vector<int> blocks;
        for (std::size_t e = 0; e + 1 < listFrom.size(); ++e) {
            blocks.clear();
            for (std::size_t k = listFrom[e]; k < listFrom[e + 1]; ++k)
                blocks.push_back(static_cast<int>(Block(unknowns[k])));
            std::sort(blocks.begin(), blocks.end());
            blocks.erase(std::unique(blocks.begin(), blocks.end()), blocks.end());
            for (std::size_t i = 0; i < blocks.size(); ++i)
                for (std::size_t j = i + 1; j < blocks.size(); ++j)
                    pairs.emplace_back(blocks[i], blocks[j]);
        }
        return pairs;
    }
    /// Columns of a neighbour begin behind those of the block itself and of nearer neighbours.
    void MakeOffsets()
    {
        m_offset.resize(m_neighbour.size());
        for (std::size_t b = 0; b + 1 < m_first.size(); ++b) {
            int sum = 0;
            for (std::size_t k = m_start[b]; k < m_start[b + 1]; ++k) {
                m_offset[k] = sum;
                const std::size_t n = static_cast<std::size_t>(m_neighbour[k]);
                sum += m_first[n + 1] - m_first[n];
            }
        }
    }

    std::span<const int> m_block;
    std::vector<int> m_first;         // first equation of each block, and the end
    std::vector<std::size_t> m_start; // of each block's neighbours
    std::vector<int> m_neighbour, m_offset, m_rowStart;
};

int CFrameAssembly::Prepare(const T_FRAME& frame, const CFrameDofs& dofs, T_SOLVER_REASON& reason)
{
    ListParts(frame, dofs);
    CPattern pattern(dofs.Blocks(), m_unknowns, m_listFrom);
    if (!pattern.Fill(m_matrix)) {
        reason = "IDS_QM_ENGINE_TOO_MANY_ENTRIES";
        return 0;
    }
    MakePlaces(pattern);
    m_matrix.value.assign(m_matrix.column.size(), 0.0);
    return 1;
}

void CFrameAssembly::ListParts(const T_FRAME& frame, const CFrameDofs& dofs)
{
    *this = {};
    m_listFrom.push_back(0);
    for (const T_ELEMENT& element : frame.elements) {
        T_START start;
        start.part = m_parts.size();
        const auto from = static_cast<long>(m_listFrom.back());
        for (std::size_t local = 0; local < ElementSize(element); ++local)
            for (const T_TERM& t : dofs.Terms(ElementIndex(element, local))) {
                auto at = std::find(m_unknowns.begin() + from, m_unknowns.end(), t.index);
                if (at != m_unknowns.end() || t.factor != 1.0) start.plain = false;
                if (at == m_unknowns.end()) at = m_unknowns.insert(at, t.index);
                m_parts.push_back({static_cast<std::uint16_t>(local),
                                   static_cast<std::uint16_t>(at - m_unknowns.begin() - from),
                                   t.factor});
            }
        // Two terms of one displacement are not plain either.
        for (std::size_t p = start.part + 1; p < m_parts.size(); ++p)
            if (m_parts[p].local == m_parts[p - 1].local) start.plain = false;
        start.unknowns = static_cast<std::uint16_t>(static_cast<long>(m_unknowns.size()) - from);
        m_listFrom.push_back(m_unknowns.size());
        m_starts.push_back(start);
    }
    m_starts.push_back({m_parts.size(), 0, 0, true});
}

void CFrameAssembly::MakePlaces(const CPattern& pattern)
{
    for (std::size_t e = 0; e + 1 < m_starts.size(); ++e) {
        m_starts[e].place = m_places.size();
        const std::span<const int> list(m_unknowns.data() + m_listFrom[e], m_starts[e].unknowns);
        for (std::size_t a = 0; a < list.size(); ++a)
            for (std::size_t b = a; b < list.size(); ++b)
                m_places.push_back(
                    pattern.Place(std::min(list[a], list[b]), std::max(list[a], list[b])));
    }
}

void CFrameAssembly::Assemble(const T_FRAME& frame, std::span<const T_AXIAL> axial)
{
    Assemble([&](std::size_t e, T_MATRIX12& stiffness) {
        ElementStiffness(frame, frame.elements[e], axial.empty() ? T_AXIAL{} : axial[e], stiffness);
    });
}

void CFrameAssembly::Assemble(const std::function<void(std::size_t, T_MATRIX12&)>& elementStiffness)
{
    std::fill(m_matrix.value.begin(), m_matrix.value.end(), 0.0);
    T_MATRIX12 stiffness;
    for (std::size_t e = 0; e + 1 < m_starts.size(); ++e) {
        if (m_starts[e].unknowns == 0) continue;
        elementStiffness(e, stiffness);
        if (m_starts[e].plain)
            AddPlain(e, stiffness);
        else
            AddTransformed(e, stiffness);
    }
}

void CFrameAssembly::AddPlain(std::size_t element, const T_MATRIX12& stiffness)
{
    const T_START& start = m_starts[element];
    const int* place = m_places.data() + start.place;
    const T_PART* parts = m_parts.data() + start.part;
    for (std::size_t a = 0; a < start.unknowns; ++a) {
        const T_VEC12& row = stiffness[parts[a].local];
        for (std::size_t b = a; b < start.unknowns; ++b)
            m_matrix.value[static_cast<std::size_t>(*place++)] += row[parts[b].local];
    }
}

/// Adds B' K B, B being the element's rows of the transformation.
void CFrameAssembly::AddTransformed(std::size_t element, const T_MATRIX12& stiffness)
{
    const T_START& start = m_starts[element];
    const std::span<const T_PART> parts(m_parts.data() + start.part,
                                        m_starts[element + 1].part - start.part);
    const std::size_t n = start.unknowns;
    m_product.assign((12 + n) * n, 0.0);
    double* half = m_product.data(); // K B, 12 x n
    double* full = half + 12 * n;    // n x n
    for (const T_PART& p : parts)
        for (std::size_t i = 0; i < 12; ++i)
            half[i * n + p.unknown] += stiffness[i][p.local] * p.factor;
    for (const T_PART& p : parts)
        for (std::size_t b = 0; b < n; ++b)
            full[p.unknown * n + b] += p.factor * half[p.local * n + b];
    const int* place = m_places.data() + start.place;
    for (std::size_t a = 0; a < n; ++a)
        for (std::size_t b = a; b < n; ++b)
            m_matrix.value[static_cast<std::size_t>(*place++)] += full[a * n + b];
}

} // namespace solver
