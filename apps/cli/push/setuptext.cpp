#include "push/setuptext.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/push/pushquantity.h"
#include "qm_rps/push/stopwarnings.h"
#include "qm_rps/pushover/loadcaserows.h"
#include "json/jsontext.h"

#include <algorithm>

namespace {

constexpr int kFollowsFunction = 2, kByDisplacement = 1;
constexpr int kNamedNode = 1; // control option
constexpr int kStatic = 0, kAcceleration = 1;

template <class NAMES, class T>
std::string WordOf(const NAMES& names, T value)
{
    const auto i = static_cast<std::size_t>(value);
    return i < names.size() ? names[i] : "?";
}

template <class R>
std::string NameIn(const T_TABLE<R>& table, int key)
{
    const auto at = table.find(key);
    return at == table.end() ? std::to_string(key) : at->second.name;
}

std::string TypeText(const T_MODEL& model, int key)
{
    return NameIn(model.hingeTypes, key);
}

/// What a row of the pattern names: load case, direction or mode.
std::string WhatOf(const T_MODEL& model, const T_POLC_PATTERN& row)
{
    if (row.kind == kStatic) return NameIn(model.loadCases, row.number);
    const auto d = static_cast<std::size_t>(row.number - 1);
    if (row.kind == kAcceleration && d < kDirectionNames.size()) return kDirectionNames[d];
    return std::to_string(row.number);
}

template <class LIST, class TEXT>
std::string Joined(const LIST& list, const std::string& ifEmpty, TEXT text)
{
    std::string out;
    for (const auto& item : list)
        out += (out.empty() ? "" : ", ") + text(item);
    return list.empty() ? ifEmpty : out;
}

// ---- table --------------------------------------------------------------------------------------

/// Characters on a terminal.
std::size_t WidthOf(const std::string& text)
{
    return static_cast<std::size_t>(std::ranges::count_if(
        text, [](char c) { return (static_cast<unsigned char>(c) & 0xC0U) != 0x80U; }));
}

/// Lines of caption and value under a head.
class CTable {
public:
    void Head(const std::string& text)
    {
        if (!m_text.empty()) m_text += "\n";
        m_text += text + "\n";
    }
    void Row(const char* caption, const std::string& value, bool isGlobal = false)
    {
        constexpr std::size_t kColumn = 54;
        const std::string text = Say(caption);
        m_text += "  " + text;
        m_text.append(WidthOf(text) < kColumn ? kColumn - WidthOf(text) : 1, ' ');
        m_text += value + (isGlobal ? "  (" + Say("IDS_QM_CLI_SETUP_GLOBAL") + ")" : "") + "\n";
    }
    void Line(const std::string& text) { m_text += "  " + text + "\n"; }
    const std::string& Text() const { return m_text; }

private:
    std::string m_text;
};

class CSetupTable {
public:
    explicit CSetupTable(CDBDoc& doc) : m_model(doc.Data().Model()), m_units(doc.Unit().Units()) {}

    std::string Print(CDBDoc& doc, const std::vector<int>& cases)
    {
        const T_POGC_D& control = m_model.pushControl;
        m_table.Head(Say("IDS_QM_UI_POGC_TITLE"));
        AddShared(control, nullptr);
        m_table.Row("IDS_QM_UI_POGC_FLOW", WordOf(kPushFlowNames, control.flow));
        m_table.Row("IDS_QM_UI_POGC_TYPES",
                    Joined(control.hingeTypes, Say("IDS_QM_CLI_SETUP_ALL"),
                           [&](int key) { return TypeText(m_model, key); }));
        m_table.Row("IDS_QM_UI_POGC_EVENTS", std::to_string(control.mostEvents));
        m_table.Row("IDS_QM_UI_POGC_MOST_STEPS", std::to_string(control.mostSteps));
        for (const int key : cases) {
            T_POLC_D record;
            if (!doc.Attr().GetPolc(key, record)) continue;
            AddCase(record);
            for (const T_FINDING& warning : StopWarnings(doc, record))
                m_table.Line("! " + warning.field + ": " + warning.text);
        }
        return m_table.Text();
    }

private:
    /// A displacement of the load case's control.
    std::string Displacement(const T_POLC_D& record, double value) const
    {
        const auto direction = static_cast<std::size_t>(std::max(record.direction, 1) - 1);
        return ShortestText(value) + " " + DisplacementIn(direction, m_units).Unit();
    }
    std::string None() const { return Say("IDS_QM_CLI_SETUP_NONE"); }

    /// What a load case may have of its own.
    void AddShared(const T_POGC_D& c, const T_POLC_D* own)
    {
        if (!own || own->initialCase.empty())
            m_table.Row("IDS_QM_UI_POGC_INITIAL",
                        Joined(c.initialLoads, None(),
                               [&](const T_PUSH_INITIAL_LOAD& load) {
                                   return NameIn(m_model.loadCases, load.loadCase) + " x " +
                                          ShortestText(load.factor);
                               }),
                        own && !own->initialLoads);
        m_table.Row("IDS_QM_UI_POGC_P_DELTA", WordOf(kPDeltaNames, c.pDelta), own && !own->pDelta);
        if (!own || !FollowsFunction(*own))
            m_table.Row("IDS_QM_UI_POGC_STEPS", std::to_string(c.steps), own && !own->steps);
        m_table.Row("IDS_QM_UI_POGC_FAILURE", WordOf(kPushFailureNames, c.onFailure),
                    own && !own->onFailure);
    }

    static bool FollowsFunction(const T_POLC_D& record)
    {
        return record.control && record.control->incrementOption == kFollowsFunction;
    }

    void AddControl(const T_POLC_D& record)
    {
        if (!record.control)
            return m_table.Row("IDS_QM_UI_POLC_METHOD", Say("IDS_QM_CLI_SETUP_NO_CONTROL"));
        const T_POLC_CONTROL& c = *record.control;
        const bool byDisplacement = c.incrementMethod == kByDisplacement;
        m_table.Row("IDS_QM_UI_POLC_METHOD", kIncrementNames[byDisplacement ? 1 : 0]);
        if (byDisplacement && c.masterNodeControl)
            m_table.Row("IDS_QM_UI_POLC_MASTER", Displacement(record, c.masterMaxDispl));
        else if (byDisplacement)
            m_table.Row("IDS_QM_UI_POLC_TRANS", Displacement(record, c.maxTransDispl));
        if (FollowsFunction(record))
            m_table.Row("IDS_QM_UI_POLC_FUNCTION",
                        NameIn(m_model.incrementFunctions, c.incrementFunction));
        if (c.stiffnessRatioLimit != 0.0)
            m_table.Row("IDS_QM_UI_POLC_RATIO", ShortestText(c.stiffnessRatioLimit));
        if (c.generateStaticAngle) m_table.Row("IDS_QM_UI_POLC_ANGLE", ShortestText(c.staticAngle));
    }

    void AddStops(const T_PUSH_STOPS_D& stops)
    {
        if (stops.drift) m_table.Row("IDS_QM_UI_POLC_DRIFT", ShortestText(*stops.drift));
        if (stops.state) m_table.Row("IDS_QM_UI_POLC_STATE", WordOf(kStateStopNames, *stops.state));
        if (stops.fractionOfPeak)
            m_table.Row("IDS_QM_UI_POLC_PEAK", ShortestText(*stops.fractionOfPeak));
    }

    void AddCase(const T_POLC_D& record)
    {
        m_table.Head(record.name);
        m_table.Row("IDS_QM_UI_POLC_NODE", std::to_string(record.controlNode) + ", " +
                                               WordOf(kDirectionNames, record.direction - 1));
        if (record.controlOption != kNamedNode)
            m_table.Row("IDS_QM_UI_POLC_CONTROL_NODE", Say("IDS_QM_UI_POLC_NODE_FOUND"));
        m_table.Row("IDS_QM_UI_POLC_PATTERNS",
                    Joined(record.patterns, None(), [&](const T_POLC_PATTERN& row) {
                        return WordOf(kPatternNames, row.kind) + ":" + WhatOf(m_model, row) +
                               " x " + ShortestText(row.factor);
                    }));
        if (record.eccentricity != 0.0)
            m_table.Row("IDS_QM_UI_POLC_ECCENTRICITY", ShortestText(record.eccentricity));
        AddControl(record);
        if (!record.control) return;
        if (!record.initialCase.empty())
            m_table.Row("IDS_QM_UI_POLC_INITIAL_CASE", record.initialCase);
        AddShared(PushControlOf(m_model, record), &record);
        AddStops(record.stops);
        if (!record.additionalDisplacements.empty())
            m_table.Row("IDS_QM_UI_POLC_ADDITIONAL",
                        Joined(record.additionalDisplacements, {},
                               [&](double d) { return Displacement(record, d); }));
        if (record.additionalEvaluations)
            m_table.Row("IDS_QM_UI_POLC_EVALUATIONS", Say("IDS_QM_CLI_HINGE_ON"));
    }

    const T_MODEL& m_model;
    T_UNITS m_units;
    CTable m_table;
};

// ---- JSON ---------------------------------------------------------------------------------------

void WriteShared(CJsonText& w, const T_MODEL& model, const T_POGC_D& c)
{
    w.Key("initial_loads").List();
    for (const T_PUSH_INITIAL_LOAD& load : c.initialLoads) {
        w.Object(kJsonOneLine);
        w.Member("case", NameIn(model.loadCases, load.loadCase)).Member("factor", load.factor);
        w.End();
    }
    w.End();
    w.Member("p_delta", WordOf(kPDeltaNames, c.pDelta)).Member("steps", c.steps);
    w.Member("on_failure", WordOf(kPushFailureNames, c.onFailure));
}

void WriteGlobal(CJsonText& w, const T_MODEL& model)
{
    const T_POGC_D& c = model.pushControl;
    w.Key("pushover_control").Object();
    WriteShared(w, model, c);
    w.Member("flow", WordOf(kPushFlowNames, c.flow));
    std::vector<std::string> types;
    for (const int key : c.hingeTypes)
        types.push_back(TypeText(model, key));
    w.Items("hinge_types", types, kJsonOneLine);
    w.Member("most_events", c.mostEvents).Member("most_steps", c.mostSteps);
    w.End();
}

void WriteControl(CJsonText& w, const T_MODEL& model, const T_POLC_CONTROL& c)
{
    const bool byDisplacement = c.incrementMethod == kByDisplacement;
    w.Key("control").Object();
    w.Member("increment_method", kIncrementNames[byDisplacement ? 1 : 0]);
    w.Member("master_node_control", c.masterNodeControl);
    w.Member("master_max_displ", c.masterMaxDispl).Member("max_trans_displ", c.maxTransDispl);
    w.Key("increment_function");
    if (c.incrementOption == kFollowsFunction)
        w.Value(NameIn(model.incrementFunctions, c.incrementFunction));
    else
        w.Value(nullptr);
    w.Member("stiffness_ratio_limit", c.stiffnessRatioLimit);
    w.Member("generate_static_angle", c.generateStaticAngle).Member("static_angle", c.staticAngle);
    w.End();
}

void WriteOwn(CJsonText& w, const T_POLC_D& record)
{
    std::vector<std::string> own;
    if (record.initialLoads) own.push_back("initial_loads");
    if (record.pDelta) own.push_back("p_delta");
    if (record.steps) own.push_back("steps");
    if (record.onFailure) own.push_back("on_failure");
    w.Items("own", own, kJsonOneLine);
}

void WriteStops(CJsonText& w, const T_PUSH_STOPS_D& stops)
{
    w.Key("stops").Object(kJsonOneLine);
    w.Member("drift", stops.drift);
    w.Key("state");
    if (stops.state)
        w.Value(WordOf(kStateStopNames, *stops.state));
    else
        w.Value(nullptr);
    w.Member("fraction_of_peak", stops.fractionOfPeak);
    w.End();
}

void WriteCase(CJsonText& w, CDBDoc& doc, const T_POLC_D& record)
{
    const T_MODEL& model = doc.Data().Model();
    w.Object();
    w.Member("name", record.name).Member("control_node", record.controlNode);
    w.Member("direction", WordOf(kDirectionNames, record.direction - 1));
    w.Member("control_option", record.controlOption);
    w.Key("patterns").List();
    for (const T_POLC_PATTERN& row : record.patterns) {
        w.Object(kJsonOneLine);
        w.Member("kind", WordOf(kPatternNames, row.kind)).Member("of", WhatOf(model, row));
        w.Member("factor", row.factor);
        w.End();
    }
    w.End();
    w.Member("eccentricity", record.eccentricity);
    if (record.control)
        WriteControl(w, model, *record.control);
    else
        w.Key("control").Value(nullptr);
    w.Member("initial_case", record.initialCase);
    WriteShared(w, model, PushControlOf(model, record));
    WriteOwn(w, record);
    WriteStops(w, record.stops);
    w.Items("additional_displacements", record.additionalDisplacements, kJsonOneLine);
    w.Member("additional_evaluations", record.additionalEvaluations);
    std::vector<std::string> warnings;
    for (const T_FINDING& warning : StopWarnings(doc, record))
        warnings.push_back(warning.field + ": " + warning.text);
    if (!warnings.empty()) w.Items("warnings", warnings, kJsonOneLine);
    w.End();
}

} // namespace

std::string SetupTable(CDBDoc& doc, const std::vector<int>& cases)
{
    return CSetupTable(doc).Print(doc, cases);
}

std::string SetupJson(CDBDoc& doc, const std::vector<int>& cases)
{
    const T_MODEL& model = doc.Data().Model();
    CJsonText w(JSON_REALS::Shortest);
    w.Object();
    w.Key("units").Object(kJsonOneLine);
    w.Member("force", std::string(NameOf(doc.Unit().Units().force)));
    w.Member("length", std::string(NameOf(doc.Unit().Units().length)));
    w.End();
    WriteGlobal(w, model);
    w.Key("pushover").List();
    for (const int key : cases) {
        T_POLC_D record;
        if (doc.Attr().GetPolc(key, record)) WriteCase(w, doc, record);
    }
    w.End();
    w.End();
    return w.Text();
}
