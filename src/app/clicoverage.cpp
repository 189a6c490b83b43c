// quillmark-cli coverage: for every individual of a family file and every
// census of a country, whether the file records the individual in it (the
// census coverage, tools/coverage.h), as JSON or CSV.
#include "app/cli.h"

#include "model/loadgedcom.h"
#include "tools/coverage.h"

#include <cstdio>
#include <string>

namespace qm {

namespace {

QString usage()
{
    return QStringLiteral("coverage needs one family file: quillmark-cli coverage FILE [--country C] [--year Y] "
                          "[--missing-only] [--format csv|json] [--settings S.ini]");
}

// Standard output in large pieces: a big file gives hundreds of megabytes.
class output {
public:
    std::string& text() { return out_; }
    void maybeflush()
    {
        if (out_.size() >= (1u << 20))
            flush();
    }
    void flush()
    {
        std::fwrite(out_.data(), 1, out_.size(), stdout);
        out_.clear();
    }

private:
    std::string out_;
};

} // namespace

int clicoverage(QStringList args)
{
    QString inipath, error, country;
    QStringList operands;
    if (!beginargs(args, operands, inipath, error))
        return clifail(error);
    int year = 0;
    bool missingonly = false, csv = false;
    for (qsizetype i = 0; i < args.size();) {
        QString value;
        if (takeoptionvalue(args, i, QStringLiteral("--country"), value, error)) {
            if (error.isEmpty())
                error = takecountry(value, &country);
        } else if (takeoptionvalue(args, i, QStringLiteral("--year"), value, error)) {
            bool ok = false;
            year = value.trimmed().toInt(&ok);
            if (error.isEmpty() && (!ok || year <= 0))
                error = QStringLiteral("--year %1: give a census year such as 1881").arg(value);
        } else if (takeoptionvalue(args, i, QStringLiteral("--format"), value, error)) {
            csv = value.compare(QLatin1String("csv"), Qt::CaseInsensitive) == 0;
            if (error.isEmpty() && !csv && value.compare(QLatin1String("json"), Qt::CaseInsensitive) != 0)
                error = QStringLiteral("--format %1: give csv or json").arg(value);
        } else if (args[i] == QLatin1String("--missing-only")) {
            missingonly = true;
            args.remove(i);
        } else {
            ++i;
        }
        if (!error.isEmpty())
            return clifail(error);
    }
    if (!endargs(args, operands, error))
        return clifail(error);
    const auto f = openfamily(args, usage(), inipath);
    if (!f)
        return clifailure;
    const settings& s = f->values();
    if (country.isEmpty())
        country = s.country;
    const gedcomindex& ix = *f->file.index();

    const censuscoverage c = computecoverage(ix, country, s.residence);
    std::vector<size_t> columns;
    for (size_t col = 0; col < c.columns(); ++col)
        if (year == 0 || c.year(col).toInt() == year)
            columns.push_back(col);
    if (columns.empty()) {
        QStringList years;
        for (size_t col = 0; col < c.columns(); ++col)
            years << c.year(col);
        return clifail(QStringLiteral("--year %1: %2 has no census of that year (its censuses: %3)")
                           .arg(year)
                           .arg(c.country, years.join(QStringLiteral(", "))));
    }
    std::vector<std::string> keys;
    for (const size_t col : columns)
        keys.push_back(c.year(col).toStdString());

    output out;
    std::string& o = out.text();
    if (csv) {
        appendcoveragecsvheading(o, c, columns);
    } else {
        o += "{\"country\": ";
        appendjsontext(o, c.country.toStdString());
        o += ", \"censuses\": [";
        for (size_t k = 0; k < keys.size(); ++k)
            o += (k ? ", \"" : "\"") + keys[k] + '"';
        o += "], \"individuals\": [";
    }
    bool first = true;
    for (size_t p = 0; p < c.people; ++p) {
        if (missingonly) {
            bool gap = false;
            for (const size_t col : columns)
                gap = gap || c.cell(p, col) == coveragecell::missing;
            if (!gap)
                continue;
        }
        const personrec& person = ix.people[p];
        if (csv) {
            appendcoveragecsvrow(o, person, c, p, columns);
        } else {
            o += first ? "\n{\"id\": " : ",\n{\"id\": ";
            o += std::to_string(person.id);
            o += ", \"name\": ";
            appendjsontext(o, person.name);
            o += ", \"cells\": {";
            for (size_t k = 0; k < columns.size(); ++k) {
                o += k ? ", \"" : "\"";
                o += keys[k];
                o += "\": \"";
                o += coverageword(c.cell(p, columns[k]));
                o += '"';
            }
            o += "}}";
        }
        first = false;
        out.maybeflush();
    }
    if (!csv)
        o += "\n]}\n";
    out.flush();
    if (std::fflush(stdout) != 0 || std::ferror(stdout))
        return clifail(QStringLiteral("the coverage could not be written to standard output"));
    // The process ends here: the system takes the index's memory back at once.
    f->file.abandonindex();
    return 0;
}

} // namespace qm
