// Reading the model's records, in the document's current units. 1 found; 0 not, output as it was.
#pragma once

#include "qm_db/datactrl.h"
#include "qm_db/records/hingetype.h"
#include "qm_db/records/recordunits.h"

#include <string>
#include <string_view>
#include <vector>

/// Ids of the elements with a hinge of that type, ascending, each once.
std::vector<int> ElementsWithHingeType(const T_MODEL& model, int hingeType);

/// A step of a construction stage with its names.
struct T_STAG_STEP_INFO {
    int stage = 0; // key
    int step = kStageFirstStep;
    std::string stageName, stepName;
    /// "S1/Last Step"
    std::string Text() const { return stageName + '/' + stepName; }
};

class CAttrCtrl {
public:
    explicit CAttrCtrl(const CDataCtrl& data) : m_data(data) {}

    /// A record of any kind by its key or id.
    template <class R>
    [[nodiscard]] int Get(int key, R& out) const
    {
        const T_TABLE<R>& table = TableOf<R>(m_data.Model());
        const auto it = table.find(key);
        if (it == table.end()) return 0;
        out = it->second;
        RecordFromSi(out, m_data.Units());
        return 1;
    }
    /// Key of the record with that name.
    template <class R>
    [[nodiscard]] int Find(std::string_view name, int& key) const
    {
        for (const auto& [k, record] : TableOf<R>(m_data.Model())) {
            if (record.name != name) continue;
            key = k;
            return 1;
        }
        return 0;
    }

    /// Title, units and gravity of the model; gravity only where the model states one.
    [[nodiscard]] int GetStyp(T_STYP_D& out) const;
    [[nodiscard]] int GetNode(int id, T_NODE_D& out) const { return Get(id, out); }
    /// Global control of the pushover analysis; every model has one.
    [[nodiscard]] int GetPogc(T_POGC_D& out) const;
    /// Restraints of a node, 1 where restrained, in the order X, Y, Z, RX, RY, RZ.
    [[nodiscard]] int GetConsNode(int id, std::array<int, 6>& out) const;
    [[nodiscard]] int GetPolc(int key, T_POLC_D& out) const { return Get(key, out); }
    [[nodiscard]] int GetSpfc(int key, T_SPFC_D& out) const { return Get(key, out); }
    [[nodiscard]] int GetEval(int key, T_EVAL_D& out) const { return Get(key, out); }
    [[nodiscard]] int GetMatl(int key, T_MATL_D& out) const { return Get(key, out); }
    [[nodiscard]] int GetSect(int key, T_SECT_D& out) const { return Get(key, out); }
    [[nodiscard]] int GetElem(int id, T_ELEM_D& out) const { return Get(id, out); }
    [[nodiscard]] int GetPhgt(int key, T_PHGT_D& out) const;
    [[nodiscard]] int GetPhge(int key, T_PHGE_D& out) const { return Get(key, out); }
    [[nodiscard]] int GetPofc(int key, T_POFC_D& out) const { return Get(key, out); }
    [[nodiscard]] int GetStld(int key, T_STLD_D& out) const { return Get(key, out); }
    /// Combinations are read as they are stored: NormalizeLcom flattens them.
    [[nodiscard]] int GetLcom(int key, T_LCOM_D& out) const { return Get(key, out); }
    [[nodiscard]] int GetUlfc(int key, T_ULFC_D& out) const { return Get(key, out); }
    [[nodiscard]] int GetUlfi(int key, T_ULFI_D& out) const { return Get(key, out); }
    [[nodiscard]] int GetStag(int key, T_STAG_D& out) const { return Get(key, out); }
    /// Control of the analysis in construction stages; every model has one.
    [[nodiscard]] int GetStct(T_STCT_D& out) const;
    /// Names of a step: "First Step", "User Step: 2", "Last Step" (step -1, and of a stage with
    /// several steps the number of its last one). 0: no such stage, or it has no such step.
    [[nodiscard]] int GetStagStepInfo(int stage, int step, T_STAG_STEP_INFO& out) const;
    /// The same by a running number over the steps of all stages in their order, from 1. A stage
    /// with one step counts once, as its first one; else the final step is given as -1.
    [[nodiscard]] int GetStagStepInfo(int number, T_STAG_STEP_INFO& out) const;
    /// Key of a stage load result by its name: the texts of IDS_DB_SGLD_SUM, IDS_DB_SGLD_DL and
    /// IDS_DB_SGLD_ER give the sums (kStageLoadSum, ...), other names the load case. The texts of
    /// the sums go before load cases of the same name.
    [[nodiscard]] int GetSgldKey(std::string_view name, int& key) const;
    /// Initial tension of an element in a load case; the sum where it has several.
    [[nodiscard]] int GetPtns(int loadCase, int element, T_PTNS_D& out) const;
    /// The same by name.
    [[nodiscard]] int GetLcom_(std::string_view name, T_LCOM_D& out) const;
    [[nodiscard]] int GetUlfc_(std::string_view name, T_ULFC_D& out) const;

    bool ExistLcom(std::string_view name) const
    {
        int key = 0;
        return GetLcomKey(name, key) != 0;
    }
    /// Key of a general combination by name. 1 found; 0 not, output as it was.
    [[nodiscard]] int GetLcomKey(std::string_view name, int& key) const
    {
        return Find<T_LCOM_D>(name, key);
    }
    /// The combination with its nested combinations replaced by their load cases: each case once,
    /// in the order of first appearance, factors along the nesting multiplied and those of one case
    /// summed. 1 done; 0 `error` says why (a case or combination is missing, a combination contains
    /// itself, a factor is not finite), `out` as it was. In and out may be one object.
    [[nodiscard]] int NormalizeLcom(const T_LCOM_D& in, T_LCOM_D& out, std::string& error) const;
    [[nodiscard]] int NormalizeLcom(const T_LCOM_D& in, T_LCOM_D& out) const;

    /// Keys in ascending order, which is that of definition; ids of nodes and elements.
    template <class T>
    std::vector<int> GetKeys() const
    {
        std::vector<int> keys;
        for (const auto& entry : TableOf<T>(m_data.Model()))
            keys.push_back(entry.first);
        return keys;
    }
    std::vector<int> GetStldKeys() const { return GetKeys<T_STLD_D>(); }
    std::vector<int> GetLcomKeys() const { return GetKeys<T_LCOM_D>(); }
    std::vector<int> GetUlfcKeys() const { return GetKeys<T_ULFC_D>(); }

    /// Section and material of an element. 0: no such element, or it lacks one of them; neither
    /// output is changed.
    [[nodiscard]] int GetSectMatlByElem(int element, T_SECT_D& sect, T_MATL_D& matl) const;
    /// Ids of the elements with a hinge of that type, ascending, each once.
    std::vector<int> GetElemsByPhgt(int hingeType) const;

    /// Key of the record with that name. 1 found; 0 not, output as it was.
    [[nodiscard]] int FindPolc(std::string_view name, int& key) const
    {
        return Find<T_POLC_D>(name, key);
    }
    [[nodiscard]] int FindSpfc(std::string_view name, int& key) const
    {
        return Find<T_SPFC_D>(name, key);
    }
    [[nodiscard]] int FindPhgt(std::string_view name, int& key) const
    {
        return Find<T_PHGT_D>(name, key);
    }
    [[nodiscard]] int FindStld(std::string_view name, int& key) const
    {
        return Find<T_STLD_D>(name, key);
    }
    [[nodiscard]] int FindUlfi(std::string_view name, int& key) const
    {
        return Find<T_ULFI_D>(name, key);
    }
    [[nodiscard]] int FindUlsi(std::string_view name, int& key) const
    {
        return Find<T_ULSI_D>(name, key);
    }

    /// A hinge type of one active FEMA component out of an inelastic hinge, and its I-end's curve
    /// back; component 0 to 5. See ConvertIehpToPhgtFema.
    [[nodiscard]] static int Convert_IehpToPhgt_FEMA(const T_IEHP_D& in, int component,
                                                     T_PHGT_D& out)
    {
        return ConvertIehpToPhgtFema(in, component, out);
    }
    [[nodiscard]] static int Convert_PhgtToIehp_FEMA(const T_PHGT_D& in, int component,
                                                     T_IEHP_D& out)
    {
        return ConvertPhgtToIehpFema(in, component, out);
    }

private:
    const CDataCtrl& m_data;
};
