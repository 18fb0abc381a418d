// A GTK 3 text view that tells a test what happens in it. Argument: the test's socket.

#include <gdk/gdkx.h>
#include <glib-unix.h>
#include <gtk/gtk.h>

#include <memory>
#include <string>

#include "testing/rig/targets/TargetChannel.h"

namespace {

using plume::target::TargetChannel;

struct Target {
    GtkWidget* window = nullptr;
    GtkWidget* view = nullptr;
    GtkTextBuffer* buffer = nullptr;
    GtkWidget* passwordWindow = nullptr;
    std::unique_ptr<TargetChannel> channel;
    int removedFrom = 0;
    int removed = 0;

    int length() const { return gtk_text_buffer_get_char_count(buffer); }
};

std::string wholeText(GtkTextBuffer* buffer) {
    GtkTextIter start;
    GtkTextIter end;
    gtk_text_buffer_get_bounds(buffer, &start, &end);
    const std::unique_ptr<char, void (*)(void*)> text(gtk_text_buffer_get_text(buffer, &start, &end, TRUE), g_free);
    return text.get();
}

void inserted(GtkTextBuffer*, const GtkTextIter* end, const char* text, int bytes, Target* target) {
    const std::string piece(text, static_cast<std::size_t>(bytes));
    const int position = gtk_text_iter_get_offset(end) - plume::target::countCharacters(piece);
    target->channel->reportText(position, 0, piece, target->length());
}

void aboutToRemove(GtkTextBuffer*, const GtkTextIter* start, const GtkTextIter* end, Target* target) {
    target->removedFrom = gtk_text_iter_get_offset(start);
    target->removed = gtk_text_iter_get_offset(end) - target->removedFrom;
}

void removed(GtkTextBuffer*, const GtkTextIter*, const GtkTextIter*, Target* target) {
    target->channel->reportText(target->removedFrom, target->removed, "", target->length());
}

void pasted(GtkTextBuffer*, GtkClipboard*, Target* target) {
    target->channel->reportPasted(target->length());
}

void showPassword(Target& target, bool shown) {
    if (target.passwordWindow != nullptr) gtk_widget_destroy(target.passwordWindow);
    target.passwordWindow = shown ? gtk_window_new(GTK_WINDOW_TOPLEVEL) : nullptr;
    if (!shown) return;
    GtkWidget* entry = gtk_entry_new();
    gtk_entry_set_visibility(GTK_ENTRY(entry), FALSE);
    gtk_entry_set_input_purpose(GTK_ENTRY(entry), GTK_INPUT_PURPOSE_PASSWORD);
    gtk_entry_set_text(GTK_ENTRY(entry), "secret");
    gtk_container_add(GTK_CONTAINER(target.passwordWindow), entry);
    gtk_widget_show_all(target.passwordWindow);
    gtk_window_present(GTK_WINDOW(target.passwordWindow));
}

gboolean mapped(GtkWidget* window, GdkEvent*, Target* target) {
    target->channel->reportReady(gdk_x11_window_get_xid(gtk_widget_get_window(window)));
    return FALSE;
}

gboolean requested(int, GIOCondition, void* target) {
    if (static_cast<Target*>(target)->channel->answerRequests()) return TRUE;
    gtk_main_quit();
    return FALSE;
}

void connectSignals(Target& target) {
    g_signal_connect_after(target.buffer, "insert-text", G_CALLBACK(inserted), &target);
    g_signal_connect(target.buffer, "delete-range", G_CALLBACK(aboutToRemove), &target);
    g_signal_connect_after(target.buffer, "delete-range", G_CALLBACK(removed), &target);
    g_signal_connect(target.buffer, "paste-done", G_CALLBACK(pasted), &target);
    g_signal_connect(target.window, "map-event", G_CALLBACK(mapped), &target);
    g_signal_connect(target.window, "destroy", G_CALLBACK(gtk_main_quit), nullptr);
    g_unix_fd_add(target.channel->descriptor(), static_cast<GIOCondition>(G_IO_IN | G_IO_HUP), requested, &target);
}

}  // namespace

int main(int argc, char** argv) {
    gtk_init(&argc, &argv);
    if (argc < 2) return 2;
    Target target;
    target.window = gtk_window_new(GTK_WINDOW_TOPLEVEL);
    target.view = gtk_text_view_new();
    target.buffer = gtk_text_view_get_buffer(GTK_TEXT_VIEW(target.view));
    target.channel = std::make_unique<TargetChannel>(
        argv[1], plume::target::Editor{
                     [&] { return wholeText(target.buffer); },
                     [&](const std::string& text) { gtk_text_buffer_set_text(target.buffer, text.c_str(), -1); },
                     [&](bool shown) { showPassword(target, shown); }});
    gtk_text_view_set_wrap_mode(GTK_TEXT_VIEW(target.view), GTK_WRAP_WORD_CHAR);
    GtkWidget* scroller = gtk_scrolled_window_new(nullptr, nullptr);
    gtk_container_add(GTK_CONTAINER(scroller), target.view);
    gtk_container_add(GTK_CONTAINER(target.window), scroller);
    gtk_window_set_title(GTK_WINDOW(target.window), "GTK text");
    gtk_window_set_default_size(GTK_WINDOW(target.window), 480, 320);
    connectSignals(target);
    gtk_widget_show_all(target.window);
    gtk_main();
    return 0;
}
