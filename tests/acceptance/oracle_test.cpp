// The program against the independent reference calculation of tests/oracle on random cases; the
// expected results were made by it, see tests/data/oracle/README.md.
#include "program.h"

#include <cmath>
#include <gtest/gtest.h>
#include <map>
#include <nlohmann/json.hpp>

namespace {

using json = nlohmann::json;

constexpr double kRelative = 1e-9;

const std::vector<std::string> kFactors{"gamma", "alpha", "mass", "gravity", "eigen_based"};
const std::vector<std::string> kPoint{"Sd", "Sa", "D", "V", "T_eff", "damping"};
const std::vector<std::string> kTarget{"T_star", "Tc",     "Se",  "ay", "dy",
                                       "Fy",     "m_star", "det", "dt", "qu"};
const std::vector<std::string> kState{"demand", "demand_step", "capacity", "capacity_step",
                                      "remark"};

json At(const json& object, const std::string& key)
{
    return object.is_object() && object.contains(key) ? object.at(key) : json(nullptr);
}

/// Numbers to 1e-9 of the larger, everything else exactly.
void ExpectSame(const json& expected, const json& found, const std::string& where)
{
    if (!expected.is_number() || !found.is_number()) {
        EXPECT_EQ(expected, found) << where;
        return;
    }
    const double a = expected, b = found;
    EXPECT_LE(std::fabs(a - b), kRelative * std::max(std::fabs(a), std::fabs(b)))
        << where << ": expected " << a << ", found " << b;
}

void ExpectSameRecord(const json& expected, const json& found, const std::vector<std::string>& keys,
                      const std::string& where)
{
    EXPECT_EQ(expected.is_null(), found.is_null()) << where;
    for (const std::string& key : keys)
        ExpectSame(At(expected, key), At(found, key), where + "." + key);
}

/// Rows by name, without those that hold nothing.
std::map<std::string, json> RowsByName(const json& rows, const char* name,
                                       const std::vector<std::string>& keys)
{
    std::map<std::string, json> table;
    for (const json& row : rows.is_array() ? rows : json::array()) {
        const bool holds = std::any_of(keys.begin(), keys.end(),
                                       [&](const std::string& k) { return !At(row, k).is_null(); });
        if (holds) table[row.at(name)] = row;
    }
    return table;
}

void ExpectSameRows(const json& expected, const json& found, const char* name,
                    const std::vector<std::string>& keys, const std::string& where)
{
    const auto a = RowsByName(expected, name, keys), b = RowsByName(found, name, keys);
    EXPECT_EQ(a.size(), b.size()) << where;
    for (const auto& [label, row] : a) {
        const auto it = b.find(label);
        ExpectSameRecord(row, it == b.end() ? json(nullptr) : it->second, keys,
                         where + "[" + label + "]");
    }
}

void ExpectSameCurve(const json& expected, const json& found, const std::string& where)
{
    for (const char* key : {"Sd", "Sa"}) {
        const json a = At(expected, key), b = At(found, key);
        ASSERT_EQ(a.size(), b.size()) << where;
        for (std::size_t i = 0; i < a.size(); ++i)
            ExpectSame(a[i], b[i], where + "." + key + "[" + std::to_string(i) + "]");
    }
}

void ExpectSameResult(const json& expected, const json& found, const std::string& file)
{
    const std::string where = file + ", " + expected.at("name").get<std::string>();
    for (const char* key : {"name", "push", "method", "status"})
        EXPECT_EQ(expected.at(key), found.at(key)) << where;
    ExpectSameRecord(expected.at("factors"), found.at("factors"), kFactors, where + ": factors");
    ExpectSameCurve(expected.at("capacity"), found.at("capacity"), where + ": capacity");
    ExpectSameRecord(At(expected, "performance_point"), At(found, "performance_point"), kPoint,
                     where + ": point");
    const json target = At(expected, "target");
    if (target.is_array())
        ExpectSameRows(target, At(found, "target"), "limit_state", kTarget, where + ": target");
    else
        ExpectSameRecord(target, At(found, "target"), kTarget, where + ": target");
    ExpectSameRows(At(expected, "limit_states"), At(found, "limit_states"), "name", kState,
                   where + ": state");
    if (expected.at("status") != "not found" && expected.contains("trials")) {
        EXPECT_EQ(expected.at("trials"), found.at("trials")) << where;
    }
}

class Oracle : public testing::TestWithParam<const char*> {};

TEST_P(Oracle, AgreesWithTheReferenceCalculation)
{
    const auto folder = ProjectFolder() / "tests/data/oracle";
    const std::string name = GetParam();
    const json expected = json::parse(ReadText(folder / (name + ".expected.json")));
    const T_RUN run = RunProgram({"evaluate", (folder / (name + ".json")).string(), "--json", "-"});
    ASSERT_LE(run.code, 1) << run.err;
    const json found = json::parse(run.out);
    ASSERT_EQ(expected.size(), found.size());
    ASSERT_GE(expected.size(), 10U);
    for (std::size_t i = 0; i < expected.size(); ++i)
        ExpectSameResult(expected[i], found[i], name);
}

INSTANTIATE_TEST_SUITE_P(Seeds, Oracle, testing::Values("seed105", "seed122", "seed129", "seed140"),
                         [](const auto& seed) { return std::string(seed.param); });

} // namespace
