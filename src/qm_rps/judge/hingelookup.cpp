#include "qm_rps/judge/hingelookup.h"

std::optional<HINGE_CODE> CHingeLookup::CodeOf(int element) const
{
    const T_PHGT_D* const type = GeneratedType(element);
    return type ? HingeCodeNamed(type->generated->code) : std::nullopt;
}

std::optional<HINGE_CODE> CHingeLookup::CodeOfModel() const
{
    std::optional<HINGE_CODE> one;
    for (const auto& entry : m_types) {
        std::optional<HINGE_CODE> code = CodeOf(entry.first);
        if (code == HINGE_CODE::Aisc342) code = HINGE_CODE::Asce17;
        if (!code || (one && one != code)) return {};
        one = code;
    }
    return one;
}
