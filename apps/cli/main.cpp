#include <CLI/CLI.hpp>

#include "Commands.h"

int main(int argc, char** argv) {
    CLI::App app{"pigmo: color conversions, color differences, ISCC-NBS names, harmonies and color books"};
    app.require_subcommand(1);
    // One line per error; the hint to --help rides on the same line.
    app.failure_message([](const CLI::App*, const CLI::Error& e) {
        return "pigmo: " + std::string(e.what()) + " (see --help)\n";
    });
    int exitCode = 0;
    AddTranslateCommand(app, exitCode);
    AddDeltaECommand(app, exitCode);
    AddHarmonyCommand(app, exitCode);
    AddNameCommand(app, exitCode);
    AddExtractCommand(app, exitCode);
    AddBookCommand(app, exitCode);
    AddPalettesCommand(app, exitCode);
    try {
        app.parse(argc, argv);
    } catch (const CLI::ParseError& e) {
        return app.exit(e);
    }
    return exitCode;
}
