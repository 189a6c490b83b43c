#include "app/aboutfrm.h"
#include "app/donatefrm.h"
#include "app/helptopics.h"
#include "app/mainfrm.h"
#include "app/milestone.h"
#include "platform/prompts.h"

#include <QAbstractButton>
#include <QApplication>
#include <QKeyEvent>
#include <QShortcut>

namespace qm {

namespace {

// F1 in a dialog presses the dialog's own Help button.
class dialoghelpkey : public QObject {
public:
    using QObject::QObject;

protected:
    bool eventFilter(QObject* watched, QEvent* event) override
    {
        if (event->type() != QEvent::KeyPress)
            return false;
        const auto* key = static_cast<QKeyEvent*>(event);
        if (key->key() != Qt::Key_F1 || key->modifiers() != Qt::NoModifier)
            return false;
        QWidget* dialog = QApplication::activeModalWidget();
        auto* target = qobject_cast<QWidget*>(watched);
        if (!dialog || !target || target->window() != dialog)
            return false;
        for (QAbstractButton* b : dialog->findChildren<QAbstractButton*>()) {
            if (b->window() == dialog && b->isVisible() && b->isEnabled() &&
                QString(b->text()).remove(u'&') == QLatin1String("Help")) {
                b->click();
                return true;
            }
        }
        return false;
    }
};

} // namespace

// F1 opens the main window's help page; in a dialog, that dialog's page.
void mainfrm::helpkeys()
{
    auto* f1 = new QShortcut(QKeySequence(Qt::Key_F1), this);
    f1->setObjectName(QStringLiteral("helpkey"));
    f1->setContext(Qt::WindowShortcut);
    connect(f1, &QShortcut::activated, this, [this] { prompts_.showhelp(maintopic); });
    qApp->installEventFilter(new dialoghelpkey(this));
}

// "Make a Donation...": the donation window in its asking form.
void mainfrm::donate()
{
    donatefrm(prompts_, std::nullopt, this).exec();
}

void mainfrm::about()
{
    aboutfrm(prompts_, this).exec();
}

// The donation reminder after the 10th, the 20th and every 50th saved entry.
void mainfrm::milestone()
{
    if (ismilestone(file_.currentsettings().count))
        donatefrm(prompts_, file_.currentsettings().count, this).exec();
}

} // namespace qm
