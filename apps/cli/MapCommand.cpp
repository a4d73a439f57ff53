// "pigmo map": the Color Map in a scene. The command is the host: it loads libpigmo.so as a 3D
// program does and reaches the map only through the SDK and the map's own interfaces.
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <memory>
#include <optional>
#include <stdexcept>
#include <string>
#include <vector>

#include "AtomicFile.h"
#include "Commands.h"
#include "Descriptor.h"
#include "IColorPalletteUser.h"
#include "Json.h"
#include "MaterialEditor.h"
#include "MessageBox.h"
#include "Output.h"
#include "Paths.h"
#include "PluginLibrary.h"
#include "Png.h"
#include "Render.h"
#include "Scene.h"
#include "ShaderCreation.h"
#include "ValueLines.h"
#include "ViewportTextures.h"

namespace {

using Pigmo::Host::Json;
using Pigmo::Host::Scene;

// The map's parameter 0, colorBookFilePath: what the file button of its rollout sets.
constexpr ParamID kBookParameter = 0;

struct MapArguments {
    std::string scene;
    std::string book;
    std::string output;
    std::optional<int> pick;
    int size = 256;
    int scale = 1;
    bool sphere = false;
    bool json = false;
};

// The plug-in library, loaded for the command and unloaded after the scene's maps are gone (declare
// it before the scene).
class PluginHost {
public:
    PluginHost() : library_(Pigmo::Host::PluginLibrary::DefaultPath()) {
        if (library_.Find(Pigmo::ColorMap::kColorMapClassID, TEXMAP_CLASS_ID) == nullptr)
            throw std::runtime_error(Pigmo::Host::PluginLibrary::DefaultPath() + " holds no Color Map");
    }
    Scene NewScene() const { return Scene(library_.Classes()); }
    Scene Load(const std::string& path) const { return Scene::Load(path, library_.Classes()); }

private:
    Pigmo::Host::PluginLibrary library_;
};

// Prints the message boxes the plug-in showed since the last look, as "Pigmo Color Map: text";
// returns how many there were.
std::size_t ShowMessageBoxes() {
    const std::vector<Pigmo::Platform::ShownMessageBox> boxes = Pigmo::Platform::TakeMessageBoxes();
    std::fflush(stdout);
    for (const Pigmo::Platform::ShownMessageBox& box : boxes)
        std::fprintf(stderr, "%s\n", Printable(box.caption + ": " + box.text).c_str());
    return boxes.size();
}

// A loaded scene's first map. A book that has gone is reported, and the map still renders its color.
Texmap& FirstMap(const Scene& scene, const std::string& path) {
    ShowMessageBoxes();
    if (scene.Maps().empty()) throw std::runtime_error(path + " holds no map");
    return *scene.Maps().front();
}

// What the palette control sees of the map; it stands in for a click on a swatch.
Pigmo::IColorPalletteUser& Palette(Texmap& map) {
    auto* palette = dynamic_cast<Pigmo::IColorPalletteUser*>(static_cast<Animatable*>(&map));
    if (palette == nullptr) throw std::runtime_error("the map has no palette");
    return *palette;
}

const Pigmo::IColorInformation& CurrentColor(Texmap& map) {
    const auto* color = dynamic_cast<const Pigmo::IColorInformation*>(static_cast<Animatable*>(&map));
    if (color == nullptr) throw std::runtime_error("the map does not describe its color");
    return *color;
}

IParamBlock2& Parameters(Texmap& map) {
    IParamBlock2* block = map.GetParamBlock(0);
    if (block == nullptr) throw std::runtime_error("the map has no parameter block");
    return *block;
}

void Pick(Texmap& map, int index) {
    Pigmo::IColorPalletteUser& palette = Palette(map);
    const unsigned int count = palette.GetColorCount();
    if (index < -1 || (index >= 0 && static_cast<unsigned int>(index) >= count)) {
        throw std::runtime_error("no color " + std::to_string(index) + " to pick: the book has " +
                                 std::to_string(count) + (count == 1 ? " color" : " colors") +
                                 " (pick 0 to count - 1, or -1 to clear the pick)");
    }
    palette.SelectColor(index);
}

// As the rollout's file button does: the parameter alone; the map reads the book and clears the pick.
void SetBook(Texmap& map, const std::string& file) {
    // The scene may be opened from anywhere.
    const std::string path =
        file.empty() ? file : std::filesystem::absolute(file).lexically_normal().string();
    if (!Parameters(map).SetValue(kBookParameter, 0, path.c_str()))
        throw std::runtime_error("the map took no book");
    if (ShowMessageBoxes() > 0)
        throw std::runtime_error("cannot use the book " + file + "; nothing was written");
}

void RunNew(const MapArguments& arguments) {
    PluginHost host;
    Scene scene = host.NewScene();
    Texmap& map = scene.NewMap(Pigmo::ColorMap::kColorMapClassID);
    if (arguments.book.empty()) {
        // A fresh map takes the first system palette and picks its first color itself.
        if (ShowMessageBoxes() > 0)
            throw std::runtime_error("cannot use the default book; nothing was written");
        if (arguments.pick) Pick(map, *arguments.pick);
    } else {
        Pigmo::Platform::TakeMessageBoxes();  // about the default book, which is replaced at once
        SetBook(map, arguments.book);
        if (arguments.pick || Palette(map).GetColorCount() > 0) Pick(map, arguments.pick.value_or(0));
    }
    scene.Save(arguments.scene);
}

void RunPick(const MapArguments& arguments) {
    PluginHost host;
    Scene scene = host.Load(arguments.scene);
    Pick(FirstMap(scene, arguments.scene), arguments.pick.value_or(0));
    scene.Save(arguments.scene);
}

void RunBook(const MapArguments& arguments) {
    PluginHost host;
    Scene scene = host.Load(arguments.scene);
    SetBook(FirstMap(scene, arguments.scene), arguments.book);
    scene.Save(arguments.scene);
}

std::string Format(const char* format, const float* values) {
    char text[192];
    std::snprintf(text, sizeof text, format, values[0], values[1], values[2]);
    return text;
}

Json Triple(const float* values) {
    return Json::array({values[0], values[1], values[2]});
}

void RunShow(const MapArguments& arguments) {
    PluginHost host;
    Scene scene = host.Load(arguments.scene);
    Texmap& map = FirstMap(scene, arguments.scene);
    // The map may keep a path written the Windows way, as palette discovery gives it.
    const std::string book = Pigmo::Platform::NativePath(Parameters(map).GetStr(kBookParameter));
    Pigmo::IColorPalletteUser& palette = Palette(map);
    const Pigmo::IColorInformation& color = CurrentColor(map);
    std::vector<std::string> tags;
    for (int i = 0; i < color.GetTagCount(); ++i)
        tags.emplace_back(color.GetTag(static_cast<unsigned int>(i)));
    std::vector<float> reflectance;
    if (const float* curve = color.GetSpectralReflectance())
        reflectance.assign(curve, curve + color.GetSpectralReflectanceCount());

    if (arguments.json) {
        Json shown = Json::object();
        shown["scene"] = arguments.scene;
        shown["map"] = map.GetName().data();
        shown["book"] = book;
        shown["colors"] = palette.GetColorCount();
        shown["selected"] = palette.GetSelectedIndex();
        shown["name"] = color.GetName();
        shown["category"] = color.GetCategory();
        shown["srgb"] = Triple(color.GetSRGB());
        shown["linear_rgb"] = Triple(color.GetLinearRGB());
        shown["lab"] = Triple(color.GetLab());
        shown["tags"] = tags;
        shown["reflectance"] = reflectance;
        // Names come from books as bytes; what is not UTF-8 is replaced rather than failing.
        WriteOut(shown.dump(2, ' ', false, Json::error_handler_t::replace) + "\n");
        return;
    }
    std::string tagList, curve;
    for (const std::string& tag : tags) tagList += (tagList.empty() ? "" : ", ") + Printable(tag);
    for (float value : reflectance) {
        char number[32];
        std::snprintf(number, sizeof number, " %.4g", value);
        curve += number;
    }
    const unsigned int count = palette.GetColorCount();
    const int selected = palette.GetSelectedIndex();
    WriteOut("map:          " + Printable(map.GetName().data()) + "\n" + "book:         " +
             (book.empty()
                  ? std::string("(none)")
                  : Printable(book) + " (" + std::to_string(count) + (count == 1 ? " color)" : " colors)")) +
             "\n" + "selected:     " + (selected == -1 ? std::string("none") : std::to_string(selected)) +
             "\n" + "name:         " + Printable(color.GetName()) + "\n" +
             "category:     " + Printable(color.GetCategory()) + "\n" +
             "sRGB:         " + Format("%.2f %.2f %.2f", color.GetSRGB()) + "\n" +
             "linear RGB:   " + Format("%.4f %.4f %.4f", color.GetLinearRGB()) + "\n" +
             "L*a*b*:       " + Format("%.2f %.2f %.2f", color.GetLab()) + "\n" + "tags:         " + tagList +
             "\n" + "reflectance:  " + std::to_string(reflectance.size()) + " values" +
             (curve.empty() ? "" : ":" + curve) + "\n");
}

void RunRender(const MapArguments& arguments) {
    PluginHost host;
    Scene scene = host.Load(arguments.scene);
    Texmap& map = FirstMap(scene, arguments.scene);
    const Pigmo::Host::Image image = arguments.sphere ? Pigmo::Host::RenderSphere(map, arguments.size)
                                                      : Pigmo::Host::RenderFlat(map, arguments.size);
    Pigmo::Host::WriteFileAtomically(arguments.output, Pigmo::Host::EncodePng(image));
}

void RunViewport(const MapArguments& arguments) {
    PluginHost host;
    Scene scene = host.Load(arguments.scene);
    Texmap& map = FirstMap(scene, arguments.scene);
    Pigmo::Host::ViewportTextures viewport;
    Interval valid;
    const std::unique_ptr<BITMAPINFO, void (*)(void*)> dib(map.GetVPDisplayDIB(0, viewport, valid),
                                                           std::free);
    if (!dib) throw std::runtime_error("the map made no viewport image");
    Pigmo::Host::WriteFileAtomically(arguments.output,
                                     Pigmo::Host::EncodePng16(dib->bmiHeader.biWidth, dib->bmiHeader.biHeight,
                                                              Pigmo::Host::DIBPixels(dib.get())));
}

void RunMentalRay(const MapArguments& arguments) {
    PluginHost host;
    Scene scene = host.Load(arguments.scene);
    Texmap& map = FirstMap(scene, arguments.scene);
    auto* translation =
        dynamic_cast<imrShaderTranslation*>(map.GetInterface(IMRSHADERTRANSLATION_INTERFACE_ID));
    if (translation == nullptr) throw std::runtime_error("the map has no mental ray translation");
    Pigmo::Host::ShaderCreation creation;
    auto* shader = dynamic_cast<Pigmo::Host::Shader*>(translation->GetMRShader(creation));
    if (shader == nullptr) throw std::runtime_error("the map asked for a shader the renderer does not know");
    imrTranslation renderer;
    Interval valid = FOREVER;
    translation->TranslateParameters(renderer, shader, 0, valid);
    IParamBlock2* parameters = shader->GetParametersParamBlock();
    AColor color;
    Interval ignored;
    for (int i = 0; i < parameters->NumParams(); ++i) {
        const ParamID id = parameters->IndextoID(i);
        if (std::string(parameters->GetParamDef(id).int_name) == "color")
            parameters->GetValue(id, 0, color, ignored);
    }
    if (arguments.json) {
        Json shown = Json::object();
        shown["shader"] = shader->Declaration();
        shown["name"] = shader->GetName();
        shown["color"] = Json::array({color.r, color.g, color.b, color.a});
        WriteOut(shown.dump(2, ' ', false, Json::error_handler_t::replace) + "\n");
        return;
    }
    char values[128];
    std::snprintf(values, sizeof values, "%.6g %.6g %.6g %.6g", color.r, color.g, color.b, color.a);
    WriteOut("shader:  " + Printable(shader->Declaration()) + "\nname:    " + Printable(shader->GetName()) +
             "\ncolor:   " + values + "\n");
}

void RunRollout(const MapArguments& arguments) {
    PluginHost host;
    Scene scene = host.Load(arguments.scene);
    Texmap& map = FirstMap(scene, arguments.scene);
    // Closed before the scene deletes the map.
    Pigmo::Host::MaterialEditor editor;
    editor.Open(map);
    const Pigmo::Host::Image image = editor.Snapshot(arguments.scale);
    ShowMessageBoxes();
    Pigmo::Host::WriteFileAtomically(arguments.output, Pigmo::Host::EncodePng(image));
}

// One "pigmo map" subcommand: its name in messages, its options and its work.
CLI::App* AddSubcommand(CLI::App& map, const std::string& name, const std::string& description,
                        const std::string& footer, int& exitCode,
                        const std::shared_ptr<MapArguments>& arguments, void (*run)(const MapArguments&)) {
    CLI::App* command = map.add_subcommand(name, description);
    command->footer(footer);
    command->add_option("SCENE", arguments->scene, "the scene file (JSON)")->required();
    command->callback([arguments, &exitCode, name, run] {
        exitCode = RunCommand("map " + name, [&] { run(*arguments); });
    });
    return command;
}

}  // namespace

void AddMapCommand(CLI::App& app, int& exitCode) {
    CLI::App* map = app.add_subcommand(
        "map", "The Color Map in a scene: create, pick, change the book, show, render, show its panel");
    map->require_subcommand(1);
    map->footer(
        "A scene is a JSON file of Color Maps; the commands work on its first map. pigmo loads libpigmo.so "
        "as a 3D program loads the plug-in. A book that cannot be read is reported as the map reports it "
        "(\"Pigmo Color Map: ...\" on stderr); a scene whose book has gone still loads and renders its "
        "color. A command that fails changes no file. Run \"pigmo map COMMAND --help\" for each command.");
    const auto arguments = std::make_shared<MapArguments>();

    CLI::App* create = AddSubcommand(
        *map, "new", "Make a scene with one new Color Map",
        "Without --book the map takes the first system palette and picks its first color, as a new map in "
        "the "
        "3D program does; with --book it takes that book and picks color --pick (default 0). SCENE is "
        "replaced "
        "if it exists.\nExample: pigmo map new scene.json --book \"Test Color Samples.cxf\" --pick 3",
        exitCode, arguments, RunNew);
    create->add_option("--book", arguments->book, "the color book (CxF 2.1) to take instead of the default");
    create->add_option("--pick", arguments->pick, "the color of the book to pick, from 0");

    AddSubcommand(
        *map, "pick", "Pick color N of the map's book (-1 clears the pick)",
        "The map copies the color's name, category, sRGB, linear RGB, L*a*b*, reflectance and tags into "
        "the scene, so the scene renders it without the book. With -1 those are cleared; the map then "
        "renders black.\nExample: pigmo map pick scene.json 5",
        exitCode, arguments, RunPick)
        ->add_option("N", arguments->pick, "the color's index in the book, from 0; -1 clears the pick")
        ->required();

    AddSubcommand(
        *map, "book", "Give the map another color book",
        "As the book button of the map's panel does: the book changes and the pick is cleared, but the "
        "map keeps rendering the color picked before until another is picked.\n"
        "Example: pigmo map book scene.json \"ISCC-NBS Centroid Colors.cxf\"",
        exitCode, arguments, RunBook)
        ->add_option("FILE", arguments->book, "the color book (CxF 2.1); \"\" for none")
        ->required();

    AddSubcommand(
        *map, "show", "Show the map's book and picked color",
        "Prints the book, the picked index, and the color the map renders from: name, category, sRGB "
        "(0..255), linear RGB (0..1), L*a*b* (D50), tags and reflectance values.\n"
        "Example: pigmo map show scene.json --json",
        exitCode, arguments, RunShow)
        ->add_flag("--json", arguments->json, "print the fields as JSON");

    CLI::App* render = AddSubcommand(
        *map, "render", "Render the map to a PNG",
        "Shades every pixel with the map (one shading call each) and writes 8-bit sRGB: each linear value "
        "encoded with the sRGB transfer function and rounded. With --sphere it renders the material editor's "
        "sample instead: a sphere lit from the upper left, over a checker.\n"
        "Example: pigmo map render scene.json -o preview.png --sphere",
        exitCode, arguments, RunRender);
    render->add_option("-o,--output", arguments->output, "the PNG file to write")->required();
    render->add_option("--size", arguments->size, "the side of the image in pixels (default 256)")
        ->check(CLI::Range(1, Pigmo::Host::kMaxRenderSize));
    render->add_flag("--sphere", arguments->sphere, "render the sample sphere");

    AddSubcommand(*map, "viewport", "Write the map's viewport texture as a 16-bit PNG",
                  "The image the map gives the 3D viewport, 64 x 64, with its 16-bit channels unchanged: the "
                  "linear color clamped to 0..1 times 65535, alpha 65535.\n"
                  "Example: pigmo map viewport scene.json -o texture.png",
                  exitCode, arguments, RunViewport)
        ->add_option("-o,--output", arguments->output, "the PNG file to write")
        ->required();

    CLI::App* rollout = AddSubcommand(
        *map, "rollout", "Render the map's editor panel to a PNG",
        "Opens the map's rollout as the 3D program's material editor does, without a window, and writes "
        "what a person would see: the book list, the palette with its strip, the picked color's fields, "
        "swatch, information and reflectance curve. --scale enlarges every pixel to S x S pixels.\n"
        "Example: pigmo map rollout scene.json -o panel.png --scale 2",
        exitCode, arguments, RunRollout);
    rollout->add_option("-o,--output", arguments->output, "the PNG file to write")->required();
    rollout->add_option("--scale", arguments->scale, "pixels per panel pixel, 1 to 8 (default 1)")
        ->check(CLI::Range(1, Pigmo::Host::kMaxSnapshotScale));

    AddSubcommand(*map, "mr", "Show the mental ray shader that stands in for the map",
                  "The shader class the map asks the renderer for, its name and its \"color\" after the map "
                  "translated its parameters.\nExample: pigmo map mr scene.json",
                  exitCode, arguments, RunMentalRay)
        ->add_flag("--json", arguments->json, "print the fields as JSON");
}
