#pragma once
// The donation window: after a milestone of saved census entries (the
// "Milestone" form, which tells the count) or when the user asks to donate
// ("Would you like to make a donation?"). Two buttons open the donation pages
// in the web browser.

#include <QDialog>

#include <cstdint>
#include <optional>

namespace qm {

class prompts;

// The addresses of the donation pages.
QString donationpage();        // a single donation
QString regulardonationpage(); // a regular donation

class donatefrm : public QDialog {
    Q_OBJECT
public:
    // `milestone`: the saved-entries count reached, for the milestone form;
    // nothing for the asking form.
    donatefrm(prompts& opener, std::optional<int64_t> milestone, QWidget* parent = nullptr);

private:
    prompts& opener_;
};

} // namespace qm
