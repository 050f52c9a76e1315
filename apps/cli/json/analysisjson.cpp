#include "json/analysisjson.h"

#include "json/jsontext.h"

namespace {

constexpr T_JSON_LAYOUT kTop{1, 0}, kCases{2, 1}, kIds{3, 2}; // ids stand so wherever they are

void Write(CJsonText& w, double value)
{
    w.Value(value);
}

void Write(CJsonText& w, const T_DOF6& values)
{
    w.Items(values, kJsonOneLine);
}

void Write(CJsonText& w, const T_BEAM_ROWS& rows)
{
    w.List(kJsonOneLine);
    for (const T_DOF6& row : rows)
        w.Items(row, kJsonOneLine);
    w.End();
}

/// {ID: value}, one to a line.
template <class T>
void Write(CJsonText& w, const std::vector<T_BY_ID<T>>& rows)
{
    w.Object(kIds);
    for (const T_BY_ID<T>& row : rows) {
        w.Key(std::to_string(row.id));
        Write(w, row.value);
    }
    w.End();
}

/// {CASE: {ID: value}}.
template <class T>
void WriteCases(CJsonText& w, const char* name, const std::vector<T_SHOWN_CASE>& shown,
                const std::vector<T_CASE_RESULTS>& results,
                std::vector<T_BY_ID<T>> T_CASE_RESULTS::*rows)
{
    w.Key(name).Object(kCases);
    for (std::size_t i = 0; i < shown.size(); ++i) {
        w.Key(shown[i].name);
        Write(w, results[i].*rows);
    }
    w.End();
}

void Write(CJsonText& w, const T_MODE_RESULTS& mode)
{
    w.Object({3, 2});
    w.Member("period", mode.period);
    w.Items("participation", mode.participation, kJsonOneLine);
    w.Items("mass_percent", mode.massPercent, kJsonOneLine);
    w.Key("shape");
    Write(w, mode.shape);
    w.End();
}

void Write(CJsonText& w, const T_SHOWN_STAGE& s)
{
    w.Object({2, 2});
    w.Member("step", s.choice.step);
    w.Beside().Member("load", s.load);
    w.Beside().Member("elements", s.elements);
    Write(w.Key("displacements"), s.results.displacements);
    Write(w.Key("reactions"), s.results.reactions);
    Write(w.Key("truss"), s.results.trusses);
    Write(w.Key("beam"), s.results.beams);
    w.End();
}

} // namespace

std::string AnalysisJson(const std::vector<T_SHOWN_CASE>& shown,
                         const std::vector<T_CASE_RESULTS>& results,
                         const std::vector<T_MODE_RESULTS>& modes,
                         const std::vector<T_SHOWN_STAGE>& stages,
                         const T_ACCURACY_BY_NAME& accuracy)
{
    CJsonText w(JSON_REALS::Shortest);
    w.Object(kTop);
    WriteCases(w, "displacements", shown, results, &T_CASE_RESULTS::displacements);
    WriteCases(w, "reactions", shown, results, &T_CASE_RESULTS::reactions);
    WriteCases(w, "truss", shown, results, &T_CASE_RESULTS::trusses);
    WriteCases(w, "beam", shown, results, &T_CASE_RESULTS::beams);
    w.Key("modes").List(kCases);
    for (const T_MODE_RESULTS& mode : modes)
        Write(w, mode);
    w.End();
    if (!accuracy.empty()) w.Key("accuracy").Object(kCases);
    for (const auto& [name, lost] : accuracy) {
        w.Key(name).Object({2, 2});
        w.Member("unrefined", lost.unrefined);
        w.Beside().Member("error", lost.error);
        w.End();
    }
    if (!accuracy.empty()) w.End();
    if (!stages.empty()) w.Key("stages").Object(kCases);
    for (const T_SHOWN_STAGE& stage : stages)
        Write(w.Key(stage.stage), stage);
    if (!stages.empty()) w.End();
    w.End();
    return w.Text();
}
