#include "qm_db/casefile/casereadertable.h"
#include "qm_db/casefile/jsonnames.h"
#include "qm_db/records/lcomflatten.h"
#include "qm_db/records/pushcontrol.h"

namespace {

/// Names and keys of a table that is read already.
template <class R>
void AddNames(const T_TABLE<R>& table, CCaseNames& names)
{
    if constexpr (kHasName<R>) {
        for (const auto& [key, record] : table)
            names.Add(KindOf<R>(), record.name, key);
    }
}

/// Names and keys of a table that is still to be read: combinations may refer to later ones.
void AddNamesAhead(CJsonReader& root, const char* member, RECORD_KIND kind, CCaseNames& names)
{
    int last = 0;
    ForEachRecord(root, member, [&](CJsonReader& item, std::size_t) {
        std::string name;
        item.Get("name", name);
        last = ReadKey(item, last);
        names.Add(kind, name, last);
    });
}

void CheckCycles(CJsonReader& root, const T_MODEL& model)
{
    auto combination = model.combinations.begin();
    ForEachRecord(root, "combinations", [&](CJsonReader& item, std::size_t) {
        T_LCOM_D flat;
        std::string reason;
        if (!FlattenLcom(model, (combination++)->second, flat, reason)) item.FailWith(reason);
    });
}

void ReadHead(CJsonReader& root, T_MODEL& model)
{
    std::string format;
    root.Get("format", format);
    if (format != kCaseFormat)
        root.FailAt("format", "IDS_QM_CASE_FORMAT", QuotedText(format), QuotedText(kCaseFormat));
    const CCaseNames names(model);
    CCaseGet get(root, model.styp.units, {}, &names);
    get.Must("units"); // no number means anything without them
    HeadFields(get, model.styp);
}

/// The members of the document, whatever their order.
void CheckKeys(CJsonReader& root)
{
    CKeysOf known;
    known.Key("format");
    CaseFields(known, T_STYP_D{});
    known.Key(kPushControlMember);
    ForEachKind([&](const auto& row) {
        if (row.member) known.Key(row.member);
    });
    root.Keys(known.m_keys);
}

class CCaseTables {
public:
    CCaseTables(CJsonReader& root, const T_CASE_FOLDER& folder, T_MODEL_CONTENT& content)
        : m_root(root), m_folder(folder), m_content(content)
    {
    }

    template <class R>
    void operator()(const T_RECORD_ROW<R>& row)
    {
        if constexpr (std::is_same_v<R, T_MATL_D>) {
            CCaseGet options(m_root, m_model.styp.units);
            OptionFields(options, m_model.styp);
        }
        if constexpr (std::is_same_v<R, T_LCOM_D>)
            AddNamesAhead(m_root, row.member, KindOf<R>(), m_names);
        if (!row.member) return;
        Read(row);
        if constexpr (std::is_same_v<R, T_LCOM_D>)
            CheckCycles(m_root, m_model);
        else if (!row.noun.empty())
            AddNames(m_model.*row.table, m_names);
    }

private:
    template <class R>
    void Read(const T_RECORD_ROW<R>& row)
    {
        ReadTable(m_root, m_names, row, m_model, {}, [](CJsonReader&, int, const R&) {});
    }
    void Read(const T_RECORD_ROW<T_POLC_D>& row)
    {
        if (m_root.Has(kPushControlMember)) {
            CJsonReader control = m_root.Member(kPushControlMember);
            CCaseGet::Record(control, m_model.styp.units, m_names, {}, m_model.pushControl);
            JudgePushControl(control, m_model.pushControl);
        }
        constexpr const char* kMore[] = {"steps", "limit_state_steps"};
        ReadTable(m_root, m_names, row, m_model, kMore,
                  [&](CJsonReader& in, int key, T_POLC_D& push) {
                      ReadSteps(in, m_names, m_folder, key, push, m_content);
                  });
        auto push = m_model.pushovers.begin(); // a case may start from the end of a later one
        ForEachRecord(m_root, row.member, [&](CJsonReader& item, std::size_t) {
            JudgePush(item, m_model, (push++)->second);
        });
    }
    void Read(const T_RECORD_ROW<T_POFC_D>& row)
    {
        ReadTable(m_root, m_names, row, m_model, {},
                  [](CJsonReader& in, int, const T_POFC_D& function) {
                      for (const char* const key : {"step", "factor"})
                          if (const char* const reason = IncrementFunctionFault(function, key))
                              in.FailAt(key, reason);
                  });
    }
    void Read(const T_RECORD_ROW<T_POVR_D>&) {}
    void Read(const T_RECORD_ROW<T_EVAL_D>& row)
    {
        ReadTable(m_root, m_names, row, m_model, {},
                  [&](CJsonReader& in, int, const T_EVAL_D& eval) {
                      JudgeEvaluation(in, m_model, eval);
                  });
    }

    CJsonReader& m_root;
    const T_CASE_FOLDER& m_folder;
    T_MODEL_CONTENT& m_content;
    T_MODEL& m_model = m_content.model;
    CCaseNames m_names{m_model};
};

} // namespace

void ReadCase(CJsonReader& root, const T_CASE_FOLDER& folder, T_MODEL_CONTENT& content)
{
    CheckKeys(root);
    ReadHead(root, content.model);
    ForEachKind(CCaseTables(root, folder, content));
}
