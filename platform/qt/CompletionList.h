#pragma once

#include "platform/TextControl.h"

#include <QListView>
#include <QStringListModel>

class QKeyEvent;
class QLineEdit;

/// The list of completions below a field. It never has the keyboard: the field hands it the keys that it has a use for,
/// and a click chooses without the field losing the keyboard. Nothing is chosen until an arrow key or a click does.
///
/// It closes when the field loses the keyboard, at a click elsewhere, and when its window moves.
class CompletionList final : public QListView {
public:
    using Find = std::function<std::vector<Completion>(const std::string& typed)>;
    using Choose = std::function<void(const Completion&)>;

    /// A child of `field`.
    CompletionList(QLineEdit& field, Find find, Choose choose);

    /// Shows what fits `typed`; closes when there is nothing.
    void offer(const std::string& typed);
    bool isOpen() const { return isVisible(); }
    /// Whether the key has done its work. Enter with nothing chosen closes the list and is the field's.
    bool takeKey(const QKeyEvent& event);
    /// Takes what is chosen, if anything is, and closes.
    /// @return whether there was something.
    bool takeChosen();

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;
    void showEvent(QShowEvent* event) override;
    void hideEvent(QHideEvent* event) override;

private:
    void place();
    void step(int rows);

    QLineEdit& field_;
    Find find_;
    Choose choose_;
    QStringListModel labels_;
    std::vector<Completion> found_; // a row each
};
