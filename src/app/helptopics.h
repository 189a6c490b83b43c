#pragma once
// The help pages: which page each help topic number opens, and the full-text
// search over the pages. The pages are HTML files shipped in the program's
// resources under ":/help" (src/app/help); tests may read them from the source
// folder instead.

#include <QString>
#include <QStringList>

#include <vector>

namespace qm {

struct helptopic {
    int topic;
    QString page;  // file name under the help folder
    QString about; // the window or command it belongs to
};

// The windows' help topics, in topic order.
const std::vector<helptopic>& helptopics();

inline constexpr int maintopic = 17; // the main window's page, also the help window's Home
QString helpfolder();                // ":/help"
QString indexpage();                 // "index.html"
QString searchpage();                // "search.html"

// The page a help request opens: "Index" the index page, "Search" the search
// page, anything else the page of the topic number (the index page for a
// number without a page of its own).
QString pagefor(int topic, const QString& command = QString());

// One page read for searching.
struct helpdoc {
    QString page;  // file name
    QString title; // the page's <title>
    QString text;  // the words shown to the reader (tags dropped, entities decoded)
};

// Every *.html page of the folder, in file-name order.
std::vector<helpdoc> readhelp(const QString& folder = helpfolder());
helpdoc parsehelp(const QString& page, const QString& html);
// The link targets (href values) of a page, in order.
QStringList helplinks(const QString& html);
// The anchor names (id= and name= values) of a page.
QStringList helpanchors(const QString& html);

struct helphit {
    QString page;
    QString title;
    int score = 0;   // matches in the text, plus extra weight for the title and the whole phrase
    int least = 0;   // the matches (title weighed in) of the query word found least often
    QString excerpt; // the text around the first match
};

// The pages holding every word of the query, best first: whole words,
// letter case ignored; a word ending in "*" matches every word that begins
// with it. Each word's matches are counted, a title match counting five;
// pages rank by the count of their rarest query word, then by the score: all
// counts plus ten for each place where the query's words stand together, in
// order. Equal pages keep page order. The index and search pages are left out.
std::vector<helphit> searchhelp(const std::vector<helpdoc>& docs, const QString& query);

// The words of a query or a text, lower-cased.
QStringList helpwords(const QString& text);

} // namespace qm
