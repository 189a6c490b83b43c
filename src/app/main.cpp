// Quillmark: transcribes census households into a Family Historian family file.
//
// The composition root: builds the prompts, the settings store and the main
// window, and hands each what it needs.
#include "app/helpfrm.h"
#include "app/mainfrm.h"
#include "platform/settingsstore.h"
#include "platform/widgetprompts_ui.h"

#include <QApplication>

int main(int argc, char* argv[])
{
    QApplication app(argc, argv);
    QApplication::setApplicationName(QStringLiteral("Quillmark"));
    QApplication::setOrganizationName(QStringLiteral("Quillmark"));

    QStringList arguments = QApplication::arguments().mid(1);
    // --settings FILE keeps the settings in an INI file instead of the user's
    // own store (trials and screenshots).
    std::unique_ptr<qm::settingsstore> store;
    const qsizetype at = arguments.indexOf(QStringLiteral("--settings"));
    if (at >= 0 && at + 1 < arguments.size()) {
        store = qm::settingsstore::onfile(arguments.at(at + 1));
        arguments.remove(at, 2);
    } else {
        store = qm::settingsstore::native();
    }

    qm::widgetprompts prompts;
    qm::mainfrm window(prompts, *store);
    prompts.setparent(&window);
    prompts.sethelp([&window](int topic, const QString& command) { qm::helpfrm::open(&window, topic, command); });
    qm::activationnotice activation;
    QObject::connect(&activation, &qm::activationnotice::activated, &window, &qm::mainfrm::checkonactivate);

    if (!window.start(arguments))
        return 0;
    window.showplaced();
    return app.exec();
}
