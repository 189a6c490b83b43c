// Before and after the save, through the main window: "Preview..." shows the
// lines the save would write and writes nothing; Edit > "Undo Last Census
// Entry" puts the file back after the question. (Its refusals, an outside
// change among them: UndoLast in undolast_test.cpp.)
#include "writer/previewfrm.h"

#include "support/mainfrmfixture.h"

#include <QAction>
#include <QListWidget>
#include <QMenu>
#include <QMenuBar>
#include <QPlainTextEdit>
#include <QPushButton>

using namespace qm;
using namespace qmtest;

namespace {

QPushButton* button(QWidget* w, const char* name)
{
    return w->findChild<QPushButton*>(QString::fromLatin1(name));
}

} // namespace

class previewfrm_test : public QObject {
    Q_OBJECT

private:
    windowfiles files_;

    // The sample opened and the Ashworths' 1881 household typed.
    std::unique_ptr<session> typed(const QString& file)
    {
        settings s = defaultsettings();
        s.requestimage = false;
        s.birthdate = false;
        s.householdcheck = false;
        auto run = files_.opened(file, &s);
        if (!run)
            return nullptr;
        mainfrm& w = *run->w;
        chooseyear(w, QStringLiteral("1881"));
        w.panel()->locationtxt->setText(QStringLiteral("Hebden Bridge, Yorkshire, England"));
        w.panel()->referencetxt->setText(QStringLiteral("RG11/4426/52"));
        w.panel()->texttxt->setPlainText(QStringLiteral("William Ashworth Head"));
        typehousehold(w, {{11, "25", "Fustian Cutter"}, {27, "23"}});
        return run;
    }

private slots:
    void initTestCase() { QVERIFY(files_.valid()); }

    void previewwritesnothing()
    {
        const QString file = files_.sample();
        const std::string before = readfile(file);
        auto run = typed(file);
        QVERIFY(run);
        mainfrm& w = *run->w;

        dialoganswers answers;
        QStringList records;
        QString lines, summary;
        bool focused = false;
        answers.expect(QStringLiteral("previewfrm"), [&](QDialog* d) {
            auto* list = d->findChild<QListWidget*>(QStringLiteral("recordslst"));
            for (int i = 0; i < list->count(); ++i)
                records << list->item(i)->text();
            focused = d->focusWidget() == list;
            summary = d->findChild<QLabel*>(QStringLiteral("summarylab"))->text();
            list->setCurrentRow(0);
            lines = d->findChild<QPlainTextEdit*>(QStringLiteral("linestxt"))->toPlainText();
            button(d, "closebut")->click();
        });
        QPushButton* preview = button(&w, "previewbut");
        QVERIFY(preview);
        QCOMPARE(preview->text(), QStringLiteral("Preview..."));
        preview->click();
        QCOMPARE(answers.unexpected, 0);
        QCOMPARE(answers.pending(), 0);
        QVERIFY(focused);
        QCOMPARE(records, (QStringList{QStringLiteral("0 @I11@ INDI (William Ashworth): changed, line 312"),
                                       QStringLiteral("0 @I27@ INDI (Agnes Schröder): changed, line %1")
                                           .arg(records.value(1).section(u' ', -1)),
                                       records.value(2)}));
        QVERIFY2(records.value(2).startsWith(QStringLiteral("0 @S12@ SOUR (Census 1881 Hebden Bridge")),
                 qPrintable(records.value(2)));
        QVERIFY2(summary.startsWith(QStringLiteral("Saving this entry would change 2 records and add 1 record")),
                 qPrintable(summary));
        QVERIFY2(lines.contains(QStringLiteral("\n+ 1 CENS\n+ 2 DATE 3 APR 1881\n")), qPrintable(lines));
        QVERIFY2(lines.contains(QStringLiteral("\n+ 1 OCCU Fustian Cutter\n")), qPrintable(lines));
        QVERIFY(lines.startsWith(QStringLiteral("  0 @I11@ INDI\n  1 NAME William /Ashworth/\n")));
        QCOMPARE(readfile(file), before);
        QCOMPARE(w.household().selectioncount, 2); // the entry stays as typed
        QCOMPARE(run->prompts.unexpected(), 0);
    }

    void undolastentry()
    {
        const QString file = files_.sample();
        const std::string before = readfile(file);
        auto run = typed(file);
        QVERIFY(run);
        mainfrm& w = *run->w;
        QAction* undo = w.menuBar()->findChild<QAction*>(QStringLiteral("undomen"));
        QVERIFY(undo);
        QCOMPARE(undo->text(), QStringLiteral("&Undo Last Census Entry"));

        // Nothing to undo yet.
        run->prompts.expect(answer::ok, QStringLiteral("has no change to"));
        undo->trigger();
        QCOMPARE(run->prompts.unexpected(), 0);

        button(&w, "addbut")->click();
        const std::string saved = readfile(file);
        QVERIFY(saved != before);

        // Asked first; No changes nothing.
        run->prompts.expect(answer::no, QStringLiteral("Undo the last change Quillmark made to"));
        undo->trigger();
        QCOMPARE(readfile(file), saved);
        run->prompts.expect(answer::yes, QStringLiteral("Undo the last change Quillmark made to"));
        run->prompts.expect(answer::ok, QStringLiteral("Undone: Census entry added: Census 1881 Hebden Bridge"));
        undo->trigger();
        QCOMPARE(run->prompts.unexpected(), 0);
        QCOMPARE(readfile(file), before);
        // The window read the file again: the next source number is free once more.
        QCOMPARE(w.panel()->sourceidlab->text(), QStringLiteral("12"));
        QVERIFY(w.watching());
    }
};

QTEST_MAIN(previewfrm_test)
#include "previewfrm_test.moc"
