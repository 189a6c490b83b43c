#pragma once
// Small parts the dialogs are built from: controls named for the program and
// for screen readers, read-only boxes, captioned rows.

#include <QFont>
#include <QString>

class QGridLayout;
class QHBoxLayout;
class QLabel;
class QLineEdit;
class QPushButton;
class QWidget;

namespace qm {

// Gives a control its program name and its accessible name.
template <class T>
T* named(T* w, const QString& name, const QString& accessible)
{
    w->setObjectName(name);
    w->setAccessibleName(accessible);
    return w;
}

template <class T>
T* named(T* w, const char* name, const QString& accessible)
{
    return named(w, QString::fromLatin1(name), accessible);
}

// A box that shows a value the user may select and copy but not change.
QLineEdit* readonlybox(QWidget* parent, const char* name, const QString& accessible);
// The same, passed over by Tab: a value shown beside the button that sets it.
QLineEdit* shownfield(QWidget* parent, const char* name, const QString& accessible);
// Names a label that shows a value (a name, a number, a count) so that screen
// readers read the value: a label without an accessible name of its own is
// read by its text, and Qt tells them whenever the text changes. The caption
// saying what the value is becomes its accessible description.
QLabel* showsvalue(QLabel* l, const QString& name, const QString& caption);
// A label showing a value as plain text the user can select (showsvalue).
QLabel* valuelabel(QWidget* parent, const QString& name, const QString& caption, const QString& text);
// A button that Enter does not press unless it has the focus.
QPushButton* plainbutton(QWidget* parent, const char* name, const QString& text, const QString& accessible);
// Adds `w` with its caption (buddy of `w`, for the mnemonic) in the next row
// of a two-column grid.
void addcaptioned(QGridLayout* grid, int& row, const QString& caption, QWidget* w);

// OK (the default button) and Cancel at the right of a row; the dialog
// connects them.
struct okcancel {
    QPushButton* ok = nullptr;
    QPushButton* cancel = nullptr;
    QHBoxLayout* row = nullptr;
};
okcancel okcancelrow(QWidget* dialog);

// The fixed-pitch font for columns of text, for every control that shows
// them: one that really is fixed-pitch wherever the program runs (checked, not
// taken from its name), found once.
QFont fixedfont();

} // namespace qm
