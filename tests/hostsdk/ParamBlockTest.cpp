// The host's parameter blocks, built from a tagged description: defaults, typed reads and writes,
// tables, change messages, resets and clones.
#include <gtest/gtest.h>

#include <cmath>
#include <functional>
#include <string>
#include <vector>

#include "FakeMap.h"

namespace {

using MaxSDK::AssetManagement::AssetUser;
using MaxSDK::AssetManagement::kInvalidId;

const std::string kDefaults =
    "0: \"\"\n1: 7\n2: \"none\"\n3: 1 2 3\n4: 0.5\n5: 0.25 0.5 0.75 1\n6: 0.25 0.25\n7:\n12: 0.125 0.5 1\n9: "
    "1\n";

class Block : public testing::Test {
protected:
    void SetUp() override {
        map_ = static_cast<Fake::Map*>(static_cast<Texmap*>(Fake::Class().Create(FALSE)));
        block_ = map_->GetParamBlock(0);
    }
    void TearDown() override { map_->DeleteThis(); }

    Fake::Map* map_ = nullptr;
    IParamBlock2* block_ = nullptr;
};

TEST_F(Block, IsBuiltFromTheTaggedListWithItsDefaults) {
    ParamBlockDesc2* desc = Fake::Class().GetParamBlockDescByID(0);
    ASSERT_NE(desc, nullptr);
    EXPECT_EQ(desc->flags, P_AUTO_CONSTRUCT | P_AUTO_UI);
    EXPECT_EQ(desc->dlg_template, 101);
    EXPECT_EQ(desc->title, 102);
    // Ids and places differ: "shade" (12) is the ninth parameter.
    EXPECT_EQ(desc->IDtoIndex(Fake::kShade), 8);
    EXPECT_EQ(desc->IndextoID(8), Fake::kShade);
    EXPECT_EQ(desc->IndextoID(10), -1);
    const ParamDef& file = desc->GetParamDef(Fake::kFile);
    EXPECT_EQ(file.ctrl_type, TYPE_FILEOPENBUTTON);
    EXPECT_EQ(file.ctrl_id, 1005);
    EXPECT_EQ(file.caption, 103);
    EXPECT_STREQ(file.init_file, "/images");
    EXPECT_EQ(file.file_types, 105);
    EXPECT_EQ(file.asset_type, 1);
    EXPECT_EQ(desc->GetParamDef(Fake::kCurve).tab_size, 2);

    EXPECT_EQ(Fake::Describe(*block_), kDefaults);
    EXPECT_EQ(block_->GetOwner(), map_);
    EXPECT_EQ(block_->GetAssetUser(Fake::kFile).GetId(), kInvalidId);
    EXPECT_TRUE(map_->changes.empty());
}

struct WriteCase {
    const char* name;
    ParamID id;
    std::function<BOOL(IParamBlock2&)> write;
    bool accepted;
};

class Writes : public Block, public testing::WithParamInterface<WriteCase> {};

// An accepted write tells the owner once which parameter changed; a refused one changes nothing
// and tells no one.
TEST_P(Writes, AreTypedAndAnnounced) {
    const WriteCase& c = GetParam();
    EXPECT_EQ(c.write(*block_), c.accepted ? TRUE : FALSE);
    EXPECT_EQ(Fake::Describe(*block_) != kDefaults, c.accepted);
    EXPECT_EQ(map_->changes, c.accepted ? std::vector<ParamID>{c.id} : std::vector<ParamID>{});
    EXPECT_EQ(block_->LastNotifyParamID(), c.accepted ? c.id : -1);
}

using B = IParamBlock2;
const AssetUser kAsset(MaxSDK::AssetManagement::AssetId(77), MaxSDK::AssetManagement::kBitmapAsset, "/b.cxf");

INSTANTIATE_TEST_SUITE_P(
    Cases, Writes,
    testing::Values(
        WriteCase{"IntoInt", Fake::kCount, [](B& b) { return b.SetValue(Fake::kCount, 0, 9); }, true},
        WriteCase{"IntoBool", Fake::kEnabled, [](B& b) { return b.SetValue(Fake::kEnabled, 0, 0); }, true},
        WriteCase{"IntIntoFloat", Fake::kWeight, [](B& b) { return b.SetValue(Fake::kWeight, 0, 2); }, false},
        WriteCase{"FloatIntoInt", Fake::kCount, [](B& b) { return b.SetValue(Fake::kCount, 0, 2.5f); },
                  false},
        WriteCase{"NaN", Fake::kWeight, [](B& b) { return b.SetValue(Fake::kWeight, 0, std::nanf("")); },
                  false},
        WriteCase{"Point3IntoRgb", Fake::kShade,
                  [](B& b) { return b.SetValue(Fake::kShade, 0, Point3(0.0f, 0.0f, 0.0f)); }, true},
        WriteCase{"ColorIntoPoint3", Fake::kPosition,
                  [](B& b) { return b.SetValue(Fake::kPosition, 0, Color(7, 8, 9)); }, true},
        WriteCase{"InfinityIntoPoint3", Fake::kPosition,
                  [](B& b) { return b.SetValue(Fake::kPosition, 0, Point3(1.0f, HUGE_VALF, 0.0f)); }, false},
        WriteCase{"AColorIntoPoint3", Fake::kPosition,
                  [](B& b) { return b.SetValue(Fake::kPosition, 0, AColor(1, 1, 1)); }, false},
        WriteCase{"AColorIntoFrgba", Fake::kTint,
                  [](B& b) { return b.SetValue(Fake::kTint, 0, AColor(1, 0, 0, 0.5f)); }, true},
        WriteCase{"Point3IntoFrgba", Fake::kTint,
                  [](B& b) { return b.SetValue(Fake::kTint, 0, Point3(1.0f, 0.0f, 0.0f)); }, false},
        WriteCase{"TextIntoFilename", Fake::kFile, [](B& b) { return b.SetValue(Fake::kFile, 0, "/a.cxf"); },
                  true},
        WriteCase{"TextIntoInt", Fake::kCount, [](B& b) { return b.SetValue(Fake::kCount, 0, "3"); }, false},
        WriteCase{"AssetIntoFilename", Fake::kFile, [](B& b) { return b.SetValue(Fake::kFile, 0, kAsset); },
                  true},
        WriteCase{"AssetIntoString", Fake::kLabel, [](B& b) { return b.SetValue(Fake::kLabel, 0, kAsset); },
                  false},
        WriteCase{"UnknownId", 99, [](B& b) { return b.SetValue(99, 0, 1); }, false},
        WriteCase{"SecondOfOne", Fake::kCount, [](B& b) { return b.SetValue(Fake::kCount, 0, 9, 1); }, false},
        WriteCase{"TableEntry", Fake::kCurve, [](B& b) { return b.SetValue(Fake::kCurve, 0, 0.75f, 1); },
                  true},
        WriteCase{"PastTheTable", Fake::kCurve, [](B& b) { return b.SetValue(Fake::kCurve, 0, 0.75f, 2); },
                  false},
        WriteCase{"BeforeTheTable", Fake::kCurve, [](B& b) { return b.SetValue(Fake::kCurve, 0, 0.75f, -1); },
                  false},
        WriteCase{"GrowTable", Fake::kTags, [](B& b) { return b.SetCount(Fake::kTags, 2) == 2; }, true},
        WriteCase{"NegativeCount", Fake::kCurve, [](B& b) { return b.SetCount(Fake::kCurve, -1) == -1; },
                  false},
        WriteCase{"HugeCount", Fake::kCurve,
                  [](B& b) { return b.SetCount(Fake::kCurve, 1 << 20) == 1 << 20; }, false},
        WriteCase{"CountOfOne", Fake::kCount, [](B& b) { return b.SetCount(Fake::kCount, 3) == 3; }, false}),
    [](const testing::TestParamInfo<WriteCase>& info) { return info.param.name; });

TEST_F(Block, ReadsOfAnotherTypeFailAndLeaveTheVariable) {
    Interval valid;
    int number = 42;
    EXPECT_FALSE(block_->GetValue(Fake::kWeight, 0, number, valid));
    EXPECT_FALSE(block_->GetValue(99, 0, number, valid));
    EXPECT_EQ(number, 42);
    // The convenience reads give zero or empty instead.
    EXPECT_STREQ(block_->GetStr(Fake::kCount), "");
    EXPECT_EQ(block_->GetPoint3(Fake::kTint), Point3());
    EXPECT_EQ(block_->Count(Fake::kCount), 0);
}

TEST_F(Block, FileNamesCarryOneAssetEachAndTextMaySetItself) {
    ASSERT_TRUE(block_->SetValue(Fake::kFile, 0, "/books/one.cxf"));
    const AssetUser one = block_->GetAssetUser(Fake::kFile);
    EXPECT_NE(one.GetId(), kInvalidId);
    EXPECT_EQ(one.GetType(), MaxSDK::AssetManagement::kBitmapAsset);
    block_->SetValue(Fake::kFile, 0, "/books/two.cxf");
    EXPECT_NE(block_->GetAssetUser(Fake::kFile).GetId(), one.GetId());
    block_->SetValue(Fake::kFile, 0, "/books/one.cxf");
    EXPECT_EQ(block_->GetAssetUser(Fake::kFile).GetId(), one.GetId());
    block_->SetValue(Fake::kFile, 0, "");
    EXPECT_EQ(block_->GetAssetUser(Fake::kFile).GetId(), kInvalidId);

    block_->SetValue(Fake::kLabel, 0, "a label longer than any short-string buffer holds");
    block_->SetValue(Fake::kLabel, 0, block_->GetStr(Fake::kLabel));
    EXPECT_STREQ(block_->GetStr(Fake::kLabel), "a label longer than any short-string buffer holds");
}

TEST_F(Block, TablesGrowWithDefaultsAndResetsBringThemBack) {
    block_->SetCount(Fake::kCurve, 4);
    block_->SetValue(Fake::kCurve, 0, 0.75f, 0);
    block_->SetValue(Fake::kCurve, 0, 0.75f, 1);
    EXPECT_EQ(block_->GetFloat(Fake::kCurve, 0, 3), 0.25f);
    block_->Reset(Fake::kCurve, 1);
    EXPECT_EQ(block_->GetFloat(Fake::kCurve, 0, 0), 0.75f);
    EXPECT_EQ(block_->GetFloat(Fake::kCurve, 0, 1), 0.25f);
    block_->Reset(Fake::kCurve);
    block_->SetValue(Fake::kLabel, 0, "red");
    block_->Reset(Fake::kLabel);
    EXPECT_EQ(Fake::Describe(*block_), kDefaults);
    const std::vector<ParamID> changes = map_->changes;
    block_->Reset(99);
    block_->Reset(Fake::kCurve, 7);
    EXPECT_EQ(map_->changes, changes);

    // All at once: one message, saying every parameter changed.
    block_->SetCount(Fake::kTags, 3);
    map_->changes.clear();
    Fake::Class().Reset(map_);
    EXPECT_EQ(map_->changes, std::vector<ParamID>{-1});
    EXPECT_EQ(block_->LastNotifyParamID(), -1);
    EXPECT_EQ(Fake::Describe(*block_), kDefaults);
}

TEST_F(Block, CloneHasTheValuesAndGoesItsOwnWay) {
    block_->SetValue(Fake::kCount, 0, 3);
    map_->SetName("Original");
    RemapDir* remap = NewRemapDir();
    auto* clone = static_cast<Fake::Map*>(map_->Clone(*remap));
    remap->DeleteThis();
    IParamBlock2* copy = clone->GetParamBlock(0);
    ASSERT_NE(copy, block_);
    EXPECT_EQ(Fake::Describe(*copy), Fake::Describe(*block_));
    EXPECT_EQ(copy->GetOwner(), clone);
    EXPECT_STREQ(clone->GetName(), "Original");
    map_->changes.clear();
    copy->SetValue(Fake::kCount, 0, 8);
    EXPECT_EQ(block_->GetInt(Fake::kCount), 3);
    EXPECT_EQ(clone->changes, std::vector<ParamID>{Fake::kCount});
    EXPECT_TRUE(map_->changes.empty());
    clone->DeleteThis();
}

}  // namespace
