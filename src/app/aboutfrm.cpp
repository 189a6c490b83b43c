#include "app/aboutfrm.h"

#include "platform/formparts_ui.h"
#include "platform/prompts.h"

#include <QDialogButtonBox>
#include <QFont>
#include <QLabel>
#include <QProcess>
#include <QPushButton>
#include <QVBoxLayout>

namespace qm {

namespace {

QLabel* textlabel(const char* name, const QString& accessible, const QString& text, QWidget* parent)
{
    QLabel* l = valuelabel(parent, QString::fromLatin1(name), accessible, text);
    l->setWordWrap(true);
    return l;
}

bool startdetached(const systemtool& tool)
{
    return QProcess::startDetached(tool.program, tool.arguments);
}

} // namespace

aboutfrm::aboutfrm(prompts& asker, QWidget* parent, systemlookup machine, starter start)
    : QDialog(parent), asker_(asker), machine_(std::move(machine)), start_(start ? std::move(start) : startdetached)
{
    setObjectName(QStringLiteral("aboutfrm"));
    setWindowTitle(QStringLiteral("About Quillmark ") + versionnumber());
    setModal(true);

    auto* title = textlabel("lblTitle", QStringLiteral("Product"), QStringLiteral("Quillmark"), this);
    QFont big = title->font();
    big.setPointSizeF(big.pointSizeF() * 1.8);
    big.setBold(true);
    title->setFont(big);
    auto* version = textlabel("lblVersion", QStringLiteral("Version"), QStringLiteral("v ") + versionnumber(), this);
    auto* description = textlabel(
        "lblDescription", QStringLiteral("Description"),
        QStringLiteral("Census transcription for family historians. Quillmark records one census household at a time "
                       "in a Family Historian family file: a census event and citation for each individual, with "
                       "occupations, calculated births, census flags and images of the census pages, and a log of "
                       "every change. The family file is backed up before each change."),
        this);
    auto* thanks = textlabel(
        "lblAcknowledgements", QStringLiteral("Acknowledgements"),
        QStringLiteral("Built with the Qt toolkit (The Qt Company Ltd and contributors), used under the GNU Lesser "
                       "General Public License version 3. Family files are read and written in GEDCOM, the "
                       "genealogical data format of The Church of Jesus Christ of Latter-day Saints. Thanks to the "
                       "family historians who tested Quillmark and suggested its options."),
        this);
    auto* disclaimer = textlabel(
        "lblDisclaimer", QStringLiteral("Disclaimer"),
        QStringLiteral("Disclaimer: the GEDCOM tag and record definitions used by Quillmark, including the "
                       "Family Historian tags _FLGS, _FILE, _DATE, _ASID and _TYPE, are those of their owners and "
                       "are used only to exchange data with the files they describe. Quillmark is not connected with "
                       "or endorsed by the makers of GEDCOM or of Family Historian. Always keep backups of your "
                       "family history data."),
        this);
    QFont small = disclaimer->font();
    small.setPointSizeF(small.pointSizeF() * 0.9);
    disclaimer->setFont(small);

    auto* buttons = new QDialogButtonBox(this);
    auto* ok = buttons->addButton(QStringLiteral("OK"), QDialogButtonBox::AcceptRole);
    ok->setObjectName(QStringLiteral("cmdOK"));
    ok->setAccessibleName(QStringLiteral("OK"));
    ok->setDefault(true);
    auto* sysinfo = buttons->addButton(QStringLiteral("&System Info..."), QDialogButtonBox::ActionRole);
    sysinfo->setObjectName(QStringLiteral("cmdSysInfo"));
    sysinfo->setAccessibleName(QStringLiteral("System Info"));
    sysinfo->setAutoDefault(false);
    connect(ok, &QPushButton::clicked, this, &QDialog::accept);
    connect(sysinfo, &QPushButton::clicked, this, &aboutfrm::systeminfo);

    auto* layout = new QVBoxLayout(this);
    layout->addWidget(title);
    layout->addWidget(version);
    layout->addSpacing(8);
    layout->addWidget(description);
    layout->addWidget(thanks);
    layout->addWidget(disclaimer);
    layout->addStretch(1);
    layout->addWidget(buttons);
    const int width = fontMetrics().averageCharWidth() * 70;
    setMinimumWidth(width);
    // Wrapped labels: the height that the text needs at that width, no more.
    resize(width, layout->heightForWidth(width));
    ok->setFocus();
}

void aboutfrm::systeminfo()
{
    const std::optional<systemtool> tool = findsysteminfo(machine_);
    if (!tool || !start_(*tool))
        asker_.tell(systeminfounavailable());
}

} // namespace qm
