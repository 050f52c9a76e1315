// What `hinge generate` writes as JSON, number by number.
#pragma once

#include "program.h"

#include <cmath>

/// The hinge of the only type, on a side of a component.
inline const json& HingeOf(const json& result, const std::string& component,
                           const std::string& side)
{
    for (const json& hinge : result.at("types").at(0).at("hinges"))
        if (hinge.at("component") == component && hinge.at("side") == side) return hinge;
    ADD_FAILURE() << component << side << ": not there";
    return result;
}

struct T_EXPECTED {
    const char* what;
    double value;
};

/// A number of a hinge: a member, a point ("C.0": deformation, "C.1": strength) of the backbone or
/// a line of the trace.
inline double ValueOf(const json& hinge, const std::string& what)
{
    const json& bone = hinge.at("backbone");
    const double y = bone.value("yield_rotation", bone.value("yield_displacement", 0.0));
    if (hinge.contains(what)) return hinge.at(what);
    if (what == "a") return bone.at("C")[0].get<double>() - y;
    if (what == "b") return bone.at("E")[0].get<double>() - y;
    if (what == "c") return bone.at("D")[1];
    if (what == "C") return bone.at("C")[1];
    if (what == "y") return y;
    if (bone.contains(what)) return bone.at(what).get<double>() - (bone.contains("IO") ? y : 0.0);
    for (const json& line : hinge.at("trace"))
        if (line.at("symbol") == what) return line.at("value");
    ADD_FAILURE() << what << ": not there";
    return 0.0;
}

inline void ExpectHinge(const json& hinge, std::initializer_list<T_EXPECTED> expected,
                        double relative, const std::string& label)
{
    for (const auto& [what, value] : expected)
        EXPECT_NEAR(value, ValueOf(hinge, what), relative * std::fabs(value))
            << label << ": " << what;
}
