// pigmo-editor: the Color Map's editor panel in a window. The program is a host: it loads
// libpigmo.so as the 3D program does and shows the map's rollout through the host's material editor.
#include <CLI/CLI.hpp>
#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <new>
#include <stdexcept>
#include <string>

#include "CommandLine.h"
#include "Descriptor.h"
#include "EditorWindow.h"
#include "Output.h"
#include "PluginLibrary.h"
#include "Scene.h"

// GLib defines TRUE and FALSE as macros; the host's headers, which declare them, come first.
#include <gtk/gtk.h>

namespace {

bool Set(const char* variable) {
    const char* value = std::getenv(variable);
    return value != nullptr && value[0] != '\0';
}

int Run(int argc, char** argv) {
    CLI::App app{"pigmo-editor: the Color Map's editor panel in a window"};
    SetUpCommandLine(app, "pigmo-editor");
    std::string scenePath;
    app.add_option("SCENE", scenePath, "the scene file (JSON) whose first Color Map to edit");
    app.footer(
        "Shows the map's panel as the 3D program's material editor does: choose a book from the list or with "
        "the file button, scroll the palette with its strip, pick a color by clicking a swatch; the fields, "
        "swatch, information and reflectance curve follow, and the tooltip names the picked color. Ctrl+S "
        "saves the scene (through a temporary file, renamed into place); the title shows '*' while changes "
        "are unsaved. Without SCENE the editor starts a new scene with a new map (the first system palette, "
        "its first color) and Ctrl+S asks where to save it.\n"
        "Example: pigmo-editor scene.json\n" +
        std::string(kExitStatusHelp));
    std::vector<std::string> arguments(argv + 1, argv + argc);
    std::reverse(arguments.begin(), arguments.end());
    if (const std::optional<int> done = ParseCommandLine(app, arguments)) return *done;

    if (!Set("DISPLAY") && !Set("WAYLAND_DISPLAY")) {
        std::fputs("pigmo-editor: cannot open a display (DISPLAY and WAYLAND_DISPLAY are not set)\n", stderr);
        return kExitFailed;
    }
    if (!gtk_init_check()) {
        const char* display =
            Set("WAYLAND_DISPLAY") ? std::getenv("WAYLAND_DISPLAY") : std::getenv("DISPLAY");
        std::fprintf(stderr, "pigmo-editor: cannot open a display (GTK cannot open \"%s\")\n",
                     Printable(display).c_str());
        return kExitFailed;
    }

    const std::string pluginPath = Pigmo::Host::PluginLibrary::DefaultPath();
    Pigmo::Host::PluginLibrary library(pluginPath);
    if (library.Find(Pigmo::ColorMap::kColorMapClassID, TEXMAP_CLASS_ID) == nullptr)
        throw std::runtime_error(pluginPath + " holds no Color Map");
    Pigmo::Host::Scene scene = scenePath.empty() ? Pigmo::Host::Scene(library.Classes())
                                                 : Pigmo::Host::Scene::Load(scenePath, library.Classes());
    // A new map takes the first system palette and picks its first color itself.
    if (scenePath.empty()) scene.NewMap(Pigmo::ColorMap::kColorMapClassID);
    if (scene.Maps().empty()) throw std::runtime_error(scenePath + " holds no map");
    EditorWindow window(scene, scenePath);
    window.Run();
    return 0;
}

}  // namespace

int main(int argc, char** argv) {
    try {
        return Run(argc, argv);
    } catch (const std::bad_alloc&) {
        std::fputs("pigmo-editor: out of memory\n", stderr);
    } catch (const std::exception& e) {
        std::fprintf(stderr, "pigmo-editor: %s\n", Printable(e.what()).c_str());
    }
    return kExitFailed;
}
