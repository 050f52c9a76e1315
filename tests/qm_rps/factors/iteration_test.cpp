#include "iterationperson.h"
#include "qm_db/dbdoc.h"
#include "tempfolder.h"

#include "qm_rps/unknownloadfactoriteranaldlg.h"

#include <filesystem>
#include <gtest/gtest.h>
#include <sstream>

namespace {

using LINES = std::vector<std::string>;

/// Says what is asked of it; refuses one operation by its name.
class CScriptedHost : public IUlfIterationHost {
public:
    std::string m_path;
    std::string m_fail; // operation to refuse
    /// By solution, of a pretension and another unknown.
    std::vector<std::vector<double>> m_factors{{2.0, 7.0}, {1.0, 7.0}};
    LINES m_log;
    int m_busy = 2;

    explicit CScriptedHost(std::string path) : m_path(std::move(path)) {}
    std::string ModelPath() const override { return m_path; }
    int Solve(std::vector<T_ULF_ITER_ROW>& rows, std::optional<T_FINDING>& said) override
    {
        if (!Do("solve" + std::to_string(m_solved))) {
            said.emplace().text = "no factors";
            return 0;
        }
        const auto& f = m_factors[std::min(m_solved++, m_factors.size() - 1)];
        rows = {{"S1/First Step", f[0], true}, {"S2/Last Step", f[1], false}};
        return 1;
    }
    int SaveCopy(const std::string& path) override
    {
        if (!Do("save " + std::filesystem::path(path).filename().string())) return 0;
        m_path = path;
        return 1;
    }
    int StartEdit(const std::string& title) override { return Do("start " + title); }
    int ScalePretension(std::size_t unknown, double factor) override
    {
        return Do("scale " + std::to_string(unknown) + " " + std::to_string(factor).substr(0, 4));
    }
    int CloseEdit() override { return Do("close"); }
    void CancelEdit() override { (void)Do("cancel"); }
    void UndoEdit() override { (void)Do("undo"); }
    void CancelAnalysis() override
    {
        m_left = 0;
        m_fail = "post";
        (void)Do("stop");
    }
    int StartAnalysis() override
    {
        m_left = m_busy;
        return Do("analyse");
    }
    bool IsExcuted() override { return m_left > 0; }
    void Wait() override
    {
        --m_left;
        (void)Do("wait");
    }
    bool IsPostMode() override { return Do("post") != 0; }

private:
    int Do(const std::string& what)
    {
        m_log.push_back(what);
        return m_fail.empty() || what.rfind(m_fail, 0) != 0;
    }
    std::size_t m_solved = 0;
    int m_left = 0;
};

class UlfIteration : public testing::Test {
protected:
    int Run(int required = 5, double tolerance = 0.001) { return Run(m_host, required, tolerance); }
    int Run(CScriptedHost& host, int required, double tolerance)
    {
        CUlfIteration run(host, m_person, {required, tolerance});
        const int done = run.Run();
        m_end = run.End();
        m_said = run.Said();
        m_history = run.History();
        return done;
    }
    std::string Report() const { return ReadText(m_folder / "frame.ulf"); }
    std::size_t Blocks() const
    {
        std::istringstream lines(Report());
        std::size_t n = 0;
        for (std::string line; std::getline(lines, line);)
            n += line.find("Iteration = ") != std::string::npos;
        return n;
    }

    CTempFolder m_folder;
    CScriptedHost m_host{m_folder / "frame.ext"};
    CPerson m_person;
    ULF_ITER_END m_end{};
    std::optional<T_FINDING> m_said;
    std::vector<T_ULF_ITER_STEP> m_history;
};

} // namespace

TEST_F(UlfIteration, AsksTheHostInOrderUntilTheFactorsAreOne)
{
    EXPECT_EQ(1, Run());
    EXPECT_EQ(ULF_ITER_END::Converged, m_end);
    EXPECT_EQ((LINES{"solve0", "save frame_01.ext",
                     "start Change load values for iterative analysis", "scale 0 2.00",
                     "scale 1 7.00", "close", "analyse", "wait", "wait", "post", "solve1"}),
              m_host.m_log);
    ASSERT_EQ(2U, m_history.size());
    EXPECT_EQ(1.0, m_history[0].tolerance); // the other unknown's 7 does not enter
    EXPECT_EQ(0.0, m_history[1].tolerance);
    EXPECT_EQ(2U, Blocks());
}

TEST_F(UlfIteration, WritesTheReportToTheLetter)
{
    ASSERT_EQ(1, Run(3, 0.25));
    const std::string rule =
        "     ======================================================================\n";
    const std::string frame =
        "         +============================================================+\n";
    const std::string report = Report();
    const std::string settings = rule + "     Required Number of Iterations = 3\n" +
                                 "     Convergence Tolerance         = 0.250000\n" + rule + "\n\n";
    const auto block = [&](const char* head, const std::string& file, const char* factor,
                           const char* tolerance) {
        return std::string("     Iteration = ") + head +
               "\n     File Name = " + m_folder.File(file) + "\n" + rule +
               "        NO                    Stage/Step              FACTOR   PRETENSION\n" +
               rule + "         1                 S1/First Step             " + factor +
               "          YES\n" +
               "         2                  S2/Last Step             7.00000           NO\n" +
               rule + "     Current Tolerance = " + tolerance + "\n" + rule + "\n\n";
    };
    const std::string tail = "\n\n" + settings + block("0", "frame.ext", "2.00000", "1.000000") +
                             block("1", "frame_01.ext", "1.00000", "0.000000");
    ASSERT_GT(report.size(), tail.size());
    const std::string head = report.substr(0, report.size() - tail.size());
    EXPECT_EQ(tail, report.substr(head.size()));
    EXPECT_EQ(frame, head.substr(0, frame.size()));
    EXPECT_EQ(frame, head.substr(head.size() - frame.size()));
    EXPECT_EQ(0U, head.size() % frame.size()); // every line is 72 characters long
    EXPECT_NE(std::string::npos, head.find("         |  QM RPS - Unknown Load Factor"));
}

TEST_F(UlfIteration, CutsThePlaceToThirtyCharacters)
{
    T_ULF_ITER_STEP step{0, "f", {{std::string(28, 'a') + "\xC3\xA9/First Step", 1.0, true}}, 0.0};
    EXPECT_NE(std::string::npos,
              UlfIterBlock(step).find("         1" + std::string(28, 'a') +
                                      "\xC3\xA9/             1.00000          YES\n"));
}

TEST_F(UlfIteration, EndsWithinTheToleranceOrAfterTheRequiredNumber)
{
    const struct {
        std::vector<std::vector<double>> factors;
        int required;
        ULF_ITER_END end;
        std::size_t steps;
    } kCases[] = {
        {{{1.0, 1.0}}, 5, ULF_ITER_END::Converged, 2}, // one iteration is always made
        {{{2, 1}, {1.002, 1}, {1.0005, 9}}, 5, ULF_ITER_END::Converged, 3},
        {{{2, 1}, {3, 1}, {4, 1}, {5, 1}}, 3, ULF_ITER_END::Required, 4}, // runs away
    };
    for (const auto& c : kCases) {
        CScriptedHost host(m_folder / "frame.ext");
        host.m_factors = c.factors;
        EXPECT_EQ(1, Run(host, c.required, 0.001));
        EXPECT_EQ(c.end, m_end);
        EXPECT_EQ(c.steps, m_history.size());
    }
    EXPECT_NEAR(0.5, UlfIterTolerance({{"", 1.3, true}, {"", 0.6, true}, {"", 8, false}}), 1e-15);
    EXPECT_EQ("frame.v2_12.json", UlfIterCopyPath("frame.v2.json", 12));
    EXPECT_EQ("a.b/frame_03", UlfIterCopyPath("a.b/frame.qmdb", 3).substr(0, 12));
}

TEST_F(UlfIteration, StopsWhereTheHostRefuses)
{
    const struct {
        const char* fail;
        ULF_ITER_END end;
        const char* last; // operation of the log
        std::size_t blocks;
    } cases[] = {
        {"solve0", ULF_ITER_END::NotSolved, "solve0", 0},
        {"save", ULF_ITER_END::NotSaved, "save frame_01.ext", 1},
        {"start", ULF_ITER_END::NotScaled, "start Change load values for iterative analysis", 1},
        {"scale 1", ULF_ITER_END::NotScaled, "cancel", 1},
        {"close", ULF_ITER_END::NotScaled, "cancel", 1},
        {"analyse", ULF_ITER_END::NotAnalysed, "save frame_01.ext", 1},
        {"post", ULF_ITER_END::NotAnalysed, "save frame_01.ext", 1},
        {"solve1", ULF_ITER_END::NotSolved, "solve1", 1},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.fail);
        std::filesystem::remove(m_folder / "frame.ulf");
        CScriptedHost host(m_folder / "frame.ext");
        host.m_fail = c.fail;
        EXPECT_EQ(0, Run(host, 5, 0.001));
        EXPECT_EQ(c.end, m_end);
        EXPECT_EQ(c.last, host.m_log.back());
        EXPECT_EQ(c.blocks, Blocks());
        EXPECT_EQ(c.end == ULF_ITER_END::NotAnalysed, std::ranges::count(host.m_log, "undo") > 0);
        EXPECT_EQ(c.end == ULF_ITER_END::NotSolved, m_said.has_value());
    }
}

TEST_F(UlfIteration, GoesOnOnlyWhenThePersonWantsIt)
{
    m_host.m_factors = {{2, 1}}; // never converges
    m_person.m_accept = 0;
    EXPECT_EQ(1, Run());
    EXPECT_EQ(ULF_ITER_END::Declined, m_end);
    EXPECT_EQ("", Report());
    m_person.m_accept = 2;
    EXPECT_EQ(1, Run());
    EXPECT_EQ(ULF_ITER_END::Declined, m_end);
    EXPECT_EQ(3U, Blocks());
    m_person.m_accept = 2, m_person.m_questions = 0;
    m_person.m_unasked = true; // for the rest of the run
    EXPECT_EQ(2, Run(4) + Run(4));
    EXPECT_EQ(ULF_ITER_END::Required, m_end);
    EXPECT_EQ(2, m_person.m_questions); // another run asks again
}

TEST_F(UlfIteration, AsksBeforeAnExistingReportIsOverwritten)
{
    const std::string path = m_folder / "frame.ulf";
    for (const bool overwrite : {false, true}) {
        WriteText(path, "old\n");
        m_person.m_overwrite = overwrite;
        EXPECT_EQ(1, Run(0)); // solves once: none is required
        EXPECT_EQ(ULF_ITER_END::Required, m_end);
        EXPECT_EQ(0U, Report().find(overwrite ? "         +=" : "old\n         +="));
    }
    EXPECT_EQ((LINES{path, path}), m_person.m_reports);
    std::filesystem::remove(path);
    std::filesystem::create_directory(path); // can't be written
    EXPECT_EQ(0, Run());
    EXPECT_EQ(ULF_ITER_END::ReportNotWritten, m_end);
    EXPECT_EQ("IDS_QM_ULF_REPORT_NOT_WRITTEN", m_said.value().messageKey);
}

TEST_F(UlfIteration, CancelDuringAnAnalysisTakesTheLoadsBack)
{
    m_host.m_factors = {{2, 1}};
    m_host.m_busy = 3;
    std::vector<int> told;
    m_person.m_goesOn = [&](int done, int) {
        told.push_back(done);
        return told.size() != 7; // in the second analysis, at its second look
    };
    EXPECT_EQ(0, Run());
    EXPECT_EQ(ULF_ITER_END::Cancelled, m_end);
    EXPECT_EQ((std::vector<int>{0, 0, 0, 0, 1, 1, 1}), told);
    const LINES end{"analyse", "wait", "stop", "wait", "post", "undo", "save frame_02.ext"};
    ASSERT_GT(m_host.m_log.size(), end.size());
    EXPECT_EQ(end, LINES(m_host.m_log.end() - static_cast<int>(end.size()), m_host.m_log.end()));
    EXPECT_EQ(2U, m_history.size());
    EXPECT_EQ(2U, Blocks());
}

TEST(UlfIterationSettings, StayWithTheDocumentUnderTheirKey)
{
    CDBDoc doc;
    CUnknownLoadFactorIterAnal* settings = CUnknownLoadFactorIterAnal::Of(doc.DynModules());
    EXPECT_EQ(settings, doc.DynModules().GetDynModule("43ABD68B_707D_010A_77B6_2AA6BE4C"));
    EXPECT_EQ((T_ULF_ITER_SETTINGS{5, 0.001}), settings->Settings());

    CUnknownLoadFactorIterAnalDlg dialog(*settings);
    dialog.OnSpin(1);
    for (const char* bad : {"-1", "nan", "1,5", ""}) {
        dialog.m_tolerance = bad;
        EXPECT_EQ(0, dialog.OnOK()) << bad;
    }
    dialog.m_tolerance = "1e-6";
    EXPECT_EQ(1, dialog.OnOK());
    EXPECT_EQ((T_ULF_ITER_SETTINGS{6, 1e-6}), settings->Settings());
}
