#include "program.h"

#include <algorithm>
#include <array>
#include <fcntl.h>
#include <gtest/gtest.h>
#include <sstream>
#include <sys/prctl.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include <linux/capability.h>

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

void SendTo(const std::string& path, int descriptor)
{
    const int file = open(path.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0600);
    if (file < 0 || dup2(file, descriptor) < 0) _exit(126);
}

/// In the child, before the program starts.
void Prepare(const T_RUN_OPTIONS& o, const std::string& outPath, const std::string& errPath)
{
    SendTo(outPath, STDOUT_FILENO);
    SendTo(errPath, STDERR_FILENO);
    if (!o.folder.empty() && chdir(o.folder.c_str()) != 0) _exit(126);
    if (o.fileSizeLimit > 0) {
        const auto bytes = static_cast<rlim_t>(o.fileSizeLimit);
        const rlimit limit{bytes, bytes};
        if (setrlimit(RLIMIT_FSIZE, &limit) != 0) _exit(126);
    }
    // Without this right root, too, is held by the mode of files and folders.
    if (o.obeyModes && geteuid() == 0 && prctl(PR_CAPBSET_DROP, CAP_DAC_OVERRIDE, 0, 0, 0) != 0)
        _exit(126);
}

T_RUN Run(const std::string& file, const std::vector<std::string>& arguments,
          const T_RUN_OPTIONS& options)
{
    const CTempFolder texts;
    const std::string outPath = texts / "out", errPath = texts / "err";
    std::vector<std::string> copies{file};
    copies.insert(copies.end(), arguments.begin(), arguments.end());
    std::vector<char*> argv;
    for (std::string& text : copies)
        argv.push_back(text.data());
    argv.push_back(nullptr);

    const pid_t child = fork();
    if (child == 0) {
        Prepare(options, outPath, errPath);
        execv(file.c_str(), argv.data());
        _exit(127);
    }
    int status = 0;
    T_RUN run;
    if (child > 0 && waitpid(child, &status, 0) == child && WIFEXITED(status))
        run.code = WEXITSTATUS(status);
    run.out = ReadText(outPath);
    run.err = ReadText(errPath);
    return run;
}

} // namespace

T_RUN RunProgram(const std::vector<std::string>& arguments, const T_RUN_OPTIONS& options)
{
    return Run(QM_PROGRAM, arguments, options);
}

T_RUN RunShell(const std::string& line, const fs::path& folder)
{
    const std::string bin = fs::path(QM_PROGRAM).parent_path().string();
    T_RUN_OPTIONS options;
    options.folder = folder;
    return Run("/bin/sh", {"-c", "PATH='" + bin + "':$PATH; " + line}, options);
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

std::string SmallCaseWith(const std::string& from, const std::string& to)
{
    std::string text = kSmallCase;
    const auto at = text.find(from);
    if (at == std::string::npos) throw std::logic_error("not in the small case: " + from);
    return text.replace(at, from.size(), to);
}
