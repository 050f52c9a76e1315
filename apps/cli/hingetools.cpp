#include "hingetools.h"
#include "qm_base/say.h"

#include <algorithm>

EXIT_CODE NoSuchType(const std::string& file, const std::string& type)
{
    return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_HINGE_NO_TYPE", file, type));
}

std::optional<HINGE_COMPONENT> ComponentOf(const std::string& name)
{
    const auto it = std::ranges::find(kComponentNames, name);
    if (it == kComponentNames.end()) return std::nullopt;
    return static_cast<HINGE_COMPONENT>(it - kComponentNames.begin());
}

std::string EndName(HINGE_END end)
{
    return Say(end == HINGE_END::I   ? "IDS_QM_CLI_HINGE_END_I"
               : end == HINGE_END::J ? "IDS_QM_CLI_HINGE_END_J"
                                     : "IDS_QM_CLI_HINGE_END_BOTH");
}

void PrintLine(const std::string& text)
{
    std::printf("%s\n", text.c_str());
}

EXIT_CODE OpenType(CDBDoc& doc, const T_HINGE_OPTIONS& o, OUTPUT_KIND kind, int& key,
                   T_PHGT_D& type)
{
    if (const EXIT_CODE code = CheckOutputs(o.file, {{o.out, kind}}, o.overwrite);
        code != EXIT_CODE::Done)
        return code;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    if (doc.Attr().FindPhgt(o.type, key) && doc.Attr().GetPhgt(key, type)) return EXIT_CODE::Done;
    return NoSuchType(doc.Path(), o.type);
}

T_SKEL_CURVE* PageOf(T_HINGE_COMPONENT& component, const std::string& end, HINGE_END& page)
{
    T_SKEL_CURVE* found = nullptr;
    ForEachPage(component, [&](HINGE_END e, T_SKEL_CURVE& curve) {
        const bool wanted =
            end.empty() || (end == "I" && e != HINGE_END::J) || (end == "J" && e != HINGE_END::I);
        if (found || !wanted) return;
        found = &curve;
        page = e;
    });
    return found;
}
