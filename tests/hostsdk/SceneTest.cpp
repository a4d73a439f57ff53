// Scenes: what a saved scene holds, how it loads, every scene the host refuses, and saves that fail.
#include <gtest/gtest.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <unistd.h>

#include <csignal>
#include <filesystem>
#include <fstream>
#include <nlohmann/json.hpp>
#include <stdexcept>
#include <string>
#include <vector>

#include "FakeMap.h"
#include "Scene.h"
#include "TempFolder.h"

namespace {

using Pigmo::Host::Scene;

std::vector<ClassDesc*> Classes() {
    return {&Fake::Class()};
}

std::string ReadFile(const std::string& path) {
    std::ifstream file(path, std::ios::binary);
    return std::string(std::istreambuf_iterator<char>(file), {});
}

std::vector<std::string> FolderEntries(const std::string& folder) {
    std::vector<std::string> names;
    for (const auto& entry : std::filesystem::directory_iterator(folder)) names.push_back(entry.path().filename());
    std::sort(names.begin(), names.end());
    return names;
}

// Gives every parameter of a fake map a value other than its default.
void FillIn(Texmap& map) {
    IParamBlock2& b = *map.GetParamBlock(0);
    b.SetValue(Fake::kFile, 0, "/books/one.cxf");
    b.SetValue(Fake::kCount, 0, -5);
    b.SetValue(Fake::kLabel, 0, "gr\xC3\xBCn \"quoted\"\n\ttab");
    b.SetValue(Fake::kPosition, 0, Point3(0.1f, -2.5f, 1e-7f));
    b.SetValue(Fake::kWeight, 0, 0.1f);
    b.SetValue(Fake::kTint, 0, AColor(1.0f, 0.0f, 0.25f, 0.5f));
    b.SetCount(Fake::kCurve, 3);
    b.SetValue(Fake::kCurve, 0, 0.3f, 2);
    b.SetCount(Fake::kTags, 2);
    b.SetValue(Fake::kTags, 0, "warm", 0);
    b.SetValue(Fake::kTags, 0, "", 1);
    b.SetValue(Fake::kShade, 0, Color(3.0f, 0.0f, -1.0f));
    b.SetValue(Fake::kEnabled, 0, 0);
    map.SetGBufID(3);
}

class Scenes : public TempFolder {
protected:
    void TearDown() override {
        EXPECT_EQ(Fake::LiveMaps(), 0);
        TempFolder::TearDown();
    }
    std::string Path(const std::string& name = "scene.json") const { return root_ + "/" + name; }
};

TEST_F(Scenes, RoundTripKeepsEveryValueNameAndId) {
    std::vector<std::string> saved;
    {
        Scene scene(Classes());
        Texmap& first = scene.NewMap(Fake::kClassID);
        FillIn(first);
        Texmap& second = scene.NewMap(Fake::kClassID);
        EXPECT_STREQ(second.GetName(), "Map #2");
        second.SetName("Second");
        scene.Save(Path());
        for (Texmap* map : scene.Maps()) saved.push_back(Fake::Describe(*map->GetParamBlock(0)));
    }
    const Scene loaded = Scene::Load(Path(), Classes());
    ASSERT_EQ(loaded.Maps().size(), 2u);
    for (std::size_t i = 0; i < 2; ++i) {
        auto* map = static_cast<Fake::Map*>(loaded.Maps()[i]);
        EXPECT_TRUE(map->loading);
        EXPECT_EQ(Fake::Describe(*map->GetParamBlock(0)), saved[i]);
    }
    EXPECT_STREQ(loaded.Maps()[0]->GetName(), "Map #1");
    EXPECT_EQ(loaded.Maps()[0]->GetGBufID(), 3);
    EXPECT_STREQ(loaded.Maps()[1]->GetName(), "Second");
    EXPECT_NE(loaded.Maps()[0]->GetParamBlock(0)->GetAssetUser(Fake::kFile).GetId(),
              MaxSDK::AssetManagement::kInvalidId);
}

// Other programs read scenes; this is the layout they rely on.
TEST_F(Scenes, FileHoldsEachValueWithItsType) {
    {
        Scene scene(Classes());
        scene.NewMap(Fake::kClassID).GetParamBlock(0)->SetValue(Fake::kWeight, 0, 0.1f);
        scene.Save(Path());
    }
    const nlohmann::json root = nlohmann::json::parse(ReadFile(Path()));
    EXPECT_EQ(root, nlohmann::json::parse(R"({"format": "pigmo-scene", "version": 1, "maps": [{
        "class": [252645940, 2694862456], "name": "Map #1", "gbufID": 0, "parameters": {
            "0": {"type": "filename", "value": ""}, "1": {"type": "int", "value": 7},
            "2": {"type": "string", "value": "none"}, "3": {"type": "point3", "value": [1, 2, 3]},
            "4": {"type": "float", "value": 0.1}, "5": {"type": "frgba", "value": [0.25, 0.5, 0.75, 1]},
            "6": {"type": "float_tab", "value": [0.25, 0.25]}, "7": {"type": "string_tab", "value": []},
            "12": {"type": "rgb", "value": [0.125, 0.5, 1]}, "9": {"type": "bool", "value": 1}}}]})"));
    // Floats are written as the shortest decimal that reads back as the same float: 0.1, not 0.100000001.
    EXPECT_EQ(root["maps"][0]["parameters"]["4"]["value"].get<double>(), 0.1);
}

TEST_F(Scenes, LoadRestoresQuietlyThenRunsCallbacksByPriority) {
    {
        Scene scene(Classes());
        const std::tuple<const char*, int, int> maps[] = {{"A", 7, 1}, {"B", 3, 2}, {"C", 7, 3}};
        for (const auto& [name, priority, count] : maps) {
            Texmap& map = scene.NewMap(Fake::kClassID);
            map.SetName(name);
            map.SetGBufID(priority);
            map.GetParamBlock(0)->SetValue(Fake::kCount, 0, count);
        }
        scene.Save(Path());
    }
    Fake::PostLoadLog().clear();
    const Scene loaded = Scene::Load(Path(), Classes());
    // Each callback saw its map complete, and no change message came from restoring the values.
    EXPECT_EQ(Fake::PostLoadLog(),
              (std::vector<std::string>{"B count=2 changes=0", "A count=1 changes=0", "C count=3 changes=0"}));
}

TEST_F(Scenes, MissingParametersKeepTheirDefaults) {
    std::ofstream(Path()) << R"({"format": "pigmo-scene", "version": 1, "maps": [{"class": [252645940, 2694862456],)"
                             R"( "name": "M", "gbufID": 0, "parameters": {"1": {"type": "int", "value": 4}}}]})";
    const Scene loaded = Scene::Load(Path(), Classes());
    ASSERT_EQ(loaded.Maps().size(), 1u);
    EXPECT_EQ(loaded.Maps()[0]->GetParamBlock(0)->GetInt(Fake::kCount), 4);
    EXPECT_STREQ(loaded.Maps()[0]->GetParamBlock(0)->GetStr(Fake::kLabel), "none");
}

std::string SceneOf(const std::string& maps) {
    return R"({"format": "pigmo-scene", "version": 1, "maps": [)" + maps + "]}";
}

std::string MapWith(const std::string& parameters, const std::string& head = R"("name": "M", "gbufID": 0)") {
    return R"({"class": [252645940, 2694862456], )" + head + R"(, "parameters": {)" + parameters + "}}";
}

std::string Repeated(const std::string& item, std::size_t count) {
    std::string text;
    for (std::size_t i = 0; i < count; ++i) text += (i > 0 ? "," : "") + item;
    return text;
}

struct RefusedCase {
    const char* name;
    std::string content;
    std::string message;  // what the message says after "FILE: "
};

class RefusedScenes : public Scenes, public testing::WithParamInterface<RefusedCase> {};

TEST_P(RefusedScenes, SayWhyAndLoadNothing) {
    std::ofstream(Path(), std::ios::binary) << GetParam().content;
    try {
        Scene::Load(Path(), Classes());
        ADD_FAILURE() << "loaded";
    } catch (const std::runtime_error& e) {
        const std::string what = e.what();
        EXPECT_EQ(what.rfind(Path() + ": ", 0), 0u) << what;
        EXPECT_NE(what.find(GetParam().message), std::string::npos) << what;
        EXPECT_EQ(what.find('\n'), std::string::npos) << what;
    }
}

INSTANTIATE_TEST_SUITE_P(
    Cases, RefusedScenes,
    testing::Values(
        RefusedCase{"Empty", "", "empty file, not a scene"},
        RefusedCase{"Truncated", SceneOf(MapWith("")).substr(0, 60), "line 1, column 61: syntax error"},
        RefusedCase{"SyntaxErrorOnLine3", "{\n\"format\": \"pigmo-scene\",\n\"version\": 1 x\n}", "line 3, column"},
        RefusedCase{"NotAnObject", "[1, 2]", "not a scene (the document is not a JSON object)"},
        RefusedCase{"OtherFormat", R"({"format": "other", "version": 1, "maps": []})", "not a Pigmo scene"},
        RefusedCase{"LaterVersion", R"({"format": "pigmo-scene", "version": 2, "maps": []})",
                    "scene version 2; this host reads version 1"},
        RefusedCase{"NoVersion", R"({"format": "pigmo-scene", "maps": []})", "no member \"version\""},
        RefusedCase{"UnknownMember", R"({"format": "pigmo-scene", "version": 1, "maps": [], "extra": 1})",
                    "unknown member \"extra\""},
        RefusedCase{"MapsNotAList", R"({"format": "pigmo-scene", "version": 1, "maps": {}})", "\"maps\" is not a list"},
        RefusedCase{"MapNotAnObject", SceneOf("3"), "map 1: not an object"},
        RefusedCase{"UnknownClass", SceneOf(R"({"class": [1, 2], "name": "M", "gbufID": 0, "parameters": {}})"),
                    "map 1: no map class (0x00000001, 0x00000002) is known"},
        RefusedCase{"ClassNotAPair", SceneOf(R"({"class": [1], "name": "M", "gbufID": 0, "parameters": {}})"),
                    "map 1: \"class\" is not a pair of 32-bit unsigned integers"},
        RefusedCase{"ClassTooLarge", SceneOf(R"({"class": [4294967296, 1], "name": "M", "gbufID": 0, "parameters": {}})"),
                    "\"class\" is not a pair"},
        RefusedCase{"ClassNegative", SceneOf(R"({"class": [-1, 1], "name": "M", "gbufID": 0, "parameters": {}})"),
                    "\"class\" is not a pair"},
        RefusedCase{"NoName", SceneOf(MapWith("", R"("gbufID": 0)")), "map 1: no member \"name\""},
        RefusedCase{"NameNotText", SceneOf(MapWith("", R"("name": 5, "gbufID": 0)")), "map 1: \"name\": not a text"},
        RefusedCase{"GBufferIdTooLarge", SceneOf(MapWith("", R"("name": "M", "gbufID": 3000000000)")),
                    "map 1: \"gbufID\": beyond the integer range"},
        RefusedCase{"UnknownMapMember", SceneOf(MapWith("", R"("name": "M", "gbufID": 0, "color": 1)")),
                    "map 1: unknown member \"color\""},
        RefusedCase{"UnknownParameter", SceneOf(MapWith(R"("99": {"type": "int", "value": 1})")),
                    "map 1: unknown parameter \"99\""},
        RefusedCase{"ParameterIdWithZero", SceneOf(MapWith(R"("01": {"type": "int", "value": 1})")),
                    "unknown parameter \"01\""},
        RefusedCase{"WrongType", SceneOf(MapWith(R"("1": {"type": "float", "value": 1})")),
                    "map 1: parameter 1 (count): type \"float\" where the map keeps \"int\""},
        RefusedCase{"NotAnInteger", SceneOf(MapWith(R"("1": {"type": "int", "value": 1.5})")),
                    "parameter 1 (count): not an integer"},
        RefusedCase{"TooFewNumbers", SceneOf(MapWith(R"("3": {"type": "point3", "value": [1, 2]})")),
                    "parameter 3 (position): not a list of 3 numbers"},
        RefusedCase{"BeyondFloats", SceneOf(MapWith(R"("4": {"type": "float", "value": 1e39})")),
                    "number overflow parsing '1e39'"},
        RefusedCase{"NoValue", SceneOf(MapWith(R"("4": {"type": "float"})")), "no member \"value\""},
        RefusedCase{"ExtraInParameter", SceneOf(MapWith(R"("4": {"type": "float", "value": 1, "unit": "m"})")),
                    "unknown member \"unit\""},
        RefusedCase{"TableNotAList", SceneOf(MapWith(R"("6": {"type": "float_tab", "value": 1})")),
                    "the value of a table is not a list"},
        RefusedCase{"TableTooLarge",
                    SceneOf(MapWith(R"("6": {"type": "float_tab", "value": [)" + Repeated("0", 65537) + "]}")),
                    "a table of 65537 entries; a table holds at most 65536"},
        RefusedCase{"BadTableEntry", SceneOf(MapWith(R"("7": {"type": "string_tab", "value": ["a", 1]})")),
                    "parameter 7 (tags): entry 1: not a text"},
        RefusedCase{"NulInText", SceneOf(MapWith(R"("2": {"type": "string", "value": "a\u0000b"})")),
                    "a text holding a NUL character"},
        RefusedCase{"SecondMapBad", SceneOf(MapWith("") + "," + MapWith(R"("1": {"type": "int", "value": "x"})")),
                    "map 2: parameter 1 (count): not an integer"},
        RefusedCase{"NestedTooDeep", SceneOf(std::string(40, '[') + std::string(40, ']')), "nested more than 16 deep"},
        RefusedCase{"TooManyValues", SceneOf(Repeated("0", (1 << 20) + 1)), "more than 1048576 values"}),
    [](const testing::TestParamInfo<RefusedCase>& info) { return info.param.name; });

TEST_F(Scenes, FilesThatCannotBeReadAreNamed) {
    std::filesystem::create_directory(Path("folder.json"));
    std::ofstream(Path("huge.json")) << "{";
    // Sparse: large to the reader, nothing on the disk.
    ASSERT_EQ(truncate(Path("huge.json").c_str(), (64LL << 20) + 1), 0);
    const std::pair<std::string, std::string> cases[] = {
        {Path("missing.json"), "cannot read " + Path("missing.json") + ": no such file or directory"},
        {Path("folder.json"), "cannot read " + Path("folder.json") + ": is a directory"},
        {Path("huge.json"), Path("huge.json") + ": larger than 64 MiB, the most a scene may hold"},
    };
    for (const auto& [path, message] : cases) {
        try {
            Scene::Load(path, Classes());
            ADD_FAILURE() << path;
        } catch (const std::runtime_error& e) {
            EXPECT_EQ(e.what(), message);
        }
    }
}

// A save that fails partway. Run as root, a folder cannot be made unwritable, but a file-size limit
// stops any writer: the write fails as it would on a full disk.
class FileSizeLimit {
public:
    FileSizeLimit() {
        getrlimit(RLIMIT_FSIZE, &saved_);
        previous_ = std::signal(SIGXFSZ, SIG_IGN);
        rlimit tight = saved_;
        tight.rlim_cur = 16;
        setrlimit(RLIMIT_FSIZE, &tight);
    }
    ~FileSizeLimit() {
        setrlimit(RLIMIT_FSIZE, &saved_);
        std::signal(SIGXFSZ, previous_);
    }

private:
    rlimit saved_{};
    void (*previous_)(int) = nullptr;
};

TEST_F(Scenes, FailedSaveLeavesTheOldSceneByteForByte) {
    Scene scene(Classes());
    Texmap& map = scene.NewMap(Fake::kClassID);
    scene.Save(Path());
    const std::string before = ReadFile(Path());
    FillIn(map);
    try {
        const FileSizeLimit limit;
        scene.Save(Path());
        ADD_FAILURE() << "saved";
    } catch (const std::runtime_error& e) {
        EXPECT_EQ(std::string(e.what()), "cannot write " + Path() + ": file too large");
    }
    EXPECT_EQ(ReadFile(Path()), before);
    EXPECT_EQ(FolderEntries(root_), std::vector<std::string>{"scene.json"});
}

TEST_F(Scenes, SaveWhereNoFileCanBeIsReported) {
    std::ofstream(Path("file")) << "not a folder";
    std::filesystem::create_directory(Path("folder"));
    Scene scene(Classes());
    scene.NewMap(Fake::kClassID);
    const std::pair<std::string, std::string> cases[] = {
        {Path("file") + "/scene.json", "not a directory"},
        {Path("folder"), "is a directory"},
        {Path("folder") + "/", "is a directory"},
    };
    for (const auto& [path, problem] : cases) {
        try {
            scene.Save(path);
            ADD_FAILURE() << path;
        } catch (const std::runtime_error& e) {
            EXPECT_EQ(std::string(e.what()), "cannot write " + path + ": " + problem);
        }
    }
    EXPECT_TRUE(std::filesystem::is_empty(Path("folder")));
    EXPECT_EQ(FolderEntries(root_), (std::vector<std::string>{"file", "folder"}));
}

TEST_F(Scenes, ReplacedSceneKeepsItsPermissionsAndTextMustBeUtf8) {
    Scene scene(Classes());
    Texmap& map = scene.NewMap(Fake::kClassID);
    scene.Save(Path());
    ASSERT_EQ(chmod(Path().c_str(), 0640), 0);
    scene.Save(Path());
    struct stat status {};
    ASSERT_EQ(stat(Path().c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 07777, 0640u);

    const std::string before = ReadFile(Path());
    map.GetParamBlock(0)->SetValue(Fake::kLabel, 0, "\xFF");
    try {
        scene.Save(Path());
        ADD_FAILURE();
    } catch (const std::runtime_error& e) {
        EXPECT_EQ(std::string(e.what()), "cannot save " + Path() + ": a text of the scene is not valid UTF-8");
    }
    EXPECT_EQ(ReadFile(Path()), before);
}

}  // namespace
