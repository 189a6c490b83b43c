#include "writer/maketitle.h"

namespace qm {

QString maketitle(const QString& templ, const QString& year, const QString& date, const QString& place,
                  const QString& address, const QString& other, const QString& reference,
                  const QString& country)
{
    QString t = templ;
    // A value that holds placeholder text is open to the later replacements.
    t.replace(QStringLiteral("{YEAR}"), year);
    t.replace(QStringLiteral("{DATE}"), date);
    t.replace(QStringLiteral("{PLACE}"), place);
    t.replace(QStringLiteral("{ADDR}"), address);
    t.replace(QStringLiteral("{OTHER}"), other);
    t.replace(QStringLiteral("{REF}"), reference);
    t.replace(QStringLiteral("{COUNTRY}"), country);

    for (;;) {
        const QString before = t;
        while (t.contains(QStringLiteral("  ")))
            t.replace(QStringLiteral("  "), QStringLiteral(" "));
        t.replace(QStringLiteral("()"), QString());
        if (t == before)
            break;
    }
    return t.isEmpty() ? QStringLiteral("{No Title}") : t;
}

} // namespace qm
