#pragma once

#include <string>

#include "MaterialEditor.h"
#include "Scene.h"

// GLib defines TRUE and FALSE as macros; the host's headers, which declare them, come first.
#include <gtk/gtk.h>

// The editor's one window: the rollout of the scene's first map, drawn by the host's material editor
// and given the mouse, with the rollout's tooltips, the host's file dialog and message boxes as GTK
// dialogs, Ctrl+S to save the scene and a status line.
class EditorWindow {
public:
    // path: where the scene was read from; empty for a scene not saved yet.
    EditorWindow(Pigmo::Host::Scene& scene, std::string path);
    ~EditorWindow();
    EditorWindow(const EditorWindow&) = delete;
    EditorWindow& operator=(const EditorWindow&) = delete;

    // Shows the window and returns when it is closed.
    void Run();

private:
    static void Draw(GtkDrawingArea* area, cairo_t* cr, int width, int height, gpointer self);
    static void Pressed(GtkGestureDrag* gesture, double x, double y, gpointer self);
    static void Dragged(GtkGestureDrag* gesture, double dx, double dy, gpointer self);
    static void Released(GtkGestureDrag* gesture, double dx, double dy, gpointer self);
    static gboolean QueryToolTip(GtkWidget* widget, int x, int y, gboolean keyboard, GtkTooltip* tooltip,
                                 gpointer self);
    static gboolean SaveShortcut(GtkWidget* widget, GVariant* arguments, gpointer self);
    static gboolean CloseRequested(GtkWindow* window, gpointer self);

    void Mouse(GtkGestureDrag* gesture, UINT message, double dx, double dy);
    void Save();
    void ShowTitle();
    void ShowStatus(const std::string& text);

    Pigmo::Host::Scene& scene_;
    std::string path_;
    bool unsaved_;
    Pigmo::Host::MaterialEditor editor_;
    GtkWindow* window_;
    GtkWidget* area_;
    GtkWidget* status_;
    GMainLoop* loop_;
};
