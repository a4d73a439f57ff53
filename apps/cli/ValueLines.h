#pragma once

#include <cstddef>
#include <functional>
#include <string>
#include <vector>

// Values of one input line, separated by blanks or commas.
std::vector<std::string> SplitLine(const std::string& line);

// Runs the work of "pigmo COMMAND". An exception, or output that cannot be written, prints
// "pigmo COMMAND: ..." as one line on stderr after what was already printed, and gives exit code 1;
// running out of memory says "out of memory".
int RunCommand(const std::string& command, const std::function<void()>& work);

// The longest line standard input may hold; a longer one ends the command with its line number.
inline constexpr std::size_t kMaxLineBytes = std::size_t{1} << 20;

// Runs handle on the values given on the command line or, when there are none, on each non-blank
// line of standard input (a UTF-8 byte-order mark before the first is skipped); an error on a line of
// standard input is rethrown with its line number. A long input shows its progress.
void ForEachValueLine(const std::string& command, const std::vector<std::string>& values,
                      const std::function<void(const std::vector<std::string>&)>& handle);
