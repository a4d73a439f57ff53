#pragma once

// Animatables and references: how the host ties objects together, tells them of changes, clones,
// loads and saves them.

#include <vector>

#include "maxtypes.h"

enum RefResult { REF_FAIL, REF_SUCCEED, REF_DONTCARE, REF_STOP, REF_INVALID };
enum IOResult { IO_OK = 0, IO_END = 1, IO_ERROR = 2 };

inline constexpr RefMessage REFMSG_CHANGE = 0x00000050;
inline constexpr RefMessage REFMSG_UV_SYM_CHANGE = 0x0000010B;
inline constexpr PartID PART_ALL = 0xFFFFFFFF;

// The first of the flags the host lends to whoever walks the scene.
inline constexpr DWORD A_WORK1 = 1u << 28;

class Animatable;
class ReferenceMaker;
class ReferenceTarget;
class IParamBlock2;
class BaseInterface;
class ILoad;
class ISave;
namespace MaxSDK::AssetManagement {
class AssetEnumCallback;
}
using RefTargetHandle = ReferenceTarget*;
using RefMakerHandle = ReferenceMaker*;

class HostExport Animatable {
public:
    virtual ~Animatable();
    virtual void DeleteThis() { delete this; }

    virtual Class_ID ClassID() { return Class_ID(); }
    virtual SClass_ID SuperClassID() { return 0; }
    virtual void GetClassName(MSTR& name) { name = ""; }

    virtual int NumSubs() { return 0; }
    virtual Animatable* SubAnim(int) { return nullptr; }
    virtual MSTR SubAnimName(int) { return ""; }
    virtual int NumParamBlocks() { return 0; }
    virtual IParamBlock2* GetParamBlock(int) { return nullptr; }
    virtual IParamBlock2* GetParamBlockByID(BlockID) { return nullptr; }

    // Interfaces by number (the old way) and by id.
    virtual void* GetInterface(ULONG) { return nullptr; }
    virtual BaseInterface* GetInterface(Interface_ID) { return nullptr; }

    void SetAFlag(DWORD mask) { flags_ |= mask; }
    void ClearAFlag(DWORD mask) { flags_ &= ~mask; }
    BOOL TestAFlag(DWORD mask) const { return (flags_ & mask) != 0 ? TRUE : FALSE; }

private:
    DWORD flags_ = 0;
};

// The clone of a reference graph: each target cloned once, however often it is reached.
class HostExport RemapDir {
public:
    virtual ~RemapDir() = default;
    virtual RefTargetHandle CloneRef(RefTargetHandle oldTarget);
    virtual void DeleteThis() { delete this; }

private:
    std::vector<std::pair<RefTargetHandle, RefTargetHandle>> clones_;
};
HostExport RemapDir* NewRemapDir();

class HostExport ReferenceMaker : public Animatable {
public:
    ReferenceMaker() = default;
    // References belong to one maker; a copy would share them.
    ReferenceMaker(const ReferenceMaker&) = delete;
    ReferenceMaker& operator=(const ReferenceMaker&) = delete;
    ~ReferenceMaker() override;

    // Makes target reference number which, dropping the one it replaces.
    RefResult ReplaceReference(int which, RefTargetHandle newTarget, BOOL deleteOld = TRUE);
    RefResult DeleteAllRefsFromMe();

    virtual int NumRefs() { return 0; }
    virtual RefTargetHandle GetReference(int) { return nullptr; }

    virtual IOResult Load(ILoad*) { return IO_OK; }
    virtual IOResult Save(ISave*) { return IO_OK; }

    // Walks the files the object needs; by default those of everything it references.
    virtual void EnumAuxFiles(MaxSDK::AssetManagement::AssetEnumCallback& callback, DWORD flags);

protected:
    // Tells the object which target its reference number i now holds.
    virtual void SetReference(int, RefTargetHandle) {}

private:
    friend class ReferenceTarget;
    virtual RefResult NotifyRefChanged(Interval changeInterval, RefTargetHandle target, PartID& part,
                                       RefMessage message) = 0;

    std::vector<RefTargetHandle> references_;
};

class HostExport ReferenceTarget : public ReferenceMaker {
public:
    ~ReferenceTarget() override;

    // Sends message to every object that references this one.
    RefResult NotifyDependents(Interval changeInterval, PartID part, RefMessage message);
    virtual RefTargetHandle Clone(RemapDir&) { return nullptr; }
    int DependentCount() const { return static_cast<int>(dependents_.size()); }

private:
    friend class ReferenceMaker;
    std::vector<ReferenceMaker*> dependents_;
};

// Runs once the whole scene is loaded.
class HostExport PostLoadCallback {
public:
    virtual ~PostLoadCallback() = default;
    virtual void proc(ILoad* iload) = 0;
    // Lower runs first.
    virtual int Priority() { return 5; }
};

// What an object reads back of its own data while a scene loads: named values in place of chunks.
class HostExport ILoad {
public:
    virtual ~ILoad() = default;
    virtual IOResult ReadString(const MCHAR* key, MSTR& value) = 0;
    virtual IOResult ReadInt(const MCHAR* key, int& value) = 0;
    virtual void RegisterPostLoadCallback(PostLoadCallback* callback) = 0;
};

class HostExport ISave {
public:
    virtual ~ISave() = default;
    virtual IOResult WriteString(const MCHAR* key, const MCHAR* value) = 0;
    virtual IOResult WriteInt(const MCHAR* key, int value) = 0;
};
