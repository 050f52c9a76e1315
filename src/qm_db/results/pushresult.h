// Results of a pushover analysis: per step the load factor, the base reaction and displacements.
// Everything is in SI and in the control direction of the load case; index 0 is step 1.
#pragma once

#include <map>
#include <memory>
#include <string>
#include <vector>

class IPushRun;

/// What the evaluation reads. A file-backed source reads a node only when it is asked for.
class IPushResult {
public:
    IPushResult() = default;
    IPushResult(const IPushResult&) = delete;
    IPushResult& operator=(const IPushResult&) = delete;
    virtual ~IPushResult() = default;

    virtual int StepCount() const = 0;
    virtual std::vector<int> NodeIds() const = 0; // ascending
    virtual bool HasNode(int node) const = 0;
    /// One value per step. 1 done; 0 the data can't be read (see Error), output cleared.
    [[nodiscard]] virtual int ReadLoadFactors(std::vector<double>& out) = 0;
    [[nodiscard]] virtual int ReadBaseReactions(std::vector<double>& out) = 0;
    [[nodiscard]] virtual int ReadDisplacements(int node, std::vector<double>& out) = 0;
    /// The run of our own that these results are of; null: another solver's.
    virtual IPushRun* Run() { return nullptr; }
    /// Why the last read failed: file, block and reason; empty after a success.
    virtual std::string Error() const { return {}; }
};

/// Results held in memory.
struct T_PUSH_DATA {
    std::vector<double> loadFactor;
    std::vector<double> baseReaction;
    std::map<int, std::vector<double>> displacement; // by node id, one value per step
    bool operator==(const T_PUSH_DATA&) const = default;
};

/// A source over results in memory.
std::shared_ptr<IPushResult> MakePushResult(T_PUSH_DATA data);
/// Reads every node of a source. 1 done; 0 a read failed (error filled), output cleared.
[[nodiscard]] int ReadWholeResult(IPushResult& source, T_PUSH_DATA& out, std::string& error);

/// Result sources by the key of the pushover load case.
using T_RESULT_MAP = std::map<int, std::shared_ptr<IPushResult>>;
