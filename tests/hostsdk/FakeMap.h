#pragma once

// A texture map class of the tests' own, with a block of every parameter type the host keeps, so
// the host side runs without the Color Map plug-in.
#include <max.h>

#include <string>
#include <vector>

namespace Fake {

inline constexpr Class_ID kClassID(0x0F0F1234, 0xA0A05678);

// The block's parameters; ids are not in the order of the description.
enum ParameterId : ParamID {
    kFile = 0,
    kCount = 1,
    kLabel = 2,
    kPosition = 3,
    kWeight = 4,
    kTint = 5,
    kCurve = 6,
    kTags = 7,
    kShade = 12,
    kEnabled = 9,
};

// The map shades with its "tint" and keeps note of what the host did to it.
class Map final : public Texmap {
public:
    Map(ClassDesc2* cd, bool loading);
    ~Map() override;

    Class_ID ClassID() override { return kClassID; }
    void GetClassName(MSTR& name) override { name = "Fake Map"; }
    int NumRefs() override { return 1; }
    RefTargetHandle GetReference(int i) override { return i == 0 ? block_ : nullptr; }
    int NumParamBlocks() override { return 1; }
    IParamBlock2* GetParamBlock(int i) override { return i == 0 ? block_ : nullptr; }
    IParamBlock2* GetParamBlockByID(BlockID id) override;

    AColor EvalColor(ShadeContext& sc) override;
    Point3 EvalNormalPerturb(ShadeContext&) override { return Point3(0.0f, 0.0f, 1.0f); }
    RefTargetHandle Clone(RemapDir& remap) override;
    // The rollout, with a procedure that writes what it is told in DialogLog().
    ParamDlg* CreateParamDlg(HWND hwMtlEdit, IMtlParams* imp) override;
    // Also registers a post-load callback whose priority is the map's G-buffer id.
    IOResult Load(ILoad* iload) override;

    const bool loading;
    std::vector<ParamID> changes;  // LastNotifyParamID of each change message from the block
    int shadings = 0;              // EvalColor calls with maps on

protected:
    void SetReference(int i, RefTargetHandle target) override;

private:
    RefResult NotifyRefChanged(Interval, RefTargetHandle target, PartID&, RefMessage message) override;

    ClassDesc2* cd_;
    IParamBlock2* block_ = nullptr;
};

// The descriptor, with its parameter block description. Its instance handle is Module().
ClassDesc2& Class();
HINSTANCE Module();

// What the user dialog procedures of fake rollouts were told, in order: "init", "destroy",
// "command ID", "thing" for another map, and "deleted" when the host deleted one.
std::vector<std::string>& DialogLog();

// Fake maps alive in this module.
int& LiveMaps();

// Every value of a block as text, through the block's interface, so two blocks compare as a whole.
std::string Describe(IParamBlock2& block);

// What the post-load callbacks saw when they ran, in order: "name count=N changes=M".
std::vector<std::string>& PostLoadLog();

}  // namespace Fake
