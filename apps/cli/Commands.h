#pragma once

#include <CLI/CLI.hpp>

// Each subcommand registers itself on the application; its callback sets the exit code.
void AddTranslateCommand(CLI::App& app, int& exitCode);
