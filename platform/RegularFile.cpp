#include "RegularFile.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cctype>
#include <cerrno>
#include <cstring>

namespace Pigmo::Platform {

namespace {

// Empty for a regular file, else what it is instead.
std::string KindProblem(mode_t mode) {
    if (S_ISREG(mode)) return {};
    if (S_ISDIR(mode)) return "is a directory";
    if (S_ISFIFO(mode)) return "is a FIFO, not a regular file";
    if (S_ISCHR(mode) || S_ISBLK(mode)) return "is a device, not a regular file";
    if (S_ISSOCK(mode)) return "is a socket, not a regular file";
    return "not a regular file";
}

}  // namespace

std::string SystemErrorText(int error) {
    std::string text = std::strerror(error);
    if (!text.empty()) text[0] = static_cast<char>(std::tolower(static_cast<unsigned char>(text[0])));
    return text;
}

int OpenRegularFile(const std::string& path, std::string& problem) {
    struct stat status {};
    if (stat(path.c_str(), &status) != 0) {
        problem = SystemErrorText(errno);
        return -1;
    }
    problem = KindProblem(status.st_mode);
    if (!problem.empty()) return -1;
    // Non-blocking, in case the path is swapped for a FIFO between the two looks.
    const int fd = open(path.c_str(), O_RDONLY | O_NONBLOCK | O_NOCTTY | O_CLOEXEC);
    if (fd < 0) {
        problem = SystemErrorText(errno);
        return -1;
    }
    if (fstat(fd, &status) != 0 || !(problem = KindProblem(status.st_mode)).empty()) {
        if (problem.empty()) problem = SystemErrorText(errno);
        close(fd);
        return -1;
    }
    fcntl(fd, F_SETFL, fcntl(fd, F_GETFL) & ~O_NONBLOCK);
    return fd;
}

}  // namespace Pigmo::Platform
