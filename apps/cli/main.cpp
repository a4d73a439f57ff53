#include <CLI/CLI.hpp>

#include "Commands.h"

int main(int argc, char** argv) {
    CLI::App app{"pigmo: color conversions, color differences, ISCC-NBS names, harmonies and color books"};
    app.require_subcommand(1);
    int exitCode = 0;
    AddTranslateCommand(app, exitCode);
    try {
        app.parse(argc, argv);
    } catch (const CLI::ParseError& e) {
        return app.exit(e);
    }
    return exitCode;
}
