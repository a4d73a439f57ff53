#pragma once

#include <CLI/CLI.hpp>
#include <optional>
#include <string>
#include <vector>

// What pigmo and pigmo-editor share on their command lines: --version, one-line usage errors and the
// exit status.

inline constexpr int kExitSuccess = 0;
inline constexpr int kExitFailed = 1;  // the operation failed; the reason is on stderr
inline constexpr int kExitUsage = 2;   // the command line was wrong

// The help's closing paragraph on the exit status.
inline constexpr const char* kExitStatusHelp =
    "Exit status: 0 on success, 1 when the operation failed (the reason is printed on stderr), 2 when the "
    "command line was wrong.";

// Names the program, adds --version and makes a usage error one line on stderr.
void SetUpCommandLine(CLI::App& app, const std::string& program);

// Parses the arguments (in the parser's order, last first). Returns the exit status when the program
// is done already: after --help or --version (0), or after a usage error (2).
std::optional<int> ParseCommandLine(CLI::App& app, std::vector<std::string>& arguments);
