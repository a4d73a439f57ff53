#pragma once

#include <cstddef>
#include <nlohmann/json.hpp>
#include <string>
#include <string_view>

// What the commands print: text from files and arguments made safe for a terminal, and results
// checked before they are printed.

// The text with control characters written as C escapes (\n, \t, \x1b, \u009b), so a name from a
// book or a file name cannot forge lines or send terminal commands. Bytes that are not UTF-8 show as
// \xHH; printable UTF-8 passes unchanged.
std::string Printable(std::string_view text);

// Throws std::runtime_error naming the values when one of them is not a finite number.
void RequireFinite(const double* values, std::size_t count);

// One line of JSON; text that is not UTF-8 shows as U+FFFD and control characters as escapes.
std::string JsonText(const nlohmann::ordered_json& value);

// Writes text to standard output; throws when it cannot be written.
void WriteOut(std::string_view text);
