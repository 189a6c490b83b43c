#pragma once
// The open family file as the tool windows get it from the main window, for
// tests of a feature's tools without the window: a settings store written
// with the settings (and flag definitions) given, and the file read.

#include "flags/flagtable.h"
#include "platform/settingsstore.h"
#include "settings/settings.h"
#include "writer/openfile.h"

#include <memory>

namespace qmtest {

struct openrun {
    std::unique_ptr<qm::settingsstore> store;
    std::unique_ptr<qm::openfile> file;
    bool read = false;
};

inline openrun openon(const QString& ini, const QString& family, const qm::settings& s,
                      const qm::flagtable* flags = nullptr)
{
    openrun r;
    r.store = qm::settingsstore::onfile(ini);
    qm::savesettings(*r.store, s);
    qm::saveflagsettings(*r.store, s);
    if (flags)
        qm::saveflagdefs(*r.store, *flags);
    r.file = std::make_unique<qm::openfile>(*r.store);
    r.file->readsettings();
    r.read = r.file->load(family).ok;
    return r;
}

} // namespace qmtest
