// A choice on which other members depend: it is set in the record, and what depends on it fits.
#include "qm_db/form/anyrecord.h"
#include "qm_db/form/jsontree.h"
#include "qm_db/records/hingefields.h"
#include "qm_db/records/pushfields.h"
#include "qm_db/records/stagefields.h"

#include <algorithm>

namespace {

class CTurn : public CFieldLook<CTurn> {
public:
    template <class T>
    using Ref = T&;
    struct T_WANTED {
        std::string path, choice;
        bool done = false;
    };
    CTurn(T_WANTED& wanted, std::string place) : m_to(wanted), m_place(std::move(place)) {}

    template <int kFirst = 0, class E>
    void Enum(const char* key, E& value, std::span<const char* const> names, const char*)
    {
        const auto it = std::ranges::find(names, m_to.choice);
        if (JoinPath(m_place, key) != m_to.path || it == names.end()) return;
        value = static_cast<E>(kFirst + (it - names.begin()));
        m_to.done = true;
    }
    template <int kFirst = 0, class E>
    void EnumOpt(const char* key, E& value, const std::type_identity_t<E>&,
                 std::span<const char* const> names, const char* what)
    {
        Enum<kFirst>(key, value, names, what);
    }
    template <class E>
    void Code(const char* key, E& value, std::span<const char* const> names, const char* what)
    {
        Enum(key, value, names, what);
    }
    template <class... T>
    void Variant(const char* key, std::variant<T...>& value, std::span<const char* const> names,
                 const char* what)
    {
        const std::array<std::variant<T...>, sizeof...(T)> blank{T{}...};
        std::size_t index = value.index();
        Enum(key, index, names, what);
        if (m_to.done && index != value.index()) value = blank[index];
    }

    template <class R, class... C>
    void Part(const char* key, R& r, const C&... context)
    {
        CTurn part(m_to, JoinPath(m_place, key));
        CaseFields(part, r, context...);
    }
    template <class R, class... C>
    void NeedPart(const char* key, R& r, const C&... context)
    {
        Part(key, r, context...);
    }
    template <class R, class... C>
    void PartIf(const char* key, std::optional<R>& r, const C&... context)
    {
        if (r) Part(key, *r, context...);
    }
    template <class R, class... C>
    void List(const char* key, std::vector<R>& all, const C&... context)
    {
        if (!m_to.path.starts_with(JoinPath(m_place, key) + '/')) return;
        for (std::size_t i = 0; i < all.size(); ++i) {
            CTurn item(m_to, JoinPath(JoinPath(m_place, key), std::to_string(i)));
            CaseFields(item, all[i], context...);
        }
    }
    template <class R, class... C>
    void ListIf(const char* key, std::optional<std::vector<R>>& all, const C&... context)
    {
        if (all) List(key, *all, context...);
    }
    template <class F>
    void Group(const char* key, const F& members)
    {
        CTurn part(m_to, JoinPath(m_place, key));
        members(part);
    }
    template <class F>
    void NeedGroup(const char* key, const F& members)
    {
        Group(key, members);
    }

private:
    T_WANTED& m_to;
    std::string m_place;
};

template <class R>
void Fit(R& r)
{
    FitRecord(r);
}
void Fit(T_EVAL_D& r)
{
    const auto offered = ProceduresOf(r.method);
    const auto is = [&](const char* name) { return r.procedure == *name; };
    if (r.procedure && std::ranges::none_of(offered, is)) r.procedure.reset();
}

} // namespace

bool TurnAny(T_ANY_RECORD& record, const std::string& path, const std::string& choice)
{
    CTurn::T_WANTED wanted{path, choice};
    std::visit(
        [&]<class R>(R& r) {
            if constexpr (!std::is_same_v<R, std::monostate>) {
                CTurn turn(wanted, {});
                CaseFields(turn, r);
                Fit(r);
            }
        },
        record);
    return wanted.done;
}
