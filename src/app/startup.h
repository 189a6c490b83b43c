#pragma once
// Start-up rules of the main window that need no widgets: the file named on
// the command line, the window title, the window placement kept in the
// settings store, and when to ask about the default file.

#include <QRect>
#include <QString>
#include <QStringList>

#include <optional>

namespace qm {

class settingsstore;

// The family file named on the command line (the arguments after the program
// name), or nothing. The arguments are joined and trimmed; a text of two
// characters or fewer names no file; surrounding quotes are removed. A
// relative path is made whole from the current folder.
std::optional<QString> commandlinefile(const QStringList& arguments);

// "Quillmark v1.0", with ".revision" when the revision is not 0.
QString versiontitle();
// The version title + " - " + the file name of the family file.
QString windowtitle(const QString& gedcomfile);

// The window's last placement, in twips (1440 per logical inch).
struct placement {
    std::optional<int> top, left, width, height; // restored in this order, up to the first missing
    bool maximised = false;
    bool centre = false;   // all four present but "Main Maximised" missing or empty
    double divider = 1;    // source text height over source note height
    bool complete() const { return top && left && width && height; }
};

placement readplacement(const settingsstore& store);
void writeplacement(settingsstore& store, bool maximised, int top, int left, int width, int height, double divider);

// Where the main window goes on a screen whose free area is `avail`: its own
// size (the classic 12000 x 8950 twips, grown to `hint` and to a comfortable
// 1280 x 760, within the screen), then as much of the placement kept as there
// is, kept within the screen and no smaller than `minimum`, so that a window
// last shown on a screen that is no longer there can still be reached.
// `at` is where the window stands before; `move` says whether it is moved.
struct windowplace {
    QPoint at;
    QSize size;
    bool move = false;
};
windowplace placewindow(const placement& p, QPoint at, QSize hint, QSize minimum, const QRect& avail, double dpi);

int twipstopixels(int twips, double dpi);
int pixelstotwips(int pixels, double dpi);

// Whether to ask "Do you want to open this file by default ...": always when
// no default file is set; when a file is opened from the menu also when the
// setting "File Open Default" is on.
bool askdefaultfile(const QString& defaultfile, bool fromopen, bool fileopendefault);

// The Open dialog's filter.
QString gedcomfilter();

} // namespace qm
