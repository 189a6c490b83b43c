#pragma once
// Gives a QLineEdit place completion: a key released at the end of the typed
// text offers the best known place with its rest selected; typing the next
// letter of the offer walks through it without changing it.

#include "model/gedcomindex.h"

#include <QObject>

#include <functional>
#include <vector>

class QLineEdit;

namespace qm {

class placecompleter : public QObject {
    Q_OBJECT
public:
    // `places` is asked at every key for the current table (it may be
    // replaced by a reload); it may return null when no file is open. The
    // completer is a child of `box` and lives as long as it.
    using placesource = std::function<const std::vector<placerec>*()>;
    placecompleter(QLineEdit* box, placesource places);

    // Attaches completion from a table that outlives the box.
    static placecompleter* attach(QLineEdit* box, const std::vector<placerec>& places);

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    QLineEdit* box_;
    placesource places_;
    bool suspended_ = false; // the last key was swallowed by typing through an offer
};

} // namespace qm
