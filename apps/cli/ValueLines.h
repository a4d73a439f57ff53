#pragma once

#include <functional>
#include <string>
#include <vector>

// Values of one input line, separated by blanks or commas.
std::vector<std::string> SplitLine(const std::string& line);

// Runs handle on the values given on the command line or, when there are none, on each non-blank
// line of standard input. Any error prints "pigmo COMMAND: ..." (with the line number for standard
// input) as one line on stderr after what was already printed, and gives exit code 1.
int ForEachValueLine(const std::string& command, const std::vector<std::string>& values,
                     const std::function<void(const std::vector<std::string>&)>& handle);
