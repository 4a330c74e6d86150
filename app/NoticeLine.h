#pragma once

#include "app/Notice.h"
#include "platform/View.h"

#include <chrono>
#include <deque>
#include <memory>
#include <optional>

class BButton;
class BMessage;
class BMessageRunner;
class NoticeText;

/// The line of notices above the status line; hidden while there is none. It shows one, and the others wait behind it.
/// A click on it dismisses the one that is shown.
///
/// It never takes the keyboard: a person who types goes on typing when a notice comes or goes.
class NoticeLine final : public BView {
public:
    /// The code that its buttons send to the window, which hands the message back to `press`.
    static constexpr uint32 kPressed = 'NtBt';

    explicit NoticeLine(BRect frame);
    ~NoticeLine() override;

    /// A passing notice stands before the others until it goes; any other one waits for its turn. A remark of
    /// the second before is told behind it: how a number was read, behind what was booked by it.
    void show(Notice notice);
    /// Takes the notice of that key away, shown or waiting, if there is one.
    void drop(const std::string& key);
    /// Runs the button that `message` comes from, and takes its notice away before. Does nothing when that was no
    /// longer shown.
    void press(BMessage* message);

    /// Gives the notice keys: Alt+6, Alt+7 and Alt+8 press its buttons, Alt+0 dismisses it.
    void AttachedToWindow() override;
    void MessageReceived(BMessage* message) override;
    void Draw(BRect updateRect) override;
    void MouseDown(BPoint where) override;

private:
    /// Null without one.
    const Notice* front() const;
    /// Whether there is one, and it is the one on the screen: a key that is pressed while another one comes up is meant
    /// for what stood there before.
    bool isSeen() const { return front() != nullptr && seen_ == shown_; }
    void removeFront();
    /// Shows what stands in front now.
    void update();
    /// The buttons at the right, each as wide as its label. @return where the text has to end.
    float placeButtons(const Notice& notice);

    std::deque<Notice> waiting_; // the first one is shown unless `passing_` is
    std::optional<Notice> passing_;
    std::chrono::steady_clock::time_point passingSince_;
    std::unique_ptr<BMessageRunner> expiry_; // of `passing_`
    int32 shown_ = 0;                        // counts what was shown, so that a late press does not meet another notice
    int32 seen_ = 0;                         // the one of these that was drawn last
    NoticeText* text_ = nullptr;
    std::vector<BButton*> buttons_;
};
