#include "ValueLines.h"

#include <cstdio>
#include <new>
#include <stdexcept>

#include "Output.h"
#include "Progress.h"

namespace {

// Reads one line of standard input without its newline; false at the end of the input. A line
// longer than kMaxLineBytes throws rather than growing without bound.
bool ReadLine(std::string& line) {
    line.clear();
    int c = 0;
    while ((c = getc_unlocked(stdin)) != EOF && c != '\n') {
        if (line.size() == kMaxLineBytes) {
            throw std::length_error("longer than " + std::to_string(kMaxLineBytes) +
                                    " bytes, the most a line may hold");
        }
        line += static_cast<char>(c);
    }
    if (std::ferror(stdin)) throw std::runtime_error("cannot read standard input");
    return c == '\n' || !line.empty();
}

}  // namespace

std::vector<std::string> SplitLine(const std::string& line) {
    std::vector<std::string> values;
    std::string current;
    for (char c : line + ' ') {
        if (c == ' ' || c == '\t' || c == ',' || c == '\r') {
            if (!current.empty()) values.push_back(current);
            current.clear();
        } else {
            current += c;
        }
    }
    return values;
}

int RunCommand(const std::string& command, const std::function<void()>& work) {
    std::string failure;
    try {
        work();
        if (std::fflush(stdout) == 0) return 0;
        failure = "cannot write the output";
    } catch (const std::bad_alloc&) {
        failure = "out of memory";
    } catch (const std::exception& e) {
        failure = Printable(e.what());
    }
    std::fflush(stdout);
    std::fprintf(stderr, "pigmo %s: %s\n", command.c_str(), failure.c_str());
    return 1;
}

void ForEachValueLine(const std::string& command, const std::vector<std::string>& values,
                      const std::function<void(const std::vector<std::string>&)>& handle) {
    if (!values.empty()) {
        handle(values);
        return;
    }
    Progress progress(command);
    std::string line;
    for (int number = 1;; ++number) {
        progress.Update([number] { return "line " + std::to_string(number); });
        try {
            if (!ReadLine(line)) break;
            if (number == 1 && line.starts_with("\xEF\xBB\xBF")) line.erase(0, 3);
            const std::vector<std::string> lineValues = SplitLine(line);
            if (!lineValues.empty()) handle(lineValues);
        } catch (const std::bad_alloc&) {
            throw;
        } catch (const std::exception& e) {
            throw std::runtime_error("line " + std::to_string(number) + ": " + e.what());
        }
    }
}
