#pragma once

#include "platform/TextControl.h"

#include <QLineEdit>

class CompletionList;
class FieldButton;

/// The field of a text control. It gives the control's `KeyDown` what it has no use for itself, and its list of
/// completions, where it has one, the keys that are for that.
class TextField final : public QLineEdit {
public:
    /// `view` outlives this.
    TextField(BView& view, QWidget& parent);

    void setCompletions(const std::function<std::vector<Completion>(const std::string&)>& find,
                        const std::function<void(const Completion&)>& choose);
    /// What the button, which there is from here on, and Alt+Down do.
    void setCalendar(const std::function<void()>& open);

    bool event(QEvent* event) override;

protected:
    void keyPressEvent(QKeyEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;

private:
    bool isListOpen() const;

    BView& view_;
    FieldButton* calendar_ = nullptr; // a child
    std::function<void()> makeList_;
    CompletionList* list_ = nullptr; // a child
};
