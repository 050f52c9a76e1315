#include "qm_db/records/recorduse.h"

#include "qm_base/msgfunction.h"
#include "qm_db/records/casenames.h"
#include "qm_db/records/hingefields.h"
#include "qm_db/records/pushfields.h"
#include "qm_db/records/pushnames.h"
#include "qm_db/records/stagefields.h"

#include <algorithm>
#include <limits>

namespace {

/// Whether the members of a record refer to another one, by its key or its name.
class CRefersTo : public CFieldLook<CRefersTo> {
public:
    template <class T>
    using Ref = const T&;
    CRefersTo(RECORD_KIND kind, int key, const std::string& name)
        : m_kind(kind), m_key(key), m_name(name)
    {
    }

    void Reference(RECORD_KIND kind, int key) { m_found |= kind == m_kind && key == m_key; }
    void Reference(RECORD_KIND kind, const std::string& name)
    {
        const bool turned = kind == KindOf<T_POLC_D>() && IsTurnOf(name, m_name);
        m_found |= kind == m_kind && (name == m_name || turned);
    }
    bool IsFound() const { return m_found; }

private:
    RECORD_KIND m_kind;
    int m_key;
    const std::string& m_name;
    bool m_found = false;
};

int PlaceOf(RECORD_KIND kind)
{
    int place = std::numeric_limits<int>::max();
    WithKind(kind, [&](const auto& row) { place = row.place; });
    return place;
}

} // namespace

T_RECORD_USERS UsersOf(const T_MODEL& model, RECORD_KIND kind, int key)
{
    const std::string* const named = CCaseNames(model).NameOf(kind, key);
    const std::string name = named ? *named : std::string();
    T_RECORD_USERS users;
    ForEachKind([&]<class R>(const T_RECORD_ROW<R>& row) {
        if (row.user.empty()) return;
        for (const auto& [k, record] : model.*row.table) {
            CRefersTo look(kind, key, name);
            CaseFields(look, record);
            if (look.IsFound()) users.push_back({KindOf<R>(), k});
        }
    });
    CRefersTo control(kind, key, name);
    CaseFields(control, model.pushControl);
    if (control.IsFound()) users.push_back({kPushControlKind, 0});
    std::ranges::stable_sort(users, {}, [](const T_RECORD_USER& u) { return PlaceOf(u.kind); });
    return users;
}

std::string DescribeUser(const T_MODEL& model, const T_RECORD_USER& user)
{
    if (user.kind == kPushControlKind)
        return zql::lib::MMSGFunction::GetValue("IDS_QM_DB_USER_PUSH_CONTROL");
    const std::string* const name = CCaseNames(model).NameOf(user.kind, user.key);
    const std::string which = name ? '"' + *name + '"' : std::to_string(user.key);
    std::string text;
    WithKind(user.kind,
             [&](const auto& row) { text = zql::lib::MMSGFunction::Format(row.user, {which}); });
    return text;
}
