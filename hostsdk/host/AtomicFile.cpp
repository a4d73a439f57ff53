#include "AtomicFile.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <filesystem>
#include <stdexcept>

#include "RegularFile.h"

namespace Pigmo::Host {

namespace {

// Removes the temporary file unless it has been renamed into place.
class TemporaryFile {
public:
    explicit TemporaryFile(std::string path) : path_(std::move(path)) {}
    ~TemporaryFile() {
        if (fd_ >= 0) close(fd_);
        if (!path_.empty()) unlink(path_.c_str());
    }
    TemporaryFile(const TemporaryFile&) = delete;
    TemporaryFile& operator=(const TemporaryFile&) = delete;

    bool Create() {
        fd_ = mkostemp(path_.data(), O_CLOEXEC);
        if (fd_ < 0) path_.clear();
        return fd_ >= 0;
    }
    int Fd() const { return fd_; }
    const std::string& Path() const { return path_; }
    bool Close() {
        const int fd = fd_;
        fd_ = -1;
        return close(fd) == 0;
    }
    void Keep() { path_.clear(); }

private:
    std::string path_;
    int fd_ = -1;
};

// What a new file gets when open() makes it: everything the umask allows.
mode_t NewFileMode() {
    const mode_t mask = umask(0);
    umask(mask);
    return 0666 & ~mask;
}

bool WriteAll(int fd, std::string_view bytes) {
    while (!bytes.empty()) {
        const ssize_t written = write(fd, bytes.data(), bytes.size());
        if (written < 0 && errno == EINTR) continue;
        if (written <= 0) return false;
        bytes.remove_prefix(static_cast<std::size_t>(written));
    }
    return true;
}

}  // namespace

void WriteFileAtomically(const std::string& path, std::string_view bytes) {
    const auto fail = [&](int error) {
        throw std::runtime_error("cannot write " + path + ": " + Platform::SystemErrorText(error));
    };
    const std::filesystem::path target(path);
    if (!target.has_filename()) fail(EISDIR);
    const std::filesystem::path folder = target.has_parent_path() ? target.parent_path() : ".";
    // Hidden, beside the target, so the rename stays within one file system.
    std::string name = ".";
    name += target.filename().string();
    name += ".XXXXXX";
    TemporaryFile temporary((folder / name).string());
    if (!temporary.Create()) fail(errno);

    struct stat existing {};
    const mode_t mode = stat(path.c_str(), &existing) == 0 ? existing.st_mode & 07777 : NewFileMode();
    if (fchmod(temporary.Fd(), mode) != 0 || !WriteAll(temporary.Fd(), bytes) || fsync(temporary.Fd()) != 0)
        fail(errno);
    if (!temporary.Close() || rename(temporary.Path().c_str(), path.c_str()) != 0) fail(errno);
    temporary.Keep();

    // The rename itself lasts once the folder is on the disk too; it has happened already, so a
    // folder that cannot be flushed is no failure of the write.
    const int folderFd = open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    if (folderFd >= 0) {
        fsync(folderFd);
        close(folderFd);
    }
}

}  // namespace Pigmo::Host
