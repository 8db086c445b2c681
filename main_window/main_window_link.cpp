#include "main_window/main_window_link.h"

namespace main_window {

MainWindowDialog::MainWindowDialog(ui::Window& window, MainWindowLink& main) : main_(main) {
    window.onLoad = [this] {
        main_.setEnabled(false);
        Form_Load();
    };
    window.onUnload = [this] {
        Form_Unload();
        main_.setEnabled(true);
        main_.bringToFront();
    };
}

}  // namespace main_window
