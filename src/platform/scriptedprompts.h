#pragma once
// Prompts answered from a script, for tests: each expected message or dialog is
// queued with its answer before the action that shows it. Every prompt shown is
// recorded; one that was not expected is recorded as unexpected and answered
// with its default (Cancel for dialogs), so that a test can fail on it.

#include "platform/prompts.h"

#include <deque>
#include <functional>
#include <vector>

namespace qm {

class scriptedprompts : public prompts {
public:
    struct shown {
        message m;     // for dialogs: text holds the caption, title "dialog:<kind>"
        bool expected; // an answer was queued for it
    };

    // Queues the answer to the next message box. `contains`, when not empty,
    // must occur in its text, or the prompt counts as unexpected.
    void expect(answer a, const QString& contains = QString());
    // Queues the answer of the next file or folder dialog (nothing = cancel).
    void expectfile(std::optional<QString> path);
    void expectfiles(std::optional<QStringList> paths);
    // Runs f when the next message box is shown, before answering it.
    void onnext(std::function<void(const message&)> f);

    answer ask(const message& m) override;
    std::optional<QString> openfile(const QString& caption, const QString& folder, const QString& filter) override;
    std::optional<QStringList> openfiles(const QString& caption, const QString& folder,
                                         const QString& filter) override;
    std::optional<QString> savefile(const QString& caption, const QString& startpath, const QString& filter) override;
    std::optional<QString> choosefolder(const QString& caption, const QString& startfolder) override;
    void setbusy(bool on) override { busy += on ? 1 : -1; }
    void showhelp(int topic, const QString& command = QString()) override;
    QString openexternal(const QString& target) override;

    const std::vector<shown>& history() const { return history_; }
    // Texts of the messages shown, in order.
    QStringList texts() const;
    // Prompts shown without a queued answer, and answers queued but never used.
    int unexpected() const;
    int pending() const { return static_cast<int>(answers_.size() + files_.size()); }
    void clear();

    int busy = 0; // > 0 while the busy pointer is shown
    // Help pages asked for: the topic number, or the command ("Index", "Search").
    QStringList helpshown;
    // Files and addresses handed to the system, and the answer given to the
    // next ones ("" = opened).
    QStringList opened;
    QString openerror;

private:
    struct queued {
        answer a;
        QString contains;
        std::function<void(const message&)> before;
    };
    std::optional<QStringList> nextfiles(const QString& kind, const QString& caption);

    std::deque<queued> answers_;
    std::deque<std::optional<QStringList>> files_;
    std::function<void(const message&)> onnext_;
    std::vector<shown> history_;
};

} // namespace qm
