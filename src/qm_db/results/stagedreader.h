// Reads results of construction stages: selected first, opened with the first value asked for.
#pragma once

#include "qm_db/datactrl.h"

/// Values are SI. Results that are missing, or older than the model, are refused. What has been
/// selected before is kept (up to a limit of memory) until the data change. Sums of load cases that
/// come apart are added up as they are read: the results of cases superpose.
class CStagedReader {
public:
    explicit CStagedReader(const CDataCtrl& data) : m_data(data) {}

    /// O(1); judged with the first read.
    void Select(const T_STAGE_CHOICE& choice);
    /// 1 done; 0 Error says why, output as it was.
    [[nodiscard]] int ReadDisplacement(int node, T_DOF6& out);
    [[nodiscard]] int ReadReaction(int node, T_DOF6& out);
    [[nodiscard]] int ReadForces(int element, T_ELEM_FORCES& out);
    /// Are there results of the stages as they are? 0: Error says why.
    [[nodiscard]] int Check();
    const std::string& Error() const { return m_error; }

private:
    using T_TERMS = std::vector<std::shared_ptr<IStaticResult>>; // of a sum
    bool CheckChoice(const T_STAG_D*& stage);
    const T_TERMS* Prepare();
    int Fail(const char* key, std::initializer_list<std::string_view> args = {});
    template <class T>
    int Read(int (IStaticResult::*read)(int, T&), bool isInModel, const char* none, int id, T& out);

    const CDataCtrl& m_data;
    T_STAGE_CHOICE m_choice;
    const T_TERMS* m_selected = nullptr; // in m_kept
    std::map<T_STAGE_CHOICE, T_TERMS> m_kept;
    long m_revision = -1;              // of the data that the rest belongs to
    std::optional<bool> m_isCurrent{}; // the results belong to the model as it is
    std::string m_error;
};
