// The arguments of the commands, one source file for each group. `code` gets what a command that
// was asked for has returned.
#pragma once

#include "exitcodes.h"

#include <span>
#include <string>

namespace CLI {
class App;
}

/// Description, labels, version and what stands below; the commands take them over.
void AddHelp(CLI::App& app);
/// What the argument parser refuses, in the language of the user.
std::string ParserWords(const std::string& what);
/// Asks for the command or option that the first unknown word of the command line was meant to be;
/// empty: all are known, or none is near.
std::string MeantWord(const CLI::App& program, std::span<const char* const> words);
void AddModel(CLI::App& app, EXIT_CODE& code);
void AddNew(CLI::App& app, EXIT_CODE& code);
void AddParts(CLI::App& app, EXIT_CODE& code);
void AddEvaluations(CLI::App& app, EXIT_CODE& code);
void AddHingeCommands(CLI::App& app, EXIT_CODE& code);
void AddSection(CLI::App& app, EXIT_CODE& code);
/// Commands below "section".
void AddSectionBars(CLI::App& section, EXIT_CODE& code);
void AddCase(CLI::App& app, EXIT_CODE& code);
void AddAnalyse(CLI::App& app, EXIT_CODE& code);
/// Pictures and tables of results.
void AddViews(CLI::App& app, EXIT_CODE& code);
void AddUlf(CLI::App& app, EXIT_CODE& code);
void AddPush(CLI::App& app, EXIT_CODE& code);
/// Commands below "push" and below "case".
void AddPushSetup(CLI::App& push, EXIT_CODE& code);
void AddCaseGenerate(CLI::App& cases, EXIT_CODE& code);
void AddJudge(CLI::App& app, EXIT_CODE& code);
void AddReport(CLI::App& app, EXIT_CODE& code);
/// "help": of a command by its name, manual pages, completion of shells. After all others.
void AddDocuments(CLI::App& app, EXIT_CODE& code);
void AddRecord(CLI::App& app, EXIT_CODE& code);
