// Reads static results of a load combination: superposes what is asked for and nothing else.
#pragma once

#include "qm_db/datactrl.h"

#include <string>
#include <unordered_map>
#include <vector>

/// Values are SI. Results that are missing, or older than the model, are refused with the load
/// case named. Selecting is O(1); a combination is flattened, and its cases are judged, with the
/// first read after selecting it or after a change of the model.
class CStaticReader {
public:
    explicit CStaticReader(const CDataCtrl& data) : m_data(data) {}

    void Select(T_LCOM_D combination);
    /// 1 done; 0 there is no such combination, the selection is as it was.
    [[nodiscard]] int SelectKey(int combination);

    /// 1 done; 0 Error says why, output as it was.
    [[nodiscard]] int ReadDisplacement(int node, T_DOF6& out);
    [[nodiscard]] int ReadReaction(int node, T_DOF6& out);
    [[nodiscard]] int ReadForces(int element, T_ELEM_FORCES& out);
    /// Are there results of the load case that belong to the model as it is? 0: Error says why.
    [[nodiscard]] int CheckCase(int loadCase);
    const std::string& Error() const { return m_error; }

private:
    struct T_TERM {
        int loadCase = 0;
        double factor = 0.0;
        IStaticResult* source = nullptr;
    };
    void Refresh();
    bool Prepare();
    int Fail(const char* key, const std::string& first, const std::string& second = {});
    std::string NameOf(int loadCase) const;
    template <class T, class F>
    int Superpose(const char* what, int id, T& out, const F& read);

    const CDataCtrl& m_data;
    T_LCOM_D m_combination; // selected, when m_key is 0
    int m_key = 0;          // of the selected one
    bool m_isPrepared = false;
    std::vector<T_TERM> m_terms;
    long m_revision = -1; // of the data that the rest belongs to
    std::uint64_t m_structure = 0;
    std::unordered_map<int, std::string> m_judged; // by load case: why not, empty: all well
    std::string m_error;
};
