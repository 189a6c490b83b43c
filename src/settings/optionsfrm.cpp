// The Options dialog: its five tabs built, the settings shown in them and read
// back, the enabling rules, the file and folder choices and Save. One file a
// little above the usual size: every part works on the same controls, which
// are the dialog's members.
#include "settings/optionsfrm.h"

#include "platform/formparts_ui.h"
#include "platform/prompts.h"

#include <QButtonGroup>
#include <QCheckBox>
#include <QCloseEvent>
#include <QComboBox>
#include <QDir>
#include <QFileInfo>
#include <QGroupBox>
#include <QGuiApplication>
#include <QHBoxLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QScreen>
#include <QShortcut>
#include <QTabWidget>
#include <QVBoxLayout>

namespace qm {

namespace {

// Captions longer than this wrap in a label beside their button.
constexpr int shortcaption = 45;

QVBoxLayout* rowsof(QGroupBox* f)
{
    return static_cast<QVBoxLayout*>(f->layout());
}

QWidget* column(std::initializer_list<QWidget*> frames, QWidget* parent)
{
    auto* w = new QWidget(parent);
    auto* v = new QVBoxLayout(w);
    v->setContentsMargins(0, 0, 0, 0);
    for (QWidget* f : frames)
        v->addWidget(f);
    v->addStretch(1);
    return w;
}

} // namespace

optionsfrm::optionsfrm(prompts& p, settingsstore& store, const settings& current, std::function<void()> donate,
                       QWidget* parent)
    : QDialog(parent), prompts_(p), store_(store), current_(current), opening_(optionsopening::of(current)),
      donate_(std::move(donate)), saved_(current)
{
    setObjectName(QStringLiteral("optionsfrm"));
    setWindowTitle(QStringLiteral("Quillmark Options"));
    setModal(true);

    SSTab1 = new QTabWidget(this);
    SSTab1->setObjectName(QStringLiteral("SSTab1"));
    SSTab1->setAccessibleName(QStringLiteral("Options"));
    SSTab1->addTab(generaltab(), QStringLiteral("&General"));
    SSTab1->addTab(methodstab(), QStringLiteral("&Recording Methods"));
    SSTab1->addTab(method1tab(), QStringLiteral("Recording Method &1"));
    SSTab1->addTab(method2tab(), QStringLiteral("Recording Method &2"));
    SSTab1->addTab(misctab(), QStringLiteral("&Miscellaneous"));

    savebut = plainbutton(this, "savebut", QStringLiteral("&Save"), QStringLiteral("Save"));
    savebut->setDefault(true);
    Cancelbut = plainbutton(this, "Cancelbut", QStringLiteral("Cancel"), QStringLiteral("Cancel"));
    defaultbut =
        plainbutton(this, "defaultbut", QStringLiteral("&Default Settings"), QStringLiteral("Default Settings"));
    Command1 = plainbutton(this, "Command1", QStringLiteral("&Help"), QStringLiteral("Help"));
    auto* donateframe = new QGroupBox(QStringLiteral("Donate?"), this);
    donateframe->setObjectName(QStringLiteral("donatefra"));
    donatebut = plainbutton(donateframe, "donatebut", QStringLiteral("D&onate"), QStringLiteral("Donate"));
    auto* d = new QHBoxLayout(donateframe);
    d->addWidget(donatebut);

    auto* buttons = new QHBoxLayout;
    buttons->addWidget(donateframe);
    buttons->addStretch(1);
    for (QPushButton* b : {savebut, Cancelbut, defaultbut, Command1})
        buttons->addWidget(b, 0, Qt::AlignBottom);

    auto* layout = new QVBoxLayout(this);
    layout->addWidget(SSTab1, 1);
    layout->addLayout(buttons);

    connect(savebut, &QPushButton::clicked, this, &optionsfrm::save);
    connect(Cancelbut, &QPushButton::clicked, this, &QDialog::reject);
    connect(defaultbut, &QPushButton::clicked, this, [this] { showform(dialogdefaults(form())); });
    connect(Command1, &QPushButton::clicked, this, [this] { prompts_.showhelp(20); });
    connect(new QShortcut(QKeySequence::HelpContents, this), &QShortcut::activated, Command1, &QPushButton::click);
    connect(donatebut, &QPushButton::clicked, this, [this] {
        if (donate_)
            donate_();
    });
    connect(pathbut, &QPushButton::clicked, this, &optionsfrm::choosepath);
    connect(folderpathbut, &QPushButton::clicked, this, &optionsfrm::choosefolder);
    connect(separatorchk, &QCheckBox::clicked, this, &optionsfrm::separatorclicked);
    connect(titlerefcom, &QComboBox::activated, this, &optionsfrm::insertplaceholder);
    connect(titletxt, &QLineEdit::textChanged, this,
            [this](const QString& t) { titleoutputlab->setText(titleexample(t)); });
    connect(defaulttitlebut, &QPushButton::clicked, this, [this] { titletxt->setText(defaulttitletemplate()); });
    for (QAbstractButton* b : std::initializer_list<QAbstractButton*>{
             keeplogchk, methodopt[0], methodopt[1], opt1entrydatechk, images2chk, ukopt, usaopt, IrelandOpt, CanadaOpt})
        connect(b, &QAbstractButton::toggled, this, &optionsfrm::applyenabling);

    // Settings incomplete: they must be saved once before the dialog can be left.
    Cancelbut->setEnabled(!current_.firststart);

    showform(current_);
    SSTab1->setCurrentIndex(0);

    const QScreen* screen = QGuiApplication::primaryScreen();
    const QSize room = screen ? screen->availableGeometry().size() - QSize(16, 40) : QSize(1350, 728);
    resize(QSize(900, 640).expandedTo(minimumSizeHint()).boundedTo(room));
}

QGroupBox* optionsfrm::frame(const QString& caption, const char* name)
{
    auto* f = new QGroupBox(caption);
    f->setObjectName(QString::fromLatin1(name));
    new QVBoxLayout(f);
    return f;
}

void optionsfrm::place(QGroupBox* f, QAbstractButton* b, const QString& caption)
{
    b->setAccessibleName(caption);
    if (caption.size() <= shortcaption) {
        b->setText(caption);
        rowsof(f)->addWidget(b);
        return;
    }
    auto* label = new QLabel(caption, f);
    label->setObjectName(b->objectName() + QStringLiteral("lab"));
    label->setTextFormat(Qt::PlainText);
    label->setWordWrap(true);
    label->setAlignment(Qt::AlignLeft | Qt::AlignTop);
    auto* row = new QHBoxLayout;
    row->addWidget(b, 0, Qt::AlignTop);
    row->addWidget(label, 1);
    rowsof(f)->addLayout(row);
    captionof_.insert(b, label);
    buttonof_.insert(label, b);
    b->installEventFilter(this);
    label->installEventFilter(this);
}

QCheckBox* optionsfrm::check(QGroupBox* f, const char* name, const QString& caption)
{
    auto* b = new QCheckBox(f);
    b->setObjectName(QString::fromLatin1(name));
    place(f, b, caption);
    return b;
}

QRadioButton* optionsfrm::option(QGroupBox* f, const char* name, const QString& caption)
{
    auto* b = new QRadioButton(f);
    b->setObjectName(QString::fromLatin1(name));
    place(f, b, caption);
    return b;
}

QWidget* optionsfrm::generaltab()
{
    auto* tab = new QWidget;
    tab->setObjectName(QStringLiteral("generaltab"));

    QGroupBox* source = frame(QStringLiteral("Source Text"), "sourcetextfra");
    Sourcetextemptychk = check(source, "Sourcetextemptychk",
                               QStringLiteral("Always warn if Save is selected but source text has not been entered."));

    QGroupBox* fileopen = frame(QStringLiteral("File Open"), "fileopenfra");
    fileopendefaultchk = check(
        fileopen, "fileopendefaultchk",
        QStringLiteral("Always ask whether the file should be opened by default when using the File Open command. "
                       "If this is not ticked then the previous default file will continue to be opened "
                       "automatically when Quillmark runs."));

    QGroupBox* idframe = frame(QStringLiteral("Individual Record ID"), "idonlyfra");
    IDonlychk = check(idframe, "IDonlychk",
                      QStringLiteral("Only show Name and Record ID in All Individuals and Immediate Family lists"));

    QGroupBox* backup = frame(QStringLiteral("Backup Folder"), "backupfra");
    auto* folderlab = new QLabel(QStringLiteral("Backups will be saved into this folder:"), backup);
    folderpathtxt = named(new QLineEdit(backup), "folderpathtxt", QStringLiteral("Backup folder"));
    folderpathtxt->setReadOnly(true);
    folderlab->setBuddy(folderpathtxt);
    folderpathbut =
        plainbutton(backup, "folderpathbut", QStringLiteral("Change..."), QStringLiteral("Change backup folder"));
    auto* folderrow = new QHBoxLayout;
    folderrow->addWidget(folderpathtxt, 1);
    folderrow->addWidget(folderpathbut);
    rowsof(backup)->addWidget(folderlab);
    rowsof(backup)->addLayout(folderrow);

    QGroupBox* log = frame(QStringLiteral("Log File"), "logfra");
    keeplogchk = check(log, "keeplogchk", QStringLiteral("Keep a log of census entries created"));
    pathtxt = named(new QLineEdit(log), "pathtxt", QStringLiteral("Log file"));
    pathbut = plainbutton(log, "pathbut", QStringLiteral("Change..."), QStringLiteral("Change log file"));
    auto* logrow = new QHBoxLayout;
    logrow->addWidget(pathtxt, 1);
    logrow->addWidget(pathbut);
    rowsof(log)->addLayout(logrow);

    QGroupBox* country = frame(QStringLiteral("Census Country"), "countryfra");
    ukopt = new QRadioButton(country);
    ukopt->setObjectName(QStringLiteral("ukopt"));
    usaopt = new QRadioButton(country);
    usaopt->setObjectName(QStringLiteral("usaopt"));
    IrelandOpt = new QRadioButton(country);
    IrelandOpt->setObjectName(QStringLiteral("IrelandOpt"));
    CanadaOpt = new QRadioButton(country);
    CanadaOpt->setObjectName(QStringLiteral("CanadaOpt"));
    countrygroup_ = new QButtonGroup(this);
    auto* countries = new QHBoxLayout;
    for (auto [b, caption] : {std::pair{ukopt, "UK"}, std::pair{usaopt, "USA"}, std::pair{IrelandOpt, "Ireland"},
                              std::pair{CanadaOpt, "Canada"}}) {
        b->setText(QString::fromLatin1(caption));
        b->setAccessibleName(QString::fromLatin1(caption));
        countrygroup_->addButton(b);
        countries->addWidget(b);
    }
    countries->addStretch(1);
    rowsof(country)->addLayout(countries);
    autorefchk = check(country, "autorefchk", QStringLiteral("Auto reference"));

    auto* grid = new QHBoxLayout(tab);
    grid->addWidget(column({source, fileopen, idframe}, tab), 1);
    grid->addWidget(column({backup, log, country}, tab), 1);
    return tab;
}

QWidget* optionsfrm::methodstab()
{
    auto* tab = new QWidget;
    tab->setObjectName(QStringLiteral("methodstab"));

    QGroupBox* method = frame(QStringLiteral("Census Recording Method"), "methodfra");
    methodopt[0] = option(
        method, "methodopt0",
        QStringLiteral("Method 1: Use Quillmark to create a source record for the census entry with census events "
                       "for each individual linked to it. (Recommended method) - click Help for more details"));
    methodopt[1] = option(
        method, "methodopt1",
        QStringLiteral("Method 2: Use existing sources for each census year with census events for each individual "
                       "linked to it with a 'where in source' entry to record the Census reference - click Help "
                       "for more details."));
    methodgroup_ = new QButtonGroup(this);
    methodgroup_->addButton(methodopt[0], 0);
    methodgroup_->addButton(methodopt[1], 1);

    QGroupBox* birth = frame(QStringLiteral("Birth"), "birthfra");
    birthchk = check(birth, "birthchk",
                     QStringLiteral("Create a calculated birth event for individuals who don't have a birth recorded"));

    QGroupBox* household = frame(QStringLiteral("Household check"), "householdcheckfra");
    householdcheckchk = check(household, "householdcheckchk",
                              QStringLiteral("Before saving, check the household against the family file: ages, "
                                             "deaths, a household entered twice"));

    QGroupBox* autotext = frame(QStringLiteral("Auto Text"), "autotextfra");
    marriageconditionchk = check(autotext, "marriageconditionchk",
                                 QStringLiteral("Add a column for the marriage condition to the Auto-text"));
    separatorchk = new QCheckBox(QStringLiteral("Separate Auto-text columns with a"), autotext);
    separatorchk->setObjectName(QStringLiteral("separatorchk"));
    separatorchk->setAccessibleName(separatorchk->text());
    separatortxt = named(new QLineEdit(autotext), "separatortxt", QStringLiteral("Separator character"));
    separatortxt->setMaxLength(1);
    separatortxt->setFixedWidth(separatortxt->fontMetrics().horizontalAdvance(QStringLiteral("WW")) + 12);
    auto* separatorrow = new QHBoxLayout;
    separatorrow->addWidget(separatorchk);
    separatorrow->addWidget(separatortxt);
    separatorrow->addWidget(new QLabel(QStringLiteral("character rather than a tab."), autotext));
    separatorrow->addStretch(1);
    rowsof(autotext)->addLayout(separatorrow);

    QGroupBox* assessment = frame(QStringLiteral("Census source assessment"), "assessmentfra");
    Norecordopt = option(assessment, "Norecordopt", QStringLiteral("Do not record Assessment"));
    assessmentgroup_ = new QButtonGroup(this);
    assessmentgroup_->addButton(Norecordopt, 4);
    const char* assessments[] = {"Record as primary evidence", "Record as secondary evidence",
                                 "Record as questionable", "Record as unreliable"};
    for (int i = 0; i < 4; ++i) {
        QRadioButton* b = option(assessment, "assessmentopt", QString::fromLatin1(assessments[i]));
        b->setObjectName(QStringLiteral("assessmentopt%1").arg(i));
        assessmentopt[static_cast<size_t>(i)] = b;
        assessmentgroup_->addButton(b, i);
    }

    QGroupBox* occupation = frame(QStringLiteral("Occupation"), "occupationfra");
    occscholarchk =
        check(occupation, "occscholarchk", QStringLiteral("I always enter scholar as an occupation when using Quillmark"));
    occplacechk = check(occupation, "occplacechk",
                        QStringLiteral("Record the census place in the place field of the occupation attribute. If "
                                       "this is not selected, the place field will be left empty."));
    occagechk = check(occupation, "occagechk",
                      QStringLiteral("Record the age as stated in the census within the age field of the occupation "
                                     "attribute."));

    auto* columns = new QHBoxLayout(tab);
    columns->addWidget(column({method, birth, household, autotext}, tab), 3);
    columns->addWidget(column({assessment, occupation}, tab), 2);
    return tab;
}

QWidget* optionsfrm::method1tab()
{
    auto* tab = new QWidget;
    tab->setObjectName(QStringLiteral("method1tab"));

    QGroupBox* options = frame(QStringLiteral("Recording Method 1 Options"), "method1fra");
    opt1entrydatechk = check(options, "opt1entrydatechk",
                             QStringLiteral("Record the date of the census within the citation 'entry date' field"));
    opt1whereinsourcechk =
        check(options, "opt1whereinsourcechk",
              QStringLiteral("Record the census reference in every citation 'where in source'  field"));
    imageschk = check(options, "imageschk",
                      QStringLiteral("Optionally attach image(s) to the source  when saving census record."));
    opt1publicationinfochk =
        check(options, "opt1publicationinfochk",
              QStringLiteral("Record the census reference in the source 'publication information' field"));
    auto* typelab = new QLabel(QStringLiteral("Record the Source Type (Leave empty if not required):"), options);
    typelab->setWordWrap(true);
    sourcetypetxt = named(new QLineEdit(options), "sourcetypetxt", QStringLiteral("Source type"));
    typelab->setBuddy(sourcetypetxt);
    rowsof(options)->addWidget(typelab);
    rowsof(options)->addWidget(sourcetypetxt);

    QGroupBox* title = frame(QStringLiteral("Title Template"), "titlefra");
    titletxt = named(new QLineEdit(title), "titletxt", QStringLiteral("Title template"));
    titlerefcom = new QComboBox(title);
    titlerefcom->setObjectName(QStringLiteral("titlerefcom"));
    titlerefcom->setAccessibleName(QStringLiteral("Add Reference"));
    titlerefcom->setPlaceholderText(QStringLiteral("<<Add Reference"));
    titlerefcom->addItems(titleplaceholders());
    titlerefcom->setCurrentIndex(-1);
    const QString resettitle = QStringLiteral("Reset to Default Title");
    defaulttitlebut = plainbutton(title, "defaulttitlebut", resettitle, resettitle);
    auto* examplelab = new QLabel(QStringLiteral("Example Output:"), title);
    titleoutputlab = showsvalue(new QLabel(title), QStringLiteral("titleoutputlab"), QStringLiteral("Example Output"));
    titleoutputlab->setTextFormat(Qt::PlainText);
    titleoutputlab->setWordWrap(true);
    titleoutputlab->setTextInteractionFlags(Qt::TextSelectableByMouse);
    auto* titlerow = new QHBoxLayout;
    titlerow->addWidget(titlerefcom);
    titlerow->addStretch(1);
    titlerow->addWidget(defaulttitlebut);
    rowsof(title)->addWidget(titletxt);
    rowsof(title)->addLayout(titlerow);
    rowsof(title)->addWidget(examplelab);
    rowsof(title)->addWidget(titleoutputlab);

    QGroupBox* link = frame(QStringLiteral("Image Link/Note"), "asidfra");
    ASIDchk = check(link, "ASIDchk",
                    QStringLiteral("Create a Link/Note record when linking to a new image - click Help for more "
                                   "details"));

    auto* grid = new QHBoxLayout(tab);
    grid->addWidget(column({options}, tab), 1);
    grid->addWidget(column({title, link}, tab), 1);
    return tab;
}

QWidget* optionsfrm::method2tab()
{
    auto* tab = new QWidget;
    tab->setObjectName(QStringLiteral("method2tab"));
    QGroupBox* options = frame(QStringLiteral("Recording Method 2 Options"), "method2fra");
    sharednotechk = check(options, "sharednotechk",
                          QStringLiteral("Record the source text in one shared note record linked from every "
                                         "citation of the census entry, instead of in each citation."));
    images2chk = check(options, "images2chk",
                       QStringLiteral("Optionally attach image(s) to the citations when saving census record."));
    auto* v = new QVBoxLayout(tab);
    v->addWidget(options);
    v->addStretch(1);
    return tab;
}

QWidget* optionsfrm::misctab()
{
    auto* tab = new QWidget;
    tab->setObjectName(QStringLiteral("misctab"));
    QGroupBox* options = frame(
        QStringLiteral("Miscellaneous Options (not recommended but included at request of individual researchers) "),
        "miscfra");
    sourcenotechk = check(options, "sourcenotechk",
                          QStringLiteral("Method 1: when no note is entered, record the source text in the note of "
                                         "the source record instead of its text field."));
    image2eventchk = check(options, "image2eventchk",
                           QStringLiteral("Method 2: link the images to the census event of each individual instead "
                                          "of to the citation."));
    entrydatetodaychk = check(options, "entrydatetodaychk",
                              QStringLiteral("Record today's date in the citation 'entry date' field instead of the "
                                             "date of the census."));
    usenotechk = check(options, "usenotechk",
                       QStringLiteral("Copy the source text and note into a note on the census event of each "
                                      "individual."));
    residencechk = check(options, "residencechk",
                         QStringLiteral("Record a residence attribute instead of a census event for each "
                                        "individual."));
    auto* v = new QVBoxLayout(tab);
    v->addWidget(options);
    v->addStretch(1);
    return tab;
}

settings optionsfrm::form() const
{
    settings s = current_;
    s.nosourcetextwarning = Sourcetextemptychk->isChecked();
    s.fileopendefault = fileopendefaultchk->isChecked();
    s.backupfolder = folderpathtxt->text();
    s.keeplog = keeplogchk->isChecked();
    s.logpath = pathtxt->text();
    s.idonly = IDonlychk->isChecked();
    s.country = usaopt->isChecked()       ? QStringLiteral("USA")
                : IrelandOpt->isChecked() ? QStringLiteral("Ireland")
                : CanadaOpt->isChecked()  ? QStringLiteral("Canada")
                                          : QStringLiteral("UK");
    s.autoreference = autorefchk->isChecked();
    s.birthdate = birthchk->isChecked();
    s.householdcheck = householdcheckchk->isChecked();
    s.fullentry = !methodopt[1]->isChecked();
    int choice = -1;
    for (int i = 0; i < 4; ++i)
        if (assessmentopt[static_cast<size_t>(i)]->isChecked())
            choice = i;
    s.certainty = certaintyofchoice(choice);
    s.occscholar = occscholarchk->isChecked();
    s.occplace = occplacechk->isChecked();
    s.occage = occagechk->isChecked();
    s.marriagecondition = marriageconditionchk->isChecked();
    s.alternateseparator = separatorchk->isChecked();
    s.alternateseparatorcharacter = separatortxt->text();
    s.opt1entrydate = opt1entrydatechk->isChecked();
    s.opt1whereinsource = opt1whereinsourcechk->isChecked();
    s.requestimage = imageschk->isChecked();
    s.opt1publicationinfo = opt1publicationinfochk->isChecked();
    s.sourcetype = sourcetypetxt->text();
    s.title = titletxt->text();
    s.asid = ASIDchk->isChecked();
    s.sharednote = sharednotechk->isChecked();
    s.requestimages2 = images2chk->isChecked();
    s.sourcenote = sourcenotechk->isChecked();
    s.image2event = image2eventchk->isChecked();
    s.entrydatetoday = entrydatetodaychk->isChecked();
    s.sourceinnote = usenotechk->isChecked();
    s.residence = residencechk->isChecked();
    return s;
}

void optionsfrm::showform(const settings& s)
{
    Sourcetextemptychk->setChecked(s.nosourcetextwarning);
    fileopendefaultchk->setChecked(s.fileopendefault);
    folderpathtxt->setText(s.backupfolder);
    keeplogchk->setChecked(s.keeplog);
    pathtxt->setText(s.logpath);
    IDonlychk->setChecked(s.idonly);
    QRadioButton* country = s.country == QLatin1String("USA")       ? usaopt
                            : s.country == QLatin1String("Ireland") ? IrelandOpt
                            : s.country == QLatin1String("Canada")  ? CanadaOpt
                                                                    : ukopt;
    country->setChecked(true);
    autorefchk->setChecked(s.autoreference);
    birthchk->setChecked(s.birthdate);
    householdcheckchk->setChecked(s.householdcheck);
    methodopt[s.fullentry ? 0 : 1]->setChecked(true);
    const int choice = choiceofcertainty(s.certainty);
    (choice < 0 ? Norecordopt : assessmentopt[static_cast<size_t>(choice)])->setChecked(true);
    occscholarchk->setChecked(s.occscholar);
    occplacechk->setChecked(s.occplace);
    occagechk->setChecked(s.occage);
    marriageconditionchk->setChecked(s.marriagecondition);
    separatorchk->setChecked(s.alternateseparator);
    separatortxt->setText(s.alternateseparatorcharacter);
    opt1entrydatechk->setChecked(s.opt1entrydate);
    opt1whereinsourcechk->setChecked(s.opt1whereinsource);
    imageschk->setChecked(s.requestimage);
    opt1publicationinfochk->setChecked(s.opt1publicationinfo);
    sourcetypetxt->setText(s.sourcetype);
    titletxt->setText(s.title);
    titletxt->setCursorPosition(0);
    titleoutputlab->setText(titleexample(s.title));
    ASIDchk->setChecked(s.asid);
    sharednotechk->setChecked(s.sharednote);
    images2chk->setChecked(s.requestimages2);
    sourcenotechk->setChecked(s.sourcenote);
    image2eventchk->setChecked(s.image2event);
    entrydatetodaychk->setChecked(s.entrydatetoday);
    usenotechk->setChecked(s.sourceinnote);
    residencechk->setChecked(s.residence);
    applyenabling();
}

void optionsfrm::applyenabling()
{
    const optionsenabling e = enablingof(form());
    pathtxt->setEnabled(e.logpath);
    pathbut->setEnabled(e.logpath);
    entrydatetodaychk->setEnabled(e.entrydatetoday);
    image2eventchk->setEnabled(e.image2event);
    separatortxt->setEnabled(e.separator);
    autorefchk->setEnabled(e.autoreference);
}

void optionsfrm::separatorclicked(bool on)
{
    applyenabling();
    if (on) {
        separatortxt->setFocus();
        separatortxt->selectAll();
    }
}

void optionsfrm::choosepath()
{
    const std::optional<QString> chosen = prompts_.savefile(
        QStringLiteral("Census Log File"), pathtxt->text().trimmed(),
        QStringLiteral("Census Log textfile (*.txt);;All Files (*)"));
    if (!chosen)
        return;
    const logname n = chooselogname(*chosen);
    if (!n.error.isEmpty()) {
        prompts_.tell(n.error);
        return;
    }
    pathtxt->setText(n.path);
}

void optionsfrm::choosefolder()
{
    const std::optional<QString> chosen = prompts_.choosefolder(
        QStringLiteral("Select a folder where you wish Quillmark to make backup copies of your family history data "
                       "before it makes changes to it."),
        folderpathtxt->text());
    if (!chosen)
        return;
    if (!QFileInfo(*chosen).isDir()) {
        prompts_.tell(QStringLiteral("You are not able to select that location for the backup folder."));
        return;
    }
    folderpathtxt->setText(QDir::toNativeSeparators(*chosen));
}

void optionsfrm::insertplaceholder(int item)
{
    if (item < 0)
        return;
    titletxt->insert(titlerefcom->itemText(item));
    titlerefcom->setCurrentIndex(-1);
    titletxt->setFocus();
}

void optionsfrm::save()
{
    const optionssave r = saveoptions(prompts_, store_, current_, form(), opening_);
    if (r.stop == optionsstop::noseparator) {
        for (int i = 0; i < SSTab1->count(); ++i)
            if (SSTab1->widget(i)->isAncestorOf(separatortxt))
                SSTab1->setCurrentIndex(i);
        prompts_.tell(noseparatormessage());
        separatortxt->setFocus();
        return;
    }
    if (!r.saved())
        return;
    saved_ = r.values;
    reloadneeded_ = r.reloadneeded;
    accept();
}

void optionsfrm::keyPressEvent(QKeyEvent* event)
{
    // Escape is Cancel, and is refused while Cancel is.
    if (event->key() == Qt::Key_Escape && !Cancelbut->isEnabled()) {
        event->accept();
        return;
    }
    QDialog::keyPressEvent(event);
}

void optionsfrm::closeEvent(QCloseEvent* event)
{
    if (!Cancelbut->isEnabled()) {
        event->ignore();
        return;
    }
    QDialog::closeEvent(event);
}

bool optionsfrm::eventFilter(QObject* watched, QEvent* event)
{
    if (event->type() == QEvent::EnabledChange) {
        if (QLabel* l = captionof_.value(watched))
            l->setEnabled(static_cast<QWidget*>(watched)->isEnabled());
    } else if (event->type() == QEvent::MouseButtonRelease) {
        QAbstractButton* b = buttonof_.value(watched);
        if (b && b->isEnabled() && static_cast<QMouseEvent*>(event)->button() == Qt::LeftButton) {
            b->setFocus(Qt::MouseFocusReason);
            b->click();
            return true;
        }
    }
    return QDialog::eventFilter(watched, event);
}

} // namespace qm
