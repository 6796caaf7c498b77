// The file named on the program's command line (by the desktop entry or a
// file manager).
#pragma once

#include <QString>

namespace kavu::ui {

class MainWindow;

// Shows the file's folder with the file list of its kind and chooses the file
// as a click in the list does; nothing is computed. A file that the list does
// not show is only put into the file box.
void ChooseFile(MainWindow& window, const QString& file);

}  // namespace kavu::ui
