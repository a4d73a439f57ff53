#include <cstdarg>
#include <cstdio>
#include <cstdlib>

#include "ifnpub.h"
#include "iparamb2.h"

void FPInterfaceDesc::LoadDescriptor(Interface_ID id, const MCHAR* int_name, StringResID descr, ClassDesc* cd,
                                     ULONG flag, ...) {
    ID = id;
    internal_name = int_name;
    description = descr;
    this->cd = cd;
    flags = flag;
    va_list args;
    va_start(args, flag);
    const int tag = va_arg(args, int);
    va_end(args);
    // The host publishes no functions; reading past something else would misread the caller's list.
    if (tag != p_end) {
        std::fprintf(
            stderr, "FPInterfaceDesc \"%s\": published functions are not supported (tag 0x%X before p_end)\n",
            internal_name.data(), static_cast<unsigned>(tag));
        std::abort();
    }
    if (cd != nullptr) cd->AddInterface(this);
}
