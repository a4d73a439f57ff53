#include <cstdio>
#include <memory>
#include <stdexcept>
#include <string>
#include <vector>

#include "ColorBookReader.h"
#include "Commands.h"
#include "Output.h"
#include "PaletteDiscovery.h"
#include "Paths.h"
#include "Settings.h"
#include "ValueLines.h"

namespace {

void RunPalettes(bool json) {
    for (const std::string& problem : Pigmo::Platform::UnusableSettings())
        std::fprintf(stderr, "pigmo palettes: warning: %s\n", Printable(problem).c_str());
    std::size_t systemCount = 0;
    const std::vector<std::string> paths = Pigmo::CollectPalettePaths(&systemCount);
    nlohmann::ordered_json list = nlohmann::ordered_json::array();
    for (std::size_t i = 0; i < paths.size(); ++i) {
        std::string name;
        const char* ignored = nullptr;
        const bool readable = Pigmo::ReadPaletteName(paths[i].c_str(), name, &ignored);
        const std::string path = Pigmo::Platform::NativePath(paths[i]);
        if (json) {
            list.push_back({{"kind", i < systemCount ? "system" : "user"},
                            {"name", readable ? nlohmann::ordered_json(name) : nlohmann::ordered_json()},
                            {"path", path}});
            continue;
        }
        if (!readable)
            name = "(not a readable book)";
        else
            name = name.empty() ? "(unnamed palette)" : Printable(name);
        WriteOut(std::string(i < systemCount ? "system" : "user  ") + "  " + name + "\n        " +
                 Printable(path) + "\n");
    }
    if (json)
        WriteOut(JsonText(list) + "\n");
    else if (paths.empty())
        WriteOut("no palettes found\n");
}

}  // namespace

void AddPalettesCommand(CLI::App& app, int& exitCode) {
    auto json = std::make_shared<bool>(false);
    CLI::App* command = app.add_subcommand("palettes", "List the palette files found on this machine");
    command->add_flag("--json", *json,
                      "print a JSON array of {kind, name, path}; an unreadable book's name is null");
    command->footer(
        "Lists each palette's name and path: first the system palettes (\"Resources/System Palettes/\" "
        "below the suite's InstallLocation: the data folder of this installation, or "
        "PIGMO_INSTALL_LOCATION), "
        "then the user's (Pigmo/Tintora/User/ below $XDG_DATA_HOME, else ~/.local/share), each in name "
        "order. A name is read from the start of its book only; a book damaged further on is listed with its "
        "name and reports the damage when it is opened. Settings that cannot be used are reported on "
        "stderr.\n"
        "Example: pigmo palettes --json");
    command->callback([json, &exitCode] { exitCode = RunCommand("palettes", [&] { RunPalettes(*json); }); });
}
