#pragma once
// The census entry of an entry file (ENTRY.json of quillmark-cli add-entry):
// the file read as JSON, then checked against one loaded family file with the
// checks of the entry form (household, census, date, source, images, birth
// details), giving the entry the save road writes. docs/cli.md describes the
// file.

#include "writer/censusentry.h"

#include <QByteArray>
#include <QString>

#include <cstdint>
#include <optional>
#include <vector>

namespace qm {

struct gedcomindex;
struct settings;

// One individual as the entry file gives it.
struct entryperson {
    int32_t id = 0;
    QString age;
    QChar agetype = u'Y';
    QString occupation;
    std::optional<QString> birthplace;
};

// One image of the entry file: a new image file with its title, or an
// existing multimedia record.
struct entryimage {
    QString file;
    QString title;
    std::optional<int32_t> object;
};

// The entry file's object, read but not yet checked against the family file.
struct entryfile {
    std::optional<int> year;
    std::optional<QString> date;
    QString place, address, reference, sourcetext, notetext, other;
    std::optional<QString> title;
    std::optional<int32_t> source;
    std::vector<entryperson> people;
    std::vector<entryimage> images;
};

// Reads the entry file's bytes into e. False with the message in error.
bool readentry(const QByteArray& bytes, entryfile& e, QString& error);

// The census entry for the family file of `index`: "" and `entry` filled, or
// the message of the first check that refuses it.
QString makeentry(const entryfile& e, const gedcomindex& index, const settings& s, censusentry& entry);

} // namespace qm
