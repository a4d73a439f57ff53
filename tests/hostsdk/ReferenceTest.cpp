// References, change messages and cloning between host objects. The sanitizer build checks that
// nothing is freed twice, used after it is gone or left over.
#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <utility>
#include <vector>

#include "FakeMap.h"

namespace {

// A target that counts its clones and names itself when asked for its files.
class Target final : public ReferenceTarget {
public:
    explicit Target(std::string name) : name(std::move(name)) {}
    RefTargetHandle Clone(RemapDir&) override {
        ++clones;
        return new Target(name + " copy");
    }
    void EnumAuxFiles(MaxSDK::AssetManagement::AssetEnumCallback& callback, DWORD) override {
        callback.RecordAsset(
            MaxSDK::AssetManagement::AssetUser({}, MaxSDK::AssetManagement::kOtherAsset, name.c_str()));
    }
    std::string name;
    int clones = 0;

private:
    RefResult NotifyRefChanged(Interval, RefTargetHandle, PartID&, RefMessage) override {
        return REF_SUCCEED;
    }
};

// A maker that remembers what it references and what it was told; it may delete another maker
// when it is told of a change.
class Watcher final : public ReferenceMaker {
public:
    std::vector<RefTargetHandle> held;
    int messages = 0;
    Watcher* deleteOnMessage = nullptr;

protected:
    void SetReference(int i, RefTargetHandle target) override {
        held.resize(std::max(held.size(), static_cast<std::size_t>(i) + 1));
        held[i] = target;
    }

private:
    RefResult NotifyRefChanged(Interval, RefTargetHandle, PartID& part, RefMessage message) override {
        EXPECT_EQ(part, PART_ALL);
        EXPECT_EQ(message, REFMSG_CHANGE);
        part = 0;  // each dependent gets its own copy
        ++messages;
        delete std::exchange(deleteOnMessage, nullptr);
        return REF_SUCCEED;
    }
};

Fake::Map* NewMap() {
    return static_cast<Fake::Map*>(static_cast<Texmap*>(Fake::Class().Create(FALSE)));
}

TEST(References, BlockLivesWhileReferencedAndGoesWithTheLast) {
    Fake::Map* map = NewMap();
    IParamBlock2* block = map->GetParamBlock(0);
    Watcher watcher;
    watcher.ReplaceReference(0, block);
    EXPECT_EQ(block->DependentCount(), 2);
    map->DeleteThis();
    EXPECT_EQ(block->GetOwner(), nullptr);
    EXPECT_EQ(block->GetInt(Fake::kCount), 7);
    // The last reference gone, the block goes too (LeakSanitizer holds the test to that).
    watcher.DeleteAllRefsFromMe();
    EXPECT_EQ(watcher.held[0], nullptr);

    // Unless the one replacing it says to keep it.
    Fake::Map* other = NewMap();
    IParamBlock2* kept = other->GetParamBlock(0);
    other->ReplaceReference(0, nullptr, FALSE);
    EXPECT_EQ(kept->GetInt(Fake::kCount), 7);
    kept->DeleteThis();
    other->DeleteThis();
}

TEST(References, TargetDeletedWhileReferencedLeavesNoDanglingReference) {
    auto* target = new Target("t");
    Watcher watcher;
    watcher.ReplaceReference(0, target);
    watcher.ReplaceReference(2, target);
    delete target;
    EXPECT_EQ(watcher.held, (std::vector<RefTargetHandle>{nullptr, nullptr, nullptr}));
    // The maker's own list forgot it too: replacing does not touch the deleted target.
    Target other("o");
    EXPECT_EQ(watcher.ReplaceReference(0, &other), REF_SUCCEED);
    EXPECT_EQ(watcher.ReplaceReference(-1, &other), REF_FAIL);
    watcher.DeleteAllRefsFromMe();
    EXPECT_EQ(other.DependentCount(), 0);
}

TEST(References, ChangesReachEveryDependentStillThere) {
    Target target("t");
    Watcher first, last;
    auto* middle = new Watcher;
    first.ReplaceReference(0, &target);
    middle->ReplaceReference(0, &target);
    last.ReplaceReference(0, &target);
    first.deleteOnMessage = middle;  // gone before its turn
    EXPECT_EQ(target.NotifyDependents(FOREVER, PART_ALL, REFMSG_CHANGE), REF_SUCCEED);
    EXPECT_EQ(first.messages, 1);
    EXPECT_EQ(last.messages, 1);
    EXPECT_EQ(target.DependentCount(), 2);
    first.DeleteAllRefsFromMe();
    last.DeleteAllRefsFromMe();
}

// A target that references another and answers its changes as told.
class Relay final : public ReferenceTarget {
public:
    explicit Relay(RefResult answer) : answer_(answer) {}

private:
    RefResult NotifyRefChanged(Interval, RefTargetHandle, PartID&, RefMessage) override { return answer_; }
    RefResult answer_;
};

class ChangeTravel : public testing::TestWithParam<std::pair<RefResult, int>> {};

TEST_P(ChangeTravel, OnToWhatReferencesTheMakerUnlessItStopsIt) {
    Target source("s");
    Relay relay(GetParam().first);
    relay.ReplaceReference(0, &source);
    Watcher watcher;
    watcher.ReplaceReference(0, &relay);
    source.NotifyDependents(FOREVER, PART_ALL, REFMSG_CHANGE);
    EXPECT_EQ(watcher.messages, GetParam().second);
    watcher.DeleteAllRefsFromMe();
    relay.DeleteAllRefsFromMe();
}

INSTANTIATE_TEST_SUITE_P(Answers, ChangeTravel,
                         testing::Values(std::pair{REF_SUCCEED, 1}, std::pair{REF_DONTCARE, 1},
                                         std::pair{REF_STOP, 0}));

class Files final : public MaxSDK::AssetManagement::AssetEnumCallback {
public:
    void RecordAsset(const MaxSDK::AssetManagement::AssetUser& asset) override {
        names.emplace_back(asset.GetFileName());
    }
    std::vector<std::string> names;
};

TEST(References, CloneEachTargetOnceAndListTheFilesOfEach) {
    Target a("a"), b("b");
    RemapDir* remap = NewRemapDir();
    RefTargetHandle once = remap->CloneRef(&a);
    EXPECT_EQ(remap->CloneRef(&a), once);
    EXPECT_EQ(remap->CloneRef(nullptr), nullptr);
    EXPECT_EQ(a.clones, 1);
    remap->DeleteThis();
    delete once;

    Watcher watcher;
    watcher.ReplaceReference(0, &a);
    watcher.ReplaceReference(3, &b);
    Files files;
    watcher.EnumAuxFiles(files, 0);
    EXPECT_EQ(files.names, (std::vector<std::string>{"a", "b"}));
    watcher.DeleteAllRefsFromMe();
}

TEST(MtlBase, NamesItselfWithItsClassAndClonesItsOwnData) {
    Fake::Map* map = NewMap();
    Fake::Map* other = NewMap();
    map->SetName("Map #3");
    map->SetGBufID(12);
    EXPECT_STREQ(map->GetFullName(), "Map #3 (Fake Map)");
    RemapDir* remap = NewRemapDir();
    map->BaseClone(map, other, *remap);
    remap->DeleteThis();
    EXPECT_STREQ(other->GetName(), "Map #3");
    EXPECT_EQ(other->GetGBufID(), 12);
    // The references stay where they were.
    EXPECT_EQ(other->GetParamBlock(0)->GetOwner(), other);
    // Mono is the mean of the color unless a map says otherwise.
    ShadeContext sc;
    EXPECT_EQ(map->EvalMono(sc), 0.5f);
    map->DeleteThis();
    other->DeleteThis();
}

class Published final : public FPStaticInterface {};

TEST(ClassDesc, FindsPublishedInterfacesById) {
    // Kept for the process, as the descriptor keeps them.
    static Published first, second;
    first.LoadDescriptor(Interface_ID(1, 2), "first", 0, &Fake::Class(), 0, p_end);
    second.LoadDescriptor(Interface_ID(3, 4), "second", 5, &Fake::Class(), 6, p_end);
    EXPECT_STREQ(second.internal_name, "second");
    EXPECT_EQ(second.description, 5);
    EXPECT_EQ(second.flags, 6u);
    EXPECT_EQ(Fake::Class().GetInterface(Interface_ID(3, 4)), &second);
    EXPECT_EQ(Fake::Class().GetInterface(Interface_ID(1, 2)), &first);
    EXPECT_EQ(Fake::Class().GetInterface(Interface_ID(5, 6)), nullptr);
}

struct IntervalCase {
    Interval a, b, both;
};

class Intervals : public testing::TestWithParam<IntervalCase> {};

TEST_P(Intervals, IntersectBothWays) {
    Interval a = GetParam().a, b = GetParam().b;
    a &= GetParam().b;
    b &= GetParam().a;
    EXPECT_EQ(a, GetParam().both);
    EXPECT_EQ(b, GetParam().both);
}

INSTANTIATE_TEST_SUITE_P(Cases, Intervals,
                         testing::Values(IntervalCase{FOREVER, Interval(0, 10), Interval(0, 10)},
                                         IntervalCase{Interval(0, 10), Interval(5, 20), Interval(5, 10)},
                                         IntervalCase{Interval(0, 4), Interval(5, 9), NEVER},
                                         IntervalCase{Interval(0, 5), Interval(5, 9), Interval(5, 5)},
                                         IntervalCase{NEVER, FOREVER, NEVER}));

}  // namespace
