// Visitor of CaseFields: calls f(double& value, T_DIM) for each number that has a dimension.
#pragma once

#include "qm_db/records/hingefields.h"
#include "qm_db/records/loadfields.h"

template <class F>
class CCaseQuantities {
public:
    template <class T>
    using Ref = T&;
    static constexpr bool kReads = false;
    static constexpr bool kWrites = false;

    explicit CCaseQuantities(const F& f) : m_f(f) {}

    template <class T>
    void Need(const char*, T& value, T_DIM dim = kDimNone)
    {
        if constexpr (std::is_same_v<T, double>)
            if (dim != kDimNone) m_f(value, dim);
    }
    template <class T>
    void Opt(const char* key, T& value, const T&, T_DIM dim = kDimNone)
    {
        Need(key, value, dim);
    }
    const char* OptOr(const char* key, const char*, double& value, double, T_DIM dim)
    {
        Need(key, value, dim);
        return key;
    }
    template <class T>
    void OptIf(const char* key, std::optional<T>& value, T_DIM dim = kDimNone)
    {
        if (value) Need(key, *value, dim);
    }
    template <std::size_t N>
    void NeedFixed(const char* key, std::array<double, N>& values, const std::array<T_DIM, N>& dims)
    {
        for (std::size_t i = 0; i < N; ++i)
            Need(key, values[i], dims[i]);
    }
    template <std::size_t N>
    void OptFixed(const char* key, std::array<double, N>& values, const std::array<double, N>&,
                  const std::array<T_DIM, N>& dims)
    {
        NeedFixed(key, values, dims);
    }
    // What holds no quantities.
    template <class... A>
    void Flags(const A&...) const
    {
    }
    template <class... A>
    void Texts(const A&...) const
    {
    }
    template <class... A>
    void OptRef(const A&...) const
    {
    }
    template <class... A>
    void NeedRef(const A&...) const
    {
    }
    template <class... A>
    void Node(const A&...) const
    {
    }
    template <class... A>
    void Element(const A&...) const
    {
    }
    template <class... A>
    void NodeList(const A&...) const
    {
    }
    template <class... A>
    void StageStep(const A&...) const
    {
    }
    template <class... A>
    void Check(const A&...) const
    {
    }
    template <class... A>
    void CheckEach(const A&...) const
    {
    }
    template <class... A>
    void Rule(const A&...) const
    {
    }
    template <class E, class... A>
    void Enum(const char*, E&, const A&...)
    {
    }
    template <int kFirst = 0, class E, class... A>
    void EnumOpt(const char*, E&, const A&...)
    {
    }
    template <class E, class... A>
    void Code(const char*, E&, const A&...)
    {
    }
    template <class R, class... C>
    void Part(const char*, R& r, const C&... context)
    {
        CaseFields(*this, r, context...);
    }
    template <class R, class... C>
    void NeedPart(const char*, R& r, const C&... context)
    {
        CaseFields(*this, r, context...);
    }
    template <class R, class... C>
    void PartIf(const char*, std::optional<R>& r, const C&... context)
    {
        if (r) CaseFields(*this, *r, context...);
    }
    template <class R, class... C>
    void List(const char*, std::vector<R>& all, const C&... context)
    {
        for (R& r : all)
            CaseFields(*this, r, context...);
    }
    template <std::size_t N>
    void Padded(const char* key, std::array<double, N>& values, T_DIM dim)
    {
        for (double& value : values)
            Need(key, value, dim);
    }
    template <std::size_t N>
    void Pairs(const char*, std::array<T_PM_POINT, N>&)
    {
    }

private:
    const F& m_f;
};
