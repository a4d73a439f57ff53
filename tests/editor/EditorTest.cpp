// pigmo-editor as a person uses it: started without a display, and in an X server without a screen
// (Xvfb), clicked and typed at with xdotool.
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <nlohmann/json.hpp>
#include <string>

#include "MaterialEditor.h"
#include "PluginLibrary.h"
#include "RunPigmo.h"
#include "Scene.h"
#include "TempFolder.h"
#include "Window.h"

namespace {

const std::string kEditor = PIGMO_EDITOR;
const std::string kTestBook = std::string(PIGMO_PALETTE_SOURCE_DIR) + "Test Color Samples.cxf";

bool Installed(const std::string& program) {
    return std::system(("command -v " + program + " >/dev/null 2>&1").c_str()) == 0;
}

TEST(Editor, SaysInOneLineThatThereIsNoDisplay) {
    const RunResult result = RunShell("env -u DISPLAY -u WAYLAND_DISPLAY '" + kEditor + "'");
    EXPECT_EQ(result.exitCode, 1);
    EXPECT_EQ(result.err, "pigmo-editor: cannot open a display (DISPLAY and WAYLAND_DISPLAY are not set)\n");
}

TEST(Editor, HelpNeedsNoDisplay) {
    const RunResult result = RunShell("env -u DISPLAY -u WAYLAND_DISPLAY '" + kEditor + "' --help");
    EXPECT_EQ(result.exitCode, 0) << result.err;
    EXPECT_NE(result.out.find("SCENE"), std::string::npos) << result.out;
    EXPECT_NE(result.out.find("Ctrl+S"), std::string::npos) << result.out;
}

// Where in the window a click picks a row of the palette: the palette control (1003) lies at 4, 88
// and is 208 x 119 dialog units; seven rows share its height, and its right 70 pixels are the strip.
POINT PaletteRow(const std::string& scene, int row) {
    Pigmo::Host::PluginLibrary library(Pigmo::Host::PluginLibrary::DefaultPath());
    Pigmo::Host::Scene loaded = Pigmo::Host::Scene::Load(scene, library.Classes());
    Pigmo::Host::MaterialEditor editor;
    editor.Open(*loaded.Maps().front());
    RECT palette{4, 88, 4 + 208, 88 + 119};
    MapDialogRect(editor.Rollout(), &palette);
    const double height = palette.bottom - palette.top;
    return {palette.left + (palette.right - palette.left - 70) / 2,
            palette.top + static_cast<LONG>((row + 0.5) * height / 7)};
}

class EditorUnderXvfb : public TempFolder {};

TEST_F(EditorUnderXvfb, ClickOnASwatchPicksItAndCtrlSSavesTheScene) {
    for (const char* program : {"xvfb-run", "xdotool"})
        if (!Installed(program))
            GTEST_SKIP() << program << " is not installed, so the editor cannot be driven";
    const std::string scene = root_ + "/scene.json";
    const RunResult made = RunPigmo("map new '" + scene + "' --book '" + kTestBook + "' --pick 0");
    ASSERT_EQ(made.exitCode, 0) << made.err;
    const POINT click = PaletteRow(scene, 3);

    const std::string script = Write("drive.sh", R"sh(set -eu
export GSK_RENDERER=cairo NO_AT_BRIDGE=1 GTK_A11Y=none
# GTK keeps its allocations until the process ends; the host's code is checked by the headless tests.
export ASAN_OPTIONS="${ASAN_OPTIONS:+$ASAN_OPTIONS:}detect_leaks=0"
"$EDITOR" "$DIR/scene.json" >"$DIR/editor.out" 2>"$DIR/editor.err" &
editor=$!
trap 'kill $editor 2>/dev/null || true' EXIT
window=$(timeout 60 xdotool search --sync --onlyvisible --name '^scene\.json - pigmo-editor$' | head -n 1)
sleep 1
xdotool mousemove --window "$window" "$X" "$Y"
sleep 0.3
xdotool click 1
sleep 0.5
xdotool getwindowname "$window" >"$DIR/title-after-click"
xdotool key ctrl+s
for i in $(seq 100); do
  case "$(xdotool getwindowname "$window")" in '*'*) sleep 0.1 ;; *) break ;; esac
done
xdotool getwindowname "$window" >"$DIR/title-after-save"
if command -v import >/dev/null; then import -window root "$DIR/screen.png"; fi
)sh");
    const RunResult run = RunShell("EDITOR='" + kEditor + "' DIR='" + root_ +
                                   "' X=" + std::to_string(click.x) + " Y=" + std::to_string(click.y) +
                                   " timeout 180 xvfb-run -a -s '-screen 0 800x700x24' sh '" + script + "'");
    ASSERT_EQ(run.exitCode, 0) << run.err << ReadWholeFile(root_ + "/editor.err");
    EXPECT_EQ(ReadWholeFile(root_ + "/title-after-click"), "*scene.json - pigmo-editor\n");
    EXPECT_EQ(ReadWholeFile(root_ + "/title-after-save"), "scene.json - pigmo-editor\n");
    const nlohmann::json saved = nlohmann::json::parse(ReadWholeFile(scene));
    EXPECT_EQ(saved["maps"][0]["parameters"]["1"]["value"], 3);
    EXPECT_EQ(saved["maps"][0]["parameters"]["2"]["value"], "TCS04");
}

}  // namespace
