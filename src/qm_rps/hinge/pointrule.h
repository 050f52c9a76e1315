// A rule that compares points of one side of a backbone with each other or with 0:
//     Deforms(B).Below(C).If(Rises)      D(B) <  D(C), on the negative side D(-C) <  D(-B)
// Its words and its field follow from the comparison; the negative side's are the mirrored ones.
#pragma once

#include "qm_rps/hinge/hingefindings.h"

#include <array>

enum class SKEL_POINT { A, B, C, D, E }; // A: the origin
enum class SKEL_VALUE { Deform, Strength };

/// One side of a backbone that reads like the positive one, and what its rules ask for.
struct T_BACKBONE_SIDE {
    T_SKEL_SIDE values;
    HINGE_SIDE side = HINGE_SIDE::Positive;
    bool strengthLoss = true;
    bool ratios = true;

    double Value(SKEL_VALUE value, SKEL_POINT point) const;
};

class CPointRule {
public:
    constexpr CPointRule(SKEL_VALUE value, SKEL_POINT first) : m_value(value), m_at(first)
    {
        m_points[0] = first;
    }

    // The comparison with 0, or with the next point of the chain.
    constexpr CPointRule Above0() const { return Next(RELATION::Above0, m_at); }
    constexpr CPointRule NotBelow0() const { return Next(RELATION::NotBelow0, m_at); }
    constexpr CPointRule Below(SKEL_POINT p) const { return Next(RELATION::Below, p); }
    constexpr CPointRule AtMost(SKEL_POINT p) const { return Next(RELATION::AtMost, p); }
    constexpr CPointRule Equals(SKEL_POINT p) const { return Next(RELATION::Equal, p); }

    /// The point that the finding marks; without it the last one of the chain.
    constexpr CPointRule At(SKEL_POINT p) const
    {
        CPointRule rule = *this;
        rule.m_at = p;
        return rule;
    }
    constexpr CPointRule If(bool (*applies)(const T_BACKBONE_SIDE&)) const
    {
        CPointRule rule = *this;
        rule.m_applies = applies;
        return rule;
    }
    /// Words that differ from those of the comparison, with %s for the symbol; null: they don't.
    constexpr CPointRule Words(const char* positive, const char* negative) const
    {
        CPointRule rule = *this;
        rule.m_words = {positive, negative};
        return rule;
    }

    /// Appends a finding where the rule applies and is not kept.
    void Walk(const T_BACKBONE_SIDE& side, const T_HINGE_PLACE& place,
              std::vector<T_FINDING>& out) const;

private:
    enum class RELATION { Above0, NotBelow0, Below, AtMost, Equal };

    constexpr CPointRule Next(RELATION relation, SKEL_POINT p) const
    {
        CPointRule rule = *this;
        rule.m_relation = relation;
        rule.m_at = p;
        if (relation >= RELATION::Below) rule.m_points[rule.m_count++] = p;
        return rule;
    }
    bool Holds(const T_BACKBONE_SIDE& side) const;
    std::string Operand(SKEL_POINT p, const T_HINGE_PLACE& place) const;
    std::string Text(const T_HINGE_PLACE& place) const;
    std::string Wording(const T_HINGE_PLACE& place) const;

    SKEL_VALUE m_value;
    RELATION m_relation = RELATION::Above0; // one between all points of the chain
    std::array<SKEL_POINT, 4> m_points{};
    std::size_t m_count = 1;
    SKEL_POINT m_at;
    bool (*m_applies)(const T_BACKBONE_SIDE&) = nullptr;
    std::array<const char*, 2> m_words{};
};

constexpr CPointRule Deforms(SKEL_POINT first)
{
    return {SKEL_VALUE::Deform, first};
}
constexpr CPointRule Strengths(SKEL_POINT first)
{
    return {SKEL_VALUE::Strength, first};
}

/// Normalised strengths count as equal within 1e-9.
bool SameStrength(double a, double b);
