#pragma once
// Helpers for the end-to-end tests of the main window. Header only: the logic
// tests, which link tests/support/*.cpp, do not link the windows library.

#include "app/mainfrm.h"
#include "census/censusrows_ui.h"
#include "census/entrypanel_ui.h"
#include "census/peoplelist_ui.h"
#include "platform/scriptedprompts.h"
#include "platform/settingsstore.h"
#include "settings/settings.h"
#include "support/testfiles.h"

#include <QApplication>
#include <QComboBox>
#include <QDialog>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QLabel>
#include <QLineEdit>
#include <QListView>
#include <QPointer>
#include <QProcess>
#include <QTemporaryDir>
#include <QTest>
#include <QTimer>

#include <deque>
#include <functional>
#include <memory>

namespace qmtest {

// One run of the program: prompts, settings store and window.
struct session {
    qm::scriptedprompts prompts;
    std::unique_ptr<qm::settingsstore> store;
    std::unique_ptr<qm::mainfrm> w;

    // With `complete`, a store without settings gets the defaults of every
    // setting, so that the program starts without the first-start options
    // dialog; without it the store is left as it is. The log and the backups
    // go beside the settings file, never into the user's own folder.
    explicit session(const QString& ini, bool complete = true) : store(qm::settingsstore::onfile(ini))
    {
        if (complete && !store->read(QStringLiteral("No Source Text Warning"))) {
            qm::settings s = qm::defaultsettings();
            const QString folder = QFileInfo(ini).absolutePath();
            s.logpath = folder + QStringLiteral("/censuslog.txt");
            // The census log is never kept among the backups.
            s.backupfolder = folder + QStringLiteral("/backups");
            QDir().mkpath(s.backupfolder);
            qm::savesettings(*store, s);
            qm::saveflagsettings(*store, s);
        }
    }

    void make() { w = std::make_unique<qm::mainfrm>(prompts, *store); }
    QString read(const char* name) const { return store->read(QString::fromLatin1(name)).value_or(QString()); }
};

// Files of one window test program: copies of the sample, settings files and
// generated family files in a temporary folder, and windows started on them.
class windowfiles {
public:
    bool valid() const { return dir_.isValid(); }
    QString path() const { return dir_.path(); }
    QString filepath(const QString& name) const { return dir_.filePath(name); }

    // A writable copy of the bundled sample.
    QString sample()
    {
        const QString to = dir_.filePath(QStringLiteral("sample%1.ged").arg(++runs_));
        QFile::copy(samplefile(), to);
        QFile(to).setPermissions(QFileDevice::ReadOwner | QFileDevice::WriteOwner);
        return to;
    }
    QString ini() { return dir_.filePath(QStringLiteral("settings%1.ini").arg(++runs_)); }

    // A family file of this many individuals from the generator ("" when it
    // did not run), made once.
    QString generated(int individuals)
    {
        const QString out = dir_.filePath(QStringLiteral("gen%1.ged").arg(individuals));
        if (QFile::exists(out))
            return out;
        const int rc = QProcess::execute(QStringLiteral("python3"),
                                         {QStringLiteral(QM_GENERATOR), QStringLiteral("--individuals"),
                                          QString::number(individuals), QStringLiteral("-o"), out});
        return rc == 0 ? out : QString();
    }

    // A window started on `file` from the command line (with settings s, and
    // its Count, when given), the default-file question answered No; shown, so
    // that lists can be clicked.
    std::unique_ptr<session> opened(const QString& file, const qm::settings* s = nullptr)
    {
        auto r = std::make_unique<session>(ini());
        if (s) {
            // Default log and backup paths would be the user's own: kept here instead.
            qm::settings given = *s;
            const qm::settings defaults = qm::defaultsettings();
            if (given.logpath == defaults.logpath)
                given.logpath = filepath(QStringLiteral("censuslog.txt"));
            if (given.backupfolder == defaults.backupfolder) {
                given.backupfolder = filepath(QStringLiteral("backups"));
                QDir().mkpath(given.backupfolder);
            }
            qm::savesettings(*r->store, given);
            qm::saveflagsettings(*r->store, given);
            if (given.count > 0)
                r->store->write(QStringLiteral("Count"), QString::number(given.count));
        }
        r->make();
        r->prompts.expect(qm::answer::no, QStringLiteral("by default"));
        if (!r->w->start({QLatin1Char('"') + file + QLatin1Char('"')}))
            return nullptr;
        r->w->show();
        return QTest::qWaitForWindowExposed(r->w.get()) ? std::move(r) : nullptr;
    }

private:
    QTemporaryDir dir_;
    int runs_ = 0;
};

template <class T>
QList<T*> rowcontrols(qm::mainfrm& w, const char* name)
{
    return w.findChild<qm::censusrowsview*>()->findChildren<T*>(QString::fromLatin1(name));
}

inline QListView* peoplelist(qm::mainfrm& w)
{
    return w.findChild<QListView*>(QStringLiteral("allpeoplelst"));
}

inline QListView* familylist(qm::mainfrm& w)
{
    return w.findChild<QListView*>(QStringLiteral("familylst"));
}

// Row of the list entry of the individual with this record number, or -1.
inline int rowofid(qm::mainfrm& w, QListView* view, int32_t id)
{
    auto* model = static_cast<qm::peoplelistmodel*>(view->model());
    for (int r = 0; r < model->rowCount(); ++r) {
        const int32_t k = model->personat(r);
        if (w.index()->people[static_cast<size_t>(k)].id == id)
            return r;
    }
    return -1;
}

inline void clickrow(QListView* view, int row)
{
    const QModelIndex i = view->model()->index(row, 0);
    view->scrollTo(i);
    QTest::mouseClick(view->viewport(), Qt::LeftButton, {}, view->visualRect(i).center());
}

inline void clickid(qm::mainfrm& w, QListView* view, int32_t id)
{
    const int r = rowofid(w, view, id);
    QVERIFY2(r >= 0, qPrintable(QStringLiteral("no entry for ID %1").arg(id)));
    clickrow(view, r);
}

inline void chooseyear(qm::mainfrm& w, const QString& year)
{
    QComboBox* years = w.panel()->yearcom;
    const int i = years->findText(year);
    QVERIFY(i >= 0);
    years->setCurrentIndex(i);
}

inline QStringList shownnames(qm::mainfrm& w)
{
    QStringList out;
    for (QLabel* l : rowcontrols<QLabel>(w, "namelab"))
        out << l->text();
    while (!out.isEmpty() && out.back().isEmpty())
        out.removeLast();
    return out;
}

// Types into the age, unit and occupation boxes of the census row r.
inline void typerow(qm::mainfrm& w, int r, const QString& age, const QString& unit = QString(),
                    const QString& occupation = QString())
{
    QTest::keyClicks(rowcontrols<QLineEdit>(w, "agetxt")[r], age);
    if (!unit.isEmpty())
        rowcontrols<QLineEdit>(w, "agetypetxt")[r]->setText(unit);
    QTest::keyClicks(rowcontrols<QLineEdit>(w, "occtxt")[r], occupation);
}

// Changes the file's bytes by `edit`, which says whether it found what to change.
inline bool editfile(const QString& path, const std::function<bool(QByteArray&)>& edit)
{
    QFile f(path);
    if (!f.open(QIODevice::ReadOnly))
        return false;
    QByteArray b = f.readAll();
    f.close();
    return edit(b) && f.open(QIODevice::WriteOnly | QIODevice::Truncate) && f.write(b) == b.size();
}

// Types text into a box, tabs and line ends as the Tab and Return keys.
inline void typetext(QWidget* box, const QString& text)
{
    for (const QChar c : text) {
        if (c == u'\t' || c == u'\n')
            QTest::keyClick(box, c == u'\t' ? Qt::Key_Tab : Qt::Key_Return);
        else
            QTest::keyClicks(box, QString(c));
    }
}

inline bool replaceinfile(const QString& path, const QByteArray& from, const QByteArray& to)
{
    return editfile(path, [&](QByteArray& b) { return b.contains(from) && !b.replace(from, to).isEmpty(); });
}

// Chooses each of a household in the people list and types its row.
struct member {
    int32_t id;
    const char* age;
    const char* occupation = "";
};
inline void typehousehold(qm::mainfrm& w, std::initializer_list<member> household)
{
    for (const member& m : household) {
        clickid(w, peoplelist(w), m.id);
        typerow(w, w.household().selectioncount - 1, QString::fromLatin1(m.age), QString(),
                QString::fromLatin1(m.occupation));
    }
}

// Answers the program's own modal dialogs (those not shown through the
// prompts) while it lives: each dialog that opens is handed to the next queued
// action, in order. A dialog with no action queued is rejected and counted as
// unexpected, so that a test never hangs on one.
class dialoganswers {
public:
    using action = std::function<void(QDialog*)>;

    dialoganswers()
    {
        timer_.setInterval(5);
        QObject::connect(&timer_, &QTimer::timeout, [this] { look(); });
        timer_.start();
    }

    void expect(const QString& objectname, action a) { queued_.push_back({objectname, std::move(a)}); }

    int unexpected = 0;
    QStringList seen; // object names of the dialogs met, in order
    int pending() const { return static_cast<int>(queued_.size()); }

private:
    void look()
    {
        auto* d = qobject_cast<QDialog*>(QApplication::activeModalWidget());
        if (!d || d == last_ || !d->isVisible())
            return;
        // Message boxes are the prompts' own business.
        if (d->objectName() == QLatin1String("messagebox"))
            return;
        last_ = d;
        seen << d->objectName();
        if (queued_.empty() || queued_.front().name != d->objectName()) {
            ++unexpected;
            d->reject();
            return;
        }
        action a = std::move(queued_.front().a);
        queued_.pop_front();
        a(d);
    }

    struct entry {
        QString name;
        action a;
    };
    QTimer timer_;
    QPointer<QDialog> last_;
    std::deque<entry> queued_;
};

} // namespace qmtest
