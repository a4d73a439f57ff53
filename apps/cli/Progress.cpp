#include "Progress.h"

#include <unistd.h>

#include <cstdio>

#include "Output.h"

Progress::Progress(std::string command)
    : command_(std::move(command)),
      active_(isatty(STDERR_FILENO) == 1 && isatty(STDOUT_FILENO) != 1),
      start_(std::chrono::steady_clock::now()),
      nextText_(start_) {
    if (active_) drawer_ = std::thread([this] { Draw(); });
}

Progress::~Progress() {
    if (!active_) return;
    {
        const std::lock_guard lock(mutex_);
        stopping_ = true;
    }
    stop_.notify_one();
    drawer_.join();
}

void Progress::Set(std::string text) {
    if (!active_) return;
    const std::lock_guard lock(mutex_);
    text_ = std::move(text);
}

void Progress::Draw() {
    bool shown = false;
    std::unique_lock lock(mutex_);
    stop_.wait_until(lock, start_ + std::chrono::seconds(1), [this] { return stopping_; });
    while (!stopping_) {
        const auto seconds =
            std::chrono::duration_cast<std::chrono::seconds>(std::chrono::steady_clock::now() - start_);
        std::fprintf(stderr, "\r\x1b[Kpigmo %s: %s (%lld s)", command_.c_str(), Printable(text_).c_str(),
                     static_cast<long long>(seconds.count()));
        std::fflush(stderr);
        shown = true;
        stop_.wait_for(lock, kRedraw, [this] { return stopping_; });
    }
    if (shown) std::fputs("\r\x1b[K", stderr);
}
