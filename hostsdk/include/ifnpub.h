#pragma once

// Function publishing: interfaces a class or an object offers by id.

#include "maxtypes.h"

class ClassDesc;

class HostExport BaseInterface {
public:
    virtual ~BaseInterface() = default;
    virtual Interface_ID GetID() = 0;
};

class HostExport FPInterface : public BaseInterface {};

// The description of a published interface; a static interface is its own description.
class HostExport FPInterfaceDesc : public FPInterface {
public:
    // Fills in the description and registers it with cd. The tagged rest ends with p_end.
    void LoadDescriptor(Interface_ID id, const MCHAR* int_name, StringResID descr, ClassDesc* cd, ULONG flag,
                        ...);
    Interface_ID GetID() override { return ID; }
    virtual HINSTANCE HInstance() { return nullptr; }

    Interface_ID ID;
    CStr internal_name;
    StringResID description = 0;
    ClassDesc* cd = nullptr;
    ULONG flags = 0;
};

class HostExport FPStaticInterface : public FPInterfaceDesc {};
