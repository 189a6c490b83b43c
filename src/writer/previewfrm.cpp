#include "writer/previewfrm.h"

#include "model/gedcomindex.h"
#include "platform/formparts_ui.h"
#include "platform/prompts.h"
#include "settings/settings.h"

#include <QDir>
#include <QFileInfo>
#include <QHBoxLayout>
#include <QLabel>
#include <QListWidget>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QSplitter>
#include <QVBoxLayout>

#include <algorithm>

namespace qm {

namespace {

// What the save may still ask for, which the preview cannot know.
QString notshown(const gedcomindex& index, const settings& s, const censusentry& entry)
{
    QStringList what;
    const auto asksbirth = [&](const selectionrec& r) {
        if (r.birthedited || r.personindex < 0 || static_cast<size_t>(r.personindex) >= index.people.size())
            return false;
        const personrec& p = index.people[static_cast<size_t>(r.personindex)];
        return !p.hasbirthdate && !p.hasbirthplace;
    };
    if (s.birthdate && std::any_of(entry.selection.begin(), entry.selection.end(), asksbirth))
        what << QStringLiteral("the calculated birth events the save will offer");
    if (s.fullentry ? s.requestimage : s.requestimages2)
        what << QStringLiteral("the images the save will ask you to choose");
    return what.isEmpty() ? QString() : QStringLiteral("Not shown: ") + what.join(QStringLiteral(" and ")) + u'.';
}

} // namespace

bool showentrypreview(const gedcomindex& index, const settings& s, const censusentry& entry, prompts& p,
                      QWidget* parent)
{
    savepreview preview;
    {
        busycursor busy(p);
        preview = previewentry(index, s, entry);
    }
    if (!preview.ok) {
        p.tell(preview.message, preview.changed ? icon::none : icon::exclamation);
        return !preview.changed;
    }
    previewfrm window(preview, notshown(index, s, entry), parent);
    window.exec();
    return true;
}

QString recordcaption(const previewrecord& r)
{
    QString caption = r.header;
    for (const diffline& l : r.lines) {
        const QString t = l.text.trimmed();
        if (l.tag != difftag::removed && (t.startsWith(QLatin1String("1 NAME ")) || t.startsWith(QLatin1String("1 TITL ")))) {
            caption += QStringLiteral(" (") + t.mid(7).remove(u'/').simplified() + u')';
            break;
        }
    }
    caption += r.added ? QStringLiteral(": new record") : QStringLiteral(": changed, line %1").arg(r.oldline);
    return caption;
}

previewfrm::previewfrm(const savepreview& preview, const QString& note, QWidget* parent)
    : QDialog(parent), preview_(preview)
{
    setObjectName(QStringLiteral("previewfrm"));
    setWindowTitle(QStringLiteral("Preview of the Census Entry"));
    setModal(true);

    int added = 0, changed = 0;
    for (const previewrecord& r : preview.records)
        ++(r.added ? added : changed);
    QString summary = QStringLiteral("Saving this entry would change %1 and add %2 in %3. Lines the save adds are "
                                     "marked +, lines it takes away -.")
                          .arg(changed == 1 ? QStringLiteral("1 record") : QStringLiteral("%1 records").arg(changed),
                               added == 1 ? QStringLiteral("1 record") : QStringLiteral("%1 records").arg(added),
                               QDir::toNativeSeparators(preview.gedcomfile));
    if (preview.lineends)
        summary += QStringLiteral(" Every line end of the file is written as CR LF, which the lines do not show.");
    auto* summarylab = valuelabel(this, QStringLiteral("summarylab"), QStringLiteral("Summary"), summary);
    summarylab->setWordWrap(true);

    auto* recordscaption = new QLabel(QStringLiteral("&Records:"), this);
    recordslst_ = named(new QListWidget(this), "recordslst", QStringLiteral("Records"));
    for (const previewrecord& r : preview.records)
        recordslst_->addItem(recordcaption(r));
    recordscaption->setBuddy(recordslst_);
    auto* linescaption = new QLabel(QStringLiteral("&Lines of the record:"), this);
    linestxt_ = named(new QPlainTextEdit(this), "linestxt", QStringLiteral("Lines of the record"));
    linestxt_->setReadOnly(true);
    linestxt_->setLineWrapMode(QPlainTextEdit::NoWrap);
    linestxt_->setFont(fixedfont());
    linescaption->setBuddy(linestxt_);

    auto* left = new QWidget(this);
    auto* lv = new QVBoxLayout(left);
    lv->setContentsMargins(0, 0, 0, 0);
    lv->addWidget(recordscaption);
    lv->addWidget(recordslst_, 1);
    auto* right = new QWidget(this);
    auto* rv = new QVBoxLayout(right);
    rv->setContentsMargins(0, 0, 0, 0);
    rv->addWidget(linescaption);
    rv->addWidget(linestxt_, 1);
    auto* split = new QSplitter(Qt::Horizontal, this);
    split->addWidget(left);
    split->addWidget(right);
    split->setStretchFactor(0, 2);
    split->setStretchFactor(1, 3);

    auto* closebut = new QPushButton(QStringLiteral("Close"), this);
    closebut->setObjectName(QStringLiteral("closebut"));
    closebut->setDefault(true);
    auto* buttons = new QHBoxLayout;
    buttons->addStretch(1);
    buttons->addWidget(closebut);

    auto* layout = new QVBoxLayout(this);
    layout->addWidget(summarylab);
    layout->addWidget(split, 1);
    if (!note.isEmpty()) {
        auto* notelab = valuelabel(this, QStringLiteral("notelab"), QStringLiteral("Note"), note);
        notelab->setWordWrap(true);
        layout->addWidget(notelab);
    }
    layout->addLayout(buttons);
    resize(960, 560);

    connect(recordslst_, &QListWidget::currentRowChanged, this, &previewfrm::showrecord);
    connect(closebut, &QPushButton::clicked, this, &QDialog::accept);
    if (!preview.records.empty())
        recordslst_->setCurrentRow(0);
    recordslst_->setFocus();
}

void previewfrm::showrecord(int k)
{
    if (k < 0 || static_cast<size_t>(k) >= preview_.records.size()) {
        linestxt_->clear();
        return;
    }
    QString text;
    for (const diffline& l : preview_.records[static_cast<size_t>(k)].lines) {
        text += l.tag == difftag::added ? QStringLiteral("+ ") : l.tag == difftag::removed ? QStringLiteral("- ")
                                                                                           : QStringLiteral("  ");
        text += l.text + u'\n';
    }
    text.chop(1);
    linestxt_->setPlainText(text);
}

} // namespace qm
