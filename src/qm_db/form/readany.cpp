// Reads the object of one record by the rules of a case file.
#include "qm_db/casefile/casereadertable.h"
#include "qm_db/form/anyrecord.h"
#include "qm_db/records/lcomflatten.h"
#include "qm_db/records/pushcontrol.h"

namespace {

/// Names that a record may refer to.
CCaseNames NamesOf(const T_MODEL& model)
{
    CCaseNames names(model);
    ForEachKind([&]<class R>(const T_RECORD_ROW<R>& row) {
        if constexpr (kHasName<R>)
            if (!row.noun.empty())
                for (const auto& [key, record] : model.*row.table)
                    names.Add(KindOf<R>(), record.name, key);
    });
    return names;
}

class CAnyReader {
public:
    CAnyReader(const T_FORM_PLACE& place, CJsonReader& in, const T_UNITS& units)
        : m_model(place.model), m_key(place.key), m_in(in), m_units(units),
          m_names(NamesOf(place.model))
    {
    }

    void operator()(std::monostate&) {}
    void operator()(T_STYP_D& r) { CCaseGet::Record(m_in, m_units, m_names, {}, r); }
    void operator()(T_POGC_D& r)
    {
        CCaseGet::Record(m_in, m_units, m_names, {}, r);
        JudgePushControl(m_in, r);
    }
    template <class R>
    void operator()(R& r)
    {
        const T_RECORD_ROW<R>& row = RowOf<R>();
        std::set<std::string> taken;
        if constexpr (kHasName<R>)
            for (const auto& [key, other] : m_model.*row.table)
                if (key != m_key) taken.insert(other.name);
        ReadRecord(m_in, m_names, m_units, row, {}, taken, r);
        if (!m_in.Failed()) Judge(r);
    }

private:
    // What the list of members leaves open.
    template <class R>
    void Judge(const R& r)
    {
        if constexpr (RowOf<R>().key == CASE_KEY::Member)
            m_in.Check("id", m_key == 0 || r.id == m_key, "IDS_QM_FORM_ID_FIXED");
    }
    void Judge(const T_LCOM_D& r)
    {
        T_MODEL of;
        of.loadCases = m_model.loadCases;
        of.combinations = m_model.combinations;
        if (m_key != 0) of.combinations[m_key] = r;
        T_LCOM_D flat;
        std::string reason;
        if (!FlattenLcom(of, r, flat, reason)) m_in.FailWith(reason);
    }
    void Judge(const T_POFC_D& r)
    {
        for (const char* const key : {"step", "factor"})
            if (const char* const reason = IncrementFunctionFault(r, key)) m_in.FailAt(key, reason);
    }
    void Judge(const T_POLC_D& r)
    {
        JudgePushNames(m_in, m_model, r);
        JudgePush(m_in, m_model, r);
    }
    void Judge(const T_EVAL_D& r) { JudgeEvaluation(m_in, m_model, r); }

    const T_MODEL& m_model;
    int m_key;
    CJsonReader& m_in;
    T_UNITS m_units;
    CCaseNames m_names;
};

} // namespace

int ReadAny(const T_FORM_PLACE& place, T_JSON object, const T_UNITS& units, T_ANY_RECORD& record,
            std::string& reason)
{
    T_FILE_ERROR error;
    CJsonReader in(&object, {}, error);
    T_ANY_RECORD read;
    std::visit([&]<class R>(const R&) { read = R{}; }, record);
    CAnyReader reader(place, in, units);
    std::visit([&](auto& r) { reader(r); }, read);
    if (in.Failed()) {
        reason = error.text;
        return 0;
    }
    record = std::move(read);
    return 1;
}
