// The Color Map against the host SDK stand-in: entry points, descriptor, parameters, shading,
// viewport, cloning, loading, assets and the mental ray translation.
#include <gtest/gtest.h>

#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <string>
#include <vector>

#include "BookFiles.h"
#include "ColorBookReader.h"
#include "Descriptor.h"
#include "Map.h"
#include "MessageBox.h"
#include "Paths.h"
#include "Registry.h"

extern "C" {
const MCHAR* LibDescription();
int LibNumberClasses();
ClassDesc* LibClassDesc(int i);
ULONG LibVersion();
ULONG CanAutoDefer();
}

namespace {

using Pigmo::ColorMap::Descriptor;
using Pigmo::ColorMap::Map;
using Pigmo::Platform::RegistryStore;
namespace CM = Pigmo::ColorMap;

Descriptor& TheDescriptor() {
    return *static_cast<Descriptor*>(LibClassDesc(0));
}

TEST(EntryPoints, AnswerAsTheHostExpects) {
    EXPECT_STREQ(LibDescription(), "Pigmo Color Map");
    EXPECT_EQ(LibNumberClasses(), 1);
    EXPECT_EQ(LibVersion(), 0x32C82300u);
    EXPECT_EQ(CanAutoDefer(), 1u);
    EXPECT_EQ(LibClassDesc(1), nullptr);
    EXPECT_EQ(LibClassDesc(0), LibClassDesc(0));
    EXPECT_NE(CM::ModuleInstance(), nullptr);
    WNDCLASSA windowClass{};
    for (const char* name : {"ColorPallette", "ColorInformation", "SpectralChart"}) {
        ASSERT_EQ(GetClassInfoA(nullptr, name, &windowClass), TRUE) << name;
        EXPECT_EQ(windowClass.style, CS_HREDRAW | CS_VREDRAW);
        EXPECT_EQ(windowClass.hInstance, CM::ModuleInstance());
    }
}

TEST(EntryPoints, DescriptorNamesTheClass) {
    Descriptor& descriptor = TheDescriptor();
    EXPECT_EQ(descriptor.IsPublic(), 1);
    EXPECT_EQ(descriptor.SuperClassID(), 0xC10u);
    EXPECT_EQ(descriptor.ClassID(), Class_ID(0x52EA6278, 0xA76B89F1));
    EXPECT_STREQ(descriptor.InternalName(), "PigmoColorMap");
    // Both texts come through the one shared buffer.
    const MCHAR* name = descriptor.ClassName();
    EXPECT_STREQ(name, "Pigmo Kromalo Plug-in");
    const MCHAR* category = descriptor.Category();
    EXPECT_EQ(name, category);
    EXPECT_STREQ(category, "Pigmo Plugins");

    auto* info = static_cast<imrShaderTranslation_ClassInfo*>(
        descriptor.GetInterface(IMRSHADERTRANSLATION_CLASSINFO_INTERFACE_ID));
    ASSERT_NE(info, nullptr);
    EXPECT_STREQ(info->internal_name, "imrShaderTranslation_ClassInfo");
    EXPECT_EQ(info->GetApplyTypes(), 0x00108042u);
    auto* compatibility = static_cast<IMtlRender_Compatibility_MtlBase*>(
        descriptor.GetInterface(IMTLRENDER_COMPATIBILITY_MTLBASE_INTERFACEID));
    ASSERT_NE(compatibility, nullptr);
    EXPECT_STREQ(compatibility->internal_name, "IMtlRender_Compability_MtlBase");
    EXPECT_TRUE(compatibility->IsCompatibleWithRenderer(descriptor));
    EXPECT_EQ(compatibility->HInstance(), CM::ModuleInstance());
}

TEST(EntryPoints, ParameterDescriptionMatchesTheTaggedList) {
    ParamBlockDesc2* description = TheDescriptor().ParameterDescription();
    ASSERT_NE(description, nullptr);
    EXPECT_EQ(description->flags, P_AUTO_CONSTRUCT | P_AUTO_UI);
    EXPECT_EQ(description->dlg_template, 101);
    EXPECT_EQ(description->title, 102);
    ASSERT_EQ(description->Count(), 9);
    const ParamDef& file = description->GetParamDef(CM::colorBookFilePath);
    EXPECT_EQ(file.type, TYPE_FILENAME);
    EXPECT_EQ(file.ctrl_type, TYPE_FILEOPENBUTTON);
    EXPECT_EQ(file.ctrl_id, 1005);
    EXPECT_EQ(file.caption, 103);
    EXPECT_EQ(file.file_types, 105);
    EXPECT_EQ(file.asset_type, 1);
    EXPECT_STREQ(description->GetParamDef(CM::currentTags).int_name, "currentTags");
    EXPECT_EQ(description->GetParamDef(CM::currentTags).type, TYPE_STRING_TAB);
    EXPECT_EQ(description->GetParamDef(CM::currentColorSpectralReflectance).type, TYPE_FLOAT_TAB);
}

// Counts the handles made, so a test can see when the texture is rebuilt.
class CountingMaker final : public TexHandleMaker {
public:
    struct Handle final : TexHandle {
        explicit Handle(BITMAPINFO* dib) : dib(dib) {}
        ~Handle() override { std::free(dib); }
        DWORD_PTR GetHandle() override { return reinterpret_cast<DWORD_PTR>(this); }
        void DeleteThis() override { delete this; }
        BITMAPINFO* dib;
    };
    int Size() override { return 4; }
    TexHandle* CreateHandle(BITMAPINFO* dib) override {
        ++made;
        return new Handle(dib);
    }
    BITMAPINFO* BitmapToDIB(Bitmap* bitmap, int, BOOL, BOOL) override {
        const std::size_t pixels = std::size_t(bitmap->Width()) * bitmap->Height();
        auto* dib = static_cast<BITMAPINFO*>(std::malloc(sizeof(BITMAPINFO) + pixels * sizeof(BMM_Color_64)));
        dib->bmiHeader = BITMAPINFOHEADER{};
        dib->bmiHeader.biWidth = bitmap->Width();
        dib->bmiHeader.biHeight = bitmap->Height();
        dib->bmiHeader.biBitCount = 64;
        auto* out = reinterpret_cast<BMM_Color_64*>(dib + 1);
        for (int y = 0; y < bitmap->Height(); ++y)
            bitmap->GetPixels(0, y, bitmap->Width(), out + y * bitmap->Width());
        return dib;
    }
    int made = 0;
};

// A host loading a scene: one value store and the callbacks it runs at the end.
class SceneLoad final : public ILoad {
public:
    IOResult ReadString(const MCHAR*, MSTR&) override { return IO_OK; }
    IOResult ReadInt(const MCHAR*, int&) override { return IO_OK; }
    void RegisterPostLoadCallback(PostLoadCallback* callback) override { callbacks.push_back(callback); }
    void Finish() {
        for (PostLoadCallback* callback : callbacks) callback->proc(this);
        callbacks.clear();
    }
    std::vector<PostLoadCallback*> callbacks;
};

// A map in a scene of its own, with books in the test's folder and no palettes but those it writes.
class ColorMap : public PaletteFolders {
protected:
    void SetUp() override {
        PaletteFolders::SetUp();
        Pigmo::Platform::TakeMessageBoxes();
    }
    void TearDown() override {
        for (Map* map : maps_) map->DeleteThis();
        PaletteFolders::TearDown();
    }

    Map& NewMap(bool loading = false) {
        auto* map = static_cast<Map*>(static_cast<Texmap*>(TheDescriptor().Create(loading ? TRUE : FALSE)));
        maps_.push_back(map);
        return *map;
    }
    // Two colors with Lab and sRGB given, the second with two tags and a curve.
    std::string ThreeColorBook(const std::string& name) {
        std::string curve;
        for (int i = 0; i < 36; ++i) curve += "<CxF:ReflectancePoint>0.5</CxF:ReflectancePoint>";
        return Write(name,
                     Book(ColorSet(
                         R"(<CxF:Color ColorName="Red"><CxF:ColorSpaceSRGB><CxF:Red>1</CxF:Red>)"
                         "<CxF:Green>0</CxF:Green><CxF:Blue>0</CxF:Blue></CxF:ColorSpaceSRGB></CxF:Color>"
                         R"(<CxF:Color ColorName="Grey"><CxF:ColorSpaceSpectral>)" +
                         curve +
                         "</CxF:ColorSpaceSpectral><CxF:CustomAttribute><CxF:Name>tags</CxF:Name>"
                         "<CxF:ValueChoice><CxF:StringValue>a</CxF:StringValue><CxF:StringValue>b"
                         "</CxF:StringValue></CxF:ValueChoice></CxF:CustomAttribute></CxF:Color>"
                         R"(<CxF:Color ColorName="Blue"><CxF:ColorSpaceSRGB><CxF:Red>0</CxF:Red>)"
                         "<CxF:Green>0</CxF:Green><CxF:Blue>1</CxF:Blue></CxF:ColorSpaceSRGB></CxF:Color>")));
    }
    void InstallSystemPalette(const std::string& content) {
        System("first.cxf", content);
        RegistryStore::Instance().SetString(Pigmo::Platform::kSuiteUninstallKey, "InstallLocation",
                                            root_ + "/suite/");
    }
    static AColor Shade(Map& map, BOOL maps = TRUE) {
        ShadeContext sc;
        sc.doMaps = maps;
        return map.EvalColor(sc);
    }

    std::vector<Map*> maps_;
};

TEST_F(ColorMap, WithoutSystemPaletteStartsEmptyAndRendersBlack) {
    Map& map = NewMap();
    IParamBlock2* block = map.GetParamBlock(0);
    EXPECT_STREQ(block->GetStr(CM::colorBookFilePath), "");
    EXPECT_EQ(block->GetInt(CM::selectedColorIndex), -1);
    EXPECT_STREQ(block->GetStr(CM::currentColorName), "");
    EXPECT_STREQ(block->GetStr(CM::currentColorCategory), "");
    for (const ParamID id : {CM::currentColorSRGB, CM::currentColorLinearRGB, CM::currentColorLAB})
        EXPECT_EQ(block->GetPoint3(id), Point3(0.0f, 0.0f, 0.0f));
    EXPECT_EQ(block->Count(CM::currentColorSpectralReflectance), 0);
    EXPECT_EQ(block->Count(CM::currentTags), 0);
    EXPECT_EQ(map.GetColorCount(), 0u);
    EXPECT_EQ(Shade(map), AColor(0, 0, 0, 1));
    EXPECT_TRUE(Pigmo::Platform::TakeMessageBoxes().empty());
}

TEST_F(ColorMap, NewMapTakesTheFirstSystemPaletteAndItsFirstColor) {
    InstallSystemPalette(
        Book(ColorSet(R"(<CxF:Color ColorName="Only"><CxF:ColorSpaceCIELab><CxF:L>50</CxF:L>)"
                      "<CxF:A>0</CxF:A><CxF:B>0</CxF:B></CxF:ColorSpaceCIELab></CxF:Color>")));
    Map& map = NewMap();
    EXPECT_EQ(Pigmo::Platform::NativePath(map.GetParamBlock(0)->GetStr(CM::colorBookFilePath)),
              root_ + "/suite/Resources/System Palettes/first.cxf");
    EXPECT_EQ(map.GetSelectedIndex(), 0);
    EXPECT_STREQ(map.GetName(), "Only");
    // A map made for loading waits for its post-load callback.
    Map& loading = NewMap(true);
    EXPECT_STREQ(loading.GetParamBlock(0)->GetStr(CM::colorBookFilePath), "");
    EXPECT_EQ(loading.GetColorCount(), 0u);
}

TEST_F(ColorMap, PickCopiesTheRecordAndMinusOneClearsIt) {
    Map& map = NewMap();
    map.SetColorBookPath(ThreeColorBook("book.cxf").c_str());
    ASSERT_EQ(map.GetColorCount(), 3u);
    EXPECT_EQ(map.GetSelectedIndex(), 0);
    EXPECT_STREQ(map.GetName(), "Red");

    map.SelectColor(1);
    const Pigmo::IColorInformation& record = *map.GetColor(1);
    EXPECT_STREQ(map.GetName(), "Grey");
    EXPECT_STREQ(map.GetCategory(), "Default");
    for (int i = 0; i < 3; ++i) {
        EXPECT_EQ(map.GetLab()[i], record.GetLab()[i]);
        EXPECT_EQ(map.GetSRGB()[i], record.GetSRGB()[i]);
        EXPECT_EQ(map.GetLinearRGB()[i], record.GetLinearRGB()[i]);
    }
    ASSERT_EQ(map.GetSpectralReflectanceCount(), 36);
    EXPECT_EQ(map.GetSpectralReflectance()[35], 0.5f);
    ASSERT_EQ(map.GetTagCount(), 2);
    EXPECT_STREQ(map.GetTag(1), "b");
    EXPECT_EQ(map.GetTag(2), nullptr);
    const Point3 linear = map.GetParamBlock(0)->GetPoint3(CM::currentColorLinearRGB);
    EXPECT_EQ(Shade(map), AColor(linear.x, linear.y, linear.z, 1.0f));

    // Beyond the book nothing changes.
    map.SelectColor(3);
    map.SelectColor(-2);
    EXPECT_EQ(map.GetSelectedIndex(), 1);

    map.SetScrollPosition(2);
    map.SelectColor(-1);
    EXPECT_EQ(map.GetSelectedIndex(), -1);
    EXPECT_STREQ(map.GetName(), "");
    EXPECT_EQ(map.GetParamBlock(0)->GetPoint3(CM::currentColorLAB), Point3(0.0f, 0.0f, 0.0f));
    EXPECT_EQ(map.GetSpectralReflectanceCount(), 0);
    EXPECT_EQ(map.GetSpectralReflectance(), nullptr);
    EXPECT_EQ(map.GetTagCount(), 0);
    EXPECT_EQ(map.GetScrollPosition(), 0);
}

TEST_F(ColorMap, AnotherBookClearsThePickButKeepsTheRenderedColor) {
    Map& map = NewMap();
    map.SetColorBookPath(ThreeColorBook("first.cxf").c_str());
    map.SelectColor(2);
    map.SetScrollPosition(2);
    const AColor before = Shade(map);
    // As the file button does: the parameter alone.
    map.GetParamBlock(0)->SetValue(
        CM::colorBookFilePath, 0,
        Write("second.cxf", Book(ColorSet(R"(<CxF:Color ColorName="Lone"/>)"))).c_str());
    EXPECT_EQ(map.GetSelectedIndex(), -1);
    EXPECT_EQ(map.GetScrollPosition(), 0);
    EXPECT_EQ(map.GetColorCount(), 1u);
    EXPECT_EQ(Shade(map), before);
    EXPECT_STREQ(map.GetName(), "Blue");
}

TEST_F(ColorMap, BookThatCannotBeReadIsReportedOnce) {
    Map& map = NewMap();
    const std::string missing = root_ + "/gone.cxf";
    map.SetColorBookPath(missing.c_str());
    const std::vector<Pigmo::Platform::ShownMessageBox> boxes = Pigmo::Platform::TakeMessageBoxes();
    ASSERT_EQ(boxes.size(), 1u);
    EXPECT_EQ(boxes[0].caption, "Pigmo Color Map");
    EXPECT_EQ(boxes[0].text, "ColorBook file '" + missing + "' doesn't exist");
    EXPECT_EQ(boxes[0].type, MB_OK);
    EXPECT_EQ(map.GetColorCount(), 0u);
}

TEST_F(ColorMap, MapsOffShadeNothingAndTheGBufferIdIsPassedOn) {
    Map& map = NewMap();
    map.SetColorBookPath(ThreeColorBook("book.cxf").c_str());
    ShadeContext sc;
    sc.doMaps = FALSE;
    EXPECT_EQ(map.EvalColor(sc), AColor(0, 0, 0, 0));
    EXPECT_EQ(map.EvalMono(sc), 0.0f);
    EXPECT_EQ(map.EvalNormalPerturb(sc), Point3(0.0f, 0.0f, 1.0f));
    sc.doMaps = TRUE;
    map.SetGBufID(7);
    EXPECT_NEAR(map.EvalMono(sc), 1.0f / 3.0f, 1e-6);  // pure red
    EXPECT_EQ(sc.gbufId, 7);
}

TEST_F(ColorMap, CloneNeedsNoSecondReadOfTheBook) {
    Map& map = NewMap();
    const std::string book = ThreeColorBook("book.cxf");
    map.SetColorBookPath(book.c_str());
    map.SelectColor(1);
    map.SetName("Map #1");
    std::filesystem::remove(book);
    RemapDir* remap = NewRemapDir();
    auto* clone = static_cast<Map*>(map.Clone(*remap));
    remap->DeleteThis();
    maps_.push_back(clone);
    EXPECT_EQ(static_cast<MtlBase*>(clone)->GetName(), static_cast<MtlBase&>(map).GetName());
    EXPECT_EQ(clone->GetColorCount(), 3u);
    EXPECT_EQ(Shade(*clone), Shade(map));
    EXPECT_NE(clone->GetParamBlock(0), map.GetParamBlock(0));
    EXPECT_EQ(clone->GetSelectedIndex(), 1);
    EXPECT_TRUE(Pigmo::Platform::TakeMessageBoxes().empty());
}

TEST_F(ColorMap, TextureIsRebuiltAfterAnyParameterChange) {
    Map& map = NewMap();
    map.SetColorBookPath(ThreeColorBook("book.cxf").c_str());
    CountingMaker maker;
    const DWORD_PTR first = map.GetActiveTexHandle(0, maker);
    EXPECT_EQ(map.GetActiveTexHandle(0, maker), first);
    EXPECT_EQ(maker.made, 1);
    map.GetParamBlock(0)->SetValue(CM::currentColorName, 0, "Renamed");
    map.GetActiveTexHandle(0, maker);
    EXPECT_EQ(maker.made, 2);
    map.ActivateTexDisplay(FALSE);
    map.GetActiveTexHandle(0, maker);
    EXPECT_EQ(maker.made, 3);
}

struct ViewportCase {
    Point3 linear;
    BMM_Color_64 pixel;
};

class ViewportPixels : public ColorMap, public testing::WithParamInterface<ViewportCase> {};

// Clamped to 0..1, then the truncation of value x 65535.
TEST_P(ViewportPixels, AreTheClampedColorIn16Bits) {
    Map& map = NewMap();
    map.GetParamBlock(0)->SetValue(CM::currentColorLinearRGB, 0, GetParam().linear);
    CountingMaker maker;
    Interval valid = NEVER;
    BITMAPINFO* dib = map.GetVPDisplayDIB(0, maker, valid, FALSE, FALSE, FALSE);
    ASSERT_NE(dib, nullptr);
    EXPECT_EQ(valid, FOREVER);
    EXPECT_EQ(dib->bmiHeader.biWidth, 4);
    const auto* pixels = reinterpret_cast<const BMM_Color_64*>(dib + 1);
    for (int i = 0; i < 16; ++i) EXPECT_EQ(pixels[i], GetParam().pixel) << i;
    std::free(dib);
}

INSTANTIATE_TEST_SUITE_P(Cases, ViewportPixels,
                         testing::Values(ViewportCase{{0.5f, 1.0f, 0.0f}, {32767, 65535, 0, 65535}},
                                         ViewportCase{{1.5f, -0.25f, 0.25f}, {65535, 0, 16383, 65535}},
                                         ViewportCase{{0.2f, 0.4f, 0.6f}, {13107, 26214, 39321, 65535}}));

TEST_F(ColorMap, LoadedMapReadsItsBookAfterTheSceneAndScrollsToThePick) {
    const std::string book = ThreeColorBook("book.cxf");
    Map& map = NewMap(true);
    SceneLoad load;
    EXPECT_EQ(map.Load(&load), IO_OK);
    ASSERT_EQ(load.callbacks.size(), 1u);
    EXPECT_EQ(load.callbacks[0]->Priority(), 5);
    // The host restores the saved parameters before the callbacks run.
    IParamBlock2* block = map.GetParamBlock(0);
    block->SetValue(CM::colorBookFilePath, 0, book.c_str());
    block->SetValue(CM::selectedColorIndex, 0, 2);
    block->SetValue(CM::currentColorLinearRGB, 0, Point3(0.1f, 0.2f, 0.3f));
    load.Finish();
    EXPECT_EQ(map.GetColorCount(), 3u);
    EXPECT_EQ(map.GetScrollPosition(), 2);
    EXPECT_EQ(Shade(map), AColor(0.1f, 0.2f, 0.3f, 1.0f));
}

// Collects what the map declares.
class Declarations final : public MaxSDK::AssetManagement::IEnumAuxAssetsCallback {
public:
    void RecordAsset(const MaxSDK::AssetManagement::AssetUser& asset) override {
        recorded.emplace_back(asset.GetFileName());
    }
    void DeclareAsset(MaxSDK::AssetManagement::IAssetAccessor& accessor) override {
        EXPECT_EQ(accessor.GetAssetType(), MaxSDK::AssetManagement::kBitmapAsset);
        declared.emplace_back(accessor.GetAsset().GetFileName());
    }
    std::vector<std::string> recorded, declared;
};

TEST_F(ColorMap, DeclaresItsBookAsAnAsset) {
    Map& map = NewMap();
    const std::string book = ThreeColorBook("book.cxf");
    map.SetColorBookPath(book.c_str());
    Declarations declarations;
    map.EnumAuxFiles(declarations, FILE_ENUM_ACCESSOR_INTERFACE);
    EXPECT_EQ(declarations.declared, std::vector<std::string>{book});

    // A map already visited is passed over.
    Declarations again;
    map.SetAFlag(A_WORK1);
    map.EnumAuxFiles(again, FILE_ENUM_ACCESSOR_INTERFACE | FILE_ENUM_CHECK_AWORK1);
    EXPECT_TRUE(again.declared.empty());
    EXPECT_TRUE(again.recorded.empty());
}

TEST_F(ColorMap, AnswersForItsInterfacesAndReferences) {
    Map& map = NewMap();
    EXPECT_EQ(map.GetInterface(I_SUBMAP), static_cast<ISubMap*>(&map));
    EXPECT_EQ(map.GetInterface(IMRSHADERTRANSLATION_INTERFACE_ID), static_cast<imrShaderTranslation*>(&map));
    EXPECT_EQ(map.GetInterface(Interface_ID(1, 2)), nullptr);
    EXPECT_EQ(map.SubAnim(0), map.GetParamBlock(0));
    EXPECT_EQ(map.SubAnim(1), nullptr);
    EXPECT_STREQ(map.SubAnimName(0), "Parameters");
    EXPECT_STREQ(map.SubAnimName(1), "");
    EXPECT_EQ(map.GetParamBlockByID(0), map.GetParamBlock(0));
    EXPECT_EQ(map.GetParamBlockByID(1), nullptr);
    EXPECT_EQ(map.GetTextureTiling(), U_WRAP | V_WRAP);
    Matrix3 transform;
    map.GetUVTransform(transform);
    EXPECT_TRUE(transform.IsIdentity());
}

// A mental ray shader whose parameters are an integer and a color under the given name.
class Shader final : public imrShader, public ReferenceMaker, public ClassDesc2 {
public:
    explicit Shader(const char* colorName)
        : description_(0, "parameters", 0, this, P_AUTO_CONSTRUCT, 0, 1, "other", TYPE_INT, 0, 0, p_end, 2,
                       colorName, TYPE_FRGBA, 0, 0, p_end, p_end) {
        MakeAutoParamBlocks(this);
    }
    IParamBlock2* GetParametersParamBlock() override { return block_; }
    ReferenceTarget* GetReferenceTarget() override { return block_; }
    const MCHAR* GetName() override { return "shader"; }

    int IsPublic() override { return 0; }
    void* Create(BOOL) override { return nullptr; }
    const MCHAR* ClassName() override { return "adsk_Utility_ColorPassThrough"; }
    SClass_ID SuperClassID() override { return 0; }
    Class_ID ClassID() override { return Class_ID(1, 1); }
    const MCHAR* Category() override { return ""; }

private:
    void SetReference(int, RefTargetHandle target) override { block_ = static_cast<IParamBlock2*>(target); }
    RefResult NotifyRefChanged(Interval, RefTargetHandle, PartID&, RefMessage) override {
        return REF_SUCCEED;
    }

    ParamBlockDesc2 description_;
    IParamBlock2* block_ = nullptr;
};

class Creation final : public imrShaderCreation {
public:
    imrShader* CreateShader(const MCHAR* declaration, const MCHAR* name) override {
        asked = std::string(declaration) + " / " + name;
        return nullptr;
    }
    std::string asked;
};

TEST_F(ColorMap, MentalRaySetsOnlyTheParameterNamedColor) {
    Map& map = NewMap();
    map.SetName("Map #1");
    map.GetParamBlock(0)->SetValue(CM::currentColorLinearRGB, 0, Point3(0.2f, 0.4f, 0.6f));
    Creation creation;
    EXPECT_EQ(map.GetMRShader(creation), nullptr);
    EXPECT_EQ(creation.asked, "adsk_Utility_ColorPassThrough / Map #1 (Pigmo Kromalo Plug-in)");
    EXPECT_FALSE(map.NeedsAutomaticParamBlock2Translation());

    imrTranslation translation;
    Interval valid = NEVER;
    Shader exact("color"), capital("Color");
    map.TranslateParameters(translation, &exact, 0, valid);
    map.TranslateParameters(translation, &capital, 0, valid);
    map.TranslateParameters(translation, nullptr, 0, valid);
    AColor color;
    Interval ignored;
    ASSERT_TRUE(exact.GetParametersParamBlock()->GetValue(2, 0, color, ignored));
    EXPECT_EQ(color, AColor(0.2f, 0.4f, 0.6f, 1.0f));
    ASSERT_TRUE(capital.GetParametersParamBlock()->GetValue(2, 0, color, ignored));
    EXPECT_EQ(color, AColor());
    EXPECT_EQ(valid, NEVER);
}

}  // namespace
