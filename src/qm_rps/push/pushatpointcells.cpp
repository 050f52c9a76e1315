#include "qm_rps/push/pushatpointcells.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/push/pushatpointtext.h"
#include "qm_rps/push/pushquantity.h"

namespace {

std::string Length(double si, const T_UNITS& units)
{
    return FormatText("%.6g", FromSi(si, units, kDimLength));
}

std::string WithUnit(const T_PUSH_QUANTITY& quantity, double si)
{
    return FormatText("%.5g ", quantity.Shown(si)) + quantity.Unit();
}

T_TEXT_COLUMN LengthColumn(const char* key, const T_UNITS& units)
{
    return {DisplacementIn(0, units).Head(key), true};
}

} // namespace

T_TEXT_TABLE PointCells(const T_HINGES_AT& h)
{
    const T_STATES_SEEN seen = StatesSeen(h);
    T_TEXT_TABLE table{
        {{Say("IDS_QM_REPORT_POINT")}, LengthColumn("IDS_QM_REPORT_DISPLACEMENT", h.units)}, {}};
    for (std::size_t s = 0; s < seen.size(); ++s)
        if (seen[s]) table.columns.push_back({PushStateText(static_cast<PUSH_STATE>(s)), true});
    table.columns.push_back({Say("IDS_QM_REPORT_WORST_HINGE")});
    table.columns.push_back({Say("IDS_QM_REPORT_LARGEST_DRIFT")});
    for (const T_PUSH_AT_POINT& at : h.points) {
        auto& row = table.rows.emplace_back(
            std::vector{PointName(at.point), Length(at.point.displacement, h.units)});
        const bool isReached = at.found == AT_POINT::Reached;
        for (std::size_t s = 0; s < seen.size(); ++s)
            if (seen[s]) row.push_back(isReached ? std::to_string(at.states[s]) : "-");
        row.push_back(isReached ? WorstHingeText(at) : WhyNot(at.found));
        row.push_back(isReached ? LargestDriftText(at) : "-");
    }
    return table;
}

T_TEXT_TABLE WorstHingeCells(const T_HINGES_AT& h)
{
    T_TEXT_TABLE table{{{Say("IDS_QM_REPORT_POINT")},
                        {Say("IDS_QM_REPORT_HINGE_PLACE")},
                        {Say("IDS_QM_REPORT_DEFORMATION"), true},
                        {Say("IDS_QM_REPORT_HINGE_FORCE"), true},
                        {Say("IDS_QM_REPORT_HINGE_STATE")},
                        {Say("IDS_QM_REPORT_HINGE_RATIO"), true}},
                       {}};
    for (const T_PUSH_AT_POINT& at : h.points)
        for (const T_HINGE_AT_POINT& hinge : at.worst)
            if (at.found == AT_POINT::Reached)
                table.rows.push_back(
                    {PointName(at.point), HingePlaceText(hinge.place),
                     WithUnit(DeformationOf(hinge.place.component, h.units), hinge.deformation),
                     WithUnit(ForceOf(hinge.place.component, h.units), hinge.force),
                     PushStateText(hinge.state), HingeRatioText(hinge)});
    return table;
}

T_TEXT_TABLE StoreyCells(const T_HINGES_AT& h)
{
    T_TEXT_TABLE table{{{Say("IDS_QM_REPORT_POINT")},
                        {Say("IDS_QM_REPORT_STOREY")},
                        LengthColumn("IDS_QM_REPORT_DISPLACEMENT", h.units),
                        {Say("IDS_QM_REPORT_DRIFT"), true},
                        {ForceOf(HINGE_COMPONENT::Fx, h.units).Head("IDS_QM_REPORT_SHEAR"), true}},
                       {}};
    for (const T_PUSH_AT_POINT& at : h.points)
        for (const T_STOREY_AT_POINT& s : at.storeys)
            if (at.found == AT_POINT::Reached)
                table.rows.push_back({PointName(at.point), s.name, Length(s.displacement, h.units),
                                      FormatText("%.6g", s.drift),
                                      s.shear
                                          ? FormatText("%.6g", FromSi(*s.shear, h.units, kDimForce))
                                          : Say("IDS_QM_UI_STOREY_UNKNOWN")});
    return table;
}
