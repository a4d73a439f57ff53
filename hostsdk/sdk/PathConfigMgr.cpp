#include <pwd.h>
#include <unistd.h>

#include <cstdlib>
#include <string>

#include "maxapi.h"

namespace {

std::string HomeFolder() {
    if (const char* home = std::getenv("HOME"); home != nullptr && home[0] != '\0') return home;
    const passwd* user = getpwuid(getuid());
    return user != nullptr && user->pw_dir != nullptr ? user->pw_dir : "";
}

// The host's folders: images (where the file dialogs open) in the user's home folder; the host
// keeps no others here.
class PathConfigMgr final : public IPathConfigMgr {
public:
    const MCHAR* GetDir(int which) const override { return which == APP_IMAGE_DIR ? images_.c_str() : ""; }

private:
    std::string images_ = HomeFolder();
};

}  // namespace

IPathConfigMgr* IPathConfigMgr::GetPathConfigMgr() {
    static PathConfigMgr manager;
    return &manager;
}
