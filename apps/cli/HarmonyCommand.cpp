#include <cstdio>
#include <map>
#include <memory>
#include <stdexcept>
#include <string>
#include <vector>

#include "Commands.h"
#include "DescriptionOptions.h"
#include "Output.h"
#include "ValueLines.h"
#include "pigmo/bp.h"

namespace {

struct HarmonyArguments {
    std::string kind;
    std::vector<std::string> lab;
    bool json = false;
};

using PairHarmony = int (*)(const double*, double*, double*);

const std::map<std::string, PairHarmony> kPairHarmonies = {
    {"monochromatic", BPHarmonyGetMonochromatic},
    {"near", BPHarmonyGetNearNeighbor},
    {"far", BPHarmonyGetFarNeighbor},
    {"triadic", BPHarmonyGetTriadic},
};

void RunHarmony(const HarmonyArguments& arguments) {
    double lab[3];
    ParseLab(arguments.lab, lab);
    double out[2][3];
    int count = 1;
    int status = 0;
    if (arguments.kind == "complement") {
        status = BPHarmonyGetComplement(lab, out[0]);
    } else {
        const auto found = kPairHarmonies.find(arguments.kind);
        if (found == kPairHarmonies.end()) {
            throw std::invalid_argument("unknown harmony '" + arguments.kind +
                                        "' (one of monochromatic, near, far, triadic, complement)");
        }
        status = found->second(lab, out[0], out[1]);
        count = 2;
    }
    if (status != 1) throw std::runtime_error("the color could not be converted");
    RequireFinite(out[0], 3 * static_cast<size_t>(count));
    if (arguments.json) {
        nlohmann::ordered_json companions = nlohmann::ordered_json::array();
        for (int i = 0; i < count; ++i) companions.push_back({out[i][0], out[i][1], out[i][2]});
        WriteOut(
            JsonText(
                {{"kind", arguments.kind}, {"color", {lab[0], lab[1], lab[2]}}, {"companions", companions}}) +
            "\n");
        return;
    }
    for (int i = 0; i < count; ++i) std::printf("%.10g %.10g %.10g\n", out[i][0], out[i][1], out[i][2]);
}

}  // namespace

void AddHarmonyCommand(CLI::App& app, int& exitCode) {
    auto arguments = std::make_shared<HarmonyArguments>();
    CLI::App* command = app.add_subcommand("harmony", "Harmonious companions of one CIELAB color");
    command->add_option("KIND", arguments->kind, "monochromatic, near, far, triadic or complement")
        ->required();
    command->add_option("LAB", arguments->lab, "L a b of the color")->required();
    command->add_flag("--json", arguments->json, "print the color and its companions as a JSON object");
    command->footer(
        "Hues turn on a twelve-sector painter's wheel: near by 30 degrees, triadic by 120, far by 150 (each "
        "both ways, printed minus first), complement by 180; monochromatic changes lightness only. Each"
        " companion is printed as L a b on one line.\n"
        "Example: pigmo harmony complement 60 30 20");
    command->callback(
        [arguments, &exitCode] { exitCode = RunCommand("harmony", [&] { RunHarmony(*arguments); }); });
}
