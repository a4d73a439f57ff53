#include <climits>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <type_traits>

#include "ParamBlock2.h"

namespace {

// A tagged list the host cannot read is a programming error of the plug-in: reading on would take
// the rest of the list for something it is not.
[[noreturn]] void Refuse(const ParamBlockDesc2& desc, const std::string& problem) {
    std::fprintf(stderr, "ParamBlockDesc2 \"%s\": %s\n", desc.int_name.data(), problem.c_str());
    std::abort();
}

std::string Hex(int value) {
    char text[16];
    std::snprintf(text, sizeof text, "0x%X", static_cast<unsigned>(value));
    return text;
}

// Point3, Color and AColor come through "..." as their floats; va_arg takes only plain types.
struct Floats3 {
    float x, y, z;
};
struct Floats4 {
    float r, g, b, a;
};
static_assert(std::is_trivially_copyable_v<Point3> && sizeof(Point3) == sizeof(Floats3));
static_assert(std::is_trivially_copyable_v<Color> && sizeof(Color) == sizeof(Floats3));
static_assert(std::is_trivially_copyable_v<AColor> && sizeof(AColor) == sizeof(Floats4));

std::string Named(const ParamDef& def) {
    return "parameter " + std::to_string(def.ID) + " (" + def.int_name.data() + ")";
}

}  // namespace

ParamBlockDesc2::ParamBlockDesc2(BlockID id, const MCHAR* int_name, StringResID local_name, ClassDesc2* cd,
                                 int flags, ...)
    : ID(id), int_name(int_name), local_name(local_name), cd(cd), flags(flags) {
    va_list args;
    va_start(args, flags);
    if ((flags & P_AUTO_CONSTRUCT) != 0) ref_no = va_arg(args, int);
    if ((flags & P_AUTO_UI) != 0) {
        dlg_template = va_arg(args, int);
        title = va_arg(args, StringResID);
        va_arg(args, int);  // test flags
        va_arg(args, int);  // rollup flags
        dlgProc_ = va_arg(args, ParamMap2UserDlgProc*);
    }
    for (int paramId = va_arg(args, int); paramId != p_end; paramId = va_arg(args, int)) {
        if (paramId < SHRT_MIN || paramId > SHRT_MAX)
            Refuse(*this, "expected a parameter id or p_end, found " + Hex(paramId));
        ParamDef def;
        def.ID = static_cast<ParamID>(paramId);
        def.int_name = va_arg(args, const MCHAR*);
        def.type = static_cast<ParamType2>(va_arg(args, int));
        Pigmo::Host::ParamKind kind;
        if (!Pigmo::Host::KindOf(def.type, kind))
            Refuse(*this, Named(def) + ": unknown type " + Hex(def.type));
        if ((def.type & TYPE_TAB) != 0) {
            def.tab_size = va_arg(args, int);
            if (def.tab_size < 0 || def.tab_size > Pigmo::Host::kMaxTableCount)
                Refuse(*this, Named(def) + ": table size " + std::to_string(def.tab_size));
        }
        def.flags = va_arg(args, int);
        def.local_name = va_arg(args, StringResID);
        for (int tag = va_arg(args, int); tag != p_end; tag = va_arg(args, int)) {
            switch (tag) {
                case p_default:
                    // Each type is passed as C passes it through "...": floats as double.
                    switch (kind) {
                        case Pigmo::Host::ParamKind::Int:
                            def.def_i = va_arg(args, int);
                            break;
                        case Pigmo::Host::ParamKind::Float:
                            def.def_f = static_cast<float>(va_arg(args, double));
                            break;
                        case Pigmo::Host::ParamKind::Vector: {
                            const Floats3 v = va_arg(args, Floats3);
                            def.def_c = AColor(v.x, v.y, v.z, 0.0f);
                            break;
                        }
                        case Pigmo::Host::ParamKind::Color4: {
                            const Floats4 c = va_arg(args, Floats4);
                            def.def_c = AColor(c.r, c.g, c.b, c.a);
                            break;
                        }
                        case Pigmo::Host::ParamKind::Text:
                        case Pigmo::Host::ParamKind::File:
                            def.def_s = va_arg(args, const MCHAR*);
                            break;
                    }
                    break;
                case p_ui:
                    def.ctrl_type = va_arg(args, int);
                    if (def.ctrl_type != TYPE_FILEOPENBUTTON)
                        Refuse(*this, Named(def) + ": control type " + std::to_string(def.ctrl_type) +
                                          " is not supported");
                    def.ctrl_id = va_arg(args, int);
                    break;
                case p_caption:
                    def.caption = va_arg(args, StringResID);
                    break;
                case p_init_file:
                    def.init_file = va_arg(args, const MCHAR*);
                    break;
                case p_file_types:
                    def.file_types = va_arg(args, StringResID);
                    break;
                case p_assetTypeID:
                    def.asset_type = va_arg(args, int);
                    break;
                default:
                    Refuse(*this, Named(def) + ": unknown tag " + Hex(tag));
            }
        }
        if (IDtoIndex(def.ID) >= 0) Refuse(*this, Named(def) + ": the id is taken");
        params_.push_back(std::move(def));
    }
    va_end(args);
    if (cd != nullptr) cd->AddParamBlockDesc(this);
}

ParamBlockDesc2::~ParamBlockDesc2() = default;

int ParamBlockDesc2::IDtoIndex(ParamID id) const {
    for (std::size_t i = 0; i < params_.size(); ++i)
        if (params_[i].ID == id) return static_cast<int>(i);
    return -1;
}

ParamID ParamBlockDesc2::IndextoID(int index) const {
    return index >= 0 && index < Count() ? params_[static_cast<std::size_t>(index)].ID : ParamID(-1);
}

ParamDef& ParamBlockDesc2::GetParamDef(ParamID id) {
    const int index = IDtoIndex(id);
    if (index >= 0) return params_[static_cast<std::size_t>(index)];
    // An unknown id reads as a blank definition, fresh each time so no write to it lasts.
    static ParamDef unknown;
    unknown = ParamDef();
    return unknown;
}

void ParamBlockDesc2::SetUserDlgProc(ParamMap2UserDlgProc* proc) {
    dlgProc_ = proc;
    if (map_ != nullptr) map_->SetUserDlgProc(proc);
}
