#include <string>

#include "imtl.h"

MtlBase& MtlBase::operator=(const MtlBase& other) {
    name_ = other.name_;
    gbufID = other.gbufID;
    return *this;
}

MSTR MtlBase::GetFullName() {
    MSTR className;
    GetClassName(className);
    return std::string(name_.data()) + " (" + className.data() + ")";
}

void MtlBase::BaseClone(ReferenceTarget* from, ReferenceTarget* to, RemapDir&) {
    auto* source = dynamic_cast<MtlBase*>(from);
    auto* clone = dynamic_cast<MtlBase*>(to);
    if (source != nullptr && clone != nullptr && source != clone) *clone = *source;
}

IOResult MtlBase::Load(ILoad* iload) {
    MSTR name;
    int id = 0;
    if (iload->ReadString("name", name) != IO_OK || iload->ReadInt("gbufID", id) != IO_OK) return IO_ERROR;
    name_ = name;
    gbufID = id;
    return IO_OK;
}

IOResult MtlBase::Save(ISave* isave) {
    if (isave->WriteString("name", name_) != IO_OK || isave->WriteInt("gbufID", gbufID) != IO_OK)
        return IO_ERROR;
    return IO_OK;
}

float Texmap::EvalMono(ShadeContext& sc) {
    const AColor color = EvalColor(sc);
    return (color.r + color.g + color.b) / 3.0f;
}
