#pragma once
// About Quillmark: the version of this build, what the program is, whom it
// thanks, the GEDCOM disclaimer, and a button that starts the platform's
// system information tool.

#include "app/about.h"

#include <QDialog>

#include <functional>

namespace qm {

class prompts;

class aboutfrm : public QDialog {
    Q_OBJECT
public:
    // Starts a tool; false when it could not be started.
    using starter = std::function<bool(const systemtool&)>;

    explicit aboutfrm(prompts& asker, QWidget* parent = nullptr, systemlookup machine = systemlookup::here(),
                      starter start = {});

private:
    void systeminfo();

    prompts& asker_;
    systemlookup machine_;
    starter start_;
};

} // namespace qm
