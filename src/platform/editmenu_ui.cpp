#include "platform/editmenu_ui.h"

#include <QAction>
#include <QApplication>
#include <QClipboard>
#include <QLineEdit>
#include <QMenu>
#include <QPlainTextEdit>

namespace qm {

namespace {

// Runs `line` or `text` on the focused box of that kind.
template <typename Line, typename Text>
void onfocused(Line line, Text text)
{
    QWidget* w = QApplication::focusWidget();
    if (auto* l = qobject_cast<QLineEdit*>(w))
        line(l);
    else if (auto* t = qobject_cast<QPlainTextEdit*>(w))
        text(t);
}

} // namespace

void addclipboarditems(QMenu* menu)
{
    const auto item = [menu](const char* name, const QString& caption) {
        QAction* a = menu->addAction(caption);
        a->setObjectName(QString::fromLatin1(name));
        return a;
    };
    QAction* copy = item("copymen", QStringLiteral("Copy"));
    QAction* cut = item("cutmen", QStringLiteral("Cut"));
    QAction* paste = item("pastemen", QStringLiteral("Paste"));
    QObject::connect(copy, &QAction::triggered, menu,
                     [] { onfocused([](QLineEdit* l) { l->copy(); }, [](QPlainTextEdit* t) { t->copy(); }); });
    QObject::connect(cut, &QAction::triggered, menu,
                     [] { onfocused([](QLineEdit* l) { l->cut(); }, [](QPlainTextEdit* t) { t->cut(); }); });
    QObject::connect(paste, &QAction::triggered, menu,
                     [] { onfocused([](QLineEdit* l) { l->paste(); }, [](QPlainTextEdit* t) { t->paste(); }); });
    QObject::connect(menu, &QMenu::aboutToShow, menu, [copy, cut, paste] {
        QWidget* w = QApplication::focusWidget();
        auto* line = qobject_cast<QLineEdit*>(w);
        auto* text = qobject_cast<QPlainTextEdit*>(w);
        const bool selected = (line && line->hasSelectedText()) || (text && text->textCursor().hasSelection());
        copy->setEnabled(selected);
        cut->setEnabled(selected && !(line && line->isReadOnly()) && !(text && text->isReadOnly()));
        const bool editable = (line && !line->isReadOnly()) || (text && !text->isReadOnly());
        paste->setEnabled(editable && !QApplication::clipboard()->text().isEmpty());
    });
}

} // namespace qm
