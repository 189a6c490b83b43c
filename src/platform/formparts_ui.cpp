#include "platform/formparts_ui.h"

#include <QFontDatabase>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

namespace qm {

QLineEdit* readonlybox(QWidget* parent, const char* name, const QString& accessible)
{
    auto* e = named(new QLineEdit(parent), name, accessible);
    e->setReadOnly(true);
    return e;
}

QLineEdit* shownfield(QWidget* parent, const char* name, const QString& accessible)
{
    auto* e = readonlybox(parent, name, accessible);
    e->setFocusPolicy(Qt::NoFocus);
    return e;
}

QLabel* valuelabel(QWidget* parent, const QString& name, const QString& accessible, const QString& text)
{
    auto* l = named(new QLabel(text, parent), name, accessible);
    l->setTextFormat(Qt::PlainText);
    l->setTextInteractionFlags(Qt::TextSelectableByMouse);
    return l;
}

QPushButton* plainbutton(QWidget* parent, const char* name, const QString& text, const QString& accessible)
{
    auto* b = named(new QPushButton(text, parent), name, accessible);
    b->setAutoDefault(false);
    return b;
}

void addcaptioned(QGridLayout* grid, int& row, const QString& caption, QWidget* w)
{
    auto* l = new QLabel(caption, grid->parentWidget());
    l->setBuddy(w);
    grid->addWidget(l, row, 0, Qt::AlignTop);
    grid->addWidget(w, row, 1);
    ++row;
}

okcancel okcancelrow(QWidget* dialog)
{
    okcancel b;
    b.ok = named(new QPushButton(QStringLiteral("OK"), dialog), "okbut", QStringLiteral("OK"));
    b.ok->setDefault(true);
    b.cancel = plainbutton(dialog, "cancelbut", QStringLiteral("Cancel"), QStringLiteral("Cancel"));
    b.row = new QHBoxLayout;
    b.row->addStretch(1);
    b.row->addWidget(b.ok);
    b.row->addWidget(b.cancel);
    return b;
}

QFont fixedfont()
{
    QFont font = QFontDatabase::systemFont(QFontDatabase::FixedFont);
    if (QFontDatabase::hasFamily(QStringLiteral("Courier New")))
        font.setFamily(QStringLiteral("Courier New"));
    return font;
}

} // namespace qm
