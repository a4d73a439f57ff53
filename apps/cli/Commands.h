#pragma once

#include <CLI/CLI.hpp>

// Each subcommand registers itself on the application; its callback sets the exit code.
void AddTranslateCommand(CLI::App& app, int& exitCode);
void AddDeltaECommand(CLI::App& app, int& exitCode);
void AddHarmonyCommand(CLI::App& app, int& exitCode);
void AddNameCommand(CLI::App& app, int& exitCode);
void AddExtractCommand(CLI::App& app, int& exitCode);
void AddBookCommand(CLI::App& app, int& exitCode);
void AddPalettesCommand(CLI::App& app, int& exitCode);
void AddMapCommand(CLI::App& app, int& exitCode);
