#include "platform/formparts_ui.h"

#include <QFontDatabase>
#include <QFontInfo>
#include <QFontMetricsF>
#include <QGridLayout>
#include <QGuiApplication>
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

QLabel* showsvalue(QLabel* l, const QString& name, const QString& caption)
{
    l->setObjectName(name);
    l->setAccessibleName(QString());
    l->setAccessibleDescription(caption);
    return l;
}

QLabel* valuelabel(QWidget* parent, const QString& name, const QString& caption, const QString& text)
{
    auto* l = showsvalue(new QLabel(text, parent), name, caption);
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

namespace {
// Whether text in the font the system gives for `f` lines up in columns.
bool fixedpitch(const QFont& f)
{
    const QFontMetricsF m(f);
    return QFontInfo(f).fixedPitch() && m.horizontalAdvance(QLatin1Char('i')) == m.horizontalAdvance(QLatin1Char('M'));
}

QFont choosefixedfont()
{
    const qreal points = QGuiApplication::font().pointSizeF();
    const auto sized = [points](QFont f) {
        if (points > 0)
            f.setPointSizeF(points);
        return f;
    };
    // The family asked for is not always the one given: where "monospace"
    // stands for a proportional font (Debian with the Noto fonts, for one)
    // the system's own fixed font can be proportional too.
    QFont asked = sized(QFont(QStringLiteral("monospace")));
    asked.setStyleHint(QFont::TypeWriter);
    if (fixedpitch(asked))
        return asked;
    const QFont system = QFontDatabase::systemFont(QFontDatabase::FixedFont);
    if (fixedpitch(system))
        return system;
    QStringList families{QStringLiteral("Courier New"),  QStringLiteral("Consolas"),
                         QStringLiteral("DejaVu Sans Mono"), QStringLiteral("Liberation Mono"),
                         QStringLiteral("Noto Sans Mono"), QStringLiteral("Noto Mono"),
                         QStringLiteral("Menlo"),          QStringLiteral("Cousine"),
                         QStringLiteral("FreeMono"),       QStringLiteral("Nimbus Mono PS"),
                         QStringLiteral("Courier")};
    for (const QString& family : QFontDatabase::families())
        if (QFontDatabase::isFixedPitch(family) && !families.contains(family))
            families << family;
    for (const QString& family : families) {
        if (!QFontDatabase::hasFamily(family))
            continue;
        QFont f = sized(QFont(family));
        f.setStyleHint(QFont::TypeWriter);
        if (fixedpitch(f))
            return f;
    }
    return asked; // no fixed-pitch font installed: the nearest the system has
}
} // namespace

QFont fixedfont()
{
    static const QFont chosen = choosefixedfont();
    return chosen;
}

} // namespace qm
