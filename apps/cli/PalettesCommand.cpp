#include <cstdio>
#include <stdexcept>
#include <string>
#include <vector>

#include "Commands.h"
#include "PaletteDiscovery.h"
#include "Paths.h"
#include "ValueLines.h"

namespace {

void RunPalettes() {
    std::size_t systemCount = 0;
    const std::vector<std::string> paths = Pigmo::CollectPalettePaths(&systemCount);
    std::string listing;
    for (std::size_t i = 0; i < paths.size(); ++i) {
        const std::string name = Pigmo::PaletteDisplayName(paths[i].c_str());
        listing += std::string(i < systemCount ? "system" : "user  ") + "  " +
                   (name.empty() ? "(not a readable book)" : name) + "\n        " +
                   Pigmo::Platform::NativePath(paths[i]) + "\n";
    }
    if (paths.empty()) listing = "no palettes found\n";
    if (std::fputs(listing.c_str(), stdout) < 0) throw std::runtime_error("cannot write the output");
}

}  // namespace

void AddPalettesCommand(CLI::App& app, int& exitCode) {
    CLI::App* command = app.add_subcommand("palettes", "List the palette files found on this machine");
    command->footer(
        "Lists each palette's name and path: first the system palettes (\"Resources/System Palettes/\" "
        "below the suite's InstallLocation: the data folder of this installation, or PIGMO_INSTALL_LOCATION, "
        "which must end with a separator), then the user's (Pigmo/Tintora/User/ below $XDG_DATA_HOME, "
        "else ~/.local/share), each in name order.");
    command->callback([&exitCode] { exitCode = RunCommand("palettes", RunPalettes); });
}
