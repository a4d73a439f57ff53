#include "ValueLines.h"

#include <cstdio>
#include <iostream>
#include <stdexcept>

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
    try {
        work();
        if (std::fflush(stdout) != 0) throw std::runtime_error("cannot write the output");
        return 0;
    } catch (const std::exception& e) {
        std::fflush(stdout);
        std::fprintf(stderr, "pigmo %s: %s\n", command.c_str(), e.what());
        return 1;
    }
}

void ForEachValueLine(const std::vector<std::string>& values,
                      const std::function<void(const std::vector<std::string>&)>& handle) {
    if (!values.empty()) {
        handle(values);
        return;
    }
    std::string line;
    for (int number = 1; std::getline(std::cin, line); ++number) {
        const std::vector<std::string> lineValues = SplitLine(line);
        if (lineValues.empty()) continue;
        try {
            handle(lineValues);
        } catch (const std::exception& e) {
            throw std::runtime_error("line " + std::to_string(number) + ": " + e.what());
        }
    }
}
