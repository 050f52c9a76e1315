// What the commands on hinge types share.
#pragma once

#include "hingecommands.h"
#include "inputfile.h"
#include "output.h"
#include "qm_rps/hinge/hingefindings.h"

#include <cstdio>
#include <optional>

EXIT_CODE NoSuchType(const std::string& file, const std::string& type);

/// Calls f(key, type in current units) for the types asked for. Usage when the name is unknown.
template <class F>
EXIT_CODE ForEachType(CDBDoc& doc, const std::string& name, F&& f)
{
    bool any = false;
    for (const auto& entry : doc.Data().Model().hingeTypes) {
        T_PHGT_D type;
        if ((!name.empty() && entry.second.name != name) || !doc.Attr().GetPhgt(entry.first, type))
            continue;
        any = true;
        f(entry.first, type);
    }
    return any || name.empty() ? EXIT_CODE::Done : NoSuchType(doc.Path(), name);
}

std::optional<HINGE_COMPONENT> ComponentOf(const std::string& name);

/// "I-end", "J-end" or "both ends".
std::string EndName(HINGE_END end);

/// Prints one line.
void PrintLine(const std::string& text);

/// Opens the document and takes the type of that name with its key, for a command that writes an
/// output of this kind.
EXIT_CODE OpenType(CDBDoc& doc, const T_HINGE_OPTIONS& o, OUTPUT_KIND kind, int& key,
                   T_PHGT_D& type);

/// The curve of the page that the options name, or null.
T_SKEL_CURVE* PageOf(T_HINGE_COMPONENT& component, const std::string& end, HINGE_END& page);
