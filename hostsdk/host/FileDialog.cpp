#include "FileDialog.h"

#include <utility>

namespace Pigmo::Host {

namespace {

FileDialogHandler& Handler() {
    static FileDialogHandler handler;
    return handler;
}

std::vector<std::string> Split(std::string_view text, char separator) {
    std::vector<std::string> parts;
    std::size_t start = 0;
    for (std::size_t end; (end = text.find(separator, start)) != std::string_view::npos; start = end + 1)
        parts.emplace_back(text.substr(start, end - start));
    parts.emplace_back(text.substr(start));
    return parts;
}

}  // namespace

void SetFileDialogHandler(FileDialogHandler handler) {
    Handler() = std::move(handler);
}

std::optional<std::string> ShowFileDialog(const FileDialogRequest& request) {
    // A copy: the handler may install another while it runs.
    const FileDialogHandler handler = Handler();
    if (!handler) return std::nullopt;
    return handler(request);
}

std::vector<FileType> ParseFileTypes(std::string_view filter) {
    std::vector<std::string> fields = Split(filter, '|');
    std::vector<FileType> types;
    for (std::size_t i = 0; i + 1 < fields.size(); i += 2) {
        FileType type{std::move(fields[i]), {}};
        for (std::string& pattern : Split(fields[i + 1], ';'))
            if (!pattern.empty()) type.patterns.push_back(std::move(pattern));
        if (!type.patterns.empty()) types.push_back(std::move(type));
    }
    return types;
}

}  // namespace Pigmo::Host
