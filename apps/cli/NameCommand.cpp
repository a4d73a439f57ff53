#include <cstdio>
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

struct NameArguments {
    std::vector<std::string> lab;
    bool json = false;
};

void RunName(const NameArguments& arguments) {
    double lab[3];
    ParseLab(arguments.lab, lab);
    const int index = BPCentroidGetForLab(lab);
    if (index < 1) throw std::runtime_error("no centroid found for this color");
    const int category = BPCentroidGetCategory(index);
    const double distance = BPCalculateDeltaE(lab, BPCentroidGetLab(index));
    RequireFinite(&distance, 1);
    if (arguments.json) {
        const double* centroid = BPCentroidGetLab(index);
        WriteOut(JsonText({{"index", index},
                           {"name", BPCentroidGetName(index)},
                           {"category", category},
                           {"category_name", BPCentroidGetCategoryName(category)},
                           {"lab", {centroid[0], centroid[1], centroid[2]}},
                           {"distance", distance}}) +
                 "\n");
        return;
    }
    std::printf("index: %d\nname: %s\ncategory: %d %s\ndistance: %.4f\n", index, BPCentroidGetName(index),
                category, BPCentroidGetCategoryName(category), distance);
}

}  // namespace

void AddNameCommand(CLI::App& app, int& exitCode) {
    auto arguments = std::make_shared<NameArguments>();
    CLI::App* command = app.add_subcommand("name", "ISCC-NBS name of a CIELAB color");
    command->add_option("LAB", arguments->lab, "L a b of the color (D50 white)")->required();
    command->add_flag("--json", arguments->json, "print the centroid as a JSON object, with its L*a*b*");
    command->footer(
        "Prints the nearest of the 267 ISCC-NBS centroid colors: its index, name, hue category and CIE76"
        " distance. The search looks among the centroids of the color's L* = 50, a* = 0, b* = 0 octant and"
        " those lying near its borders.\n"
        "Example: pigmo name 50 -20 10");
    command->callback(
        [arguments, &exitCode] { exitCode = RunCommand("name", [&] { RunName(*arguments); }); });
}
