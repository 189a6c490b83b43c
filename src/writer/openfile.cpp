#include "writer/openfile.h"

#include "flags/flagtable.h"
#include "model/filechanged.h"
#include "model/loadgedcom.h"
#include "platform/prompts.h"

#include <QDir>
#include <QFileInfo>

namespace qm {

openfile::openfile(settingsstore& store, prompts* p) : store_(store), prompts_(p) {}

openfile::~openfile() = default;

settingsload openfile::readsettings()
{
    settingsload loaded = loadsettings(store_);
    settings_ = loaded.values;
    return loaded;
}

readoutcome openfile::load(const QString& path, bool needhead)
{
    const pausewatch paused(*this);
    readoutcome out;
    flagtable defs;
    if (!loadflagdefs(store_, defs)) {
        out.flagerror = flagloaderrormessage();
        if (prompts_)
            prompts_->tell(out.flagerror);
    }
    loadresult r;
    {
        std::optional<busycursor> busy;
        if (prompts_)
            busy.emplace(*prompts_);
        r = loadgedcom(path, defs);
    }
    if (r.index && needhead && !r.index->hashead) {
        r.index.reset();
        r.error = QStringLiteral("%1 is not a GEDCOM family file: it has no \"0 HEAD\" line")
                      .arg(QDir::toNativeSeparators(path));
    }
    out.ms = r.ms;
    if (r.index) {
        out.ok = true;
        path_ = path;
        index_ = std::move(r.index);
    } else {
        out.error = r.error;
        if (prompts_)
            prompts_->tell(out.error, icon::exclamation);
        // The file read before stays open; without one the path is the new
        // file's, over an empty index.
        if (index_ && !index_->gedcomfile.isEmpty())
            path_ = index_->gedcomfile;
        else
            path_ = path;
        if (!index_)
            index_ = std::make_unique<gedcomindex>();
    }
    for (const std::function<void()>& listener : listeners_)
        listener();
    return out;
}

readoutcome openfile::reload()
{
    return load(path_);
}

void openfile::onread(std::function<void()> listener)
{
    listeners_.push_back(std::move(listener));
}

bool openfile::changed() const
{
    return index_ && filechanged(*index_);
}

bool openfile::missing() const
{
    return index_ && !QFileInfo::exists(index_->gedcomfile);
}

openfile::pausewatch::pausewatch(openfile& f) : file_(&f)
{
    ++file_->pauses_;
}

openfile::pausewatch::~pausewatch()
{
    if (file_)
        --file_->pauses_;
}

openfile::pausewatch::pausewatch(pausewatch&& other) noexcept : file_(other.file_)
{
    other.file_ = nullptr;
}

saveoutcome openfile::save(const rewriterequest& request, const backupresult* made)
{
    saveoutcome out = savechange(*index_, settings_, request, made);
    if (out.saved())
        index_->gedcomdate = out.newstamp;
    return out;
}

} // namespace qm
