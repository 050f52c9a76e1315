// What is added to a list, or made where a part is left out.
#include "qm_db/casefile/caseput.h"
#include "qm_db/casefile/jsonparser.h"
#include "qm_db/form/anyrecord.h"
#include "qm_db/form/formfill.h"
#include "qm_db/form/jsontree.h"

namespace {

/// Looks for a list of records, or a part that is left out, and prints a new one.
class CNewPart : public CFieldLook<CNewPart> {
public:
    template <class T>
    using Ref = const T&;

    struct T_WANTED {
        const T_MODEL& model;
        std::string path;
        std::optional<T_JSON> made{};
        std::optional<RECORD_KIND> missing{};
        std::string reason{};
    };
    CNewPart(T_WANTED& wanted, std::string place) : m_to(wanted), m_place(std::move(place)) {}

    template <class R, class... C>
    void Part(const char* key, const R& r, const C&... context)
    {
        CNewPart part(m_to, JoinPath(m_place, key));
        if (part.IsOnTheWay()) CaseFields(part, r, context...);
        if constexpr (std::is_same_v<R, T_HINGE_COMPONENTS>)
            for (std::size_t i = 0; i < r.size(); ++i)
                if (m_to.path == part.m_place + '/' + kComponentNames[i])
                    MakeComponent(CurveDims(i, HINGE_DEFINITION::MomentRotation));
    }
    template <class R, class... C>
    void NeedPart(const char* key, const R& r, const C&... context)
    {
        Part(key, r, context...);
    }
    template <class R, class... C>
    void PartIf(const char* key, const std::optional<R>& r, const C&... context)
    {
        if (r) return Part(key, *r, context...);
        if (JoinPath(m_place, key) == m_to.path) Make(R{}, context...);
    }
    template <class F>
    void Group(const char* key, const F& members)
    {
        CNewPart part(m_to, JoinPath(m_place, key));
        if (part.IsOnTheWay()) members(part);
    }
    template <class F>
    void NeedGroup(const char* key, const F& members)
    {
        Group(key, members);
    }
    template <class R, class... C>
    void List(const char* key, const std::vector<R>& all, const C&... context)
    {
        const std::string place = JoinPath(m_place, key);
        if (place == m_to.path) return Make(R{}, context...);
        for (std::size_t i = 0; i < all.size(); ++i) {
            CNewPart item(m_to, JoinPath(place, std::to_string(i)));
            if (item.IsOnTheWay()) CaseFields(item, all[i], context...);
        }
    }
    template <class R, class... C>
    void ListIf(const char* key, const std::optional<std::vector<R>>& all, const C&... context)
    {
        List(key, all.value_or(std::vector<R>{}), context...);
    }

private:
    bool IsOnTheWay() const { return m_to.path.starts_with(m_place + '/'); }

    void MakeComponent(const T_CURVE_DIMS& dims)
    {
        T_HINGE_COMPONENT component;
        component.active = true;
        Make(component, dims);
    }
    template <class R, class... C>
    void Make(R item, const C&... context)
    {
        CFormFill fill(m_to.model);
        if constexpr (std::is_same_v<R, T_LCOM_ITEM>) item.factor = 1.0;
        if constexpr (std::is_same_v<R, T_SECT_DETAIL>) // mm: usual ones, above 0 by the rules
            item.cover = 0.025, item.stirrupDiameter = 0.008, item.stirrupSpacing = 0.15;
        CaseFields(fill, item, context...);
        m_to.missing = fill.Missing();
        const CCaseNames names(m_to.model);
        CJsonWriter text(kSiUnits);
        text.BeginObject();
        CCasePut put(text, &names);
        CaseFields(put, item, context...);
        text.EndObject();
        T_FILE_ERROR error = text.Error();
        T_JSON made;
        if (!text.Failed() && ParseJson(text.TakeText(), made, error))
            m_to.made = std::move(made);
        else
            m_to.reason = error.text;
    }

    T_WANTED& m_to;
    std::string m_place;
};

} // namespace

int NewPart(const T_MODEL& model, const T_ANY_RECORD& record, const std::string& path, T_JSON& out,
            std::string& reason)
{
    CNewPart::T_WANTED wanted{model, path};
    std::visit(
        [&]<class R>(const R& r) {
            if constexpr (!std::is_same_v<R, std::monostate>) {
                CNewPart look(wanted, {});
                CaseFields(look, r);
            }
        },
        record);
    if (wanted.missing) {
        reason = NeedsFirst(*wanted.missing);
        return 0;
    }
    reason = wanted.reason;
    if (wanted.made) out = std::move(*wanted.made);
    return wanted.made ? 1 : 0;
}
