#pragma once
// Titles of new census sources, built from the user's title template.

#include <QString>

namespace qm {

// Fills the placeholders {YEAR}, {DATE}, {PLACE}, {ADDR}, {OTHER}, {REF} and
// {COUNTRY} of template (in that order, case-sensitive) and tidies the result:
// double spaces collapse and empty brackets "()" go. An empty result gives
// "{No Title}". The result is not trimmed.
QString maketitle(const QString& templ, const QString& year, const QString& date, const QString& place,
                  const QString& address, const QString& other, const QString& reference,
                  const QString& country);

} // namespace qm
