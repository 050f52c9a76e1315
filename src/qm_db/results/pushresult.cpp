#include "qm_db/results/pushresult.h"

namespace {

class CMemoryPushResult : public IPushResult {
public:
    explicit CMemoryPushResult(T_PUSH_DATA data) : m_data(std::move(data)) {}

    int StepCount() const override { return static_cast<int>(m_data.loadFactor.size()); }
    bool HasNode(int node) const override { return m_data.displacement.contains(node); }
    std::vector<int> NodeIds() const override
    {
        std::vector<int> ids;
        for (const auto& entry : m_data.displacement)
            ids.push_back(entry.first);
        return ids;
    }
    int ReadLoadFactors(std::vector<double>& out) override
    {
        out = m_data.loadFactor;
        return 1;
    }
    int ReadBaseReactions(std::vector<double>& out) override
    {
        out = m_data.baseReaction;
        return 1;
    }
    int ReadDisplacements(int node, std::vector<double>& out) override
    {
        const auto it = m_data.displacement.find(node);
        if (it == m_data.displacement.end()) {
            out.clear();
            return 0;
        }
        out = it->second;
        return 1;
    }

private:
    T_PUSH_DATA m_data;
};

} // namespace

std::shared_ptr<IPushResult> MakePushResult(T_PUSH_DATA data)
{
    return std::make_shared<CMemoryPushResult>(std::move(data));
}

int ReadWholeResult(IPushResult& source, T_PUSH_DATA& out, std::string& error)
{
    T_PUSH_DATA data;
    bool ok =
        source.ReadLoadFactors(data.loadFactor) && source.ReadBaseReactions(data.baseReaction);
    for (const int node : source.NodeIds())
        ok = ok && source.ReadDisplacements(node, data.displacement[node]);
    error = ok ? std::string() : source.Error();
    out = ok ? std::move(data) : T_PUSH_DATA{};
    return ok ? 1 : 0;
}
