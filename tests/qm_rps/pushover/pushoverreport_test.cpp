#include "qm_rps/pushover/pushoverreport.h"

#include "pushsample.h"

#include <cmath>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <iterator>
#include <sstream>

namespace {

// The golden files were written by hand from the formats of the report, the evaluations below
// being their only input.

T_PUSH_EVALUATION Base(PUSH_METHOD method)
{
    T_PUSH_EVALUATION e;
    e.eval.method = method;
    e.loadCase = PushX("PX", 5);
    e.units = {FORCE_UNIT::kN, LENGTH_UNIT::m};
    e.factors.gamma = 1.25;
    e.factors.mode = 2;
    e.mStar = 123456789.0;
    e.curve = {static_cast<PLOT_TYPE>(static_cast<int>(method)),
               {0.001, 0.01, 0.02, 0.04},
               {0.02, 0.2, 0.25, 0.1875}};
    return e;
}

T_PUSH_EVALUATION Atc40Found()
{
    T_PUSH_EVALUATION e = Base(PUSH_METHOD::Atc40);
    e.result = 1;
    e.point = T_PERF_POINT{0.015625, 0.25, 0.0195312, 1234.5, 0.5, 12.25};
    return e;
}

T_PUSH_EVALUATION Atc40NotFound()
{
    T_PUSH_EVALUATION e = Base(PUSH_METHOD::Atc40);
    e.loadCase = PushX("Push 2", 7);
    e.loadCase.direction = 5;
    e.loadCase.patternKind = 2;
    e.units = {FORCE_UNIT::kips, LENGTH_UNIT::in};
    return e;
}

T_PUSH_EVALUATION Fema440Elastic()
{
    T_PUSH_EVALUATION e = Base(PUSH_METHOD::Fema440);
    e.result = 2;
    e.loadCase.direction = 2;
    e.loadCase.patternKind = 1;
    e.point = T_PERF_POINT{0.015625, 0.25, 0.0195312, 1234.5, 0.5, 5.0};
    return e;
}

T_PUSH_EVALUATION AtcWithoutDamping()
{
    T_PUSH_EVALUATION e = Atc40Found();
    e.point->damping.reset();
    e.curve = {PLOT_TYPE::LoadFactor, {}, {}};
    return e;
}

T_TARGET_DISP Target(double det, double dt, std::optional<double> qu)
{
    T_TARGET_DISP t;
    t.found = true;
    t.mStar = 0.000015;
    t.Fy = 1e6;
    t.Tstar = 0.75;
    t.Tc = 0.5;
    t.Se = 0.3;
    t.det = det;
    t.dt = dt;
    t.qu = qu;
    return t;
}

T_PUSH_EVALUATION Ec8Long()
{
    T_PUSH_EVALUATION e = Base(PUSH_METHOD::Ec8Opcm);
    e.result = 1;
    e.targets = {Target(0.02, 0.02, {})};
    e.limitStates = {
        {"DL", 0.01, {}, 1, {}, ""}, {"SD", 0.025, {}, 2, {}, ""}, {"NC", 0.0375, {}, {}, {}, ""}};
    return e;
}

T_PUSH_EVALUATION Masonry()
{
    T_PUSH_EVALUATION e = Ec8Long();
    e.loadCase.patternKind = 3;
    e.targets = {Target(0.016, 0.04, 1.5)};
    e.limitStates = {{"DL", 0.02, 0.025, 2, 2, "OK"},
                     {"SD", 0.05, 0.045, 3, 3, "N/A"},
                     {"NC", 0.075, {}, {}, {}, ""},
                     {"q*=3", {}, 0.0625, {}, 3, ""}};
    return e;
}

T_PUSH_EVALUATION Ec8NotFoundDrift()
{
    T_PUSH_EVALUATION e = Base(PUSH_METHOD::Ec8Opcm);
    e.limitStates = {
        {"DL", {}, {}, {}, {}, ""}, {"SD", {}, {}, {}, {}, ""}, {"NC", {}, {}, {}, {}, ""}};
    e.curve = {PLOT_TYPE::Drift, {0.0, 0.004, 0.003}, {-0.5, 0.25, 0.125}};
    return e;
}

T_PUSH_EVALUATION Ntc2008()
{
    T_PUSH_EVALUATION e = Base(PUSH_METHOD::Ntc2008);
    e.result = 1;
    e.targets = {Target(0.008, 0.008, {}), {}, Target(0.016, 0.04, 1.5), Target(0.02, 0.02, {})};
    e.limitStates = {{"SLO", 0.01, 0.005, 1, {}, "NG"},
                     {"SLD", {}, 0.0125, {}, 1, ""},
                     {"SLV", 0.05, {}, 3, 1, ""},
                     {"SLC", 0.025, {}, 3, {}, ""}};
    return e;
}

T_PUSH_EVALUATION Ntc2018()
{
    T_PUSH_EVALUATION e = Ntc2008();
    e.eval.method = PUSH_METHOD::Ntc2018;
    e.targets[1] = Target(0.004, 0.004, 0.5);
    e.limitStates = {{"SLO", 0.01, 0.0125, 1, {}, "OK"},
                     {"SLD", 0.0125, 0.0125, 1, 1, "NG"},
                     {"SLV", 0.05, 0.075, 3, 1, "OK"},
                     {"SLC", 0.025, 0.1, 3, {}, "OK"}};
    return e;
}

std::string FileText(const std::string& path)
{
    std::ostringstream text;
    text << std::ifstream(path, std::ios::binary).rdbuf();
    return text.str();
}

struct T_GOLDEN {
    const char* file;
    T_PUSH_EVALUATION (*make)();
};

constexpr T_GOLDEN kGolden[] = {{"atc40_found", Atc40Found},
                                {"atc40_not_found", Atc40NotFound},
                                {"atc40_no_damping", AtcWithoutDamping},
                                {"fema440_elastic", Fema440Elastic},
                                {"ec8_long", Ec8Long},
                                {"ec8_masonry", Masonry},
                                {"ec8_not_found_drift", Ec8NotFoundDrift},
                                {"ntc2008", Ntc2008},
                                {"ntc2018", Ntc2018}};

} // namespace

TEST(PushoverReport, IsTheGoldenTextToTheByte)
{
    for (const T_GOLDEN& g : kGolden) {
        const std::string text = FileText(std::string(QM_RPS_GOLDEN) + "/" + g.file + ".txt");
        ASSERT_FALSE(text.empty()) << g.file;
        EXPECT_EQ(text, PushoverReportText(g.make())) << g.file;
    }
}

// Every column is found again whatever the size and sign of its numbers, in all plot types.
TEST(PushoverReport, TheCurveTableReadsBack)
{
    const std::vector<double> values{-1.23456e-300, 9.99999e+300, -0.0, 1e15, -1e100, 0.00390625};
    for (int type = 0; type <= 8; ++type) {
        T_PUSH_EVALUATION e = Base(PUSH_METHOD::Atc40);
        e.curve = {static_cast<PLOT_TYPE>(type), values, values};
        std::istringstream in(PushoverCurveText(e));
        std::string line;
        while (std::getline(in, line) && !line.starts_with("----------")) {
        }
        for (std::size_t i = 0; i < values.size(); ++i) {
            ASSERT_TRUE(std::getline(in, line));
            std::istringstream row(line);
            const std::vector<std::string> words{std::istream_iterator<std::string>(row), {}};
            ASSERT_LE(3U, words.size()) << line;
            EXPECT_EQ(std::to_string(i), words[0]);
            for (const std::string& word :
                 {words[1], words.back()}) { // a drift has ": 1/ n" between
                EXPECT_NEAR(values[i], std::stod(word), 5e-6 * std::abs(values[i])) << line;
                EXPECT_EQ(std::signbit(values[i]), std::signbit(std::stod(word))) << line;
            }
        }
    }
}

TEST(PushoverReport, WritesTheWholeTextOrNothing)
{
    const std::string folder = testing::TempDir() + "pushoverreport_test";
    std::filesystem::create_directory(folder);
    const std::string path = folder + "/report.txt";
    std::string error = "old";
    const T_PUSH_EVALUATION e = Masonry();
    ASSERT_EQ(1, WritePushoverReport(e, path, error)) << error;
    EXPECT_EQ(PushoverReportText(e), FileText(path));
    ASSERT_EQ(1, WritePushoverCurve(e, path, error)) << error;
    EXPECT_EQ(PushoverCurveText(e), FileText(path));
    EXPECT_TRUE(PushoverReportText(e).ends_with(PushoverCurveText(e)));
    error.clear();
    const std::string missing = folder + "/none/report.txt";
    EXPECT_EQ(0, WritePushoverReport(e, missing, error));
    EXPECT_NE(std::string::npos, error.find(missing));
    EXPECT_FALSE(std::filesystem::exists(folder + "/none"));
    std::filesystem::remove_all(folder);
}
