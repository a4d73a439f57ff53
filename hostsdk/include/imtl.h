#pragma once

// Materials and texture maps: shading, viewport textures, parameter dialogs.

#include "iparamb2.h"

struct BITMAPINFO;
class Bitmap;

// What a map is shaded for at one point.
class HostExport ShadeContext {
public:
    virtual ~ShadeContext() = default;
    virtual void SetGBufferID(int id) { gbufId = id; }

    BOOL doMaps = TRUE;  // false when the renderer switched maps off
    int gbufId = 0;
};

// A texture living in the viewport's graphics system.
class HostExport TexHandle {
public:
    virtual ~TexHandle() = default;
    virtual DWORD_PTR GetHandle() = 0;
    virtual void DeleteThis() = 0;
};

// What the viewport offers a map to turn its image into a texture.
class HostExport TexHandleMaker {
public:
    virtual ~TexHandleMaker() = default;
    virtual int Size() = 0;
    // Takes over bminf, which BitmapToDIB made.
    virtual TexHandle* CreateHandle(BITMAPINFO* bminf) = 0;
    // A device-independent bitmap of bm, which the caller owns (and frees with free()).
    virtual BITMAPINFO* BitmapToDIB(Bitmap* bm, int extraFlags, BOOL forceW, BOOL forceH) = 0;
};

// The material editor's side of a parameter dialog.
class HostExport IMtlParams {
public:
    virtual ~IMtlParams() = default;
};

class HostExport ParamDlg {
public:
    virtual ~ParamDlg() = default;
    virtual Class_ID ClassID() = 0;
    virtual void SetThing(ReferenceTarget* m) = 0;
    virtual ReferenceTarget* GetThing() = 0;
    virtual void DeleteThis() = 0;
};

// The dialogs ClassDesc2::CreateParamDlgs built for an object.
class HostExport IAutoMParamDlg : public ParamDlg {
public:
    virtual IParamMap2* GetMap(int i = 0) = 0;
};

inline constexpr ULONG I_SUBMAP = 0x1150;

// The sub-map view of materials and maps.
class HostExport ISubMap {
public:
    virtual ~ISubMap() = default;
    virtual int NumSubTexmaps() { return 0; }
    virtual class Texmap* GetSubTexmap(int) { return nullptr; }
    virtual void SetSubTexmap(int, class Texmap*) {}
    virtual MSTR GetSubTexmapSlotName(int) { return ""; }
};

class HostExport MtlBase : public ReferenceTarget, public ISubMap {
public:
    MtlBase() = default;
    // Copies what MtlBase itself holds (name, G-buffer id), not the references.
    MtlBase& operator=(const MtlBase& other);

    const MSTR& GetName() const { return name_; }
    void SetName(const MSTR& name) { name_ = name; }
    // The name and the class, as the host lists the object.
    virtual MSTR GetFullName();
    int GetGBufID() const { return gbufID; }
    void SetGBufID(int id) { gbufID = id; }

    virtual void Update(TimeValue, Interval&) {}
    virtual void Reset() {}
    virtual Interval Validity(TimeValue) { return FOREVER; }
    virtual ParamDlg* CreateParamDlg(HWND, IMtlParams*) { return nullptr; }

    virtual DWORD_PTR GetActiveTexHandle(TimeValue, TexHandleMaker&) { return 0; }
    virtual void ActivateTexDisplay(BOOL) {}

    // Copies what MtlBase itself holds from one object to its clone.
    void BaseClone(ReferenceTarget* from, ReferenceTarget* to, RemapDir& remap);

    IOResult Load(ILoad* iload) override;
    IOResult Save(ISave* isave) override;

protected:
    int gbufID = 0;

private:
    MSTR name_;
};

class HostExport Texmap : public MtlBase {
public:
    SClass_ID SuperClassID() override { return TEXMAP_CLASS_ID; }
    virtual AColor EvalColor(ShadeContext& sc) = 0;
    virtual float EvalMono(ShadeContext& sc);
    virtual Point3 EvalNormalPerturb(ShadeContext& sc) = 0;
    virtual void GetUVTransform(Matrix3& uvtrans) { uvtrans.IdentityMatrix(); }
    virtual int GetTextureTiling() { return 0; }
    virtual BITMAPINFO* GetVPDisplayDIB(TimeValue, TexHandleMaker&, Interval&, BOOL /*mono*/ = FALSE,
                                        BOOL /*forceW*/ = 0, BOOL /*forceH*/ = 0) {
        return nullptr;
    }
};

// Texture tiling flags.
inline constexpr int U_WRAP = 1 << 0;
inline constexpr int V_WRAP = 1 << 1;
