#include "Scene.h"

#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <charconv>
#include <climits>
#include <cstdio>
#include <cstring>
#include <stdexcept>
#include <utility>

#include "AtomicFile.h"
#include "Json.h"
#include "ParamBlock2.h"
#include "RegularFile.h"

namespace Pigmo::Host {

namespace {

constexpr const char* kFormat = "pigmo-scene";
constexpr int kVersion = 1;
// Far beyond any scene, and low enough that no document costs much more memory than its size.
constexpr std::size_t kMaxValues = std::size_t{1} << 20;
constexpr int kMaxDepth = 16;

// Why a scene cannot be loaded; Load puts the file's name in front.
struct Refused : std::runtime_error {
    using std::runtime_error::runtime_error;
};

// A text from the file, cut short for a message.
std::string Shown(const std::string& text) {
    return text.size() <= 40 ? text : text.substr(0, 40) + "...";
}

std::string IdText(Class_ID id) {
    char text[32];
    std::snprintf(text, sizeof text, "(0x%08lX, 0x%08lX)", id.PartA(), id.PartB());
    return text;
}

// The class of that id whose maps a scene can keep, with the description of the block it stores.
bool Storable(const std::vector<ClassDesc*>& classes, Class_ID id, ClassDesc2*& cd, ParamBlockDesc2*& desc) {
    for (ClassDesc* candidate : classes) {
        if (candidate->ClassID() != id || candidate->SuperClassID() != TEXMAP_CLASS_ID) continue;
        cd = dynamic_cast<ClassDesc2*>(candidate);
        for (int i = 0; cd != nullptr && i < cd->NumParamBlockDescs(); ++i) {
            desc = cd->GetParamBlockDesc(i);
            if ((desc->flags & P_AUTO_CONSTRUCT) != 0) return true;
        }
    }
    return false;
}

// What Create returned, as a texture map; anything else is deleted.
Texmap* Made(void* made) {
    if (made == nullptr) return nullptr;
    auto* object = static_cast<Animatable*>(made);
    auto* map = dynamic_cast<Texmap*>(object);
    if (map == nullptr) object->DeleteThis();
    return map;
}

// The map's own data (MtlBase::Save): the only members besides "class" and "parameters".
enum class DataKind { Text, Int };
constexpr std::pair<const char*, DataKind> kMapData[] = {{"name", DataKind::Text}, {"gbufID", DataKind::Int}};

bool IsMapData(const char* key, DataKind kind) {
    return key != nullptr && std::any_of(std::begin(kMapData), std::end(kMapData), [&](const auto& data) {
               return std::strcmp(data.first, key) == 0 && data.second == kind;
           });
}

std::string TypeTag(ParamType2 type) {
    std::string tag;
    switch (type & ~TYPE_TAB) {
        case TYPE_INT: tag = "int"; break;
        case TYPE_BOOL: tag = "bool"; break;
        case TYPE_FLOAT: tag = "float"; break;
        case TYPE_POINT3: tag = "point3"; break;
        case TYPE_RGBA: tag = "rgb"; break;
        case TYPE_FRGBA: tag = "frgba"; break;
        case TYPE_STRING: tag = "string"; break;
        case TYPE_FILENAME: tag = "filename"; break;
        default: break;
    }
    return (type & TYPE_TAB) != 0 ? tag + "_tab" : tag;
}

Json ValueToJson(const ParamValue& value, ParamKind kind) {
    switch (kind) {
        case ParamKind::Int: return std::get<int>(value);
        case ParamKind::Float: return std::get<float>(value);
        case ParamKind::Vector: {
            const AColor& c = std::get<AColor>(value);
            return Json::array({c.r, c.g, c.b});
        }
        case ParamKind::Color4: {
            const AColor& c = std::get<AColor>(value);
            return Json::array({c.r, c.g, c.b, c.a});
        }
        case ParamKind::Text: return std::get<std::string>(value);
        case ParamKind::File: return std::get<MaxSDK::AssetManagement::AssetUser>(value).GetFileName().data();
    }
    return nullptr;
}

Json ParameterToJson(const ParamDef& def, const std::vector<ParamValue>& values) {
    const ParamKind kind = KindOf(def);
    Json value;
    if ((def.type & TYPE_TAB) == 0) {
        value = ValueToJson(values.front(), kind);
    } else {
        value = Json::array();
        for (const ParamValue& entry : values) value.push_back(ValueToJson(entry, kind));
    }
    Json parameter = Json::object();
    parameter["type"] = TypeTag(def.type);
    parameter["value"] = std::move(value);
    return parameter;
}

// The map's own data, written into its object of the scene.
class SceneSave final : public ISave {
public:
    explicit SceneSave(Json& map) : map_(map) {}
    IOResult WriteString(const MCHAR* key, const MCHAR* value) override {
        if (!IsMapData(key, DataKind::Text)) return IO_ERROR;
        map_[key] = value != nullptr ? value : "";
        return IO_OK;
    }
    IOResult WriteInt(const MCHAR* key, int value) override {
        if (!IsMapData(key, DataKind::Int)) return IO_ERROR;
        map_[key] = value;
        return IO_OK;
    }

private:
    Json& map_;
};

const Json& Member(const Json& object, const char* name) {
    const auto found = object.find(name);
    if (found == object.end()) throw Refused(std::string("no member \"") + name + "\"");
    return *found;
}

void OnlyMembers(const Json& object, std::initializer_list<const char*> names) {
    for (const auto& member : object.items()) {
        if (std::none_of(names.begin(), names.end(), [&](const char* name) { return member.key() == name; }))
            throw Refused("unknown member \"" + Shown(member.key()) + "\"");
    }
}

bool IsInt(const Json& value) {
    if (value.is_number_unsigned()) return value.get<std::uint64_t>() <= INT_MAX;
    if (value.is_number_integer()) return value.get<std::int64_t>() >= INT_MIN && value.get<std::int64_t>() <= INT_MAX;
    return false;
}

int Integer(const Json& value) {
    if (!value.is_number_integer()) throw Refused("not an integer");
    if (!IsInt(value)) throw Refused("beyond the integer range");
    return value.get<int>();
}

// Always finite: the parser refuses numbers beyond the float range.
float Number(const Json& value) {
    if (!value.is_number()) throw Refused("not a number");
    return value.get<float>();
}

AColor Numbers(const Json& value, std::size_t count) {
    if (!value.is_array() || value.size() != count) throw Refused("not a list of " + std::to_string(count) + " numbers");
    float numbers[4] = {};
    for (std::size_t i = 0; i < count; ++i) numbers[i] = Number(value[i]);
    return AColor(numbers[0], numbers[1], numbers[2], numbers[3]);
}

const std::string& Text(const Json& value) {
    if (!value.is_string()) throw Refused("not a text");
    const std::string& text = value.get_ref<const std::string&>();
    // The plug-in reads texts as C strings, which would end there.
    if (text.find('\0') != std::string::npos) throw Refused("a text holding a NUL character");
    return text;
}

ParamValue ValueFromJson(const Json& value, const ParamDef& def) {
    switch (KindOf(def)) {
        case ParamKind::Int: return ParamValue(std::in_place_type<int>, Integer(value));
        case ParamKind::Float: return ParamValue(std::in_place_type<float>, Number(value));
        case ParamKind::Vector: return Numbers(value, 3);
        case ParamKind::Color4: return Numbers(value, 4);
        case ParamKind::Text: return Text(value);
        case ParamKind::File: return FileAsset(Text(value).c_str(), def.asset_type);
    }
    return 0;
}

std::vector<ParamValue> ParameterFromJson(const ParamDef& def, const Json& parameter) {
    if (!parameter.is_object()) throw Refused("not an object with \"type\" and \"value\"");
    OnlyMembers(parameter, {"type", "value"});
    const Json& type = Member(parameter, "type");
    const std::string tag = TypeTag(def.type);
    if (!type.is_string() || type.get_ref<const std::string&>() != tag)
        throw Refused("type " + Shown(type.dump()) + " where the map keeps \"" + tag + "\"");
    const Json& value = Member(parameter, "value");
    if ((def.type & TYPE_TAB) == 0) return {ValueFromJson(value, def)};
    if (!value.is_array()) throw Refused("the value of a table is not a list");
    if (value.size() > static_cast<std::size_t>(kMaxTableCount))
        throw Refused("a table of " + std::to_string(value.size()) + " entries; a table holds at most " +
                      std::to_string(kMaxTableCount));
    std::vector<ParamValue> values;
    values.reserve(value.size());
    for (std::size_t i = 0; i < value.size(); ++i) {
        try {
            values.push_back(ValueFromJson(value[i], def));
        } catch (const Refused& e) {
            throw Refused("entry " + std::to_string(i) + ": " + e.what());
        }
    }
    return values;
}

// A parameter id as the scene writes it: plain decimal digits, nothing else.
bool ParseParamId(const std::string& key, ParamID& id) {
    int value = 0;
    const auto [end, error] = std::from_chars(key.data(), key.data() + key.size(), value);
    if (error != std::errc() || end != key.data() + key.size() || std::to_string(value) != key) return false;
    if (value < SHRT_MIN || value > SHRT_MAX) return false;
    id = static_cast<ParamID>(value);
    return true;
}

// One map of the scene, checked and read, waiting to be made.
struct MapRecord {
    ClassDesc2* cd = nullptr;
    ParamBlockDesc2* desc = nullptr;
    const Json* data = nullptr;
    std::vector<std::pair<ParamID, std::vector<ParamValue>>> parameters;
};

MapRecord CheckMap(const Json& map, const std::vector<ClassDesc*>& classes) {
    if (!map.is_object()) throw Refused("not an object");
    OnlyMembers(map, {"class", "name", "gbufID", "parameters"});
    MapRecord record;
    record.data = &map;
    const Json& classId = Member(map, "class");
    const auto isPart = [](const Json& part) { return part.is_number_unsigned() && part.get<std::uint64_t>() <= 0xFFFFFFFFu; };
    if (!classId.is_array() || classId.size() != 2 || !isPart(classId[0]) || !isPart(classId[1]))
        throw Refused("\"class\" is not a pair of 32-bit unsigned integers");
    const Class_ID id(classId[0].get<ULONG>(), classId[1].get<ULONG>());
    if (!Storable(classes, id, record.cd, record.desc)) throw Refused("no map class " + IdText(id) + " is known");
    const Json& name = Member(map, "name");
    const Json& gbufId = Member(map, "gbufID");
    try {
        Text(name);
    } catch (const Refused& e) {
        throw Refused(std::string("\"name\": ") + e.what());
    }
    try {
        Integer(gbufId);
    } catch (const Refused& e) {
        throw Refused(std::string("\"gbufID\": ") + e.what());
    }
    const Json& parameters = Member(map, "parameters");
    if (!parameters.is_object()) throw Refused("\"parameters\" is not an object");
    for (const auto& parameter : parameters.items()) {
        ParamID paramId = 0;
        const int index = ParseParamId(parameter.key(), paramId) ? record.desc->IDtoIndex(paramId) : -1;
        if (index < 0) throw Refused("unknown parameter \"" + Shown(parameter.key()) + "\"");
        const ParamDef& def = record.desc->paramdef(index);
        try {
            record.parameters.emplace_back(paramId, ParameterFromJson(def, parameter.value()));
        } catch (const Refused& e) {
            throw Refused("parameter " + parameter.key() + " (" + def.int_name.data() + "): " + e.what());
        }
    }
    return record;
}

std::vector<MapRecord> CheckScene(const Json& root, const std::vector<ClassDesc*>& classes) {
    if (!root.is_object()) throw Refused("not a scene (the document is not a JSON object)");
    OnlyMembers(root, {"format", "version", "maps"});
    const Json& format = Member(root, "format");
    if (!format.is_string() || format.get_ref<const std::string&>() != kFormat)
        throw Refused("not a Pigmo scene (format " + Shown(format.dump()) + ")");
    const Json& version = Member(root, "version");
    if (!version.is_number_integer() || version.get<std::int64_t>() != kVersion)
        throw Refused("scene version " + Shown(version.dump()) + "; this host reads version " + std::to_string(kVersion));
    const Json& maps = Member(root, "maps");
    if (!maps.is_array()) throw Refused("\"maps\" is not a list");
    std::vector<MapRecord> records;
    for (std::size_t i = 0; i < maps.size(); ++i) {
        try {
            records.push_back(CheckMap(maps[i], classes));
        } catch (const Refused& e) {
            throw Refused("map " + std::to_string(i + 1) + ": " + e.what());
        }
    }
    return records;
}

std::string ReadScene(const std::string& path) {
    std::string problem;
    const int fd = Platform::OpenRegularFile(path, problem);
    if (fd < 0) throw std::runtime_error("cannot read " + path + ": " + problem);
    std::string text;
    char buffer[1 << 16];
    for (;;) {
        const ssize_t got = read(fd, buffer, sizeof buffer);
        if (got < 0 && errno == EINTR) continue;
        if (got <= 0 || text.size() + static_cast<std::size_t>(got) > static_cast<std::size_t>(kMaxSceneBytes)) {
            const int error = errno;
            close(fd);
            if (got == 0) return text;
            if (got < 0) throw std::runtime_error("cannot read " + path + ": " + Platform::SystemErrorText(error));
            throw std::runtime_error(path + ": larger than 64 MiB, the most a scene may hold");
        }
        text.append(buffer, static_cast<std::size_t>(got));
    }
}

Json Parse(const std::string& text) {
    if (text.empty()) throw Refused("empty file, not a scene");
    std::size_t values = 0;
    const Json::parser_callback_t bounded = [&values](int depth, Json::parse_event_t, Json&) {
        if (depth > kMaxDepth) throw Refused("values nested more than " + std::to_string(kMaxDepth) + " deep; not a scene");
        if (++values > kMaxValues) throw Refused("more than " + std::to_string(kMaxValues) + " values; not a scene");
        return true;
    };
    try {
        return Json::parse(text, bounded);
    } catch (const Json::exception& e) {
        // "[json.exception.parse_error.101] parse error at line 3, column 5: syntax error ...", or a
        // number too large for a float: "[json.exception.out_of_range.406] number overflow ..."
        std::string what = e.what();
        what.erase(0, what.find("] ") != std::string::npos ? what.find("] ") + 2 : 0);
        if (what.starts_with("parse error at ")) what.erase(0, std::strlen("parse error at "));
        throw Refused(what);
    }
}

// What the maps read back of their own data while the scene loads, and the callbacks they leave.
class SceneLoad final : public ILoad {
public:
    SceneLoad() = default;
    SceneLoad(const SceneLoad&) = delete;
    SceneLoad& operator=(const SceneLoad&) = delete;
    ~SceneLoad() override {
        for (PostLoadCallback* callback : callbacks_) delete callback;
    }

    void SetMap(const Json* map) { map_ = map; }

    IOResult ReadString(const MCHAR* key, MSTR& value) override {
        const Json* member = Find(key);
        if (member == nullptr || !member->is_string()) return IO_ERROR;
        value = member->get<std::string>();
        return IO_OK;
    }
    IOResult ReadInt(const MCHAR* key, int& value) override {
        const Json* member = Find(key);
        if (member == nullptr || !IsInt(*member)) return IO_ERROR;
        value = member->get<int>();
        return IO_OK;
    }
    void RegisterPostLoadCallback(PostLoadCallback* callback) override {
        if (callback != nullptr) callbacks_.push_back(callback);
    }

    // Runs the callbacks, lowest priority first and in order of registration among equals; each
    // deletes itself.
    void RunCallbacks() {
        std::vector<PostLoadCallback*> pending = std::exchange(callbacks_, {});
        std::stable_sort(pending.begin(), pending.end(),
                         [](PostLoadCallback* a, PostLoadCallback* b) { return a->Priority() < b->Priority(); });
        map_ = nullptr;
        for (PostLoadCallback* callback : pending) callback->proc(this);
    }

private:
    const Json* Find(const MCHAR* key) const {
        if (map_ == nullptr || (!IsMapData(key, DataKind::Text) && !IsMapData(key, DataKind::Int)))
            return nullptr;
        const auto found = map_->find(key);
        return found != map_->end() ? &*found : nullptr;
    }

    const Json* map_ = nullptr;
    std::vector<PostLoadCallback*> callbacks_;
};

}  // namespace

Scene::Scene(std::vector<ClassDesc*> classes) : classes_(std::move(classes)) {}

Scene::Scene(Scene&& other) noexcept
    : classes_(std::move(other.classes_)), maps_(std::exchange(other.maps_, {})) {}

Scene::~Scene() {
    for (auto map = maps_.rbegin(); map != maps_.rend(); ++map) (*map)->DeleteThis();
}

Texmap& Scene::NewMap(Class_ID id) {
    ClassDesc2* cd = nullptr;
    ParamBlockDesc2* desc = nullptr;
    if (!Storable(classes_, id, cd, desc)) throw std::runtime_error("no map class " + IdText(id) + " is known");
    maps_.reserve(maps_.size() + 1);
    Texmap* map = Made(cd->Create(FALSE));
    if (map == nullptr) throw std::runtime_error("the map class " + IdText(id) + " made no texture map");
    maps_.push_back(map);
    map->SetName(("Map #" + std::to_string(maps_.size())).c_str());
    return *map;
}

Scene Scene::Load(const std::string& path, std::vector<ClassDesc*> classes) {
    Json root;
    std::vector<MapRecord> records;
    try {
        root = Parse(ReadScene(path));
        records = CheckScene(root, classes);
    } catch (const Refused& e) {
        throw std::runtime_error(path + ": " + e.what());
    }
    Scene scene(std::move(classes));
    SceneLoad load;  // gone before the maps, so no callback outlives its map
    scene.maps_.reserve(records.size());
    for (std::size_t i = 0; i < records.size(); ++i) {
        MapRecord& record = records[i];
        const std::string which = path + ": map " + std::to_string(i + 1) + ": ";
        Texmap* map = Made(record.cd->Create(TRUE));
        if (map == nullptr) throw std::runtime_error(which + "its class made no texture map");
        scene.maps_.push_back(map);
        load.SetMap(record.data);
        if (map->Load(&load) != IO_OK) throw std::runtime_error(which + "the map could not read its data");
        auto* block = dynamic_cast<ParamBlock2*>(map->GetParamBlockByID(record.desc->ID));
        if (block == nullptr) throw std::runtime_error(which + "the map has no parameter block of its class");
        for (auto& [paramId, values] : record.parameters) {
            if (!block->Restore(paramId, std::move(values)))
                throw std::runtime_error(which + "parameter " + std::to_string(paramId) + " does not fit the map's block");
        }
    }
    load.RunCallbacks();
    return scene;
}

void Scene::Save(const std::string& path) const {
    const auto fail = [&](std::size_t index, const std::string& problem) {
        throw std::runtime_error("cannot save " + path + ": map " + std::to_string(index + 1) + " " + problem);
    };
    Json maps = Json::array();
    for (std::size_t i = 0; i < maps_.size(); ++i) {
        Texmap* map = maps_[i];
        ClassDesc2* cd = nullptr;
        ParamBlockDesc2* desc = nullptr;
        if (!Storable(classes_, map->ClassID(), cd, desc)) fail(i, "is of a class the scene does not know");
        Json entry = Json::object();
        entry["class"] = Json::array({map->ClassID().PartA(), map->ClassID().PartB()});
        SceneSave save(entry);
        if (map->Save(&save) != IO_OK) fail(i, "could not write its data");
        auto* block = dynamic_cast<ParamBlock2*>(map->GetParamBlockByID(desc->ID));
        if (block == nullptr) fail(i, "has no parameter block of its class");
        Json parameters = Json::object();
        for (int p = 0; p < desc->Count(); ++p) {
            const ParamDef& def = desc->paramdef(p);
            parameters[std::to_string(def.ID)] = ParameterToJson(def, *block->Values(def.ID));
        }
        entry["parameters"] = std::move(parameters);
        maps.push_back(std::move(entry));
    }
    Json root = Json::object();
    root["format"] = kFormat;
    root["version"] = kVersion;
    root["maps"] = std::move(maps);
    std::string text;
    try {
        text = root.dump(2) + "\n";
    } catch (const Json::type_error&) {
        throw std::runtime_error("cannot save " + path + ": a text of the scene is not valid UTF-8");
    }
    WriteFileAtomically(path, text);
}

}  // namespace Pigmo::Host
