#include "flags/flagtable.h"

#include "platform/encoding.h"
#include "platform/settingsstore.h"

namespace qm {

namespace {

// Accented characters and the letters they fold to, paired by position.
const QString accentlist = QStringLiteral(
    "ŠŒŽšœžŸ¥µÀÁÂÃÄÅÆÇÈÉÊËÌÍÎÏÐÑÒÓÔÕÖØÙÚÛÜÝßàáâãäåæçèéêëìíîïðñòóôõöøùúûüýÿ");
constexpr char foldlist[] = "SOZsozYYuAAAAAAACEEEEIIIIDNOOOOOOUUUUYsaaaaaaaceeeeiiiionoooooouuuuyy";
static_assert(sizeof(foldlist) - 1 == 69);

constexpr size_t maxcodelength = 15;

QString flaggroup(int n)
{
    return QStringLiteral("Flags/") + QString::number(n);
}

bool haslinebreak(const QString& s)
{
    return s.contains(QLatin1Char('\r')) || s.contains(QLatin1Char('\n'));
}

// A code is written as a GEDCOM tag: a space or a control character in it
// would change what the flag line means when the file is read again.
bool usablecode(const QString& code)
{
    for (const QChar c : code)
        if (c.isSpace() || c.category() == QChar::Other_Control)
            return false;
    return true;
}

} // namespace

size_t noteflag(flagtable& table, std::string_view code, std::string_view name)
{
    for (size_t i = 0; i < table.size(); ++i) {
        if (table[i].code == code) {
            ++table[i].count;
            return i;
        }
    }
    flagrec f;
    f.code = std::string(code);
    f.name = std::string(name);
    f.count = 1;
    table.push_back(std::move(f));
    return table.size() - 1;
}

bool loadflagdefs(settingsstore& store, flagtable& table)
{
    bool faulty = false;
    for (int n = 1;; ++n) {
        const QString group = flaggroup(n);
        if (!store.groupexists(group))
            break;
        const auto code = store.read(group, QStringLiteral("Code"));
        const auto name = store.read(group, QStringLiteral("Name"));
        const auto date = store.read(group, QStringLiteral("Date"));
        const auto country = store.read(group, QStringLiteral("Country"));
        const bool good = code && code->size() >= 3 && usablecode(*code) && name && name->size() >= 1 &&
                          !haslinebreak(*name) && date && date->size() >= 4 && country && country->size() >= 2;
        if (!good) {
            faulty = true;
            continue;
        }
        const size_t i = noteflag(table, u8(*code), u8(*name));
        --table[i].count; // a definition is not a use
        table[i].date = u8(*date);
        table[i].country = u8(*country);
    }
    if (faulty)
        saveflagdefs(store, table);
    return !faulty;
}

QString flagloaderrormessage()
{
    return QStringLiteral("There was an error loading in the flags from the registry. Quillmark has ignored the "
                          "errors but you should review the flag settings and add any missing values");
}

void saveflagdefs(settingsstore& store, const flagtable& table)
{
    // The whole group goes, not only the run of numbered groups from 1: a group
    // left beyond a gap would come back as a definition once the run is
    // renumbered.
    store.removegroup(QStringLiteral("Flags"));
    int k = 0;
    for (const flagrec& f : table) {
        if (f.date.empty())
            continue;
        const QString group = flaggroup(++k);
        store.write(group, QStringLiteral("Code"), qs(f.code));
        store.write(group, QStringLiteral("Name"), qs(f.name));
        store.write(group, QStringLiteral("Date"), qs(f.date));
        store.write(group, QStringLiteral("Country"), qs(f.country));
    }
    store.sync();
}

std::string codeforflag(const QString& name)
{
    // Composed form, so that a letter typed as base letter plus accent folds
    // like the single character.
    const QString text = name.normalized(QString::NormalizationForm_C);
    std::string code = "__";
    for (const QChar c : text) {
        const qsizetype at = accentlist.indexOf(c);
        if (at >= 0) {
            char folded = foldlist[at];
            if (folded >= 'a' && folded <= 'z')
                folded = static_cast<char>(folded - 'a' + 'A');
            code += folded;
            continue;
        }
        const char16_t u = c.unicode();
        if (u >= 'a' && u <= 'z')
            code += static_cast<char>(u - 'a' + 'A');
        else if ((u >= 'A' && u <= 'Z') || (u >= '0' && u <= '9'))
            code += static_cast<char>(u);
        else if (u == ' ')
            code += '_';
    }
    if (code.size() > maxcodelength)
        code.resize(maxcodelength);
    return code;
}

std::optional<size_t> findentryflag(const flagtable& table, std::string_view censusdate, std::string_view country)
{
    for (size_t i = 0; i < table.size(); ++i) {
        const flagrec& f = table[i];
        if (!f.date.empty() && f.country == country && censusdate.find(f.date) != std::string_view::npos)
            return i;
    }
    return std::nullopt;
}

} // namespace qm
