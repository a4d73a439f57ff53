#include "EditorWindow.h"

#include <cmath>
#include <filesystem>
#include <stdexcept>
#include <utility>

#include "Desktop.h"
#include "Dialogs.h"
#include "MessageBox.h"

EditorWindow::EditorWindow(Pigmo::Host::Scene& scene, std::string path)
    : scene_(scene),
      path_(std::move(path)),
      unsaved_(path_.empty()),
      window_(GTK_WINDOW(gtk_window_new())),
      area_(gtk_drawing_area_new()),
      status_(gtk_label_new("")),
      loop_(g_main_loop_new(nullptr, FALSE)) {
    editor_.Open(*scene_.Maps().front());

    gtk_drawing_area_set_content_width(GTK_DRAWING_AREA(area_), editor_.Width());
    gtk_drawing_area_set_content_height(GTK_DRAWING_AREA(area_), editor_.Height());
    gtk_drawing_area_set_draw_func(GTK_DRAWING_AREA(area_), Draw, this, nullptr);
    GtkGesture* drag = gtk_gesture_drag_new();
    gtk_gesture_single_set_button(GTK_GESTURE_SINGLE(drag), GDK_BUTTON_PRIMARY);
    g_signal_connect(drag, "drag-begin", G_CALLBACK(Pressed), this);
    g_signal_connect(drag, "drag-update", G_CALLBACK(Dragged), this);
    g_signal_connect(drag, "drag-end", G_CALLBACK(Released), this);
    gtk_widget_add_controller(area_, GTK_EVENT_CONTROLLER(drag));
    gtk_widget_set_has_tooltip(area_, TRUE);
    g_signal_connect(area_, "query-tooltip", G_CALLBACK(QueryToolTip), this);

    gtk_label_set_xalign(GTK_LABEL(status_), 0.0f);
    gtk_label_set_ellipsize(GTK_LABEL(status_), PANGO_ELLIPSIZE_MIDDLE);
    gtk_widget_set_margin_start(status_, 6);
    gtk_widget_set_margin_end(status_, 6);
    gtk_widget_set_margin_top(status_, 3);
    gtk_widget_set_margin_bottom(status_, 3);
    GtkWidget* box = gtk_box_new(GTK_ORIENTATION_VERTICAL, 0);
    gtk_box_append(GTK_BOX(box), area_);
    gtk_box_append(GTK_BOX(box), status_);
    gtk_window_set_child(window_, box);
    gtk_window_set_resizable(window_, FALSE);

    GtkEventController* shortcuts = gtk_shortcut_controller_new();
    gtk_shortcut_controller_set_scope(GTK_SHORTCUT_CONTROLLER(shortcuts), GTK_SHORTCUT_SCOPE_GLOBAL);
    gtk_shortcut_controller_add_shortcut(
        GTK_SHORTCUT_CONTROLLER(shortcuts),
        gtk_shortcut_new(gtk_shortcut_trigger_parse_string("<Control>s"),
                         gtk_callback_action_new(SaveShortcut, this, nullptr)));
    gtk_widget_add_controller(GTK_WIDGET(window_), shortcuts);
    g_signal_connect(window_, "close-request", G_CALLBACK(CloseRequested), this);

    editor_.SetChangeHandler([this] {
        if (unsaved_) return;
        unsaved_ = true;
        ShowTitle();
    });
    Pigmo::Platform::SetInvalidationHandler([this](HWND) { gtk_widget_queue_draw(area_); });
    Pigmo::Host::SetFileDialogHandler(
        [this](const Pigmo::Host::FileDialogRequest& request) { return ChooseFileToOpen(window_, request); });
    ShowTitle();
    ShowStatus(path_.empty() ? "A new scene; Ctrl+S saves it" : "Opened " + path_ + "; Ctrl+S saves it");
}

EditorWindow::~EditorWindow() {
    Pigmo::Platform::SetMessageBoxHandler({});
    Pigmo::Host::SetFileDialogHandler({});
    Pigmo::Platform::SetInvalidationHandler({});
    editor_.Close();
    gtk_window_destroy(window_);
    g_main_loop_unref(loop_);
}

void EditorWindow::Run() {
    gtk_window_present(window_);
    // What the plug-in said while the scene loaded, then whatever it says from now on.
    const auto show = [this](const Pigmo::Platform::ShownMessageBox& box) {
        ShowMessage(window_, box.caption, box.text);
    };
    for (const Pigmo::Platform::ShownMessageBox& box : Pigmo::Platform::TakeMessageBoxes()) show(box);
    Pigmo::Platform::SetMessageBoxHandler([show](const Pigmo::Platform::ShownMessageBox& box) {
        Pigmo::Platform::TakeMessageBoxes();
        show(box);
    });
    g_main_loop_run(loop_);
}

void EditorWindow::Draw(GtkDrawingArea*, cairo_t* cr, int, int, gpointer self) {
    cairo_surface_t* surface = static_cast<EditorWindow*>(self)->editor_.Paint();
    cairo_set_source_surface(cr, surface, 0, 0);
    // A display that scales keeps the panel's pixels sharp.
    cairo_pattern_set_filter(cairo_get_source(cr), CAIRO_FILTER_NEAREST);
    cairo_paint(cr);
}

void EditorWindow::Mouse(GtkGestureDrag* gesture, UINT message, double dx, double dy) {
    double x = 0, y = 0;
    gtk_gesture_drag_get_start_point(gesture, &x, &y);
    editor_.Mouse(message, static_cast<int>(std::floor(x + dx)), static_cast<int>(std::floor(y + dy)));
}

void EditorWindow::Pressed(GtkGestureDrag* gesture, double, double, gpointer self) {
    static_cast<EditorWindow*>(self)->Mouse(gesture, WM_LBUTTONDOWN, 0, 0);
}

void EditorWindow::Dragged(GtkGestureDrag* gesture, double dx, double dy, gpointer self) {
    static_cast<EditorWindow*>(self)->Mouse(gesture, WM_MOUSEMOVE, dx, dy);
}

void EditorWindow::Released(GtkGestureDrag* gesture, double dx, double dy, gpointer self) {
    static_cast<EditorWindow*>(self)->Mouse(gesture, WM_LBUTTONUP, dx, dy);
}

gboolean EditorWindow::QueryToolTip(GtkWidget*, int x, int y, gboolean, GtkTooltip* tooltip, gpointer self) {
    const std::string text = static_cast<EditorWindow*>(self)->editor_.ToolTipAt(x, y);
    if (text.empty()) return FALSE;
    gtk_tooltip_set_text(tooltip, DisplayText(text).c_str());
    return TRUE;
}

gboolean EditorWindow::SaveShortcut(GtkWidget*, GVariant*, gpointer self) {
    static_cast<EditorWindow*>(self)->Save();
    return TRUE;
}

gboolean EditorWindow::CloseRequested(GtkWindow*, gpointer self) {
    g_main_loop_quit(static_cast<EditorWindow*>(self)->loop_);
    return TRUE;
}

void EditorWindow::Save() {
    if (path_.empty()) {
        const std::optional<std::string> chosen = ChooseFileToSave(window_, "Save the Scene", "scene.json");
        if (!chosen) return;
        path_ = *chosen;
    }
    try {
        scene_.Save(path_);
        unsaved_ = false;
        ShowStatus("Saved " + path_);
    } catch (const std::exception& e) {
        ShowStatus(std::string("Not saved: ") + e.what());
    }
    ShowTitle();
}

void EditorWindow::ShowTitle() {
    const std::string name = path_.empty() ? "Untitled" : std::filesystem::path(path_).filename().string();
    gtk_window_set_title(window_, DisplayText((unsaved_ ? "*" : "") + name + " - pigmo-editor").c_str());
}

void EditorWindow::ShowStatus(const std::string& text) {
    gtk_label_set_text(GTK_LABEL(status_), DisplayText(text).c_str());
}
