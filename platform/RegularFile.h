#pragma once

#include <string>

namespace Pigmo::Platform {

// Opens a file for reading only when it is a regular file, so that a FIFO, a device or a directory
// given as a book or an image can neither block nor be read without end. Returns the descriptor, or
// -1 with problem saying why in a few lowercase words ("permission denied", "is a directory",
// "is a FIFO, not a regular file", "too many levels of symbolic links").
int OpenRegularFile(const std::string& path, std::string& problem);

// strerror's text in lowercase, as it reads inside a message.
std::string SystemErrorText(int error);

}  // namespace Pigmo::Platform
