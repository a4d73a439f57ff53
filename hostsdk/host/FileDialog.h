#pragma once

// The host's file dialog, which parameter maps open for their file buttons. The host application
// shows it (a window system's file chooser, or a script in tests); without one every dialog is
// cancelled.

#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "maxtypes.h"

namespace Pigmo::Host {

// One entry of the dialog's type list: its name and its file patterns ("*.cxf").
struct FileType {
    std::string name;
    std::vector<std::string> patterns;
};

struct FileDialogRequest {
    HWND owner = nullptr;
    std::string caption;
    std::vector<FileType> types;
    std::string initialPath;  // a folder, or a file to start at; empty for none
};

// Answers with the chosen file, or nothing when the person cancels.
using FileDialogHandler = std::function<std::optional<std::string>(const FileDialogRequest&)>;

// Empty to stop.
HostExport void SetFileDialogHandler(FileDialogHandler handler);
HostExport std::optional<std::string> ShowFileDialog(const FileDialogRequest& request);

// A Windows filter, "name|patterns|name|patterns|", patterns separated by ';'. A name without its
// patterns is dropped.
HostExport std::vector<FileType> ParseFileTypes(std::string_view filter);

}  // namespace Pigmo::Host
