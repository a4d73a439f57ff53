#pragma once

#include <optional>
#include <string>

#include "FileDialog.h"

// GLib defines TRUE and FALSE as macros; the host's headers, which declare them, come first.
#include <gtk/gtk.h>

// The editor's GTK dialogs. The file choosers are modal and return only when closed, so the host's
// file dialog stays a plain call.

std::optional<std::string> ChooseFileToOpen(GtkWindow* parent, const Pigmo::Host::FileDialogRequest& request);
std::optional<std::string> ChooseFileToSave(GtkWindow* parent, const std::string& title,
                                            const std::string& suggestedName);
// Shown beside the window; the call does not wait for it.
void ShowMessage(GtkWindow* parent, const std::string& caption, const std::string& text);

// Text from files and books as GTK takes it: bytes that are not UTF-8 replaced.
std::string DisplayText(const std::string& text);
