#include "qm_db/results/pushrun.h"

#include <algorithm>

namespace {

class CMemoryPushRun : public IPushRun {
public:
    explicit CMemoryPushRun(T_RUN_DATA data) : m_data(std::move(data)) {}

    int StepCount() const override { return static_cast<int>(m_data.steps.size()); }
    std::vector<int> NodeIds() const override { return m_data.nodes; }
    bool HasNode(int node) const override { return Find(node) < m_data.nodes.size(); }
    const T_RUN_HEAD& Head() const override { return m_data.head; }

    int ReadSteps(std::vector<T_RUN_STEP>& out) override
    {
        out = m_data.steps;
        return 1;
    }
    int ReadEvents(std::vector<T_RUN_EVENT>& out) override
    {
        out = m_data.events;
        return 1;
    }
    int ReadHinges(std::vector<T_RUN_HINGE>& out) override
    {
        out = m_data.hinges;
        return 1;
    }
    int ReadStart(std::vector<T_DOF6>& out) override
    {
        out = m_data.start;
        out.resize(m_data.nodes.size()); // none: at rest
        return 1;
    }
    int ReadNode(int node, std::vector<T_DOF6>& out) override
    {
        return Column(m_data.displacement, Find(node), m_data.nodes.size(), out);
    }
    int ReadShape(int step, std::vector<T_DOF6>& out) override
    {
        return Row(m_data.displacement, step, out);
    }
    int ReadHinge(std::size_t hinge, std::vector<T_RUN_STATE>& out) override
    {
        return Column(m_data.states, hinge, m_data.hinges.size(), out);
    }
    int ReadStates(int step, std::vector<T_RUN_STATE>& out) override
    {
        return Row(m_data.states, step, out);
    }

private:
    /// The number of nodes when it is not there.
    std::size_t Find(int node) const
    {
        const auto it = std::ranges::lower_bound(m_data.nodes, node);
        const bool found = it != m_data.nodes.end() && *it == node;
        return found ? static_cast<std::size_t>(it - m_data.nodes.begin()) : m_data.nodes.size();
    }
    template <class T>
    static int Column(const std::vector<std::vector<T>>& all, std::size_t at, std::size_t count,
                      std::vector<T>& out)
    {
        out.clear();
        if (at >= count) return 0;
        for (const std::vector<T>& step : all)
            out.push_back(step[at]);
        return 1;
    }
    template <class T>
    static int Row(const std::vector<std::vector<T>>& all, int step, std::vector<T>& out)
    {
        out.clear();
        if (step < 1 || static_cast<std::size_t>(step) > all.size()) return 0;
        out = all[static_cast<std::size_t>(step) - 1];
        return 1;
    }

    T_RUN_DATA m_data;
};

} // namespace

std::shared_ptr<IPushRun> MakePushRun(T_RUN_DATA data)
{
    return std::make_shared<CMemoryPushRun>(std::move(data));
}

int IPushRun::ReadOfSteps(double T_RUN_STEP::*member, std::vector<double>& out)
{
    std::vector<T_RUN_STEP> steps;
    out.clear();
    if (!ReadSteps(steps)) return 0;
    for (const T_RUN_STEP& step : steps)
        out.push_back(step.*member);
    return 1;
}

int IPushRun::ReadLoadFactors(std::vector<double>& out)
{
    return ReadOfSteps(&T_RUN_STEP::loadFactor, out);
}

int IPushRun::ReadBaseReactions(std::vector<double>& out)
{
    if (!ReadOfSteps(&T_RUN_STEP::baseReaction, out)) return 0;
    for (double& reaction : out)
        reaction -= Head().startReaction;
    return 1;
}

int IPushRun::ReadDisplacements(int node, std::vector<double>& out)
{
    std::vector<T_DOF6> all, start;
    out.clear();
    const std::vector<int> nodes = NodeIds();
    const auto at = std::ranges::lower_bound(nodes, node);
    if (!ReadNode(node, all) || !ReadStart(start) || at == nodes.end() || *at != node) return 0;
    const T_DOF6& before = start[static_cast<std::size_t>(at - nodes.begin())];
    for (const T_DOF6& u : all) {
        double along = 0.0;
        for (std::size_t i = 0; i < u.size(); ++i)
            along += Head().control[i] * (u[i] - before[i]);
        out.push_back(along);
    }
    return 1;
}

int ReadWholeRun(IPushRun& source, T_RUN_DATA& out, std::string& error)
{
    T_RUN_DATA data;
    data.head = source.Head();
    data.nodes = source.NodeIds();
    bool ok = source.Error().empty() && source.ReadHinges(data.hinges) &&
              source.ReadSteps(data.steps) && source.ReadEvents(data.events) &&
              source.ReadStart(data.start);
    for (int step = 1; ok && step <= source.StepCount(); ++step)
        ok = source.ReadShape(step, data.displacement.emplace_back()) &&
             source.ReadStates(step, data.states.emplace_back());
    error = ok ? std::string() : source.Error();
    out = ok ? std::move(data) : T_RUN_DATA{};
    return ok ? 1 : 0;
}
