#include "census/placecompleter_ui.h"

#include "census/placecompletion.h"

#include <QKeyEvent>
#include <QLineEdit>

namespace qm {

namespace {

placebox boxstate(const QLineEdit* box)
{
    placebox b;
    b.text = box->text();
    if (box->hasSelectedText()) {
        b.selstart = box->selectionStart();
        b.sellength = box->selectionLength();
    } else {
        b.selstart = box->cursorPosition();
    }
    return b;
}

void show(QLineEdit* box, const placebox& b)
{
    if (box->text() != b.text)
        box->setText(b.text);
    // Selecting from the start of the rest leaves the caret at the end of the text.
    if (b.sellength > 0)
        box->setSelection(b.selstart, b.sellength);
    else
        box->setCursorPosition(b.selstart);
}

} // namespace

placecompleter::placecompleter(QLineEdit* box, placesource places)
    : QObject(box), box_(box), places_(std::move(places))
{
    box_->installEventFilter(this);
}

placecompleter* placecompleter::attach(QLineEdit* box, const std::vector<placerec>& places)
{
    const std::vector<placerec>* table = &places;
    return new placecompleter(box, [table] { return table; });
}

bool placecompleter::eventFilter(QObject* watched, QEvent* event)
{
    if (watched != box_)
        return false;
    if (event->type() == QEvent::KeyPress) {
        auto* key = static_cast<QKeyEvent*>(event);
        suspended_ = false;
        if (key->key() == Qt::Key_Backspace || key->key() == Qt::Key_Delete)
            return false;
        if (auto next = typethrough(boxstate(box_), key->text())) {
            show(box_, *next);
            suspended_ = true;
            return true;
        }
        return false;
    }
    if (event->type() == QEvent::KeyRelease) {
        auto* key = static_cast<QKeyEvent*>(event);
        // Backspace and Delete take away an offer: offering it again at once
        // would make it impossible to keep only the typed text.
        if (suspended_ || key->key() == Qt::Key_Backspace || key->key() == Qt::Key_Delete)
            return false;
        const std::vector<placerec>* places = places_();
        if (!places)
            return false;
        if (auto done = completeplace(*places, boxstate(box_)))
            show(box_, *done);
        return false;
    }
    return false;
}

} // namespace qm
