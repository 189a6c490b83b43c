#include "app/filechoice_ui.h"

#include "app/startup.h"
#include "platform/paths.h"
#include "platform/prompts.h"
#include "platform/settingsstore.h"

#include <QAction>
#include <QFileInfo>
#include <QMenu>

namespace qm {

namespace {
const QString defaultfilename = QStringLiteral("Default File");
const QString gedcomfoldername = QStringLiteral("Gedcom Folder");

QString doesnotexist()
{
    return QStringLiteral("The file selected does not exist. Please try again.");
}
} // namespace

filechoice::filechoice(settingsstore& store, prompts& p, QMenu* menu, QObject* parent)
    : QObject(parent), store_(store), prompts_(p)
{
    separator_ = menu->addSeparator();
    for (int i = 0; i < recentfiles::slotcount; ++i) {
        QAction* a = menu->addAction(QString());
        a->setObjectName(QStringLiteral("RecentFilesmen%1").arg(i + 1));
        a->setVisible(false);
        connect(a, &QAction::triggered, this,
                [this, i] { emit recentchosen(recent_.paths[static_cast<size_t>(i)]); });
        items_[static_cast<size_t>(i)] = a;
    }
}

void filechoice::read()
{
    recent_.read(store_);
    showrecent();
    defaultfile_ = store_.read(defaultfilename).value_or(QString()).trimmed();
    folder_ = store_.read(gedcomfoldername).value_or(QString()).trimmed();
}

std::optional<QString> filechoice::askforfile()
{
    return prompts_.openfile(QStringLiteral("Open GEDCOM family history file"), folder_, gedcomfilter());
}

void filechoice::forgetdefault()
{
    defaultfile_.clear();
    store_.write(defaultfilename, QString());
}

std::optional<QString> filechoice::atstart(const QStringList& arguments)
{
    std::optional<QString> named = commandlinefile(arguments);
    for (;;) {
        bool fromdefault = false;
        QString file;
        if (named) {
            file = *named;
            named.reset(); // first attempt only
        } else if (defaultfile_.size() < 3) {
            const std::optional<QString> chosen = askforfile();
            if (!chosen)
                return std::nullopt;
            file = *chosen;
        } else {
            file = defaultfile_;
            fromdefault = true;
        }
        if (QFileInfo(file).isFile())
            return file;
        // A missing file named on the command line leaves the default file alone.
        if (!fromdefault)
            prompts_.tell(doesnotexist());
        if (fromdefault || defaultfile_.isEmpty())
            forgetdefault();
    }
}

std::optional<QString> filechoice::another(const QString& path)
{
    if (path != QLatin1String("-1")) {
        if (QFileInfo(path).isFile())
            return path;
        if (prompts_.yes(QStringLiteral("The recent file selected does not exist or can not be accessed. Do you "
                                        "want to remove it from the recent files list?"),
                         icon::exclamation, answer::no, QStringLiteral("Open Recent File")))
            recent_.remove(path);
        showrecent();
        return std::nullopt;
    }
    for (;;) {
        const std::optional<QString> f = askforfile();
        if (!f || QFileInfo(*f).isFile())
            return f;
        prompts_.tell(doesnotexist());
    }
}

void filechoice::remember(const QString& path, bool fromopen, bool fileopendefault)
{
    if (askdefaultfile(defaultfile_, fromopen, fileopendefault) &&
        prompts_.yes(QStringLiteral("Do you want to open this file by default whenever you use Quillmark?"),
                     icon::question)) {
        defaultfile_ = path;
        store_.write(defaultfilename, path);
    }
    const QString folder = folderof(path);
    if (!folder.isEmpty()) {
        folder_ = folder;
        store_.write(gedcomfoldername, folder);
    }
    recent_.remember(path);
    showrecent();
}

void filechoice::dropdefault(const QString& path)
{
    if (path == defaultfile_)
        forgetdefault();
}

// The list is written back each time it is shown, so that the store always
// holds what the menu shows.
void filechoice::showrecent()
{
    recent_.write(store_);
    bool any = false;
    for (int i = 0; i < recentfiles::slotcount; ++i) {
        QAction* a = items_[static_cast<size_t>(i)];
        const bool used = recent_.inuse(i);
        a->setVisible(used);
        if (used)
            a->setText(recent_.caption(i));
        any = any || used;
    }
    separator_->setVisible(any);
}

} // namespace qm
