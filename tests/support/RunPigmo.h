#pragma once

// Runs the built pigmo binary (PIGMO_CLI), or any shell command, and collects what it prints.
#include <sys/wait.h>
#include <unistd.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>

struct RunResult {
    int exitCode = -1;  // -1 when the program did not exit normally
    std::string out;
    std::string err;
};

inline std::string ReadWholeFile(const std::filesystem::path& path) {
    std::ifstream file(path);
    std::stringstream text;
    text << file.rdbuf();
    return text.str();
}

// Runs COMMAND with sh, INPUT on its standard input, and collects what it prints.
inline RunResult RunShell(const std::string& command, const std::string& input = "") {
    char pattern[] = "/tmp/pigmo-cli-test-XXXXXX";
    const std::filesystem::path dir = mkdtemp(pattern);
    std::ofstream(dir / "in", std::ios::binary) << input;
    const std::string redirected = command + " <'" + (dir / "in").string() + "' >'" + (dir / "out").string() +
                                   "' 2>'" + (dir / "err").string() + "'";
    const int status = std::system(redirected.c_str());
    RunResult result;
    result.exitCode = WIFEXITED(status) ? WEXITSTATUS(status) : -1;
    result.out = ReadWholeFile(dir / "out");
    result.err = ReadWholeFile(dir / "err");
    std::filesystem::remove_all(dir);
    return result;
}

// ARGUMENTS are shell words after "pigmo"; INPUT goes to standard input. SHELL_PREFIX comes before the
// command: a "ulimit ...;" or variable assignments.
inline RunResult RunPigmo(const std::string& arguments, const std::string& input = "",
                          const std::string& shellPrefix = "") {
    return RunShell(shellPrefix + " '" + PIGMO_CLI + "' " + arguments, input);
}
