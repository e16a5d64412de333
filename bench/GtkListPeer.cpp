// Opens a window with a plain list of GTK's, and prints the seconds until it is shown. A first, empty one is
// not measured: what a toolkit does once in a process is not what a list costs.
#include <gtk/gtk.h>

#include <string>
#include <vector>

#include "bench/PeerWindow.h"

namespace
{
GtkListStore* rowsOf(const std::vector<std::string>& lines)
{
    GtkListStore* rows = gtk_list_store_new(1, G_TYPE_STRING);
    for (const std::string& line : lines)
        gtk_list_store_insert_with_values(rows, nullptr, -1, 0, line.c_str(), -1);
    return rows;
}

GtkWidget* viewOf(GtkListStore* rows)
{
    GtkWidget* view = gtk_tree_view_new_with_model(GTK_TREE_MODEL(rows));
    GtkTreeViewColumn* column =
        gtk_tree_view_column_new_with_attributes("Path", gtk_cell_renderer_text_new(), "text", 0, nullptr);
    gtk_tree_view_column_set_sizing(column, GTK_TREE_VIEW_COLUMN_FIXED);
    gtk_tree_view_append_column(GTK_TREE_VIEW(view), column);
    gtk_tree_view_set_fixed_height_mode(GTK_TREE_VIEW(view), TRUE);
    return view;
}

gboolean notePainted(GtkWidget*, cairo_t*, gpointer painted)
{
    *static_cast<bool*>(painted) = true;
    return FALSE;
}

bool show(const std::vector<std::string>& lines)
{
    bool painted = false;
    GtkListStore* rows = rowsOf(lines);
    GtkWidget* window = gtk_window_new(GTK_WINDOW_TOPLEVEL);
    gtk_window_set_default_size(GTK_WINDOW(window), bench::kPeerWidth, bench::kPeerHeight);
    GtkWidget* scrolled = gtk_scrolled_window_new(nullptr, nullptr);
    GtkWidget* view = viewOf(rows);
    gtk_container_add(GTK_CONTAINER(scrolled), view);
    gtk_container_add(GTK_CONTAINER(window), scrolled);
    g_signal_connect_after(view, "draw", G_CALLBACK(notePainted), &painted);
    gtk_widget_show_all(window);
    while (!painted || gtk_events_pending())
        gtk_main_iteration();
    gdk_display_sync(gdk_display_get_default());
    const int shown = gtk_tree_model_iter_n_children(GTK_TREE_MODEL(rows), nullptr);
    gtk_widget_destroy(window);
    g_object_unref(rows);
    return shown == static_cast<int>(lines.size());
}
} // namespace

int main(int argc, char** argv)
{
    return gtk_init_check(&argc, &argv) ? bench::runPeer(argc, argv, show) : EXIT_FAILURE;
}
