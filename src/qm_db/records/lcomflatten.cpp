#include "qm_db/records/lcomflatten.h"

#include "qm_base/msgfunction.h"

#include <cmath>
#include <unordered_map>

namespace {

using zql::lib::MMSGFunction;

constexpr std::size_t kMaxDepth = 1000; // of nesting; far below what the stack bears

class CFlattener {
public:
    CFlattener(const T_MODEL& model, std::string& error) : m_model(model), m_error(error) {}

    bool Flatten(const T_LCOM_D& in, std::vector<T_LCOM_ITEM>& out)
    {
        std::vector<T_LCOM_ITEM> flat;
        std::unordered_map<int, std::size_t> place; // by load case
        for (const T_LCOM_ITEM& item : in.items) {
            const T_LCOM_ITEM self{false, item.key, 1.0};
            const T_LCOM_ITEM* from = &self;
            std::size_t count = 1;
            if (item.combination) {
                const std::vector<T_LCOM_ITEM>* const nested = Nested(in, item.key);
                if (!nested) return false;
                from = nested->data();
                count = nested->size();
            } else if (!m_model.loadCases.contains(item.key)) {
                return Fail("IDS_QM_DB_LCOM_NO_CASE", in.name, std::to_string(item.key));
            }
            for (std::size_t i = 0; i < count; ++i) {
                const auto [it, isNew] = place.try_emplace(from[i].key, flat.size());
                if (isNew) flat.push_back({false, from[i].key, 0.0});
                flat[it->second].factor += item.factor * from[i].factor;
            }
        }
        for (const T_LCOM_ITEM& item : flat) {
            if (!std::isfinite(item.factor)) return Fail("IDS_QM_DB_LCOM_FACTOR", in.name, {});
        }
        out = std::move(flat);
        return true;
    }

private:
    /// The load cases of a combination that `in` refers to, each worked out once; null on a fault.
    const std::vector<T_LCOM_ITEM>* Nested(const T_LCOM_D& in, int key)
    {
        const auto it = m_model.combinations.find(key);
        if (it == m_model.combinations.end()) {
            Fail("IDS_QM_DB_LCOM_NO_COMBINATION", in.name, std::to_string(key));
            return nullptr;
        }
        const auto [known, isNew] = m_known.try_emplace(key);
        T_KNOWN& entry = known->second; // stays where it is while others are added
        if (!isNew && entry.done) return &entry.items;
        if (!isNew || m_depth == kMaxDepth) {
            Fail(isNew ? "IDS_QM_DB_LCOM_DEEP" : "IDS_QM_DB_LCOM_CYCLE", it->second.name, {});
            return nullptr;
        }
        ++m_depth;
        entry.done = Flatten(it->second, entry.items);
        --m_depth;
        return entry.done ? &entry.items : nullptr;
    }

    bool Fail(const char* key, const std::string& name, const std::string& what)
    {
        m_error = MMSGFunction::Format(key, {name, what});
        return false;
    }

    struct T_KNOWN {
        bool done = false;
        std::vector<T_LCOM_ITEM> items;
    };
    const T_MODEL& m_model;
    std::string& m_error;
    std::unordered_map<int, T_KNOWN> m_known;
    std::size_t m_depth = 0;
};

} // namespace

int FlattenLcom(const T_MODEL& model, const T_LCOM_D& in, T_LCOM_D& out, std::string& error)
{
    std::vector<T_LCOM_ITEM> items;
    if (!CFlattener(model, error).Flatten(in, items)) return 0;
    out.name = in.name;
    out.items = std::move(items);
    return 1;
}
