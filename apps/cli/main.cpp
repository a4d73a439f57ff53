#include <CLI/CLI.hpp>
#include <cctype>
#include <cstdio>
#include <new>
#include <string>
#include <vector>

#include "CommandLine.h"
#include "Commands.h"
#include "Output.h"

namespace {

// The parser takes "-.5" for an option; written "-0.5" it is the value it means.
std::vector<std::string> Arguments(int argc, char** argv) {
    std::vector<std::string> arguments(argv + 1, argv + argc);
    for (std::string& argument : arguments) {
        if (argument.size() > 2 && argument[0] == '-' && argument[1] == '.' &&
            std::isdigit(static_cast<unsigned char>(argument[2])))
            argument.insert(1, "0");
    }
    // The parser takes its arguments last first.
    return {arguments.rbegin(), arguments.rend()};
}

int Run(int argc, char** argv) {
    CLI::App app{
        "pigmo: color conversions, color differences, ISCC-NBS names, harmonies, color books and the Color "
        "Map"};
    SetUpCommandLine(app, "pigmo");
    app.require_subcommand(1);
    app.footer(std::string(
                   "Run 'pigmo SUBCOMMAND --help' for a subcommand's arguments, defaults and an example.\n") +
               kExitStatusHelp);
    int exitCode = kExitSuccess;
    AddTranslateCommand(app, exitCode);
    AddDeltaECommand(app, exitCode);
    AddHarmonyCommand(app, exitCode);
    AddNameCommand(app, exitCode);
    AddExtractCommand(app, exitCode);
    AddBookCommand(app, exitCode);
    AddPalettesCommand(app, exitCode);
    AddMapCommand(app, exitCode);
    // The parser would say only that a subcommand is required.
    const auto known = [&app](const char* name) {
        for (const CLI::App* command : app.get_subcommands({}))
            if (command->check_name(name)) return true;
        return false;
    };
    if (argc > 1 && argv[1][0] != '-' && !known(argv[1])) {
        std::fprintf(stderr, "pigmo: unknown command '%s' (see --help)\n", Printable(argv[1]).c_str());
        return kExitUsage;
    }
    std::vector<std::string> arguments = Arguments(argc, argv);
    if (const std::optional<int> done = ParseCommandLine(app, arguments)) return *done;
    return exitCode;
}

}  // namespace

int main(int argc, char** argv) {
    // The commands catch their own failures; this is for the parser and the setup around them.
    try {
        return Run(argc, argv);
    } catch (const std::bad_alloc&) {
        std::fputs("pigmo: out of memory\n", stderr);
    } catch (const std::exception& e) {
        std::fprintf(stderr, "pigmo: %s\n", Printable(e.what()).c_str());
    }
    return kExitFailed;
}
