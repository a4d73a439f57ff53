// Feeds arbitrary bytes to the scene loader as a scene file. Loaded against the tests' fake map class,
// which keeps a parameter of every type the host knows, so the fuzzer reaches every value reader
// without the plug-in, its books or the files they name. A scene that loads must save and load again
// to the same maps: names, G-buffer ids and every parameter value.
#include <unistd.h>

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <optional>
#include <stdexcept>
#include <string>
#include <vector>

#include "FakeMap.h"
#include "Scene.h"

namespace {

// One pair of files per process, rewritten for every input: the loader takes paths.
std::string TemporaryPath() {
    char name[] = "/tmp/pigmo-fuzz-scene-XXXXXX";
    const int fd = mkstemp(name);
    if (fd < 0) std::abort();
    close(fd);
    return name;
}

std::string Describe(const Pigmo::Host::Scene& scene) {
    std::string text;
    for (Texmap* map : scene.Maps())
        text += std::string(map->GetName().data()) + " " + std::to_string(map->GetGBufID()) + "\n" +
                Fake::Describe(*map->GetParamBlock(0));
    return text;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    static const std::string input = TemporaryPath(), saved = TemporaryPath();
    FILE* file = std::fopen(input.c_str(), "wb");
    if (file == nullptr || (size > 0 && std::fwrite(data, 1, size, file) != size)) std::abort();
    std::fclose(file);

    const std::vector<ClassDesc*> classes{&Fake::Class()};
    std::optional<Pigmo::Host::Scene> scene;
    try {
        scene.emplace(Pigmo::Host::Scene::Load(input, classes));
    } catch (const std::runtime_error& e) {
        // A refusal names the file and leaves no map behind.
        if (std::string(e.what()).find(input) == std::string::npos || Fake::LiveMaps() != 0) std::abort();
        return 0;
    }
    // What loaded saves (an exception here ends the run) and loads again the same.
    const std::string first = Describe(*scene);
    scene->Save(saved);
    scene.reset();
    if (Fake::LiveMaps() != 0 || Describe(Pigmo::Host::Scene::Load(saved, classes)) != first) std::abort();
    Fake::PostLoadLog().clear();
    return 0;
}
