#include "qm_db/results/staticresult.h"

#include <algorithm>

namespace {

template <class T>
int Find(const std::vector<int>& ids, const std::vector<T>& values, int id, T& out)
{
    const auto it = std::lower_bound(ids.begin(), ids.end(), id);
    if (it == ids.end() || *it != id) return 0;
    out = values[static_cast<std::size_t>(it - ids.begin())];
    return 1;
}

class CMemoryStaticResult : public IStaticResult {
public:
    explicit CMemoryStaticResult(T_STATIC_DATA data) : m_data(std::move(data)) {}

    std::uint64_t Fingerprint() const override { return m_data.fingerprint; }
    int ReadDisplacement(int node, T_DOF6& out) override
    {
        return Find(m_data.nodes, m_data.displacement, node, out);
    }
    int ReadReaction(int node, T_DOF6& out) override
    {
        return Find(m_data.nodes, m_data.reaction, node, out);
    }
    int ReadForces(int element, T_ELEM_FORCES& out) override
    {
        return Find(m_data.elements, m_data.force, element, out);
    }
    int ReadAll(T_STATIC_DATA& out) override
    {
        out = m_data;
        return 1;
    }

private:
    T_STATIC_DATA m_data;
};

} // namespace

std::shared_ptr<IStaticResult> MakeStaticResult(T_STATIC_DATA data)
{
    return std::make_shared<CMemoryStaticResult>(std::move(data));
}
