#include "Dialogs.h"

#include <filesystem>
#include <memory>

namespace {

struct Answer {
    GMainLoop* loop;
    int response = GTK_RESPONSE_CANCEL;
};

void Responded(GtkNativeDialog*, int response, gpointer data) {
    auto* answer = static_cast<Answer*>(data);
    answer->response = response;
    g_main_loop_quit(answer->loop);
}

// Runs a nested main loop until the chooser closes; takes the chooser.
std::optional<std::string> Run(GtkFileChooserNative* chooser) {
    Answer answer{g_main_loop_new(nullptr, FALSE)};
    g_signal_connect(chooser, "response", G_CALLBACK(Responded), &answer);
    gtk_native_dialog_set_modal(GTK_NATIVE_DIALOG(chooser), TRUE);
    gtk_native_dialog_show(GTK_NATIVE_DIALOG(chooser));
    g_main_loop_run(answer.loop);
    g_main_loop_unref(answer.loop);
    std::optional<std::string> chosen;
    if (answer.response == GTK_RESPONSE_ACCEPT) {
        if (GFile* file = gtk_file_chooser_get_file(GTK_FILE_CHOOSER(chooser))) {
            if (char* path = g_file_get_path(file)) {
                chosen = path;
                g_free(path);
            }
            g_object_unref(file);
        }
    }
    g_object_unref(chooser);
    return chosen;
}

// Windows patterns: "*.*" is every file, and a type's extension matches in any case.
void AddPattern(GtkFileFilter* filter, const std::string& pattern) {
    if (pattern == "*.*") {
        gtk_file_filter_add_pattern(filter, "*");
    } else if (pattern.starts_with("*.") && pattern.find_first_of("*?[", 2) == std::string::npos) {
        gtk_file_filter_add_suffix(filter, pattern.c_str() + 2);
    } else {
        gtk_file_filter_add_pattern(filter, pattern.c_str());
    }
}

void StartAt(GtkFileChooser* chooser, const std::string& path) {
    if (path.empty()) return;
    std::error_code error;
    const std::filesystem::path start(path);
    const bool folder = std::filesystem::is_directory(start, error);
    const std::filesystem::path where =
        folder || std::filesystem::exists(start, error) ? start : start.parent_path();
    if (where.empty()) return;
    GFile* file = g_file_new_for_path(where.c_str());
    if (folder || where != start)
        gtk_file_chooser_set_current_folder(chooser, file, nullptr);
    else
        gtk_file_chooser_set_file(chooser, file, nullptr);
    g_object_unref(file);
}

}  // namespace

std::optional<std::string> ChooseFileToOpen(GtkWindow* parent,
                                            const Pigmo::Host::FileDialogRequest& request) {
    const std::string title = request.caption.empty() ? "Open" : DisplayText(request.caption);
    GtkFileChooserNative* chooser =
        gtk_file_chooser_native_new(title.c_str(), parent, GTK_FILE_CHOOSER_ACTION_OPEN, "_Open", "_Cancel");
    for (const Pigmo::Host::FileType& type : request.types) {
        GtkFileFilter* filter = gtk_file_filter_new();
        gtk_file_filter_set_name(filter, DisplayText(type.name).c_str());
        for (const std::string& pattern : type.patterns) AddPattern(filter, pattern);
        gtk_file_chooser_add_filter(GTK_FILE_CHOOSER(chooser), filter);
        g_object_unref(filter);
    }
    StartAt(GTK_FILE_CHOOSER(chooser), request.initialPath);
    return Run(chooser);
}

std::optional<std::string> ChooseFileToSave(GtkWindow* parent, const std::string& title,
                                            const std::string& suggestedName) {
    GtkFileChooserNative* chooser =
        gtk_file_chooser_native_new(title.c_str(), parent, GTK_FILE_CHOOSER_ACTION_SAVE, "_Save", "_Cancel");
    gtk_file_chooser_set_current_name(GTK_FILE_CHOOSER(chooser), suggestedName.c_str());
    return Run(chooser);
}

void ShowMessage(GtkWindow* parent, const std::string& caption, const std::string& text) {
    GtkWidget* dialog = gtk_message_dialog_new(parent, GTK_DIALOG_DESTROY_WITH_PARENT, GTK_MESSAGE_WARNING,
                                               GTK_BUTTONS_OK, "%s", DisplayText(text).c_str());
    gtk_window_set_title(GTK_WINDOW(dialog), DisplayText(caption).c_str());
    g_signal_connect(dialog, "response", G_CALLBACK(gtk_window_destroy), nullptr);
    gtk_window_present(GTK_WINDOW(dialog));
}

std::string DisplayText(const std::string& text) {
    const std::unique_ptr<char, void (*)(void*)> valid(
        g_utf8_make_valid(text.data(), static_cast<gssize>(text.size())), g_free);
    return valid.get();
}
