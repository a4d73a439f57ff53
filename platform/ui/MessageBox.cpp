#include "MessageBox.h"

#include <mutex>
#include <utility>

namespace {

struct MessageBoxRecord {
    std::mutex lock;
    std::vector<Pigmo::Platform::ShownMessageBox> shown;
    std::function<void(const Pigmo::Platform::ShownMessageBox&)> handler;
};

MessageBoxRecord& Record() {
    static MessageBoxRecord record;
    return record;
}

}  // namespace

int MessageBoxA(HWND owner, LPCSTR text, LPCSTR caption, UINT type) {
    const Pigmo::Platform::ShownMessageBox box{owner, caption != nullptr ? caption : "Error",
                                               text != nullptr ? text : "", type};
    std::function<void(const Pigmo::Platform::ShownMessageBox&)> handler;
    {
        MessageBoxRecord& record = Record();
        std::lock_guard guard(record.lock);
        record.shown.push_back(box);
        handler = record.handler;
    }
    if (handler) handler(box);
    return IDOK;
}

namespace Pigmo::Platform {

std::vector<ShownMessageBox> TakeMessageBoxes() {
    MessageBoxRecord& record = Record();
    std::lock_guard guard(record.lock);
    return std::exchange(record.shown, {});
}

void SetMessageBoxHandler(std::function<void(const ShownMessageBox&)> handler) {
    MessageBoxRecord& record = Record();
    std::lock_guard guard(record.lock);
    record.handler = std::move(handler);
}

}  // namespace Pigmo::Platform
