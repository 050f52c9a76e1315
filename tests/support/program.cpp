#include "program.h"

#include <cstdlib>
#include <sstream>
#include <sys/wait.h>

namespace fs = std::filesystem;

const char* const kSmallCase = R"({
 "format": "qm-rps case 1",
 "title": "small frame",
 "units": {"force": "kN", "length": "m"},
 "nodes": [
  {"id": 1, "xyz": [0, 0, 0], "restraint": [1, 1, 1, 1, 1, 1]},
  {"id": 2, "xyz": [0, 0, 3], "mass": [100, 0, 100], "restraint": [0, 1, 0, 1, 0, 1]}
 ],
 "storeys": [{"name": "1F", "height": 3, "nodes": [2]}],
 "modes": [{"period": 0.628, "shape": {"2": [1, 0, 0, 0, 0, 0]}}],
 "spectra": [
  {"name": "ATC", "kind": "atc40", "Ca": 0.4, "Cv": 0.6},
  {"name": "USER", "kind": "user", "T": [0, 0.5, 2], "Sa": [0.4, 1, 0.25]}
 ],
 "pushover": [
  {
   "name": "PX",
   "control_node": 2,
   "direction": "DX",
   "pattern": {"kind": "mode", "modes": [1]},
   "steps": {
    "load_factor": [1, 2, 3],
    "base_reaction": [280, 300, 336],
    "displacement": {"2": [0.028, 0.0653125, 0.14]}
   }
  }
 ],
 "evaluations": [
  {"name": "E1", "push": "PX", "method": "ATC-40", "procedure": "A", "spectrum": "ATC"}
 ]
}
)";

namespace {

std::string WithExamples(std::string line)
{
    for (auto at = line.find('@'); at != std::string::npos; at = line.find('@', at)) {
        const std::size_t length = line.find_first_of(" ;", at) - at;
        const std::string path = ExampleCase(line.substr(at + 1, length - 1));
        line.replace(at, length, path);
        at += path.size();
    }
    return line;
}

} // namespace

T_RUN RunShell(const std::string& line, const fs::path& folder)
{
    const CTempFolder texts;
    const std::string bin = fs::path(QM_PROGRAM).parent_path().string();
    const int status =
        std::system(("cd '" + folder.string() + "' && PATH='" + bin + "':$PATH && { " +
                     WithExamples(line) + " ; } >" + texts / "out" + " 2>" + texts / "err")
                        .c_str());
    return {WIFEXITED(status) ? WEXITSTATUS(status) : -1, ReadText(texts / "out"),
            ReadText(texts / "err")};
}

T_RUN CProgramTest::Run(const std::string& arguments, const std::string& before) const
{
    return RunShell(before + "qm-rps " + arguments, m_folder.Path());
}

std::string CProgramTest::Done(const std::string& arguments) const
{
    const T_RUN run = Run(arguments);
    EXPECT_EQ(0, run.code) << arguments << ": " << run.err;
    return run.out;
}

json CProgramTest::Json(const std::string& arguments, int code) const
{
    const T_RUN run = Run(arguments + " --json -");
    EXPECT_EQ(code, run.code) << arguments << ": " << run.err;
    return json::parse(run.out);
}

std::string CProgramTest::ExpectRefused(const std::string& arguments, int code,
                                        const std::string& says) const
{
    const T_RUN run = Run(arguments);
    EXPECT_EQ(code, run.code) << arguments << ": " << run.err;
    EXPECT_EQ("", run.out) << arguments;
    EXPECT_EQ(1U, Lines(run.err).size()) << arguments << ": " << run.err;
    EXPECT_NE(std::string::npos, run.err.find(says)) << arguments << ": " << run.err;
    return run.err;
}

void ExpectHolds(const std::string& text, std::initializer_list<const char*> pieces)
{
    for (const char* piece : pieces)
        EXPECT_NE(std::string::npos, text.find(piece)) << piece << " is not in " << text;
}

std::string With(std::string text, const std::string& from, const std::string& to)
{
    const auto at = text.find(from);
    if (at == std::string::npos) throw std::logic_error("not in the text: " + from);
    return text.replace(at, from.size(), to);
}

std::vector<std::string> Lines(const std::string& text)
{
    std::vector<std::string> lines;
    std::istringstream in(text);
    for (std::string line; std::getline(in, line);)
        lines.push_back(line);
    return lines;
}

fs::path ProjectFolder()
{
    return QM_PROJECT;
}

std::string ExampleCase(const std::string& name)
{
    return (ProjectFolder() / "examples" / name / "case.json").string();
}
