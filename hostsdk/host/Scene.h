#pragma once

#include <string>
#include <vector>

#include "imtl.h"

namespace Pigmo::Host {

// The most a scene file may hold.
inline constexpr long long kMaxSceneBytes = 64LL << 20;

// The texture maps of a scene, made through their class descriptors and deleted with the scene.
//
// A scene file is a JSON document:
//   {"format": "pigmo-scene", "version": 1, "maps": [
//     {"class": [1391092344, 2808842737], "name": "Map #1", "gbufID": 0,
//      "parameters": {"0": {"type": "filename", "value": "/books/a.cxf"},
//                     "7": {"type": "float_tab", "value": [0.5, 0.25]}, ...}}]}
// "name" and "gbufID" are what MtlBase::Save writes; "parameters" holds the block the class builds
// automatically, by parameter id, each value with its type: int, bool, float, point3, rgb, frgba,
// string, filename, and "_tab" after any of them for a table.
class HostExport Scene {
public:
    // classes: what the host can make maps of; the scene keeps the pointers.
    explicit Scene(std::vector<ClassDesc*> classes);
    ~Scene();
    Scene(Scene&& other) noexcept;
    Scene(const Scene&) = delete;
    Scene& operator=(const Scene&) = delete;

    // Reads a scene as the host loads one. Everything is checked before any map is made; then each
    // map is created for loading, reads its own data (Load), gets its parameters back without change
    // messages, and once all are in, the post-load callbacks run, lowest priority first. Throws
    // std::runtime_error naming the file, and the line where the parser knows it; nothing is kept.
    static Scene Load(const std::string& path, std::vector<ClassDesc*> classes);

    // A fresh map of the class, named "Map #n"; throws when there is no such class or it makes none.
    Texmap& NewMap(Class_ID id);
    const std::vector<Texmap*>& Maps() const { return maps_; }

    // Saves through a temporary file beside path, renamed into place; throws std::runtime_error
    // naming path on any failure, and path is then as it was.
    void Save(const std::string& path) const;

private:
    std::vector<ClassDesc*> classes_;
    std::vector<Texmap*> maps_;
};

}  // namespace Pigmo::Host
