// The host's services to plug-ins and tools: loading a plug-in library, the mental ray shaders, the
// asset manager, the configured folders and the main window.
#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <memory>
#include <stdexcept>
#include <string>

#include "CoreInterface.h"
#include "FakeMap.h"
#include "PluginLibrary.h"
#include "Scene.h"
#include "ShaderCreation.h"

namespace {

using Pigmo::Host::PluginLibrary;

std::string LoadError(const std::string& path) {
    try {
        PluginLibrary library(path);
    } catch (const std::runtime_error& e) {
        return e.what();
    }
    return "";
}

TEST(PluginLibrary, LoadsClassesThroughTheEntryPoints) {
    const PluginLibrary library(FAKE_PLUGIN);
    // The library says it has two classes; the second is missing.
    ASSERT_EQ(library.Classes().size(), 1u);
    EXPECT_NE(library.Find(Fake::kClassID, TEXMAP_CLASS_ID), nullptr);
    EXPECT_EQ(library.Find(Fake::kClassID, 0), nullptr);
    EXPECT_EQ(library.Find(Class_ID(0x52EA6278, 0xA76B89F1), TEXMAP_CLASS_ID), nullptr);

    // A scene of the library's maps goes before the library does.
    Pigmo::Host::Scene scene(library.Classes());
    Texmap& map = scene.NewMap(Fake::kClassID);
    EXPECT_EQ(map.GetParamBlock(0)->GetInt(Fake::kCount), 7);
}

TEST(PluginLibrary, RefusesWhatIsNotAPluginOfThisHost) {
    EXPECT_EQ(LoadError(FAKE_PLUGIN_OLD), std::string(FAKE_PLUGIN_OLD) +
                                              ": plug-in version 0x00000001, but this host loads version 0x32C82300");
    EXPECT_EQ(LoadError("/nonexistent/libpigmo.so"),
              "cannot load the plug-in: /nonexistent/libpigmo.so: cannot open shared object file: No such file or directory");
    // The plug-in is looked for beside the host's library, which is a library but not a plug-in.
    const std::filesystem::path plugin = PluginLibrary::DefaultPath();
    EXPECT_TRUE(plugin.is_absolute());
    EXPECT_EQ(plugin.filename(), "libpigmo.so");
    const std::string host = plugin.parent_path() / "libpigmo-hostsdk.so";
    EXPECT_EQ(LoadError(host), host + ": not a plug-in of this host (no entry point LibVersion)");
}

TEST(MentalRay, ShadersComeWithTheParametersOfTheirClass) {
    Pigmo::Host::ShaderCreation creation;
    imrShader* shader = creation.CreateShader("adsk_Utility_ColorPassThrough", "Map #1 (Color Map)");
    ASSERT_NE(shader, nullptr);
    EXPECT_STREQ(shader->GetName(), "Map #1 (Color Map)");
    EXPECT_EQ(dynamic_cast<Pigmo::Host::Shader*>(shader)->Declaration(), "adsk_Utility_ColorPassThrough");
    EXPECT_NE(shader->GetReferenceTarget(), nullptr);
    IParamBlock2* parameters = shader->GetParametersParamBlock();
    ASSERT_NE(parameters, nullptr);
    ASSERT_EQ(parameters->NumParams(), 1);
    const ParamID id = parameters->IndextoID(0);
    EXPECT_STREQ(parameters->GetParamDef(id).int_name, "color");
    EXPECT_EQ(parameters->GetParamDef(id).type, TYPE_FRGBA);
    EXPECT_TRUE(parameters->SetValue(id, 0, AColor(0.2f, 0.4f, 0.6f, 1.0f)));
    EXPECT_EQ(creation.CreateShader("adsk_Unknown", "x"), nullptr);
    EXPECT_EQ(creation.CreateShader(nullptr, "x"), nullptr);

    // Declared anew with a parameter of another name; the shader made before keeps its own.
    creation.Declare("adsk_Utility_ColorPassThrough",
                     std::make_shared<ParamBlockDesc2>(0, "parameters", 0, nullptr, 0, 4, "Color", TYPE_FRGBA, 0, 0,
                                                       p_end, p_end));
    imrShader* renamed = creation.CreateShader("adsk_Utility_ColorPassThrough", "Map #2");
    ASSERT_NE(renamed, nullptr);
    EXPECT_STREQ(renamed->GetParametersParamBlock()->GetParamDef(4).int_name, "Color");
    EXPECT_STREQ(parameters->GetParamDef(id).int_name, "color");
}

TEST(Host, AnswersForItsAssetsFoldersAndWindow) {
    using namespace MaxSDK::AssetManagement;
    IAssetManager* assets = IAssetManager::GetInstance();
    const AssetId a = assets->GetAsset("/books/a.cxf", kBitmapAsset).GetId();
    EXPECT_NE(a, kInvalidId);
    EXPECT_EQ(assets->GetAsset("/books/a.cxf", kOtherAsset).GetId(), a);
    EXPECT_NE(assets->GetAsset("/books/b.cxf", kBitmapAsset).GetId(), a);
    EXPECT_EQ(assets->GetAsset("", kBitmapAsset).GetId(), kInvalidId);

    if (const char* home = std::getenv("HOME")) {
        EXPECT_STREQ(IPathConfigMgr::GetPathConfigMgr()->GetDir(APP_IMAGE_DIR), home);
    }
    EXPECT_STREQ(IPathConfigMgr::GetPathConfigMgr()->GetDir(1), "");

    EXPECT_EQ(GetCOREInterface()->GetMAXHWnd(), nullptr);
    const auto window = reinterpret_cast<HWND>(std::uintptr_t{0x1234});
    Pigmo::Host::SetMainWindow(window);
    EXPECT_EQ(GetCOREInterface()->GetMAXHWnd(), window);
    Pigmo::Host::SetMainWindow(nullptr);
}

}  // namespace
