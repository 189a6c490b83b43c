#pragma once
// The generated family files the benchmarks read (made by
// gen_family_gedcom.py; the folder is QM_BENCH_DIR, else build/gen in the
// repository: see bench/README.md).
#include "flags/flagtable.h"
#include "model/loadgedcom.h"

#include <QFileInfo>
#include <QString>

#include <benchmark/benchmark.h>

#include <cstdlib>
#include <map>
#include <memory>
#include <string>

namespace qmbench {

inline QString benchfile(const char* name)
{
    const char* dir = std::getenv("QM_BENCH_DIR");
    return QString::fromLocal8Bit(dir && *dir ? dir : QM_BENCH_DEFAULT_DIR) + QLatin1Char('/') + QLatin1String(name);
}

// The file loaded once for all the benchmarks of the program that use it,
// with the defined flags `flagdefs`; null when the file is absent.
inline qm::gedcomindex* benchindex(const char* name, const qm::flagtable& flagdefs = {})
{
    static std::map<std::string, std::unique_ptr<qm::gedcomindex>> loaded;
    auto& slot = loaded[name];
    if (!slot) {
        const QString path = benchfile(name);
        if (!QFileInfo(path).isFile())
            return nullptr;
        slot = qm::loadgedcom(path, flagdefs).index;
    }
    return slot.get();
}

// False, after skipping the benchmark with how to make the file, when `found` is.
inline bool benchfilefound(benchmark::State& state, bool found, const char* name)
{
    if (!found)
        state.SkipWithError((benchfile(name).toStdString() + " is absent: make it with gen_family_gedcom.py").c_str());
    return found;
}

} // namespace qmbench
