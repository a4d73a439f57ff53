#include "CommandLine.h"

#include "Output.h"

void SetUpCommandLine(CLI::App& app, const std::string& program) {
    app.name(program);
    app.set_version_flag("--version", program + " " + PIGMO_VERSION);
    // One line per error; the hint to --help rides on the same line.
    app.failure_message([program](const CLI::App*, const CLI::Error& e) {
        return program + ": " + Printable(e.what()) + " (see --help)\n";
    });
}

std::optional<int> ParseCommandLine(CLI::App& app, std::vector<std::string>& arguments) {
    try {
        app.parse(arguments);
    } catch (const CLI::ParseError& e) {
        // Help and version print and succeed; every other parse error is wrong usage.
        return app.exit(e) == 0 ? kExitSuccess : kExitUsage;
    }
    return std::nullopt;
}
