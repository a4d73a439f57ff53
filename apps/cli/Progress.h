#pragma once

#include <chrono>
#include <condition_variable>
#include <mutex>
#include <string>
#include <thread>

// A progress line on stderr for work that may last more than a moment. It shows only when stderr is a
// terminal and standard output goes elsewhere (on a shared terminal the output itself shows progress).
// A thread of its own draws it, so one long call can show its phase too: it appears after a second,
// with the seconds taken, is redrawn five times a second and is erased when the work ends.
class Progress {
public:
    explicit Progress(std::string command);
    ~Progress();  // erases the line before anything else goes to stderr
    Progress(const Progress&) = delete;
    Progress& operator=(const Progress&) = delete;

    void Set(std::string text);

    // For loops: the text is made at most five times a second.
    template <class MakeText>
    void Update(MakeText&& text) {
        if (!active_) return;
        const auto now = std::chrono::steady_clock::now();
        if (now < nextText_) return;
        nextText_ = now + kRedraw;
        Set(text());
    }

private:
    static constexpr std::chrono::milliseconds kRedraw{200};
    void Draw();

    const std::string command_;
    const bool active_;
    const std::chrono::steady_clock::time_point start_;
    std::chrono::steady_clock::time_point nextText_;
    std::mutex mutex_;
    std::condition_variable stop_;
    bool stopping_ = false;
    std::string text_;
    std::thread drawer_;
};
